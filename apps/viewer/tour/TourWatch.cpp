#include "TourWatch.h"

#include "ViewerStatusBar.h"

#include <commctrl.h>

namespace TourWatch {

namespace {

// A sent message the viewer's thread does not answer within this time is
// given up, so a stuck viewer cannot stop the tour.
constexpr UINT SendTimeoutMs = 5000;
constexpr DWORD PollMs = 10;
// Wine hands painted windows to the X server on its own clock; a picture
// taken at once may miss the last paint.
constexpr DWORD ScreenFlushMs = 150;

LRESULT SendWithin(HWND window, UINT message, WPARAM wParam, LPARAM lParam)
{
    DWORD_PTR answer = 0;
    if (!::SendMessageTimeoutA(window, message, wParam, lParam, SMTO_NORMAL, SendTimeoutMs, &answer))
        return 0;
    return static_cast<LRESULT>(answer);
}

} // namespace

bool WaitFor(const std::function<bool()>& condition, DWORD timeoutMs)
{
    const DWORD start = ::GetTickCount();
    for (;;) {
        if (condition())
            return true;
        if (::GetTickCount() - start > timeoutMs)
            return false;
        ::Sleep(PollMs);
    }
}

void Pause(DWORD ms) { ::Sleep(ms); }

std::string WindowText(HWND window)
{
    char text[512] = {};
    SendWithin(window, WM_GETTEXT, sizeof text, reinterpret_cast<LPARAM>(text));
    return text;
}

std::string StatusPart(HWND statusBar, int part)
{
    // The text may change between two messages to the viewer's thread, so
    // its length is not asked first: the buffer holds the longest text the
    // viewer ever gives a part.
    char text[ViewerStatusBar::MaxPartLength + 1] = {};
    SendWithin(statusBar, SB_GETTEXTA, part, reinterpret_cast<LPARAM>(text));
    return text;
}

HWND CaptureOf(DWORD thread)
{
    GUITHREADINFO info = {};
    info.cbSize = sizeof(info);
    return ::GetGUIThreadInfo(thread, &info) ? info.hwndCapture : nullptr;
}

HWND VisibleDialogOf(DWORD thread)
{
    HWND found = nullptr;
    ::EnumThreadWindows(
        thread,
        [](HWND window, LPARAM result) -> BOOL {
            char name[16] = {};
            ::GetClassNameA(window, name, sizeof name);
            if (::lstrcmpA(name, "#32770") != 0 || !::IsWindowVisible(window))
                return TRUE;
            *reinterpret_cast<HWND*>(result) = window;
            return FALSE;
        },
        reinterpret_cast<LPARAM>(&found));
    return found;
}

POINT CentreOf(HWND window)
{
    RECT rect = {};
    ::GetWindowRect(window, &rect);
    return {(rect.left + rect.right) / 2, (rect.top + rect.bottom) / 2};
}

void Settle(HWND frame, HWND extra, bool repaint)
{
    SendWithin(frame, WM_NULL, 0, 0);
    if (repaint) {
        ::RedrawWindow(frame, nullptr, nullptr, RDW_UPDATENOW | RDW_ALLCHILDREN);
        if (extra)
            ::RedrawWindow(extra, nullptr, nullptr, RDW_UPDATENOW | RDW_ALLCHILDREN);
    }
    SendWithin(frame, WM_NULL, 0, 0);
    ::Sleep(ScreenFlushMs);
}

} // namespace TourWatch
