// Tavo_GrSurface: the base behaviour of a surface. See Tavo_GrSurface.h for how
// a drawing calls it.
#include "Tavo_GrSurface.h"

#include "Tavo_GrDrawing.h"
#include "Tavo_GrPolygonFill.h"

#include "Tavo_GrRound.h"

#include <vector>

// Reused between calls so that drawing passes do not allocate.
std::vector<int>& Tavo_GrPolygonScratch()
{
    static std::vector<int> scratch;
    return scratch;
}

Tavo_GrSurface::Tavo_GrSurface() = default;

// ---- Calls ------------------------------------------------------------------

void Tavo_GrSurface::DrawCall(const Tavo_GrCall* call)
{
    if (!call || !call->GetDrawing() || m_callDepth >= kMaxCallDepth)
        return;

    const Tavo_GrTransform callerTransform = m_transform;
    const Tavo_GrWRect callerClip = m_worldClip;
    const int dx = call->GetDx();
    const int dy = call->GetDy();
    m_transform = m_transform.Translated(dx, dy);
    // The caller's clip in the called drawing's coordinates.
    m_worldClip = {Tavo_GrSubtract(callerClip.x1, dx), Tavo_GrSubtract(callerClip.y1, dy),
                   Tavo_GrSubtract(callerClip.x2, dx), Tavo_GrSubtract(callerClip.y2, dy)};

    ++m_callDepth;
    call->GetDrawing()->DrawItems(*this, false);
    --m_callDepth;

    m_transform = callerTransform;
    m_worldClip = callerClip;
}

void Tavo_GrSurface::DrawEHCall(const Tavo_GrCall* call)
{
    DrawCall(call);
}

void Tavo_GrSurface::DrawEHSignalCall(const Tavo_GrCall* call)
{
    DrawCall(call);
}

// ---- Primitives: the base only applies the attribute ------------------------

void Tavo_GrSurface::DrawCircle(Tavo_GrDPoint&, int, Tavo_GrAttr* attr)
{
    SetCurrentAttr(attr);
}

void Tavo_GrSurface::DrawDot(Tavo_GrDPoint&, Tavo_GrAttr* attr)
{
    SetCurrentAttr(attr);
}

void Tavo_GrSurface::DrawGrid(Tavo_GrDPoint&, Tavo_GrDPoint&, Tavo_GrDPoint&, Tavo_GrAttr*)
{
}

void Tavo_GrSurface::DrawLine(Tavo_GrDPoint&, Tavo_GrDPoint&, Tavo_GrAttr* attr)
{
    SetCurrentAttr(attr);
}

void Tavo_GrSurface::DrawRect(Tavo_GrDRect&, Tavo_GrAttr* attr)
{
    SetCurrentAttr(attr);
}

void Tavo_GrSurface::DrawText(const char*, Tavo_GrDRect&, Tavo_GrAttr* attr, unsigned int)
{
    SetCurrentAttr(attr);
}

void Tavo_GrSurface::DrawText(const char*, Tavo_GrDPoint&, Tavo_GrAttr* attr)
{
    SetCurrentAttr(attr);
}

// ---- Shapes made of simpler operations ----------------------------------------

void Tavo_GrSurface::DrawPline(int count, Tavo_GrDPoint* points, Tavo_GrAttr* attr)
{
    SetCurrentAttr(attr);
    if (!points)
        return;
    for (int i = 1; i < count; ++i)
        DrawLine(points[i - 1], points[i], attr);
}

void Tavo_GrSurface::DrawTriangle(Tavo_GrDPoint points[3], Tavo_GrAttr* attr)
{
    SetCurrentAttr(attr);
    if (!points)
        return;
    DrawLine(points[0], points[1], attr);
    DrawLine(points[1], points[2], attr);
    DrawLine(points[2], points[0], attr);
}

void Tavo_GrSurface::DrawPolygon(int count, Tavo_GrDPoint* points, Tavo_GrAttr* attr)
{
    SetCurrentAttr(attr);
    if (!points || count < 1)
        return;
    if (count < 3 || m_hollow) {
        // The outline, closed back to the first point.
        for (int i = 1; i < count; ++i)
            DrawLine(points[i - 1], points[i], attr);
        if (count >= 3)
            DrawLine(points[count - 1], points[0], attr);
        return;
    }
    Tavo_GrFillPolygon(count, points, Tavo_GrPolygonScratch(),
                       [&](const Tavo_GrDPoint& a, const Tavo_GrDPoint& b, const Tavo_GrDPoint& c) {
                           Tavo_GrDPoint triangle[3] = {a, b, c};
                           DrawTriangle(triangle, attr);
                       });
}

// ---- Pass ---------------------------------------------------------------------

void Tavo_GrSurface::Flush()
{
}

void Tavo_GrSurface::OnAttrChange()
{
}

void Tavo_GrSurface::BeginDrawing(const Tavo_GrDrawing* drawing)
{
    m_drawing = drawing;
    m_hasCurrentAttr = false;
}

void Tavo_GrSurface::EndDrawing()
{
    m_drawing = nullptr;
    m_hasCurrentAttr = false;
}

void Tavo_GrSurface::BeginLayer(const Tavo_GrLayer*)
{
}

void Tavo_GrSurface::EndLayer()
{
}

bool Tavo_GrSurface::PollDrawInterrupt()
{
    return m_drawingInterrupted;
}

void Tavo_GrSurface::ResetDrawingInterruptFlags()
{
    m_drawingInterrupted = false;
}

// ---- Current attribute -------------------------------------------------------

void Tavo_GrSurface::SetCurrentAttr(Tavo_GrAttr* attr)
{
    static const Tavo_GrAttr kDefaultAttr;
    const Tavo_GrAttr& next = attr ? *attr : kDefaultAttr;
    m_hollow = next.IsHollow();
    if (m_hasCurrentAttr && next == m_currentAttr)
        return;
    m_currentAttr = next;
    m_hasCurrentAttr = true;
    OnAttrChange();
}
