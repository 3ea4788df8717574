// Tavo_WiDrawWnd: construction, binding a drawing, the paint path, the
// coordinate conversions, invalidation, the paint pump and live resizing.
// Zooming and panning are in Tavo_WiDrawWndZoom.cpp, the pointer in
// Tavo_WiDrawWndPointer.cpp, printing in Tavo_WiDrawWndPrint.cpp.
#include "Tavo_WiDrawWnd.h"

#include "Tavo_GrRound.h"
#include "Tavo_WiViewMath.h"

#include <cstdlib>
#include <new>

namespace {

// The size in world units of the view a mapping shows in an area, as far as
// an int holds it.
CSize ViewExtent(const Tavo_GrMapping& mapping, const CSize& area)
{
    const Tavo_GrWRect view = mapping.GetTransform().InvertRect(Tavo_GrDRect{0, 0, area.cx, area.cy});
    const double scale = mapping.GetTransform().GetScale();
    return CSize(Tavo_GrSaturate(Tavo_WiViewMath::ViewSideLength(view.x1, view.x2, area.cx, scale)),
                 Tavo_GrSaturate(Tavo_WiViewMath::ViewSideLength(view.y1, view.y2, area.cy, scale)));
}

} // namespace

BEGIN_MESSAGE_MAP(Tavo_WiDrawWnd, Tavo_WiScrollWnd)
    ON_WM_WINDOWPOSCHANGED()
    ON_WM_TIMER()
END_MESSAGE_MAP()

Tavo_WiDrawWnd::Tavo_WiDrawWnd()
{
    // World y grows upwards, so the scroll position is the view's top-left
    // world point and scrolling down decreases it.
    SetScrollInvertedY(1);
}

// The mapping goes with the unique_ptr; the drawing is the application's, and
// a running autoscroll timer dies with the window.
Tavo_WiDrawWnd::~Tavo_WiDrawWnd() = default;

// ---- binding ----------------------------------------------------------------------

void Tavo_WiDrawWnd::SetDrawingInfo(Tavo_GrDrawing* drawing, int maxZoomLevel, int surfaceOption,
                                    int zeroLevelExpansion, unsigned int maxClipWidth,
                                    unsigned int maxClipHeight)
{
    // The undo clip box is a view of the old drawing: it goes with the
    // mapping, so an undo after rebinding does nothing.
    m_mapping.reset();
    m_undoClipBox = Tavo_GrWRect();
    m_drawing = nullptr;
    if (!drawing)
        return;
    m_surfaceOption = surfaceOption;
    // Without memory for the mapping the window stays unbound, and usable.
    m_mapping.reset(new (std::nothrow) Tavo_GrMapping(drawing, ZoomLevelsPerDoubling));
    if (!m_mapping)
        return;
    m_drawing = drawing;
    m_mapping->SetMaxZoomLevel(maxZoomLevel);
    m_mapping->SetZeroLevelExpansion(zeroLevelExpansion);
    m_mapping->SetMaxZoomWorldClipBoxSize(maxClipWidth, maxClipHeight);
    // The children keep their creation rectangle until the first layout; a
    // drawing bound right after Create must be fitted to the real client
    // area, not to that placeholder.
    if (::IsWindow(GetSafeHwnd()))
        SetScrollDone();
    InternalZoom(Tavo_GrZoom::ZeroLevel, 1, nullptr, true);
}

double Tavo_WiDrawWnd::GetZoomLevel() const
{
    if (!m_mapping)
        return 0.0;
    const double level = m_mapping->GetZoomLevel();
    return level < m_mapping->GetRealZoomLevel() ? level : m_mapping->GetRealZoomLevel();
}

// ---- painting ------------------------------------------------------------------------

void Tavo_WiDrawWnd::OnDraw(Tavo_WiScrollee* scrollee, CDC* dc)
{
    if (!m_drawing || !m_mapping)
        return;
    Tavo_GrDRect rect;
    Tavo_WiNativeWindowSurface* surface = GetNativeWindowSurface();
    if (!surface)
        return;
    OnPrepareSurface(scrollee, dc, surface);
    OnPrepareMapping(scrollee, dc, m_mapping.get(), rect);
    surface->SetScreenPaintFlag(1);
    OnDraw(scrollee, dc, m_drawing, surface, m_mapping.get(), rect);
}

Tavo_WiNativeWindowSurface* Tavo_WiDrawWnd::GetNativeWindowSurface()
{
    return nullptr;
}

void Tavo_WiDrawWnd::OnPrepareSurface(Tavo_WiScrollee*, CDC* dc, Tavo_WiNativeWindowSurface* surface)
{
    surface->SetSurfaceOption(m_surfaceOption);
    surface->SetDC(dc->GetSafeHdc());
}

void Tavo_WiDrawWnd::OnPrepareMapping(Tavo_WiScrollee* scrollee, CDC* dc, Tavo_GrMapping* mapping,
                                      Tavo_GrDRect& rect)
{
    CRect client(0, 0, 0, 0);
    scrollee->GetClientRect(&client);
    const int h = client.Height();
    mapping->SetDeviceWindowSize(client.Width(), h, false, nullptr);

    // The clip box is in client coordinates, y down; the repaint rectangle
    // is a device rectangle, y up from the bottom edge.
    CRect clip(0, 0, 0, 0);
    dc->GetClipBox(&clip);
    const int top = Tavo_GrSubtract(h, clip.top);
    const int bottom = Tavo_GrSubtract(h, clip.bottom);
    rect.xmin = std::min(clip.left, clip.right);
    rect.xmax = std::max(clip.left, clip.right);
    rect.ymin = std::min(top, bottom);
    rect.ymax = std::max(top, bottom);
}

void Tavo_WiDrawWnd::OnDraw(Tavo_WiScrollee*, CDC*, Tavo_GrDrawing* drawing, Tavo_WiNativeWindowSurface* surface,
                            Tavo_GrMapping* mapping, Tavo_GrDRect& rect)
{
    // Zoomed in, the scroll position decides what is shown; at the zero level
    // the mapping's fit does.
    const double level = std::min(static_cast<double>(mapping->GetZoomLevel()), mapping->GetRealZoomLevel());
    if (level > 0.0) {
        const CPoint position = GetScrollPosition();
        mapping->PanTo(Tavo_GrWPoint{position.x, position.y});
    }
    drawing->Draw(*surface, *mapping, &rect);
}

// ---- coordinates and invalidation --------------------------------------------------

CSize Tavo_WiDrawWnd::GetScrolleeSize()
{
    CRect client(0, 0, 0, 0);
    ::GetClientRect(GetScrollee()->GetSafeHwnd(), &client);
    return CSize(client.Width(), client.Height());
}

Tavo_GrWRect Tavo_WiDrawWnd::VisibleWorldRect(int width, int height) const
{
    return m_mapping->GetTransform().InvertRect(Tavo_GrDRect{0, 0, width, height});
}

Tavo_GrWRect Tavo_WiDrawWnd::GetWorldClipBox() const
{
    if (!m_mapping)
        return Tavo_GrWRect();
    CRect client(0, 0, 0, 0);
    ::GetClientRect(const_cast<Tavo_WiDrawWnd*>(this)->GetScrollee()->GetSafeHwnd(), &client);
    return VisibleWorldRect(client.Width(), client.Height());
}

void Tavo_WiDrawWnd::InvalidateRect(const Tavo_GrWRect& given, bool erase)
{
    if (!m_mapping)
        return;
    if (given.x1 == 0 && given.y1 == 0 && given.x2 == 0 && given.y2 == 0)
        return;
    const Tavo_GrWRect rect{std::min(given.x1, given.x2), std::min(given.y1, given.y2),
                            std::max(given.x1, given.x2), std::max(given.y1, given.y2)};
    // A rectangle touching the clip box counts as inside it.
    const Tavo_GrWRect clip = m_mapping->GetWorldClipBox();
    if (clip.x1 > rect.x2 || clip.x2 < rect.x1 || clip.y1 > rect.y2 || clip.y2 < rect.y1)
        return;

    const Tavo_GrDRect d = m_mapping->GetTransform().Rect(rect);
    const int h = m_mapping->GetDeviceWindowHeight();
    const int margin = InvalidateMarginPixels;
    const RECT area = {Tavo_GrSubtract(d.xmin, margin),
                       Tavo_GrSubtract(Tavo_GrSubtract(h, d.ymax), margin),
                       Tavo_GrAdd(d.xmax, margin),
                       Tavo_GrAdd(Tavo_GrSubtract(h, d.ymin), margin)};
    ::InvalidateRect(GetScrollee()->GetSafeHwnd(), &area, erase ? TRUE : FALSE);
}

void Tavo_WiDrawWnd::PumpPaintMessages()
{
    for (int i = 0; i < MaxPumpedPaintMessages; ++i) {
        MSG msg;
        // A peek with a filter still reports WM_QUIT; that one stays for the
        // application's loop.
        if (!::PeekMessageA(&msg, nullptr, WM_PAINT, WM_PAINT, PM_NOREMOVE) || msg.message != WM_PAINT)
            return;
        const BOOL got = ::GetMessageA(&msg, nullptr, WM_PAINT, WM_PAINT);
        if (got <= 0) {
            // The quit was taken after all: give it back and stop.
            if (got == 0)
                ::PostQuitMessage(static_cast<int>(msg.wParam));
            return;
        }
        ::TranslateMessage(&msg);
        ::DispatchMessageA(&msg);
    }
}

// ---- live resizing -----------------------------------------------------------------

bool Tavo_WiDrawWnd::IsShownWindow()
{
    const HWND hwnd = GetSafeHwnd();
    return hwnd != nullptr && ::IsWindow(hwnd) && ::IsWindowVisible(hwnd);
}

void Tavo_WiDrawWnd::OnEnterSizeMove()
{
    if (!m_drawing || !m_mapping || !IsShownWindow())
        return;
    m_sizing = 1;
    m_savedSize = GetScrolleeSize();
    m_savedPoint = GetScrollPosition();
}

void Tavo_WiDrawWnd::OnWindowPosChanged(WINDOWPOS* windowPos)
{
    CWnd::OnWindowPosChanged(windowPos);
    if (!m_drawing || !m_mapping || !IsShownWindow() || m_sizing)
        return;
    m_undoClipBox = m_mapping->GetWorldClipBox();
    InternalZoom(Tavo_GrZoom::Keep, 1, nullptr, true);
}

void Tavo_WiDrawWnd::OnExitSizeMove()
{
    m_sizing = 0;
    if (!m_drawing || !m_mapping || !IsShownWindow())
        return;
    // Nothing to show while the scrollee has no area (minimised, zero-sized).
    const CSize size = GetScrolleeSize();
    if (size.cx <= 0 || size.cy <= 0)
        return;
    const Tavo_GrWRect before = m_mapping->GetWorldClipBox();
    // Zoomed in, the mapping is sized to the new area first, as the next
    // paint would size it: the scale and the top-left world point stay, and
    // a window that grew until the whole drawing fits at that scale shows
    // the zero level.
    if (GetZoomLevel() != 0.0)
        m_mapping->SetDeviceWindowSize(size.cx, size.cy, false, nullptr);
    // A resize that ends at the size it began at changes nothing, unless a
    // paint on the way changed the scale (a window grown until the drawing
    // fitted, or shrunk below the largest zoom's clip box): then the view
    // is no longer the one the scroll model was derived from.
    const CSize extent = ViewExtent(*m_mapping, size);
    const bool zoomedIn = GetZoomLevel() != 0.0;
    if (size == m_savedSize && zoomedIn == (m_zoomedIn != 0) && std::abs(extent.cx - GetWindowExtent().cx) <= 1 &&
        std::abs(extent.cy - GetWindowExtent().cy) <= 1)
        return;
    if (!zoomedIn) {
        m_undoClipBox = before;
        InternalZoom(Tavo_GrZoom::ZeroLevel, 1, nullptr, true);
        return;
    }
    // The window shows more or less of the drawing from the same top-left
    // point. The view is panned there, as the next paint does, so that the
    // extent is read from the view that will be shown: a view elsewhere
    // could lie partly beyond the int range, where its corners are cut.
    const auto showFromSavedPoint = [this](const CSize& area) {
        m_mapping->PanTo(Tavo_GrWPoint{m_savedPoint.x, m_savedPoint.y});
        const CSize shown = ViewExtent(*m_mapping, area);
        SetScrollWindowExtent(shown.cx, shown.cy);
        SetScrollPosition(m_savedPoint);
    };
    showFromSavedPoint(size);
    SetScrollDone();
    // A bar that appeared or went changes the area, as in InternalZoom; an
    // area that grew so may show the whole drawing at this scale.
    const CSize laidOut = GetScrolleeSize();
    if (laidOut != size && laidOut.cx > 0 && laidOut.cy > 0) {
        m_mapping->SetDeviceWindowSize(laidOut.cx, laidOut.cy, false, nullptr);
        if (GetZoomLevel() == 0.0) {
            m_undoClipBox = before;
            InternalZoom(Tavo_GrZoom::ZeroLevel, 1, nullptr, true);
            return;
        }
        showFromSavedPoint(laidOut);
    }
    CWnd::InvalidateRect(nullptr, TRUE);
}
