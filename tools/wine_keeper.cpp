// Keeps the Wine desktop process of the private prefix alive between test
// programs. Without a long-lived GUI process the desktop shuts down after each
// program and the next one pays about a second to start it again.
//
// It owns one hidden window and pumps messages until it is sent WM_CLOSE or
// the wineserver goes away.
//
//   wine_keeper [ready file]
//
// Once its window exists (so Wine's start-up services run and the desktop is
// up) it creates the ready file, if one is named: the runner waits for it
// before it starts any other program, so that no test program becomes the
// one that starts Wine's services with the test's streams.
#include <windows.h>

static LRESULT CALLBACK KeeperProc(HWND hwnd, UINT msg, WPARAM wParam, LPARAM lParam)
{
    if (msg == WM_DESTROY) {
        PostQuitMessage(0);
        return 0;
    }
    return DefWindowProcA(hwnd, msg, wParam, lParam);
}

static void SignalReady(const char* readyFile)
{
    if (!readyFile || !*readyFile)
        return;
    HANDLE file = CreateFileA(readyFile, GENERIC_WRITE, 0, nullptr, CREATE_ALWAYS, FILE_ATTRIBUTE_NORMAL, nullptr);
    if (file != INVALID_HANDLE_VALUE)
        CloseHandle(file);
}

int WINAPI WinMain(HINSTANCE instance, HINSTANCE, LPSTR commandLine, int)
{
    WNDCLASSA wc = {};
    wc.lpfnWndProc = KeeperProc;
    wc.hInstance = instance;
    wc.lpszClassName = "TavoWineKeeper";
    if (!RegisterClassA(&wc))
        return 1;
    if (!CreateWindowA(wc.lpszClassName, "Tavo Wine keeper", WS_OVERLAPPED, 0, 0, 1, 1,
                       nullptr, nullptr, instance, nullptr))
        return 1;
    SignalReady(commandLine);

    MSG msg;
    while (GetMessageA(&msg, nullptr, 0, 0) > 0)
        DispatchMessageA(&msg);
    return 0;
}
