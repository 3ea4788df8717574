// paint_bench: what the drawing window's own paint path costs on a large
// drawing, on a real window of the virtual display.
//
// A generated drawing of a million primitives (BenchDrawing) is bound to a
// Tavo_WiDrawWnd of 1280 x 1024 pixels, in a borderless popup that covers the
// display. Every figure goes through the window as an application's user
// drives it: invalidation and WM_PAINT through the scrollee, the scroll
// window's ScrollWindowEx with its strip repaint, a pan drag's step through
// the pointer code and PumpPaintMessages. Each run measures, in turn:
//   full     a full paint at the zero level (the reference);
//   deep     a full paint at the zoom level where about 1 % of the drawing
//            is in view;
//   scroll   a scroll by 10 % of the view (alternately right and left) and
//            the repaint of its strip, one level in (the densest zoomed view);
//   pan      one pan-drag step of 5 % of the view on both axes, one level in;
// and, to show where the time goes, two floors:
//   erase    a full paint with no surface: the scrollee erases, nothing is
//            drawn (what any full-view paint costs before the drawing);
//   move     the scroll alone, its strip left unpainted (the pixels moved).
// It prints the medians of the times and of their ratios to the full paint
// of the same run, what the surface drew (primitives, and the attribute
// changes that made it rebuild its pen and brush), and the heap allocations
// of each action: those of the library's own DLLs during the runs, those of
// the framework's DLL in one more round.
//
// --one-colour draws every primitive outlined in one colour: the same shapes
// without a single attribute change, to tell the cost of attribute changes
// from the cost of the shapes.
#include "BenchDrawing.h"
#include "HeapCallCounter.h"

#include "Tavo_GrDrawing.h"
#include "Tavo_WiDrawWnd.h"
#include "Tavo_WiLibrary.h"
#include "Tavo_WiNativeWindowSurface.h"

#include <algorithm>
#include <cerrno>
#include <cmath>
#include <cstdio>
#include <cstdlib>
#include <cstring>
#include <initializer_list>
#include <memory>
#include <vector>

namespace {

const int kDefaultPrimitives = 1000000;
const int kDefaultRuns = 7;
const int kViewWidth = 1280;
const int kViewHeight = 1024;
const UINT kDrawWndId = 1;
const int kMaxZoomLevel = 50;
const int kSurfaceOption = 3;
// The part of the drawing's area in view at the deep level.
const double kDeepVisibleFraction = 0.01;
const int kScrollPercent = 10;
// A pan step: the pointer moves this percentage of the view on each axis.
const int kPanPercent = 5;
// The palette index of --one-colour (red).
const char kOneColour = 4;

struct Options {
    int primitives = kDefaultPrimitives;
    int runs = kDefaultRuns;
    bool oneColour = false;
};

bool ParseOptions(int argc, char** argv, Options& options)
{
    for (int i = 1; i < argc; ++i) {
        if (std::strcmp(argv[i], "--one-colour") == 0) {
            options.oneColour = true;
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
    return options.runs >= 1;
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

double Median(std::vector<double> values)
{
    std::sort(values.begin(), values.end());
    const size_t n = values.size();
    return n % 2 ? values[n / 2] : (values[n / 2 - 1] + values[n / 2]) / 2.0;
}

// Dispatches what is pending, as an application's message loop would
// between two user actions.
void PumpPending()
{
    MSG msg;
    while (PeekMessageA(&msg, nullptr, 0, 0, PM_REMOVE)) {
        TranslateMessage(&msg);
        DispatchMessageA(&msg);
    }
}

// The drawing window with its own on-screen surface, which it can withhold
// so that a paint only erases.
class BenchDrawWnd : public Tavo_WiDrawWnd {
public:
    bool drawNothing = false;

    // What the surface drew since the last call: primitives, and the
    // attribute changes that rebuilt its pen and brush.
    struct Work {
        unsigned long long primitives = 0;
        unsigned long long attributeChanges = 0;
    };
    Work TakeWork()
    {
        Tavo_GrSurfaceStats stats;
        m_surface.FetchStats(stats);
        m_surface.ResetStats();
        Work work;
        for (int c = Tavo_GrSurfaceStats::Dots; c <= Tavo_GrSurfaceStats::Calls; ++c)
            work.primitives += stats.Get(static_cast<Tavo_GrSurfaceStats::Counter>(c));
        work.attributeChanges = stats.Get(Tavo_GrSurfaceStats::AttrChanges);
        return work;
    }

protected:
    Tavo_WiNativeWindowSurface* GetNativeWindowSurface() override { return drawNothing ? nullptr : &m_surface; }

private:
    Tavo_WiNativeWindowSurface m_surface;
};

// Counts the heap allocations of the named loaded modules while it lives.
class ModuleHeapCounter {
public:
    explicit ModuleHeapCounter(std::initializer_list<const char*> names) : m_counter(Modules(names)) {}
    bool IsCounting() const { return m_counter.IsCounting(); }
    long long GetCount() const { return m_counter.GetCount(); }

private:
    static std::vector<HMODULE> Modules(std::initializer_list<const char*> names)
    {
        std::vector<HMODULE> modules;
        for (const char* name : names)
            if (const HMODULE module = GetModuleHandleA(name))
                modules.push_back(module);
        return modules;
    }

    HeapCallCounter m_counter;
};

// A borderless popup at the display's origin, the drawing window's parent.
class HostWindow {
public:
    HostWindow()
    {
        WNDCLASSA wc = {};
        wc.lpfnWndProc = DefWindowProcA;
        wc.hInstance = GetModuleHandleA(nullptr);
        wc.hbrBackground = static_cast<HBRUSH>(GetStockObject(WHITE_BRUSH));
        wc.lpszClassName = "PaintBenchHost";
        RegisterClassA(&wc);
        m_hwnd = CreateWindowExA(0, wc.lpszClassName, "paint_bench", WS_POPUP | WS_VISIBLE | WS_CLIPCHILDREN, 0, 0,
                                 kViewWidth, kViewHeight, nullptr, nullptr, wc.hInstance, nullptr);
        m_wnd.Attach(m_hwnd);
        SetForegroundWindow(m_hwnd);
        PumpPending();
    }
    ~HostWindow()
    {
        m_wnd.Detach();
        DestroyWindow(m_hwnd);
    }
    HostWindow(const HostWindow&) = delete;
    HostWindow& operator=(const HostWindow&) = delete;

    CWnd* Wnd() { return &m_wnd; }
    bool IsValid() const { return m_hwnd != nullptr; }

private:
    HWND m_hwnd = nullptr;
    CWnd m_wnd;
};

// One measured action: its times, its heap allocations and what it drew.
struct Measure {
    Measure(const char* n, double t) : name(n), target(t) {}
    const char* name;
    double target; // largest ratio to the full paint; 0: none
    std::vector<double> seconds;
    std::vector<double> ratios;         // to the full paint of the same run
    long long systemAllocations = 0;    // most in one action, by the library's DLLs
    long long frameworkAllocations = 0; // most in one action, by the framework's DLL
    BenchDrawWnd::Work work;            // drawn by the last one
};

// The area of the part of a rectangle that lies inside bounds.
double OverlapArea(const Tavo_GrWRect& r, const Tavo_GrWRect& bounds)
{
    const double w = std::min(r.x2, bounds.x2) - static_cast<double>(std::max(r.x1, bounds.x1));
    const double h = std::min(r.y2, bounds.y2) - static_cast<double>(std::max(r.y1, bounds.y1));
    return w > 0 && h > 0 ? w * h : 0.0;
}

double Area(const Tavo_GrWRect& r)
{
    return (static_cast<double>(r.x2) - r.x1) * (static_cast<double>(r.y2) - r.y1);
}

class PaintBench {
public:
    PaintBench(BenchDrawWnd& wnd, Tavo_GrDrawing& drawing)
        : m_wnd(wnd), m_scrollee(wnd.GetScrollee()->GetSafeHwnd()), m_drawing(drawing)
    {
        drawing.FetchBounds(m_bounds);
    }

    // Binds the drawing and paints it once at the zero level: that first
    // pass builds the drawing's index. Chooses the deep level: the one at
    // which kDeepVisibleFraction of the drawing's area is in view.
    void Bind()
    {
        m_wnd.SetDrawingInfo(&m_drawing, kMaxZoomLevel, kSurfaceOption, 0, 0, 0);
        UpdateWindow(m_scrollee);
        PumpPending();
        const double linear = std::sqrt(Area(m_wnd.GetWorldClipBox()) / (kDeepVisibleFraction * Area(m_bounds)));
        m_deepLevel = m_wnd.GetMapping()->GetLevelsPerDoubling() * std::log2(linear);
    }

    // Where the actions' heap allocations are counted from now on.
    void CountAllocations(const ModuleHeapCounter& counter, long long Measure::*into)
    {
        m_heap = &counter;
        m_allocations = into;
    }

    // The views to measure in. The zoom's own repaint is dropped where the
    // measured action repaints the whole view anyway.
    void ShowZeroLevel()
    {
        m_wnd.ZoomWindow(Tavo_GrZoom::ZeroLevel, 1, Tavo_WiZoomCenter::AtViewCentre, 0, 0, true);
        DropPendingPaint();
    }
    // Returns the part of the drawing's area in view.
    double ShowDeepLevel()
    {
        const int x = static_cast<int>((static_cast<long long>(m_bounds.x1) + m_bounds.x2) / 2);
        const int y = static_cast<int>((static_cast<long long>(m_bounds.y1) + m_bounds.y2) / 2);
        m_wnd.ZoomWindow(m_deepLevel, x, y);
        DropPendingPaint();
        return OverlapArea(m_wnd.GetWorldClipBox(), m_bounds) / Area(m_bounds);
    }
    void ShowFirstLevelIn()
    {
        m_wnd.ZoomWindow(Tavo_GrZoom::ZeroLevel, 1, Tavo_WiZoomCenter::AtViewCentre, 0, 0, true);
        m_wnd.ZoomWindow(Tavo_GrZoom::In, 1, Tavo_WiZoomCenter::AtViewCentre, 0, 0, false);
        UpdateWindow(m_scrollee);
        PumpPending();
    }

    double FullPaint(Measure& measure)
    {
        return Timed(measure, [&] {
            InvalidateRect(m_scrollee, nullptr, TRUE);
            UpdateWindow(m_scrollee);
        });
    }

    double Erase(Measure& measure)
    {
        m_wnd.drawNothing = true;
        const double seconds = FullPaint(measure);
        m_wnd.drawNothing = false;
        return seconds;
    }

    // The scroll alone; its strip is painted afterwards, untimed.
    double Move(Measure& measure, bool forward)
    {
        const double seconds = Timed(measure, [&] {
            m_wnd.ScrollWindow(forward ? Tavo_WiScroll::Right : Tavo_WiScroll::Left, Tavo_WiScroll::Percent,
                               kScrollPercent);
        });
        UpdateWindow(m_scrollee);
        return seconds;
    }

    double Scroll(Measure& measure, bool forward)
    {
        return Timed(measure, [&] {
            m_wnd.ScrollWindow(forward ? Tavo_WiScroll::Right : Tavo_WiScroll::Left, Tavo_WiScroll::Percent,
                               kScrollPercent);
            UpdateWindow(m_scrollee);
        });
    }

    // A pan drag from the view's middle by kPanPercent on both axes; only
    // the step itself (two scrolls, each with PumpPaintMessages) is timed.
    double PanStep(Measure& measure, bool forward)
    {
        CRect client;
        GetClientRect(m_scrollee, &client);
        const CPoint start(client.Width() / 2, client.Height() / 2);
        const int sign = forward ? 1 : -1;
        const CPoint step(start.x + sign * client.Width() * kPanPercent / 100,
                          start.y + sign * client.Height() * kPanPercent / 100);
        m_wnd.OnDragStart(MK_LBUTTON, MK_LBUTTON, start);
        const double seconds = Timed(measure, [&] { m_wnd.OnDragMove(MK_LBUTTON, MK_LBUTTON, step); });
        m_wnd.OnDragEnd(MK_LBUTTON, 0, step, 1);
        PumpPending();
        return seconds;
    }

private:
    void DropPendingPaint()
    {
        ValidateRect(m_scrollee, nullptr);
        PumpPending();
    }

    template <class Action>
    double Timed(Measure& measure, Action action)
    {
        PumpPending();
        m_wnd.TakeWork();
        const long long before = m_heap->GetCount();
        Stopwatch watch;
        action();
        GdiFlush();
        const double seconds = watch.Seconds();
        const long long allocations = m_heap->GetCount() - before;
        measure.seconds.push_back(seconds);
        measure.*m_allocations = std::max(measure.*m_allocations, allocations);
        measure.work = m_wnd.TakeWork();
        return seconds;
    }

    BenchDrawWnd& m_wnd;
    HWND m_scrollee;
    Tavo_GrDrawing& m_drawing;
    const ModuleHeapCounter* m_heap = nullptr;
    long long Measure::*m_allocations = &Measure::systemAllocations;
    Tavo_GrWRect m_bounds;
    double m_deepLevel = 0.0;
};

void PrintMeasure(const Measure& m)
{
    const bool reference = m.ratios.empty();
    const double ratio = reference ? 1.0 : Median(m.ratios);
    const char* verdict = m.target <= 0.0 ? "" : (ratio <= m.target ? "met" : "MISSED");
    char target[16] = "";
    if (m.target > 0.0)
        std::snprintf(target, sizeof target, "%.2f", m.target);
    std::printf("  %-7s %10.2f  %7.4f  %6s %-6s  %10llu  %9llu  %7lld  %9lld\n", m.name, Median(m.seconds) * 1000.0,
                ratio, target, verdict, m.work.primitives, m.work.attributeChanges, m.systemAllocations,
                m.frameworkAllocations);
}

// One round of every action; returns the ratios of this round.
struct Round {
    Measure* full;
    Measure* erase;
    Measure* deep;
    Measure* scroll;
    Measure* move;
    Measure* pan;
};

void RunRound(PaintBench& bench, const Round& m, bool forward, bool keepRatios, double& deepFraction)
{
    bench.ShowZeroLevel();
    const double f = bench.FullPaint(*m.full);
    const double e = bench.Erase(*m.erase);
    deepFraction = bench.ShowDeepLevel();
    const double d = bench.FullPaint(*m.deep);
    bench.ShowFirstLevelIn();
    const double s = bench.Scroll(*m.scroll, forward);
    const double v = bench.Move(*m.move, !forward);
    const double p = bench.PanStep(*m.pan, forward);
    if (!keepRatios)
        return;
    m.erase->ratios.push_back(e / f);
    m.deep->ratios.push_back(d / f);
    m.scroll->ratios.push_back(s / f);
    m.move->ratios.push_back(v / f);
    m.pan->ratios.push_back(p / f);
    std::printf(" %3zu  %9.2f  %7.4f  %7.4f  %7.4f  %7.4f  %7.4f\n", m.deep->ratios.size(), f * 1000.0, d / f, s / f, p / f,
                e / f, v / f);
}

} // namespace

int main(int argc, char** argv)
{
    Options options;
    if (!ParseOptions(argc, argv, options)) {
        std::fprintf(stderr, "usage: paint_bench [--primitives N] [--runs R] [--one-colour]\n");
        return 2;
    }
    // Progress shows as it happens, also when the output goes to a file.
    std::setvbuf(stdout, nullptr, _IONBF, 0);
    Tavo_WiLibrary::Initialize();

    std::printf("paint_bench: generating %d primitives%s ...\n", options.primitives,
                options.oneColour ? ", all outlined in one colour" : "");
    std::vector<BenchPrimitive> primitives = GeneratePrimitives(options.primitives);
    if (options.oneColour) {
        for (BenchPrimitive& p : primitives) {
            p.colour = kOneColour;
            p.fill = 0;
        }
    }
    Tavo_GrDrawing drawing;
    BuildDrawing(primitives, drawing);
    primitives = {};

    HostWindow host;
    BenchDrawWnd wnd;
    if (!host.IsValid() || !wnd.Create(WS_CHILD | WS_VISIBLE, CRect(0, 0, kViewWidth, kViewHeight), host.Wnd(), kDrawWndId)) {
        std::fprintf(stderr, "paint_bench: no %d x %d drawing window\n", kViewWidth, kViewHeight);
        return 1;
    }
    PumpPending();

    // The library's own DLLs; the framework's is counted in a round of its
    // own (one counter at a time).
    auto systemHeap = std::make_unique<ModuleHeapCounter>(std::initializer_list<const char*>{"libTavo_Windows.dll", "libTavo_Core.dll"});
    PaintBench bench(wnd, drawing);
    // The first paint builds the drawing's index and makes room for every
    // later pass; it is not measured.
    const long long beforeFirst = systemHeap->GetCount();
    bench.Bind();
    const long long firstAllocations = systemHeap->GetCount() - beforeFirst;

    CRect client;
    GetClientRect(wnd.GetScrollee()->GetSafeHwnd(), &client);
    std::printf("paint_bench: %d items in a %d x %d drawing window (scrollee %d x %d at the zero level), %d runs\n",
                drawing.GetItemCount(), kViewWidth, kViewHeight, client.Width(), client.Height(), options.runs);

    Measure full("full", 0.0), erase("erase", 0.0), deep("deep", 0.02), scroll("scroll", 0.12), move("move", 0.0),
        pan("pan", 0.15);
    const Round round{&full, &erase, &deep, &scroll, &move, &pan};
    double deepFraction = 0.0;
    std::printf("\n run    full ms     deep   scroll      pan    erase     move   (ratios to the full paint of the run)\n");
    bench.CountAllocations(*systemHeap, &Measure::systemAllocations);
    for (int run = 0; run < options.runs; ++run)
        RunRound(bench, round, run % 2 == 0, true, deepFraction);
    const bool systemCounted = systemHeap->IsCounting();
    systemHeap.reset();

    // The framework's round, in measures of its own so that its times stay
    // out of the medians.
    std::vector<Measure> extra(6, Measure("", 0.0));
    const Round frameworkRound{&extra[0], &extra[1], &extra[2], &extra[3], &extra[4], &extra[5]};
    const ModuleHeapCounter frameworkHeap({"afx.dll"});
    bench.CountAllocations(frameworkHeap, &Measure::frameworkAllocations);
    RunRound(bench, frameworkRound, true, false, deepFraction);
    Measure* const measures[] = {&full, &erase, &deep, &scroll, &move, &pan};
    for (size_t i = 0; i < extra.size(); ++i)
        measures[i]->frameworkAllocations = extra[i].frameworkAllocations;

    std::printf("\nmedians of %d runs (deep level: %.2f %% of the drawing's area in view; scroll, move and pan one"
                " level in):\n",
                options.runs, deepFraction * 100.0);
    std::printf("                                           drawn by the last one   heap allocations\n");
    std::printf("  action    time ms    ratio  target         primitives  attributes  library  framework\n");
    for (const Measure* m : {&full, &deep, &scroll, &pan, &erase, &move})
        PrintMeasure(*m);
    if (systemCounted && frameworkHeap.IsCounting())
        std::printf("heap allocations of the library's DLLs in the first paint (the drawing's index): %lld\n",
                    firstAllocations);
    else
        std::printf("heap allocations: not counted (no allocation import found)\n");

    wnd.SetDrawingInfo(nullptr, kMaxZoomLevel, kSurfaceOption, 0, 0, 0);
    wnd.DestroyWindow();
    Tavo_WiLibrary::Terminate(false);
    return 0;
}
