// ViewerPrinting: prints what a drawing view shows as a grid of pages, the
// way an application runs the framework's print protocol itself (there is
// no document/view print loop here): the view lays out the pages and
// installs its print dialog (OnPreparePrinting), the dialog runs on the
// application's printer defaults, and each chosen page is one
// StartPage/OnPrint/EndPage of a document on the printer the dialog returned.
#pragma once

#include <afxwin.h>

#include <functional>
#include <string>

class DrawingView;

namespace ViewerPrinting {

enum class Outcome {
    Printed,
    Cancelled, // the dialog or the output file was not confirmed
    Failed
};

struct Result {
    Outcome outcome = Outcome::Failed;
    int pages = 0;   // pages sent to the printer
    int columns = 0; // the page grid
    int rows = 0;
    std::string output;  // the file the job went to; empty: the printer's port
    std::string message; // a sentence for the status bar
};

// Asks for the file a job goes to when the printer writes to a file; false
// when the person cancels.
using AskOutputFile = std::function<bool(std::string& path)>;

// Prints view through the print dialog, owned by owner. A printer whose port
// is FILE: (or a job the person sends to a file) goes to outputFile when it
// is not empty, else to the file askOutput names. title names the document
// in the print queue.
Result PrintView(DrawingView& view, CWnd* owner, const std::string& title, const std::string& outputFile,
                 const AskOutputFile& askOutput);

} // namespace ViewerPrinting
