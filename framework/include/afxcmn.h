// afxcmn.h - the framework's wrappers of the common controls.
//
// Classes: CStatusBarCtrl.
#ifndef TAVO_FRAMEWORK_AFXCMN_H
#define TAVO_FRAMEWORK_AFXCMN_H

#include "afxwin.h"
#include <commctrl.h>

// The common status bar control (STATUSCLASSNAME): a strip along the bottom
// of its parent, divided into parts that each show one text. The control
// places and sizes itself: it takes its parent's width and its own height
// whenever it receives WM_SIZE, so the rectangle given to Create is ignored
// and a parent passes its WM_SIZE on to it.
class AFX_FRAMEWORK_CLASS CStatusBarCtrl : public CWnd {
public:
    CStatusBarCtrl() = default;
    ~CStatusBarCtrl() override = default;

    // Registers the common controls' bar classes first (once per process).
    // dwStyle gets WS_CHILD.
    virtual BOOL Create(DWORD dwStyle, const RECT& rect, CWnd* pParentWnd, UINT nID);

    // nParts parts whose right edges, in client coordinates, are pWidths;
    // -1 extends a part to the right edge. At most 255 parts.
    BOOL SetParts(int nParts, int* pWidths);
    // Copies up to nParts right edges into pParts (may be NULL); returns the
    // number of parts.
    int GetParts(int nParts, int* pParts) const;
    // nType: 0 (sunken), SBT_NOBORDERS, SBT_POPOUT, SBT_RTLREADING.
    BOOL SetText(LPCTSTR lpszText, int nPane, int nType);
    CString GetText(int nPane, int* pType = NULL) const;
    int GetTextLength(int nPane, int* pType = NULL) const;
    BOOL GetRect(int nPane, LPRECT lpRect) const;
    void SetMinHeight(int nMin);
    void SetSimple(BOOL bSimple = TRUE);
    BOOL IsSimple() const;

private:
    // The window's own Create replaces the general one, which stays out of reach.
    using CWnd::Create;
};

#endif // TAVO_FRAMEWORK_AFXCMN_H
