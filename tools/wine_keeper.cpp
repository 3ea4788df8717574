// Keeps the Wine desktop process of the private prefix alive between test
// programs. Without a long-lived GUI process the desktop shuts down after each
// program and the next one pays about a second to start it again.
//
// It owns one hidden window and pumps messages until it is sent WM_CLOSE or
// the wineserver goes away.
#include <windows.h>

static LRESULT CALLBACK KeeperProc(HWND hwnd, UINT msg, WPARAM wParam, LPARAM lParam)
{
    if (msg == WM_DESTROY) {
        PostQuitMessage(0);
        return 0;
    }
    return DefWindowProcA(hwnd, msg, wParam, lParam);
}

int WINAPI WinMain(HINSTANCE instance, HINSTANCE, LPSTR, int)
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

    MSG msg;
    while (GetMessageA(&msg, nullptr, 0, 0) > 0)
        DispatchMessageA(&msg);
    return 0;
}
