// Tavo_GrDrawing: the drawing model and the drawing pass. Tavo_GrSurface.h
// describes the order of calls a pass makes.
#include "Tavo_GrDrawing.h"

#include "Tavo_GrDrawingData.h"
#include "Tavo_GrMapping.h"
#include "Tavo_GrPolygonFill.h"
#include "Tavo_GrRound.h"
#include "Tavo_GrSurface.h"

#include <algorithm>
#include <climits>
#include <cstring>

namespace {

// A pass that visits more than one item in this many marks them instead of
// sorting their numbers.
constexpr size_t kMarkingShare = 16;

// The device rectangle the pass covers, widened for pixels drawn beyond an
// item's exact extent; false when the pass covers everything.
bool PassArea(const Tavo_GrMapping& mapping, const Tavo_GrDRect* clip, Tavo_GrDRect& area)
{
    if (clip) {
        area = {std::min(clip->xmin, clip->xmax), std::min(clip->ymin, clip->ymax), std::max(clip->xmin, clip->xmax),
                std::max(clip->ymin, clip->ymax)};
    } else if (mapping.GetDeviceWindowWidth() > 0 && mapping.GetDeviceWindowHeight() > 0) {
        area = {0, 0, mapping.GetDeviceWindowWidth(), mapping.GetDeviceWindowHeight()};
    } else {
        return false;
    }
    const int margin = Tavo_GrDrawing::kClipMarginPixels;
    area = {Tavo_GrAdd(area.xmin, -margin), Tavo_GrAdd(area.ymin, -margin), Tavo_GrAdd(area.xmax, margin),
            Tavo_GrAdd(area.ymax, margin)};
    return true;
}

} // namespace

// ---- Tavo_GrLayer ---------------------------------------------------------

Tavo_GrLayer::Tavo_GrLayer(std::unique_ptr<Tavo_GrLayerData> data) : m_data(std::move(data)) {}
Tavo_GrLayer::~Tavo_GrLayer() = default;

const char* Tavo_GrLayer::GetName() const { return m_data->name.c_str(); }
int Tavo_GrLayer::GetIndex() const { return m_data->index; }
bool Tavo_GrLayer::IsVisible() const { return m_data->visible; }
int Tavo_GrLayer::GetItemCount() const { return static_cast<int>(m_data->items.size()); }

// ---- Tavo_GrDrawing: the model ---------------------------------------------

Tavo_GrDrawing::Tavo_GrDrawing() : m_data(std::make_unique<Tavo_GrDrawingData>()) {}
Tavo_GrDrawing::~Tavo_GrDrawing() = default;

Tavo_GrWRect Tavo_GrDrawing::GetBounds() const
{
    return m_data->bounds;
}

void Tavo_GrDrawing::FetchBounds(Tavo_GrWRect& bounds) const
{
    bounds = m_data->bounds;
}

bool Tavo_GrDrawing::IsEmpty() const
{
    return m_data->itemCount == 0;
}

int Tavo_GrDrawing::GetItemCount() const
{
    return m_data->itemCount;
}

int Tavo_GrDrawing::GetLayerCount() const
{
    return static_cast<int>(m_data->layers.size());
}

const Tavo_GrLayer* Tavo_GrDrawing::GetLayer(int index) const
{
    if (index < 0 || index >= GetLayerCount())
        return nullptr;
    return m_data->layers[index].get();
}

void Tavo_GrDrawing::SetLayerVisible(int index, bool visible)
{
    if (index < 0 || index >= GetLayerCount())
        return;
    m_data->layers[index]->m_data->visible = visible;
}

// ---- Tavo_GrDrawing: the pass -----------------------------------------------

void Tavo_GrDrawing::Draw(Tavo_GrSurface& surface, const Tavo_GrMapping& mapping, const Tavo_GrDRect* clip) const
{
    surface.ResetDrawingInterruptFlags();
    const Tavo_GrTransform& transform = mapping.GetTransform();
    surface.SetTransform(transform);
    surface.SetDeviceHeight(mapping.GetDeviceWindowHeight());

    Tavo_GrDRect area;
    surface.m_hasWorldClip = PassArea(mapping, clip, area);
    if (surface.m_hasWorldClip)
        surface.m_worldClip = transform.InvertRect(area);
    surface.m_callDepth = 0;
    surface.m_itemsSincePoll = 0;

    surface.BeginDrawing(this);
    DrawItems(surface, true);
    surface.Flush();
    surface.EndDrawing();
}

namespace {

// Draws one item; the surface's transform places it.
void DrawItem(Tavo_GrSurface& surface, Tavo_GrDrawingData& data, const Tavo_GrItem& item)
{
    const Tavo_GrTransform& t = surface.GetTransform();
    // The surface operations take a non-const attribute for historical
    // reasons; surfaces never write through it.
    Tavo_GrAttr* attr = &data.attrs[item.attr];
    const Tavo_GrWPoint* p = data.points.data() + item.points;

    switch (item.kind) {
    case Tavo_GrItemKind::Dot: {
        Tavo_GrDPoint d = t.Point(p[0]);
        surface.DrawDot(d, attr);
        break;
    }
    case Tavo_GrItemKind::Line: {
        Tavo_GrDPoint a = t.Point(p[0]);
        Tavo_GrDPoint b = t.Point(p[1]);
        surface.DrawLine(a, b, attr);
        break;
    }
    case Tavo_GrItemKind::Polyline:
    case Tavo_GrItemKind::Polygon: {
        // The pool keeps its capacity, so after the first pass this does not allocate.
        std::vector<Tavo_GrDPoint>& device = data.devicePoints;
        device.resize(item.count);
        for (int i = 0; i < item.count; ++i)
            device[i] = t.Point(p[i]);
        if (item.kind == Tavo_GrItemKind::Polyline)
            surface.DrawPline(item.count, device.data(), attr);
        else
            surface.DrawPolygon(item.count, device.data(), attr);
        break;
    }
    case Tavo_GrItemKind::Rect: {
        Tavo_GrDRect r = t.Rect({p[0].x, p[0].y, p[1].x, p[1].y});
        surface.DrawRect(r, attr);
        break;
    }
    case Tavo_GrItemKind::Circle: {
        Tavo_GrDPoint centre = t.Point(p[0]);
        surface.DrawCircle(centre, t.Length(item.count), attr);
        break;
    }
    case Tavo_GrItemKind::Triangle: {
        Tavo_GrDPoint corners[3] = {t.Point(p[0]), t.Point(p[1]), t.Point(p[2])};
        surface.DrawTriangle(corners, attr);
        break;
    }
    case Tavo_GrItemKind::Text: {
        Tavo_GrDPoint anchor = t.Point(p[0]);
        surface.DrawText(data.texts.data() + item.count, anchor, attr);
        break;
    }
    case Tavo_GrItemKind::TextBox: {
        Tavo_GrDRect box = t.Rect({p[0].x, p[0].y, p[1].x, p[1].y});
        const int pixels = std::max(0, Tavo_GrRound(attr->GetCharHeight() * t.GetScale()));
        surface.DrawText(data.texts.data() + item.count, box, attr, static_cast<unsigned int>(pixels));
        break;
    }
    case Tavo_GrItemKind::Call: {
        const Tavo_GrCall* call = &data.calls[item.count];
        switch (call->GetKind()) {
        case Tavo_GrCall::EH: surface.DrawEHCall(call); break;
        case Tavo_GrCall::EHSignal: surface.DrawEHSignalCall(call); break;
        case Tavo_GrCall::Plain:
        default: surface.DrawCall(call); break;
        }
        break;
    }
    }
}

} // namespace

namespace {

bool Contains(const Tavo_GrWRect& outer, const Tavo_GrWRect& inner)
{
    return outer.x1 <= inner.x1 && outer.y1 <= inner.y1 && inner.x2 <= outer.x2 && inner.y2 <= outer.y2;
}

// Every item of the layer, in order. Returns false once the pass is interrupted.
template <typename KeepGoing>
bool DrawAllItems(Tavo_GrSurface& surface, Tavo_GrDrawingData& data, const Tavo_GrLayerData& layer, KeepGoing keepGoing)
{
    for (const Tavo_GrItem& item : layer.items) {
        DrawItem(surface, data, item);
        if (!keepGoing())
            return false;
    }
    return true;
}

// Whether what the item holding text may draw meets the clip. A call is found
// by its bounds widened as far as any text of the layer reaches, which holds
// the text of the called drawing; that drawing's own pass culls its items.
bool TextMeets(const Tavo_GrDrawingData& data, const Tavo_GrLayerData& layer, uint32_t index,
               const Tavo_GrWRect& clip, double floor)
{
    const Tavo_GrWRect& bounds = layer.bounds[index];
    if (Tavo_GrIntersects(bounds, clip))
        return true;
    const Tavo_GrItem& item = layer.items[index];
    if (item.kind != Tavo_GrItemKind::Text && item.kind != Tavo_GrItemKind::TextBox)
        return true;
    const Tavo_GrAttr& attr = data.attrs[item.attr];
    const int length = Tavo_GrSaturate(static_cast<long long>(std::strlen(data.texts.data() + item.count)));
    const int height = attr.GetCharHeight();
    const char align = attr.GetTextAlign();
    const Tavo_GrWRect extent = item.kind == Tavo_GrItemKind::Text
        ? Tavo_GrText::PointExtent(bounds, data.points[item.points], height, length, align, floor)
        : Tavo_GrText::BoxExtent(bounds, height, length, align, floor);
    return Tavo_GrIntersects(extent, clip);
}

// Appends to hits the items holding text whose text may be drawn inside the
// clip: those the text index finds within the clip widened by the farthest
// the layer's text reaches, each then checked by its own extent.
void FindTextItems(const Tavo_GrSurface& surface, const Tavo_GrDrawingData& data, const Tavo_GrLayerData& layer,
                   const Tavo_GrWRect& clip, std::vector<uint32_t>& hits)
{
    const double floor = Tavo_GrText::Floor(surface.GetMinTextPixels(), surface.GetScale());
    const Tavo_GrWPoint reach = layer.textFacts.Reach(floor);
    const Tavo_GrWRect area{Tavo_GrSubtract(clip.x1, reach.x), Tavo_GrSubtract(clip.y1, reach.y),
                            Tavo_GrAdd(clip.x2, reach.x), Tavo_GrAdd(clip.y2, reach.y)};
    const size_t first = hits.size();
    layer.textIndex.Query(area, layer.bounds, hits);
    size_t kept = first;
    for (size_t i = first; i < hits.size(); ++i)
        if (TextMeets(data, layer, hits[i], clip, floor))
            hits[kept++] = hits[i];
    hits.resize(kept); // shrinking: no allocation
}

// The items of the layer that meet the surface's world clip, in order, found
// through the spatial indexes. Returns false once the pass is interrupted.
template <typename KeepGoing>
bool DrawVisibleItems(Tavo_GrSurface& surface, Tavo_GrDrawingData& data, Tavo_GrLayerData& layer, KeepGoing keepGoing,
                      const Tavo_GrWRect& clip)
{
    // A pass over this drawing started while another one walks it (a surface
    // that draws the drawing again from one of its operations) finds the
    // lists busy and uses lists of its own.
    std::vector<uint32_t> ownHits;
    std::vector<uint8_t> ownMarks;
    const bool claimed = !layer.hitsBusy;
    std::vector<uint32_t>& hits = claimed ? layer.hits : ownHits;
    std::vector<uint8_t>& marks = claimed ? layer.marks : ownMarks;
    layer.hitsBusy = true;

    hits.clear();
    layer.spatialIndex.Query(clip, layer.bounds, hits);
    if (layer.textFacts.Any())
        FindTextItems(surface, data, layer, clip, hits);
    bool going = true;
    if (hits.size() * kMarkingShare < layer.items.size()) {
        std::sort(hits.begin(), hits.end());
        for (size_t i = 0; i < hits.size() && going; ++i) {
            DrawItem(surface, data, layer.items[hits[i]]);
            going = keepGoing();
        }
    } else {
        // Many items: marking them and walking the layer costs less than sorting.
        marks.resize(layer.items.size());
        for (uint32_t item : hits)
            marks[item] = 1;
        for (size_t i = 0; i < marks.size(); ++i) {
            if (!marks[i])
                continue;
            marks[i] = 0;
            if (going) {
                DrawItem(surface, data, layer.items[i]);
                going = keepGoing();
            }
        }
    }
    if (claimed)
        layer.hitsBusy = false;
    return going;
}

} // namespace

void Tavo_GrPrepareLayer(Tavo_GrDrawingData& data, Tavo_GrLayerData& layer)
{
    if (layer.spatialIndex.IsBuilt())
        return;
    if (layer.textFacts.Any()) {
        std::vector<uint32_t> plain;
        std::vector<uint32_t> text;
        for (uint32_t i = 0; i < layer.items.size(); ++i)
            (layer.items[i].holdsText ? text : plain).push_back(i);
        layer.spatialIndex.Build(layer.bounds, std::move(plain));
        layer.textIndex.Build(layer.bounds, std::move(text));
    } else {
        layer.spatialIndex.Build(layer.bounds);
    }
    layer.hits.reserve(layer.items.size());
    layer.marks.assign(layer.items.size(), 0);
    data.devicePoints.reserve(data.largestPointCount);
    Tavo_GrPolygonScratch().reserve(data.largestPointCount);
}

bool Tavo_GrDrawing::DrawItems(Tavo_GrSurface& surface, bool withLayers) const
{
    Tavo_GrDrawingData& data = *m_data;

    // After each item: stop once interrupted; ask the surface every so often.
    auto keepGoing = [&surface]() {
        if (surface.m_drawingInterrupted)
            return false;
        if (++surface.m_itemsSincePoll < Tavo_GrSurface::kPollInterval)
            return true;
        surface.m_itemsSincePoll = 0;
        return !surface.PollDrawInterrupt() && !surface.m_drawingInterrupted;
    };

    for (const std::unique_ptr<Tavo_GrLayer>& layerObject : data.layers)
        Tavo_GrPrepareLayer(data, *layerObject->m_data);

    for (const std::unique_ptr<Tavo_GrLayer>& layerObject : data.layers) {
        Tavo_GrLayerData& layer = *layerObject->m_data;
        if (!layer.visible)
            continue;
        if (withLayers)
            surface.BeginLayer(layerObject.get());

        const bool going = surface.m_hasWorldClip && !Contains(surface.m_worldClip, layer.extent)
            ? DrawVisibleItems(surface, data, layer, keepGoing, surface.m_worldClip)
            : DrawAllItems(surface, data, layer, keepGoing);
        if (withLayers)
            surface.EndLayer();
        if (!going)
            return false;
    }
    return true;
}
