// The soak: real drawing windows on the virtual display driven by a seeded
// generator through long runs of mixed use, with what a user relies on
// checked after every step and what the process holds counted at the start
// and the end.
//
// Each step is one action on one window (or the creation or destruction of
// one): binding, zooming by every form, undo, scrolling by bars and keys,
// clicks, pan drags with autoscroll, rubber rectangles, drag and drop, a
// capture taken away in the middle of a drag, data tips, resizes (live, to
// zero size, minimised, hidden), invalidations, paints, and printing pages to
// a PostScript file. The same seed replays the same steps exactly: every
// choice comes from the generator, input carries explicit message times, and
// timers are delivered by the run, never by the clock.
//
// A run stops at the first violation and names the seed, the step and the
// action, so `soak --seed S --steps N --trace` shows the way to it again.
#pragma once

#include "resource_census.h"

#include <array>
#include <cstdint>
#include <functional>
#include <string>

namespace Soak {

enum Action {
    CreateWindow,
    DestroyWindow,
    Bind,
    Unbind,
    ZoomByType,
    ZoomToLevel,
    ZoomToRect,
    ZoomToLimit,
    Undo,
    ScrollByBar,
    ScrollByKey,
    ScrollByDeltas,
    CentreAtCursor,
    Click,
    DoubleClick,
    PanDrag,
    RubberRectangle,
    DragAndDrop,
    CaptureStolen,
    DataTip,
    Resize,
    LiveResize,
    Minimise,
    HideAndShow,
    Invalidate,
    Paint,
    Print,
    ActionCount
};
const char* NameOf(Action action);

struct Options {
    std::uint64_t seed = 1;
    long long steps = 1000;
    bool trace = false; // print every step as it runs
    // Where print jobs go (a Windows path; Z:\ reaches the Unix side);
    // empty: a file in the temporary folder.
    std::string printPath;
    // Asked after each step's own checks; a non-empty answer is a violation.
    std::function<std::string(long long step)> extraCheck;
};

// What the windows told the application and what they did, over a run.
struct Events {
    long long paints = 0;
    long long clicks = 0;
    long long doubleClicks = 0;
    long long rubberRectangles = 0;
    long long dragAndDrops = 0;
    long long dataTipsShown = 0;
    long long pagesPrinted = 0;
};

struct Result {
    std::uint64_t seed = 0;
    long long stepsRun = 0;
    long long failedStep = -1; // the step whose checks failed; -1: none did
    std::string failedAction;
    std::string violation;
    Census before;            // after the warm-up, before the first step
    Census after;             // after the last step, every window destroyed
    double seconds = 0.0;     // the steps alone
    std::uint64_t digest = 0; // of the view after every step
    std::array<long long, ActionCount> actions = {};
    Events events;
    int idleCensuses = 0;      // times no window was left and the census was compared
    std::string newGdiObjects; // at the end, when more live than at the start

    bool IsClean() const { return failedStep < 0 && before == after; }
};

Result Run(const Options& options);

// "seed S, step N (action): violation" or a line of figures for a clean run.
std::string Describe(const Result& result);

} // namespace Soak
