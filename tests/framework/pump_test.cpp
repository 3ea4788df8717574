// pump_test.cpp - CWinThread's message loop: PreTranslateMessage sees each
// message at its target first and then at every parent, the walk stops at
// the first window that takes the message, and the loop ends on WM_QUIT.
#include <afxwin.h>

#include <vector>

#include <gtest/gtest.h>

#include "framework_test_support.h"

namespace {

constexpr UINT kProbeMessage = WM_APP + 20;

class CRecordingWnd : public CWnd {
public:
    explicit CRecordingWnd(std::vector<CWnd*>& order) : m_order(order) {}
    BOOL PreTranslateMessage(MSG* pMsg) override
    {
        if (pMsg->message != kProbeMessage)
            return FALSE;
        m_order.push_back(this);
        return m_takesMessage;
    }
    LRESULT WindowProc(UINT message, WPARAM wParam, LPARAM lParam) override
    {
        if (message == kProbeMessage)
            ++m_dispatched;
        return CWnd::WindowProc(message, wParam, lParam);
    }
    BOOL m_takesMessage = FALSE;
    int m_dispatched = 0;

private:
    std::vector<CWnd*>& m_order;
};

class PumpTest : public framework_test::WindowTest {
protected:
    void SetUp() override
    {
        ASSERT_TRUE(m_top.CreateEx(0, NULL, "top", WS_OVERLAPPEDWINDOW, 0, 0, 200, 200, NULL, NULL));
        ASSERT_TRUE(m_middle.Create(NULL, NULL, WS_VISIBLE, CRect(0, 0, 100, 100), &m_top, 1));
        ASSERT_TRUE(m_leaf.Create(NULL, NULL, WS_VISIBLE, CRect(0, 0, 50, 50), &m_middle, 2));
        framework_test::DispatchPendingMessages(); // the probe is the next message
    }

    std::vector<CWnd*> m_order;
    CRecordingWnd m_top{m_order};
    CRecordingWnd m_middle{m_order};
    CRecordingWnd m_leaf{m_order};
};

} // namespace

TEST_F(PumpTest, PreTranslateSeesTargetThenEachParentWithOrWithoutApplication)
{
    ASSERT_EQ(nullptr, AfxGetApp());
    ASSERT_TRUE(m_leaf.PostMessage(kProbeMessage));
    ASSERT_TRUE(AfxPumpMessage());
    EXPECT_EQ((std::vector<CWnd*>{&m_leaf, &m_middle, &m_top}), m_order);
    m_order.clear();
    CWinApp app;
    ASSERT_TRUE(m_leaf.PostMessage(kProbeMessage));
    ASSERT_TRUE(app.PumpMessage());
    EXPECT_EQ((std::vector<CWnd*>{&m_leaf, &m_middle, &m_top}), m_order);
    EXPECT_EQ(2, m_leaf.m_dispatched);
}

TEST_F(PumpTest, WindowThatTakesMessageEndsWalkAndDispatch)
{
    m_middle.m_takesMessage = TRUE;
    CWinApp app;
    ASSERT_TRUE(m_leaf.PostMessage(kProbeMessage));
    ASSERT_TRUE(app.PumpMessage());
    EXPECT_EQ((std::vector<CWnd*>{&m_leaf, &m_middle}), m_order);
    EXPECT_EQ(0, m_leaf.m_dispatched);
}

TEST_F(PumpTest, WalkStopsAtTheStopWindow)
{
    MSG msg = {m_leaf.m_hWnd, kProbeMessage, 0, 0, 0, {0, 0}};
    EXPECT_FALSE(CWnd::WalkPreTranslateTree(m_middle.m_hWnd, &msg));
    EXPECT_EQ((std::vector<CWnd*>{&m_leaf, &m_middle}), m_order);
}

TEST_F(PumpTest, WindowOutsideMainWindowIsAlsoOfferedToMainWindow)
{
    std::vector<CWnd*> order;
    CRecordingWnd popup(order);
    ASSERT_TRUE(popup.CreateEx(0, NULL, "popup", WS_POPUP, 0, 0, 20, 20, NULL, NULL));
    CWinApp app;
    app.m_pMainWnd = &m_top;
    ASSERT_TRUE(popup.PostMessage(kProbeMessage));
    ASSERT_TRUE(app.PumpMessage());
    EXPECT_EQ((std::vector<CWnd*>{&popup}), order);
    EXPECT_EQ((std::vector<CWnd*>{&m_top}), m_order);
    app.m_pMainWnd = NULL;
}

TEST_F(PumpTest, RunDispatchesThenIdlesUntilQuitAndReturnsItsCode)
{
    constexpr int kExitCode = 5;
    struct CIdleApp : CWinApp {
        LONG m_highestCount = -1;
        BOOL OnIdle(LONG lCount) override
        {
            m_highestCount = lCount;
            if (lCount >= 1)
                ::PostQuitMessage(kExitCode);
            return CWinApp::OnIdle(lCount);
        }
    } app;
    ASSERT_TRUE(m_leaf.PostMessage(kProbeMessage));
    EXPECT_EQ(kExitCode, app.Run());
    EXPECT_EQ(1, m_leaf.m_dispatched);
    EXPECT_EQ(1, app.m_highestCount);
}

TEST_F(PumpTest, DestroyingMainWindowPostsQuit)
{
    CWinApp app;
    CWnd main;
    ASSERT_TRUE(main.CreateEx(0, NULL, "main", WS_OVERLAPPEDWINDOW, 0, 0, 50, 50, NULL, NULL));
    app.m_pMainWnd = &main;
    main.DestroyWindow();
    EXPECT_EQ(nullptr, app.m_pMainWnd);
    MSG msg;
    EXPECT_TRUE(::PeekMessageA(&msg, NULL, WM_QUIT, WM_QUIT, PM_REMOVE));
}
