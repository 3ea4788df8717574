#include "GdiCallRecorder.h"

#include <algorithm>
#include <iterator>
#include <numeric>
#include <utility>

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

BOOL WINAPI RecordPolyPolyline(HDC dc, const POINT* points, const DWORD* counts, DWORD polylines)
{
    GdiCall call{GdiCall::PolyPolyline};
    call.counts = counts;
    call.countValues.assign(counts, counts + polylines);
    call.points.assign(points, points + std::accumulate(counts, counts + polylines, DWORD(0)));
    Note(std::move(call));
    return Forward<decltype(&PolyPolyline)>(GdiCall::PolyPolyline)(dc, points, counts, polylines);
}

BOOL WINAPI RecordPolygon(HDC dc, const POINT* points, int count)
{
    GdiCall call{GdiCall::Polygon};
    call.points.assign(points, points + std::max(count, 0));
    Note(std::move(call));
    return Forward<decltype(&Polygon)>(GdiCall::Polygon)(dc, points, count);
}

// Rectangle and Ellipse.
template <GdiCall::Kind kind>
BOOL WINAPI RecordBox(HDC dc, int left, int top, int right, int bottom)
{
    Note({kind, {left, top, right, bottom}});
    return Forward<decltype(&Rectangle)>(kind)(dc, left, top, right, bottom);
}

BOOL WINAPI RecordTextOutA(HDC dc, int x, int y, LPCSTR text, int length)
{
    Note({GdiCall::TextOut, {x, y}, nullptr, 0, 0, nullptr, std::string(text, std::max(length, 0))});
    return Forward<decltype(&TextOutA)>(GdiCall::TextOut)(dc, x, y, text, length);
}

HGDIOBJ WINAPI RecordSelectObject(HDC dc, HGDIOBJ object)
{
    const HGDIOBJ displaced = Forward<decltype(&SelectObject)>(GdiCall::SelectObject)(dc, object);
    Note({GdiCall::SelectObject, {}, object, 0, 0, displaced});
    return displaced;
}

HPEN WINAPI RecordCreatePen(int style, int width, COLORREF colour)
{
    const HPEN pen = Forward<decltype(&CreatePen)>(GdiCall::CreatePen)(style, width, colour);
    GdiCall call{GdiCall::CreatePen, {}, pen, static_cast<UINT>(style), colour};
    call.width = width;
    Note(std::move(call));
    return pen;
}

HBRUSH WINAPI RecordCreateBrushIndirect(const LOGBRUSH* description)
{
    const HBRUSH brush = Forward<decltype(&CreateBrushIndirect)>(GdiCall::CreateBrush)(description);
    Note({GdiCall::CreateBrush, {}, brush, description->lbStyle, description->lbColor});
    return brush;
}

HFONT WINAPI RecordCreateFontIndirectA(const LOGFONTA* description)
{
    const HFONT font = Forward<decltype(&CreateFontIndirectA)>(GdiCall::CreateFont)(description);
    Note({GdiCall::CreateFont, {}, font, static_cast<UINT>(description->lfHeight)});
    return font;
}

BOOL WINAPI RecordDeleteObject(HGDIOBJ object)
{
    const BOOL deleted = Forward<decltype(&DeleteObject)>(GdiCall::DeleteObject)(object);
    Note({GdiCall::DeleteObject, {}, object, static_cast<UINT>(deleted)});
    return deleted;
}

UINT WINAPI RecordSetTextAlign(HDC dc, UINT align)
{
    Note({GdiCall::SetTextAlign, {}, nullptr, align});
    return Forward<decltype(&SetTextAlign)>(GdiCall::SetTextAlign)(dc, align);
}

COLORREF WINAPI RecordSetTextColor(HDC dc, COLORREF colour)
{
    Note({GdiCall::SetTextColor, {}, nullptr, 0, colour});
    return Forward<decltype(&SetTextColor)>(GdiCall::SetTextColor)(dc, colour);
}

#define TAVO_RECORD(function)                                   \
    {                                                           \
#function, reinterpret_cast < void*>(&Record##function) \
    }

// In the order of GdiCall::Kind.
const std::pair<const char*, void*> kReplacements[] = {
    TAVO_RECORD(PolyPolyline),
    TAVO_RECORD(Polygon),
    {"Rectangle", reinterpret_cast<void*>(&RecordBox<GdiCall::Rectangle>)},
    {"Ellipse", reinterpret_cast<void*>(&RecordBox<GdiCall::Ellipse>)},
    TAVO_RECORD(TextOutA),
    TAVO_RECORD(SelectObject),
    TAVO_RECORD(CreatePen),
    TAVO_RECORD(CreateBrushIndirect),
    TAVO_RECORD(CreateFontIndirectA),
    TAVO_RECORD(DeleteObject),
    TAVO_RECORD(SetTextAlign),
    TAVO_RECORD(SetTextColor),
};

#undef TAVO_RECORD

} // namespace

GdiCallRecorder::GdiCallRecorder()
{
    s_current = this;
    const HMODULE module = GetModuleHandleA("libTavo_Windows.dll");
    for (const auto& entry : kReplacements)
        m_redirects.push_back(std::make_unique<ImportPatch>(module, entry.first, entry.second));
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
    m_created += call.IsCreation() && call.object;
    m_deleted += call.kind == GdiCall::DeleteObject && call.value;
    m_calls.push_back(std::move(call));
}

std::vector<GdiCall> GdiCallRecorder::Of(GdiCall::Kind kind) const
{
    std::vector<GdiCall> calls;
    std::copy_if(m_calls.begin(), m_calls.end(), std::back_inserter(calls),
                 [kind](const GdiCall& call) { return call.kind == kind; });
    return calls;
}
