// ScreenCapture: the tour's pictures, copied from the screen as a person
// sees it (windows, pop-ups, the data tip, the rubber rectangle), and a look
// at the screen for something drawn to point at.
#pragma once

#include <windows.h>

#include <memory>
#include <string>

class DibCanvas;

namespace ScreenCapture {

// The screen's pixels inside area (screen coordinates), or null when GDI
// refused.
std::unique_ptr<DibCanvas> Grab(const RECT& area);
// Writes the screen's pixels inside area to a PNG file, with the mouse
// pointer drawn where it is (the screen's pixels never hold it); empty on
// success, else why not.
std::string SavePng(const RECT& area, const std::string& path);
// The screen rectangle that holds both windows (second may be null).
RECT Around(HWND first, HWND second);

// The screen point nearest to target, within window's client area, whose
// pixel is not background, searched in growing squares; false when the
// window shows nothing else.
bool FindDrawnPoint(HWND window, POINT target, COLORREF background, POINT& found);

} // namespace ScreenCapture
