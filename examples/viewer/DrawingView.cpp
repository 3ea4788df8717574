#include "DrawingView.h"

#include <cstdlib>

namespace {

// How the drawing is bound: zoom up to 40 levels in (eight doublings), fit
// it with 5 % of its size to spare on every side, no least world size for
// the view at the largest zoom, and surface option 0 (the GDI surface reads
// none).
constexpr int kMaxZoomLevel = 40;
constexpr int kSurfaceOption = 0;
constexpr int kZeroLevelExpansionPercent = 5;
constexpr unsigned int kNoMinimumViewWidth = 0;
constexpr unsigned int kNoMinimumViewHeight = 0;
// What the view shows around the drawing.
constexpr COLORREF kBackground = RGB(255, 255, 255);

} // namespace

BEGIN_MESSAGE_MAP(DrawingView, Tavo_WiDrawWnd)
    ON_WM_MOUSEWHEEL()
END_MESSAGE_MAP()

BOOL DrawingView::CreateView(CWnd* parent, const CRect& rect, UINT id, Tavo_GrDrawing* drawing)
{
    if (!Create(WS_CHILD | WS_VISIBLE, rect, parent, id))
        return FALSE;
    GetScrollee()->SetBackgroundColor(kBackground);
    SetDrawingInfo(drawing, kMaxZoomLevel, kSurfaceOption, kZeroLevelExpansionPercent, kNoMinimumViewWidth,
                   kNoMinimumViewHeight);
    return TRUE;
}

Tavo_WiNativeWindowSurface* DrawingView::GetNativeWindowSurface()
{
    return &m_surface;
}

void DrawingView::OnDoubleClick(UINT, UINT, const Tavo_GrWRect&)
{
    ZoomWindow(Tavo_GrZoom::ZeroLevel, 0, Tavo_WiZoomCenter::AtViewCentre, 0, 0, false);
}

// The wheel message reaches the focused scrollee first, which leaves it to
// its parent, this window.
BOOL DrawingView::OnMouseWheel(UINT, short delta, CPoint)
{
    m_wheelRemainder += delta;
    const int notches = m_wheelRemainder / WHEEL_DELTA;
    m_wheelRemainder -= notches * WHEEL_DELTA;
    if (notches == 0)
        return TRUE;
    const Tavo_GrZoom::Type direction = notches > 0 ? Tavo_GrZoom::In : Tavo_GrZoom::Out;
    ZoomWindow(direction, std::abs(notches) * LevelsPerNotch, Tavo_WiZoomCenter::AtCursor, 0, 0, false);
    return TRUE;
}
