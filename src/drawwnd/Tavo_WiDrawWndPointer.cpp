// Tavo_WiDrawWnd: the pointer. Clicks, double clicks and data-tip questions
// become world apertures for the application; drags pan the view (with
// autoscroll once the pointer leaves it), run a rubber rectangle, or are
// handed to the application as drag and drop.
#include "Tavo_WiDrawWnd.h"
#include "Tavo_WiParkedCursorMonitor.h"

#include "Tavo_WiResourceIds.h"
#include "Tavo_WiViewMath.h"

using namespace Tavo_WiViewMath;

namespace {

void SetArrowCursor()
{
    ::SetCursor(::LoadCursor(nullptr, IDC_ARROW));
}

// The pan cursor from whichever module of the chain holds it: the library's
// own unless the application overrides the resource.
void SetPanCursor()
{
    LPCSTR name = MAKEINTRESOURCEA(TAVO_WI_IDC_PAN);
    HINSTANCE module = AfxFindResourceHandle(name, RT_GROUP_CURSOR);
    if (HCURSOR cursor = ::LoadCursorA(module, name))
        ::SetCursor(cursor);
}

// One pan or autoscroll step on one axis: a signed percentage of the view
// scrolls towards positive or negative (the scroll window takes sizes, not
// signs), and the strip it uncovered is painted at once so the view keeps up
// with the pointer.
void ScrollStep(Tavo_WiDrawWnd& wnd, int step, Tavo_WiScroll::Dir positive, Tavo_WiScroll::Dir negative)
{
    if (step == 0)
        return;
    const int size = step > 0 ? step : Tavo_GrSaturate(-static_cast<long long>(step));
    wnd.ScrollWindow(step > 0 ? positive : negative, Tavo_WiScroll::Percent, size);
    wnd.PumpPaintMessages();
}

} // namespace

// ---- apertures ------------------------------------------------------------------------

int Tavo_WiDrawWnd::FetchApertureFromPoint(const CPoint& point, Tavo_GrWRect& aperture)
{
    if (!m_drawing || !m_mapping) {
        aperture = Tavo_GrWRect();
        return 0;
    }
    CRect client(0, 0, 0, 0);
    ::GetClientRect(GetScrollee()->GetSafeHwnd(), &client);
    const bool inside = client.PtInRect(point) != FALSE;
    const Tavo_GrTransform& t = m_mapping->GetTransform();
    const int h = m_mapping->GetDeviceWindowHeight();
    const Tavo_GrWPoint world{t.Invertxcoord(point.x), t.Invertycoord(Tavo_GrSubtract(h, point.y))};
    aperture = Aperture(world, t.GetScale());
    return inside ? 1 : 0;
}

void Tavo_WiDrawWnd::OnClick(UINT button, UINT flags, const CPoint& point)
{
    SetArrowCursor();
    Tavo_GrWRect aperture;
    if (FetchApertureFromPoint(point, aperture))
        OnClick(button, flags, aperture);
}

void Tavo_WiDrawWnd::OnDoubleClick(UINT button, UINT flags, const CPoint& point)
{
    Tavo_GrWRect aperture;
    if (FetchApertureFromPoint(point, aperture))
        OnDoubleClick(button, flags, aperture);
}

CString Tavo_WiDrawWnd::GetDataTipText(const CPoint& point)
{
    Tavo_GrWRect aperture;
    if (!FetchApertureFromPoint(point, aperture))
        return CString();
    return GetDataTipText(aperture);
}

void Tavo_WiDrawWnd::OnClick(UINT, UINT, const Tavo_GrWRect&) {}
void Tavo_WiDrawWnd::OnDoubleClick(UINT, UINT, const Tavo_GrWRect&) {}
void Tavo_WiDrawWnd::OnRubberRectangle(UINT, UINT, const Tavo_GrWRect&) {}
void Tavo_WiDrawWnd::DoDragAndDrop(UINT, UINT, const CPoint&) {}

CString Tavo_WiDrawWnd::GetDataTipText(const Tavo_GrWRect&)
{
    return CString();
}

Tavo_WiDrawWnd::DragAction Tavo_WiDrawWnd::GetDragAction(UINT, UINT, const CPoint&)
{
    return Pan;
}

// ---- drags ------------------------------------------------------------------------------

void Tavo_WiDrawWnd::OnDragStart(UINT button, UINT flags, const CPoint& point)
{
    switch (GetDragAction(button, flags, point)) {
    case RubberRectangle:
        // The scrollee forgets the press and its capture, so it reports
        // nothing more of this drag.
        AbortDrag();
        DoRubberRectangle(button, flags, point);
        break;
    case DragAndDrop:
        AbortDrag();
        DoDragAndDrop(button, flags, point);
        break;
    case Pan: {
        // At the zero level the whole drawing is in view, and without a
        // drawing there is no view: nothing to pan.
        if (!m_zoomedIn || !m_mapping)
            break;
        CRect window(0, 0, 0, 0);
        ::GetWindowRect(GetScrollee()->GetSafeHwnd(), &window);
        m_savedSize = CSize(window.Width(), window.Height());
        m_savedPoint = point;
        m_panDrag = 1;
        SetDragScrollingFlag(1);
        OnDragScrollStart(GetScrollPosition());
        SetPanCursor();
        break;
    }
    default:
        break;
    }
}

void Tavo_WiDrawWnd::OnDragMove(UINT, UINT, const CPoint& point)
{
    // While autoscrolling the ticks scroll; moves only keep the reference.
    if (m_autoScrollTimerId != 0 || !m_panDrag) {
        m_savedPoint = point;
        return;
    }
    if (point.x < 0 || point.x > m_savedSize.cx || point.y < 0 || point.y > m_savedSize.cy) {
        m_autoScrollTimerId = static_cast<UINT>(SetTimer(AutoScrollTimerId, AutoScrollPeriodMs, nullptr));
        return;
    }
    // Moving the pointer left scrolls the view right, so the drawing follows
    // the pointer (with the pan direction +1).
    const int hx = PanStepPercent(m_savedPoint.x, point.x, m_savedSize.cx, m_panDirection);
    ScrollStep(*this, hx, Tavo_WiScroll::Right, Tavo_WiScroll::Left);
    const int vy = PanStepPercent(m_savedPoint.y, point.y, m_savedSize.cy, m_panDirection);
    ScrollStep(*this, vy, Tavo_WiScroll::Down, Tavo_WiScroll::Up);
    // An axis that moved less than half a percent keeps its reference, so
    // slow movements add up.
    if (hx != 0)
        m_savedPoint.x = point.x;
    if (vy != 0)
        m_savedPoint.y = point.y;
}

void Tavo_WiDrawWnd::OnTimer(UINT_PTR id)
{
    // A derived window's own timers are not autoscroll ticks.
    if (id != AutoScrollTimerId) {
        CWnd::OnTimer(id);
        return;
    }
    KillTimer(id);
    m_autoScrollTimerId = 0;

    POINT cursor = {0, 0};
    ::GetCursorPos(&cursor);
    // The scrollee lies at the origin of this window's client area.
    ::ScreenToClient(GetSafeHwnd(), &cursor);
    m_savedPoint = CPoint(cursor.x, cursor.y);

    // A drag towards an edge scrolls that way; the speed grows with the
    // square of the overshoot.
    const int forward = m_panDirection > 0 ? 1 : -1;
    const int n = AutoScrollPercent(m_savedPoint.x, m_savedSize.cx);
    ScrollStep(*this, m_savedPoint.x < 0 ? n * forward : -n * forward, Tavo_WiScroll::Right, Tavo_WiScroll::Left);
    const int m = AutoScrollPercent(m_savedPoint.y, m_savedSize.cy);
    ScrollStep(*this, m_savedPoint.y < 0 ? m * forward : -m * forward, Tavo_WiScroll::Down, Tavo_WiScroll::Up);

    // The paints of the steps may have destroyed the window; a timer set
    // then would belong to no window, a thread timer nothing ever kills.
    if ((n != 0 || m != 0) && m_panDrag && ::IsWindow(GetSafeHwnd()))
        m_autoScrollTimerId = static_cast<UINT>(SetTimer(AutoScrollTimerId, AutoScrollPeriodMs, nullptr));
}

void Tavo_WiDrawWnd::OnDragEnd(UINT, UINT, const CPoint&, int)
{
    SetArrowCursor();
    SetDragScrollingFlag(0);
    OnDragScrollEnd(GetScrollPosition());
    // A tick already due still scrolls once, without re-arming.
    m_panDrag = 0;
}

// ---- rubber rectangle ------------------------------------------------------------------

namespace {

CRect Spanned(const CPoint& a, const CPoint& b)
{
    return CRect(std::min(a.x, b.x), std::min(a.y, b.y), std::max(a.x, b.x), std::max(a.y, b.y));
}

UINT ButtonUpMessage(UINT button)
{
    switch (button) {
    case MK_LBUTTON:
        return WM_LBUTTONUP;
    case MK_MBUTTON:
        return WM_MBUTTONUP;
    case MK_RBUTTON:
        return WM_RBUTTONUP;
    default:
        return 0;
    }
}

} // namespace

void Tavo_WiDrawWnd::DoRubberRectangle(UINT button, UINT flags, const CPoint& start)
{
    // Only the release of one of the three buttons ends the loop: with any
    // other code it would hold the capture and every message of the thread
    // for good, so no rectangle is run at all.
    const UINT endMessage = ButtonUpMessage(button);
    if (endMessage == 0)
        return;
    Tavo_WiScrollee* scrollee = GetScrollee();
    // A paint the loop dispatches may destroy the window; the handles taken
    // now still tell then, where the objects' own read null.
    const HWND self = GetSafeHwnd();
    const HWND view = scrollee->GetSafeHwnd();
    CClientDC dc(scrollee);
    SetCapture();
    CPoint last = start;
    CRect rect = Spanned(start, start);
    dc.DrawFocusRect(&rect);

    bool completed = false;
    for (;;) {
        MSG msg;
        const BOOL got = ::GetMessageA(&msg, nullptr, 0, 0);
        if (got <= 0) {
            // The application is ending: cancel, and leave the quit for its loop.
            if (got == 0)
                ::PostQuitMessage(static_cast<int>(msg.wParam));
            break;
        }
        if (msg.message == WM_PAINT) {
            // A paint left undone keeps its update region and comes back at
            // once; dispatch it so the window keeps up and the loop sleeps.
            // The outline is drawn in XOR, so it is taken off around the paint.
            dc.DrawFocusRect(&rect);
            ::DispatchMessageA(&msg);
            if (!::IsWindow(view))
                break;
            dc.DrawFocusRect(&rect);
        } else if (msg.message == endMessage) {
            // The scrollee's parked cursor monitor saw the press and would
            // wait for this release, showing no data tip until the next
            // click: it is shown the release the loop takes.
            if (::IsWindow(view))
                if (Tavo_WiParkedCursorMonitor* monitor = scrollee->GetParkedCursorMonitor())
                    monitor->RelayEvent(&msg);
            completed = true;
            break;
        } else if (msg.message == WM_MOUSEMOVE) {
            POINT screen = msg.pt;
            ::ScreenToClient(scrollee->GetSafeHwnd(), &screen);
            const CPoint current(screen.x, screen.y);
            if (current != last) {
                dc.DrawFocusRect(&rect);
                rect = Spanned(start, current);
                dc.DrawFocusRect(&rect);
                last = current;
            }
        }
        if (::GetCapture() != self || !::IsWindow(self))
            break;
    }
    // A window destroyed meanwhile took its device context with it: the
    // handle may already serve another window and is left alone.
    const bool alive = ::IsWindow(view) != FALSE;
    if (alive)
        dc.DrawFocusRect(&rect);
    else
        dc.Detach();
    // After a cancellation the capture belongs to the window that took it;
    // ReleaseCapture would take it from that window as well.
    if (::GetCapture() == self)
        ::ReleaseCapture();

    if (!completed || !alive || !m_drawing || !m_mapping)
        return;
    const int h = m_mapping->GetDeviceWindowHeight();
    const Tavo_GrDRect device{rect.left, Tavo_GrSubtract(h, rect.bottom), rect.right, Tavo_GrSubtract(h, rect.top)};
    OnRubberRectangle(button, flags, m_mapping->GetTransform().InvertRect(device));
}
