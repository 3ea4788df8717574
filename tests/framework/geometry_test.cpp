// geometry_test.cpp - CPoint, CSize and CRect.
#include <afx.h>

#include <gtest/gtest.h>

TEST(CPointOperations, ArithmeticWithSizesAndPoints)
{
  CPoint p(3, 4);
  p += CSize(1, 2);
  EXPECT_EQ(CPoint(4, 6), p);
  EXPECT_EQ(CSize(2, 3), CPoint(5, 7) - CPoint(3, 4));
  EXPECT_EQ(CPoint(-4, -6), -p);
  p.Offset(-4, -6);
  EXPECT_EQ(CPoint(0, 0), p);
}

TEST(CPointOperations, MouseMessageCoordinatesAreSigned)
{
  const CPoint p(MAKELPARAM(static_cast<WORD>(-5), 7));
  EXPECT_EQ(-5, p.x);
  EXPECT_EQ(7, p.y);
}

TEST(CSizeOperations, ArithmeticAndComparison)
{
  CSize s(10, 20);
  s -= CSize(5, 5);
  EXPECT_EQ(CSize(5, 15), s);
  EXPECT_TRUE(s != CSize(5, 16));
  EXPECT_EQ(CSize(6, 16), s + CSize(1, 1));
}

TEST(CRectOperations, SizesAndCorners)
{
  CRect r(10, 20, 110, 70);
  EXPECT_EQ(100, r.Width());
  EXPECT_EQ(50, r.Height());
  EXPECT_EQ(CSize(100, 50), r.Size());
  EXPECT_EQ(CPoint(10, 20), r.TopLeft());
  r.BottomRight() = CPoint(30, 40);
  EXPECT_EQ(CRect(10, 20, 30, 40), r);
  EXPECT_EQ(CPoint(20, 30), r.CenterPoint());
}

TEST(CRectOperations, PtInRectIsHalfOpen)
{
  const CRect r(0, 0, 10, 10);
  EXPECT_TRUE(r.PtInRect(CPoint(0, 0)));
  EXPECT_TRUE(r.PtInRect(CPoint(9, 9)));
  EXPECT_FALSE(r.PtInRect(CPoint(10, 5)));
  EXPECT_FALSE(r.PtInRect(CPoint(5, 10)));
}

TEST(CRectOperations, InflateOffsetNormalize)
{
  CRect r(10, 10, 20, 20);
  r.InflateRect(4, 2);
  EXPECT_EQ(CRect(6, 8, 24, 22), r);
  r.OffsetRect(-6, -8);
  EXPECT_EQ(CRect(0, 0, 18, 14), r);
  CRect flipped(5, 9, 1, 2);
  flipped.NormalizeRect();
  EXPECT_EQ(CRect(1, 2, 5, 9), flipped);
  EXPECT_TRUE(CRect().IsRectNull());
  EXPECT_TRUE(CRect(3, 3, 3, 8).IsRectEmpty());
}

TEST(CRectOperations, IntersectionAndUnion)
{
  const CRect a(0, 0, 10, 10);
  const CRect b(5, 5, 15, 15);
  EXPECT_EQ(CRect(5, 5, 10, 10), a & b);
  EXPECT_EQ(CRect(0, 0, 15, 15), a | b);
  CRect none;
  EXPECT_FALSE(none.IntersectRect(&a, CRect(20, 20, 30, 30)));
}
