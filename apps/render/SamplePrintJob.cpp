#include "SamplePrintJob.h"

#include "Tavo_WiDrawWnd.h"
#include "Tavo_WiWin32Surface.h"

#include <afxext.h>

namespace {

// The largest zoom level of the window, and its control id in the host.
const int kMaxZoomLevel = 50;
const UINT kWindowId = 1;

// A drawing window that prints through its own surface.
class PrintingDrawWnd : public Tavo_WiDrawWnd {
public:
    Tavo_WiWin32Surface* GetPrintSurface() override { return &m_printSurface; }

private:
    Tavo_WiWin32Surface m_printSurface;
};

// A hidden top-level window to hold the drawing window.
class HiddenHost {
public:
    HiddenHost(int width, int height)
        : m_hwnd(::CreateWindowExA(0, "STATIC", "render", WS_POPUP, 0, 0, width, height, nullptr, nullptr,
                                   ::GetModuleHandleA(nullptr), nullptr))
    {
        if (m_hwnd)
            m_wnd.Attach(m_hwnd);
    }
    ~HiddenHost()
    {
        if (!m_hwnd)
            return;
        m_wnd.Detach();
        ::DestroyWindow(m_hwnd);
    }
    HiddenHost(const HiddenHost&) = delete;
    HiddenHost& operator=(const HiddenHost&) = delete;

    CWnd* Wnd() { return m_hwnd ? &m_wnd : nullptr; }

private:
    HWND m_hwnd;
    CWnd m_wnd;
};

// Prints the pages of the range the dialog's record holds into a document.
std::string PrintPages(PrintingDrawWnd& window, CDC& printer, CPrintInfo& info, const std::string& output,
                       int& printed)
{
    DOCINFOA document = {};
    document.cbSize = sizeof(document);
    document.lpszDocName = "render: sample drawing";
    document.lpszOutput = output.c_str();
    if (printer.StartDoc(&document) <= 0)
        return "the printer refused the document";
    for (UINT page = info.m_pPD->m_pd.nFromPage; page <= info.m_pPD->m_pd.nToPage; ++page) {
        info.m_nCurPage = page;
        if (printer.StartPage() <= 0) {
            printer.AbortDoc();
            return "the printer refused a page";
        }
        window.OnPrint(&printer, &info);
        printer.EndPage();
        ++printed;
    }
    printer.EndDoc();
    return "";
}

} // namespace

std::string PrintSampleGrid(Tavo_GrDrawing& drawing, int windowWidth, int windowHeight, int zoomLevel,
                            const std::string& output, SamplePrintResult& result)
{
    // The printer defaults are the application's.
    CWinApp application("render");
    HiddenHost host(windowWidth, windowHeight);
    if (!host.Wnd())
        return "could not create the host window";
    PrintingDrawWnd window;
    if (!window.Create(WS_CHILD | WS_VISIBLE, CRect(0, 0, windowWidth, windowHeight), host.Wnd(), kWindowId))
        return "could not create the drawing window";
    window.SetDrawingInfo(&drawing, kMaxZoomLevel, 3, 0, 0, 0);
    if (zoomLevel > 0)
        window.ZoomWindow(Tavo_GrZoom::ToLevel, zoomLevel, Tavo_WiZoomCenter::AtViewCentre, 0, 0, false);

    CPrintInfo info;
    window.OnPreparePrinting(&info);
    const Tavo_WiPrintLayout& layout = window.GetPrintLayout();
    result.columns = layout.m_numCols;
    result.rows = layout.m_numRows;
    result.currentPage = layout.m_currentPage;
    // What the dialog leaves when the user chooses all pages.
    PRINTDLG& choice = info.m_pPD->m_pd;
    choice.Flags &= ~static_cast<DWORD>(PD_SELECTION | PD_PAGENUMS);
    choice.nFromPage = 1;
    choice.nToPage = choice.nMaxPage;

    CDC printer;
    if (!application.CreatePrinterDC(printer)) {
        window.DestroyWindow();
        return "there is no default printer";
    }
    window.OnBeginPrinting(&printer, &info);
    const std::string failure = PrintPages(window, printer, info, output, result.pagesPrinted);
    window.OnEndPrinting(&printer, &info);
    window.DestroyWindow();
    return failure;
}
