// Tavo_GrDrawing: what lies under a world rectangle. The layers' spatial
// indexes give the items whose bounds meet it; each is then tested by its
// shape.
#include "Tavo_GrDrawing.h"

#include "Tavo_GrDrawingData.h"
#include "Tavo_GrHitTest.h"
#include "Tavo_GrRound.h"

#include <algorithm>

namespace {

Tavo_GrWRect Moved(const Tavo_GrWRect& r, int dx, int dy)
{
    return {Tavo_GrSubtract(r.x1, dx), Tavo_GrSubtract(r.y1, dy), Tavo_GrSubtract(r.x2, dx), Tavo_GrSubtract(r.y2, dy)};
}

// Whether the item's shape meets the area (the drawing's header says how each
// kind meets it).
bool ShapeMeets(const Tavo_GrDrawingData& data, const Tavo_GrItem& item, const Tavo_GrWRect& bounds,
                const Tavo_GrWRect& area)
{
    using namespace Tavo_GrHitTest;
    const Tavo_GrWPoint* p = data.points.data() + item.points;
    const bool filled = !data.attrs[item.attr].IsHollow();
    switch (item.kind) {
    case Tavo_GrItemKind::Dot: return Contains(area, p[0].x, p[0].y);
    case Tavo_GrItemKind::Line: return SegmentMeets(p[0], p[1], area);
    case Tavo_GrItemKind::Polyline: return ChainMeets(p, item.count, false, area);
    case Tavo_GrItemKind::Polygon: return PolygonMeets(p, item.count, filled, area);
    case Tavo_GrItemKind::Triangle: return PolygonMeets(p, 3, filled, area);
    case Tavo_GrItemKind::Rect: return RectMeets(bounds, filled, area);
    case Tavo_GrItemKind::Circle: return CircleMeets(p[0], item.count, filled, area);
    case Tavo_GrItemKind::Text:
    case Tavo_GrItemKind::TextBox: return Tavo_GrIntersects(bounds, area);
    case Tavo_GrItemKind::Call: {
        const Tavo_GrCall& call = data.calls[item.count];
        int found = 0;
        // The builder refuses cycles, so the recursion ends.
        call.GetDrawing()->FindItems(Moved(area, call.GetDx(), call.GetDy()), [&found](const Tavo_GrItemInfo&) {
            ++found;
            return false;
        });
        return found > 0;
    }
    }
    return false;
}

} // namespace

int Tavo_GrDrawing::FindItems(const Tavo_GrWRect& rect, const Tavo_GrItemVisitor& visitor) const
{
    if (!visitor)
        return 0;
    const Tavo_GrWRect area{std::min(rect.x1, rect.x2), std::min(rect.y1, rect.y2), std::max(rect.x1, rect.x2),
                            std::max(rect.y1, rect.y2)};
    Tavo_GrDrawingData& data = *m_data;
    int reported = 0;
    std::vector<uint32_t> candidates;
    for (const std::unique_ptr<Tavo_GrLayer>& layerObject : data.layers) {
        Tavo_GrLayerData& layer = *layerObject->m_data;
        if (!layer.visible || layer.items.empty() || !Tavo_GrIntersects(layer.extent, area))
            continue;
        Tavo_GrPrepareLayer(data, layer);
        candidates.clear();
        layer.spatialIndex.Query(area, layer.bounds, candidates);
        if (layer.textFacts.Any())
            layer.textIndex.Query(area, layer.bounds, candidates);
        std::sort(candidates.begin(), candidates.end());
        for (uint32_t index : candidates) {
            const Tavo_GrItem& item = layer.items[index];
            const Tavo_GrWRect& bounds = layer.bounds[index];
            if (!ShapeMeets(data, item, bounds, area))
                continue;
            Tavo_GrItemInfo info;
            info.layer = layerObject.get();
            info.index = static_cast<int>(index);
            info.kind = item.kind;
            info.attr = data.attrs[item.attr];
            info.bounds = bounds;
            if (item.kind == Tavo_GrItemKind::Text || item.kind == Tavo_GrItemKind::TextBox)
                info.text = data.texts.data() + item.count;
            ++reported;
            if (!visitor(info))
                return reported;
        }
    }
    return reported;
}
