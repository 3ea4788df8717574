// Tavo_DxfDrawingSink: shapes in drawing coordinates to core items.
#include "Tavo_DxfDrawingSink.h"

#include "Tavo_GrPalette.h"
#include "Tavo_GrRound.h"

#include <algorithm>

Tavo_DxfDrawingSink::Tavo_DxfDrawingSink(Tavo_GrDrawing& drawing, int firstLayer, Tavo_DxfColourResolver& colours,
                                         double scale, double originX, double originY)
    : m_builder(drawing), m_firstLayer(firstLayer), m_colours(colours), m_scale(scale), m_originX(originX),
      m_originY(originY)
{
}

Tavo_GrWPoint Tavo_DxfDrawingSink::World(const Tavo_DxfXY& p) const
{
    return {Tavo_GrRound((p.x - m_originX) * m_scale), Tavo_GrRound((p.y - m_originY) * m_scale)};
}

int Tavo_DxfDrawingSink::WorldLength(double length) const
{
    return Tavo_GrRound(length * m_scale);
}

void Tavo_DxfDrawingSink::Use(const Tavo_DxfStyle& style, char fill, int charHeight, char align)
{
    m_builder.UseLayer(m_firstLayer + style.layer);
    const uint32_t key = style.colour.Packed();
    auto found = m_colourIndex.find(key);
    if (found == m_colourIndex.end())
        found = m_colourIndex.emplace(key, m_colours.ColourIndexOf(style.colour)).first;
    m_builder.SetAttr(Tavo_GrAttr(found->second, fill, charHeight, align));
}

void Tavo_DxfDrawingSink::Dot(const Tavo_DxfStyle& style, const Tavo_DxfXY& p)
{
    Use(style, Tavo_GrPalette::Hollow);
    const Tavo_GrWPoint w = World(p);
    m_builder.AddDot(w.x, w.y);
}

void Tavo_DxfDrawingSink::Line(const Tavo_DxfStyle& style, const Tavo_DxfXY& p, const Tavo_DxfXY& q)
{
    Use(style, Tavo_GrPalette::Hollow);
    const Tavo_GrWPoint a = World(p);
    const Tavo_GrWPoint b = World(q);
    m_builder.AddLine(a.x, a.y, b.x, b.y);
}

void Tavo_DxfDrawingSink::Polyline(const Tavo_DxfStyle& style, const std::vector<Tavo_DxfXY>& points, bool closed)
{
    Use(style, Tavo_GrPalette::Hollow);
    m_points.clear();
    for (const Tavo_DxfXY& p : points)
        m_points.push_back(World(p));
    if (closed)
        m_points.push_back(m_points.front());
    m_builder.AddPolyline(static_cast<int>(m_points.size()), m_points.data());
}

void Tavo_DxfDrawingSink::Polygon(const Tavo_DxfStyle& style, const Tavo_DxfXY* points, int count)
{
    Use(style, Tavo_GrPalette::Solid);
    m_points.clear();
    for (int i = 0; i < count; ++i)
        m_points.push_back(World(points[i]));
    m_builder.AddPolygon(count, m_points.data());
}

void Tavo_DxfDrawingSink::Circle(const Tavo_DxfStyle& style, const Tavo_DxfXY& centre, double radius)
{
    Use(style, Tavo_GrPalette::Hollow);
    const Tavo_GrWPoint c = World(centre);
    m_builder.AddCircle(c.x, c.y, std::max(1, WorldLength(radius)));
}

void Tavo_DxfDrawingSink::Text(const Tavo_DxfStyle& style, const Tavo_DxfTextPlacement& placement,
                               const std::string& text)
{
    Use(style, Tavo_GrPalette::Hollow, std::max(1, WorldLength(placement.height)), placement.align);
    const Tavo_GrWPoint at = World(placement.anchor);
    m_builder.AddText(at.x, at.y, text.c_str());
}
