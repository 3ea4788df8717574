// The arithmetic of the drawing window's view, kept apart from the window so
// that it can be checked with plain numbers: world rectangles, the scroll
// range around drawing and view, device and world deltas with their rounding
// error, and the aperture of a point.
//
// S is the scale, device pixels per world unit, always above 0 in a mapping.
// Every int result saturates (Tavo_GrRound.h); a scale that is not above 0 or
// not finite gives the zero result instead of a division by it.
#pragma once

#include "Tavo_GrRound.h"
#include "Tavo_GrTypes.h"

#include <algorithm>
#include <climits>
#include <cmath>

namespace Tavo_WiViewMath {

inline bool IsUsableScale(double scale)
{
    return scale > 0.0 && std::isfinite(scale);
}

// Width and height of a world rectangle, formed in 64 bits.
inline long long Width(const Tavo_GrWRect& r)
{
    return static_cast<long long>(r.x2) - r.x1;
}
inline long long Height(const Tavo_GrWRect& r)
{
    return static_cast<long long>(r.y2) - r.y1;
}

// The centre of a world rectangle, halves truncated toward zero.
inline Tavo_GrWPoint Centre(const Tavo_GrWRect& r)
{
    return {Tavo_GrAdd(r.x1, Width(r) / 2), Tavo_GrAdd(r.y1, Height(r) / 2)};
}

inline Tavo_GrWRect Union(const Tavo_GrWRect& a, const Tavo_GrWRect& b)
{
    return {std::min(a.x1, b.x1), std::min(a.y1, b.y1), std::max(a.x2, b.x2), std::max(a.y2, b.y2)};
}

// The length of one side of a view `pixels` device pixels long, its corners
// low and high: high - low, except where the view reaches beyond the int
// range and a corner is cut at its end; then the view's own length, pixels /
// S rounded, as far as an int holds it.
inline long long ViewSideLength(int low, int high, int pixels, double scale)
{
    if (low != INT_MIN && high != INT_MAX)
        return std::max(0LL, static_cast<long long>(high) - low);
    if (pixels <= 0 || !IsUsableScale(scale))
        return 0;
    return std::min(std::floor(pixels / scale + 0.5), static_cast<double>(INT_MAX));
}

inline Tavo_GrWRect Offset(const Tavo_GrWRect& r, long long dx, long long dy)
{
    return {Tavo_GrAdd(r.x1, dx), Tavo_GrAdd(r.y1, dy), Tavo_GrAdd(r.x2, dx), Tavo_GrAdd(r.y2, dy)};
}

// The scroll range of a view, as xMin, xMax, yMin, yMax.
struct ScrollRange {
    int xMin = 0;
    int xMax = 0;
    int yMin = 0;
    int yMax = 0;
};

// The scroll range for drawing bounds B and the visible rectangle V.
// Zoomed in, the range is the union of both with a margin of m = the world
// length of 100 pixels on the left and right, 3m/2 below and m/2 above, so
// the drawing can be scrolled a little past its edges. At the zero level the
// view stands at the top-left corner of the range: its left and top come
// from V alone; and the range is no wider or higher than INT_MAX, the most a
// scroll extent holds, so that a view wider than that (the whole int range
// and more) cannot be scrolled at the zero level either.
inline ScrollRange ScrollRangeFor(const Tavo_GrWRect& bounds, const Tavo_GrWRect& visible, double scale,
                                  bool zoomedIn)
{
    const Tavo_GrWRect u = Union(bounds, visible);
    if (!zoomedIn) {
        const long long width = std::min<long long>(static_cast<long long>(u.x2) - visible.x1, INT_MAX);
        const long long height = std::min<long long>(static_cast<long long>(visible.y2) - u.y1, INT_MAX);
        return {visible.x1, Tavo_GrAdd(visible.x1, width), Tavo_GrSubtract(visible.y2, height), visible.y2};
    }
    const long long m = IsUsableScale(scale) ? Tavo_GrRound(100.0 / scale) : 0;
    return {Tavo_GrSubtract(u.x1, m), Tavo_GrAdd(u.x2, m), Tavo_GrSubtract(u.y1, (3 * m) / 2),
            Tavo_GrAdd(u.y2, m / 2)};
}

// A world delta in device pixels, rounded, with what the rounding left over
// (rounded minus exact), which the mapping keeps as its error term.
struct DeviceDelta {
    int pixels = 0;
    double error = 0.0;
};

inline DeviceDelta ToDeviceDelta(long long worldDelta, double scale)
{
    if (worldDelta == 0 || !(scale > 0.0))
        return {};
    const double exact = static_cast<double>(worldDelta) * scale;
    const int pixels = Tavo_GrRound(exact);
    // A move beyond the int range uncovers the whole view: no moved pixel
    // stays to line up with, so no error is kept (it could not be measured
    // in int pixels anyway).
    if (!(std::fabs(exact) < static_cast<double>(INT_MAX)))
        return {pixels, 0.0};
    return {pixels, pixels - exact};
}

// A device delta in world units: 0 stays 0, anything else moves at least one
// unit in its own direction, so that a small device movement still moves the
// view.
inline int ToWorldStep(int deviceDelta, double scale)
{
    if (deviceDelta == 0 || !IsUsableScale(scale))
        return 0;
    const int magnitude = std::max(1, Tavo_GrRound(std::fabs(static_cast<double>(deviceDelta)) / scale));
    return deviceDelta < 0 ? -magnitude : magnitude;
}

// Half the width of an aperture: the world length of two pixels, rounded
// (0 once a world unit is wider than four pixels).
inline int ApertureHalfWidth(double scale)
{
    return IsUsableScale(scale) ? Tavo_GrRound(2.0 / scale) : 0;
}

inline Tavo_GrWRect Aperture(const Tavo_GrWPoint& p, double scale)
{
    const int a = ApertureHalfWidth(scale);
    return {Tavo_GrSubtract(p.x, a), Tavo_GrSubtract(p.y, a), Tavo_GrAdd(p.x, a), Tavo_GrAdd(p.y, a)};
}

// A pan drag step on one axis: the pointer's movement from the reference in
// percent of the window's size, rounded, in the pan direction. 0 for a window
// of no size.
inline int PanStepPercent(int reference, int pointer, int size, int direction)
{
    if (size <= 0)
        return 0;
    const double percent = (static_cast<double>(reference) - pointer) * 100.0 / size;
    return Tavo_GrSaturate(static_cast<long long>(Tavo_GrRound(percent)) * direction);
}

// An autoscroll step in percent for a pointer at position on an axis of the
// given size: 0 inside [0, size]; beyond it the square of the overshoot
// relative to the size, times 1000, truncated, and at least 1. 0 for a window
// of no size.
inline int AutoScrollPercent(int position, int size)
{
    if (size <= 0)
        return 0;
    long long overshoot = 0;
    if (position < 0)
        overshoot = -static_cast<long long>(position);
    else if (position > size)
        overshoot = static_cast<long long>(position) - size;
    else
        return 0;
    const double ratio = static_cast<double>(overshoot) * 10.0 / size;
    return std::max(1, Tavo_GrTruncate(ratio * ratio * 10.0));
}

} // namespace Tavo_WiViewMath
