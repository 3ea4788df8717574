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

#include <string>
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

    void ExpectEqual(const AttachSnapshot& other) const
    {
        EXPECT_EQ(record.bInitialized, other.record.bInitialized);
        EXPECT_EQ(record.hModule, other.record.hModule);
        EXPECT_EQ(record.hResource, other.record.hResource);
        EXPECT_EQ(link, other.link);
        EXPECT_EQ(resourceModules, other.resourceModules);
        EXPECT_EQ(serviceUsers, other.serviceUsers);
    }
};

// ---- Loading -------------------------------------------------------------------------

TEST(LibraryLoad, TheFirstAttachInitialisedTheExtensionModule)
{
    ASSERT_NE(LibraryModule(), nullptr);
    EXPECT_EQ(Tavo_WiGetModuleInstance(), LibraryModule());
    const AFX_EXTENSION_MODULE& record = Tavo_WiGetExtensionModule();
    EXPECT_TRUE(record.bInitialized);
    EXPECT_EQ(record.hModule, LibraryModule());
}

TEST(LibraryLoad, TheLibraryIsLinkedIntoTheFrameworksChain)
{
    const CDynLinkLibrary* link = Tavo_WiGetLibraryLink();
    ASSERT_NE(link, nullptr);
    EXPECT_EQ(link->m_hModule, LibraryModule());
    EXPECT_FALSE(link->m_bSystem);
    EXPECT_EQ(AfxFindStringResourceHandle(20800), LibraryModule());
}

TEST(LibraryLoad, TheLibrarysStringsAreRegisteredForMessages)
{
    const AttachSnapshot now = AttachSnapshot::Take();
    int found = 0;
    for (HINSTANCE module : now.resourceModules)
        found += module == LibraryModule();
    EXPECT_EQ(found, 1);
}

TEST(LibraryLoad, ThePortabilityServicesAreHeldWhileTheLibraryIsLoaded)
{
    for (int users : AttachSnapshot::Take().serviceUsers)
        EXPECT_GE(users, 1);
}

TEST(LibraryEntry, ASecondProcessAttachChangesNothing)
{
    const AttachSnapshot before = AttachSnapshot::Take();
    // Another instance handle: work done again would show in the record or
    // in the registered resource modules.
    EXPECT_TRUE(Tavo_WiLibraryEntry(GetModuleHandleA(nullptr), DLL_PROCESS_ATTACH, nullptr));
    AttachSnapshot::Take().ExpectEqual(before);
}

TEST(LibraryEntry, DetachAndThreadNotificationsReturnOneAndChangeNothing)
{
    const AttachSnapshot before = AttachSnapshot::Take();
    EXPECT_EQ(Tavo_WiLibraryEntry(LibraryModule(), DLL_THREAD_ATTACH, nullptr), TRUE);
    EXPECT_EQ(Tavo_WiLibraryEntry(LibraryModule(), DLL_THREAD_DETACH, nullptr), TRUE);
    EXPECT_EQ(Tavo_WiLibraryEntry(LibraryModule(), DLL_PROCESS_DETACH, nullptr), TRUE);
    AttachSnapshot::Take().ExpectEqual(before);
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

TEST_F(LibraryObjectTest, GetPaletteInstallsAPaletteAndThenReusesIt)
{
    Tavo_WiPalette* palette = Tavo_WiLibrary::GetPalette();
    ASSERT_NE(palette, nullptr);
    EXPECT_EQ(Tavo_GrLibrary::GetPalette(), palette);
    EXPECT_EQ(palette->GetColorCount(), 16);
    EXPECT_EQ(Tavo_WiLibrary::GetPalette(), palette);
}

TEST_F(LibraryObjectTest, GetPaletteReplacesAPaletteOfAnotherClass)
{
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
    EXPECT_EQ(Tavo_GrLibrary::GetInitializeCount(), before + 1);
    Tavo_WiLibrary::Terminate(false);
    EXPECT_EQ(Tavo_GrLibrary::GetInitializeCount(), before);
    Tavo_WiLibrary::Initialize();
    Tavo_WiLibrary::Initialize();
    Tavo_WiLibrary::GetPalette();
    Tavo_WiLibrary::Terminate(true);
    EXPECT_EQ(Tavo_GrLibrary::GetInitializeCount(), 0);
    EXPECT_EQ(Tavo_GrLibrary::GetPalette(), nullptr) << "forced termination released the palette";
}

TEST_F(LibraryObjectTest, TracePassesTheTextByteForByte)
{
    struct Seen {
        const char* pointer = nullptr;
        std::string bytes;
    } seen;
    Tavo_GrLibrary::SetTraceSink(
        [](const char* message, void* context) {
            static_cast<Seen*>(context)->pointer = message;
            static_cast<Seen*>(context)->bytes = message;
        },
        &seen);
    const char message[] = "zoom %d%% \x7F\xFF\x80 \t done\n";
    Tavo_WiLibrary::Trace(message);
    EXPECT_EQ(seen.pointer, message);
    EXPECT_EQ(seen.bytes, std::string(message));
}

TEST(LibraryObject, AssignmentCopiesNothing)
{
    Tavo_WiLibrary a;
    Tavo_WiLibrary b;
    EXPECT_EQ(&(a = b), &a);
}

// ---- Resources -------------------------------------------------------------------------

TEST(LibraryStrings, TheFourTextsFormatFromTheLibrarysOwnStringTable)
{
    EXPECT_EQ(Text((Gui_Msg(20800) << 8 << 2 << 6 << 2 << 5).GetValue()), "Page 8   [col 2 of 6, row 2 of 5]");
    EXPECT_EQ(Text((Gui_Msg(20801) << 8).GetValue()), "C&urrent (Page 8)");
    EXPECT_EQ(Text((Gui_Msg(20802) << 6 << 5).GetValue()), "&All (6col, 5 row)");
    EXPECT_EQ(Text(Gui_Msg(20803).GetValue()), "&Pages");
}

TEST(LibraryStrings, TheTextsAreThereWhenTheModuleIsNamed)
{
    EXPECT_EQ(Text((Gui_Msg(20801, LibraryModule()) << 12).GetValue()), "C&urrent (Page 12)");
    EXPECT_TRUE(Gui_Msg(20804, LibraryModule()).GetValue().IsEmpty());
}

// Reads the cursor's monochrome mask: AND mask above the XOR mask, 32 x 64.
struct CursorMasks {
    std::vector<unsigned char> bits; // top-down rows of 4 bytes
    bool Bit(int x, int y) const { return (bits[y * 4 + x / 8] >> (7 - x % 8)) & 1; }
    bool And(int x, int y) const { return Bit(x, y); }
    bool Xor(int x, int y) const { return Bit(x, y + 32); }
};

TEST(LibraryCursor, ThePanCursorIsAMonochromeArrowWithItsHotSpotInTheMiddle)
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
    EXPECT_EQ(mask.bmWidth, 32);
    EXPECT_EQ(mask.bmHeight, 64);

    CursorMasks masks;
    masks.bits.resize(64 * 4);
    struct {
        BITMAPINFOHEADER header;
        RGBQUAD colours[2];
    } format{};
    format.header.biSize = sizeof(BITMAPINFOHEADER);
    format.header.biWidth = 32;
    format.header.biHeight = -64; // top-down
    format.header.biPlanes = 1;
    format.header.biBitCount = 1;
    HDC screen = GetDC(nullptr);
    const int rows = GetDIBits(screen, info.hbmMask, 0, 64, masks.bits.data(),
                               reinterpret_cast<BITMAPINFO*>(&format), DIB_RGB_COLORS);
    ReleaseDC(nullptr, screen);
    DeleteObject(info.hbmMask);
    ASSERT_EQ(rows, 64);

    // Black where the arrow is (centre and the four tips), transparent in the corners.
    for (POINT p : {POINT{16, 16}, POINT{16, 2}, POINT{16, 29}, POINT{2, 16}, POINT{29, 16}}) {
        EXPECT_FALSE(masks.And(p.x, p.y)) << p.x << "," << p.y;
        EXPECT_FALSE(masks.Xor(p.x, p.y)) << p.x << "," << p.y;
    }
    for (POINT p : {POINT{0, 0}, POINT{31, 0}, POINT{0, 31}, POINT{31, 31}, POINT{8, 8}}) {
        EXPECT_TRUE(masks.And(p.x, p.y)) << p.x << "," << p.y;
        EXPECT_FALSE(masks.Xor(p.x, p.y)) << p.x << "," << p.y;
    }
    // A white outline next to the shaft.
    EXPECT_FALSE(masks.And(14, 9));
    EXPECT_TRUE(masks.Xor(14, 9));
}

} // namespace
