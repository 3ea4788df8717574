// Tavo_WiWin32Surface drawing operations, checked on the pixels of a 32-bit
// DIB section (and on the recorded calls where pixels cannot tell).
#include "SurfaceFixture.h"

#pragma push_macro("DrawText")
#undef DrawText

namespace {

Tavo_GrDPoint At(int x, int y)
{
    return Tavo_GrDPoint{x, y};
}

} // namespace

class DrawingTest : public SurfaceTest {
protected:
    Tavo_GrAttr m_red = Outline(kRed);
    Tavo_GrAttr m_redFilled = Filled(kRed);
    Tavo_GrAttr m_blue = Outline(kBlue);
};

// ---- Dots -----------------------------------------------------------------------

TEST_F(DrawingTest, DotIsExactlyOnePixelAtTheFlippedPosition)
{
    Tavo_GrDPoint p = At(17, 30);
    m_surface->DrawDot(p, &m_red);
    EndPass();
    EXPECT_EQ(1, CountColour(kRed));
    EXPECT_TRUE(IsColour(17, kHeight - 30, kRed));
}

TEST_F(DrawingTest, RepeatedDotNeitherDrawsNorChangesTheColour)
{
    Tavo_GrDPoint p = At(17, 30);
    m_surface->DrawDot(p, &m_red);
    m_surface->DrawDot(p, &m_blue);
    EndPass();
    EXPECT_EQ(0, CountColour(kBlue));
    EXPECT_EQ(1, CountColour(kRed));
    EXPECT_EQ(1u, Stats().Get(Tavo_GrSurfaceStats::AttrChanges));
}

// ---- Lines ------------------------------------------------------------------------

TEST_F(DrawingTest, HorizontalLineLeavesOutItsLastPoint)
{
    Tavo_GrDPoint a = At(10, 20), b = At(30, 20);
    m_surface->DrawLine(a, b, &m_red);
    EndPass();
    EXPECT_EQ(20, CountColour(kRed));
    EXPECT_TRUE(IsColour(10, kHeight - 20, kRed));
    EXPECT_FALSE(IsColour(30, kHeight - 20, kRed));
}

TEST_F(DrawingTest, VerticalLineFarBeyondTheSurfaceIsClampedAndCoversTheColumn)
{
    GdiCallRecorder recorder;
    Tavo_GrDPoint a = At(30, -100), b = At(30, kHeight + 50);
    m_surface->DrawLine(a, b, &m_red);
    EndPass();
    bool found = false;
    for (const GdiCall& call : recorder.Of(GdiCall::PolyPolyline)) {
        if (call.count != 1)
            continue;
        found = true;
        EXPECT_EQ(kHeight, call.points[0].y);
        EXPECT_EQ(-1, call.points[1].y);
    }
    EXPECT_TRUE(found);
    EXPECT_EQ(kHeight, m_canvas.CountPixels(ColourOf(kRed), 30, 0, 31, kHeight));
}

TEST_F(DrawingTest, SlantedLineOverTheSameSpanIsNotClamped)
{
    GdiCallRecorder recorder;
    Tavo_GrDPoint a = At(30, -100), b = At(31, kHeight + 50);
    m_surface->DrawLine(a, b, &m_red);
    EndPass();
    bool found = false;
    for (const GdiCall& call : recorder.Of(GdiCall::PolyPolyline)) {
        if (call.count != 1)
            continue;
        found = true;
        EXPECT_EQ(kHeight + 100, call.points[0].y);
        EXPECT_EQ(-50, call.points[1].y);
    }
    EXPECT_TRUE(found);
}

TEST_F(DrawingTest, ThickenedVerticalLineGainsColumnsToTheRight)
{
    m_surface->SetThickenVertLine(2);
    Tavo_GrDPoint a = At(10, 20), b = At(10, 60);
    m_surface->DrawLine(a, b, &m_red);
    Tavo_GrDPoint c = At(50, 80), d = At(90, 80);
    m_surface->DrawLine(c, d, &m_red);
    EndPass();
    for (int x : {10, 11, 12})
        EXPECT_EQ(40, m_canvas.CountPixels(ColourOf(kRed), x, 0, x + 1, kHeight)) << "column " << x;
    EXPECT_EQ(0, m_canvas.CountPixels(ColourOf(kRed), 13, 0, 14, kHeight));
    EXPECT_EQ(0, m_canvas.CountPixels(ColourOf(kRed), 9, 0, 10, kHeight));
    EXPECT_EQ(40, m_canvas.CountPixels(ColourOf(kRed), 0, 0, kWidth, kHeight - 79)) << "horizontal stays one row";
    EXPECT_EQ(4u, Stats().Get(Tavo_GrSurfaceStats::Lines));
}

TEST_F(DrawingTest, ThickeningNeedsAPositiveGate)
{
    m_surface->SetThickenVertLine(2);
    m_surface->SetThickenGate(0.0);
    Tavo_GrDPoint a = At(10, 20), b = At(10, 60);
    m_surface->DrawLine(a, b, &m_red);
    EndPass();
    EXPECT_EQ(40, CountColour(kRed));
}

TEST_F(DrawingTest, ThickeningFromTheEnvironmentWidensVerticalLines)
{
    {
        ScopedEnvironment thicken("BRY_VWR_THICKENVERTICALLINE", "2");
        CreateSurface();
    }
    Tavo_GrDPoint a = At(10, 20), b = At(10, 60);
    m_surface->DrawLine(a, b, &m_red);
    EndPass();
    EXPECT_EQ(120, CountColour(kRed));
}

TEST_F(DrawingTest, PolylineDrawsEachSegment)
{
    Tavo_GrDPoint points[3] = {At(10, 20), At(30, 20), At(30, 50)};
    m_surface->DrawPline(3, points, &m_red);
    EndPass();
    EXPECT_TRUE(IsColour(10, kHeight - 20, kRed));
    EXPECT_TRUE(IsColour(30, kHeight - 40, kRed));
    EXPECT_EQ(2u, Stats().Get(Tavo_GrSurfaceStats::Lines));
}

TEST_F(DrawingTest, PolylineOfFewerThanTwoPointsDrawsNothing)
{
    Tavo_GrDPoint points[1] = {At(10, 20)};
    m_surface->DrawPline(1, points, &m_red);
    m_surface->DrawPline(0, points, &m_red);
    m_surface->DrawPline(-3, points, &m_red);
    m_surface->DrawPline(3, nullptr, &m_red);
    EndPass();
    EXPECT_EQ(0, CountColour(kRed));
    EXPECT_EQ(0u, Stats().Get(Tavo_GrSurfaceStats::Lines));
}

// ---- Rectangles -------------------------------------------------------------------

// Wine's DIB engine draws nothing for a Rectangle one pixel wide and one high
// (Windows draws the pixel), so the one-pixel case is checked on the call and
// the pixels on the thinnest rectangles that both draw.
TEST_F(DrawingTest, DegenerateFilledRectangleIsARectangleCallCoveringOnePixel)
{
    GdiCallRecorder recorder;
    Tavo_GrDRect r{40, 40, 40, 40};
    m_surface->DrawRect(r, &m_redFilled);
    EndPass();
    const std::vector<GdiCall> rects = recorder.Of(GdiCall::Rectangle);
    ASSERT_EQ(1u, rects.size());
    EXPECT_EQ(40, rects[0].values[0]);
    EXPECT_EQ(kHeight - 40, rects[0].values[1]);
    EXPECT_EQ(41, rects[0].values[2]);
    EXPECT_EQ(kHeight - 40 + 1, rects[0].values[3]);
}

TEST_F(DrawingTest, OneColumnAndOneRowRectanglesCoverExactlyTheirPixels)
{
    Tavo_GrDRect column{40, 40, 40, 41};
    Tavo_GrDRect row{60, 40, 61, 40};
    m_surface->DrawRect(column, &m_redFilled);
    m_surface->DrawRect(row, &m_redFilled);
    EndPass();
    EXPECT_EQ(4, CountColour(kRed));
    EXPECT_TRUE(IsColour(40, kHeight - 40, kRed));
    EXPECT_TRUE(IsColour(40, kHeight - 41, kRed));
    EXPECT_TRUE(IsColour(60, kHeight - 40, kRed));
    EXPECT_TRUE(IsColour(61, kHeight - 40, kRed));
}

TEST_F(DrawingTest, FilledRectangleIncludesBothEdges)
{
    Tavo_GrDRect r{10, 20, 29, 34};
    m_surface->DrawRect(r, &m_redFilled);
    EndPass();
    EXPECT_EQ(20 * 15, CountColour(kRed));
    EXPECT_TRUE(IsColour(10, kHeight - 20, kRed));
    EXPECT_TRUE(IsColour(29, kHeight - 34, kRed));
}

TEST_F(DrawingTest, HollowRectangleOutlinesTheSamePixelsAsTheFilledOneBorders)
{
    Tavo_GrDRect r{10, 20, 29, 34};
    m_surface->DrawRect(r, &m_red);
    EndPass();
    EXPECT_TRUE(IsColour(10, kHeight - 34, kRed));
    EXPECT_FALSE(IsColour(20, kHeight - 27, kRed)) << "inside stays empty";
    EXPECT_EQ(2 * 21 + 2 * 14, CountColour(kRed)) << "outline through (l,t) .. (r+1,b+1)";
}

// ---- Circles and triangles ---------------------------------------------------------

TEST_F(DrawingTest, CircleWithoutRadiusIsOneDot)
{
    GdiCallRecorder recorder;
    Tavo_GrDPoint c = At(50, 50);
    m_surface->DrawCircle(c, 0, &m_red);
    Tavo_GrDPoint d = At(70, 50);
    m_surface->DrawCircle(d, -5, &m_red);
    EndPass();
    EXPECT_EQ(2, CountColour(kRed));
    EXPECT_TRUE(IsColour(70, kHeight - 50, kRed));
    EXPECT_EQ(2u, Stats().Get(Tavo_GrSurfaceStats::Dots));
}

TEST_F(DrawingTest, CircleDotDoesNotTakePartInRepeatSuppression)
{
    Tavo_GrDPoint c = At(50, 50);
    m_surface->DrawCircle(c, 0, &m_red);
    m_surface->DrawDot(c, &m_red);
    EndPass();
    EXPECT_EQ(2u, Stats().Get(Tavo_GrSurfaceStats::Dots));
}

TEST_F(DrawingTest, SmallCircleIsAnOutlinedTriangleWhateverTheFill)
{
    GdiCallRecorder recorder;
    Tavo_GrDPoint c = At(50, 50);
    m_surface->DrawCircle(c, 2, &m_redFilled);
    EndPass();
    EXPECT_EQ(1u, Stats().Get(Tavo_GrSurfaceStats::HollowTriangles));
    EXPECT_EQ(0u, Stats().Get(Tavo_GrSurfaceStats::Circles));
    const int y = kHeight - 50;
    bool found = false;
    for (const GdiCall& call : recorder.Of(GdiCall::PolyPolyline)) {
        if (call.count != 1)
            continue;
        found = true;
        ASSERT_EQ(4u, call.points.size());
        EXPECT_EQ(48, call.points[0].x);
        EXPECT_EQ(y + 2, call.points[0].y);
        EXPECT_EQ(52, call.points[1].x);
        EXPECT_EQ(y + 2, call.points[1].y);
        EXPECT_EQ(50, call.points[2].x);
        EXPECT_EQ(y - 2, call.points[2].y);
    }
    EXPECT_TRUE(found);
}

TEST_F(DrawingTest, FilledCircleIsFilledInItsOutlineColour)
{
    Tavo_GrDPoint c = At(60, 60);
    m_surface->DrawCircle(c, 3, &m_redFilled);
    Tavo_GrDPoint d = At(150, 60);
    m_surface->DrawCircle(d, 20, &m_redFilled);
    EndPass();
    EXPECT_EQ(2u, Stats().Get(Tavo_GrSurfaceStats::Circles));
    EXPECT_TRUE(IsColour(150, kHeight - 60, kRed));
    EXPECT_TRUE(IsColour(60, kHeight - 60, kRed));
}

TEST_F(DrawingTest, HollowCircleLeavesItsInsideEmpty)
{
    Tavo_GrDPoint c = At(100, 60);
    m_surface->DrawCircle(c, 20, &m_red);
    EndPass();
    EXPECT_FALSE(IsColour(100, kHeight - 60, kRed));
    EXPECT_TRUE(IsColour(80, kHeight - 60, kRed));
    EXPECT_GT(CountColour(kRed), 80);
}

TEST_F(DrawingTest, TinyOutlinedTriangleIsAnOpenUniangle)
{
    GdiCallRecorder recorder;
    Tavo_GrDPoint points[3] = {At(10, 10), At(14, 6), At(6, 14)};
    m_surface->DrawTriangle(points, &m_red);
    EndPass();
    EXPECT_EQ(1u, Stats().Get(Tavo_GrSurfaceStats::Lines));
    EXPECT_EQ(0u, Stats().Get(Tavo_GrSurfaceStats::HollowTriangles));
}

TEST_F(DrawingTest, TriangleWithAFarPointIsClosed)
{
    Tavo_GrDPoint points[3] = {At(10, 10), At(15, 10), At(6, 14)};
    m_surface->DrawTriangle(points, &m_red);
    EndPass();
    EXPECT_EQ(0u, Stats().Get(Tavo_GrSurfaceStats::Lines));
    EXPECT_EQ(1u, Stats().Get(Tavo_GrSurfaceStats::HollowTriangles));
}

TEST_F(DrawingTest, FilledTriangleIsFilled)
{
    Tavo_GrDPoint points[3] = {At(20, 20), At(120, 20), At(70, 120)};
    m_surface->DrawTriangle(points, &m_redFilled);
    EndPass();
    EXPECT_TRUE(IsColour(70, kHeight - 50, kRed));
    EXPECT_FALSE(IsColour(25, kHeight - 110, kRed));
    EXPECT_EQ(1u, Stats().Get(Tavo_GrSurfaceStats::FilledTriangles));
}

TEST_F(DrawingTest, GridChangesNothingNotEvenTheAttribute)
{
    GdiCallRecorder recorder;
    Tavo_GrDPoint a = At(0, 0), b = At(10, 10), c = At(100, 100);
    m_surface->DrawGrid(a, b, c, &m_red);
    EXPECT_TRUE(recorder.GetCalls().empty());
    EndPass();
    EXPECT_EQ(0, CountColour(kRed));
    EXPECT_EQ(0u, Stats().Get(Tavo_GrSurfaceStats::AttrChanges));
}

#pragma pop_macro("DrawText")
