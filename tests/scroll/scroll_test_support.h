// Shared helpers of the scrolling-window tests: a host top-level window on the
// virtual display, a scroll window that records every call of its virtual
// operations, a message pump bounded by a deadline, input with explicit
// message times, and pixel read-back.
#pragma once

#include <afxwin.h>

#include "Tavo_WiScrollWnd.h"

#include <functional>
#include <ostream>
#include <string>
#include <vector>

namespace ScrollTest {

// ---- message pump ---------------------------------------------------------------

// Dispatches every message that is pending now, the way the application's
// pump does (pre-translation by the target and its parents first). Real
// WM_TIMER messages are dropped: the tests drive every timer themselves by
// sending WM_TIMER.
void PumpPending();

// Pumps as PumpPending does until done() holds or the deadline passes;
// returns done().
bool PumpUntil(const std::function<bool()>& done, DWORD timeoutMs = 3000);

// ---- input with explicit message times --------------------------------------------

// A mouse event at a screen point, delivered with exactly this message time.
void SendMouse(DWORD buttonFlags, POINT screenPoint, DWORD time);
// A key press and release.
void SendKey(WORD virtualKey, DWORD time);

// ---- windows ---------------------------------------------------------------------

// A plain top-level window at a fixed screen position, shown and activated.
class HostWindow
{
public:
    HostWindow(int x, int y, int width, int height);
    ~HostWindow();
    HostWindow(const HostWindow&) = delete;
    HostWindow& operator=(const HostWindow&) = delete;

    HWND Handle() const { return m_hwnd; }
    CWnd* Wnd() { return &m_wnd; }

private:
    HWND m_hwnd = nullptr;
    CWnd m_wnd;   // attached to m_hwnd for the framework's calls
};

// A plain window that records the registered messages it receives.
class NotificationSink
{
public:
    struct Note
    {
        HWND window;
        UINT message;
        WPARAM wParam;
    };

    explicit NotificationSink(HWND parent = nullptr);
    ~NotificationSink();
    NotificationSink(const NotificationSink&) = delete;
    NotificationSink& operator=(const NotificationSink&) = delete;

    HWND Handle() const { return m_hwnd; }
    CWnd* Wnd() { return &m_wnd; }
    // Every note received by any sink, in order.
    static std::vector<Note>& Notes();

private:
    HWND m_hwnd = nullptr;
    CWnd m_wnd;
};

// One call of a scroll window's virtual operation.
struct Call
{
    std::string name;
    UINT button = 0;
    UINT flags = 0;
    CPoint point{0, 0};
    int completed = -1;

    bool operator==(const Call& other) const
    {
        return name == other.name && button == other.button && flags == other.flags &&
               point == other.point && completed == other.completed;
    }
};
std::ostream& operator<<(std::ostream& out, const Call& call);

// A scroll window that records the calls of its virtual operations.
class RecordingScrollWnd : public Tavo_WiScrollWnd
{
public:
    std::vector<Call> calls;
    // Asked by GetDataTipText.
    CString dataTipText;
    // Paints the view when set.
    std::function<void(Tavo_WiScrollee*, CDC*)> painter;
    // Device deltas when set; the base behaviour otherwise.
    std::function<void(const CPoint&, const CPoint&, int&, int&, int)> deltas;

    std::vector<Call> CallsNamed(const std::string& name) const;
    void Clear() { calls.clear(); }

    using Tavo_WiScrollWnd::SetDragScrollingFlag;

    void OnDraw(Tavo_WiScrollee* scrollee, CDC* dc) override;
    void GetScrollDeviceDeltas(const CPoint& a, const CPoint& b, int& dx, int& dy,
                               int scrolling) override;
    void OnClick(UINT button, UINT flags, const CPoint& point) override;
    void OnDoubleClick(UINT button, UINT flags, const CPoint& point) override;
    void OnDragStart(UINT button, UINT flags, const CPoint& point) override;
    void OnDragMove(UINT button, UINT flags, const CPoint& point) override;
    void OnDragEnd(UINT button, UINT flags, const CPoint& point, int completed) override;
    void OnDragAbort() override;
    void OnParkedCursorStart(const CPoint& point) override;
    void OnParkedCursorEnd() override;
    CString GetDataTipText(const CPoint& point) override;
    void OnDragScrollStart(const CPoint& position) override;
    void OnDragScrollMove(const CPoint& position) override;
    void OnDragScrollEnd(const CPoint& position) override;
    void OnNonDragScrollEnd(const CPoint& position) override;

private:
    void Record(const char* name, const CPoint& point, UINT button = 0, UINT flags = 0,
                int completed = -1);
};

// ---- pixels ------------------------------------------------------------------------

// The window's client pixels as on screen, row by row, as 0x00RRGGBB.
class Pixels
{
public:
    Pixels(HWND window, int width, int height);
    COLORREF At(int x, int y) const;   // as a COLORREF (0x00BBGGRR)
    int Width() const { return m_width; }
    int Height() const { return m_height; }

private:
    int m_width;
    int m_height;
    std::vector<DWORD> m_bits;
};

// The client rectangle of child in its parent's client coordinates.
CRect ChildRect(HWND child);

}  // namespace ScrollTest

namespace ScrollTest {

// A base for explicit message times: at least two seconds after every base
// handed out before, so that no two tests' clicks make a double click.
DWORD FreshTime();

// Pumps until no input message is left in the queue.
void PumpInput();

}  // namespace ScrollTest

// Readable values in test failures.
inline void PrintTo(const CRect& rect, std::ostream* out)
{
    *out << "(" << rect.left << ", " << rect.top << ", " << rect.right << ", " << rect.bottom << ")";
}

inline void PrintTo(const CPoint& point, std::ostream* out)
{
    *out << "(" << point.x << ", " << point.y << ")";
}

namespace ScrollTest {

// Whether the library uses its own window classes in this process (the user's
// default locale is English).
bool EnglishLocale();

}  // namespace ScrollTest
