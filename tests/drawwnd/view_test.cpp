// Tavo_WiDrawWnd: binding a drawing, the paint path, the coordinate
// conversions, invalidation, zooming, panning and live resizing, on real
// windows under Wine.
#include "drawwnd_test_support.h"

#include "Tavo_GrRound.h"
#include "Tavo_WiViewMath.h"

#include <gtest/gtest.h>

#include <climits>
#include <cmath>
#include <limits>
#include <memory>

using namespace DrawWndTest;
using ScrollTest::PixelAt;
using Tavo_WiScroll::Down;
using Tavo_WiScroll::Left;
using Tavo_WiScroll::Right;
using Tavo_WiScroll::Up;

namespace {

constexpr COLORREF RedPixel = RGB(255, 0, 0);
constexpr COLORREF WhitePixel = RGB(255, 255, 255);
constexpr COLORREF BluePixel = RGB(0, 0, 255);
// What the scrollee's eraser leaves where nothing is drawn.
constexpr COLORREF ErasedPixel = RGB(0, 0, 0);

const Tavo_WiScroll::Dir AllDirs[] = {Left, Right, Up, Down};

// 1000 x 800 world units: red on the left half, white on the right, a blue
// band along the bottom 100 units. In a 500 x 400 scrollee the zero level
// shows it at exactly half a pixel per unit.
struct HalvesDrawing {
    HalvesDrawing()
    {
        AddFilledRect(drawing, {0, 0, 500, 800}, Red);
        AddFilledRect(drawing, {500, 0, 1000, 800}, White);
        AddFilledRect(drawing, {0, 0, 1000, 100}, Blue);
    }
    static constexpr Tavo_GrWRect Bounds = {0, 0, 1000, 800};
    Tavo_GrDrawing drawing;
};

// Lines, circles, rectangles and text of many colours and sizes over 1000 x
// 800 world units, so that a strip cut anywhere crosses shapes and words
// whose pixels must meet the moved ones exactly.
struct BusyDrawing {
    BusyDrawing()
    {
        AddShapes();
        AddLabels();
    }

    void AddShapes()
    {
        Tavo_GrDrawingBuilder build(drawing);
        build.BeginLayer("busy");
        for (int i = 0; i <= 40; ++i) {
            build.SetAttr(Tavo_GrAttr(static_cast<char>(i % 15), 0));
            build.AddLine(i * 25, 0, 1000 - i * 25, 800);
            build.AddLine(0, i * 20, 1000, 800 - i * 20);
        }
        for (int x = 0; x < 10; ++x) {
            for (int y = 0; y < 8; ++y) {
                build.SetAttr(Tavo_GrAttr(static_cast<char>((x + y) % 15), static_cast<char>((x * y) % 2)));
                build.AddCircle(50 + 100 * x, 50 + 100 * y, 20 + 3 * x);
                build.AddRect(10 + 100 * x, 70 + 100 * y, 37 + 100 * x, 93 + 100 * y);
            }
        }
    }

    // Words every 40 units, of heights from below the smallest font to
    // several lines, in every alignment, and wrapped text boxes.
    void AddLabels()
    {
        static const char alignments[] = {
            Tavo_GrAttr::AlignLeft | Tavo_GrAttr::AlignBottom, Tavo_GrAttr::AlignRight | Tavo_GrAttr::AlignTop,
            Tavo_GrAttr::AlignCentre | Tavo_GrAttr::AlignMiddle, Tavo_GrAttr::AlignLeft | Tavo_GrAttr::AlignTop};
        Tavo_GrDrawingBuilder build(drawing);
        build.BeginLayer("labels");
        int n = 0;
        for (int x = 0; x < 1000; x += 40) {
            for (int y = 10; y < 800; y += 40, ++n) {
                build.SetAttr(Tavo_GrAttr(static_cast<char>(n % 15), 0, 4 + (n * 7) % 40, alignments[n % 4]));
                if (n % 5 == 0)
                    build.AddTextBox({x, y, x + 90, y + 35}, "Wrapped words in a box");
                else
                    build.AddText(x, y, n % 2 ? "Mgjy" : "W|q");
            }
        }
        // Words below the smallest font, drawn at it, so more than twice as
        // long as their own bounds, and closer together than that: some of
        // them straddle every strip's edge.
        build.SetAttr(Tavo_GrAttr(White, 0, 6));
        for (int x = 3; x < 1000; x += 70)
            for (int y = 5; y < 800; y += 37)
                build.AddText(x, y, "WWWWWW");
    }

    Tavo_GrDrawing drawing;
};

class DrawWndViewTest : public ::testing::Test {
protected:
    void Bind(int zeroLevelExpansion = 0)
    {
        hosted.wnd.SetDrawingInfo(&halves.drawing, 50, 3, zeroLevelExpansion, 0, 0);
        PaintNow(Scrollee());
    }
    TestDrawWnd& Wnd() { return hosted.wnd; }
    HWND Scrollee() { return hosted.Scrollee(); }
    const Tavo_GrTransform& Transform() { return hosted.wnd.GetMapping()->GetTransform(); }
    double Scale() { return Transform().GetScale(); }

    // The world point shown at a client pixel, as painted.
    Tavo_GrWPoint WorldAt(const CPoint& client)
    {
        const int h = hosted.wnd.GetMapping()->GetDeviceWindowHeight();
        return {Transform().Invertxcoord(client.x), Transform().Invertycoord(h - client.y)};
    }
    CPoint ToScreen(const CPoint& client)
    {
        POINT p = {client.x, client.y};
        ::ClientToScreen(Scrollee(), &p);
        return CPoint(p.x, p.y);
    }
    void Zoom(Tavo_GrZoom::Type type, int amount, Tavo_WiZoomCenter::Type centre = Tavo_WiZoomCenter::AtViewCentre,
              int x = 0, int y = 0, bool force = false)
    {
        hosted.wnd.ZoomWindow(type, amount, centre, x, y, force);
        PaintNow(Scrollee());
    }
    // The scroll position after scrolling to the end of the range that way.
    CPoint ScrolledToLimit(Tavo_WiScroll::Dir dir)
    {
        hosted.wnd.ScrollWindow(dir, Tavo_WiScroll::Limit, 0);
        return hosted.wnd.GetScrollPosition();
    }
    bool BarShown(UINT id) { return ::IsWindowVisible(::GetDlgItem(hosted.wnd.GetSafeHwnd(), id)) != FALSE; }

    HalvesDrawing halves;
    HostedDrawWnd hosted;
};

// ---- the pure arithmetic of the view -----------------------------------------------

TEST(ViewMath, ScrollRangeHasMarginsOnlyWhenZoomedIn)
{
    const Tavo_GrWRect bounds = {0, 0, 1000, 800};
    const Tavo_GrWRect visible = {-100, 200, 400, 900}; // sticks out left and above
    const double nan = std::numeric_limits<double>::quiet_NaN();
    const double inf = std::numeric_limits<double>::infinity();
    const struct {
        double scale;
        bool zoomedIn;
        int xMin, xMax, yMin, yMax;
    } cases[] = {
        {1.0, false, -100, 1000, 0, 900},    // left and top from the view alone
        {1.0, true, -200, 1100, -150, 950},  // 100 pixels are 100 units: 150 below, 50 above
        {0.4, true, -350, 1250, -375, 1025}, // 100 pixels are 250 units
        {0.0, true, -100, 1000, 0, 900},     // no usable scale: no margin
        {nan, true, -100, 1000, 0, 900},
        {inf, true, -100, 1000, 0, 900},
        {1e-12, true, INT_MIN, INT_MAX, INT_MIN, 900 + INT_MAX / 2}, // saturates
    };
    for (const auto& c : cases) {
        const Tavo_WiViewMath::ScrollRange r = Tavo_WiViewMath::ScrollRangeFor(bounds, visible, c.scale, c.zoomedIn);
        EXPECT_EQ(r.xMin, c.xMin) << c.scale;
        EXPECT_EQ(r.xMax, c.xMax) << c.scale;
        EXPECT_EQ(r.yMin, c.yMin) << c.scale;
        EXPECT_EQ(r.yMax, c.yMax) << c.scale;
    }
}

TEST(ViewMath, DeltasRoundAwayFromZeroAndNeverLeaveAnUnboundedError)
{
    // The ordinary cases are checked through the window; here the extremes.
    const double inf = std::numeric_limits<double>::infinity();
    const struct {
        long long world;
        double scale;
        int pixels;
        double error;
    } toDevice[] = {
        {-3, 1.5, -5, -0.5}, {1, 0.3, 0, -0.3}, {0, inf, 0, 0.0}, {5, 0.0, 0, 0.0},
        // Beyond int range the whole view is uncovered: nothing to line up with.
        {10000, 1e6, INT_MAX, 0.0},
        {-2, inf, INT_MIN, 0.0}};
    for (const auto& c : toDevice) {
        const Tavo_WiViewMath::DeviceDelta d = Tavo_WiViewMath::ToDeviceDelta(c.world, c.scale);
        EXPECT_EQ(d.pixels, c.pixels) << c.world << " at " << c.scale;
        EXPECT_DOUBLE_EQ(d.error, c.error) << c.world << " at " << c.scale;
    }
    const struct {
        int device;
        double scale;
        int world;
    } toWorld[] = {
        {7, 0.5, 14}, {-15, 10.0, -2}, {3, 0.0, 0}, {INT_MAX, 1e-3, INT_MAX}, {INT_MIN, 1e-3, -INT_MAX}};
    for (const auto& c : toWorld)
        EXPECT_EQ(Tavo_WiViewMath::ToWorldStep(c.device, c.scale), c.world) << c.device << " at " << c.scale;
}

// ---- binding and painting ------------------------------------------------------------

TEST_F(DrawWndViewTest, UnboundWindowPaintsNothingAndIgnoresEveryViewOperation)
{
    // Never laid out, the scrollee keeps its 10 x 10 pixels of creation.
    ::InvalidateRect(Scrollee(), nullptr, TRUE);
    PaintNow(Scrollee());
    EXPECT_EQ(Wnd().paints, 0);
    EXPECT_EQ(PixelAt(Scrollee(), 5, 5), ErasedPixel);

    const CPoint position = Wnd().GetScrollPosition();
    Wnd().InvalidateRect(Tavo_GrWRect{0, 0, 10, 10}, true);
    Wnd().ZoomWindow(Tavo_GrZoom::In, 1, Tavo_WiZoomCenter::AtCursor, 0, 0, true);
    Wnd().ZoomWindow(2.0, 10, 10);
    Wnd().ZoomWindow(Tavo_GrWRect{0, 0, 10, 10});
    Wnd().UndoLastScrollZoom();
    Wnd().CenterWindowAtCursor();
    Wnd().ScrollWindowByDeviceDeltas(5, 5);
    Wnd().OnEnterSizeMove();
    Wnd().OnExitSizeMove();
    EXPECT_TRUE(PendingUpdate(Scrollee()).IsRectEmpty());
    EXPECT_EQ(Wnd().GetScrollPosition(), position);
    EXPECT_EQ(Wnd().GetMapping(), nullptr);
    EXPECT_EQ(Wnd().GetWorldClipBox(), Tavo_GrWRect());
    EXPECT_FALSE(Wnd().ZoomWindowTest(Tavo_GrZoom::In, 1));
    for (Tavo_WiScroll::Dir dir : AllDirs)
        EXPECT_FALSE(Wnd().ScrollWindowTest(dir, Tavo_WiScroll::Limit, 0)) << dir;
    int dx = 0;
    int dy = 0;
    Wnd().GetScrollDeviceDeltas(CPoint(10, 20), CPoint(3, 5), dx, dy, 1);
    EXPECT_EQ(CPoint(dx, dy), CPoint(7, 15));
}

TEST_F(DrawWndViewTest, BoundWithoutSurfacePaintsNothingWhileTheScrolleeStillErases)
{
    Bind();
    ASSERT_EQ(PixelAt(Scrollee(), 100, 200), RedPixel);
    const int paints = Wnd().paints;
    Wnd().useSurface = false;
    ::InvalidateRect(Scrollee(), nullptr, TRUE);
    PaintNow(Scrollee());
    EXPECT_EQ(Wnd().paints, paints);
    EXPECT_EQ(PixelAt(Scrollee(), 100, 200), ErasedPixel);
}

TEST_F(DrawWndViewTest, DrawingBoundRightAfterCreateIsFittedToTheRealClientArea)
{
    Bind();
    EXPECT_EQ(Wnd().surface.GetSurfaceOption(), 3);
    EXPECT_TRUE(Wnd().surface.IsScreenPaint());
    EXPECT_EQ(hosted.ScrolleeSize(), CSize(500, 400));
    EXPECT_DOUBLE_EQ(Scale(), 0.5);
    EXPECT_EQ(Wnd().GetWorldClipBox(), HalvesDrawing::Bounds);
    EXPECT_GT(Wnd().paints, 0);
    // World y grows upwards: the blue band along the bottom of the drawing
    // fills the bottom 50 rows (client y grows downwards).
    const struct {
        int x, y;
        COLORREF colour;
    } pixels[] = {
        {100, 200, RedPixel}, {400, 200, WhitePixel}, {100, 352, BluePixel}, {400, 398, BluePixel}, {100, 347, RedPixel}, {248, 100, RedPixel}, {252, 100, WhitePixel}};
    for (const auto& p : pixels)
        EXPECT_EQ(PixelAt(Scrollee(), p.x, p.y), p.colour) << p.x << ", " << p.y;
}

TEST_F(DrawWndViewTest, RebindingStartsAgainAtTheZeroLevelAndUnbindingStopsPainting)
{
    Bind();
    Zoom(Tavo_GrZoom::In, 5);
    HalvesDrawing other;
    Wnd().SetDrawingInfo(&other.drawing, 50, 7, 0, 0, 0);
    PaintNow(Scrollee());
    EXPECT_EQ(Wnd().surface.GetSurfaceOption(), 7);
    EXPECT_EQ(Wnd().GetZoomLevel(), 0.0);
    EXPECT_EQ(Wnd().GetWorldClipBox(), HalvesDrawing::Bounds);
    EXPECT_EQ(PixelAt(Scrollee(), 100, 200), RedPixel);

    const int paints = Wnd().paints;
    Wnd().SetDrawingInfo(nullptr, 50, 3, 0, 0, 0);
    ::InvalidateRect(Scrollee(), nullptr, TRUE);
    PaintNow(Scrollee());
    EXPECT_EQ(Wnd().GetMapping(), nullptr);
    EXPECT_EQ(Wnd().paints, paints);
}

// ---- invalidation ------------------------------------------------------------------------

TEST_F(DrawWndViewTest, InvalidateRectMarksTheScreenAreaWithItsMarginUnlessWhollyOutside)
{
    Bind();
    // The clip box is (0, 0, 1000, 800) at half a pixel per unit; the
    // update region is clipped to the 500 x 400 client area.
    const struct {
        Tavo_GrWRect world;
        CRect update;
    } cases[] = {
        {{0, 0, 0, 0}, CRect(0, 0, 0, 0)},
        {{1001, 100, 1200, 200}, CRect(0, 0, 0, 0)},
        {{-300, -200, -1, 100}, CRect(0, 0, 0, 0)},
        {{100, 801, 300, 900}, CRect(0, 0, 0, 0)},
        {{100, 100, 300, 200}, CRect(48, 298, 152, 352)},
        {{300, 200, 100, 100}, CRect(48, 298, 152, 352)},    // corners in any order
        {{1000, 100, 1200, 200}, CRect(498, 298, 500, 352)}, // shares the right edge only
        {{-200, 800, 0, 900}, CRect(0, 0, 2, 2)},            // shares the top-left corner only
    };
    for (const auto& c : cases) {
        ::ValidateRect(Scrollee(), nullptr);
        Wnd().InvalidateRect(c.world, false);
        EXPECT_EQ(PendingUpdate(Scrollee()), c.update)
            << c.world.x1 << ", " << c.world.y1 << ", " << c.world.x2 << ", " << c.world.y2;
    }
}

// ---- the zero level and zooming -----------------------------------------------------

TEST_F(DrawWndViewTest, ZeroLevelFitsTheDrawingWithARangeWithoutMargins)
{
    Bind();
    EXPECT_EQ(Wnd().GetScrollPosition(), CPoint(0, 800));
    EXPECT_EQ(Wnd().GetWindowExtent(), CSize(1000, 800));
    EXPECT_FALSE(BarShown(Tavo_WiScrollWnd::HorzBarId));
    EXPECT_FALSE(BarShown(Tavo_WiScrollWnd::VertBarId));
    for (Tavo_WiScroll::Dir dir : AllDirs)
        for (Tavo_WiScroll::Amount amount : {Tavo_WiScroll::Line, Tavo_WiScroll::Page, Tavo_WiScroll::Limit})
            EXPECT_FALSE(Wnd().ScrollWindowTest(dir, amount, 0)) << dir << " " << amount;
}

TEST_F(DrawWndViewTest, ZoomedInRangeReachesTheMarginsBeyondDrawingAndView)
{
    // Zoom-in amounts from the zero level; with an expansion the view is
    // wider than the drawing even after one level in.
    const struct {
        int expansion;
        int amount;
    } cases[] = {{0, 5}, {0, 10}, {50, 1}};
    for (const auto& c : cases) {
        Bind(c.expansion);
        Zoom(Tavo_GrZoom::In, c.amount);
        ASSERT_GT(Wnd().GetZoomLevel(), 0.0);
        for (Tavo_WiScroll::Dir dir : AllDirs)
            EXPECT_TRUE(Wnd().ScrollWindowTest(dir, Tavo_WiScroll::Line, 0)) << dir;

        // 100 pixels' worth of units left and right, 150 below, 50 above,
        // beyond the union of the drawing and the view.
        const Tavo_GrWRect v = Wnd().GetWorldClipBox();
        const Tavo_GrWRect u = {std::min(0, v.x1), std::min(0, v.y1), std::max(1000, v.x2), std::max(800, v.y2)};
        const int m = Tavo_GrRound(100.0 / Scale());
        const CSize extent = Wnd().GetWindowExtent();
        EXPECT_EQ(ScrolledToLimit(Left).x, u.x1 - m) << c.amount;
        EXPECT_EQ(ScrolledToLimit(Right).x, u.x2 + m - extent.cx) << c.amount;
        EXPECT_EQ(ScrolledToLimit(Up).y, u.y2 + m / 2) << c.amount;
        EXPECT_EQ(ScrolledToLimit(Down).y, u.y1 - 3 * m / 2 + extent.cy) << c.amount;
    }
}

TEST_F(DrawWndViewTest, ZoomAtAPixelKeepsTheWorldPointUnderIt)
{
    // Client pixels; the first zoom from the zero level also brings the
    // scroll bars, which take rows and columns off the bottom and right.
    const struct {
        Tavo_WiZoomCenter::Type centre;
        CPoint pixel;
        int amount;
    } cases[] = {
        {Tavo_WiZoomCenter::AtPoint, CPoint(250, 200), 5},
        {Tavo_WiZoomCenter::AtPoint, CPoint(100, 300), 3},
        {Tavo_WiZoomCenter::AtPoint, CPoint(470, 20), 7},
        {Tavo_WiZoomCenter::AtCursor, CPoint(400, 50), 5},
        {Tavo_WiZoomCenter::AtCursor, CPoint(30, 360), 2},
        {Tavo_WiZoomCenter::AtCursor, CPoint(0, 0), 10},
    };
    for (const auto& c : cases) {
        Bind();
        const Tavo_GrWPoint before = WorldAt(c.pixel);
        const CPoint screen = ToScreen(c.pixel);
        ::SetCursorPos(screen.x, screen.y);
        // A device point: client y = 0 is device y = 400.
        Zoom(Tavo_GrZoom::In, c.amount, c.centre, c.pixel.x, 400 - c.pixel.y);
        ASSERT_GT(Wnd().GetZoomLevel(), 0.0);
        const Tavo_GrWPoint after = WorldAt(c.pixel);
        EXPECT_NEAR(after.x, before.x, 1) << c.pixel.x << ", " << c.pixel.y;
        EXPECT_NEAR(after.y, before.y, 1) << c.pixel.x << ", " << c.pixel.y;
    }
    // The red-white border at world x = 500 stays in client column 250.
    Bind();
    Zoom(Tavo_GrZoom::In, 5, Tavo_WiZoomCenter::AtPoint, 250, 200);
    EXPECT_EQ(PixelAt(Scrollee(), 248, 100), RedPixel);
    EXPECT_EQ(PixelAt(Scrollee(), 252, 100), WhitePixel);
}

TEST_F(DrawWndViewTest, ZoomAtTheViewCentreCentresOnTheDrawingFirstAndOnTheViewThen)
{
    Bind();
    Zoom(Tavo_GrZoom::In, 5);
    // The scroll bars that came with the zoom took their pixels off the
    // bottom and the right without moving the picture: the drawing's middle
    // is where the middle of the view was.
    EXPECT_NEAR(WorldAt(CPoint(250, 200)).x, 500, 1);
    EXPECT_NEAR(WorldAt(CPoint(250, 200)).y, 400, 1);
    const CSize size = hosted.ScrolleeSize();
    const CPoint middle(size.cx / 2, size.cy / 2);

    Wnd().ScrollWindowByDeviceDeltas(-120, 60);
    PaintNow(Scrollee());
    const Tavo_GrWPoint shown = WorldAt(middle);
    Zoom(Tavo_GrZoom::In, 2);
    EXPECT_NEAR(WorldAt(middle).x, shown.x, 1);
    EXPECT_NEAR(WorldAt(middle).y, shown.y, 1);
}

TEST_F(DrawWndViewTest, ZoomThatKeepsTheLevelTouchesNothingUnlessForced)
{
    // At the zero level of a window whose largest level is 5.
    const struct {
        Tavo_GrZoom::Type type;
        int amount;
    } unchanged[] = {
        {Tavo_GrZoom::Out, 1}, {Tavo_GrZoom::ZeroLevel, 1}, {Tavo_GrZoom::Keep, 1}, {Tavo_GrZoom::ToLevel, 0}};
    for (const auto& c : unchanged) {
        Wnd().SetDrawingInfo(&halves.drawing, 5, 3, 0, 0, 0);
        PaintNow(Scrollee());
        const Tavo_GrWRect clip = Wnd().GetMapping()->GetWorldClipBox();
        EXPECT_FALSE(Wnd().ZoomWindowTest(c.type, c.amount));
        Wnd().ZoomWindow(c.type, c.amount, Tavo_WiZoomCenter::AtPoint, 10, 10, false);
        EXPECT_TRUE(PendingUpdate(Scrollee()).IsRectEmpty()) << c.type;
        EXPECT_EQ(Wnd().GetMapping()->GetWorldClipBox(), clip) << c.type;
        // The undo clip box is still empty, so an undo does nothing either.
        Wnd().UndoLastScrollZoom();
        EXPECT_TRUE(PendingUpdate(Scrollee()).IsRectEmpty()) << c.type;

        Wnd().ZoomWindow(c.type, c.amount, Tavo_WiZoomCenter::AtViewCentre, 0, 0, true);
        EXPECT_EQ(PendingUpdate(Scrollee()), CRect(0, 0, 500, 400)) << c.type;
        EXPECT_EQ(Wnd().GetMapping()->GetWorldClipBox(), clip) << c.type;
    }
    // At the largest level a further level in changes nothing either.
    Zoom(Tavo_GrZoom::ToLevel, 5);
    const Tavo_GrWRect deepest = Wnd().GetMapping()->GetWorldClipBox();
    EXPECT_FALSE(Wnd().ZoomWindowTest(Tavo_GrZoom::In, 1));
    Wnd().ZoomWindow(Tavo_GrZoom::In, 1, Tavo_WiZoomCenter::AtViewCentre, 0, 0, false);
    EXPECT_TRUE(PendingUpdate(Scrollee()).IsRectEmpty());
    EXPECT_EQ(Wnd().GetMapping()->GetWorldClipBox(), deepest);
}

TEST_F(DrawWndViewTest, UndoTogglesBetweenTheLastTwoViewsAndDoesNothingBeforeAnyZoom)
{
    Bind();
    const Tavo_GrWRect whole = Wnd().GetMapping()->GetWorldClipBox();
    Wnd().UndoLastScrollZoom();
    EXPECT_TRUE(PendingUpdate(Scrollee()).IsRectEmpty());
    EXPECT_EQ(Wnd().GetMapping()->GetWorldClipBox(), whole);

    Zoom(Tavo_GrZoom::In, 5, Tavo_WiZoomCenter::AtPoint, 100, 300);
    const double zoomedScale = Scale();
    for (int round = 0; round < 2; ++round) {
        // The view before the first undo of the pair, to the unit that
        // centring a rectangle of odd width on a whole unit may shift.
        const Tavo_GrWRect zoomed = Wnd().GetMapping()->GetWorldClipBox();
        Wnd().UndoLastScrollZoom();
        PaintNow(Scrollee());
        EXPECT_EQ(Wnd().GetZoomLevel(), 0.0) << round;
        EXPECT_EQ(Wnd().GetMapping()->GetWorldClipBox(), whole) << round;

        Wnd().UndoLastScrollZoom();
        PaintNow(Scrollee());
        EXPECT_DOUBLE_EQ(Scale(), zoomedScale) << round;
        const Tavo_GrWRect back = Wnd().GetMapping()->GetWorldClipBox();
        EXPECT_NEAR(back.x1, zoomed.x1, 1) << round;
        EXPECT_NEAR(back.y1, zoomed.y1, 1) << round;
        EXPECT_NEAR(back.x2, zoomed.x2, 1) << round;
        EXPECT_NEAR(back.y2, zoomed.y2, 1) << round;
    }
    // Rebinding forgets the view of the old drawing.
    Bind();
    Wnd().UndoLastScrollZoom();
    EXPECT_TRUE(PendingUpdate(Scrollee()).IsRectEmpty());
    EXPECT_EQ(Wnd().GetZoomLevel(), 0.0);
}

TEST_F(DrawWndViewTest, ZoomToARectangleFillsTheViewWithItAndIgnoresADegenerateOne)
{
    Bind();
    const CPoint position = Wnd().GetScrollPosition();
    for (const Tavo_GrWRect& degenerate : {Tavo_GrWRect{}, Tavo_GrWRect{100, 100, 100, 500}, Tavo_GrWRect{0, 7, 900, 7}}) {
        Wnd().ZoomWindow(degenerate);
        EXPECT_TRUE(PendingUpdate(Scrollee()).IsRectEmpty());
        EXPECT_EQ(Wnd().GetScrollPosition(), position);
    }
    Wnd().ZoomWindow(Tavo_GrWRect{400, 300, 600, 500});
    PaintNow(Scrollee());
    const Tavo_GrWRect shown = Wnd().GetWorldClipBox();
    EXPECT_LE(shown.x1, 400);
    EXPECT_LE(shown.y1, 300);
    EXPECT_GE(shown.x2, 600);
    EXPECT_GE(shown.y2, 500);
    // Fills it: the view is not much more than the rectangle on its tighter axis.
    EXPECT_LE(shown.y2 - shown.y1, 200 * 1.15 + 2);
    // The model agrees with the view the scrollee shows (to the unit that
    // rounding the view's corners may add).
    EXPECT_NEAR(Wnd().GetWindowExtent().cx, shown.x2 - shown.x1, 1);
    EXPECT_NEAR(Wnd().GetWindowExtent().cy, shown.y2 - shown.y1, 1);
}

// ---- device deltas and panning ---------------------------------------------------------

TEST(DrawWndDeltas, WorldDeltasBecomeRoundedPixelsWithTheRestKeptAsErrorTerms)
{
    // 400 x 320 world units in a 600 x 480 scrollee: 1.5 pixels per unit.
    Tavo_GrDrawing drawing;
    AddFilledRect(drawing, {0, 0, 400, 320}, Red);
    HostedDrawWnd hosted(CRect(0, 0, 600, 480), CRect(50, 50, 700, 580));
    hosted.wnd.SetDrawingInfo(&drawing, 50, 3, 0, 0, 0);
    ASSERT_DOUBLE_EQ(hosted.wnd.GetMapping()->GetTransform().GetScale(), 1.5);

    const struct {
        CPoint from, to;
        int scrolling;
        int dx, dy;
        double errorX, errorY;
    } cases[] = {
        {CPoint(3, 0), CPoint(0, 0), 1, 5, 0, 0.5, 0.0}, // 4.5 rounds away from zero
        {CPoint(3, 0), CPoint(0, 0), 0, 5, 0, 0.5, 0.0}, // measuring keeps the error terms
        {CPoint(0, 0), CPoint(3, 3), 1, -5, -5, 0.0, -0.5},
        {CPoint(10, 12), CPoint(8, 10), 1, 3, 3, 0.0, -0.5}, // whole pixels add nothing
        {CPoint(0, 1), CPoint(0, 0), 1, 0, 2, 0.0, 0.0},
    };
    for (const auto& c : cases) {
        int dx = 0;
        int dy = 0;
        hosted.wnd.GetScrollDeviceDeltas(c.from, c.to, dx, dy, c.scrolling);
        EXPECT_EQ(CPoint(dx, dy), CPoint(c.dx, c.dy));
        EXPECT_DOUBLE_EQ(hosted.wnd.GetMapping()->GetXErrorTerm(), c.errorX);
        EXPECT_DOUBLE_EQ(hosted.wnd.GetMapping()->GetYErrorTerm(), c.errorY);
    }
}

TEST(DrawWndDeltas, DeviceDeltasScrollByRoundedWorldUnitsAndAtLeastOne)
{
    // 100 x 80 units in 500 x 400: 5 pixels per unit, 10 after five levels in.
    Tavo_GrDrawing drawing;
    AddFilledRect(drawing, {0, 0, 100, 80}, Red);
    HostedDrawWnd hosted;
    hosted.wnd.SetDrawingInfo(&drawing, 50, 3, 0, 0, 0);
    hosted.wnd.ZoomWindow(Tavo_GrZoom::In, 5, Tavo_WiZoomCenter::AtViewCentre, 0, 0, false);
    PaintNow(hosted.Scrollee());
    ASSERT_DOUBLE_EQ(hosted.wnd.GetMapping()->GetTransform().GetScale(), 10.0);

    const struct {
        int dx, dy;
        CPoint moved;
    } cases[] = {
        {1, 0, CPoint(1, 0)}, {0, 5, CPoint(0, 1)}, {-1, 0, CPoint(-1, 0)}, {25, 0, CPoint(3, 0)}, {0, -14, CPoint(0, -1)}, {0, 0, CPoint(0, 0)}, {-15, 30, CPoint(-2, 3)}};
    for (const auto& c : cases) {
        const CPoint before = hosted.wnd.GetScrollPosition();
        hosted.wnd.ScrollWindowByDeviceDeltas(c.dx, c.dy);
        const CPoint after = hosted.wnd.GetScrollPosition();
        EXPECT_EQ(CPoint(after.x - before.x, after.y - before.y), c.moved) << c.dx << ", " << c.dy;
    }
}

TEST_F(DrawWndViewTest, ScrollByTheBarRepaintsOnlyTheUncoveredStripAsAFullRepaintWould)
{
    BusyDrawing busy;
    Wnd().SetDrawingInfo(&busy.drawing, 50, 3, 0, 0, 0);
    // Three levels in: a scale that is not a whole number of pixels per unit,
    // so that every step leaves a rounding error behind.
    Zoom(Tavo_GrZoom::In, 3);
    const HWND drawWnd = Wnd().GetSafeHwnd();
    const struct {
        UINT message;
        UINT code;
    } steps[] = {
        {WM_HSCROLL, SB_LINERIGHT}, {WM_HSCROLL, SB_LINERIGHT}, {WM_VSCROLL, SB_LINEDOWN}, {WM_HSCROLL, SB_LINELEFT}, {WM_VSCROLL, SB_PAGEUP}, {WM_VSCROLL, SB_LINEDOWN}, {WM_HSCROLL, SB_PAGERIGHT}};
    for (const auto& step : steps) {
        const CPoint before = Wnd().GetScrollPosition();
        const HWND bar = ::GetDlgItem(drawWnd, step.message == WM_HSCROLL ? Tavo_WiScrollWnd::HorzBarId : Tavo_WiScrollWnd::VertBarId);
        ::SendMessageA(drawWnd, step.message, MAKEWPARAM(step.code, 0), reinterpret_cast<LPARAM>(bar));
        ::SendMessageA(drawWnd, step.message, MAKEWPARAM(SB_ENDSCROLL, 0), reinterpret_cast<LPARAM>(bar));
        const CPoint after = Wnd().GetScrollPosition();
        const CPoint moved(after.x - before.x, after.y - before.y);
        ASSERT_NE(moved, CPoint(0, 0)) << step.code;

        // The content moved by the rounded distance; only the strip it
        // uncovered waits to be painted, and only it is repainted.
        const CSize size = hosted.ScrolleeSize();
        const int dx = Tavo_GrRound(std::fabs(moved.x * Scale()));
        const int dy = Tavo_GrRound(std::fabs(moved.y * Scale()));
        const CRect strip = moved.x > 0 ? CRect(size.cx - dx, 0, size.cx, size.cy)
            : moved.x < 0               ? CRect(0, 0, dx, size.cy)
            : moved.y > 0               ? CRect(0, 0, size.cx, dy)
                                        : CRect(0, size.cy - dy, size.cx, size.cy);
        EXPECT_EQ(PendingUpdate(Scrollee()), strip) << step.code;
        const int paints = Wnd().paints;
        PaintNow(Scrollee());
        EXPECT_EQ(Wnd().paints, paints + 1);
        const Tavo_GrDRect device = Wnd().lastPaintRect;
        EXPECT_EQ(CRect(device.xmin, size.cy - device.ymax, device.xmax, size.cy - device.ymin), strip);

        const ClientPicture scrolled = Snapshot(Scrollee());
        ::InvalidateRect(Scrollee(), nullptr, TRUE);
        PaintNow(Scrollee());
        EXPECT_EQ(DifferingPixels(scrolled, Snapshot(Scrollee())), 0) << step.code;
    }
}

TEST_F(DrawWndViewTest, CentringAtThePointerBringsItsWorldPointToTheMiddle)
{
    Bind();
    Zoom(Tavo_GrZoom::In, 5);
    const CPoint pixel(100, 120);
    const Tavo_GrWPoint pointed = WorldAt(pixel);
    const CPoint screen = ToScreen(pixel);
    ::SetCursorPos(screen.x, screen.y);
    Wnd().CenterWindowAtCursor();
    PaintNow(Scrollee());
    const CSize size = hosted.ScrolleeSize();
    EXPECT_NEAR(WorldAt(CPoint(size.cx / 2, size.cy / 2)).x, pointed.x, 1);
    EXPECT_NEAR(WorldAt(CPoint(size.cx / 2, size.cy / 2)).y, pointed.y, 1);
}

TEST_F(DrawWndViewTest, PaintPumpDispatchesAtMostTenPaintsAndLeavesAQuitForTheApplication)
{
    Bind();
    Zoom(Tavo_GrZoom::In, 5);
    std::vector<std::unique_ptr<ScrollTest::TestWindow>> others;
    for (int i = 0; i < 12; ++i)
        others.push_back(std::make_unique<ScrollTest::TestWindow>(CRect(510, 10 * i, 520, 10 * i + 8), hosted.host.Handle()));
    ::RedrawWindow(hosted.host.Handle(), nullptr, nullptr, RDW_UPDATENOW | RDW_ALLCHILDREN);

    // The scrolled strip and twelve other windows wait; ten are painted.
    Wnd().ScrollWindowByDeviceDeltas(30, 0);
    for (const auto& other : others)
        ::InvalidateRect(other->Handle(), nullptr, TRUE);
    Wnd().PumpPaintMessages();
    int waiting = PendingUpdate(Scrollee()).IsRectEmpty() ? 0 : 1;
    for (const auto& other : others)
        waiting += PendingUpdate(other->Handle()).IsRectEmpty() ? 0 : 1;
    EXPECT_EQ(waiting, 13 - Tavo_WiDrawWnd::MaxPumpedPaintMessages);

    ::PostQuitMessage(3);
    Wnd().PumpPaintMessages();
    MSG msg;
    ASSERT_TRUE(::PeekMessageA(&msg, nullptr, WM_QUIT, WM_QUIT, PM_REMOVE));
    EXPECT_EQ(msg.wParam, 3u);
    Wnd().PumpPaintMessages();
    EXPECT_TRUE(PendingUpdate(Scrollee()).IsRectEmpty());
    for (const auto& other : others)
        EXPECT_TRUE(PendingUpdate(other->Handle()).IsRectEmpty());
}

// ---- window size ---------------------------------------------------------------------------

TEST_F(DrawWndViewTest, LiveResizeChangesTheViewOnlyAtItsEndAndOnlyForANewSize)
{
    const CSize start(500, 400);
    const CSize other(400, 300);
    const struct {
        int zoomIn;
        CSize end;
    } cases[] = {{0, start}, {5, start}, {0, other}, {5, other}};
    for (const auto& c : cases) {
        ::SetWindowPos(Wnd().GetSafeHwnd(), nullptr, 0, 0, start.cx, start.cy, SWP_NOZORDER | SWP_NOMOVE);
        Bind();
        if (c.zoomIn)
            Zoom(Tavo_GrZoom::In, c.zoomIn, Tavo_WiZoomCenter::AtPoint, 120, 250);
        const double scale = Scale();
        const CPoint position = Wnd().GetScrollPosition();
        const CSize extent = Wnd().GetWindowExtent();

        Wnd().OnEnterSizeMove();
        ::SetWindowPos(Wnd().GetSafeHwnd(), nullptr, 0, 0, 640, 480, SWP_NOZORDER | SWP_NOMOVE);
        ::SetWindowPos(Wnd().GetSafeHwnd(), nullptr, 0, 0, c.end.cx, c.end.cy, SWP_NOZORDER | SWP_NOMOVE);
        // Meanwhile the window's size changes do not touch the view.
        EXPECT_EQ(Wnd().GetScrollPosition(), position);
        EXPECT_EQ(Wnd().GetWindowExtent(), extent);
        ::ValidateRect(Wnd().GetSafeHwnd(), nullptr);
        ::ValidateRect(Scrollee(), nullptr);
        Wnd().OnExitSizeMove();

        const CSize size = hosted.ScrolleeSize();
        if (c.end == start) {
            EXPECT_TRUE(PendingUpdate(Scrollee()).IsRectEmpty()) << c.zoomIn;
            EXPECT_EQ(Wnd().GetWindowExtent(), extent) << c.zoomIn;
        } else {
            EXPECT_EQ(PendingUpdate(Scrollee()), CRect(CPoint(0, 0), size)) << c.zoomIn;
        }
        PaintNow(Wnd().GetSafeHwnd());
        if (c.zoomIn && c.end != start) {
            // The scale and the world point at the top-left corner stay.
            EXPECT_DOUBLE_EQ(Scale(), scale);
            EXPECT_EQ(Wnd().GetScrollPosition(), position);
            EXPECT_EQ(WorldAt(CPoint(0, 0)), (Tavo_GrWPoint{position.x, position.y}));
            const Tavo_GrWRect shown = Wnd().GetWorldClipBox();
            EXPECT_NEAR(Wnd().GetWindowExtent().cx, shown.x2 - shown.x1, 1);
            EXPECT_NEAR(Wnd().GetWindowExtent().cy, shown.y2 - shown.y1, 1);
        } else if (c.end != start) {
            // Refitted: the whole drawing in the new size, 0.375 pixels per unit.
            EXPECT_EQ(Wnd().GetZoomLevel(), 0.0);
            EXPECT_DOUBLE_EQ(Scale(), std::min(size.cx / 1000.0, size.cy / 800.0));
            const Tavo_GrWRect shown = Wnd().GetWorldClipBox();
            EXPECT_EQ(Wnd().GetScrollPosition(), CPoint(shown.x1, shown.y2));
        } else {
            EXPECT_EQ(Scale(), scale) << c.zoomIn;
            EXPECT_EQ(Wnd().GetScrollPosition(), position) << c.zoomIn;
        }
    }
}

TEST_F(DrawWndViewTest, ResizeOutsideALiveResizeKeepsTheLevelAndFitsTheNewSize)
{
    for (int zoomIn : {0, 4}) {
        ::SetWindowPos(Wnd().GetSafeHwnd(), nullptr, 0, 0, 500, 400, SWP_NOZORDER | SWP_NOMOVE);
        Bind();
        if (zoomIn)
            Zoom(Tavo_GrZoom::In, zoomIn);
        const double level = Wnd().GetZoomLevel();
        ::SetWindowPos(Wnd().GetSafeHwnd(), nullptr, 0, 0, 400, 300, SWP_NOZORDER | SWP_NOMOVE);
        PaintNow(Scrollee());
        const CSize size = hosted.ScrolleeSize();
        const double fit = std::min(size.cx / 1000.0, size.cy / 800.0);
        EXPECT_NEAR(Wnd().GetZoomLevel(), level, 1e-9) << zoomIn;
        EXPECT_NEAR(Scale(), fit * std::exp2(level / Tavo_WiDrawWnd::ZoomLevelsPerDoubling), 1e-9) << zoomIn;
        const Tavo_GrWRect shown = Wnd().GetWorldClipBox();
        EXPECT_EQ(Wnd().GetScrollPosition(), CPoint(shown.x1, shown.y2)) << zoomIn;
        EXPECT_NEAR(Wnd().GetWindowExtent().cx, shown.x2 - shown.x1, 1) << zoomIn;
        EXPECT_NEAR(Wnd().GetWindowExtent().cy, shown.y2 - shown.y1, 1) << zoomIn;
    }
}

// ---- what must not break the view -------------------------------------------------------

TEST_F(DrawWndViewTest, ZeroSizedOrMinimisedWindowLeavesTheViewAlone)
{
    Bind();
    Zoom(Tavo_GrZoom::In, 3);
    const Tavo_GrWRect clip = Wnd().GetMapping()->GetWorldClipBox();
    const CPoint position = Wnd().GetScrollPosition();

    ::SetWindowPos(Wnd().GetSafeHwnd(), nullptr, 0, 0, 0, 0, SWP_NOZORDER | SWP_NOMOVE);
    ScrollTest::PumpPending();
    ASSERT_TRUE(CRect(CPoint(0, 0), hosted.ScrolleeSize()).IsRectEmpty());
    Wnd().ZoomWindow(Tavo_GrZoom::In, 2, Tavo_WiZoomCenter::AtCursor, 0, 0, true);
    Wnd().ZoomWindow(Tavo_GrZoom::ZeroLevel, 1, Tavo_WiZoomCenter::AtViewCentre, 0, 0, true);
    Wnd().ZoomWindow(Tavo_GrWRect{0, 0, 300, 300});
    Wnd().OnEnterSizeMove();
    Wnd().OnExitSizeMove();
    EXPECT_EQ(Wnd().GetMapping()->GetWorldClipBox(), clip);
    EXPECT_EQ(Wnd().GetScrollPosition(), position);

    // A minimised top-level drawing window has no client area either.
    TestDrawWnd popup;
    ASSERT_TRUE(popup.Create(WS_POPUP | WS_VISIBLE, CRect(700, 100, 1100, 400), nullptr, 0));
    popup.SetDrawingInfo(&halves.drawing, 50, 3, 0, 0, 0);
    PaintNow(popup.GetScrollee()->GetSafeHwnd());
    popup.ZoomWindow(Tavo_GrZoom::In, 4, Tavo_WiZoomCenter::AtViewCentre, 0, 0, false);
    const Tavo_GrWRect popupClip = popup.GetMapping()->GetWorldClipBox();
    ::ShowWindow(popup.GetSafeHwnd(), SW_MINIMIZE);
    ScrollTest::PumpPending();
    popup.ZoomWindow(Tavo_GrZoom::In, 2, Tavo_WiZoomCenter::AtViewCentre, 0, 0, true);
    EXPECT_EQ(popup.GetMapping()->GetWorldClipBox(), popupClip);
    ::ShowWindow(popup.GetSafeHwnd(), SW_RESTORE);
    ScrollTest::PumpPending();
    EXPECT_GT(popup.GetZoomLevel(), 0.0);
    popup.DestroyWindow();
}

TEST_F(DrawWndViewTest, EmptyOrHugeDrawingKeepsASoundViewAtEveryLevel)
{
    Tavo_GrDrawing empty;
    Tavo_GrDrawing huge;
    AddFilledRect(huge, {INT_MIN + 1, INT_MIN + 1, INT_MAX - 1, INT_MAX - 1}, Red);
    for (Tavo_GrDrawing* drawing : {&empty, &huge}) {
        // Levels far beyond any sensible zoom, a large zero-level expansion.
        Wnd().SetDrawingInfo(drawing, 400, 3, 1000, 0, 0);
        PaintNow(Scrollee());
        for (int level : {0, 1, 50, 200, 400}) {
            Zoom(Tavo_GrZoom::ToLevel, level);
            EXPECT_TRUE(std::isfinite(Scale()) && Scale() > 0.0) << level;
            const Tavo_GrWRect shown = Wnd().GetWorldClipBox();
            EXPECT_LE(shown.x1, shown.x2);
            EXPECT_LE(shown.y1, shown.y2);
            // A unit is far more pixels than an int holds: the moved pixels
            // leave no error term behind that would push later drawing away.
            Wnd().ScrollWindowByDeviceDeltas(7, -7);
            Wnd().ScrollWindow(Right, Tavo_WiScroll::Page, 0);
            PaintNow(Scrollee());
            EXPECT_LE(std::fabs(Wnd().GetMapping()->GetXErrorTerm()), 1.0) << level;
            EXPECT_LE(std::fabs(Wnd().GetMapping()->GetYErrorTerm()), 1.0) << level;
        }
    }
}

} // namespace
