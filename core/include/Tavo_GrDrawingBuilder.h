// Tavo_GrDrawingBuilder: makes a drawing in code.
//
// The builder appends items to one drawing. Each item takes the builder's
// current attribute (SetAttr; initially Tavo_GrAttr()) and goes into its current
// layer (the first item without BeginLayer makes a layer named "default").
// Rectangles are normalised. An item with invalid input (a null point array, a
// polyline of fewer than 2 points, a polygon or a triangle of fewer than 3, a
// null called drawing, a call of the drawing itself) is not added and the
// operation returns false; a null text counts as the empty text.
//
//     Tavo_GrDrawing drawing;
//     Tavo_GrDrawingBuilder build(drawing);
//     build.SetAttr(Tavo_GrAttr(4, 1));      // red, filled
//     build.AddRect(0, 0, 100, 50);
//     build.AddText(10, 60, "caption");
#pragma once

#include "Tavo_CoreApi.h"
#include "Tavo_GrAttr.h"
#include "Tavo_GrDrawing.h"
#include "Tavo_GrTypes.h"

#include <cstdint>

namespace Tavo_GrText {
struct Facts;
}

class TAVO_CORE_API Tavo_GrDrawingBuilder {
public:
    explicit Tavo_GrDrawingBuilder(Tavo_GrDrawing& drawing);

    void SetAttr(const Tavo_GrAttr& attr) { m_attr = attr; }
    const Tavo_GrAttr& GetAttr() const { return m_attr; }

    // Makes a new layer (drawn after those made before) and the current one;
    // returns its index. A null name counts as "".
    int BeginLayer(const char* name);
    // Makes an existing layer current; false for an unknown index.
    bool UseLayer(int index);

    // Room for that many more items and points, to make large drawings quickly.
    void Reserve(int items, int points);

    bool AddDot(int x, int y);
    bool AddLine(int x1, int y1, int x2, int y2);
    bool AddPolyline(int count, const Tavo_GrWPoint* points);
    bool AddPolygon(int count, const Tavo_GrWPoint* points);
    bool AddRect(int x1, int y1, int x2, int y2);
    bool AddCircle(int x, int y, int radius);
    bool AddTriangle(const Tavo_GrWPoint& p0, const Tavo_GrWPoint& p1, const Tavo_GrWPoint& p2);
    // Text at a point: the point is placed by the attribute's alignment code.
    bool AddText(int x, int y, const char* text);
    // Text wrapped into a box.
    bool AddTextBox(const Tavo_GrWRect& box, const char* text);
    // Places the other drawing, not owned, moved by (dx, dy).
    bool AddCall(const Tavo_GrDrawing* drawing, int dx, int dy, Tavo_GrCall::Kind kind = Tavo_GrCall::Plain);

    // Calls nested deeper than this are refused when they are added.
    static constexpr int kMaxCallChain = 64;

private:
    static bool Calls(const Tavo_GrDrawing& from, const Tavo_GrDrawing* target, int depth);

    // The layer new items go into, and the index of the builder's attribute in
    // the drawing's attribute table (added when it changed since the last item).
    Tavo_GrLayerData& CurrentLayer();
    uint32_t CurrentAttrIndex();
    // text: for an item that holds text, what the pass needs to know of it.
    bool AddItem(int kind, const Tavo_GrWPoint* points, int pointCount, int count, const Tavo_GrWRect& bounds,
                 const Tavo_GrText::Facts* text = nullptr);

    Tavo_GrDrawing& m_drawing;
    Tavo_GrAttr m_attr;
    int m_layer = -1;
    int m_attrIndex = -1;
};
