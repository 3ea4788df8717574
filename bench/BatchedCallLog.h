// BatchedCallLog: the GDI calls that the rendering surface makes in one pass,
// recorded once and replayed directly from precomputed arrays. The replay is
// the floor for the surface: the same batched calls without the surface's own
// work (walking the drawing, applying attributes, filling batches).
//
// Recording watches one pass through the shared GdiCallRecorder, then turns
// its call list into replay operations once, outside any timing; pens and
// brushes created during the pass are created again in the replay at the same
// moments.
#pragma once

#include <windows.h>

#include <cstdint>
#include <functional>
#include <vector>

struct GdiCall;

class BatchedCallLog {
public:
    // Runs `pass` while recording; false when the imports could not be found or
    // the pass drew polylines the replay's count arrays do not cover.
    bool Record(const std::function<void()>& pass);
    void Replay(HDC dc) const;

    size_t GetCallCount() const { return m_ops.size(); }

private:
    enum Code : std::uint8_t {
        PolyPolylineOp,
        PolygonOp,
        RectangleOp,
        EllipseOp,
        SelectCreatedOp,
        SelectOtherOp,
        CreatePenOp,
        CreateBrushOp,
        DeleteCreatedOp,
        SetTextColorOp,
    };
    struct Op {
        Code code = PolyPolylineOp;
        int a = 0, b = 0, c = 0, d = 0;
        size_t offset = 0;
        HGDIOBJ other = nullptr;
    };
    // The surface's polyline batches hold polylines of one length each, at most this.
    static constexpr int kMaxPointsPerPolyline = 5;

    // Appends the replay operation of one recorded call; calls the replay does
    // not repeat (text, fonts, deletes of objects made before the pass) add none.
    // False for a polyline batch of mixed or too long polylines.
    bool Add(const GdiCall& call);
    size_t AddPoints(const std::vector<POINT>& points);
    void NoteCounts(int pointsPerPolyline, int polylines);
    // The slot of an object created during the pass, or -1.
    int FindSlot(HGDIOBJ object) const;
    int NewSlot(HGDIOBJ object);

    std::vector<Op> m_ops;
    std::vector<POINT> m_points;
    std::vector<HGDIOBJ> m_recordedSlots;
    std::vector<DWORD> m_counts[kMaxPointsPerPolyline + 1]; // m_counts[n]: all n, for polylines of n points
    mutable std::vector<HGDIOBJ> m_replaySlots;
};
