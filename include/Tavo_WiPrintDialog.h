// Tavo_WiPrintDialog: the platform's print dialog with its page-range group
// relabelled for a grid of pages.
//
// The selection choice becomes "the current page" and is selected when the
// dialog opens; the all-pages choice names the size of the grid; the page
// boxes start at 1 and at the number of pages. Tavo_WiDrawWnd's
// OnPreparePrinting creates it, links it to the window's print layout and
// hands it to the CPrintInfo record, which owns it from then on.
#pragma once

#include <afxdlgs.h>

#include "Tavo_WiPrintLayout.h"

class AFX_EXT_CLASS Tavo_WiPrintDialog : public CPrintDialog {
public:
    // Control ids of the standard print dialog template.
    static constexpr int FirstPageBoxId = 1152;      // edt1
    static constexpr int LastPageBoxId = 1153;       // edt2
    static constexpr int AllPagesButtonId = 1056;    // rad1
    static constexpr int CurrentPageButtonId = 1057; // rad2, the template's selection choice
    static constexpr int PageRangeButtonId = 1058;   // rad3

    Tavo_WiPrintDialog(BOOL printSetupOnly, DWORD flags, CWnd* parent);
    virtual ~Tavo_WiPrintDialog();

    BOOL OnInitDialog() override;

    // The layout of the window that made the dialog; not owned. It must
    // outlive the dialog, as the window does.
    const Tavo_WiPrintLayout* m_layout = nullptr;
};
