// framework_test_support.h - helpers shared by the framework's tests.
#ifndef TAVO_TESTS_FRAMEWORK_SUPPORT_H
#define TAVO_TESTS_FRAMEWORK_SUPPORT_H

#include <afxwin.h>

namespace framework_test {

// Dispatches every message already waiting for this thread (posted, sent,
// paint) and returns without waiting for more.
inline void DispatchPendingMessages()
{
  MSG msg;
  while (::PeekMessageA(&msg, NULL, 0, 0, PM_REMOVE)) {
    ::TranslateMessage(&msg);
    ::DispatchMessageA(&msg);
  }
}

// A rectangle for test windows, away from the screen's corner.
inline CRect TestWindowRect() { return CRect(100, 100, 400, 300); }

}  // namespace framework_test

#endif
