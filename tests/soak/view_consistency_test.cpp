// The drawing window's view stays consistent through the sequences the soak
// found to break it: after each, the scroll model, the mapping and what the
// scrollee shows agree (Soak::CheckView). Then the arithmetic behind the
// mendings, at its limits.
#include "hostile_drawings.h"
#include "soak_checks.h"
#include "soak_test_support.h"

#include "SampleDrawing.h"
#include "Tavo_GrMapping.h"
#include "Tavo_WiViewMath.h"

#include <gtest/gtest.h>

#include <climits>
#include <cmath>
#include <functional>

using namespace SoakTest;

namespace {

struct Scenario {
    const char* name;
    CRect hostRect;
    Hostile::Kind drawing; // KindCount: the sample drawing
    int maxLevel;
    int expansion;
    unsigned int maxClipWidth;
    std::function<void(SoakHost&)> act;
};

void Resize(SoakHost& host, int width, int height, bool paint)
{
    ::SetWindowPos(host.Handle(), nullptr, 0, 0, width, height, SWP_NOMOVE | SWP_NOZORDER | SWP_NOACTIVATE);
    if (paint)
        Settle(host);
}

void LiveResize(SoakHost& host, const std::vector<CSize>& sizes, bool paint)
{
    ::SendMessageA(host.Handle(), WM_ENTERSIZEMOVE, 0, 0);
    for (const CSize& size : sizes)
        Resize(host, size.cx, size.cy, paint);
    ::SendMessageA(host.Handle(), WM_EXITSIZEMOVE, 0, 0);
}

void ZoomTo(SoakHost& host, int level)
{
    host.Wnd().ZoomWindow(Tavo_GrZoom::ToLevel, level, Tavo_WiZoomCenter::AtViewCentre, 0, 0, false);
}

TEST(ViewConsistency, HoldsThroughWhatTheSoakFound)
{
    constexpr Hostile::Kind Sample = Hostile::KindCount;
    const Scenario scenarios[] = {
        // Laying out the bars for a new range changes the scrollee: the view
        // is derived again for the area it really has.
        {"a resize that hides the bar the old range wanted", {975, 325, 1183, 662}, Sample, 200, 0, 0, [](SoakHost& host) { Resize(host, 304, 101, false); }},
        {"zooming in, which brings both bars", {50, 50, 450, 350}, Sample, 50, 0, 0, [](SoakHost& host) { ZoomTo(host, 3); }},
        // Corners rounded to whole units make a view of a few units measure
        // a pixel more than its area, and the bars would flip back and forth.
        {"a view of two units", {516, 274, 577, 825}, Hostile::Empty, 200, 0, 0, [](SoakHost&) {}},
        {"a view of three hundred units at 1.1 pixels each", {163, 703, 493, 942}, Hostile::Empty, 50, 10000, 1000, [](SoakHost&) {}},
        // A window that shrinks at the largest zoom would exceed it.
        {"shrinking at the largest zoom", {50, 50, 650, 550}, Sample, 20, 0, 0, [](SoakHost& host) {
             ZoomTo(host, 20);
             LiveResize(host, {{300, 200}}, true);
         }},
        // An absurd largest level would take the scale to infinity.
        {"zooming to an absurd largest level", {50, 50, 350, 250}, Hostile::OnePoint, INT_MAX, 0, 0, [](SoakHost& host) { ZoomTo(host, INT_MAX); }},
        // A scroll by one unit that spans more pixels than an int holds.
        {"scrolling a unit wider than the int range of pixels", {50, 50, 350, 250}, Sample, INT_MAX, 0, 0, [](SoakHost& host) {
             ZoomTo(host, INT_MAX);
             host.Wnd().ScrollWindowByDeviceDeltas(0, 1);
             host.Wnd().ScrollWindowByDeviceDeltas(-1, 0);
         }},
        // The whole int range and more at the zero level: nothing to scroll.
        {"scrolling at the zero level a view wider than the int range", {733, 916, 1260, 956}, Hostile::FullRange, 50, 0, 0, [](SoakHost& host) {
             for (const UINT code : {SB_BOTTOM, SB_PAGEDOWN, SB_TOP}) {
                 ::SendMessageA(host.DrawWnd(), WM_VSCROLL, MAKEWPARAM(code, 0), 0);
                 ::SendMessageA(host.DrawWnd(), WM_HSCROLL, MAKEWPARAM(code, 0), 0);
             }
         }},
        // A zoom about a point far outside moves the view beyond the int
        // range before the position brings it back.
        {"zooming about a point far below the view", {50, 50, 365, 488}, Sample, 50, 0, 0, [](SoakHost& host) {
             host.Wnd().ZoomWindow(Tavo_GrZoom::In, 2, Tavo_WiZoomCenter::AtPoint, 213, -(1 << 30), true);
         }},
        // Live resizes: the paints on the way size the mapping.
        {"a live resize that grows until the drawing fits", {50, 50, 350, 250}, Sample, 50, 0, 0, [](SoakHost& host) {
             ZoomTo(host, 1);
             LiveResize(host, {{1200, 900}}, false);
         }},
        {"a live resize back to its first size after a paint fitted the drawing", {50, 50, 350, 250}, Sample, 50, 0, 0, [](SoakHost& host) {
             ZoomTo(host, 1);
             LiveResize(host, {{1200, 900}, {300, 200}}, true);
         }},
        {"a live resize of a view reaching beyond the int range", {197, 772, 666, 983}, Hostile::FullRange, 50, 10000, 0, [](SoakHost& host) {
             ZoomTo(host, 24);
             LiveResize(host, {{525, 461}, {172, 62}, {527, 40}}, false);
         }},
    };
    for (const Scenario& s : scenarios) {
        SCOPED_TRACE(s.name);
        const auto hostile = s.drawing == Sample ? nullptr : Hostile::Build(s.drawing, 10);
        Tavo_GrDrawing sample;
        BuildSampleDrawing(sample);
        SoakHost host(s.hostRect);
        host.Wnd().SetDrawingInfo(hostile ? hostile.get() : &sample, s.maxLevel, 3, s.expansion, s.maxClipWidth, 0);
        Settle(host);
        s.act(host);
        Settle(host);
        EXPECT_EQ(Soak::CheckView(host), "") << Soak::DescribeView(host);
    }
}

// ---- the arithmetic at its limits ------------------------------------------------------

TEST(ViewConsistency, MappingShrunkAtTheLargestZoomKeepsTheLargestLevelAndTheTopLeftCorner)
{
    Tavo_GrDrawing drawing;
    BuildSampleDrawing(drawing);
    Tavo_GrMapping mapping(&drawing, 5);
    mapping.SetMaxZoomLevel(20);
    mapping.SetDeviceWindowSize(600, 500, true, nullptr);
    mapping.Zoom(Tavo_GrZoom::ToLevel, 800, 500, 20);
    const Tavo_GrWRect before = mapping.GetWorldClipBox();
    mapping.SetDeviceWindowSize(300, 100, false, nullptr);
    EXPECT_EQ(mapping.GetRealZoomLevel(), 20.0);
    const Tavo_GrWRect after = mapping.GetWorldClipBox();
    EXPECT_EQ(after.x1, before.x1);
    EXPECT_EQ(after.y2, before.y2);
}

TEST(ViewConsistency, LargestScaleIsOneUnitAcrossTheIntRangeOfPixels)
{
    const auto drawing = Hostile::Build(Hostile::OnePoint);
    Tavo_GrMapping mapping(drawing.get(), 5);
    mapping.SetMaxZoomLevel(INT_MAX);
    mapping.SetDeviceWindowSize(300, 200, true, nullptr);
    mapping.Zoom(1e300, 0, 0);
    EXPECT_NEAR(mapping.GetTransform().GetScale() / Tavo_GrMapping::kMaxScale, 1.0, 1e-6);
    EXPECT_FALSE(mapping.ChangesZoomLevel(Tavo_GrZoom::In, 1));
}

TEST(ViewConsistency, ZeroLevelRangeAndCutSidesStayWithinWhatAnIntHolds)
{
    using namespace Tavo_WiViewMath;
    const Tavo_GrWRect all{INT_MIN, INT_MIN, INT_MAX, INT_MAX};
    const ScrollRange range = ScrollRangeFor(all, all, 1e-7, false);
    EXPECT_EQ(range.xMin, INT_MIN);
    EXPECT_EQ(range.xMax, -1) << "INT_MAX units wide: as wide as the extent, nothing to scroll";
    EXPECT_EQ(range.yMax, INT_MAX);
    EXPECT_EQ(range.yMin, 0);
    const ScrollRange ordinary = ScrollRangeFor({0, 0, 1600, 1000}, {-10, -20, 1610, 1020}, 0.3, false);
    EXPECT_EQ(ordinary.xMin, -10);
    EXPECT_EQ(ordinary.xMax, 1610);
    EXPECT_EQ(ordinary.yMin, -20);
    EXPECT_EQ(ordinary.yMax, 1020);

    EXPECT_EQ(ViewSideLength(10, 210, 400, 2.0), 200) << "a side within the range is itself";
    EXPECT_EQ(ViewSideLength(INT_MIN, -5, 100, 1e-8), INT_MAX) << "cut, and longer than an int holds";
    EXPECT_EQ(ViewSideLength(INT_MIN, 1000, 100, 1e-6), 100000000) << "cut: the view's own length";
    EXPECT_EQ(ViewSideLength(5, INT_MAX, 0, 1.0), 0);
}

} // namespace
