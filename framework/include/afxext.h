// afxext.h - framework extensions: the print job record (CPrintInfo).
//
// Classes: CPrintInfo.
#ifndef TAVO_FRAMEWORK_AFXEXT_H
#define TAVO_FRAMEWORK_AFXEXT_H

#include "afxwin.h"
#include "afxdlgs.h"

// The state of one print job, handed to a view's print protocol
// (OnPreparePrinting, OnBeginPrinting, OnPrint, OnEndPrinting).
//
// Owns m_pPD: the constructor creates a print dialog (not a setup dialog)
// with PD_ALLPAGES | PD_USEDEVMODECOPIES | PD_NOSELECTION, pages 1 to 0xFFFF;
// whoever replaces it deletes the old one first, and the destructor deletes
// the dialog there is. The printer DC in m_pPD->m_pd.hDC belongs to the code
// that asked for it and is not deleted here.
struct AFX_FRAMEWORK_CLASS CPrintInfo {
    CPrintInfo();
    ~CPrintInfo();
    CPrintInfo(const CPrintInfo&) = delete;
    CPrintInfo& operator=(const CPrintInfo&) = delete;

    CPrintDialog* m_pPD = NULL; // owned
    BOOL m_bDocObject = FALSE;
    DWORD m_dwFlags = 0;
    UINT m_nOffsetPage = 0;
    BOOL m_bDirect = FALSE; // print without showing the dialog
    BOOL m_bPreview = FALSE;
    BOOL m_bContinuePrinting = TRUE;
    UINT m_nCurPage = 1;
    UINT m_nNumPreviewPages = 0;
    CString m_strPageDesc;
    LPVOID m_lpUserData = NULL; // not owned
    CRect m_rectDraw;
    int m_nJobNumber = 0;

    void SetMinPage(UINT nMinPage);
    void SetMaxPage(UINT nMaxPage);
    UINT GetMinPage() const;
    UINT GetMaxPage() const;
    UINT GetFromPage() const;
    UINT GetToPage() const;
    UINT GetOffsetPage() const;
};

#endif // TAVO_FRAMEWORK_AFXEXT_H
