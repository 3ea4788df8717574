#include "soak_window.h"

#include "Tavo_WiLibrary.h"

namespace {

constexpr char HostClassName[] = "SoakHost";
constexpr UINT DrawWndId = 1;

const char* HostClass()
{
    static const char* const name = [] {
        WNDCLASSA wc = {};
        wc.lpfnWndProc = DefWindowProcA;
        wc.hInstance = ::GetModuleHandleA(nullptr);
        wc.hCursor = ::LoadCursor(nullptr, IDC_ARROW);
        wc.hbrBackground = static_cast<HBRUSH>(::GetStockObject(WHITE_BRUSH));
        wc.lpszClassName = HostClassName;
        ::RegisterClassA(&wc);
        return HostClassName;
    }();
    return name;
}

// The core is initialised once for the whole program, as an application
// does at start.
struct LibraryInitialisation {
    LibraryInitialisation() { Tavo_WiLibrary::Initialize(); }
};

} // namespace

// ---- the drawing window ------------------------------------------------------------

void SoakDrawWnd::OnDraw(Tavo_WiScrollee* scrollee, CDC* dc, Tavo_GrDrawing* drawing,
                         Tavo_WiNativeWindowSurface* surface, Tavo_GrMapping* mapping, Tavo_GrDRect& rect)
{
    ++counts.paints;
    if (onPaint)
        onPaint();
    Tavo_WiDrawWnd::OnDraw(scrollee, dc, drawing, surface, mapping, rect);
}

void SoakDrawWnd::OnDragMove(UINT button, UINT flags, const CPoint& point)
{
    Tavo_WiDrawWnd::OnDragMove(button, flags, point);
    if (onDragMove)
        onDragMove();
}

void SoakDrawWnd::OnRubberRectangle(UINT, UINT, const Tavo_GrWRect& rect)
{
    ++counts.rubberRectangles;
    lastRubberRectangle = rect;
}

CString SoakDrawWnd::GetDataTipText(const Tavo_GrWRect&)
{
    ++counts.dataTipQuestions;
    return dataTipText;
}

// ---- the host ------------------------------------------------------------------------

SoakHost::SoakHost(const CRect& screenRect)
{
    static LibraryInitialisation initialised;
    m_hwnd = ::CreateWindowExA(0, HostClass(), "soak", WS_POPUP | WS_VISIBLE | WS_CLIPCHILDREN, screenRect.left,
                               screenRect.top, screenRect.Width(), screenRect.Height(), nullptr, nullptr,
                               ::GetModuleHandleA(nullptr), nullptr);
    m_wnd.Attach(m_hwnd);
    ::SetWindowLongPtrA(m_hwnd, GWLP_USERDATA, reinterpret_cast<LONG_PTR>(this));
    ::SetWindowLongPtrA(m_hwnd, GWLP_WNDPROC, reinterpret_cast<LONG_PTR>(&Proc));
    CRect client(0, 0, 0, 0);
    ::GetClientRect(m_hwnd, &client);
    m_drawWnd.Create(WS_CHILD | WS_VISIBLE, client, &m_wnd, DrawWndId);
    Activate();
}

SoakHost::~SoakHost()
{
    m_drawWnd.DestroyWindow();
    m_wnd.Detach();
    ::DestroyWindow(m_hwnd);
}

void SoakHost::Activate()
{
    ::SetWindowPos(m_hwnd, HWND_TOP, 0, 0, 0, 0, SWP_NOMOVE | SWP_NOSIZE);
    ::SetForegroundWindow(m_hwnd);
    ::SetActiveWindow(m_hwnd);
    ::SetFocus(m_hwnd);
}

void SoakHost::FillClientArea()
{
    if (!IsAlive())
        return;
    CRect client(0, 0, 0, 0);
    ::GetClientRect(m_hwnd, &client);
    ::MoveWindow(DrawWnd(), 0, 0, client.Width(), client.Height(), TRUE);
}

void SoakHost::ScrollByKey(WPARAM key)
{
    if (!IsAlive())
        return;
    struct Binding {
        WPARAM key;
        Tavo_WiScroll::Dir dir;
        Tavo_WiScroll::Amount amount;
    };
    static constexpr Binding bindings[] = {
        {VK_LEFT, Tavo_WiScroll::Left, Tavo_WiScroll::Line},
        {VK_RIGHT, Tavo_WiScroll::Right, Tavo_WiScroll::Line},
        {VK_UP, Tavo_WiScroll::Up, Tavo_WiScroll::Line},
        {VK_DOWN, Tavo_WiScroll::Down, Tavo_WiScroll::Line},
        {VK_PRIOR, Tavo_WiScroll::Up, Tavo_WiScroll::Page},
        {VK_NEXT, Tavo_WiScroll::Down, Tavo_WiScroll::Page},
        {VK_HOME, Tavo_WiScroll::Left, Tavo_WiScroll::Limit},
        {VK_END, Tavo_WiScroll::Right, Tavo_WiScroll::Limit},
    };
    for (const Binding& binding : bindings)
        if (binding.key == key)
            m_drawWnd.ScrollWindow(binding.dir, binding.amount, 0);
}

LRESULT CALLBACK SoakHost::Proc(HWND hwnd, UINT message, WPARAM wParam, LPARAM lParam)
{
    auto* host = reinterpret_cast<SoakHost*>(::GetWindowLongPtrA(hwnd, GWLP_USERDATA));
    switch (message) {
    case WM_SIZE:
        host->FillClientArea();
        break;
    case WM_ENTERSIZEMOVE:
        host->m_drawWnd.OnEnterSizeMove();
        return 0;
    case WM_EXITSIZEMOVE:
        host->m_drawWnd.OnExitSizeMove();
        return 0;
    case WM_KEYDOWN:
        host->ScrollByKey(wParam);
        return 0;
    default:
        break;
    }
    return ::DefWindowProcA(hwnd, message, wParam, lParam);
}
