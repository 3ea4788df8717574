#include "PerPrimitiveRenderer.h"

#include "Tavo_GrTransform.h"
#include "Tavo_WiLibrary.h"
#include "Tavo_WiPalette.h"

void DrawPerPrimitive(HDC dc, const std::vector<BenchPrimitive>& primitives, const Tavo_GrTransform& transform,
                      int deviceHeight)
{
    Tavo_WiPalette* palette = Tavo_WiLibrary::GetPalette();
    HPEN pen = nullptr;
    HBRUSH brush = nullptr;
    HGDIOBJ oldPen = nullptr;
    HGDIOBJ oldBrush = nullptr;
    COLORREF colour = 0;
    int lastColour = -1000;
    int lastFill = -1000;

    const auto x = [&](int worldX) { return transform.xcoord(worldX); };
    const auto y = [&](int worldY) { return deviceHeight - transform.ycoord(worldY); };

    for (const BenchPrimitive& p : primitives) {
        if (p.colour != lastColour || p.fill != lastFill) {
            colour = palette->GetWin32Color(p.colour, false);
            HPEN newPen = CreatePen(PS_SOLID, 0, colour);
            LOGBRUSH description = {};
            description.lbStyle = p.fill ? BS_SOLID : BS_HOLLOW;
            description.lbColor = colour;
            HBRUSH newBrush = CreateBrushIndirect(&description);
            HGDIOBJ displacedPen = SelectObject(dc, newPen);
            HGDIOBJ displacedBrush = SelectObject(dc, newBrush);
            if (pen) {
                DeleteObject(pen);
                DeleteObject(brush);
            } else {
                oldPen = displacedPen;
                oldBrush = displacedBrush;
            }
            pen = newPen;
            brush = newBrush;
            lastColour = p.colour;
            lastFill = p.fill;
        }
        POINT points[5];
        for (int k = 0; k < p.pointCount; ++k)
            points[k] = {x(p.points[k][0]), y(p.points[k][1])};
        switch (p.kind) {
        case BenchPrimitive::Dot:
            SetPixelV(dc, points[0].x, points[0].y, colour);
            break;
        case BenchPrimitive::Line:
        case BenchPrimitive::Polyline:
            Polyline(dc, points, p.pointCount);
            break;
        case BenchPrimitive::Rect:
            Rectangle(dc, points[0].x, points[0].y, points[1].x + 1, points[1].y + 1);
            break;
        case BenchPrimitive::Circle: {
            const int r = transform.Length(p.radius);
            Ellipse(dc, points[0].x - r, points[0].y - r, points[0].x + r, points[0].y + r);
            break;
        }
        case BenchPrimitive::Triangle:
            Polygon(dc, points, 3);
            break;
        }
    }
    if (pen) {
        SelectObject(dc, oldPen);
        SelectObject(dc, oldBrush);
        DeleteObject(pen);
        DeleteObject(brush);
    }
}
