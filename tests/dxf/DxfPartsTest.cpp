// The importer's parts that work on plain values: the group-code reader, the
// ACI table and nearest colours, text decoding and the plane geometry.
#include "DxfTestSupport.h"

#include "Tavo_DxfColours.h"
#include "Tavo_DxfGeometry.h"
#include "Tavo_DxfReader.h"
#include "Tavo_DxfText.h"

#include <gtest/gtest.h>

#include <cmath>

namespace {

std::vector<Tavo_DxfPair> AllPairs(Tavo_DxfReader& reader)
{
    std::vector<Tavo_DxfPair> pairs;
    Tavo_DxfPair pair;
    while (reader.Next(pair))
        pairs.push_back(pair);
    return pairs;
}

// ---- Reader -----------------------------------------------------------------------------

TEST(DxfReader, ReadsPairsWithTheirLineWhateverTheLineEnds)
{
    for (const std::string& text : {std::string("  0\nLINE\n 10\n1.5\n"), std::string("  0\r\nLINE\r\n 10\r\n1.5\r\n"),
                                    std::string("  0\rLINE\r 10\r1.5"), std::string("\xEF\xBB\xBF  0\nLINE  \n 10\n1.5")}) {
        Tavo_DxfReader reader(text.data(), text.size());
        const std::vector<Tavo_DxfPair> pairs = AllPairs(reader);
        ASSERT_EQ(pairs.size(), 2u) << text;
        EXPECT_EQ(pairs[0].code, 0);
        EXPECT_EQ(pairs[0].value, "LINE");
        EXPECT_EQ(pairs[0].line, 1);
        EXPECT_EQ(pairs[1].code, 10);
        EXPECT_EQ(pairs[1].value, "1.5");
        EXPECT_EQ(pairs[1].line, 3);
        EXPECT_TRUE(reader.AtEnd());
        EXPECT_FALSE(reader.Failed());
    }
}

TEST(DxfReader, RefusesCodesThatAreNotSixteenBitNumbersWithTheirLine)
{
    const struct {
        std::string text;
        int line;
        const char* says;
    } cases[] = {
        {"  0\nLINE\nten\n1\n", 3, "expected a group code"},
        {"  0\nLINE\n 1e3\n1\n", 3, "expected a group code"},
        {"  0\nLINE\n70000\n1\n", 3, "expected a group code"},
        {"  0\nLINE\n\n1\n", 3, "expected a group code"},
        {"  0\nLINE\n 10\n", 3, "ends after group code 10"},
    };
    for (const auto& c : cases) {
        Tavo_DxfReader reader(c.text.data(), c.text.size());
        AllPairs(reader);
        EXPECT_TRUE(reader.Failed()) << c.text;
        EXPECT_EQ(reader.ErrorLine(), c.line) << c.text;
        EXPECT_NE(reader.Error().find(c.says), std::string::npos) << reader.Error();
    }
}

TEST(DxfReader, ParsesOnlyWholeFiniteNumbers)
{
    double d = 0.0;
    long long i = 0;
    EXPECT_TRUE(Tavo_DxfParseDouble(" -2.5e3 ", d));
    EXPECT_EQ(d, -2500.0);
    for (const char* bad : {"", "abc", "1.5x", "nan", "inf", "1e400", "-1e999"})
        EXPECT_FALSE(Tavo_DxfParseDouble(bad, d)) << bad;
    EXPECT_TRUE(Tavo_DxfParseInt("  42", i));
    EXPECT_EQ(i, 42);
    for (const char* bad : {"", "4.2", "0x10", "99999999999999999999999"})
        EXPECT_FALSE(Tavo_DxfParseInt(bad, i)) << bad;
}

// ---- Colours ----------------------------------------------------------------------------

TEST(DxfColours, AciTableHasTheStandardColours)
{
    const struct {
        int aci;
        uint32_t rgb;
    } cases[] = {
        {1, 0xFF0000},
        {2, 0xFFFF00},
        {3, 0x00FF00},
        {4, 0x00FFFF},
        {5, 0x0000FF},
        {6, 0xFF00FF},
        {7, 0xFFFFFF},
        {8, 0x808080},
        {9, 0xC0C0C0},
        {10, 0xFF0000},
        {11, 0xFF7F7F},
        {13, 0xCC6666},
        {20, 0xFF3F00},
        {21, 0xFF9F7F},
        {30, 0xFF7F00},
        {40, 0xFFBF00},
        {140, 0x00BFFF},
        {190, 0x7F00FF},
        {249, 0x4C262F},
        {250, 0x333333},
        {255, 0xFFFFFF},
        {-1, 0xFF0000},
        {0, 0x000000},
        {256, 0x000000},
    };
    for (const auto& c : cases)
        EXPECT_EQ(Tavo_DxfAciColour(c.aci).Packed(), c.rgb) << "ACI " << c.aci;
}

TEST(DxfColours, NearestColourWeighsGreenMost)
{
    const Tavo_DxfRgb candidates[] = {{255, 0, 0}, {0, 255, 0}, {0, 0, 255}};
    EXPECT_EQ(Tavo_DxfNearestColour({250, 10, 10}, candidates, 3), 0);
    EXPECT_EQ(Tavo_DxfNearestColour({0, 0, 200}, candidates, 3), 2);
    // 127 short of green's green and 128 short of blue's blue: the miss on
    // the heavier component is the smaller one, so green is nearer.
    EXPECT_EQ(Tavo_DxfNearestColour({0, 128, 128}, candidates, 3), 1);
    EXPECT_EQ(Tavo_DxfNearestColour({1, 2, 3}, candidates, 0), -1);
}

// ---- Text -------------------------------------------------------------------------------

TEST(DxfText, TextControlCodesAndEncodings)
{
    EXPECT_EQ(Tavo_DxfPlainText("%%c20 %%p0.1 45%%d 100%%%", false), "\xD8"
                                                                     "20 \xB1"
                                                                     "0.1 45\xB0 100%");
    EXPECT_EQ(Tavo_DxfPlainText("%%uunder%%u \\U+00E9t\\U+20AC", false), "under \xE9t\x80");
    EXPECT_EQ(Tavo_DxfPlainText("Caf\xC3\xA9 \xE2\x86\x92", true), "Caf\xE9 ?");
    EXPECT_EQ(Tavo_DxfPlainText("Caf\xE9", false), "Caf\xE9");
    EXPECT_EQ(Tavo_DxfPlainText("bad \xC3 utf8", true), "bad ? utf8");
    EXPECT_EQ(Tavo_DxfPlainText("tab\there", false), "tab here");
}

TEST(DxfText, MTextFormattingIsRemovedAndParagraphsSplit)
{
    const std::vector<std::string> lines =
        Tavo_DxfPlainMText("{\\fArial|b1|i0;Bold} \\H2.5x;big\\Pa\\~b \\S1^2; \\{x\\}\\\\\\P\\C1;red\\LU\\l", false);
    ASSERT_EQ(lines.size(), 3u);
    EXPECT_EQ(lines[0], "Bold big");
    EXPECT_EQ(lines[1], "a\xA0"
                        "b 1/2 {x}\\");
    EXPECT_EQ(lines[2], "redU");
    EXPECT_EQ(Tavo_DxfPlainMText("unterminated \\fArial", false), std::vector<std::string>{"unterminated "});
}

// ---- Geometry ---------------------------------------------------------------------------

TEST(DxfGeometry, ExtrusionDownwardsMirrorsX)
{
    const Tavo_DxfAffine up = Tavo_DxfObjectToWorld({0, 0, 1}, 5.0);
    EXPECT_EQ(up.Apply(3, 4).x, 3.0);
    EXPECT_EQ(up.Apply(3, 4).y, 4.0);
    const Tavo_DxfAffine down = Tavo_DxfObjectToWorld({0, 0, -1}, 5.0);
    EXPECT_NEAR(down.Apply(3, 4).x, -3.0, 1e-12);
    EXPECT_NEAR(down.Apply(3, 4).y, 4.0, 1e-12);
    EXPECT_TRUE(down.IsSimilarity());
    const Tavo_DxfAffine zero = Tavo_DxfObjectToWorld({0, 0, 0}, 0.0);
    EXPECT_EQ(zero.Apply(3, 4).x, 3.0);
}

TEST(DxfGeometry, BulgeOfOneIsAHalfCircleTurningCounterClockwise)
{
    Tavo_DxfFlattening fine;
    fine.tolerance = 1e-4;
    std::vector<Tavo_DxfXY> points;
    Tavo_DxfAppendBulge(points, {0, 0}, {2, 0}, 1.0, fine);
    ASSERT_GT(points.size(), 8u);
    EXPECT_EQ(points.back().x, 2.0);
    EXPECT_EQ(points.back().y, 0.0);
    double lowest = 0.0;
    for (const Tavo_DxfXY& p : points) {
        EXPECT_NEAR(std::hypot(p.x - 1.0, p.y), 1.0, 1e-9);
        lowest = std::min(lowest, p.y);
    }
    EXPECT_NEAR(lowest, -1.0, 1e-3); // counter-clockwise from (0,0) to (2,0) passes below
    points.clear();
    Tavo_DxfAppendBulge(points, {0, 0}, {2, 0}, -1.0, fine);
    EXPECT_GT(points[points.size() / 2].y, 0.9);
}

TEST(DxfGeometry, FlatteningFollowsToleranceWithinBounds)
{
    Tavo_DxfFlattening coarse;
    EXPECT_EQ(coarse.Segments(2 * kTavo_DxfPi, 1000.0), Tavo_DxfFlattening::kFewestPerTurn);
    Tavo_DxfFlattening fine;
    fine.tolerance = 0.01;
    const int segments = fine.Segments(2 * kTavo_DxfPi, 100.0);
    const double step = 2 * kTavo_DxfPi / segments;
    EXPECT_LE(100.0 * (1 - std::cos(step / 2)), 0.01);
    EXPECT_EQ(fine.Segments(kTavo_DxfPi / 2, 1e12), Tavo_DxfFlattening::kMostPerTurn / 4);
    EXPECT_EQ(fine.Segments(0.0, 10.0), 1);
    EXPECT_NEAR(Tavo_DxfArcSweep(30, 10), 340 * kTavo_DxfPi / 180, 1e-12);
    EXPECT_NEAR(Tavo_DxfArcSweep(0, 360), 2 * kTavo_DxfPi, 1e-12);
    EXPECT_NEAR(Tavo_DxfArcSweep(90, 90), 2 * kTavo_DxfPi, 1e-12);
}

} // namespace
