// Colours of DXF drawings.
//
// Classes: Tavo_DxfRgb (a colour value), Tavo_DxfColourResolver (turns colour
// values into palette indices; the caller's side of the importer).
//
// DXF names colours by AutoCAD Colour Index (ACI): 1 ... 255 index a fixed
// table, 0 is "by block" and 256 "by layer"; entities may also carry a 24-bit
// true colour. The importer turns both into RGB values and asks the resolver,
// once per distinct value, which palette index to draw it with. The resolver
// keeps the importer free of any particular palette: Tavo_DxfPaletteColours
// (Tavo_DxfPaletteColours.h) serves the library's palette.
#pragma once

#include <cstdint>

struct Tavo_DxfRgb {
    uint8_t red = 0;
    uint8_t green = 0;
    uint8_t blue = 0;

    bool operator==(const Tavo_DxfRgb& other) const
    {
        return red == other.red && green == other.green && blue == other.blue;
    }
    bool operator!=(const Tavo_DxfRgb& other) const { return !(*this == other); }
    uint32_t Packed() const { return (uint32_t(red) << 16) | (uint32_t(green) << 8) | blue; }
    static Tavo_DxfRgb FromPacked(uint32_t value)
    {
        return {uint8_t(value >> 16), uint8_t(value >> 8), uint8_t(value)};
    }
};

class Tavo_DxfColourResolver {
public:
    virtual ~Tavo_DxfColourResolver() = default;
    // The palette index (Tavo_GrAttr's colour) to draw this colour with.
    virtual char ColourIndexOf(const Tavo_DxfRgb& colour) = 0;
};

// ACI 1 ... 255 as RGB; other numbers (0 by block, 256 by layer, negative for
// a layer that is switched off) give the colour of their absolute value, and 0
// and 256 black.
Tavo_DxfRgb Tavo_DxfAciColour(int aci);

// The ACI that stands for "the foreground": white on a dark screen, black on
// paper.
constexpr int kTavo_DxfAciForeground = 7;

// Squared distance of two colours, weighted for the eye (red 2, green 4, blue
// 3), the measure "nearest colour" uses.
int Tavo_DxfColourDistance(const Tavo_DxfRgb& a, const Tavo_DxfRgb& b);

// Index of the candidate nearest to colour (the first of equally near ones);
// -1 when count is 0.
int Tavo_DxfNearestColour(const Tavo_DxfRgb& colour, const Tavo_DxfRgb* candidates, int count);
