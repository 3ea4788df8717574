// The viewer's words and numbers without windows: positions written to the
// pixel, zoom texts, item descriptions, and the command line.
#include "DrawingUnits.h"
#include "ItemDescription.h"
#include "StatusText.h"
#include "ViewerOptions.h"
#include "ViewerStatusBar.h"

#include "Tavo_GrDrawingBuilder.h"

#include <gtest/gtest.h>

#include <vector>

namespace {

TEST(DrawingUnitsText, PositionsAreWrittenToTheScreenPixelAndNeverAsMinusZero)
{
    const struct {
        double pixelsPerUnit;
        int decimals;
    } rows[] = {
        {0.01, 0},
        {1.0, 0},
        {1.5, 1},
        {10.0, 1},
        {10.5, 2},
        {3.7e5, 6},
        {1e300, 6},
        {-2.0, 0},
    };
    for (const auto& row : rows)
        EXPECT_EQ(DrawingUnitsText::DecimalsForPixel(row.pixelsPerUnit), row.decimals) << row.pixelsPerUnit;
    EXPECT_EQ(DrawingUnitsText::Fixed(-0.004, 2), "0.00");
    EXPECT_EQ(DrawingUnitsText::Fixed(-0.006, 2), "-0.01");
    EXPECT_EQ(DrawingUnitsText::Length(1200.0), "1200");
    EXPECT_EQ(DrawingUnitsText::Length(0.00012345678), "0.00012346");
    EXPECT_EQ(StatusText::Pointer(12.5, -3.25, 2), "x 12.50   y -3.25");

    DrawingUnits units;
    units.scale = 1000.0;
    units.originX = 5.0;
    units.originY = -1.0;
    EXPECT_DOUBLE_EQ(units.ToDrawingX(2500), 7.5);
    EXPECT_DOUBLE_EQ(units.ToDrawingY(-1000), -2.0);
    EXPECT_DOUBLE_EQ(units.ToDrawingLength(250), 0.25);
}

TEST(StatusText, ZoomNamesTheLevelAndTheMagnificationOfTheFittedDrawing)
{
    const struct {
        double level;
        const char* text;
    } rows[] = {
        {0.0, "Zoom level 0 (1x)"},
        {5.0, "Zoom level 5 (2x)"},
        {2.0, "Zoom level 2 (1.32x)"},
        {7.5, "Zoom level 7.5 (2.83x)"},
        {6.02, "Zoom level 6 (2.3x)"},
        {60.0, "Zoom level 60 (4096x)"},
    };
    for (const auto& row : rows)
        EXPECT_EQ(StatusText::Zoom(row.level, 5), row.text);
}

TEST(ItemDescription, NamesLayerKindSizeTextAndHowManyMoreLieThere)
{
    Tavo_GrDrawing drawing;
    Tavo_GrDrawingBuilder build(drawing);
    build.BeginLayer("site");
    build.SetAttr(Tavo_GrAttr(4, 1));
    const Tavo_GrWPoint triangle[3] = {{0, 0}, {3000, 0}, {0, 1500}};
    build.AddPolygon(3, triangle);
    build.SetAttr(Tavo_GrAttr(1, 0, 100));
    build.AddText(0, 200, "a very long label that the status bar would never hold in full");
    build.AddDot(100, 300);

    DrawingUnits metres;
    metres.scale = 1000.0;
    EXPECT_EQ(ItemDescription::DescribeAperture(drawing, {10, 10, 20, 20}, metres),
              "Layer \"site\": filled polygon, 3 x 1.5");
    EXPECT_EQ(ItemDescription::DescribeAperture(drawing, {90, 190, 110, 310}, metres),
              "Layer \"site\": dot, 0 x 0 (and 2 more)");
    EXPECT_EQ(ItemDescription::DescribeAperture(drawing, {5000, 180, 5010, 190}, metres),
              "Layer \"site\": text \"a very long label that the status bar...\", 6.2 x 0.2");
    EXPECT_EQ(ItemDescription::DescribeAperture(drawing, {2900, 1400, 2950, 1450}, metres), "Nothing here");
    EXPECT_EQ(ItemDescription::KindName(Tavo_GrItemKind::Line, true), "line") << "only closed shapes are filled";
    EXPECT_EQ(ItemDescription::KindName(Tavo_GrItemKind::Call, false), "symbol");
}

TEST(ViewerStatusBar, APartHoldsAtMostItsLongestTextAndSaysWhereItWasCut)
{
    const std::string longest(ViewerStatusBar::MaxPartLength, 'x');
    EXPECT_EQ(ViewerStatusBar::PartText(longest), longest);
    const std::string cut = ViewerStatusBar::PartText(longest + "y");
    EXPECT_EQ(cut.size(), ViewerStatusBar::MaxPartLength);
    EXPECT_EQ(cut.substr(cut.size() - 4), "x...");
}

TEST(ViewerOptions, TheCommandLineNamesAFileOrATourAndRefusesTheRest)
{
    const struct {
        std::vector<const char*> arguments;
        bool ok;
        const char* file;
        const char* tour;
    } rows[] = {
        {{}, true, "", ""},
        {{"plan.dxf"}, true, "plan.dxf", ""},
        {{"--tour", "out", "plan.dxf"}, true, "plan.dxf", "out"},
        {{"plan.dxf", "--tour", "out"}, true, "plan.dxf", "out"},
        {{"--tour"}, false, "", ""},
        {{"--tour", "out"}, false, "", ""},
        {{"a.dxf", "b.dxf"}, false, "", ""},
        {{"--zoom", "3"}, false, "", ""},
    };
    for (const auto& row : rows) {
        std::vector<char*> argv{const_cast<char*>("viewer")};
        for (const char* argument : row.arguments)
            argv.push_back(const_cast<char*>(argument));
        ViewerOptions options;
        std::string error;
        SCOPED_TRACE(testing::Message() << row.arguments.size() << " arguments, first "
                                        << (row.arguments.empty() ? "-" : row.arguments[0]));
        ASSERT_EQ(ParseViewerOptions(static_cast<int>(argv.size()), argv.data(), options, error), row.ok);
        EXPECT_EQ(error.empty(), row.ok) << error;
        if (!row.ok)
            continue;
        EXPECT_EQ(options.file, row.file);
        EXPECT_EQ(options.tourFolder, row.tour);
    }
    ViewerOptions help;
    std::string error;
    char* argv[] = {const_cast<char*>("viewer"), const_cast<char*>("--help")};
    EXPECT_TRUE(ParseViewerOptions(2, argv, help, error) && help.help);
}

} // namespace
