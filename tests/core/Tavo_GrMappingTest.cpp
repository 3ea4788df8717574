// The mapping's zoom model and the transform: zero-level fit, zoom levels,
// panning, the world clip box, window sizes and round trips.
#include "Tavo_GrDrawing.h"
#include "Tavo_GrDrawingBuilder.h"
#include "Tavo_GrMapping.h"

#include <gtest/gtest.h>

#include <climits>
#include <cmath>
#include <cstring>

namespace {

constexpr int kLevelsPerDoubling = 5;

// A drawing whose bounds are (0, 0, 1000, 500), shown in a 400 x 400 window:
// the zero level fits its width, at 0.4 pixels per world unit.
class MappingTest : public ::testing::Test {
protected:
    void SetUp() override
    {
        Tavo_GrDrawingBuilder build(m_drawing);
        build.AddRect(0, 0, 1000, 500);
        m_mapping.SetDeviceWindowSize(400, 400, true, nullptr);
    }

    Tavo_GrDrawing m_drawing;
    Tavo_GrMapping m_mapping{&m_drawing, kLevelsPerDoubling};
};

TEST_F(MappingTest, ZeroLevelFitsTheBoundsAndCentresThem)
{
    EXPECT_DOUBLE_EQ(m_mapping.GetTransform().GetScale(), 0.4);
    EXPECT_EQ(m_mapping.GetZoomLevel(), 0);
    EXPECT_EQ(m_mapping.GetRealZoomLevel(), 0.0);
    EXPECT_EQ(m_mapping.GetWorldClipBox(), (Tavo_GrWRect{0, -250, 1000, 750}));
    EXPECT_EQ(m_mapping.GetTransform().Rect(m_drawing.GetBounds()), (Tavo_GrDRect{0, 100, 400, 300}));
}

TEST_F(MappingTest, ZeroLevelExpansionEnlargesTheBoundsByAPercentageOnEachSide)
{
    m_mapping.SetZeroLevelExpansion(10);
    m_mapping.Zoom(Tavo_GrZoom::ZeroLevel, 0, 0, 1);
    // 1200 x 600 fitted into 400 x 400.
    EXPECT_DOUBLE_EQ(m_mapping.GetTransform().GetScale(), 400.0 / 1200.0);
    EXPECT_EQ(m_mapping.GetTransform().Rect(m_drawing.GetBounds()), (Tavo_GrDRect{33, 117, 367, 283}));
}

TEST_F(MappingTest, ZoomInByLevelsScalesByTheLevelsPerDoublingAndCentresOnThePoint)
{
    EXPECT_NE(m_mapping.Zoom(Tavo_GrZoom::In, 300, 200, kLevelsPerDoubling), 0);
    EXPECT_EQ(m_mapping.GetZoomLevel(), 5);
    EXPECT_EQ(m_mapping.GetRealZoomLevel(), 5.0);
    EXPECT_DOUBLE_EQ(m_mapping.GetTransform().GetScale(), 0.8);
    EXPECT_EQ(m_mapping.GetTransform().Point({300, 200}), (Tavo_GrDPoint{200, 200}));
}

TEST_F(MappingTest, ZoomingOutToLevelZeroShowsTheFitWhateverTheCentre)
{
    m_mapping.Zoom(Tavo_GrZoom::In, 900, 100, 3);
    m_mapping.Zoom(Tavo_GrZoom::Out, 900, 100, 3);
    EXPECT_EQ(m_mapping.GetRealZoomLevel(), 0.0);
    EXPECT_EQ(m_mapping.GetWorldClipBox(), (Tavo_GrWRect{0, -250, 1000, 750}));
}

TEST_F(MappingTest, ZoomLevelNeverGoesBelowZero)
{
    m_mapping.Zoom(Tavo_GrZoom::Out, 500, 250, 4);
    EXPECT_EQ(m_mapping.GetRealZoomLevel(), 0.0);
    EXPECT_FALSE(m_mapping.ChangesZoomLevel(Tavo_GrZoom::Out, 1));
}

TEST_F(MappingTest, KeepLevelRecentresWithoutChangingTheScale)
{
    m_mapping.Zoom(Tavo_GrZoom::ToLevel, 500, 250, 5);
    EXPECT_FALSE(m_mapping.ChangesZoomLevel(Tavo_GrZoom::Keep, 1));
    EXPECT_NE(m_mapping.Zoom(Tavo_GrZoom::Keep, 100, 100, 1), 0);
    EXPECT_DOUBLE_EQ(m_mapping.GetTransform().GetScale(), 0.8);
    EXPECT_EQ(m_mapping.GetTransform().Point({100, 100}), (Tavo_GrDPoint{200, 200}));
    EXPECT_EQ(m_mapping.Zoom(Tavo_GrZoom::Keep, 100, 100, 1), 0) << "nothing changed the second time";
}

TEST_F(MappingTest, ChangesZoomLevelTellsWhetherAZoomWouldMove)
{
    EXPECT_TRUE(m_mapping.ChangesZoomLevel(Tavo_GrZoom::In, 1));
    EXPECT_FALSE(m_mapping.ChangesZoomLevel(Tavo_GrZoom::ZeroLevel, 1));
    EXPECT_FALSE(m_mapping.ChangesZoomLevel(Tavo_GrZoom::Keep, 1));
    m_mapping.Zoom(Tavo_GrZoom::In, 0, 0, 2);
    EXPECT_TRUE(m_mapping.ChangesZoomLevel(Tavo_GrZoom::ZeroLevel, 1));
    EXPECT_TRUE(m_mapping.ChangesZoomLevel(Tavo_GrZoom::Out, 1));
}

TEST_F(MappingTest, ZoomReportsWhetherTheViewChanged)
{
    EXPECT_EQ(m_mapping.Zoom(Tavo_GrZoom::ZeroLevel, 0, 0, 1), 0) << "already at the zero level";
    EXPECT_NE(m_mapping.Zoom(Tavo_GrZoom::ToLevel, 500, 250, 3), 0);
    EXPECT_EQ(m_mapping.Zoom(Tavo_GrZoom::ToLevel, 500, 250, 3), 0);
    EXPECT_NE(m_mapping.Zoom(Tavo_GrZoom::ZeroLevel, 0, 0, 1), 0);
}

TEST_F(MappingTest, UnknownZoomTypesKeepTheLevel)
{
    m_mapping.Zoom(Tavo_GrZoom::ToLevel, 500, 250, 4);
    EXPECT_FALSE(m_mapping.ChangesZoomLevel(static_cast<Tavo_GrZoom::Type>(7), 3));
    m_mapping.Zoom(static_cast<Tavo_GrZoom::Type>(7), 500, 250, 3);
    EXPECT_EQ(m_mapping.GetRealZoomLevel(), 4.0);
}

TEST_F(MappingTest, ALevelThatIsNotANumberIsTheZeroLevel)
{
    m_mapping.Zoom(Tavo_GrZoom::ToLevel, 500, 250, 4);
    m_mapping.Zoom(std::nan(""), 10, 10);
    EXPECT_EQ(m_mapping.GetRealZoomLevel(), 0.0);
    EXPECT_EQ(m_mapping.GetWorldClipBox(), (Tavo_GrWRect{0, -250, 1000, 750}));
}

TEST_F(MappingTest, MaximumZoomLevelLimitsZoomingIn)
{
    m_mapping.SetMaxZoomLevel(7);
    m_mapping.Zoom(Tavo_GrZoom::In, 0, 0, 20);
    EXPECT_EQ(m_mapping.GetZoomLevel(), 7);
    EXPECT_FALSE(m_mapping.ChangesZoomLevel(Tavo_GrZoom::In, 1));
}

TEST_F(MappingTest, LargestZoomKeepsTheWorldClipBoxAtLeastItsSize)
{
    m_mapping.SetMaxZoomLevel(100);
    m_mapping.SetMaxZoomWorldClipBoxSize(100, 100);
    m_mapping.Zoom(Tavo_GrZoom::In, 500, 250, 100);
    // 400 pixels for 100 world units: 4 pixels per unit, ten times the fit.
    EXPECT_NEAR(m_mapping.GetTransform().GetScale(), 4.0, 1e-9);
    EXPECT_NEAR(m_mapping.GetRealZoomLevel(), 5.0 * std::log2(10.0), 1e-9);
    EXPECT_EQ(m_mapping.GetZoomLevel(), 17) << "the integer level is the next whole level";
    const Tavo_GrWRect box = m_mapping.GetWorldClipBox();
    EXPECT_EQ(box.x2 - box.x1, 100);
    EXPECT_FALSE(m_mapping.ChangesZoomLevel(Tavo_GrZoom::In, 1));
}

TEST_F(MappingTest, EnclosingZoomLevelFitsTheRectangleExactly)
{
    const Tavo_GrWRect rect{0, 0, 250, 125};
    const double level = m_mapping.GetEnclosingZoomLevel(rect);
    EXPECT_EQ(level, 10.0);
    m_mapping.Zoom(level, 125, 62);
    EXPECT_DOUBLE_EQ(m_mapping.GetTransform().GetScale(), 1.6);
    EXPECT_EQ(m_mapping.GetWorldClipBox(), (Tavo_GrWRect{0, -63, 250, 187}));
}

TEST_F(MappingTest, EnclosingZoomLevelOfALargeRectangleIsTheZeroLevel)
{
    EXPECT_EQ(m_mapping.GetEnclosingZoomLevel({-5000, -5000, 5000, 5000}), 0.0);
}

TEST_F(MappingTest, EnclosingZoomLevelBetweenWholeLevelsReadsAsTheRealLevel)
{
    const double level = m_mapping.GetEnclosingZoomLevel({0, 0, 300, 300});
    m_mapping.Zoom(level, 150, 150);
    EXPECT_NEAR(m_mapping.GetRealZoomLevel(), 5.0 * std::log2((400.0 / 300.0) / 0.4), 1e-9);
    EXPECT_EQ(m_mapping.GetZoomLevel(), static_cast<int>(std::ceil(m_mapping.GetRealZoomLevel())));
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

TEST_F(MappingTest, PanToPutsTheWorldPointAtTheTopLeftCorner)
{
    m_mapping.Zoom(Tavo_GrZoom::In, 500, 250, 5);
    EXPECT_NE(m_mapping.PanTo({100, 300}), 0);
    const Tavo_GrWRect box = m_mapping.GetWorldClipBox();
    EXPECT_EQ(box.x1, 100);
    EXPECT_EQ(box.y2, 300);
    EXPECT_EQ(box.x2 - box.x1, 500);
    EXPECT_DOUBLE_EQ(m_mapping.GetTransform().GetScale(), 0.8);
    EXPECT_EQ(m_mapping.PanTo({100, 300}), 0);
}

TEST_F(MappingTest, ErrorTermsShiftDevicePointsUntilTheScaleIsSetAnew)
{
    m_mapping.Zoom(Tavo_GrZoom::In, 500, 250, 5);
    const Tavo_GrDPoint before = m_mapping.GetTransform().Point({500, 250});
    m_mapping.SetErrorTerms(2.0, -3.0);
    EXPECT_EQ(m_mapping.GetXErrorTerm(), 2.0);
    EXPECT_EQ(m_mapping.GetYErrorTerm(), -3.0);
    EXPECT_EQ(m_mapping.GetTransform().Point({500, 250}), (Tavo_GrDPoint{before.x + 2, before.y - 3}));
    m_mapping.PanTo({0, 500});
    EXPECT_EQ(m_mapping.GetXErrorTerm(), 2.0) << "panning keeps them";
    m_mapping.Zoom(Tavo_GrZoom::In, 500, 250, 1);
    EXPECT_EQ(m_mapping.GetXErrorTerm(), 0.0);
    EXPECT_EQ(m_mapping.GetYErrorTerm(), 0.0);
}

TEST_F(MappingTest, WorldClipBoxOfTheSameSizeMovesTheView)
{
    m_mapping.Zoom(Tavo_GrZoom::In, 500, 250, 5);
    m_mapping.SetErrorTerms(0.25, 0.0);
    Tavo_GrWRect box = m_mapping.GetWorldClipBox();
    box.x1 += 37;
    box.x2 += 37;
    box.y1 -= 11;
    box.y2 -= 11;
    m_mapping.SetWorldClipBox(box);
    EXPECT_EQ(m_mapping.GetWorldClipBox(), box);
    EXPECT_DOUBLE_EQ(m_mapping.GetTransform().GetScale(), 0.8);
    EXPECT_EQ(m_mapping.GetXErrorTerm(), 0.25);
}

TEST_F(MappingTest, WorldClipBoxOfAnotherSizeIsFittedAndSetsTheRealLevel)
{
    m_mapping.SetWorldClipBox({0, 0, 200, 100});
    EXPECT_DOUBLE_EQ(m_mapping.GetTransform().GetScale(), 2.0);
    EXPECT_NEAR(m_mapping.GetRealZoomLevel(), 5.0 * std::log2(5.0), 1e-9);
    EXPECT_EQ(m_mapping.GetTransform().Point({100, 50}), (Tavo_GrDPoint{200, 200}));
}

TEST_F(MappingTest, ResizingWithoutForceKeepsScaleAndTopLeftCorner)
{
    m_mapping.Zoom(Tavo_GrZoom::In, 500, 250, 5);
    const Tavo_GrWRect before = m_mapping.GetWorldClipBox();
    EXPECT_NE(m_mapping.SetDeviceWindowSize(600, 300, false, nullptr), 0);
    const Tavo_GrWRect after = m_mapping.GetWorldClipBox();
    EXPECT_DOUBLE_EQ(m_mapping.GetTransform().GetScale(), 0.8);
    EXPECT_EQ(after.x1, before.x1);
    EXPECT_EQ(after.y2, before.y2);
    EXPECT_EQ(after.x2 - after.x1, 750);
    EXPECT_EQ(m_mapping.GetDeviceWindowHeight(), 300);
    // The fit of the new window is 0.6 pixels per unit.
    EXPECT_NEAR(m_mapping.GetRealZoomLevel(), 5.0 * std::log2(0.8 / 0.6), 1e-9);
}

TEST_F(MappingTest, ResizingWithoutForceUntilTheDrawingFitsGoesToTheZeroLevel)
{
    m_mapping.Zoom(Tavo_GrZoom::In, 500, 250, 1); // 0.4 * 2^(1/5) = 0.46 pixels per unit
    m_mapping.SetDeviceWindowSize(800, 800, false, nullptr);
    EXPECT_EQ(m_mapping.GetRealZoomLevel(), 0.0);
    EXPECT_DOUBLE_EQ(m_mapping.GetTransform().GetScale(), 0.8);
}

TEST_F(MappingTest, ResizingToTheSameSizeWithoutForceChangesNothing)
{
    EXPECT_EQ(m_mapping.SetDeviceWindowSize(400, 400, false, nullptr), 0);
}

TEST_F(MappingTest, ResizingWithForceKeepsTheLevelAndCentresOnThePoint)
{
    m_mapping.Zoom(Tavo_GrZoom::In, 500, 250, 5);
    const Tavo_GrWPoint centre{700, 100};
    m_mapping.SetDeviceWindowSize(800, 800, true, &centre);
    EXPECT_EQ(m_mapping.GetRealZoomLevel(), 5.0);
    EXPECT_DOUBLE_EQ(m_mapping.GetTransform().GetScale(), 1.6);
    EXPECT_EQ(m_mapping.GetTransform().Point(centre), (Tavo_GrDPoint{400, 400}));
}

TEST_F(MappingTest, ResizingAtTheZeroLevelRefitsTheDrawing)
{
    m_mapping.SetDeviceWindowSize(200, 100, false, nullptr);
    EXPECT_DOUBLE_EQ(m_mapping.GetTransform().GetScale(), 0.2);
    EXPECT_EQ(m_mapping.GetRealZoomLevel(), 0.0);
}

TEST_F(MappingTest, ACopyZoomsIndependently)
{
    Tavo_GrMapping copy = m_mapping;
    copy.Zoom(Tavo_GrZoom::In, 0, 0, 5);
    EXPECT_EQ(m_mapping.GetRealZoomLevel(), 0.0);
    EXPECT_EQ(copy.GetRealZoomLevel(), 5.0);
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

TEST(Transform, ScaleIsTheFirstField)
{
    const Tavo_GrTransform transform(2.5, 10.0, 20.0);
    double first = 0.0;
    static_assert(sizeof(Tavo_GrTransform) >= sizeof(double), "the transform holds doubles");
    std::memcpy(&first, &transform, sizeof first);
    EXPECT_EQ(first, 2.5);
}

TEST(Transform, RectIsNormalisedAndHoldsBothCorners)
{
    const Tavo_GrTransform transform(2.0, 10.0, 20.0);
    EXPECT_EQ(transform.Rect({30, 40, 10, 20}), (Tavo_GrDRect{0, 0, 40, 40}));
    EXPECT_EQ(transform.InvertRect({40, 40, 0, 0}), (Tavo_GrWRect{10, 20, 30, 40}));
}

TEST(Transform, RoundsHalvesAwayFromZero)
{
    const Tavo_GrTransform transform(0.5, 0.0, 0.0);
    EXPECT_EQ(transform.xcoord(3), 2);   // 1.5
    EXPECT_EQ(transform.xcoord(-3), -2); // -1.5
    EXPECT_EQ(transform.Invertxcoord(1), 2);
}

TEST(Transform, SaturatesFarPointsInsteadOfOverflowing)
{
    const Tavo_GrTransform transform(1000.0, 0.0, 0.0);
    EXPECT_EQ(transform.xcoord(2000000000), INT_MAX);
    EXPECT_EQ(transform.ycoord(-2000000000), INT_MIN);
}

TEST_F(MappingTest, DevicePointsSurviveARoundTripWhenZoomedOut)
{
    m_mapping.Zoom(Tavo_GrZoom::In, 321, 123, 5); // 0.8 pixels per unit
    const Tavo_GrTransform& t = m_mapping.GetTransform();
    for (int d = -50; d <= 450; d += 7) {
        EXPECT_EQ(t.xcoord(t.Invertxcoord(d)), d);
        EXPECT_EQ(t.ycoord(t.Invertycoord(d)), d);
    }
}

TEST_F(MappingTest, WorldPointsSurviveARoundTripWhenZoomedIn)
{
    m_mapping.Zoom(Tavo_GrZoom::In, 321, 123, 15); // 3.2 pixels per unit
    m_mapping.SetErrorTerms(0.4, -0.3);
    const Tavo_GrTransform& t = m_mapping.GetTransform();
    for (int w = 200; w <= 450; w += 3) {
        EXPECT_EQ(t.Invertxcoord(t.xcoord(w)), w);
        EXPECT_EQ(t.Invertycoord(t.ycoord(w)), w);
    }
    const Tavo_GrWRect rect{250, 60, 390, 190};
    EXPECT_EQ(t.InvertRect(t.Rect(rect)), rect);
}

} // namespace
