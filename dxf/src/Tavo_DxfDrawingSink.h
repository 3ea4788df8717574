// Tavo_DxfDrawingSink: adds the walker's shapes to a core drawing.
//
// Drawing coordinates become world units as (coordinate - origin) * scale,
// rounded and saturated (Tavo_GrRound); a circle's radius and a text's height
// are scaled alike. Each shape goes into the core layer of its DXF layer (the
// layers were made in the model's order, so the indices agree) with the
// palette index the resolver gives for its colour, asked once per colour.
#pragma once

#include "Tavo_DxfWalker.h"
#include "Tavo_GrDrawingBuilder.h"

#include <unordered_map>
#include <vector>

class Tavo_DxfDrawingSink : public Tavo_DxfSink {
public:
    Tavo_DxfDrawingSink(Tavo_GrDrawing& drawing, int firstLayer, Tavo_DxfColourResolver& colours, double scale,
                        double originX, double originY);

    void Dot(const Tavo_DxfStyle& style, const Tavo_DxfXY& p) override;
    void Line(const Tavo_DxfStyle& style, const Tavo_DxfXY& p, const Tavo_DxfXY& q) override;
    void Polyline(const Tavo_DxfStyle& style, const std::vector<Tavo_DxfXY>& points, bool closed) override;
    void Polygon(const Tavo_DxfStyle& style, const Tavo_DxfXY* points, int count) override;
    void Circle(const Tavo_DxfStyle& style, const Tavo_DxfXY& centre, double radius) override;
    void Text(const Tavo_DxfStyle& style, const Tavo_DxfTextPlacement& placement, const std::string& text) override;

    Tavo_GrDrawingBuilder& Builder() { return m_builder; }

private:
    Tavo_GrWPoint World(const Tavo_DxfXY& p) const;
    int WorldLength(double length) const;
    // Makes the style's layer current and the attribute the builder's.
    void Use(const Tavo_DxfStyle& style, char fill, int charHeight = 0, char align = Tavo_GrAttr::AlignDefault);

    Tavo_GrDrawingBuilder m_builder;
    int m_firstLayer;
    Tavo_DxfColourResolver& m_colours;
    double m_scale;
    double m_originX;
    double m_originY;
    std::unordered_map<uint32_t, char> m_colourIndex;
    std::vector<Tavo_GrWPoint> m_points;
};
