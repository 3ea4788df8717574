// Tavo_WiScrollee: real mouse input with explicit message times classified
// into clicks, double clicks and drags; capture handling; the background
// erase; painting through the scroll window; parked-cursor notifications.
#include "scroll_test_support.h"

#include "Tavo_WiDataTip.h"
#include "Tavo_WiParkedCursorMonitor.h"

#include <gtest/gtest.h>

#include <cstdlib>
#include <string>
#include <utility>

using namespace ScrollTest;

namespace {

constexpr int HostX = 120;
constexpr int HostY = 140;
constexpr int WndWidth = 400;
constexpr int WndHeight = 300;

constexpr DWORD LeftDown = MOUSEEVENTF_LEFTDOWN;
constexpr DWORD LeftUp = MOUSEEVENTF_LEFTUP;
constexpr DWORD RightDown = MOUSEEVENTF_RIGHTDOWN;
constexpr DWORD RightUp = MOUSEEVENTF_RIGHTUP;
constexpr DWORD MoveOnly = 0;

class ScrolleeTest : public ::testing::Test
{
protected:
    void SetUp() override
    {
        ASSERT_TRUE(wnd.Create(WS_CHILD | WS_VISIBLE, CRect(0, 0, WndWidth, WndHeight), host.Wnd(), 5));
        wnd.SetScrollDone();   // the default range needs no bars: the scrollee fills the window
        PumpPending();
        ASSERT_EQ(ChildRect(Scrollee()), CRect(0, 0, WndWidth, WndHeight));
        base = FreshTime();
        // Start every test with the pointer resting inside, no button down.
        Input(MoveOnly, CPoint(1, 1), 0);
        wnd.Clear();
    }

    void TearDown() override
    {
        // No button stays down for the next test.
        const std::pair<int, DWORD> buttons[] = {{VK_LBUTTON, LeftUp}, {VK_RBUTTON, RightUp},
                                                 {VK_MBUTTON, MOUSEEVENTF_MIDDLEUP}};
        for (const auto& button : buttons)
            if (::GetAsyncKeyState(button.first) & 0x8000)
                Input(button.second, CPoint(1, 1), 1900);
        ::ReleaseCapture();
        wnd.DestroyWindow();
        PumpPending();
    }

    HWND Scrollee() { return wnd.GetScrollee()->GetSafeHwnd(); }

    // Mouse input at a point of the scrollee, at base + offset milliseconds.
    void Input(DWORD flags, CPoint client, DWORD offset)
    {
        SendMouse(flags, POINT{HostX + client.x, HostY + client.y}, base + offset);
        PumpInput();
    }

    void FireHoldTimer()
    {
        ::SendMessageA(Scrollee(), WM_TIMER, Tavo_WiScrollee::HoldTimerId, 0);
    }

    std::vector<Call> Gestures() const
    {
        std::vector<Call> result;
        for (const Call& call : wnd.calls)
            if (call.name != "DataTipText" && call.name.rfind("Parked", 0) != 0)
                result.push_back(call);
        return result;
    }

    HostWindow host{HostX, HostY, 500, 400};
    RecordingScrollWnd wnd;
    DWORD base = 0;
};

// ---- clicks ----------------------------------------------------------------------------------

TEST_F(ScrolleeTest, ClickShorterThanHoldTimeIsReportedWithTheReleasesFlagsAndPoint)
{
    Input(LeftDown, CPoint(50, 60), 1000);
    Input(LeftUp, CPoint(53, 64), 1299);
    const std::vector<Call> expected = {{"Click", MK_LBUTTON, 0, {53, 64}, -1}};
    EXPECT_EQ(Gestures(), expected);
    // The click killed the hold timer: firing it late starts nothing.
    FireHoldTimer();
    EXPECT_EQ(Gestures(), expected);
}

TEST_F(ScrolleeTest, ReleaseAtHoldTimeBeforeTheTimerIsHandledReportsNothing)
{
    Input(LeftDown, CPoint(50, 60), 1000);
    Input(LeftUp, CPoint(50, 60), 1300);
    FireHoldTimer();
    EXPECT_TRUE(Gestures().empty());
}

TEST_F(ScrolleeTest, RightAndMiddleButtonsReportTheirOwnKeyFlags)
{
    Input(RightDown, CPoint(10, 10), 1000);
    Input(RightUp, CPoint(10, 10), 1010);
    Input(MOUSEEVENTF_MIDDLEDOWN, CPoint(200, 10), 3000);
    Input(MOUSEEVENTF_MIDDLEUP, CPoint(200, 10), 3010);
    const std::vector<Call> expected = {
        {"Click", MK_RBUTTON, 0, {10, 10}, -1},
        {"Click", MK_MBUTTON, 0, {200, 10}, -1},
    };
    EXPECT_EQ(Gestures(), expected);
}

TEST_F(ScrolleeTest, SecondButtonWhileOneIsHeldIsIgnored)
{
    Input(LeftDown, CPoint(30, 30), 1000);
    Input(RightDown, CPoint(30, 30), 1050);
    Input(RightUp, CPoint(30, 30), 1100);
    Input(LeftUp, CPoint(30, 30), 1150);
    const std::vector<Call> expected = {{"Click", MK_LBUTTON, 0, {30, 30}, -1}};
    EXPECT_EQ(Gestures(), expected);
}

// ---- drags ---------------------------------------------------------------------------------------

TEST_F(ScrolleeTest, HoldTimerStartsADragWithThePressFlagsAndPoint)
{
    Input(LeftDown, CPoint(50, 60), 1000);
    Input(MoveOnly, CPoint(70, 80), 1100);   // moves before the drag are not reported
    FireHoldTimer();
    Input(MoveOnly, CPoint(90, 95), 1400);
    Input(LeftUp, CPoint(90, 95), 1500);

    const std::vector<Call> expected = {
        {"DragStart", MK_LBUTTON, MK_LBUTTON, {50, 60}, -1},
        {"DragMove", MK_LBUTTON, MK_LBUTTON, {90, 95}, -1},
        {"DragEnd", MK_LBUTTON, 0, {90, 95}, 1},
    };
    EXPECT_EQ(Gestures(), expected);
    EXPECT_EQ(::GetCapture(), nullptr) << "the drag's capture is released";
}

TEST_F(ScrolleeTest, DragHoldsTheCaptureSoMovesOutsideAreReported)
{
    Input(LeftDown, CPoint(50, 60), 1000);
    FireHoldTimer();
    EXPECT_EQ(::GetCapture(), Scrollee());
    Input(MoveOnly, CPoint(450, 60), 1400);   // outside the scrollee, inside the host
    Input(LeftUp, CPoint(450, 60), 1500);
    ASSERT_EQ(wnd.CallsNamed("DragMove").size(), 1u);
    EXPECT_EQ(wnd.CallsNamed("DragMove")[0].point, CPoint(450, 60));
    EXPECT_EQ(wnd.CallsNamed("DragEnd")[0].point, CPoint(450, 60));
}

TEST_F(ScrolleeTest, MoveWithoutAButtonFlagDuringADragIsNotReported)
{
    Input(LeftDown, CPoint(50, 60), 1000);
    FireHoldTimer();
    ::SendMessageA(Scrollee(), WM_MOUSEMOVE, MK_SHIFT, MAKELPARAM(5, 6));
    EXPECT_TRUE(wnd.CallsNamed("DragMove").empty());
    // Any of the three button flags will do; the pressed button is reported.
    ::SendMessageA(Scrollee(), WM_MOUSEMOVE, MK_RBUTTON, MAKELPARAM(7, 8));
    const std::vector<Call> expected = {{"DragMove", MK_LBUTTON, MK_RBUTTON, {7, 8}, -1}};
    EXPECT_EQ(wnd.CallsNamed("DragMove"), expected);
    Input(LeftUp, CPoint(50, 60), 1500);
}

TEST_F(ScrolleeTest, AnotherWindowTakingTheCaptureEndsTheDragIncomplete)
{
    NotificationSink other(host.Handle());
    Input(LeftDown, CPoint(50, 60), 1000);
    FireHoldTimer();
    ::SetCapture(other.Handle());
    const std::vector<Call> ended = {
        {"DragStart", MK_LBUTTON, MK_LBUTTON, {50, 60}, -1},
        {"DragEnd", MK_LBUTTON, 0, {0, 0}, 0},
    };
    EXPECT_EQ(Gestures(), ended);
    ::ReleaseCapture();
    Input(LeftUp, CPoint(50, 60), 1500);
    EXPECT_EQ(Gestures(), ended) << "the later release is ignored";
}

TEST_F(ScrolleeTest, ReleaseMouseDuringADragEndsItThroughTheCaptureLoss)
{
    Input(LeftDown, CPoint(50, 60), 1000);
    FireHoldTimer();
    wnd.GetScrollee()->ReleaseMouse();
    ASSERT_EQ(wnd.CallsNamed("DragEnd").size(), 1u);
    EXPECT_EQ(wnd.CallsNamed("DragEnd")[0], (Call{"DragEnd", MK_LBUTTON, 0, {0, 0}, 0}));
    Input(LeftUp, CPoint(50, 60), 1500);
    EXPECT_EQ(wnd.CallsNamed("DragEnd").size(), 1u);
}

TEST_F(ScrolleeTest, AbortDragForgetsTheDragWithoutEndingIt)
{
    Input(LeftDown, CPoint(50, 60), 1000);
    FireHoldTimer();
    wnd.AbortDrag();
    EXPECT_EQ(::GetCapture(), nullptr);
    Input(MoveOnly, CPoint(60, 60), 1400);
    Input(LeftUp, CPoint(60, 60), 1500);
    const std::vector<Call> expected = {
        {"DragStart", MK_LBUTTON, MK_LBUTTON, {50, 60}, -1},
        {"DragAbort", 0, 0, {0, 0}, -1},
    };
    EXPECT_EQ(Gestures(), expected);
}

TEST_F(ScrolleeTest, AbortDragBeforeTheHoldTimerLeavesTheTimerHarmless)
{
    Input(LeftDown, CPoint(50, 60), 1000);
    wnd.AbortDrag();
    FireHoldTimer();
    Input(LeftUp, CPoint(50, 60), 1100);
    const std::vector<Call> expected = {{"DragAbort", 0, 0, {0, 0}, -1}};
    EXPECT_EQ(Gestures(), expected);
}

TEST_F(ScrolleeTest, PressWhileTheScrolleeHoldsItsOwnCaptureReportsNothing)
{
    wnd.GetScrollee()->CaptureMouse();
    ASSERT_EQ(::GetCapture(), Scrollee());
    Input(LeftDown, CPoint(50, 60), 1000);
    EXPECT_EQ(::GetCapture(), nullptr);
    FireHoldTimer();
    Input(LeftUp, CPoint(50, 60), 1100);
    EXPECT_TRUE(Gestures().empty());
}

// ---- double clicks -------------------------------------------------------------------------------

TEST_F(ScrolleeTest, PressReleaseDoubleClickReleaseIsAClickThenADoubleClick)
{
    Input(LeftDown, CPoint(40, 40), 1000);
    Input(LeftUp, CPoint(40, 40), 1050);
    Input(LeftDown, CPoint(40, 40), 1100);
    Input(LeftUp, CPoint(40, 40), 1150);
    const std::vector<Call> expected = {
        {"Click", MK_LBUTTON, 0, {40, 40}, -1},
        {"DoubleClick", MK_LBUTTON, MK_LBUTTON, {40, 40}, -1},
    };
    EXPECT_EQ(Gestures(), expected);
}

TEST_F(ScrolleeTest, HoldingTheSecondPressOfADoubleClickStartsNoDrag)
{
    Input(LeftDown, CPoint(40, 40), 1000);
    Input(LeftUp, CPoint(40, 40), 1050);
    Input(LeftDown, CPoint(40, 40), 1100);
    FireHoldTimer();
    Input(LeftUp, CPoint(40, 40), 1900);
    EXPECT_TRUE(wnd.CallsNamed("DragStart").empty());
    EXPECT_EQ(wnd.CallsNamed("DoubleClick").size(), 1u);
    EXPECT_EQ(Gestures().size(), 2u);
}

// ---- painting ---------------------------------------------------------------------------------------

TEST_F(ScrolleeTest, EraseFillsBlackUntilABackgroundColourIsSet)
{
    const auto fillWhite = [this] {
        HDC dc = ::GetDC(Scrollee());
        RECT all = {0, 0, WndWidth, WndHeight};
        ::FillRect(dc, &all, static_cast<HBRUSH>(::GetStockObject(WHITE_BRUSH)));
        ::ReleaseDC(Scrollee(), dc);
    };
    fillWhite();
    ::InvalidateRect(Scrollee(), nullptr, TRUE);
    ::UpdateWindow(Scrollee());
    Pixels black(Scrollee(), WndWidth, WndHeight);
    EXPECT_EQ(black.At(0, 0), RGB(0, 0, 0));
    EXPECT_EQ(black.At(WndWidth / 2, WndHeight / 2), RGB(0, 0, 0));
    EXPECT_EQ(black.At(WndWidth - 1, WndHeight - 1), RGB(0, 0, 0));

    const COLORREF colour = RGB(0, 128, 255);
    wnd.GetScrollee()->SetBackgroundColor(colour);
    Pixels unchanged(Scrollee(), WndWidth, WndHeight);
    EXPECT_EQ(unchanged.At(10, 10), RGB(0, 0, 0)) << "setting the colour repaints nothing";

    fillWhite();
    ::InvalidateRect(Scrollee(), nullptr, TRUE);
    ::UpdateWindow(Scrollee());
    Pixels coloured(Scrollee(), WndWidth, WndHeight);
    // Filled and outlined with the colour, edges included.
    EXPECT_EQ(coloured.At(0, 0), colour);
    EXPECT_EQ(coloured.At(WndWidth / 2, WndHeight / 2), colour);
    EXPECT_EQ(coloured.At(WndWidth - 1, 0), colour);
    EXPECT_EQ(coloured.At(WndWidth - 1, WndHeight - 1), colour);
}

TEST_F(ScrolleeTest, PaintCallsOnDrawWithTheScrolleeAndAnMmTextContext)
{
    Tavo_WiScrollee* painted = nullptr;
    int mapMode = 0;
    wnd.painter = [&](Tavo_WiScrollee* scrollee, CDC* dc) {
        painted = scrollee;
        mapMode = ::GetMapMode(dc->GetSafeHdc());
        dc->FillSolidRect(0, 0, 10, 10, RGB(255, 0, 0));
    };
    ::InvalidateRect(Scrollee(), nullptr, TRUE);
    ::UpdateWindow(Scrollee());
    EXPECT_EQ(painted, wnd.GetScrollee());
    EXPECT_EQ(mapMode, MM_TEXT);
    Pixels pixels(Scrollee(), WndWidth, WndHeight);
    EXPECT_EQ(pixels.At(5, 5), RGB(255, 0, 0));
    EXPECT_EQ(pixels.At(20, 20), RGB(0, 0, 0)) << "erased before the paint";
}

// ---- parked cursor ------------------------------------------------------------------------------------

TEST_F(ScrolleeTest, RestStartShowsTheDataTipTextAtThePointer)
{
    wnd.dataTipText = "tip text";
    ::SetCursorPos(HostX + 40, HostY + 50);
    const LRESULT result =
        ::SendMessageA(Scrollee(), Tavo_WiParkedCursorMonitor::GetNotifyMsg(), 1, 0);
    EXPECT_EQ(result, 1);
    ASSERT_EQ(wnd.CallsNamed("ParkedStart").size(), 1u);
    EXPECT_EQ(wnd.CallsNamed("ParkedStart")[0].point, CPoint(40, 50));
    EXPECT_EQ(wnd.CallsNamed("DataTipText")[0].point, CPoint(40, 50));
    Tavo_WiDataTip* tip = wnd.GetScrollee()->GetDataTip();
    EXPECT_EQ(tip->IsVisible(), 1);
    EXPECT_TRUE(::IsWindowVisible(tip->GetSafeHwnd()));

    EXPECT_EQ(::SendMessageA(Scrollee(), Tavo_WiParkedCursorMonitor::GetNotifyMsg(), 0, 0), 1);
    EXPECT_EQ(wnd.CallsNamed("ParkedEnd").size(), 1u);
    EXPECT_EQ(tip->IsVisible(), 0);
    EXPECT_FALSE(::IsWindowVisible(tip->GetSafeHwnd()));
}

TEST_F(ScrolleeTest, RestWithAnEmptyTextShowsNoTip)
{
    ::SetCursorPos(HostX + 40, HostY + 50);
    ::SendMessageA(Scrollee(), Tavo_WiParkedCursorMonitor::GetNotifyMsg(), 1, 0);
    EXPECT_EQ(wnd.CallsNamed("DataTipText").size(), 1u);
    EXPECT_EQ(wnd.GetScrollee()->GetDataTip()->IsVisible(), 0);
}

TEST_F(ScrolleeTest, PreTranslatedMovesReachTheMonitorAndARestShowsTheTip)
{
    wnd.dataTipText = "resting";
    Input(MoveOnly, CPoint(60, 70), 1000);
    const HWND monitor = ::GetDlgItem(Scrollee(), Tavo_WiParkedCursorMonitor::ControlId);
    ASSERT_NE(monitor, nullptr);
    ::SendMessageA(monitor, WM_TIMER, Tavo_WiParkedCursorMonitor::ParkTimerId, 0);
    ASSERT_EQ(wnd.CallsNamed("ParkedStart").size(), 1u);
    EXPECT_EQ(wnd.CallsNamed("ParkedStart")[0].point, CPoint(60, 70));
    EXPECT_EQ(wnd.GetScrollee()->GetDataTip()->IsVisible(), 1);

    // The next move to another point ends the rest and hides the tip.
    Input(MoveOnly, CPoint(61, 70), 1200);
    EXPECT_EQ(wnd.CallsNamed("ParkedEnd").size(), 1u);
    EXPECT_EQ(wnd.GetScrollee()->GetDataTip()->IsVisible(), 0);
}

TEST_F(ScrolleeTest, SwitchedOffMonitorReportsNoRest)
{
    wnd.SetParkedCursorMonitorFlag(0);
    Input(MoveOnly, CPoint(60, 70), 1000);
    const HWND monitor = ::GetDlgItem(Scrollee(), Tavo_WiParkedCursorMonitor::ControlId);
    ::SendMessageA(monitor, WM_TIMER, Tavo_WiParkedCursorMonitor::ParkTimerId, 0);
    EXPECT_TRUE(wnd.CallsNamed("ParkedStart").empty());
}

// ---- windows ------------------------------------------------------------------------------------------

TEST_F(ScrolleeTest, ScrolleeOwnsItsMonitorAndDataTipWindows)
{
    const HWND monitor = ::GetDlgItem(Scrollee(), 2000);
    ASSERT_NE(monitor, nullptr);
    EXPECT_FALSE(::IsWindowVisible(monitor));
    const HWND tip = wnd.GetScrollee()->GetDataTip()->GetSafeHwnd();
    ASSERT_NE(tip, nullptr);
    EXPECT_FALSE(::IsWindowVisible(tip));

    EXPECT_TRUE(wnd.GetScrollee()->DestroyWindow());
    EXPECT_FALSE(::IsWindow(monitor));
    EXPECT_FALSE(::IsWindow(tip));
}

std::string ClassOf(HWND hwnd)
{
    char name[64] = {};
    ::GetClassNameA(hwnd, name, sizeof name);
    return name;
}

TEST_F(ScrolleeTest, UnderEnglishTheLibrarysOwnClassesAreUsed)
{
    if (!EnglishLocale())
        GTEST_SKIP() << "the user's default locale is not English";
    EXPECT_EQ(ClassOf(Scrollee()), "Tavo_WiScrollee");
    EXPECT_EQ(::GetClassLongPtrA(Scrollee(), GCL_STYLE), static_cast<ULONG_PTR>(CS_DBLCLKS | CS_PARENTDC));
    EXPECT_EQ(reinterpret_cast<HBRUSH>(::GetClassLongPtrA(Scrollee(), GCLP_HBRBACKGROUND)),
              static_cast<HBRUSH>(::GetStockObject(BLACK_BRUSH)));
    EXPECT_EQ(ClassOf(wnd.GetSafeHwnd()), "Tavo_WiScrollWnd");
    EXPECT_EQ(::GetClassLongPtrA(wnd.GetSafeHwnd(), GCL_STYLE), static_cast<ULONG_PTR>(CS_DBLCLKS | CS_PARENTDC));
    EXPECT_EQ(::GetClassLongPtrA(wnd.GetSafeHwnd(), GCLP_HBRBACKGROUND), 0u);
    EXPECT_EQ(::GetClassLongPtrA(wnd.GetSafeHwnd(), GCLP_HCURSOR), 0u);
    const HWND monitor = ::GetDlgItem(Scrollee(), Tavo_WiParkedCursorMonitor::ControlId);
    EXPECT_EQ(ClassOf(monitor), "Tavo_WiParkedCursorWnd");
    EXPECT_EQ(::GetClassLongPtrA(monitor, GCL_STYLE), static_cast<ULONG_PTR>(CS_PARENTDC));
    const HWND tip = wnd.GetScrollee()->GetDataTip()->GetSafeHwnd();
    EXPECT_EQ(ClassOf(tip), "Tavo_WiDataTip");
    EXPECT_EQ(::GetClassLongPtrA(tip, GCL_STYLE), static_cast<ULONG_PTR>(CS_SAVEBITS | CS_DBLCLKS));
    EXPECT_NE(::GetClassLongPtrA(tip, GCLP_HBRBACKGROUND), 0u);
    EXPECT_EQ(reinterpret_cast<HCURSOR>(::GetClassLongPtrA(tip, GCLP_HCURSOR)), ::LoadCursor(nullptr, IDC_ARROW));
}

TEST_F(ScrolleeTest, UnderAnotherLanguageTheFrameworksDefaultClassIsUsed)
{
    if (EnglishLocale())
        GTEST_SKIP() << "the user's default locale is English";
    for (HWND hwnd : {wnd.GetSafeHwnd(), Scrollee(), ::GetDlgItem(Scrollee(), 2000),
                      wnd.GetScrollee()->GetDataTip()->GetSafeHwnd()}) {
        ASSERT_NE(hwnd, nullptr);
        EXPECT_EQ(ClassOf(hwnd).rfind("Tavo_Wi", 0), std::string::npos) << ClassOf(hwnd);
    }
    // The tip still carries its border and tool-window style.
    const HWND tip = wnd.GetScrollee()->GetDataTip()->GetSafeHwnd();
    EXPECT_NE(::GetWindowLongA(tip, GWL_EXSTYLE) & WS_EX_TOOLWINDOW, 0);
    EXPECT_NE(::GetWindowLongA(tip, GWL_STYLE) & WS_BORDER, 0);
}

TEST(ScrollLocale, ProcessRunsUnderTheExpectedLanguage)
{
    // The suite runs once more under a German locale; that run names the
    // language it expects, so that a locale the platform ignored is noticed.
    const char* expected = std::getenv("SCROLL_TEST_PRIMARY_LANGUAGE");
    if (expected == nullptr)
        GTEST_SKIP() << "no language expected";
    EXPECT_EQ(static_cast<int>(::GetUserDefaultLCID() & 0x3FF), std::atoi(expected));
}

}  // namespace
