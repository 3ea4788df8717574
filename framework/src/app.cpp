// app.cpp - CWinApp: the current application object, its printer defaults
// and its cursors.
#include <afxwin.h>
#include <afxdlgs.h>

namespace {
CWinApp* g_currentApp = NULL; // not owned
} // namespace

CWinApp* AfxGetApp() { return g_currentApp; }

// The framework keeps one user-interface thread: the application's.
CWinThread* AfxGetThread() { return g_currentApp; }

CWnd* AfxGetMainWnd()
{
    CWinThread* thread = AfxGetThread();
    return thread != NULL ? thread->GetMainWnd() : NULL;
}

CWinApp::CWinApp(LPCTSTR lpszAppName)
    : m_pszAppName(lpszAppName), m_hInstance(::GetModuleHandleA(NULL)), m_pPreviousApp(g_currentApp)
{
    g_currentApp = this;
}

CWinApp::~CWinApp()
{
    if (m_hDevMode != NULL)
        ::GlobalFree(m_hDevMode);
    if (m_hDevNames != NULL)
        ::GlobalFree(m_hDevNames);
    if (g_currentApp == this)
        g_currentApp = m_pPreviousApp;
}

BOOL CWinApp::InitInstance() { return TRUE; }

int CWinApp::ExitInstance() { return CWinThread::ExitInstance(); }

int CWinApp::Run() { return CWinThread::Run(); }

void CWinApp::UpdatePrinterSelection(BOOL bForceDefaults)
{
    if (!bForceDefaults && m_hDevNames != NULL)
        return;
    CPrintDialog defaults(TRUE);
    if (!defaults.GetDefaults())
        return;
    if (m_hDevMode != NULL)
        ::GlobalFree(m_hDevMode);
    if (m_hDevNames != NULL)
        ::GlobalFree(m_hDevNames);
    m_hDevMode = defaults.m_pd.hDevMode;
    m_hDevNames = defaults.m_pd.hDevNames;
}

BOOL CWinApp::GetPrinterDeviceDefaults(PRINTDLG* pPrintDlg)
{
    if (pPrintDlg == NULL)
        return FALSE;
    UpdatePrinterSelection(m_hDevNames == NULL);
    if (m_hDevNames == NULL)
        return FALSE;
    pPrintDlg->hDevNames = m_hDevNames;
    pPrintDlg->hDevMode = m_hDevMode;
    return TRUE;
}

int CWinApp::DoPrintDialog(CPrintDialog* pPD)
{
    if (pPD == NULL)
        return IDCANCEL;
    UpdatePrinterSelection(FALSE);
    pPD->m_pd.hDevMode = m_hDevMode;
    pPD->m_pd.hDevNames = m_hDevNames;
    INT_PTR response = pPD->DoModal();
    if (response != IDOK) {
        // Defaults that name a printer that is gone or changed: take fresh
        // ones and ask again, once.
        const DWORD error = ::CommDlgExtendedError();
        if (error == PDERR_PRINTERNOTFOUND || error == PDERR_DNDMMISMATCH || error == PDERR_DEFAULTDIFFERENT) {
            UpdatePrinterSelection(TRUE);
            pPD->m_pd.hDevMode = m_hDevMode;
            pPD->m_pd.hDevNames = m_hDevNames;
            response = pPD->DoModal();
        }
    }
    // PrintDlg may have reallocated the handles or replaced them with those
    // of another printer; they are the application's defaults from now on.
    m_hDevMode = pPD->m_pd.hDevMode;
    m_hDevNames = pPD->m_pd.hDevNames;
    return static_cast<int>(response);
}

BOOL CWinApp::CreatePrinterDC(CDC& dc)
{
    CPrintDialog printer(FALSE);
    if (!GetPrinterDeviceDefaults(&printer.m_pd))
        return FALSE;
    const HDC hDC = printer.CreatePrinterDC();
    if (hDC == NULL)
        return FALSE;
    if (!dc.Attach(hDC)) {
        ::DeleteDC(hDC);
        return FALSE;
    }
    return TRUE;
}

HCURSOR CWinApp::LoadCursor(LPCTSTR lpszResourceName) const
{
    return ::LoadCursorA(AfxFindResourceHandle(lpszResourceName, RT_GROUP_CURSOR), lpszResourceName);
}

HCURSOR CWinApp::LoadCursor(UINT nIDResource) const { return LoadCursor(MAKEINTRESOURCEA(nIDResource)); }

HCURSOR CWinApp::LoadStandardCursor(LPCTSTR lpszCursorName) const { return ::LoadCursorA(NULL, lpszCursorName); }
