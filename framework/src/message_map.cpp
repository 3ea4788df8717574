// message_map.cpp - message-map dispatch: a window message is looked up in
// the object's message map and then in each base class's map, and the first
// matching entry's handler is called with the message unpacked for its
// signature. Also the default handlers of CWnd and the pre-translation walk.
#include "afx_internal.h"

using afx_internal::CurrentThreadState;

// ---------------------------------------------------------------------------
// The root maps
// ---------------------------------------------------------------------------

const AFX_MSGMAP* CCmdTarget::GetMessageMap() const { return GetThisMessageMap(); }

const AFX_MSGMAP* CCmdTarget::GetThisMessageMap()
{
    static const AFX_MSGMAP_ENTRY entries[] = {{0, 0, 0, 0, AfxSig_end, static_cast<AFX_PMSG>(nullptr)}};
    static const AFX_MSGMAP messageMap = {NULL, &entries[0]};
    return &messageMap;
}

BEGIN_MESSAGE_MAP(CWnd, CCmdTarget)
    ON_WM_NCDESTROY()
END_MESSAGE_MAP()

// ---------------------------------------------------------------------------
// Dispatch
// ---------------------------------------------------------------------------

namespace {

bool EntryMatches(const AFX_MSGMAP_ENTRY& entry, UINT message)
{
    if (entry.nMessage == AFX_REGISTERED_MESSAGE_CODE) {
        const auto* registeredId = reinterpret_cast<const UINT*>(entry.nSig);
        return registeredId != NULL && *registeredId != 0 && *registeredId == message;
    }
    return entry.nMessage == message;
}

const AFX_MSGMAP_ENTRY* FindEntry(const AFX_MSGMAP* map, UINT message)
{
    for (; map != NULL; map = map->pfnGetBaseMap != NULL ? map->pfnGetBaseMap() : NULL) {
        for (const AFX_MSGMAP_ENTRY* entry = map->lpEntries; entry->nSig != AfxSig_end; ++entry) {
            if (EntryMatches(*entry, message))
                return entry;
        }
    }
    return NULL;
}

// Calls the handler of entry for the message; the entry's signature says
// how wParam and lParam become the handler's arguments, and the handler
// pointer goes back to the type it had when the map was built.
PTM_WARNING_DISABLE
LRESULT CallHandler(CWnd* pWnd, const AFX_MSGMAP_ENTRY& entry, WPARAM wParam, LPARAM lParam)
{
    const AFX_PMSGW pfn = static_cast<AFX_PMSGW>(entry.pfn);
    if (entry.nMessage == AFX_REGISTERED_MESSAGE_CODE) {
        return (pWnd->*reinterpret_cast<LRESULT (CWnd::*)(WPARAM, LPARAM)>(pfn))(wParam, lParam);
    }
    const CPoint point(lParam);
    switch (entry.nSig) {
    case AfxSig_lwl:
        return (pWnd->*reinterpret_cast<LRESULT (CWnd::*)(WPARAM, LPARAM)>(pfn))(wParam, lParam);
    case AfxSig_vv:
        (pWnd->*pfn)();
        return 0;
    case AfxSig_is:
        return (pWnd->*reinterpret_cast<int (CWnd::*)(LPCREATESTRUCT)>(pfn))(reinterpret_cast<LPCREATESTRUCT>(lParam));
    case AfxSig_bD:
        return (pWnd->*reinterpret_cast<BOOL (CWnd::*)(CDC*)>(pfn))(CDC::FromHandle(reinterpret_cast<HDC>(wParam)));
    case AfxSig_vwii:
        (pWnd->*reinterpret_cast<void (CWnd::*)(UINT, int, int)>(pfn))(
            static_cast<UINT>(wParam), static_cast<short>(LOWORD(lParam)), static_cast<short>(HIWORD(lParam)));
        return 0;
    case AfxSig_vii:
        (pWnd->*reinterpret_cast<void (CWnd::*)(int, int)>(pfn))(static_cast<short>(LOWORD(lParam)),
                                                                 static_cast<short>(HIWORD(lParam)));
        return 0;
    case AfxSig_vwwx:
        (pWnd->*reinterpret_cast<void (CWnd::*)(UINT, UINT, CScrollBar*)>(pfn))(
            LOWORD(wParam), HIWORD(wParam), static_cast<CScrollBar*>(CWnd::FromHandle(reinterpret_cast<HWND>(lParam))));
        return 0;
    case AfxSig_vt:
        (pWnd->*reinterpret_cast<void (CWnd::*)(UINT_PTR)>(pfn))(static_cast<UINT_PTR>(wParam));
        return 0;
    case AfxSig_vwp:
        (pWnd->*reinterpret_cast<void (CWnd::*)(UINT, CPoint)>(pfn))(static_cast<UINT>(wParam), point);
        return 0;
    case AfxSig_bwsp:
        return (pWnd->*reinterpret_cast<BOOL (CWnd::*)(UINT, short, CPoint)>(pfn))(
            LOWORD(wParam), static_cast<short>(HIWORD(wParam)), point);
    case AfxSig_vW:
        (pWnd->*reinterpret_cast<void (CWnd::*)(CWnd*)>(pfn))(
            CWnd::FromHandle(reinterpret_cast<HWND>(entry.nMessage == WM_CAPTURECHANGED ? lParam : wParam)));
        return 0;
    case AfxSig_vPOS:
        (pWnd->*reinterpret_cast<void (CWnd::*)(WINDOWPOS*)>(pfn))(reinterpret_cast<WINDOWPOS*>(lParam));
        return 0;
    case AfxSig_vwww:
        (pWnd->*reinterpret_cast<void (CWnd::*)(UINT, UINT, UINT)>(pfn))(static_cast<UINT>(wParam), LOWORD(lParam),
                                                                         HIWORD(lParam));
        return 0;
    case AfxSig_bWww:
        return (pWnd->*reinterpret_cast<BOOL (CWnd::*)(CWnd*, UINT, UINT)>(pfn))(
            CWnd::FromHandle(reinterpret_cast<HWND>(wParam)), LOWORD(lParam), HIWORD(lParam));
    case AfxSig_iWww:
        return (pWnd->*reinterpret_cast<int (CWnd::*)(CWnd*, UINT, UINT)>(pfn))(
            CWnd::FromHandle(reinterpret_cast<HWND>(wParam)), LOWORD(lParam), HIWORD(lParam));
    case AfxSig_vMMI:
        (pWnd->*reinterpret_cast<void (CWnd::*)(MINMAXINFO*)>(pfn))(reinterpret_cast<MINMAXINFO*>(lParam));
        return 0;
    case AfxSig_vbw:
        (pWnd->*reinterpret_cast<void (CWnd::*)(BOOL, UINT)>(pfn))(static_cast<BOOL>(wParam),
                                                                   static_cast<UINT>(lParam));
        return 0;
    case AfxSig_lp:
        return (pWnd->*reinterpret_cast<LRESULT (CWnd::*)(CPoint)>(pfn))(point);
    case AfxSig_vWp:
        (pWnd->*reinterpret_cast<void (CWnd::*)(CWnd*, CPoint)>(pfn))(CWnd::FromHandle(reinterpret_cast<HWND>(wParam)),
                                                                      point);
        return 0;
    case AfxSig_wv:
        return (pWnd->*reinterpret_cast<UINT (CWnd::*)()>(pfn))();
    default:
        return 0;
    }
}
PTM_WARNING_RESTORE

} // namespace

BOOL CWnd::OnWndMsg(UINT message, WPARAM wParam, LPARAM lParam, LRESULT* pResult)
{
    const AFX_MSGMAP_ENTRY* entry = FindEntry(GetMessageMap(), message);
    if (entry == NULL)
        return FALSE;
    const LRESULT result = CallHandler(this, *entry, wParam, lParam);
    if (pResult != NULL)
        *pResult = result;
    return TRUE;
}

LRESULT CWnd::WindowProc(UINT message, WPARAM wParam, LPARAM lParam)
{
    LRESULT result = 0;
    if (!OnWndMsg(message, wParam, lParam, &result))
        result = DefWindowProc(message, wParam, lParam);
    return result;
}

LRESULT CWnd::DefWindowProc(UINT message, WPARAM wParam, LPARAM lParam)
{
    const WNDPROC super = *GetSuperWndProcAddr();
    if (super != NULL)
        return ::CallWindowProcA(super, m_hWnd, message, wParam, lParam);
    return ::DefWindowProcA(m_hWnd, message, wParam, lParam);
}

LRESULT CWnd::Default()
{
    const MSG& current = CurrentThreadState().currentMessage;
    return DefWindowProc(current.message, current.wParam, current.lParam);
}

// ---------------------------------------------------------------------------
// Pre-translation
// ---------------------------------------------------------------------------

BOOL CWnd::PreTranslateMessage(MSG* /*pMsg*/) { return FALSE; }

BOOL CWnd::WalkPreTranslateTree(HWND hWndStop, MSG* pMsg)
{
    if (pMsg == NULL)
        return FALSE;
    for (HWND hWnd = pMsg->hwnd; hWnd != NULL; hWnd = ::GetParent(hWnd)) {
        CWnd* pWnd = FromHandlePermanent(hWnd);
        if (pWnd != NULL && pWnd->PreTranslateMessage(pMsg))
            return TRUE;
        if (hWnd == hWndStop)
            break;
    }
    return FALSE;
}

// ---------------------------------------------------------------------------
// Default handlers
// ---------------------------------------------------------------------------

void CWnd::OnNcDestroy()
{
    // The end of the main window ends the application's message loop.
    CWinThread* thread = AfxGetThread();
    if (thread != NULL && thread->m_pMainWnd == this) {
        thread->m_pMainWnd = NULL;
        ::PostQuitMessage(0);
    }
    if (thread != NULL && thread->m_pActiveWnd == this)
        thread->m_pActiveWnd = NULL;
    Default();
    afx_internal::DetachDestroyedWindow(this);
}

int CWnd::OnCreate(LPCREATESTRUCT) { return static_cast<int>(Default()); }
void CWnd::OnDestroy() { Default(); }
void CWnd::OnClose() { Default(); }
void CWnd::OnPaint() { Default(); }
BOOL CWnd::OnEraseBkgnd(CDC*) { return static_cast<BOOL>(Default()); }
void CWnd::OnSize(UINT, int, int) { Default(); }
void CWnd::OnMove(int, int) { Default(); }
void CWnd::OnHScroll(UINT, UINT, CScrollBar*) { Default(); }
void CWnd::OnVScroll(UINT, UINT, CScrollBar*) { Default(); }
void CWnd::OnTimer(UINT_PTR) { Default(); }
void CWnd::OnMouseMove(UINT, CPoint) { Default(); }
void CWnd::OnLButtonDown(UINT, CPoint) { Default(); }
void CWnd::OnLButtonUp(UINT, CPoint) { Default(); }
void CWnd::OnLButtonDblClk(UINT, CPoint) { Default(); }
void CWnd::OnRButtonDown(UINT, CPoint) { Default(); }
void CWnd::OnRButtonUp(UINT, CPoint) { Default(); }
void CWnd::OnRButtonDblClk(UINT, CPoint) { Default(); }
void CWnd::OnMButtonDown(UINT, CPoint) { Default(); }
void CWnd::OnMButtonUp(UINT, CPoint) { Default(); }
void CWnd::OnMButtonDblClk(UINT, CPoint) { Default(); }
BOOL CWnd::OnMouseWheel(UINT, short, CPoint) { return static_cast<BOOL>(Default()); }
void CWnd::OnCaptureChanged(CWnd*) { Default(); }
void CWnd::OnSetFocus(CWnd*) { Default(); }
void CWnd::OnKillFocus(CWnd*) { Default(); }
void CWnd::OnWindowPosChanged(WINDOWPOS*) { Default(); }
void CWnd::OnWindowPosChanging(WINDOWPOS*) { Default(); }
void CWnd::OnKeyDown(UINT, UINT, UINT) { Default(); }
void CWnd::OnKeyUp(UINT, UINT, UINT) { Default(); }
void CWnd::OnChar(UINT, UINT, UINT) { Default(); }
BOOL CWnd::OnSetCursor(CWnd*, UINT, UINT) { return static_cast<BOOL>(Default()); }
int CWnd::OnMouseActivate(CWnd*, UINT, UINT) { return static_cast<int>(Default()); }
void CWnd::OnGetMinMaxInfo(MINMAXINFO*) { Default(); }
void CWnd::OnShowWindow(BOOL, UINT) { Default(); }
LRESULT CWnd::OnNcHitTest(CPoint) { return Default(); }
void CWnd::OnContextMenu(CWnd*, CPoint) { Default(); }
void CWnd::OnCancelMode() { Default(); }
UINT CWnd::OnGetDlgCode() { return static_cast<UINT>(Default()); }
