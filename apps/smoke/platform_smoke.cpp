// Opens a window on the display and reports what the platform gave the
// program: screen, colour depth, and the default printer with its page.
// Exit status 0 when a window and a printer DC were both obtained.
#include <windows.h>
#include <commdlg.h>

#include <cstdio>

static int ReportScreen()
{
    HWND hwnd = CreateWindowA("STATIC", "libTavo_Windows platform smoke", WS_OVERLAPPEDWINDOW | WS_VISIBLE,
                              CW_USEDEFAULT, CW_USEDEFAULT, 400, 300, nullptr, nullptr,
                              GetModuleHandleA(nullptr), nullptr);
    if (!hwnd) {
        std::printf("window:          could not be created (error %lu)\n", GetLastError());
        return 1;
    }
    HDC screen = GetDC(hwnd);
    std::printf("screen:          %d x %d pixels, %d bits per pixel, %d dpi\n", GetSystemMetrics(SM_CXSCREEN),
                GetSystemMetrics(SM_CYSCREEN), GetDeviceCaps(screen, BITSPIXEL), GetDeviceCaps(screen, LOGPIXELSX));
    ReleaseDC(hwnd, screen);
    RECT client;
    GetClientRect(hwnd, &client);
    std::printf("window:          created, client area %ld x %ld\n", client.right, client.bottom);
    DestroyWindow(hwnd);
    return 0;
}

static int ReportPrinter()
{
    PRINTDLGA pd = {};
    pd.lStructSize = sizeof(pd);
    pd.Flags = PD_RETURNDEFAULT | PD_RETURNDC;
    if (!PrintDlgA(&pd) || !pd.hDC) {
        std::printf("default printer: none (print dialog error %lu)\n", CommDlgExtendedError());
        return 1;
    }
    const char* name = "?";
    DEVNAMES* names = pd.hDevNames ? static_cast<DEVNAMES*>(GlobalLock(pd.hDevNames)) : nullptr;
    if (names)
        name = reinterpret_cast<const char*>(names) + names->wDeviceOffset;
    HDC dc = pd.hDC;
    const int dpiX = GetDeviceCaps(dc, LOGPIXELSX), dpiY = GetDeviceCaps(dc, LOGPIXELSY);
    const int pageW = GetDeviceCaps(dc, PHYSICALWIDTH), pageH = GetDeviceCaps(dc, PHYSICALHEIGHT);
    TEXTMETRICA tm = {};
    GetTextMetricsA(dc, &tm);
    std::printf("default printer: %s\n", name);
    std::printf("  page:          %d x %d pixels (%.1f x %.1f mm)\n", pageW, pageH, pageW * 25.4 / dpiX,
                pageH * 25.4 / dpiY);
    std::printf("  printable:     %d x %d pixels at offset (%d, %d)\n", GetDeviceCaps(dc, HORZRES),
                GetDeviceCaps(dc, VERTRES), GetDeviceCaps(dc, PHYSICALOFFSETX), GetDeviceCaps(dc, PHYSICALOFFSETY));
    std::printf("  resolution:    %d x %d dpi, %d colours\n", dpiX, dpiY, GetDeviceCaps(dc, NUMCOLORS));
    std::printf("  default font:  %ld pixels high\n", tm.tmHeight);
    if (names)
        GlobalUnlock(pd.hDevNames);
    DeleteDC(dc);
    GlobalFree(pd.hDevMode);
    GlobalFree(pd.hDevNames);
    return 0;
}

int main()
{
    const int screenFailed = ReportScreen();
    const int printerFailed = ReportPrinter();
    return screenFailed || printerFailed ? 1 : 0;
}
