// The numeric rules of the graphics library family, one place for each:
//
// - Tavo_GrRound: a double becomes an int by rounding half away from zero
//   (add 0.5, or subtract 0.5 when negative, then truncate);
// - Tavo_GrTruncate: a double becomes an int by truncation toward zero;
// - Tavo_GrSaturate, Tavo_GrAdd, Tavo_GrSubtract: int arithmetic formed in
//   64 bits.
//
// Every result is saturated into the int range, so that a huge zoom, a
// far-away world coordinate or an extreme device coordinate clamps instead of
// wrapping onto the visible area. NaN gives 0.
#pragma once

#include <climits>

inline int Tavo_GrSaturate(long long value)
{
    if (value > INT_MAX)
        return INT_MAX;
    if (value < INT_MIN)
        return INT_MIN;
    return static_cast<int>(value);
}

inline int Tavo_GrAdd(int a, long long b)
{
    return Tavo_GrSaturate(static_cast<long long>(a) + b);
}

inline int Tavo_GrSubtract(int a, long long b)
{
    return Tavo_GrSaturate(static_cast<long long>(a) - b);
}

inline int Tavo_GrTruncate(double value)
{
    if (!(value == value)) // NaN
        return 0;
    if (value >= static_cast<double>(INT_MAX))
        return INT_MAX;
    if (value <= static_cast<double>(INT_MIN))
        return INT_MIN;
    return static_cast<int>(value);
}

inline int Tavo_GrRound(double value)
{
    return Tavo_GrTruncate(value < 0.0 ? value - 0.5 : value + 0.5);
}
