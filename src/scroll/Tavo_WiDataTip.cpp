// Tavo_WiDataTip: the tip window, the process-wide current tip and the thread
// keyboard hook that hides it.
#include "Tavo_WiDataTip.h"

#include "Tavo_WiScrollStatics.h"
#include "Tavo_WiWindowClass.h"

namespace {

constexpr char ClassName[] = "Tavo_WiDataTip";
constexpr UINT ClassStyle = CS_SAVEBITS | CS_DBLCLKS;
constexpr DWORD TipExStyle = WS_EX_TOOLWINDOW;
constexpr DWORD TipStyle = WS_POPUP | WS_CLIPSIBLINGS | WS_BORDER;
// Under the framework's default class the tip also carries WS_CHILD.
constexpr DWORD DefaultClassTipStyle = WS_POPUP | WS_CHILD | WS_CLIPSIBLINGS | WS_BORDER;
constexpr int InitialSize = 10;
constexpr char NotifyMessageName[] = "BrymarTavo_WiDataTipMessage";

// Process-wide state shared by all tips; everything runs on the one
// user-interface thread.
int s_instanceCount = 0;
HHOOK s_keyboardHook = nullptr;
int s_keyFlag = 0;                      // a keyboard event has passed the hook
Tavo_WiDataTip* s_currentTip = nullptr; // the shown tip, if any; not owned
UINT s_notifyMsg = 0;
bool s_classRegistered = false;

LRESULT CALLBACK KeyboardHookProc(int code, WPARAM wParam, LPARAM lParam)
{
    if (code >= 0)
        s_keyFlag = 1;
    return CallNextHookEx(s_keyboardHook, code, wParam, lParam);
}

void CreateSharedObjects()
{
    CFont& font = Tavo_WiScrollStatics::dataTipFont;
    if (font.GetSafeHandle() == nullptr) {
        LOGFONTA description = {};
        ::GetObjectA(GetStockObject(ANSI_VAR_FONT), sizeof description, &description);
        font.CreateFontIndirect(&description);
    }
    std::unique_ptr<CBrush>& brush = Tavo_WiScrollStatics::dataTipBrush;
    if (!brush) {
        brush.reset(new CBrush);
        brush->CreateSolidBrush(GetSysColor(COLOR_INFOBK));
    }
    if (s_keyboardHook == nullptr)
        s_keyboardHook = SetWindowsHookExA(WH_KEYBOARD, KeyboardHookProc, nullptr, GetCurrentThreadId());
}

} // namespace

BEGIN_MESSAGE_MAP(Tavo_WiDataTip, CWnd)
    ON_WM_TIMER()
    ON_WM_PAINT()
END_MESSAGE_MAP()

Tavo_WiDataTip::Tavo_WiDataTip()
{
    ++s_instanceCount;
}

Tavo_WiDataTip::~Tavo_WiDataTip()
{
    if (s_currentTip == this)
        s_currentTip = nullptr;
    if (GetSafeHwnd() != nullptr)
        Tavo_WiDataTip::DestroyWindow();
    --s_instanceCount;
    if (s_instanceCount < 1) {
        if (s_keyboardHook != nullptr)
            UnhookWindowsHookEx(s_keyboardHook);
        s_keyboardHook = nullptr;
        s_instanceCount = 0;
    }
}

UINT Tavo_WiDataTip::GetNotifyMsg()
{
    if (s_notifyMsg == 0)
        s_notifyMsg = RegisterWindowMessageA(NotifyMessageName);
    return s_notifyMsg;
}

BOOL Tavo_WiDataTip::Create(CWnd* owner)
{
    CreateSharedObjects();
    m_owner = owner;
    const HWND parent = owner != nullptr ? owner->GetSafeHwnd() : nullptr;

    if (Tavo_WiWindowClass::UseOwnClasses()) {
        Tavo_WiWindowClass::RegisterOnce(
            s_classRegistered, ClassName, ClassStyle, LoadCursor(nullptr, IDC_ARROW),
            static_cast<HBRUSH>(Tavo_WiScrollStatics::dataTipBrush->GetSafeHandle()));
        return CreateEx(TipExStyle, ClassName, nullptr, TipStyle, 0, 0, InitialSize, InitialSize,
                        parent, nullptr, nullptr);
    }
    return CreateEx(TipExStyle, nullptr, nullptr, DefaultClassTipStyle, 0, 0, InitialSize,
                    InitialSize, parent, nullptr, nullptr);
}

BOOL Tavo_WiDataTip::DestroyWindow()
{
    StopTimer();
    if (s_currentTip == this)
        s_currentTip = nullptr;
    return CWnd::DestroyWindow();
}

// ---- showing and hiding ------------------------------------------------------------

void Tavo_WiDataTip::Show(const CPoint& point, const CString& text)
{
    if (s_currentTip != nullptr)
        s_currentTip->Hide();
    if (!::IsWindow(GetSafeHwnd()) || m_owner == nullptr || !::IsWindow(m_owner->GetSafeHwnd()))
        return;

    // The client rectangle is half open: its right and bottom edges are outside.
    CRect ownerClient;
    ::GetClientRect(m_owner->GetSafeHwnd(), &ownerClient);
    if (!ownerClient.PtInRect(point))
        return;

    CPoint anchor = point;
    ::ClientToScreen(m_owner->GetSafeHwnd(), &anchor);
    anchor.Offset(AnchorOffset, AnchorOffset);
    m_position = anchor;
    m_text = text;

    CRect frame;
    {
        CClientDC dc(this);
        CFont* oldFont = dc.SelectObject(&Tavo_WiScrollStatics::dataTipFont);
        SIZE extent = {0, 0};
        ::GetTextExtentPoint32A(dc.GetSafeHdc(), m_text, m_text.GetLength(), &extent);
        frame.SetRect(anchor.x, anchor.y, anchor.x + extent.cx, anchor.y + extent.cy);
        frame.InflateRect(MarginX, MarginY);

        // Kept on the screen horizontally only: the right edge first, then
        // the left edge, which wins for a tip wider than the screen.
        const int screenWidth = dc.GetDeviceCaps(HORZRES);
        if (frame.right > screenWidth)
            frame.OffsetRect(screenWidth - frame.right, 0);
        if (frame.left < 0)
            frame.OffsetRect(-frame.left, 0);
        dc.SelectObject(oldFont);
    }
    ::SetWindowPos(GetSafeHwnd(), HWND_TOP, frame.left, frame.top, frame.Width(), frame.Height(),
                   SWP_NOACTIVATE | SWP_SHOWWINDOW);

    s_currentTip = this;
    s_keyFlag = 0;
    m_visible = 1;
    SendDataTipNotification();
    StartTimer();
}

void Tavo_WiDataTip::Hide()
{
    if (::IsWindow(GetSafeHwnd()))
        ::ShowWindow(GetSafeHwnd(), SW_HIDE);
    m_visible = 0;
    StopTimer();
    s_currentTip = nullptr;
    SendDataTipNotification();
}

void Tavo_WiDataTip::OnTimer(UINT_PTR)
{
    // Keys are watched by the hook; the tip only looks at its flag.
    if (!s_keyFlag || s_currentTip == nullptr)
        return;
    s_currentTip->Hide();
    s_currentTip = nullptr;
    s_keyFlag = 0;
}

void Tavo_WiDataTip::OnPaint()
{
    CRect client;
    GetClientRect(&client);
    CPaintDC dc(this);
    CFont* oldFont = dc.SelectObject(&Tavo_WiScrollStatics::dataTipFont);
    dc.SetBkColor(GetSysColor(COLOR_INFOBK));
    dc.SetTextColor(GetSysColor(COLOR_INFOTEXT));
    dc.SetTextAlign(TA_CENTER | TA_TOP);
    dc.TextOut((client.right - client.left) / 2, 1, m_text);
    dc.SelectObject(oldFont);
}

// ---- implementation --------------------------------------------------------------------

void Tavo_WiDataTip::StartTimer()
{
    StopTimer();
    m_timerId = ::SetTimer(GetSafeHwnd(), TimerId, TimerPeriodMs, nullptr);
}

void Tavo_WiDataTip::StopTimer()
{
    if (m_timerId != 0)
        ::KillTimer(GetSafeHwnd(), m_timerId);
    m_timerId = 0;
}

void Tavo_WiDataTip::SendDataTipNotification()
{
    if (m_owner == nullptr || !::IsWindow(m_owner->GetSafeHwnd()))
        return;
    ::SendMessageA(m_owner->GetSafeHwnd(), GetNotifyMsg(), static_cast<WPARAM>(m_visible), 0);
}
