// handle_map_test.cpp - the permanent and temporary handle maps of CWnd,
// CDC and CGdiObject, and the idle-time deletion of temporary objects.
#include <afxwin.h>

#include <thread>

#include <gtest/gtest.h>

#include "framework_test_support.h"

namespace {

// Deletes the calling thread's temporary objects, as idle time does.
void RunIdleCleanUp()
{
  CWinThread idleThread;
  idleThread.OnIdle(1);
}

class HandleMapTest : public ::testing::Test {
protected:
  void SetUp() override
  {
    m_rawWindow = ::CreateWindowExA(0, "STATIC", "raw", WS_POPUP, 0, 0, 10, 10, NULL, NULL, NULL, NULL);
    ASSERT_NE(nullptr, m_rawWindow);
  }
  void TearDown() override
  {
    RunIdleCleanUp();
    ::DestroyWindow(m_rawWindow);
  }
  HWND m_rawWindow = NULL;
};

}  // namespace

TEST_F(HandleMapTest, NullHandlesGiveNullObjects)
{
  EXPECT_EQ(nullptr, CWnd::FromHandle(NULL));
  EXPECT_EQ(nullptr, CWnd::FromHandlePermanent(NULL));
  EXPECT_EQ(nullptr, CDC::FromHandle(NULL));
  EXPECT_EQ(nullptr, CGdiObject::FromHandle(NULL));
  const CWnd* none = nullptr;
  EXPECT_EQ(NULL, none->GetSafeHwnd());
}

TEST_F(HandleMapTest, AttachedWindowRoundTripsThroughPermanentMap)
{
  CWnd wnd;
  ASSERT_TRUE(wnd.Attach(m_rawWindow));
  EXPECT_EQ(&wnd, CWnd::FromHandle(m_rawWindow));
  EXPECT_EQ(&wnd, CWnd::FromHandlePermanent(m_rawWindow));
  EXPECT_EQ(m_rawWindow, wnd.Detach());
  EXPECT_EQ(nullptr, CWnd::FromHandlePermanent(m_rawWindow));
  EXPECT_TRUE(::IsWindow(m_rawWindow));
}

TEST_F(HandleMapTest, SecondObjectCannotAttachSameWindow)
{
  CWnd first;
  CWnd second;
  ASSERT_TRUE(first.Attach(m_rawWindow));
  EXPECT_FALSE(second.Attach(m_rawWindow));
  EXPECT_EQ(&first, CWnd::FromHandlePermanent(m_rawWindow));
  first.Detach();
}

TEST_F(HandleMapTest, TemporaryWindowIsReusedUntilIdleAndLeavesWindowAlive)
{
  CWnd* temporary = CWnd::FromHandle(m_rawWindow);
  ASSERT_NE(nullptr, temporary);
  EXPECT_EQ(m_rawWindow, temporary->m_hWnd);
  EXPECT_EQ(nullptr, CWnd::FromHandlePermanent(m_rawWindow));
  EXPECT_EQ(temporary, CWnd::FromHandle(m_rawWindow));
  RunIdleCleanUp();
  EXPECT_TRUE(::IsWindow(m_rawWindow));
  EXPECT_EQ(m_rawWindow, CWnd::FromHandle(m_rawWindow)->m_hWnd);
}

TEST_F(HandleMapTest, TemporaryDcIsReplacedAfterIdleCleanUp)
{
  const HDC screen = ::GetDC(NULL);
  const HDC other = ::CreateCompatibleDC(screen);
  CDC* temporary = CDC::FromHandle(screen);
  ASSERT_NE(nullptr, temporary);
  EXPECT_EQ(screen, temporary->m_hAttribDC);
  temporary->SetAttribDC(other);  // a mark that only this object carries
  EXPECT_EQ(other, CDC::FromHandle(screen)->m_hAttribDC);
  RunIdleCleanUp();
  EXPECT_EQ(screen, CDC::FromHandle(screen)->m_hAttribDC);
  RunIdleCleanUp();
  EXPECT_NE(0u, ::GetObjectType(screen));  // the temporary did not delete the DC
  ::DeleteDC(other);
  ::ReleaseDC(NULL, screen);
}

TEST_F(HandleMapTest, LockedTemporaryMapsKeepTheirObjects)
{
  const HDC screen = ::GetDC(NULL);
  const HDC other = ::CreateCompatibleDC(screen);
  AfxLockTempMaps();
  CDC::FromHandle(screen)->SetAttribDC(other);
  AfxLockTempMaps();
  EXPECT_FALSE(AfxUnlockTempMaps(TRUE));  // still locked once
  EXPECT_EQ(other, CDC::FromHandle(screen)->m_hAttribDC);
  EXPECT_TRUE(AfxUnlockTempMaps(TRUE));
  EXPECT_EQ(screen, CDC::FromHandle(screen)->m_hAttribDC);
  ::DeleteDC(other);
  ::ReleaseDC(NULL, screen);
}

TEST_F(HandleMapTest, TemporaryGdiObjectHasTheHandlesClassAndKeepsTheHandle)
{
  const HPEN pen = ::CreatePen(PS_SOLID, 1, RGB(1, 2, 3));
  const HBRUSH brush = ::CreateSolidBrush(RGB(4, 5, 6));
  EXPECT_NE(nullptr, dynamic_cast<CPen*>(CGdiObject::FromHandle(pen)));
  EXPECT_NE(nullptr, dynamic_cast<CBrush*>(CGdiObject::FromHandle(brush)));
  EXPECT_EQ(pen, CPen::FromHandle(pen)->m_hObject);
  RunIdleCleanUp();
  EXPECT_EQ(static_cast<DWORD>(OBJ_PEN), ::GetObjectType(pen));
  EXPECT_EQ(static_cast<DWORD>(OBJ_BRUSH), ::GetObjectType(brush));
  ::DeleteObject(pen);
  ::DeleteObject(brush);
}

TEST_F(HandleMapTest, AttachedGdiObjectAndDcRoundTrip)
{
  CBrush brush;
  ASSERT_TRUE(brush.CreateSolidBrush(RGB(9, 9, 9)));
  EXPECT_EQ(&brush, CBrush::FromHandle(static_cast<HBRUSH>(brush.m_hObject)));
  CDC dc;
  ASSERT_TRUE(dc.CreateCompatibleDC(NULL));
  EXPECT_EQ(&dc, CDC::FromHandle(dc.m_hDC));
  const HDC hDC = dc.Detach();
  EXPECT_NE(&dc, CDC::FromHandle(hDC));
  RunIdleCleanUp();
  ::DeleteDC(hDC);
}

TEST_F(HandleMapTest, PermanentMapsBelongToTheirThread)
{
  CWnd wnd;
  ASSERT_TRUE(wnd.Attach(m_rawWindow));
  CWnd* seenByOtherThread = &wnd;
  std::thread other([&] { seenByOtherThread = CWnd::FromHandlePermanent(m_rawWindow); });
  other.join();
  EXPECT_EQ(nullptr, seenByOtherThread);
  wnd.Detach();
}
