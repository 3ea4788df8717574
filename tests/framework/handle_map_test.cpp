// handle_map_test.cpp - the permanent and temporary handle maps of CWnd,
// CDC and CGdiObject, and the idle-time deletion of temporary objects.
#include <afxwin.h>

#include <gtest/gtest.h>

namespace {

// Deletes the calling thread's temporary objects, as idle time does.
void RunIdleCleanUp() { CWinThread().OnIdle(1); }

class HandleMapTest : public ::testing::Test {
protected:
    void SetUp() override
    {
        m_rawWindow = ::CreateWindowExA(0, "STATIC", "raw", WS_POPUP, 0, 0, 10, 10, NULL, NULL, NULL, NULL);
        ASSERT_NE(nullptr, m_rawWindow);
        m_screen = ::GetDC(NULL);
        m_other = ::CreateCompatibleDC(m_screen);
    }
    void TearDown() override
    {
        RunIdleCleanUp();
        ::DeleteDC(m_other);
        ::ReleaseDC(NULL, m_screen);
        ::DestroyWindow(m_rawWindow);
    }
    HWND m_rawWindow = NULL;
    HDC m_screen = NULL;
    HDC m_other = NULL; // marks a temporary CDC: only that object carries it as its attribute handle
};

} // namespace

TEST_F(HandleMapTest, PermanentObjectsRoundTripUntilDetached)
{
    CWnd wnd;
    ASSERT_TRUE(wnd.Attach(m_rawWindow));
    EXPECT_EQ(&wnd, CWnd::FromHandle(m_rawWindow));
    EXPECT_EQ(&wnd, CWnd::FromHandlePermanent(m_rawWindow));
    CWnd second;
    EXPECT_FALSE(second.Attach(m_rawWindow));
    EXPECT_EQ(&wnd, CWnd::FromHandlePermanent(m_rawWindow));
    EXPECT_EQ(m_rawWindow, wnd.Detach());
    EXPECT_EQ(nullptr, CWnd::FromHandlePermanent(m_rawWindow));
    EXPECT_TRUE(::IsWindow(m_rawWindow));

    CBrush brush;
    ASSERT_TRUE(brush.CreateSolidBrush(RGB(9, 9, 9)));
    EXPECT_EQ(&brush, CBrush::FromHandle(static_cast<HBRUSH>(brush.m_hObject)));
}

TEST_F(HandleMapTest, TemporaryObjectsLastUntilIdleAndNeverDestroyTheirHandles)
{
    EXPECT_EQ(nullptr, CWnd::FromHandle(NULL)); // no handle, no object
    EXPECT_EQ(nullptr, CWnd::FromHandlePermanent(NULL));
    EXPECT_EQ(nullptr, CDC::FromHandle(NULL));
    EXPECT_EQ(nullptr, CGdiObject::FromHandle(NULL));
    CWnd* temporaryWnd = CWnd::FromHandle(m_rawWindow);
    ASSERT_NE(nullptr, temporaryWnd);
    EXPECT_EQ(m_rawWindow, temporaryWnd->m_hWnd);
    EXPECT_EQ(nullptr, CWnd::FromHandlePermanent(m_rawWindow));
    EXPECT_EQ(temporaryWnd, CWnd::FromHandle(m_rawWindow));
    CDC* temporaryDc = CDC::FromHandle(m_screen);
    ASSERT_NE(nullptr, temporaryDc);
    EXPECT_EQ(m_screen, temporaryDc->m_hAttribDC);
    temporaryDc->SetAttribDC(m_other);
    EXPECT_EQ(m_other, CDC::FromHandle(m_screen)->m_hAttribDC);
    const HPEN pen = ::CreatePen(PS_SOLID, 1, RGB(1, 2, 3));
    const HBRUSH brush = ::CreateSolidBrush(RGB(4, 5, 6));
    EXPECT_NE(nullptr, dynamic_cast<CPen*>(CGdiObject::FromHandle(pen))); // the handle's own class
    EXPECT_NE(nullptr, dynamic_cast<CBrush*>(CGdiObject::FromHandle(brush)));
    EXPECT_EQ(pen, CPen::FromHandle(pen)->m_hObject);

    RunIdleCleanUp();
    EXPECT_EQ(m_screen, CDC::FromHandle(m_screen)->m_hAttribDC); // a new object
    RunIdleCleanUp();
    EXPECT_TRUE(::IsWindow(m_rawWindow));
    EXPECT_EQ(m_rawWindow, CWnd::FromHandle(m_rawWindow)->m_hWnd);
    EXPECT_NE(0u, ::GetObjectType(m_screen));
    EXPECT_EQ(static_cast<DWORD>(OBJ_PEN), ::GetObjectType(pen));
    EXPECT_EQ(static_cast<DWORD>(OBJ_BRUSH), ::GetObjectType(brush));
    ::DeleteObject(pen);
    ::DeleteObject(brush);
}
