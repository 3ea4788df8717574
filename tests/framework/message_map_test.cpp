// message_map_test.cpp - CWnd creation with the object hooked to its window,
// message-map dispatch with base-class chaining, registered messages and
// destruction.
#include <afxwin.h>

#include <algorithm>
#include <vector>

#include <gtest/gtest.h>

#include "framework_test_support.h"

namespace {

constexpr UINT kAppMessage = WM_APP + 1;
constexpr UINT kDerivedOnlyMessage = WM_APP + 2;
constexpr LRESULT kAppAnswer = 11;
constexpr LRESULT kRegisteredAnswer = 22;
constexpr LRESULT kDerivedAnswer = 33;

// Registered before any map is walked: the maps read it at dispatch time.
UINT g_registeredMessage = ::RegisterWindowMessageA("TavoAfxTestRegistered");

class CBaseTestWnd : public CWnd {
public:
    std::vector<UINT> m_messagesSeen;
    int m_createCount = 0;
    LPVOID m_createParam = NULL;
    int m_baseSizeCount = 0;
    CSize m_lastSize{-1, -1};
    CPoint m_lastPoint{-1, -1};
    WPARAM m_lastRegisteredWParam = 0;
    int m_postNcDestroyCount = 0;
    bool m_throwOnAppMessage = false;
    bool m_refuseCreate = false;

    BOOL CreateTopLevel(LPVOID param = NULL)
    {
        return CreateEx(0, NULL, "test", WS_OVERLAPPEDWINDOW, 100, 100, 300, 200, NULL, NULL, param);
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
        if (m_refuseCreate)
            return -1;
        return CWnd::OnCreate(lpCreateStruct);
    }
    afx_msg void OnSize(UINT, int cx, int cy)
    {
        ++m_baseSizeCount;
        m_lastSize = CSize(cx, cy);
    }
    afx_msg void OnLButtonDown(UINT, CPoint point) { m_lastPoint = point; }
    afx_msg LRESULT OnAppMessage(WPARAM, LPARAM)
    {
        if (m_throwOnAppMessage)
            AfxThrowResourceException();
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
    ON_WM_LBUTTONDOWN()
    ON_MESSAGE(kAppMessage, &CBaseTestWnd::OnAppMessage)
    ON_REGISTERED_MESSAGE(g_registeredMessage, &CBaseTestWnd::OnRegistered)
END_MESSAGE_MAP()

// Overrides a base handler, adds an entry of its own, and takes WM_NCDESTROY
// itself, leaving out the framework's handling.
class CDerivedTestWnd : public CBaseTestWnd {
public:
    int m_derivedSizeCount = 0;
    int m_ncDestroyCount = 0;

protected:
    afx_msg void OnSize(UINT, int cx, int cy)
    {
        ++m_derivedSizeCount;
        m_lastSize = CSize(cx, cy);
    }
    afx_msg LRESULT OnDerivedOnly(WPARAM, LPARAM) { return kDerivedAnswer; }
    afx_msg void OnNcDestroy() { ++m_ncDestroyCount; }

    DECLARE_MESSAGE_MAP()
};

BEGIN_MESSAGE_MAP(CDerivedTestWnd, CBaseTestWnd)
    ON_WM_SIZE()
    ON_WM_NCDESTROY()
    ON_MESSAGE(kDerivedOnlyMessage, &CDerivedTestWnd::OnDerivedOnly)
END_MESSAGE_MAP()

using MessageMapTest = framework_test::WindowTest;

} // namespace

TEST_F(MessageMapTest, CreateHooksObjectsBeforeFirstMessageEvenWhenNested)
{
    // The inner window is created while the outer one is in WM_CREATE.
    struct CCreatesChildWnd : CBaseTestWnd {
        CBaseTestWnd m_inner;
        LRESULT WindowProc(UINT message, WPARAM wParam, LPARAM lParam) override
        {
            if (message == WM_CREATE && !m_inner.Create(NULL, NULL, 0, CRect(0, 0, 5, 5), this, 9))
                return -1;
            return CBaseTestWnd::WindowProc(message, wParam, lParam);
        }
    } wnd;
    int marker = 0;
    ASSERT_TRUE(wnd.CreateTopLevel(&marker));
    EXPECT_EQ(1, wnd.m_createCount);
    EXPECT_EQ(&marker, wnd.m_createParam);
    // Everything from the non-client creation on reached the object.
    const std::vector<UINT>& seen = wnd.m_messagesSeen;
    EXPECT_LT(std::find(seen.begin(), seen.end(), WM_NCCREATE), std::find(seen.begin(), seen.end(), WM_CREATE));
    EXPECT_EQ(&wnd, CWnd::FromHandlePermanent(wnd.m_hWnd));
    EXPECT_EQ(reinterpret_cast<LONG_PTR>(AfxGetAfxWndProc()), ::GetWindowLongPtrA(wnd.m_hWnd, GWLP_WNDPROC));
    EXPECT_EQ(1, wnd.m_inner.m_createCount);
    EXPECT_EQ(&wnd.m_inner, wnd.GetDlgItem(9)); // a child of the outer window, mapped to its object
}

TEST_F(MessageMapTest, FailedCreateLeavesObjectUnattached)
{
    CBaseTestWnd refused;
    refused.m_refuseCreate = true;
    EXPECT_FALSE(refused.CreateTopLevel());
    EXPECT_EQ(1, refused.m_createCount);
    CBaseTestWnd unknownClass;
    EXPECT_FALSE(unknownClass.CreateEx(0, "NoSuchClassAnywhere", NULL, WS_POPUP, 0, 0, 10, 10, NULL, NULL));
    for (CBaseTestWnd* wnd : {&refused, &unknownClass}) {
        EXPECT_EQ(NULL, wnd->m_hWnd);
        EXPECT_EQ(1, wnd->m_postNcDestroyCount);
    }
    CBaseTestWnd attached;
    ASSERT_TRUE(attached.CreateTopLevel());
    const HWND first = attached.m_hWnd;
    EXPECT_FALSE(attached.CreateTopLevel());
    EXPECT_EQ(first, attached.m_hWnd);
}

TEST_F(MessageMapTest, BaseClassEntriesDispatchAndContainExceptions)
{
    CBaseTestWnd wnd;
    ASSERT_TRUE(wnd.CreateTopLevel());
    EXPECT_EQ(kAppAnswer, wnd.SendMessage(kAppMessage));
    EXPECT_EQ(kRegisteredAnswer, wnd.SendMessage(g_registeredMessage, 77));
    EXPECT_EQ(77u, wnd.m_lastRegisteredWParam);
    EXPECT_EQ(0, wnd.SendMessage(kDerivedOnlyMessage)); // a derived class's entry is not the base's
    wnd.SendMessage(WM_LBUTTONDOWN, MK_LBUTTON, MAKELPARAM(static_cast<WORD>(-3), 5));
    EXPECT_EQ(CPoint(-3, 5), wnd.m_lastPoint);
    wnd.m_throwOnAppMessage = true; // the exception ends at the framework's window procedure
    EXPECT_EQ(0, wnd.SendMessage(kAppMessage));
    EXPECT_TRUE(::IsWindow(wnd.m_hWnd));
}

TEST_F(MessageMapTest, DerivedEntryOverridesBaseAndBaseEntriesStillServe)
{
    CDerivedTestWnd wnd;
    ASSERT_TRUE(wnd.CreateTopLevel());
    const int baseBefore = wnd.m_baseSizeCount;
    wnd.SendMessage(WM_SIZE, SIZE_RESTORED, MAKELPARAM(120, 80));
    EXPECT_EQ(baseBefore, wnd.m_baseSizeCount);
    EXPECT_GE(wnd.m_derivedSizeCount, 1);
    EXPECT_EQ(CSize(120, 80), wnd.m_lastSize);
    EXPECT_EQ(kDerivedAnswer, wnd.SendMessage(kDerivedOnlyMessage));
    EXPECT_EQ(kAppAnswer, wnd.SendMessage(kAppMessage));
    EXPECT_EQ(kRegisteredAnswer, wnd.SendMessage(g_registeredMessage));
}

TEST_F(MessageMapTest, DestroyingDetachesEvenWhenNcDestroyHandlerSkipsTheBase)
{
    CBaseTestWnd plain;
    CDerivedTestWnd forgetful;
    for (CBaseTestWnd* wnd : {&plain, static_cast<CBaseTestWnd*>(&forgetful)}) {
        ASSERT_TRUE(wnd->CreateTopLevel());
        const HWND hWnd = wnd->m_hWnd;
        EXPECT_TRUE(wnd->DestroyWindow());
        EXPECT_EQ(NULL, wnd->m_hWnd);
        EXPECT_FALSE(::IsWindow(hWnd));
        EXPECT_EQ(NULL, CWnd::FromHandlePermanent(hWnd));
        EXPECT_EQ(1, wnd->m_postNcDestroyCount);
        EXPECT_FALSE(wnd->DestroyWindow());
    }
    EXPECT_EQ(1, forgetful.m_ncDestroyCount);
    HWND destroyedByDestructor = NULL;
    {
        CBaseTestWnd wnd;
        ASSERT_TRUE(wnd.CreateTopLevel());
        destroyedByDestructor = wnd.m_hWnd;
    }
    EXPECT_FALSE(::IsWindow(destroyedByDestructor));
    EXPECT_EQ(NULL, CWnd::FromHandlePermanent(destroyedByDestructor));
}

TEST_F(MessageMapTest, RegisterClassAcceptsRepeatsAndRefusesIncompleteDescriptions)
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

    EXPECT_FALSE(AfxRegisterClass(NULL));
    WNDCLASSA incomplete = wc;
    incomplete.lpszClassName = NULL;
    EXPECT_FALSE(AfxRegisterClass(&incomplete));
    incomplete.lpszClassName = "TavoAfxTestClassWithoutProcedure";
    incomplete.lpfnWndProc = NULL;
    EXPECT_FALSE(AfxRegisterClass(&incomplete));
}
