#include "scroll_test_support.h"

#include <ostream>

namespace ScrollTest {

namespace {

// Dispatches one message as the application's pump does: the target and
// then its parents may pre-translate it.
void Dispatch(MSG& msg)
{
    if (CWnd::WalkPreTranslateTree(nullptr, &msg))
        return;
    ::TranslateMessage(&msg);
    ::DispatchMessageA(&msg);
}

bool PeekOne(MSG& msg)
{
    // Unfiltered: a message range would upset the platform's double-click
    // detection. Real timer messages are dropped, so that no real timer
    // fires inside a test.
    while (::PeekMessageA(&msg, nullptr, 0, 0, PM_REMOVE)) {
        if (msg.message != WM_TIMER)
            return true;
    }
    return false;
}

LRESULT CALLBACK SinkProc(HWND hwnd, UINT message, WPARAM wParam, LPARAM lParam)
{
    if (message >= 0xC000 && message <= 0xFFFF)
        NotificationSink::Notes().push_back({hwnd, message, wParam});
    return ::DefWindowProcA(hwnd, message, wParam, lParam);
}

const char* RegisterPlainClass(const char* name, WNDPROC proc)
{
    WNDCLASSA wc = {};
    if (!::GetClassInfoA(::GetModuleHandleA(nullptr), name, &wc)) {
        wc.lpfnWndProc = proc;
        wc.hInstance = ::GetModuleHandleA(nullptr);
        wc.hCursor = ::LoadCursor(nullptr, IDC_ARROW);
        wc.hbrBackground = static_cast<HBRUSH>(::GetStockObject(WHITE_BRUSH));
        wc.lpszClassName = name;
        wc.style = CS_DBLCLKS;
        ::RegisterClassA(&wc);
    }
    return name;
}

}  // namespace

void PumpPending()
{
    MSG msg;
    while (PeekOne(msg))
        Dispatch(msg);
}

bool PumpUntil(const std::function<bool()>& done, DWORD timeoutMs)
{
    const DWORD start = ::GetTickCount();
    for (;;) {
        PumpPending();
        if (done())
            return true;
        if (::GetTickCount() - start > timeoutMs)
            return false;
        ::MsgWaitForMultipleObjects(0, nullptr, FALSE, 10, QS_ALLINPUT);
    }
}

void SendMouse(DWORD buttonFlags, POINT screenPoint, DWORD time)
{
    const int width = ::GetSystemMetrics(SM_CXSCREEN);
    const int height = ::GetSystemMetrics(SM_CYSCREEN);
    INPUT input = {};
    input.type = INPUT_MOUSE;
    // Absolute coordinates land exactly when rounded up.
    input.mi.dx = static_cast<LONG>((static_cast<long long>(screenPoint.x) * 65536 + width - 1) / width);
    input.mi.dy = static_cast<LONG>((static_cast<long long>(screenPoint.y) * 65536 + height - 1) / height);
    input.mi.dwFlags = buttonFlags | MOUSEEVENTF_MOVE | MOUSEEVENTF_ABSOLUTE;
    input.mi.time = time;
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

// ---- windows ------------------------------------------------------------------------

HostWindow::HostWindow(int x, int y, int width, int height)
{
    const char* cls = RegisterPlainClass("ScrollTestHost", ::DefWindowProcA);
    m_hwnd = ::CreateWindowExA(0, cls, "scroll test", WS_POPUP | WS_VISIBLE | WS_CLIPCHILDREN, x, y,
                               width, height, nullptr, nullptr, ::GetModuleHandleA(nullptr), nullptr);
    m_wnd.Attach(m_hwnd);
    ::SetForegroundWindow(m_hwnd);
    ::SetActiveWindow(m_hwnd);
    PumpPending();
}

HostWindow::~HostWindow()
{
    m_wnd.Detach();
    ::DestroyWindow(m_hwnd);
    PumpPending();
}

NotificationSink::NotificationSink(HWND parent)
{
    const char* cls = RegisterPlainClass("ScrollTestSink", SinkProc);
    const DWORD style = parent != nullptr ? WS_CHILD | WS_VISIBLE : WS_POPUP;
    m_hwnd = ::CreateWindowExA(0, cls, "", style, 0, 0, 100, 100, parent, nullptr,
                               ::GetModuleHandleA(nullptr), nullptr);
    m_wnd.Attach(m_hwnd);
}

NotificationSink::~NotificationSink()
{
    m_wnd.Detach();
    ::DestroyWindow(m_hwnd);
}

std::vector<NotificationSink::Note>& NotificationSink::Notes()
{
    static std::vector<Note> notes;
    return notes;
}

// ---- recording scroll window ---------------------------------------------------------

std::ostream& operator<<(std::ostream& out, const Call& call)
{
    return out << call.name << "(button " << call.button << ", flags " << call.flags << ", ("
               << call.point.x << ", " << call.point.y << "), completed " << call.completed << ")";
}

std::vector<Call> RecordingScrollWnd::CallsNamed(const std::string& name) const
{
    std::vector<Call> result;
    for (const Call& call : calls)
        if (call.name == name)
            result.push_back(call);
    return result;
}

void RecordingScrollWnd::Record(const char* name, const CPoint& point, UINT button, UINT flags,
                                int completed)
{
    calls.push_back({name, button, flags, point, completed});
}

void RecordingScrollWnd::OnDraw(Tavo_WiScrollee* scrollee, CDC* dc)
{
    if (painter)
        painter(scrollee, dc);
}

void RecordingScrollWnd::GetScrollDeviceDeltas(const CPoint& a, const CPoint& b, int& dx, int& dy,
                                               int scrolling)
{
    if (scrolling)
        Record("ScrollDeltas", b);
    if (deltas)
        deltas(a, b, dx, dy, scrolling);
    else
        Tavo_WiScrollWnd::GetScrollDeviceDeltas(a, b, dx, dy, scrolling);
}

void RecordingScrollWnd::OnClick(UINT button, UINT flags, const CPoint& point)
{
    Record("Click", point, button, flags);
}

void RecordingScrollWnd::OnDoubleClick(UINT button, UINT flags, const CPoint& point)
{
    Record("DoubleClick", point, button, flags);
}

void RecordingScrollWnd::OnDragStart(UINT button, UINT flags, const CPoint& point)
{
    Record("DragStart", point, button, flags);
}

void RecordingScrollWnd::OnDragMove(UINT button, UINT flags, const CPoint& point)
{
    Record("DragMove", point, button, flags);
}

void RecordingScrollWnd::OnDragEnd(UINT button, UINT flags, const CPoint& point, int completed)
{
    Record("DragEnd", point, button, flags, completed);
}

void RecordingScrollWnd::OnDragAbort()
{
    Record("DragAbort", CPoint(0, 0));
}

void RecordingScrollWnd::OnParkedCursorStart(const CPoint& point)
{
    Record("ParkedStart", point);
    Tavo_WiScrollWnd::OnParkedCursorStart(point);
}

void RecordingScrollWnd::OnParkedCursorEnd()
{
    Record("ParkedEnd", CPoint(0, 0));
    Tavo_WiScrollWnd::OnParkedCursorEnd();
}

CString RecordingScrollWnd::GetDataTipText(const CPoint& point)
{
    Record("DataTipText", point);
    return dataTipText;
}

void RecordingScrollWnd::OnDragScrollStart(const CPoint& position)
{
    Record("DragScrollStart", position);
}

void RecordingScrollWnd::OnDragScrollMove(const CPoint& position)
{
    Record("DragScrollMove", position);
}

void RecordingScrollWnd::OnDragScrollEnd(const CPoint& position)
{
    Record("DragScrollEnd", position);
}

void RecordingScrollWnd::OnNonDragScrollEnd(const CPoint& position)
{
    Record("NonDragScrollEnd", position);
}

// ---- pixels ----------------------------------------------------------------------------

Pixels::Pixels(HWND window, int width, int height)
    : m_width(width), m_height(height), m_bits(static_cast<size_t>(width) * height)
{
    BITMAPINFO info = {};
    info.bmiHeader.biSize = sizeof info.bmiHeader;
    info.bmiHeader.biWidth = width;
    info.bmiHeader.biHeight = -height;   // top-down
    info.bmiHeader.biPlanes = 1;
    info.bmiHeader.biBitCount = 32;
    info.bmiHeader.biCompression = BI_RGB;
    void* bits = nullptr;
    HBITMAP dib = ::CreateDIBSection(nullptr, &info, DIB_RGB_COLORS, &bits, nullptr, 0);
    HDC memory = ::CreateCompatibleDC(nullptr);
    HGDIOBJ old = ::SelectObject(memory, dib);
    HDC source = ::GetDC(window);
    ::BitBlt(memory, 0, 0, width, height, source, 0, 0, SRCCOPY);
    ::ReleaseDC(window, source);
    ::GdiFlush();
    const DWORD* pixels = static_cast<const DWORD*>(bits);
    m_bits.assign(pixels, pixels + m_bits.size());
    ::SelectObject(memory, old);
    ::DeleteDC(memory);
    ::DeleteObject(dib);
}

COLORREF Pixels::At(int x, int y) const
{
    const DWORD rgb = m_bits[static_cast<size_t>(y) * m_width + x] & 0xFFFFFF;
    return RGB((rgb >> 16) & 0xFF, (rgb >> 8) & 0xFF, rgb & 0xFF);
}

CRect ChildRect(HWND child)
{
    CRect rect;
    ::GetWindowRect(child, &rect);
    ::MapWindowPoints(nullptr, ::GetParent(child), reinterpret_cast<POINT*>(&rect), 2);
    return rect;
}

}  // namespace ScrollTest

namespace ScrollTest {

DWORD FreshTime()
{
    static DWORD next = 0;
    DWORD now = ::GetTickCount();
    if (static_cast<LONG>(now - next) < 0)
        now = next;
    next = now + 2000;
    return now;
}

void PumpInput()
{
    PumpUntil([] { return HIWORD(::GetQueueStatus(QS_INPUT)) == 0; });
}

}  // namespace ScrollTest

namespace ScrollTest {

bool EnglishLocale()
{
    return (::GetUserDefaultLCID() & 0x3FF) == LANG_ENGLISH;
}

}  // namespace ScrollTest
