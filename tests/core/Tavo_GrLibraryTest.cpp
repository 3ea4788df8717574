// The graphics core's library object: palette ownership, initialisation
// count, trace sink; and the base palette's fills and name comparison.
#include "Tavo_GrLibrary.h"
#include "Tavo_GrPalette.h"

#include <gtest/gtest.h>

#include <string>

namespace {

// A palette that reports its destruction.
class WatchedPalette : public Tavo_GrPalette {
public:
    explicit WatchedPalette(bool* destroyed) : m_destroyed(destroyed) {}
    ~WatchedPalette() override { *m_destroyed = true; }

private:
    bool* m_destroyed;
};

class LibraryTest : public ::testing::Test {
protected:
    void TearDown() override
    {
        Tavo_GrLibrary::Terminate(true);
        Tavo_GrLibrary::SetTraceSink(nullptr, nullptr);
    }
};

TEST_F(LibraryTest, SetPaletteInstallsAndTheCoreDeletesTheOneItReplaces)
{
    bool firstGone = false;
    bool secondGone = false;
    auto* first = new WatchedPalette(&firstGone);
    Tavo_GrLibrary::SetPalette(first);
    EXPECT_EQ(Tavo_GrLibrary::GetPalette(), first);
    Tavo_GrLibrary::SetPalette(first);
    EXPECT_FALSE(firstGone) << "installing the same palette again keeps it";
    Tavo_GrLibrary::SetPalette(new WatchedPalette(&secondGone));
    EXPECT_TRUE(firstGone);
    EXPECT_FALSE(secondGone);
}

TEST_F(LibraryTest, TerminateReleasesThePaletteAfterTheLastInitialize)
{
    bool gone = false;
    Tavo_GrLibrary::Initialize();
    Tavo_GrLibrary::Initialize();
    Tavo_GrLibrary::SetPalette(new WatchedPalette(&gone));
    Tavo_GrLibrary::Terminate(false);
    EXPECT_FALSE(gone);
    EXPECT_EQ(Tavo_GrLibrary::GetInitializeCount(), 1);
    Tavo_GrLibrary::Terminate(false);
    EXPECT_TRUE(gone);
    EXPECT_EQ(Tavo_GrLibrary::GetPalette(), nullptr);
}

TEST_F(LibraryTest, TerminateWithoutInitializeDoesNothingUnlessForced)
{
    bool gone = false;
    Tavo_GrLibrary::SetPalette(new WatchedPalette(&gone));
    Tavo_GrLibrary::Terminate(false);
    EXPECT_FALSE(gone);
    Tavo_GrLibrary::Terminate(true);
    EXPECT_TRUE(gone);
    EXPECT_EQ(Tavo_GrLibrary::GetInitializeCount(), 0);
}

TEST_F(LibraryTest, TraceHandsTheMessageToTheSinkUnchanged)
{
    struct Seen {
        const char* pointer = nullptr;
        std::string bytes;
        int calls = 0;
    } seen;
    Tavo_GrLibrary::SetTraceSink(
        [](const char* message, void* context) {
            auto* s = static_cast<Seen*>(context);
            s->pointer = message;
            s->bytes = message;
            ++s->calls;
        },
        &seen);
    const char message[] = "100% %s %d \xE9\x01";
    Tavo_GrLibrary::Trace(message);
    EXPECT_EQ(seen.pointer, message);
    EXPECT_EQ(seen.bytes, std::string(message));
    Tavo_GrLibrary::Trace(nullptr);
    EXPECT_EQ(seen.calls, 1);
}

// ---- The base palette --------------------------------------------------------------

TEST(BasePalette, HoldsNoColours)
{
    Tavo_GrPalette palette;
    EXPECT_STREQ(palette.GetClassName(), "Tavo_GrPalette");
    EXPECT_EQ(palette.GetColorCount(), 0);
    EXPECT_EQ(palette.GetColor(0, 9), 9);
    EXPECT_EQ(palette.GetUserNamedColor("red", 9), 9);
    EXPECT_EQ(palette.GetColorUserName(0), nullptr);
}

TEST(BasePalette, KnowsTheFillCodes)
{
    Tavo_GrPalette palette;
    EXPECT_STREQ(palette.GetFillName(0), "hollow");
    EXPECT_STREQ(palette.GetFillName(1), "solid");
    EXPECT_EQ(palette.GetFillName(2), nullptr);
    EXPECT_EQ(palette.GetFill("SOLID", -1), 1);
    EXPECT_EQ(palette.GetFill("Hollow", -1), 0);
    EXPECT_EQ(palette.GetFill("striped", -1), -1);
    EXPECT_EQ(palette.GetFill(nullptr, -1), -1);
}

TEST(BasePalette, ColourNamesCompareWithoutCaseAndWithSeparatorsAlike)
{
    EXPECT_EQ(Tavo_GrPalette::CompareColorNames("dark_gray", "Dark Gray"), 0);
    EXPECT_EQ(Tavo_GrPalette::CompareColorNames("dark-gray", "DARK_GRAY"), 0);
    EXPECT_NE(Tavo_GrPalette::CompareColorNames("darkgray", "dark_gray"), 0);
    EXPECT_NE(Tavo_GrPalette::CompareColorNames("red", "reddish"), 0);
    EXPECT_NE(Tavo_GrPalette::CompareColorNames(nullptr, "red"), 0);
    EXPECT_NE(Tavo_GrPalette::CompareColorNames("red", nullptr), 0);
    EXPECT_NE(Tavo_GrPalette::CompareColorNames(nullptr, nullptr), 0);
}

} // namespace
