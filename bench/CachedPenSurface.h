// CachedPenSurface: the surface a developer new to the library would write
// first, as the benchmark's peer of Tavo_WiWin32Surface. It is drawn through
// the same graphics-core Draw and makes one GDI call per primitive (SetPixelV,
// Polyline, Rectangle, Ellipse, Polygon) on the spot, with no batching. Its
// pens and solid brushes are made once per colour and kept for the surface's
// life, so an attribute change costs only the selections; outlines use the
// stock null brush. It never asks the keyboard: an Escape key is the real
// surface's service alone.
#pragma once

#include <windows.h>

#include "Tavo_GrSurface.h"

#include <array>
#include <vector>

#pragma push_macro("DrawText")
#undef DrawText

class CachedPenSurface : public Tavo_GrSurface {
public:
    CachedPenSurface() = default;
    ~CachedPenSurface();

    // Binds the surface to a device context before a drawing pass.
    void SetDC(HDC dc) { m_hdc = dc; }

    void DrawCircle(Tavo_GrDPoint& centre, int radius, Tavo_GrAttr* attr) override;
    void DrawDot(Tavo_GrDPoint& point, Tavo_GrAttr* attr) override;
    void DrawLine(Tavo_GrDPoint& from, Tavo_GrDPoint& to, Tavo_GrAttr* attr) override;
    void DrawPline(int count, Tavo_GrDPoint* points, Tavo_GrAttr* attr) override;
    void DrawRect(Tavo_GrDRect& rect, Tavo_GrAttr* attr) override;
    void DrawTriangle(Tavo_GrDPoint points[3], Tavo_GrAttr* attr) override;
    void OnAttrChange() override;
    void EndDrawing() override;

private:
    // One of each per colour index.
    static constexpr size_t kColourCount = 256;

    POINT Flip(const Tavo_GrDPoint& point) const { return {point.x, GetDeviceHeight() - point.y}; }

    HDC m_hdc = nullptr;                             // the owner's
    std::array<HPEN, kColourCount> m_pens = {};      // owned
    std::array<HBRUSH, kColourCount> m_brushes = {}; // owned
    std::array<COLORREF, kColourCount> m_colours = {};
    COLORREF m_colour = 0;
    // What the first selection of a pass displaced, given back by EndDrawing.
    HGDIOBJ m_oldPen = nullptr;
    HGDIOBJ m_oldBrush = nullptr;
    std::vector<POINT> m_polyline; // room for the longest polyline so far
};

#pragma pop_macro("DrawText")
