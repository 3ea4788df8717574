// Tavo_WiPalette: the process's named colour table.
//
// Classes: Tavo_WiPaletteEntry (one colour), DARRAY_Tavo_WiPaletteEntryPointer
// (the entry table), Tavo_WiPalette (the palette).
//
// The graphics core names colours by signed 8-bit indices. 0 upward index the
// entries: sixteen built-in colours (0 "black" ... 15 "olive"), then colours
// added at run time. -1, -2 and -3 are "transparent", "inherit" and "default"
// and have no entry. Since indices are 8-bit, the table holds at most 128
// entries (0 ... 127): once it is full, AddColor adds nothing and returns -99.
//
// Lookups never fail: an unknown or null name gives the caller's default, an
// index out of range gives null (names), 0 (GetTextColor) or the colour of
// entry 7, "white" (colour values). The library installs one palette as the
// graphics core's palette (Tavo_WiLibrary::GetPalette); the rendering surface
// asks it for every pen, brush and text colour. A palette cannot be copied.
#pragma once

#include <afxwin.h>

#include "Tavo_GrPalette.h"
#include "UT_DARRAY.h"
#include "UT_STR.h"

struct _WidgetRec;

// One colour. Names are owned copies (UT_STR::Dup), freed with the record.
class Tavo_WiPaletteEntry {
public:
    enum Flags : unsigned char {
        HasRGBFlag = 1,
        HasWin32PaletteValueFlag = 2,
        HasMotifValueFlag = 4,
    };

    Tavo_WiPaletteEntry() = default;
    Tavo_WiPaletteEntry(const char* userName, const char* internalName)
        : m_userName(UT_STR::Dup(userName)), m_internalName(UT_STR::Dup(internalName))
    {
    }
    Tavo_WiPaletteEntry(const char* name, unsigned char red, unsigned char green, unsigned char blue)
        : m_userName(UT_STR::Dup(name)), m_internalName(UT_STR::Dup(name))
    {
        SetRGB(red, green, blue);
    }
    Tavo_WiPaletteEntry(const Tavo_WiPaletteEntry& other)
        : m_userName(UT_STR::Dup(other.m_userName)),
          m_internalName(UT_STR::Dup(other.m_internalName)),
          m_win32PaletteValue(other.m_win32PaletteValue),
          m_motifValue(other.m_motifValue),
          m_textColor(other.m_textColor),
          m_red(other.m_red),
          m_green(other.m_green),
          m_blue(other.m_blue),
          m_flags(other.m_flags)
    {
    }
    Tavo_WiPaletteEntry& operator=(const Tavo_WiPaletteEntry&) = delete;
    ~Tavo_WiPaletteEntry()
    {
        delete[] m_userName;
        delete[] m_internalName;
    }

    void SetRGB(unsigned char red, unsigned char green, unsigned char blue)
    {
        m_red = red;
        m_green = green;
        m_blue = blue;
        m_flags |= HasRGBFlag;
    }
    void SetWin32PaletteValue(DWORD value)
    {
        m_win32PaletteValue = value;
        m_flags |= HasWin32PaletteValueFlag;
    }
    void SetMotifValue(DWORD value)
    {
        m_motifValue = value;
        m_flags |= HasMotifValueFlag;
    }
    bool HasRGB(unsigned char red, unsigned char green, unsigned char blue) const
    {
        return (m_flags & HasRGBFlag) && m_red == red && m_green == green && m_blue == blue;
    }

    char* m_userName = nullptr;
    char* m_internalName = nullptr;
    DWORD m_win32PaletteValue = 0;
    DWORD m_motifValue = 0;
    char m_textColor = 0;
    unsigned char m_red = 0;
    unsigned char m_green = 0;
    unsigned char m_blue = 0;
    unsigned char m_flags = 0;
};

// The entry table: a growable array of entry pointers. The palette deletes the
// entries before it deletes the table; the table releases only its storage.
class DARRAY_Tavo_WiPaletteEntryPointer : public UT_DARRAY {
public:
    static constexpr int kInitialCapacity = 20;

    explicit DARRAY_Tavo_WiPaletteEntryPointer(Tavo_WiPaletteEntry*** storage)
        : UT_DARRAY(storage, sizeof(Tavo_WiPaletteEntry*), kInitialCapacity, 1)
    {
    }
    ~DARRAY_Tavo_WiPaletteEntryPointer() override = default;
};

class AFX_EXT_CLASS Tavo_WiPalette : public Tavo_GrPalette {
public:
    static constexpr char kTransparent = -1;
    static constexpr char kInherit = -2;
    static constexpr char kDefault = -3;
    static constexpr char kNotFound = -99;  // AddColor: nothing found or added
    static constexpr char kWhite = 7;       // stands for indices out of range
    static constexpr int kMaxEntries = 128; // indices 0 ... 127
    static constexpr char kNoColorIndex = 16;

    Tavo_WiPalette();
    ~Tavo_WiPalette() override;
    Tavo_WiPalette(const Tavo_WiPalette&) = delete;
    Tavo_WiPalette& operator=(const Tavo_WiPalette&) = delete;

    // ---- Overridables of Tavo_GrPalette ------------------------------------
    const char* GetClassName() const override;
    int GetColorCount() const override;
    char GetColor(int index, char defaultColor) const override;
    char GetUserNamedColor(const char* name, char defaultColor) const override;
    const char* GetColorUserName(char index) override;

    // ---- Names -------------------------------------------------------------
    char GetInternalNamedColor(const char* name, char defaultColor) const;
    const char* GetColorName(char index) const;

    // ---- Colour values -----------------------------------------------------
    // The RGB value of the colour (0 when the entry has none); with grey, its
    // luminance in all three components.
    DWORD GetWin32Color(char index, bool grey) const;
    // The value to give GDI: the palette-index form when a Win32 palette
    // exists (never on this platform), else the RGB form.
    DWORD GetWin32Index(char index) const;
    HPALETTE GetWin32Palette() const { return m_hPalette; }
    void CreateWin32Palette() {}
    void DeleteWin32Palette() {}
    DWORD GetMotifColor(char index) const;
    bool DefineMotifColors(_WidgetRec*) { return false; }
    void DeleteMotifColormap() {}
    char GetTextColor(int index) const;

    // ---- Adding colours ----------------------------------------------------
    // The first entry with this red, green and blue, or a new entry named name.
    // -99 when name is null, or when the table is full and no entry matches.
    char AddColor(const char* name, unsigned char red, unsigned char green, unsigned char blue);
    // Appends an entry carrying userName for the colour whose internal name is
    // internalName, with that colour's values, and returns the index of the
    // matched colour. -99 (nothing added) when no entry has that internal name,
    // a name is null or the table is full.
    char AddColor(const char* userName, const char* internalName);

private:
    const Tavo_WiPaletteEntry* EntryAt(int index) const;
    // The entry whose colour an index stands for: out-of-range indices stand
    // for "white".
    const Tavo_WiPaletteEntry& ResolvedEntry(char index) const;
    // Takes ownership of entry; returns its index, or -99 (entry deleted) when
    // the table is full or cannot grow.
    char Append(Tavo_WiPaletteEntry* entry);

    DARRAY_Tavo_WiPaletteEntryPointer* m_entries = nullptr; // owned
    HPALETTE m_hPalette = nullptr;                          // never created here
    Tavo_WiPaletteEntry** m_entryStorage = nullptr;         // kept by m_entries
};
