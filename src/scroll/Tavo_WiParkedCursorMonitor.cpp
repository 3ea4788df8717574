// Tavo_WiParkedCursorMonitor: the park timer and the rest notifications.
#include "Tavo_WiParkedCursorMonitor.h"

#include "Tavo_WiWindowClass.h"

namespace {

constexpr char ClassName[] = "Tavo_WiParkedCursorWnd";
constexpr UINT ClassStyle = CS_PARENTDC;
constexpr char NotifyMessageName[] = "BrymarTavo_WiParkedCursorMonitorMessage";

UINT s_notifyMsg = 0;
bool s_classRegistered = false;

// The park point while no rest is in progress.
constexpr int NoCoordinate = -1;

bool IsButtonPress(UINT message)
{
    switch (message) {
    case WM_NCLBUTTONDOWN:
    case WM_NCRBUTTONDOWN:
    case WM_NCMBUTTONDOWN:
    case WM_LBUTTONDOWN:
    case WM_RBUTTONDOWN:
    case WM_MBUTTONDOWN:
        return true;
    default:
        return false;
    }
}

bool IsButtonReleaseOrDoubleClick(UINT message)
{
    switch (message) {
    case WM_NCLBUTTONUP:
    case WM_NCLBUTTONDBLCLK:
    case WM_NCRBUTTONUP:
    case WM_NCRBUTTONDBLCLK:
    case WM_NCMBUTTONUP:
    case WM_NCMBUTTONDBLCLK:
    case WM_LBUTTONUP:
    case WM_LBUTTONDBLCLK:
    case WM_RBUTTONUP:
    case WM_RBUTTONDBLCLK:
    case WM_MBUTTONUP:
    case WM_MBUTTONDBLCLK:
        return true;
    default:
        return false;
    }
}

} // namespace

BEGIN_MESSAGE_MAP(Tavo_WiParkedCursorMonitor, CWnd)
    ON_WM_TIMER()
END_MESSAGE_MAP()

Tavo_WiParkedCursorMonitor::Tavo_WiParkedCursorMonitor() = default;

Tavo_WiParkedCursorMonitor::~Tavo_WiParkedCursorMonitor() = default;

UINT Tavo_WiParkedCursorMonitor::GetNotifyMsg()
{
    if (s_notifyMsg == 0)
        s_notifyMsg = RegisterWindowMessageA(NotifyMessageName);
    return s_notifyMsg;
}

BOOL Tavo_WiParkedCursorMonitor::Create(CWnd* parent, UINT id, CCreateContext* context)
{
    const CRect empty(0, 0, 0, 0);
    BOOL created = FALSE;
    if (Tavo_WiWindowClass::UseOwnClasses()) {
        Tavo_WiWindowClass::RegisterOnce(s_classRegistered, ClassName, ClassStyle, nullptr, nullptr);
        created = CWnd::Create(ClassName, "", WS_CHILD, empty, parent, id, context);
    } else {
        created = CWnd::Create(nullptr, nullptr, WS_CHILD, empty, parent, id, context);
    }
    m_owner = parent;
    return created;
}

void Tavo_WiParkedCursorMonitor::Enable(int flag)
{
    if (m_enabled && !flag)
        StopParkTimer();
    m_enabled = flag;
}

void Tavo_WiParkedCursorMonitor::RelayEvent(MSG* msg)
{
    if (msg == nullptr)
        return;

    if (msg->message == WM_MOUSEMOVE) {
        // Compared as the message's unsigned 16-bit halves: only a change of
        // position matters, not its sign.
        const CPoint point(LOWORD(msg->lParam), HIWORD(msg->lParam));
        if (point == m_lastPoint)
            return;
        StopParkedCursor();
        StartParkTimer();
        m_lastPoint = point;
        return;
    }
    if (IsButtonPress(msg->message)) {
        m_buttonDown = 1;
        StopParkedCursor();
        StopParkTimer();
        return;
    }
    if (IsButtonReleaseOrDoubleClick(msg->message)) {
        // No timer yet: the next move starts it.
        m_buttonDown = 0;
        StopParkedCursor();
        StopParkTimer();
    }
}

void Tavo_WiParkedCursorMonitor::OnTimer(UINT_PTR id)
{
    if (id != m_timerId)
        return;
    StopParkTimer();
    StartParkedCursor();
}

// ---- implementation -------------------------------------------------------------

void Tavo_WiParkedCursorMonitor::StartParkTimer()
{
    if (!m_enabled || m_buttonDown)
        return;
    StopParkTimer();
    m_timerId = ::SetTimer(GetSafeHwnd(), ParkTimerId, ParkTimeMs, nullptr);
}

void Tavo_WiParkedCursorMonitor::StopParkTimer()
{
    if (m_timerId != 0)
        ::KillTimer(GetSafeHwnd(), m_timerId);
    m_timerId = 0;
}

void Tavo_WiParkedCursorMonitor::StartParkedCursor()
{
    StopParkedCursor();
    if (!m_enabled || !OwnerIsLive() || m_buttonDown)
        return;

    const HWND owner = m_owner->GetSafeHwnd();
    CRect ownerRect;
    ::GetWindowRect(owner, &ownerRect);
    CPoint cursor;
    ::GetCursorPos(&cursor);
    if (!ownerRect.PtInRect(cursor))
        return;

    // Only a window of the active application rests under the pointer.
    const HWND active = ::GetActiveWindow();
    if (active == nullptr || !::IsWindow(active) || !::IsChild(active, owner))
        return;

    ::ScreenToClient(owner, &cursor);
    m_parked = 1;
    m_parkPoint = cursor;
    SendParkedNotification(1);
}

void Tavo_WiParkedCursorMonitor::StopParkedCursor()
{
    const int wasParked = m_parked;
    m_parkPoint = CPoint(NoCoordinate, NoCoordinate);
    m_parked = 0;
    if (wasParked)
        SendParkedNotification(0);
}

bool Tavo_WiParkedCursorMonitor::OwnerIsLive() const
{
    return m_owner != nullptr && ::IsWindow(m_owner->GetSafeHwnd());
}

void Tavo_WiParkedCursorMonitor::SendParkedNotification(WPARAM parked)
{
    if (!OwnerIsLive())
        return;
    ::SendMessageA(m_owner->GetSafeHwnd(), GetNotifyMsg(), parked, 0);
}
