// The mapping's zoom model and the transform: zero-level fit, zoom levels,
// panning, the world clip box, window sizes and round trips.
#include "Tavo_GrDrawing.h"
#include "Tavo_GrDrawingBuilder.h"
#include "Tavo_GrMapping.h"

#include <gtest/gtest.h>

#include <climits>
#include <cmath>

namespace {

constexpr int kLevelsPerDoubling = 5;
const Tavo_GrWRect kZeroLevelBox{0, -250, 1000, 750};

// A drawing whose bounds are (0, 0, 1000, 500), shown in a 400 x 400 window:
// the zero level fits its width, at 0.4 pixels per world unit.
class MappingTest : public ::testing::Test {
protected:
    void SetUp() override
    {
        Tavo_GrDrawingBuilder(m_drawing).AddRect(0, 0, 1000, 500);
        m_mapping.SetDeviceWindowSize(400, 400, true, nullptr);
    }
    double Scale() const { return m_mapping.GetTransform().GetScale(); }

    Tavo_GrDrawing m_drawing;
    Tavo_GrMapping m_mapping{&m_drawing, kLevelsPerDoubling};
};

// ---- Zero level and zooming ------------------------------------------------------

TEST_F(MappingTest, ZeroLevelFitsTheBoundsAndCentresThem)
{
    EXPECT_DOUBLE_EQ(Scale(), 0.4);
    EXPECT_EQ(m_mapping.GetRealZoomLevel(), 0.0);
    EXPECT_EQ(m_mapping.GetWorldClipBox(), kZeroLevelBox);
    EXPECT_EQ(m_mapping.GetTransform().Rect(m_drawing.GetBounds()), (Tavo_GrDRect{0, 100, 400, 300}));

    m_mapping.SetZeroLevelExpansion(10); // a tenth more on each side: 1200 x 600
    m_mapping.Zoom(Tavo_GrZoom::ZeroLevel, 0, 0, 1);
    EXPECT_DOUBLE_EQ(Scale(), 400.0 / 1200.0);
    EXPECT_EQ(m_mapping.GetTransform().Rect(m_drawing.GetBounds()), (Tavo_GrDRect{33, 117, 367, 283}));
}

TEST_F(MappingTest, ZoomInByLevelsScalesByTheLevelsPerDoublingAndCentresOnThePointAndKeepOnlyRecentres)
{
    EXPECT_NE(m_mapping.Zoom(Tavo_GrZoom::In, 300, 200, kLevelsPerDoubling), 0);
    EXPECT_EQ(m_mapping.GetZoomLevel(), 5);
    EXPECT_DOUBLE_EQ(Scale(), 0.8);
    EXPECT_EQ(m_mapping.GetTransform().Point({300, 200}), (Tavo_GrDPoint{200, 200}));
    EXPECT_NE(m_mapping.Zoom(Tavo_GrZoom::Keep, 100, 100, 1), 0);
    EXPECT_DOUBLE_EQ(Scale(), 0.8);
    EXPECT_EQ(m_mapping.GetTransform().Point({100, 100}), (Tavo_GrDPoint{200, 200}));
    EXPECT_EQ(m_mapping.Zoom(Tavo_GrZoom::Keep, 100, 100, 1), 0) << "nothing changed the second time";

    m_mapping.Zoom(Tavo_GrZoom::Out, 900, 100, 5);
    EXPECT_EQ(m_mapping.GetWorldClipBox(), kZeroLevelBox) << "level zero shows the fit whatever the centre";
    m_mapping.Zoom(Tavo_GrZoom::In, 900, 100, 5);
    m_mapping.Zoom(std::nan(""), 10, 10);
    EXPECT_EQ(m_mapping.GetWorldClipBox(), kZeroLevelBox) << "a level that is not a number is the zero level";
}

TEST_F(MappingTest, ZoomAndChangesZoomLevelAgreeOnWhetherTheViewMoves)
{
    const struct {
        Tavo_GrZoom::Type type;
        int amount;
        bool changes;
        double levelAfter;
    } rows[] = {
        {Tavo_GrZoom::ZeroLevel, 1, false, 0.0}, // already at the zero level
        {Tavo_GrZoom::Out, 4, false, 0.0},       // never below zero
        {Tavo_GrZoom::In, 3, true, 3.0},
        {Tavo_GrZoom::ToLevel, 3, false, 3.0},
        {static_cast<Tavo_GrZoom::Type>(7), 3, false, 3.0}, // unknown types keep the level
        {Tavo_GrZoom::Out, 1, true, 2.0},
        {Tavo_GrZoom::ZeroLevel, 1, true, 0.0},
    };
    for (const auto& row : rows) {
        SCOPED_TRACE(testing::Message() << "type " << row.type << " by " << row.amount);
        EXPECT_EQ(m_mapping.ChangesZoomLevel(row.type, row.amount), row.changes);
        EXPECT_EQ(m_mapping.Zoom(row.type, 500, 250, row.amount) != 0, row.changes);
        EXPECT_EQ(m_mapping.GetRealZoomLevel(), row.levelAfter);
    }
}

TEST_F(MappingTest, ZoomingInStopsAtTheMaximumLevelAndTheLargestZoomsClipBox)
{
    m_mapping.SetMaxZoomLevel(7);
    m_mapping.Zoom(Tavo_GrZoom::In, 0, 0, 20);
    EXPECT_EQ(m_mapping.GetZoomLevel(), 7);

    m_mapping.SetMaxZoomLevel(100);
    m_mapping.SetMaxZoomWorldClipBoxSize(100, 100);
    m_mapping.Zoom(Tavo_GrZoom::In, 500, 250, 100);
    // 400 pixels for 100 world units: 4 pixels per unit, ten times the fit.
    EXPECT_NEAR(Scale(), 4.0, 1e-9);
    EXPECT_NEAR(m_mapping.GetRealZoomLevel(), 5.0 * std::log2(10.0), 1e-9);
    EXPECT_EQ(m_mapping.GetZoomLevel(), 17) << "the integer level is the next whole level";
    EXPECT_EQ(m_mapping.GetWorldClipBox().x2 - m_mapping.GetWorldClipBox().x1, 100);
}

// ---- Enclosing level ---------------------------------------------------------------

TEST_F(MappingTest, EnclosingZoomLevelFitsTheRectangle)
{
    EXPECT_EQ(m_mapping.GetEnclosingZoomLevel({-5000, -5000, 5000, 5000}), 0.0) << "never below zero";
    const double between = m_mapping.GetEnclosingZoomLevel({0, 0, 300, 300});
    EXPECT_NEAR(between, 5.0 * std::log2((400.0 / 300.0) / 0.4), 1e-9);
    m_mapping.Zoom(between, 150, 150);
    EXPECT_EQ(m_mapping.GetZoomLevel(), static_cast<int>(std::ceil(between)));

    const double level = m_mapping.GetEnclosingZoomLevel({0, 0, 250, 125});
    EXPECT_EQ(level, 10.0);
    m_mapping.Zoom(level, 125, 62);
    EXPECT_DOUBLE_EQ(Scale(), 1.6);
    EXPECT_EQ(m_mapping.GetWorldClipBox(), (Tavo_GrWRect{0, -63, 250, 187}));
}

TEST(MappingEnclosingLevel, TheClipBoxOfAWholeLevelGivesBackThatLevel)
{
    Tavo_GrDrawing drawing;
    Tavo_GrDrawingBuilder(drawing).AddRect(0, 0, 1003, 500);
    Tavo_GrMapping mapping(&drawing, 5);
    mapping.SetZeroLevelExpansion(10); // 1203.6 units wide: the clip box rounds to 1203
    mapping.SetDeviceWindowSize(400, 400, true, nullptr);
    const Tavo_GrWRect zeroLevelBox = mapping.GetWorldClipBox();
    ASSERT_EQ(zeroLevelBox.x2 - zeroLevelBox.x1, 1203);
    EXPECT_EQ(mapping.GetEnclosingZoomLevel(zeroLevelBox), 0.0);

    mapping.Zoom(Tavo_GrZoom::ToLevel, 300, 200, 7);
    const Tavo_GrWRect levelSevenBox = mapping.GetWorldClipBox();
    mapping.Zoom(Tavo_GrZoom::ZeroLevel, 0, 0, 1);
    EXPECT_EQ(mapping.GetEnclosingZoomLevel(levelSevenBox), 7.0);
}

// ---- Panning, error terms and the clip box ----------------------------------------------

TEST_F(MappingTest, PanToPutsTheWorldPointAtTheTopLeftCornerAndErrorTermsShiftDevicePointsUntilAZoomOrAFit)
{
    m_mapping.Zoom(Tavo_GrZoom::In, 500, 250, 5);
    EXPECT_NE(m_mapping.PanTo({100, 300}), 0);
    EXPECT_EQ(m_mapping.GetWorldClipBox(), (Tavo_GrWRect{100, -200, 600, 300}));
    EXPECT_DOUBLE_EQ(Scale(), 0.8);
    EXPECT_EQ(m_mapping.PanTo({100, 300}), 0);

    const Tavo_GrDPoint before = m_mapping.GetTransform().Point({500, 250});
    m_mapping.SetErrorTerms(2.0, -3.0);
    EXPECT_EQ(m_mapping.GetTransform().Point({500, 250}), (Tavo_GrDPoint{before.x + 2, before.y - 3}));
    m_mapping.PanTo({0, 500});
    EXPECT_EQ(m_mapping.GetXErrorTerm(), 2.0) << "panning keeps them";
    // Terms that never put a corner on half a unit, where rounding half away
    // from zero is not the same on both sides of zero.
    m_mapping.SetErrorTerms(0.25, -3.0);
    Tavo_GrWRect box = m_mapping.GetWorldClipBox();
    box = {box.x1 + 37, box.y1 - 11, box.x2 + 37, box.y2 - 11};
    m_mapping.SetWorldClipBox(box);
    EXPECT_EQ(m_mapping.GetWorldClipBox(), box);
    EXPECT_DOUBLE_EQ(Scale(), 0.8);
    EXPECT_EQ(m_mapping.GetYErrorTerm(), -3.0) << "so does a clip box of the same size";
    m_mapping.Zoom(Tavo_GrZoom::In, 500, 250, 1);
    EXPECT_TRUE(m_mapping.GetXErrorTerm() == 0.0 && m_mapping.GetYErrorTerm() == 0.0);

    m_mapping.SetErrorTerms(1.0, 1.0); // a clip box of another size is fitted and centred, without them
    m_mapping.SetWorldClipBox({0, 0, 200, 100});
    EXPECT_DOUBLE_EQ(Scale(), 2.0);
    EXPECT_NEAR(m_mapping.GetRealZoomLevel(), 5.0 * std::log2(5.0), 1e-9);
    EXPECT_EQ(m_mapping.GetTransform().Point({100, 50}), (Tavo_GrDPoint{200, 200}));
}

// ---- Window sizes ----------------------------------------------------------------------

TEST_F(MappingTest, ResizingWithoutForceKeepsScaleAndTopLeftCornerAboveTheZeroLevel)
{
    EXPECT_EQ(m_mapping.SetDeviceWindowSize(400, 400, false, nullptr), 0) << "same size";
    m_mapping.Zoom(Tavo_GrZoom::In, 500, 250, 5);
    const Tavo_GrWRect before = m_mapping.GetWorldClipBox();
    EXPECT_NE(m_mapping.SetDeviceWindowSize(600, 300, false, nullptr), 0);
    EXPECT_EQ(m_mapping.GetWorldClipBox(), (Tavo_GrWRect{before.x1, before.y2 - 375, before.x1 + 750, before.y2}));
    EXPECT_DOUBLE_EQ(Scale(), 0.8);
    // The fit of the new window is 0.6 pixels per unit.
    EXPECT_NEAR(m_mapping.GetRealZoomLevel(), 5.0 * std::log2(0.8 / 0.6), 1e-9);

    // Grown until the drawing fits at more than the kept scale: the zero level.
    m_mapping.SetDeviceWindowSize(1000, 1000, false, nullptr);
    EXPECT_EQ(m_mapping.GetRealZoomLevel(), 0.0);
    EXPECT_DOUBLE_EQ(Scale(), 1.0);
    m_mapping.SetDeviceWindowSize(200, 100, false, nullptr);
    EXPECT_DOUBLE_EQ(Scale(), 0.2) << "at the zero level a resize refits the drawing";
}

TEST_F(MappingTest, ResizingWithForceKeepsTheLevelAndCentresOnThePoint)
{
    m_mapping.Zoom(Tavo_GrZoom::In, 500, 250, 5);
    const Tavo_GrWPoint centre{700, 100};
    m_mapping.SetDeviceWindowSize(800, 800, true, &centre);
    EXPECT_EQ(m_mapping.GetRealZoomLevel(), 5.0);
    EXPECT_DOUBLE_EQ(Scale(), 1.6);
    EXPECT_EQ(m_mapping.GetTransform().Point(centre), (Tavo_GrDPoint{400, 400}));
}

TEST(MappingWithoutDrawing, FitsAOneUnitDrawingAndNeverDividesByZero)
{
    Tavo_GrMapping mapping(nullptr, 0);
    EXPECT_EQ(mapping.GetLevelsPerDoubling(), 1);
    mapping.SetDeviceWindowSize(0, 0, true, nullptr);
    EXPECT_EQ(mapping.GetTransform().GetScale(), 1.0);
    mapping.SetDeviceWindowSize(100, 50, true, nullptr);
    EXPECT_DOUBLE_EQ(mapping.GetTransform().GetScale(), 50.0);
    EXPECT_EQ(mapping.GetEnclosingZoomLevel({0, 0, 0, 0}), 0.0);
}

// ---- Transform ----------------------------------------------------------------

TEST(Transform, RoundsHalvesAwayFromZeroSaturatesAndNormalisesRectangles)
{
    const Tavo_GrTransform half(0.5, 0.0, 0.0);
    EXPECT_EQ(half.xcoord(3), 2);   // 1.5
    EXPECT_EQ(half.xcoord(-3), -2); // -1.5
    EXPECT_EQ(half.Invertxcoord(1), 2);
    const Tavo_GrTransform large(1000.0, 0.0, 0.0);
    EXPECT_EQ(large.xcoord(2000000000), INT_MAX);
    EXPECT_EQ(large.ycoord(-2000000000), INT_MIN);
    const Tavo_GrTransform transform(2.0, 10.0, 20.0);
    EXPECT_EQ(transform.Rect({30, 40, 10, 20}), (Tavo_GrDRect{0, 0, 40, 40}));
    EXPECT_EQ(transform.InvertRect({40, 40, 0, 0}), (Tavo_GrWRect{10, 20, 30, 40}));
}

TEST_F(MappingTest, PointsSurviveARoundTripFromTheCoarserSide)
{
    m_mapping.Zoom(Tavo_GrZoom::In, 321, 123, 5); // 0.8 pixels per unit: device points
    const Tavo_GrTransform& out = m_mapping.GetTransform();
    for (int d = -50; d <= 450; d += 7)
        EXPECT_TRUE(out.xcoord(out.Invertxcoord(d)) == d && out.ycoord(out.Invertycoord(d)) == d) << d;
    m_mapping.Zoom(Tavo_GrZoom::In, 321, 123, 10); // 3.2 pixels per unit: world points
    m_mapping.SetErrorTerms(0.4, -0.3);
    const Tavo_GrTransform& in = m_mapping.GetTransform();
    for (int w = 200; w <= 450; w += 3)
        EXPECT_TRUE(in.Invertxcoord(in.xcoord(w)) == w && in.Invertycoord(in.ycoord(w)) == w) << w;
    const Tavo_GrWRect rect{250, 60, 390, 190};
    EXPECT_EQ(in.InvertRect(in.Rect(rect)), rect);
}

} // namespace
