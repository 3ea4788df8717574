// Integer arithmetic of the rendering surface that must not overflow.
//
// The graphics core hands the surface 32-bit device coordinates; flipping y or
// adding an edge offset to a coordinate near the end of the int range would
// overflow. These helpers compute in 64 bits and saturate into int range, so
// an extreme coordinate stays far off the surface instead of wrapping onto it.
#pragma once

#include <climits>

namespace Tavo_WiSurfaceMath {

inline int Saturate(long long value)
{
    if (value > INT_MAX)
        return INT_MAX;
    if (value < INT_MIN)
        return INT_MIN;
    return static_cast<int>(value);
}

inline int Add(int a, int b)
{
    return Saturate(static_cast<long long>(a) + b);
}

inline int Subtract(int a, int b)
{
    return Saturate(static_cast<long long>(a) - b);
}

} // namespace Tavo_WiSurfaceMath
