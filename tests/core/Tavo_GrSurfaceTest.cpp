// The surface base: the current attribute, and the polygon it expresses
// through triangles or lines.
#include "RecordingSurface.h"

#include <gtest/gtest.h>

#include <cstdlib>
#include <vector>

namespace {

TEST(SurfaceAttribute, OnlyADifferingAttributeIsAChangeAndAPassBoundaryForgetsIt)
{
    RecordingSurface surface;
    Tavo_GrAttr attr(3, 1, 12, 9);
    Tavo_GrAttr same(3, 1, 12, 9);
    surface.SetCurrentAttr(&attr);
    surface.SetCurrentAttr(&same);
    EXPECT_EQ(surface.m_attrChanges, 1) << "the first always counts; an equal one through another pointer does not";
    EXPECT_FALSE(surface.IsHollow());
    attr.SetCharHeight(13);
    surface.SetCurrentAttr(&attr);
    attr.SetTextAlign(6);
    surface.SetCurrentAttr(&attr);
    EXPECT_EQ(surface.m_attrChanges, 3);

    Tavo_GrAttr defaults;
    surface.SetCurrentAttr(nullptr);
    surface.SetCurrentAttr(&defaults);
    EXPECT_EQ(surface.m_attrChanges, 4) << "a null attribute stands for the default";
    EXPECT_TRUE(surface.IsHollow());
    surface.BeginDrawing(nullptr);
    surface.SetCurrentAttr(&defaults);
    surface.EndDrawing();
    surface.SetCurrentAttr(&defaults);
    EXPECT_EQ(surface.m_attrChanges, 6) << "beginning and ending a pass each forget the attribute";
}

// ---- Operations made of simpler ones ---------------------------------------------

TEST(SurfacePolygon, AFilledPolygonBecomesTrianglesCoveringIt)
{
    struct Row {
        const char* name;
        std::vector<Tavo_GrDPoint> points;
        const char* triangles;
        long long twiceArea;
    };
    const Row rows[] = {
        {"square", {{0, 0}, {10, 0}, {10, 10}, {0, 10}}, "Triangle Triangle", 200},
        {"concave L, cut into ears", {{0, 0}, {20, 0}, {20, 10}, {10, 10}, {10, 20}, {0, 20}}, "Triangle Triangle Triangle Triangle", 600},
    };
    for (const Row& row : rows) {
        SCOPED_TRACE(row.name);
        RecordingSurface surface;
        Tavo_GrAttr filled(1, 1);
        std::vector<Tavo_GrDPoint> points = row.points;
        surface.DrawPolygon(static_cast<int>(points.size()), points.data(), &filled);
        ASSERT_EQ(surface.Ops(), row.triangles);
        long long twiceArea = 0;
        for (const RecordingSurface::Call& call : surface.m_calls) {
            const auto& p = call.points;
            twiceArea += std::llabs(static_cast<long long>(p[1].x - p[0].x) * (p[2].y - p[0].y) - static_cast<long long>(p[1].y - p[0].y) * (p[2].x - p[0].x));
        }
        EXPECT_EQ(twiceArea, row.twiceArea);
    }
}

TEST(SurfacePolygon, AnOutlineIsDrawnAsClosedLines)
{
    RecordingSurface surface;
    Tavo_GrAttr outline(1, 0);
    Tavo_GrAttr filled(1, 1);
    Tavo_GrDPoint triangle[3] = {{0, 0}, {10, 0}, {0, 10}};
    surface.DrawPolygon(3, triangle, &outline);
    ASSERT_EQ(surface.Ops(), "Line Line Line");
    EXPECT_EQ(surface.m_calls[2].points[1], (Tavo_GrDPoint{0, 0})) << "closed";
    surface.m_calls.clear(); // degenerate polygons draw what they have
    surface.DrawPolygon(2, triangle, &filled);
    surface.DrawPolygon(-1, triangle, &filled);
    surface.DrawPolygon(3, nullptr, &filled);
    EXPECT_EQ(surface.Ops(), "Line");
}

} // namespace
