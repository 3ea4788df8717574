// Soak::Engine: the actions of a step, the input they give with explicit
// message times, and the timers they deliver.
#include "soak_engine.h"

#include "hostile_drawings.h"
#include "scroll_test_support.h"

#include "SampleDrawing.h"
#include "Tavo_WiDataTip.h"
#include "Tavo_WiParkedCursorMonitor.h"
#include "Tavo_WiScrollee.h"

#include <afxext.h>

#include <atomic>
#include <cstdarg>
#include <cstdio>
#include <fstream>
#include <iterator>
#include <limits>
#include <thread>

namespace Soak {

namespace {

// How often each action is picked, in parts of the sum.
constexpr int Weights[ActionCount] = {
    3, 2, 4, 1,       // create, destroy, bind, unbind
    8, 5, 4, 3, 3,    // zoom by type, to a level, to a rectangle, to a limit; undo
    8, 5, 4, 2,       // scroll by bar, by key, by deltas; centre at the cursor
    5, 3, 7, 4, 2, 2, // click, double click, pan drag, rubber rectangle, drag and drop, stolen capture
    4,                // data tip
    4, 3, 2, 2,       // resize, live resize, minimise, hide and show
    5, 4, 1,          // invalidate, paint, print
};

// Device contexts the warm-up takes at once, to grow the system's cache of
// them beyond what the library ever takes at once.
constexpr int DeviceContextCache = 24;
// Points tried for one in a view that the view itself shows.
constexpr int PointAttempts = 8;
// Time between two interactions, far beyond the double-click time.
constexpr DWORD InteractionGap = 2000;
// Time between the events of one interaction.
constexpr DWORD EventGap = 40;
// Past this, a rubber rectangle's loop is ended from another thread (and the
// step fails): a loop that behaves ends long before.
constexpr DWORD RubberRectangleDeadlineMs = 5000;

struct Button {
    UINT flag;
    DWORD down;
    DWORD up;
};
constexpr Button Buttons[] = {
    {MK_LBUTTON, MOUSEEVENTF_LEFTDOWN, MOUSEEVENTF_LEFTUP},
    {MK_RBUTTON, MOUSEEVENTF_RIGHTDOWN, MOUSEEVENTF_RIGHTUP},
    {MK_MBUTTON, MOUSEEVENTF_MIDDLEDOWN, MOUSEEVENTF_MIDDLEUP},
};
constexpr DWORD MoveOnly = 0;

int Saturated(long long value)
{
    return static_cast<int>(std::clamp<long long>(value, INT_MIN, INT_MAX));
}

} // namespace

const char* NameOf(Action action)
{
    static constexpr const char* names[ActionCount] = {
        "create window", "destroy window", "bind", "unbind", "zoom by type", "zoom to level", "zoom to rectangle",
        "zoom to limit", "undo", "scroll by bar", "scroll by key", "scroll by deltas", "centre at cursor", "click",
        "double click", "pan drag", "rubber rectangle", "drag and drop", "capture stolen", "data tip", "resize",
        "live resize", "minimise", "hide and show", "invalidate", "paint", "print"};
    return action >= 0 && action < ActionCount ? names[action] : "?";
}

// ---- construction -----------------------------------------------------------------------

Engine::Engine(const Options& options) : m_options(options), m_random(options.seed)
{
    m_hosts.reserve(MaxWindows);
    auto sample = std::make_unique<Tavo_GrDrawing>();
    BuildSampleDrawing(*sample);
    m_drawings.push_back(std::move(sample));
    for (int kind = 0; kind < Hostile::KindCount; ++kind)
        m_drawings.push_back(Hostile::Build(static_cast<Hostile::Kind>(kind), SoakCrowd));

    m_printPath = options.printPath;
    if (m_printPath.empty()) {
        char folder[MAX_PATH] = {};
        ::GetTempPathA(MAX_PATH, folder);
        m_printPath = std::string(folder) + "tavo_soak.ps";
    }
    m_time = ::GetTickCount();
}

Engine::~Engine()
{
    DestroyAll();
}

void Engine::WarmUp()
{
    // The run's own generator is left untouched, so the warm-up is the same
    // for every seed.
    const SoakRandom runGenerator = m_random;
    m_random = SoakRandom(0x50A4);
    m_warmingUp = true;
    // The system makes its colour brushes at their first use and keeps
    // them for the process.
    for (int colour = 0; colour <= COLOR_MENUBAR; ++colour)
        ::GetSysColorBrush(colour);
    for (size_t drawing = 0; drawing < m_drawings.size(); ++drawing) {
        DoCreateWindow();
        SoakHost& host = *m_hosts.back();
        host.Wnd().SetDrawingInfo(m_drawings[drawing].get(), 50, 3, 0, 0, 0);
        for (int action = ZoomByType; action < ActionCount; ++action)
            Run(static_cast<Action>(action), &host);
        Run(Unbind, &host);
        DestroyAll();
    }
    while (m_hosts.size() < MaxWindows)
        DoCreateWindow();
    // The system keeps the device contexts of its cache, each with its
    // regions, for reuse: the cache grows to the most ever taken at once.
    HDC taken[DeviceContextCache] = {};
    for (HDC& dc : taken)
        dc = ::GetDC(m_hosts.front()->Scrollee());
    for (HDC dc : taken)
        ::ReleaseDC(m_hosts.front()->Scrollee(), dc);
    DestroyAll();
    m_random = runGenerator;
    m_warmingUp = false;
}

// ---- steps ---------------------------------------------------------------------------------

Action Engine::PickAction()
{
    int total = 0;
    for (int weight : Weights)
        total += weight;
    int pick = m_random.Below(total);
    for (int action = 0; action < ActionCount; ++action) {
        if (pick < Weights[action])
            return static_cast<Action>(action);
        pick -= Weights[action];
    }
    return Paint;
}

Action Engine::Step()
{
    Action action = PickAction();
    if (m_hosts.empty())
        action = CreateWindow;
    else if (action == CreateWindow && m_hosts.size() >= MaxWindows)
        action = DestroyWindow;
    const int target = action == CreateWindow ? -1 : m_random.Below(static_cast<int>(m_hosts.size()));
    SoakHost* host = target < 0 ? nullptr : m_hosts[static_cast<size_t>(target)].get();
    Trace("%s", NameOf(action));
    if (host)
        Trace(" on window %d (drawing %d, level %g)", target, DrawingIndex(host->Wnd().GetDrawing()),
              host->Wnd().GetZoomLevel());
    Run(action, host);
    Trace("\n");
    return action;
}

void Engine::Run(Action action, SoakHost* host)
{
    if (action == CreateWindow) {
        DoCreateWindow();
        return;
    }
    if (!host)
        return;
    switch (action) {
    case DestroyWindow: DoDestroyWindow(*host); return;
    case Bind: DoBind(*host); break;
    case Unbind: host->Wnd().SetDrawingInfo(nullptr, 0, 0, 0, 0, 0); break;
    case ZoomByType: DoZoomByType(*host); break;
    case ZoomToLevel: DoZoomToLevel(*host); break;
    case ZoomToRect: DoZoomToRect(*host); break;
    case ZoomToLimit: DoZoomToLimit(*host); break;
    case Undo: host->Wnd().UndoLastScrollZoom(); break;
    case ScrollByBar: DoScrollByBar(*host); break;
    case ScrollByKey: DoScrollByKey(*host); break;
    case ScrollByDeltas: DoScrollByDeltas(*host); break;
    case CentreAtCursor: DoCentreAtCursor(*host); break;
    case Click: DoClick(*host, false); break;
    case DoubleClick: DoClick(*host, true); break;
    case PanDrag: DoDrag(*host, Tavo_WiDrawWnd::Pan, false); break;
    case RubberRectangle: DoRubberRectangle(*host); break;
    case DragAndDrop: DoDrag(*host, Tavo_WiDrawWnd::DragAndDrop, false); break;
    case CaptureStolen: DoDrag(*host, Tavo_WiDrawWnd::Pan, true); break;
    case DataTip: DoDataTip(*host); break;
    case Resize: DoResize(*host); break;
    case LiveResize: DoLiveResize(*host); break;
    case Minimise: DoMinimise(*host); break;
    case HideAndShow: DoHideAndShow(*host); break;
    case Invalidate: DoInvalidate(*host); break;
    case Paint: DoPaint(*host); break;
    case Print: DoPrint(*host); break;
    default: break;
    }
    Pump();
    PaintAll();
}

// ---- windows and drawings ----------------------------------------------------------------

CRect Engine::HostRect()
{
    static constexpr int sizes[] = {0, 1, 2, 17, 40};
    const int width = m_random.Chance(10) ? m_random.Pick(sizes) : m_random.Between(60, 700);
    const int height = m_random.Chance(10) ? m_random.Pick(sizes) : m_random.Between(60, 600);
    const int x = m_random.Between(0, ::GetSystemMetrics(SM_CXSCREEN) - std::max(width, 1));
    const int y = m_random.Between(0, ::GetSystemMetrics(SM_CYSCREEN) - std::max(height, 1));
    return CRect(x, y, x + width, y + height);
}

void Engine::DoCreateWindow()
{
    const CRect rect = HostRect();
    Trace(" at (%d, %d) %d x %d", rect.left, rect.top, rect.Width(), rect.Height());
    m_hosts.push_back(std::make_unique<SoakHost>(rect));
    if (m_random.Chance(60))
        DoBind(*m_hosts.back());
    Pump();
    PaintAll();
}

void Engine::DoDestroyWindow(SoakHost& host)
{
    for (auto it = m_hosts.begin(); it != m_hosts.end(); ++it) {
        if (it->get() == &host) {
            Retire(it);
            break;
        }
    }
    Pump();
}

void Engine::DestroyAll()
{
    while (!m_hosts.empty())
        Retire(m_hosts.end() - 1);
    Pump();
}

void Engine::Retire(std::vector<std::unique_ptr<SoakHost>>::iterator host)
{
    if (!m_warmingUp) {
        const SoakDrawWnd::Counts& counts = (*host)->Wnd().counts;
        m_events.paints += counts.paints;
        m_events.clicks += counts.clicks;
        m_events.doubleClicks += counts.doubleClicks;
        m_events.rubberRectangles += counts.rubberRectangles;
        m_events.dragAndDrops += counts.dragAndDrops;
    }
    m_hosts.erase(host);
}

int Engine::DrawingIndex(const Tavo_GrDrawing* drawing) const
{
    for (size_t i = 0; i < m_drawings.size(); ++i)
        if (m_drawings[i].get() == drawing)
            return static_cast<int>(i);
    return -1;
}

Tavo_GrDrawing* Engine::PickDrawing()
{
    // The sample drawing half of the time, a hostile one otherwise.
    const int index = m_random.Chance(50) ? 0 : m_random.Between(1, static_cast<int>(m_drawings.size()) - 1);
    return m_drawings[static_cast<size_t>(index)].get();
}

void Engine::DoBind(SoakHost& host)
{
    static constexpr int maxLevels[] = {-5, 0, 1, 10, 50, 50, 200, INT_MAX};
    static constexpr int expansions[] = {-10, 0, 0, 10, 100, 10000, INT_MAX};
    static constexpr unsigned int clipSizes[] = {0, 0, 0, 1, 10, 1000, UINT_MAX};
    Tavo_GrDrawing* drawing = PickDrawing();
    const int maxLevel = m_random.Pick(maxLevels);
    const int expansion = m_random.Pick(expansions);
    const unsigned int clipWidth = m_random.Pick(clipSizes);
    const unsigned int clipHeight = m_random.Pick(clipSizes);
    const int option = m_random.Between(-1, 4);
    Trace(" drawing %d, max level %d, expansion %d, clip %u x %u", DrawingIndex(drawing), maxLevel, expansion,
          clipWidth, clipHeight);
    host.Wnd().SetDrawingInfo(drawing, maxLevel, option, expansion, clipWidth, clipHeight);
}

// A world rectangle: inside the bound drawing, tiny, empty, inverted or absurd.
Tavo_GrWRect Engine::WorldRect(SoakHost& host)
{
    Tavo_GrWRect bounds;
    if (host.Wnd().GetDrawing())
        bounds = host.Wnd().GetDrawing()->GetBounds();
    const auto inside = [&](int low, int high) { return low >= high ? low : m_random.Between(low, high); };
    const int x = inside(bounds.x1, bounds.x2);
    const int y = inside(bounds.y1, bounds.y2);
    switch (m_random.Below(6)) {
    case 0: return {x, y, Saturated(x + 1LL), Saturated(y + 1LL)};
    case 1: return {x, y, x, Saturated(y + 100LL)};
    case 2: return {Saturated(x + 500LL), Saturated(y + 500LL), x, y};
    case 3: return {m_random.AbsurdInt(), m_random.AbsurdInt(), m_random.AbsurdInt(), m_random.AbsurdInt()};
    case 4: return {INT_MIN, INT_MIN, INT_MAX, INT_MAX};
    default: return {std::min(x, inside(x, bounds.x2)), std::min(y, inside(y, bounds.y2)), inside(x, bounds.x2),
                     inside(y, bounds.y2)};
    }
}

// ---- zooming and scrolling ------------------------------------------------------------------

void Engine::DoZoomByType(SoakHost& host)
{
    static constexpr Tavo_GrZoom::Type types[] = {Tavo_GrZoom::ZeroLevel, Tavo_GrZoom::Out, Tavo_GrZoom::Keep,
                                                  Tavo_GrZoom::In, Tavo_GrZoom::In, Tavo_GrZoom::ToLevel,
                                                  static_cast<Tavo_GrZoom::Type>(7)};
    static constexpr Tavo_WiZoomCenter::Type centres[] = {Tavo_WiZoomCenter::AtCursor, Tavo_WiZoomCenter::AtViewCentre,
                                                          Tavo_WiZoomCenter::AtPoint,
                                                          static_cast<Tavo_WiZoomCenter::Type>(9)};
    static constexpr int amounts[] = {1, 1, 2, 5, 13, 50};
    const Tavo_GrZoom::Type type = m_random.Pick(types);
    const int amount = m_random.Chance(15) ? m_random.AbsurdInt() : m_random.Pick(amounts);
    const Tavo_WiZoomCenter::Type centre = m_random.Pick(centres);
    const int x = m_random.Chance(20) ? m_random.AbsurdInt() : m_random.Between(-50, 700);
    const int y = m_random.Chance(20) ? m_random.AbsurdInt() : m_random.Between(-50, 600);
    const bool force = m_random.Chance(30);
    const POINT cursor = PointOnScreen();
    ::SetCursorPos(cursor.x, cursor.y);
    Trace(" type %d amount %d centre %d (%d, %d) force %d cursor (%ld, %ld)", type, amount, centre, x, y, force,
          cursor.x, cursor.y);
    host.Wnd().ZoomWindow(type, amount, centre, x, y, force);
}

void Engine::DoZoomToLevel(SoakHost& host)
{
    const double levels[] = {-1.0, 0.0, 0.5, 1.0, 7.3, 25.0, 50.0, 1e9,
                             std::numeric_limits<double>::quiet_NaN(), std::numeric_limits<double>::infinity(),
                             -std::numeric_limits<double>::infinity()};
    const double level = m_random.Chance(50) ? m_random.Between(0, 600) / 10.0 : m_random.Pick(levels);
    const Tavo_GrWRect r = WorldRect(host);
    Trace(" level %g about (%d, %d)", level, r.x1, r.y1);
    host.Wnd().ZoomWindow(level, r.x1, r.y1);
}

void Engine::DoZoomToRect(SoakHost& host)
{
    const Tavo_GrWRect r = WorldRect(host);
    Trace(" (%d, %d, %d, %d)", r.x1, r.y1, r.x2, r.y2);
    host.Wnd().ZoomWindow(r);
}

void Engine::DoZoomToLimit(SoakHost& host)
{
    SoakDrawWnd& wnd = host.Wnd();
    const bool in = m_random.Chance(60);
    const Tavo_WiZoomCenter::Type centre = m_random.Chance(50) ? Tavo_WiZoomCenter::AtPoint : Tavo_WiZoomCenter::AtViewCentre;
    const int x = m_random.Between(0, 600);
    const int y = m_random.Between(0, 500);
    Trace(" %s at %d (%d, %d)", in ? "in" : "out", centre, x, y);
    wnd.ZoomWindow(in ? Tavo_GrZoom::In : Tavo_GrZoom::Out, INT_MAX, centre, x, y, false);
    // At the limit one more step changes nothing, unless forced.
    wnd.ZoomWindow(in ? Tavo_GrZoom::In : Tavo_GrZoom::Out, 1, centre, x, y, m_random.Chance(30));
}

void Engine::DoScrollByBar(SoakHost& host)
{
    const bool horizontal = m_random.Chance(50);
    const UINT message = horizontal ? WM_HSCROLL : WM_VSCROLL;
    const HWND bar = ::GetDlgItem(host.DrawWnd(), horizontal ? Tavo_WiScrollWnd::HorzBarId : Tavo_WiScrollWnd::VertBarId);
    static constexpr UINT codes[] = {SB_LINEUP, SB_LINEDOWN, SB_PAGEUP, SB_PAGEDOWN, SB_THUMBTRACK, SB_TOP,
                                     SB_BOTTOM, Tavo_WiScrollWnd::PercentBack, Tavo_WiScrollWnd::PercentForward};
    const UINT code = m_random.Pick(codes);
    const auto send = [&](UINT c, int n) {
        ::SendMessageA(host.DrawWnd(), message, MAKEWPARAM(c, static_cast<WORD>(n)), reinterpret_cast<LPARAM>(bar));
    };
    Trace(" %s code %u", horizontal ? "horizontal" : "vertical", code);
    if (code == SB_THUMBTRACK) {
        // A thumb drag: tracking positions anywhere on the bar and a little
        // beyond, the release, then the end of the scroll.
        int low = 0;
        int high = 0;
        ::GetScrollRange(bar, SB_CTL, &low, &high);
        int position = low;
        for (int i = m_random.Between(1, 4); i > 0; --i) {
            position = m_random.Between(low - 5, std::max(low, high) + 5);
            send(SB_THUMBTRACK, position);
        }
        send(SB_THUMBPOSITION, position);
    } else {
        send(code, code >= Tavo_WiScrollWnd::PercentBack ? m_random.Between(0, 250) : 0);
    }
    send(SB_ENDSCROLL, 0);
}

void Engine::DoScrollByKey(SoakHost& host)
{
    static constexpr WORD keys[] = {VK_LEFT, VK_RIGHT, VK_UP, VK_DOWN, VK_PRIOR, VK_NEXT, VK_HOME, VK_END};
    host.Activate();
    Pump();
    for (int i = m_random.Between(1, 3); i > 0; --i) {
        const WORD key = m_random.Pick(keys);
        Trace(" key %u", key);
        Key(key, EventGap);
    }
}

void Engine::DoScrollByDeltas(SoakHost& host)
{
    const int dx = m_random.Chance(25) ? m_random.AbsurdInt() : m_random.Between(-300, 300);
    const int dy = m_random.Chance(25) ? m_random.AbsurdInt() : m_random.Between(-300, 300);
    Trace(" (%d, %d)", dx, dy);
    host.Wnd().ScrollWindowByDeviceDeltas(dx, dy);
}

void Engine::DoCentreAtCursor(SoakHost& host)
{
    const POINT cursor = PointOnScreen();
    ::SetCursorPos(cursor.x, cursor.y);
    Trace(" cursor (%ld, %ld)", cursor.x, cursor.y);
    host.Wnd().CenterWindowAtCursor();
}

// ---- the pointer ------------------------------------------------------------------------------

void Engine::DoClick(SoakHost& host, bool twice)
{
    POINT at;
    if (!ActivateAndPointIn(host, at))
        return;
    const Button& button = m_random.Pick(Buttons);
    Trace(" button %u at (%ld, %ld)", button.flag, at.x, at.y);
    Mouse(button.down, at, InteractionGap);
    Mouse(button.up, at, EventGap);
    if (twice) {
        Mouse(button.down, at, EventGap);
        Mouse(button.up, at, EventGap);
    }
    DeliverDueTicks(host);
}

void Engine::DoDrag(SoakHost& host, Tavo_WiDrawWnd::DragAction action, bool stealCapture)
{
    SoakDrawWnd& wnd = host.Wnd();
    POINT at;
    if (!ActivateAndPointIn(host, at))
        return;
    static constexpr int directions[] = {-7, -1, 0, 1, 5};
    wnd.SetPanDirectionality(m_random.Pick(directions));
    wnd.dragAction = m_random.Chance(5) ? static_cast<Tavo_WiDrawWnd::DragAction>(7) : action;
    const Button& button = m_random.Pick(Buttons);
    Trace(" action %d button %u from (%ld, %ld)", wnd.dragAction, button.flag, at.x, at.y);
    Mouse(button.down, at, InteractionGap);

    // The press has been held long enough: the drag starts.
    if (m_ledger.HasTimer(host.Scrollee(), Tavo_WiScrollee::HoldTimerId)) {
        Trace(" held");
        ::SendMessageA(host.Scrollee(), WM_TIMER, Tavo_WiScrollee::HoldTimerId, 0);
    }
    Pump();

    const int moves = m_random.Between(1, 8);
    const int stealAt = stealCapture ? m_random.Below(moves) : -1;
    SoakHost* thief = m_hosts[m_random.Below(static_cast<int>(m_hosts.size()))].get();
    for (int i = 0; i < moves; ++i) {
        // Mostly near the view, now and then anywhere: across other windows.
        POINT to;
        if (m_random.Chance(30) || !PointIn(host, to))
            to = PointOnScreen();
        Trace(" (%ld, %ld)", to.x, to.y);
        Mouse(MoveOnly, to, EventGap);
        if (i == stealAt) {
            Trace(" stolen by %p", static_cast<void*>(thief->Handle()));
            ::SetCapture(thief->Handle());
            Pump();
        }
        // Autoscroll ticks while the pointer is out of the view.
        for (int tick = m_random.Below(4); tick > 0; --tick) {
            if (!host.IsAlive() || !m_ledger.HasTimer(host.DrawWnd(), Tavo_WiDrawWnd::AutoScrollTimerId))
                break;
            Trace(" tick");
            ::SendMessageA(host.DrawWnd(), WM_TIMER, Tavo_WiDrawWnd::AutoScrollTimerId, 0);
            Pump();
        }
    }
    POINT last = {0, 0};
    ::GetCursorPos(&last);
    Trace(" up at (%ld, %ld)%s", last.x, last.y, m_ledger.HasTimer(host.Scrollee(), Tavo_WiScrollee::HoldTimerId) ? " (hold timer runs)" : "");
    Mouse(button.up, last, EventGap);
    // The window that took the capture gives it back.
    if (::GetCapture() == thief->Handle())
        ::ReleaseCapture();
    DeliverDueTicks(host);
}

void Engine::DoRubberRectangle(SoakHost& host)
{
    SoakDrawWnd& wnd = host.Wnd();
    POINT at;
    if (!ActivateAndPointIn(host, at))
        return;
    const Button& button = m_random.Pick(Buttons);
    wnd.dragAction = Tavo_WiDrawWnd::RubberRectangle;
    Trace(" button %u from (%ld, %ld)", button.flag, at.x, at.y);
    Mouse(button.down, at, InteractionGap);

    // The loop takes what is queued: moves, a paint, other buttons' releases,
    // and at last the release of its own button. They are queued before the
    // press has been held long enough, so the capture the scrollee takes then
    // is taken now, or input beyond the window would go to the windows under it.
    ::SetCapture(host.Scrollee());
    POINT to = at;
    for (int i = m_random.Between(0, 6); i > 0; --i) {
        if (m_random.Chance(30) || !PointIn(host, to))
            to = PointOnScreen();
        m_time += EventGap;
        ScrollTest::SendMouse(MoveOnly, to, m_time);
        if (m_random.Chance(20))
            ::InvalidateRect(host.Scrollee(), nullptr, TRUE);
    }
    m_time += EventGap;
    ScrollTest::SendMouse(button.up, to, m_time);
    if (m_ledger.HasTimer(host.Scrollee(), Tavo_WiScrollee::HoldTimerId)) {
        const int reported = wnd.counts.rubberRectangles;
        const ScrollTest::ButtonReleaseDeadline deadline(RubberRectangleDeadlineMs);
        ::SendMessageA(host.Scrollee(), WM_TIMER, Tavo_WiScrollee::HoldTimerId, 0);
        if (deadline.Passed())
            m_stepFault = "the rubber rectangle's loop had to be ended from outside";
        else if (wnd.GetDrawing() && wnd.counts.rubberRectangles != reported + 1)
            m_stepFault = "the rubber rectangle ended by its button was not reported";
    } else {
        ::ReleaseCapture();
    }
    PumpInput();
    DeliverDueTicks(host);
}

void Engine::DoDataTip(SoakHost& host)
{
    SoakDrawWnd& wnd = host.Wnd();
    POINT at;
    if (!ActivateAndPointIn(host, at))
        return;
    static const char* const texts[] = {"", "tip", "a data tip of a few words"};
    wnd.dataTipText = m_random.Chance(10) ? CString(std::string(2000, 'T').c_str()) : CString(m_random.Pick(texts));
    Trace(" at (%ld, %ld) text of %d", at.x, at.y, wnd.dataTipText.GetLength());
    Mouse(MoveOnly, at, InteractionGap);
    Tavo_WiScrollee* scrollee = wnd.GetScrollee();
    const HWND monitor = scrollee->GetParkedCursorMonitor()->GetSafeHwnd();
    // The pointer has rested long enough.
    if (m_ledger.HasTimer(monitor, Tavo_WiParkedCursorMonitor::ParkTimerId))
        ::SendMessageA(monitor, WM_TIMER, Tavo_WiParkedCursorMonitor::ParkTimerId, 0);
    Pump();
    if (scrollee->GetDataTip()->IsVisible() && !m_warmingUp)
        ++m_events.dataTipsShown;
    const HWND tip = scrollee->GetDataTip()->GetSafeHwnd();
    switch (m_random.Below(3)) {
    case 0:
        // A key hides the tip at its next tick.
        Trace(" key");
        Key(VK_SHIFT, EventGap);
        if (m_ledger.HasTimer(tip, Tavo_WiDataTip::TimerId))
            ::SendMessageA(tip, WM_TIMER, Tavo_WiDataTip::TimerId, 0);
        break;
    case 1: {
        Trace(" move");
        POINT away = PointOnScreen();
        Mouse(MoveOnly, away, EventGap);
        break;
    }
    default:
        // The tip stays up.
        break;
    }
}

// ---- sizes and visibility ------------------------------------------------------------------

void Engine::DoResize(SoakHost& host)
{
    const CRect rect = HostRect();
    Trace(" to (%d, %d) %d x %d", rect.left, rect.top, rect.Width(), rect.Height());
    ::SetWindowPos(host.Handle(), nullptr, rect.left, rect.top, rect.Width(), rect.Height(),
                   SWP_NOZORDER | SWP_NOACTIVATE);
}

void Engine::DoLiveResize(SoakHost& host)
{
    ::SendMessageA(host.Handle(), WM_ENTERSIZEMOVE, 0, 0);
    for (int i = m_random.Between(1, 5); i > 0; --i) {
        DoResize(host);
        if (m_random.Chance(50))
            PaintAll();
    }
    ::SendMessageA(host.Handle(), WM_EXITSIZEMOVE, 0, 0);
}

void Engine::DoMinimise(SoakHost& host)
{
    ::ShowWindow(host.Handle(), SW_MINIMIZE);
    Pump();
    // Work on the window while it is minimised.
    if (m_random.Chance(50))
        DoZoomByType(host);
    if (m_random.Chance(50))
        DoInvalidate(host);
    if (m_random.Chance(30))
        DoScrollByBar(host);
    ::ShowWindow(host.Handle(), SW_RESTORE);
    host.Activate();
}

void Engine::DoHideAndShow(SoakHost& host)
{
    if (!host.IsAlive())
        return;
    ::ShowWindow(host.DrawWnd(), SW_HIDE);
    Pump();
    // Its frame changes size while it is hidden.
    if (m_random.Chance(60))
        DoResize(host);
    if (m_random.Chance(40))
        DoZoomByType(host);
    ::ShowWindow(host.DrawWnd(), SW_SHOW);
}

void Engine::DoInvalidate(SoakHost& host)
{
    const Tavo_GrWRect r = m_random.Chance(10) ? Tavo_GrWRect() : WorldRect(host);
    const bool erase = m_random.Chance(50);
    Trace(" (%d, %d, %d, %d) erase %d", r.x1, r.y1, r.x2, r.y2, erase);
    host.Wnd().InvalidateRect(r, erase);
}

void Engine::DoPaint(SoakHost& host)
{
    if (m_random.Chance(50)) {
        ::RedrawWindow(host.Handle(), nullptr, nullptr, RDW_INVALIDATE | RDW_ERASE | RDW_ALLCHILDREN);
        host.Wnd().PumpPaintMessages();
    } else {
        ::RedrawWindow(host.Scrollee(), nullptr, nullptr, RDW_INVALIDATE | RDW_UPDATENOW);
    }
}

// ---- printing ----------------------------------------------------------------------------------

void Engine::DoPrint(SoakHost& host)
{
    SoakDrawWnd& wnd = host.Wnd();
    wnd.printsWithSurface = m_random.Chance(85);
    CPrintInfo info;
    wnd.OnPreparePrinting(&info);
    PRINTDLG& choice = info.m_pPD->m_pd;
    if (m_random.Chance(50))
        choice.Flags &= ~static_cast<DWORD>(PD_SELECTION);
    CDC printer;
    DOCINFOA document = {sizeof document, "soak", m_printPath.c_str(), nullptr, 0};
    if (!m_app.CreatePrinterDC(printer) || printer.StartDoc(&document) <= 0) {
        m_stepFault = "the default printer took no print job";
        return;
    }
    wnd.OnBeginPrinting(&printer, &info);
    const UINT pages = choice.nMaxPage;
    const UINT candidates[] = {0u, 1u, static_cast<UINT>(wnd.GetPrintLayout().m_currentPage), pages, pages + 1,
                               static_cast<UINT>(m_random.Between(1, std::max<int>(pages, 1))), UINT_MAX};
    const int sheets = m_random.Between(1, 3);
    for (int i = 0; i < sheets; ++i) {
        info.m_nCurPage = m_random.Pick(candidates);
        Trace(" page %u of %u", info.m_nCurPage, pages);
        printer.StartPage();
        wnd.OnPrint(&printer, &info);
        printer.EndPage();
        if (info.m_nCurPage >= 1 && info.m_nCurPage <= pages && wnd.GetDrawing() && !m_warmingUp)
            ++m_events.pagesPrinted;
    }
    printer.EndDoc();
    wnd.OnEndPrinting(&printer, &info);
    // Every sheet started is in the job, if only blank.
    if (CountPostScriptPages(m_printPath) != sheets)
        m_stepFault = "the print job is not PostScript with a page for each sheet";
}

int Engine::CountPostScriptPages(const std::string& path)
{
    std::ifstream file(path, std::ios::binary);
    std::string job((std::istreambuf_iterator<char>(file)), std::istreambuf_iterator<char>());
    if (job.rfind("%!PS", 0) != 0)
        return -1;
    // The driver writes over the file without truncating it: whatever
    // follows the job's end is left from a longer job before.
    const size_t end = job.find("\n%%EOF");
    if (end == std::string::npos)
        return -1;
    job.resize(end);
    int pages = 0;
    for (size_t at = job.find("\n%%Page:"); at != std::string::npos; at = job.find("\n%%Page:", at + 1))
        ++pages;
    return pages;
}

// ---- input and time ----------------------------------------------------------------------------

void Engine::Mouse(DWORD flags, POINT screen, DWORD dt)
{
    m_time += dt;
    ScrollTest::SendMouse(flags, screen, m_time);
    PumpInput();
}

void Engine::Key(WORD key, DWORD dt)
{
    m_time += dt;
    ScrollTest::SendKey(key, m_time);
    PumpInput();
}

void Engine::Pump()
{
    ScrollTest::PumpPending();
    AfxLockTempMaps();
    AfxUnlockTempMaps(TRUE);
}

void Engine::PumpInput()
{
    ScrollTest::PumpInput();
    Pump();
}

void Engine::PaintAll()
{
    for (const auto& host : m_hosts)
        ::RedrawWindow(host->Handle(), nullptr, nullptr, RDW_UPDATENOW | RDW_ALLCHILDREN);
    Pump();
}

void Engine::DeliverDueTicks(SoakHost& host)
{
    if (!host.IsAlive())
        return;
    if (m_ledger.HasTimer(host.Scrollee(), Tavo_WiScrollee::HoldTimerId))
        ::SendMessageA(host.Scrollee(), WM_TIMER, Tavo_WiScrollee::HoldTimerId, 0);
    if (m_ledger.HasTimer(host.DrawWnd(), Tavo_WiDrawWnd::AutoScrollTimerId))
        ::SendMessageA(host.DrawWnd(), WM_TIMER, Tavo_WiDrawWnd::AutoScrollTimerId, 0);
    Pump();
}

bool Engine::PointIn(SoakHost& host, POINT& screen)
{
    CRect client(0, 0, 0, 0);
    if (!host.IsAlive() || !::GetClientRect(host.Scrollee(), &client) || client.IsRectEmpty())
        return false;
    // Only a point where the scrollee itself is on the screen can be pointed
    // at: its frame may cut it off, the screen's edge, or another window.
    for (int attempt = 0; attempt < PointAttempts; ++attempt) {
        screen = {m_random.Below(client.Width()), m_random.Below(client.Height())};
        ::ClientToScreen(host.Scrollee(), &screen);
        if (::WindowFromPoint(screen) == host.Scrollee())
            return true;
    }
    return false;
}

bool Engine::ActivateAndPointIn(SoakHost& host, POINT& screen)
{
    host.Activate();
    Pump();
    return PointIn(host, screen);
}

POINT Engine::PointOnScreen()
{
    return {m_random.Below(::GetSystemMetrics(SM_CXSCREEN)), m_random.Below(::GetSystemMetrics(SM_CYSCREEN))};
}

void Engine::Trace(const char* format, ...)
{
    if (!m_options.trace || m_warmingUp)
        return;
    va_list arguments;
    va_start(arguments, format);
    std::vprintf(format, arguments);
    va_end(arguments);
    // A step that never ends shows how far it came.
    std::fflush(stdout);
}

} // namespace Soak
