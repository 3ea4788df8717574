// gdi_objects_test.cpp - CGdiObject and its kinds delete exactly the GDI
// objects they own.
#include <afxwin.h>

#include <gtest/gtest.h>

namespace {
bool IsLive(HGDIOBJ h) { return ::GetObjectType(h) != 0; }
}  // namespace

TEST(GdiObjectOwnership, DestructorDeletesCreatedObjects)
{
  HGDIOBJ pen = NULL;
  HGDIOBJ brush = NULL;
  HGDIOBJ font = NULL;
  HGDIOBJ region = NULL;
  {
    CPen p(PS_SOLID, 2, RGB(1, 1, 1));
    CBrush b(RGB(2, 2, 2));
    CFont f;
    LOGFONTA logFont = {};
    logFont.lfHeight = 12;
    ASSERT_TRUE(f.CreateFontIndirect(&logFont));
    CRgn r;
    ASSERT_TRUE(r.CreateRectRgn(0, 0, 5, 5));
    pen = p.m_hObject;
    brush = b.m_hObject;
    font = f.m_hObject;
    region = r.m_hObject;
    EXPECT_TRUE(IsLive(pen) && IsLive(brush) && IsLive(font) && IsLive(region));
  }
  EXPECT_FALSE(IsLive(pen));
  EXPECT_FALSE(IsLive(brush));
  EXPECT_FALSE(IsLive(font));
  EXPECT_FALSE(IsLive(region));
}

TEST(GdiObjectOwnership, DetachedObjectSurvivesItsWrapper)
{
  HGDIOBJ pen = NULL;
  {
    CPen p(PS_SOLID, 1, RGB(3, 3, 3));
    pen = p.Detach();
    EXPECT_EQ(nullptr, p.m_hObject);
  }
  EXPECT_TRUE(IsLive(pen));
  ::DeleteObject(pen);
}

TEST(GdiObjectOwnership, DeleteObjectDeletesOnceAndEmptiesWrapper)
{
  CBrush brush;
  EXPECT_FALSE(brush.DeleteObject());  // nothing to delete
  ASSERT_TRUE(brush.CreateSolidBrush(RGB(4, 4, 4)));
  const HGDIOBJ handle = brush.m_hObject;
  EXPECT_TRUE(brush.DeleteObject());
  EXPECT_FALSE(IsLive(handle));
  EXPECT_EQ(nullptr, brush.m_hObject);
  EXPECT_FALSE(brush.DeleteObject());
}

TEST(GdiObjectOwnership, WrapperHoldingAnObjectRefusesAnother)
{
  CPen pen;
  ASSERT_TRUE(pen.CreatePen(PS_SOLID, 1, RGB(5, 5, 5)));
  const HGDIOBJ first = pen.m_hObject;
  const HPEN second = ::CreatePen(PS_DOT, 1, RGB(6, 6, 6));
  EXPECT_FALSE(pen.Attach(second));
  EXPECT_EQ(first, pen.m_hObject);
  ::DeleteObject(second);
}

TEST(GdiObjectOwnership, TemporaryWrapperNeverDeletesItsHandle)
{
  const HBRUSH raw = ::CreateSolidBrush(RGB(7, 7, 7));
  CBrush* temporary = CBrush::FromHandle(raw);
  ASSERT_NE(nullptr, temporary);
  EXPECT_EQ(raw, static_cast<HBRUSH>(*temporary));
  CGdiObject::DeleteTempMap();
  EXPECT_TRUE(IsLive(raw));
  ::DeleteObject(raw);
}

TEST(GdiObjectOwnership, StockObjectSurvivesWrapper)
{
  const HGDIOBJ stock = ::GetStockObject(BLACK_PEN);
  {
    CGdiObject wrapper;
    ASSERT_TRUE(wrapper.CreateStockObject(BLACK_PEN));
    EXPECT_EQ(static_cast<UINT>(OBJ_PEN), wrapper.GetObjectType());
  }
  EXPECT_TRUE(IsLive(stock));
}

TEST(GdiObjectQueries, LogicalDescriptionsComeBack)
{
  CPen pen(PS_DASH, 1, RGB(10, 20, 30));
  LOGPEN logPen = {};
  ASSERT_NE(0, pen.GetLogPen(&logPen));
  EXPECT_EQ(static_cast<UINT>(PS_DASH), logPen.lopnStyle);
  EXPECT_EQ(RGB(10, 20, 30), logPen.lopnColor);
  CBrush brush(RGB(40, 50, 60));
  LOGBRUSH logBrush = {};
  ASSERT_NE(0, brush.GetLogBrush(&logBrush));
  EXPECT_EQ(RGB(40, 50, 60), logBrush.lbColor);
}

TEST(GdiObjectQueries, RegionsCombineAndHitTest)
{
  CRgn a;
  CRgn b;
  CRgn both;
  ASSERT_TRUE(a.CreateRectRgn(0, 0, 10, 10));
  ASSERT_TRUE(b.CreateRectRgn(20, 0, 30, 10));
  ASSERT_TRUE(both.CreateRectRgn(0, 0, 0, 0));
  EXPECT_EQ(COMPLEXREGION, both.CombineRgn(&a, &b, RGN_OR));
  EXPECT_TRUE(both.PtInRegion(25, 5));
  EXPECT_FALSE(both.PtInRegion(15, 5));
  CRect box;
  both.GetRgnBox(&box);
  EXPECT_EQ(CRect(0, 0, 30, 10), box);
}

TEST(ResourceException, ThrownAcrossTheLibraryAndDeletedByCatcher)
{
  bool caught = false;
  try {
    AfxThrowResourceException();
  } catch (CResourceException* e) {
    char text[128] = {};
    EXPECT_TRUE(e->GetErrorMessage(text, sizeof(text)));
    EXPECT_NE('\0', text[0]);
    e->Delete();
    caught = true;
  }
  EXPECT_TRUE(caught);
}
