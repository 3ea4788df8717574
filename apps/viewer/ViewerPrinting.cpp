#include "ViewerPrinting.h"

#include "DrawingView.h"

#include <afxext.h>

#include <algorithm>

namespace ViewerPrinting {

namespace {

// The port of printers that write to a file.
constexpr char FilePort[] = "FILE:";

// The pages the dialog chose: a range as given (within the grid), the
// current page as OnBeginPrinting turned it into a range, or all of them.
void ChosenPages(const CPrintInfo& info, UINT& first, UINT& last)
{
    const PRINTDLG& pd = info.m_pPD->m_pd;
    const UINT lastPage = std::max<UINT>(pd.nMaxPage, 1);
    if ((pd.Flags & (PD_PAGENUMS | PD_SELECTION)) != 0) {
        first = std::clamp<UINT>(pd.nFromPage, 1, lastPage);
        last = std::clamp<UINT>(pd.nToPage, first, lastPage);
        return;
    }
    first = 1;
    last = lastPage;
}

Result Failure(const std::string& message)
{
    Result result;
    result.outcome = Outcome::Failed;
    result.message = message;
    return result;
}

} // namespace

Result PrintView(DrawingView& view, CWnd* owner, const std::string& title, const std::string& outputFile,
                 const AskOutputFile& askOutput)
{
    if (!view.GetDrawing())
        return Failure("There is no drawing to print.");
    // The application object holds the printer settings between jobs.
    CWinApp* app = AfxGetApp();
    if (!app)
        return Failure("There is no application object to keep the printer settings.");
    CPrintInfo info;
    view.OnPreparePrinting(&info);
    CPrintDialog& dialog = *info.m_pPD;
    dialog.m_pd.hwndOwner = owner ? owner->GetSafeHwnd() : nullptr;
    // The dialog runs on the application's printer defaults, which then keep
    // the printer and settings the person chose.
    if (app->DoPrintDialog(&dialog) != IDOK) {
        Result cancelled;
        cancelled.outcome = Outcome::Cancelled;
        cancelled.message = "Printing cancelled.";
        return cancelled;
    }

    // The printer's device context is the job's; it is deleted with printer.
    CDC printer;
    if (!dialog.m_pd.hDC || !printer.Attach(dialog.m_pd.hDC))
        return Failure("The printer gave no device context.");
    dialog.m_pd.hDC = nullptr;

    Result result;
    result.columns = view.GetPrintLayout().m_numCols;
    result.rows = view.GetPrintLayout().m_numRows;
    const bool toFile = dialog.GetPortName() == FilePort || (dialog.m_pd.Flags & PD_PRINTTOFILE) != 0;
    if (toFile) {
        result.output = outputFile;
        if (result.output.empty() && !(askOutput && askOutput(result.output))) {
            result.outcome = Outcome::Cancelled;
            result.message = "Printing cancelled.";
            return result;
        }
    }

    view.OnBeginPrinting(&printer, &info);
    UINT first = 1;
    UINT last = 1;
    ChosenPages(info, first, last);
    DOCINFOA document = {};
    document.cbSize = sizeof(document);
    document.lpszDocName = title.c_str();
    document.lpszOutput = result.output.empty() ? nullptr : result.output.c_str();
    if (printer.StartDoc(&document) <= 0) {
        view.OnEndPrinting(&printer, &info);
        return Failure("The printer refused the job.");
    }
    for (UINT page = first; page <= last; ++page) {
        if (printer.StartPage() <= 0) {
            printer.AbortDoc();
            view.OnEndPrinting(&printer, &info);
            return Failure("The printer refused page " + std::to_string(page) + ".");
        }
        info.m_nCurPage = page;
        view.OnPrint(&printer, &info);
        printer.EndPage();
        ++result.pages;
    }
    printer.EndDoc();
    view.OnEndPrinting(&printer, &info);

    result.outcome = Outcome::Printed;
    result.message = "Printed " + std::to_string(result.pages) + (result.pages == 1 ? " page" : " pages") +
        " of the " + std::to_string(result.columns) + " x " + std::to_string(result.rows) +
        " page grid" + (result.output.empty() ? std::string(".") : " to " + result.output + ".");
    return result;
}

} // namespace ViewerPrinting
