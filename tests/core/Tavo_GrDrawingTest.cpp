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

namespace {

const Tavo_GrAttr kRedFilled(4, 1, 10);
const Tavo_GrAttr kBlueHollow(1, 0, 10);

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

// ---- The pass ------------------------------------------------------------------

TEST(DrawingPass, CallsTheVisibleLayersInOrderWithTheBaseStateSetThenFlushesAndEnds)
{
    Tavo_GrDrawing drawing;
    Tavo_GrDrawingBuilder build(drawing);
    build.BeginLayer("shapes");
    build.SetAttr(kRedFilled);
    build.AddRect(10, 10, 20, 20);
    build.BeginLayer("hidden");
    build.AddDot(1, 1);
    build.BeginLayer("marks");
    build.SetAttr(kBlueHollow);
    build.AddDot(5, 5);
    build.UseLayer(0);
    build.SetAttr(kRedFilled);
    build.AddLine(0, 0, 30, 30);
    build.AddDot(7, 7);
    drawing.SetLayerVisible(1, false);

    Tavo_GrMapping mapping(&drawing, 5);
    mapping.SetDeviceWindowSize(200, 300, true, nullptr);
    RecordingSurface surface;
    drawing.Draw(surface, mapping, nullptr);
    ASSERT_EQ(surface.Ops(), "BeginDrawing BeginLayer Rect Line Dot EndLayer BeginLayer Dot EndLayer Flush EndDrawing");
    const RecordingSurface::Call& filled = surface.m_calls[2];
    EXPECT_EQ(filled.scale, mapping.GetTransform().GetScale());
    EXPECT_EQ(filled.deviceHeight, 300);
    EXPECT_TRUE(filled.color == 4 && !filled.hollow);
    EXPECT_TRUE(surface.m_calls[7].color == 1 && surface.m_calls[7].hollow);
    EXPECT_EQ(surface.m_attrChanges, 2) << "only where the attribute differs";
    drawing.Draw(surface, mapping, nullptr);
    EXPECT_EQ(surface.m_attrChanges, 4) << "the first attribute of every pass counts as a change";
}

TEST(DrawingPass, ItemsAreConvertedThroughTheTransform)
{
    Tavo_GrDrawing drawing;
    Tavo_GrDrawingBuilder build(drawing);
    build.SetAttr(Tavo_GrAttr(0, 1, 7));
    build.AddCircle(10, 20, 5);
    build.AddRect(30, 40, 10, 20);
    const Tavo_GrWPoint line[3] = {{0, 0}, {10, 0}, {10, 10}};
    build.AddPolyline(3, line);
    build.AddTriangle({0, 0}, {4, 0}, {0, 4});
    build.AddText(50, 60, "label");
    build.AddTextBox({0, 0, 40, 20}, "boxed");

    // 2 pixels per world unit, world origin at device (0, 0).
    Tavo_GrMapping mapping(&drawing, 1);
    mapping.SetDeviceWindowSize(200, 200, true, nullptr);
    mapping.SetWorldClipBox({0, 0, 100, 100});
    RecordingSurface surface;
    drawing.Draw(surface, mapping, nullptr);

    ASSERT_EQ(surface.Ops(), "BeginDrawing BeginLayer Circle Rect Pline Triangle Text TextBox EndLayer Flush EndDrawing");
    const auto& calls = surface.m_calls;
    EXPECT_EQ(calls[2].points[0], (Tavo_GrDPoint{20, 40}));
    EXPECT_EQ(calls[2].number, 10);
    EXPECT_EQ(calls[3].points, (std::vector<Tavo_GrDPoint>{{20, 40}, {60, 80}})) << "normalised";
    EXPECT_EQ(calls[4].points, (std::vector<Tavo_GrDPoint>{{0, 0}, {20, 0}, {20, 20}}));
    EXPECT_EQ(calls[5].points[1], (Tavo_GrDPoint{8, 0}));
    EXPECT_EQ(calls[6].text, "label");
    EXPECT_EQ(calls[6].points[0], (Tavo_GrDPoint{100, 120}));
    EXPECT_EQ(calls[7].text, "boxed");
    EXPECT_EQ(calls[7].number, 14) << "font height: character height 7 at 2 pixels per unit";
}

TEST(DrawingModel, BoundsCoverEveryItemAndInvalidItemsAndCyclesAreRefused)
{
    Tavo_GrDrawing drawing;
    Tavo_GrDrawingBuilder build(drawing);
    build.AddDot(10, 10);
    build.AddCircle(100, 0, 20);
    build.SetAttr(Tavo_GrAttr(0, 0, 10, Tavo_GrAttr::AlignRight | Tavo_GrAttr::AlignBottom));
    build.AddText(0, 50, "abc"); // 30 units to the left of its point
    EXPECT_EQ(drawing.GetBounds(), (Tavo_GrWRect{-30, -20, 120, 60}));

    const Tavo_GrWPoint two[2] = {{0, 0}, {1, 1}};
    EXPECT_FALSE(build.AddPolyline(1, two) || build.AddPolyline(2, nullptr) || build.AddPolygon(2, two)
                 || build.AddCall(nullptr, 0, 0) || build.AddCall(&drawing, 0, 0));
    EXPECT_EQ(drawing.GetItemCount(), 3);
    Tavo_GrDrawing b;
    Tavo_GrDrawing c;
    EXPECT_TRUE(Tavo_GrDrawingBuilder(b).AddCall(&c, 0, 0) && Tavo_GrDrawingBuilder(c).AddCall(&drawing, 0, 0));
    EXPECT_FALSE(build.AddCall(&b, 0, 0)) << "a cycle of calls";
}

// ---- Calls ------------------------------------------------------------------

TEST(DrawingCalls, ACalledDrawingIsDrawnAtItsOffsetAndCulledByTheClip)
{
    Tavo_GrDrawing symbol;
    Tavo_GrDrawingBuilder symbolBuild(symbol);
    symbolBuild.AddDot(0, 0);
    symbolBuild.AddDot(500, 0);
    Tavo_GrDrawing drawing;
    Tavo_GrDrawingBuilder build(drawing);
    build.AddCall(&symbol, 100, 50);
    build.AddCall(&symbol, 300, 70);
    build.AddDot(1, 1);

    RecordingSurface surface;
    const Tavo_GrDRect clip{0, 0, 400, 100};
    drawing.Draw(surface, UnitMapping(drawing), &clip);
    // (1, 1): the caller's transform is back after the calls.
    EXPECT_EQ(DotsDrawn(surface), (std::vector<Tavo_GrDPoint>{{100, 50}, {300, 70}, {1, 1}}));
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

TEST(DrawingCulling, AMillionItemsThroughASmallClipReachTheSurfaceAsOnlyTheItemsItMeets)
{
    constexpr int kSide = 1000;
    constexpr int kSpacing = 10;
    Tavo_GrDrawing drawing;
    Tavo_GrDrawingBuilder build(drawing);
    build.Reserve(kSide * kSide, kSide * kSide);
    for (int i = 0; i < kSide; ++i)
        for (int j = 0; j < kSide; ++j)
            build.AddDot(i * kSpacing, j * kSpacing);
    ASSERT_EQ(drawing.GetItemCount(), kSide * kSide);

    const Tavo_GrMapping mapping = UnitMapping(drawing);
    const Tavo_GrDRect clip{100, 200, 149, 249};
    RecordingSurface surface;
    drawing.Draw(surface, mapping, &clip);

    // At one pixel per unit the clip, widened by the margin, is the world area.
    const int m = Tavo_GrDrawing::kClipMarginPixels;
    std::vector<Tavo_GrDPoint> expected;
    for (int x = 0; x < kSide * kSpacing; x += kSpacing)
        for (int y = 0; y < kSide * kSpacing; y += kSpacing)
            if (x >= clip.xmin - m && x <= clip.xmax + m && y >= clip.ymin - m && y <= clip.ymax + m)
                expected.push_back({x, y});
    EXPECT_EQ(surface.m_items, static_cast<int>(expected.size()));
    EXPECT_EQ(DotsDrawn(surface), expected) << "exactly the items the clip meets, in the order they were added";
    EXPECT_EQ(expected.size(), 36u);

    // Another part of the same drawing, through the index already built.
    const Tavo_GrDRect corner{0, 0, 5, 5};
    RecordingSurface second;
    drawing.Draw(second, mapping, &corner);
    EXPECT_EQ(second.m_items, 1);
}

TEST(DrawingCulling, TheDeviceWindowIsTheClipWhenThereIsOne)
{
    Tavo_GrDrawing drawing;
    Tavo_GrDrawingBuilder build(drawing);
    build.AddDot(500, 500);
    build.AddDot(1003, 500); // within the margin
    build.AddDot(1100, 500);
    build.AddRect(-100, -100, 2000, 2000); // covers the window
    RecordingSurface surface;
    drawing.Draw(surface, UnitMapping(drawing), nullptr);
    EXPECT_EQ(surface.Ops(), "BeginDrawing BeginLayer Dot Dot Rect EndLayer Flush EndDrawing");

    RecordingSurface everything;
    drawing.Draw(everything, Tavo_GrMapping(&drawing, 5), nullptr);
    EXPECT_EQ(everything.m_items, 4) << "a mapping without a window draws everything";
}

TEST(DrawingCulling, AClipThatMeetsMostItemsDrawsThemInOrderPassAfterPass)
{
    Tavo_GrDrawing drawing;
    Tavo_GrDrawingBuilder build(drawing);
    // Added in an order the spatial index does not keep: right to left.
    for (int x = 990; x >= 0; x -= 10)
        build.AddDot(x, 500);
    const Tavo_GrMapping mapping = UnitMapping(drawing);
    const Tavo_GrDRect clip{0, 0, 895, 1000}; // meets x 0 ... 890 (with the margin: ... 899)
    for (int pass = 0; pass < 2; ++pass) {
        SCOPED_TRACE(pass); // the marks of the first pass must be cleared
        RecordingSurface surface;
        drawing.Draw(surface, mapping, &clip);
        const std::vector<Tavo_GrDPoint> dots = DotsDrawn(surface);
        ASSERT_EQ(dots.size(), 90u);
        EXPECT_TRUE(dots.front().x == 890 && dots.back().x == 0);
    }
    build.AddDot(20, 20);
    RecordingSurface later;
    drawing.Draw(later, mapping, &clip);
    EXPECT_EQ(later.m_items, 91) << "an item added after a pass is found";
}

// ---- Memory ---------------------------------------------------------------------

TEST(DrawingMemory, PassesAfterTheFirstAllocateNothingInTheCoreWhateverTheyVisit)
{
    Tavo_GrDrawing symbol;
    Tavo_GrDrawingBuilder(symbol).AddCircle(0, 0, 3);
    Tavo_GrDrawing drawing;
    Tavo_GrDrawingBuilder build(drawing);
    for (int i = 0; i < 2000; ++i) {
        const int x = (i * 37) % 1000;
        const int y = (i * 91) % 1000;
        build.SetAttr(Tavo_GrAttr(static_cast<char>(i % 16), static_cast<char>(i % 2), 8));
        build.AddDot(x, y);
        build.AddLine(x, y, x + 20, y + 5);
        const Tavo_GrWPoint shape[6] = {{x, y}, {x + 20, y}, {x + 20, y + 10}, {x + 10, y + 10}, {x + 10, y + 20}, {x, y + 20}};
        build.AddPolygon(6, shape);
        build.AddPolyline(6, shape);
        build.AddText(x, y, "text");
        build.AddCall(&symbol, x, y);
    }
    const Tavo_GrMapping mapping = UnitMapping(drawing);
    const Tavo_GrDRect most{0, 0, 900, 1000};
    const Tavo_GrDRect small{100, 100, 200, 200};
    RecordingSurface surface;
    HeapCallCounter counter("libTavo_Core.dll");
    ASSERT_TRUE(counter.IsCounting());
    drawing.Draw(surface, mapping, &small); // builds the index and makes room for any pass
    EXPECT_GT(counter.GetCount(), 0) << "the first pass builds the index: the counter sees it";
    counter.Reset();
    drawing.Draw(surface, mapping, &most);
    drawing.Draw(surface, mapping, &small);
    drawing.Draw(surface, mapping, nullptr);
    EXPECT_EQ(counter.GetCount(), 0);
    EXPECT_GT(surface.m_items, 0);
}

// ---- Interruption ---------------------------------------------------------------

TEST(DrawingInterrupt, AnInterruptStopsThePassButStillEndsTheLayerFlushesAndEnds)
{
    Tavo_GrDrawing drawing;
    Tavo_GrDrawingBuilder build(drawing);
    for (int i = 0; i < 10000; ++i)
        build.AddDot(i % 1000, i / 1000);
    const Tavo_GrMapping mapping = UnitMapping(drawing);

    RecordingSurface surface;
    surface.m_interruptAtPoll = 2;
    drawing.Draw(surface, mapping, nullptr);
    EXPECT_EQ(surface.m_items, 2 * Tavo_GrSurface::kPollInterval);
    EXPECT_EQ(surface.Ops("Dot"), "BeginDrawing BeginLayer EndLayer Flush EndDrawing");
    EXPECT_TRUE(surface.IsDrawingInterrupted());

    RecordingSurface stopping;
    stopping.m_interruptAfterItem = 3;
    drawing.Draw(stopping, mapping, nullptr);
    EXPECT_EQ(stopping.m_items, 3) << "a flag set by the surface itself stops the pass at the next item";

    // The next pass starts with the flag cleared.
    surface.m_interruptAtPoll = 0;
    surface.m_items = 0;
    drawing.Draw(surface, mapping, nullptr);
    EXPECT_EQ(surface.m_items, 10000);
    EXPECT_FALSE(surface.IsDrawingInterrupted());
}

} // namespace
