#include "CachedPenSurface.h"

#include "Tavo_WiLibrary.h"
#include "Tavo_WiPalette.h"

#pragma push_macro("DrawText")
#undef DrawText

CachedPenSurface::~CachedPenSurface()
{
    for (HPEN pen : m_pens)
        if (pen)
            DeleteObject(pen);
    for (HBRUSH brush : m_brushes)
        if (brush)
            DeleteObject(brush);
}

void CachedPenSurface::OnAttrChange()
{
    Tavo_GrSurface::OnAttrChange();
    const unsigned char index = static_cast<unsigned char>(GetCurrentColor());
    if (!m_pens[index]) {
        m_colours[index] = Tavo_WiLibrary::GetPalette()->GetWin32Color(static_cast<char>(index), false);
        m_pens[index] = CreatePen(PS_SOLID, 0, m_colours[index]);
        m_brushes[index] = CreateSolidBrush(m_colours[index]);
    }
    m_colour = m_colours[index];
    const HGDIOBJ brush = IsHollow() ? GetStockObject(NULL_BRUSH) : m_brushes[index];
    const HGDIOBJ displacedPen = SelectObject(m_hdc, m_pens[index]);
    const HGDIOBJ displacedBrush = SelectObject(m_hdc, brush);
    if (!m_oldPen) {
        m_oldPen = displacedPen;
        m_oldBrush = displacedBrush;
    }
}

void CachedPenSurface::EndDrawing()
{
    Tavo_GrSurface::EndDrawing();
    if (m_oldPen) {
        SelectObject(m_hdc, m_oldPen);
        SelectObject(m_hdc, m_oldBrush);
    }
    m_oldPen = nullptr;
    m_oldBrush = nullptr;
}

void CachedPenSurface::DrawDot(Tavo_GrDPoint& point, Tavo_GrAttr* attr)
{
    SetCurrentAttr(attr);
    const POINT p = Flip(point);
    SetPixelV(m_hdc, p.x, p.y, m_colour);
}

void CachedPenSurface::DrawLine(Tavo_GrDPoint& from, Tavo_GrDPoint& to, Tavo_GrAttr* attr)
{
    SetCurrentAttr(attr);
    const POINT points[2] = {Flip(from), Flip(to)};
    Polyline(m_hdc, points, 2);
}

void CachedPenSurface::DrawPline(int count, Tavo_GrDPoint* points, Tavo_GrAttr* attr)
{
    SetCurrentAttr(attr);
    if (!points || count < 2)
        return;
    if (m_polyline.size() < static_cast<size_t>(count))
        m_polyline.resize(static_cast<size_t>(count));
    for (int i = 0; i < count; ++i)
        m_polyline[static_cast<size_t>(i)] = Flip(points[i]);
    Polyline(m_hdc, m_polyline.data(), count);
}

void CachedPenSurface::DrawRect(Tavo_GrDRect& rect, Tavo_GrAttr* attr)
{
    SetCurrentAttr(attr);
    // Rectangle leaves out the right and bottom edges: one more includes them.
    Rectangle(m_hdc, rect.xmin, GetDeviceHeight() - rect.ymax, rect.xmax + 1, GetDeviceHeight() - rect.ymin + 1);
}

void CachedPenSurface::DrawCircle(Tavo_GrDPoint& centre, int radius, Tavo_GrAttr* attr)
{
    SetCurrentAttr(attr);
    const POINT c = Flip(centre);
    Ellipse(m_hdc, c.x - radius, c.y - radius, c.x + radius, c.y + radius);
}

void CachedPenSurface::DrawTriangle(Tavo_GrDPoint points[3], Tavo_GrAttr* attr)
{
    SetCurrentAttr(attr);
    if (!points)
        return;
    const POINT corners[3] = {Flip(points[0]), Flip(points[1]), Flip(points[2])};
    Polygon(m_hdc, corners, 3);
}

#pragma pop_macro("DrawText")
