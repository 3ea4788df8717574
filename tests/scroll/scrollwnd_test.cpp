// Tavo_WiScrollWnd: the scroll model as the real scroll bars show it, every
// scroll code, ScrollWindowTest, drag scrolling, the layout of the children,
// the moving of pixels and the destruction of the window family.
#include "scroll_test_support.h"

#include "Tavo_WiDataTip.h"
#include "Tavo_WiParkedCursorMonitor.h"
#include "Tavo_WiScrollMath.h"

#include <gtest/gtest.h>

#include <climits>

using namespace ScrollTest;
using Tavo_WiScroll::Down;
using Tavo_WiScroll::Left;
using Tavo_WiScroll::Right;
using Tavo_WiScroll::Up;

namespace {

constexpr int WndWidth = 400;
constexpr int WndHeight = 300;

SCROLLINFO BarInfo(HWND bar)
{
    SCROLLINFO info = {sizeof info, SIF_ALL, 0, 0, 0, 0, 0};
    ::GetScrollInfo(bar, SB_CTL, &info);
    return info;
}

// Range 0..1000 on both axes, a window of 100 x 100, lines of 10, pages of 50.
void SetSquareModel(RecordingScrollWnd& wnd, const CPoint& position)
{
    wnd.SetScrollRange(0, 1000, 0, 1000);
    wnd.SetScrollDeltas(CSize(50, 50), CSize(10, 10));
    wnd.SetScrollWindowExtent(100, 100);
    wnd.SetScrollPosition(position);
    wnd.SetScrollDone();
    wnd.Clear();
}

class ScrollWndTest : public ::testing::Test {
protected:
    void SetUp() override
    {
        ASSERT_TRUE(wnd.Create(WS_CHILD | WS_VISIBLE, CRect(0, 0, WndWidth, WndHeight), host.Wnd(), 77));
        PumpPending();
    }

    HWND HorzBar() { return ::GetDlgItem(wnd.GetSafeHwnd(), Tavo_WiScrollWnd::HorzBarId); }
    HWND VertBar() { return ::GetDlgItem(wnd.GetSafeHwnd(), Tavo_WiScrollWnd::VertBarId); }
    HWND Corner() { return ::GetDlgItem(wnd.GetSafeHwnd(), Tavo_WiScrollWnd::CornerId); }
    HWND Scrollee() { return wnd.GetScrollee()->GetSafeHwnd(); }

    // A WM_HSCROLL or WM_VSCROLL from the matching bar.
    void SendScroll(UINT message, UINT code, int n = 0)
    {
        const HWND bar = message == WM_HSCROLL ? HorzBar() : VertBar();
        ::SendMessageA(wnd.GetSafeHwnd(), message, MAKEWPARAM(code, n), reinterpret_cast<LPARAM>(bar));
    }

    TestWindow host{CRect(100, 100, 600, 500)};
    RecordingScrollWnd wnd;
};

TEST(ScrollMath, BarUnitsRoundAwayFromZeroUnlessWhole)
{
    const struct {
        int value;
        double scale;
        int expected;
    } cases[] = {
        {3, 2.0, 2}, {4, 2.0, 2}, {5, 2.0, 3}, {-3, 2.0, -2}, {-4, 2.0, -2}, {-5, 2.0, -3}, {0, 2.0, 0}, {INT_MAX, 1.0, INT_MAX}, {INT_MIN, 1.0, INT_MIN}};
    for (const auto& c : cases)
        EXPECT_EQ(Tavo_WiScrollMath::ToBarUnits(c.value, c.scale), c.expected) << c.value << " / " << c.scale;
}

TEST_F(ScrollWndTest, BarsHoldTheRangeScaledToTheirLimitWithItsEndsRoundedOutwards)
{
    // Ranges as (x minimum, y minimum, x maximum, y maximum), the bars' likewise.
    const struct {
        CRect range, bars;
        CPoint lowest, highest;
    } cases[] = {
        // Twice the bar limit: scale 2.0 on x only.
        {{0, 0, 2 * 32767, 100}, {0, 0, 32767, 100}, {0, 0}, {2 * 32767, 100}},
        // Empty and reversed ranges are 100 units wide.
        {{5, 0, 5, 0}, {5, 0, 105, 100}, {5, 0}, {105, 100}},
        {{5, 0, 2, 0}, {5, 0, 105, 100}, {5, 0}, {105, 100}},
        // Scale 2.0 on both: 3 is bar unit 2 and stored as 4, -3 is bar unit -2
        // and stored as -4, 65537 is 32769 and stored as 65538.
        {{3, -3, 65537, 65531}, {2, -2, 32769, 32766}, {4, -4}, {65538, 65532}},
    };
    wnd.SetScrollWindowExtent(0, 0);
    for (const auto& c : cases) {
        SCOPED_TRACE(testing::PrintToString(c.range));
        wnd.SetScrollRange(c.range.left, c.range.right, c.range.top, c.range.bottom);
        const SCROLLINFO h = BarInfo(HorzBar());
        const SCROLLINFO v = BarInfo(VertBar());
        EXPECT_EQ(CRect(h.nMin, v.nMin, h.nMax, v.nMax), c.bars);
        wnd.ScrollWindowTo(CPoint(INT_MIN, INT_MIN));
        EXPECT_EQ(wnd.GetScrollPosition(), c.lowest);
        wnd.ScrollWindowTo(CPoint(INT_MAX, INT_MAX));
        EXPECT_EQ(wnd.GetScrollPosition(), c.highest);
    }
    // Extreme ranges saturate instead of wrapping.
    wnd.SetScrollRange(INT_MIN, INT_MAX, INT_MAX - 10, INT_MAX - 20);
    wnd.SetScrollWindowExtent(100, 100);
    wnd.ScrollWindowTo(CPoint(INT_MAX, INT_MAX));
    EXPECT_GT(wnd.GetScrollPosition().x, INT_MAX - 200000);
    EXPECT_GT(wnd.GetScrollPosition().y, INT_MAX - 200);
}

TEST_F(ScrollWndTest, ThumbPositionsMapBackFromBarUnitsBeyondSixteenBits)
{
    // Bar ranges of -2 .. 32766 (scale 2.0: a window of 200 units is a page
    // of 100 bar units) and 200000 .. 230000. The message carries the low 16
    // bits of the thumb position only.
    wnd.SetScrollRange(-3, 65531, 200000, 230000);
    wnd.SetScrollWindowExtent(200, 10);
    wnd.SetScrollPosition(CPoint(1000, 200007));
    const SCROLLINFO h = BarInfo(HorzBar());
    EXPECT_EQ(h.nPage, 100u);
    EXPECT_EQ(h.nPos, 500);
    EXPECT_EQ(BarInfo(VertBar()).nPos, 200007);
    SendScroll(WM_HSCROLL, SB_THUMBTRACK, 0xFFFF & -2);
    EXPECT_EQ(wnd.GetScrollPosition().x, -4);
    SendScroll(WM_VSCROLL, SB_THUMBTRACK, 0xFFFF & 210000);
    EXPECT_EQ(wnd.GetScrollPosition().y, 210000);
}

TEST_F(ScrollWndTest, WindowLargerThanTheRangeEndsBeforeTheMinimumOrInvertedAtTheMaximumY)
{
    for (int inverted : {0, 1}) {
        wnd.SetScrollInvertedY(inverted);
        wnd.SetScrollRange(0, 100, 0, 100);
        wnd.SetScrollWindowExtent(150, 150);
        wnd.ScrollWindowTo(CPoint(10, 10));
        EXPECT_EQ(wnd.GetScrollPosition(), inverted ? CPoint(-50, 100) : CPoint(-50, -50));
    }
}

TEST(ScrollWndWithoutWindow, ModelWorksBeforeCreateAndTouchesNoWindow)
{
    RecordingScrollWnd unborn;
    SetSquareModel(unborn, CPoint(2000, -5));
    EXPECT_EQ(unborn.GetScrollPosition(), CPoint(900, 0));
    // Unknown directions and amounts do nothing at all.
    unborn.ScrollWindow(static_cast<Tavo_WiScroll::Dir>(4), Tavo_WiScroll::Line, 0);
    unborn.ScrollWindow(Left, static_cast<Tavo_WiScroll::Amount>(-1), 0);
    EXPECT_TRUE(unborn.calls.empty());
    unborn.ScrollWindow(Left, Tavo_WiScroll::Page, 0);
    EXPECT_EQ(unborn.GetScrollPosition(), CPoint(850, 0));
    EXPECT_TRUE(unborn.ScrollWindowTest(Down, Tavo_WiScroll::Limit, 0));
    unborn.AbortDrag();
    unborn.OnParkedCursorEnd();
    EXPECT_EQ(unborn.GetSafeHwnd(), nullptr);
}

TEST_F(ScrollWndTest, EveryScrollCodeMovesToItsTargetAndTheBarShowsIt)
{
    // From (500, 500): the target normally and with y inverted (y grows
    // upwards, so up is towards the maximum; the flag leaves x alone). 100
    // and 101 step back and forward by n percent of the window extent.
    const struct {
        UINT code;
        int n;
        int normal, invertedY;
    } cases[] = {
        {SB_LINEUP, 0, 490, 510},
        {SB_LINEDOWN, 0, 510, 490},
        {SB_PAGEUP, 0, 450, 550},
        {SB_PAGEDOWN, 0, 550, 450},
        {SB_THUMBTRACK, 200, 200, 800},
        {SB_THUMBPOSITION, 321, 321, 679},
        {SB_TOP, 0, 0, 1000},
        {SB_BOTTOM, 0, 900, 100},
        {100, 25, 475, 525},
        {101, 25, 525, 475},
        {42, 0, 500, 500},
    };
    for (UINT message : {WM_HSCROLL, WM_VSCROLL})
        for (int inverted : {0, 1})
            for (const auto& c : cases) {
                const bool horizontal = message == WM_HSCROLL;
                SCOPED_TRACE(testing::Message() << (horizontal ? "H" : "V") << " inverted " << inverted << " code "
                                                << c.code);
                wnd.SetScrollInvertedY(inverted);
                SetSquareModel(wnd, CPoint(500, 500));
                SendScroll(message, c.code, c.n);
                const int expected = !horizontal && inverted ? c.invertedY : c.normal;
                EXPECT_EQ(wnd.GetScrollPosition(), horizontal ? CPoint(expected, 500) : CPoint(500, expected));
                // An inverted bar shows the distance from the top of the range.
                const int barPosition = !horizontal && inverted ? 1000 - expected : expected;
                EXPECT_EQ(BarInfo(horizontal ? HorzBar() : VertBar()).nPos, barPosition);
                SendScroll(message, SB_ENDSCROLL);
            }
}

TEST_F(ScrollWndTest, DraggingTheRealThumbOfAFarRangeScrolls)
{
    wnd.SetScrollRange(200000, 230000, 0, 100);
    wnd.SetScrollWindowExtent(3000, 10);
    wnd.SetScrollPosition(CPoint(200000, 0));
    wnd.SetScrollDone();
    ASSERT_TRUE(::IsWindowVisible(HorzBar()));
    SCROLLBARINFO bar = {};
    bar.cbSize = sizeof bar;
    ASSERT_TRUE(::GetScrollBarInfo(HorzBar(), OBJID_CLIENT, &bar));
    const POINT thumb = {bar.rcScrollBar.left + (bar.xyThumbTop + bar.xyThumbBottom) / 2,
                         (bar.rcScrollBar.top + bar.rcScrollBar.bottom) / 2};
    const POINT dragged = {thumb.x + 100, thumb.y};
    const DWORD time = FreshTime();
    // Queued at once: the bar's own tracking loop takes them all.
    SendMouse(0, thumb, time);
    SendMouse(MOUSEEVENTF_LEFTDOWN, thumb, time + 10);
    SendMouse(0, dragged, time + 20);
    SendMouse(MOUSEEVENTF_LEFTUP, dragged, time + 30);
    PumpUntil([this] { return wnd.Count("DragScrollEnd") != 0; });

    ASSERT_EQ(wnd.Count("DragScrollStart"), 1);
    ASSERT_EQ(wnd.Count("DragScrollEnd"), 1);
    const int x = wnd.GetScrollPosition().x;
    EXPECT_GT(x, 201000) << "the thumb moved a good part of the range";
    EXPECT_LE(x, 230000 - 3000);
    EXPECT_EQ(BarInfo(HorzBar()).nPos, x);
}

TEST_F(ScrollWndTest, PercentStepsTruncateHorizontallyAndRoundVertically)
{
    // The 101-unit window: the horizontal 50 percent truncates to 50; the
    // vertical one in inverted-Y mode is the nearest integer to -50.5, -51,
    // subtracted by Up.
    wnd.SetScrollInvertedY(1);
    wnd.SetScrollRange(0, 10000, 0, 10000);
    wnd.SetScrollWindowExtent(101, 101);
    wnd.SetScrollPosition(CPoint(1000, 5000));
    // A negative percentage scrolls nothing.
    const struct {
        Tavo_WiScroll::Dir dir;
        int n;
        CPoint expected;
    } steps[] = {
        {Up, 50, {1000, 5051}}, {Right, 50, {1050, 5051}}, {Down, 50, {1050, 5000}}, {Left, 50, {1000, 5000}}, {Right, -30, {1000, 5000}}, {Down, -30, {1000, 5000}}};
    for (const auto& step : steps) {
        wnd.ScrollWindow(step.dir, Tavo_WiScroll::Percent, step.n);
        EXPECT_EQ(wnd.GetScrollPosition(), step.expected) << step.dir << " " << step.n;
    }
    // The step of a huge extent does not wrap.
    wnd.SetScrollRange(0, 2000000000, 0, 10000);
    wnd.SetScrollWindowExtent(50000000, 10);
    wnd.SetScrollPosition(CPoint(0, 5000));
    wnd.ScrollWindow(Right, Tavo_WiScroll::Percent, 100);
    EXPECT_EQ(wnd.GetScrollPosition().x, 50000000);
}

TEST_F(ScrollWndTest, ScrollWindowTestChangesNeitherPositionNorBarsNorPixels)
{
    SetSquareModel(wnd, CPoint(900, 500));
    ::UpdateWindow(Scrollee());
    const int barPosition = BarInfo(HorzBar()).nPos;
    EXPECT_FALSE(wnd.ScrollWindowTest(Right, Tavo_WiScroll::Line, 0)) << "clamped back at the right end";
    EXPECT_TRUE(wnd.ScrollWindowTest(Left, Tavo_WiScroll::Line, 0));
    EXPECT_TRUE(wnd.ScrollWindowTest(Up, Tavo_WiScroll::Percent, 10));
    EXPECT_EQ(wnd.GetScrollPosition(), CPoint(900, 500));
    EXPECT_EQ(BarInfo(HorzBar()).nPos, barPosition);
    EXPECT_FALSE(::GetUpdateRect(Scrollee(), nullptr, FALSE)) << "nothing was invalidated";
    // Each test ends like a ScrollWindow call, with the unchanged position,
    // and moves no pixels.
    const Call end{"NonDragScrollEnd", 0, 0, {900, 500}};
    EXPECT_EQ(wnd.calls, (std::vector<Call>{end, end, end}));

    // A limit towards the edge already reached moves nothing but still ends.
    SetSquareModel(wnd, CPoint(0, 500));
    wnd.ScrollWindow(Left, Tavo_WiScroll::Limit, 0);
    EXPECT_EQ(wnd.calls, (std::vector<Call>{{"NonDragScrollEnd", 0, 0, {0, 500}}}));
}

TEST_F(ScrollWndTest, ThumbCodesDragScrollAndTheEndCodeEndsWhicheverScrollRan)
{
    SetSquareModel(wnd, CPoint(500, 500));
    SendScroll(WM_HSCROLL, SB_THUMBTRACK, 300);
    SendScroll(WM_HSCROLL, SB_THUMBTRACK, 310);
    SendScroll(WM_HSCROLL, SB_THUMBPOSITION, 310);
    EXPECT_EQ(wnd.IsDragScrolling(), 1);
    SendScroll(WM_HSCROLL, SB_ENDSCROLL);
    EXPECT_EQ(wnd.IsDragScrolling(), 0);
    SendScroll(WM_VSCROLL, SB_LINEDOWN);
    SendScroll(WM_VSCROLL, SB_ENDSCROLL);

    const std::vector<Call> expected = {
        {"DragScrollStart", 0, 0, {500, 500}}, {"ScrollDeltas", 0, 0, {300, 500}}, {"DragScrollMove", 0, 0, {300, 500}}, {"ScrollDeltas", 0, 0, {310, 500}}, {"DragScrollMove", 0, 0, {310, 500}}, {"DragScrollEnd", 0, 0, {310, 500}}, {"ScrollDeltas", 0, 0, {310, 510}}, {"NonDragScrollEnd", 0, 0, {310, 510}}};
    EXPECT_EQ(wnd.calls, expected);
}

TEST_F(ScrollWndTest, BarAppearsOnlyWhenTheRangeIsWiderThanTheWindowAndTheChildrenTileIt)
{
    const int vw = ::GetSystemMetrics(SM_CXVSCROLL);
    const int hh = ::GetSystemMetrics(SM_CYHSCROLL);
    wnd.SetScrollRange(0, WndWidth, 0, WndHeight + 1);
    wnd.SetScrollDone();
    EXPECT_FALSE(::IsWindowVisible(HorzBar())) << "exactly as wide as the range";
    EXPECT_TRUE(::IsWindowVisible(VertBar()));
    EXPECT_FALSE(::IsWindowVisible(Corner()));
    EXPECT_EQ(ChildRect(Scrollee()), CRect(0, 0, WndWidth - vw, WndHeight));
    EXPECT_EQ(ChildRect(VertBar()), CRect(WndWidth - vw, 0, WndWidth, WndHeight));

    // One pixel narrower, through a real WM_SIZE.
    const int width = WndWidth - 1;
    ::SetWindowPos(wnd.GetSafeHwnd(), nullptr, 0, 0, width, WndHeight, SWP_NOZORDER | SWP_NOMOVE);
    for (HWND child : {HorzBar(), VertBar(), Corner()})
        EXPECT_TRUE(::IsWindowVisible(child));
    const int cw = width - vw;
    const int ch = WndHeight - hh;
    EXPECT_EQ(ChildRect(Scrollee()), CRect(0, 0, cw, ch));
    EXPECT_EQ(ChildRect(HorzBar()), CRect(0, ch, cw, WndHeight));
    EXPECT_EQ(ChildRect(VertBar()), CRect(cw, 0, width, ch));
    EXPECT_EQ(ChildRect(Corner()), CRect(cw, ch, width, WndHeight));
}

// Vertical stripes 8 units wide whose colour shows the scroll unit under each column.
COLORREF StripeColour(int unit)
{
    return ((unit / 8) % 2) != 0 ? RGB(255, 0, 0) : RGB(0, 0, 255);
}

TEST_F(ScrollWndTest, ScrollWindowToMovesThePaintedPixelsAndInvalidatesOnlyTheStrip)
{
    wnd.SetScrollBarAutoVisibilityFlag(0);
    wnd.SetScrollBarVisibilityFlags(0, 0);
    wnd.SetScrollRange(0, 4000, 0, WndHeight);
    wnd.SetScrollWindowExtent(WndWidth, WndHeight);
    wnd.SetScrollPosition(CPoint(0, 0));
    wnd.SetScrollDone();
    wnd.painter = [this](Tavo_WiScrollee*, CDC* dc) {
        for (int x = 0; x < WndWidth; ++x)
            dc->FillSolidRect(x, 0, 1, WndHeight, StripeColour(wnd.GetScrollPosition().x + x));
    };
    ::InvalidateRect(Scrollee(), nullptr, TRUE);
    ::UpdateWindow(Scrollee());
    wnd.painter = nullptr;

    // 13 units right moves the content 13 pixels left, then 5 units back 5 pixels right.
    const struct {
        int x;
        CRect strip;
        int firstKept, lastKept;
    } steps[] = {
        {13, {WndWidth - 13, 0, WndWidth, WndHeight}, 0, WndWidth - 13}, {8, {0, 0, 5, WndHeight}, 5, WndWidth - 13}};
    for (const auto& step : steps) {
        SCOPED_TRACE(step.x);
        ::ValidateRect(Scrollee(), nullptr);
        wnd.ScrollWindowTo(CPoint(step.x, 0));
        CRect update;
        ASSERT_TRUE(::GetUpdateRect(Scrollee(), &update, FALSE));
        EXPECT_EQ(update, step.strip);
        for (int x = step.firstKept; x < step.lastKept; ++x)
            ASSERT_EQ(PixelAt(Scrollee(), x, 150), StripeColour(x + step.x)) << "column " << x;
    }
}

TEST_F(ScrollWndTest, DestructionTakesEveryWindowOfTheFamilyWithIt)
{
    const HWND monitor = ::GetDlgItem(Scrollee(), Tavo_WiParkedCursorMonitor::ControlId);
    const HWND tip = wnd.GetScrollee()->GetDataTip()->GetSafeHwnd(); // an owned popup, no child
    std::vector<HWND> family = {wnd.GetSafeHwnd(), Scrollee(), monitor, tip, HorzBar(), VertBar(), Corner()};
    for (HWND hwnd : family)
        ASSERT_TRUE(::IsWindow(hwnd));
    {
        // The destructor alone is enough.
        RecordingScrollWnd other;
        ASSERT_TRUE(other.Create(WS_CHILD, CRect(0, 0, 100, 100), host.Wnd(), 78));
        family.push_back(other.GetSafeHwnd());
        family.push_back(other.GetScrollee()->GetDataTip()->GetSafeHwnd());
    }
    EXPECT_TRUE(wnd.DestroyWindow());
    EXPECT_FALSE(wnd.DestroyWindow()) << "a second DestroyWindow finds no window";
    for (HWND hwnd : family)
        EXPECT_FALSE(::IsWindow(hwnd));
}

} // namespace
