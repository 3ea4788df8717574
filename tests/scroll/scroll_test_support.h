// Shared helpers of the scrolling-window tests: plain windows, a scroll
// window recording its virtual operations, a pump bounded by a deadline,
// input with explicit message times, pixel read-back.
#pragma once

#include <afxwin.h>

#include "Tavo_WiScrollWnd.h"

#include <algorithm>
#include <atomic>
#include <functional>
#include <ostream>
#include <string>
#include <thread>
#include <tuple>
#include <vector>

namespace ScrollTest {

// Dispatches every pending message as the application's pump does. Real
// WM_TIMER messages are dropped: the tests drive every timer by sending it.
void PumpPending();
// Pumps until done() holds or three seconds pass; returns done().
bool PumpUntil(const std::function<bool()>& done);
// Pumps until no input message is left in the queue.
void PumpInput();

// A mouse event at a screen point with exactly this message time (data: the
// wheel's delta, for a wheel event), to send.
INPUT MouseInput(DWORD buttonFlags, POINT screenPoint, DWORD time, DWORD data = 0);
// A mouse event at a screen point, delivered with exactly this message time.
void SendMouse(DWORD buttonFlags, POINT screenPoint, DWORD time);
// A key press and release.
void SendKey(WORD virtualKey, DWORD time);
// A base for explicit message times, at least two seconds after every base
// handed out before, so that no two tests' clicks make a double click.
DWORD FreshTime();

// Ends a modal mouse loop (a rubber rectangle's) that a fault keeps running:
// once the deadline passes, another thread releases every button, so the
// test fails instead of hanging. A loop that behaves ends long before.
class ButtonReleaseDeadline {
public:
    explicit ButtonReleaseDeadline(DWORD milliseconds = 5000);
    ~ButtonReleaseDeadline();
    ButtonReleaseDeadline(const ButtonReleaseDeadline&) = delete;
    ButtonReleaseDeadline& operator=(const ButtonReleaseDeadline&) = delete;

    bool Passed() const { return m_passed; }

private:
    HANDLE m_stop;
    std::atomic<bool> m_passed{false};
    std::thread m_thread;
};

// A plain window attached to a CWnd for the framework's calls: a shown and
// activated top-level window at a screen rectangle when parent is null, a
// visible child at a client rectangle otherwise. Every registered message
// any of them receives is noted, in order.
class TestWindow {
public:
    struct Note {
        HWND window;
        UINT message;
        WPARAM wParam;
    };

    explicit TestWindow(const CRect& rect, HWND parent = nullptr);
    ~TestWindow();
    TestWindow(const TestWindow&) = delete;
    TestWindow& operator=(const TestWindow&) = delete;

    HWND Handle() const { return m_hwnd; }
    CWnd* Wnd() { return &m_wnd; }
    static std::vector<Note>& Notes() { return s_notes; }

private:
    static inline std::vector<Note> s_notes;
    HWND m_hwnd = nullptr;
    CWnd m_wnd;
};

// One call of a scroll window's virtual operation.
struct Call {
    std::string name;
    UINT button = 0;
    UINT flags = 0;
    CPoint point{0, 0};
    int completed = -1;

    bool operator==(const Call& other) const
    {
        return std::tie(name, button, flags, point.x, point.y, completed) ==
            std::tie(other.name, other.button, other.flags, other.point.x, other.point.y, other.completed);
    }
};
std::ostream& operator<<(std::ostream& out, const Call& call);

// A scroll window that records the calls of its virtual operations.
class RecordingScrollWnd : public Tavo_WiScrollWnd {
public:
    std::vector<Call> calls;
    CString dataTipText;                                 // answered by GetDataTipText
    std::function<void(Tavo_WiScrollee*, CDC*)> painter; // paints the view when set

    long Count(const std::string& name) const
    {
        return std::count_if(calls.begin(), calls.end(), [&](const Call& call) { return call.name == name; });
    }
    void Clear() { calls.clear(); }

    void OnDraw(Tavo_WiScrollee* scrollee, CDC* dc) override
    {
        if (painter)
            painter(scrollee, dc);
    }
    // Records only the calls that really move pixels.
    void GetScrollDeviceDeltas(const CPoint& a, const CPoint& b, int& dx, int& dy, int scrolling) override
    {
        if (scrolling)
            Record("ScrollDeltas", b);
        Tavo_WiScrollWnd::GetScrollDeviceDeltas(a, b, dx, dy, scrolling);
    }
    void OnClick(UINT button, UINT flags, const CPoint& point) override { Record("Click", point, button, flags); }
    void OnDoubleClick(UINT button, UINT flags, const CPoint& point) override { Record("DoubleClick", point, button, flags); }
    void OnDragStart(UINT button, UINT flags, const CPoint& point) override { Record("DragStart", point, button, flags); }
    void OnDragMove(UINT button, UINT flags, const CPoint& point) override { Record("DragMove", point, button, flags); }
    void OnDragEnd(UINT button, UINT flags, const CPoint& point, int completed) override
    {
        calls.push_back({"DragEnd", button, flags, point, completed});
    }
    void OnDragAbort() override { Record("DragAbort"); }
    void OnParkedCursorStart(const CPoint& point) override
    {
        Record("ParkedStart", point);
        Tavo_WiScrollWnd::OnParkedCursorStart(point);
    }
    void OnParkedCursorEnd() override
    {
        Record("ParkedEnd");
        Tavo_WiScrollWnd::OnParkedCursorEnd();
    }
    CString GetDataTipText(const CPoint& point) override
    {
        Record("DataTipText", point);
        return dataTipText;
    }
    void OnDragScrollStart(const CPoint& position) override { Record("DragScrollStart", position); }
    void OnDragScrollMove(const CPoint& position) override { Record("DragScrollMove", position); }
    void OnDragScrollEnd(const CPoint& position) override { Record("DragScrollEnd", position); }
    void OnNonDragScrollEnd(const CPoint& position) override { Record("NonDragScrollEnd", position); }

private:
    void Record(const char* name, const CPoint& point = CPoint(0, 0), UINT button = 0, UINT flags = 0)
    {
        calls.push_back({name, button, flags, point});
    }
};

// A pixel of a window's client area as on screen.
inline COLORREF PixelAt(HWND window, int x, int y) { return CClientDC(CWnd::FromHandle(window)).GetPixel(x, y); }

// The window rectangle of child in its parent's client coordinates.
CRect ChildRect(HWND child);

} // namespace ScrollTest

// Readable values in test failures.
inline void PrintTo(const CRect& r, std::ostream* out)
{
    *out << "(" << r.left << ", " << r.top << ", " << r.right << ", " << r.bottom << ")";
}
inline void PrintTo(const CPoint& p, std::ostream* out) { *out << "(" << p.x << ", " << p.y << ")"; }
