// Soak::Engine: the state of a soak run and its steps. The actions are in
// soak_actions.cpp, the checks in soak_checks.cpp, the run around them in
// soak_run.cpp.
#pragma once

#include "soak_random.h"
#include "soak_run.h"
#include "soak_window.h"

#include "Tavo_GrDrawing.h"

#include <afxwin.h>

#include <memory>
#include <vector>

namespace Soak {

class Engine {
public:
    // At most this many windows live at once.
    static constexpr size_t MaxWindows = 3;
    // The crowd the soak binds: smaller than the hostile tests' million, as
    // it is painted thousands of times.
    static constexpr int SoakCrowd = 5000;

    explicit Engine(const Options& options);
    ~Engine();
    Engine(const Engine&) = delete;
    Engine& operator=(const Engine&) = delete;

    // Runs every action once on every drawing, with a generator of its own,
    // so that what the library, the framework, the printer driver and Wine
    // allocate once per process is there before the census is taken.
    void WarmUp();
    // Picks one action and a window for it and runs it.
    Action Step();
    // Everything a user relies on after a step; empty when it all holds.
    std::string Check();
    // Destroys every window and lets the framework free its temporaries.
    void DestroyAll();

    // The census every later one is compared with.
    const Census& TakeBaseline();
    const ResourceLedger& Ledger() const { return m_ledger; }
    // The GDI objects that live now and did not at the baseline.
    std::string DescribeNewGdiObjects() const { return ::DescribeNewGdiObjects(m_baselineGdiTable); }
    int IdleCensuses() const { return m_idleCensuses; }
    // What the windows destroyed so far did (the warm-up's left out).
    const Events& GetEvents() const { return m_events; }
    // Folds the view of every window after a step into a running digest.
    std::uint64_t Digest(std::uint64_t digest, Action action) const;

private:
    // ---- actions (soak_actions.cpp) ----------------------------------------------------
    void Run(Action action, SoakHost* host);
    Action PickAction();
    void DoCreateWindow();
    void DoDestroyWindow(SoakHost& host);
    void DoBind(SoakHost& host);
    void DoZoomByType(SoakHost& host);
    void DoZoomToLevel(SoakHost& host);
    void DoZoomToRect(SoakHost& host);
    void DoZoomToLimit(SoakHost& host);
    void DoScrollByBar(SoakHost& host);
    void DoScrollByKey(SoakHost& host);
    void DoScrollByDeltas(SoakHost& host);
    void DoCentreAtCursor(SoakHost& host);
    void DoClick(SoakHost& host, bool twice);
    void DoDrag(SoakHost& host, Tavo_WiDrawWnd::DragAction action, bool stealCapture);
    void DoRubberRectangle(SoakHost& host);
    void DoDataTip(SoakHost& host);
    void DoResize(SoakHost& host);
    void DoLiveResize(SoakHost& host);
    void DoMinimise(SoakHost& host);
    void DoHideAndShow(SoakHost& host);
    void DoInvalidate(SoakHost& host);
    void DoPaint(SoakHost& host);
    void DoPrint(SoakHost& host);
    // The pages of a PostScript job; -1 when the file holds none.
    static int CountPostScriptPages(const std::string& path);

    // ---- input and time ------------------------------------------------------------------
    // A mouse event at a screen point, dt milliseconds after the last one.
    void Mouse(DWORD flags, POINT screen, DWORD dt);
    void Key(WORD key, DWORD dt);
    // Dispatches what is pending and frees the framework's temporaries, as
    // an application's idle time does.
    void Pump();
    void PumpInput();
    void PaintAll();
    // Delivers the one-shot ticks that have fallen due (the scrollee's hold
    // timer, the autoscroll timer), as the system would; the run drops the
    // real ones to stay independent of the clock.
    void DeliverDueTicks(SoakHost& host);
    // A screen point in the scrollee's client area; false when it has none.
    bool PointIn(SoakHost& host, POINT& screen);
    // The window activated, then a point in it as PointIn gives one.
    bool ActivateAndPointIn(SoakHost& host, POINT& screen);
    POINT PointOnScreen();
    CRect HostRect();
    Tavo_GrWRect WorldRect(SoakHost& host);
    Tavo_GrDrawing* PickDrawing();
    // The drawing's place in m_drawings (0 the sample, then the hostile
    // kinds in order), -1 for none.
    int DrawingIndex(const Tavo_GrDrawing* drawing) const;
    void Trace(const char* format, ...);
    // Adds what a window did to the run's events and destroys it.
    void Retire(std::vector<std::unique_ptr<SoakHost>>::iterator host);

    // ---- checks (soak_checks.cpp) -----------------------------------------------------------
    std::string CheckWindow(SoakHost& host);
    std::string CheckInteractionEnded();
    std::string CheckCensus();

    const Options& m_options;
    SoakRandom m_random;
    CWinApp m_app{"soak"}; // its printer defaults are the printer's
    ResourceLedger m_ledger;
    std::vector<std::unique_ptr<Tavo_GrDrawing>> m_drawings;
    std::vector<std::unique_ptr<SoakHost>> m_hosts; // capacity MaxWindows, reserved
    std::string m_printPath;
    DWORD m_time = 0; // the message time of the last input
    Census m_baseline;
    std::vector<unsigned char> m_baselineGdiTable; // what lived in each entry at the baseline
    int m_idleCensuses = 0;
    bool m_warmingUp = false;
    Events m_events;
    std::string m_stepFault; // what an action saw go wrong, for the step's check
};

} // namespace Soak
