// print_test.cpp - CPrintDialog on the real print dialog, CPrintInfo and the
// application's printer defaults (the test machine has a default printer).
#include <afxext.h>
#include <winspool.h>

#include <gtest/gtest.h>

#include "framework_test_support.h"

namespace {

// Ids of the standard print dialog template's radio buttons.
constexpr int kAllPagesButton = 1056;  // rad1
constexpr int kSelectionButton = 1057; // rad2
constexpr int kPageRangeButton = 1058; // rad3

// A print dialog that looks at its real controls when it opens, then closes
// itself from there.
class CInspectingPrintDialog : public CPrintDialog {
public:
    explicit CInspectingPrintDialog(UINT closeCommand)
        : CPrintDialog(FALSE, PD_SELECTION | PD_USEDEVMODECOPIES), m_closeCommand(closeCommand)
    {}

    int m_initCount = 0;
    bool m_attachedToDialog = false;
    UINT m_selectionChecked = 0;

    BOOL OnInitDialog() override
    {
        const BOOL result = CPrintDialog::OnInitDialog();
        ++m_initCount;
        // Attached and subclassed, so the dialog's messages reach this object.
        m_attachedToDialog = CWnd::FromHandlePermanent(m_hWnd) == this && ::GetWindowLongPtrA(m_hWnd, GWLP_WNDPROC) == reinterpret_cast<LONG_PTR>(AfxGetAfxWndProc());
        CheckRadioButton(kAllPagesButton, kPageRangeButton, kSelectionButton);
        m_selectionChecked = IsDlgButtonChecked(kSelectionButton);
        PostMessage(WM_COMMAND, MAKEWPARAM(m_closeCommand, BN_CLICKED), 0);
        return result;
    }

private:
    const UINT m_closeCommand;
};

class PrintTest : public framework_test::WindowTest {
protected:
    // Without a printer the system's print dialog would wait for the user to
    // dismiss its complaint, so the printer tests need one.
    void SetUp() override
    {
        char name[256] = {};
        DWORD length = sizeof(name);
        if (!::GetDefaultPrinterA(name, &length))
            GTEST_SKIP() << "no default printer";
    }
};

} // namespace

TEST_F(PrintTest, DialogInitialisesOnTheRealDialogAndClosesFromThere)
{
    for (const UINT closeCommand : {IDCANCEL, IDOK}) {
        SCOPED_TRACE(closeCommand == IDOK ? "confirmed" : "cancelled");
        CInspectingPrintDialog dialog(closeCommand);
        dialog.m_pd.nMinPage = 1;
        dialog.m_pd.nMaxPage = 30;
        ASSERT_EQ(static_cast<INT_PTR>(closeCommand), dialog.DoModal());
        EXPECT_EQ(1, dialog.m_initCount);
        EXPECT_TRUE(dialog.m_attachedToDialog);
        EXPECT_EQ(static_cast<UINT>(BST_CHECKED), dialog.m_selectionChecked);
        EXPECT_EQ(nullptr, dialog.m_hWnd);
        if (closeCommand == IDOK) {
            EXPECT_NE(nullptr, dialog.GetPrinterDC());
            EXPECT_TRUE(dialog.PrintSelection()); // the selection button was checked in OnInitDialog
            EXPECT_FALSE(dialog.GetDeviceName().IsEmpty());
        }
        // The printer handles belong to the caller.
        ::DeleteDC(dialog.m_pd.hDC);
        ::GlobalFree(dialog.m_pd.hDevMode);
        ::GlobalFree(dialog.m_pd.hDevNames);
    }
}

TEST_F(PrintTest, PrintInfoMakesItsDialogWithFrameworkFlagsAndFullPageRangeAndOwnsIt)
{
    struct CCountedDialog : CPrintDialog {
        explicit CCountedDialog(int& destroyed) : CPrintDialog(FALSE), m_destroyed(destroyed) {}
        ~CCountedDialog() override { ++m_destroyed; }
        int& m_destroyed;
    };
    int destroyed = 0;
    {
        CPrintInfo info;
        ASSERT_NE(nullptr, info.m_pPD);
        const DWORD flags = info.m_pPD->m_pd.Flags;
        EXPECT_EQ(static_cast<DWORD>(PD_USEDEVMODECOPIES | PD_NOSELECTION | PD_RETURNDC),
                  flags & static_cast<DWORD>(PD_USEDEVMODECOPIES | PD_NOSELECTION | PD_RETURNDC | PD_PRINTSETUP));
        EXPECT_EQ(1u, info.GetMinPage());
        EXPECT_EQ(0xFFFFu, info.GetMaxPage());
        EXPECT_EQ(1u, info.GetFromPage());
        EXPECT_EQ(0xFFFFu, info.GetToPage());
        delete info.m_pPD;
        info.m_pPD = new CCountedDialog(destroyed);
    }
    EXPECT_EQ(1, destroyed);
}

TEST_F(PrintTest, ApplicationKeepsOnePrinterDefaultAndPrinterDcsComeFromIt)
{
    CWinApp app;
    CPrintInfo info;
    PRINTDLG& pd = info.m_pPD->m_pd;
    EXPECT_EQ(nullptr, info.m_pPD->CreatePrinterDC()); // no printer data yet
    ASSERT_TRUE(app.GetPrinterDeviceDefaults(&pd));
    EXPECT_NE(nullptr, pd.hDevMode);
    PRINTDLG again = {};
    ASSERT_TRUE(app.GetPrinterDeviceDefaults(&again)); // lent again, not taken anew
    EXPECT_EQ(app.m_hDevNames, pd.hDevNames);
    EXPECT_EQ(pd.hDevNames, again.hDevNames);
    EXPECT_EQ(pd.hDevMode, again.hDevMode);

    const HDC printer = info.m_pPD->CreatePrinterDC();
    ASSERT_NE(nullptr, printer);
    EXPECT_EQ(printer, pd.hDC);
    // Drawing on the screen with the printer's measures, as a preview does.
    CDC dc;
    ASSERT_TRUE(dc.CreateCompatibleDC(NULL));
    dc.SetAttribDC(printer);
    EXPECT_EQ(DT_RASPRINTER, dc.GetDeviceCaps(TECHNOLOGY));
    EXPECT_EQ(::GetDeviceCaps(printer, HORZRES), dc.GetDeviceCaps(HORZRES));
    EXPECT_NE(::GetDeviceCaps(dc.m_hDC, HORZRES), dc.GetDeviceCaps(HORZRES));
    dc.ReleaseAttribDC();
    ::DeleteDC(printer);
    CDC appPrinter;
    ASSERT_TRUE(app.CreatePrinterDC(appPrinter));
    EXPECT_EQ(DT_RASPRINTER, appPrinter.GetDeviceCaps(TECHNOLOGY));
}

TEST_F(PrintTest, ApplicationShowsTheDialogOnItsDefaultsAndKeepsWhatWasChosen)
{
    CWinApp app;
    CInspectingPrintDialog dialog(IDOK);
    dialog.m_pd.nMinPage = 1;
    dialog.m_pd.nMaxPage = 30;
    ASSERT_EQ(IDOK, app.DoPrintDialog(&dialog));
    EXPECT_EQ(1, dialog.m_initCount);
    ASSERT_NE(nullptr, app.m_hDevNames);
    EXPECT_EQ(app.m_hDevNames, dialog.m_pd.hDevNames);
    EXPECT_EQ(app.m_hDevMode, dialog.m_pd.hDevMode);
    PRINTDLG lent = {};
    ASSERT_TRUE(app.GetPrinterDeviceDefaults(&lent));
    EXPECT_EQ(dialog.m_pd.hDevNames, lent.hDevNames);
    // The printer DC is the caller's; the printer handles stay the application's.
    EXPECT_NE(nullptr, dialog.GetPrinterDC());
    ::DeleteDC(dialog.m_pd.hDC);
    EXPECT_EQ(IDCANCEL, app.DoPrintDialog(NULL));
}
