// dc_test.cpp - CDC's output and attribute handles, CPaintDC and CClientDC.
#include <afxwin.h>

#include <gtest/gtest.h>

#include "framework_test_support.h"

namespace {

constexpr int kBitmapSize = 32;

// A memory DC with a 32-bit DIB section selected, for reading pixels back.
struct PixelSurface {
  PixelSurface()
  {
    BITMAPINFO info = {};
    info.bmiHeader.biSize = sizeof(info.bmiHeader);
    info.bmiHeader.biWidth = kBitmapSize;
    info.bmiHeader.biHeight = -kBitmapSize;
    info.bmiHeader.biPlanes = 1;
    info.bmiHeader.biBitCount = 32;
    dc = ::CreateCompatibleDC(NULL);
    bitmap = ::CreateDIBSection(dc, &info, DIB_RGB_COLORS, reinterpret_cast<void**>(&bits), NULL, 0);
    previous = ::SelectObject(dc, bitmap);
    ::PatBlt(dc, 0, 0, kBitmapSize, kBitmapSize, WHITENESS);
  }
  ~PixelSurface()
  {
    ::SelectObject(dc, previous);
    ::DeleteObject(bitmap);
    ::DeleteDC(dc);
  }
  bool AnyPixelNot(DWORD value) const
  {
    for (int i = 0; i < kBitmapSize * kBitmapSize; ++i) {
      if ((bits[i] & 0xFFFFFF) != value) return true;
    }
    return false;
  }
  HDC dc = NULL;
  HBITMAP bitmap = NULL;
  HGDIOBJ previous = NULL;
  DWORD* bits = nullptr;
};

class CPaintRecorderWnd : public CWnd {
public:
  HDC m_paintDc = NULL;
  bool m_paintDcWasMapped = false;
  int m_paintCount = 0;

protected:
  afx_msg void OnPaint()
  {
    CPaintDC dc(this);
    ++m_paintCount;
    m_paintDc = dc.m_hDC;
    m_paintDcWasMapped = CDC::FromHandle(dc.m_hDC) == &dc;
    dc.FillSolidRect(0, 0, 5, 5, RGB(255, 0, 0));
  }
  DECLARE_MESSAGE_MAP()
};

BEGIN_MESSAGE_MAP(CPaintRecorderWnd, CWnd)
  ON_WM_PAINT()
END_MESSAGE_MAP()

class DcTest : public ::testing::Test {
protected:
  void TearDown() override
  {
    framework_test::DispatchPendingMessages();
    CWinThread().OnIdle(1);
  }
};

}  // namespace

TEST_F(DcTest, PaintDcEndsPaintingAndLetsGoOfItsDc)
{
  CPaintRecorderWnd wnd;
  ASSERT_TRUE(wnd.CreateEx(0, NULL, "paint", WS_POPUP | WS_VISIBLE, 0, 0, 60, 60, NULL, NULL));
  wnd.Invalidate(FALSE);
  wnd.UpdateWindow();
  EXPECT_GE(wnd.m_paintCount, 1);
  EXPECT_TRUE(wnd.m_paintDcWasMapped);
  RECT update;
  EXPECT_FALSE(::GetUpdateRect(wnd.m_hWnd, &update, FALSE));  // EndPaint validated it
  EXPECT_NE(nullptr, CDC::FromHandle(wnd.m_paintDc));
  CDC* afterwards = CDC::FromHandle(wnd.m_paintDc);
  EXPECT_EQ(wnd.m_paintDc, afterwards->m_hDC);  // a fresh temporary, not the destroyed CPaintDC
}

TEST_F(DcTest, ClientDcReleasesItsDc)
{
  CWnd wnd;
  ASSERT_TRUE(wnd.CreateEx(0, NULL, "client", WS_POPUP, 0, 0, 60, 60, NULL, NULL));
  HDC hDC = NULL;
  {
    CClientDC dc(&wnd);
    hDC = dc.m_hDC;
    ASSERT_NE(nullptr, hDC);
    EXPECT_EQ(&dc, CDC::FromHandle(hDC));
    EXPECT_EQ(&wnd, dc.GetWindow());
  }
  // Released: releasing it once more fails.
  EXPECT_EQ(0, ::ReleaseDC(wnd.m_hWnd, hDC));
}

TEST_F(DcTest, ClientDcOfNullWindowIsTheScreen)
{
  CClientDC dc(NULL);
  EXPECT_NE(nullptr, dc.m_hDC);
  EXPECT_EQ(::GetDeviceCaps(dc.m_hDC, HORZRES), dc.GetDeviceCaps(HORZRES));
}

TEST_F(DcTest, DcThatCreatedItsHandleDeletesIt)
{
  HDC hDC = NULL;
  {
    CDC dc;
    ASSERT_TRUE(dc.CreateCompatibleDC(NULL));
    hDC = dc.m_hDC;
    EXPECT_EQ(hDC, dc.m_hAttribDC);
  }
  EXPECT_EQ(0u, ::GetObjectType(hDC));
}

TEST_F(DcTest, DetachedDcIsNotDeleted)
{
  HDC hDC = NULL;
  {
    CDC dc;
    ASSERT_TRUE(dc.CreateCompatibleDC(NULL));
    hDC = dc.Detach();
    EXPECT_EQ(nullptr, dc.m_hDC);
    EXPECT_EQ(nullptr, dc.m_hAttribDC);
  }
  EXPECT_NE(0u, ::GetObjectType(hDC));
  ::DeleteDC(hDC);
}

TEST_F(DcTest, CapabilitiesAndMetricsComeFromAttributeHandle)
{
  PixelSurface output;
  const HDC attribute = ::CreateCompatibleDC(NULL);
  LOGFONTA big = {};
  big.lfHeight = 40;
  const HFONT bigFont = ::CreateFontIndirectA(&big);
  const HGDIOBJ previousFont = ::SelectObject(attribute, bigFont);

  CDC dc;
  dc.m_hDC = output.dc;
  dc.SetAttribDC(attribute);
  TEXTMETRICA metrics = {};
  ASSERT_TRUE(dc.GetTextMetrics(&metrics));
  TEXTMETRICA outputMetrics = {};
  ASSERT_TRUE(dc.GetOutputTextMetrics(&outputMetrics));
  EXPECT_EQ(40, metrics.tmHeight);
  EXPECT_NE(40, outputMetrics.tmHeight);
  EXPECT_GT(dc.GetTextExtent("Wide text").cy, dc.GetOutputTextExtent("Wide text", 9).cy);

  dc.SetTextColor(RGB(1, 2, 3));  // attributes are set on both handles
  EXPECT_EQ(RGB(1, 2, 3), ::GetTextColor(output.dc));
  EXPECT_EQ(RGB(1, 2, 3), ::GetTextColor(attribute));

  dc.ReleaseAttribDC();
  dc.ReleaseOutputDC();
  ::SelectObject(attribute, previousFont);
  ::DeleteObject(bigFont);
  ::DeleteDC(attribute);
}

TEST_F(DcTest, OutputGoesToOutputHandleOnly)
{
  PixelSurface output;
  PixelSurface attribute;
  CDC dc;
  dc.m_hDC = output.dc;
  dc.SetAttribDC(attribute.dc);
  dc.FillSolidRect(2, 2, 4, 4, RGB(0, 0, 0));
  dc.MoveTo(0, 10);
  dc.LineTo(20, 10);
  EXPECT_TRUE(output.AnyPixelNot(0xFFFFFF));
  EXPECT_FALSE(attribute.AnyPixelNot(0xFFFFFF));
  EXPECT_EQ(CPoint(20, 10), dc.GetCurrentPosition());  // kept on the attribute handle too
  dc.ReleaseAttribDC();
  dc.ReleaseOutputDC();
}

TEST_F(DcTest, SelectObjectReturnsPreviousObjectWrapped)
{
  PixelSurface surface;
  CDC dc;
  ASSERT_TRUE(dc.Attach(surface.dc));
  CPen red(PS_SOLID, 1, RGB(255, 0, 0));
  const HGDIOBJ stockPen = ::GetCurrentObject(surface.dc, OBJ_PEN);
  CPen* previous = dc.SelectObject(&red);
  ASSERT_NE(nullptr, previous);
  EXPECT_EQ(stockPen, previous->m_hObject);
  EXPECT_EQ(&red, dc.SelectObject(previous));
  dc.Detach();
}

TEST_F(DcTest, ClipRegionAndViewportOrigin)
{
  PixelSurface surface;
  CDC dc;
  ASSERT_TRUE(dc.Attach(surface.dc));
  CRgn region;
  ASSERT_TRUE(region.CreateRectRgn(0, 0, 10, 10));
  EXPECT_EQ(SIMPLEREGION, dc.SelectClipRgn(&region));
  dc.IntersectClipRect(2, 2, 8, 8);
  CRect box;
  dc.GetClipBox(&box);
  EXPECT_EQ(CRect(2, 2, 8, 8), box);
  EXPECT_EQ(CPoint(0, 0), dc.SetViewportOrg(0, 5));
  EXPECT_EQ(CPoint(0, 5), dc.GetViewportOrg());
  dc.Detach();
}
