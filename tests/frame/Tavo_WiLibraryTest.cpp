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

// What the entry point's work can change, to compare before and after a call.
struct AttachSnapshot {
    AFX_EXTENSION_MODULE record;
    const CDynLinkLibrary* link;
    std::vector<HINSTANCE> resourceModules;
    std::vector<int> serviceUsers;

    static AttachSnapshot Take()
    {
        AttachSnapshot s{Tavo_WiGetExtensionModule(), Tavo_WiGetLibraryLink(), {}, {}};
        for (int i = 0; i < Gui_Locale::GetResourceModuleCount(); ++i)
            s.resourceModules.push_back(Gui_Locale::GetResourceModule(i));
        for (Port_Service service : {Port_Service::File, Port_Service::PathList, Port_Service::InstanceTable,
                                     Port_Service::Factory, Port_Service::MsgMan})
            s.serviceUsers.push_back(Port_GetServiceUsers(service));
        return s;
    }

    auto Fields() const
    {
        return std::tie(record.bInitialized, record.hModule, record.hResource, link, resourceModules, serviceUsers);
    }
};

// ---- Loading -------------------------------------------------------------------------

TEST(LibraryLoad, TheFirstAttachLinkedTheLibraryIntoTheFrameworkAndTheMessageLookup)
{
    ASSERT_NE(LibraryModule(), nullptr);
    EXPECT_EQ(Tavo_WiGetModuleInstance(), LibraryModule());
    const AttachSnapshot now = AttachSnapshot::Take();
    EXPECT_TRUE(now.record.bInitialized && now.record.hModule == LibraryModule());
    ASSERT_NE(now.link, nullptr);
    EXPECT_TRUE(now.link->m_hModule == LibraryModule() && !now.link->m_bSystem);
    EXPECT_EQ(AfxFindStringResourceHandle(20800), LibraryModule());
    EXPECT_EQ(std::count(now.resourceModules.begin(), now.resourceModules.end(), LibraryModule()), 1);
    for (int users : now.serviceUsers)
        EXPECT_GE(users, 1) << "the portability services are held while the library is loaded";
}

TEST(LibraryEntry, ASecondProcessAttachAndOtherNotificationsChangeNothing)
{
    const struct {
        HINSTANCE instance;
        DWORD reason;
    } calls[] = {
        // Another instance handle: work done again would show in the record or
        // in the registered resource modules.
        {GetModuleHandleA(nullptr), DLL_PROCESS_ATTACH},
        {LibraryModule(), DLL_THREAD_ATTACH},
        {LibraryModule(), DLL_THREAD_DETACH},
        {LibraryModule(), DLL_PROCESS_DETACH},
    };
    for (const auto& call : calls) {
        SCOPED_TRACE(call.reason);
        const AttachSnapshot before = AttachSnapshot::Take();
        EXPECT_EQ(Tavo_WiLibraryEntry(call.instance, call.reason, nullptr), TRUE);
        EXPECT_EQ(AttachSnapshot::Take().Fields(), before.Fields());
    }
}

// ---- The library object ------------------------------------------------------------------

class ForeignPalette : public Tavo_GrPalette {
public:
    ForeignPalette(const char* className, bool* destroyed) : m_className(className), m_destroyed(destroyed) {}
    ~ForeignPalette() override { *m_destroyed = true; }
    const char* GetClassName() const override { return m_className; }

private:
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
    EXPECT_EQ(Tavo_GrLibrary::GetPalette(), installed);
    EXPECT_EQ(installed->GetColorCount(), 16);
    EXPECT_EQ(Tavo_WiLibrary::GetPalette(), installed);

    // Only the exact class name is ours; a differently cased one is not.
    for (const char* name : {"Tavo_GrPalette", "tavo_wipalette", "Tavo_WiPalette2"}) {
        SCOPED_TRACE(name);
        bool destroyed = false;
        auto* foreign = new ForeignPalette(name, &destroyed);
        Tavo_GrLibrary::SetPalette(foreign);
        Tavo_WiPalette* palette = Tavo_WiLibrary::GetPalette();
        ASSERT_NE(palette, nullptr);
        EXPECT_NE(static_cast<Tavo_GrPalette*>(palette), static_cast<Tavo_GrPalette*>(foreign));
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
    EXPECT_EQ(Tavo_GrLibrary::GetInitializeCount(), before + 2);
    Tavo_WiLibrary::Terminate(false);
    EXPECT_EQ(Tavo_GrLibrary::GetInitializeCount(), before + 1);
    Tavo_WiLibrary::GetPalette();
    Tavo_WiLibrary::Terminate(true);
    EXPECT_EQ(Tavo_GrLibrary::GetInitializeCount(), 0);
    EXPECT_EQ(Tavo_GrLibrary::GetPalette(), nullptr) << "forced termination released the palette";
}

TEST_F(LibraryObjectTest, TracePassesTheTextByteForByte)
{
    struct Seen {
        const char* pointer;
        std::string bytes;
    } seen{nullptr, {}};
    Tavo_GrLibrary::SetTraceSink([](const char* text, void* context) { *static_cast<Seen*>(context) = {text, text}; }, &seen);
    const char message[] = "zoom %d%% \x7F\xFF\x80 \t done\n";
    Tavo_WiLibrary::Trace(message);
    EXPECT_EQ(seen.pointer, message);
    EXPECT_EQ(seen.bytes, std::string(message));
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
    HMODULE module = LibraryModule();
    EXPECT_NE(FindResourceA(module, MAKEINTRESOURCEA(20800), MAKEINTRESOURCEA(12) /* RT_GROUP_CURSOR */), nullptr);
    HCURSOR cursor = LoadCursorA(module, MAKEINTRESOURCEA(20800));
    ASSERT_NE(cursor, nullptr);
    ICONINFO info{};
    ASSERT_TRUE(GetIconInfo(cursor, &info));
    EXPECT_FALSE(info.fIcon);
    EXPECT_EQ(info.xHotspot, 16u);
    EXPECT_EQ(info.yHotspot, 16u);
    EXPECT_EQ(info.hbmColor, nullptr) << "monochrome";
    ASSERT_NE(info.hbmMask, nullptr);
    BITMAP mask{};
    GetObjectA(info.hbmMask, sizeof mask, &mask);
    DeleteObject(info.hbmMask);
    EXPECT_EQ(mask.bmWidth, 32);
    EXPECT_EQ(mask.bmHeight, 64) << "32 x 32: the AND mask above the XOR mask";
}

} // namespace
