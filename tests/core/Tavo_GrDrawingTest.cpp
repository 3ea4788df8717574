// Drawing a drawing: the order of calls, the base state the surface sees, item
// conversion, calls of other drawings, culling through the spatial index and
// interruption.
#include "HeapCallCounter.h"
#include "RecordingSurface.h"

#include "Tavo_GrDrawing.h"
#include "Tavo_GrDrawingBuilder.h"
#include "Tavo_GrMapping.h"

#include <gtest/gtest.h>

#include <memory>
#include <string>
#include <vector>

namespace {

// A mapping at 1 device pixel per world unit, world origin at device (0, 0),
// in a 1000 x 1000 window.
Tavo_GrMapping UnitMapping(const Tavo_GrDrawing& drawing)
{
    Tavo_GrMapping mapping(&drawing, 5);
    mapping.SetDeviceWindowSize(1000, 1000, true, nullptr);
    mapping.SetWorldClipBox({0, 0, 1000, 1000});
    return mapping;
}

std::vector<Tavo_GrDPoint> DotsDrawn(const RecordingSurface& surface)
{
    std::vector<Tavo_GrDPoint> dots;
    for (const RecordingSurface::Call& call : surface.m_calls)
        if (call.op == "Dot")
            dots.push_back(call.points[0]);
    return dots;
}

class DrawingTest : public ::testing::Test {
protected:
    void DrawAtUnitScale(const Tavo_GrDRect* clip = nullptr) { m_drawing.Draw(m_surface, UnitMapping(m_drawing), clip); }

    Tavo_GrDrawing m_drawing;
    Tavo_GrDrawingBuilder m_build{m_drawing};
    RecordingSurface m_surface;
};

// ---- The pass ------------------------------------------------------------------

TEST_F(DrawingTest, CallsTheVisibleLayersInOrderWithTheBaseStateSetThenFlushesAndEnds)
{
    const Tavo_GrAttr redFilled(4, 1, 10);
    m_build.BeginLayer("shapes");
    m_build.SetAttr(redFilled);
    m_build.AddRect(10, 10, 20, 20);
    m_build.BeginLayer("hidden");
    m_build.AddDot(1, 1);
    m_build.BeginLayer("marks");
    m_build.SetAttr(Tavo_GrAttr(1, 0, 10));
    m_build.AddDot(5, 5);
    m_build.UseLayer(0);
    m_build.SetAttr(redFilled);
    m_build.AddLine(0, 0, 30, 30);
    m_build.AddDot(7, 7);
    m_drawing.SetLayerVisible(1, false);

    Tavo_GrMapping mapping(&m_drawing, 5);
    mapping.SetDeviceWindowSize(200, 300, true, nullptr);
    m_drawing.Draw(m_surface, mapping, nullptr);
    ASSERT_EQ(m_surface.Ops(), "BeginDrawing BeginLayer Rect Line Dot EndLayer BeginLayer Dot EndLayer Flush EndDrawing");
    const RecordingSurface::Call& filled = m_surface.m_calls[2];
    EXPECT_TRUE(filled.scale == mapping.GetTransform().GetScale() && filled.deviceHeight == 300);
    EXPECT_TRUE(filled.color == 4 && !filled.hollow);
    EXPECT_TRUE(m_surface.m_calls[7].color == 1 && m_surface.m_calls[7].hollow);
    EXPECT_EQ(m_surface.m_attrChanges, 2) << "only where the attribute differs";
    m_drawing.Draw(m_surface, mapping, nullptr);
    EXPECT_EQ(m_surface.m_attrChanges, 4) << "the first attribute of every pass counts as a change";
}

TEST_F(DrawingTest, ItemsAreConvertedThroughTheTransform)
{
    m_build.SetAttr(Tavo_GrAttr(0, 1, 7));
    m_build.AddCircle(10, 20, 5);
    m_build.AddRect(30, 40, 10, 20);
    const Tavo_GrWPoint line[3] = {{0, 0}, {10, 0}, {10, 10}};
    m_build.AddPolyline(3, line);
    m_build.AddTriangle({0, 0}, {4, 0}, {0, 4});
    m_build.AddText(50, 60, "label");
    m_build.AddTextBox({0, 0, 40, 20}, "boxed");

    // 2 pixels per world unit, world origin at device (0, 0).
    Tavo_GrMapping mapping(&m_drawing, 1);
    mapping.SetDeviceWindowSize(200, 200, true, nullptr);
    mapping.SetWorldClipBox({0, 0, 100, 100});
    m_drawing.Draw(m_surface, mapping, nullptr);

    ASSERT_EQ(m_surface.Ops(), "BeginDrawing BeginLayer Circle Rect Pline Triangle Text TextBox EndLayer Flush EndDrawing");
    const auto& calls = m_surface.m_calls;
    EXPECT_TRUE(calls[2].points[0] == (Tavo_GrDPoint{20, 40}) && calls[2].number == 10);
    EXPECT_EQ(calls[3].points, (std::vector<Tavo_GrDPoint>{{20, 40}, {60, 80}})) << "normalised";
    EXPECT_EQ(calls[4].points, (std::vector<Tavo_GrDPoint>{{0, 0}, {20, 0}, {20, 20}}));
    EXPECT_EQ(calls[5].points[1], (Tavo_GrDPoint{8, 0}));
    EXPECT_TRUE(calls[6].text == "label" && calls[6].points[0] == (Tavo_GrDPoint{100, 120}));
    EXPECT_TRUE(calls[7].text == "boxed" && calls[7].number == 14) << "font height: character height 7 at 2 pixels per unit";
}

TEST_F(DrawingTest, BoundsCoverEveryItemAndInvalidItemsAndCyclesAreRefused)
{
    m_build.AddDot(10, 10);
    m_build.AddCircle(100, 0, 20);
    m_build.SetAttr(Tavo_GrAttr(0, 0, 10, Tavo_GrAttr::AlignRight | Tavo_GrAttr::AlignBottom));
    m_build.AddText(0, 50, "abc"); // 30 units to the left of its point
    EXPECT_EQ(m_drawing.GetBounds(), (Tavo_GrWRect{-30, -20, 120, 60}));

    const Tavo_GrWPoint two[2] = {{0, 0}, {1, 1}};
    EXPECT_FALSE(m_build.AddPolyline(1, two) || m_build.AddPolyline(2, nullptr) || m_build.AddPolygon(2, two) || m_build.AddCall(nullptr, 0, 0) || m_build.AddCall(&m_drawing, 0, 0));
    EXPECT_EQ(m_drawing.GetItemCount(), 3);
    Tavo_GrDrawing b;
    Tavo_GrDrawing c;
    EXPECT_TRUE(Tavo_GrDrawingBuilder(b).AddCall(&c, 0, 0) && Tavo_GrDrawingBuilder(c).AddCall(&m_drawing, 0, 0));
    EXPECT_FALSE(m_build.AddCall(&b, 0, 0)) << "a cycle of calls";
}

// ---- Calls ------------------------------------------------------------------

TEST_F(DrawingTest, ACalledDrawingIsDrawnAtItsOffsetAndCulledByTheClip)
{
    Tavo_GrDrawing symbol;
    Tavo_GrDrawingBuilder(symbol).AddDot(0, 0);
    Tavo_GrDrawingBuilder(symbol).AddDot(500, 0);
    m_build.AddCall(&symbol, 100, 50);
    m_build.AddCall(&symbol, 300, 70);
    m_build.AddDot(1, 1);
    const Tavo_GrDRect clip{0, 0, 400, 100};
    DrawAtUnitScale(&clip);
    // (1, 1): the caller's transform is back after the calls.
    EXPECT_EQ(DotsDrawn(m_surface), (std::vector<Tavo_GrDPoint>{{100, 50}, {300, 70}, {1, 1}}));
}

TEST(DrawingCalls, NestedCallsAddTheirOffsetsUpToTheDepthLimit)
{
    // A chain of drawings, each calling the next one unit to the right; the
    // last holds one dot.
    for (int depth : {Tavo_GrSurface::kMaxCallDepth, Tavo_GrSurface::kMaxCallDepth + 1}) {
        SCOPED_TRACE(depth);
        std::vector<std::unique_ptr<Tavo_GrDrawing>> chain;
        for (int i = 0; i <= depth; ++i)
            chain.push_back(std::make_unique<Tavo_GrDrawing>());
        Tavo_GrDrawingBuilder(*chain.back()).AddDot(0, 0);
        for (int i = depth - 1; i >= 0; --i)
            Tavo_GrDrawingBuilder(*chain[i]).AddCall(chain[i + 1].get(), 1, 0);

        RecordingSurface surface;
        chain[0]->Draw(surface, UnitMapping(*chain[0]), nullptr);
        if (depth <= Tavo_GrSurface::kMaxCallDepth)
            EXPECT_EQ(DotsDrawn(surface), (std::vector<Tavo_GrDPoint>{{depth, 0}}));
        else
            EXPECT_EQ(surface.m_items, 0) << "nested deeper than the limit";
    }
}

// ---- Culling ------------------------------------------------------------------

TEST_F(DrawingTest, AMillionItemsThroughASmallClipReachTheSurfaceAsOnlyTheItemsItMeets)
{
    constexpr int kSide = 1000;
    constexpr int kSpacing = 10;
    m_build.Reserve(kSide * kSide, kSide * kSide);
    for (int i = 0; i < kSide; ++i)
        for (int j = 0; j < kSide; ++j)
            m_build.AddDot(i * kSpacing, j * kSpacing);
    const Tavo_GrDRect clip{100, 200, 149, 249};
    DrawAtUnitScale(&clip);

    // At one pixel per unit the clip, widened by the margin, is the world area.
    const int m = Tavo_GrDrawing::kClipMarginPixels;
    std::vector<Tavo_GrDPoint> expected;
    for (int x = 0; x < kSide * kSpacing; x += kSpacing)
        for (int y = 0; y < kSide * kSpacing; y += kSpacing)
            if (x >= clip.xmin - m && x <= clip.xmax + m && y >= clip.ymin - m && y <= clip.ymax + m)
                expected.push_back({x, y});
    EXPECT_EQ(expected.size(), 36u);
    EXPECT_EQ(DotsDrawn(m_surface), expected) << "exactly the items the clip meets, in the order they were added";

    // Another part of the same drawing, through the index already built.
    const Tavo_GrDRect corner{0, 0, 5, 5};
    RecordingSurface second;
    m_drawing.Draw(second, UnitMapping(m_drawing), &corner);
    EXPECT_EQ(second.m_items, 1);
}

TEST_F(DrawingTest, TheDeviceWindowIsTheClipWhenThereIsOne)
{
    m_build.AddDot(500, 500);
    m_build.AddDot(1003, 500); // within the margin
    m_build.AddDot(1100, 500);
    m_build.AddRect(-100, -100, 2000, 2000); // covers the window
    DrawAtUnitScale();
    EXPECT_EQ(m_surface.Ops(), "BeginDrawing BeginLayer Dot Dot Rect EndLayer Flush EndDrawing");

    RecordingSurface everything;
    m_drawing.Draw(everything, Tavo_GrMapping(&m_drawing, 5), nullptr);
    EXPECT_EQ(everything.m_items, 4) << "a mapping without a window draws everything";
}

TEST_F(DrawingTest, AClipThatMeetsMostItemsDrawsThemInOrderPassAfterPass)
{
    // Added in an order the spatial index does not keep: right to left.
    for (int x = 990; x >= 0; x -= 10)
        m_build.AddDot(x, 500);
    const Tavo_GrDRect clip{0, 0, 895, 1000}; // meets x 0 ... 890 (with the margin: ... 899)
    for (int pass = 0; pass < 2; ++pass) {
        SCOPED_TRACE(pass); // the marks of the first pass must be cleared
        m_surface.m_calls.clear();
        DrawAtUnitScale(&clip);
        const std::vector<Tavo_GrDPoint> dots = DotsDrawn(m_surface);
        ASSERT_EQ(dots.size(), 90u);
        EXPECT_TRUE(dots.front().x == 890 && dots.back().x == 0);
    }
    m_build.AddDot(20, 20);
    m_surface.m_calls.clear();
    DrawAtUnitScale(&clip);
    EXPECT_EQ(DotsDrawn(m_surface).size(), 91u) << "an item added after a pass is found";
}

// ---- Culling of text ----------------------------------------------------------------

// What the pass visited: "Dot", "Rect", "Line", or the text of a text item.
std::vector<std::string> Visited(const RecordingSurface& surface)
{
    std::vector<std::string> visited;
    for (const RecordingSurface::Call& call : surface.m_calls) {
        if (call.op == "Text" || call.op == "TextBox")
            visited.push_back(call.text);
        else if (call.op == "Dot" || call.op == "Rect" || call.op == "Line")
            visited.push_back(call.op);
    }
    return visited;
}

TEST_F(DrawingTest, TextIsFoundWhereTheSurfaceDrawsItOtherItemsByTheirBounds)
{
    // A clip of x and y 400 ... 499 at one pixel per unit: with the margin,
    // world 396 ... 503. The texts are 5 units high, drawn 8 pixels high by a
    // surface whose smallest text is 8 pixels.
    constexpr int kHeight = 5;
    constexpr char kLeft = Tavo_GrAttr::AlignLeft | Tavo_GrAttr::AlignBottom;
    constexpr char kRight = Tavo_GrAttr::AlignRight | Tavo_GrAttr::AlignBottom;
    constexpr char kCentre = Tavo_GrAttr::AlignCentre | Tavo_GrAttr::AlignBottom;
    Tavo_GrDrawing symbol;
    Tavo_GrDrawingBuilder symbolBuild(symbol);
    symbolBuild.SetAttr(Tavo_GrAttr(0, 0, kHeight, kLeft));
    symbolBuild.AddText(0, 0, "called 1234");

    const struct {
        const char* text; // or the item's kind
        bool withoutFloor;
        bool withFloor;
        void (*add)(Tavo_GrDrawingBuilder& build, const Tavo_GrDrawing& symbol);
    } items[] = {
        // 11 characters: 55 units nominally, 88 at the floor.
        {"left 789012", false, true,
         [](auto& b, auto&) { b.SetAttr({0, 0, kHeight, kLeft}); b.AddText(340, 450, "left 789012"); }},
        {"right 89012", false, true,
         [](auto& b, auto&) { b.SetAttr({0, 0, kHeight, kRight}); b.AddText(560, 450, "right 89012"); }},
        {"centre 9012", false, true,
         [](auto& b, auto&) { b.SetAttr({0, 0, kHeight, kCentre}); b.AddText(540, 450, "centre 9012"); }},
        {"far 5678901", false, false,
         [](auto& b, auto&) { b.SetAttr({0, 0, kHeight, kLeft}); b.AddText(300, 450, "far 5678901"); }},
        // Above the clip: 1.5 character heights below the baseline reach it only at the floor.
        {"above", false, true, [](auto& b, auto&) { b.SetAttr({0, 0, kHeight, kLeft}); b.AddText(420, 513, "above"); }},
        // Tall text below the clip: its cell may stand half a height above its nominal bounds.
        {"tall", true, true, [](auto& b, auto&) { b.SetAttr({0, 0, 20, kLeft}); b.AddText(420, 370, "tall"); }},
        // Right-aligned lines of a box are drawn left of it.
        {"box right", true, true,
         [](auto& b, auto&) { b.SetAttr({0, 0, kHeight, kRight}); b.AddTextBox({510, 440, 560, 460}, "box right"); }},
        {"box left", false, false,
         [](auto& b, auto&) { b.SetAttr({0, 0, kHeight, kLeft}); b.AddTextBox({510, 440, 560, 460}, "box left"); }},
        // Cut text of a box above the clip: two lines below the box.
        {"box near", true, true,
         [](auto& b, auto&) { b.SetAttr({0, 0, kHeight, kLeft}); b.AddTextBox({420, 508, 480, 530}, "box near"); }},
        {"box above", false, true,
         [](auto& b, auto&) { b.SetAttr({0, 0, kHeight, kLeft}); b.AddTextBox({420, 515, 480, 530}, "box above"); }},
        {"called 1234", false, true, [](auto& b, auto& s) { b.AddCall(&s, 340, 450); }},
        // Other items just beyond the margin stay out; the one inside is in.
        {"Dot", false, false, [](auto& b, auto&) { b.AddDot(504, 450); }},
        {"Rect", false, false, [](auto& b, auto&) { b.AddRect(380, 504, 520, 520); }},
        {"Line", false, false, [](auto& b, auto&) { b.AddLine(300, 395, 600, 395); }},
        {"Dot", true, true, [](auto& b, auto&) { b.AddDot(450, 450); }},
    };
    std::vector<std::string> withoutFloor;
    std::vector<std::string> withFloor;
    for (const auto& item : items) {
        item.add(m_build, symbol);
        if (item.withoutFloor)
            withoutFloor.push_back(item.text);
        if (item.withFloor)
            withFloor.push_back(item.text);
    }

    const Tavo_GrDRect clip{400, 400, 499, 499};
    DrawAtUnitScale(&clip);
    EXPECT_EQ(Visited(m_surface), withoutFloor) << "without a smallest text height";
    RecordingSurface floored;
    floored.SetMinTextPixels(8);
    m_drawing.Draw(floored, UnitMapping(m_drawing), &clip);
    EXPECT_EQ(Visited(floored), withFloor) << "text drawn at least 8 pixels high";

    // Zoomed in fourfold the 5-unit texts are 20 pixels high: the floor adds nothing.
    RecordingSurface zoomed;
    zoomed.SetMinTextPixels(8);
    Tavo_GrMapping mapping(&m_drawing, 5);
    mapping.SetDeviceWindowSize(1000, 1000, true, nullptr);
    mapping.SetWorldClipBox({0, 0, 250, 250});
    const Tavo_GrDRect zoomedClip{1600, 1600, 1996, 1996}; // world 399 ... 500 with the margin
    m_drawing.Draw(zoomed, mapping, &zoomedClip);
    EXPECT_EQ(Visited(zoomed), withoutFloor);
}

// ---- Memory ---------------------------------------------------------------------

TEST_F(DrawingTest, PassesAfterTheFirstAllocateNothingInTheCoreWhateverTheyVisit)
{
    Tavo_GrDrawing symbol;
    Tavo_GrDrawingBuilder(symbol).AddCircle(0, 0, 3);
    for (int i = 0; i < 2000; ++i) {
        const int x = (i * 37) % 1000;
        const int y = (i * 91) % 1000;
        m_build.SetAttr(Tavo_GrAttr(static_cast<char>(i % 16), static_cast<char>(i % 2), 8));
        const Tavo_GrWPoint shape[6] = {{x, y}, {x + 20, y}, {x + 20, y + 10}, {x + 10, y + 10}, {x + 10, y + 20}, {x, y + 20}};
        m_build.AddPolygon(6, shape);
        m_build.AddPolyline(6, shape);
        m_build.AddText(x, y, "text");
        m_build.AddCall(&symbol, x, y);
    }
    const Tavo_GrMapping mapping = UnitMapping(m_drawing);
    m_surface.SetMinTextPixels(16); // the texts are looked for as if twice as high
    const Tavo_GrDRect most{0, 0, 900, 1000};
    const Tavo_GrDRect small{100, 100, 200, 200};
    HeapCallCounter counter("libTavo_Core.dll");
    ASSERT_TRUE(counter.IsCounting());
    m_drawing.Draw(m_surface, mapping, &small); // builds the index and makes room for any pass
    EXPECT_GT(counter.GetCount(), 0) << "the first pass builds the index: the counter sees it";
    counter.Reset();
    m_drawing.Draw(m_surface, mapping, &most);
    m_drawing.Draw(m_surface, mapping, &small);
    m_drawing.Draw(m_surface, mapping, nullptr);
    EXPECT_EQ(counter.GetCount(), 0);
    EXPECT_GT(m_surface.m_items, 0);
}

// ---- Interruption ---------------------------------------------------------------

TEST_F(DrawingTest, AnInterruptStopsThePassButStillEndsTheLayerFlushesAndEnds)
{
    for (int i = 0; i < 10000; ++i)
        m_build.AddDot(i % 1000, i / 1000);
    m_surface.m_interruptAtPoll = 2;
    DrawAtUnitScale();
    EXPECT_EQ(m_surface.m_items, 2 * Tavo_GrSurface::kPollInterval);
    EXPECT_EQ(m_surface.Ops("Dot"), "BeginDrawing BeginLayer EndLayer Flush EndDrawing");
    EXPECT_TRUE(m_surface.IsDrawingInterrupted());

    RecordingSurface stopping;
    stopping.m_interruptAfterItem = 3;
    m_drawing.Draw(stopping, UnitMapping(m_drawing), nullptr);
    EXPECT_EQ(stopping.m_items, 3) << "a flag set by the surface itself stops the pass at the next item";

    // The next pass starts with the flag cleared.
    m_surface.m_interruptAtPoll = 0;
    m_surface.m_items = 0;
    DrawAtUnitScale();
    EXPECT_EQ(m_surface.m_items, 10000);
    EXPECT_FALSE(m_surface.IsDrawingInterrupted());
}

} // namespace
