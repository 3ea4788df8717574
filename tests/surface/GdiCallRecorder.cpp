#include "GdiCallRecorder.h"

#include <algorithm>
#include <iterator>

GdiCallRecorder* GdiCallRecorder::s_current = nullptr;

namespace {

template <class Function>
Function Forward(GdiCall::Kind kind)
{
    return reinterpret_cast<Function>(GdiCallRecorder::Current()->Original(kind));
}

void Note(GdiCall call)
{
    GdiCallRecorder::Current()->Add(std::move(call));
}

void Note(GdiCall::Kind kind, HGDIOBJ object, UINT value = 0, COLORREF colour = 0)
{
    GdiCall call;
    call.kind = kind;
    call.object = object;
    call.value = value;
    call.colour = colour;
    Note(std::move(call));
}

GdiCall BoxCall(GdiCall::Kind kind, int left, int top, int right, int bottom)
{
    GdiCall call;
    call.kind = kind;
    call.box = {left, top, right, bottom};
    return call;
}

BOOL WINAPI RecordPolyPolyline(HDC dc, const POINT* points, const DWORD* counts, DWORD polylines)
{
    GdiCall call;
    call.counts = counts;
    call.count = static_cast<int>(polylines);
    call.countValues.assign(counts, counts + polylines);
    DWORD total = 0;
    for (DWORD n : call.countValues)
        total += n;
    call.points.assign(points, points + total);
    Note(std::move(call));
    return Forward<decltype(&PolyPolyline)>(GdiCall::PolyPolyline)(dc, points, counts, polylines);
}

BOOL WINAPI RecordPolygon(HDC dc, const POINT* points, int count)
{
    GdiCall call;
    call.kind = GdiCall::Polygon;
    call.points.assign(points, points + std::max(count, 0));
    Note(std::move(call));
    return Forward<decltype(&Polygon)>(GdiCall::Polygon)(dc, points, count);
}

BOOL WINAPI RecordRectangle(HDC dc, int left, int top, int right, int bottom)
{
    Note(BoxCall(GdiCall::Rectangle, left, top, right, bottom));
    return Forward<decltype(&Rectangle)>(GdiCall::Rectangle)(dc, left, top, right, bottom);
}

BOOL WINAPI RecordEllipse(HDC dc, int left, int top, int right, int bottom)
{
    Note(BoxCall(GdiCall::Ellipse, left, top, right, bottom));
    return Forward<decltype(&Ellipse)>(GdiCall::Ellipse)(dc, left, top, right, bottom);
}

BOOL WINAPI RecordTextOutA(HDC dc, int x, int y, LPCSTR text, int length)
{
    GdiCall call = BoxCall(GdiCall::TextOut, x, y, 0, 0);
    call.text.assign(text, std::max(length, 0));
    Note(std::move(call));
    return Forward<decltype(&TextOutA)>(GdiCall::TextOut)(dc, x, y, text, length);
}

HGDIOBJ WINAPI RecordSelectObject(HDC dc, HGDIOBJ object)
{
    GdiCall call;
    call.kind = GdiCall::SelectObject;
    call.object = object;
    call.displaced = Forward<decltype(&SelectObject)>(GdiCall::SelectObject)(dc, object);
    Note(call);
    return call.displaced;
}

HPEN WINAPI RecordCreatePen(int style, int width, COLORREF colour)
{
    const HPEN pen = Forward<decltype(&CreatePen)>(GdiCall::CreatePen)(style, width, colour);
    Note(GdiCall::CreatePen, pen, 0, colour);
    return pen;
}

HBRUSH WINAPI RecordCreateBrushIndirect(const LOGBRUSH* description)
{
    const HBRUSH brush = Forward<decltype(&CreateBrushIndirect)>(GdiCall::CreateBrush)(description);
    Note(GdiCall::CreateBrush, brush, description->lbStyle, description->lbColor);
    return brush;
}

HFONT WINAPI RecordCreateFontIndirectA(const LOGFONTA* description)
{
    const HFONT font = Forward<decltype(&CreateFontIndirectA)>(GdiCall::CreateFont)(description);
    Note(GdiCall::CreateFont, font, static_cast<UINT>(description->lfHeight));
    return font;
}

BOOL WINAPI RecordDeleteObject(HGDIOBJ object)
{
    const BOOL deleted = Forward<decltype(&DeleteObject)>(GdiCall::DeleteObject)(object);
    Note(GdiCall::DeleteObject, object, static_cast<UINT>(deleted));
    return deleted;
}

UINT WINAPI RecordSetTextAlign(HDC dc, UINT align)
{
    Note(GdiCall::SetTextAlign, nullptr, align);
    return Forward<decltype(&SetTextAlign)>(GdiCall::SetTextAlign)(dc, align);
}

COLORREF WINAPI RecordSetTextColor(HDC dc, COLORREF colour)
{
    Note(GdiCall::SetTextColor, nullptr, 0, colour);
    return Forward<decltype(&SetTextColor)>(GdiCall::SetTextColor)(dc, colour);
}

// In the order of GdiCall::Kind.
const struct {
    const char* function;
    void* replacement;
} kReplacements[] = {
    {"PolyPolyline", reinterpret_cast<void*>(&RecordPolyPolyline)},
    {"Polygon", reinterpret_cast<void*>(&RecordPolygon)},
    {"Rectangle", reinterpret_cast<void*>(&RecordRectangle)},
    {"Ellipse", reinterpret_cast<void*>(&RecordEllipse)},
    {"TextOutA", reinterpret_cast<void*>(&RecordTextOutA)},
    {"SelectObject", reinterpret_cast<void*>(&RecordSelectObject)},
    {"CreatePen", reinterpret_cast<void*>(&RecordCreatePen)},
    {"CreateBrushIndirect", reinterpret_cast<void*>(&RecordCreateBrushIndirect)},
    {"CreateFontIndirectA", reinterpret_cast<void*>(&RecordCreateFontIndirectA)},
    {"DeleteObject", reinterpret_cast<void*>(&RecordDeleteObject)},
    {"SetTextAlign", reinterpret_cast<void*>(&RecordSetTextAlign)},
    {"SetTextColor", reinterpret_cast<void*>(&RecordSetTextColor)},
};

} // namespace

GdiCallRecorder::GdiCallRecorder()
{
    s_current = this;
    const HMODULE module = GetModuleHandleA("libTavo_Windows.dll");
    for (const auto& entry : kReplacements)
        m_redirects.push_back(std::make_unique<ImportPatch>(module, entry.function, entry.replacement));
}

GdiCallRecorder::~GdiCallRecorder()
{
    m_redirects.clear();
    s_current = nullptr;
}

bool GdiCallRecorder::IsActive() const
{
    return std::all_of(m_redirects.begin(), m_redirects.end(),
                       [](const std::unique_ptr<ImportPatch>& patch) { return patch->IsActive(); });
}

void GdiCallRecorder::Add(GdiCall call)
{
    const bool made = call.kind == GdiCall::CreatePen || call.kind == GdiCall::CreateBrush
        || call.kind == GdiCall::CreateFont;
    if (made && call.object)
        ++m_created;
    if (call.kind == GdiCall::DeleteObject && call.value)
        ++m_deleted;
    if (m_keepCalls)
        m_calls.push_back(std::move(call));
}

std::vector<GdiCall> GdiCallRecorder::Of(GdiCall::Kind kind) const
{
    std::vector<GdiCall> calls;
    std::copy_if(m_calls.begin(), m_calls.end(), std::back_inserter(calls),
                 [kind](const GdiCall& call) { return call.kind == kind; });
    return calls;
}
