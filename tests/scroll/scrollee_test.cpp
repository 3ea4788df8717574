// Tavo_WiScrollee: real mouse input with explicit message times classified
// into clicks, double clicks and drags; capture handling; the background
// erase; a rest showing the data tip; the window classes under each locale.
#include "scroll_test_support.h"

#include "Tavo_WiDataTip.h"
#include "Tavo_WiParkedCursorMonitor.h"

#include <gtest/gtest.h>

#include <cstdlib>
#include <string>

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

class ScrolleeTest : public ::testing::Test {
protected:
    void SetUp() override
    {
        ASSERT_TRUE(wnd.Create(WS_CHILD | WS_VISIBLE, CRect(0, 0, WndWidth, WndHeight), host.Wnd(), 5));
        wnd.SetScrollDone(); // the default range needs no bars: the scrollee fills the window
        PumpPending();
        ASSERT_EQ(ChildRect(Scrollee()), CRect(0, 0, WndWidth, WndHeight));
        base = FreshTime();
        // Every test starts with the pointer resting inside, no button down.
        Input(MoveOnly, CPoint(1, 1), 0);
        wnd.Clear();
    }

    void TearDown() override
    {
        // No button stays down for the next test.
        const DWORD releases[][2] = {
            {VK_LBUTTON, LeftUp}, {VK_RBUTTON, RightUp}, {VK_MBUTTON, MOUSEEVENTF_MIDDLEUP}};
        for (const auto& release : releases)
            if (::GetAsyncKeyState(static_cast<int>(release[0])) & 0x8000)
                Input(release[1], CPoint(1, 1), 1900);
        ::ReleaseCapture();
    }

    HWND Scrollee() { return wnd.GetScrollee()->GetSafeHwnd(); }

    // Mouse input at a point of the scrollee, at base + offset milliseconds.
    void Input(DWORD flags, CPoint client, DWORD offset)
    {
        SendMouse(flags, POINT{HostX + client.x, HostY + client.y}, base + offset);
        PumpInput();
    }

    // The pump drops real timers, so no rest begins unless a test sends the park timer.
    void FireHoldTimer() { ::SendMessageA(Scrollee(), WM_TIMER, Tavo_WiScrollee::HoldTimerId, 0); }

    TestWindow host{CRect(HostX, HostY, HostX + 500, HostY + 400)};
    RecordingScrollWnd wnd;
    DWORD base = 0;
};

TEST_F(ScrolleeTest, ReleaseBeforeHoldTimeIsAClickWithTheReleasesFlagsAndPointAndAtItNothing)
{
    // Presses 400 ms apart, the same button never twice in a row, so that no two make a double click.
    const struct {
        DWORD down, up;
        UINT button;
        DWORD held;
    } presses[] = {
        {LeftDown, LeftUp, MK_LBUTTON, 299}, {RightDown, RightUp, MK_RBUTTON, 299}, {MOUSEEVENTF_MIDDLEDOWN, MOUSEEVENTF_MIDDLEUP, MK_MBUTTON, 299}, {LeftDown, LeftUp, MK_LBUTTON, 300}};
    DWORD time = 100;
    for (const auto& p : presses) {
        SCOPED_TRACE(testing::Message() << p.button << " held " << p.held);
        wnd.Clear();
        Input(p.down, CPoint(50, 60), time);
        Input(p.up, CPoint(53, 64), time + p.held);
        FireHoldTimer(); // killed by the release: starts nothing
        const std::vector<Call> click = {{"Click", p.button, 0, {53, 64}}};
        EXPECT_EQ(wnd.calls, p.held < 300 ? click : std::vector<Call>{});
        time += 400;
    }
}

TEST_F(ScrolleeTest, SecondButtonWhileOneIsHeldIsIgnored)
{
    Input(LeftDown, CPoint(30, 30), 1000);
    Input(RightDown, CPoint(30, 30), 1050);
    Input(RightUp, CPoint(30, 30), 1100);
    Input(LeftUp, CPoint(30, 30), 1150);
    EXPECT_EQ(wnd.calls, (std::vector<Call>{{"Click", MK_LBUTTON, 0, {30, 30}}}));
}

TEST_F(ScrolleeTest, PressReleaseDoubleClickReleaseIsAClickThenADoubleClick)
{
    Input(LeftDown, CPoint(40, 40), 1000);
    Input(LeftUp, CPoint(40, 40), 1050);
    Input(LeftDown, CPoint(40, 40), 1100);
    FireHoldTimer(); // holding the second press starts no drag
    Input(LeftUp, CPoint(40, 40), 1150);
    EXPECT_EQ(wnd.calls,
              (std::vector<Call>{{"Click", MK_LBUTTON, 0, {40, 40}}, {"DoubleClick", MK_LBUTTON, MK_LBUTTON, {40, 40}}}));
}

TEST_F(ScrolleeTest, HoldTimerStartsADragWhoseMovesNeedAButtonFlag)
{
    Input(LeftDown, CPoint(50, 60), 1000);
    Input(MoveOnly, CPoint(70, 80), 1100); // moves before the drag are not reported
    FireHoldTimer();
    EXPECT_EQ(::GetCapture(), Scrollee());
    ::SendMessageA(Scrollee(), WM_MOUSEMOVE, MK_SHIFT, MAKELPARAM(5, 6));
    // Any of the three button flags will do; the pressed button is reported.
    ::SendMessageA(Scrollee(), WM_MOUSEMOVE, MK_RBUTTON, MAKELPARAM(7, 8));
    Input(MoveOnly, CPoint(450, 60), 1400); // outside the scrollee, inside the host
    Input(LeftUp, CPoint(450, 60), 1500);
    const std::vector<Call> expected = {
        {"DragStart", MK_LBUTTON, MK_LBUTTON, {50, 60}}, {"DragMove", MK_LBUTTON, MK_RBUTTON, {7, 8}}, {"DragMove", MK_LBUTTON, MK_LBUTTON, {450, 60}}, {"DragEnd", MK_LBUTTON, 0, {450, 60}, 1}};
    EXPECT_EQ(wnd.calls, expected);
    EXPECT_EQ(::GetCapture(), nullptr) << "the drag's capture is released";
}

TEST_F(ScrolleeTest, AnotherWindowTakingTheCaptureEndsTheDragIncomplete)
{
    TestWindow other(CRect(0, 0, 10, 10), host.Handle());
    Input(LeftDown, CPoint(50, 60), 1000);
    FireHoldTimer();
    ::SetCapture(other.Handle());
    const std::vector<Call> ended = {{"DragStart", MK_LBUTTON, MK_LBUTTON, {50, 60}}, {"DragEnd", MK_LBUTTON, 0, {0, 0}, 0}};
    EXPECT_EQ(wnd.calls, ended);
    ::ReleaseCapture();
    Input(LeftUp, CPoint(50, 60), 1500);
    EXPECT_EQ(wnd.calls, ended) << "the later release is ignored";
}

TEST_F(ScrolleeTest, AbortDragForgetsTheDragOrThePressWithoutEndingIt)
{
    Input(LeftDown, CPoint(50, 60), 1000);
    FireHoldTimer();
    wnd.AbortDrag();
    EXPECT_EQ(::GetCapture(), nullptr);
    Input(MoveOnly, CPoint(60, 60), 1100);
    Input(LeftUp, CPoint(60, 60), 1200);
    // Before the hold timer: the timer fired afterwards starts nothing.
    Input(LeftDown, CPoint(150, 60), 1800);
    wnd.AbortDrag();
    FireHoldTimer();
    Input(LeftUp, CPoint(150, 60), 1850);
    const Call abort{"DragAbort"};
    EXPECT_EQ(wnd.calls, (std::vector<Call>{{"DragStart", MK_LBUTTON, MK_LBUTTON, {50, 60}}, abort, abort}));
}

TEST_F(ScrolleeTest, PressWhileTheScrolleeHoldsItsOwnCaptureReportsNothing)
{
    wnd.GetScrollee()->CaptureMouse();
    ASSERT_EQ(::GetCapture(), Scrollee());
    Input(LeftDown, CPoint(50, 60), 1000);
    EXPECT_EQ(::GetCapture(), nullptr);
    FireHoldTimer();
    Input(LeftUp, CPoint(50, 60), 1100);
    EXPECT_TRUE(wnd.calls.empty());
}

TEST_F(ScrolleeTest, EraseFillsBlackUntilABackgroundColourIsSet)
{
    const auto repaintOverWhite = [this] {
        CClientDC(wnd.GetScrollee()).FillSolidRect(0, 0, WndWidth, WndHeight, RGB(255, 255, 255));
        ::RedrawWindow(Scrollee(), nullptr, nullptr, RDW_INVALIDATE | RDW_ERASE | RDW_UPDATENOW);
    };
    // Filled and outlined alike, edges included.
    const CPoint probes[] = {{0, 0}, {WndWidth / 2, WndHeight / 2}, {WndWidth - 1, 0}, {WndWidth - 1, WndHeight - 1}};
    repaintOverWhite();
    for (CPoint probe : probes)
        EXPECT_EQ(PixelAt(Scrollee(), probe.x, probe.y), RGB(0, 0, 0)) << testing::PrintToString(probe);
    const COLORREF colour = RGB(0, 128, 255);
    wnd.GetScrollee()->SetBackgroundColor(colour);
    EXPECT_EQ(PixelAt(Scrollee(), 0, 0), RGB(0, 0, 0)) << "setting the colour repaints nothing";
    repaintOverWhite();
    for (CPoint probe : probes)
        EXPECT_EQ(PixelAt(Scrollee(), probe.x, probe.y), colour) << testing::PrintToString(probe);
}

TEST_F(ScrolleeTest, PreTranslatedMovesReachTheMonitorAndARestShowsTheTip)
{
    wnd.dataTipText = "resting";
    Input(MoveOnly, CPoint(60, 70), 1000);
    ::SendMessageA(::GetDlgItem(Scrollee(), Tavo_WiParkedCursorMonitor::ControlId), WM_TIMER,
                   Tavo_WiParkedCursorMonitor::ParkTimerId, 0);
    EXPECT_EQ(wnd.calls, (std::vector<Call>{{"ParkedStart", 0, 0, {60, 70}}, {"DataTipText", 0, 0, {60, 70}}}));
    const HWND tip = wnd.GetScrollee()->GetDataTip()->GetSafeHwnd();
    EXPECT_TRUE(::IsWindowVisible(tip));

    // The next move to another point ends the rest and hides the tip.
    Input(MoveOnly, CPoint(61, 70), 1200);
    EXPECT_EQ(wnd.Count("ParkedEnd"), 1);
    EXPECT_FALSE(::IsWindowVisible(tip));
}

std::string ClassOf(HWND hwnd)
{
    char name[64] = {};
    ::GetClassNameA(hwnd, name, sizeof name);
    return name;
}

// Whether the library uses its own window classes: the user's locale is English.
bool EnglishLocale() { return (::GetUserDefaultLCID() & 0x3FF) == LANG_ENGLISH; }

TEST_F(ScrolleeTest, WindowsUseTheLibrarysOwnClassesUnderEnglishOnly)
{
    const HWND tip = wnd.GetScrollee()->GetDataTip()->GetSafeHwnd();
    const struct {
        HWND hwnd;
        const char* name;
        ULONG_PTR style;
    } windows[] = {
        {wnd.GetSafeHwnd(), "Tavo_WiScrollWnd", CS_DBLCLKS | CS_PARENTDC},
        {Scrollee(), "Tavo_WiScrollee", CS_DBLCLKS | CS_PARENTDC},
        {::GetDlgItem(Scrollee(), Tavo_WiParkedCursorMonitor::ControlId), "Tavo_WiParkedCursorWnd", CS_PARENTDC},
        {tip, "Tavo_WiDataTip", CS_SAVEBITS | CS_DBLCLKS},
    };
    for (const auto& w : windows) {
        SCOPED_TRACE(w.name);
        ASSERT_NE(w.hwnd, nullptr);
        if (!EnglishLocale()) {
            EXPECT_EQ(ClassOf(w.hwnd).rfind("Tavo_Wi", 0), std::string::npos) << ClassOf(w.hwnd);
            continue;
        }
        EXPECT_EQ(ClassOf(w.hwnd), w.name);
        EXPECT_EQ(::GetClassLongPtrA(w.hwnd, GCL_STYLE), w.style);
    }
    // The tip carries its border and tool-window style under either.
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

} // namespace
