// print_test.cpp - CPrintDialog on the real print dialog, CPrintInfo and the
// application's printer defaults (the test machine has a default printer).
#include <afxext.h>
#include <winspool.h>

#include <gtest/gtest.h>

#include "framework_test_support.h"

namespace {

// Ids of the standard print dialog template's controls.
constexpr int kAllPagesButton = 1056;    // rad1
constexpr int kSelectionButton = 1057;   // rad2
constexpr int kPageRangeButton = 1058;   // rad3
constexpr UINT kCloseRequest = WM_APP + 40;

// A print dialog that looks at its real controls when it opens, then asks
// its own message map to close it.
class CInspectingPrintDialog : public CPrintDialog {
public:
  explicit CInspectingPrintDialog(UINT closeCommand)
      : CPrintDialog(FALSE, PD_SELECTION | PD_USEDEVMODECOPIES), m_closeCommand(closeCommand)
  {
  }

  int m_initCount = 0;
  bool m_attachedToDialog = false;
  UINT m_selectionChecked = 0;

  BOOL OnInitDialog() override
  {
    const BOOL result = CPrintDialog::OnInitDialog();
    ++m_initCount;
    m_attachedToDialog = ::IsWindow(m_hWnd) && CWnd::FromHandlePermanent(m_hWnd) == this;
    CheckRadioButton(kAllPagesButton, kPageRangeButton, kSelectionButton);
    m_selectionChecked = IsDlgButtonChecked(kSelectionButton);
    PostMessage(kCloseRequest);
    return result;
  }

protected:
  afx_msg LRESULT OnCloseRequest(WPARAM, LPARAM)
  {
    PostMessage(WM_COMMAND, MAKEWPARAM(m_closeCommand, BN_CLICKED), 0);
    return 0;
  }
  DECLARE_MESSAGE_MAP()

private:
  UINT m_closeCommand;
};

BEGIN_MESSAGE_MAP(CInspectingPrintDialog, CPrintDialog)
  ON_MESSAGE(kCloseRequest, &CInspectingPrintDialog::OnCloseRequest)
END_MESSAGE_MAP()

void FreePrinterHandles(PRINTDLG& pd)
{
  if (pd.hDC != NULL) ::DeleteDC(pd.hDC);
  if (pd.hDevMode != NULL) ::GlobalFree(pd.hDevMode);
  if (pd.hDevNames != NULL) ::GlobalFree(pd.hDevNames);
  pd.hDC = NULL;
  pd.hDevMode = pd.hDevNames = NULL;
}

class PrintTest : public framework_test::WindowTest {
protected:
  // Without a printer the system's print dialog would wait for the user to
  // dismiss its complaint, so the printer tests need one.
  void SetUp() override
  {
    char name[256] = {};
    DWORD length = sizeof(name);
    if (!::GetDefaultPrinterA(name, &length)) GTEST_SKIP() << "no default printer";
  }
};

}  // namespace

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
      EXPECT_TRUE(dialog.PrintSelection());  // the selection button was checked in OnInitDialog
      EXPECT_FALSE(dialog.GetDeviceName().IsEmpty());
    }
    FreePrinterHandles(dialog.m_pd);
  }
}

TEST_F(PrintTest, PrintInfoStartsWithFrameworkDialogFlagsAndFullPageRange)
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
  info.SetMaxPage(30);
  EXPECT_EQ(30u, info.m_pPD->m_pd.nMaxPage);
}

TEST_F(PrintTest, PrintInfoOwnsTheDialogPutInIt)
{
  struct CCountedDialog : CPrintDialog {
    explicit CCountedDialog(int& destroyed) : CPrintDialog(FALSE), m_destroyed(destroyed) {}
    ~CCountedDialog() override { ++m_destroyed; }
    int& m_destroyed;
  };
  int destroyed = 0;
  {
    CPrintInfo info;
    delete info.m_pPD;
    info.m_pPD = new CCountedDialog(destroyed);
  }
  EXPECT_EQ(1, destroyed);
}

TEST_F(PrintTest, ApplicationPrinterDefaultsAreTakenOnceAndKept)
{
  CWinApp app;
  PRINTDLG first = {};
  ASSERT_TRUE(app.GetPrinterDeviceDefaults(&first));
  EXPECT_NE(nullptr, first.hDevNames);
  EXPECT_NE(nullptr, first.hDevMode);
  PRINTDLG second = {};
  ASSERT_TRUE(app.GetPrinterDeviceDefaults(&second));
  EXPECT_EQ(first.hDevNames, second.hDevNames);
  EXPECT_EQ(first.hDevMode, second.hDevMode);
  EXPECT_EQ(app.m_hDevNames, first.hDevNames);
}

TEST_F(PrintTest, PrinterDcFromDefaultsGivesCapabilitiesAsAttributeHandle)
{
  CWinApp app;
  CPrintInfo info;
  ASSERT_TRUE(app.GetPrinterDeviceDefaults(&info.m_pPD->m_pd));
  const HDC printer = info.m_pPD->CreatePrinterDC();
  ASSERT_NE(nullptr, printer);
  EXPECT_EQ(printer, info.m_pPD->m_pd.hDC);
  // Drawing on the screen with the printer's measures, as a preview does.
  CDC dc;
  ASSERT_TRUE(dc.CreateCompatibleDC(NULL));
  dc.SetAttribDC(printer);
  EXPECT_EQ(DT_RASPRINTER, dc.GetDeviceCaps(TECHNOLOGY));
  EXPECT_EQ(::GetDeviceCaps(printer, HORZRES), dc.GetDeviceCaps(HORZRES));
  EXPECT_NE(::GetDeviceCaps(dc.m_hDC, HORZRES), dc.GetDeviceCaps(HORZRES));
  dc.ReleaseAttribDC();
  ::DeleteDC(printer);
  info.m_pPD->m_pd.hDC = NULL;
  info.m_pPD->m_pd.hDevMode = info.m_pPD->m_pd.hDevNames = NULL;  // the application's
}

TEST_F(PrintTest, ApplicationCreatesPrinterDcButDialogWithoutPrinterDataGivesNull)
{
  CWinApp app;
  CDC dc;
  ASSERT_TRUE(app.CreatePrinterDC(dc));
  EXPECT_EQ(DT_RASPRINTER, dc.GetDeviceCaps(TECHNOLOGY));
  CPrintDialog dialog(FALSE);
  EXPECT_EQ(nullptr, dialog.CreatePrinterDC());
}
