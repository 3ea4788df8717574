// GdiCallRecorder: records the GDI calls that libTavo_Windows.dll makes.
//
// While a recorder lives, the DLL's imports of the drawing, selection and
// object calls are redirected to recording functions that note the call and
// its arguments and then forward it to GDI, so pixels are still drawn. The
// Escape key state seen by the DLL can be set as well. One recorder at a time.
#pragma once

#include "ImportPatch.h"

#include <windows.h>

#include <memory>
#include <string>
#include <vector>

struct GdiCall {
    enum Kind {
        PolyPolyline, Polygon, Rectangle, Ellipse, TextOut,
        SelectObject, CreatePen, CreateBrush, CreateFont, DeleteObject,
        SetTextAlign, SetTextColor, SetBkMode, SetPolyFillMode,
    };
    Kind kind = PolyPolyline;
    HDC dc = nullptr;
    // PolyPolyline: the points of every polyline, the count array's address
    // and its first entries; Polygon: its points.
    std::vector<POINT> points;
    const DWORD* counts = nullptr;
    std::vector<DWORD> countValues;
    int count = 0;
    // Rectangle, Ellipse: left, top, right, bottom. TextOut: x, y.
    int values[4] = {};
    // SelectObject: the object selected and the one it displaced;
    // Create*: the object made; DeleteObject: the object deleted.
    HGDIOBJ object = nullptr;
    HGDIOBJ displaced = nullptr;
    // SetTextAlign, SetTextColor, SetBkMode, SetPolyFillMode: the value.
    // CreatePen: the colour; CreateBrush: the style (colour in `colour`).
    UINT value = 0;
    COLORREF colour = 0;
    LOGFONTA font = {};
    std::string text;
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
    // The calls of one kind, in order.
    std::vector<GdiCall> Of(GdiCall::Kind kind) const;
    int CountOf(GdiCall::Kind kind) const;
    // The kinds of all calls, in order.
    std::vector<GdiCall::Kind> GetKinds() const;

    // Objects the DLL created and has not deleted yet.
    int GetLiveObjectCount() const { return m_created - m_deleted; }
    int GetCreatedCount() const { return m_created; }

    // What GetAsyncKeyState reports to the DLL for the Escape key.
    void SetEscapeDown(bool down) { m_escapeDown = down; }
    int GetEscapePollCount() const { return m_escapePolls; }

    // Forwarding entry points used by the recording functions.
    static GdiCallRecorder* Current() { return s_current; }
    void Add(GdiCall call)
    {
        if (m_keepCalls)
            m_calls.push_back(std::move(call));
    }
    void NoteCreated() { ++m_created; }
    void NoteDeleted() { ++m_deleted; }
    bool IsEscapeDown() { ++m_escapePolls; return m_escapeDown; }
    void* Original(const char* function) const;

private:
    static GdiCallRecorder* s_current;

    struct Redirect {
        const char* function;
        std::unique_ptr<ImportPatch> patch;
    };
    std::vector<Redirect> m_redirects;
    std::vector<GdiCall> m_calls;
    int m_created = 0;
    int m_deleted = 0;
    bool m_keepCalls = true;
    bool m_escapeDown = false;
    int m_escapePolls = 0;
};
