// message_map_test.cpp - CWnd creation with the object hooked to its window,
// message-map dispatch with base-class chaining, registered messages,
// default processing, subclassing and destruction.
#include <afxwin.h>

#include <vector>

#include <gtest/gtest.h>

#include "framework_test_support.h"

namespace {

constexpr UINT kAppMessage = WM_APP + 1;
constexpr UINT kDerivedOnlyMessage = WM_APP + 2;
constexpr LRESULT kAppAnswer = 11;
constexpr LRESULT kRegisteredAnswer = 22;
constexpr LRESULT kDerivedAnswer = 33;

UINT g_registeredMessage = 0;  // filled by the tests after the maps exist

class CBaseTestWnd : public CWnd {
public:
  std::vector<UINT> m_messagesSeen;
  int m_createCount = 0;
  LPVOID m_createParam = NULL;
  int m_baseSizeCount = 0;
  CSize m_lastSize{-1, -1};
  UINT_PTR m_lastTimer = 0;
  UINT m_lastFlags = 0;
  CPoint m_lastPoint{-1, -1};
  WPARAM m_lastRegisteredWParam = 0;
  int m_postNcDestroyCount = 0;
  bool m_throwOnAppMessage = false;
  bool m_refuseCreate = false;

  BOOL CreateTopLevel(LPVOID param = NULL)
  {
    const CRect rect = framework_test::TestWindowRect();
    return CreateEx(0, NULL, "test", WS_OVERLAPPEDWINDOW, rect.left, rect.top, rect.Width(), rect.Height(),
                    NULL, NULL, param);
  }

  LRESULT WindowProc(UINT message, WPARAM wParam, LPARAM lParam) override
  {
    m_messagesSeen.push_back(message);
    return CWnd::WindowProc(message, wParam, lParam);
  }

  void PostNcDestroy() override { ++m_postNcDestroyCount; }

protected:
  afx_msg int OnCreate(LPCREATESTRUCT lpCreateStruct)
  {
    ++m_createCount;
    m_createParam = lpCreateStruct->lpCreateParams;
    if (m_refuseCreate) return -1;
    return CWnd::OnCreate(lpCreateStruct);
  }
  afx_msg void OnSize(UINT, int cx, int cy)
  {
    ++m_baseSizeCount;
    m_lastSize = CSize(cx, cy);
  }
  afx_msg void OnTimer(UINT_PTR nIDEvent) { m_lastTimer = nIDEvent; }
  afx_msg void OnLButtonDown(UINT nFlags, CPoint point)
  {
    m_lastFlags = nFlags;
    m_lastPoint = point;
  }
  afx_msg LRESULT OnAppMessage(WPARAM, LPARAM)
  {
    if (m_throwOnAppMessage) AfxThrowResourceException();
    return kAppAnswer;
  }
  afx_msg LRESULT OnRegistered(WPARAM wParam, LPARAM)
  {
    m_lastRegisteredWParam = wParam;
    return kRegisteredAnswer;
  }

  DECLARE_MESSAGE_MAP()
};

BEGIN_MESSAGE_MAP(CBaseTestWnd, CWnd)
  ON_WM_CREATE()
  ON_WM_SIZE()
  ON_WM_TIMER()
  ON_WM_LBUTTONDOWN()
  ON_MESSAGE(kAppMessage, &CBaseTestWnd::OnAppMessage)
  ON_REGISTERED_MESSAGE(g_registeredMessage, &CBaseTestWnd::OnRegistered)
END_MESSAGE_MAP()

class CDerivedTestWnd : public CBaseTestWnd {
public:
  int m_derivedSizeCount = 0;

protected:
  afx_msg void OnSize(UINT, int cx, int cy)
  {
    ++m_derivedSizeCount;
    m_lastSize = CSize(cx, cy);
  }
  afx_msg LRESULT OnDerivedOnly(WPARAM, LPARAM) { return kDerivedAnswer; }

  DECLARE_MESSAGE_MAP()
};

BEGIN_MESSAGE_MAP(CDerivedTestWnd, CBaseTestWnd)
  ON_WM_SIZE()
  ON_MESSAGE(kDerivedOnlyMessage, &CDerivedTestWnd::OnDerivedOnly)
END_MESSAGE_MAP()

// Takes WM_NCDESTROY itself and leaves out the framework's handling.
class CForgetfulWnd : public CBaseTestWnd {
public:
  int m_ncDestroyCount = 0;

protected:
  afx_msg void OnNcDestroy() { ++m_ncDestroyCount; }
  DECLARE_MESSAGE_MAP()
};

BEGIN_MESSAGE_MAP(CForgetfulWnd, CBaseTestWnd)
  ON_WM_NCDESTROY()
END_MESSAGE_MAP()

class MessageMapTest : public ::testing::Test {
protected:
  void SetUp() override
  {
    if (g_registeredMessage == 0) g_registeredMessage = ::RegisterWindowMessageA("TavoAfxTestRegistered");
  }
  void TearDown() override
  {
    framework_test::DispatchPendingMessages();
    AfxLockTempMaps();
    AfxUnlockTempMaps(TRUE);
  }
};

}  // namespace

TEST_F(MessageMapTest, CreateHooksObjectBeforeFirstMessage)
{
  CBaseTestWnd wnd;
  int marker = 0;
  ASSERT_TRUE(wnd.CreateTopLevel(&marker));
  EXPECT_EQ(1, wnd.m_createCount);
  EXPECT_EQ(&marker, wnd.m_createParam);
  ASSERT_FALSE(wnd.m_messagesSeen.empty());
  // Everything from the non-client creation on reached the object.
  bool sawNcCreate = false;
  for (UINT message : wnd.m_messagesSeen) {
    if (message == WM_NCCREATE) sawNcCreate = true;
    if (message == WM_CREATE) break;
  }
  EXPECT_TRUE(sawNcCreate);
  EXPECT_EQ(&wnd, CWnd::FromHandlePermanent(wnd.m_hWnd));
  EXPECT_EQ(reinterpret_cast<LONG_PTR>(AfxGetAfxWndProc()), ::GetWindowLongPtrA(wnd.m_hWnd, GWLP_WNDPROC));
}

TEST_F(MessageMapTest, RefusedCreateFailsAndDetachesTheDeadWindow)
{
  CBaseTestWnd wnd;
  wnd.m_refuseCreate = true;
  EXPECT_FALSE(wnd.CreateTopLevel());
  EXPECT_EQ(1, wnd.m_createCount);
  EXPECT_EQ(NULL, wnd.m_hWnd);
  EXPECT_EQ(1, wnd.m_postNcDestroyCount);
}

TEST_F(MessageMapTest, NullClassNameUsesFrameworkDefaultClass)
{
  CBaseTestWnd wnd;
  ASSERT_TRUE(wnd.CreateTopLevel());
  char className[64] = {};
  ::GetClassNameA(wnd.m_hWnd, className, sizeof(className));
  EXPECT_STREQ("AfxWnd80", className);
}

TEST_F(MessageMapTest, ChildCreatedWithCreateGetsIdAndParent)
{
  CBaseTestWnd parent;
  ASSERT_TRUE(parent.CreateTopLevel());
  CBaseTestWnd child;
  ASSERT_TRUE(child.Create(NULL, NULL, WS_VISIBLE, CRect(0, 0, 20, 10), &parent, 1234));
  EXPECT_EQ(1234, child.GetDlgCtrlID());
  EXPECT_EQ(&parent, child.GetParent());
  EXPECT_NE(0u, child.GetStyle() & WS_CHILD);
  EXPECT_EQ(&child, parent.GetDlgItem(1234));
}

TEST_F(MessageMapTest, SecondCreateOnSameObjectFails)
{
  CBaseTestWnd wnd;
  ASSERT_TRUE(wnd.CreateTopLevel());
  const HWND first = wnd.m_hWnd;
  EXPECT_FALSE(wnd.CreateTopLevel());
  EXPECT_EQ(first, wnd.m_hWnd);
}

TEST_F(MessageMapTest, CreateWithUnknownClassFailsAndLeavesObjectUnattached)
{
  CBaseTestWnd wnd;
  EXPECT_FALSE(wnd.CreateEx(0, "NoSuchClassAnywhere", NULL, WS_POPUP, 0, 0, 10, 10, NULL, NULL));
  EXPECT_EQ(NULL, wnd.m_hWnd);
  EXPECT_EQ(1, wnd.m_postNcDestroyCount);
}

TEST_F(MessageMapTest, OnMessageEntryReturnsHandlerResult)
{
  CBaseTestWnd wnd;
  ASSERT_TRUE(wnd.CreateTopLevel());
  EXPECT_EQ(kAppAnswer, wnd.SendMessage(kAppMessage));
}

TEST_F(MessageMapTest, RegisteredMessageReachesItsHandler)
{
  CBaseTestWnd wnd;
  ASSERT_TRUE(wnd.CreateTopLevel());
  EXPECT_EQ(kRegisteredAnswer, wnd.SendMessage(g_registeredMessage, 77));
  EXPECT_EQ(77u, wnd.m_lastRegisteredWParam);
}

TEST_F(MessageMapTest, DerivedEntryOverridesBaseHandler)
{
  CDerivedTestWnd wnd;
  ASSERT_TRUE(wnd.CreateTopLevel());
  const int baseBefore = wnd.m_baseSizeCount;
  wnd.SendMessage(WM_SIZE, SIZE_RESTORED, MAKELPARAM(120, 80));
  EXPECT_EQ(baseBefore, wnd.m_baseSizeCount);
  EXPECT_GE(wnd.m_derivedSizeCount, 1);
  EXPECT_EQ(CSize(120, 80), wnd.m_lastSize);
}

TEST_F(MessageMapTest, BaseEntriesServeDerivedClass)
{
  CDerivedTestWnd wnd;
  ASSERT_TRUE(wnd.CreateTopLevel());
  EXPECT_EQ(kAppAnswer, wnd.SendMessage(kAppMessage));
  EXPECT_EQ(kDerivedAnswer, wnd.SendMessage(kDerivedOnlyMessage));
  EXPECT_EQ(kRegisteredAnswer, wnd.SendMessage(g_registeredMessage));
}

TEST_F(MessageMapTest, BaseClassDoesNotSeeDerivedEntries)
{
  CBaseTestWnd wnd;
  ASSERT_TRUE(wnd.CreateTopLevel());
  EXPECT_EQ(0, wnd.SendMessage(kDerivedOnlyMessage));
}

TEST_F(MessageMapTest, HandlersReceiveUnpackedArguments)
{
  CBaseTestWnd wnd;
  ASSERT_TRUE(wnd.CreateTopLevel());
  wnd.SendMessage(WM_TIMER, 7);
  EXPECT_EQ(7u, wnd.m_lastTimer);
  wnd.SendMessage(WM_LBUTTONDOWN, MK_LBUTTON | MK_SHIFT, MAKELPARAM(static_cast<WORD>(-3), 5));
  EXPECT_EQ(static_cast<UINT>(MK_LBUTTON | MK_SHIFT), wnd.m_lastFlags);
  EXPECT_EQ(CPoint(-3, 5), wnd.m_lastPoint);
}

TEST_F(MessageMapTest, UnmappedMessagesGetDefaultProcessing)
{
  CBaseTestWnd wnd;
  ASSERT_TRUE(wnd.CreateTopLevel());
  wnd.SetWindowText("changed by default processing");
  CString text;
  wnd.GetWindowText(text);
  EXPECT_STREQ("changed by default processing", static_cast<LPCSTR>(text));
}

TEST_F(MessageMapTest, ExceptionInHandlerStopsAtWindowProcedure)
{
  CBaseTestWnd wnd;
  ASSERT_TRUE(wnd.CreateTopLevel());
  wnd.m_throwOnAppMessage = true;
  EXPECT_EQ(0, wnd.SendMessage(kAppMessage));
  EXPECT_TRUE(::IsWindow(wnd.m_hWnd));
}

TEST_F(MessageMapTest, DestroyWindowDetachesObjectAndCallsPostNcDestroy)
{
  CBaseTestWnd wnd;
  ASSERT_TRUE(wnd.CreateTopLevel());
  const HWND hWnd = wnd.m_hWnd;
  EXPECT_TRUE(wnd.DestroyWindow());
  EXPECT_EQ(NULL, wnd.m_hWnd);
  EXPECT_FALSE(::IsWindow(hWnd));
  EXPECT_EQ(NULL, CWnd::FromHandlePermanent(hWnd));
  EXPECT_EQ(1, wnd.m_postNcDestroyCount);
  EXPECT_FALSE(wnd.DestroyWindow());
}

TEST_F(MessageMapTest, ObjectIsDetachedEvenWhenItsNcDestroyHandlerSkipsTheBase)
{
  CForgetfulWnd wnd;
  ASSERT_TRUE(wnd.CreateTopLevel());
  const HWND hWnd = wnd.m_hWnd;
  EXPECT_TRUE(wnd.DestroyWindow());
  EXPECT_EQ(1, wnd.m_ncDestroyCount);
  EXPECT_EQ(NULL, wnd.m_hWnd);
  EXPECT_EQ(NULL, CWnd::FromHandlePermanent(hWnd));
  EXPECT_EQ(1, wnd.m_postNcDestroyCount);
}

TEST_F(MessageMapTest, DestructorDestroysLiveWindow)
{
  HWND hWnd = NULL;
  {
    CBaseTestWnd wnd;
    ASSERT_TRUE(wnd.CreateTopLevel());
    hWnd = wnd.m_hWnd;
  }
  EXPECT_FALSE(::IsWindow(hWnd));
  EXPECT_EQ(NULL, CWnd::FromHandlePermanent(hWnd));
}

TEST_F(MessageMapTest, SubclassedWindowRoutesThroughMapAndKeepsOldProcedure)
{
  const HWND edit = ::CreateWindowExA(0, "EDIT", "start", WS_POPUP, 0, 0, 50, 20, NULL, NULL, NULL, NULL);
  ASSERT_NE(nullptr, edit);
  const LONG_PTR originalProc = ::GetWindowLongPtrA(edit, GWLP_WNDPROC);
  CBaseTestWnd wnd;
  ASSERT_TRUE(wnd.SubclassWindow(edit));
  EXPECT_EQ(kAppAnswer, wnd.SendMessage(kAppMessage));
  wnd.SetWindowText("through the control");  // the edit control's own procedure keeps its text
  char text[64] = {};
  ::GetWindowTextA(edit, text, sizeof(text));
  EXPECT_STREQ("through the control", text);
  EXPECT_EQ(edit, wnd.UnsubclassWindow());
  EXPECT_EQ(originalProc, ::GetWindowLongPtrA(edit, GWLP_WNDPROC));
  EXPECT_EQ(NULL, CWnd::FromHandlePermanent(edit));
  ::DestroyWindow(edit);
}

TEST_F(MessageMapTest, RegisterClassTwiceSucceedsAndWindowsOfItAreHooked)
{
  WNDCLASSA wc = {};
  wc.lpfnWndProc = AfxGetAfxWndProc();
  wc.hInstance = AfxGetInstanceHandle();
  wc.lpszClassName = "TavoAfxTestClass";
  ASSERT_TRUE(AfxRegisterClass(&wc));
  EXPECT_TRUE(AfxRegisterClass(&wc));
  CBaseTestWnd wnd;
  ASSERT_TRUE(wnd.CreateEx(0, "TavoAfxTestClass", "", WS_POPUP, 0, 0, 30, 30, NULL, NULL));
  EXPECT_EQ(1, wnd.m_createCount);
  EXPECT_EQ(kAppAnswer, wnd.SendMessage(kAppMessage));
}

TEST_F(MessageMapTest, RegisterClassRefusesIncompleteDescriptions)
{
  EXPECT_FALSE(AfxRegisterClass(NULL));
  WNDCLASSA unnamed = {};
  unnamed.lpfnWndProc = AfxGetAfxWndProc();
  EXPECT_FALSE(AfxRegisterClass(&unnamed));
  WNDCLASSA noProcedure = {};
  noProcedure.hInstance = AfxGetInstanceHandle();
  noProcedure.lpszClassName = "TavoAfxTestClassWithoutProcedure";
  EXPECT_FALSE(AfxRegisterClass(&noProcedure));
}

TEST_F(MessageMapTest, WindowsCreatedInsideCreateHandlersAttachToTheirOwnObjects)
{
  struct COuterWnd : CBaseTestWnd {
    CBaseTestWnd m_inner;
    int OnCreateInner()
    {
      return m_inner.Create(NULL, NULL, WS_CHILD, CRect(0, 0, 5, 5), this, 9) ? 0 : -1;
    }
  };
  // The inner window is created while the outer one is in WM_CREATE.
  struct CCreatesChildWnd : COuterWnd {
    LRESULT WindowProc(UINT message, WPARAM wParam, LPARAM lParam) override
    {
      if (message == WM_CREATE && OnCreateInner() != 0) return -1;
      return COuterWnd::WindowProc(message, wParam, lParam);
    }
  } outer;
  ASSERT_TRUE(outer.CreateTopLevel());
  EXPECT_EQ(1, outer.m_createCount);
  EXPECT_EQ(1, outer.m_inner.m_createCount);
  EXPECT_EQ(&outer.m_inner, CWnd::FromHandlePermanent(outer.m_inner.m_hWnd));
  EXPECT_EQ(&outer, CWnd::FromHandlePermanent(outer.m_hWnd));
}
