// Tavo_GrPalette: the base palette (no colours), fill names and the colour-name
// comparison.
#include "Tavo_GrPalette.h"

#include <cctype>

namespace {

struct FillName {
    char fill;
    const char* name;
};

constexpr FillName kFillNames[] = {
    {Tavo_GrPalette::Hollow, "hollow"},
    {Tavo_GrPalette::Solid, "solid"},
};

// '_', '-' and ' ' separate words the same way; letters compare without case.
int NameChar(char c)
{
    if (c == '-' || c == ' ')
        return '_';
    return std::tolower(static_cast<unsigned char>(c));
}

} // namespace

Tavo_GrPalette::Tavo_GrPalette() = default;
Tavo_GrPalette::~Tavo_GrPalette() = default;

const char* Tavo_GrPalette::GetClassName() const
{
    return "Tavo_GrPalette";
}

int Tavo_GrPalette::GetColorCount() const
{
    return 0;
}

char Tavo_GrPalette::GetColor(int index, char defaultColor) const
{
    return index >= 0 && index < GetColorCount() ? static_cast<char>(index) : defaultColor;
}

char Tavo_GrPalette::GetUserNamedColor(const char*, char defaultColor) const
{
    return defaultColor;
}

const char* Tavo_GrPalette::GetColorUserName(char)
{
    return nullptr;
}

const char* Tavo_GrPalette::GetFillName(char fill) const
{
    for (const FillName& entry : kFillNames) {
        if (entry.fill == fill)
            return entry.name;
    }
    return nullptr;
}

char Tavo_GrPalette::GetFill(const char* name, char defaultFill) const
{
    for (const FillName& entry : kFillNames) {
        if (CompareColorNames(entry.name, name) == 0)
            return entry.fill;
    }
    return defaultFill;
}

int Tavo_GrPalette::CompareColorNames(const char* a, const char* b)
{
    if (!a || !b)
        return a == b ? 1 : (a ? 1 : -1); // a null name matches nothing, not even null
    for (;; ++a, ++b) {
        const int ca = NameChar(*a);
        const int cb = NameChar(*b);
        if (ca != cb)
            return ca < cb ? -1 : 1;
        if (ca == 0)
            return 0;
    }
}
