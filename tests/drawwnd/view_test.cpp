// Tavo_WiDrawWnd: binding a drawing, the paint path, the coordinate
// conversions, invalidation, zooming, panning and live resizing, on real
// windows under Wine.
#include "drawwnd_test_support.h"

#include "Tavo_WiViewMath.h"

#include <gtest/gtest.h>

using namespace DrawWndTest;
using ScrollTest::PixelAt;

namespace {

// 1000 x 800 world units: red on the left half, white on the right. In a
// 500 x 400 scrollee the zero level shows it at exactly half a pixel per unit.
struct HalvesDrawing
{
    HalvesDrawing()
    {
        AddFilledRect(drawing, {0, 0, 500, 800}, Red);
        AddFilledRect(drawing, {500, 0, 1000, 800}, White);
    }
    Tavo_GrDrawing drawing;
};

class DrawWndViewTest : public ::testing::Test
{
protected:
    void Bind() { hosted.wnd.SetDrawingInfo(&halves.drawing, 50, 3, 0, 0, 0); }

    HalvesDrawing halves;
    HostedDrawWnd hosted;
};

TEST_F(DrawWndViewTest, DrawingBoundRightAfterCreateIsFittedToTheRealClientArea)
{
    Bind();
    PaintNow(hosted.Scrollee());
    EXPECT_EQ(hosted.ScrolleeSize(), CSize(500, 400));
    EXPECT_DOUBLE_EQ(hosted.wnd.GetMapping()->GetTransform().GetScale(), 0.5);
    EXPECT_EQ(PixelAt(hosted.Scrollee(), 100, 200), RGB(255, 0, 0));
    EXPECT_EQ(PixelAt(hosted.Scrollee(), 400, 200), RGB(255, 255, 255));
    EXPECT_GT(hosted.wnd.paints, 0);
}

}  // namespace
