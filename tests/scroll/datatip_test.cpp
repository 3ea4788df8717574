// Tavo_WiDataTip: placement from the pointer and the text's extent, keeping
// on the screen horizontally, one shown tip per process, the notifications to
// the owner, and hiding by a real key press through the keyboard hook.
#include "scroll_test_support.h"

#include "Tavo_WiDataTip.h"

#include <gtest/gtest.h>

#include <string>

using namespace ScrollTest;

namespace {

constexpr int ScreenWidth = 1280;
constexpr int ScreenHeight = 1024;

// The size of a text in the tip's font.
CSize TextExtent(const char* text)
{
    LOGFONTA description = {};
    ::GetObjectA(::GetStockObject(ANSI_VAR_FONT), sizeof description, &description);
    HFONT font = ::CreateFontIndirectA(&description);
    HDC dc = ::GetDC(nullptr);
    HGDIOBJ old = ::SelectObject(dc, font);
    SIZE size = {};
    ::GetTextExtentPoint32A(dc, text, static_cast<int>(strlen(text)), &size);
    ::SelectObject(dc, old);
    ::ReleaseDC(nullptr, dc);
    ::DeleteObject(font);
    return CSize(size.cx, size.cy);
}

CRect WindowRect(const CWnd& wnd)
{
    CRect rect;
    ::GetWindowRect(wnd.GetSafeHwnd(), &rect);
    return rect;
}

// An owner window of a given size placed at a screen position.
struct Owner
{
    Owner(int x, int y, int width, int height) : host(x, y, width, height), sink(host.Handle())
    {
        ::SetWindowPos(sink.Handle(), nullptr, 0, 0, width, height, SWP_NOZORDER);
    }
    HostWindow host;
    NotificationSink sink;
};

class DataTipTest : public ::testing::Test
{
protected:
    void SetUp() override
    {
        ASSERT_TRUE(tipA.Create(ownerA.sink.Wnd()));
        ASSERT_TRUE(tipB.Create(ownerB.sink.Wnd()));
        NotificationSink::Notes().clear();
    }

    void TearDown() override
    {
        tipA.Hide();
        tipB.Hide();
        tipA.DestroyWindow();
        tipB.DestroyWindow();
        PumpPending();
    }

    void Tick(Tavo_WiDataTip& tip)
    {
        ::SendMessageA(tip.GetSafeHwnd(), WM_TIMER, Tavo_WiDataTip::TimerId, 0);
    }

    // Owner window and wParam of every tip notification, in order.
    std::vector<std::pair<HWND, WPARAM>> Notifications() const
    {
        std::vector<std::pair<HWND, WPARAM>> result;
        for (const NotificationSink::Note& note : NotificationSink::Notes())
            if (note.message == Tavo_WiDataTip::GetNotifyMsg())
                result.emplace_back(note.window, note.wParam);
        return result;
    }

    Owner ownerA{100, 100, 300, 200};
    Owner ownerB{500, 100, 300, 200};
    Tavo_WiDataTip tipA;
    Tavo_WiDataTip tipB;
};

TEST_F(DataTipTest, NotifyMessageIsTheRegisteredTipMessage)
{
    EXPECT_EQ(Tavo_WiDataTip::GetNotifyMsg(), ::RegisterWindowMessageA("BrymarTavo_WiDataTipMessage"));
}

TEST_F(DataTipTest, CreatedTipIsAHiddenToolWindowPopup)
{
    const HWND hwnd = tipA.GetSafeHwnd();
    EXPECT_FALSE(::IsWindowVisible(hwnd));
    EXPECT_EQ(tipA.IsVisible(), 0);
    EXPECT_NE(::GetWindowLongA(hwnd, GWL_EXSTYLE) & WS_EX_TOOLWINDOW, 0);
    const DWORD style = static_cast<DWORD>(::GetWindowLongA(hwnd, GWL_STYLE));
    EXPECT_NE(style & WS_POPUP, 0u);
    EXPECT_NE(style & WS_BORDER, 0u);
    EXPECT_EQ(::GetWindow(hwnd, GW_OWNER), ownerA.host.Handle()) << "a popup is owned by the top-level window";
}

TEST_F(DataTipTest, ShowPlacesTheTipBelowRightOfThePointerSizedByTheText)
{
    const char* text = "Data tip text";
    tipA.Show(CPoint(10, 20), text);
    const CSize extent = TextExtent(text);
    const int x = 100 + 10 + 16;
    const int y = 100 + 20 + 16;
    EXPECT_EQ(WindowRect(tipA), CRect(x - 4, y - 2, x + extent.cx + 4, y + extent.cy + 2));
    EXPECT_TRUE(::IsWindowVisible(tipA.GetSafeHwnd()));
    EXPECT_EQ(tipA.IsVisible(), 1);
    EXPECT_EQ(Notifications(), (std::vector<std::pair<HWND, WPARAM>>{{ownerA.sink.Handle(), 1}}));
}

TEST_F(DataTipTest, TipPaintsInTheToolTipColours)
{
    if (!EnglishLocale())
        GTEST_SKIP() << "the background comes from the library's own window class";
    tipA.Show(CPoint(10, 20), "Colours");
    ::UpdateWindow(tipA.GetSafeHwnd());
    CRect client;
    ::GetClientRect(tipA.GetSafeHwnd(), &client);
    Pixels pixels(tipA.GetSafeHwnd(), client.Width(), client.Height());
    EXPECT_EQ(pixels.At(0, 0), ::GetSysColor(COLOR_INFOBK));
    EXPECT_EQ(pixels.At(client.Width() - 1, client.Height() - 1), ::GetSysColor(COLOR_INFOBK));
    bool sawText = false;
    for (int y = 0; y < client.Height(); ++y)
        for (int x = 0; x < client.Width(); ++x)
            sawText = sawText || pixels.At(x, y) == ::GetSysColor(COLOR_INFOTEXT);
    EXPECT_TRUE(sawText);
}

TEST_F(DataTipTest, PointOnTheRightOrBottomEdgeShowsNothingButHidesTheShownTip)
{
    tipA.Show(CPoint(10, 20), "first");
    tipA.Show(CPoint(300, 20), "on the right edge");
    EXPECT_EQ(tipA.IsVisible(), 0);
    EXPECT_FALSE(::IsWindowVisible(tipA.GetSafeHwnd()));
    tipA.Show(CPoint(10, 200), "on the bottom edge");
    EXPECT_EQ(tipA.IsVisible(), 0);
    const HWND a = ownerA.sink.Handle();
    EXPECT_EQ(Notifications(), (std::vector<std::pair<HWND, WPARAM>>{{a, 1}, {a, 0}}));
}

TEST_F(DataTipTest, TipPassingTheRightScreenEdgeIsMovedLeftOntoIt)
{
    Owner nearRight(ScreenWidth - 100, 300, 100, 100);
    Tavo_WiDataTip tip;
    ASSERT_TRUE(tip.Create(nearRight.sink.Wnd()));
    tip.Show(CPoint(50, 10), "a tip too long to fit");
    const CRect rect = WindowRect(tip);
    EXPECT_EQ(rect.right, ScreenWidth);
    EXPECT_EQ(rect.top, 300 + 10 + 16 - 2);
    EXPECT_EQ(rect.Width(), TextExtent("a tip too long to fit").cx + 8);
    tip.Hide();
}

TEST_F(DataTipTest, TipWiderThanTheScreenStartsAtItsLeftEdge)
{
    const std::string text(400, 'W');
    ASSERT_GT(TextExtent(text.c_str()).cx, ScreenWidth);
    tipA.Show(CPoint(10, 20), text.c_str());
    const CRect rect = WindowRect(tipA);
    EXPECT_EQ(rect.left, 0);
    EXPECT_GT(rect.right, ScreenWidth);
}

TEST_F(DataTipTest, TipNearTheBottomOfTheScreenIsNotMovedUp)
{
    Owner nearBottom(200, ScreenHeight - 40, 200, 40);
    Tavo_WiDataTip tip;
    ASSERT_TRUE(tip.Create(nearBottom.sink.Wnd()));
    tip.Show(CPoint(20, 30), "low");
    EXPECT_EQ(WindowRect(tip).top, ScreenHeight - 40 + 30 + 16 - 2);
    EXPECT_GT(WindowRect(tip).bottom, ScreenHeight);
    tip.Hide();
}

TEST_F(DataTipTest, ShowingTipBHidesTipAFirst)
{
    tipA.Show(CPoint(10, 20), "A");
    NotificationSink::Notes().clear();
    tipB.Show(CPoint(10, 20), "B");
    EXPECT_EQ(tipA.IsVisible(), 0);
    EXPECT_FALSE(::IsWindowVisible(tipA.GetSafeHwnd()));
    EXPECT_EQ(tipB.IsVisible(), 1);
    EXPECT_EQ(Notifications(), (std::vector<std::pair<HWND, WPARAM>>{{ownerA.sink.Handle(), 0},
                                                                     {ownerB.sink.Handle(), 1}}));
}

TEST_F(DataTipTest, HideOnAHiddenTipStillNotifiesItsOwner)
{
    tipB.Show(CPoint(10, 20), "B");
    NotificationSink::Notes().clear();
    tipA.Hide();
    EXPECT_EQ(Notifications(), (std::vector<std::pair<HWND, WPARAM>>{{ownerA.sink.Handle(), 0}}));
    EXPECT_EQ(tipB.IsVisible(), 1) << "another tip is left as it is";
}

TEST_F(DataTipTest, KeyPressHidesTheShownTipAtTheNextTick)
{
    tipA.Show(CPoint(10, 20), "keys");
    SendKey('K', FreshTime());
    PumpInput();
    EXPECT_EQ(tipA.IsVisible(), 1) << "hidden only at the tick";
    Tick(tipA);
    EXPECT_EQ(tipA.IsVisible(), 0);
    EXPECT_FALSE(::IsWindowVisible(tipA.GetSafeHwnd()));
    const HWND a = ownerA.sink.Handle();
    EXPECT_EQ(Notifications(), (std::vector<std::pair<HWND, WPARAM>>{{a, 1}, {a, 0}}));
}

TEST_F(DataTipTest, KeyPressWhileNoTipIsShownIsForgottenByTheNextShow)
{
    SendKey('K', FreshTime());
    PumpInput();
    tipA.Show(CPoint(10, 20), "after the key");
    Tick(tipA);
    EXPECT_EQ(tipA.IsVisible(), 1);
}

TEST_F(DataTipTest, TipWithoutAWindowShowsNothing)
{
    Tavo_WiDataTip unborn;
    unborn.Show(CPoint(1, 1), "nothing");
    EXPECT_EQ(unborn.IsVisible(), 0);
    unborn.Hide();
    EXPECT_EQ(unborn.IsVisible(), 0);
}

TEST_F(DataTipTest, DestroyingTheShownTipLeavesNoCurrentTip)
{
    {
        Tavo_WiDataTip shortLived;
        ASSERT_TRUE(shortLived.Create(ownerA.sink.Wnd()));
        shortLived.Show(CPoint(10, 20), "brief");
    }
    NotificationSink::Notes().clear();
    tipB.Show(CPoint(10, 20), "B");
    EXPECT_EQ(Notifications(), (std::vector<std::pair<HWND, WPARAM>>{{ownerB.sink.Handle(), 1}}));
}

}  // namespace
