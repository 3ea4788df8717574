// Tavo_GrRound: the one rounding rule of the graphics library family.
//
// A double becomes an int by rounding half away from zero (add 0.5, or
// subtract 0.5 when negative, then truncate), saturated into the int range so
// that a huge zoom or a far-away world coordinate never overflows. NaN gives 0.
#pragma once

#include <climits>

inline int Tavo_GrRound(double value)
{
    if (!(value == value)) // NaN
        return 0;
    if (value >= static_cast<double>(INT_MAX))
        return INT_MAX;
    if (value <= static_cast<double>(INT_MIN))
        return INT_MIN;
    return static_cast<int>(value < 0.0 ? value - 0.5 : value + 0.5);
}
