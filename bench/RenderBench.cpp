// render_bench: how fast the GDI rendering surface draws a large drawing.
//
// One generated drawing of at least a million mixed primitives is drawn into a
// 1920 x 1080 DIB section, several runs of each of:
//   (a) the surface, through the graphics core's Draw;
//   (b) hand-written GDI, one call per primitive (PerPrimitiveRenderer);
//   (c) the batched GDI calls that (a) makes, replayed directly from arrays;
//   (d) a peer surface through the same Draw, one GDI call per primitive with
//       pens and brushes cached per colour (CachedPenSurface).
// The runs are made twice: on a thread without windows, and on a thread that
// owns a (hidden) window, as every drawing window paints; there asking the
// keyboard costs far more. It prints primitives per second for each, the time
// ratios a/c (the surface's cost over the floor), b/a (how much slower the
// naive way is) and a/d (the surface against the cached-pen peer), minimum and
// median over the runs, the key-state queries and the heap allocations of each
// pass of (a).
#include "BatchedCallLog.h"
#include "BenchDrawing.h"
#include "CachedPenSurface.h"
#include "DibCanvas.h"
#include "EscapePollRedirect.h"
#include "HeapCounter.h"
#include "PerPrimitiveRenderer.h"

#include "Tavo_GrDrawing.h"
#include "Tavo_GrMapping.h"
#include "Tavo_WiLibrary.h"
#include "Tavo_WiWin32Surface.h"

#include <algorithm>
#include <cerrno>
#include <cstdio>
#include <cstdlib>
#include <cstring>
#include <cstdint>
#include <vector>

namespace {

const int kDefaultPrimitives = 1000000;
const int kDefaultRuns = 5;
const int kLevelsPerDoubling = 5;

struct Options {
    int primitives = kDefaultPrimitives;
    int runs = kDefaultRuns;
    int only = -1; // one kind of primitive only
};

bool ParseOptions(int argc, char** argv, Options& options)
{
    for (int i = 1; i < argc; ++i) {
        if (std::strcmp(argv[i], "--only") == 0 && i + 1 < argc) {
            options.only = BenchKindOfName(argv[++i]);
            if (options.only < 0)
                return false;
            continue;
        }
        const bool isPrimitives = std::strcmp(argv[i], "--primitives") == 0;
        const bool isRuns = std::strcmp(argv[i], "--runs") == 0;
        if ((!isPrimitives && !isRuns) || i + 1 >= argc)
            return false;
        char* end = nullptr;
        errno = 0;
        const long value = std::strtol(argv[++i], &end, 10);
        if (errno != 0 || *end != '\0' || value < 1 || value > 50000000)
            return false;
        (isPrimitives ? options.primitives : options.runs) = static_cast<int>(value);
    }
    return true;
}

class Stopwatch {
public:
    Stopwatch() { QueryPerformanceCounter(&m_start); }
    double Seconds() const
    {
        LARGE_INTEGER now, frequency;
        QueryPerformanceCounter(&now);
        QueryPerformanceFrequency(&frequency);
        return static_cast<double>(now.QuadPart - m_start.QuadPart) / static_cast<double>(frequency.QuadPart);
    }

private:
    LARGE_INTEGER m_start;
};

template <class Pass>
double TimePass(DibCanvas& canvas, Pass pass)
{
    canvas.Fill(RGB(255, 255, 255));
    Stopwatch watch;
    pass();
    GdiFlush();
    return watch.Seconds();
}

double Median(std::vector<double> values)
{
    std::sort(values.begin(), values.end());
    const size_t n = values.size();
    return n % 2 ? values[n / 2] : (values[n / 2 - 1] + values[n / 2]) / 2.0;
}

double Minimum(const std::vector<double>& values)
{
    return *std::min_element(values.begin(), values.end());
}

// The share of pixels in which two pictures differ, in per cent.
double DifferingPercent(const std::vector<std::uint32_t>& picture, const DibCanvas& canvas)
{
    GdiFlush();
    size_t differing = 0;
    for (size_t i = 0; i < picture.size(); ++i)
        differing += (picture[i] & 0xFFFFFF) != (canvas.GetBits()[i] & 0xFFFFFF);
    return 100.0 * static_cast<double>(differing) / static_cast<double>(picture.size());
}

// Everything a run draws with, built once.
struct Bench {
    const std::vector<BenchPrimitive>& primitives;
    const Tavo_GrDrawing& drawing;
    const Tavo_GrMapping& mapping;
    DibCanvas& canvas;
    Tavo_WiWin32Surface& surface;
    CachedPenSurface& peer;
    const BatchedCallLog& log;
    HeapCounter& heap;
    EscapePollRedirect& keys;
    double items;
};

// Runs the four passes `runs` times, interleaved, and prints what they took.
void RunSeries(const char* title, Bench& bench, int runs)
{
    std::vector<double> timeA, timeB, timeC, timeD, ratioAC, ratioBA, ratioAD, keyQueries;
    std::vector<long long> allocations;
    for (std::vector<double>* values : {&timeA, &timeB, &timeC, &timeD, &ratioAC, &ratioBA, &ratioAD, &keyQueries})
        values->reserve(static_cast<size_t>(runs));
    allocations.reserve(static_cast<size_t>(runs)); // nothing the timed passes count
    const Tavo_GrTransform& transform = bench.mapping.GetTransform();
    const auto surfacePass = [&] {
        const long long heapBefore = bench.heap.GetCount();
        const long long keysBefore = bench.keys.GetKeyQueryCount();
        bench.surface.SetDC(bench.canvas.GetDC());
        bench.drawing.Draw(bench.surface, bench.mapping, nullptr);
        allocations.push_back(bench.heap.GetCount() - heapBefore);
        keyQueries.push_back(static_cast<double>(bench.keys.GetKeyQueryCount() - keysBefore));
    };
    const auto perPrimitivePass = [&] {
        DrawPerPrimitive(bench.canvas.GetDC(), bench.primitives, transform, kBenchHeight);
    };
    const auto replayPass = [&] { bench.log.Replay(bench.canvas.GetDC()); };
    const auto peerPass = [&] {
        bench.peer.SetDC(bench.canvas.GetDC());
        bench.drawing.Draw(bench.peer, bench.mapping, nullptr);
    };

    std::printf("\n%s\n", title);
    std::printf(" run  (a) surface  (b) per-primitive  (c) batched floor  (d) cached pens"
                "    a/c    b/a    a/d  key queries\n");
    for (int run = 0; run < runs; ++run) {
        const double a = TimePass(bench.canvas, surfacePass);
        const double b = TimePass(bench.canvas, perPrimitivePass);
        const double c = TimePass(bench.canvas, replayPass);
        const double d = TimePass(bench.canvas, peerPass);
        timeA.push_back(a);
        timeB.push_back(b);
        timeC.push_back(c);
        timeD.push_back(d);
        ratioAC.push_back(a / c);
        ratioBA.push_back(b / a);
        ratioAD.push_back(a / d);
        std::printf(" %3d  %9.0f/s  %15.0f/s  %15.0f/s  %13.0f/s  %6.3f %6.3f %6.3f  %11.0f\n", run + 1,
                    bench.items / a, bench.items / b, bench.items / c, bench.items / d, a / c, b / a, a / d,
                    keyQueries.back());
    }

    std::printf("primitives per second (median of %d runs):\n", runs);
    std::printf("  (a) surface through Draw                 %12.0f\n", bench.items / Median(timeA));
    std::printf("  (b) per-primitive GDI                    %12.0f\n", bench.items / Median(timeB));
    std::printf("  (c) batched GDI, precomputed             %12.0f\n", bench.items / Median(timeC));
    std::printf("  (d) per-primitive surface, cached pens   %12.0f\n", bench.items / Median(timeD));
    std::printf("time ratio a/c: min %.3f  median %.3f   (surface over the batched floor)\n", Minimum(ratioAC),
                Median(ratioAC));
    std::printf("time ratio b/a: min %.3f  median %.3f   (per-primitive GDI over the surface)\n", Minimum(ratioBA),
                Median(ratioBA));
    std::printf("time ratio a/d: min %.3f  median %.3f   (surface over the cached-pen peer)\n", Minimum(ratioAD),
                Median(ratioAD));
    std::printf("key-state queries in a pass of (a): min %.0f  median %.0f  max %.0f\n", Minimum(keyQueries),
                Median(keyQueries), *std::max_element(keyQueries.begin(), keyQueries.end()));
    if (bench.heap.IsActive()) {
        std::printf("heap allocations in a pass of (a): at most %lld (%d modules watched)\n",
                    *std::max_element(allocations.begin(), allocations.end()), bench.heap.GetModuleCount());
    }
}

// A window that is never shown: once the thread owns it, the thread's
// keyboard queries go the way a drawing window's do.
class HiddenWindow {
public:
    HiddenWindow()
        : m_window(CreateWindowExA(0, "STATIC", "render_bench", WS_OVERLAPPED, 0, 0, 100, 100, nullptr, nullptr,
                                   GetModuleHandleA(nullptr), nullptr))
    {
    }
    ~HiddenWindow()
    {
        if (m_window)
            DestroyWindow(m_window);
    }
    HiddenWindow(const HiddenWindow&) = delete;
    HiddenWindow& operator=(const HiddenWindow&) = delete;

    bool IsValid() const { return m_window != nullptr; }

private:
    HWND m_window;
};

} // namespace

int main(int argc, char** argv)
{
    Options options;
    if (!ParseOptions(argc, argv, options)) {
        std::fprintf(stderr, "usage: render_bench [--primitives N] [--runs R] [--only dot|line|polyline|rect|circle|triangle]\n");
        return 2;
    }
    Tavo_WiLibrary::Initialize();

    std::printf("render_bench: generating %d primitives ...\n", options.primitives);
    const std::vector<BenchPrimitive> primitives = GeneratePrimitives(options.primitives, options.only);
    Tavo_GrDrawing drawing;
    BuildDrawing(primitives, drawing);
    Tavo_GrMapping mapping(&drawing, kLevelsPerDoubling);
    mapping.SetDeviceWindowSize(kBenchWidth, kBenchHeight, true, nullptr);
    const Tavo_GrTransform& transform = mapping.GetTransform();
    std::printf("render_bench: %d items (with the frame) at %d x %d, scale %.3f\n", drawing.GetItemCount(),
                kBenchWidth, kBenchHeight, transform.GetScale());

    DibCanvas canvas(kBenchWidth, kBenchHeight);
    if (!canvas.IsValid()) {
        std::fprintf(stderr, "render_bench: no %d x %d bitmap\n", kBenchWidth, kBenchHeight);
        return 1;
    }
    Tavo_WiWin32Surface surface;
    CachedPenSurface peer;
    const auto surfacePass = [&] {
        surface.SetDC(canvas.GetDC());
        drawing.Draw(surface, mapping, nullptr);
    };

    // Heap allocations of the first pass of (a): building the drawing's index
    // and the palette. Every later pass must allocate nothing.
    HeapCounter heap;
    long long firstPassAllocations = 0;
    TimePass(canvas, [&] {
        const long long before = heap.GetCount();
        surfacePass();
        firstPassAllocations = heap.GetCount() - before;
    });

    BatchedCallLog log;
    if (!log.Record(surfacePass)) {
        std::fprintf(stderr, "render_bench: could not record the surface's GDI calls\n");
        return 1;
    }
    std::printf("render_bench: the surface makes %zu GDI calls per pass\n", log.GetCallCount());
    if (heap.IsActive())
        std::printf("render_bench: the first pass of (a) allocated %lld times\n", firstPassAllocations);
    else
        std::printf("render_bench: heap allocations not counted (no allocation import found)\n");

    // The replay must draw exactly what the surface draws; the per-primitive
    // ways draw the same shapes, a pixel here and there apart.
    TimePass(canvas, surfacePass);
    GdiFlush();
    const std::vector<std::uint32_t> surfacePicture(canvas.GetBits(),
                                                    canvas.GetBits() + static_cast<size_t>(kBenchWidth) * kBenchHeight);
    TimePass(canvas, [&] { log.Replay(canvas.GetDC()); });
    const bool replayMatches = DifferingPercent(surfacePicture, canvas) == 0.0;
    std::printf("render_bench: the replay draws %s picture as the surface\n", replayMatches ? "the same" : "A DIFFERENT");
    TimePass(canvas, [&] { DrawPerPrimitive(canvas.GetDC(), primitives, transform, kBenchHeight); });
    std::printf("render_bench: (b) differs from the surface in %.2f %% of the pixels\n",
                DifferingPercent(surfacePicture, canvas));
    TimePass(canvas, [&] {
        peer.SetDC(canvas.GetDC());
        drawing.Draw(peer, mapping, nullptr);
    });
    std::printf("render_bench: (d) differs from the surface in %.2f %% of the pixels\n",
                DifferingPercent(surfacePicture, canvas));

    EscapePollRedirect keys;
    if (!keys.IsActive()) {
        std::fprintf(stderr, "render_bench: could not watch the surface's key-state queries\n");
        return 1;
    }
    surface.ResetStats();
    Bench bench{primitives, drawing, mapping, canvas, surface, peer, log, heap, keys,
                static_cast<double>(drawing.GetItemCount())};
    RunSeries("on a thread without windows:", bench, options.runs);
    {
        HiddenWindow window;
        if (!window.IsValid()) {
            std::fprintf(stderr, "render_bench: no hidden window\n");
            return 1;
        }
        RunSeries("on a thread that owns a window (hidden), as a drawing window paints:", bench, options.runs);
    }

    Tavo_GrSurfaceStats stats;
    surface.FetchStats(stats);
    std::printf("\nsurface statistics over the timed runs: %u attribute changes, %u dots, %u lines, %u rects, %u circles\n",
                stats.Get(Tavo_GrSurfaceStats::AttrChanges), stats.Get(Tavo_GrSurfaceStats::Dots),
                stats.Get(Tavo_GrSurfaceStats::Lines),
                stats.Get(Tavo_GrSurfaceStats::HollowRects) + stats.Get(Tavo_GrSurfaceStats::FilledRects),
                stats.Get(Tavo_GrSurfaceStats::Circles));
    Tavo_WiLibrary::Terminate(false);
    return 0;
}
