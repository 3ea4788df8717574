// Tavo_WiDrawWnd: zooming and panning. InternalZoom is the one place that
// re-derives the scroll model (range, deltas, extent, position) from the
// mapping; scrolling moves only the position and pans the mapping with it.
#include "Tavo_WiDrawWnd.h"

#include "Tavo_WiViewMath.h"

using namespace Tavo_WiViewMath;

namespace {

int Clamped(long long value)
{
    return Tavo_GrSaturate(value);
}

bool IsEmptyArea(const CSize& size)
{
    return size.cx <= 0 || size.cy <= 0;
}

} // namespace

void Tavo_WiDrawWnd::InternalZoom(Tavo_GrZoom::Type type, int amount, Tavo_GrDPoint* centre, bool force)
{
    if (!m_drawing || !m_mapping)
        return;
    // Nothing to fit into while the scrollee has no area (minimised, zero-sized).
    const CSize size = GetScrolleeSize();
    if (IsEmptyArea(size))
        return;

    Tavo_GrWRect bounds;
    m_drawing->FetchBounds(bounds);
    const Tavo_GrTransform& before = m_mapping->GetTransform();
    const Tavo_GrWRect visible = VisibleWorldRect(size.cx, size.cy);

    Tavo_GrWPoint worldCentre;
    if (centre)
        worldCentre = {before.Invertxcoord(centre->x), before.Invertycoord(centre->y)};
    else if (GetZoomLevel() == 0.0)
        worldCentre = Centre(bounds);
    else
        worldCentre = Centre(visible);

    m_mapping->SetDeviceWindowSize(size.cx, size.cy, force, &worldCentre);
    const int changed = m_mapping->Zoom(type, worldCentre.x, worldCentre.y, amount);

    if (centre && GetZoomLevel() != 0.0) {
        // Bring the world point that was under the centre pixel back under it.
        const Tavo_GrTransform& after = m_mapping->GetTransform();
        const Tavo_GrWPoint now{after.Invertxcoord(centre->x), after.Invertycoord(centre->y)};
        const Tavo_GrWRect shown = VisibleWorldRect(size.cx, size.cy);
        m_mapping->SetWorldClipBox(Offset(shown, static_cast<long long>(worldCentre.x) - now.x,
                                          static_cast<long long>(worldCentre.y) - now.y));
    }
    DeriveScrollModel(bounds, size);
    SetScrollDone();

    // Laying out the scroll bars may have shown or hidden one, which gives
    // the scrollee another size: the model must describe the area that is
    // left. The mapping keeps its scale and the top-left corner, as the
    // screen does (at the zero level it fits the drawing again). Only once,
    // and the bars stay as they are: laid out again they could flip back (a
    // view of a few units, its corners rounded to whole units, may measure a
    // pixel more than its area), and the model would describe the wrong area.
    const CSize laidOut = GetScrolleeSize();
    if (laidOut != size && !IsEmptyArea(laidOut)) {
        m_mapping->SetDeviceWindowSize(laidOut.cx, laidOut.cy, false, nullptr);
        DeriveScrollModel(bounds, laidOut);
    }

    if (changed || force)
        ::InvalidateRect(GetScrollee()->GetSafeHwnd(), nullptr, TRUE);
}

void Tavo_WiDrawWnd::DeriveScrollModel(const Tavo_GrWRect& bounds, const CSize& size)
{
    const Tavo_GrWRect visible = VisibleWorldRect(size.cx, size.cy);
    const bool zoomedIn = GetZoomLevel() != 0.0;
    m_zoomedIn = zoomedIn ? 1 : 0;
    const ScrollRange range = ScrollRangeFor(bounds, visible, m_mapping->GetTransform().GetScale(), zoomedIn);
    SetScrollRange(range.xMin, range.xMax, range.yMin, range.yMax);

    // The view's own size where it reaches beyond the int range and its
    // corners are cut there.
    const double scale = m_mapping->GetTransform().GetScale();
    const long long width = ViewSideLength(visible.x1, visible.x2, size.cx, scale);
    const long long height = ViewSideLength(visible.y1, visible.y2, size.cy, scale);
    SetScrollDeltas(CSize(Clamped(width / 2), Clamped(height / 2)), CSize(Clamped(width / 10), Clamped(height / 10)));
    SetScrollWindowExtent(Clamped(width), Clamped(height));
    SetScrollPosition(CPoint(visible.x1, visible.y2));
}

void Tavo_WiDrawWnd::ZoomWindow(Tavo_GrZoom::Type type, int amount, Tavo_WiZoomCenter::Type centre, int x, int y,
                                bool force)
{
    if (!force && (!m_mapping || !m_mapping->ChangesZoomLevel(type, amount)))
        return;
    // Without a client area there is no view to zoom (InternalZoom would do
    // nothing); the undo clip box stays as well.
    if (m_mapping && IsEmptyArea(GetScrolleeSize()))
        return;

    Tavo_GrDPoint point;
    Tavo_GrDPoint* centrePoint = nullptr;
    if (centre == Tavo_WiZoomCenter::AtCursor && m_mapping) {
        point = GetCursorPositionInScrollee();
        centrePoint = &point;
    } else if (centre == Tavo_WiZoomCenter::AtPoint) {
        point = {x, y};
        centrePoint = &point;
    }
    if (m_mapping)
        m_undoClipBox = m_mapping->GetWorldClipBox();
    InternalZoom(type, amount, centrePoint, true);
    InternalZoom(Tavo_GrZoom::Keep, 1, nullptr, false);
}

void Tavo_WiDrawWnd::ZoomWindow(double level, int x, int y)
{
    // Without a client area the mapping must not change behind the scroll
    // model's back: nothing happens.
    if (!m_mapping || IsEmptyArea(GetScrolleeSize()))
        return;
    m_undoClipBox = m_mapping->GetWorldClipBox();
    m_mapping->Zoom(level, x, y);
    InternalZoom(Tavo_GrZoom::Keep, 1, nullptr, false);
    ::InvalidateRect(GetScrollee()->GetSafeHwnd(), nullptr, TRUE);
}

void Tavo_WiDrawWnd::ZoomWindow(const Tavo_GrWRect& rect)
{
    if (rect.x1 == rect.x2 || rect.y1 == rect.y2 || !m_mapping)
        return;
    const Tavo_GrWPoint c = Centre(rect);
    const CSize size = GetScrolleeSize();
    ZoomWindow(m_mapping->GetEnclosingZoomLevel(rect), c.x, c.y);
    // The zoom may have shown or hidden the scroll bars, so that the level
    // was chosen for an area the scrollee no longer has: choose again for
    // the area it has now, keeping the view before the first zoom for undo.
    if (GetScrolleeSize() == size)
        return;
    const Tavo_GrWRect undo = m_undoClipBox;
    ZoomWindow(m_mapping->GetEnclosingZoomLevel(rect), c.x, c.y);
    m_undoClipBox = undo;
}

bool Tavo_WiDrawWnd::ZoomWindowTest(Tavo_GrZoom::Type type, int amount) const
{
    return m_mapping && m_mapping->ChangesZoomLevel(type, amount);
}

void Tavo_WiDrawWnd::UndoLastScrollZoom()
{
    // ZoomWindow stores the current view as the next undo box, so a second
    // undo returns to the view before the first.
    ZoomWindow(Tavo_GrWRect(m_undoClipBox));
}

bool Tavo_WiDrawWnd::ScrollWindowTest(Tavo_WiScroll::Dir dir, Tavo_WiScroll::Amount amount, int n)
{
    if (!m_mapping || GetZoomLevel() <= 0.0)
        return false;
    return Tavo_WiScrollWnd::ScrollWindowTest(dir, amount, n);
}

void Tavo_WiDrawWnd::GetScrollDeviceDeltas(const CPoint& from, const CPoint& to, int& dx, int& dy, int scrolling)
{
    if (!m_mapping) {
        Tavo_WiScrollWnd::GetScrollDeviceDeltas(from, to, dx, dy, scrolling);
        return;
    }
    const double scale = m_mapping->GetTransform().GetScale();
    const DeviceDelta x = ToDeviceDelta(static_cast<long long>(from.x) - to.x, scale);
    const DeviceDelta y = ToDeviceDelta(static_cast<long long>(from.y) - to.y, scale);
    dx = x.pixels;
    dy = y.pixels;
    // The pixels move by whole numbers; what the rounding left over stays
    // with the mapping, so later drawing lines up with the moved pixels.
    if (scrolling)
        m_mapping->SetErrorTerms(m_mapping->GetXErrorTerm() + x.error, m_mapping->GetYErrorTerm() + y.error);
}

void Tavo_WiDrawWnd::OnDragScrollMove(const CPoint& position)
{
    Tavo_WiScrollWnd::OnDragScrollMove(position);
    if (m_mapping)
        m_mapping->PanTo(Tavo_GrWPoint{position.x, position.y});
}

void Tavo_WiDrawWnd::OnNonDragScrollEnd(const CPoint& position)
{
    Tavo_WiScrollWnd::OnNonDragScrollEnd(position);
    if (m_mapping)
        m_mapping->PanTo(Tavo_GrWPoint{position.x, position.y});
}

void Tavo_WiDrawWnd::ScrollWindowByDeviceDeltas(int dx, int dy)
{
    if (!m_mapping)
        return;
    const double scale = m_mapping->GetTransform().GetScale();
    const CPoint position = GetScrollPosition();
    ScrollWindowTo(CPoint(Tavo_GrAdd(position.x, ToWorldStep(dx, scale)),
                          Tavo_GrAdd(position.y, ToWorldStep(dy, scale))));
}

void Tavo_WiDrawWnd::CenterWindowAtCursor()
{
    if (!m_mapping)
        return;
    const Tavo_GrDPoint p = GetCursorPositionInScrollee();
    const Tavo_GrTransform& t = m_mapping->GetTransform();
    ScrollWindowCenterTo(CPoint(t.Invertxcoord(p.x), t.Invertycoord(p.y)));
}

Tavo_GrDPoint Tavo_WiDrawWnd::GetCursorPositionInScrollee()
{
    if (!m_mapping)
        return Tavo_GrDPoint();
    POINT p = {0, 0};
    ::GetCursorPos(&p);
    ::ScreenToClient(GetScrollee()->GetSafeHwnd(), &p);
    return {p.x, Tavo_GrSubtract(m_mapping->GetDeviceWindowHeight(), p.y)};
}

void Tavo_WiDrawWnd::SetPanDirectionality(int direction)
{
    m_panDirection = direction < 0 ? -1 : 1;
}
