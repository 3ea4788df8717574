// What lies under a world rectangle: each kind found by its shape rather than
// its bounds, drawing order across layers, hidden layers, stopping early,
// calls, extreme coordinates, and queries that leave later passes
// allocation-free.
#include "HeapCallCounter.h"
#include "RecordingSurface.h"

#include "Tavo_GrDrawing.h"
#include "Tavo_GrDrawingBuilder.h"
#include "Tavo_GrMapping.h"

#include <gtest/gtest.h>

#include <climits>
#include <string>
#include <vector>

namespace {

constexpr char Hollow = 0;
constexpr char Filled = 1;

// A square aperture of half-width 2 around (x, y).
Tavo_GrWRect ApertureAt(int x, int y)
{
    return {x - 2, y - 2, x + 2, y + 2};
}

std::vector<Tavo_GrItemInfo> Found(const Tavo_GrDrawing& drawing, const Tavo_GrWRect& area)
{
    std::vector<Tavo_GrItemInfo> found;
    drawing.FindItems(area, [&found](const Tavo_GrItemInfo& info) {
        found.push_back(info);
        return true;
    });
    return found;
}

// One item, and two points of its bounds: one its shape covers, one it does not.
struct ShapeCase {
    const char* name;
    char fill;
    void (*add)(Tavo_GrDrawingBuilder&);
    Tavo_GrWPoint on;
    Tavo_GrWPoint off; // inside the bounds, outside the shape
};

const ShapeCase kShapeCases[] = {
    {"diagonal line", Hollow, [](Tavo_GrDrawingBuilder& b) { b.AddLine(0, 0, 1000, 1000); }, {500, 500}, {800, 100}},
    {"polyline (open: no closing segment)", Hollow, [](Tavo_GrDrawingBuilder& b) {
         const Tavo_GrWPoint p[3] = {{0, 0}, {1000, 0}, {1000, 1000}};
         b.AddPolyline(3, p);
     },
     {1000, 600},
     {500, 500}},
    {"hollow rectangle: its outline", Hollow, [](Tavo_GrDrawingBuilder& b) { b.AddRect(0, 0, 1000, 600); }, {1000, 300}, {500, 300}},
    {"filled rectangle: its inside", Filled, [](Tavo_GrDrawingBuilder& b) { b.AddRect(0, 0, 1000, 600); }, {500, 300}, {1200, 300}},
    {"hollow circle: its rim", Hollow, [](Tavo_GrDrawingBuilder& b) { b.AddCircle(500, 500, 400); }, {900, 500}, {500, 500}},
    {"filled circle: its disc, not the corners of its box", Filled, [](Tavo_GrDrawingBuilder& b) { b.AddCircle(500, 500, 400); }, {500, 500}, {140, 140}},
    {"filled L-shaped polygon: not its notch", Filled, [](Tavo_GrDrawingBuilder& b) {
         const Tavo_GrWPoint p[6] = {{0, 0}, {1000, 0}, {1000, 400}, {400, 400}, {400, 1000}, {0, 1000}};
         b.AddPolygon(6, p);
     },
     {200, 800},
     {700, 700}},
    {"hollow polygon: its closing edge", Hollow, [](Tavo_GrDrawingBuilder& b) {
         const Tavo_GrWPoint p[4] = {{0, 0}, {1000, 0}, {1000, 1000}, {0, 1000}};
         b.AddPolygon(4, p);
     },
     {0, 500},
     {500, 500}},
    {"filled triangle: not beyond its slanted side", Filled, [](Tavo_GrDrawingBuilder& b) { b.AddTriangle({0, 0}, {1000, 0}, {0, 1000}); }, {200, 200}, {800, 800}},
    {"dot", Hollow, [](Tavo_GrDrawingBuilder& b) { b.AddDot(300, 300); }, {301, 299}, {310, 300}},
};

TEST(DrawingQuery, EachKindIsFoundByItsShapeNotByItsBounds)
{
    for (const ShapeCase& c : kShapeCases) {
        SCOPED_TRACE(c.name);
        Tavo_GrDrawing drawing;
        Tavo_GrDrawingBuilder build(drawing);
        build.SetAttr(Tavo_GrAttr(4, c.fill));
        c.add(build);
        EXPECT_EQ(Found(drawing, ApertureAt(c.on.x, c.on.y)).size(), 1u);
        EXPECT_EQ(Found(drawing, ApertureAt(c.off.x, c.off.y)).size(), 0u);
    }
}

TEST(DrawingQuery, ReportsLayerPlaceKindAttributeBoundsAndTextInDrawingOrder)
{
    Tavo_GrDrawing drawing;
    Tavo_GrDrawingBuilder build(drawing);
    build.BeginLayer("walls");
    build.SetAttr(Tavo_GrAttr(4, Filled));
    build.AddRect(0, 0, 100, 100);
    build.AddLine(-50, 50, 150, 50);
    build.BeginLayer("hidden");
    build.AddDot(50, 50);
    build.BeginLayer("labels");
    build.SetAttr(Tavo_GrAttr(1, Hollow, 10));
    build.AddText(40, 50, "door");
    build.UseLayer(0);
    build.AddCircle(500, 500, 5); // elsewhere
    drawing.SetLayerVisible(1, false);

    const std::vector<Tavo_GrItemInfo> found = Found(drawing, ApertureAt(50, 50));
    ASSERT_EQ(found.size(), 3u);
    EXPECT_STREQ(found[0].layer->GetName(), "walls");
    EXPECT_EQ(found[0].index, 0);
    EXPECT_EQ(found[0].kind, Tavo_GrItemKind::Rect);
    EXPECT_EQ(found[0].attr, Tavo_GrAttr(4, Filled));
    EXPECT_EQ(found[0].bounds, (Tavo_GrWRect{0, 0, 100, 100}));
    EXPECT_EQ(found[0].text, nullptr);
    EXPECT_EQ(found[1].index, 1);
    EXPECT_EQ(found[1].kind, Tavo_GrItemKind::Line);
    EXPECT_STREQ(found[2].layer->GetName(), "labels");
    EXPECT_EQ(found[2].kind, Tavo_GrItemKind::Text);
    EXPECT_STREQ(found[2].text, "door");
}

TEST(DrawingQuery, AVisitorThatReturnsFalseEndsTheSearchAndSwappedCornersCount)
{
    Tavo_GrDrawing drawing;
    Tavo_GrDrawingBuilder build(drawing);
    for (int i = 0; i < 5; ++i)
        build.AddLine(0, i, 100, i);
    int seen = 0;
    const int reported = drawing.FindItems({60, 10, 40, -10}, [&seen](const Tavo_GrItemInfo&) { return ++seen < 2; });
    EXPECT_EQ(reported, 2);
    EXPECT_EQ(seen, 2);
    EXPECT_EQ(drawing.FindItems({40, -10, 60, 10}, nullptr), 0);
    EXPECT_EQ(Found(Tavo_GrDrawing(), {0, 0, 10, 10}).size(), 0u);
}

TEST(DrawingQuery, ACallIsFoundWhereAnItemOfTheCalledDrawingIs)
{
    Tavo_GrDrawing symbol;
    Tavo_GrDrawingBuilder(symbol).AddCircle(0, 0, 10); // hollow: only its rim
    Tavo_GrDrawing drawing;
    Tavo_GrDrawingBuilder(drawing).AddCall(&symbol, 1000, 2000);

    const std::vector<Tavo_GrItemInfo> onRim = Found(drawing, ApertureAt(1010, 2000));
    ASSERT_EQ(onRim.size(), 1u);
    EXPECT_EQ(onRim[0].kind, Tavo_GrItemKind::Call);
    EXPECT_EQ(onRim[0].bounds, (Tavo_GrWRect{990, 1990, 1010, 2010}));
    EXPECT_EQ(Found(drawing, ApertureAt(1000, 2000)).size(), 0u) << "the centre of a hollow circle";
}

TEST(DrawingQuery, ShapesSpanningTheWholeIntRangeAreTestedWithoutOverflow)
{
    Tavo_GrDrawing drawing;
    Tavo_GrDrawingBuilder build(drawing);
    build.AddLine(INT_MIN, INT_MIN, INT_MAX, INT_MAX);
    build.SetAttr(Tavo_GrAttr(4, Filled));
    const Tavo_GrWPoint corners[3] = {{INT_MIN, INT_MIN}, {INT_MAX, INT_MIN}, {INT_MIN, INT_MAX}};
    build.AddPolygon(3, corners);
    build.SetAttr(Tavo_GrAttr(4, Hollow));
    build.AddCircle(0, 0, INT_MAX);
    EXPECT_EQ(Found(drawing, ApertureAt(0, 0)).size(), 2u) << "the line and the polygon's inside, not the rim";
    EXPECT_EQ(Found(drawing, {INT_MAX - 4, -2, INT_MAX, 2}).size(), 1u) << "the circle's rim only";
    EXPECT_EQ(Found(drawing, {INT_MAX - 4, INT_MAX - 4, INT_MAX, INT_MAX}).size(), 1u) << "the line's end only";
}

TEST(DrawingQuery, AQueryBeforeTheFirstPassLeavesLaterPassesAllocationFree)
{
    Tavo_GrDrawing drawing;
    Tavo_GrDrawingBuilder build(drawing);
    for (int i = 0; i < 500; ++i) {
        const Tavo_GrWPoint shape[4] = {{i, 0}, {i + 10, 0}, {i + 10, 10}, {i, 10}};
        build.AddPolyline(4, shape);
        build.AddText(i, 20, "label");
    }
    Tavo_GrMapping mapping(&drawing, 5);
    mapping.SetDeviceWindowSize(800, 600, true, nullptr);
    RecordingSurface surface;

    HeapCallCounter counter("libTavo_Core.dll");
    ASSERT_TRUE(counter.IsCounting());
    EXPECT_GT(Found(drawing, ApertureAt(100, 5)).size(), 0u);
    counter.Reset();
    drawing.Draw(surface, mapping, nullptr);
    EXPECT_EQ(counter.GetCount(), 0) << "the query made room for the passes as the first pass would";
}

} // namespace
