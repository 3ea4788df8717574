// Tavo_WiDrawWnd printing and Tavo_WiPrintDialog: the page-grid arithmetic
// with given numbers, the layout against the real default printer, the real
// print dialog, pages printed into a bitmap, and a print job through the
// real PostScript printer.
//
// The print job is checked on its pages as pictures in two runs of this
// program around Ghostscript (print_pages_test, ctest's
// drawwnd_print_pages_test): TAVO_PRINT_PASS=write prints the job into the
// folder TAVO_PRINT_PAGES names, the script turns each page into a PNG file,
// and TAVO_PRINT_PASS=check reads them back. Run without them, the job is
// printed to a temporary file and only its PostScript is checked.
#include "drawwnd_test_support.h"

#include "DibCanvas.h"
#include "ImportPatch.h"
#include "Tavo_WiLibrary.h"
#include "Tavo_WiPalette.h"
#include "Tavo_WiPrintDialog.h"
#include "Tavo_WiPrintMath.h"
#include "png_picture.h"

#include <afxext.h>
#include <gtest/gtest.h>

#include <climits>
#include <cstdlib>
#include <fstream>
#include <functional>
#include <sstream>

using namespace DrawWndTest;
using namespace Tavo_WiPrintMath;

namespace {

constexpr DWORD DialogFlags = PD_SELECTION | PD_USEDEVMODECOPIES;
constexpr COLORREF PaperWhite = RGB(255, 255, 255);
constexpr COLORREF PenBlack = RGB(0, 0, 0);

std::string Describe(const Tavo_WiPrintLayout& layout)
{
    const Tavo_GrWRect& box = layout.m_firstPageBox;
    std::ostringstream out;
    out << layout.m_numCols << " x " << layout.m_numRows << ", current " << layout.m_currentPage << ", page "
        << layout.m_page << ", first (" << box.x1 << ", " << box.y1 << ", " << box.x2 << ", " << box.y2 << ")";
    return out.str();
}

// ---- the arithmetic, with given numbers -------------------------------------

const Paper ExamplePaper{4800, 6600, 100};

TEST(PrintMath, WorkedExampleGivesSixColumnsFiveRowsAndCurrentPageEight)
{
    const Tavo_WiPrintLayout layout = LayOutPages({100, 0, 300, 400}, {0, -500, 1000, 600}, ExamplePaper);
    EXPECT_EQ(Describe(layout), Describe({6, 5, 8, 8, {-100, 400, 100, 669}}));
    EXPECT_EQ(HeaderHeight(100), 150);
    EXPECT_EQ(DialogPageCount(layout), 30);
    EXPECT_EQ(PageBox(layout, 1), layout.m_firstPageBox);
    EXPECT_EQ(PageBox(layout, 8), (Tavo_GrWRect{100, 131, 300, 400}));
    EXPECT_EQ(PageBox(layout, 30), (Tavo_GrWRect{900, -676, 1100, -407}));
    EXPECT_EQ(CornerMarkLength(4800), 150);
}

TEST(PrintMath, LayoutsOfTheZeroLevelTheDrawingsCornerAndUnprintableAreas)
{
    struct Case {
        const char* name;
        Tavo_GrWRect area;
        Tavo_GrWRect bounds;
        Paper paper;
        Tavo_WiPrintLayout expected;
    };
    const Tavo_GrWRect roomy{0, 0, 5000, 5000};
    const Case cases[] = {
        // At the zero level the area is the drawing: one column, and rows
        // below only when the drawing is taller than a page.
        {"zero level, low drawing", {0, 0, 1000, 500}, {0, 0, 1000, 500}, ExamplePaper, {1, 1, 1, 1, {0, -843, 1000, 500}}},
        {"zero level, tall drawing", {0, 0, 1000, 3000}, {0, 0, 1000, 3000}, ExamplePaper, {1, 3, 1, 1, {0, 1656, 1000, 3000}}},
        {"view at the drawing's top-left corner", {0, 300, 200, 600}, {0, -500, 1000, 600}, ExamplePaper, {5, 5, 1, 1, {0, 331, 200, 600}}},
        {"drawing within one page", {100, 0, 300, 400}, {150, 200, 250, 300}, ExamplePaper, {1, 1, 1, 1, {100, 131, 300, 400}}},
        // A header as tall as the paper leaves pages of no height.
        {"page of no height", {0, 0, 1000, 500}, roomy, {100, 150, 100}, {1, 1, 1, 1, {0, 0, 1000, 500}}},
        {"paper of no width", {0, 0, 1000, 500}, roomy, {0, 0, 0}, {1, 1, 1, 1, {0, 0, 1000, 500}}},
        {"area of no width", {5, 0, 5, 500}, roomy, ExamplePaper, {1, 1, 1, 1, {5, 0, 5, 500}}},
        {"area of no height", {0, 5, 1000, 5}, roomy, ExamplePaper, {1, 1, 1, 1, {0, 5, 1000, 5}}},
    };
    for (const Case& c : cases)
        EXPECT_EQ(Describe(LayOutPages(c.area, c.bounds, c.paper)), Describe(c.expected)) << c.name;
}

TEST(PrintMath, HugeGridsSaturateInsteadOfWrapping)
{
    // Pages of one world unit over the whole coordinate range.
    const Tavo_WiPrintLayout huge = LayOutPages({0, 0, 1, 1}, {INT_MIN, INT_MIN, INT_MAX, INT_MAX}, {1, 1, 0});
    EXPECT_EQ(Describe(huge),
              Describe({INT_MAX, INT_MAX, INT_MAX, INT_MAX, {INT_MIN, INT_MAX - 1, INT_MIN + 1, INT_MAX}}));
    EXPECT_EQ(DialogPageCount(huge), 65535);

    const Tavo_WiPrintLayout tall{1, INT_MAX, 1, 1, {0, 0, 1000, 1000}};
    EXPECT_EQ(PageBox(tall, INT_MAX), (Tavo_GrWRect{0, INT_MIN, 1000, INT_MIN}));
    const Tavo_WiPrintLayout wide{INT_MAX, 1, 1, 1, {0, 0, 1000, 1000}};
    EXPECT_EQ(PageBox(wide, INT_MAX), (Tavo_GrWRect{INT_MAX, 0, INT_MAX, 1000}));
}

TEST(PrintMath, PagesOfTheGridStartAtOneAndEndAtTheLastPage)
{
    const Tavo_WiPrintLayout grid{6, 5, 8, 8, {}};
    const Tavo_WiPrintLayout huge{INT_MAX, INT_MAX, 1, 1, {}};
    const std::pair<long long, bool> pages[] = {{0, false}, {1, true}, {30, true}, {31, false}, {-1, false}};
    for (const auto& [page, inGrid] : pages)
        EXPECT_EQ(IsPageOfGrid(grid, page), inGrid) << page;
    // Beyond what the layout's page number can hold.
    EXPECT_TRUE(IsPageOfGrid(huge, INT_MAX));
    EXPECT_FALSE(IsPageOfGrid(huge, static_cast<long long>(INT_MAX) + 1));
}

TEST(PrintMath, HeaderNamesThePageAndItsPlaceInTheGrid)
{
    Tavo_WiDrawWnd window;
    const std::pair<int, const char*> pages[] = {{8, "Page 8   [col 2 of 6, row 2 of 5]"},
                                                 {7, "Page 7   [col 1 of 6, row 2 of 5]"},
                                                 {30, "Page 30   [col 6 of 6, row 5 of 5]"}};
    for (const auto& [page, header] : pages)
        EXPECT_STREQ(window.GetPrintHeader({6, 5, 8, page, {}}), header);
}

// ---- the real dialog ------------------------------------------------------------

// The page-range group of a print dialog in one line: the page boxes, the
// two relabelled buttons, whether their right edges line up with the last
// page box, and whether the current-page choice is selected.
std::string DescribeRangeGroup(HWND dialog)
{
    const auto text = [dialog](int id) {
        char buffer[256] = {};
        ::GetDlgItemTextA(dialog, id, buffer, sizeof buffer);
        return std::string(buffer);
    };
    const auto right = [dialog](int id) {
        RECT rect = {};
        ::GetWindowRect(::GetDlgItem(dialog, id), &rect);
        return rect.right;
    };
    using Ids = Tavo_WiPrintDialog;
    const LONG edge = right(Ids::LastPageBoxId);
    const bool aligned = right(Ids::AllPagesButtonId) == edge && right(Ids::CurrentPageButtonId) == edge;
    const bool current = ::IsDlgButtonChecked(dialog, Ids::CurrentPageButtonId) == BST_CHECKED;
    return text(Ids::FirstPageBoxId) + " to " + text(Ids::LastPageBoxId) + " | " + text(Ids::AllPagesButtonId) +
        " | " + text(Ids::CurrentPageButtonId) + (aligned ? " | aligned" : " | not aligned") +
        (current ? " | current chosen" : " | current not chosen");
}

// Shows the real print dialog through the application; once it has been
// initialised (OnInitDialog included), visit sees it, then it is closed with
// command as if the user pressed that button.
class DialogRun {
public:
    static int Show(CWinApp& app, CPrintDialog* dialog, UINT command, const std::function<void(HWND)>& visit)
    {
        s_visit = &visit;
        s_command = command;
        const HHOOK hook = ::SetWindowsHookExA(WH_CALLWNDPROCRET, AfterMessage, nullptr, ::GetCurrentThreadId());
        const int result = app.DoPrintDialog(dialog);
        ::UnhookWindowsHookEx(hook);
        s_visit = nullptr;
        return result;
    }

private:
    static LRESULT CALLBACK AfterMessage(int code, WPARAM wParam, LPARAM lParam)
    {
        const auto* sent = reinterpret_cast<const CWPRETSTRUCT*>(lParam);
        if (code == HC_ACTION && sent->message == WM_INITDIALOG && s_visit) {
            (*s_visit)(sent->hwnd);
            s_visit = nullptr;
            ::PostMessageA(sent->hwnd, WM_COMMAND, MAKEWPARAM(s_command, BN_CLICKED), 0);
        }
        return ::CallNextHookEx(nullptr, code, wParam, lParam);
    }

    static inline const std::function<void(HWND)>* s_visit = nullptr;
    static inline UINT s_command = IDCANCEL;
};

TEST(PrintDialog, RelabelsThePageRangeGroupForTheGridAndChoosesTheCurrentPage)
{
    CWinApp app;
    const Tavo_WiPrintLayout grid{6, 5, 8, 8, {}};
    Tavo_WiPrintDialog gridDialog(FALSE, DialogFlags, nullptr);
    gridDialog.m_layout = &grid;
    gridDialog.m_pd.nMaxPage = 30;
    // An unbound window lays out one page.
    Tavo_WiDrawWnd unbound;
    CPrintInfo onePage;
    unbound.OnPreparePrinting(&onePage);

    const std::pair<CPrintDialog*, const char*> cases[] = {
        {&gridDialog, "1 to 30 | &All (6col, 5 row) | C&urrent (Page 8) | aligned | current chosen"},
        {onePage.m_pPD, "1 to 1 | &All (1col, 1 row) | C&urrent (Page 1) | aligned | current chosen"}};
    for (const auto& [dialog, expected] : cases) {
        std::string group;
        EXPECT_EQ(DialogRun::Show(app, dialog, IDCANCEL, [&](HWND shown) { group = DescribeRangeGroup(shown); }),
                  IDCANCEL);
        EXPECT_EQ(group, expected);
    }
}

// ---- a window laid out for the default printer -------------------------------

// The page of a device context as OnPrint sees it.
struct PageGeometry {
    explicit PageGeometry(CDC& dc)
    {
        TEXTMETRICA metrics = {};
        dc.GetTextMetrics(&metrics);
        width = dc.GetDeviceCaps(HORZRES);
        height = dc.GetDeviceCaps(VERTRES);
        textHeight = metrics.tmHeight;
        header = HeaderHeight(textHeight);
    }
    int width = 0;
    int height = 0;
    int textHeight = 0;
    int header = 0;
};

// A window showing the middle of a 1000 x 1000 drawing, laid out for the
// default printer, with a print surface. Once the grid is known each page
// gets a marker of its own colour in the upper left quarter of its box:
// a page that shows another page's box, or its own box turned, is caught.
// The markers stay within the grid, so the layout does not change.
class PrintedGrid : public ::testing::Test {
protected:
    PrintedGrid()
    {
        Tavo_GrDrawingBuilder build(drawing);
        build.SetAttr(Tavo_GrAttr(White, 1));
        build.AddDot(0, 0);
        build.AddDot(1000, 1000);
        hosted.wnd.SetDrawingInfo(&drawing, 50, 3, 0, 0, 0);
        hosted.wnd.ZoomWindow(Tavo_GrWRect{350, 450, 650, 750});
        hosted.wnd.printSurface = &surface;
        hosted.wnd.OnPreparePrinting(&info);
        layout = hosted.wnd.GetPrintLayout();
        for (int page = 1; page <= PageCount(); ++page) {
            const Tavo_GrWRect marker = Marker(page);
            build.SetAttr(Tavo_GrAttr(MarkerColour(page), 1));
            build.AddRect(marker.x1, marker.y1, marker.x2, marker.y2);
        }
    }

    int PageCount() const { return layout.m_numCols * layout.m_numRows; }
    static char MarkerColour(int page) { return static_cast<char>(1 + (page - 1) % 6); }
    Tavo_GrWRect Marker(int page) const
    {
        const Tavo_GrWRect box = PageBox(layout, page);
        const int w = box.x2 - box.x1;
        const int h = box.y2 - box.y1;
        return {box.x1 + w / 8, box.y2 - 3 * h / 8, box.x1 + 3 * w / 8, box.y2 - h / 8};
    }
    // The centres of the page's quarters, its marker's first.
    std::vector<Tavo_GrWPoint> QuarterCentres(int page) const
    {
        const Tavo_GrWRect box = PageBox(layout, page);
        const int w = box.x2 - box.x1;
        const int h = box.y2 - box.y1;
        return {{box.x1 + w / 4, box.y2 - h / 4}, {box.x2 - w / 4, box.y2 - h / 4}, {box.x1 + w / 4, box.y1 + h / 4}, {box.x2 - w / 4, box.y1 + h / 4}};
    }
    // What the centre of quarter q of a page shows in colour: its marker or paper.
    static COLORREF QuarterColour(int page, size_t q)
    {
        return q == 0 ? Colour(MarkerColour(page), false) : PaperWhite;
    }
    // Where OnPrint puts the world point of a page: the window's mapping
    // sized to the page below the header and fitted to the page's box.
    CPoint PagePoint(const PageGeometry& geometry, int page, const Tavo_GrWPoint& world) const
    {
        Tavo_GrMapping mapping(*hosted.wnd.GetMapping());
        const int body = geometry.height - geometry.header;
        mapping.SetDeviceWindowSize(geometry.width, body, true, nullptr);
        mapping.SetWorldClipBox(PageBox(layout, page));
        const Tavo_GrDPoint device = mapping.GetTransform().Point(world);
        return CPoint(device.x, geometry.header + body - device.y);
    }
    CString Header(int page)
    {
        Tavo_WiPrintLayout of = layout;
        of.m_page = page;
        return hosted.wnd.GetPrintHeader(of);
    }
    static COLORREF Colour(char index, bool grey) { return Tavo_WiLibrary::GetPalette()->GetWin32Color(index, grey); }

    CWinApp app;
    Tavo_GrDrawing drawing;
    HostedDrawWnd hosted;
    Tavo_WiWin32Surface surface;
    CPrintInfo info;
    Tavo_WiPrintLayout layout;
};

TEST_F(PrintedGrid, LaysOutTheViewOverTheDefaultPrintersPaper)
{
    CDC printer;
    ASSERT_TRUE(app.CreatePrinterDC(printer));
    const PageGeometry page(printer);
    const Paper paper{page.width, page.height, page.textHeight};
    const Tavo_WiPrintLayout expected = LayOutPages(hosted.wnd.GetWorldClipBox(), drawing.GetBounds(), paper);
    EXPECT_EQ(Describe(layout), Describe(expected));
    EXPECT_GT(layout.m_numCols, 1);
    EXPECT_GT(layout.m_numRows, 1);
    EXPECT_GT(layout.m_currentPage, 1);
    EXPECT_EQ(info.m_nCurPage, static_cast<UINT>(layout.m_currentPage));

    const auto* dialog = dynamic_cast<Tavo_WiPrintDialog*>(info.m_pPD);
    ASSERT_NE(dialog, nullptr);
    EXPECT_EQ(dialog->m_layout, &hosted.wnd.GetPrintLayout());
    EXPECT_EQ(dialog->m_pd.nMaxPage, PageCount());
    EXPECT_EQ(dialog->m_pd.Flags & (DialogFlags | PD_PRINTSETUP | PD_NOSELECTION), DialogFlags);

    // The markers added since lie within the grid: laying out again gives the same pages.
    hosted.wnd.OnPreparePrinting(&info);
    EXPECT_EQ(Describe(hosted.wnd.GetPrintLayout()), Describe(layout));
}

TEST_F(PrintedGrid, AtTheZeroLevelTheDrawingIsPrintedInOneColumnFromPageOne)
{
    hosted.wnd.ZoomWindow(Tavo_GrZoom::ZeroLevel, 0, Tavo_WiZoomCenter::AtViewCentre, 0, 0, true);
    hosted.wnd.OnPreparePrinting(&info);
    const Tavo_WiPrintLayout& zero = hosted.wnd.GetPrintLayout();
    EXPECT_EQ(zero.m_numCols, 1);
    EXPECT_EQ(zero.m_numRows, 1); // the drawing is square, the page taller
    EXPECT_EQ(zero.m_currentPage, 1);
    EXPECT_EQ(zero.m_firstPageBox.x1, drawing.GetBounds().x1);
    EXPECT_EQ(zero.m_firstPageBox.x2, drawing.GetBounds().x2);
    EXPECT_EQ(zero.m_firstPageBox.y2, drawing.GetBounds().y2);
}

TEST(PrintLayout, WithoutPrinterDefaultsOrDrawingTheLayoutIsOnePage)
{
    Tavo_GrDrawing drawing;
    AddFilledRect(drawing, {0, 0, 1000, 3000}, Red);
    HostedDrawWnd hosted;
    hosted.wnd.SetDrawingInfo(&drawing, 50, 3, 0, 0, 0);
    CPrintInfo info;
    // No application object, so no printer defaults: one page covering the
    // drawing, which the zero level shows.
    hosted.wnd.OnPreparePrinting(&info);
    EXPECT_EQ(Describe(hosted.wnd.GetPrintLayout()), Describe({1, 1, 1, 1, {0, 0, 1000, 3000}}));

    CWinApp app;
    hosted.wnd.SetDrawingInfo(nullptr, 0, 0, 0, 0, 0);
    hosted.wnd.OnPreparePrinting(&info);
    EXPECT_EQ(Describe(hosted.wnd.GetPrintLayout()), Describe({1, 1, 1, 1, {}}));
    EXPECT_EQ(info.m_nCurPage, 1u);
    EXPECT_EQ(info.m_pPD->m_pd.nMaxPage, 1);
}

// The choice the user leaves in the real dialog, and what OnBeginPrinting
// makes of it.
TEST_F(PrintedGrid, BeginPrintingTurnsTheCurrentPageChoiceIntoARangeAndLeavesTheOthers)
{
    struct Case {
        const char* name;
        std::function<void(HWND)> choose;
        bool currentPage;
    };
    const Case cases[] = {
        {"current page", [](HWND) {}, true},
        {"all pages", [](HWND dialog) { ::CheckRadioButton(dialog, 1056, 1058, 1056); }, false},
        {"pages 2 to 5",
         [](HWND dialog) {
             ::CheckRadioButton(dialog, 1056, 1058, 1058);
             ::SetDlgItemTextA(dialog, Tavo_WiPrintDialog::FirstPageBoxId, "2");
             ::SetDlgItemTextA(dialog, Tavo_WiPrintDialog::LastPageBoxId, "5");
         },
         false},
    };
    for (const Case& c : cases) {
        hosted.wnd.OnPreparePrinting(&info);
        ASSERT_EQ(DialogRun::Show(app, info.m_pPD, IDOK, c.choose), IDOK) << c.name;
        PRINTDLG& pd = info.m_pPD->m_pd;
        const WORD from = pd.nFromPage;
        const WORD to = pd.nToPage;
        hosted.wnd.OnBeginPrinting(nullptr, &info);
        if (c.currentPage) {
            EXPECT_EQ(pd.nFromPage, layout.m_currentPage) << c.name;
            EXPECT_EQ(pd.nToPage, layout.m_currentPage) << c.name;
        } else {
            EXPECT_EQ(pd.nFromPage, from) << c.name;
            EXPECT_EQ(pd.nToPage, to) << c.name;
        }
        ::DeleteDC(pd.hDC);
        pd.hDC = nullptr;
    }
    EXPECT_EQ(info.m_pPD->m_pd.nFromPage, 2);
    EXPECT_EQ(info.m_pPD->m_pd.nToPage, 5);
}

// ---- pages printed into a bitmap -------------------------------------------------

// A page printed into a 32-bit bitmap. A memory device context reports the
// screen's size as its page, so the bitmap is that size.
struct BitmapPage {
    BitmapPage() : canvas(::GetSystemMetrics(SM_CXSCREEN), ::GetSystemMetrics(SM_CYSCREEN))
    {
        dc.Attach(canvas.GetDC());
    }
    ~BitmapPage() { dc.Detach(); }
    DibCanvas canvas;
    CDC dc;
};

// The smallest rectangle holding every pixel of rows top to bottom - 1 that
// is not white; left > right when there is none.
CRect Ink(const std::function<COLORREF(int, int)>& pixel, int width, int top, int bottom)
{
    CRect ink(INT_MAX, INT_MAX, INT_MIN, INT_MIN);
    for (int y = top; y < bottom; ++y)
        for (int x = 0; x < width; ++x)
            if (pixel(x, y) != PaperWhite)
                ink = CRect(std::min<int>(ink.left, x), std::min<int>(ink.top, y), std::max<int>(ink.right, x),
                            std::max<int>(ink.bottom, y));
    return ink;
}

// The corners of a page's body, each with the directions its mark's arms run in.
struct Corner {
    int x, y, dx, dy;
};
std::vector<Corner> Corners(const PageGeometry& page)
{
    const int right = page.width - 1;
    const int top = page.header;
    const int bottom = page.height - 1;
    return {{0, top, 1, 1}, {0, bottom, 1, -1}, {right, top, -1, 1}, {right, bottom, -1, -1}};
}

TEST_F(PrintedGrid, EachPageShowsItsOwnBoxUnderItsHeader)
{
    // One device context for every page, as a print job has.
    BitmapPage bitmap;
    const PageGeometry geometry(bitmap.dc);
    for (int page = 1; page <= PageCount(); ++page) {
        bitmap.canvas.Fill(PaperWhite);
        info.m_nCurPage = static_cast<UINT>(page);
        hosted.wnd.OnPrint(&bitmap.dc, &info);
        EXPECT_EQ(hosted.wnd.GetPrintLayout().m_page, page);
        const std::vector<Tavo_GrWPoint> quarters = QuarterCentres(page);
        for (size_t q = 0; q < quarters.size(); ++q) {
            const CPoint at = PagePoint(geometry, page, quarters[q]);
            EXPECT_EQ(bitmap.canvas.GetPixel(at.x, at.y), QuarterColour(page, q))
                << "page " << page << ", quarter " << q;
        }
        const CRect header = Ink([&](int x, int y) { return bitmap.canvas.GetPixel(x, y); }, geometry.width, 0,
                                 geometry.header);
        const CSize extent = bitmap.dc.GetTextExtent(Header(page));
        EXPECT_LE(header.left, header.right) << "page " << page << " has its header";
        EXPECT_LT(header.right, extent.cx) << page;
    }
}

TEST_F(PrintedGrid, WithoutAPrintSurfaceTheHeaderAndCornerMarksStillPrint)
{
    hosted.wnd.printSurface = nullptr;
    BitmapPage bitmap;
    const PageGeometry geometry(bitmap.dc);
    info.m_nCurPage = static_cast<UINT>(layout.m_currentPage);
    hosted.wnd.OnPrint(&bitmap.dc, &info);

    const auto pixel = [&](int x, int y) { return bitmap.canvas.GetPixel(x, y); };
    const int mark = CornerMarkLength(geometry.width);
    for (const Corner& c : Corners(geometry)) {
        // Each arm from the corner, its far end excluded where a line ends.
        EXPECT_EQ(pixel(c.x + c.dx * mark, c.y), PenBlack) << c.x << ", " << c.y;
        EXPECT_EQ(pixel(c.x, c.y), PenBlack) << c.x << ", " << c.y;
        EXPECT_EQ(pixel(c.x, c.y + c.dy * (mark - 1)), PenBlack) << c.x << ", " << c.y;
        EXPECT_EQ(pixel(c.x + c.dx * (mark + 1), c.y), PaperWhite) << c.x << ", " << c.y;
        EXPECT_EQ(pixel(c.x, c.y + c.dy * mark), PaperWhite) << c.x << ", " << c.y;
    }
    const CRect header = Ink(pixel, geometry.width, 0, geometry.header);
    EXPECT_LE(header.left, header.right);
    const CPoint marker = PagePoint(geometry, layout.m_currentPage, QuarterCentres(layout.m_currentPage)[0]);
    EXPECT_EQ(pixel(marker.x, marker.y), PaperWhite);
}

TEST_F(PrintedGrid, PagesOutsideTheGridPrintNothing)
{
    BitmapPage bitmap;
    const int all = bitmap.canvas.GetWidth() * bitmap.canvas.GetHeight();
    for (const UINT page : {0u, static_cast<UINT>(PageCount()) + 1u}) {
        info.m_nCurPage = page;
        hosted.wnd.OnPrint(&bitmap.dc, &info);
        EXPECT_EQ(bitmap.canvas.CountPixels(PaperWhite), all) << page;
        EXPECT_EQ(hosted.wnd.GetPrintLayout().m_page, layout.m_page) << page;
    }
}

// A print surface that notes its settings while it draws.
class ObservingSurface : public Tavo_WiWin32Surface {
public:
    void DrawRect(Tavo_GrDRect& rect, Tavo_GrAttr* attr) override
    {
        blackAndWhiteWhileDrawing = IsBlackAndWhite();
        thickeningWhileDrawing = GetThickenVertLine();
        Tavo_WiWin32Surface::DrawRect(rect, attr);
    }
    bool blackAndWhiteWhileDrawing = false;
    int thickeningWhileDrawing = -1;
};

// Makes the framework's device contexts report a number of colours for one
// device context.
class ColourCount {
public:
    ColourCount(HDC dc, int colours)
        : m_patch(::GetModuleHandleA("afx.dll"), "GetDeviceCaps", reinterpret_cast<void*>(&Answer))
    {
        s_dc = dc;
        s_colours = colours;
        s_original = reinterpret_cast<decltype(&::GetDeviceCaps)>(m_patch.GetOriginal());
    }
    ~ColourCount() { s_dc = nullptr; }
    bool IsActive() const { return m_patch.IsActive(); }

private:
    static int WINAPI Answer(HDC dc, int index)
    {
        return dc == s_dc && index == NUMCOLORS ? s_colours : s_original(dc, index);
    }
    ImportPatch m_patch;
    static inline HDC s_dc = nullptr;
    static inline int s_colours = 0;
    static inline decltype(&::GetDeviceCaps) s_original = nullptr;
};

TEST_F(PrintedGrid, TwoColourDevicesPrintGreyThroughThePaletteOthersInColourAndTheSurfaceIsRestored)
{
    struct Case {
        int colours;        // what the device reports as NUMCOLORS
        bool blackAndWhite; // the surface's own setting
        bool grey;
    };
    // True-colour devices, printers among them, report -1.
    const Case cases[] = {{-1, true, false}, {256, true, false}, {2, false, true}, {0, false, true}};
    const int page = layout.m_currentPage;
    for (const Case& c : cases) {
        BitmapPage bitmap;
        const PageGeometry geometry(bitmap.dc);
        ObservingSurface observing;
        observing.SetBlackAndWhiteFlag(c.blackAndWhite);
        observing.SetThickenVertLine(3);
        hosted.wnd.printSurface = &observing;
        {
            const ColourCount count(bitmap.canvas.GetDC(), c.colours);
            ASSERT_TRUE(count.IsActive());
            info.m_nCurPage = static_cast<UINT>(page);
            hosted.wnd.OnPrint(&bitmap.dc, &info);
        }
        const CPoint marker = PagePoint(geometry, page, QuarterCentres(page)[0]);
        EXPECT_EQ(bitmap.canvas.GetPixel(marker.x, marker.y), Colour(MarkerColour(page), c.grey)) << c.colours;
        EXPECT_EQ(observing.blackAndWhiteWhileDrawing, c.grey) << c.colours;
        EXPECT_EQ(observing.thickeningWhileDrawing, 0) << c.colours;
        EXPECT_EQ(observing.IsBlackAndWhite(), c.blackAndWhite) << c.colours;
        EXPECT_EQ(observing.GetThickenVertLine(), 3) << c.colours;
    }
}

// ---- a print job through the real printer --------------------------------------

std::string PrintPass()
{
    const char* pass = std::getenv("TAVO_PRINT_PASS");
    return pass ? pass : "";
}

// Where the job's PostScript goes: the folder of the two-pass run, else a
// temporary file.
std::string JobPath()
{
    if (const char* folder = std::getenv("TAVO_PRINT_PAGES"))
        return std::string(folder) + "\\grid.ps";
    char temp[MAX_PATH] = {};
    ::GetTempPathA(MAX_PATH, temp);
    return std::string(temp) + "drawwnd_print_test.ps";
}

using PrintJob = PrintedGrid;

TEST_F(PrintJob, PrintsEveryPageOfTheGridToPostScriptAndRestoresTheSurfaceAfterEach)
{
    // The printer prints in colour even so.
    surface.SetBlackAndWhiteFlag(true);
    surface.SetThickenVertLine(2);
    const std::string path = JobPath();
    ::DeleteFileA(path.c_str());
    CDC printer;
    ASSERT_TRUE(app.CreatePrinterDC(printer));
    DOCINFOA doc = {sizeof(doc), "drawwnd print test", path.c_str(), nullptr, 0};
    ASSERT_GT(printer.StartDoc(&doc), 0);
    for (int page = 1; page <= PageCount(); ++page) {
        info.m_nCurPage = static_cast<UINT>(page);
        ASSERT_GT(printer.StartPage(), 0);
        hosted.wnd.OnPrint(&printer, &info);
        ASSERT_GT(printer.EndPage(), 0);
        EXPECT_TRUE(surface.IsBlackAndWhite()) << page;
        EXPECT_EQ(surface.GetThickenVertLine(), 2) << page;
    }
    ASSERT_GT(printer.EndDoc(), 0);
    hosted.wnd.OnEndPrinting(&printer, &info);

    std::ifstream file(path, std::ios::binary);
    const std::string job((std::istreambuf_iterator<char>(file)), std::istreambuf_iterator<char>());
    EXPECT_EQ(job.rfind("%!PS", 0), 0u);
    int pages = 0;
    for (size_t at = job.find("\n%%Page:"); at != std::string::npos; at = job.find("\n%%Page:", at + 1))
        ++pages;
    EXPECT_EQ(pages, PageCount());
    if (PrintPass() != "write") {
        file.close();
        ::DeleteFileA(path.c_str());
    }
}

bool Near(COLORREF a, COLORREF b, int tolerance)
{
    return std::abs(GetRValue(a) - GetRValue(b)) <= tolerance && std::abs(GetGValue(a) - GetGValue(b)) <= tolerance &&
        std::abs(GetBValue(a) - GetBValue(b)) <= tolerance;
}

bool DarkAround(const Picture& picture, CPoint at, int radius)
{
    for (int y = at.y - radius; y <= at.y + radius; ++y)
        for (int x = at.x - radius; x <= at.x + radius; ++x)
            if (Near(picture.At(x, y), PenBlack, 100))
                return true;
    return false;
}

using PrintedPages = PrintedGrid;

TEST_F(PrintedPages, ShowTheirHeaderCornerMarksAndOwnBoxInColour)
{
    if (PrintPass() != "check")
        GTEST_SKIP() << "needs the print job's pages as PNG files: run through print_pages_test";
    CDC printer;
    ASSERT_TRUE(app.CreatePrinterDC(printer));
    const PageGeometry geometry(printer);
    const CPoint margin(printer.GetDeviceCaps(PHYSICALOFFSETX), printer.GetDeviceCaps(PHYSICALOFFSETY));
    const int paperWidth = printer.GetDeviceCaps(PHYSICALWIDTH);
    const int mark = CornerMarkLength(geometry.width);
    const std::string folder = std::getenv("TAVO_PRINT_PAGES");
    for (int page = 1; page <= PageCount(); ++page) {
        SCOPED_TRACE("page " + std::to_string(page));
        Picture picture;
        ASSERT_TRUE(ReadPng(folder + "\\grid-page" + std::to_string(page) + ".png", picture));
        // Device pixels of the printable area to pixels of the whole sheet.
        const double scale = static_cast<double>(picture.width) / paperWidth;
        const auto sheet = [&](int x, int y) {
            return CPoint(static_cast<int>((margin.x + x) * scale), static_cast<int>((margin.y + y) * scale));
        };

        const std::vector<Tavo_GrWPoint> quarters = QuarterCentres(page);
        for (size_t q = 0; q < quarters.size(); ++q) {
            const CPoint device = PagePoint(geometry, page, quarters[q]);
            const CPoint at = sheet(device.x, device.y);
            EXPECT_TRUE(Near(picture.At(at.x, at.y), QuarterColour(page, q), 3))
                << "quarter " << q << " shows " << std::hex << picture.At(at.x, at.y);
        }
        for (const Corner& c : Corners(geometry)) {
            EXPECT_TRUE(DarkAround(picture, sheet(c.x + c.dx * mark, c.y), 1)) << c.x << ", " << c.y;
            EXPECT_TRUE(DarkAround(picture, sheet(c.x, c.y), 1)) << c.x << ", " << c.y;
            EXPECT_TRUE(DarkAround(picture, sheet(c.x, c.y + c.dy * (mark - 1)), 1)) << c.x << ", " << c.y;
            EXPECT_FALSE(DarkAround(picture, sheet(c.x + c.dx * (mark + 8), c.y), 1)) << c.x << ", " << c.y;
            EXPECT_FALSE(DarkAround(picture, sheet(c.x, c.y + c.dy * (mark + 8)), 1)) << c.x << ", " << c.y;
        }
        // The header's text: from the left edge to its extent, above the body.
        const CSize extent = printer.GetTextExtent(Header(page));
        const CPoint top = sheet(0, 0);
        const CRect header = Ink([&](int x, int y) { return picture.At(x, y); }, picture.width, top.y,
                                 sheet(0, geometry.header - 2).y);
        EXPECT_GE(header.left, top.x - 1);
        EXPECT_LE(header.right, sheet(extent.cx, 0).x + 1);
        EXPECT_GT(header.right - header.left, (sheet(extent.cx, 0).x - top.x) / 2);
    }
}

} // namespace
