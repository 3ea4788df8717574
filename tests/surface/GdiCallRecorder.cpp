#include "GdiCallRecorder.h"

#include <algorithm>
#include <cstring>

GdiCallRecorder* GdiCallRecorder::s_current = nullptr;

namespace {

const char kSurfaceModule[] = "libTavo_Windows.dll";

template <class Function>
Function Forward(const char* function)
{
    return reinterpret_cast<Function>(GdiCallRecorder::Current()->Original(function));
}

void Record(GdiCall call)
{
    GdiCallRecorder::Current()->Add(std::move(call));
}

BOOL WINAPI RecordPolyPolyline(HDC dc, const POINT* points, const DWORD* counts, DWORD polylines)
{
    GdiCall call;
    call.kind = GdiCall::PolyPolyline;
    call.dc = dc;
    call.counts = counts;
    call.count = static_cast<int>(polylines);
    size_t total = 0;
    for (DWORD i = 0; i < polylines; ++i)
        total += counts[i];
    call.countValues.assign(counts, counts + polylines);
    call.points.assign(points, points + total);
    Record(std::move(call));
    return Forward<decltype(&PolyPolyline)>("PolyPolyline")(dc, points, counts, polylines);
}

BOOL WINAPI RecordPolygon(HDC dc, const POINT* points, int count)
{
    GdiCall call;
    call.kind = GdiCall::Polygon;
    call.dc = dc;
    call.count = count;
    call.points.assign(points, points + (count > 0 ? count : 0));
    Record(std::move(call));
    return Forward<decltype(&Polygon)>("Polygon")(dc, points, count);
}

GdiCall BoxCall(GdiCall::Kind kind, HDC dc, int left, int top, int right, int bottom)
{
    GdiCall call;
    call.kind = kind;
    call.dc = dc;
    call.values[0] = left;
    call.values[1] = top;
    call.values[2] = right;
    call.values[3] = bottom;
    return call;
}

BOOL WINAPI RecordRectangle(HDC dc, int left, int top, int right, int bottom)
{
    Record(BoxCall(GdiCall::Rectangle, dc, left, top, right, bottom));
    return Forward<decltype(&Rectangle)>("Rectangle")(dc, left, top, right, bottom);
}

BOOL WINAPI RecordEllipse(HDC dc, int left, int top, int right, int bottom)
{
    Record(BoxCall(GdiCall::Ellipse, dc, left, top, right, bottom));
    return Forward<decltype(&Ellipse)>("Ellipse")(dc, left, top, right, bottom);
}

BOOL WINAPI RecordTextOutA(HDC dc, int x, int y, LPCSTR text, int length)
{
    GdiCall call = BoxCall(GdiCall::TextOut, dc, x, y, 0, 0);
    call.text.assign(text, length > 0 ? length : 0);
    call.count = length;
    Record(std::move(call));
    return Forward<decltype(&TextOutA)>("TextOutA")(dc, x, y, text, length);
}

HGDIOBJ WINAPI RecordSelectObject(HDC dc, HGDIOBJ object)
{
    const HGDIOBJ displaced = Forward<decltype(&SelectObject)>("SelectObject")(dc, object);
    GdiCall call;
    call.kind = GdiCall::SelectObject;
    call.dc = dc;
    call.object = object;
    call.displaced = displaced;
    Record(std::move(call));
    return displaced;
}

HPEN WINAPI RecordCreatePen(int style, int width, COLORREF colour)
{
    const HPEN pen = Forward<decltype(&CreatePen)>("CreatePen")(style, width, colour);
    GdiCall call;
    call.kind = GdiCall::CreatePen;
    call.object = pen;
    call.value = static_cast<UINT>(style);
    call.count = width;
    call.colour = colour;
    Record(std::move(call));
    if (pen)
        GdiCallRecorder::Current()->NoteCreated();
    return pen;
}

HBRUSH WINAPI RecordCreateBrushIndirect(const LOGBRUSH* description)
{
    const HBRUSH brush = Forward<decltype(&CreateBrushIndirect)>("CreateBrushIndirect")(description);
    GdiCall call;
    call.kind = GdiCall::CreateBrush;
    call.object = brush;
    call.value = description->lbStyle;
    call.colour = description->lbColor;
    Record(std::move(call));
    if (brush)
        GdiCallRecorder::Current()->NoteCreated();
    return brush;
}

HFONT WINAPI RecordCreateFontIndirectA(const LOGFONTA* description)
{
    const HFONT font = Forward<decltype(&CreateFontIndirectA)>("CreateFontIndirectA")(description);
    GdiCall call;
    call.kind = GdiCall::CreateFont;
    call.object = font;
    call.font = *description;
    Record(std::move(call));
    if (font)
        GdiCallRecorder::Current()->NoteCreated();
    return font;
}

BOOL WINAPI RecordDeleteObject(HGDIOBJ object)
{
    const BOOL deleted = Forward<decltype(&DeleteObject)>("DeleteObject")(object);
    GdiCall call;
    call.kind = GdiCall::DeleteObject;
    call.object = object;
    Record(std::move(call));
    if (deleted)
        GdiCallRecorder::Current()->NoteDeleted();
    return deleted;
}

GdiCall ValueCall(GdiCall::Kind kind, HDC dc, UINT value)
{
    GdiCall call;
    call.kind = kind;
    call.dc = dc;
    call.value = value;
    return call;
}

UINT WINAPI RecordSetTextAlign(HDC dc, UINT align)
{
    Record(ValueCall(GdiCall::SetTextAlign, dc, align));
    return Forward<decltype(&SetTextAlign)>("SetTextAlign")(dc, align);
}

COLORREF WINAPI RecordSetTextColor(HDC dc, COLORREF colour)
{
    Record(ValueCall(GdiCall::SetTextColor, dc, colour));
    return Forward<decltype(&SetTextColor)>("SetTextColor")(dc, colour);
}

int WINAPI RecordSetBkMode(HDC dc, int mode)
{
    Record(ValueCall(GdiCall::SetBkMode, dc, static_cast<UINT>(mode)));
    return Forward<decltype(&SetBkMode)>("SetBkMode")(dc, mode);
}

int WINAPI RecordSetPolyFillMode(HDC dc, int mode)
{
    Record(ValueCall(GdiCall::SetPolyFillMode, dc, static_cast<UINT>(mode)));
    return Forward<decltype(&SetPolyFillMode)>("SetPolyFillMode")(dc, mode);
}

SHORT WINAPI RecordGetAsyncKeyState(int key)
{
    if (key == VK_ESCAPE)
        return GdiCallRecorder::Current()->IsEscapeDown() ? SHORT(0x8000) : SHORT(0);
    return Forward<decltype(&GetAsyncKeyState)>("GetAsyncKeyState")(key);
}

struct Replacement {
    const char* function;
    void* replacement;
};

const Replacement kReplacements[] = {
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
    {"SetBkMode", reinterpret_cast<void*>(&RecordSetBkMode)},
    {"SetPolyFillMode", reinterpret_cast<void*>(&RecordSetPolyFillMode)},
    {"GetAsyncKeyState", reinterpret_cast<void*>(&RecordGetAsyncKeyState)},
};

} // namespace

GdiCallRecorder::GdiCallRecorder()
{
    s_current = this;
    const HMODULE module = GetModuleHandleA(kSurfaceModule);
    for (const Replacement& entry : kReplacements)
        m_redirects.push_back({entry.function, std::make_unique<ImportPatch>(module, entry.function, entry.replacement)});
}

GdiCallRecorder::~GdiCallRecorder()
{
    m_redirects.clear();
    s_current = nullptr;
}

bool GdiCallRecorder::IsActive() const
{
    return std::all_of(m_redirects.begin(), m_redirects.end(),
                       [](const Redirect& redirect) { return redirect.patch->IsActive(); });
}

void* GdiCallRecorder::Original(const char* function) const
{
    for (const Redirect& redirect : m_redirects)
        if (std::strcmp(redirect.function, function) == 0)
            return redirect.patch->GetOriginal();
    return nullptr;
}

std::vector<GdiCall> GdiCallRecorder::Of(GdiCall::Kind kind) const
{
    std::vector<GdiCall> calls;
    for (const GdiCall& call : m_calls)
        if (call.kind == kind)
            calls.push_back(call);
    return calls;
}

int GdiCallRecorder::CountOf(GdiCall::Kind kind) const
{
    return static_cast<int>(std::count_if(m_calls.begin(), m_calls.end(),
                                          [kind](const GdiCall& call) { return call.kind == kind; }));
}

std::vector<GdiCall::Kind> GdiCallRecorder::GetKinds() const
{
    std::vector<GdiCall::Kind> kinds;
    for (const GdiCall& call : m_calls)
        kinds.push_back(call.kind);
    return kinds;
}
