// Tavo_WiWin32Surface: the drawing operations the graphics core calls. Each
// applies its attribute, flips the core's upward y into GDI's downward y,
// treats the degenerate cases (repeated dots, tiny circles and triangles,
// vertical lines running far off the surface) and appends to a batch.
#include "Tavo_WiWin32Surface.h"

#include "Tavo_GrRound.h"

#pragma push_macro("DrawText")
#undef DrawText

namespace {

// Radii that are drawn as a small outlined triangle instead of a circle.
const int kLargestTriangleRadius = 2;
// A triangle whose second and third points lie this close to its first, on
// both axes, is drawn as an open outline without its closing side.
const int kTinyTriangleSpan = 4;

bool IsTinyDifference(int a, int b)
{
    const long long difference = static_cast<long long>(a) - b;
    return difference >= -kTinyTriangleSpan && difference <= kTinyTriangleSpan;
}

} // namespace

void Tavo_WiWin32Surface::DrawDot(Tavo_GrDPoint& point, Tavo_GrAttr* attr)
{
    // Dense drawings repeat a dot in long runs; a repeat costs one comparison
    // and leaves even the attribute alone.
    if (point.x == m_lastDotX && point.y == m_lastDotY)
        return;
    SetCurrentAttr(attr);
    m_lastDotX = point.x;
    m_lastDotY = point.y;
    AddDot(point.x, FlipY(point.y));
}

void Tavo_WiWin32Surface::DrawSegment(const Tavo_GrDPoint& from, const Tavo_GrDPoint& to)
{
    int y1 = from.y;
    int y2 = to.y;
    if (from.x == to.x) {
        // A vertical line reaching far beyond the surface is cut just outside
        // it, so that GDI never has to clip a huge span.
        const int height = GetDeviceHeight();
        const int above = Tavo_GrAdd(height, 1);
        y1 = y1 < 0 ? 0 : (y1 > height ? above : y1);
        y2 = y2 < 0 ? 0 : (y2 > height ? above : y2);
    }
    AddLine(from.x, FlipY(y1), to.x, FlipY(y2));
}

void Tavo_WiWin32Surface::DrawLine(Tavo_GrDPoint& from, Tavo_GrDPoint& to, Tavo_GrAttr* attr)
{
    SetCurrentAttr(attr);
    DrawSegment(from, to);
}

void Tavo_WiWin32Surface::DrawPline(int count, Tavo_GrDPoint* points, Tavo_GrAttr* attr)
{
    SetCurrentAttr(attr);
    if (!points)
        return;
    // Separate two-point segments, each clamped on its own.
    for (int i = 1; i < count; ++i)
        DrawSegment(points[i - 1], points[i]);
}

void Tavo_WiWin32Surface::DrawRect(Tavo_GrDRect& rect, Tavo_GrAttr* attr)
{
    SetCurrentAttr(attr);
    // Rectangle leaves out the right and bottom edges; one more includes the
    // maximum column and row. The outline runs through the same corners.
    const int left = rect.xmin;
    const int top = FlipY(rect.ymax);
    const int right = Tavo_GrAdd(rect.xmax, 1);
    const int bottom = Tavo_GrAdd(FlipY(rect.ymin), 1);
    if (IsHollow())
        AddHollowRect(left, top, right, bottom);
    else
        AddFilledRect(left, top, right, bottom);
}

void Tavo_WiWin32Surface::DrawCircle(Tavo_GrDPoint& centre, int radius, Tavo_GrAttr* attr)
{
    SetCurrentAttr(attr);
    const int x = centre.x;
    const int y = FlipY(centre.y);
    if (radius <= 0) {
        // Not a repeat-checked dot: the remembered dot stays as it is.
        AddDot(x, y);
        return;
    }
    if (radius <= kLargestTriangleRadius) {
        // Base below the centre, apex above, whatever the fill.
        AddHollowTriangle(Tavo_GrSubtract(x, radius), Tavo_GrAdd(y, radius), Tavo_GrAdd(x, radius),
                          Tavo_GrAdd(y, radius), x, Tavo_GrSubtract(y, radius));
        return;
    }
    if (IsHollow())
        AddHollowCircle(x, y, radius);
    else
        AddFilledCircle(x, y, radius);
}

void Tavo_WiWin32Surface::DrawTriangle(Tavo_GrDPoint points[3], Tavo_GrAttr* attr)
{
    SetCurrentAttr(attr);
    if (!points)
        return;
    const Tavo_GrDPoint& p0 = points[0];
    const Tavo_GrDPoint& p1 = points[1];
    const Tavo_GrDPoint& p2 = points[2];
    const int y0 = FlipY(p0.y);
    const int y1 = FlipY(p1.y);
    const int y2 = FlipY(p2.y);
    if (!IsHollow()) {
        AddFilledTriangle(p0.x, y0, p1.x, y1, p2.x, y2);
        return;
    }
    // Only the distances from the first point decide.
    const bool tiny = IsTinyDifference(p0.x, p1.x) && IsTinyDifference(p0.x, p2.x) && IsTinyDifference(p0.y, p1.y) && IsTinyDifference(p0.y, p2.y);
    if (tiny)
        AddUniangle(p0.x, y0, p1.x, y1, p2.x, y2);
    else
        AddHollowTriangle(p0.x, y0, p1.x, y1, p2.x, y2);
}

void Tavo_WiWin32Surface::DrawGrid(Tavo_GrDPoint&, Tavo_GrDPoint&, Tavo_GrDPoint&, Tavo_GrAttr*)
{
    // Grids are not drawn by this surface; the attribute is not even applied.
}

#pragma pop_macro("DrawText")
