// Tavo_WiDrawWnd: the pointer on real windows under Wine. Clicks, double
// clicks and data tips as world apertures; the drag dispatch; pan drags with
// their edge autoscroll; rubber rectangles driven by real input; and the
// arithmetic behind them.
#include "drawwnd_test_support.h"

#include "Tavo_WiModule.h"
#include "Tavo_WiResourceIds.h"
#include "Tavo_WiScrollee.h"
#include "Tavo_WiViewMath.h"

#include <gtest/gtest.h>

#include <climits>
#include <cmath>
#include <limits>

using namespace DrawWndTest;
using ScrollTest::PixelAt;
using ScrollTest::PumpInput;
using ScrollTest::PumpPending;

namespace {

constexpr DWORD MoveOnly = 0;
constexpr UINT_PTR HoldTimer = Tavo_WiScrollee::HoldTimerId;
constexpr UINT_PTR AutoScrollTimer = Tavo_WiDrawWnd::AutoScrollTimerId;

// ---- the arithmetic ---------------------------------------------------------------

TEST(PointerArithmetic, ApertureIsTwoPixelsOfWorldRoundedHalfAwayFromZero)
{
    const double nan = std::numeric_limits<double>::quiet_NaN();
    const struct { double scale; int halfWidth; } rows[] = {
        {1.0, 2}, {0.5, 4}, {4.0, 1}, {4.01, 0}, {10.0, 0}, {1e-12, INT_MAX}, {0.0, 0}, {-1.0, 0}, {nan, 0}};
    for (const auto& row : rows)
        EXPECT_EQ(Tavo_WiViewMath::ApertureHalfWidth(row.scale), row.halfWidth) << "scale " << row.scale;
    // Far out the aperture saturates instead of wrapping onto the other side.
    EXPECT_EQ(Tavo_WiViewMath::Aperture({INT_MAX - 1, INT_MIN + 1}, 1.0),
              (Tavo_GrWRect{INT_MAX - 3, INT_MIN, INT_MAX, INT_MIN + 3}));
}

TEST(PointerArithmetic, PanStepIsTheRoundedMovementInPercentTimesTheDirection)
{
    const struct { int reference, pointer, size, direction, step; } rows[] = {
        {300, 250, 500, 1, 10},   {300, 250, 500, -1, -10}, {300, 350, 500, 1, -10},
        {300, 298, 500, 1, 0},    // 0.4 percent
        {300, 297, 500, 1, 1},    // 0.6 percent
        {100, 99, 200, 1, 1},     {100, 101, 200, 1, -1},   // halves away from zero
        {5, 0, 0, 1, 0},          // a window of no size scrolls nothing
        {INT_MAX, INT_MIN, 1, 1, INT_MAX}, {INT_MIN, INT_MAX, 1, -1, INT_MAX}};
    for (const auto& r : rows)
        EXPECT_EQ(Tavo_WiViewMath::PanStepPercent(r.reference, r.pointer, r.size, r.direction), r.step)
            << r.reference << " to " << r.pointer << " of " << r.size << ", direction " << r.direction;
}

TEST(PointerArithmetic, AutoScrollGrowsWithTheSquareOfTheOvershootAndIsAtLeastOne)
{
    const struct { int position, size, percent; } rows[] = {
        {-50, 500, 10}, {550, 500, 10}, {-25, 500, 2}, {-22, 500, 1}, {-5, 500, 1}, {501, 500, 1},
        {0, 500, 0},    {500, 500, 0},   // the far edge itself is inside
        {-1, 0, 0},     {30, 0, 0},      // a window of no size scrolls nothing
        {INT_MIN, 1, INT_MAX}};
    for (const auto& r : rows)
        EXPECT_EQ(Tavo_WiViewMath::AutoScrollPercent(r.position, r.size), r.percent)
            << r.position << " of " << r.size;
}

// ---- the window ------------------------------------------------------------------------

HCURSOR Arrow()
{
    return ::LoadCursor(nullptr, IDC_ARROW);
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

// A child window that takes the mouse capture when it paints, once armed. The
// rubber-rectangle loop dispatches paint messages and nothing else, so a paint
// of this window left pending before the loop starts is how another window of
// the thread takes the capture at a known point of the loop.
class CaptureThief
{
public:
    explicit CaptureThief(HWND parent, const CRect& rect)
    {
        static const char* const className = [] {
            WNDCLASSA wc = {};
            wc.lpfnWndProc = Proc;
            wc.hInstance = ::GetModuleHandleA(nullptr);
            wc.lpszClassName = "PointerTestCaptureThief";
            ::RegisterClassA(&wc);
            return wc.lpszClassName;
        }();
        m_hwnd = ::CreateWindowExA(0, className, "", WS_CHILD | WS_VISIBLE, rect.left, rect.top, rect.Width(),
                                   rect.Height(), parent, nullptr, ::GetModuleHandleA(nullptr), nullptr);
        ::SetWindowLongPtrA(m_hwnd, GWLP_USERDATA, reinterpret_cast<LONG_PTR>(this));
        ::UpdateWindow(m_hwnd);
    }
    ~CaptureThief() { ::DestroyWindow(m_hwnd); }
    CaptureThief(const CaptureThief&) = delete;
    CaptureThief& operator=(const CaptureThief&) = delete;

    HWND Handle() const { return m_hwnd; }
    // Leaves a paint pending that takes the capture.
    void ArmForNextPaint()
    {
        m_armed = true;
        ::InvalidateRect(m_hwnd, nullptr, FALSE);
    }

private:
    static LRESULT CALLBACK Proc(HWND hwnd, UINT message, WPARAM wParam, LPARAM lParam)
    {
        if (message != WM_PAINT)
            return ::DefWindowProcA(hwnd, message, wParam, lParam);
        PAINTSTRUCT paint;
        ::BeginPaint(hwnd, &paint);
        ::EndPaint(hwnd, &paint);
        auto* self = reinterpret_cast<CaptureThief*>(::GetWindowLongPtrA(hwnd, GWLP_USERDATA));
        if (self && self->m_armed)
            ::SetCapture(hwnd);
        return 0;
    }

    HWND m_hwnd = nullptr;
    bool m_armed = false;
};

// A drawing window in a 500 x 400 scrollee without scroll bars, and a drawing
// of 500 x 400 world units, red on the left half and white on the right.
// Bound, the zero level shows it at one world unit per pixel: the client point
// (x, y) is the world point (x, 400 - y).
class DrawWndPointerTest : public ::testing::Test
{
protected:
    void SetUp() override
    {
        AddFilledRect(drawing, {0, 0, 250, 400}, Red);
        AddFilledRect(drawing, {250, 0, 500, 400}, White);
        wnd().SetScrollBarAutoVisibilityFlag(0);
        wnd().SetScrollBarVisibilityFlags(0, 0);
        wnd().SetScrollDone();   // lays the children out, the scrollee over the whole window
        PumpPending();
        ASSERT_EQ(hosted.ScrolleeSize(), CSize(500, 400));
        base = ScrollTest::FreshTime();
    }

    void TearDown() override
    {
        // No button stays down and no capture or timer stays for the next test.
        const struct { int key; DWORD up; } buttons[] = {
            {VK_LBUTTON, MOUSEEVENTF_LEFTUP}, {VK_RBUTTON, MOUSEEVENTF_RIGHTUP}, {VK_MBUTTON, MOUSEEVENTF_MIDDLEUP}};
        for (const auto& b : buttons)
            if (::GetAsyncKeyState(b.key) & 0x8000)
                Input(b.up, CPoint(1, 1), 1900);
        ::ReleaseCapture();
        ::KillTimer(Wnd(), AutoScrollTimer);
        PumpPending();
    }

    TestDrawWnd& wnd() { return hosted.wnd; }
    // The point operations as the scrollee calls them (the test window
    // overrides their world-rectangle forms).
    Tavo_WiDrawWnd& pointer() { return hosted.wnd; }
    HWND Wnd() { return wnd().GetSafeHwnd(); }
    HWND Scrollee() { return hosted.Scrollee(); }

    void Bind()
    {
        wnd().SetDrawingInfo(&drawing, 50, 3, 0, 0, 0);
        PaintNow(Scrollee());
        ASSERT_DOUBLE_EQ(wnd().GetMapping()->GetTransform().GetScale(), 1.0);
    }

    // Mouse input at a point of the scrollee at base + offset milliseconds:
    // handled at once, or left in the queue for a loop that takes it later.
    void Input(DWORD flags, const CPoint& client, DWORD offset)
    {
        Queue(flags, client, offset);
        PumpInput();
    }
    void Queue(DWORD flags, const CPoint& client, DWORD offset)
    {
        ScrollTest::SendMouse(flags, ScreenPoint(Scrollee(), client), base + offset);
    }

    // The scrollee's hold timer: the press held so far becomes a drag.
    void FireHoldTimer() { ::SendMessageA(Scrollee(), WM_TIMER, HoldTimer, 0); }

    // An autoscroll tick with the pointer at a point of the draw window's client area.
    void Tick(const CPoint& pointer)
    {
        const POINT screen = ScreenPoint(Wnd(), pointer);
        ::SetCursorPos(screen.x, screen.y);
        ::SendMessageA(Wnd(), WM_TIMER, AutoScrollTimer, 0);
    }

    // Whether the autoscroll timer is armed; the probe stops it.
    bool AutoScrollArmed() { return ::KillTimer(Wnd(), AutoScrollTimer) != FALSE; }

    std::vector<std::string> NoteNames()
    {
        std::vector<std::string> names;
        for (const auto& note : wnd().notes)
            names.push_back(note.name);
        return names;
    }

    // Whether a run of pixels in the middle of each side of a rectangle's
    // outline shows the drawing (red) again, not what the focus rectangle's
    // dotted XOR left behind.
    bool OutlineIsClean(const CRect& r)
    {
        const COLORREF red = RGB(255, 0, 0);
        const int x = r.left + r.Width() / 2;
        const int y = r.top + r.Height() / 2;
        for (int i = 0; i < 6; ++i) {
            if (PixelAt(Scrollee(), x + i, r.top) != red || PixelAt(Scrollee(), x + i, r.bottom - 1) != red ||
                PixelAt(Scrollee(), r.left, y + i) != red || PixelAt(Scrollee(), r.right - 1, y + i) != red)
                return false;
        }
        return true;
    }

    Tavo_GrDrawing drawing;
    HostedDrawWnd hosted;
    DWORD base = 0;
};

class DrawWndPointerBoundTest : public DrawWndPointerTest
{
protected:
    void SetUp() override
    {
        DrawWndPointerTest::SetUp();
        ASSERT_NO_FATAL_FAILURE(Bind());
    }
};

// Zoomed in to two pixels per world unit about the drawing's middle: the view
// is 250 x 200 world units with its top-left corner at (125, 300), so ten
// percent of it is 25 units across and 20 up or down.
class DrawWndPointerZoomedTest : public DrawWndPointerBoundTest
{
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

    const CPoint Start{125, 300};
};

// ---- apertures: clicks, double clicks, data tips ---------------------------------------

TEST_F(DrawWndPointerTest, WithoutADrawingThePointGivesTheEmptyApertureAndNoApplicationCall)
{
    Tavo_GrWRect aperture{1, 2, 3, 4};
    EXPECT_EQ(wnd().FetchApertureFromPoint(CPoint(100, 150), aperture), 0);
    EXPECT_EQ(aperture, Tavo_GrWRect());
    wnd().dataTipText = "tip";
    EXPECT_EQ(pointer().GetDataTipText(CPoint(100, 150)), CString());
    ::SetCursor(::LoadCursor(nullptr, IDC_CROSS));
    pointer().OnClick(MK_LBUTTON, 0, CPoint(100, 150));
    EXPECT_EQ(::GetCursor(), Arrow()) << "a click sets the arrow even without a drawing";
    pointer().OnDoubleClick(MK_LBUTTON, MK_LBUTTON, CPoint(100, 150));
    EXPECT_TRUE(wnd().notes.empty());
}

TEST_F(DrawWndPointerBoundTest, ApertureIsTheWorldPointWidenedByTwoPixelsAndOnlyTheClientAreaIsInside)
{
    const double tenPixelsPerUnit = 5.0 * std::log2(10.0);   // five levels double the scale
    const struct { double level; CPoint point; Tavo_GrWRect aperture; bool inside; } rows[] = {
        {0.0, {100, 150}, {98, 248, 102, 252}, true},
        {0.0, {0, 0}, {-2, 398, 2, 402}, true},
        {0.0, {499, 399}, {497, -1, 501, 3}, true},
        {0.0, {500, 100}, {498, 298, 502, 302}, false},   // one past the last column
        {0.0, {100, 400}, {98, -2, 102, 2}, false},       // one past the last row
        {0.0, {-1, 10}, {-3, 388, 1, 392}, false},
        {tenPixelsPerUnit, {250, 200}, {250, 200, 250, 200}, true},   // the point itself
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

        ::SetCursor(::LoadCursor(nullptr, IDC_CROSS));
        pointer().OnDoubleClick(MK_RBUTTON, MK_RBUTTON | MK_SHIFT, row.point);
        EXPECT_EQ(::GetCursor(), ::LoadCursor(nullptr, IDC_CROSS)) << "a double click leaves the cursor";
        pointer().OnClick(MK_MBUTTON, MK_CONTROL, row.point);
        EXPECT_EQ(::GetCursor(), Arrow());
        EXPECT_EQ(pointer().GetDataTipText(row.point), row.inside ? CString("tip") : CString());

        if (!row.inside) {
            EXPECT_TRUE(wnd().notes.empty());
            continue;
        }
        ASSERT_EQ(NoteNames(), (std::vector<std::string>{"DoubleClick", "Click", "DataTipText"}));
        EXPECT_EQ(wnd().notes[0].button, UINT(MK_RBUTTON));
        EXPECT_EQ(wnd().notes[0].flags, UINT(MK_RBUTTON | MK_SHIFT));
        EXPECT_EQ(wnd().notes[1].button, UINT(MK_MBUTTON));
        EXPECT_EQ(wnd().notes[1].flags, UINT(MK_CONTROL));
        for (const auto& note : wnd().notes)
            EXPECT_EQ(note.rect, row.aperture) << note.name;
    }
}

TEST_F(DrawWndPointerBoundTest, RealClickAndDoubleClickReachTheApplicationAsApertures)
{
    Input(MOUSEEVENTF_LEFTDOWN, CPoint(100, 150), 1000);
    Input(MOUSEEVENTF_LEFTUP, CPoint(100, 150), 1050);
    Input(MOUSEEVENTF_LEFTDOWN, CPoint(100, 150), 1100);
    Input(MOUSEEVENTF_LEFTUP, CPoint(100, 150), 1150);
    ASSERT_EQ(NoteNames(), (std::vector<std::string>{"Click", "DoubleClick"}));
    EXPECT_EQ(wnd().notes[0].flags, 0u) << "the flags of the release";
    EXPECT_EQ(wnd().notes[1].flags, UINT(MK_LBUTTON)) << "the flags of the double click";
    for (const auto& note : wnd().notes) {
        EXPECT_EQ(note.button, UINT(MK_LBUTTON));
        EXPECT_EQ(note.rect, (Tavo_GrWRect{98, 248, 102, 252}));
    }
}

// ---- the drag dispatch ------------------------------------------------------------------

TEST_F(DrawWndPointerBoundTest, PanDragAtTheZeroLevelDoesNothing)
{
    Input(MOUSEEVENTF_LEFTDOWN, CPoint(300, 200), 1000);
    ::SetCursor(::LoadCursor(nullptr, IDC_CROSS));
    FireHoldTimer();
    EXPECT_EQ(wnd().IsDragScrolling(), 0);
    EXPECT_EQ(::GetCursor(), ::LoadCursor(nullptr, IDC_CROSS)) << "no pan cursor";
    const CPoint position = wnd().GetScrollPosition();
    Input(MoveOnly, CPoint(250, 150), 1100);
    Input(MOUSEEVENTF_LEFTUP, CPoint(250, 150), 1200);
    EXPECT_EQ(wnd().GetScrollPosition(), position);
    EXPECT_EQ(NoteNames(), std::vector<std::string>{"DragEnd"});
}

TEST_F(DrawWndPointerBoundTest, DragAndDropReachesTheApplicationAfterTheScrolleeForgotThePress)
{
    wnd().dragAction = Tavo_WiDrawWnd::DragAndDrop;
    Input(MOUSEEVENTF_RIGHTDOWN, CPoint(120, 130), 1000);
    FireHoldTimer();
    ASSERT_EQ(NoteNames(), std::vector<std::string>{"DragAndDrop"});
    const auto& note = wnd().notes[0];
    EXPECT_EQ(note.button, UINT(MK_RBUTTON));
    EXPECT_EQ(note.flags, UINT(MK_RBUTTON)) << "the flags of the press";
    EXPECT_EQ(note.rect, (Tavo_GrWRect{120, 130, 120, 130})) << "the press point in client coordinates";
    EXPECT_EQ(note.capture, nullptr) << "the scrollee has let the capture go";
    // Within the hold time: a press the scrollee still followed would be a click or a drag end.
    Input(MOUSEEVENTF_RIGHTUP, CPoint(120, 130), 1100);
    EXPECT_EQ(NoteNames(), std::vector<std::string>{"DragAndDrop"});
}

TEST_F(DrawWndPointerTest, UnknownActionsAndPansWithoutADrawingStartNothing)
{
    const struct { const char* what; Tavo_WiDrawWnd::DragAction action; UINT button; } rows[] = {
        {"an unknown action", static_cast<Tavo_WiDrawWnd::DragAction>(7), MK_LBUTTON},
        {"a pan without a drawing", Tavo_WiDrawWnd::Pan, MK_LBUTTON},
        // No release could end it: no loop, no capture.
        {"a rubber rectangle of no known button", Tavo_WiDrawWnd::RubberRectangle, MK_LBUTTON | MK_RBUTTON},
    };
    for (const auto& row : rows) {
        SCOPED_TRACE(row.what);
        wnd().dragAction = row.action;
        ::SetCursor(::LoadCursor(nullptr, IDC_CROSS));
        wnd().OnDragStart(row.button, row.button, CPoint(100, 100));
        EXPECT_EQ(wnd().IsDragScrolling(), 0);
        EXPECT_EQ(::GetCapture(), nullptr);
        EXPECT_EQ(::GetCursor(), ::LoadCursor(nullptr, IDC_CROSS));
        EXPECT_TRUE(wnd().notes.empty());
    }
}

// ---- pan drags ------------------------------------------------------------------------------

TEST_F(DrawWndPointerZoomedTest, PanDragShowsTheLibrarysPanCursorAndEndsWithTheArrow)
{
    Input(MOUSEEVENTF_LEFTDOWN, CPoint(300, 200), 1000);
    FireHoldTimer();
    EXPECT_EQ(wnd().IsDragScrolling(), 1);
    const HCURSOR cursor = ::GetCursor();
    EXPECT_EQ(cursor, PanCursor());
    ICONINFO info = {};
    ASSERT_TRUE(::GetIconInfo(cursor, &info));
    ::DeleteObject(info.hbmMask);
    if (info.hbmColor)
        ::DeleteObject(info.hbmColor);
    EXPECT_EQ(info.xHotspot, 16u);
    EXPECT_EQ(info.yHotspot, 16u);

    // Real moves with the button down: 50 pixels left scroll the view 10 percent right.
    Input(MoveOnly, CPoint(250, 200), 1100);
    EXPECT_EQ(Moved(), CSize(25, 0));
    EXPECT_EQ(::GetCursor(), PanCursor());
    Input(MOUSEEVENTF_LEFTUP, CPoint(250, 200), 1200);
    EXPECT_EQ(wnd().IsDragScrolling(), 0);
    EXPECT_EQ(NoteNames(), std::vector<std::string>{"DragEnd"});

    // The end sets the arrow itself (not only the next cursor message).
    ::SetCursor(::LoadCursor(nullptr, IDC_CROSS));
    wnd().OnDragEnd(MK_LBUTTON, 0, CPoint(0, 0), 0);
    EXPECT_EQ(::GetCursor(), Arrow());
}

TEST_F(DrawWndPointerZoomedTest, PanDragScrollsByTheMovementInPercentOfTheView)
{
    const struct { int direction; CPoint to; CSize moved; } rows[] = {
        {1, {250, 200}, {25, 0}},     // 50 of 500 pixels left: the view goes right, the drawing with the pointer
        {-1, {250, 200}, {-25, 0}},
        {1, {350, 200}, {-25, 0}},
        {1, {300, 160}, {0, -20}},    // 40 of 400 pixels up: the view goes down (world y falls)
        {1, {300, 240}, {0, 20}},
        {-1, {300, 160}, {0, 20}},
        {1, {250, 160}, {25, -20}},
        {1, {500, 400}, {-100, 100}},   // the far edges themselves are inside: 40 and 50 percent
    };
    for (const auto& row : rows) {
        SCOPED_TRACE(testing::Message() << "direction " << row.direction << " to (" << row.to.x << ", " << row.to.y << ")");
        wnd().ScrollWindowTo(Start);
        wnd().SetPanDirectionality(row.direction);
        wnd().OnDragStart(MK_LBUTTON, MK_LBUTTON, CPoint(300, 200));
        EXPECT_EQ(wnd().IsDragScrolling(), 1);
        wnd().OnDragMove(MK_LBUTTON, MK_LBUTTON, row.to);
        EXPECT_EQ(Moved(), row.moved);
        wnd().OnDragEnd(MK_LBUTTON, 0, row.to, 1);
        EXPECT_EQ(wnd().IsDragScrolling(), 0);
        EXPECT_FALSE(AutoScrollArmed());
    }
}

TEST_F(DrawWndPointerZoomedTest, SlowPanMovesBelowHalfAPercentAddUpOnEachAxis)
{
    // One pixel is 0.2 percent across and 0.25 percent up or down; one
    // percent of the view is 2 world units on either axis.
    const struct { CPoint to; CSize moved; } steps[] = {
        {{298, 199}, {0, 0}},    // 0.4 and 0.25 percent: the reference stays
        {{296, 198}, {2, -2}},   // 0.8 and 0.5 percent from it: one percent each
        {{295, 198}, {2, -2}},
        {{294, 197}, {2, -2}},
        {{293, 196}, {4, -4}},   // 0.6 and 0.5 percent from (296, 198)
    };
    wnd().OnDragStart(MK_LBUTTON, MK_LBUTTON, CPoint(300, 200));
    for (const auto& step : steps) {
        wnd().OnDragMove(MK_LBUTTON, MK_LBUTTON, step.to);
        EXPECT_EQ(Moved(), step.moved) << "at (" << step.to.x << ", " << step.to.y << ")";
    }
}

TEST_F(DrawWndPointerZoomedTest, AutoScrollTickScrollsTowardsTheEdgeWithTheSquareOfTheOvershoot)
{
    const struct { int direction; CPoint pointer; CSize moved; bool rearmed; } rows[] = {
        {1, {-50, 200}, {25, 0}, true},     // a tenth of the width beyond: 10 percent
        {1, {-5, 200}, {2, 0}, true},       // a hundredth: 1 percent
        {1, {550, 200}, {-25, 0}, true},
        {-1, {-50, 200}, {-25, 0}, true},
        {1, {250, -40}, {0, -20}, true},
        {1, {250, 440}, {0, 20}, true},
        {-1, {250, 440}, {0, -20}, true},
        {1, {-50, 440}, {25, 20}, true},
        {1, {250, 200}, {0, 0}, false},     // back inside: the timer stops
        {1, {500, 400}, {0, 0}, false},
    };
    for (const auto& row : rows) {
        SCOPED_TRACE(testing::Message() << "direction " << row.direction << " at (" << row.pointer.x << ", "
                                        << row.pointer.y << ")");
        wnd().ScrollWindowTo(Start);
        wnd().SetPanDirectionality(row.direction);
        wnd().OnDragStart(MK_LBUTTON, MK_LBUTTON, CPoint(250, 200));
        wnd().OnDragMove(MK_LBUTTON, MK_LBUTTON, CPoint(-50, 200));
        EXPECT_EQ(Moved(), CSize(0, 0)) << "leaving the view only starts the timer";
        Tick(row.pointer);
        EXPECT_EQ(Moved(), row.moved);
        EXPECT_EQ(AutoScrollArmed(), row.rearmed);
        wnd().OnDragEnd(MK_LBUTTON, 0, row.pointer, 1);
    }
}

TEST_F(DrawWndPointerZoomedTest, WhileAutoScrollingMovesOnlyKeepTheReferenceAndPanningResumesFromTheLastTick)
{
    wnd().OnDragStart(MK_LBUTTON, MK_LBUTTON, CPoint(250, 200));
    wnd().OnDragMove(MK_LBUTTON, MK_LBUTTON, CPoint(-50, 200));
    Tick(CPoint(-50, 200));
    EXPECT_EQ(Moved(), CSize(25, 0));
    wnd().OnDragMove(MK_LBUTTON, MK_LBUTTON, CPoint(100, 200));
    EXPECT_EQ(Moved(), CSize(25, 0)) << "the timer runs: the move does not pan";
    Tick(CPoint(300, 200));
    EXPECT_EQ(Moved(), CSize(25, 0));
    // The timer has stopped; the reference is the last tick's pointer, not the move's.
    wnd().OnDragMove(MK_LBUTTON, MK_LBUTTON, CPoint(250, 200));
    EXPECT_EQ(Moved(), CSize(50, 0));
    EXPECT_FALSE(AutoScrollArmed());
}

TEST_F(DrawWndPointerZoomedTest, TickDueAfterTheDragEndedScrollsOnceWithoutReArming)
{
    wnd().OnDragStart(MK_LBUTTON, MK_LBUTTON, CPoint(250, 200));
    wnd().OnDragMove(MK_LBUTTON, MK_LBUTTON, CPoint(-50, 200));
    wnd().OnDragEnd(MK_LBUTTON, 0, CPoint(-50, 200), 1);
    EXPECT_EQ(wnd().IsDragScrolling(), 0);
    Tick(CPoint(-50, 200));
    EXPECT_EQ(Moved(), CSize(25, 0));
    EXPECT_FALSE(AutoScrollArmed());
}

TEST_F(DrawWndPointerZoomedTest, ScrolleeOfNoWidthOrHeightPansAndAutoScrollsNothing)
{
    // The view keeps its zoom while the scrollee has no area, so a pan drag
    // still starts; its steps would divide by the saved size.
    const struct { CSize size; CPoint start, inside, outside; } rows[] = {
        {{0, 400}, {5, 200}, {0, 200}, {40, 200}},
        {{500, 0}, {250, 5}, {250, 0}, {250, 40}},
    };
    for (const auto& row : rows) {
        SCOPED_TRACE(testing::Message() << row.size.cx << " x " << row.size.cy);
        ::SetWindowPos(Wnd(), nullptr, 0, 0, row.size.cx, row.size.cy, SWP_NOMOVE | SWP_NOZORDER);
        PumpPending();
        ASSERT_EQ(hosted.ScrolleeSize(), row.size);
        wnd().OnDragStart(MK_LBUTTON, MK_LBUTTON, row.start);
        ASSERT_EQ(wnd().IsDragScrolling(), 1);
        wnd().OnDragMove(MK_LBUTTON, MK_LBUTTON, row.inside);
        EXPECT_EQ(Moved(), CSize(0, 0));
        wnd().OnDragMove(MK_LBUTTON, MK_LBUTTON, row.outside);
        Tick(row.outside);
        EXPECT_EQ(Moved(), CSize(0, 0));
        EXPECT_FALSE(AutoScrollArmed());
        wnd().OnDragEnd(MK_LBUTTON, 0, row.outside, 1);
    }
}

// ---- rubber rectangles --------------------------------------------------------------------
//
// The rectangle's loop takes the thread's messages itself: each test queues
// the input the loop is to see before the hold timer starts the drag.

TEST_F(DrawWndPointerBoundTest, RubberRectangleEndsOnlyWithItsOwnButtonAndIsReportedInWorldCoordinates)
{
    const struct { UINT button; DWORD down, up, otherDown, otherUp; } rows[] = {
        {MK_LBUTTON, MOUSEEVENTF_LEFTDOWN, MOUSEEVENTF_LEFTUP, MOUSEEVENTF_RIGHTDOWN, MOUSEEVENTF_RIGHTUP},
        {MK_RBUTTON, MOUSEEVENTF_RIGHTDOWN, MOUSEEVENTF_RIGHTUP, MOUSEEVENTF_MIDDLEDOWN, MOUSEEVENTF_MIDDLEUP},
        {MK_MBUTTON, MOUSEEVENTF_MIDDLEDOWN, MOUSEEVENTF_MIDDLEUP, MOUSEEVENTF_LEFTDOWN, MOUSEEVENTF_LEFTUP},
    };
    wnd().dragAction = Tavo_WiDrawWnd::RubberRectangle;
    DWORD time = 1000;
    for (const auto& row : rows) {
        SCOPED_TRACE(testing::Message() << "button " << row.button);
        wnd().notes.clear();
        Input(row.down, CPoint(100, 100), time);
        Queue(MoveOnly, CPoint(150, 180), time + 350);
        Queue(row.otherDown, CPoint(150, 180), time + 360);
        Queue(row.otherUp, CPoint(150, 180), time + 370);   // another button: the rectangle goes on
        Queue(MoveOnly, CPoint(200, 250), time + 380);
        Queue(row.up, CPoint(200, 250), time + 400);
        FireHoldTimer();

        ASSERT_EQ(NoteNames(), std::vector<std::string>{"RubberRectangle"});
        const auto& note = wnd().notes[0];
        EXPECT_EQ(note.button, row.button);
        EXPECT_EQ(note.flags, row.button) << "the flags of the press";
        // Client (100, 100)-(200, 250): y runs from 400 - 250 to 400 - 100 in the world.
        EXPECT_EQ(note.rect, (Tavo_GrWRect{100, 150, 200, 300}));
        EXPECT_EQ(note.capture, nullptr) << "released before the report";
        EXPECT_EQ(HIWORD(::GetQueueStatus(QS_INPUT)), 0u) << "the loop took the input";
        EXPECT_TRUE(OutlineIsClean(CRect(100, 100, 200, 250))) << "the last outline is erased";
        time += 1000;
    }
}

TEST_F(DrawWndPointerBoundTest, RubberRectangleWithoutMovementIsReportedWithZeroSize)
{
    wnd().dragAction = Tavo_WiDrawWnd::RubberRectangle;
    Input(MOUSEEVENTF_LEFTDOWN, CPoint(120, 130), 1000);
    Queue(MOUSEEVENTF_LEFTUP, CPoint(120, 130), 1400);
    FireHoldTimer();
    ASSERT_EQ(NoteNames(), std::vector<std::string>{"RubberRectangle"});
    EXPECT_EQ(wnd().notes[0].rect, (Tavo_GrWRect{120, 270, 120, 270}));
}

TEST_F(DrawWndPointerTest, RubberRectangleWithoutADrawingEndsWithoutAReport)
{
    wnd().dragAction = Tavo_WiDrawWnd::RubberRectangle;
    Input(MOUSEEVENTF_LEFTDOWN, CPoint(120, 130), 1000);
    Queue(MoveOnly, CPoint(150, 160), 1350);
    Queue(MOUSEEVENTF_LEFTUP, CPoint(150, 160), 1400);
    FireHoldTimer();
    EXPECT_TRUE(wnd().notes.empty());
    EXPECT_EQ(::GetCapture(), nullptr);
    EXPECT_EQ(HIWORD(::GetQueueStatus(QS_INPUT)), 0u) << "the loop ran to the release";
}

TEST_F(DrawWndPointerBoundTest, RubberRectangleIsCancelledWhenAnotherWindowTakesTheCapture)
{
    CaptureThief thief(hosted.host.Handle(), CRect(550, 0, 600, 50));
    PumpPending();
    wnd().dragAction = Tavo_WiDrawWnd::RubberRectangle;
    Input(MOUSEEVENTF_LEFTDOWN, CPoint(100, 100), 1000);
    Queue(MoveOnly, CPoint(200, 250), 1350);
    // Taken once the input is consumed and the loop turns to paint messages.
    thief.ArmForNextPaint();
    FireHoldTimer();
    EXPECT_EQ(::GetCapture(), thief.Handle()) << "the thief keeps the capture";
    EXPECT_TRUE(wnd().notes.empty());
    EXPECT_TRUE(OutlineIsClean(CRect(100, 100, 200, 250)));
    ::ReleaseCapture();
    Input(MOUSEEVENTF_LEFTUP, CPoint(200, 250), 1400);
    EXPECT_TRUE(wnd().notes.empty()) << "the scrollee has forgotten the press";
}

TEST_F(DrawWndPointerBoundTest, QuitTakenByTheRubberRectangleCancelsItAndReachesTheApplicationsLoop)
{
    wnd().dragAction = Tavo_WiDrawWnd::RubberRectangle;
    Input(MOUSEEVENTF_LEFTDOWN, CPoint(100, 100), 1000);
    Queue(MoveOnly, CPoint(200, 250), 1350);
    ::PostQuitMessage(7);
    FireHoldTimer();
    EXPECT_TRUE(wnd().notes.empty());
    EXPECT_EQ(::GetCapture(), nullptr);
    MSG quit = {};
    ASSERT_TRUE(::PeekMessageA(&quit, nullptr, WM_QUIT, WM_QUIT, PM_REMOVE));
    EXPECT_EQ(quit.wParam, 7u);
    EXPECT_TRUE(OutlineIsClean(CRect(100, 100, 200, 250)));
    Input(MOUSEEVENTF_LEFTUP, CPoint(200, 250), 1400);
    EXPECT_TRUE(wnd().notes.empty());
}

TEST_F(DrawWndPointerBoundTest, PaintTakenByTheRubberRectangleIsDispatchedUnderTheOutline)
{
    wnd().dragAction = Tavo_WiDrawWnd::RubberRectangle;
    Input(MOUSEEVENTF_LEFTDOWN, CPoint(100, 100), 1000);
    Queue(MoveOnly, CPoint(200, 250), 1350);
    // The loop reaches the paint once the input is consumed; only a paint
    // that is really carried out queues the release that ends the loop.
    ::InvalidateRect(Scrollee(), nullptr, TRUE);
    const int paintsBefore = wnd().paints;
    wnd().onPaint = [this] { Queue(MOUSEEVENTF_LEFTUP, CPoint(200, 250), 1400); };
    FireHoldTimer();
    wnd().onPaint = nullptr;
    EXPECT_EQ(wnd().paints, paintsBefore + 1);
    ASSERT_EQ(NoteNames(), std::vector<std::string>{"RubberRectangle"});
    EXPECT_EQ(wnd().notes[0].rect, (Tavo_GrWRect{100, 150, 200, 300}));
    // The outline was taken off for the paint and put back after it, so the last erase leaves the drawing.
    EXPECT_TRUE(OutlineIsClean(CRect(100, 100, 200, 250)));
}

}  // namespace
