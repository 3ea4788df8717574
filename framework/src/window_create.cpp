// window_create.cpp - the life of a CWnd's window: the framework's window
// procedure, creation with the object hooked to its window before the first
// message, subclassing, destruction and window-class registration.
#include "afx_internal.h"

#include <cctype>
#include <map>
#include <mutex>
#include <string>

using afx_internal::CurrentThreadState;

const CWnd CWnd::wndTop(HWND_TOP);
const CWnd CWnd::wndBottom(HWND_BOTTOM);
const CWnd CWnd::wndTopMost(HWND_TOPMOST);
const CWnd CWnd::wndNoTopMost(HWND_NOTOPMOST);

namespace {

constexpr int kClassNameLength = 256;

std::string LowerCase(LPCSTR text)
{
    std::string result(text);
    for (char& c : result)
        c = static_cast<char>(std::tolower(static_cast<unsigned char>(c)));
    return result;
}

// Window classes registered through AfxRegisterClass, by lower-case name,
// with the instance they were registered for.
struct ClassRegistry {
    std::mutex mutex;
    std::map<std::string, HINSTANCE> instances;
};

ClassRegistry& Registry()
{
    static ClassRegistry registry;
    return registry;
}

bool IsImeWindow(HWND hWnd)
{
    char className[kClassNameLength] = {};
    ::GetClassNameA(hWnd, className, kClassNameLength);
    return ::lstrcmpiA(className, afx_internal::kImeWindowClass) == 0;
}

// Makes AfxWndProc the procedure of hWnd, keeping the previous one in the
// object so that DefWindowProc can pass messages on to it.
void InstallFrameworkProcedure(CWnd* pWnd, HWND hWnd)
{
    const WNDPROC frameworkProc = AfxGetAfxWndProc();
    const auto previous = reinterpret_cast<WNDPROC>(::SetWindowLongPtrA(hWnd, GWLP_WNDPROC, reinterpret_cast<LONG_PTR>(frameworkProc)));
    if (previous != frameworkProc)
        *pWnd->GetSuperWndProcAddr() = previous;
}

// The creation hook: the first window created on the thread after
// HookWindowCreate is attached to the waiting object before it receives
// any message (WM_GETMINMAXINFO, WM_NCCREATE, WM_CREATE ...).
LRESULT CALLBACK CreationHook(int nCode, WPARAM wParam, LPARAM lParam)
{
    afx_internal::ThreadState& state = CurrentThreadState();
    if (nCode == HCBT_CREATEWND && state.windowBeingCreated != NULL) {
        const auto hWnd = reinterpret_cast<HWND>(wParam);
        if (!IsImeWindow(hWnd)) {
            CWnd* pWnd = state.windowBeingCreated;
            state.windowBeingCreated = NULL;
            pWnd->Attach(hWnd);
            pWnd->PreSubclassWindow();
            InstallFrameworkProcedure(pWnd, hWnd);
        }
    }
    return ::CallNextHookEx(state.creationHook, nCode, wParam, lParam);
}

} // namespace

namespace afx_internal {

HINSTANCE RegisteredClassInstance(LPCSTR className)
{
    if (className == NULL || IS_INTRESOURCE(className))
        return NULL;
    ClassRegistry& registry = Registry();
    std::lock_guard<std::mutex> lock(registry.mutex);
    const auto it = registry.instances.find(LowerCase(className));
    return it == registry.instances.end() ? NULL : it->second;
}

bool RegisterDefaultWindowClass()
{
    WNDCLASSA wndcls = {};
    wndcls.style = CS_DBLCLKS | CS_HREDRAW | CS_VREDRAW;
    wndcls.lpfnWndProc = ::DefWindowProcA; // replaced by AfxWndProc at creation
    wndcls.hInstance = AfxGetInstanceHandle();
    wndcls.hCursor = ::LoadCursorA(NULL, MAKEINTRESOURCEA(32512)); // IDC_ARROW
    wndcls.lpszClassName = kDefaultWindowClass;
    return AfxRegisterClass(&wndcls) != FALSE;
}

void HookWindowCreate(CWnd* pWnd)
{
    ThreadState& state = CurrentThreadState();
    if (state.creationHook == NULL) {
        state.creationHook = ::SetWindowsHookExA(WH_CBT, CreationHook, NULL, ::GetCurrentThreadId());
    }
    state.windowBeingCreated = pWnd;
}

bool UnhookWindowCreate()
{
    ThreadState& state = CurrentThreadState();
    if (state.creationHook != NULL) {
        ::UnhookWindowsHookEx(state.creationHook);
        state.creationHook = NULL;
    }
    const bool used = state.windowBeingCreated == NULL;
    state.windowBeingCreated = NULL;
    return used;
}

LRESULT CallWindowProcedure(CWnd* pWnd, HWND hWnd, UINT nMsg, WPARAM wParam, LPARAM lParam)
{
    ThreadState& state = CurrentThreadState();
    const MSG previous = state.currentMessage;
    state.currentMessage = MSG{hWnd, nMsg, wParam, lParam, 0, {0, 0}};
    LRESULT result = 0;
    try {
        result = pWnd->WindowProc(nMsg, wParam, lParam);
    } catch (CException* e) {
        ::OutputDebugStringA("afx: a framework exception ended a message handler\n");
        e->Delete();
        result = nMsg == WM_CREATE ? -1 : 0;
    } catch (...) {
        ::OutputDebugStringA("afx: an exception ended a message handler\n");
        result = nMsg == WM_CREATE ? -1 : 0;
    }
    // A handler that left out the base OnNcDestroy still gets its object
    // detached from the dead window.
    if (nMsg == WM_NCDESTROY && CWnd::FromHandlePermanent(hWnd) == pWnd)
        DetachDestroyedWindow(pWnd);
    state.currentMessage = previous;
    return result;
}

void DetachDestroyedWindow(CWnd* pWnd)
{
    const HWND hWnd = pWnd->m_hWnd;
    const WNDPROC super = *pWnd->GetSuperWndProcAddr();
    if (super != NULL && reinterpret_cast<WNDPROC>(::GetWindowLongPtrA(hWnd, GWLP_WNDPROC)) == AfxGetAfxWndProc()) {
        ::SetWindowLongPtrA(hWnd, GWLP_WNDPROC, reinterpret_cast<LONG_PTR>(super));
    }
    *pWnd->GetSuperWndProcAddr() = NULL;
    pWnd->Detach();
    pWnd->PostNcDestroy();
}

} // namespace afx_internal

LRESULT CALLBACK AfxWndProc(HWND hWnd, UINT nMsg, WPARAM wParam, LPARAM lParam)
{
    CWnd* pWnd = CWnd::FromHandlePermanent(hWnd);
    if (pWnd == NULL)
        return ::DefWindowProcA(hWnd, nMsg, wParam, lParam);
    return afx_internal::CallWindowProcedure(pWnd, hWnd, nMsg, wParam, lParam);
}

WNDPROC AfxGetAfxWndProc() { return &AfxWndProc; }

BOOL AfxRegisterClass(WNDCLASS* lpWndClass)
{
    // A class without a name or a window procedure could only fail later.
    if (lpWndClass == NULL || lpWndClass->lpszClassName == NULL || lpWndClass->lpfnWndProc == NULL)
        return FALSE;
    WNDCLASSA existing = {};
    if (!::GetClassInfoA(lpWndClass->hInstance, lpWndClass->lpszClassName, &existing)) {
        if (!::RegisterClassA(lpWndClass))
            return FALSE;
    }
    if (!IS_INTRESOURCE(lpWndClass->lpszClassName)) {
        ClassRegistry& registry = Registry();
        std::lock_guard<std::mutex> lock(registry.mutex);
        registry.instances[LowerCase(lpWndClass->lpszClassName)] = lpWndClass->hInstance;
    }
    return TRUE;
}

// ---------------------------------------------------------------------------
// Creation
// ---------------------------------------------------------------------------

BOOL CWnd::Create(LPCTSTR lpszClassName, LPCTSTR lpszWindowName, DWORD dwStyle, const RECT& rect, CWnd* pParentWnd,
                  UINT nID, CCreateContext* pContext)
{
    return CreateEx(0, lpszClassName, lpszWindowName, dwStyle | WS_CHILD, rect.left, rect.top, rect.right - rect.left,
                    rect.bottom - rect.top, pParentWnd->GetSafeHwnd(),
                    reinterpret_cast<HMENU>(static_cast<UINT_PTR>(nID)), pContext);
}

BOOL CWnd::CreateEx(DWORD dwExStyle, LPCTSTR lpszClassName, LPCTSTR lpszWindowName, DWORD dwStyle, const RECT& rect,
                    CWnd* pParentWnd, UINT nID, LPVOID lpParam)
{
    return CreateEx(dwExStyle, lpszClassName, lpszWindowName, dwStyle, rect.left, rect.top, rect.right - rect.left,
                    rect.bottom - rect.top, pParentWnd->GetSafeHwnd(),
                    reinterpret_cast<HMENU>(static_cast<UINT_PTR>(nID)), lpParam);
}

BOOL CWnd::CreateEx(DWORD dwExStyle, LPCTSTR lpszClassName, LPCTSTR lpszWindowName, DWORD dwStyle, int x, int y,
                    int nWidth, int nHeight, HWND hWndParent, HMENU nIDorHMenu, LPVOID lpParam)
{
    if (m_hWnd != NULL)
        return FALSE; // one window per object

    CREATESTRUCTA cs = {};
    cs.dwExStyle = dwExStyle;
    cs.lpszClass = lpszClassName;
    cs.lpszName = lpszWindowName;
    cs.style = dwStyle;
    cs.x = x;
    cs.y = y;
    cs.cx = nWidth;
    cs.cy = nHeight;
    cs.hwndParent = hWndParent;
    cs.hMenu = nIDorHMenu;
    cs.hInstance = AfxGetInstanceHandle();
    cs.lpCreateParams = lpParam;
    if (!PreCreateWindow(cs)) {
        PostNcDestroy();
        return FALSE;
    }
    // A class registered by an extension library for its own module is only
    // found with that module's instance.
    if (const HINSTANCE classInstance = afx_internal::RegisteredClassInstance(cs.lpszClass)) {
        cs.hInstance = classInstance;
    }

    afx_internal::HookWindowCreate(this);
    const HWND hWnd = ::CreateWindowExA(cs.dwExStyle, cs.lpszClass, cs.lpszName, cs.style, cs.x, cs.y, cs.cx, cs.cy,
                                        cs.hwndParent, cs.hMenu, cs.hInstance, cs.lpCreateParams);
    if (!afx_internal::UnhookWindowCreate())
        PostNcDestroy(); // failed before any message
    return hWnd != NULL && hWnd == m_hWnd;
}

BOOL CWnd::PreCreateWindow(CREATESTRUCT& cs)
{
    if (cs.lpszClass == NULL) {
        if (!afx_internal::RegisterDefaultWindowClass())
            return FALSE;
        cs.lpszClass = afx_internal::kDefaultWindowClass;
    }
    return TRUE;
}

void CWnd::PreSubclassWindow() {}

void CWnd::PostNcDestroy() {}

WNDPROC* CWnd::GetSuperWndProcAddr() { return &m_pfnSuper; }

// ---------------------------------------------------------------------------
// Subclassing and destruction
// ---------------------------------------------------------------------------

BOOL CWnd::SubclassWindow(HWND hWnd)
{
    if (!::IsWindow(hWnd) || !Attach(hWnd))
        return FALSE;
    PreSubclassWindow();
    InstallFrameworkProcedure(this, hWnd);
    return TRUE;
}

BOOL CWnd::SubclassDlgItem(UINT nID, CWnd* pParent)
{
    const HWND hWndControl = ::GetDlgItem(pParent->GetSafeHwnd(), static_cast<int>(nID));
    return hWndControl != NULL && SubclassWindow(hWndControl);
}

HWND CWnd::UnsubclassWindow()
{
    if (m_hWnd == NULL)
        return NULL;
    if (m_pfnSuper != NULL) {
        ::SetWindowLongPtrA(m_hWnd, GWLP_WNDPROC, reinterpret_cast<LONG_PTR>(m_pfnSuper));
        m_pfnSuper = NULL;
    }
    return Detach();
}

BOOL CWnd::DestroyWindow()
{
    if (m_hWnd == NULL)
        return FALSE;
    const HWND hWnd = m_hWnd;
    // An object attached through the framework's procedure is detached by
    // WM_NCDESTROY and may even be deleted by PostNcDestroy: it must not be
    // touched afterwards. Any other object (a temporary, or one attached to
    // a window of another procedure) lets go of the dead window here.
    const bool detachesItself = FromHandlePermanent(hWnd) == this && reinterpret_cast<WNDPROC>(::GetWindowLongPtrA(hWnd, GWLP_WNDPROC)) == AfxGetAfxWndProc();
    const BOOL result = ::DestroyWindow(hWnd);
    if (!detachesItself && m_hWnd == hWnd && !::IsWindow(hWnd))
        Detach();
    return result;
}

CWnd::~CWnd()
{
    if (m_hWnd != NULL && FromHandlePermanent(m_hWnd) == this) {
        // The derived parts are gone: only the framework's defaults handle the
        // destruction messages from here.
        CWnd::DestroyWindow();
    }
    if (m_hWnd != NULL)
        Detach();
}
