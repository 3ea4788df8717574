// Tavo_WiDataTip: placement from the pointer and the text's extent, kept on
// the screen horizontally only, one shown tip per process, the notifications
// to the owner, and hiding by a real key press through the keyboard hook.
#include "scroll_test_support.h"

#include "Tavo_WiDataTip.h"

#include <gtest/gtest.h>

#include <string>
#include <utility>

using namespace ScrollTest;

namespace {

constexpr int ScreenWidth = 1280;
constexpr int ScreenHeight = 1024;

// The tip's window rectangle for text shown at pointer, a screen point: the
// pointer + (16, 16) is where the text starts, with margins of 4 and 2 pixels.
CRect ExpectedRect(CPoint pointer, const char* text)
{
    CClientDC dc(CWnd::FromHandle(::GetDesktopWindow()));
    dc.SelectStockObject(ANSI_VAR_FONT);
    const CSize extent = dc.GetTextExtent(CString(text));
    const CPoint origin = pointer + CPoint(16, 16);
    return CRect(origin.x - 4, origin.y - 2, origin.x + extent.cx + 4, origin.y + extent.cy + 2);
}

CRect WindowRect(const CWnd& wnd)
{
    CRect rect;
    ::GetWindowRect(wnd.GetSafeHwnd(), &rect);
    return rect;
}

// The owner and wParam of every tip notification, in order.
using Notes = std::vector<std::pair<HWND, WPARAM>>;
Notes Notifications()
{
    Notes result;
    for (const TestWindow::Note& note : TestWindow::Notes())
        if (note.message == Tavo_WiDataTip::GetNotifyMsg())
            result.emplace_back(note.window, note.wParam);
    return result;
}

class DataTipTest : public ::testing::Test {
protected:
    void SetUp() override
    {
        ASSERT_TRUE(tipA.Create(ownerA.Wnd()));
        ASSERT_TRUE(tipB.Create(ownerB.Wnd()));
        TestWindow::Notes().clear();
    }

    // The tips go first, each destroying its window while its owner lives.
    TestWindow ownerA{CRect(100, 100, 400, 300)};
    TestWindow ownerB{CRect(500, 100, 800, 300)};
    Tavo_WiDataTip tipA;
    Tavo_WiDataTip tipB;
};

TEST_F(DataTipTest, TipIsMovedOntoTheScreenHorizontallyButNeverUp)
{
    const auto shownAt = [](const CRect& ownerRect, CPoint point, const char* text) {
        TestWindow owner(ownerRect);
        Tavo_WiDataTip tip;
        EXPECT_TRUE(tip.Create(owner.Wnd()));
        tip.Show(point, text);
        const CRect rect = WindowRect(tip);
        tip.Hide();
        return rect;
    };
    // Past the right edge: moved left to end on it.
    CRect natural = ExpectedRect(CPoint(ScreenWidth - 50, 310), "a tip too long to fit");
    EXPECT_EQ(shownAt(CRect(ScreenWidth - 100, 300, ScreenWidth, 400), CPoint(50, 10), "a tip too long to fit"),
              natural + CPoint(ScreenWidth - natural.right, 0));
    // Wider than the screen: starts at its left edge.
    const std::string wide(400, 'W');
    natural = ExpectedRect(CPoint(110, 120), wide.c_str());
    ASSERT_GT(natural.Width(), ScreenWidth);
    EXPECT_EQ(shownAt(CRect(100, 100, 400, 300), CPoint(10, 20), wide.c_str()),
              natural + CPoint(-natural.left, 0));
    // Past the bottom: not moved up.
    natural = ExpectedRect(CPoint(220, ScreenHeight - 10), "low");
    ASSERT_GT(natural.bottom, ScreenHeight);
    EXPECT_EQ(shownAt(CRect(200, ScreenHeight - 40, 400, ScreenHeight), CPoint(20, 30), "low"), natural);
}

TEST_F(DataTipTest, ShowPlacesTheTipBelowRightOfThePointerSizedByTheTextAndHidesTheOtherTipFirst)
{
    tipA.Show(CPoint(10, 20), "Data tip text");
    EXPECT_EQ(WindowRect(tipA), ExpectedRect(CPoint(110, 120), "Data tip text"));
    EXPECT_TRUE(::IsWindowVisible(tipA.GetSafeHwnd()));
    EXPECT_EQ(tipA.IsVisible(), 1);
    tipB.Show(CPoint(10, 20), "B");
    EXPECT_FALSE(::IsWindowVisible(tipA.GetSafeHwnd()));
    EXPECT_EQ(tipB.IsVisible(), 1);
    EXPECT_EQ(Notifications(), (Notes{{ownerA.Handle(), 1}, {ownerA.Handle(), 0}, {ownerB.Handle(), 1}}));

    TestWindow::Notes().clear();
    tipA.Hide();
    EXPECT_EQ(Notifications(), (Notes{{ownerA.Handle(), 0}}));
    EXPECT_EQ(tipB.IsVisible(), 1) << "another tip is left as it is";
}

TEST_F(DataTipTest, KeyPressHidesTheShownTipAtTheNextTick)
{
    // A key pressed while no tip is shown is forgotten by the next Show.
    SendKey('K', FreshTime());
    PumpInput();
    tipA.Show(CPoint(10, 20), "keys");
    const auto tick = [this] { ::SendMessageA(tipA.GetSafeHwnd(), WM_TIMER, Tavo_WiDataTip::TimerId, 0); };
    tick();
    ASSERT_EQ(tipA.IsVisible(), 1);

    SendKey('K', FreshTime());
    PumpInput();
    EXPECT_EQ(tipA.IsVisible(), 1) << "hidden only at the tick";
    tick();
    EXPECT_EQ(tipA.IsVisible(), 0);
    EXPECT_FALSE(::IsWindowVisible(tipA.GetSafeHwnd()));
    EXPECT_EQ(Notifications(), (Notes{{ownerA.Handle(), 1}, {ownerA.Handle(), 0}}));
}

TEST_F(DataTipTest, DestroyedTipIsNoLongerTheCurrentTip)
{
    {
        Tavo_WiDataTip shortLived;
        ASSERT_TRUE(shortLived.Create(ownerA.Wnd()));
        shortLived.Show(CPoint(10, 20), "brief");
    }
    TestWindow::Notes().clear();
    tipB.Show(CPoint(10, 20), "B");
    EXPECT_EQ(Notifications(), (Notes{{ownerB.Handle(), 1}}));
    // A tip without a window shows nothing.
    Tavo_WiDataTip unborn;
    unborn.Show(CPoint(1, 1), "nothing");
    EXPECT_EQ(unborn.IsVisible(), 0);
}

} // namespace
