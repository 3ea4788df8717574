#include "drawwnd_test_support.h"

#include "Tavo_WiLibrary.h"

#include <algorithm>

namespace DrawWndTest {

namespace {

constexpr UINT DrawWndId = 42;

// The core is initialised once for the whole test program, as an
// application does at start.
struct LibraryInitialisation {
    LibraryInitialisation() { Tavo_WiLibrary::Initialize(); }
};

} // namespace

HostedDrawWnd::HostedDrawWnd(const CRect& clientRect, const CRect& hostRect) : host(hostRect)
{
    static LibraryInitialisation initialised;
    wnd.Create(WS_CHILD | WS_VISIBLE, clientRect, host.Wnd(), DrawWndId);
    ScrollTest::PumpPending();
}

HostedDrawWnd::~HostedDrawWnd()
{
    wnd.DestroyWindow();
}

CSize HostedDrawWnd::ScrolleeSize()
{
    CRect client(0, 0, 0, 0);
    ::GetClientRect(Scrollee(), &client);
    return CSize(client.Width(), client.Height());
}

void AddFilledRect(Tavo_GrDrawing& drawing, const Tavo_GrWRect& rect, char colour)
{
    Tavo_GrDrawingBuilder build(drawing);
    build.BeginLayer("rect");
    build.SetAttr(Tavo_GrAttr(colour, 1));
    build.AddRect(rect.x1, rect.y1, rect.x2, rect.y2);
}

void PaintNow(HWND window)
{
    ::UpdateWindow(window);
    ScrollTest::PumpPending();
}

CRect PendingUpdate(HWND window)
{
    CRect box(0, 0, 0, 0);
    ::GetUpdateRect(window, &box, FALSE);
    return box;
}

ClientPicture Snapshot(HWND window)
{
    ClientPicture picture;
    CRect client(0, 0, 0, 0);
    ::GetClientRect(window, &client);
    picture.width = client.Width();
    picture.height = client.Height();
    if (picture.width <= 0 || picture.height <= 0)
        return picture;

    BITMAPINFO info = {};
    info.bmiHeader.biSize = sizeof info.bmiHeader;
    info.bmiHeader.biWidth = picture.width;
    info.bmiHeader.biHeight = -picture.height; // top-down rows
    info.bmiHeader.biPlanes = 1;
    info.bmiHeader.biBitCount = 32;
    info.bmiHeader.biCompression = BI_RGB;
    const HDC windowDc = ::GetDC(window);
    const HDC memoryDc = ::CreateCompatibleDC(windowDc);
    void* bits = nullptr;
    const HBITMAP bitmap = ::CreateDIBSection(memoryDc, &info, DIB_RGB_COLORS, &bits, nullptr, 0);
    const HGDIOBJ displaced = ::SelectObject(memoryDc, bitmap);
    ::BitBlt(memoryDc, 0, 0, picture.width, picture.height, windowDc, 0, 0, SRCCOPY);
    ::GdiFlush();
    const auto* pixels = static_cast<const unsigned int*>(bits);
    picture.pixels.assign(pixels, pixels + static_cast<size_t>(picture.width) * picture.height);
    for (unsigned int& pixel : picture.pixels)
        pixel &= 0xFFFFFF;
    ::SelectObject(memoryDc, displaced);
    ::DeleteObject(bitmap);
    ::DeleteDC(memoryDc);
    ::ReleaseDC(window, windowDc);
    return picture;
}

long DifferingPixels(const ClientPicture& a, const ClientPicture& b)
{
    if (a.width != b.width || a.height != b.height)
        return static_cast<long>(std::max(a.pixels.size(), b.pixels.size()));
    long differing = 0;
    for (size_t i = 0; i < a.pixels.size(); ++i)
        differing += a.pixels[i] != b.pixels[i] ? 1 : 0;
    return differing;
}

} // namespace DrawWndTest
