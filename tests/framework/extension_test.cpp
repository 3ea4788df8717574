// extension_test.cpp - resources found through the extension-module chain,
// and links leaving the chain.
#include <afxwin.h>

#include <gtest/gtest.h>

#include "extension_library.h"
#include "extension_resources.h"
#include "framework_test_support.h"

namespace {

HMODULE ExtensionModule() { return ::GetModuleHandleA("afx_test_extension.dll"); }

using ExtensionTest = framework_test::WindowTest;

} // namespace

TEST_F(ExtensionTest, StringIsFoundInTheLibraryThatJoinedTheChainAtLoad)
{
    ASSERT_TRUE(ExtensionLibraryAttached());
    ASSERT_NE(nullptr, ExtensionModule());
    EXPECT_EQ(ExtensionModule(), AfxFindStringResourceHandle(IDS_EXTENSION_GREETING));
    CString text;
    ASSERT_TRUE(text.LoadString(IDS_EXTENSION_GREETING));
    EXPECT_STREQ("Hello from the extension library", static_cast<LPCSTR>(text));
    const CString second(MAKEINTRESOURCEA(IDS_EXTENSION_SECOND));
    EXPECT_STREQ("Second string of the block", static_cast<LPCSTR>(second));
    // The block holding these strings exists, but not this entry of it.
    EXPECT_EQ(AfxGetResourceHandle(), AfxFindStringResourceHandle(IDS_EXTENSION_SECOND + 1));
}

TEST_F(ExtensionTest, CursorIsFoundInTheExtensionLibrary)
{
    EXPECT_EQ(ExtensionModule(), AfxFindResourceHandle(MAKEINTRESOURCEA(IDC_EXTENSION_CURSOR), RT_GROUP_CURSOR));
    CWinApp app;
    EXPECT_NE(nullptr, app.LoadCursor(IDC_EXTENSION_CURSOR));
    EXPECT_EQ(AfxGetResourceHandle(), AfxFindResourceHandle(MAKEINTRESOURCEA(31999), RT_GROUP_CURSOR));
}

TEST_F(ExtensionTest, RemovedLinkIsNoLongerSearched)
{
    AFX_EXTENSION_MODULE record = {};
    ASSERT_TRUE(AfxInitExtensionModule(record, ExtensionModule()));
    EXPECT_TRUE(AfxInitExtensionModule(record, NULL)); // already initialised: unchanged
    EXPECT_EQ(ExtensionModule(), record.hResource);
    // A system link for the same module is searched only after application
    // links; removing the records of this module leaves nothing to find.
    new CDynLinkLibrary(record, TRUE);
    AfxTermExtensionModule(record);
    EXPECT_EQ(AfxGetResourceHandle(), AfxFindStringResourceHandle(IDS_EXTENSION_GREETING));
    // Put the library back into the chain for the other tests.
    new CDynLinkLibrary(record);
    EXPECT_EQ(ExtensionModule(), AfxFindStringResourceHandle(IDS_EXTENSION_GREETING));
}
