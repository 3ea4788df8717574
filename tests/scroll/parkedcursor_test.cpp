// Tavo_WiParkedCursorMonitor: a rest begins when the park timer fires (sent
// explicitly) with the pointer still inside an active window, and ends at the
// next move to another point or any button.
#include "scroll_test_support.h"

#include "Tavo_WiParkedCursorMonitor.h"

#include <gtest/gtest.h>

using namespace ScrollTest;

namespace {

constexpr int HostX = 200;
constexpr int HostY = 150;

class ParkedCursorTest : public ::testing::Test {
protected:
    void SetUp() override
    {
        ASSERT_TRUE(monitor.Create(owner.Wnd(), Tavo_WiParkedCursorMonitor::ControlId));
        ::SetCursorPos(HostX + 30, HostY + 40);
        TestWindow::Notes().clear();
    }

    void TearDown() override { monitor.DestroyWindow(); }

    // Pre-translates a message of the owner at a client point.
    void Relay(UINT message, int x, int y, WPARAM wParam = 0)
    {
        MSG msg = {owner.Handle(), message, wParam, MAKELPARAM(x, y), 0, {0, 0}};
        monitor.RelayEvent(&msg);
    }

    int FireParkTimer()
    {
        ::SendMessageA(monitor.GetSafeHwnd(), WM_TIMER, Tavo_WiParkedCursorMonitor::ParkTimerId, 0);
        return monitor.IsParked();
    }

    // A move to a client point, then the park timer; whether a rest began.
    int MoveAndFire(int x, int y)
    {
        Relay(WM_MOUSEMOVE, x, y);
        return FireParkTimer();
    }

    // The wParam of every rest notification the owner received, in order.
    std::vector<WPARAM> Notifications() const
    {
        std::vector<WPARAM> result;
        for (const TestWindow::Note& note : TestWindow::Notes())
            if (note.window == owner.Handle() && note.message == Tavo_WiParkedCursorMonitor::GetNotifyMsg())
                result.push_back(note.wParam);
        return result;
    }

    TestWindow host{CRect(HostX, HostY, HostX + 400, HostY + 300)}; // shown and activated
    TestWindow owner{CRect(0, 0, 300, 200), host.Handle()};
    Tavo_WiParkedCursorMonitor monitor;
};

TEST_F(ParkedCursorTest, RestBeginsWhenTheTimerFiresAfterAMoveAndEndsOnlyAtAMoveElsewhere)
{
    EXPECT_EQ(FireParkTimer(), 0) << "no move, no rest";
    Relay(WM_MOUSEMOVE, 30, 40);
    EXPECT_EQ(monitor.IsParked(), 0);
    EXPECT_EQ(FireParkTimer(), 1);
    // The park point is where the pointer is, in the owner's client coordinates.
    EXPECT_EQ(monitor.GetParkPoint(), CPoint(30, 40));

    MoveAndFire(30, 40); // would end and begin the rest again had the move restarted the timer
    Relay(WM_NCMOUSEMOVE, 90, 90);
    Relay(WM_MOUSEWHEEL, 90, 90, MAKEWPARAM(0, 120));
    Relay(WM_KEYDOWN, 0, 0, 'A');
    monitor.RelayEvent(nullptr);
    EXPECT_EQ(monitor.IsParked(), 1);
    EXPECT_EQ(Notifications(), std::vector<WPARAM>{1});

    // One pixel away ends it.
    Relay(WM_MOUSEMOVE, 31, 40);
    EXPECT_EQ(monitor.IsParked(), 0);
    EXPECT_EQ(monitor.GetParkPoint(), CPoint(-1, -1));
    EXPECT_EQ(Notifications(), (std::vector<WPARAM>{1, 0}));
}

TEST_F(ParkedCursorTest, HeldButtonKeepsTheMonitorIdleUntilReleaseAndALaterMove)
{
    Relay(WM_MOUSEMOVE, 30, 40);
    Relay(WM_LBUTTONDOWN, 30, 40, MK_LBUTTON);
    FireParkTimer();
    EXPECT_EQ(MoveAndFire(35, 40), 0);
    Relay(WM_LBUTTONUP, 35, 40);
    EXPECT_EQ(FireParkTimer(), 0) << "a release starts no timer";
    EXPECT_EQ(MoveAndFire(30, 40), 1);
    EXPECT_EQ(Notifications(), std::vector<WPARAM>{1});
}

TEST_F(ParkedCursorTest, DoubleClickOrAnyButtonEndsARest)
{
    Relay(WM_MOUSEMOVE, 30, 40);
    Relay(WM_LBUTTONDOWN, 30, 40, MK_LBUTTON);
    Relay(WM_LBUTTONUP, 30, 40);
    ASSERT_EQ(MoveAndFire(31, 40), 1);
    Relay(WM_LBUTTONDBLCLK, 31, 40, MK_LBUTTON);
    EXPECT_EQ(monitor.IsParked(), 0);
    EXPECT_EQ(MoveAndFire(30, 40), 1) << "the double click left no button down";
    Relay(WM_NCRBUTTONDOWN, 30, 40);
    EXPECT_EQ(monitor.IsParked(), 0);
    EXPECT_EQ(Notifications(), (std::vector<WPARAM>{1, 0, 1, 0}));
}

TEST_F(ParkedCursorTest, DisablingStopsThePendingTimerAndKeepsARestUntilTheNextMove)
{
    Relay(WM_MOUSEMOVE, 30, 40);
    monitor.Enable(0);
    monitor.Enable(1);
    EXPECT_EQ(FireParkTimer(), 0);

    MoveAndFire(31, 40);
    monitor.Enable(0);
    EXPECT_EQ(monitor.IsEnabled(), 0);
    EXPECT_EQ(monitor.IsParked(), 1);
    EXPECT_EQ(MoveAndFire(32, 40), 0) << "the move ended the rest and started no timer";

    // Enabling starts nothing until a move.
    monitor.Enable(1);
    EXPECT_EQ(FireParkTimer(), 0);
    EXPECT_EQ(MoveAndFire(30, 40), 1);
}

TEST_F(ParkedCursorTest, NoRestOverAnInactiveApplication)
{
    TestWindow other(CRect(700, 600, 800, 700)); // activates itself
    ASSERT_EQ(::GetActiveWindow(), other.Handle());
    EXPECT_EQ(MoveAndFire(30, 40), 0);
    EXPECT_TRUE(Notifications().empty());
}

TEST_F(ParkedCursorTest, RestEndsSilentlyOnceTheOwnerIsGone)
{
    ASSERT_EQ(MoveAndFire(30, 40), 1);
    ::DestroyWindow(owner.Handle()); // takes the monitor's window with it
    EXPECT_EQ(monitor.GetSafeHwnd(), nullptr);
    Relay(WM_MOUSEMOVE, 31, 40);
    EXPECT_EQ(monitor.IsParked(), 0);
    EXPECT_EQ(Notifications(), std::vector<WPARAM>{1});
}

} // namespace
