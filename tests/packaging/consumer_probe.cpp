// consumer_probe: runs the viewer example, built against a fresh install of
// the library, and checks on the screen what a user would see: the window
// shows its drawing (the pond, a blue disc at the drawing's centre, under the
// middle of the view at the zero level), a wheel turn of five notches over
// the pond doubles it, and closing the window ends the program with status 0.
//
//   consumer_probe <viewer.exe>
//
// Prints what it measured; exits 0 when every check held, 1 otherwise.
#include "Tavo_WiLibrary.h"
#include "Tavo_WiPalette.h"

#include <windows.h>

#include <cstdio>
#include <functional>
#include <string>

namespace {

// How long the viewer may take for each step. Generous: the deadlines only
// bound a failing run, a passing one moves on as soon as a check holds.
constexpr DWORD kStartDeadlineMs = 30000;
constexpr DWORD kScreenDeadlineMs = 20000;
constexpr DWORD kExitDeadlineMs = 20000;
constexpr DWORD kPollPeriodMs = 20;
// Five levels double the scale; the viewer zooms one level per notch.
constexpr int kWheelNotches = 5;
constexpr double kZoomRatio = 2.0;
// The disc's width in whole pixels after doubling may differ from twice the
// old one by the rounding of both.
constexpr double kRatioTolerance = 0.05;

bool Fail(const char* what)
{
    std::printf("FAILED: %s\n", what);
    return false;
}

// Polls condition until it holds or the deadline passes; returns whether it held.
bool WaitFor(DWORD deadlineMs, const std::function<bool()>& condition)
{
    const DWORD start = GetTickCount();
    for (;;) {
        if (condition())
            return true;
        if (GetTickCount() - start >= deadlineMs)
            return false;
        Sleep(kPollPeriodMs);
    }
}

// The viewer's process, ended by force if the probe gives up on it.
class Program
{
public:
    explicit Program(const std::string& path)
    {
        STARTUPINFOA startup = {};
        startup.cb = sizeof(startup);
        std::string commandLine = "\"" + path + "\"";
        m_started = CreateProcessA(path.c_str(), commandLine.data(), nullptr, nullptr, FALSE, 0, nullptr, nullptr,
                                   &startup, &m_process) != FALSE;
    }
    ~Program()
    {
        if (!m_started)
            return;
        if (WaitForSingleObject(m_process.hProcess, 0) == WAIT_TIMEOUT)
            TerminateProcess(m_process.hProcess, 1);
        CloseHandle(m_process.hThread);
        CloseHandle(m_process.hProcess);
    }
    Program(const Program&) = delete;
    Program& operator=(const Program&) = delete;

    bool Started() const { return m_started; }
    HANDLE Process() const { return m_process.hProcess; }
    DWORD Id() const { return m_process.dwProcessId; }

private:
    PROCESS_INFORMATION m_process = {};
    bool m_started = false;
};

// The first visible top-level window of a process.
HWND FindMainWindow(DWORD processId)
{
    struct Search { DWORD processId; HWND found; } search = {processId, nullptr};
    EnumWindows(
        [](HWND window, LPARAM param) -> BOOL {
            auto* s = reinterpret_cast<Search*>(param);
            DWORD owner = 0;
            GetWindowThreadProcessId(window, &owner);
            if (owner != s->processId || !IsWindowVisible(window))
                return TRUE;
            s->found = window;
            return FALSE;
        },
        reinterpret_cast<LPARAM>(&search));
    return search.found;
}

// The first descendant of a window with the given class name.
HWND FindDescendant(HWND parent, const char* className)
{
    struct Search { const char* className; HWND found; } search = {className, nullptr};
    EnumChildWindows(
        parent,
        [](HWND window, LPARAM param) -> BOOL {
            auto* s = reinterpret_cast<Search*>(param);
            char name[64] = {};
            GetClassNameA(window, name, sizeof(name));
            if (lstrcmpA(name, s->className) != 0)
                return TRUE;
            s->found = window;
            return FALSE;
        },
        reinterpret_cast<LPARAM>(&search));
    return search.found;
}

// The centre of a window's client area, in screen coordinates.
POINT ClientCentreOnScreen(HWND window)
{
    RECT client = {};
    GetClientRect(window, &client);
    POINT centre = {client.right / 2, client.bottom / 2};
    ClientToScreen(window, &centre);
    return centre;
}

// The length of the run of pixels of one colour through a screen point along
// its row, read from the screen across the window's width; 0 when the point
// itself has another colour.
int ColourRunThrough(HWND window, POINT point, COLORREF colour)
{
    RECT rect = {};
    GetWindowRect(window, &rect);
    const int width = rect.right - rect.left;
    if (width <= 0)
        return 0;

    BITMAPINFO info = {};
    info.bmiHeader.biSize = sizeof(info.bmiHeader);
    info.bmiHeader.biWidth = width;
    info.bmiHeader.biHeight = 1;
    info.bmiHeader.biPlanes = 1;
    info.bmiHeader.biBitCount = 32;
    info.bmiHeader.biCompression = BI_RGB;
    void* bits = nullptr;
    HDC screen = GetDC(nullptr);
    HDC memory = CreateCompatibleDC(screen);
    HBITMAP row = CreateDIBSection(screen, &info, DIB_RGB_COLORS, &bits, nullptr, 0);
    HGDIOBJ previous = SelectObject(memory, row);
    BitBlt(memory, 0, 0, width, 1, screen, rect.left, point.y, SRCCOPY);
    GdiFlush();

    // DIB pixels are 0x00RRGGBB, COLORREF is 0x00BBGGRR.
    const DWORD wanted = (GetRValue(colour) << 16) | (GetGValue(colour) << 8) | GetBValue(colour);
    const DWORD* pixels = static_cast<const DWORD*>(bits);
    auto matches = [&](int x) { return (pixels[x] & 0x00FFFFFF) == wanted; };
    const int x = point.x - rect.left;
    int run = 0;
    if (x >= 0 && x < width && matches(x)) {
        int left = x;
        int right = x;
        while (left > 0 && matches(left - 1))
            --left;
        while (right + 1 < width && matches(right + 1))
            ++right;
        run = right - left + 1;
    }

    SelectObject(memory, previous);
    DeleteObject(row);
    DeleteDC(memory);
    ReleaseDC(nullptr, screen);
    return run;
}

// The run once two readings in a row agree (a paint may still be reaching
// the screen on the first); 0 when it never did before the deadline.
int SteadyRun(HWND window, POINT point, COLORREF colour, const std::function<bool(int)>& acceptable)
{
    int last = -1;
    int steady = 0;
    WaitFor(kScreenDeadlineMs, [&] {
        const int run = ColourRunThrough(window, point, colour);
        if (run == last && acceptable(run))
            steady = run;
        last = run;
        return steady != 0;
    });
    return steady;
}

bool Probe(const std::string& viewerPath)
{
    Tavo_WiPalette* palette = Tavo_WiLibrary::GetPalette();
    const COLORREF pondColour = palette->GetWin32Color(palette->GetUserNamedColor("blue", 0), false);

    Program viewer(viewerPath);
    if (!viewer.Started())
        return Fail("the viewer did not start");
    if (WaitForInputIdle(viewer.Process(), kStartDeadlineMs) != 0)
        return Fail("the viewer never waited for input");
    HWND frame = nullptr;
    HWND scrollee = nullptr;
    WaitFor(kStartDeadlineMs, [&] {
        frame = FindMainWindow(viewer.Id());
        scrollee = frame != nullptr ? FindDescendant(frame, "Tavo_WiScrollee") : nullptr;
        return scrollee != nullptr;
    });
    if (scrollee == nullptr)
        return Fail("no drawing window showed");

    const POINT centre = ClientCentreOnScreen(scrollee);
    const int before = SteadyRun(scrollee, centre, pondColour, [](int run) { return run > 0; });
    std::printf("the pond under the middle of the view: %d pixels across\n", before);
    if (before == 0)
        return Fail("the middle of the view never showed the pond");

    SetCursorPos(centre.x, centre.y);
    PostMessageA(scrollee, WM_MOUSEWHEEL, MAKEWPARAM(0, kWheelNotches * WHEEL_DELTA), MAKELPARAM(centre.x, centre.y));
    const auto doubled = [&](int run) {
        const double ratio = static_cast<double>(run) / before;
        return ratio > kZoomRatio - kRatioTolerance * kZoomRatio && ratio < kZoomRatio + kRatioTolerance * kZoomRatio;
    };
    const int after = SteadyRun(scrollee, centre, pondColour, doubled);
    std::printf("after %d wheel notches in: %d pixels across\n", kWheelNotches,
                after != 0 ? after : ColourRunThrough(scrollee, centre, pondColour));
    if (after == 0)
        return Fail("the wheel did not double the pond");

    PostMessageA(frame, WM_CLOSE, 0, 0);
    if (WaitForSingleObject(viewer.Process(), kExitDeadlineMs) != WAIT_OBJECT_0)
        return Fail("the viewer did not end when its window was closed");
    DWORD status = 1;
    GetExitCodeProcess(viewer.Process(), &status);
    std::printf("the viewer ended with status %lu\n", static_cast<unsigned long>(status));
    return status == 0 || Fail("the viewer ended with a failure status");
}

}  // namespace

int main(int argc, char** argv)
{
    if (argc != 2) {
        std::fprintf(stderr, "usage: consumer_probe <viewer.exe>\n");
        return 2;
    }
    Tavo_WiLibrary::Initialize();
    const bool passed = Probe(argv[1]);
    Tavo_WiLibrary::Terminate(false);
    std::printf("%s\n", passed ? "the viewer works" : "the viewer failed");
    return passed ? 0 : 1;
}
