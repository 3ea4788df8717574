// controls_test.cpp - CScrollBar, CButton and CStatusBarCtrl on real
// controls, and the scroll messages a bar sends to its parent's message map.
#include <afxcmn.h>
#include <afxwin.h>

#include <vector>

#include <gtest/gtest.h>

#include "framework_test_support.h"

namespace {

constexpr UINT kBarId = 1001;
constexpr UINT kButtonId = 1003;
constexpr UINT kStatusBarId = 1004;

struct ScrollEvent {
    UINT message;
    UINT code;
    UINT position;
    CScrollBar* bar;
};

class CScrollParentWnd : public CWnd {
public:
    std::vector<ScrollEvent> m_events;

protected:
    afx_msg void OnHScroll(UINT nSBCode, UINT nPos, CScrollBar* pScrollBar)
    {
        m_events.push_back({WM_HSCROLL, nSBCode, nPos, pScrollBar});
    }
    afx_msg void OnVScroll(UINT nSBCode, UINT nPos, CScrollBar* pScrollBar)
    {
        m_events.push_back({WM_VSCROLL, nSBCode, nPos, pScrollBar});
    }
    DECLARE_MESSAGE_MAP()
};

BEGIN_MESSAGE_MAP(CScrollParentWnd, CWnd)
    ON_WM_HSCROLL()
    ON_WM_VSCROLL()
END_MESSAGE_MAP()

class ControlsTest : public framework_test::WindowTest {
protected:
    void SetUp() override
    {
        ASSERT_TRUE(m_parent.CreateEx(0, NULL, "parent", WS_POPUP | WS_VISIBLE, 0, 0, 200, 200, NULL, NULL));
    }
    CScrollParentWnd m_parent;
};

} // namespace

TEST_F(ControlsTest, ScrollBarIsARealControlReportingToItsParentsMap)
{
    CScrollBar vertical;
    ASSERT_TRUE(vertical.Create(WS_CHILD | WS_VISIBLE | SBS_VERT, CRect(0, 0, 10, 100), &m_parent, kBarId));
    char className[32] = {};
    ::GetClassNameA(vertical.m_hWnd, className, sizeof(className));
    EXPECT_EQ(0, ::lstrcmpiA("ScrollBar", className));
    EXPECT_EQ(&vertical, CWnd::FromHandlePermanent(vertical.m_hWnd));
    EXPECT_EQ(static_cast<int>(kBarId), vertical.GetDlgCtrlID());
    vertical.SetScrollRange(0, 32767);
    SCROLLINFO page = {};
    page.fMask = SIF_PAGE;
    page.nPage = 100;
    EXPECT_TRUE(vertical.SetScrollInfo(&page));
    EXPECT_EQ(32767 - 99, vertical.GetScrollLimit()); // the last position that still shows a full page
    vertical.SetScrollPos(500);
    EXPECT_EQ(500, vertical.GetScrollPos());
    m_parent.SendMessage(WM_VSCROLL, MAKEWPARAM(SB_THUMBTRACK, 4242), reinterpret_cast<LPARAM>(vertical.m_hWnd));
    ASSERT_EQ(1u, m_parent.m_events.size());
    EXPECT_EQ(static_cast<UINT>(WM_VSCROLL), m_parent.m_events[0].message);
    EXPECT_EQ(static_cast<UINT>(SB_THUMBTRACK), m_parent.m_events[0].code);
    EXPECT_EQ(4242u, m_parent.m_events[0].position);
    EXPECT_EQ(&vertical, m_parent.m_events[0].bar);

    CScrollBar horizontal;
    ASSERT_TRUE(horizontal.Create(WS_CHILD | WS_VISIBLE | SBS_HORZ, CRect(20, 0, 120, 16), &m_parent, kBarId + 1));
    horizontal.SetScrollRange(0, 100);
    m_parent.m_events.clear();
    horizontal.SendMessage(WM_KEYDOWN, VK_RIGHT, 0); // the control itself reports to its parent
    ASSERT_FALSE(m_parent.m_events.empty());
    EXPECT_EQ(static_cast<UINT>(WM_HSCROLL), m_parent.m_events.front().message);
    EXPECT_EQ(static_cast<UINT>(SB_LINERIGHT), m_parent.m_events.front().code);
    EXPECT_EQ(&horizontal, m_parent.m_events.front().bar);
}

TEST_F(ControlsTest, ButtonIsARealControlWithItsCaptionAndCheck)
{
    CButton button;
    ASSERT_TRUE(
        button.Create("Corner", WS_CHILD | WS_VISIBLE | BS_AUTOCHECKBOX, CRect(0, 0, 60, 20), &m_parent, kButtonId));
    char className[32] = {};
    ::GetClassNameA(button.m_hWnd, className, sizeof(className));
    EXPECT_EQ(0, ::lstrcmpiA("Button", className));
    CString caption;
    button.GetWindowText(caption);
    EXPECT_STREQ("Corner", static_cast<LPCSTR>(caption));
    EXPECT_EQ(static_cast<UINT>(BS_AUTOCHECKBOX), button.GetButtonStyle());
    button.SetCheck(BST_CHECKED);
    EXPECT_EQ(BST_CHECKED, button.GetCheck());
    EXPECT_EQ(&button, m_parent.GetDlgItem(kButtonId));
}

TEST_F(ControlsTest, StatusBarPlacesItselfAtTheBottomAndKeepsATextPerPart)
{
    CStatusBarCtrl bar;
    ASSERT_TRUE(bar.Create(WS_VISIBLE, CRect(5, 5, 6, 6), &m_parent, kStatusBarId));
    EXPECT_EQ(&bar, CWnd::FromHandlePermanent(bar.m_hWnd));
    EXPECT_TRUE(bar.GetStyle() & WS_CHILD);
    bar.SendMessage(WM_SIZE, 0, 0);
    CRect client;
    CRect placed;
    m_parent.GetClientRect(&client);
    bar.GetWindowRect(&placed);
    m_parent.ScreenToClient(&placed);
    EXPECT_EQ(placed.bottom, client.bottom) << "the rectangle given to Create is ignored";
    EXPECT_EQ(placed.Width(), client.Width());

    int edges[3] = {60, 120, -1};
    ASSERT_TRUE(bar.SetParts(3, edges));
    int read[3] = {};
    EXPECT_EQ(3, bar.GetParts(3, read));
    EXPECT_EQ(120, read[1]);
    EXPECT_EQ(3, bar.GetParts(0, NULL));
    ASSERT_TRUE(bar.SetText("zoom 2", 1, SBT_POPOUT));
    ASSERT_TRUE(bar.SetText("", 2, 0));
    int type = -1;
    EXPECT_STREQ("zoom 2", static_cast<LPCSTR>(bar.GetText(1, &type)));
    EXPECT_EQ(SBT_POPOUT, type);
    EXPECT_EQ(6, bar.GetTextLength(1));
    EXPECT_STREQ("", static_cast<LPCSTR>(bar.GetText(2)));
    CRect part;
    ASSERT_TRUE(bar.GetRect(1, &part));
    EXPECT_LE(part.right, 120);
    EXPECT_GE(part.left, 60);
    bar.SetSimple(TRUE);
    EXPECT_TRUE(bar.IsSimple());
}
