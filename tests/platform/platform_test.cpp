// The platform every other test stands on: a real window on the virtual
// display, GDI drawing into a DIB section, and the default printer that the
// print dialog hands out. If these fail, scripts/wine-run did not prepare the
// environment.
#include <windows.h>
#include <commdlg.h>
#include <gtest/gtest.h>

#include <cstdio>
#include <string>

namespace {

LRESULT CALLBACK CountingProc(HWND hwnd, UINT msg, WPARAM wParam, LPARAM lParam)
{
    if (msg == WM_CREATE)
        SetWindowLongPtrA(hwnd, GWLP_USERDATA, 1);
    return DefWindowProcA(hwnd, msg, wParam, lParam);
}

TEST(VirtualDisplay, HasTheConfiguredScreen)
{
    EXPECT_EQ(GetSystemMetrics(SM_CXSCREEN), 1280);
    EXPECT_EQ(GetSystemMetrics(SM_CYSCREEN), 1024);
    HDC screen = GetDC(nullptr);
    EXPECT_EQ(GetDeviceCaps(screen, BITSPIXEL), 32);
    ReleaseDC(nullptr, screen);
}

TEST(VirtualDisplay, RealWindowIsCreatedShownAndDestroyed)
{
    WNDCLASSA wc = {};
    wc.lpfnWndProc = CountingProc;
    wc.hInstance = GetModuleHandleA(nullptr);
    wc.lpszClassName = "PlatformTestWindow";
    ASSERT_NE(RegisterClassA(&wc), 0);

    HWND hwnd = CreateWindowA(wc.lpszClassName, "platform", WS_OVERLAPPEDWINDOW, 100, 120, 300, 200,
                              nullptr, nullptr, wc.hInstance, nullptr);
    ASSERT_NE(hwnd, nullptr);
    EXPECT_EQ(GetWindowLongPtrA(hwnd, GWLP_USERDATA), 1) << "WM_CREATE reached the window procedure";
    ShowWindow(hwnd, SW_SHOW);
    EXPECT_TRUE(IsWindowVisible(hwnd));

    RECT r;
    ASSERT_TRUE(GetWindowRect(hwnd, &r));
    EXPECT_EQ(r.left, 100);
    EXPECT_EQ(r.top, 120);
    EXPECT_EQ(r.right - r.left, 300);
    EXPECT_EQ(r.bottom - r.top, 200);

    EXPECT_TRUE(DestroyWindow(hwnd));
    EXPECT_FALSE(IsWindow(hwnd));
    UnregisterClassA(wc.lpszClassName, wc.hInstance);
}

TEST(DibSection, GdiDrawingIsReadBackFromTheBits)
{
    BITMAPINFO bi = {};
    bi.bmiHeader.biSize = sizeof(bi.bmiHeader);
    bi.bmiHeader.biWidth = 16;
    bi.bmiHeader.biHeight = -16; // top-down: row 0 is the top
    bi.bmiHeader.biPlanes = 1;
    bi.bmiHeader.biBitCount = 32;
    bi.bmiHeader.biCompression = BI_RGB;
    void* bits = nullptr;
    HBITMAP dib = CreateDIBSection(nullptr, &bi, DIB_RGB_COLORS, &bits, nullptr, 0);
    ASSERT_NE(dib, nullptr);
    HDC dc = CreateCompatibleDC(nullptr);
    HGDIOBJ old = SelectObject(dc, dib);

    RECT all = {0, 0, 16, 16};
    HBRUSH white = static_cast<HBRUSH>(GetStockObject(WHITE_BRUSH));
    FillRect(dc, &all, white);
    SetPixel(dc, 3, 5, RGB(255, 0, 0));
    GdiFlush();

    const DWORD* px = static_cast<const DWORD*>(bits);
    EXPECT_EQ(px[5 * 16 + 3] & 0xFFFFFF, 0xFF0000u) << "red, as 0x00RRGGBB in a 32-bit DIB";
    EXPECT_EQ(px[0] & 0xFFFFFF, 0xFFFFFFu);
    EXPECT_EQ(px[5 * 16 + 4] & 0xFFFFFF, 0xFFFFFFu);

    SelectObject(dc, old);
    DeleteDC(dc);
    DeleteObject(dib);
}

struct DefaultPrinter {
    HDC dc = nullptr;
    HGLOBAL devMode = nullptr;
    HGLOBAL devNames = nullptr;

    DefaultPrinter()
    {
        PRINTDLGA pd = {};
        pd.lStructSize = sizeof(pd);
        pd.Flags = PD_RETURNDEFAULT | PD_RETURNDC;
        if (PrintDlgA(&pd)) {
            dc = pd.hDC;
            devMode = pd.hDevMode;
            devNames = pd.hDevNames;
        }
    }
    ~DefaultPrinter()
    {
        if (dc)
            DeleteDC(dc);
        if (devMode)
            GlobalFree(devMode);
        if (devNames)
            GlobalFree(devNames);
    }
};

TEST(DefaultPrinter, PrintDialogReturnsARealPrinterDC)
{
    DefaultPrinter printer;
    ASSERT_NE(printer.dc, nullptr) << "PrintDlg(PD_RETURNDEFAULT | PD_RETURNDC) gave no DC; error "
                                   << CommDlgExtendedError();
    EXPECT_EQ(GetDeviceCaps(printer.dc, TECHNOLOGY), DT_RASPRINTER);
    const int dpiX = GetDeviceCaps(printer.dc, LOGPIXELSX);
    const int dpiY = GetDeviceCaps(printer.dc, LOGPIXELSY);
    EXPECT_EQ(dpiX, 300);
    EXPECT_EQ(dpiY, 300);

    // An A4 page, less its unprintable margins, at 300 dpi: about 8 by 11 inches.
    const int width = GetDeviceCaps(printer.dc, HORZRES);
    const int height = GetDeviceCaps(printer.dc, VERTRES);
    EXPECT_GT(width, 7 * dpiX);
    EXPECT_LT(width, 9 * dpiX);
    EXPECT_GT(height, 10 * dpiY);
    EXPECT_LT(height, 12 * dpiY);
    EXPECT_EQ(GetDeviceCaps(printer.dc, PHYSICALWIDTH), 2479);
    EXPECT_EQ(GetDeviceCaps(printer.dc, PHYSICALHEIGHT), 3508);

    TEXTMETRICA tm = {};
    ASSERT_TRUE(GetTextMetricsA(printer.dc, &tm));
    EXPECT_GT(tm.tmHeight, 20) << "printer fonts are measured in printer pixels";
}

TEST(DefaultPrinter, PrintsAPostScriptPageToAFile)
{
    DefaultPrinter printer;
    ASSERT_NE(printer.dc, nullptr);

    char dir[MAX_PATH];
    ASSERT_GT(GetTempPathA(MAX_PATH, dir), 0u);
    const std::string output = std::string(dir) + "platform_test_page.ps";
    DeleteFileA(output.c_str());

    DOCINFOA doc = {};
    doc.cbSize = sizeof(doc);
    doc.lpszDocName = "platform test";
    doc.lpszOutput = output.c_str();
    ASSERT_GT(StartDocA(printer.dc, &doc), 0);
    ASSERT_GT(StartPage(printer.dc), 0);
    Rectangle(printer.dc, 100, 100, 1000, 600);
    TextOutA(printer.dc, 120, 700, "platform test", 13);
    ASSERT_GT(EndPage(printer.dc), 0);
    ASSERT_GT(EndDoc(printer.dc), 0);

    FILE* f = std::fopen(output.c_str(), "rb");
    ASSERT_NE(f, nullptr) << output;
    char head[5] = {};
    const size_t got = std::fread(head, 1, 4, f);
    std::fclose(f);
    EXPECT_EQ(got, 4u);
    EXPECT_STREQ(head, "%!PS");
    DeleteFileA(output.c_str());
}

} // namespace
