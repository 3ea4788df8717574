// Tavo_DxfWalker: walks the entities of a parsed drawing, expanding every
// insert, and hands what is to be drawn to a sink as plane shapes in drawing
// coordinates.
//
// Classes: Tavo_DxfStyle (layer and colour of a shape), Tavo_DxfSink (what the
// shapes go to), Tavo_DxfWalker.
//
// The walk is deterministic: two walks of one model with one flattening hand
// the same shapes to their sinks in the same order, and count the same items,
// points and text bytes. The importer walks three times: for the extents, to
// count at the final flattening, and to build; only the last adds anything.
//
// A walk fails (Walk returns false) as soon as its counts pass the limits;
// everything else that is wrong with an entity skips the entity, with a
// warning when the walk was given a warnings list.
#pragma once

#include "Tavo_DxfColours.h"
#include "Tavo_DxfGeometry.h"
#include "Tavo_DxfImport.h"
#include "Tavo_DxfModel.h"
#include "Tavo_DxfWarnings.h"

#include <string>
#include <vector>

struct Tavo_DxfStyle {
    int layer = 0; // index in the model's layers
    Tavo_DxfRgb colour;
};

// Core alignment codes the walker chooses from (Tavo_GrAttr's text alignment).
struct Tavo_DxfTextPlacement {
    Tavo_DxfXY anchor;
    double height = 0.0;
    char align = 0;
};

class Tavo_DxfSink {
public:
    virtual ~Tavo_DxfSink() = default;
    virtual void Dot(const Tavo_DxfStyle& style, const Tavo_DxfXY& p) = 0;
    virtual void Line(const Tavo_DxfStyle& style, const Tavo_DxfXY& p, const Tavo_DxfXY& q) = 0;
    // At least 2 points; closed: the last point joins the first.
    virtual void Polyline(const Tavo_DxfStyle& style, const std::vector<Tavo_DxfXY>& points, bool closed) = 0;
    // A filled triangle or quadrilateral.
    virtual void Polygon(const Tavo_DxfStyle& style, const Tavo_DxfXY* points, int count) = 0;
    virtual void Circle(const Tavo_DxfStyle& style, const Tavo_DxfXY& centre, double radius) = 0;
    virtual void Text(const Tavo_DxfStyle& style, const Tavo_DxfTextPlacement& placement, const std::string& text) = 0;
};

// A sink that draws nothing: for walks that only count.
class Tavo_DxfNullSink : public Tavo_DxfSink {
public:
    void Dot(const Tavo_DxfStyle&, const Tavo_DxfXY&) override {}
    void Line(const Tavo_DxfStyle&, const Tavo_DxfXY&, const Tavo_DxfXY&) override {}
    void Polyline(const Tavo_DxfStyle&, const std::vector<Tavo_DxfXY>&, bool) override {}
    void Polygon(const Tavo_DxfStyle&, const Tavo_DxfXY*, int) override {}
    void Circle(const Tavo_DxfStyle&, const Tavo_DxfXY&, double) override {}
    void Text(const Tavo_DxfStyle&, const Tavo_DxfTextPlacement&, const std::string&) override {}
};

class Tavo_DxfWalker {
public:
    // Character height of texts that give none (0), in drawing units.
    static constexpr double kDefaultTextHeight = 2.5;
    // Points farther out than this after every transform are not drawn: no
    // drawing worth showing reaches there, and it keeps every sum finite.
    static constexpr double kLargestWorldCoordinate = 1e18;

    // warnings: null for a walk that should not repeat the warnings of
    // another one.
    Tavo_DxfWalker(const Tavo_DxfModel& model, Tavo_DxfSink& sink, const Tavo_DxfFlattening& flattening,
                   const Tavo_DxfLimits& limits, Tavo_DxfWarnings* warnings);

    bool Walk();

    const std::string& Error() const { return m_error; }
    int ErrorLine() const { return m_errorLine; }
    long long Items() const { return m_items; }
    long long Points() const { return m_points; }
    long long TextBytes() const { return m_textBytes; }
    // Entities (at any depth of inserts) skipped for what they hold.
    int Skipped() const { return m_skipped; }

private:
    struct Context {
        Tavo_DxfAffine transform; // block coordinates to drawing coordinates
        int insertLayer = -1;     // the layer entities on layer "0" take; -1 at the top
        Tavo_DxfRgb byBlock;      // the colour "by block" stands for
        int depth = 0;
    };

    void Entity(const Tavo_DxfEntity& entity, const Context& context);
    void Insert(const Tavo_DxfEntity& entity, const Context& context);
    void Circle(const Tavo_DxfEntity& entity, const Context& context, const Tavo_DxfStyle& style);
    void Arc(const Tavo_DxfEntity& entity, const Context& context, const Tavo_DxfStyle& style);
    void Ellipse(const Tavo_DxfEntity& entity, const Context& context, const Tavo_DxfStyle& style);
    void Polyline(const Tavo_DxfEntity& entity, const Context& context, const Tavo_DxfStyle& style);
    void Solid(const Tavo_DxfEntity& entity, const Context& context, const Tavo_DxfStyle& style);
    void Text(const Tavo_DxfEntity& entity, const Context& context, const Tavo_DxfStyle& style);
    void MText(const Tavo_DxfEntity& entity, const Context& context, const Tavo_DxfStyle& style);

    int EffectiveLayer(const Tavo_DxfEntity& entity, const Context& context) const;
    Tavo_DxfRgb ColourOf(const Tavo_DxfEntity& entity, int layer, const Context& context) const;

    // Each counts the item and passes it on, unless a limit or the range of
    // coordinates forbids; the points are in drawing coordinates.
    bool Count(long long items, long long points, long long textBytes);
    void EmitPolyline(const Tavo_DxfStyle& style, bool closed);
    void EmitText(const Tavo_DxfStyle& style, const Tavo_DxfTextPlacement& placement, const std::string& text);
    bool InRange(const Tavo_DxfXY& p) const;
    bool ScratchInRange() const;

    void Skip(const Tavo_DxfEntity& entity, const std::string& why);
    bool Fail(std::string message);

    // The flattening in an entity's own coordinates, for a transform that
    // stretches lengths by up to `stretch`.
    Tavo_DxfFlattening LocalFlattening(const Tavo_DxfAffine& transform) const;

    const Tavo_DxfModel& m_model;
    Tavo_DxfSink& m_sink;
    Tavo_DxfFlattening m_flattening;
    Tavo_DxfLimits m_limits;
    Tavo_DxfWarnings* m_warnings;
    bool m_utf8 = false;
    int m_layerZero = -1;

    std::vector<int> m_activeBlocks; // the inserts being expanded, outermost first
    std::vector<Tavo_DxfXY> m_scratch;
    const Tavo_DxfEntity* m_current = nullptr; // the entity of the ENTITIES section being walked

    long long m_items = 0;
    long long m_points = 0;
    long long m_textBytes = 0;
    long long m_work = 0;
    int m_skipped = 0;
    bool m_failed = false;
    std::string m_error;
    int m_errorLine = 0;
};
