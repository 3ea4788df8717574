// DrawingUnits: how a drawing's world units relate to the units of the file
// it came from, and how the viewer writes lengths and positions in them.
// Pure functions, tested with plain numbers.
//
// world = (drawing - origin) * scale on both axes; the built-in sample is
// drawn in drawing units (scale 1, origin 0), an imported drawing in a finer
// world.
#pragma once

#include <algorithm>
#include <cmath>
#include <cstdio>
#include <cstdlib>
#include <string>

struct DrawingUnits {
    double scale = 1.0;   // world units per drawing unit, positive
    double originX = 0.0; // the drawing point at world (0, 0)
    double originY = 0.0;

    double ToDrawingX(double worldX) const { return worldX / scale + originX; }
    double ToDrawingY(double worldY) const { return worldY / scale + originY; }
    double ToDrawingLength(double worldLength) const { return worldLength / scale; }
};

namespace DrawingUnitsText {

// The most decimals a position is written with.
constexpr int MaxDecimals = 6;

// Decimals enough to tell apart two positions one screen pixel apart, for
// pixelsPerDrawingUnit screen pixels per drawing unit: 0 while a pixel spans
// a whole unit or more, one more for each tenfold below that.
inline int DecimalsForPixel(double pixelsPerDrawingUnit)
{
    if (!(pixelsPerDrawingUnit > 1.0))
        return 0;
    const double decimals = std::ceil(std::log10(pixelsPerDrawingUnit));
    return static_cast<int>(std::clamp(decimals, 0.0, static_cast<double>(MaxDecimals)));
}

inline std::string Fixed(double value, int decimals)
{
    char text[64];
    // -0.00 reads as 0.00.
    const double shown = value == 0.0 ? 0.0 : value;
    std::snprintf(text, sizeof text, "%.*f", decimals, shown);
    if (text[0] == '-' && std::strtod(text, nullptr) == 0.0)
        return text + 1;
    return text;
}

// A length to five significant digits: "1200", "12.5", "0.0004".
inline std::string Length(double value)
{
    char text[64];
    std::snprintf(text, sizeof text, "%.5g", value);
    return text;
}

} // namespace DrawingUnitsText
