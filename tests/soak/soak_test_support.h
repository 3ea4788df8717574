// Shared helpers of the soak suite's test cases: letting a window settle,
// reading back what its view shows, and the colours the drawings use.
#pragma once

#include "soak_window.h"

#include "DibCanvas.h"
#include "scroll_test_support.h"

#include "Tavo_WiLibrary.h"
#include "Tavo_WiPalette.h"

#include <memory>

namespace SoakTest {

// Dispatches what is pending, paints every window of the host and lets the
// framework free its temporaries, as an application's idle time does.
inline void Settle(SoakHost& host)
{
    ScrollTest::PumpPending();
    ::RedrawWindow(host.Handle(), nullptr, nullptr, RDW_UPDATENOW | RDW_ALLCHILDREN);
    ScrollTest::PumpPending();
    AfxLockTempMaps();
    AfxUnlockTempMaps(TRUE);
}

// The scrollee's client area as it is on the screen.
inline std::unique_ptr<DibCanvas> Capture(SoakHost& host)
{
    CRect client(0, 0, 0, 0);
    ::GetClientRect(host.Scrollee(), &client);
    auto canvas = std::make_unique<DibCanvas>(client.Width(), client.Height());
    const HDC screen = ::GetDC(host.Scrollee());
    ::BitBlt(canvas->GetDC(), 0, 0, client.Width(), client.Height(), screen, 0, 0, SRCCOPY);
    ::ReleaseDC(host.Scrollee(), screen);
    return canvas;
}

inline COLORREF Colour(char index)
{
    return Tavo_WiLibrary::GetPalette()->GetWin32Color(index, false);
}

// The scrollee's background, where nothing is drawn.
constexpr COLORREF Background = RGB(0, 0, 0);

} // namespace SoakTest
