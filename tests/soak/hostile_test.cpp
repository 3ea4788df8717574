// Hostile drawings in a real drawing window: each is drawn with a defined
// picture, zoomed by every form to both limits with a consistent view,
// clicked and asked for a data tip, and printed page by page to PostScript.
#include "hostile_drawings.h"
#include "soak_checks.h"
#include "soak_test_support.h"

#include "Tavo_WiDataTip.h"

#include <afxext.h>
#include <gtest/gtest.h>

#include <cctype>
#include <cmath>
#include <fstream>
#include <functional>
#include <iterator>
#include <limits>

using namespace SoakTest;

namespace {

// The scrollee is 500 x 400 without bars; at the zero level a drawing of
// square bounds fills the 400 x 400 square in its middle (one more column,
// as both edges of a rectangle are drawn).
constexpr int Width = 500;
constexpr int Height = 400;
const CRect SquareOfTheZeroLevel(50, 0, 451, 400);

int Count(const DibCanvas& canvas, COLORREF colour, const CRect& area)
{
    return canvas.CountPixels(colour, area.left, area.top, area.right, area.bottom);
}

int CountAll(const DibCanvas& canvas, COLORREF colour)
{
    return canvas.CountPixels(colour);
}

bool SquareOnly(const DibCanvas& canvas, COLORREF colour)
{
    const int square = SquareOfTheZeroLevel.Width() * SquareOfTheZeroLevel.Height();
    return Count(canvas, colour, SquareOfTheZeroLevel) == square &&
        CountAll(canvas, Background) == Width * Height - square;
}

struct Picture {
    Hostile::Kind kind;
    const char* what;
    std::function<bool(const DibCanvas&)> holds;
};

const Picture ZeroLevelPictures[] = {
    {Hostile::Empty, "nothing but the background",
     [](const DibCanvas& c) { return CountAll(c, Background) == Width * Height; }},
    {Hostile::OnePoint, "one white pixel in the middle",
     [](const DibCanvas& c) {
         return CountAll(c, Colour(Hostile::White)) == 1 && c.GetPixel(Width / 2, Height / 2) == Colour(Hostile::White);
     }},
    {Hostile::FullRange, "the red square (the white middle is far below a pixel)",
     [](const DibCanvas& c) { return SquareOnly(c, Colour(Hostile::Red)); }},
    {Hostile::Corners, "nothing: squares a ten-thousandth of a pixel wide are not drawn",
     [](const DibCanvas& c) { return CountAll(c, Background) == Width * Height; }},
    {Hostile::Degenerate, "the red square of the inverted rectangle and a few blue pixels of the empty items",
     [](const DibCanvas& c) {
         const int blue = CountAll(c, Colour(Hostile::Blue));
         return blue > 0 && blue <= 8 && Count(c, Colour(Hostile::Red), SquareOfTheZeroLevel) + blue >= SquareOfTheZeroLevel.Width() * SquareOfTheZeroLevel.Height();
     }},
    {Hostile::Crowd, "a red square of 2 x 2 pixels in the middle, and nothing else: every item on the point is that small",
     [](const DibCanvas& c) {
         return CountAll(c, Colour(Hostile::Red)) == 4 &&
             Count(c, Colour(Hostile::Red), CRect(Width / 2, Height / 2, Width / 2 + 2, Height / 2 + 2)) == 4;
     }},
    {Hostile::AbsurdText, "white and red text, each character of it smaller than the window",
     [](const DibCanvas& c) {
         return CountAll(c, Colour(Hostile::White)) > 1000 && CountAll(c, Colour(Hostile::Red)) > 1000;
     }},
};

// Zoomed to a world rectangle, the middle of the view shows a colour.
struct ZoomedPicture {
    Hostile::Kind kind;
    Tavo_GrWRect rect;
    char colour;
};

const ZoomedPicture ZoomedPictures[] = {
    {Hostile::FullRange, Hostile::Middle, Hostile::White},
    {Hostile::FullRange, {INT_MAX - 10, INT_MIN, INT_MAX, INT_MIN + 10}, Hostile::Red},
    {Hostile::Corners, Hostile::HighCorner, Hostile::Red},
    {Hostile::Corners, Hostile::LowInside, Hostile::Blue},
    {Hostile::Crowd, {Hostile::CrowdPoint.x - 1, Hostile::CrowdPoint.y - 1, Hostile::CrowdPoint.x + 1, Hostile::CrowdPoint.y + 1}, Hostile::Red},
    {Hostile::OnePoint, {Hostile::Point.x - 1, Hostile::Point.y - 1, Hostile::Point.x + 1, Hostile::Point.y + 1}, Hostile::White},
};

class HostileDrawingTest : public ::testing::TestWithParam<Hostile::Kind> {
protected:
    static void SetUpTestSuite()
    {
        for (int kind = 0; kind < Hostile::KindCount; ++kind)
            s_drawings[kind] = Hostile::Build(static_cast<Hostile::Kind>(kind));
    }
    static void TearDownTestSuite()
    {
        for (auto& drawing : s_drawings)
            drawing.reset();
    }

    void SetUp() override
    {
        wnd().SetScrollBarAutoVisibilityFlag(0);
        wnd().SetScrollBarVisibilityFlags(0, 0);
        wnd().SetDrawingInfo(Drawing(), 50, 3, 0, 0, 0);
        Settle(host);
        ASSERT_EQ(CSize(Capture(host)->GetWidth(), Capture(host)->GetHeight()), CSize(Width, Height));
    }

    Tavo_GrDrawing* Drawing() { return s_drawings[GetParam()].get(); }
    SoakDrawWnd& wnd() { return host.Wnd(); }
    // A paint of the whole view, then the checks of the soak.
    void Repaint(const char* after)
    {
        ::InvalidateRect(host.Scrollee(), nullptr, TRUE);
        Settle(host);
        EXPECT_EQ(Soak::CheckView(host), "") << after << ": " << Soak::DescribeView(host);
    }

    static inline std::unique_ptr<Tavo_GrDrawing> s_drawings[Hostile::KindCount];
    SoakHost host{CRect(50, 50, 50 + Width, 50 + Height)};
};

TEST_P(HostileDrawingTest, ZeroLevelShowsItsDefinedPicture)
{
    for (const Picture& picture : ZeroLevelPictures) {
        if (picture.kind != GetParam())
            continue;
        const auto first = Capture(host);
        EXPECT_TRUE(picture.holds(*first)) << picture.what;
        Repaint("a repaint");
        EXPECT_EQ(CountAll(*Capture(host), Background), CountAll(*first, Background)) << "the same picture again";
    }
}

TEST_P(HostileDrawingTest, ZoomsByEveryFormToBothLimitsWithAConsistentView)
{
    const double nan = std::numeric_limits<double>::quiet_NaN();
    const struct
    {
        const char* name;
        std::function<void(SoakDrawWnd&)> zoom;
    } zooms[] = {
        {"in by INT_MAX", [](SoakDrawWnd& w) { w.ZoomWindow(Tavo_GrZoom::In, INT_MAX, Tavo_WiZoomCenter::AtViewCentre, 0, 0, false); }},
        {"in once more", [](SoakDrawWnd& w) { w.ZoomWindow(Tavo_GrZoom::In, 1, Tavo_WiZoomCenter::AtPoint, 10, 10, true); }},
        {"out by INT_MAX", [](SoakDrawWnd& w) { w.ZoomWindow(Tavo_GrZoom::Out, INT_MAX, Tavo_WiZoomCenter::AtCursor, 0, 0, false); }},
        {"to the largest level", [](SoakDrawWnd& w) { w.ZoomWindow(Tavo_GrZoom::ToLevel, 50, Tavo_WiZoomCenter::AtPoint, -5, 900, false); }},
        {"to level 1e9", [](SoakDrawWnd& w) { w.ZoomWindow(1e9, INT_MIN, INT_MAX); }},
        {"to level NaN", [nan](SoakDrawWnd& w) { w.ZoomWindow(nan, 0, 0); }},
        {"to level -1", [](SoakDrawWnd& w) { w.ZoomWindow(-1.0, 0, 0); }},
        {"to a rectangle of one unit", [](SoakDrawWnd& w) { w.ZoomWindow(Tavo_GrWRect{INT_MAX - 1, INT_MAX - 1, INT_MAX, INT_MAX}); }},
        {"to the whole int range", [](SoakDrawWnd& w) { w.ZoomWindow(Tavo_GrWRect{INT_MIN, INT_MIN, INT_MAX, INT_MAX}); }},
        {"to an inverted rectangle", [](SoakDrawWnd& w) { w.ZoomWindow(Tavo_GrWRect{100, 100, -100, -100}); }},
        {"back by undo", [](SoakDrawWnd& w) { w.UndoLastScrollZoom(); }},
        {"forth by undo", [](SoakDrawWnd& w) { w.UndoLastScrollZoom(); }},
        {"to the bottom right", [](SoakDrawWnd& w) {
             w.ScrollWindow(Tavo_WiScroll::Down, Tavo_WiScroll::Limit, 0);
             w.ScrollWindow(Tavo_WiScroll::Right, Tavo_WiScroll::Limit, 0);
         }},
        {"by absurd device deltas", [](SoakDrawWnd& w) { w.ScrollWindowByDeviceDeltas(INT_MIN, INT_MAX); }},
        {"to the zero level", [](SoakDrawWnd& w) { w.ZoomWindow(Tavo_GrZoom::ZeroLevel, 0, Tavo_WiZoomCenter::AtViewCentre, 0, 0, false); }},
    };
    for (const auto& z : zooms) {
        z.zoom(wnd());
        Repaint(z.name);
        EXPECT_LE(wnd().GetZoomLevel(), 50.0) << z.name;
    }
    // Rebound with room to zoom until a square of a thousand units fills the view.
    wnd().SetDrawingInfo(Drawing(), 200, 3, 0, 0, 0);
    for (const ZoomedPicture& picture : ZoomedPictures) {
        if (picture.kind != GetParam())
            continue;
        wnd().ZoomWindow(picture.rect);
        Repaint("a zoom to a rectangle");
        EXPECT_EQ(Capture(host)->GetPixel(Width / 2, Height / 2), Colour(picture.colour))
            << "zoomed to (" << picture.rect.x1 << ", " << picture.rect.y1 << ", " << picture.rect.x2 << ", "
            << picture.rect.y2 << ")";
    }
}

TEST_P(HostileDrawingTest, ClicksAndDataTipsGiveTheApertureOfThePointUnderThePointer)
{
    for (const int level : {0, 50}) {
        wnd().ZoomWindow(Tavo_GrZoom::ToLevel, level, Tavo_WiZoomCenter::AtViewCentre, 0, 0, true);
        Settle(host);
        const CPoint middle(Width / 2, Height / 2);
        Tavo_GrWRect aperture;
        ASSERT_EQ(wnd().FetchApertureFromPoint(middle, aperture), 1) << level;
        const Tavo_GrWRect view = wnd().GetWorldClipBox();
        EXPECT_LE(aperture.x1, aperture.x2) << level;
        EXPECT_TRUE(Tavo_GrIntersects(aperture, view)) << level;

        const int clicks = wnd().counts.clicks;
        const DWORD time = ScrollTest::FreshTime();
        POINT screen = {middle.x, middle.y};
        ::ClientToScreen(host.Scrollee(), &screen);
        ScrollTest::SendMouse(MOUSEEVENTF_LEFTDOWN, screen, time);
        ScrollTest::SendMouse(MOUSEEVENTF_LEFTUP, screen, time + 40);
        ScrollTest::PumpInput();
        EXPECT_EQ(wnd().counts.clicks, clicks + 1) << level;

        wnd().dataTipText = "hostile";
        wnd().OnParkedCursorStart(middle);
        EXPECT_TRUE(wnd().GetScrollee()->GetDataTip()->IsVisible()) << level;
        wnd().OnParkedCursorEnd();
    }
}

TEST_P(HostileDrawingTest, PrintsEveryPageOfItsGridToPostScript)
{
    CWinApp app("hostile test");
    // Zoomed in a little, so that the grid has more than one page where the
    // drawing reaches beyond the view.
    wnd().ZoomWindow(Tavo_GrZoom::ToLevel, 3, Tavo_WiZoomCenter::AtViewCentre, 0, 0, false);
    CPrintInfo info;
    wnd().OnPreparePrinting(&info);
    const UINT pages = std::min<UINT>(info.m_pPD->m_pd.nMaxPage, 4);
    CDC printer;
    ASSERT_TRUE(app.CreatePrinterDC(printer));
    char folder[MAX_PATH] = {};
    ::GetTempPathA(MAX_PATH, folder);
    const std::string path = std::string(folder) + "hostile_test.ps";
    DOCINFOA document = {sizeof document, "hostile test", path.c_str(), nullptr, 0};
    ASSERT_GT(printer.StartDoc(&document), 0);
    for (UINT page = 1; page <= pages; ++page) {
        info.m_nCurPage = page;
        ASSERT_GT(printer.StartPage(), 0);
        wnd().OnPrint(&printer, &info);
        ASSERT_GT(printer.EndPage(), 0);
    }
    ASSERT_GT(printer.EndDoc(), 0);

    std::ifstream file(path, std::ios::binary);
    const std::string job((std::istreambuf_iterator<char>(file)), std::istreambuf_iterator<char>());
    file.close();
    ::DeleteFileA(path.c_str());
    EXPECT_EQ(job.rfind("%!PS", 0), 0u);
    size_t printed = 0;
    for (size_t at = job.find("\n%%Page:"); at != std::string::npos; at = job.find("\n%%Page:", at + 1))
        ++printed;
    EXPECT_EQ(printed, pages);
}

INSTANTIATE_TEST_SUITE_P(Kinds, HostileDrawingTest,
                         ::testing::Values(Hostile::Empty, Hostile::OnePoint, Hostile::FullRange, Hostile::Corners,
                                           Hostile::Degenerate, Hostile::Crowd, Hostile::AbsurdText),
                         [](const ::testing::TestParamInfo<Hostile::Kind>& kind) {
                             std::string name = Hostile::NameOf(kind.param);
                             for (char& c : name)
                                 if (!std::isalnum(static_cast<unsigned char>(c)))
                                     c = '_';
                             return name;
                         });

} // namespace
