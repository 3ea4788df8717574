// The library frame: what loading the library did, a second process attach,
// the library object (palette, initialisation, trace) and the library's own
// resources (string table and pan cursor).
#include "Tavo_WiLibrary.h"
#include "Tavo_WiModule.h"
#include "Tavo_WiPalette.h"

#include "Gui_Locale.h"
#include "Gui_Msg.h"
#include "Port_Init.h"
#include "Tavo_GrLibrary.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <string>
#include <tuple>
#include <utility>
#include <vector>

namespace {

HMODULE LibraryModule()
{
    return GetModuleHandleA("libTavo_Windows.dll");
}

std::string Text(const CString& value)
{
    return std::string(value.GetString(), value.GetLength());
}

// What the entry point's work can change, to compare before and after a call:
// the framework's record, the library's link, the registered resource modules
// and the users of each portability service.
auto AttachState()
{
    std::vector<HINSTANCE> resourceModules;
    for (int i = 0; i < Gui_Locale::GetResourceModuleCount(); ++i)
        resourceModules.push_back(Gui_Locale::GetResourceModule(i));
    std::vector<int> serviceUsers;
    for (Port_Service service : {Port_Service::File, Port_Service::PathList, Port_Service::InstanceTable,
                                 Port_Service::Factory, Port_Service::MsgMan})
        serviceUsers.push_back(Port_GetServiceUsers(service));
    const AFX_EXTENSION_MODULE& record = Tavo_WiGetExtensionModule();
    return std::make_tuple(record.bInitialized, record.hModule, record.hResource, Tavo_WiGetLibraryLink(), resourceModules,
                           serviceUsers);
}

// ---- Loading -------------------------------------------------------------------------

TEST(LibraryLoad, TheFirstAttachLinkedTheLibraryIntoTheFrameworkAndTheMessageLookup)
{
    ASSERT_NE(LibraryModule(), nullptr);
    EXPECT_EQ(Tavo_WiGetModuleInstance(), LibraryModule());
    const auto [initialized, module, resource, link, resourceModules, serviceUsers] = AttachState();
    EXPECT_TRUE(initialized && module == LibraryModule());
    ASSERT_NE(link, nullptr);
    EXPECT_TRUE(link->m_hModule == LibraryModule() && !link->m_bSystem);
    EXPECT_EQ(AfxFindStringResourceHandle(20800), LibraryModule());
    EXPECT_EQ(std::count(resourceModules.begin(), resourceModules.end(), LibraryModule()), 1);
    for (int users : serviceUsers)
        EXPECT_GE(users, 1) << "the portability services are held while the library is loaded";
}

TEST(LibraryEntry, ASecondProcessAttachAndOtherNotificationsChangeNothing)
{
    // The second attach comes with another instance handle: work done again
    // would show in the record or in the registered resource modules.
    for (auto [instance, reason] : {std::pair<HINSTANCE, DWORD>{GetModuleHandleA(nullptr), DLL_PROCESS_ATTACH},
                                    {LibraryModule(), DLL_THREAD_ATTACH},
                                    {LibraryModule(), DLL_THREAD_DETACH},
                                    {LibraryModule(), DLL_PROCESS_DETACH}}) {
        SCOPED_TRACE(reason);
        const auto before = AttachState();
        EXPECT_EQ(Tavo_WiLibraryEntry(instance, reason, nullptr), TRUE);
        EXPECT_EQ(AttachState(), before);
    }
}

// ---- The library object ------------------------------------------------------------------

// A palette of another class that reports its destruction.
struct ForeignPalette : Tavo_GrPalette {
    ForeignPalette(const char* className, bool* destroyed) : m_className(className), m_destroyed(destroyed) {}
    ~ForeignPalette() override { *m_destroyed = true; }
    const char* GetClassName() const override { return m_className; }
    const char* m_className;
    bool* m_destroyed;
};

class LibraryObjectTest : public ::testing::Test {
protected:
    void SetUp() override { Tavo_GrLibrary::SetPalette(nullptr); }
    void TearDown() override
    {
        Tavo_GrLibrary::SetPalette(nullptr);
        Tavo_GrLibrary::SetTraceSink(nullptr, nullptr);
    }
};

TEST_F(LibraryObjectTest, GetPaletteInstallsReusesAndReplacesAPaletteOfAnotherClass)
{
    Tavo_WiPalette* installed = Tavo_WiLibrary::GetPalette();
    ASSERT_NE(installed, nullptr);
    EXPECT_EQ(installed->GetColorCount(), 16);
    EXPECT_TRUE(Tavo_GrLibrary::GetPalette() == installed && Tavo_WiLibrary::GetPalette() == installed) << "installed, then reused";

    // Only the exact class name is ours; a differently cased one is not.
    for (const char* name : {"Tavo_GrPalette", "tavo_wipalette", "Tavo_WiPalette2"}) {
        SCOPED_TRACE(name);
        bool destroyed = false;
        Tavo_GrLibrary::SetPalette(new ForeignPalette(name, &destroyed));
        Tavo_WiPalette* palette = Tavo_WiLibrary::GetPalette();
        ASSERT_NE(palette, nullptr);
        EXPECT_STREQ(palette->GetClassName(), "Tavo_WiPalette");
        EXPECT_EQ(Tavo_GrLibrary::GetPalette(), palette);
        EXPECT_TRUE(destroyed) << "the core released the palette it held";
    }
}

TEST_F(LibraryObjectTest, InitializeAndTerminateArePassedToTheCore)
{
    const int before = Tavo_GrLibrary::GetInitializeCount();
    Tavo_WiLibrary::Initialize();
    Tavo_WiLibrary::Initialize();
    Tavo_WiLibrary::Terminate(false);
    EXPECT_EQ(Tavo_GrLibrary::GetInitializeCount(), before + 1);
    Tavo_WiLibrary::Terminate(true);
    EXPECT_EQ(Tavo_GrLibrary::GetInitializeCount(), 0);
}

TEST_F(LibraryObjectTest, TracePassesTheTextByteForByte)
{
    std::vector<const char*> seen;
    Tavo_GrLibrary::SetTraceSink([](const char* text, void* s) { static_cast<std::vector<const char*>*>(s)->push_back(text); }, &seen);
    const char message[] = "zoom %d%% \x7F\xFF\x80 \t done\n";
    Tavo_WiLibrary::Trace(message);
    EXPECT_EQ(seen, std::vector<const char*>{message}) << "the caller's very bytes, once";
}

// ---- Resources -------------------------------------------------------------------------

TEST(LibraryStrings, TheFourTextsFormatFromTheLibrarysOwnStringTable)
{
    EXPECT_EQ(Text((Gui_Msg(20800) << 8 << 2 << 6 << 2 << 5).GetValue()), "Page 8   [col 2 of 6, row 2 of 5]");
    EXPECT_EQ(Text((Gui_Msg(20801) << 8).GetValue()), "C&urrent (Page 8)");
    EXPECT_EQ(Text((Gui_Msg(20802) << 6 << 5).GetValue()), "&All (6col, 5 row)");
    EXPECT_EQ(Text(Gui_Msg(20803).GetValue()), "&Pages");
    EXPECT_EQ(Text((Gui_Msg(20801, LibraryModule()) << 12).GetValue()), "C&urrent (Page 12)");
    EXPECT_TRUE(Gui_Msg(20804, LibraryModule()).GetValue().IsEmpty());
}

TEST(LibraryCursor, ThePanCursorIsAMonochrome32By32CursorWithItsHotSpotInTheMiddle)
{
    HCURSOR cursor = LoadCursorA(LibraryModule(), MAKEINTRESOURCEA(20800));
    ICONINFO info{};
    ASSERT_TRUE(cursor && GetIconInfo(cursor, &info));
    EXPECT_TRUE(!info.fIcon && info.xHotspot == 16u && info.yHotspot == 16u);
    EXPECT_EQ(info.hbmColor, nullptr) << "monochrome";
    ASSERT_NE(info.hbmMask, nullptr);
    BITMAP mask{};
    GetObjectA(info.hbmMask, sizeof mask, &mask);
    DeleteObject(info.hbmMask);
    EXPECT_TRUE(mask.bmWidth == 32 && mask.bmHeight == 64) << "32 x 32: the AND mask above the XOR mask";
}

} // namespace
