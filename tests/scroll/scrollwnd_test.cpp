// Tavo_WiScrollWnd: the scroll model as the real scroll bars show it, every
// scroll code, ScrollWindowTest, drag-scroll sequencing, the layout of the
// children and the moving of pixels.
#include "scroll_test_support.h"

#include "Tavo_WiDataTip.h"
#include "Tavo_WiScrollMath.h"

#include <gtest/gtest.h>

#include <climits>

using namespace ScrollTest;

namespace {

constexpr int HostX = 100;
constexpr int HostY = 100;
constexpr int WndWidth = 400;
constexpr int WndHeight = 300;

SCROLLINFO BarInfo(HWND bar)
{
    SCROLLINFO info = {};
    info.cbSize = sizeof info;
    info.fMask = SIF_ALL;
    ::GetScrollInfo(bar, SB_CTL, &info);
    return info;
}

class ScrollWndTest : public ::testing::Test
{
protected:
    void SetUp() override
    {
        ASSERT_TRUE(wnd.Create(WS_CHILD | WS_VISIBLE, CRect(0, 0, WndWidth, WndHeight), host.Wnd(), 77));
        PumpPending();
    }

    void TearDown() override
    {
        wnd.DestroyWindow();
        PumpPending();
    }

    HWND HorzBar() { return ::GetDlgItem(wnd.GetSafeHwnd(), Tavo_WiScrollWnd::HorzBarId); }
    HWND VertBar() { return ::GetDlgItem(wnd.GetSafeHwnd(), Tavo_WiScrollWnd::VertBarId); }
    HWND Corner() { return ::GetDlgItem(wnd.GetSafeHwnd(), Tavo_WiScrollWnd::CornerId); }
    HWND Scrollee() { return wnd.GetScrollee()->GetSafeHwnd(); }

    // Range 0..1000 on both axes, a window of 100 x 100, lines of 10, pages of 50.
    void SetSquareModel(const CPoint& position)
    {
        wnd.SetScrollRange(0, 1000, 0, 1000);
        wnd.SetScrollDeltas(CSize(50, 50), CSize(10, 10));
        wnd.SetScrollWindowExtent(100, 100);
        wnd.SetScrollPosition(position);
        wnd.SetScrollDone();
        wnd.Clear();
    }

    void SendHScroll(UINT code, int n = 0)
    {
        ::SendMessageA(wnd.GetSafeHwnd(), WM_HSCROLL, MAKEWPARAM(code, n),
                       reinterpret_cast<LPARAM>(HorzBar()));
    }

    void SendVScroll(UINT code, int n = 0)
    {
        ::SendMessageA(wnd.GetSafeHwnd(), WM_VSCROLL, MAKEWPARAM(code, n),
                       reinterpret_cast<LPARAM>(VertBar()));
    }

    HostWindow host{HostX, HostY, 500, 400};
    RecordingScrollWnd wnd;
};

// ---- construction and children ----------------------------------------------------

TEST_F(ScrollWndTest, CreateMakesTheFourChildrenWithTheirIdsAndStyles)
{
    ASSERT_NE(Scrollee(), nullptr);
    EXPECT_EQ(::GetDlgCtrlID(Scrollee()), 1000);
    EXPECT_EQ(static_cast<DWORD>(::GetWindowLongA(Scrollee(), GWL_STYLE)) & 0xFFFF0000u, 0x54000000u);
    ASSERT_NE(HorzBar(), nullptr);
    EXPECT_EQ(static_cast<DWORD>(::GetWindowLongA(HorzBar(), GWL_STYLE)) & 0xF000000Fu, 0x50000000u);
    ASSERT_NE(VertBar(), nullptr);
    EXPECT_EQ(static_cast<DWORD>(::GetWindowLongA(VertBar(), GWL_STYLE)) & 0xF000000Fu, 0x50000001u);
    ASSERT_NE(Corner(), nullptr);
    char cls[64] = {};
    ::GetClassNameA(Corner(), cls, sizeof cls);
    EXPECT_STRCASEEQ(cls, "Button");
}

TEST_F(ScrollWndTest, ChildrenKeepTheirInitialRectangleUntilTheFirstLayout)
{
    EXPECT_EQ(ChildRect(Scrollee()), CRect(0, 0, 10, 10));
    EXPECT_EQ(ChildRect(HorzBar()), CRect(0, 0, 10, 10));
}

TEST_F(ScrollWndTest, DestroyWindowTakesTheChildrenAndTheScrolleesWindowsWithIt)
{
    const HWND self = wnd.GetSafeHwnd();
    const HWND scrollee = Scrollee();
    const HWND monitor = ::GetDlgItem(scrollee, 2000);
    ASSERT_NE(monitor, nullptr);
    EXPECT_TRUE(wnd.DestroyWindow());
    EXPECT_FALSE(::IsWindow(self));
    EXPECT_FALSE(::IsWindow(scrollee));
    EXPECT_FALSE(::IsWindow(monitor));
    EXPECT_EQ(wnd.GetSafeHwnd(), nullptr);
    EXPECT_FALSE(wnd.DestroyWindow()) << "a second DestroyWindow finds no window";
}

TEST_F(ScrollWndTest, DestructorAloneLeavesNoWindowBehind)
{
    std::vector<HWND> windows;
    {
        RecordingScrollWnd other;
        ASSERT_TRUE(other.Create(WS_CHILD | WS_VISIBLE, CRect(0, 0, 100, 100), host.Wnd(), 78));
        const HWND scrollee = other.GetScrollee()->GetSafeHwnd();
        windows = {other.GetSafeHwnd(), scrollee, ::GetDlgItem(scrollee, 2000),
                   other.GetScrollee()->GetDataTip()->GetSafeHwnd(),
                   ::GetDlgItem(other.GetSafeHwnd(), 1001), ::GetDlgItem(other.GetSafeHwnd(), 1002),
                   ::GetDlgItem(other.GetSafeHwnd(), 1003)};
        for (HWND hwnd : windows)
            ASSERT_TRUE(::IsWindow(hwnd));
    }
    for (HWND hwnd : windows)
        EXPECT_FALSE(::IsWindow(hwnd));
}

TEST(ScrollWndWithoutWindow, ModelWorksBeforeCreateAndTouchesNoWindow)
{
    RecordingScrollWnd unborn;
    unborn.SetScrollRange(0, 1000, 0, 1000);
    unborn.SetScrollDeltas(CSize(50, 50), CSize(10, 10));
    unborn.SetScrollWindowExtent(100, 100);
    unborn.SetScrollPosition(CPoint(2000, -5));
    unborn.SetScrollDone();
    EXPECT_EQ(unborn.GetScrollPosition(), CPoint(900, 0));
    unborn.ScrollWindow(Tavo_WiScroll::Left, Tavo_WiScroll::Page, 0);
    EXPECT_EQ(unborn.GetScrollPosition(), CPoint(850, 0));
    EXPECT_TRUE(unborn.ScrollWindowTest(Tavo_WiScroll::Down, Tavo_WiScroll::Limit, 0));
    unborn.AbortDrag();
    unborn.OnParkedCursorEnd();
    EXPECT_EQ(unborn.GetSafeHwnd(), nullptr);
}

TEST(ScrollWndWithoutWindow, UnknownDirectionOrAmountDoesNothing)
{
    RecordingScrollWnd unborn;
    unborn.SetScrollRange(0, 1000, 0, 1000);
    unborn.SetScrollPosition(CPoint(500, 500));
    unborn.Clear();
    unborn.ScrollWindow(static_cast<Tavo_WiScroll::Dir>(4), Tavo_WiScroll::Line, 0);
    unborn.ScrollWindow(Tavo_WiScroll::Left, static_cast<Tavo_WiScroll::Amount>(-1), 0);
    EXPECT_EQ(unborn.GetScrollPosition(), CPoint(500, 500));
    EXPECT_TRUE(unborn.calls.empty());
}

// ---- the scroll model on the bars -----------------------------------------------------

TEST_F(ScrollWndTest, BeforeAnyRangeThePositionClampsToTheConstructedRange)
{
    wnd.ScrollWindowTo(CPoint(50, 50));
    EXPECT_EQ(wnd.GetScrollPosition(), CPoint(0, 100));
}

TEST_F(ScrollWndTest, RangeOfTwiceTheBarLimitIsHalvedOnTheHorizontalBar)
{
    wnd.SetScrollRange(0, 2 * 32767, 0, 100);
    SCROLLINFO h = BarInfo(HorzBar());
    EXPECT_EQ(h.nMin, 0);
    EXPECT_EQ(h.nMax, 32767);
    SCROLLINFO v = BarInfo(VertBar());
    EXPECT_EQ(v.nMin, 0);
    EXPECT_EQ(v.nMax, 100);

    // Scale 2.0: a window of 200 units is a page of 100 bar units, and the
    // position 1000 is bar position 500; the vertical bar keeps scale 1.
    wnd.SetScrollWindowExtent(200, 10);
    EXPECT_EQ(BarInfo(HorzBar()).nPage, 100u);
    EXPECT_EQ(BarInfo(VertBar()).nPage, 10u);
    wnd.SetScrollPosition(CPoint(1000, 7));
    EXPECT_EQ(BarInfo(HorzBar()).nPos, 500);
    EXPECT_EQ(BarInfo(VertBar()).nPos, 7);

    // The stored x range is 0 .. 65534 scroll units.
    wnd.ScrollWindowTo(CPoint(INT_MAX, 0));
    EXPECT_EQ(wnd.GetScrollPosition().x, 2 * 32767 - 200);
}

TEST_F(ScrollWndTest, EmptyOrReversedRangeIsOneHundredUnitsWide)
{
    wnd.SetScrollRange(5, 5, 0, 0);
    EXPECT_EQ(BarInfo(HorzBar()).nMin, 5);
    EXPECT_EQ(BarInfo(HorzBar()).nMax, 105);
    EXPECT_EQ(BarInfo(VertBar()).nMin, 0);
    EXPECT_EQ(BarInfo(VertBar()).nMax, 100);

    wnd.SetScrollRange(5, 2, 0, 0);
    EXPECT_EQ(BarInfo(HorzBar()).nMax, 105);
    EXPECT_EQ(BarInfo(VertBar()).nMax, 100);
}

TEST_F(ScrollWndTest, ScaledRangeEndsRoundOutwardsToWholeBarUnits)
{
    // Scale 2.0 on x: 3 is bar unit 2 and stored as 4; the end 65537 is bar
    // unit 32769 and stored as 65538.
    wnd.SetScrollRange(3, 65537, -3, 65531);
    SCROLLINFO h = BarInfo(HorzBar());
    EXPECT_EQ(h.nMin, 2);
    EXPECT_EQ(h.nMax, 32769);
    // Scale 2.0 on y too: -3 is bar unit -2 and stored as -4.
    SCROLLINFO v = BarInfo(VertBar());
    EXPECT_EQ(v.nMin, -2);
    EXPECT_EQ(v.nMax, 32766);

    wnd.SetScrollWindowExtent(0, 0);
    wnd.ScrollWindowTo(CPoint(INT_MIN, INT_MIN));
    EXPECT_EQ(wnd.GetScrollPosition(), CPoint(4, -4));
    wnd.ScrollWindowTo(CPoint(INT_MAX, INT_MAX));
    EXPECT_EQ(wnd.GetScrollPosition(), CPoint(65538, 65532));
}

TEST_F(ScrollWndTest, BarUnitsRoundAwayFromZeroUnlessWhole)
{
    using Tavo_WiScrollMath::ToBarUnits;
    EXPECT_EQ(ToBarUnits(3, 2.0), 2);
    EXPECT_EQ(ToBarUnits(4, 2.0), 2);
    EXPECT_EQ(ToBarUnits(5, 2.0), 3);
    EXPECT_EQ(ToBarUnits(-3, 2.0), -2);
    EXPECT_EQ(ToBarUnits(0, 2.0), 0);
    EXPECT_EQ(ToBarUnits(-17, 1.0), -17);
    EXPECT_EQ(ToBarUnits(INT_MAX, 1.0), INT_MAX);
    EXPECT_EQ(ToBarUnits(INT_MIN, 1.0), INT_MIN);
}

TEST_F(ScrollWndTest, ExtremeRangeSaturatesInsteadOfWrapping)
{
    wnd.SetScrollRange(INT_MIN, INT_MAX, INT_MAX - 10, INT_MAX - 20);
    wnd.SetScrollWindowExtent(100, 100);
    wnd.ScrollWindowTo(CPoint(INT_MAX, INT_MAX));
    EXPECT_GT(wnd.GetScrollPosition().x, INT_MAX - 200000);
    EXPECT_GT(wnd.GetScrollPosition().y, INT_MAX - 200);
}

TEST_F(ScrollWndTest, NormalModeWindowLargerThanRangeEndsBeforeTheMinimum)
{
    wnd.SetScrollRange(0, 100, 0, 100);
    wnd.SetScrollWindowExtent(150, 150);
    wnd.ScrollWindowTo(CPoint(10, 10));
    EXPECT_EQ(wnd.GetScrollPosition(), CPoint(-50, -50));
}

TEST_F(ScrollWndTest, InvertedModeWindowLargerThanRangeEndsAtTheMaximumY)
{
    wnd.SetScrollInvertedY(1);
    wnd.SetScrollRange(0, 100, 0, 100);
    wnd.SetScrollWindowExtent(150, 150);
    wnd.ScrollWindowTo(CPoint(10, 10));
    EXPECT_EQ(wnd.GetScrollPosition(), CPoint(-50, 100));
}

TEST_F(ScrollWndTest, InvertedModeKeepsTheTopOfTheRangeAtTheTopOfTheBar)
{
    wnd.SetScrollInvertedY(1);
    wnd.SetScrollRange(0, 1000, 0, 1000);
    wnd.SetScrollWindowExtent(100, 100);
    wnd.SetScrollPosition(CPoint(0, 1000));
    EXPECT_EQ(BarInfo(VertBar()).nPos, 0);
    wnd.SetScrollPosition(CPoint(0, 300));
    EXPECT_EQ(BarInfo(VertBar()).nPos, 700);
    wnd.SetScrollPosition(CPoint(0, 50));
    EXPECT_EQ(wnd.GetScrollPosition().y, 100) << "clamped to minimum y + extent height";
}

TEST_F(ScrollWndTest, ScrollDeltasHaveTheirMinimumsAndPageComesFirst)
{
    SetSquareModel(CPoint(500, 500));
    wnd.SetScrollDeltas(CSize(1, 1), CSize(0, 0));
    SendHScroll(SB_LINERIGHT);
    EXPECT_EQ(wnd.GetScrollPosition().x, 501);
    SendHScroll(SB_PAGERIGHT);
    EXPECT_EQ(wnd.GetScrollPosition().x, 503);
}

// ---- scroll codes ------------------------------------------------------------------------

struct CodeCase
{
    UINT code;
    int n;
    int expected;
};

TEST_F(ScrollWndTest, EveryHorizontalCodeMovesToItsTarget)
{
    const CodeCase cases[] = {
        {SB_LINELEFT, 0, 490},  {SB_LINERIGHT, 0, 510}, {SB_PAGELEFT, 0, 450},
        {SB_PAGERIGHT, 0, 550}, {SB_THUMBTRACK, 200, 200}, {SB_THUMBPOSITION, 321, 321},
        {SB_LEFT, 0, 0},        {SB_RIGHT, 0, 900},     {100, 25, 475},
        {101, 25, 525},         {42, 0, 500},
    };
    for (const CodeCase& c : cases) {
        SetSquareModel(CPoint(500, 500));
        SendHScroll(c.code, c.n);
        EXPECT_EQ(wnd.GetScrollPosition(), CPoint(c.expected, 500)) << "code " << c.code;
        EXPECT_EQ(BarInfo(HorzBar()).nPos, c.expected) << "code " << c.code;
        SendHScroll(SB_ENDSCROLL);
    }
}

TEST_F(ScrollWndTest, EveryVerticalCodeMovesToItsTargetInNormalMode)
{
    const CodeCase cases[] = {
        {SB_LINEUP, 0, 490},  {SB_LINEDOWN, 0, 510}, {SB_PAGEUP, 0, 450},   {SB_PAGEDOWN, 0, 550},
        {SB_THUMBTRACK, 200, 200}, {SB_TOP, 0, 0},   {SB_BOTTOM, 0, 900},   {100, 25, 475},
        {101, 25, 525},       {42, 0, 500},
    };
    for (const CodeCase& c : cases) {
        SetSquareModel(CPoint(500, 500));
        SendVScroll(c.code, c.n);
        EXPECT_EQ(wnd.GetScrollPosition(), CPoint(500, c.expected)) << "code " << c.code;
        SendVScroll(SB_ENDSCROLL);
    }
}

TEST_F(ScrollWndTest, EveryVerticalCodeMovesToItsTargetInInvertedMode)
{
    wnd.SetScrollInvertedY(1);
    const CodeCase cases[] = {
        {SB_LINEUP, 0, 510},  {SB_LINEDOWN, 0, 490}, {SB_PAGEUP, 0, 550},     {SB_PAGEDOWN, 0, 450},
        {SB_THUMBTRACK, 200, 800}, {SB_TOP, 0, 1000}, {SB_BOTTOM, 0, 100},    {100, 25, 525},
        {101, 25, 475},       {42, 0, 500},
    };
    for (const CodeCase& c : cases) {
        SetSquareModel(CPoint(500, 500));
        SendVScroll(c.code, c.n);
        EXPECT_EQ(wnd.GetScrollPosition(), CPoint(500, c.expected)) << "code " << c.code;
        // The bar shows the distance from the top of the range.
        EXPECT_EQ(BarInfo(VertBar()).nPos, 1000 - c.expected) << "code " << c.code;
        SendVScroll(SB_ENDSCROLL);
    }
}

TEST_F(ScrollWndTest, ThumbOnAScaledBarMapsBackToScrollUnits)
{
    wnd.SetScrollRange(0, 2 * 32767, 0, 100);
    wnd.SetScrollWindowExtent(200, 10);
    wnd.SetScrollPosition(CPoint(0, 0));
    SendHScroll(SB_THUMBTRACK, 1234);
    EXPECT_EQ(wnd.GetScrollPosition().x, 2468);
}

TEST_F(ScrollWndTest, ThumbMessageFindsItsPositionInABarRangeBeyondSixteenBits)
{
    // A bar range of -2 .. 32766 (scale 2.0) and one of 200000 .. 230000:
    // the message carries the low 16 bits of the thumb position only.
    wnd.SetScrollRange(-3, 65531, 200000, 230000);
    wnd.SetScrollWindowExtent(0, 0);
    wnd.SetScrollPosition(CPoint(1000, 200000));
    SendHScroll(SB_THUMBTRACK, 0xFFFF & -2);
    EXPECT_EQ(wnd.GetScrollPosition().x, -4);
    SendVScroll(SB_THUMBTRACK, 0xFFFF & 210000);
    EXPECT_EQ(wnd.GetScrollPosition().y, 210000);
}

TEST_F(ScrollWndTest, DraggingTheRealThumbOfAFarRangeScrolls)
{
    wnd.SetScrollRange(200000, 230000, 0, 100);
    wnd.SetScrollDeltas(CSize(100, 10), CSize(10, 1));
    wnd.SetScrollWindowExtent(3000, 10);
    wnd.SetScrollPosition(CPoint(200000, 0));
    wnd.SetScrollDone();
    ASSERT_TRUE(::IsWindowVisible(HorzBar()));
    wnd.Clear();

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
    PumpUntil([this] { return !wnd.CallsNamed("DragScrollEnd").empty(); });

    ASSERT_EQ(wnd.CallsNamed("DragScrollStart").size(), 1u);
    ASSERT_EQ(wnd.CallsNamed("DragScrollEnd").size(), 1u);
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
    wnd.ScrollWindow(Tavo_WiScroll::Up, Tavo_WiScroll::Percent, 50);
    EXPECT_EQ(wnd.GetScrollPosition(), CPoint(1000, 5051));
    wnd.ScrollWindow(Tavo_WiScroll::Right, Tavo_WiScroll::Percent, 50);
    EXPECT_EQ(wnd.GetScrollPosition(), CPoint(1050, 5051));
    wnd.ScrollWindow(Tavo_WiScroll::Down, Tavo_WiScroll::Percent, 50);
    EXPECT_EQ(wnd.GetScrollPosition(), CPoint(1050, 5000));
    wnd.ScrollWindow(Tavo_WiScroll::Left, Tavo_WiScroll::Percent, 50);
    EXPECT_EQ(wnd.GetScrollPosition(), CPoint(1000, 5000));
}

TEST_F(ScrollWndTest, PercentStepOfAHugeExtentDoesNotWrap)
{
    wnd.SetScrollRange(0, 2000000000, 0, 100);
    wnd.SetScrollWindowExtent(50000000, 10);
    wnd.SetScrollPosition(CPoint(0, 0));
    wnd.ScrollWindow(Tavo_WiScroll::Right, Tavo_WiScroll::Percent, 100);
    EXPECT_EQ(wnd.GetScrollPosition().x, 50000000);
}

TEST_F(ScrollWndTest, NegativePercentageScrollsNothing)
{
    SetSquareModel(CPoint(500, 500));
    wnd.ScrollWindow(Tavo_WiScroll::Right, Tavo_WiScroll::Percent, -30);
    wnd.ScrollWindow(Tavo_WiScroll::Down, Tavo_WiScroll::Percent, -30);
    EXPECT_EQ(wnd.GetScrollPosition(), CPoint(500, 500));
}

TEST_F(ScrollWndTest, ScrollWindowMapsDirectionAndAmountToTheBarCodes)
{
    struct Case
    {
        Tavo_WiScroll::Dir dir;
        Tavo_WiScroll::Amount amount;
        CPoint expected;
    };
    const Case cases[] = {
        {Tavo_WiScroll::Left, Tavo_WiScroll::Line, {490, 500}},
        {Tavo_WiScroll::Right, Tavo_WiScroll::Page, {550, 500}},
        {Tavo_WiScroll::Up, Tavo_WiScroll::Limit, {500, 0}},
        {Tavo_WiScroll::Down, Tavo_WiScroll::Limit, {500, 900}},
        {Tavo_WiScroll::Down, Tavo_WiScroll::Line, {500, 510}},
    };
    for (const Case& c : cases) {
        SetSquareModel(CPoint(500, 500));
        wnd.ScrollWindow(c.dir, c.amount, 77);
        EXPECT_EQ(wnd.GetScrollPosition(), c.expected) << "dir " << c.dir << " amount " << c.amount;
    }
}

TEST_F(ScrollWndTest, ScrollWindowCenterToPutsThePointInTheMiddle)
{
    SetSquareModel(CPoint(0, 0));
    wnd.ScrollWindowCenterTo(CPoint(500, 500));
    EXPECT_EQ(wnd.GetScrollPosition(), CPoint(450, 450));

    wnd.SetScrollInvertedY(1);
    wnd.ScrollWindowCenterTo(CPoint(500, 500));
    EXPECT_EQ(wnd.GetScrollPosition(), CPoint(450, 550));
}

// ---- ScrollWindowTest ---------------------------------------------------------------------

TEST_F(ScrollWndTest, LimitTowardsTheEdgeAlreadyReachedMovesNothingButStillEnds)
{
    SetSquareModel(CPoint(0, 500));
    wnd.ScrollWindow(Tavo_WiScroll::Left, Tavo_WiScroll::Limit, 0);
    EXPECT_TRUE(wnd.CallsNamed("ScrollDeltas").empty()) << "no ScrollWindowTo";
    ASSERT_EQ(wnd.calls.size(), 1u);
    EXPECT_EQ(wnd.calls[0], (Call{"NonDragScrollEnd", 0, 0, {0, 500}, -1}));
    EXPECT_FALSE(wnd.ScrollWindowTest(Tavo_WiScroll::Left, Tavo_WiScroll::Limit, 0));
}

TEST_F(ScrollWndTest, ScrollWindowTestChangesNeitherPositionNorBarsNorPixels)
{
    SetSquareModel(CPoint(900, 500));
    ::UpdateWindow(Scrollee());
    const SCROLLINFO before = BarInfo(HorzBar());

    // At the right end a line to the right is clamped back: false.
    EXPECT_FALSE(wnd.ScrollWindowTest(Tavo_WiScroll::Right, Tavo_WiScroll::Line, 0));
    // A line to the left would move: true, yet nothing moves.
    EXPECT_TRUE(wnd.ScrollWindowTest(Tavo_WiScroll::Left, Tavo_WiScroll::Line, 0));
    EXPECT_TRUE(wnd.ScrollWindowTest(Tavo_WiScroll::Up, Tavo_WiScroll::Percent, 10));

    EXPECT_EQ(wnd.GetScrollPosition(), CPoint(900, 500));
    EXPECT_EQ(BarInfo(HorzBar()).nPos, before.nPos);
    EXPECT_TRUE(wnd.CallsNamed("ScrollDeltas").empty()) << "no pixels were scrolled";
    EXPECT_FALSE(::GetUpdateRect(Scrollee(), nullptr, FALSE)) << "nothing was invalidated";
    // Each test ends like a ScrollWindow call, with the unchanged position.
    EXPECT_EQ(wnd.CallsNamed("NonDragScrollEnd").size(), 3u);
    EXPECT_EQ(wnd.CallsNamed("NonDragScrollEnd").back().point, CPoint(900, 500));
}

// ---- drag scrolling ---------------------------------------------------------------------

TEST_F(ScrollWndTest, ThumbStartsADragScrollAndTheEndCodeEndsIt)
{
    SetSquareModel(CPoint(500, 500));
    SendHScroll(SB_THUMBTRACK, 300);
    SendHScroll(SB_THUMBTRACK, 310);
    SendHScroll(SB_THUMBPOSITION, 310);
    EXPECT_EQ(wnd.IsDragScrolling(), 1);
    SendHScroll(SB_ENDSCROLL);
    EXPECT_EQ(wnd.IsDragScrolling(), 0);

    const std::vector<Call> expected = {
        {"DragScrollStart", 0, 0, {500, 500}, -1}, {"ScrollDeltas", 0, 0, {300, 500}, -1},
        {"DragScrollMove", 0, 0, {300, 500}, -1},  {"ScrollDeltas", 0, 0, {310, 500}, -1},
        {"DragScrollMove", 0, 0, {310, 500}, -1},  {"DragScrollEnd", 0, 0, {310, 500}, -1},
    };
    EXPECT_EQ(wnd.calls, expected);
}

TEST_F(ScrollWndTest, EndCodeWithoutThumbEndsANonDragScroll)
{
    SetSquareModel(CPoint(500, 500));
    SendVScroll(SB_LINEDOWN);
    SendVScroll(SB_ENDSCROLL);
    const std::vector<Call> expected = {
        {"ScrollDeltas", 0, 0, {500, 510}, -1},
        {"NonDragScrollEnd", 0, 0, {500, 510}, -1},
    };
    EXPECT_EQ(wnd.calls, expected);
}

TEST_F(ScrollWndTest, ScrollWindowDuringADerivedDragMovesWithoutEnding)
{
    SetSquareModel(CPoint(500, 500));
    wnd.SetDragScrollingFlag(1);
    wnd.ScrollWindow(Tavo_WiScroll::Right, Tavo_WiScroll::Line, 0);
    const std::vector<Call> expected = {
        {"ScrollDeltas", 0, 0, {510, 500}, -1},
        {"DragScrollMove", 0, 0, {510, 500}, -1},
    };
    EXPECT_EQ(wnd.calls, expected);
    EXPECT_EQ(wnd.IsDragScrolling(), 1);
}

// ---- layout ----------------------------------------------------------------------------------

TEST_F(ScrollWndTest, LayoutPlacesScrolleeBarsAndCorner)
{
    SetSquareModel(CPoint(0, 0));   // 1000 units do not fit: both bars
    const int vw = ::GetSystemMetrics(SM_CXVSCROLL);
    const int hh = ::GetSystemMetrics(SM_CYHSCROLL);
    const int cw = WndWidth - vw;
    const int ch = WndHeight - hh;
    EXPECT_EQ(ChildRect(Scrollee()), CRect(0, 0, cw, ch));
    EXPECT_EQ(ChildRect(HorzBar()), CRect(0, ch, cw, WndHeight));
    EXPECT_EQ(ChildRect(VertBar()), CRect(cw, 0, WndWidth, ch));
    EXPECT_EQ(ChildRect(Corner()), CRect(cw, ch, WndWidth, WndHeight));
    EXPECT_TRUE(::IsWindowVisible(HorzBar()));
    EXPECT_TRUE(::IsWindowVisible(VertBar()));
    EXPECT_TRUE(::IsWindowVisible(Corner()));
}

TEST_F(ScrollWndTest, BarIsHiddenWhenTheClientIsExactlyAsWideAsTheRange)
{
    wnd.SetScrollRange(0, WndWidth, 0, WndHeight + 1);
    wnd.SetScrollDone();
    EXPECT_FALSE(::IsWindowVisible(HorzBar()));
    EXPECT_TRUE(::IsWindowVisible(VertBar()));
    EXPECT_FALSE(::IsWindowVisible(Corner()));
    const int vw = ::GetSystemMetrics(SM_CXVSCROLL);
    EXPECT_EQ(ChildRect(Scrollee()), CRect(0, 0, WndWidth - vw, WndHeight));

    // One pixel narrower, through a real WM_SIZE.
    ::SetWindowPos(wnd.GetSafeHwnd(), nullptr, 0, 0, WndWidth - 1, WndHeight, SWP_NOZORDER | SWP_NOMOVE);
    EXPECT_TRUE(::IsWindowVisible(HorzBar()));
    EXPECT_TRUE(::IsWindowVisible(Corner()));
}

TEST_F(ScrollWndTest, UnchangedVisibilityFlagsDoNotLayOutAgain)
{
    // The size message at creation decided (0, 0) for the default range,
    // before any child existed.
    wnd.SetScrollBarAutoVisibilityFlag(0);
    wnd.SetScrollBarVisibilityFlags(0, 0);
    EXPECT_EQ(ChildRect(Scrollee()), CRect(0, 0, 10, 10));
    wnd.SetScrollBarVisibilityFlags(1, 1);
    wnd.SetScrollBarVisibilityFlags(0, 0);
    EXPECT_EQ(ChildRect(Scrollee()), CRect(0, 0, WndWidth, WndHeight));
    ::SetWindowPos(Scrollee(), nullptr, 0, 0, 50, 50, SWP_NOZORDER);
    wnd.SetScrollBarVisibilityFlags(0, 0);
    EXPECT_EQ(ChildRect(Scrollee()), CRect(0, 0, 50, 50));
    wnd.SetScrollBarVisibilityFlags(1, 0);
    EXPECT_EQ(ChildRect(Scrollee()), CRect(0, 0, WndWidth, WndHeight - ::GetSystemMetrics(SM_CYHSCROLL)));
}

TEST_F(ScrollWndTest, AutoVisibilityOverridesTheFlagsAtTheNextSetScrollDone)
{
    wnd.SetScrollRange(0, 10, 0, 10);
    wnd.SetScrollBarVisibilityFlags(1, 1);
    EXPECT_TRUE(::IsWindowVisible(HorzBar()));
    wnd.SetScrollDone();
    EXPECT_FALSE(::IsWindowVisible(HorzBar()));
    EXPECT_FALSE(::IsWindowVisible(VertBar()));
}

// ---- pixels -----------------------------------------------------------------------------------

// Paints vertical stripes 8 units wide whose colour depends on the scroll
// unit under each pixel column, so that the content shows the position.
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
        const int first = wnd.GetScrollPosition().x;
        for (int x = 0; x < WndWidth; ++x)
            dc->FillSolidRect(x, 0, 1, WndHeight, StripeColour(first + x));
    };
    ::InvalidateRect(Scrollee(), nullptr, TRUE);
    ::UpdateWindow(Scrollee());
    {
        Pixels before(Scrollee(), WndWidth, WndHeight);
        ASSERT_EQ(before.At(0, 10), StripeColour(0));
        ASSERT_EQ(before.At(8, 10), StripeColour(8));
    }

    // Scrolling 13 units right moves the content 13 pixels left.
    wnd.painter = nullptr;
    wnd.ScrollWindowTo(CPoint(13, 0));
    CRect update;
    ASSERT_TRUE(::GetUpdateRect(Scrollee(), &update, FALSE));
    EXPECT_EQ(update, CRect(WndWidth - 13, 0, WndWidth, WndHeight));
    Pixels moved(Scrollee(), WndWidth, WndHeight);
    for (int x = 0; x < WndWidth - 13; ++x)
        ASSERT_EQ(moved.At(x, 150), StripeColour(x + 13)) << "column " << x;

    // Scrolling back 5 units moves the content 5 pixels right.
    ::ValidateRect(Scrollee(), nullptr);
    wnd.ScrollWindowTo(CPoint(8, 0));
    ASSERT_TRUE(::GetUpdateRect(Scrollee(), &update, FALSE));
    EXPECT_EQ(update, CRect(0, 0, 5, WndHeight));
    Pixels back(Scrollee(), WndWidth, WndHeight);
    for (int x = 5; x < WndWidth - 13; ++x)
        ASSERT_EQ(back.At(x, 150), StripeColour(x + 8)) << "column " << x;
}

TEST_F(ScrollWndTest, InvertedModeScrollsUpwardsContentDown)
{
    wnd.SetScrollInvertedY(1);
    wnd.SetScrollBarAutoVisibilityFlag(0);
    wnd.SetScrollBarVisibilityFlags(0, 0);
    wnd.SetScrollRange(0, WndWidth, 0, 4000);
    wnd.SetScrollWindowExtent(WndWidth, WndHeight);
    wnd.SetScrollPosition(CPoint(0, 2000));
    wnd.SetScrollDone();
    ::ValidateRect(Scrollee(), nullptr);
    // Moving the top edge up by 20 units shows more above: the content moves down.
    wnd.ScrollWindowTo(CPoint(0, 2020));
    CRect update;
    ASSERT_TRUE(::GetUpdateRect(Scrollee(), &update, FALSE));
    EXPECT_EQ(update, CRect(0, 0, WndWidth, 20));
}

}  // namespace
