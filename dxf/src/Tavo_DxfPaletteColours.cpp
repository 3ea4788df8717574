// Tavo_DxfPaletteColours: DXF colours onto the library's palette.
#include "Tavo_DxfPaletteColours.h"

#include "Tavo_WiPalette.h"

#include <cstdio>
#include <vector>

namespace {

Tavo_DxfRgb EntryColour(const Tavo_WiPalette& palette, int index)
{
    const DWORD value = palette.GetWin32Color(static_cast<char>(index), false);
    return {GetRValue(value), GetGValue(value), GetBValue(value)};
}

} // namespace

char Tavo_DxfPaletteColours::ColourIndexOf(const Tavo_DxfRgb& colour)
{
    const int count = m_palette.GetColorCount();
    const int builtIn = count < kBuiltInColours ? count : kBuiltInColours;
    std::vector<Tavo_DxfRgb> entries;
    entries.reserve(count);
    for (int i = 0; i < count; ++i)
        entries.push_back(EntryColour(m_palette, i));

    const int nearestBuiltIn = Tavo_DxfNearestColour(colour, entries.data(), builtIn);
    if (nearestBuiltIn >= 0 && Tavo_DxfColourDistance(colour, entries[nearestBuiltIn]) <= kNearEnough)
        return static_cast<char>(nearestBuiltIn);

    char name[16];
    std::snprintf(name, sizeof name, "dxf %02X%02X%02X", colour.red, colour.green, colour.blue);
    const char added = m_palette.AddColor(name, colour.red, colour.green, colour.blue);
    if (added != Tavo_WiPalette::kNotFound)
        return added;
    const int nearest = Tavo_DxfNearestColour(colour, entries.data(), count);
    return static_cast<char>(nearest < 0 ? 0 : nearest);
}
