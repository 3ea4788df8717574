// The soak itself: a seed replays exactly, a failing check names the seed
// and the step, and the census sees each kind of thing a process can leak.
#include "resource_census.h"
#include "soak_run.h"
#include "soak_test_support.h"

#include <gtest/gtest.h>

#include <cstdlib>

using ScrollTest::PumpPending;

namespace {

TEST(Soak, SameSeedReplaysTheSameStepsAndAnotherSeedOthers)
{
    Soak::Options options;
    options.seed = 7;
    options.steps = 120;
    const Soak::Result first = Soak::Run(options);
    const Soak::Result again = Soak::Run(options);
    ASSERT_EQ(first.failedStep, -1) << Soak::Describe(first);
    EXPECT_EQ(again.digest, first.digest);
    EXPECT_EQ(again.actions, first.actions);
    EXPECT_TRUE(again.IsClean()) << Soak::Describe(again);

    options.seed = 8;
    const Soak::Result other = Soak::Run(options);
    EXPECT_NE(other.digest, first.digest);
}

TEST(Soak, FailingCheckStopsTheRunAndNamesTheSeedAndTheStep)
{
    Soak::Options options;
    options.seed = 7;
    options.steps = 100;
    options.extraCheck = [](long long step) { return step == 37 ? std::string("planted fault") : std::string(); };
    const Soak::Result result = Soak::Run(options);
    EXPECT_EQ(result.failedStep, 37);
    EXPECT_EQ(result.stepsRun, 37);
    EXPECT_FALSE(result.IsClean());
    const std::string report = Soak::Describe(result);
    EXPECT_EQ(report.rfind("seed 7, step 37 (" + result.failedAction + "): planted fault", 0), 0u) << report;
}

// Each kind of thing the census counts shows when one is left behind.
TEST(Soak, CensusCountsWhatIsLeftBehind)
{
    ResourceLedger ledger;
    ASSERT_TRUE(ledger.IsActive());
    const auto settled = [&ledger] {
        PumpPending();
        AfxLockTempMaps();
        AfxUnlockTempMaps(TRUE);
        return TakeCensus(&ledger);
    };
    {
        // What the library and the system make once per process: the
        // window classes, the data tip's objects, cached device contexts.
        SoakHost first(CRect(50, 50, 350, 250));
        settled();
        const CClientDC dc(&first.Wnd());
    }
    const Census before = settled();
    auto host = std::make_unique<SoakHost>(CRect(50, 50, 350, 250));
    Census with = settled();
    EXPECT_EQ(with.windows, before.windows + SoakHost::WindowCount);
    EXPECT_EQ(with.hooks, before.hooks + 1) << "the data tips' keyboard hook";

    const HBRUSH brush = ::CreateSolidBrush(RGB(1, 2, 3));
    EXPECT_EQ(settled().gdiObjects, with.gdiObjects + 1);
    ::DeleteObject(brush);
    const HWND window = ::CreateWindowExA(0, "STATIC", "", WS_POPUP, 0, 0, 10, 10, nullptr, nullptr, nullptr, nullptr);
    EXPECT_EQ(settled().windows, with.windows + 1);
    ::DestroyWindow(window);
    host->Wnd().SetTimer(77, 1000, nullptr); // through the framework, as the drawing window does
    EXPECT_EQ(settled().timers, with.timers + 1);
    host->Wnd().KillTimer(77);
    {
        const CClientDC dc(&host->Wnd()); // through the framework
        EXPECT_EQ(settled().deviceContexts, with.deviceContexts + 1);
    }
    const long long heap = CountHeapBytes();
    void* volatile block = std::malloc(1000);
    EXPECT_GE(CountHeapBytes(), heap + 1000);
    std::free(block);
    EXPECT_EQ(settled(), with);

    host.reset();
    EXPECT_EQ(settled(), before);
}

} // namespace
