// GdiCallRecorder: while it lives, redirects libTavo_Windows.dll's imports of
// the drawing, selection and object calls (ImportPatch) to functions that note
// the call and forward it to GDI, so pixels are still drawn. One at a time.
#pragma once

#include "ImportPatch.h"

#include <windows.h>

#include <array>
#include <memory>
#include <string>
#include <vector>

struct GdiCall {
    enum Kind {
        PolyPolyline,
        Polygon,
        Rectangle,
        Ellipse,
        TextOut,
        SelectObject,
        CreatePen,
        CreateBrush,
        CreateFont,
        DeleteObject,
        SetTextAlign,
        SetTextColor,
    };
    bool IsCreation() const { return kind >= CreatePen && kind <= CreateFont; }

    Kind kind = PolyPolyline;
    // Rectangle, Ellipse: left, top, right, bottom. TextOut: x, y.
    std::array<int, 4> box = {};
    // SelectObject: the object selected. Create*: the object made. DeleteObject: the object.
    HGDIOBJ object = nullptr;
    // CreatePen, CreateBrush: the style; CreateFont: the height; SetTextAlign:
    // the flags; DeleteObject: whether the object went.
    UINT value = 0;
    COLORREF colour = 0;         // CreatePen, CreateBrush, SetTextColor
    HGDIOBJ displaced = nullptr; // SelectObject: the object it displaced
    std::string text = {};       // TextOut
    // PolyPolyline: every polyline's points, the count array and its values.
    // Polygon: its points.
    std::vector<POINT> points = {};
    const DWORD* counts = nullptr;
    std::vector<DWORD> countValues = {};
    int width = 0; // CreatePen
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
    std::vector<GdiCall> Of(GdiCall::Kind kind) const;
    int CountOf(GdiCall::Kind kind) const { return static_cast<int>(Of(kind).size()); }

    // Objects the DLL created, and those it has not deleted yet; Clear keeps both.
    int GetCreatedCount() const { return m_created; }
    int GetLiveObjectCount() const { return m_created - m_deleted; }

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
};
