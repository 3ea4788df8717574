// gdi_objects_test.cpp - CGdiObject and its kinds delete exactly the GDI
// objects they own; the framework's resource exception reaches its catcher
// across the library boundary.
#include <afxwin.h>

#include <vector>

#include <gtest/gtest.h>

TEST(GdiObjectOwnership, DestructorDeletesCreatedObjectsButNotDetachedOnes)
{
    std::vector<HGDIOBJ> owned;
    HGDIOBJ detached = NULL;
    {
        CPen pen(PS_SOLID, 2, RGB(1, 1, 1));
        CBrush brush(RGB(2, 2, 2));
        CFont font;
        LOGFONTA logFont = {};
        logFont.lfHeight = 12;
        ASSERT_TRUE(font.CreateFontIndirect(&logFont));
        CRgn region;
        ASSERT_TRUE(region.CreateRectRgn(0, 0, 5, 5));
        owned = {pen.m_hObject, brush.m_hObject, font.m_hObject, region.m_hObject};
        for (HGDIOBJ handle : owned)
            ASSERT_NE(0u, ::GetObjectType(handle));
        CPen released(PS_SOLID, 1, RGB(3, 3, 3));
        detached = released.Detach();
        EXPECT_EQ(nullptr, released.m_hObject);
    }
    for (HGDIOBJ handle : owned)
        EXPECT_EQ(0u, ::GetObjectType(handle));
    EXPECT_NE(0u, ::GetObjectType(detached));
    ::DeleteObject(detached);
}

TEST(GdiObjectOwnership, WrapperHoldsOneObjectAndDeletesItOnce)
{
    CBrush brush;
    EXPECT_FALSE(brush.DeleteObject()); // nothing to delete
    ASSERT_TRUE(brush.CreateSolidBrush(RGB(4, 4, 4)));
    const HGDIOBJ deleted = brush.m_hObject;
    const HBRUSH another = ::CreateSolidBrush(RGB(6, 6, 6));
    EXPECT_FALSE(brush.Attach(another)); // the first one would leak
    EXPECT_EQ(deleted, brush.m_hObject);
    ::DeleteObject(another);
    EXPECT_TRUE(brush.DeleteObject());
    EXPECT_EQ(0u, ::GetObjectType(deleted));
    EXPECT_EQ(nullptr, brush.m_hObject);
    EXPECT_FALSE(brush.DeleteObject());
}

TEST(ResourceException, ThrownAcrossTheLibraryAndDeletedByCatcher)
{
    try {
        AfxThrowResourceException();
        FAIL() << "nothing thrown";
    } catch (CResourceException* e) {
        char text[128] = {};
        EXPECT_TRUE(e->GetErrorMessage(text, sizeof(text)));
        EXPECT_NE('\0', text[0]);
        e->Delete();
    }
}
