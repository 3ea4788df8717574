#include "scroll_test_support.h"

namespace ScrollTest {

namespace {

LRESULT CALLBACK NotingProc(HWND hwnd, UINT message, WPARAM wParam, LPARAM lParam)
{
    if (message >= 0xC000 && message <= 0xFFFF)
        TestWindow::Notes().push_back({hwnd, message, wParam});
    return ::DefWindowProcA(hwnd, message, wParam, lParam);
}

const char* TestWindowClass()
{
    static const char* const name = [] {
        WNDCLASSA wc = {};
        wc.style = CS_DBLCLKS;
        wc.lpfnWndProc = NotingProc;
        wc.hInstance = ::GetModuleHandleA(nullptr);
        wc.hCursor = ::LoadCursor(nullptr, IDC_ARROW);
        wc.hbrBackground = static_cast<HBRUSH>(::GetStockObject(WHITE_BRUSH));
        wc.lpszClassName = "ScrollTestWindow";
        ::RegisterClassA(&wc);
        return wc.lpszClassName;
    }();
    return name;
}

} // namespace

void PumpPending()
{
    MSG msg;
    // Unfiltered: under Wine a message range upsets the double-click
    // detection of a pending button message.
    while (::PeekMessageA(&msg, nullptr, 0, 0, PM_REMOVE)) {
        if (msg.message == WM_TIMER || CWnd::WalkPreTranslateTree(nullptr, &msg))
            continue;
        ::TranslateMessage(&msg);
        ::DispatchMessageA(&msg);
    }
}

bool PumpUntil(const std::function<bool()>& done)
{
    const DWORD start = ::GetTickCount();
    for (;;) {
        PumpPending();
        if (done())
            return true;
        if (::GetTickCount() - start > 3000)
            return false;
        ::MsgWaitForMultipleObjects(0, nullptr, FALSE, 10, QS_ALLINPUT);
    }
}

void PumpInput()
{
    PumpUntil([] { return HIWORD(::GetQueueStatus(QS_INPUT)) == 0; });
}

INPUT MouseInput(DWORD buttonFlags, POINT screenPoint, DWORD time, DWORD data)
{
    const long long width = ::GetSystemMetrics(SM_CXSCREEN);
    const long long height = ::GetSystemMetrics(SM_CYSCREEN);
    INPUT input = {};
    input.type = INPUT_MOUSE;
    // Absolute coordinates land exactly when rounded up.
    input.mi.dx = static_cast<LONG>((screenPoint.x * 65536LL + width - 1) / width);
    input.mi.dy = static_cast<LONG>((screenPoint.y * 65536LL + height - 1) / height);
    input.mi.mouseData = data;
    input.mi.dwFlags = buttonFlags | MOUSEEVENTF_MOVE | MOUSEEVENTF_ABSOLUTE;
    input.mi.time = time;
    return input;
}

void SendMouse(DWORD buttonFlags, POINT screenPoint, DWORD time)
{
    INPUT input = MouseInput(buttonFlags, screenPoint, time);
    ::SendInput(1, &input, sizeof input);
}

void SendKey(WORD virtualKey, DWORD time)
{
    INPUT inputs[2] = {};
    for (INPUT& input : inputs) {
        input.type = INPUT_KEYBOARD;
        input.ki.wVk = virtualKey;
        input.ki.time = time;
    }
    inputs[1].ki.dwFlags = KEYEVENTF_KEYUP;
    ::SendInput(2, inputs, sizeof(INPUT));
}

DWORD FreshTime()
{
    static DWORD next = 0;
    DWORD now = ::GetTickCount();
    if (static_cast<LONG>(now - next) < 0)
        now = next;
    next = now + 2000;
    return now;
}

ButtonReleaseDeadline::ButtonReleaseDeadline(DWORD milliseconds) : m_stop(::CreateEventA(nullptr, TRUE, FALSE, nullptr))
{
    m_thread = std::thread([this, milliseconds] {
        if (::WaitForSingleObject(m_stop, milliseconds) != WAIT_TIMEOUT)
            return;
        m_passed = true;
        INPUT input = {};
        input.type = INPUT_MOUSE;
        input.mi.dwFlags = MOUSEEVENTF_LEFTUP | MOUSEEVENTF_RIGHTUP | MOUSEEVENTF_MIDDLEUP;
        ::SendInput(1, &input, sizeof input);
    });
}

ButtonReleaseDeadline::~ButtonReleaseDeadline()
{
    ::SetEvent(m_stop);
    m_thread.join();
    ::CloseHandle(m_stop);
}

TestWindow::TestWindow(const CRect& rect, HWND parent)
{
    const DWORD style = parent != nullptr ? WS_CHILD | WS_VISIBLE : WS_POPUP | WS_VISIBLE | WS_CLIPCHILDREN;
    m_hwnd = ::CreateWindowExA(0, TestWindowClass(), "scroll test", style, rect.left, rect.top,
                               rect.Width(), rect.Height(), parent, nullptr, ::GetModuleHandleA(nullptr),
                               nullptr);
    m_wnd.Attach(m_hwnd);
    if (parent != nullptr)
        return;
    ::SetForegroundWindow(m_hwnd);
    ::SetActiveWindow(m_hwnd);
    PumpPending();
}

TestWindow::~TestWindow()
{
    m_wnd.Detach();
    ::DestroyWindow(m_hwnd);
    PumpPending();
}

std::ostream& operator<<(std::ostream& out, const Call& call)
{
    return out << call.name << "(button " << call.button << ", flags " << call.flags << ", (" << call.point.x
               << ", " << call.point.y << "), completed " << call.completed << ")";
}

CRect ChildRect(HWND child)
{
    CRect rect;
    ::GetWindowRect(child, &rect);
    ::MapWindowPoints(nullptr, ::GetParent(child), reinterpret_cast<POINT*>(&rect), 2);
    return rect;
}

} // namespace ScrollTest
