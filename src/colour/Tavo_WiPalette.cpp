// Tavo_WiPalette: the built-in colours, name lookup, colour values and adding
// colours.
#include "Tavo_WiPalette.h"

namespace {

// A built-in colour. The table ends with a row whose name is null.
struct BuiltInColor {
    const char* name; // user name and internal name alike
    unsigned char red, green, blue;
    DWORD win32PaletteValue; // 0 with flags 1: none
    char textColor;
    unsigned char flags;
};

// The palette indices are those of the Windows default system palette (its
// first ten and last ten slots).
constexpr BuiltInColor kBuiltInColors[] = {
    {"black", 0, 0, 0, 0x01000000, 7, 3},
    {"blue", 0, 0, 255, 0x010000FC, 7, 3},
    {"green", 0, 255, 0, 0x010000FA, 0, 3},
    {"cyan", 0, 255, 255, 0x010000FE, 0, 3},
    {"red", 255, 0, 0, 0x010000F9, 7, 3},
    {"magenta", 255, 0, 255, 0x010000FD, 0, 3},
    {"yellow", 255, 255, 0, 0x010000FB, 0, 3},
    {"white", 255, 255, 255, 0x010000FF, 0, 3},
    {"gray", 160, 160, 164, 0x010000F7, 0, 3},
    {"dark_gray", 75, 75, 75, 0, 7, 1},
    {"dark_blue", 0, 0, 128, 0x01000004, 7, 3},
    {"dark_green", 0, 128, 0, 0, 7, 1},
    {"dark_cyan", 0, 128, 128, 0x01000006, 7, 3},
    {"dark_red", 128, 0, 0, 0x01000001, 7, 3},
    {"dark_magenta", 128, 0, 128, 0x01000005, 7, 3},
    {"olive", 80, 100, 40, 0, 7, 1},
    {nullptr, 0, 0, 0, 0, 0, 0},
};

DWORD RgbOf(const Tavo_WiPaletteEntry& entry)
{
    return static_cast<DWORD>(entry.m_red) | (static_cast<DWORD>(entry.m_green) << 8) | (static_cast<DWORD>(entry.m_blue) << 16);
}

// The luminance of a colour as a grey: green, red and blue weighted and added
// in this order in double precision, then truncated.
DWORD GreyOf(const Tavo_WiPaletteEntry& entry)
{
    double luminance = entry.m_green * 0.59;
    luminance += entry.m_red * 0.3;
    luminance += entry.m_blue * 0.11;
    const DWORD level = static_cast<DWORD>(luminance);
    return level | (level << 8) | (level << 16);
}

} // namespace

Tavo_WiPalette::Tavo_WiPalette() : m_entries(new DARRAY_Tavo_WiPaletteEntryPointer(&m_entryStorage))
{
    for (const BuiltInColor* row = kBuiltInColors; row->name; ++row) {
        auto* entry = new Tavo_WiPaletteEntry(row->name, row->red, row->green, row->blue);
        entry->m_textColor = row->textColor;
        entry->m_win32PaletteValue = row->win32PaletteValue;
        entry->m_flags = row->flags;
        Append(entry);
    }
}

Tavo_WiPalette::~Tavo_WiPalette()
{
    const int count = m_entries->getnum();
    for (int i = 0; i < count; ++i)
        delete m_entryStorage[i];
    m_entries->a_resetnum(0);
    delete m_entries;
}

// ---- Overridables ---------------------------------------------------------------

const char* Tavo_WiPalette::GetClassName() const
{
    return "Tavo_WiPalette";
}

int Tavo_WiPalette::GetColorCount() const
{
    return m_entries->getnum();
}

char Tavo_WiPalette::GetColor(int index, char defaultColor) const
{
    return index >= 0 && index < GetColorCount() ? static_cast<char>(index) : defaultColor;
}

char Tavo_WiPalette::GetUserNamedColor(const char* name, char defaultColor) const
{
    if (!name)
        return defaultColor;
    if (UT_STR::ICompare(name, "grey") == 0)
        name = "gray";
    if (UT_STR::ICompare(name, "default") == 0)
        return kDefault;
    if (UT_STR::ICompare(name, "inherit") == 0)
        return kInherit;
    if (UT_STR::ICompare(name, "transparent") == 0)
        return kTransparent;

    const int count = GetColorCount();
    for (int i = 0; i < count; ++i) {
        if (CompareColorNames(m_entryStorage[i]->m_userName, name) == 0)
            return static_cast<char>(i);
    }
    return defaultColor;
}

const char* Tavo_WiPalette::GetColorUserName(char index)
{
    switch (index) {
    case kTransparent: return "transparent";
    case kInherit: return "inherit";
    case kDefault: return "default";
    case kNoColorIndex: return "no color";
    default: break;
    }
    const Tavo_WiPaletteEntry* entry = EntryAt(index);
    return entry ? entry->m_userName : nullptr;
}

// ---- Names --------------------------------------------------------------------

char Tavo_WiPalette::GetInternalNamedColor(const char* name, char defaultColor) const
{
    if (!name)
        return defaultColor;
    const int count = GetColorCount();
    for (int i = 0; i < count; ++i) {
        if (CompareColorNames(m_entryStorage[i]->m_internalName, name) == 0)
            return static_cast<char>(i);
    }
    return defaultColor;
}

const char* Tavo_WiPalette::GetColorName(char index) const
{
    const Tavo_WiPaletteEntry* entry = EntryAt(index);
    return entry ? entry->m_internalName : nullptr;
}

// ---- Colour values --------------------------------------------------------------

DWORD Tavo_WiPalette::GetWin32Color(char index, bool grey) const
{
    const Tavo_WiPaletteEntry& entry = ResolvedEntry(index);
    if (!(entry.m_flags & Tavo_WiPaletteEntry::HasRGBFlag))
        return 0;
    return grey ? GreyOf(entry) : RgbOf(entry);
}

DWORD Tavo_WiPalette::GetWin32Index(char index) const
{
    const Tavo_WiPaletteEntry& entry = ResolvedEntry(index);
    if (m_hPalette && (entry.m_flags & Tavo_WiPaletteEntry::HasWin32PaletteValueFlag))
        return entry.m_win32PaletteValue;
    if (!(entry.m_flags & Tavo_WiPaletteEntry::HasRGBFlag))
        return 0;
    return RgbOf(entry);
}

DWORD Tavo_WiPalette::GetMotifColor(char index) const
{
    const Tavo_WiPaletteEntry& entry = ResolvedEntry(index);
    return (entry.m_flags & Tavo_WiPaletteEntry::HasMotifValueFlag) ? entry.m_motifValue : 0;
}

char Tavo_WiPalette::GetTextColor(int index) const
{
    const Tavo_WiPaletteEntry* entry = EntryAt(index);
    return entry ? entry->m_textColor : 0;
}

// ---- Adding colours ---------------------------------------------------------------

char Tavo_WiPalette::AddColor(const char* name, unsigned char red, unsigned char green, unsigned char blue)
{
    if (!name)
        return kNotFound;
    const int count = GetColorCount();
    for (int i = 0; i < count; ++i) {
        if (m_entryStorage[i]->HasRGB(red, green, blue))
            return static_cast<char>(i);
    }
    return Append(new Tavo_WiPaletteEntry(name, red, green, blue));
}

char Tavo_WiPalette::AddColor(const char* userName, const char* internalName)
{
    if (!userName || !internalName)
        return kNotFound;
    const char matched = GetInternalNamedColor(internalName, kNotFound);
    if (matched == kNotFound)
        return kNotFound;

    // The synonym carries the matched colour, so that looking it up by its own
    // index gives the same colour as the name it stands for.
    const Tavo_WiPaletteEntry& original = *m_entryStorage[static_cast<int>(matched)];
    auto* synonym = new Tavo_WiPaletteEntry(userName, internalName);
    synonym->m_win32PaletteValue = original.m_win32PaletteValue;
    synonym->m_motifValue = original.m_motifValue;
    synonym->m_textColor = original.m_textColor;
    synonym->m_red = original.m_red;
    synonym->m_green = original.m_green;
    synonym->m_blue = original.m_blue;
    synonym->m_flags = original.m_flags;
    return Append(synonym) == kNotFound ? kNotFound : matched;
}

// ---- Implementation ------------------------------------------------------------------

const Tavo_WiPaletteEntry* Tavo_WiPalette::EntryAt(int index) const
{
    if (index < 0 || index >= GetColorCount())
        return nullptr;
    return m_entryStorage[index];
}

const Tavo_WiPaletteEntry& Tavo_WiPalette::ResolvedEntry(char index) const
{
    const Tavo_WiPaletteEntry* entry = EntryAt(index);
    if (!entry)
        entry = EntryAt(kWhite);
    static const Tavo_WiPaletteEntry kNoEntry;
    return entry ? *entry : kNoEntry;
}

char Tavo_WiPalette::Append(Tavo_WiPaletteEntry* entry)
{
    const int index = GetColorCount();
    void* slot = index < kMaxEntries ? m_entries->getaddr(index) : nullptr;
    if (!slot) {
        delete entry;
        return kNotFound;
    }
    *static_cast<Tavo_WiPaletteEntry**>(slot) = entry;
    return static_cast<char>(index);
}
