// Faults injected into the drawing window's work: the mouse capture taken
// away in the middle of a drag and of a rubber rectangle, the window
// destroyed from inside a drag, an autoscroll tick, a rubber rectangle and a
// paint, Escape held during a paint, no default printer, a printer device
// context that cannot be made, and memory that runs out while a drawing is
// bound. The window survives each with a defined state and gives back
// everything it took.
#include "hostile_drawings.h"
#include "resource_census.h"
#include "soak_test_support.h"

#include "SampleDrawing.h"
#include "Tavo_WiScrollee.h"

#include <afxext.h>
#include <gtest/gtest.h>

#include <atomic>
#include <thread>

using namespace SoakTest;
using ScrollTest::PumpPending;

namespace {

constexpr DWORD MoveOnly = 0;
constexpr UINT_PTR AutoScrollTimer = Tavo_WiDrawWnd::AutoScrollTimerId;
constexpr UINT_PTR HoldTimer = Tavo_WiScrollee::HoldTimerId;

// Redirects one import of one of the library's modules to a function of the
// test while it lives.
template <class Function>
class Fault {
public:
    Fault(const char* module, const char* name, Function replacement)
        : m_patch(::GetModuleHandleA(module), name, reinterpret_cast<void*>(replacement))
    {
    }
    bool IsActive() const { return m_patch.IsActive(); }

private:
    ImportPatch m_patch;
};

SHORT WINAPI EscapeDown(int key)
{
    return key == VK_ESCAPE ? static_cast<SHORT>(0x8000) : 0;
}

BOOL WINAPI NoPrinter(PRINTDLGA*)
{
    return FALSE;
}

HDC WINAPI NoDeviceContext(LPCSTR, LPCSTR, LPCSTR, const DEVMODEA*)
{
    return nullptr;
}

// The allocation of a mapping fails; the others go on (the runtime itself
// needs memory to report the failure as an exception).
void* (*s_malloc)(size_t) = nullptr;
void* __cdecl NoMemoryForAMapping(size_t size)
{
    return size == sizeof(Tavo_GrMapping) ? nullptr : s_malloc(size);
}

// A host with the sample drawing bound and zoomed in, so that drags pan, and
// a census of what the process holds before it existed.
class FaultTest : public ::testing::Test {
protected:
    void SetUp() override
    {
        // One window first, so that what the library makes once per process
        // (the data tip's shared objects, the window classes) is there.
        {
            SoakHost warmUp(CRect(50, 50, 450, 350));
        }
        PumpPending();
        before = TakeCensus(&ledger);
        host = std::make_unique<SoakHost>(CRect(50, 50, 550, 450));
        BuildSampleDrawing(drawing);
        wnd().SetDrawingInfo(&drawing, 50, 3, 0, 0, 0);
        wnd().ZoomWindow(Tavo_GrZoom::ToLevel, 10, Tavo_WiZoomCenter::AtViewCentre, 0, 0, false);
        Settle(*host);
        time = ScrollTest::FreshTime();
    }

    // Everything the window took is given back once it is gone.
    void ExpectNothingLeftAfterTheHost()
    {
        host.reset();
        PumpPending();
        AfxLockTempMaps();
        AfxUnlockTempMaps(TRUE);
        EXPECT_EQ(::GetCapture(), nullptr);
        EXPECT_EQ(ledger.CountThreadTimers(), 0);
        const Census after = TakeCensus(&ledger);
        EXPECT_EQ(after.windows, before.windows);
        EXPECT_EQ(after.timers, before.timers);
        EXPECT_EQ(after.hooks, before.hooks);
        EXPECT_EQ(after.deviceContexts, before.deviceContexts);
    }

    SoakDrawWnd& wnd() { return host->Wnd(); }
    POINT Screen(int x, int y)
    {
        POINT point = {x, y};
        ::ClientToScreen(host->Scrollee(), &point);
        return point;
    }
    void Mouse(DWORD flags, int x, int y)
    {
        time += 40;
        ScrollTest::SendMouse(flags, Screen(x, y), time);
        ScrollTest::PumpInput();
    }
    // A left-button press held until it becomes a drag.
    void StartDrag(int x, int y)
    {
        Mouse(MOUSEEVENTF_LEFTDOWN, x, y);
        ::SendMessageA(host->Scrollee(), WM_TIMER, HoldTimer, 0);
        PumpPending();
    }
    void TearDown() override
    {
        if (::GetAsyncKeyState(VK_LBUTTON) & 0x8000) {
            time += 40;
            ScrollTest::SendMouse(MOUSEEVENTF_LEFTUP, POINT{1, 1}, time);
            ScrollTest::PumpInput();
        }
        ::ReleaseCapture();
    }

    ResourceLedger ledger;
    Census before;
    Tavo_GrDrawing drawing;
    std::unique_ptr<SoakHost> host;
    DWORD time = 0;
};

// ---- the capture taken away ----------------------------------------------------------

TEST_F(FaultTest, CaptureTakenInAPanDragEndsItAndTheDueTickScrollsOnceWithoutReArming)
{
    StartDrag(250, 200);
    ASSERT_TRUE(wnd().IsDragScrolling());
    Mouse(MoveOnly, -40, 200); // out of the view: autoscroll
    ASSERT_TRUE(ledger.HasTimer(wnd().GetSafeHwnd(), AutoScrollTimer));
    const CPoint position = wnd().GetScrollPosition();

    SoakHost thief(CRect(600, 50, 700, 150));
    ::SetCapture(thief.Handle());
    PumpPending();
    EXPECT_FALSE(wnd().IsDragScrolling()) << "the drag ended with the capture";
    ::SendMessageA(wnd().GetSafeHwnd(), WM_TIMER, AutoScrollTimer, 0);
    EXPECT_NE(wnd().GetScrollPosition(), position) << "the tick already due still scrolls";
    EXPECT_FALSE(ledger.HasTimer(wnd().GetSafeHwnd(), AutoScrollTimer)) << "and does not re-arm";
    Mouse(MOUSEEVENTF_LEFTUP, -40, 200);
    EXPECT_EQ(::GetCapture(), thief.Handle());
    ::ReleaseCapture();
    EXPECT_FALSE(ledger.HasTimer(host->Scrollee(), HoldTimer));
}

TEST_F(FaultTest, CaptureTakenInARubberRectangleCancelsItWithNothingReported)
{
    auto thief = std::make_unique<SoakHost>(CRect(600, 50, 700, 150));
    wnd().dragAction = Tavo_WiDrawWnd::RubberRectangle;
    wnd().onPaint = [&] { ::SetCapture(thief->Handle()); };
    Mouse(MOUSEEVENTF_LEFTDOWN, 100, 100);
    ::SetCapture(host->Scrollee()); // as the hold time would, so the queue below is the view's
    ScrollTest::SendMouse(MoveOnly, Screen(200, 150), time += 40);
    ::InvalidateRect(host->Scrollee(), nullptr, FALSE);
    ::SendMessageA(host->Scrollee(), WM_TIMER, HoldTimer, 0);
    wnd().onPaint = nullptr;
    EXPECT_EQ(wnd().counts.rubberRectangles, 0);
    EXPECT_EQ(::GetCapture(), thief->Handle()) << "the capture stays with the window that took it";
    ::ReleaseCapture();
    Mouse(MOUSEEVENTF_LEFTUP, 200, 150);
    thief.reset();
    ExpectNothingLeftAfterTheHost();
}

// ---- the window destroyed from inside --------------------------------------------------

TEST_F(FaultTest, WindowDestroyedFromInsideADragMoveLeavesNothingBehind)
{
    StartDrag(250, 200);
    wnd().onDragMove = [&] { wnd().DestroyWindow(); };
    Mouse(MoveOnly, 200, 200);
    EXPECT_FALSE(host->IsAlive());
    Mouse(MoveOnly, -40, 200);
    Mouse(MOUSEEVENTF_LEFTUP, -40, 200);
    ExpectNothingLeftAfterTheHost();
}

TEST_F(FaultTest, WindowDestroyedFromInsideAnAutoScrollTickLeavesNothingBehind)
{
    StartDrag(250, 200);
    Mouse(MoveOnly, -40, 200);
    ASSERT_TRUE(ledger.HasTimer(wnd().GetSafeHwnd(), AutoScrollTimer));
    // The tick scrolls and paints the uncovered strip at once: the paint destroys.
    wnd().onPaint = [&] { wnd().DestroyWindow(); };
    const HWND window = wnd().GetSafeHwnd();
    ::SendMessageA(window, WM_TIMER, AutoScrollTimer, 0);
    EXPECT_FALSE(host->IsAlive());
    EXPECT_EQ(ledger.CountThreadTimers(), 0) << "no timer was set on the window that was gone";
    Mouse(MOUSEEVENTF_LEFTUP, -40, 200);
    ExpectNothingLeftAfterTheHost();
}

TEST_F(FaultTest, WindowDestroyedFromInsideItsPaintLeavesNothingBehind)
{
    wnd().onPaint = [&] { wnd().DestroyWindow(); };
    ::InvalidateRect(host->Scrollee(), nullptr, TRUE);
    Settle(*host);
    EXPECT_FALSE(host->IsAlive());
    ExpectNothingLeftAfterTheHost();
}

TEST_F(FaultTest, WindowDestroyedFromInsideARubberRectangleEndsItAtOnce)
{
    wnd().dragAction = Tavo_WiDrawWnd::RubberRectangle;
    wnd().onPaint = [&] { wnd().DestroyWindow(); };
    Mouse(MOUSEEVENTF_LEFTDOWN, 100, 100);
    ::SetCapture(host->Scrollee());
    ScrollTest::SendMouse(MoveOnly, Screen(200, 150), time += 40);
    ::InvalidateRect(host->Scrollee(), nullptr, FALSE);
    // Should the loop wait for the release after all, the release comes
    // from outside after a while, and the test fails.
    std::atomic<bool> released{false};
    const HANDLE stop = ::CreateEventA(nullptr, TRUE, FALSE, nullptr);
    std::thread deadline([&] {
        if (::WaitForSingleObject(stop, 5000) != WAIT_TIMEOUT)
            return;
        released = true;
        INPUT input = {};
        input.type = INPUT_MOUSE;
        input.mi.dwFlags = MOUSEEVENTF_LEFTUP;
        ::SendInput(1, &input, sizeof input);
    });
    ::SendMessageA(host->Scrollee(), WM_TIMER, HoldTimer, 0);
    ::SetEvent(stop);
    deadline.join();
    ::CloseHandle(stop);
    EXPECT_FALSE(released) << "the loop went on waiting for the release of a window that was gone";
    EXPECT_FALSE(host->IsAlive());
    EXPECT_EQ(wnd().counts.rubberRectangles, 0);
    Mouse(MOUSEEVENTF_LEFTUP, 200, 150);
    ExpectNothingLeftAfterTheHost();
}

// ---- Escape during a paint --------------------------------------------------------------

TEST_F(FaultTest, EscapeHeldDuringAPaintStopsThePassAndTheNextPaintIsWhole)
{
    // Red rectangles stacked on one box, filling the view.
    const Tavo_GrWRect box{100, 100, 200, 200};
    auto crowd = Hostile::BuildStack(box, 20000);
    wnd().SetDrawingInfo(crowd.get(), 50, 3, 0, 0, 0);
    wnd().ZoomWindow(box);
    Settle(*host);
    const int whole = wnd().counts.paints;
    ASSERT_EQ(Capture(*host)->GetPixel(250, 200), Colour(Hostile::Red));
    {
        const Fault<decltype(&EscapeDown)> escape("libTavo_Windows.dll", "GetAsyncKeyState", &EscapeDown);
        ASSERT_TRUE(escape.IsActive());
        ::InvalidateRect(host->Scrollee(), nullptr, TRUE);
        Settle(*host);
        EXPECT_TRUE(wnd().GetNativeWindowSurface()->IsDrawingInterrupted());
        EXPECT_EQ(ledger.CountDeviceContexts(), before.deviceContexts) << "the paint gave its device context back";
    }
    EXPECT_EQ(wnd().counts.paints, whole + 1);
    ::InvalidateRect(host->Scrollee(), nullptr, TRUE);
    Settle(*host);
    EXPECT_FALSE(wnd().GetNativeWindowSurface()->IsDrawingInterrupted());
    EXPECT_EQ(Capture(*host)->GetPixel(250, 200), Colour(Hostile::Red));
    ExpectNothingLeftAfterTheHost();
}

// ---- printers that fail -------------------------------------------------------------------

TEST_F(FaultTest, PrintingWithoutADefaultPrinterOrItsDeviceContextLaysOutOnePage)
{
    struct Case {
        const char* name;
        const char* module;
        const char* function;
        void* replacement;
    };
    const Case cases[] = {
        {"no default printer", "afx.dll", "PrintDlgA", reinterpret_cast<void*>(&NoPrinter)},
        {"no printer device context", "afx.dll", "CreateDCA", reinterpret_cast<void*>(&NoDeviceContext)},
    };
    CWinApp app("fault test");
    for (const Case& c : cases) {
        const ImportPatch fault(::GetModuleHandleA(c.module), c.function, c.replacement);
        ASSERT_TRUE(fault.IsActive()) << c.name;
        CPrintInfo info;
        wnd().OnPreparePrinting(&info);
        const Tavo_WiPrintLayout& layout = wnd().GetPrintLayout();
        EXPECT_EQ(layout.m_numCols, 1) << c.name;
        EXPECT_EQ(layout.m_numRows, 1) << c.name;
        EXPECT_EQ(layout.m_currentPage, 1) << c.name;
        EXPECT_EQ(layout.m_firstPageBox, wnd().GetWorldClipBox()) << c.name;
        EXPECT_EQ(info.m_pPD->m_pd.nMaxPage, 1) << c.name;
        CDC printer;
        EXPECT_FALSE(app.CreatePrinterDC(printer)) << c.name;
        EXPECT_EQ(ledger.CountDeviceContexts(), before.deviceContexts) << c.name;
    }
    ExpectNothingLeftAfterTheHost();
}

// ---- memory that runs out ------------------------------------------------------------------

TEST_F(FaultTest, MemoryRunningOutWhileBindingLeavesTheWindowUnboundAndUsable)
{
    Tavo_GrDrawing other;
    BuildSampleDrawing(other);
    s_malloc = reinterpret_cast<void* (*)(size_t)>(
        reinterpret_cast<void*>(::GetProcAddress(::GetModuleHandleA("msvcrt.dll"), "malloc")));
    {
        const Fault<decltype(&NoMemoryForAMapping)> noMemory("libTavo_Windows.dll", "malloc", &NoMemoryForAMapping);
        ASSERT_TRUE(noMemory.IsActive());
        wnd().SetDrawingInfo(&other, 50, 3, 0, 0, 0);
    }
    EXPECT_EQ(wnd().GetDrawing(), nullptr);
    EXPECT_EQ(wnd().GetMapping(), nullptr);
    EXPECT_EQ(wnd().GetWorldClipBox(), Tavo_GrWRect());
    EXPECT_EQ(wnd().GetZoomLevel(), 0.0);
    wnd().ZoomWindow(Tavo_GrZoom::In, 1, Tavo_WiZoomCenter::AtViewCentre, 0, 0, true);
    ::InvalidateRect(host->Scrollee(), nullptr, TRUE);
    Settle(*host);

    wnd().SetDrawingInfo(&other, 50, 3, 0, 0, 0);
    Settle(*host);
    EXPECT_EQ(wnd().GetDrawing(), &other);
    ASSERT_NE(wnd().GetMapping(), nullptr);
    EXPECT_TRUE(Tavo_GrIntersects(wnd().GetWorldClipBox(), other.GetBounds()));
    ExpectNothingLeftAfterTheHost();
}

} // namespace
