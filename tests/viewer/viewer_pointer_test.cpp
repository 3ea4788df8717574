// The viewer's pointer on a real frame under Wine, driven by real input:
// clicks name what lies under the aperture, a double click and the wheel zoom
// about the pointer, the status bar follows the pointer, drags pan, Shift and
// a drag zoom to a rubber rectangle, and a resting pointer gets a data tip
// (also after a rubber rectangle).
#include "viewer_test_support.h"

#include "Tavo_WiDataTip.h"

#include <cmath>
#include <cstdio>

using namespace ViewerTest;
using ScrollTest::PixelAt;
using ScrollTest::PumpPending;

namespace {

constexpr DWORD MoveOnly = 0;
constexpr COLORREF RedPixel = RGB(255, 0, 0);

// Within this many world units of each other: the test drawing is shown at
// about one pixel per unit, and each conversion rounds.
bool Near(const Tavo_GrWPoint& a, const Tavo_GrWPoint& b, int units = 3)
{
    return std::abs(a.x - b.x) <= units && std::abs(a.y - b.y) <= units;
}

TEST_F(ViewerFixture, AClickNamesTheTopmostItemUnderThePointerInTheStatusBar)
{
    const struct {
        Tavo_GrWPoint at;
        const char* message;
    } rows[] = {
        {{200, 200}, "Layer \"walls\": filled rectangle, 200 x 200"},
        {{650, 500}, "Nothing here"}, // inside the hollow circle
        {{750, 500}, "Layer \"pipes\": circle, 200 x 200"},
        {{600, 150}, "Layer \"pipes\": line, 500 x 0"},
        {{750, 720}, "Layer \"labels\": text \"valve\", 200 x 80"},
        {{0, 400}, "Layer \"frame\": rectangle, 1000 x 800"},
    };
    DWORD time = 0;
    for (const auto& row : rows) {
        SCOPED_TRACE(row.message);
        Click(ScreenOf(row.at.x, row.at.y), time += 1000);
        EXPECT_EQ(Status(ViewerStatusBar::Message), row.message);
    }
    EXPECT_EQ(View().GetZoomLevel(), 0.0) << "clicks do not zoom";
}

TEST_F(ViewerFixture, ADoubleClickZoomsInADoublingAboutThePointer)
{
    const POINT screen = ScreenOf(200, 250);
    Click(screen, 100);
    Click(screen, 250);
    EXPECT_EQ(View().GetZoomLevel(), 5.0);
    EXPECT_EQ(Status(ViewerStatusBar::Zoom), "Zoom level 5 (2x)");
    POINT client = screen;
    ::ScreenToClient(Scrollee(), &client);
    EXPECT_TRUE(Near(WorldAt(client), {200, 250})) << "the point under the pointer stays under it";
}

TEST_F(ViewerFixture, TheWheelZoomsAboutThePointerInWholeNotches)
{
    const POINT screen = ScreenOf(700, 300);
    POINT client = screen;
    ::ScreenToClient(Scrollee(), &client);
    Mouse(MOUSEEVENTF_WHEEL, screen, 100, WHEEL_DELTA);
    EXPECT_EQ(View().GetZoomLevel(), 2.0);
    EXPECT_TRUE(Near(WorldAt(client), {700, 300}));
    Mouse(MOUSEEVENTF_WHEEL, screen, 200, static_cast<DWORD>(-WHEEL_DELTA / 2));
    EXPECT_EQ(View().GetZoomLevel(), 2.0) << "half a notch waits for the other half";
    Mouse(MOUSEEVENTF_WHEEL, screen, 300, static_cast<DWORD>(-WHEEL_DELTA / 2));
    EXPECT_EQ(View().GetZoomLevel(), 0.0);
    EXPECT_EQ(Status(ViewerStatusBar::Zoom), "Zoom level 0 (1x)");
}

TEST_F(ViewerFixture, TheStatusBarShowsTheDrawingPositionUnderThePointer)
{
    for (const Tavo_GrWPoint at : {Tavo_GrWPoint{250, 400}, Tavo_GrWPoint{900, 20}}) {
        Mouse(MoveOnly, ScreenOf(at.x, at.y), 100);
        double x = 0;
        double y = 0;
        ASSERT_EQ(std::sscanf(Status(ViewerStatusBar::Pointer).c_str(), "x %lf y %lf", &x, &y), 2);
        EXPECT_TRUE(Near({static_cast<int>(x), static_cast<int>(y)}, at)) << x << ", " << y;
    }
}

TEST_F(ViewerFixture, ADragPansTheZoomedInViewWithThePointerAndNotTheFittedOne)
{
    const POINT centre = ScreenOf(500, 400);
    const CPoint before = View().GetScrollPosition();
    Mouse(MOUSEEVENTF_LEFTDOWN, centre, 100);
    FireHoldTimer();
    Mouse(MoveOnly, {centre.x - 40, centre.y}, 200);
    Mouse(MOUSEEVENTF_LEFTUP, {centre.x - 40, centre.y}, 300);
    EXPECT_EQ(View().GetScrollPosition(), before) << "the whole drawing is in view";

    Key(VK_ADD);
    Key(VK_ADD);
    ScrollTest::PumpUntil([&] { return ::GetUpdateRect(Scrollee(), nullptr, FALSE) == FALSE; });
    ::UpdateWindow(Scrollee());
    // The red rectangle's right edge, on the row through its middle.
    const CPoint edge = ClientOf(300, 200);
    ASSERT_EQ(PixelAt(Scrollee(), edge.x - 3, edge.y), RedPixel);
    const CPoint zoomed = View().GetScrollPosition();
    const POINT start = ScreenOf(300, 200);
    Mouse(MOUSEEVENTF_LEFTDOWN, start, 1100);
    FireHoldTimer();
    Mouse(MoveOnly, {start.x - 40, start.y}, 1200);
    Mouse(MOUSEEVENTF_LEFTUP, {start.x - 40, start.y}, 1300);
    ::UpdateWindow(Scrollee());
    EXPECT_GT(View().GetScrollPosition().x, zoomed.x) << "the view moved right: the drawing went left";
    EXPECT_EQ(View().GetScrollPosition().y, zoomed.y);
    EXPECT_EQ(PixelAt(Scrollee(), edge.x - 43, edge.y), RedPixel);
    EXPECT_NE(PixelAt(Scrollee(), edge.x - 3, edge.y), RedPixel);
}

TEST_F(ViewerFixture, ShiftAndADragZoomToTheRubberRectangle)
{
    const Tavo_GrWRect wanted{400, 100, 900, 350};
    ShiftPress(ScreenOf(wanted.x1, wanted.y2), 100);
    // The rectangle's loop takes the rest of the input once the drag begins.
    Mouse(MoveOnly, ScreenOf(650, 200), 450, 0, false);
    Mouse(MoveOnly, ScreenOf(wanted.x2, wanted.y1), 500, 0, false);
    Mouse(MOUSEEVENTF_LEFTUP, ScreenOf(wanted.x2, wanted.y1), 550, 0, false);
    FireHoldTimer();

    EXPECT_GT(View().GetZoomLevel(), 2.0);
    const Tavo_GrWRect shown = View().GetWorldClipBox();
    EXPECT_TRUE(shown.x1 <= wanted.x1 + 3 && shown.x2 >= wanted.x2 - 3 && shown.y1 <= wanted.y1 + 3 &&
                shown.y2 >= wanted.y2 - 3)
        << "the rectangle is in view";
    // The rectangle is wider than the view's shape: it fills the width.
    EXPECT_LT(std::abs((shown.x2 - shown.x1) - (wanted.x2 - wanted.x1)), 10);
    EXPECT_EQ(Status(ViewerStatusBar::Zoom).rfind("Zoom level ", 0), 0u);
    EXPECT_NE(Status(ViewerStatusBar::Zoom), "Zoom level 0 (1x)");
}

TEST_F(ViewerFixture, ARestingPointerGetsADataTipOverAnItemAndNoneOverEmptySpace)
{
    Tavo_WiDataTip* tip = View().GetScrollee()->GetDataTip();
    Mouse(MoveOnly, ScreenOf(200, 200), 100);
    FireParkTimer();
    EXPECT_TRUE(tip->IsVisible());
    EXPECT_STREQ(View().GetDataTipText(ClientOf(200, 200)), "Layer \"walls\": filled rectangle, 200 x 200");

    Mouse(MoveOnly, ScreenOf(650, 500), 200);
    EXPECT_FALSE(tip->IsVisible()) << "a move ends the rest";
    FireParkTimer();
    EXPECT_FALSE(tip->IsVisible()) << "nothing lies inside the hollow circle";
}

TEST_F(ViewerFixture, AfterARubberRectangleARestingPointerStillGetsADataTip)
{
    ShiftPress(ScreenOf(50, 350), 100);
    Mouse(MoveOnly, ScreenOf(350, 50), 450, 0, false);
    Mouse(MOUSEEVENTF_LEFTUP, ScreenOf(350, 50), 500, 0, false);
    FireHoldTimer();
    ASSERT_GT(View().GetZoomLevel(), 0.0);

    Mouse(MoveOnly, ScreenOf(200, 200), 1000);
    FireParkTimer();
    EXPECT_TRUE(View().GetScrollee()->GetDataTip()->IsVisible());
}

} // namespace
