// Tavo_WiDrawWnd: the pointer on real windows under Wine. Clicks, double
// clicks and data tips as world apertures; the drag dispatch; pan drags with
// their edge autoscroll; rubber rectangles driven by real input.
#include "drawwnd_test_support.h"

#include "Tavo_WiModule.h"
#include "Tavo_WiParkedCursorMonitor.h"
#include "Tavo_WiResourceIds.h"
#include "Tavo_WiScrollee.h"
#include "Tavo_WiViewMath.h"

#include <gtest/gtest.h>

#include <atomic>
#include <climits>
#include <cmath>
#include <thread>

using namespace DrawWndTest;
using ScrollTest::PixelAt;
using ScrollTest::PumpInput;
using ScrollTest::PumpPending;

namespace {

constexpr DWORD MoveOnly = 0;
constexpr UINT_PTR AutoScrollTimer = Tavo_WiDrawWnd::AutoScrollTimerId;
using Names = std::vector<std::string>;

// The boundaries the window tests below do not reach.
TEST(PointerArithmetic, RoundingBoundariesAndSaturation)
{
    using namespace Tavo_WiViewMath;
    EXPECT_EQ(ApertureHalfWidth(4.0), 1) << "half a unit rounds away from zero";
    EXPECT_EQ(ApertureHalfWidth(4.01), 0);
    EXPECT_EQ(ApertureHalfWidth(1e-12), INT_MAX);
    EXPECT_EQ(Aperture({INT_MAX - 1, INT_MIN + 1}, 1.0), (Tavo_GrWRect{INT_MAX - 3, INT_MIN, INT_MAX, INT_MIN + 3}));
    EXPECT_EQ(PanStepPercent(100, 99, 200, 1), 1);
    EXPECT_EQ(PanStepPercent(100, 101, 200, 1), -1);
    EXPECT_EQ(PanStepPercent(INT_MIN, INT_MAX, 1, -1), INT_MAX);
    EXPECT_EQ(AutoScrollPercent(-25, 500), 2) << "2.5 truncated";
    EXPECT_EQ(AutoScrollPercent(501, 500), 1);
    EXPECT_EQ(AutoScrollPercent(INT_MIN, 1), INT_MAX);
}

HCURSOR Cursor(LPCSTR id)
{
    return ::LoadCursorA(nullptr, id);
}

HCURSOR PanCursor()
{
    return ::LoadCursorA(Tavo_WiGetModuleInstance(), MAKEINTRESOURCEA(TAVO_WI_IDC_PAN));
}

POINT ScreenPoint(HWND window, const CPoint& client)
{
    POINT point = {client.x, client.y};
    ::ClientToScreen(window, &point);
    return point;
}

// A 500 x 400 scrollee without scroll bars and a drawing of 500 x 400 world
// units, red on the left half, white on the right. Bound, the zero level
// shows one unit per pixel: the client point (x, y) is the world point
// (x, 400 - y).
class DrawWndPointerTest : public ::testing::Test {
protected:
    void SetUp() override
    {
        AddFilledRect(drawing, {0, 0, 250, 400}, Red);
        AddFilledRect(drawing, {250, 0, 500, 400}, White);
        wnd().SetScrollBarAutoVisibilityFlag(0);
        wnd().SetScrollBarVisibilityFlags(0, 0);
        wnd().SetScrollDone();
        PumpPending();
        ASSERT_EQ(hosted.ScrolleeSize(), CSize(500, 400));
        base = ScrollTest::FreshTime();
    }

    void TearDown() override
    {
        const struct {
            int key;
            DWORD up;
        } buttons[] = {
            {VK_LBUTTON, MOUSEEVENTF_LEFTUP}, {VK_RBUTTON, MOUSEEVENTF_RIGHTUP}, {VK_MBUTTON, MOUSEEVENTF_MIDDLEUP}};
        for (const auto& b : buttons)
            if (::GetAsyncKeyState(b.key) & 0x8000)
                Input(b.up, CPoint(1, 1), 1900);
        ::ReleaseCapture();
        ::KillTimer(Wnd(), AutoScrollTimer);
        PumpPending();
    }

    TestDrawWnd& wnd() { return hosted.wnd; }
    // The point operations as the scrollee calls them.
    Tavo_WiDrawWnd& pointer() { return hosted.wnd; }
    HWND Wnd() { return wnd().GetSafeHwnd(); }
    HWND Scrollee() { return hosted.Scrollee(); }
    Names NoteNames()
    {
        Names names;
        for (const auto& note : wnd().notes)
            names.push_back(note.name);
        return names;
    }

    // Mouse input at a point of the scrollee at base + offset milliseconds:
    // handled at once, or queued for a loop that takes it later.
    void Input(DWORD flags, const CPoint& client, DWORD offset)
    {
        Queue(flags, client, offset);
        PumpInput();
    }
    void Queue(DWORD flags, const CPoint& client, DWORD offset)
    {
        ScrollTest::SendMouse(flags, ScreenPoint(Scrollee(), client), base + offset);
    }
    void FireHoldTimer() { ::SendMessageA(Scrollee(), WM_TIMER, Tavo_WiScrollee::HoldTimerId, 0); }
    void FireHoldTimerIntoRubberRectangle()
    {
        wnd().dragAction = Tavo_WiDrawWnd::RubberRectangle;
        const ScrollTest::ButtonReleaseDeadline deadline;
        FireHoldTimer();
        EXPECT_FALSE(deadline.Passed()) << "the loop had to be ended from outside";
    }
    // An autoscroll tick with the pointer at a point of the draw window's client area.
    void Tick(const CPoint& pointer)
    {
        const POINT screen = ScreenPoint(Wnd(), pointer);
        ::SetCursorPos(screen.x, screen.y);
        ::SendMessageA(Wnd(), WM_TIMER, AutoScrollTimer, 0);
    }
    // Whether the autoscroll timer is armed; the probe stops it.
    bool AutoScrollArmed() { return ::KillTimer(Wnd(), AutoScrollTimer) != FALSE; }

    // Whether runs of pixels on each side of a rectangle's outline show the
    // drawing (red) again, not what the dotted XOR outline left behind.
    bool OutlineIsClean(const CRect& r)
    {
        const COLORREF red = RGB(255, 0, 0);
        const int x = r.left + r.Width() / 2;
        const int y = r.top + r.Height() / 2;
        for (int i = 0; i < 6; ++i)
            if (PixelAt(Scrollee(), x + i, r.top) != red || PixelAt(Scrollee(), x + i, r.bottom - 1) != red ||
                PixelAt(Scrollee(), r.left, y + i) != red || PixelAt(Scrollee(), r.right - 1, y + i) != red)
                return false;
        return true;
    }

    Tavo_GrDrawing drawing;
    HostedDrawWnd hosted;
    DWORD base = 0;
};

class DrawWndPointerBoundTest : public DrawWndPointerTest {
protected:
    void SetUp() override
    {
        DrawWndPointerTest::SetUp();
        wnd().SetDrawingInfo(&drawing, 50, 3, 0, 0, 0);
        PaintNow(Scrollee());
        ASSERT_DOUBLE_EQ(wnd().GetMapping()->GetTransform().GetScale(), 1.0);
    }
};

// Zoomed in to two pixels per unit about the middle: the view is 250 x 200
// units with its top-left corner at (125, 300); ten percent of it is 25
// units across and 20 up or down.
class DrawWndPointerZoomedTest : public DrawWndPointerBoundTest {
protected:
    void SetUp() override
    {
        DrawWndPointerBoundTest::SetUp();
        wnd().ZoomWindow(5.0, 250, 200);
        PaintNow(Scrollee());
        ASSERT_DOUBLE_EQ(wnd().GetMapping()->GetTransform().GetScale(), 2.0);
        ASSERT_EQ(wnd().GetScrollPosition(), Start);
        ASSERT_EQ(wnd().GetWindowExtent(), CSize(250, 200));
    }
    CSize Moved() { return wnd().GetScrollPosition() - Start; }
    // A pan drag from a point, with a pan direction, from the starting view.
    void StartPan(const CPoint& point, int direction = 1)
    {
        wnd().ScrollWindowTo(Start);
        wnd().SetPanDirectionality(direction);
        wnd().OnDragStart(MK_LBUTTON, MK_LBUTTON, point);
    }
    void MoveTo(const CPoint& point) { wnd().OnDragMove(MK_LBUTTON, MK_LBUTTON, point); }
    void EndDrag() { wnd().OnDragEnd(MK_LBUTTON, 0, CPoint(0, 0), 1); }

    const CPoint Start{125, 300};
};

// ---- apertures ------------------------------------------------------------------------

TEST_F(DrawWndPointerTest, WithoutADrawingThePointGivesTheEmptyApertureAndNoApplicationCall)
{
    Tavo_GrWRect aperture{1, 2, 3, 4};
    EXPECT_EQ(wnd().FetchApertureFromPoint(CPoint(100, 150), aperture), 0);
    EXPECT_EQ(aperture, Tavo_GrWRect());
    wnd().dataTipText = "tip";
    EXPECT_EQ(pointer().GetDataTipText(CPoint(100, 150)), CString());
    ::SetCursor(Cursor(IDC_CROSS));
    pointer().OnClick(MK_LBUTTON, 0, CPoint(100, 150));
    EXPECT_EQ(::GetCursor(), Cursor(IDC_ARROW)) << "a click sets the arrow all the same";
    pointer().OnDoubleClick(MK_LBUTTON, MK_LBUTTON, CPoint(100, 150));
    EXPECT_TRUE(wnd().notes.empty());
}

TEST_F(DrawWndPointerBoundTest, ApertureIsTheWorldPointWidenedByTwoPixelsAndOnlyTheClientAreaIsInside)
{
    const double tenPixelsPerUnit = 5.0 * std::log2(10.0); // five levels double the scale
    const struct {
        double level;
        CPoint point;
        Tavo_GrWRect aperture;
        bool inside;
    } rows[] = {
        {0.0, {100, 150}, {98, 248, 102, 252}, true},
        {0.0, {0, 0}, {-2, 398, 2, 402}, true},
        {0.0, {499, 399}, {497, -1, 501, 3}, true},
        {0.0, {500, 100}, {498, 298, 502, 302}, false}, // one past the last column
        {0.0, {100, 400}, {98, -2, 102, 2}, false},     // one past the last row
        {0.0, {-1, 10}, {-3, 388, 1, 392}, false},
        {tenPixelsPerUnit, {250, 200}, {250, 200, 250, 200}, true}, // the point itself
        {tenPixelsPerUnit, {260, 190}, {251, 201, 251, 201}, true},
    };
    wnd().dataTipText = "tip";
    for (const auto& row : rows) {
        SCOPED_TRACE(testing::Message() << "level " << row.level << " at (" << row.point.x << ", " << row.point.y << ")");
        if (row.level == 0.0)
            wnd().ZoomWindow(Tavo_GrZoom::ZeroLevel, 1, Tavo_WiZoomCenter::AtViewCentre, 0, 0, true);
        else
            wnd().ZoomWindow(row.level, 250, 200);
        wnd().notes.clear();

        Tavo_GrWRect aperture;
        EXPECT_EQ(wnd().FetchApertureFromPoint(row.point, aperture) != 0, row.inside);
        EXPECT_EQ(aperture, row.aperture) << "filled in also outside";
        ::SetCursor(Cursor(IDC_CROSS));
        pointer().OnDoubleClick(MK_RBUTTON, MK_RBUTTON | MK_SHIFT, row.point);
        EXPECT_EQ(::GetCursor(), Cursor(IDC_CROSS)) << "a double click leaves the cursor";
        pointer().OnClick(MK_MBUTTON, MK_CONTROL, row.point);
        EXPECT_EQ(::GetCursor(), Cursor(IDC_ARROW));
        EXPECT_EQ(pointer().GetDataTipText(row.point), row.inside ? CString("tip") : CString());

        if (!row.inside) {
            EXPECT_TRUE(wnd().notes.empty());
            continue;
        }
        ASSERT_EQ(NoteNames(), (Names{"DoubleClick", "Click", "DataTipText"}));
        EXPECT_EQ(wnd().notes[0].flags, UINT(MK_RBUTTON | MK_SHIFT));
        EXPECT_EQ(wnd().notes[1].button, UINT(MK_MBUTTON));
        for (const auto& note : wnd().notes)
            EXPECT_EQ(note.rect, row.aperture) << note.name;
    }
}

TEST_F(DrawWndPointerBoundTest, RealClickAndDoubleClickReachTheApplicationAsApertures)
{
    for (DWORD time : {1000, 1100}) {
        Input(MOUSEEVENTF_LEFTDOWN, CPoint(100, 150), time);
        Input(MOUSEEVENTF_LEFTUP, CPoint(100, 150), time + 50);
    }
    ASSERT_EQ(NoteNames(), (Names{"Click", "DoubleClick"}));
    EXPECT_EQ(wnd().notes[0].flags, 0u) << "the flags of the release";
    EXPECT_EQ(wnd().notes[1].flags, UINT(MK_LBUTTON)) << "the flags of the double click";
    for (const auto& note : wnd().notes)
        EXPECT_EQ(note.rect, (Tavo_GrWRect{98, 248, 102, 252}));
}

// ---- the drag dispatch ------------------------------------------------------------------

TEST_F(DrawWndPointerBoundTest, PanDragAtTheZeroLevelDoesNothing)
{
    Input(MOUSEEVENTF_LEFTDOWN, CPoint(300, 200), 1000);
    ::SetCursor(Cursor(IDC_CROSS));
    FireHoldTimer();
    EXPECT_EQ(wnd().IsDragScrolling(), 0);
    EXPECT_EQ(::GetCursor(), Cursor(IDC_CROSS)) << "no pan cursor";
    Input(MOUSEEVENTF_LEFTUP, CPoint(250, 150), 1200);
    EXPECT_EQ(NoteNames(), Names{"DragEnd"});
}

TEST_F(DrawWndPointerBoundTest, DragAndDropReachesTheApplicationAfterTheScrolleeForgotThePress)
{
    wnd().dragAction = Tavo_WiDrawWnd::DragAndDrop;
    Input(MOUSEEVENTF_RIGHTDOWN, CPoint(120, 130), 1000);
    FireHoldTimer();
    ASSERT_EQ(NoteNames(), Names{"DragAndDrop"});
    const auto& note = wnd().notes[0];
    EXPECT_EQ(note.button, UINT(MK_RBUTTON));
    EXPECT_EQ(note.flags, UINT(MK_RBUTTON)) << "the flags of the press";
    EXPECT_EQ(note.rect, (Tavo_GrWRect{120, 130, 120, 130})) << "the press point, client coordinates";
    EXPECT_EQ(note.capture, nullptr) << "the scrollee has let the capture go";
    // Within the hold time: a press still followed would end as a click or a drag end.
    Input(MOUSEEVENTF_RIGHTUP, CPoint(120, 130), 1100);
    EXPECT_EQ(NoteNames(), Names{"DragAndDrop"});
}

TEST_F(DrawWndPointerTest, UnknownActionsAndPansWithoutADrawingStartNothing)
{
    const struct {
        Tavo_WiDrawWnd::DragAction action;
        UINT button;
    } rows[] = {
        {static_cast<Tavo_WiDrawWnd::DragAction>(7), MK_LBUTTON},
        {Tavo_WiDrawWnd::Pan, MK_LBUTTON},
        // No release could end that loop: it is not run at all.
        {Tavo_WiDrawWnd::RubberRectangle, MK_LBUTTON | MK_RBUTTON},
    };
    for (const auto& row : rows) {
        SCOPED_TRACE(testing::Message() << "action " << row.action);
        wnd().dragAction = row.action;
        ::SetCursor(Cursor(IDC_CROSS));
        wnd().OnDragStart(row.button, row.button, CPoint(100, 100));
        EXPECT_EQ(wnd().IsDragScrolling(), 0);
        EXPECT_EQ(::GetCapture(), nullptr);
        EXPECT_EQ(::GetCursor(), Cursor(IDC_CROSS));
        EXPECT_TRUE(wnd().notes.empty());
    }
}

// ---- pan drags ------------------------------------------------------------------------------

TEST_F(DrawWndPointerZoomedTest, PanDragShowsTheLibrarysPanCursorAndEndsWithTheArrow)
{
    Input(MOUSEEVENTF_LEFTDOWN, CPoint(300, 200), 1000);
    FireHoldTimer();
    EXPECT_EQ(wnd().IsDragScrolling(), 1);
    EXPECT_EQ(::GetCursor(), PanCursor());
    ICONINFO info = {};
    ASSERT_TRUE(::GetIconInfo(::GetCursor(), &info));
    ::DeleteObject(info.hbmMask);
    ::DeleteObject(info.hbmColor);
    EXPECT_EQ(CPoint(info.xHotspot, info.yHotspot), CPoint(16, 16));

    Input(MoveOnly, CPoint(250, 200), 1100); // with the button down
    EXPECT_EQ(Moved(), CSize(25, 0));
    EXPECT_EQ(::GetCursor(), PanCursor());
    Input(MOUSEEVENTF_LEFTUP, CPoint(250, 200), 1200);
    EXPECT_EQ(wnd().IsDragScrolling(), 0);
    EXPECT_EQ(NoteNames(), Names{"DragEnd"});

    // The end sets the arrow itself, not only the next cursor message.
    ::SetCursor(Cursor(IDC_CROSS));
    pointer().OnDragEnd(MK_LBUTTON, 0, CPoint(0, 0), 0);
    EXPECT_EQ(::GetCursor(), Cursor(IDC_ARROW));
}

TEST_F(DrawWndPointerZoomedTest, PanDragScrollsByTheMovementInPercentOfTheView)
{
    const struct {
        int direction;
        CPoint to;
        CSize moved;
    } rows[] = {
        {1, {250, 200}, {25, 0}}, // 50 of 500 pixels left: the view goes right, the drawing with the pointer
        {-1, {250, 200}, {-25, 0}},
        {1, {350, 200}, {-25, 0}},
        {1, {300, 160}, {0, -20}}, // 40 of 400 pixels up: the view goes down (world y falls)
        {-1, {300, 160}, {0, 20}},
        {1, {500, 400}, {-100, 100}}, // the far edges are inside: 40 and 50 percent
    };
    for (const auto& row : rows) {
        SCOPED_TRACE(testing::Message() << row.direction << " to (" << row.to.x << ", " << row.to.y << ")");
        StartPan(CPoint(300, 200), row.direction);
        EXPECT_EQ(wnd().IsDragScrolling(), 1);
        MoveTo(row.to);
        EXPECT_EQ(Moved(), row.moved);
        EndDrag();
        EXPECT_EQ(wnd().IsDragScrolling(), 0);
        EXPECT_FALSE(AutoScrollArmed());
    }
}

TEST_F(DrawWndPointerZoomedTest, SlowPanMovesBelowHalfAPercentAddUpOnEachAxis)
{
    // A pixel is 0.2 percent across and 0.25 up or down; one percent is 2 units.
    const struct {
        CPoint to;
        CSize moved;
    } steps[] = {
        {{298, 199}, {0, 0}},  // 0.4 and 0.25 percent: the reference stays
        {{296, 198}, {2, -2}}, // 0.8 and 0.5 from it: one percent each
        {{295, 198}, {2, -2}},
        {{294, 197}, {2, -2}},
        {{293, 196}, {4, -4}}, // 0.6 and 0.5 from (296, 198)
    };
    StartPan(CPoint(300, 200));
    for (const auto& step : steps) {
        MoveTo(step.to);
        EXPECT_EQ(Moved(), step.moved) << "at (" << step.to.x << ", " << step.to.y << ")";
    }
}

TEST_F(DrawWndPointerZoomedTest, AutoScrollTickScrollsTowardsTheEdgeWithTheSquareOfTheOvershoot)
{
    const struct {
        int direction;
        CPoint pointer;
        CSize moved;
        bool rearmed;
    } rows[] = {
        {1, {-50, 200}, {25, 0}, true}, // a tenth of the width beyond: 10 percent
        {1, {-5, 200}, {2, 0}, true},   // a hundredth: 1 percent
        {1, {550, 200}, {-25, 0}, true},
        {-1, {-50, 200}, {-25, 0}, true},
        {1, {250, -40}, {0, -20}, true},
        {-1, {250, 440}, {0, -20}, true},
        {1, {-50, 440}, {25, 20}, true},
        {1, {250, 200}, {0, 0}, false}, // back inside: the timer stops
        {1, {500, 400}, {0, 0}, false},
    };
    for (const auto& row : rows) {
        SCOPED_TRACE(testing::Message() << row.direction << " at (" << row.pointer.x << ", " << row.pointer.y << ")");
        StartPan(CPoint(250, 200), row.direction);
        MoveTo(CPoint(-50, 200));
        EXPECT_EQ(Moved(), CSize(0, 0)) << "leaving the view only starts the timer";
        Tick(row.pointer);
        EXPECT_EQ(Moved(), row.moved);
        EXPECT_EQ(AutoScrollArmed(), row.rearmed);
        EndDrag();
    }
}

TEST_F(DrawWndPointerZoomedTest, WhileAutoScrollingMovesOnlyKeepTheReferenceAndPanningResumesFromTheLastTick)
{
    StartPan(CPoint(250, 200));
    MoveTo(CPoint(-50, 200));
    Tick(CPoint(-50, 200));
    MoveTo(CPoint(100, 200));
    EXPECT_EQ(Moved(), CSize(25, 0)) << "the timer runs: the move does not pan";
    Tick(CPoint(300, 200));
    MoveTo(CPoint(250, 200));
    EXPECT_EQ(Moved(), CSize(50, 0)) << "panned from the last tick's pointer, not the last move's";
    EXPECT_FALSE(AutoScrollArmed());
}

TEST_F(DrawWndPointerZoomedTest, TickDueAfterTheDragEndedScrollsOnceWithoutReArming)
{
    StartPan(CPoint(250, 200));
    MoveTo(CPoint(-50, 200));
    EndDrag();
    Tick(CPoint(-50, 200));
    EXPECT_EQ(Moved(), CSize(25, 0));
    EXPECT_FALSE(AutoScrollArmed());
}

TEST_F(DrawWndPointerZoomedTest, ScrolleeOfNoWidthOrHeightPansAndAutoScrollsNothing)
{
    // The zoom stays while the scrollee has no area, so a pan drag still
    // starts; its steps would divide by the saved size.
    const struct {
        CSize size;
        CPoint start, inside, outside;
    } rows[] = {
        {{0, 400}, {5, 200}, {0, 200}, {40, 200}},
        {{500, 0}, {250, 5}, {250, 0}, {250, 40}},
    };
    for (const auto& row : rows) {
        ::SetWindowPos(Wnd(), nullptr, 0, 0, row.size.cx, row.size.cy, SWP_NOMOVE | SWP_NOZORDER);
        ASSERT_EQ(hosted.ScrolleeSize(), row.size);
        StartPan(row.start);
        ASSERT_EQ(wnd().IsDragScrolling(), 1);
        MoveTo(row.inside);
        MoveTo(row.outside);
        Tick(row.outside);
        EXPECT_EQ(Moved(), CSize(0, 0)) << row.size.cx << " x " << row.size.cy;
        EXPECT_FALSE(AutoScrollArmed());
        EndDrag();
    }
}

// ---- rubber rectangles ----------------------------------------------------------------
//
// The rectangle's loop takes the thread's messages itself: each test queues
// what the loop is to see before the hold timer starts the drag.

TEST_F(DrawWndPointerBoundTest, RubberRectangleEndsOnlyWithItsOwnButtonAndIsReportedInWorldCoordinates)
{
    const struct {
        UINT button;
        DWORD down, up, otherDown, otherUp;
    } rows[] = {
        {MK_LBUTTON, MOUSEEVENTF_LEFTDOWN, MOUSEEVENTF_LEFTUP, MOUSEEVENTF_RIGHTDOWN, MOUSEEVENTF_RIGHTUP},
        {MK_RBUTTON, MOUSEEVENTF_RIGHTDOWN, MOUSEEVENTF_RIGHTUP, MOUSEEVENTF_MIDDLEDOWN, MOUSEEVENTF_MIDDLEUP},
        {MK_MBUTTON, MOUSEEVENTF_MIDDLEDOWN, MOUSEEVENTF_MIDDLEUP, MOUSEEVENTF_LEFTDOWN, MOUSEEVENTF_LEFTUP},
    };
    DWORD time = 1000;
    for (const auto& row : rows) {
        SCOPED_TRACE(testing::Message() << "button " << row.button);
        wnd().notes.clear();
        Input(row.down, CPoint(100, 100), time);
        Queue(MoveOnly, CPoint(150, 180), time + 350);
        Queue(row.otherDown, CPoint(150, 180), time + 360);
        Queue(row.otherUp, CPoint(150, 180), time + 370);
        Queue(MoveOnly, CPoint(200, 250), time + 380);
        Queue(row.up, CPoint(200, 250), time + 400);
        FireHoldTimerIntoRubberRectangle();

        ASSERT_EQ(NoteNames(), Names{"RubberRectangle"});
        const auto& note = wnd().notes[0];
        EXPECT_EQ(note.button, row.button);
        EXPECT_EQ(note.flags, row.button) << "the flags of the press";
        // Client (100, 100)-(200, 250): world y runs from 400 - 250 to 400 - 100.
        EXPECT_EQ(note.rect, (Tavo_GrWRect{100, 150, 200, 300}));
        EXPECT_EQ(note.capture, nullptr) << "released before the report";
        EXPECT_EQ(HIWORD(::GetQueueStatus(QS_INPUT)), 0u) << "the loop took the input";
        EXPECT_TRUE(OutlineIsClean(CRect(100, 100, 200, 250))) << "the last outline is erased";
        time += 1000;
    }
}

TEST_F(DrawWndPointerBoundTest, RubberRectangleWithoutMovementIsReportedWithZeroSize)
{
    Input(MOUSEEVENTF_LEFTDOWN, CPoint(120, 130), 1000);
    Queue(MOUSEEVENTF_LEFTUP, CPoint(120, 130), 1400);
    FireHoldTimerIntoRubberRectangle();
    ASSERT_EQ(NoteNames(), Names{"RubberRectangle"});
    EXPECT_EQ(wnd().notes[0].rect, (Tavo_GrWRect{120, 270, 120, 270}));
}

TEST_F(DrawWndPointerBoundTest, RubberRectangleShowsTheReleaseItTakesToTheParkedCursorMonitor)
{
    // The monitor saw the press. Had it not seen the release, which the
    // rectangle's loop takes, it would start no wait for a rest, and show no
    // data tip, until the next click.
    const HWND monitor = wnd().GetScrollee()->GetParkedCursorMonitor()->GetSafeHwnd();
    Input(MOUSEEVENTF_LEFTDOWN, CPoint(120, 130), 1000);
    Queue(MOUSEEVENTF_LEFTUP, CPoint(160, 170), 1400);
    FireHoldTimerIntoRubberRectangle();
    ASSERT_EQ(NoteNames(), Names{"RubberRectangle"});
    Input(MoveOnly, CPoint(180, 190), 1500);
    EXPECT_TRUE(::KillTimer(monitor, Tavo_WiParkedCursorMonitor::ParkTimerId)) << "the move starts the wait for a rest";
}

TEST_F(DrawWndPointerBoundTest, PaintTakenByTheRubberRectangleIsDispatchedUnderTheOutline)
{
    Input(MOUSEEVENTF_LEFTDOWN, CPoint(100, 100), 1000);
    Queue(MoveOnly, CPoint(200, 250), 1350);
    // The loop turns to the paint once the input is consumed; only a paint
    // really carried out queues the release that ends it.
    ::InvalidateRect(Scrollee(), nullptr, TRUE);
    wnd().onPaint = [this] { Queue(MOUSEEVENTF_LEFTUP, CPoint(200, 250), 1400); };
    FireHoldTimerIntoRubberRectangle();
    wnd().onPaint = nullptr;
    ASSERT_EQ(NoteNames(), Names{"RubberRectangle"});
    EXPECT_EQ(wnd().notes[0].rect, (Tavo_GrWRect{100, 150, 200, 300}));
    // The outline was taken off for the paint and put back after it.
    EXPECT_TRUE(OutlineIsClean(CRect(100, 100, 200, 250)));
}

TEST_F(DrawWndPointerBoundTest, RubberRectangleIsCancelledWhenAnotherWindowTakesTheCapture)
{
    // The loop dispatches paint messages and nothing else: a paint of the
    // scrollee left pending is where another window can take the capture.
    ScrollTest::TestWindow other(CRect(550, 0, 600, 50), hosted.host.Handle());
    Input(MOUSEEVENTF_LEFTDOWN, CPoint(100, 100), 1000);
    Queue(MoveOnly, CPoint(200, 250), 1350);
    ::InvalidateRect(Scrollee(), nullptr, TRUE);
    wnd().onPaint = [&] { ::SetCapture(other.Handle()); };
    FireHoldTimerIntoRubberRectangle();
    wnd().onPaint = nullptr;
    EXPECT_EQ(::GetCapture(), other.Handle()) << "the other window keeps the capture";
    EXPECT_TRUE(wnd().notes.empty());
    EXPECT_TRUE(OutlineIsClean(CRect(100, 100, 200, 250)));
    ::ReleaseCapture();
    Input(MOUSEEVENTF_LEFTUP, CPoint(200, 250), 1400);
    EXPECT_TRUE(wnd().notes.empty()) << "the scrollee has forgotten the press";
}

TEST_F(DrawWndPointerBoundTest, QuitTakenByTheRubberRectangleCancelsItAndReachesTheApplicationsLoop)
{
    Input(MOUSEEVENTF_LEFTDOWN, CPoint(100, 100), 1000);
    Queue(MoveOnly, CPoint(200, 250), 1350);
    ::PostQuitMessage(7);
    FireHoldTimerIntoRubberRectangle();
    EXPECT_TRUE(wnd().notes.empty());
    EXPECT_EQ(::GetCapture(), nullptr);
    MSG quit = {};
    ASSERT_TRUE(::PeekMessageA(&quit, nullptr, WM_QUIT, WM_QUIT, PM_REMOVE));
    EXPECT_EQ(quit.wParam, 7u);
    EXPECT_TRUE(OutlineIsClean(CRect(100, 100, 200, 250)));
}

} // namespace
