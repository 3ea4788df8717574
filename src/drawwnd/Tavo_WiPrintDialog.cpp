// Tavo_WiPrintDialog: relabels the page-range group of the print dialog for a
// grid of pages once the platform has filled the dialog's controls.
#include "Tavo_WiPrintDialog.h"

#include "Gui_Msg.h"
#include "Tavo_WiResourceIds.h"
#include "bryform.h"

namespace {

// Widens a button so that its right edge lines up with reference's.
void AlignRightEdge(CWnd* button, const CRect& reference)
{
    CRect rect(0, 0, 0, 0);
    button->GetWindowRect(&rect);
    button->SetWindowPos(nullptr, 0, 0, reference.right - rect.left, rect.Height(), SWP_NOMOVE | SWP_NOZORDER);
}

} // namespace

Tavo_WiPrintDialog::Tavo_WiPrintDialog(BOOL printSetupOnly, DWORD flags, CWnd* parent)
    : CPrintDialog(printSetupOnly, flags, parent)
{
}

Tavo_WiPrintDialog::~Tavo_WiPrintDialog() = default;

BOOL Tavo_WiPrintDialog::OnInitDialog()
{
    const BOOL result = CPrintDialog::OnInitDialog();
    if (!result)
        return 0;

    if (CWnd* first = GetDlgItem(FirstPageBoxId))
        first->SetWindowText("1");

    CRect reference(0, 0, 0, 0);
    bool haveReference = false;
    if (CWnd* last = GetDlgItem(LastPageBoxId)) {
        last->SetWindowText(bryform("%d", static_cast<int>(m_pd.nMaxPage)));
        last->GetWindowRect(&reference);
        haveReference = true;
    }

    // A dialog made without a window's layout labels the one-page layout.
    const int columns = m_layout ? m_layout->m_numCols : 1;
    const int rows = m_layout ? m_layout->m_numRows : 1;
    const int current = m_layout ? m_layout->m_currentPage : 1;
    if (CWnd* all = GetDlgItem(AllPagesButtonId)) {
        if (haveReference)
            AlignRightEdge(all, reference);
        all->SetWindowText((Gui_Msg(TAVO_WI_IDS_ALL_PAGES) << columns << rows).GetValue());
    }
    if (CWnd* currentPage = GetDlgItem(CurrentPageButtonId)) {
        if (haveReference)
            AlignRightEdge(currentPage, reference);
        currentPage->SetWindowText((Gui_Msg(TAVO_WI_IDS_CURRENT_PAGE) << current).GetValue());
    }
    CheckRadioButton(AllPagesButtonId, PageRangeButtonId, CurrentPageButtonId);
    return result;
}
