// Tavo_GrDrawingBuilder: appends items to a drawing and keeps its bounds.
#include "Tavo_GrDrawingBuilder.h"

#include "Tavo_GrDrawingData.h"
#include "Tavo_GrRound.h"

#include <algorithm>
#include <climits>
#include <cstring>

namespace {

int Clamp(long long value)
{
    return static_cast<int>(std::clamp<long long>(value, INT_MIN, INT_MAX));
}

Tavo_GrWRect Normalised(int x1, int y1, int x2, int y2)
{
    return {std::min(x1, x2), std::min(y1, y2), std::max(x1, x2), std::max(y1, y2)};
}

Tavo_GrWRect BoundsOf(const Tavo_GrWPoint* points, int count)
{
    Tavo_GrWRect box{points[0].x, points[0].y, points[0].x, points[0].y};
    for (int i = 1; i < count; ++i) {
        box.x1 = std::min(box.x1, points[i].x);
        box.y1 = std::min(box.y1, points[i].y);
        box.x2 = std::max(box.x2, points[i].x);
        box.y2 = std::max(box.y2, points[i].y);
    }
    return box;
}

} // namespace

Tavo_GrDrawingBuilder::Tavo_GrDrawingBuilder(Tavo_GrDrawing& drawing) : m_drawing(drawing)
{
    const int layers = drawing.GetLayerCount();
    m_layer = layers > 0 ? layers - 1 : -1;
}

int Tavo_GrDrawingBuilder::BeginLayer(const char* name)
{
    Tavo_GrDrawingData& data = *m_drawing.m_data;
    auto layerData = std::make_unique<Tavo_GrLayerData>();
    layerData->name = name ? name : "";
    layerData->index = static_cast<int>(data.layers.size());
    data.layers.push_back(std::unique_ptr<Tavo_GrLayer>(new Tavo_GrLayer(std::move(layerData))));
    m_layer = static_cast<int>(data.layers.size()) - 1;
    return m_layer;
}

bool Tavo_GrDrawingBuilder::UseLayer(int index)
{
    if (index < 0 || index >= m_drawing.GetLayerCount())
        return false;
    m_layer = index;
    return true;
}

void Tavo_GrDrawingBuilder::Reserve(int items, int points)
{
    Tavo_GrLayerData& layer = CurrentLayer();
    if (items > 0) {
        layer.items.reserve(layer.items.size() + items);
        layer.bounds.reserve(layer.bounds.size() + items);
    }
    if (points > 0)
        m_drawing.m_data->points.reserve(m_drawing.m_data->points.size() + points);
}

Tavo_GrLayerData& Tavo_GrDrawingBuilder::CurrentLayer()
{
    if (m_layer < 0 || m_layer >= m_drawing.GetLayerCount())
        BeginLayer("default");
    return *m_drawing.m_data->layers[m_layer]->m_data;
}

uint32_t Tavo_GrDrawingBuilder::CurrentAttrIndex()
{
    std::vector<Tavo_GrAttr>& attrs = m_drawing.m_data->attrs;
    if (m_attrIndex < 0 || attrs[m_attrIndex] != m_attr) {
        attrs.push_back(m_attr);
        m_attrIndex = static_cast<int>(attrs.size()) - 1;
    }
    return static_cast<uint32_t>(m_attrIndex);
}

bool Tavo_GrDrawingBuilder::AddItem(int kind, const Tavo_GrWPoint* points, int pointCount, int count,
                                    const Tavo_GrWRect& bounds, const Tavo_GrText::Facts* text)
{
    Tavo_GrDrawingData& data = *m_drawing.m_data;
    Tavo_GrLayerData& layer = CurrentLayer();

    Tavo_GrItem item;
    item.kind = static_cast<Tavo_GrItemKind>(kind);
    if (text && text->Any()) {
        item.holdsText = true;
        layer.textFacts.Add(*text);
        data.textFacts.Add(*text);
    }
    item.attr = CurrentAttrIndex();
    item.points = static_cast<uint32_t>(data.points.size());
    item.count = count;
    data.points.insert(data.points.end(), points, points + pointCount);
    layer.extent = layer.items.empty() ? bounds
                                       : Tavo_GrWRect{std::min(layer.extent.x1, bounds.x1), std::min(layer.extent.y1, bounds.y1),
                                                      std::max(layer.extent.x2, bounds.x2), std::max(layer.extent.y2, bounds.y2)};
    layer.items.push_back(item);
    layer.bounds.push_back(bounds);
    layer.spatialIndex.Clear();
    layer.textIndex.Clear();

    data.bounds = data.itemCount == 0 ? bounds
                                      : Tavo_GrWRect{std::min(data.bounds.x1, bounds.x1), std::min(data.bounds.y1, bounds.y1),
                                                     std::max(data.bounds.x2, bounds.x2), std::max(data.bounds.y2, bounds.y2)};
    ++data.itemCount;
    data.largestPointCount = std::max(data.largestPointCount, pointCount);
    return true;
}

bool Tavo_GrDrawingBuilder::AddDot(int x, int y)
{
    const Tavo_GrWPoint p{x, y};
    return AddItem(static_cast<int>(Tavo_GrItemKind::Dot), &p, 1, 0, {x, y, x, y});
}

bool Tavo_GrDrawingBuilder::AddLine(int x1, int y1, int x2, int y2)
{
    const Tavo_GrWPoint p[2] = {{x1, y1}, {x2, y2}};
    return AddItem(static_cast<int>(Tavo_GrItemKind::Line), p, 2, 0, Normalised(x1, y1, x2, y2));
}

bool Tavo_GrDrawingBuilder::AddPolyline(int count, const Tavo_GrWPoint* points)
{
    if (!points || count < 2)
        return false;
    return AddItem(static_cast<int>(Tavo_GrItemKind::Polyline), points, count, count, BoundsOf(points, count));
}

bool Tavo_GrDrawingBuilder::AddPolygon(int count, const Tavo_GrWPoint* points)
{
    if (!points || count < 3)
        return false;
    return AddItem(static_cast<int>(Tavo_GrItemKind::Polygon), points, count, count, BoundsOf(points, count));
}

bool Tavo_GrDrawingBuilder::AddRect(int x1, int y1, int x2, int y2)
{
    const Tavo_GrWRect box = Normalised(x1, y1, x2, y2);
    const Tavo_GrWPoint p[2] = {{box.x1, box.y1}, {box.x2, box.y2}};
    return AddItem(static_cast<int>(Tavo_GrItemKind::Rect), p, 2, 0, box);
}

bool Tavo_GrDrawingBuilder::AddCircle(int x, int y, int radius)
{
    const Tavo_GrWPoint p{x, y};
    const long long r = std::max(radius, 0);
    const Tavo_GrWRect box{Clamp(x - r), Clamp(y - r), Clamp(x + r), Clamp(y + r)};
    return AddItem(static_cast<int>(Tavo_GrItemKind::Circle), &p, 1, radius, box);
}

bool Tavo_GrDrawingBuilder::AddTriangle(const Tavo_GrWPoint& p0, const Tavo_GrWPoint& p1, const Tavo_GrWPoint& p2)
{
    const Tavo_GrWPoint p[3] = {p0, p1, p2};
    return AddItem(static_cast<int>(Tavo_GrItemKind::Triangle), p, 3, 0, BoundsOf(p, 3));
}

namespace {

// Appends the text to the pool and returns where it starts.
int32_t PoolText(std::vector<char>& pool, const char* text)
{
    const char* t = text ? text : "";
    const int32_t offset = static_cast<int32_t>(pool.size());
    pool.insert(pool.end(), t, t + std::strlen(t) + 1);
    return offset;
}

int TextLength(const char* text)
{
    return text ? Tavo_GrSaturate(static_cast<long long>(std::strlen(text))) : 0;
}

} // namespace

bool Tavo_GrDrawingBuilder::AddText(int x, int y, const char* text)
{
    const long long length = text ? static_cast<long long>(std::strlen(text)) : 0;
    const long long height = std::llabs(static_cast<long long>(m_attr.GetCharHeight()));
    const long long width = length * height;
    long long left = x;
    switch (m_attr.GetTextAlign() & Tavo_GrAttr::kHorizontalAlignMask) {
    case Tavo_GrAttr::AlignRight: left = x - width; break;
    case Tavo_GrAttr::AlignCentre: left = x - width / 2; break;
    default: break;
    }
    const Tavo_GrWRect box{Clamp(left), Clamp(y - height), Clamp(left + width), Clamp(y + height)};
    const Tavo_GrWPoint p{x, y};
    const int32_t offset = PoolText(m_drawing.m_data->texts, text);
    Tavo_GrText::Facts facts;
    facts.AddPointText(m_attr.GetCharHeight(), TextLength(text));
    return AddItem(static_cast<int>(Tavo_GrItemKind::Text), &p, 1, offset, box, &facts);
}

bool Tavo_GrDrawingBuilder::AddTextBox(const Tavo_GrWRect& box, const char* text)
{
    const Tavo_GrWRect b = Normalised(box.x1, box.y1, box.x2, box.y2);
    const Tavo_GrWPoint p[2] = {{b.x1, b.y1}, {b.x2, b.y2}};
    const int32_t offset = PoolText(m_drawing.m_data->texts, text);
    Tavo_GrText::Facts facts;
    facts.AddBoxText(b, m_attr.GetCharHeight(), TextLength(text), m_attr.GetTextAlign());
    return AddItem(static_cast<int>(Tavo_GrItemKind::TextBox), p, 2, offset, b, &facts);
}

bool Tavo_GrDrawingBuilder::Calls(const Tavo_GrDrawing& from, const Tavo_GrDrawing* target, int depth)
{
    if (depth <= 0)
        return true; // deeper than any chain worth drawing: refuse as if a cycle
    for (const Tavo_GrCall& call : from.m_data->calls) {
        if (call.GetDrawing() == target || Calls(*call.GetDrawing(), target, depth - 1))
            return true;
    }
    return false;
}

bool Tavo_GrDrawingBuilder::AddCall(const Tavo_GrDrawing* drawing, int dx, int dy, Tavo_GrCall::Kind kind)
{
    // A call that would make the drawing reach itself again is refused, so the
    // calls of drawings never form a cycle.
    if (!drawing || drawing == &m_drawing || Calls(*drawing, &m_drawing, kMaxCallChain))
        return false;
    Tavo_GrDrawingData& data = *m_drawing.m_data;
    const Tavo_GrWRect called = drawing->GetBounds();
    const Tavo_GrWRect box{Clamp(static_cast<long long>(called.x1) + dx), Clamp(static_cast<long long>(called.y1) + dy),
                           Clamp(static_cast<long long>(called.x2) + dx), Clamp(static_cast<long long>(called.y2) + dy)};
    data.calls.emplace_back(drawing, dx, dy, kind);
    // The called drawing's text may reach beyond its bounds as its own does.
    return AddItem(static_cast<int>(Tavo_GrItemKind::Call), nullptr, 0, static_cast<int>(data.calls.size()) - 1, box,
                   &drawing->m_data->textFacts);
}
