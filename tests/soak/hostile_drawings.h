// Drawings that no sensible application makes but a presentation library
// still has to show: coordinates at the ends of the int range, rectangles of
// no size or turned inside out, nothing at all, one point, a crowd of items on
// one spot, text of absurd height. The soak binds them among ordinary ones;
// the hostile-input tests draw, zoom, click and print each.
#pragma once

#include "Tavo_GrDrawing.h"

#include <climits>
#include <memory>

namespace Hostile {

// Palette indices the drawings use.
constexpr char Blue = 1;
constexpr char Red = 4;
constexpr char White = 7;

enum Kind {
    Empty,      // no items
    OnePoint,   // one dot at Point
    FullRange,  // a red filled rectangle over the whole int range, a white one around the origin
    Corners,    // red squares at the two ends of the int range, blue ones just inside
    Degenerate, // rectangles, lines, circles, triangles of no size, and inverted rectangles
    Crowd,      // crowd red items of every kind, filled and hollow, all on CrowdPoint
    AbsurdText, // text up to INT_MAX world units high, a text box as high as the range, a long line
    KindCount
};

const char* NameOf(Kind kind);

constexpr Tavo_GrWPoint Point{-1234567, 7654321};
// Around the origin of FullRange, red elsewhere.
constexpr Tavo_GrWRect Middle{-1000, -1000, 1000, 1000};
// The squares of Corners: a red square at each end, 1000 units wide, a blue
// one beside it, 1000 units further in.
constexpr Tavo_GrWRect LowCorner{INT_MIN, INT_MIN, INT_MIN + 1000, INT_MIN + 1000};
constexpr Tavo_GrWRect HighCorner{INT_MAX - 1000, INT_MAX - 1000, INT_MAX, INT_MAX};
constexpr Tavo_GrWRect LowInside{INT_MIN + 2000, INT_MIN + 2000, INT_MIN + 3000, INT_MIN + 3000};
constexpr Tavo_GrWRect HighInside{INT_MAX - 3000, INT_MAX - 3000, INT_MAX - 2000, INT_MAX - 2000};
constexpr Tavo_GrWPoint CrowdPoint{150, 150};
// The crowd of the hostile-input tests; the soak binds a smaller one, as it
// paints it thousands of times.
constexpr int MillionItems = 1000000;

// A new drawing of the kind; crowd is the number of items of Crowd.
std::unique_ptr<Tavo_GrDrawing> Build(Kind kind, int crowd = MillionItems);
// A drawing of count red filled rectangles stacked on `box`: at a zoom that
// makes the box fill the view, a pass long enough to be interrupted.
std::unique_ptr<Tavo_GrDrawing> BuildStack(const Tavo_GrWRect& box, int count);

} // namespace Hostile
