// StatusText: the texts of the status bar's pointer and zoom parts. Pure
// functions, tested with plain numbers.
#pragma once

#include "DrawingUnits.h"

#include <cmath>
#include <cstdio>
#include <string>

namespace StatusText {

// "x 12.5   y -3.25": a position in drawing units, written to decimals places.
inline std::string Pointer(double x, double y, int decimals)
{
    return "x " + DrawingUnitsText::Fixed(x, decimals) + "   y " + DrawingUnitsText::Fixed(y, decimals);
}

// "Zoom level 7.5 (2.83x)": the drawing window's zoom level and how much
// larger than the fitted drawing the view shows it, for levelsPerDoubling
// levels per doubling of the scale.
inline std::string Zoom(double level, int levelsPerDoubling)
{
    const double magnification = std::pow(2.0, level / (levelsPerDoubling > 0 ? levelsPerDoubling : 1));
    const bool whole = std::abs(level - std::round(level)) < 0.05;
    char levelText[32];
    std::snprintf(levelText, sizeof levelText, whole ? "%.0f" : "%.1f", level);
    // Three digits, and whole numbers once those need more.
    char times[32];
    std::snprintf(times, sizeof times, magnification < 100.0 ? "%.3g" : "%.0f", magnification);
    return std::string("Zoom level ") + levelText + " (" + times + "x)";
}

} // namespace StatusText
