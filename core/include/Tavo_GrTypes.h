// Value types of the graphics core: device and world points and rectangles.
//
//   Tavo_GrDPoint, Tavo_GrDRect   device pixels, origin at the bottom-left
//                                 corner of the device window, y up
//   Tavo_GrWPoint, Tavo_GrWRect   world units of a drawing, y up
//
// All coordinates are 32-bit signed integers. A rectangle is normalised when
// its minimum is not above its maximum on both axes; the core always hands out
// normalised rectangles. Both corners belong to a rectangle (a device rectangle
// with xmin == xmax covers one column of pixels).
#pragma once

struct Tavo_GrDPoint {
    int x = 0;
    int y = 0;
};

struct Tavo_GrDRect {
    int xmin = 0;
    int ymin = 0;
    int xmax = 0;
    int ymax = 0;
};

struct Tavo_GrWPoint {
    int x = 0;
    int y = 0;
};

struct Tavo_GrWRect {
    int x1 = 0; // xmin
    int y1 = 0; // ymin
    int x2 = 0; // xmax
    int y2 = 0; // ymax
};

inline bool operator==(const Tavo_GrDPoint& a, const Tavo_GrDPoint& b) { return a.x == b.x && a.y == b.y; }
inline bool operator!=(const Tavo_GrDPoint& a, const Tavo_GrDPoint& b) { return !(a == b); }
inline bool operator==(const Tavo_GrWPoint& a, const Tavo_GrWPoint& b) { return a.x == b.x && a.y == b.y; }
inline bool operator!=(const Tavo_GrWPoint& a, const Tavo_GrWPoint& b) { return !(a == b); }

inline bool operator==(const Tavo_GrDRect& a, const Tavo_GrDRect& b)
{
    return a.xmin == b.xmin && a.ymin == b.ymin && a.xmax == b.xmax && a.ymax == b.ymax;
}
inline bool operator!=(const Tavo_GrDRect& a, const Tavo_GrDRect& b) { return !(a == b); }

inline bool operator==(const Tavo_GrWRect& a, const Tavo_GrWRect& b)
{
    return a.x1 == b.x1 && a.y1 == b.y1 && a.x2 == b.x2 && a.y2 == b.y2;
}
inline bool operator!=(const Tavo_GrWRect& a, const Tavo_GrWRect& b) { return !(a == b); }

// Whether two normalised world rectangles share at least one point (touching
// edges count).
inline bool Tavo_GrIntersects(const Tavo_GrWRect& a, const Tavo_GrWRect& b)
{
    return a.x1 <= b.x2 && b.x1 <= a.x2 && a.y1 <= b.y2 && b.y1 <= a.y2;
}
