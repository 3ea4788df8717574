// The viewer's keys on a real frame under Wine, pressed as real input: zoom
// in and out at the view's centre, fit, undo as a toggle, scroll by lines and
// pages; the menu and the frame's layout they belong to.
#include "viewer_test_support.h"

#include "ViewerCommands.h"

using namespace ViewerTest;

namespace {

TEST_F(ViewerFixture, KeysZoomAtTheViewCentreFitAndUndoTheLastZoomAsAToggle)
{
    const struct {
        WORD key;
        WORD modifier;
        double level;
    } presses[] = {
        {VK_OEM_PLUS, 0, 2.0}, // '=' / '+' on the main keys
        {VK_ADD, 0, 4.0},      // the number pad's +
        {VK_OEM_PLUS, VK_SHIFT, 6.0},
        {VK_OEM_MINUS, 0, 4.0},
        {VK_SUBTRACT, 0, 2.0},
        {VK_HOME, 0, 0.0},
        {VK_BACK, 0, 2.0}, // back to the view before Home
        {VK_BACK, 0, 0.0}, // and forth again
    };
    const Tavo_GrWPoint centre{500, 400};
    for (const auto& press : presses) {
        SCOPED_TRACE(testing::Message() << "key " << press.key << " modifier " << press.modifier);
        Key(press.key, press.modifier);
        // An undo zooms to the view it kept, in whole world units: close to
        // the level it left.
        EXPECT_NEAR(View().GetZoomLevel(), press.level, 0.01);
        const Tavo_GrWRect shown = View().GetWorldClipBox();
        EXPECT_NEAR((shown.x1 + shown.x2) / 2, centre.x, 3) << "about the view's centre";
        EXPECT_NEAR((shown.y1 + shown.y2) / 2, centre.y, 3);
    }
    EXPECT_EQ(Status(ViewerStatusBar::Zoom), "Zoom level 0 (1x)");
}

TEST_F(ViewerFixture, ArrowsScrollALineAndPageKeysAPageWhileZoomedIn)
{
    Key(VK_HOME);
    const CPoint fitted = View().GetScrollPosition();
    Key(VK_RIGHT);
    EXPECT_EQ(View().GetScrollPosition(), fitted) << "the fitted drawing does not scroll";

    Key(VK_ADD);
    Key(VK_ADD);
    const CSize view = View().GetWindowExtent();
    const CSize line(view.cx / 10, view.cy / 10);
    const CSize page(view.cx / 2, view.cy / 2);
    // World y grows upwards: scrolling down lowers the top edge's y.
    const struct {
        WORD key;
        CSize step;
    } presses[] = {
        {VK_RIGHT, CSize(line.cx, 0)},
        {VK_LEFT, CSize(-line.cx, 0)},
        {VK_DOWN, CSize(0, -line.cy)},
        {VK_UP, CSize(0, line.cy)},
        {VK_NEXT, CSize(0, -page.cy)},
        {VK_PRIOR, CSize(0, page.cy)},
    };
    for (const auto& press : presses) {
        SCOPED_TRACE(testing::Message() << "key " << press.key);
        const CPoint before = View().GetScrollPosition();
        Key(press.key);
        const CPoint after = View().GetScrollPosition();
        EXPECT_EQ(CSize(after.x - before.x, after.y - before.y), press.step);
    }
}

TEST_F(ViewerFixture, TheFrameHoldsTheMenuTheViewAndTheStatusBarBelowIt)
{
    const HMENU menu = ::GetMenu(frame.GetSafeHwnd());
    ASSERT_NE(menu, nullptr);
    char label[64] = {};
    ::GetMenuStringA(menu, 0, label, sizeof label, MF_BYPOSITION);
    EXPECT_STREQ(label, "&File");
    ::GetMenuStringA(menu, 1, label, sizeof label, MF_BYPOSITION);
    EXPECT_STREQ(label, "&View");
    ::GetMenuStringA(menu, ViewerCommands::FilePrint, label, sizeof label, MF_BYCOMMAND);
    EXPECT_STREQ(label, "&Print...\tCtrl+P");
    ::GetMenuStringA(menu, ViewerCommands::UndoZoom, label, sizeof label, MF_BYCOMMAND);
    EXPECT_STREQ(label, "&Undo zoom\tBackspace");

    CRect client;
    frame.GetClientRect(&client);
    const CRect bar = ScrollTest::ChildRect(frame.GetStatusBar().GetSafeHwnd());
    const CRect view = ScrollTest::ChildRect(View().GetSafeHwnd());
    EXPECT_EQ(bar.bottom, client.bottom);
    EXPECT_EQ(bar.Width(), client.Width());
    EXPECT_EQ(view, CRect(0, 0, client.right, bar.top));
    EXPECT_EQ(Status(ViewerStatusBar::Zoom), "Zoom level 0 (1x)");
    EXPECT_EQ(Status(ViewerStatusBar::Message), "Showing test drawing: 5 items on 4 layers.");
    CString title;
    frame.GetWindowText(title);
    EXPECT_STREQ(title, "test drawing - Tavo viewer");
}

TEST_F(ViewerFixture, ALiveResizeRederivesTheViewOnceWhenItEnds)
{
    const CSize extentBefore = View().GetWindowExtent();
    const CRect viewBefore = ScrollTest::ChildRect(View().GetSafeHwnd());
    frame.SendMessage(WM_ENTERSIZEMOVE);
    frame.SetWindowPos(nullptr, 0, 0, FrameWidth + 200, FrameHeight, SWP_NOMOVE | SWP_NOZORDER);
    ScrollTest::PumpPending();
    const CRect view = ScrollTest::ChildRect(View().GetSafeHwnd());
    EXPECT_EQ(view.Width(), viewBefore.Width() + 200) << "the view follows the frame";
    EXPECT_EQ(View().GetWindowExtent(), extentBefore) << "the scroll model waits for the end";

    frame.SendMessage(WM_EXITSIZEMOVE);
    ScrollTest::PumpPending();
    EXPECT_GT(View().GetWindowExtent().cx, extentBefore.cx) << "the fitted drawing shows more of its width";
    EXPECT_EQ(View().GetZoomLevel(), 0.0);
    const CRect bar = ScrollTest::ChildRect(frame.GetStatusBar().GetSafeHwnd());
    EXPECT_EQ(view.bottom, bar.top);
}

} // namespace
