// The drawing window's view stays consistent through sequences the soak found
// to break it: what the scroll model says and what the mapping shows agree
// after every operation.
#include "soak_window.h"

#include "SampleDrawing.h"
#include "hostile_drawings.h"
#include "scroll_test_support.h"

#include "Tavo_WiViewMath.h"

#include <gtest/gtest.h>

namespace {

using ScrollTest::PumpPending;

void Settle(SoakHost& host)
{
    PumpPending();
    ::RedrawWindow(host.Handle(), nullptr, nullptr, RDW_UPDATENOW | RDW_ALLCHILDREN);
    PumpPending();
}

TEST(ViewConsistency, ExtentMatchesTheViewAfterAResize)
{
    Tavo_GrDrawing drawing;
    BuildSampleDrawing(drawing);
    SoakHost host(CRect(975, 325, 975 + 208, 325 + 337));
    SoakDrawWnd& wnd = host.Wnd();
    wnd.SetDrawingInfo(&drawing, 200, 3, 0, 0, 0);
    Settle(host);
    wnd.ZoomWindow(static_cast<Tavo_GrZoom::Type>(7), 2, Tavo_WiZoomCenter::AtCursor, 458, -15, false);
    Settle(host);
    wnd.ZoomWindow(Tavo_GrZoom::ZeroLevel, 1, Tavo_WiZoomCenter::AtViewCentre, 172, -27, false);
    Settle(host);
    CRect c; ::GetClientRect(host.Scrollee(), &c);
    printf("before resize scrollee %d x %d extent %ld x %ld\n", c.Width(), c.Height(), wnd.GetWindowExtent().cx, wnd.GetWindowExtent().cy);
    ::SetWindowPos(host.Handle(), nullptr, 297, 554, 304, 101, SWP_NOZORDER | SWP_NOACTIVATE);
    ::GetClientRect(host.Scrollee(), &c);
    printf("after resize scrollee %d x %d extent %ld x %ld\n", c.Width(), c.Height(), wnd.GetWindowExtent().cx, wnd.GetWindowExtent().cy);
    Settle(host);
    const Tavo_GrWRect clip = wnd.GetWorldClipBox();
    EXPECT_EQ(wnd.GetWindowExtent(), CSize(clip.x2 - clip.x1, clip.y2 - clip.y1));
}

TEST(ViewConsistency, EmptyDrawingInANarrowWindow)
{
    auto drawing = Hostile::Build(Hostile::Empty);
    SoakHost host(CRect(516, 274, 516 + 61, 274 + 551));
    SoakDrawWnd& wnd = host.Wnd();
    wnd.SetDrawingInfo(drawing.get(), 200, 3, 0, 0, 0);
    CRect c; ::GetClientRect(host.Scrollee(), &c);
    printf("after bind scrollee %d x %d extent %ld x %ld\n", c.Width(), c.Height(), wnd.GetWindowExtent().cx, wnd.GetWindowExtent().cy);
    Settle(host);
    ::GetClientRect(host.Scrollee(), &c);
    printf("after paint scrollee %d x %d extent %ld x %ld\n", c.Width(), c.Height(), wnd.GetWindowExtent().cx, wnd.GetWindowExtent().cy);
    const Tavo_GrWRect clip = wnd.GetWorldClipBox();
    EXPECT_EQ(wnd.GetWindowExtent(), CSize(clip.x2 - clip.x1, clip.y2 - clip.y1));
}

}  // namespace
