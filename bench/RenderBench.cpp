// render_bench: how fast the GDI rendering surface draws a large drawing.
//
// One generated drawing of at least a million mixed primitives is drawn into a
// 1920 x 1080 DIB section, several runs of each of:
//   (a) the surface, through the graphics core's Draw;
//   (b) hand-written GDI, one call per primitive (PerPrimitiveRenderer);
//   (c) the batched GDI calls that (a) makes, replayed directly from arrays.
// It prints primitives per second for each, the time ratios a/c (the surface's
// cost over the floor) and b/a (how much slower the naive way is), minimum and
// median over the runs, and the heap allocations of each pass of (a).
#include "BatchedCallLog.h"
#include "BenchDrawing.h"
#include "DibCanvas.h"
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
};

bool ParseOptions(int argc, char** argv, Options& options)
{
    for (int i = 1; i < argc; ++i) {
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

// FNV-1a over the pixels: equal pictures give equal sums.
std::uint64_t PictureSum(const DibCanvas& canvas)
{
    GdiFlush();
    std::uint64_t sum = 1469598103934665603ull;
    const size_t total = static_cast<size_t>(canvas.GetWidth()) * canvas.GetHeight();
    for (size_t i = 0; i < total; ++i)
        sum = (sum ^ (canvas.GetBits()[i] & 0xFFFFFF)) * 1099511628211ull;
    return sum;
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

} // namespace

int main(int argc, char** argv)
{
    Options options;
    if (!ParseOptions(argc, argv, options)) {
        std::fprintf(stderr, "usage: render_bench [--primitives N] [--runs R]\n");
        return 2;
    }
    Tavo_WiLibrary::Initialize();

    std::printf("render_bench: generating %d primitives ...\n", options.primitives);
    const std::vector<BenchPrimitive> primitives = GeneratePrimitives(options.primitives);
    Tavo_GrDrawing drawing;
    BuildDrawing(primitives, drawing);
    Tavo_GrMapping mapping(&drawing, kLevelsPerDoubling);
    mapping.SetDeviceWindowSize(kBenchWidth, kBenchHeight, true, nullptr);
    const Tavo_GrTransform& transform = mapping.GetTransform();
    const double items = drawing.GetItemCount();
    std::printf("render_bench: %d items (with the frame) at %d x %d, scale %.3f\n", drawing.GetItemCount(),
                kBenchWidth, kBenchHeight, transform.GetScale());

    DibCanvas canvas(kBenchWidth, kBenchHeight);
    if (!canvas.IsValid()) {
        std::fprintf(stderr, "render_bench: no %d x %d bitmap\n", kBenchWidth, kBenchHeight);
        return 1;
    }
    Tavo_WiWin32Surface surface;
    const auto surfacePass = [&] {
        surface.SetDC(canvas.GetDC());
        drawing.Draw(surface, mapping, nullptr);
    };

    // Heap allocations of every pass of (a), the first included.
    HeapCounter heap;
    std::vector<long long> allocations;
    const auto countedSurfacePass = [&] {
        const long long before = heap.GetCount();
        surfacePass();
        allocations.push_back(heap.GetCount() - before);
    };
    TimePass(canvas, countedSurfacePass);

    BatchedCallLog log;
    if (!log.Record(surfacePass)) {
        std::fprintf(stderr, "render_bench: could not record the surface's GDI calls\n");
        return 1;
    }
    surface.ResetStats();
    std::printf("render_bench: the surface makes %zu GDI calls per pass\n", log.GetCallCount());

    // The replay must draw exactly what the surface draws.
    TimePass(canvas, surfacePass);
    const std::uint64_t surfacePicture = PictureSum(canvas);
    TimePass(canvas, [&] { log.Replay(canvas.GetDC()); });
    const bool replayMatches = PictureSum(canvas) == surfacePicture;
    std::printf("render_bench: the replay draws %s picture as the surface\n", replayMatches ? "the same" : "A DIFFERENT");

    std::vector<double> timeA, timeB, timeC, ratioAC, ratioBA;
    std::printf("\n run   (a) surface    (b) per-primitive  (c) batched floor   a/c    b/a\n");
    for (int run = 0; run < options.runs; ++run) {
        const double a = TimePass(canvas, countedSurfacePass);
        const double b = TimePass(canvas, [&] { DrawPerPrimitive(canvas.GetDC(), primitives, transform, kBenchHeight); });
        const double c = TimePass(canvas, [&] { log.Replay(canvas.GetDC()); });
        timeA.push_back(a);
        timeB.push_back(b);
        timeC.push_back(c);
        ratioAC.push_back(a / c);
        ratioBA.push_back(b / a);
        std::printf(" %3d  %9.0f/s  %12.0f/s  %12.0f/s  %6.3f %6.3f\n", run + 1, items / a, items / b, items / c,
                    a / c, b / a);
    }

    std::printf("\nprimitives per second (median of %d runs):\n", options.runs);
    std::printf("  (a) surface through Draw        %12.0f\n", items / Median(timeA));
    std::printf("  (b) per-primitive GDI           %12.0f\n", items / Median(timeB));
    std::printf("  (c) batched GDI, precomputed    %12.0f\n", items / Median(timeC));
    std::printf("time ratio a/c: min %.3f  median %.3f   (surface over the batched floor)\n", Minimum(ratioAC),
                Median(ratioAC));
    std::printf("time ratio b/a: min %.3f  median %.3f   (per-primitive GDI over the surface)\n", Minimum(ratioBA),
                Median(ratioBA));
    if (heap.IsActive()) {
        long long later = 0;
        for (size_t i = 1; i < allocations.size(); ++i)
            later = std::max(later, allocations[i]);
        std::printf("heap allocations in a pass of (a): first pass %lld, every later pass at most %lld"
                    " (%d modules watched)\n",
                    allocations.front(), later, heap.GetModuleCount());
    } else {
        std::printf("heap allocations: not counted (no allocation import found)\n");
    }
    Tavo_GrSurfaceStats stats;
    surface.FetchStats(stats);
    std::printf("surface statistics over the timed runs: %u attribute changes, %u dots, %u lines, %u rects, %u circles\n",
                stats.Get(Tavo_GrSurfaceStats::AttrChanges), stats.Get(Tavo_GrSurfaceStats::Dots),
                stats.Get(Tavo_GrSurfaceStats::Lines),
                stats.Get(Tavo_GrSurfaceStats::HollowRects) + stats.Get(Tavo_GrSurfaceStats::FilledRects),
                stats.Get(Tavo_GrSurfaceStats::Circles));
    Tavo_WiLibrary::Terminate(false);
    return 0;
}
