// Tavo_GrDrawing: a drawing of the graphics core, and how it is drawn.
// Tavo_GrLayer:   a named group of a drawing's items, drawn in order.
// Tavo_GrCall:    an item that places another drawing at an offset.
// Tavo_GrItemKind, Tavo_GrItemInfo: what FindItems reports of an item.
//
// A drawing holds items of these kinds, each with its attribute (Tavo_GrAttr):
// dot, line, polyline, polygon, rectangle, circle, triangle, text at a point,
// text wrapped in a box, and calls. Items belong to layers; layers are drawn in
// the order they were made, the items of a layer in the order they were added.
// Drawings are made with Tavo_GrDrawingBuilder.
//
// Draw(surface, mapping, clip) calls the surface as Tavo_GrSurface.h describes.
// Item coordinates are turned into device coordinates by the mapping's
// transform (a circle's radius and a text box's font height are scaled and
// rounded); only items whose world bounds meet the clip are visited, and items
// holding text when what the surface may draw for their text meets it (below).
// The clip is the device rectangle given (or the whole device window when none
// is given; everything when the device window is empty too), widened by
// kClipMarginPixels on every side for the pixels a surface may draw beyond an
// item's exact extent, and inverted through the transform. Spatial indexes,
// built once per layer at the first pass after items were added, find those
// items, so a pass over a small part of a large drawing costs in proportion to
// what it visits. That first pass also makes room for everything a pass may
// need, so later passes allocate no memory (until items are added again).
//
// World bounds of an item: its points (a circle: centre +- radius; a text at a
// point: a box of length x charHeight by charHeight on each side of the point's
// baseline, placed by the horizontal alignment; a text box: the box; a call: the
// called drawing's bounds at the call's offset, as they were when the call was
// added).
//
// Text is drawn beyond those bounds, so text is culled by where it may be
// drawn. With E the character height, raised to the surface's smallest text
// height (Tavo_GrSurface::GetMinTextPixels) where it scales to less: a text
// at a point may be drawn within a box of length x E by 1.5 E on each side of
// its baseline, placed by the horizontal alignment (a surface may set a cell E
// high up to half a cell off the baseline); a text box's lines start at the
// box's left edge by the horizontal alignment (right- and centre-aligned lines
// lie left of it), are no wider than the box or 3 E or, below the smallest
// height, the whole text at E, and reach at most 2 E below the box. A call of
// a drawing that held text when the call was added is found by its bounds
// widened by as much as the text of its layer may reach.
//
// FindItems(area, visitor) answers what lies under a world rectangle (a
// pointer's aperture): it reports, in the order they are drawn, the items of
// the visible layers whose shapes meet the area, touching counts. Lines,
// polylines and the outlines of hollow shapes meet it where a segment or the
// circle passes through it; filled shapes also with their inside; dots where
// the point lies in it; texts and text boxes by their bounds (not by where a
// surface may draw their text); a call when an item of the called drawing
// meets the area moved back by the call's offset. The layers' spatial indexes
// find the candidates, so a query costs about what a pass over the same area
// costs.
//
// A drawing is not thread-safe: draw and query it from one thread at a time.
#pragma once

#include "Tavo_CoreApi.h"
#include "Tavo_GrAttr.h"
#include "Tavo_GrTypes.h"

#include <cstdint>
#include <functional>
#include <memory>

class Tavo_GrMapping;
class Tavo_GrSurface;
class Tavo_GrDrawing;
struct Tavo_GrDrawingData;
struct Tavo_GrLayerData;

// The kinds of items, in the terms of Tavo_GrDrawingBuilder's Add operations.
enum class Tavo_GrItemKind : uint8_t {
    Dot,
    Line,
    Polyline,
    Polygon,
    Rect,
    Circle,
    Triangle,
    Text,
    TextBox,
    Call
};

class TAVO_CORE_API Tavo_GrCall {
public:
    enum Kind {
        Plain = 0,    // drawn through Tavo_GrSurface::DrawCall
        EH = 1,       // a call that carries an event handler: DrawEHCall
        EHSignal = 2, // a call that signals its event handler: DrawEHSignalCall
    };

    Tavo_GrCall() = default;
    Tavo_GrCall(const Tavo_GrDrawing* drawing, int dx, int dy, Kind kind = Plain)
        : m_drawing(drawing), m_dx(dx), m_dy(dy), m_kind(kind)
    {
    }

    const Tavo_GrDrawing* GetDrawing() const { return m_drawing; } // not owned
    int GetDx() const { return m_dx; }
    int GetDy() const { return m_dy; }
    Kind GetKind() const { return m_kind; }

private:
    const Tavo_GrDrawing* m_drawing = nullptr;
    int m_dx = 0;
    int m_dy = 0;
    Kind m_kind = Plain;
};

class TAVO_CORE_API Tavo_GrLayer {
public:
    ~Tavo_GrLayer();
    Tavo_GrLayer(const Tavo_GrLayer&) = delete;
    Tavo_GrLayer& operator=(const Tavo_GrLayer&) = delete;

    const char* GetName() const;
    int GetIndex() const;
    bool IsVisible() const;
    int GetItemCount() const;

private:
    friend class Tavo_GrDrawing;
    friend class Tavo_GrDrawingBuilder;
    explicit Tavo_GrLayer(std::unique_ptr<Tavo_GrLayerData> data);

    std::unique_ptr<Tavo_GrLayerData> m_data;
};

// One item found by Tavo_GrDrawing::FindItems. The pointers stay valid while
// the drawing lives and no layer is added to it.
struct Tavo_GrItemInfo {
    const Tavo_GrLayer* layer = nullptr; // the item's layer; not owned
    int index = 0;                       // the item's place in its layer, from 0, in the order added
    Tavo_GrItemKind kind = Tavo_GrItemKind::Dot;
    Tavo_GrAttr attr;
    Tavo_GrWRect bounds;        // the item's world bounds (see above)
    const char* text = nullptr; // a text's or text box's text; null for other kinds
};

// Called with each item found; returning false stops the search.
using Tavo_GrItemVisitor = std::function<bool(const Tavo_GrItemInfo&)>;

class TAVO_CORE_API Tavo_GrDrawing {
public:
    static constexpr int kClipMarginPixels = 4;

    Tavo_GrDrawing();
    ~Tavo_GrDrawing();
    Tavo_GrDrawing(const Tavo_GrDrawing&) = delete;
    Tavo_GrDrawing& operator=(const Tavo_GrDrawing&) = delete;

    // Draws the items that meet clip (device coordinates, y up; null: the
    // device window) onto the surface through the mapping's transform.
    void Draw(Tavo_GrSurface& surface, const Tavo_GrMapping& mapping, const Tavo_GrDRect* clip) const;

    // The world extent of all items; all zero for an empty drawing.
    Tavo_GrWRect GetBounds() const;
    void FetchBounds(Tavo_GrWRect& bounds) const;
    bool IsEmpty() const;

    int GetItemCount() const;
    int GetLayerCount() const;
    // Null for an index outside 0 ... GetLayerCount() - 1.
    const Tavo_GrLayer* GetLayer(int index) const;
    void SetLayerVisible(int index, bool visible);

    // Reports to visitor every item of a visible layer whose shape meets area
    // (world units; a rectangle with swapped corners counts as its normalised
    // form), in drawing order, until the visitor returns false; returns how
    // many items were reported. Nothing for a null visitor. A visitor must
    // not add to the drawing.
    int FindItems(const Tavo_GrWRect& area, const Tavo_GrItemVisitor& visitor) const;

private:
    friend class Tavo_GrDrawingBuilder;
    friend class Tavo_GrSurface;

    // Visits the items that meet the surface's world clip, layer by layer
    // (BeginLayer/EndLayer only when withLayers is set); returns false once the
    // pass is interrupted.
    bool DrawItems(Tavo_GrSurface& surface, bool withLayers) const;

    std::unique_ptr<Tavo_GrDrawingData> m_data;
};
