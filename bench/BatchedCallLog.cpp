#include "BatchedCallLog.h"

#include "GdiCallRecorder.h"

#include <algorithm>

bool BatchedCallLog::Record(const std::function<void()>& pass)
{
    GdiCallRecorder recorder;
    if (!recorder.IsActive())
        return false;
    pass();
    m_ops.clear();
    m_points.clear();
    m_recordedSlots.clear();
    for (const GdiCall& call : recorder.GetCalls()) {
        if (!Add(call))
            return false;
    }
    m_replaySlots.assign(m_recordedSlots.size(), nullptr);
    return true;
}

bool BatchedCallLog::Add(const GdiCall& call)
{
    Op op;
    switch (call.kind) {
    case GdiCall::PolyPolyline: {
        const std::vector<DWORD>& counts = call.countValues;
        const int perPolyline = counts.empty() ? 2 : static_cast<int>(counts.front());
        const bool uniform = std::all_of(counts.begin(), counts.end(),
                                         [perPolyline](DWORD count) { return static_cast<int>(count) == perPolyline; });
        if (!uniform || perPolyline > kMaxPointsPerPolyline)
            return false;
        op.code = PolyPolylineOp;
        op.a = static_cast<int>(counts.size());
        op.b = perPolyline;
        op.offset = AddPoints(call.points);
        NoteCounts(perPolyline, op.a);
        break;
    }
    case GdiCall::Polygon:
        op.code = PolygonOp;
        op.a = static_cast<int>(call.points.size());
        op.offset = AddPoints(call.points);
        break;
    case GdiCall::Rectangle:
    case GdiCall::Ellipse:
        op.code = call.kind == GdiCall::Rectangle ? RectangleOp : EllipseOp;
        op.a = call.box[0];
        op.b = call.box[1];
        op.c = call.box[2];
        op.d = call.box[3];
        break;
    case GdiCall::SelectObject:
        op.a = FindSlot(call.object);
        op.code = op.a >= 0 ? SelectCreatedOp : SelectOtherOp;
        op.other = call.object; // a stock object or one the DC held before the pass
        break;
    case GdiCall::CreatePen:
        op.code = CreatePenOp;
        op.a = NewSlot(call.object);
        op.b = static_cast<int>(call.value);
        op.c = call.width;
        op.d = static_cast<int>(call.colour);
        break;
    case GdiCall::CreateBrush:
        op.code = CreateBrushOp;
        op.a = NewSlot(call.object);
        op.b = static_cast<int>(call.value);
        op.c = static_cast<int>(call.colour);
        break;
    case GdiCall::DeleteObject:
        op.code = DeleteCreatedOp;
        op.a = FindSlot(call.object);
        if (op.a < 0)
            return true;
        m_recordedSlots[static_cast<size_t>(op.a)] = nullptr;
        break;
    case GdiCall::SetTextColor:
        op.code = SetTextColorOp;
        op.a = static_cast<int>(call.colour);
        break;
    case GdiCall::TextOut:
    case GdiCall::CreateFont:
    case GdiCall::SetTextAlign:
        return true;
    }
    m_ops.push_back(op);
    return true;
}

size_t BatchedCallLog::AddPoints(const std::vector<POINT>& points)
{
    const size_t offset = m_points.size();
    m_points.insert(m_points.end(), points.begin(), points.end());
    return offset;
}

void BatchedCallLog::NoteCounts(int pointsPerPolyline, int polylines)
{
    std::vector<DWORD>& counts = m_counts[pointsPerPolyline];
    if (static_cast<int>(counts.size()) < polylines)
        counts.assign(static_cast<size_t>(polylines), static_cast<DWORD>(pointsPerPolyline));
}

int BatchedCallLog::FindSlot(HGDIOBJ object) const
{
    // Few objects live at once: a pen and a brush, briefly two of each.
    for (size_t i = m_recordedSlots.size(); i-- > 0;)
        if (m_recordedSlots[i] == object)
            return static_cast<int>(i);
    return -1;
}

int BatchedCallLog::NewSlot(HGDIOBJ object)
{
    for (size_t i = 0; i < m_recordedSlots.size(); ++i) {
        if (!m_recordedSlots[i]) {
            m_recordedSlots[i] = object;
            return static_cast<int>(i);
        }
    }
    m_recordedSlots.push_back(object);
    return static_cast<int>(m_recordedSlots.size() - 1);
}

void BatchedCallLog::Replay(HDC dc) const
{
    for (const Op& op : m_ops) {
        switch (op.code) {
        case PolyPolylineOp:
            PolyPolyline(dc, m_points.data() + op.offset, m_counts[op.b].data(), static_cast<DWORD>(op.a));
            break;
        case PolygonOp:
            Polygon(dc, m_points.data() + op.offset, op.a);
            break;
        case RectangleOp:
            Rectangle(dc, op.a, op.b, op.c, op.d);
            break;
        case EllipseOp:
            Ellipse(dc, op.a, op.b, op.c, op.d);
            break;
        case SelectCreatedOp:
            SelectObject(dc, m_replaySlots[op.a]);
            break;
        case SelectOtherOp:
            SelectObject(dc, op.other);
            break;
        case CreatePenOp:
            m_replaySlots[op.a] = CreatePen(op.b, op.c, static_cast<COLORREF>(op.d));
            break;
        case CreateBrushOp: {
            LOGBRUSH description = {};
            description.lbStyle = static_cast<UINT>(op.b);
            description.lbColor = static_cast<COLORREF>(op.c);
            m_replaySlots[op.a] = CreateBrushIndirect(&description);
            break;
        }
        case DeleteCreatedOp:
            DeleteObject(m_replaySlots[op.a]);
            m_replaySlots[op.a] = nullptr;
            break;
        case SetTextColorOp:
            SetTextColor(dc, static_cast<COLORREF>(op.a));
            break;
        }
    }
}
