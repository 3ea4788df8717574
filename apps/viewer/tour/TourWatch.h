// TourWatch: what the tour's driver thread sees of the viewer's thread, by
// the same means a test or an accessibility tool would use: the windows'
// texts, the thread's capture, its dialogs. Every wait has a deadline.
#pragma once

#include <windows.h>

#include <functional>
#include <string>

namespace TourWatch {

// How long the tour waits for anything the viewer should do at once.
constexpr DWORD PromptMs = 5000;

// Polls condition until it holds or timeoutMs pass; returns it.
bool WaitFor(const std::function<bool()>& condition, DWORD timeoutMs = PromptMs);
// Waits for the given time, for the real timers of the viewer.
void Pause(DWORD ms);

// The text of a window, and of a status bar's part.
std::string WindowText(HWND window);
std::string StatusPart(HWND statusBar, int part);

// The window holding thread's mouse capture; null when none does.
HWND CaptureOf(DWORD thread);
// The first visible dialog box of thread; null when none shows.
HWND VisibleDialogOf(DWORD thread);
// The centre of a window on the screen.
POINT CentreOf(HWND window);

// Returns once the thread of frame has handled every message sent before,
// and, with repaint, has painted every window of frame and of extra (a
// pop-up; may be null) that waited for a paint.
void Settle(HWND frame, HWND extra, bool repaint);

} // namespace TourWatch
