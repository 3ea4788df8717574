#include "drawwnd_test_support.h"

#include "Tavo_WiLibrary.h"

namespace DrawWndTest {

namespace {

constexpr UINT DrawWndId = 42;

// The core is initialised once for the whole test program, as an
// application does at start.
struct LibraryInitialisation
{
    LibraryInitialisation() { Tavo_WiLibrary::Initialize(); }
};

}  // namespace

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

}  // namespace DrawWndTest
