// dc_test.cpp - CDC's output and attribute handles, CPaintDC and CClientDC.
#include <afxwin.h>

#include <gtest/gtest.h>

#include "framework_test_support.h"

namespace {

constexpr int kBitmapSize = 32;
constexpr COLORREF kRed = RGB(255, 0, 0);

// A memory DC with a white bitmap selected, for reading pixels back.
struct PixelSurface {
    PixelSurface()
    {
        ::SelectObject(dc, bitmap);
        ::PatBlt(dc, 0, 0, kBitmapSize, kBitmapSize, WHITENESS);
    }
    ~PixelSurface()
    {
        ::DeleteDC(dc); // lets go of the bitmap, which can then be deleted
        ::DeleteObject(bitmap);
    }
    HDC dc = ::CreateCompatibleDC(NULL);
    HBITMAP bitmap = ::CreateBitmap(kBitmapSize, kBitmapSize, 1, 32, NULL);
};

class CPaintRecorderWnd : public CWnd {
public:
    HDC m_paintDc = NULL;
    bool m_paintDcWasMapped = false;

protected:
    afx_msg void OnPaint()
    {
        CPaintDC dc(this);
        m_paintDc = dc.m_hDC;
        m_paintDcWasMapped = CDC::FromHandle(dc.m_hDC) == &dc;
    }
    DECLARE_MESSAGE_MAP()
};

BEGIN_MESSAGE_MAP(CPaintRecorderWnd, CWnd)
    ON_WM_PAINT()
END_MESSAGE_MAP()

using DcTest = framework_test::WindowTest;

} // namespace

TEST_F(DcTest, PaintDcEndsPaintingAndLetsGoOfItsDc)
{
    CPaintRecorderWnd wnd;
    ASSERT_TRUE(wnd.CreateEx(0, NULL, "paint", WS_POPUP | WS_VISIBLE, 0, 0, 60, 60, NULL, NULL));
    wnd.Invalidate(FALSE);
    wnd.UpdateWindow();
    ASSERT_NE(nullptr, wnd.m_paintDc);
    EXPECT_TRUE(wnd.m_paintDcWasMapped);
    RECT update;
    EXPECT_FALSE(::GetUpdateRect(wnd.m_hWnd, &update, FALSE));
    EXPECT_EQ(0, ::ReleaseDC(wnd.m_hWnd, wnd.m_paintDc)); // EndPaint already gave it back
    CDC* afterwards = CDC::FromHandle(wnd.m_paintDc);
    ASSERT_NE(nullptr, afterwards);
    EXPECT_EQ(wnd.m_paintDc, afterwards->m_hDC); // a fresh temporary, not the destroyed CPaintDC
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
    }
    EXPECT_EQ(0, ::ReleaseDC(wnd.m_hWnd, hDC)); // already released
}

TEST_F(DcTest, DcDeletesTheHandleItCreatedUnlessDetached)
{
    HDC kept = NULL;
    HDC deleted = NULL;
    {
        CDC owner;
        ASSERT_TRUE(owner.CreateCompatibleDC(NULL));
        deleted = owner.m_hDC;
        EXPECT_EQ(deleted, owner.m_hAttribDC);
        CDC detached;
        ASSERT_TRUE(detached.CreateCompatibleDC(NULL));
        kept = detached.Detach();
        EXPECT_EQ(nullptr, detached.m_hDC);
        EXPECT_EQ(nullptr, detached.m_hAttribDC);
        EXPECT_NE(&detached, CDC::FromHandle(kept)); // no longer mapped to it
    }
    EXPECT_EQ(0u, ::GetObjectType(deleted));
    EXPECT_NE(0u, ::GetObjectType(kept));
    ::DeleteDC(kept);
}

TEST_F(DcTest, DrawingGoesToOutputHandleAndMetricsComeFromAttributeHandle)
{
    LOGFONTA tall = {};
    tall.lfHeight = 40;
    CFont tallFont; // declared first: the surfaces' DCs go before the font they hold
    ASSERT_TRUE(tallFont.CreateFontIndirect(&tall));
    PixelSurface output;
    PixelSurface attribute;
    ::SelectObject(attribute.dc, tallFont);
    CDC dc;
    dc.m_hDC = output.dc;
    dc.SetAttribDC(attribute.dc);

    TEXTMETRICA metrics = {};
    ASSERT_TRUE(dc.GetTextMetrics(&metrics));
    TEXTMETRICA outputMetrics = {};
    ASSERT_TRUE(dc.GetOutputTextMetrics(&outputMetrics));
    EXPECT_EQ(40, metrics.tmHeight);
    EXPECT_NE(40, outputMetrics.tmHeight);
    EXPECT_GT(dc.GetTextExtent("Wide text").cy, dc.GetOutputTextExtent("Wide text", 9).cy);
    dc.SetTextColor(RGB(1, 2, 3)); // attributes are set on both handles
    EXPECT_EQ(RGB(1, 2, 3), ::GetTextColor(output.dc));
    EXPECT_EQ(RGB(1, 2, 3), ::GetTextColor(attribute.dc));

    CPen red(PS_SOLID, 1, kRed);
    CPen* previous = dc.SelectObject(&red); // the old pen comes back wrapped
    ASSERT_NE(nullptr, previous);
    EXPECT_EQ(::GetStockObject(BLACK_PEN), previous->m_hObject);
    dc.FillSolidRect(2, 2, 4, 4, kRed);
    dc.MoveTo(0, 10);
    dc.LineTo(20, 10);
    EXPECT_EQ(&red, dc.SelectObject(previous));
    for (const CPoint drawn : {CPoint(3, 3), CPoint(15, 10)}) {
        EXPECT_EQ(kRed, ::GetPixel(output.dc, drawn.x, drawn.y));
        EXPECT_EQ(RGB(255, 255, 255), ::GetPixel(attribute.dc, drawn.x, drawn.y));
    }
    EXPECT_EQ(CPoint(20, 10), dc.GetCurrentPosition()); // kept on the attribute handle too
    dc.ReleaseAttribDC();
    dc.ReleaseOutputDC();
}
