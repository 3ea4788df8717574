// The storage of a drawing and of its layers, shared by Tavo_GrDrawing (which
// draws it) and Tavo_GrDrawingBuilder (which fills it). Not part of the
// core's interface.
//
// An item is 16 bytes: its kind, whether it holds text (a text, a text box, or
// a call of a drawing that held text when the call was added), its attribute
// (an index into the drawing's attribute table), where its points start in the
// drawing's point pool and one more number whose meaning depends on the kind:
//
//   kind       points                       count
//   Dot        1                            -
//   Line       2                            -
//   Polyline   count                        number of points
//   Polygon    count                        number of points
//   Rect       2 (x1, y1), (x2, y2)         -
//   Circle     1 centre                     radius in world units
//   Triangle   3                            -
//   Text       1 anchor                     offset of the text in the text pool
//   TextBox    2 corners of the box         offset of the text in the text pool
//   Call       -                            index in the call table
#pragma once

#include "Tavo_GrAttr.h"
#include "Tavo_GrDrawing.h"
#include "Tavo_GrSpatialIndex.h"
#include "Tavo_GrTextReach.h"
#include "Tavo_GrTypes.h"

#include <cstdint>
#include <memory>
#include <string>
#include <vector>

struct Tavo_GrItem {
    Tavo_GrItemKind kind = Tavo_GrItemKind::Dot;
    bool holdsText = false;
    uint32_t attr = 0;
    uint32_t points = 0;
    int32_t count = 0;
};
static_assert(sizeof(Tavo_GrItem) == 16, "an item stays 16 bytes");

struct Tavo_GrLayerData {
    std::string name;
    int index = 0;
    bool visible = true;
    std::vector<Tavo_GrItem> items;
    std::vector<Tavo_GrWRect> bounds; // one per item
    Tavo_GrWRect extent;              // of all items (valid when there are items)
    // Of the items that hold text: text may be drawn beyond its bounds.
    Tavo_GrText::Facts textFacts;

    // Built at the first Draw after items were added (cleared by adding): one
    // index of the items without text, found by their bounds, and one of the
    // items that hold text, found by where their text may be drawn.
    Tavo_GrSpatialIndex spatialIndex;
    Tavo_GrSpatialIndex textIndex;
    // The items a pass visits, kept between passes so that passes do not
    // allocate; busy while a pass walks them (a pass started inside that pass
    // uses storage of its own).
    std::vector<uint32_t> hits;
    // One mark per item, all clear between passes: a pass that visits many
    // items marks them and walks the layer in order instead of sorting.
    std::vector<uint8_t> marks;
    bool hitsBusy = false;
};

struct Tavo_GrDrawingData {
    std::vector<std::unique_ptr<Tavo_GrLayer>> layers;
    std::vector<Tavo_GrAttr> attrs;
    std::vector<Tavo_GrWPoint> points;
    std::vector<char> texts; // zero-terminated texts, one after the other
    std::vector<Tavo_GrCall> calls;
    Tavo_GrWRect bounds;
    int itemCount = 0;
    int largestPointCount = 0; // of the polylines and polygons
    // Of all text in the drawing, for the layers of drawings that call it.
    Tavo_GrText::Facts textFacts;

    // Device points of the polyline or polygon being drawn.
    std::vector<Tavo_GrDPoint> devicePoints;
};

// Builds the layer's spatial indexes and makes room for whatever a pass may
// visit, once after items were added (nothing when the indexes are built), so
// that later passes do not allocate. Passes and queries call it first.
void Tavo_GrPrepareLayer(Tavo_GrDrawingData& data, Tavo_GrLayerData& layer);
