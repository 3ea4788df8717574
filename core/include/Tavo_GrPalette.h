// Tavo_GrPalette: the colour table behind the graphics core's colour indices.
//
// The base class holds no colours (a palette for drawings that use none); the
// palette a system installs (Tavo_GrLibrary::SetPalette) derives from it. It
// also knows the fill codes of attributes:
//
//   0 "hollow"  outlines only
//   1 "solid"   filled
//
// Colour and fill names are compared with CompareColorNames: ignoring case, and
// with '_', '-' and ' ' counting as the same character, so "Dark Gray",
// "dark-gray" and "dark_gray" name one colour. A null name matches nothing.
#pragma once

#include "Tavo_CoreApi.h"

class TAVO_CORE_API Tavo_GrPalette {
public:
    enum Fill : char {
        Hollow = 0,
        Solid = 1,
    };

    Tavo_GrPalette();
    // Slots in order: destructor, GetClassName, GetColorCount, GetColor,
    // GetUserNamedColor, GetColorUserName, GetFillName, GetFill.
    virtual ~Tavo_GrPalette();
    virtual const char* GetClassName() const;
    virtual int GetColorCount() const;
    // index when 0 <= index < GetColorCount(), else defaultColor.
    virtual char GetColor(int index, char defaultColor) const;
    virtual char GetUserNamedColor(const char* name, char defaultColor) const;
    // Null for an unknown index.
    virtual const char* GetColorUserName(char index);
    // The name of a fill code; null for an unknown code.
    virtual const char* GetFillName(char fill) const;
    // The fill code of a name; defaultFill for an unknown or null name.
    virtual char GetFill(const char* name, char defaultFill) const;

    // 0 when the two names are equal under the rule above, else non-zero.
    static int CompareColorNames(const char* a, const char* b);

protected:
    Tavo_GrPalette(const Tavo_GrPalette&) = default;
    Tavo_GrPalette& operator=(const Tavo_GrPalette&) = default;
};
