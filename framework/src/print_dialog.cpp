// print_dialog.cpp - CPrintDialog over PrintDlg: the dialog object is
// attached to the real dialog window from WM_INITDIALOG until the dialog
// is destroyed, and its OnInitDialog runs once the system's own
// initialisation of the controls is done.
#include <afxdlgs.h>

namespace {

// The dialog object that DoModal is showing on this thread; the hook
// attaches it to the dialog window when that window initialises.
thread_local CPrintDialog* t_dialogBeingShown = NULL;

UINT_PTR CALLBACK PrintDialogHook(HWND hDlg, UINT message, WPARAM, LPARAM)
{
    if (message != WM_INITDIALOG)
        return 0;
    CPrintDialog* dialog = t_dialogBeingShown;
    // The hook also sees dialogs opened from this one (printer setup): only
    // the first one belongs to the object.
    if (dialog == NULL || dialog->m_hWnd != NULL)
        return TRUE;
    t_dialogBeingShown = NULL;
    if (!dialog->SubclassWindow(hDlg))
        return TRUE;
    try {
        return static_cast<UINT_PTR>(dialog->OnInitDialog());
    } catch (CException* e) {
        e->Delete();
    } catch (...) {
    }
    return TRUE;
}

struct DevNamesView {
    explicit DevNamesView(HGLOBAL hDevNames)
        : m_handle(hDevNames), m_names(static_cast<const DEVNAMES*>(hDevNames ? ::GlobalLock(hDevNames) : NULL))
    {}
    ~DevNamesView()
    {
        if (m_names != NULL)
            ::GlobalUnlock(m_handle);
    }
    DevNamesView(const DevNamesView&) = delete;
    DevNamesView& operator=(const DevNamesView&) = delete;

    // The string at a DEVNAMES offset (counted in characters from the start).
    LPCSTR At(WORD offset) const { return m_names == NULL ? NULL : reinterpret_cast<LPCSTR>(m_names) + offset; }
    const DEVNAMES* Get() const { return m_names; }

private:
    HGLOBAL m_handle;
    const DEVNAMES* m_names;
};

} // namespace

CPrintDialog::CPrintDialog(BOOL bPrintSetupOnly, DWORD dwFlags, CWnd* pParentWnd) : CCommonDialog(pParentWnd), m_pd()
{
    m_pd.lStructSize = sizeof(m_pd);
    m_pd.Flags = dwFlags;
    m_pd.lpfnPrintHook = PrintDialogHook;
    m_pd.lpfnSetupHook = PrintDialogHook;
    if (bPrintSetupOnly) {
        m_pd.Flags |= PD_PRINTSETUP | PD_ENABLESETUPHOOK;
    } else {
        m_pd.Flags |= PD_RETURNDC | PD_ENABLEPRINTHOOK;
    }
    m_pd.Flags &= ~static_cast<DWORD>(PD_RETURNIC); // information contexts are not offered
}

INT_PTR CPrintDialog::DoModal()
{
    const HWND previousOwner = m_pd.hwndOwner;
    if (m_pd.hwndOwner == NULL) {
        CWnd* owner = m_pParentWnd != NULL ? m_pParentWnd : AfxGetMainWnd();
        m_pd.hwndOwner = owner->GetSafeHwnd();
    }
    CPrintDialog* const outer = t_dialogBeingShown;
    t_dialogBeingShown = this;
    const BOOL confirmed = ::PrintDlgA(&m_pd);
    t_dialogBeingShown = outer;
    m_pd.hwndOwner = previousOwner;
    // The window is gone; WM_NCDESTROY has normally detached the object.
    if (m_hWnd != NULL)
        Detach();
    m_pfnSuper = NULL;
    return confirmed ? IDOK : IDCANCEL;
}

BOOL CPrintDialog::GetDefaults()
{
    m_pd.Flags |= PD_RETURNDEFAULT;
    const BOOL found = ::PrintDlgA(&m_pd);
    m_pd.Flags &= ~static_cast<DWORD>(PD_RETURNDEFAULT);
    return found;
}

HDC CPrintDialog::CreatePrinterDC()
{
    DevNamesView names(m_pd.hDevNames);
    if (names.Get() == NULL)
        return NULL;
    const auto* devMode = static_cast<const DEVMODEA*>(m_pd.hDevMode ? ::GlobalLock(m_pd.hDevMode) : NULL);
    m_pd.hDC = ::CreateDCA(names.At(names.Get()->wDriverOffset), names.At(names.Get()->wDeviceOffset), NULL, devMode);
    if (devMode != NULL)
        ::GlobalUnlock(m_pd.hDevMode);
    return m_pd.hDC;
}

HDC CPrintDialog::GetPrinterDC() const { return m_pd.hDC; }

LPDEVMODE CPrintDialog::GetDevMode() const
{
    return m_pd.hDevMode == NULL ? NULL : static_cast<LPDEVMODE>(::GlobalLock(m_pd.hDevMode));
}

CString CPrintDialog::GetDriverName() const
{
    DevNamesView names(m_pd.hDevNames);
    return names.Get() == NULL ? CString() : CString(names.At(names.Get()->wDriverOffset));
}

CString CPrintDialog::GetDeviceName() const
{
    DevNamesView names(m_pd.hDevNames);
    return names.Get() == NULL ? CString() : CString(names.At(names.Get()->wDeviceOffset));
}

CString CPrintDialog::GetPortName() const
{
    DevNamesView names(m_pd.hDevNames);
    return names.Get() == NULL ? CString() : CString(names.At(names.Get()->wOutputOffset));
}

int CPrintDialog::GetCopies() const
{
    if ((m_pd.Flags & PD_USEDEVMODECOPIES) != 0) {
        const LPDEVMODE devMode = GetDevMode();
        if (devMode != NULL) {
            const int copies = devMode->dmCopies;
            ::GlobalUnlock(m_pd.hDevMode);
            return copies;
        }
    }
    return m_pd.nCopies;
}

BOOL CPrintDialog::PrintAll() const { return !PrintRange() && !PrintSelection(); }
BOOL CPrintDialog::PrintRange() const { return (m_pd.Flags & PD_PAGENUMS) != 0; }
BOOL CPrintDialog::PrintSelection() const { return (m_pd.Flags & PD_SELECTION) != 0; }
int CPrintDialog::GetFromPage() const { return PrintRange() ? m_pd.nFromPage : -1; }
int CPrintDialog::GetToPage() const { return PrintRange() ? m_pd.nToPage : -1; }
