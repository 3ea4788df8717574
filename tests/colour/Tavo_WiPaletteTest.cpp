// The named colour palette: the built-in table, name lookups, colour values,
// adding colours and the limits of the 8-bit index.
#include "Tavo_WiPalette.h"

#include <gtest/gtest.h>

namespace {

const struct {
    const char* name;
    DWORD rgb;
    char textColor;
} kBuiltIns[16] = {
    {"black", 0x000000, 7},
    {"blue", 0xFF0000, 7},
    {"green", 0x00FF00, 0},
    {"cyan", 0xFFFF00, 0},
    {"red", 0x0000FF, 7},
    {"magenta", 0xFF00FF, 0},
    {"yellow", 0x00FFFF, 0},
    {"white", 0xFFFFFF, 0},
    {"gray", 0xA4A0A0, 0},
    {"dark_gray", 0x4B4B4B, 7},
    {"dark_blue", 0x800000, 7},
    {"dark_green", 0x008000, 7},
    {"dark_cyan", 0x808000, 7},
    {"dark_red", 0x000080, 7},
    {"dark_magenta", 0x800080, 7},
    {"olive", 0x286450, 7},
};

class PaletteTest : public ::testing::Test {
protected:
    Tavo_WiPalette m_palette;
};

// ---- The built-in table and names ---------------------------------------------------

TEST_F(PaletteTest, HoldsTheSixteenBuiltInColoursInOrder)
{
    ASSERT_EQ(m_palette.GetColorCount(), 16);
    for (int i = 0; i < 16; ++i) {
        SCOPED_TRACE(kBuiltIns[i].name);
        EXPECT_STREQ(m_palette.GetColorName(static_cast<char>(i)), kBuiltIns[i].name);
        EXPECT_STREQ(m_palette.GetColorUserName(static_cast<char>(i)), kBuiltIns[i].name);
        EXPECT_EQ(m_palette.GetWin32Color(static_cast<char>(i), false), kBuiltIns[i].rgb);
        EXPECT_EQ(m_palette.GetTextColor(i), kBuiltIns[i].textColor);
    }
    EXPECT_TRUE(m_palette.GetColor(15, -3) == 15 && m_palette.GetColor(16, -3) == -3 && m_palette.GetColor(-1, 9) == 9);
    EXPECT_TRUE(m_palette.GetTextColor(-5) == 0 && m_palette.GetTextColor(16) == 0) << "black outside the table";
}

TEST_F(PaletteTest, UserNameLookups)
{
    const struct {
        const char* name;
        char index;
    } rows[] = {
        {"grey", 8}, {"Grey", 8}, {"GREY", 8}, {"Dark Red", 13}, {"dark-gray", 9}, {"darkgray", 42}, {"reddish", 42}, // separators matter, and the whole name
        // Special names never reach the table.
        {"DEFAULT", -3},
        {"Inherit", -2},
        {"transparent", -1},
        {"mauve", 42},
        {nullptr, 42}, // the caller's default
    };
    for (const auto& row : rows)
        EXPECT_EQ(m_palette.GetUserNamedColor(row.name, 42), row.index) << (row.name ? row.name : "(null)");
    EXPECT_EQ(m_palette.GetInternalNamedColor("Dark Red", 42), 13);
    EXPECT_EQ(m_palette.GetInternalNamedColor("grey", 42), 42) << "no synonyms for internal names";
    EXPECT_EQ(m_palette.GetInternalNamedColor(nullptr, 42), 42);
}

TEST_F(PaletteTest, SpecialIndicesHaveNamesAndSixteenIsNoColorBesideTheEntrysInternalName)
{
    EXPECT_STREQ(m_palette.GetColorUserName(-1), "transparent");
    EXPECT_STREQ(m_palette.GetColorUserName(-2), "inherit");
    EXPECT_STREQ(m_palette.GetColorUserName(-3), "default");
    EXPECT_TRUE(!m_palette.GetColorUserName(-4) && !m_palette.GetColorName(-1) && !m_palette.GetColorName(16));
    EXPECT_STREQ(m_palette.GetColorUserName(16), "no color");
    ASSERT_EQ(m_palette.AddColor("coral", 255, 127, 80), 16);
    EXPECT_STREQ(m_palette.GetColorUserName(16), "no color");
    EXPECT_STREQ(m_palette.GetColorName(16), "coral");
}

// ---- Colour values -----------------------------------------------------------------

TEST_F(PaletteTest, GreyIsTheTruncatedLuminanceWin32IndexTheRgbValueAndOutOfRangeIndicesWhite)
{
    const struct {
        char index;
        int level;
    } rows[] = {{0, 0}, {1, 28}, {2, 150}, {4, 76}, {6, 226}, {7, 255}, {8, 160}, {15, 87}};
    for (const auto& row : rows)
        EXPECT_EQ(m_palette.GetWin32Color(row.index, true), static_cast<DWORD>(row.level) * 0x010101u)
            << "index " << int(row.index);
    EXPECT_EQ(m_palette.GetWin32Color(8, false), 0x00A4A0A0u);
    EXPECT_EQ(m_palette.GetWin32Index(1), 0x00FF0000u);
    EXPECT_EQ(m_palette.GetWin32Index(9), 0x004B4B4Bu);
    for (char outside : {-3, -1, 100})
        EXPECT_TRUE(m_palette.GetWin32Index(outside) == 0xFFFFFF && m_palette.GetWin32Color(outside, false) == 0xFFFFFF);
}

// ---- Adding colours ----------------------------------------------------------------

TEST_F(PaletteTest, AddingByValueFindsAnExistingColourOrAppendsANewOne)
{
    EXPECT_EQ(m_palette.AddColor("scarlet", 255, 0, 0), 4);
    EXPECT_EQ(m_palette.GetUserNamedColor("scarlet", -99), -99) << "the name was not added";
    EXPECT_EQ(m_palette.AddColor("crimson", 200, 0, 0), 16);
    EXPECT_TRUE(m_palette.GetWin32Color(16, false) == 0x0000C8 && m_palette.GetTextColor(16) == 0);
    EXPECT_TRUE(m_palette.GetUserNamedColor("Crimson", -1) == 16 && m_palette.GetInternalNamedColor("crimson", -1) == 16);
    EXPECT_EQ(m_palette.AddColor("again", 200, 0, 0), 16);
}

TEST_F(PaletteTest, AddingAUserNameForAnInternalNameReturnsTheMatchedColour)
{
    EXPECT_EQ(m_palette.AddColor("rouge", "red"), 4);
    ASSERT_EQ(m_palette.GetColorCount(), 17);
    EXPECT_STREQ(m_palette.GetColorName(16), "red");
    EXPECT_EQ(m_palette.GetUserNamedColor("rouge", -1), 16);
    EXPECT_EQ(m_palette.GetWin32Color(16, false), 0x000000FFu) << "the synonym draws in its colour";
    EXPECT_EQ(m_palette.GetTextColor(16), 7);
}

TEST_F(PaletteTest, UnknownInternalNamesAndNullNamesAddNothing)
{
    for (int added : {m_palette.AddColor("rouge", "vermilion"), m_palette.AddColor(nullptr, 1, 2, 3),
                      m_palette.AddColor(nullptr, "red"), m_palette.AddColor("rouge", nullptr)})
        EXPECT_EQ(added, -99);
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
