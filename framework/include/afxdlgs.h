// afxdlgs.h - the common dialogs of the framework.
//
// Classes: CCommonDialog, CPrintDialog.
#ifndef TAVO_FRAMEWORK_AFXDLGS_H
#define TAVO_FRAMEWORK_AFXDLGS_H

#include "afxwin.h"
#include <commdlg.h>

class AFX_FRAMEWORK_CLASS CCommonDialog : public CDialog {
public:
    explicit CCommonDialog(CWnd* pParentWnd) : CDialog(pParentWnd) {}
    ~CCommonDialog() override = default;
};

// The system's print dialog (PrintDlg). While DoModal shows it, this object
// is attached to the real dialog window, so GetDlgItem, SetWindowText and
// the message map work on it, and the virtual OnInitDialog runs once the
// dialog has initialised its controls.
//
// The handles PrintDlg returns in m_pd (hDC, hDevMode, hDevNames) belong to
// the caller: this class never frees them.
class AFX_FRAMEWORK_CLASS CPrintDialog : public CCommonDialog {
public:
    PRINTDLG m_pd;

    explicit CPrintDialog(BOOL bPrintSetupOnly,
                          DWORD dwFlags = PD_ALLPAGES | PD_USEDEVMODECOPIES | PD_NOPAGENUMS | PD_HIDEPRINTTOFILE | PD_NOSELECTION,
                          CWnd* pParentWnd = NULL);
    ~CPrintDialog() override = default;

    // Shows the dialog: IDOK when the user confirmed it, else IDCANCEL.
    virtual INT_PTR DoModal();
    // Fills m_pd with the default printer without showing anything.
    BOOL GetDefaults();
    // A DC for the printer of m_pd.hDevNames/hDevMode, also stored in
    // m_pd.hDC; NULL without printer data. The caller deletes it.
    HDC CreatePrinterDC();
    HDC GetPrinterDC() const;
    LPDEVMODE GetDevMode() const; // locks m_pd.hDevMode; NULL without one
    CString GetDriverName() const;
    CString GetDeviceName() const;
    CString GetPortName() const;
    int GetCopies() const;
    BOOL PrintAll() const;
    BOOL PrintRange() const;
    BOOL PrintSelection() const;
    int GetFromPage() const;
    int GetToPage() const;
};

#endif // TAVO_FRAMEWORK_AFXDLGS_H
