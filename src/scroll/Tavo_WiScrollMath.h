// The arithmetic of the scroll model, kept apart from the windows so that it
// can be checked on its own.
//
// Scroll units are the caller's (world units for the drawing window); bar
// units are what a scroll bar holds, at most MaxBarRange of them across a
// range. Every conversion from double saturates into int range, and every
// sum of two ints is formed in 64 bits first, so extreme ranges and
// positions clamp instead of wrapping.
#pragma once

#include "Tavo_GrRound.h"
#include "Tavo_WiScroll.h"

#include <climits>

namespace Tavo_WiScrollMath {

using Tavo_WiScroll::MaxBarRange;

// The width given to a requested range that is empty or reversed.
constexpr int DefaultRangeWidth = 100;

// R(v, s): a scroll-unit value in bar units of scale s, rounded outwards (away
// from zero) unless the quotient is already (nearly) whole, so that a bar
// range always covers the scroll-unit range it stands for.
inline int ToBarUnits(int value, double scale)
{
    const double quotient = value / scale;
    return Tavo_GrTruncate(value > 0 ? quotient + 0.999999 : quotient - 0.999999);
}

// A bar-unit value in scroll units again.
inline int ToScrollUnits(int barValue, double scale)
{
    return Tavo_GrTruncate(barValue * scale);
}

// The effective maximum of a requested range: a range that is empty or
// reversed becomes DefaultRangeWidth wide.
inline int EffectiveMaximum(int minimum, int maximum)
{
    return minimum < maximum ? maximum : Tavo_GrAdd(minimum, DefaultRangeWidth);
}

// Scroll units per bar unit for a range, never below 1.
inline double ScaleFor(int minimum, int effectiveMaximum)
{
    const double scale =
        (static_cast<double>(effectiveMaximum) - static_cast<double>(minimum)) / MaxBarRange;
    return scale < 1.0 ? 1.0 : scale;
}

// Clamps one coordinate of the window's leading edge into [low, high]; the
// upper bound is applied last, so it wins when the window is larger than the
// range.
inline int Clamp(int value, long long low, long long high)
{
    long long v = value;
    if (v < low)
        v = low;
    if (v > high)
        v = high;
    return Tavo_GrSaturate(v);
}

// A step of percent of extent, truncated (the horizontal percentage).
inline long long TruncatedPercentOf(int extent, unsigned int percent)
{
    return static_cast<long long>(extent) * percent / 100;
}

// A step of percent of extent in the direction sign, the nearest integer,
// halves away from zero (the vertical percentage).
inline int RoundedPercentOf(int extent, unsigned int percent, int sign)
{
    return Tavo_GrRound(sign * static_cast<double>(percent) * extent / 100.0);
}

} // namespace Tavo_WiScrollMath
