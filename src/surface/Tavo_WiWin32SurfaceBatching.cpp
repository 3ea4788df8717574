// Tavo_WiWin32Surface: the nine primitive batches, their add and emit
// operations, the fixed flush order and the point-count arrays shared by all
// surfaces.
//
// Emission order inside one run of a colour and fill: dots, lines, uniangles,
// hollow triangles, filled triangles, hollow rectangles, filled rectangles,
// hollow circles, filled circles. A change of colour or fill flushes first,
// so runs keep their order.
#include "Tavo_WiWin32Surface.h"

#include "Tavo_GrRound.h"

#pragma push_macro("DrawText")
#undef DrawText

namespace {

void SetPoint(POINT& point, int x, int y)
{
    point.x = x;
    point.y = y;
}

void SetBox(RECT& box, int left, int top, int right, int bottom)
{
    box.left = left;
    box.top = top;
    box.right = right;
    box.bottom = bottom;
}

} // namespace

// ---- Point-count arrays -----------------------------------------------------

void Tavo_WiWin32Surface::AllocStaticArrays(const int* maxCounts)
{
    std::unique_ptr<DWORD[]>* arrays[] = {&m_2array, &m_3array, &m_4array, &m_5array};
    for (int points = 2; points <= 5; ++points) {
        const int length = maxCounts[points];
        std::unique_ptr<DWORD[]>& array = *arrays[points - 2];
        array.reset(new DWORD[length]);
        for (int i = 0; i < length; ++i)
            array[i] = static_cast<DWORD>(points);
    }
}

void Tavo_WiWin32Surface::FreeStaticArrays()
{
    m_2array.reset();
    m_3array.reset();
    m_4array.reset();
    m_5array.reset();
}

// ---- Adding -----------------------------------------------------------------

void Tavo_WiWin32Surface::AddDot(int x, int y)
{
    // GDI leaves out a polyline's last point, so this draws exactly (x, y).
    POINT* element = m_dots.Append();
    SetPoint(element[0], x, y);
    SetPoint(element[1], Tavo_GrAdd(x, 1), y);
    if (m_dots.IsFull())
        FlushDots();
}

void Tavo_WiWin32Surface::AddLine(int x1, int y1, int x2, int y2)
{
    const auto append = [this](int ax, int ay, int bx, int by) {
        POINT* element = m_lines.Append();
        SetPoint(element[0], ax, ay);
        SetPoint(element[1], bx, by);
        if (m_lines.IsFull())
            FlushLines();
    };
    append(x1, y1, x2, y2);
    if (m_thickenVertLine <= 0 || x1 != x2 || !(GetThickenGate() > 0.0))
        return;
    // Extra columns always go to the right.
    for (int i = 1; i <= m_thickenVertLine; ++i)
        append(Tavo_GrAdd(x1, i), y1, Tavo_GrAdd(x2, i), y2);
}

void Tavo_WiWin32Surface::AddUniangle(int x0, int y0, int x1, int y1, int x2, int y2)
{
    POINT* element = m_uniangles.Append();
    SetPoint(element[0], x0, y0);
    SetPoint(element[1], x1, y1);
    SetPoint(element[2], x2, y2);
    if (m_uniangles.IsFull())
        FlushUniangles();
}

void Tavo_WiWin32Surface::AddHollowTriangle(int x0, int y0, int x1, int y1, int x2, int y2)
{
    POINT* element = m_hollowTriangles.Append();
    SetPoint(element[0], x0, y0);
    SetPoint(element[1], x1, y1);
    SetPoint(element[2], x2, y2);
    SetPoint(element[3], x0, y0);
    if (m_hollowTriangles.IsFull())
        FlushHollowTriangles();
}

void Tavo_WiWin32Surface::AddFilledTriangle(int x0, int y0, int x1, int y1, int x2, int y2)
{
    POINT* element = m_filledTriangles.Append();
    SetPoint(element[0], x0, y0);
    SetPoint(element[1], x1, y1);
    SetPoint(element[2], x2, y2);
    SetPoint(element[3], x0, y0);
    if (m_filledTriangles.IsFull())
        FlushFilledTriangles();
}

void Tavo_WiWin32Surface::AddHollowRect(int l, int t, int r, int b)
{
    POINT* element = m_hollowRects.Append();
    SetPoint(element[0], l, t);
    SetPoint(element[1], r, t);
    SetPoint(element[2], r, b);
    SetPoint(element[3], l, b);
    SetPoint(element[4], l, t);
    if (m_hollowRects.IsFull())
        FlushHollowRects();
}

// Boxes keep full 32-bit coordinates: cutting them to 16 bits would wrap an
// edge beyond 32767 pixels (common in a zoomed-in view) to the other side.
void Tavo_WiWin32Surface::AddFilledRect(int l, int t, int r, int b)
{
    SetBox(*m_filledRects.Append(), l, t, r, b);
    if (m_filledRects.IsFull())
        FlushFilledRects();
}

void Tavo_WiWin32Surface::AddHollowCircle(int x, int y, int radius)
{
    SetBox(*m_hollowCircles.Append(), Tavo_GrSubtract(x, radius), Tavo_GrSubtract(y, radius), Tavo_GrAdd(x, radius),
           Tavo_GrAdd(y, radius));
    if (m_hollowCircles.IsFull())
        FlushHollowCircles();
}

void Tavo_WiWin32Surface::AddFilledCircle(int x, int y, int radius)
{
    SetBox(*m_filledCircles.Append(), Tavo_GrSubtract(x, radius), Tavo_GrSubtract(y, radius), Tavo_GrAdd(x, radius),
           Tavo_GrAdd(y, radius));
    if (m_filledCircles.IsFull())
        FlushFilledCircles();
}

// ---- Emitting ---------------------------------------------------------------

void Tavo_WiWin32Surface::EmitPolylines(const POINT* points, const DWORD* counts, int polylines)
{
    // Each batch boundary gives the Escape key a chance to stop a long pass;
    // the graphics core reads the flag.
    PollDrawInterrupt();
    PolyPolyline(m_hdc, points, counts, static_cast<DWORD>(polylines));
}

void Tavo_WiWin32Surface::FlushDots()
{
    EmitPolylines(m_dots.GetElements(), m_2array.get(), m_dots.m_count);
    m_stats.Add(Tavo_GrSurfaceStats::Dots, m_dots.m_count);
    m_dots.m_count = 0;
    // Repeat suppression only spans dots still waiting in the batch.
    m_lastDotX = kNoDotSinceEmission;
    m_lastDotY = kNoDotSinceEmission;
}

void Tavo_WiWin32Surface::FlushLines()
{
    EmitPolylines(m_lines.GetElements(), m_2array.get(), m_lines.m_count);
    m_stats.Add(Tavo_GrSurfaceStats::Lines, m_lines.m_count);
    m_lines.m_count = 0;
}

void Tavo_WiWin32Surface::FlushUniangles()
{
    EmitPolylines(m_uniangles.GetElements(), m_3array.get(), m_uniangles.m_count);
    m_stats.Add(Tavo_GrSurfaceStats::Lines, m_uniangles.m_count);
    m_uniangles.m_count = 0;
}

void Tavo_WiWin32Surface::FlushHollowTriangles()
{
    EmitPolylines(m_hollowTriangles.GetElements(), m_4array.get(), m_hollowTriangles.m_count);
    m_stats.Add(Tavo_GrSurfaceStats::HollowTriangles, m_hollowTriangles.m_count);
    m_hollowTriangles.m_count = 0;
}

void Tavo_WiWin32Surface::FlushFilledTriangles()
{
    PollDrawInterrupt();
    for (int i = 0; i < m_filledTriangles.m_count; ++i)
        Polygon(m_hdc, m_filledTriangles.GetElement(i), 4);
    m_stats.Add(Tavo_GrSurfaceStats::FilledTriangles, m_filledTriangles.m_count);
    m_filledTriangles.m_count = 0;
}

void Tavo_WiWin32Surface::FlushHollowRects()
{
    EmitPolylines(m_hollowRects.GetElements(), m_5array.get(), m_hollowRects.m_count);
    m_stats.Add(Tavo_GrSurfaceStats::HollowRects, m_hollowRects.m_count);
    m_hollowRects.m_count = 0;
}

void Tavo_WiWin32Surface::FlushFilledRects()
{
    PollDrawInterrupt();
    for (int i = 0; i < m_filledRects.m_count; ++i) {
        const RECT& box = *m_filledRects.GetElement(i);
        Rectangle(m_hdc, box.left, box.top, box.right, box.bottom);
    }
    m_stats.Add(Tavo_GrSurfaceStats::FilledRects, m_filledRects.m_count);
    m_filledRects.m_count = 0;
}

void Tavo_WiWin32Surface::EmitEllipses(const BoxBatch& batch)
{
    for (int i = 0; i < batch.m_count; ++i) {
        const RECT& box = *batch.GetElement(i);
        Ellipse(m_hdc, box.left, box.top, box.right, box.bottom);
    }
}

void Tavo_WiWin32Surface::FlushHollowCircles()
{
    PollDrawInterrupt();
    // The null brush is selected even for an empty batch, keeping the calls
    // of every flush the same.
    const HGDIOBJ displaced = SelectObject(m_hdc, GetStockObject(NULL_BRUSH));
    EmitEllipses(m_hollowCircles);
    SelectObject(m_hdc, displaced);
    m_stats.Add(Tavo_GrSurfaceStats::Circles, m_hollowCircles.m_count);
    m_hollowCircles.m_count = 0;
}

void Tavo_WiWin32Surface::FlushFilledCircles()
{
    PollDrawInterrupt();
    EmitEllipses(m_filledCircles);
    m_stats.Add(Tavo_GrSurfaceStats::Circles, m_filledCircles.m_count);
    m_filledCircles.m_count = 0;
}

void Tavo_WiWin32Surface::Flush()
{
    FlushDots();
    FlushLines();
    FlushUniangles();
    FlushHollowTriangles();
    FlushFilledTriangles();
    FlushHollowRects();
    FlushFilledRects();
    FlushHollowCircles();
    FlushFilledCircles();
    Tavo_GrSurface::Flush();
}

#pragma pop_macro("DrawText")
