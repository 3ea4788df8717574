// GdiCallRecorder: records the GDI calls that libTavo_Windows.dll makes.
//
// While a recorder lives, the DLL's imports of the drawing, selection and
// object calls are redirected (ImportPatch) to functions that note the call
// and then forward it to GDI, so pixels are still drawn. One at a time.
#pragma once

#include "ImportPatch.h"

#include <windows.h>

#include <array>
#include <memory>
#include <string>
#include <vector>

struct GdiCall {
    enum Kind {
        PolyPolyline, Polygon, Rectangle, Ellipse, TextOut, SelectObject,
        CreatePen, CreateBrush, CreateFont, DeleteObject, SetTextAlign, SetTextColor,
    };
    Kind kind = PolyPolyline;
    // PolyPolyline: every polyline's points, the count array, its values and
    // their number. Polygon: its points.
    std::vector<POINT> points;
    const DWORD* counts = nullptr;
    std::vector<DWORD> countValues;
    int count = 0;
    // Rectangle, Ellipse: left, top, right, bottom. TextOut: x, y and the text.
    std::array<int, 4> box = {};
    std::string text;
    // SelectObject: the object selected and the one it displaced. Create*:
    // the object made. DeleteObject: the object and (value) whether it went.
    HGDIOBJ object = nullptr;
    HGDIOBJ displaced = nullptr;
    // CreateBrush: the style; CreateFont: the height; SetTextAlign: the flags.
    UINT value = 0;
    // CreatePen, CreateBrush, SetTextColor.
    COLORREF colour = 0;
};

class GdiCallRecorder {
public:
    GdiCallRecorder();
    ~GdiCallRecorder();
    GdiCallRecorder(const GdiCallRecorder&) = delete;
    GdiCallRecorder& operator=(const GdiCallRecorder&) = delete;

    // True when every import could be redirected.
    bool IsActive() const;

    const std::vector<GdiCall>& GetCalls() const { return m_calls; }
    void Clear() { m_calls.clear(); }
    // Long runs only count objects: they keep no calls.
    void SetKeepCalls(bool keep) { m_keepCalls = keep; }
    std::vector<GdiCall> Of(GdiCall::Kind kind) const;
    int CountOf(GdiCall::Kind kind) const { return static_cast<int>(Of(kind).size()); }

    // Objects the DLL created and has not deleted yet.
    int GetLiveObjectCount() const { return m_created - m_deleted; }
    int GetCreatedCount() const { return m_created; }

    // Used by the recording functions.
    static GdiCallRecorder* Current() { return s_current; }
    void Add(GdiCall call);
    void* Original(GdiCall::Kind kind) const { return m_redirects[kind]->GetOriginal(); }

private:
    static GdiCallRecorder* s_current;

    std::vector<std::unique_ptr<ImportPatch>> m_redirects; // one per GdiCall::Kind
    std::vector<GdiCall> m_calls;
    int m_created = 0;
    int m_deleted = 0;
    bool m_keepCalls = true;
};
