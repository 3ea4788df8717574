// Tavo_GrHitTest: whether the shape of an item meets a world rectangle, for
// Tavo_GrDrawing::FindItems. Pure functions of world points; the arithmetic
// runs in doubles, which hold every int coordinate and every product of two
// exactly enough, so no coordinate near the int range's ends overflows.
//
// Rectangles are normalised and closed: touching counts as meeting.
#pragma once

#include "Tavo_GrTypes.h"

#include <algorithm>
#include <cmath>

namespace Tavo_GrHitTest {

inline bool Contains(const Tavo_GrWRect& r, double x, double y)
{
    return r.x1 <= x && x <= r.x2 && r.y1 <= y && y <= r.y2;
}

// The segment from a to b meets r: the part of the segment's parameter range
// inside each slab of r (Liang-Barsky) is not empty.
inline bool SegmentMeets(const Tavo_GrWPoint& a, const Tavo_GrWPoint& b, const Tavo_GrWRect& r)
{
    double t0 = 0.0;
    double t1 = 1.0;
    const double d[2] = {static_cast<double>(b.x) - a.x, static_cast<double>(b.y) - a.y};
    const double start[2] = {static_cast<double>(a.x), static_cast<double>(a.y)};
    const double low[2] = {static_cast<double>(r.x1), static_cast<double>(r.y1)};
    const double high[2] = {static_cast<double>(r.x2), static_cast<double>(r.y2)};
    for (int axis = 0; axis < 2; ++axis) {
        if (d[axis] == 0.0) {
            if (start[axis] < low[axis] || start[axis] > high[axis])
                return false;
            continue;
        }
        double enter = (low[axis] - start[axis]) / d[axis];
        double leave = (high[axis] - start[axis]) / d[axis];
        if (enter > leave)
            std::swap(enter, leave);
        t0 = std::max(t0, enter);
        t1 = std::min(t1, leave);
        if (t0 > t1)
            return false;
    }
    return true;
}

// The chain of count points meets r; closed: the last point joins the first.
inline bool ChainMeets(const Tavo_GrWPoint* points, int count, bool closed, const Tavo_GrWRect& r)
{
    if (count <= 0)
        return false;
    if (count == 1)
        return Contains(r, points[0].x, points[0].y);
    for (int i = 1; i < count; ++i)
        if (SegmentMeets(points[i - 1], points[i], r))
            return true;
    return closed && SegmentMeets(points[count - 1], points[0], r);
}

// Whether (x, y) lies inside the polygon by the even-odd rule, GDI's default
// fill mode (ALTERNATE), with which the surface fills polygons.
inline bool PolygonContains(const Tavo_GrWPoint* points, int count, double x, double y)
{
    bool inside = false;
    for (int i = 0, j = count - 1; i < count; j = i++) {
        const double yi = points[i].y;
        const double yj = points[j].y;
        if ((yi > y) == (yj > y))
            continue;
        const double crossX = points[i].x + (y - yi) * (static_cast<double>(points[j].x) - points[i].x) / (yj - yi);
        if (x < crossX)
            inside = !inside;
    }
    return inside;
}

// A polygon meets r when its outline does, or, with filled, when r lies
// inside it: if no edge crosses r, r is wholly inside or wholly outside, so
// its centre decides.
inline bool PolygonMeets(const Tavo_GrWPoint* points, int count, bool filled, const Tavo_GrWRect& r)
{
    if (ChainMeets(points, count, true, r))
        return true;
    return filled && count >= 3 && PolygonContains(points, count, (static_cast<double>(r.x1) + r.x2) / 2, (static_cast<double>(r.y1) + r.y2) / 2);
}

// A circle meets r when its rim passes through r (the nearest point of r is
// not outside the circle and the farthest not inside it), or, with filled,
// when the nearest point of r is not outside it.
inline bool CircleMeets(const Tavo_GrWPoint& centre, int radius, bool filled, const Tavo_GrWRect& r)
{
    const double cx = centre.x;
    const double cy = centre.y;
    const double nearX = std::clamp(cx, static_cast<double>(r.x1), static_cast<double>(r.x2)) - cx;
    const double nearY = std::clamp(cy, static_cast<double>(r.y1), static_cast<double>(r.y2)) - cy;
    const double farX = std::max(std::abs(r.x1 - cx), std::abs(r.x2 - cx));
    const double farY = std::max(std::abs(r.y1 - cy), std::abs(r.y2 - cy));
    const double rr = static_cast<double>(std::max(radius, 0)) * std::max(radius, 0);
    const double nearest = nearX * nearX + nearY * nearY;
    if (nearest > rr)
        return false;
    return filled || farX * farX + farY * farY >= rr;
}

// A rectangle item meets r with its outline, or anywhere when filled.
inline bool RectMeets(const Tavo_GrWRect& item, bool filled, const Tavo_GrWRect& r)
{
    if (filled)
        return Tavo_GrIntersects(item, r);
    const Tavo_GrWPoint corners[4] = {{item.x1, item.y1}, {item.x2, item.y1}, {item.x2, item.y2}, {item.x1, item.y2}};
    return ChainMeets(corners, 4, true, r);
}

} // namespace Tavo_GrHitTest
