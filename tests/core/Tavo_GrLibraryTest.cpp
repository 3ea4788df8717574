// The graphics core's library object: palette ownership, initialisation
// count, trace sink.
#include "Tavo_GrLibrary.h"
#include "Tavo_GrPalette.h"

#include <gtest/gtest.h>

#include <vector>

namespace {

// A palette that reports its destruction.
struct WatchedPalette : Tavo_GrPalette {
    explicit WatchedPalette(bool* destroyed) : m_destroyed(destroyed) {}
    ~WatchedPalette() override { *m_destroyed = true; }
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

TEST_F(LibraryTest, TheCoreOwnsThePaletteUntilTheLastOrAForcedTerminate)
{
    bool firstGone = false;
    bool secondGone = false;
    auto* first = new WatchedPalette(&firstGone);
    Tavo_GrLibrary::SetPalette(first);
    Tavo_GrLibrary::SetPalette(first);
    EXPECT_FALSE(firstGone) << "installing the same palette again keeps it";
    Tavo_GrLibrary::SetPalette(new WatchedPalette(&secondGone));
    EXPECT_TRUE(firstGone) << "the one replaced is deleted";
    Tavo_GrLibrary::Terminate(false);
    EXPECT_FALSE(secondGone) << "no Initialize to end";
    Tavo_GrLibrary::Initialize();
    Tavo_GrLibrary::Initialize();
    Tavo_GrLibrary::Terminate(false);
    EXPECT_TRUE(!secondGone && Tavo_GrLibrary::GetInitializeCount() == 1);
    Tavo_GrLibrary::Terminate(false);
    EXPECT_TRUE(secondGone && Tavo_GrLibrary::GetPalette() == nullptr);

    bool thirdGone = false;
    Tavo_GrLibrary::Initialize();
    Tavo_GrLibrary::SetPalette(new WatchedPalette(&thirdGone));
    Tavo_GrLibrary::Initialize();
    Tavo_GrLibrary::Terminate(true);
    EXPECT_TRUE(thirdGone && Tavo_GrLibrary::GetInitializeCount() == 0);
}

TEST_F(LibraryTest, TraceHandsTheMessageToTheSinkUnchangedAndIgnoresNull)
{
    std::vector<const char*> seen;
    Tavo_GrLibrary::SetTraceSink([](const char* text, void* s) { static_cast<std::vector<const char*>*>(s)->push_back(text); }, &seen);
    const char message[] = "100% %s %d \xE9\x01";
    Tavo_GrLibrary::Trace(message);
    Tavo_GrLibrary::Trace(nullptr);
    EXPECT_EQ(seen, std::vector<const char*>{message}) << "the caller's very bytes, once";
}

} // namespace
