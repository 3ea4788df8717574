// Shared helpers of the viewer tests: a shown viewer frame with a drawing of
// known items, conversions between its world and the screen, real input with
// explicit message times, and the timers of drags and data tips driven by
// sending their messages.
#pragma once

#include "scroll_test_support.h"

#include "ViewerFrame.h"

#include <gtest/gtest.h>

#include <memory>
#include <string>

namespace ViewerTest {

// 1000 x 800 world units, in drawing units (scale 1):
//   layer "walls":  a filled red rectangle (100, 100)-(300, 300)
//   layer "pipes":  a line (400, 150)-(900, 150); a hollow blue circle of
//                   radius 100 about (650, 500)
//   layer "labels": the text "valve" at (700, 700), 40 units high
//   layer "frame":  a hollow rectangle (0, 0)-(1000, 800)
std::unique_ptr<ViewerDocument> MakeTestDocument();

// A file in the system's temporary folder, deleted when the object goes.
class TempFile {
public:
    TempFile(const std::string& name, const std::string& content);
    ~TempFile();
    TempFile(const TempFile&) = delete;
    TempFile& operator=(const TempFile&) = delete;
    const std::string& Path() const { return m_path; }

private:
    std::string m_path;
};

// A viewer frame at a fixed place on the screen, active, showing the test
// document. Each test gets a new one.
class ViewerFixture : public ::testing::Test {
protected:
    static constexpr int FrameX = 60;
    static constexpr int FrameY = 40;
    static constexpr int FrameWidth = 800;
    static constexpr int FrameHeight = 600;

    void SetUp() override;
    void TearDown() override;

    DrawingView& View() { return frame.GetView(); }
    HWND Scrollee() { return View().GetScrollee()->GetSafeHwnd(); }
    std::string Status(ViewerStatusBar::Part part) { return frame.GetStatusBar().GetPartText(part); }

    // The scrollee's client point that shows a world point, and back.
    CPoint ClientOf(int x, int y);
    POINT ScreenOf(int x, int y);
    Tavo_GrWPoint WorldAt(const CPoint& client);

    // Mouse input at a screen point, base + offset milliseconds, handled at
    // once (or only queued, for a loop that takes it later).
    void Mouse(DWORD flags, POINT screen, DWORD offset, DWORD data = 0, bool handle = true);
    void Click(POINT screen, DWORD offset);
    // A key pressed and released, with a modifier key held around it.
    void Key(WORD virtualKey, WORD modifier = 0);
    void KeyDown(WORD virtualKey);
    void KeyUp(WORD virtualKey);
    // The left button pressed at a screen point with Shift held for the press.
    void ShiftPress(POINT screen, DWORD offset);
    // The hold timer of the scrollee runs out: a held button becomes a drag.
    void FireHoldTimer();
    // The pointer has rested: the parked cursor monitor's timer runs out.
    void FireParkTimer();

    ViewerFrame frame;
    DWORD base = 0;
};

} // namespace ViewerTest
