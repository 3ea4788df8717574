// The surface base: the current attribute, and the operations it expresses
// through simpler ones.
#include "RecordingSurface.h"

#include <gtest/gtest.h>

#pragma push_macro("DrawText")
#undef DrawText

namespace {

TEST(SurfaceAttribute, TheFirstAttributeAlwaysCountsAsAChange)
{
    RecordingSurface surface;
    Tavo_GrAttr attr(0, 0);
    surface.SetCurrentAttr(&attr);
    EXPECT_EQ(surface.m_attrChanges, 1);
}

TEST(SurfaceAttribute, AnEqualAttributeIsNoChangeEvenThroughAnotherPointer)
{
    RecordingSurface surface;
    Tavo_GrAttr first(3, 1, 12, 9);
    Tavo_GrAttr same(3, 1, 12, 9);
    surface.SetCurrentAttr(&first);
    surface.SetCurrentAttr(&same);
    EXPECT_EQ(surface.m_attrChanges, 1);
    EXPECT_EQ(surface.GetCurrentColor(), 3);
    EXPECT_EQ(surface.GetCurrentFill(), 1);
    EXPECT_EQ(surface.GetCurrentCharHeight(), 12);
    EXPECT_EQ(surface.GetCurrentTextAlign(), 9);
}

TEST(SurfaceAttribute, AnyDifferingFieldIsAChange)
{
    RecordingSurface surface;
    Tavo_GrAttr attr(3, 1, 12, 5);
    surface.SetCurrentAttr(&attr);
    attr.SetCharHeight(13);
    surface.SetCurrentAttr(&attr);
    attr.SetTextAlign(6);
    surface.SetCurrentAttr(&attr);
    EXPECT_EQ(surface.m_attrChanges, 3);
}

TEST(SurfaceAttribute, BeginningOrEndingAPassForgetsTheCurrentAttribute)
{
    RecordingSurface surface;
    Tavo_GrAttr attr(3, 1);
    surface.SetCurrentAttr(&attr);
    surface.BeginDrawing(nullptr);
    surface.SetCurrentAttr(&attr);
    surface.EndDrawing();
    surface.SetCurrentAttr(&attr);
    EXPECT_EQ(surface.m_attrChanges, 3);
}

TEST(SurfaceAttribute, HollowFlagFollowsTheFill)
{
    RecordingSurface surface;
    Tavo_GrAttr outline(2, 0);
    Tavo_GrAttr filled(2, 1);
    surface.SetCurrentAttr(&filled);
    EXPECT_FALSE(surface.IsHollow());
    surface.SetCurrentAttr(&outline);
    EXPECT_TRUE(surface.IsHollow());
}

TEST(SurfaceAttribute, ANullAttributeStandsForTheDefault)
{
    RecordingSurface surface;
    surface.SetCurrentAttr(nullptr);
    EXPECT_EQ(surface.m_attrChanges, 1);
    EXPECT_EQ(surface.GetCurrentAttr(), Tavo_GrAttr());
    Tavo_GrAttr defaults;
    surface.SetCurrentAttr(&defaults);
    EXPECT_EQ(surface.m_attrChanges, 1);
}

TEST(SurfaceState, SettingsKeepTheirValues)
{
    RecordingSurface surface;
    EXPECT_EQ(surface.GetThickenGate(), 1.0);
    EXPECT_EQ(surface.GetSurfaceOption(), 0);
    EXPECT_FALSE(surface.IsScreenPaint());
    surface.SetThickenGate(0.0);
    surface.SetSurfaceOption(3);
    surface.SetScreenPaintFlag(1);
    surface.SetDeviceHeight(480);
    surface.SetTransform(Tavo_GrTransform(2.5, 0.0, 0.0));
    EXPECT_EQ(surface.GetThickenGate(), 0.0);
    EXPECT_EQ(surface.GetSurfaceOption(), 3);
    EXPECT_TRUE(surface.IsScreenPaint());
    EXPECT_EQ(surface.GetDeviceHeight(), 480);
    EXPECT_EQ(surface.GetScale(), 2.5);
}

TEST(SurfaceState, InterruptFlagStaysSetUntilReset)
{
    RecordingSurface surface;
    EXPECT_FALSE(surface.PollDrawInterrupt());
    surface.m_interruptAtPoll = 1;
    EXPECT_TRUE(surface.PollDrawInterrupt());
    surface.m_interruptAtPoll = 0;
    EXPECT_TRUE(surface.PollDrawInterrupt());
    surface.ResetDrawingInterruptFlags();
    EXPECT_FALSE(surface.IsDrawingInterrupted());
}

// ---- Operations made of simpler ones ---------------------------------------------

// Twice the area of the triangles a polygon was cut into.
long long TwiceArea(const RecordingSurface& surface)
{
    long long sum = 0;
    for (const RecordingSurface::Call& call : surface.m_calls) {
        if (call.op != "Triangle")
            continue;
        const auto& p = call.points;
        const long long cross = static_cast<long long>(p[1].x - p[0].x) * (p[2].y - p[0].y)
            - static_cast<long long>(p[1].y - p[0].y) * (p[2].x - p[0].x);
        sum += cross < 0 ? -cross : cross;
    }
    return sum;
}

struct PolygonSurface : RecordingSurface {
    void DrawPolygon(int count, Tavo_GrDPoint* points, Tavo_GrAttr* attr) override
    {
        Tavo_GrSurface::DrawPolygon(count, points, attr);
    }
};

TEST(SurfacePolygon, AFilledConvexPolygonBecomesTrianglesCoveringIt)
{
    PolygonSurface surface;
    Tavo_GrAttr filled(1, 1);
    Tavo_GrDPoint square[4] = {{0, 0}, {10, 0}, {10, 10}, {0, 10}};
    surface.DrawPolygon(4, square, &filled);
    EXPECT_EQ(surface.Count("Triangle"), 2);
    EXPECT_EQ(TwiceArea(surface), 200);
}

TEST(SurfacePolygon, AFilledConcavePolygonIsCutIntoEars)
{
    PolygonSurface surface;
    Tavo_GrAttr filled(1, 1);
    // An L: 20 x 10 plus 10 x 10 on top of its left half, area 300.
    Tavo_GrDPoint shape[6] = {{0, 0}, {20, 0}, {20, 10}, {10, 10}, {10, 20}, {0, 20}};
    surface.DrawPolygon(6, shape, &filled);
    EXPECT_EQ(surface.Count("Triangle"), 4);
    EXPECT_EQ(TwiceArea(surface), 600);
}

TEST(SurfacePolygon, AHollowPolygonIsItsClosedOutline)
{
    PolygonSurface surface;
    Tavo_GrAttr outline(1, 0);
    Tavo_GrDPoint triangle[3] = {{0, 0}, {10, 0}, {0, 10}};
    surface.DrawPolygon(3, triangle, &outline);
    ASSERT_EQ(surface.Count("Line"), 3);
    EXPECT_EQ(surface.m_calls[2].points[1], (Tavo_GrDPoint{0, 0}));
}

TEST(SurfacePolygon, DegeneratePolygonsDrawWhatTheyHave)
{
    PolygonSurface surface;
    Tavo_GrAttr filled(1, 1);
    Tavo_GrDPoint two[2] = {{0, 0}, {5, 5}};
    surface.DrawPolygon(2, two, &filled);
    surface.DrawPolygon(-1, two, &filled);
    surface.DrawPolygon(3, nullptr, &filled);
    EXPECT_EQ(surface.Count("Line"), 1);
    EXPECT_EQ(surface.Count("Triangle"), 0);
}

TEST(SurfaceBase, PolylineAndTriangleAreDrawnAsLines)
{
    struct LinesOnly : RecordingSurface {
        void DrawPline(int count, Tavo_GrDPoint* points, Tavo_GrAttr* attr) override
        {
            Tavo_GrSurface::DrawPline(count, points, attr);
        }
        void DrawTriangle(Tavo_GrDPoint points[3], Tavo_GrAttr* attr) override
        {
            Tavo_GrSurface::DrawTriangle(points, attr);
        }
    } surface;
    Tavo_GrAttr attr(1, 1);
    Tavo_GrDPoint points[3] = {{0, 0}, {10, 0}, {0, 10}};
    surface.DrawPline(3, points, &attr);
    surface.DrawTriangle(points, &attr);
    EXPECT_EQ(surface.Count("Line"), 5);
}

} // namespace

#pragma pop_macro("DrawText")
