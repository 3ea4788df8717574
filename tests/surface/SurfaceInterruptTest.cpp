// Tavo_WiWin32Surface and the Escape key: where the surface polls, when a poll
// asks the keyboard, and how long an interrupt lasts. The key state and the
// clock the surface reads are the test's own (EscapePollRedirect).
#include "SurfaceFixture.h"

#include "EscapePollRedirect.h"

#include "Tavo_GrDrawing.h"
#include "Tavo_GrDrawingBuilder.h"
#include "Tavo_GrMapping.h"

#include <vector>

namespace {

// A surface that notes, for each of its polls, how many GDI calls had been
// made before it: the polls' places among the batches.
class PollNotingSurface : public Tavo_WiWin32Surface {
public:
    explicit PollNotingSurface(const GdiCallRecorder& recorder) : m_recorder(recorder) {}

    bool PollDrawInterrupt() override
    {
        m_pollsAt.push_back(m_recorder.GetCalls().size());
        return Tavo_WiWin32Surface::PollDrawInterrupt();
    }

    std::vector<size_t> m_pollsAt;

private:
    const GdiCallRecorder& m_recorder;
};

} // namespace

class SurfaceInterruptTest : public ::testing::Test {
protected:
    static constexpr int kWidth = 240;
    static constexpr int kHeight = 160;
    static constexpr ULONGLONG kStartTick = 1000000;

    void SetUp() override
    {
        ASSERT_TRUE(m_canvas.IsValid());
        ASSERT_TRUE(m_recorder.IsActive());
        ASSERT_TRUE(m_keyAndClock.IsActive());
        m_keyAndClock.SetEscapeDown(false);
        m_keyAndClock.SetTick(kStartTick);
        m_surface.SetDC(m_canvas.GetDC());
        m_surface.SetDeviceHeight(kHeight);
        m_surface.SetTransform(Tavo_GrTransform(1.0, 0.0, 0.0));
        m_surface.BeginDrawing(nullptr);
        m_recorder.Clear();
    }

    void TearDown() override
    {
        m_surface.Flush();
        m_surface.EndDrawing();
    }

    // Queries made by one poll at the current tick, and the poll's answer.
    struct PollResult {
        long long queries;
        bool interrupted;
    };
    PollResult Poll()
    {
        const long long before = m_keyAndClock.GetKeyQueryCount();
        const bool interrupted = m_surface.PollDrawInterrupt();
        return {m_keyAndClock.GetKeyQueryCount() - before, interrupted};
    }

    DibCanvas m_canvas{kWidth, kHeight};
    GdiCallRecorder m_recorder;
    EscapePollRedirect m_keyAndClock;
    PollNotingSurface m_surface{m_recorder};
};

TEST_F(SurfaceInterruptTest, EveryFlushPollsNineTimesEachBeforeItsBatchWhateverTheKey)
{
    // Empty batches: five PolyPolylines, nothing for the filled triangles and
    // rectangles, the null brush in and out around the (no) hollow circles.
    // Calls:   0 dots, 1 lines, 2 uniangles, 3 hollow triangles, 4 hollow
    // rectangles, 5 and 6 the null brush in and out.
    const std::vector<size_t> pollsBeforeEachBatch = {0, 1, 2, 3, 4, 4, 5, 5, 7};
    for (const bool escapeDown : {false, true}) {
        SCOPED_TRACE(escapeDown ? "Escape down" : "Escape up");
        m_keyAndClock.SetEscapeDown(escapeDown);
        m_keyAndClock.AdvanceTick(1);
        m_recorder.Clear();
        m_surface.m_pollsAt.clear();

        m_surface.Flush();

        EXPECT_EQ(pollsBeforeEachBatch, m_surface.m_pollsAt);
        EXPECT_EQ(7u, m_recorder.GetCalls().size()) << "an interrupt does not hold batches back";
        EXPECT_EQ(escapeDown, m_surface.IsDrawingInterrupted());
    }
}

TEST_F(SurfaceInterruptTest, PollsWithinOneClockTickAskTheKeyOnce)
{
    m_surface.Flush();
    m_surface.Flush();
    m_surface.Flush();
    EXPECT_EQ(27u, m_surface.m_pollsAt.size());
    EXPECT_EQ(1, m_keyAndClock.GetKeyQueryCount()) << "the first poll of the pass";

    m_keyAndClock.AdvanceTick(1);
    m_surface.Flush();
    EXPECT_EQ(2, m_keyAndClock.GetKeyQueryCount()) << "the first poll of the next tick";
}

TEST_F(SurfaceInterruptTest, EscapePressedDuringAPassIsSeenAtTheNextClockTick)
{
    EXPECT_EQ(1, Poll().queries);

    m_keyAndClock.SetEscapeDown(true);
    const PollResult sameTick = Poll();
    EXPECT_EQ(0, sameTick.queries);
    EXPECT_FALSE(sameTick.interrupted) << "answered from the flag until the clock moves";

    m_keyAndClock.AdvanceTick(1);
    const PollResult nextTick = Poll();
    EXPECT_EQ(1, nextTick.queries);
    EXPECT_TRUE(nextTick.interrupted);
    EXPECT_TRUE(m_surface.IsDrawingInterrupted());
}

TEST_F(SurfaceInterruptTest, AnInterruptLastsUntilTheFlagIsResetWhateverTheKeyDoes)
{
    m_keyAndClock.SetEscapeDown(true);
    ASSERT_TRUE(Poll().interrupted);

    m_keyAndClock.SetEscapeDown(false);
    for (int tick = 0; tick < 3; ++tick) {
        m_keyAndClock.AdvanceTick(1);
        const PollResult later = Poll();
        EXPECT_TRUE(later.interrupted) << "tick " << tick;
        EXPECT_EQ(0, later.queries) << "an interrupted pass needs no key";
    }

    m_surface.ResetDrawingInterruptFlags();
    m_keyAndClock.AdvanceTick(1);
    EXPECT_FALSE(Poll().interrupted);
    EXPECT_FALSE(m_surface.IsDrawingInterrupted());
}

TEST_F(SurfaceInterruptTest, EscapeHeldAtTheStartOfAPassStopsItAtItsFirstPoll)
{
    // One colour throughout: after the first pass no attribute change flushes,
    // so the first poll of the next pass is the core's, after kPollInterval items.
    const int dots = 4 * Tavo_GrSurface::kPollInterval;
    Tavo_GrDrawing drawing;
    Tavo_GrDrawingBuilder build(drawing);
    build.SetAttr(Outline(kRed));
    build.AddRect(0, 0, kWidth, kHeight);
    for (int i = 0; i < dots; ++i)
        build.AddDot(1 + i % (kWidth - 2), 1 + i / (kWidth - 2));
    Tavo_GrMapping mapping(&drawing, 5);
    mapping.SetDeviceWindowSize(kWidth, kHeight, true, nullptr);
    const auto itemsDrawn = [&] {
        Tavo_GrSurfaceStats stats;
        m_surface.FetchStats(stats);
        return stats.Get(Tavo_GrSurfaceStats::Dots) + stats.Get(Tavo_GrSurfaceStats::HollowRects);
    };

    // The clock stands still: the pass with Escape held asks in the same tick
    // as the last query of the pass before it.
    m_surface.EndDrawing();
    m_surface.SetDC(m_canvas.GetDC());
    drawing.Draw(m_surface, mapping, nullptr);
    ASSERT_EQ(static_cast<unsigned int>(dots + 1), itemsDrawn());
    ASSERT_FALSE(m_surface.IsDrawingInterrupted());

    m_keyAndClock.SetEscapeDown(true);
    m_keyAndClock.ResetKeyQueryCount();
    m_surface.ResetStats();
    m_surface.SetDC(m_canvas.GetDC());
    drawing.Draw(m_surface, mapping, nullptr);

    EXPECT_TRUE(m_surface.IsDrawingInterrupted());
    EXPECT_EQ(static_cast<unsigned int>(Tavo_GrSurface::kPollInterval), itemsDrawn());
    EXPECT_EQ(1, m_keyAndClock.GetKeyQueryCount());
}
