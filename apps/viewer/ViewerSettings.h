// ViewerSettings: how the viewer binds drawings to its drawing window and how
// far each zoom gesture goes. Zoom levels are the drawing window's: five per
// doubling of the scale (Tavo_WiDrawWnd::ZoomLevelsPerDoubling).
#pragma once

#include <windows.h>

namespace ViewerSettings {

// Twelve doublings in: a detail of a 3000 mm drawing shown at about 1 mm a
// screen centimetre still has room to grow.
constexpr int MaxZoomLevel = 60;
// The fitted drawing keeps this much of its size free on every side (percent).
constexpr int ZeroLevelExpansionPercent = 3;
// Copied into every on-screen surface; the GDI surface reads none.
constexpr int SurfaceOption = 3;
// No smallest view at the largest zoom.
constexpr unsigned int NoMinimumViewWidth = 0;
constexpr unsigned int NoMinimumViewHeight = 0;

// Zoom steps: a wheel notch and the + and - keys go two levels (about 1.3
// times), a double click five (twice the scale).
constexpr int LevelsPerWheelNotch = 2;
constexpr int LevelsPerKey = 2;
constexpr int LevelsPerDoubleClick = 5;

// What the view shows around the drawing.
constexpr COLORREF Background = RGB(255, 255, 255);

// The frame's initial size, in pixels.
constexpr int FrameWidth = 1024;
constexpr int FrameHeight = 768;

} // namespace ViewerSettings
