// The viewer's files: opening DXF drawings (and refusing what it cannot
// show, with a reason), the status bar in the file's own units, exporting the
// view as a PNG, and printing the page grid through the print dialog opened
// with Ctrl+P.
#include "viewer_test_support.h"

#include "png_picture.h"

#include <commdlg.h>

#include <cstdio>
#include <fstream>
#include <functional>
#include <sstream>

#include "Tavo_WiPrintDialog.h"

using namespace ViewerTest;

namespace {

// Two layers: a line from (10, 20) to (30, 20) on "walls", a circle of
// radius 5 about (20, 40) on "pipes", and an entity the importer skips.
const char GoodDxf[] =
    "0\nSECTION\n2\nENTITIES\n"
    "0\nLINE\n8\nwalls\n10\n10\n20\n20\n11\n30\n21\n20\n"
    "0\nCIRCLE\n8\npipes\n10\n20\n20\n40\n40\n5\n"
    "0\nHATCH\n8\nwalls\n"
    "0\nENDSEC\n0\nEOF\n";

std::string ReadFile(const std::string& path)
{
    std::ifstream file(path, std::ios::binary);
    std::ostringstream content;
    content << file.rdbuf();
    return content.str();
}

TEST(OpenDrawing, RefusesWhatItCannotShowAndSaysWhy)
{
    char folder[MAX_PATH] = {};
    ::GetTempPathA(sizeof folder, folder);
    const TempFile text("viewer-test-notes.dxf", "these are not\ngroup codes\n");
    const TempFile cut("viewer-test-cut.dxf", "0\nSECTION\n2\nENTITIES\n0\nLINE\n8\n0\n10\n");
    const struct {
        std::string path;
        std::string startOfError;
    } rows[] = {
        {"", "No file name was given."},
        {std::string(folder) + "viewer-test-missing.dxf", "Cannot open viewer-test-missing.dxf: there is no such file."},
        {folder, "Cannot open " + std::string(folder) + ": access is denied"},
        {text.Path(), "Cannot open viewer-test-notes.dxf: "},
        {cut.Path(), "Cannot open viewer-test-cut.dxf: "},
    };
    for (const auto& row : rows) {
        SCOPED_TRACE(row.path);
        const OpenDrawingResult result = OpenDrawing(row.path);
        EXPECT_EQ(result.document, nullptr);
        EXPECT_EQ(result.error.rfind(row.startOfError, 0), 0u) << result.error;
        EXPECT_GT(result.error.size(), row.startOfError.size() - 1);
    }
}

TEST(OpenDrawing, ReadsADxfDrawingWithItsLayersUnitsAndWarnings)
{
    const TempFile good("viewer-test-good.dxf", GoodDxf);
    const OpenDrawingResult result = OpenDrawing(good.Path());
    ASSERT_NE(result.document, nullptr) << result.error;
    EXPECT_EQ(result.document->GetName(), "viewer-test-good.dxf");
    const Tavo_GrDrawing& drawing = result.document->GetDrawing();
    EXPECT_EQ(drawing.GetItemCount(), 2);
    // The line's middle is at (20, 20) in the file's units.
    const DrawingUnits& units = result.document->GetUnits();
    const Tavo_GrWRect bounds = drawing.GetBounds();
    EXPECT_NEAR(units.ToDrawingX(bounds.x1), 10.0, 1e-6);
    EXPECT_NEAR(units.ToDrawingY(bounds.y2), 45.0, 1e-6);
    ASSERT_EQ(result.warnings.size(), 1u);
    EXPECT_NE(result.warnings[0].find("HATCH"), std::string::npos) << result.warnings[0];

    const TempFile empty("viewer-test-empty.dxf", "0\nSECTION\n2\nENTITIES\n0\nENDSEC\n0\nEOF\n");
    const OpenDrawingResult nothing = OpenDrawing(empty.Path());
    ASSERT_NE(nothing.document, nullptr) << "a drawing with nothing to draw opens empty";
    EXPECT_TRUE(nothing.document->GetDrawing().IsEmpty());
}

TEST_F(ViewerFixture, OpeningAFileShowsItInItsUnitsAndARefusedFileKeepsTheDrawing)
{
    const TempFile good("viewer-test-open.dxf", GoodDxf);
    std::string error;
    ASSERT_TRUE(frame.OpenFile(good.Path(), error)) << error;
    CString title;
    frame.GetWindowText(title);
    EXPECT_STREQ(title, "viewer-test-open.dxf - Tavo viewer");
    EXPECT_EQ(Status(ViewerStatusBar::Message).rfind("Opened with a warning: ", 0), 0u);
    EXPECT_EQ(View().GetZoomLevel(), 0.0);

    // The line's middle, (20, 20) in the file, is named in the file's units.
    const DrawingUnits& units = frame.GetDocument()->GetUnits();
    const int x = static_cast<int>((20 - units.originX) * units.scale);
    const int y = static_cast<int>((20 - units.originY) * units.scale);
    Click(ScreenOf(x, y), 100);
    EXPECT_EQ(Status(ViewerStatusBar::Message), "Layer \"walls\": line, 20 x 0");
    double px = 0;
    double py = 0;
    ASSERT_EQ(std::sscanf(Status(ViewerStatusBar::Pointer).c_str(), "x %lf y %lf", &px, &py), 2);
    EXPECT_NEAR(px, 20.0, 0.2);
    EXPECT_NEAR(py, 20.0, 0.2);

    ViewerDocument* shown = frame.GetDocument();
    EXPECT_FALSE(frame.OpenFile(good.Path() + ".missing", error));
    EXPECT_EQ(frame.GetDocument(), shown);
    EXPECT_EQ(Status(ViewerStatusBar::Message), error);

    // An empty drawing shows an empty view that still answers.
    const TempFile empty("viewer-test-nothing.dxf", "0\nSECTION\n2\nENTITIES\n0\nENDSEC\n0\nEOF\n");
    ASSERT_TRUE(frame.OpenFile(empty.Path(), error)) << error;
    EXPECT_EQ(Status(ViewerStatusBar::Message), "Opened with a warning: the drawing has nothing to draw");
    Key(VK_ADD);
    Click(ScreenOf(0, 0), 1000);
    EXPECT_EQ(Status(ViewerStatusBar::Message), "Nothing here");
}

TEST_F(ViewerFixture, ExportWritesWhatTheViewShowsAsAPng)
{
    Key(VK_ADD);
    ::UpdateWindow(Scrollee());
    const TempFile png("viewer-test-export.png", "");
    ASSERT_EQ(frame.ExportView(png.Path()), "");
    EXPECT_EQ(Status(ViewerStatusBar::Message), "Exported the view to " + png.Path() + ".");

    DrawWndTest::Picture picture;
    ASSERT_TRUE(DrawWndTest::ReadPng(png.Path(), picture));
    CRect client;
    ::GetClientRect(Scrollee(), &client);
    EXPECT_EQ(CSize(picture.width, picture.height), client.Size());
    for (const Tavo_GrWPoint at : {Tavo_GrWPoint{200, 200}, Tavo_GrWPoint{650, 500}, Tavo_GrWPoint{750, 500}}) {
        const CPoint p = ClientOf(at.x, at.y);
        EXPECT_EQ(picture.At(p.x, p.y), ScrollTest::PixelAt(Scrollee(), p.x, p.y)) << at.x << ", " << at.y;
    }
    EXPECT_EQ(picture.At(ClientOf(200, 200).x, ClientOf(200, 200).y), RGB(255, 0, 0));

    const std::string nowhere = "Z:\\no\\such\\folder\\view.png";
    EXPECT_EQ(frame.ExportView(nowhere).rfind("Cannot export the view to " + nowhere + ": ", 0), 0u);
}

// Answers the print dialog the way a person would, once it has opened.
class DialogAnswer {
public:
    explicit DialogAnswer(std::function<void(HWND)> answer)
        : m_hook(::SetWindowsHookExA(WH_CALLWNDPROCRET, AfterMessage, nullptr, ::GetCurrentThreadId()))
    {
        s_answer = std::move(answer);
    }
    ~DialogAnswer()
    {
        ::UnhookWindowsHookEx(m_hook);
        s_answer = nullptr;
    }

private:
    static LRESULT CALLBACK AfterMessage(int code, WPARAM wParam, LPARAM lParam)
    {
        const auto* sent = reinterpret_cast<const CWPRETSTRUCT*>(lParam);
        if (code == HC_ACTION && sent->message == WM_INITDIALOG && s_answer) {
            s_answer(sent->hwnd);
            s_answer = nullptr;
        }
        return ::CallNextHookEx(nullptr, code, wParam, lParam);
    }

    static inline std::function<void(HWND)> s_answer;
    HHOOK m_hook;
};

TEST_F(ViewerFixture, CtrlPPrintsEveryPageOfTheGridThroughTheDialogOrNothingWhenCancelled)
{
    Key(VK_ADD);
    Key(VK_ADD);
    Key(VK_ADD);
    const TempFile job("viewer-test-print.ps", "");
    ::DeleteFileA(job.Path().c_str());
    frame.SetPrintOutput(job.Path());
    {
        DialogAnswer cancel([](HWND dialog) { ::PostMessageA(dialog, WM_COMMAND, IDCANCEL, 0); });
        Key('P', VK_CONTROL);
    }
    EXPECT_EQ(Status(ViewerStatusBar::Message), "Printing cancelled.");
    EXPECT_EQ(::GetFileAttributesA(job.Path().c_str()), INVALID_FILE_ATTRIBUTES);

    bool currentChosen = false;
    {
        DialogAnswer all([&](HWND dialog) {
            currentChosen = ::IsDlgButtonChecked(dialog, Tavo_WiPrintDialog::CurrentPageButtonId) == BST_CHECKED;
            ::CheckRadioButton(dialog, Tavo_WiPrintDialog::AllPagesButtonId, Tavo_WiPrintDialog::PageRangeButtonId,
                               Tavo_WiPrintDialog::AllPagesButtonId);
            ::PostMessageA(dialog, WM_COMMAND, IDOK, 0);
        });
        Key('P', VK_CONTROL);
    }
    EXPECT_TRUE(currentChosen) << "the dialog opens on the current page";
    const Tavo_WiPrintLayout& layout = View().GetPrintLayout();
    ASSERT_GT(layout.m_numCols * layout.m_numRows, 1);
    const int pages = layout.m_numCols * layout.m_numRows;
    EXPECT_EQ(Status(ViewerStatusBar::Message), "Printed " + std::to_string(pages) + " pages of the " + std::to_string(layout.m_numCols) + " x " + std::to_string(layout.m_numRows) + " page grid to " + job.Path() + ".");
    const std::string postscript = ReadFile(job.Path());
    EXPECT_EQ(postscript.rfind("%!PS", 0), 0u);
    size_t pageMarks = 0;
    for (size_t at = postscript.find("%%Page:"); at != std::string::npos; at = postscript.find("%%Page:", at + 1))
        ++pageMarks;
    EXPECT_EQ(pageMarks, static_cast<size_t>(pages));
}

} // namespace
