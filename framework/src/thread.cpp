// thread.cpp - CWinThread: the message loop that offers every message to
// the windows' PreTranslateMessage before dispatching it, and idle time.
#include "afx_internal.h"

namespace {

// WM_SYSTIMER: the caret's blink timer; like paint messages it does not
// count as activity that restarts idle processing.
constexpr UINT kSystemTimerMessage = 0x0118;

} // namespace

CWinThread::CWinThread() : m_nThreadID(::GetCurrentThreadId()) {}

CWnd* CWinThread::GetMainWnd() { return m_pMainWnd; }

BOOL CWinThread::InitInstance() { return TRUE; }

int CWinThread::ExitInstance() { return static_cast<int>(m_msgCur.wParam); }

int CWinThread::Run()
{
    BOOL idle = TRUE;
    LONG idleCount = 0;
    for (;;) {
        while (idle && !::PeekMessageA(&m_msgCur, NULL, 0, 0, PM_NOREMOVE)) {
            if (!OnIdle(idleCount++))
                idle = FALSE;
        }
        do {
            if (!PumpMessage())
                return ExitInstance();
            if (IsIdleMessage(&m_msgCur)) {
                idle = TRUE;
                idleCount = 0;
            }
        } while (::PeekMessageA(&m_msgCur, NULL, 0, 0, PM_NOREMOVE));
    }
}

BOOL CWinThread::PumpMessage()
{
    if (!::GetMessageA(&m_msgCur, NULL, 0, 0))
        return FALSE;
    if (!PreTranslateMessage(&m_msgCur)) {
        ::TranslateMessage(&m_msgCur);
        ::DispatchMessageA(&m_msgCur);
    }
    return TRUE;
}

BOOL CWinThread::PreTranslateMessage(MSG* pMsg)
{
    CWnd* mainWnd = GetMainWnd();
    if (CWnd::WalkPreTranslateTree(mainWnd->GetSafeHwnd(), pMsg))
        return TRUE;
    // A message for a window outside the main window (a popup, a modeless
    // dialog) still gets the main window's look.
    if (mainWnd != NULL && mainWnd->m_hWnd != NULL && pMsg->hwnd != NULL) {
        CWnd* target = CWnd::FromHandle(pMsg->hwnd);
        if (target->GetTopLevelParent() != mainWnd)
            return mainWnd->PreTranslateMessage(pMsg);
    }
    return FALSE;
}

BOOL CWinThread::OnIdle(LONG lCount)
{
    if (lCount <= 0)
        return TRUE; // one more round, then the clean-up
    AfxLockTempMaps();
    AfxUnlockTempMaps(TRUE);
    return FALSE;
}

BOOL CWinThread::IsIdleMessage(MSG* pMsg)
{
    // A mouse move to the same place, a paint or a caret blink is no activity.
    if (pMsg->message == WM_MOUSEMOVE || pMsg->message == WM_NCMOUSEMOVE) {
        const CPoint point(pMsg->pt);
        if (m_ptCursorLast == point && pMsg->message == m_nMsgLast)
            return FALSE;
        m_ptCursorLast = point;
        m_nMsgLast = pMsg->message;
        return TRUE;
    }
    return pMsg->message != WM_PAINT && pMsg->message != kSystemTimerMessage;
}

BOOL AfxPumpMessage()
{
    if (CWinThread* thread = AfxGetThread())
        return thread->PumpMessage();
    MSG msg = {};
    if (!::GetMessageA(&msg, NULL, 0, 0))
        return FALSE;
    if (!CWnd::WalkPreTranslateTree(NULL, &msg)) {
        ::TranslateMessage(&msg);
        ::DispatchMessageA(&msg);
    }
    return TRUE;
}
