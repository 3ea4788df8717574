// Tavo_WiScrollee: creation and destruction with the monitor and the data tip,
// painting and erasing, and the classification of mouse input into clicks,
// double clicks and drags.
#include "Tavo_WiScrollee.h"

#include "Tavo_WiDataTip.h"
#include "Tavo_WiParkedCursorMonitor.h"
#include "Tavo_WiScrollStatics.h"
#include "Tavo_WiScrollWnd.h"
#include "Tavo_WiWindowClass.h"

namespace {

constexpr char ClassName[] = "Tavo_WiScrollee";
constexpr UINT ClassStyle = CS_DBLCLKS | CS_PARENTDC;
bool s_classRegistered = false;

} // namespace

BEGIN_MESSAGE_MAP(Tavo_WiScrollee, CWnd)
    ON_WM_PAINT()
    ON_WM_LBUTTONDOWN()
    ON_WM_MBUTTONDOWN()
    ON_WM_RBUTTONDOWN()
    ON_WM_LBUTTONUP()
    ON_WM_MBUTTONUP()
    ON_WM_RBUTTONUP()
    ON_WM_LBUTTONDBLCLK()
    ON_WM_MBUTTONDBLCLK()
    ON_WM_RBUTTONDBLCLK()
    ON_WM_MOUSEMOVE()
    ON_WM_TIMER()
    ON_WM_ERASEBKGND()
    ON_WM_CAPTURECHANGED()
    ON_REGISTERED_MESSAGE(Tavo_WiScrollStatics::parkedCursorNotifyMsg, OnPCNotifyMsg)
END_MESSAGE_MAP()

Tavo_WiScrollee::Tavo_WiScrollee()
    : m_monitor(new Tavo_WiParkedCursorMonitor), m_dataTip(new Tavo_WiDataTip)
{
}

Tavo_WiScrollee::~Tavo_WiScrollee()
{
    if (GetSafeHwnd() != nullptr)
        Tavo_WiScrollee::DestroyWindow();
    m_monitor.reset();
    m_dataTip.reset();
}

// ---- creation and destruction -------------------------------------------------

BOOL Tavo_WiScrollee::Create(DWORD style, const CRect& rect, Tavo_WiScrollWnd* parent, UINT id)
{
    return Create(ClassName, "", style, rect, parent, id, nullptr);
}

BOOL Tavo_WiScrollee::Create(LPCSTR className, LPCSTR windowName, DWORD style, const CRect& rect,
                             CWnd* parent, UINT id, CCreateContext* context)
{
    BOOL created = FALSE;
    if (Tavo_WiWindowClass::UseOwnClasses()) {
        Tavo_WiWindowClass::RegisterOnce(s_classRegistered, ClassName, ClassStyle, nullptr,
                                         static_cast<HBRUSH>(GetStockObject(BLACK_BRUSH)));
        created = CWnd::Create(className, windowName, style, rect, parent, id, context);
    } else {
        created = CWnd::Create(nullptr, nullptr, style, rect, parent, id, context);
    }
    if (!created)
        return FALSE;
    if (!m_monitor->Create(this, Tavo_WiParkedCursorMonitor::ControlId, nullptr))
        return FALSE;
    return m_dataTip->Create(this);
}

BOOL Tavo_WiScrollee::DestroyWindow()
{
    if (m_monitor && ::IsWindow(m_monitor->GetSafeHwnd()))
        m_monitor->DestroyWindow();
    if (m_dataTip && ::IsWindow(m_dataTip->GetSafeHwnd()))
        m_dataTip->DestroyWindow();
    if (!::IsWindow(GetSafeHwnd()))
        return FALSE;
    return CWnd::DestroyWindow();
}

BOOL Tavo_WiScrollee::PreTranslateMessage(MSG* msg)
{
    if (m_monitor && ::IsWindow(m_monitor->GetSafeHwnd()))
        m_monitor->RelayEvent(msg);
    return CWnd::PreTranslateMessage(msg);
}

Tavo_WiScrollWnd* Tavo_WiScrollee::GetScrollWnd() const
{
    const HWND parent = ::GetParent(GetSafeHwnd());
    if (parent == nullptr)
        return nullptr;
    return dynamic_cast<Tavo_WiScrollWnd*>(CWnd::FromHandle(parent));
}

// ---- operations ------------------------------------------------------------------

void Tavo_WiScrollee::CaptureMouse()
{
    ::SetCapture(GetSafeHwnd());
    m_capture = 1;
}

void Tavo_WiScrollee::ReleaseMouse()
{
    if (!m_capture)
        return;
    m_capture = 0;
    ::ReleaseCapture();
}

void Tavo_WiScrollee::ClearButtonDownState()
{
    m_pressedButton = 0;
    m_pressTime = 0;
    m_doubleClick = 0;
    m_dragging = 0;
}

void Tavo_WiScrollee::ShowDataTip(const CPoint& point, const CString& text)
{
    m_dataTip->Show(point, text);
}

void Tavo_WiScrollee::HideDataTip()
{
    m_dataTip->Hide();
}

void Tavo_WiScrollee::SetParkedCursorMonitorFlag(int flag)
{
    m_monitor->Enable(flag);
}

void Tavo_WiScrollee::SetBackgroundColor(COLORREF color)
{
    m_backgroundColor = color;
    m_backgroundColorSet = 1;
}

// ---- painting ----------------------------------------------------------------------

void Tavo_WiScrollee::OnPaint()
{
    CPaintDC dc(this);
    dc.SetMapMode(MM_TEXT);
    if (Tavo_WiScrollWnd* scrollWnd = GetScrollWnd())
        scrollWnd->OnDraw(this, &dc);
}

BOOL Tavo_WiScrollee::OnEraseBkgnd(CDC* dc)
{
    CBrush brush(m_backgroundColorSet ? m_backgroundColor : RGB(0, 0, 0));
    CPen pen(PS_SOLID, 0, m_backgroundColor);
    CBrush* oldBrush = dc->SelectObject(&brush);
    CPen* oldPen = dc->SelectObject(&pen);
    CRect clip;
    dc->GetClipBox(&clip);
    dc->Rectangle(&clip);
    dc->SelectObject(oldBrush);
    dc->SelectObject(oldPen);
    return TRUE;
}

// ---- mouse buttons -------------------------------------------------------------------

void Tavo_WiScrollee::OnLButtonDown(UINT flags, CPoint point) { OnXButtonDown(MK_LBUTTON, flags, point); }
void Tavo_WiScrollee::OnMButtonDown(UINT flags, CPoint point) { OnXButtonDown(MK_MBUTTON, flags, point); }
void Tavo_WiScrollee::OnRButtonDown(UINT flags, CPoint point) { OnXButtonDown(MK_RBUTTON, flags, point); }
void Tavo_WiScrollee::OnLButtonUp(UINT flags, CPoint point) { OnXButtonUp(MK_LBUTTON, flags, point); }
void Tavo_WiScrollee::OnMButtonUp(UINT flags, CPoint point) { OnXButtonUp(MK_MBUTTON, flags, point); }
void Tavo_WiScrollee::OnRButtonUp(UINT flags, CPoint point) { OnXButtonUp(MK_RBUTTON, flags, point); }
void Tavo_WiScrollee::OnLButtonDblClk(UINT flags, CPoint point) { OnXButtonDblClk(MK_LBUTTON, flags, point); }
void Tavo_WiScrollee::OnMButtonDblClk(UINT flags, CPoint point) { OnXButtonDblClk(MK_MBUTTON, flags, point); }
void Tavo_WiScrollee::OnRButtonDblClk(UINT flags, CPoint point) { OnXButtonDblClk(MK_RBUTTON, flags, point); }

void Tavo_WiScrollee::OnXButtonDown(UINT button, UINT flags, const CPoint& point)
{
    // A second button pressed while one is followed is ignored.
    if (m_pressedButton != 0)
        return;
    m_pressedButton = button;
    m_pressTime = ::GetMessageTime();
    m_pressFlags = flags;
    m_pressPoint = point;

    // Flags first: releasing a capture the scrollee still holds delivers the
    // capture-lost notification at once, and it must find no drag.
    const int hadCapture = m_capture;
    m_doubleClick = 0;
    m_dragging = 0;
    m_capture = 0;
    if (hadCapture)
        ::ReleaseCapture();

    m_holdTimerId = ::SetTimer(GetSafeHwnd(), HoldTimerId, HoldTimeMs, nullptr);
}

void Tavo_WiScrollee::OnTimer(UINT_PTR id)
{
    // The scrollee keeps no repeating timer.
    ::KillTimer(GetSafeHwnd(), id);
    if (id != m_holdTimerId)
        return;
    m_holdTimerId = 0;
    if (m_pressedButton == 0)
        return;

    ::SetCapture(GetSafeHwnd());
    m_capture = 1;
    m_dragging = 1;
    if (Tavo_WiScrollWnd* scrollWnd = GetScrollWnd())
        scrollWnd->OnDragStart(m_pressedButton, m_pressFlags, m_pressPoint);
}

void Tavo_WiScrollee::OnMouseMove(UINT flags, CPoint point)
{
    if ((flags & ButtonFlagMask) == 0 || !m_dragging)
        return;
    if (Tavo_WiScrollWnd* scrollWnd = GetScrollWnd())
        scrollWnd->OnDragMove(m_pressedButton, flags, point);
}

void Tavo_WiScrollee::OnXButtonUp(UINT button, UINT flags, const CPoint& point)
{
    if (button != m_pressedButton)
        return;

    // Message times wrap; their signed difference does not.
    const LONG elapsed = static_cast<LONG>(static_cast<DWORD>(::GetMessageTime()) -
                                           static_cast<DWORD>(m_pressTime));
    if (!m_doubleClick) {
        Tavo_WiScrollWnd* scrollWnd = GetScrollWnd();
        if (m_dragging) {
            if (scrollWnd)
                scrollWnd->OnDragEnd(button, flags, point, 1);
        } else if (elapsed < static_cast<LONG>(HoldTimeMs)) {
            ::KillTimer(GetSafeHwnd(), HoldTimerId);
            if (scrollWnd)
                scrollWnd->OnClick(button, flags, point);
        }
    }

    // The press is over before the capture goes, so the capture-lost
    // handling that follows reports nothing.
    const int hadCapture = m_capture;
    m_pressedButton = 0;
    m_pressTime = 0;
    m_doubleClick = 0;
    m_dragging = 0;
    m_capture = 0;
    if (hadCapture)
        ::ReleaseCapture();
}

void Tavo_WiScrollee::OnXButtonDblClk(UINT button, UINT flags, const CPoint& point)
{
    if (m_pressedButton != 0)
        return;
    // The second press of a double click never becomes a drag.
    if (m_holdTimerId != 0) {
        ::KillTimer(GetSafeHwnd(), m_holdTimerId);
        m_holdTimerId = 0;
    }
    m_pressedButton = button;
    m_pressTime = ::GetMessageTime();
    m_doubleClick = 1;
    m_pressPoint = point;
    if (Tavo_WiScrollWnd* scrollWnd = GetScrollWnd())
        scrollWnd->OnDoubleClick(button, flags, point);
}

void Tavo_WiScrollee::OnCaptureChanged(CWnd* window)
{
    // The system reports a capture taken again by the window that holds it
    // (the hold timer's SetCapture after the application took it for the
    // scrollee) as a change; nothing is lost then.
    if (window == this)
        return;
    m_capture = 0;
    if (m_dragging) {
        if (Tavo_WiScrollWnd* scrollWnd = GetScrollWnd())
            scrollWnd->OnDragEnd(m_pressedButton, 0, CPoint(0, 0), 0);
    }
    m_pressedButton = 0;
    m_pressTime = 0;
    m_doubleClick = 0;
    m_dragging = 0;
}

// ---- parked cursor -----------------------------------------------------------------------

LRESULT Tavo_WiScrollee::OnPCNotifyMsg(WPARAM wParam, LPARAM)
{
    Tavo_WiScrollWnd* scrollWnd = GetScrollWnd();
    if (scrollWnd == nullptr)
        return 1;
    if (wParam != 0) {
        CPoint point;
        ::GetCursorPos(&point);
        ::ScreenToClient(GetSafeHwnd(), &point);
        scrollWnd->OnParkedCursorStart(point);
    } else {
        scrollWnd->OnParkedCursorEnd();
    }
    return 1;
}
