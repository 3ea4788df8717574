// framework_test_support.h - helpers shared by the framework's tests.
#ifndef TAVO_TESTS_FRAMEWORK_SUPPORT_H
#define TAVO_TESTS_FRAMEWORK_SUPPORT_H

#include <afxwin.h>

#include <gtest/gtest.h>

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

// Leaves no message and no temporary object behind for the next test.
class WindowTest : public ::testing::Test {
protected:
    void TearDown() override
    {
        DispatchPendingMessages();
        CWinThread().OnIdle(1);
    }
};

} // namespace framework_test

#endif
