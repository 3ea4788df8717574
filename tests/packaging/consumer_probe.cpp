// consumer_probe: runs the viewer example, built against a fresh install of
// the library, and checks on the screen what a user would see: the middle of
// the view shows the pond (a blue disc at the drawing's centre), five wheel
// notches over it double its width, and closing the window ends the program
// with status 0. Prints what it measured; exits 0 when every check held.
//
//   consumer_probe <viewer.exe>
#include "Tavo_WiLibrary.h"
#include "Tavo_WiPalette.h"
#include "Tavo_WiScrollWnd.h"

#include <windows.h>

#include <cstdio>
#include <functional>
#include <string>

namespace {

// The deadlines only bound a failing run: a passing one moves on as soon as
// its check holds.
constexpr DWORD kDeadlineMs = 20000;
constexpr DWORD kPollPeriodMs = 20;
// The viewer zooms one level per notch; five levels double the scale.
constexpr int kWheelNotches = 5;
// Both widths are whole pixels: twice the first may be off by a few.
constexpr double kLeastRatio = 1.9;
constexpr double kMostRatio = 2.1;

bool WaitFor(const std::function<bool()>& condition)
{
    const DWORD start = GetTickCount();
    while (!condition()) {
        if (GetTickCount() - start >= kDeadlineMs)
            return false;
        Sleep(kPollPeriodMs);
    }
    return true;
}

HWND VisibleWindowOf(DWORD processId)
{
    struct Search {
        DWORD processId;
        HWND found;
    } search = {processId, nullptr};
    EnumWindows(
        [](HWND window, LPARAM param) -> BOOL {
            auto* s = reinterpret_cast<Search*>(param);
            DWORD owner = 0;
            GetWindowThreadProcessId(window, &owner);
            if (owner == s->processId && IsWindowVisible(window))
                s->found = window;
            return s->found == nullptr;
        },
        reinterpret_cast<LPARAM>(&search));
    return search.found;
}

// The width of the run of one colour through a screen point along its row;
// 0 when the point itself has another colour.
int RunThrough(POINT point, COLORREF colour)
{
    HDC screen = GetDC(nullptr);
    const int width = GetDeviceCaps(screen, HORZRES);
    auto matches = [&](int x) { return GetPixel(screen, x, point.y) == colour; };
    int run = 0;
    if (matches(point.x)) {
        int left = point.x;
        int right = point.x;
        while (left > 0 && matches(left - 1))
            --left;
        while (right + 1 < width && matches(right + 1))
            ++right;
        run = right - left + 1;
    }
    ReleaseDC(nullptr, screen);
    return run;
}

// The run once two readings in a row agree and are acceptable (a paint may
// still be reaching the screen); 0 when that never happened.
int SteadyRun(POINT point, COLORREF colour, const std::function<bool(int)>& acceptable)
{
    int last = -1;
    int steady = 0;
    WaitFor([&] {
        const int run = RunThrough(point, colour);
        if (run == last && acceptable(run))
            steady = run;
        last = run;
        return steady != 0;
    });
    if (steady == 0)
        std::printf("the last reading: %d pixels\n", last);
    return steady;
}

const char* Probe(PROCESS_INFORMATION& viewer, COLORREF pond)
{
    if (WaitForInputIdle(viewer.hProcess, kDeadlineMs) != 0)
        return "the viewer never waited for input";
    HWND frame = nullptr;
    HWND scrollee = nullptr;
    WaitFor([&] {
        frame = VisibleWindowOf(viewer.dwProcessId);
        scrollee = GetDlgItem(GetWindow(frame, GW_CHILD), Tavo_WiScrollWnd::ScrolleeId);
        return scrollee != nullptr;
    });
    if (scrollee == nullptr)
        return "no drawing window showed";

    RECT client = {};
    GetClientRect(scrollee, &client);
    POINT centre = {client.right / 2, client.bottom / 2};
    ClientToScreen(scrollee, &centre);
    const int before = SteadyRun(centre, pond, [](int run) { return run > 0; });
    std::printf("the pond in the middle of the view: %d pixels across\n", before);
    if (before == 0)
        return "the middle of the view never showed the pond";

    SetCursorPos(centre.x, centre.y);
    PostMessageA(scrollee, WM_MOUSEWHEEL, MAKEWPARAM(0, kWheelNotches * WHEEL_DELTA), MAKELPARAM(centre.x, centre.y));
    const int after = SteadyRun(centre, pond, [&](int run) {
        return run >= kLeastRatio * before && run <= kMostRatio * before;
    });
    std::printf("after %d wheel notches in: %d pixels across\n", kWheelNotches, after);
    if (after == 0)
        return "the wheel did not double the pond";

    PostMessageA(frame, WM_CLOSE, 0, 0);
    DWORD status = STILL_ACTIVE;
    if (WaitForSingleObject(viewer.hProcess, kDeadlineMs) != WAIT_OBJECT_0)
        return "the viewer did not end when its window was closed";
    GetExitCodeProcess(viewer.hProcess, &status);
    return status == 0 ? nullptr : "the viewer ended with a failure status";
}

} // namespace

int main(int argc, char** argv)
{
    if (argc != 2) {
        std::fprintf(stderr, "usage: consumer_probe <viewer.exe>\n");
        return 2;
    }
    Tavo_WiLibrary::Initialize();
    Tavo_WiPalette* palette = Tavo_WiLibrary::GetPalette();
    const COLORREF pond = palette->GetWin32Color(palette->GetUserNamedColor("blue", 0), false);

    STARTUPINFOA startup = {};
    startup.cb = sizeof(startup);
    PROCESS_INFORMATION viewer = {};
    std::string commandLine = std::string("\"") + argv[1] + "\"";
    const char* failure = "the viewer did not start";
    if (CreateProcessA(argv[1], commandLine.data(), nullptr, nullptr, FALSE, 0, nullptr, nullptr, &startup, &viewer)) {
        failure = Probe(viewer, pond);
        if (WaitForSingleObject(viewer.hProcess, 0) == WAIT_TIMEOUT)
            TerminateProcess(viewer.hProcess, 1);
        CloseHandle(viewer.hThread);
        CloseHandle(viewer.hProcess);
    }
    Tavo_WiLibrary::Terminate(false);
    std::printf("%s%s\n", failure ? "FAILED: " : "the viewer works", failure ? failure : "");
    return failure ? 1 : 0;
}
