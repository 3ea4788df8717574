// Tavo_DxfPaletteColours: gives DXF colours palette indices of the library's
// palette (Tavo_WiPalette).
//
// A colour within kNearEnough of one of the sixteen built-in named colours
// takes that colour (ACI 1 ... 6 are exactly red, yellow, green, cyan, blue and
// magenta); any other is added to the palette by value (or found there, when
// an equal one was added before) under the name "dxf RRGGBB". When the palette
// is full (128 entries), the nearest colour it holds is used.
#pragma once

#include "Tavo_DxfColours.h"

class Tavo_WiPalette;

class Tavo_DxfPaletteColours : public Tavo_DxfColourResolver {
public:
    // Weighted squared distance (Tavo_DxfColourDistance) within which a
    // built-in colour stands for a DXF colour: about 8 steps of 255 on each
    // component.
    static constexpr int kNearEnough = 9 * 8 * 8;
    static constexpr int kBuiltInColours = 16;

    // palette: not owned; it must outlive this object.
    explicit Tavo_DxfPaletteColours(Tavo_WiPalette& palette) : m_palette(palette) {}

    char ColourIndexOf(const Tavo_DxfRgb& colour) override;

private:
    Tavo_WiPalette& m_palette;
};
