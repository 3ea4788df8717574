#include "BatchedCallLog.h"

#include "ImportPatch.h"

#include <memory>

namespace {

BatchedCallLog* g_log = nullptr;

struct Forwarders {
    decltype(&PolyPolyline) polyPolyline = nullptr;
    decltype(&Polygon) polygon = nullptr;
    decltype(&Rectangle) rectangle = nullptr;
    decltype(&Ellipse) ellipse = nullptr;
    decltype(&SelectObject) selectObject = nullptr;
    decltype(&CreatePen) createPen = nullptr;
    decltype(&CreateBrushIndirect) createBrush = nullptr;
    decltype(&DeleteObject) deleteObject = nullptr;
    decltype(&SetTextColor) setTextColor = nullptr;
} g_forward;

using Op = BatchedCallLog::Op;

Op MakeOp(BatchedCallLog::Code code, int a = 0, int b = 0, int c = 0, int d = 0)
{
    Op op;
    op.code = code;
    op.a = a;
    op.b = b;
    op.c = c;
    op.d = d;
    return op;
}

BOOL WINAPI RecordPolyPolyline(HDC dc, const POINT* points, const DWORD* counts, DWORD polylines)
{
    // The surface's batches hold polylines of one length each.
    const int perPolyline = polylines > 0 ? static_cast<int>(counts[0]) : 2;
    Op op = MakeOp(BatchedCallLog::PolyPolylineOp, static_cast<int>(polylines), perPolyline);
    op.offset = g_log->AddPoints(points, static_cast<size_t>(polylines) * perPolyline);
    g_log->AddOp(op);
    NoteCounts(*g_log, perPolyline, static_cast<int>(polylines));
    return g_forward.polyPolyline(dc, points, counts, polylines);
}

BOOL WINAPI RecordPolygon(HDC dc, const POINT* points, int count)
{
    Op op = MakeOp(BatchedCallLog::PolygonOp, count);
    op.offset = g_log->AddPoints(points, static_cast<size_t>(count));
    g_log->AddOp(op);
    return g_forward.polygon(dc, points, count);
}

BOOL WINAPI RecordRectangle(HDC dc, int l, int t, int r, int b)
{
    g_log->AddOp(MakeOp(BatchedCallLog::RectangleOp, l, t, r, b));
    return g_forward.rectangle(dc, l, t, r, b);
}

BOOL WINAPI RecordEllipse(HDC dc, int l, int t, int r, int b)
{
    g_log->AddOp(MakeOp(BatchedCallLog::EllipseOp, l, t, r, b));
    return g_forward.ellipse(dc, l, t, r, b);
}

HGDIOBJ WINAPI RecordSelectObject(HDC dc, HGDIOBJ object)
{
    const int slot = g_log->FindSlot(object);
    Op op = MakeOp(slot >= 0 ? BatchedCallLog::SelectCreatedOp : BatchedCallLog::SelectOtherOp, slot);
    op.other = object; // a stock object or one the DC held before the pass
    g_log->AddOp(op);
    return g_forward.selectObject(dc, object);
}

HPEN WINAPI RecordCreatePen(int style, int width, COLORREF colour)
{
    HPEN pen = g_forward.createPen(style, width, colour);
    g_log->AddOp(MakeOp(BatchedCallLog::CreatePenOp, g_log->NewSlot(pen), style, width, static_cast<int>(colour)));
    return pen;
}

HBRUSH WINAPI RecordCreateBrushIndirect(const LOGBRUSH* description)
{
    HBRUSH brush = g_forward.createBrush(description);
    g_log->AddOp(MakeOp(BatchedCallLog::CreateBrushOp, g_log->NewSlot(brush), static_cast<int>(description->lbStyle),
                        static_cast<int>(description->lbColor)));
    return brush;
}

BOOL WINAPI RecordDeleteObject(HGDIOBJ object)
{
    const int slot = g_log->FindSlot(object);
    if (slot >= 0) {
        g_log->AddOp(MakeOp(BatchedCallLog::DeleteCreatedOp, slot));
        g_log->FreeSlot(slot);
    }
    return g_forward.deleteObject(object);
}

COLORREF WINAPI RecordSetTextColor(HDC dc, COLORREF colour)
{
    g_log->AddOp(MakeOp(BatchedCallLog::SetTextColorOp, static_cast<int>(colour)));
    return g_forward.setTextColor(dc, colour);
}

} // namespace

void NoteCounts(BatchedCallLog& log, int pointsPerPolyline, int polylines)
{
    if (pointsPerPolyline < 0 || pointsPerPolyline > 5)
        return;
    std::vector<DWORD>& counts = log.m_counts[pointsPerPolyline];
    if (static_cast<int>(counts.size()) < polylines)
        counts.assign(static_cast<size_t>(polylines), static_cast<DWORD>(pointsPerPolyline));
}

size_t BatchedCallLog::AddPoints(const POINT* points, size_t count)
{
    const size_t offset = m_points.size();
    m_points.insert(m_points.end(), points, points + count);
    return offset;
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

bool BatchedCallLog::Record(const std::function<void()>& pass)
{
    const HMODULE module = GetModuleHandleA("libTavo_Windows.dll");
    struct Entry {
        const char* name;
        void* replacement;
        void** forward;
    };
    const Entry entries[] = {
        {"PolyPolyline", reinterpret_cast<void*>(&RecordPolyPolyline), reinterpret_cast<void**>(&g_forward.polyPolyline)},
        {"Polygon", reinterpret_cast<void*>(&RecordPolygon), reinterpret_cast<void**>(&g_forward.polygon)},
        {"Rectangle", reinterpret_cast<void*>(&RecordRectangle), reinterpret_cast<void**>(&g_forward.rectangle)},
        {"Ellipse", reinterpret_cast<void*>(&RecordEllipse), reinterpret_cast<void**>(&g_forward.ellipse)},
        {"SelectObject", reinterpret_cast<void*>(&RecordSelectObject), reinterpret_cast<void**>(&g_forward.selectObject)},
        {"CreatePen", reinterpret_cast<void*>(&RecordCreatePen), reinterpret_cast<void**>(&g_forward.createPen)},
        {"CreateBrushIndirect", reinterpret_cast<void*>(&RecordCreateBrushIndirect),
         reinterpret_cast<void**>(&g_forward.createBrush)},
        {"DeleteObject", reinterpret_cast<void*>(&RecordDeleteObject), reinterpret_cast<void**>(&g_forward.deleteObject)},
        {"SetTextColor", reinterpret_cast<void*>(&RecordSetTextColor), reinterpret_cast<void**>(&g_forward.setTextColor)},
    };
    std::vector<std::unique_ptr<ImportPatch>> patches;
    for (const Entry& entry : entries) {
        patches.push_back(std::make_unique<ImportPatch>(module, entry.name, entry.replacement));
        if (!patches.back()->IsActive())
            return false;
        *entry.forward = patches.back()->GetOriginal();
    }
    m_ops.clear();
    m_points.clear();
    m_recordedSlots.clear();
    g_log = this;
    pass();
    g_log = nullptr;
    m_replaySlots.assign(m_recordedSlots.size(), nullptr);
    return true;
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
