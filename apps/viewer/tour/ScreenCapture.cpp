#include "ScreenCapture.h"

#include "DibCanvas.h"
#include "PngWriter.h"

#include <algorithm>

namespace ScreenCapture {

std::unique_ptr<DibCanvas> Grab(const RECT& area)
{
    const int width = area.right - area.left;
    const int height = area.bottom - area.top;
    auto canvas = std::make_unique<DibCanvas>(width, height);
    if (!canvas->IsValid())
        return nullptr;
    const HDC screen = ::GetDC(nullptr);
    const BOOL copied = ::BitBlt(canvas->GetDC(), 0, 0, width, height, screen, area.left, area.top, SRCCOPY);
    ::ReleaseDC(nullptr, screen);
    return copied ? std::move(canvas) : nullptr;
}

namespace {

// Draws the pointer's current shape at its place into a canvas showing area.
void DrawPointer(DibCanvas& canvas, const RECT& area)
{
    CURSORINFO pointer = {};
    pointer.cbSize = sizeof(pointer);
    if (!::GetCursorInfo(&pointer) || !(pointer.flags & CURSOR_SHOWING) || !pointer.hCursor)
        return;
    ICONINFO shape = {};
    if (!::GetIconInfo(pointer.hCursor, &shape))
        return;
    // GetIconInfo hands out copies of the shape's bitmaps.
    if (shape.hbmMask)
        ::DeleteObject(shape.hbmMask);
    if (shape.hbmColor)
        ::DeleteObject(shape.hbmColor);
    ::DrawIconEx(canvas.GetDC(), pointer.ptScreenPos.x - area.left - static_cast<int>(shape.xHotspot),
                 pointer.ptScreenPos.y - area.top - static_cast<int>(shape.yHotspot), pointer.hCursor, 0, 0, 0,
                 nullptr, DI_NORMAL);
}

} // namespace

std::string SavePng(const RECT& area, const std::string& path)
{
    const std::unique_ptr<DibCanvas> canvas = Grab(area);
    if (!canvas)
        return "could not copy the screen";
    DrawPointer(*canvas, area);
    return WritePng(*canvas, path);
}

RECT Around(HWND first, HWND second)
{
    RECT area = {};
    ::GetWindowRect(first, &area);
    if (second) {
        RECT other = {};
        ::GetWindowRect(second, &other);
        ::UnionRect(&area, &area, &other);
    }
    // Only what lies on the screen can be copied.
    const RECT screen = {0, 0, ::GetSystemMetrics(SM_CXSCREEN), ::GetSystemMetrics(SM_CYSCREEN)};
    ::IntersectRect(&area, &area, &screen);
    return area;
}

bool FindDrawnPoint(HWND window, POINT target, COLORREF background, POINT& found)
{
    RECT client = {};
    ::GetClientRect(window, &client);
    ::MapWindowPoints(window, nullptr, reinterpret_cast<POINT*>(&client), 2);
    const std::unique_ptr<DibCanvas> canvas = Grab(client);
    if (!canvas)
        return false;
    const int cx = std::clamp<int>(target.x - client.left, 0, canvas->GetWidth() - 1);
    const int cy = std::clamp<int>(target.y - client.top, 0, canvas->GetHeight() - 1);
    const int farthest = std::max(canvas->GetWidth(), canvas->GetHeight());
    for (int r = 0; r < farthest; ++r) {
        for (int dy = -r; dy <= r; ++dy) {
            for (int dx = -r; dx <= r; ++dx) {
                // Only the ring at distance r: the inside was searched before.
                if (std::max(std::abs(dx), std::abs(dy)) != r)
                    continue;
                const COLORREF pixel = canvas->GetPixel(cx + dx, cy + dy);
                if (pixel == CLR_INVALID || pixel == background)
                    continue;
                found = {client.left + cx + dx, client.top + cy + dy};
                return true;
            }
        }
    }
    return false;
}

} // namespace ScreenCapture
