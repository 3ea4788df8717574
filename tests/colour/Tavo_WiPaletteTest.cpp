// The named colour palette: the built-in table, name lookups, colour values,
// adding colours and the limits of the 8-bit index.
#include "Tavo_WiPalette.h"

#include <gtest/gtest.h>

#include <string>
#include <type_traits>

namespace {

struct BuiltIn {
    const char* name;
    DWORD rgb;
    char textColor;
};

const BuiltIn kBuiltIns[16] = {
    {"black", 0x000000, 7},      {"blue", 0xFF0000, 7},        {"green", 0x00FF00, 0},
    {"cyan", 0xFFFF00, 0},       {"red", 0x0000FF, 7},         {"magenta", 0xFF00FF, 0},
    {"yellow", 0x00FFFF, 0},     {"white", 0xFFFFFF, 0},       {"gray", 0xA4A0A0, 0},
    {"dark_gray", 0x4B4B4B, 7},  {"dark_blue", 0x800000, 7},   {"dark_green", 0x008000, 7},
    {"dark_cyan", 0x808000, 7},  {"dark_red", 0x000080, 7},    {"dark_magenta", 0x800080, 7},
    {"olive", 0x286450, 7},
};

DWORD Grey(int level)
{
    return static_cast<DWORD>(level) * 0x010101;
}

class PaletteTest : public ::testing::Test {
protected:
    Tavo_WiPalette m_palette;
};

// ---- The built-in table ---------------------------------------------------------

TEST_F(PaletteTest, HoldsTheSixteenBuiltInColoursInOrder)
{
    ASSERT_EQ(m_palette.GetColorCount(), 16);
    for (int i = 0; i < 16; ++i) {
        SCOPED_TRACE(kBuiltIns[i].name);
        EXPECT_STREQ(m_palette.GetColorName(static_cast<char>(i)), kBuiltIns[i].name);
        EXPECT_STREQ(m_palette.GetColorUserName(static_cast<char>(i)), kBuiltIns[i].name);
        EXPECT_EQ(m_palette.GetWin32Color(static_cast<char>(i), false), kBuiltIns[i].rgb);
        EXPECT_EQ(m_palette.GetTextColor(i), kBuiltIns[i].textColor);
        EXPECT_EQ(m_palette.GetMotifColor(static_cast<char>(i)), 0u);
    }
}

TEST_F(PaletteTest, NamesItsClass)
{
    EXPECT_STREQ(m_palette.GetClassName(), "Tavo_WiPalette");
    EXPECT_EQ(m_palette.GetWin32Palette(), nullptr);
}

TEST_F(PaletteTest, GetColorAcceptsOnlyIndicesOfEntries)
{
    EXPECT_EQ(m_palette.GetColor(15, -3), 15);
    EXPECT_EQ(m_palette.GetColor(16, -3), -3);
    EXPECT_EQ(m_palette.GetColor(-1, 9), 9);
}

// ---- Names ------------------------------------------------------------------------

TEST_F(PaletteTest, GreyInAnyCaseIsGray)
{
    EXPECT_EQ(m_palette.GetUserNamedColor("grey", -1), 8);
    EXPECT_EQ(m_palette.GetUserNamedColor("Grey", -1), 8);
    EXPECT_EQ(m_palette.GetUserNamedColor("GREY", -1), 8);
}

TEST_F(PaletteTest, SpecialNamesNeverReachTheTable)
{
    EXPECT_EQ(m_palette.GetUserNamedColor("DEFAULT", 0), -3);
    EXPECT_EQ(m_palette.GetUserNamedColor("Inherit", 0), -2);
    EXPECT_EQ(m_palette.GetUserNamedColor("transparent", 0), -1);
}

TEST_F(PaletteTest, UnknownAndNullNamesGiveTheCallersDefault)
{
    EXPECT_EQ(m_palette.GetUserNamedColor("mauve", 42), 42);
    EXPECT_EQ(m_palette.GetUserNamedColor(nullptr, 42), 42);
    EXPECT_EQ(m_palette.GetInternalNamedColor(nullptr, 42), 42);
    EXPECT_EQ(m_palette.GetInternalNamedColor("grey", 42), 42) << "no synonyms for internal names";
    EXPECT_EQ(m_palette.GetInternalNamedColor("Dark Red", 42), 13);
}

TEST_F(PaletteTest, SpecialIndicesHaveNames)
{
    EXPECT_STREQ(m_palette.GetColorUserName(-1), "transparent");
    EXPECT_STREQ(m_palette.GetColorUserName(-2), "inherit");
    EXPECT_STREQ(m_palette.GetColorUserName(-3), "default");
    EXPECT_EQ(m_palette.GetColorUserName(-4), nullptr);
    EXPECT_EQ(m_palette.GetColorName(-1), nullptr);
    EXPECT_EQ(m_palette.GetColorName(16), nullptr);
}

TEST_F(PaletteTest, SixteenIsNoColorBesideTheEntrysInternalName)
{
    EXPECT_STREQ(m_palette.GetColorUserName(16), "no color");
    ASSERT_EQ(m_palette.AddColor("coral", 255, 127, 80), 16);
    EXPECT_STREQ(m_palette.GetColorUserName(16), "no color");
    EXPECT_STREQ(m_palette.GetColorName(16), "coral");
}

// ---- Colour values -----------------------------------------------------------------

TEST_F(PaletteTest, IndicesOutOfRangeStandForWhite)
{
    EXPECT_EQ(m_palette.GetWin32Color(-1, false), 0x00FFFFFFu);
    EXPECT_EQ(m_palette.GetWin32Color(100, false), 0x00FFFFFFu);
    EXPECT_EQ(m_palette.GetWin32Index(-3), 0x00FFFFFFu);
}

TEST_F(PaletteTest, GrayWithAndWithoutGrey)
{
    EXPECT_EQ(m_palette.GetWin32Color(8, false), 0x00A4A0A0u);
    EXPECT_EQ(m_palette.GetWin32Color(8, true), 0x00A0A0A0u);
}

TEST_F(PaletteTest, GreyIsTheTruncatedLuminance)
{
    EXPECT_EQ(m_palette.GetWin32Color(1, true), Grey(28));   // blue
    EXPECT_EQ(m_palette.GetWin32Color(2, true), Grey(150));  // green
    EXPECT_EQ(m_palette.GetWin32Color(4, true), Grey(76));   // red
    EXPECT_EQ(m_palette.GetWin32Color(6, true), Grey(226));  // yellow
    EXPECT_EQ(m_palette.GetWin32Color(7, true), Grey(255));  // white
    EXPECT_EQ(m_palette.GetWin32Color(15, true), Grey(87));  // olive
    EXPECT_EQ(m_palette.GetWin32Color(0, true), Grey(0));    // black
}

TEST_F(PaletteTest, Win32IndexIsTheRgbValueWithoutAWin32Palette)
{
    EXPECT_EQ(m_palette.GetWin32Index(1), 0x00FF0000u);
    EXPECT_EQ(m_palette.GetWin32Index(9), 0x004B4B4Bu);
}

// ---- Adding colours ----------------------------------------------------------------

TEST_F(PaletteTest, AddingAnExistingColourByValueFindsIt)
{
    EXPECT_EQ(m_palette.AddColor("scarlet", 255, 0, 0), 4);
    EXPECT_EQ(m_palette.GetColorCount(), 16);
    EXPECT_EQ(m_palette.GetUserNamedColor("scarlet", -99), -99) << "the name was not added";
}

TEST_F(PaletteTest, AddingANewColourByValueAppendsIt)
{
    EXPECT_EQ(m_palette.AddColor("crimson", 200, 0, 0), 16);
    EXPECT_EQ(m_palette.GetColorCount(), 17);
    EXPECT_EQ(m_palette.GetWin32Color(16, false), 0x000000C8u);
    EXPECT_EQ(m_palette.GetTextColor(16), 0);
    EXPECT_EQ(m_palette.GetUserNamedColor("Crimson", -1), 16);
    EXPECT_EQ(m_palette.GetInternalNamedColor("crimson", -1), 16);
    EXPECT_EQ(m_palette.AddColor("again", 200, 0, 0), 16);
}

TEST_F(PaletteTest, AddingAUserNameForAnInternalNameReturnsTheMatchedColour)
{
    EXPECT_EQ(m_palette.AddColor("rouge", "red"), 4);
    ASSERT_EQ(m_palette.GetColorCount(), 17);
    EXPECT_STREQ(m_palette.GetColorUserName(16), "no color");
    EXPECT_STREQ(m_palette.GetColorName(16), "red");
    const char rouge = m_palette.GetUserNamedColor("rouge", -1);
    EXPECT_EQ(rouge, 16);
    EXPECT_EQ(m_palette.GetWin32Color(rouge, false), 0x000000FFu) << "the synonym draws in its colour";
    EXPECT_EQ(m_palette.GetTextColor(rouge), 7);
}

TEST_F(PaletteTest, AddingAUserNameForAnUnknownInternalNameAddsNothing)
{
    EXPECT_EQ(m_palette.AddColor("rouge", "vermilion"), -99);
    EXPECT_EQ(m_palette.GetColorCount(), 16);
}

TEST_F(PaletteTest, NullNamesAddNothing)
{
    EXPECT_EQ(m_palette.AddColor(nullptr, 1, 2, 3), -99);
    EXPECT_EQ(m_palette.AddColor(nullptr, "red"), -99);
    EXPECT_EQ(m_palette.AddColor("rouge", nullptr), -99);
    EXPECT_EQ(m_palette.GetColorCount(), 16);
}

TEST_F(PaletteTest, AFullTableAddsNothingAndNeverHandsOutANegativeIndex)
{
    for (int i = 16; i < Tavo_WiPalette::kMaxEntries; ++i)
        ASSERT_EQ(m_palette.AddColor("filler", static_cast<unsigned char>(i), 1, 2), static_cast<char>(i));
    ASSERT_EQ(m_palette.GetColorCount(), 128);
    EXPECT_EQ(m_palette.AddColor("one too many", 9, 9, 9), -99);
    EXPECT_EQ(m_palette.AddColor("synonym", "red"), -99);
    EXPECT_EQ(m_palette.GetColorCount(), 128);
    EXPECT_EQ(m_palette.AddColor("existing", 127, 1, 2), 127) << "existing colours are still found";
}

TEST_F(PaletteTest, TextColourOutsideTheTableIsBlack)
{
    EXPECT_EQ(m_palette.GetTextColor(0), 7);
    EXPECT_EQ(m_palette.GetTextColor(2), 0);
    EXPECT_EQ(m_palette.GetTextColor(-5), 0);
    EXPECT_EQ(m_palette.GetTextColor(m_palette.GetColorCount()), 0);
}

TEST_F(PaletteTest, MotifAndWin32PaletteOperationsDoNothing)
{
    m_palette.CreateWin32Palette();
    EXPECT_EQ(m_palette.GetWin32Palette(), nullptr);
    EXPECT_FALSE(m_palette.DefineMotifColors(nullptr));
    m_palette.DeleteMotifColormap();
    m_palette.DeleteWin32Palette();
    EXPECT_EQ(m_palette.GetMotifColor(3), 0u);
}

TEST(PaletteCopying, IsForbidden)
{
    EXPECT_FALSE(std::is_copy_constructible<Tavo_WiPalette>::value);
    EXPECT_FALSE(std::is_copy_assignable<Tavo_WiPalette>::value);
}

TEST(PaletteEntry, CopiesOwnTheirNames)
{
    Tavo_WiPaletteEntry original("teal", 0, 128, 128);
    Tavo_WiPaletteEntry copy(original);
    EXPECT_NE(copy.m_userName, original.m_userName);
    EXPECT_STREQ(copy.m_internalName, "teal");
    EXPECT_TRUE(copy.HasRGB(0, 128, 128));
    EXPECT_FALSE(Tavo_WiPaletteEntry("plain", "plain").HasRGB(0, 0, 0)) << "no colour until one is set";
}

} // namespace
