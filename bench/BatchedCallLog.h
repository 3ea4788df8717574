// BatchedCallLog: the GDI calls that the rendering surface makes in one pass,
// recorded once and replayed directly from precomputed arrays. The replay is
// the floor for the surface: the same batched calls without the surface's own
// work (walking the drawing, applying attributes, filling batches).
//
// Recording redirects libTavo_Windows.dll's imports of the GDI calls for the
// duration of one pass (see ImportPatch); pens and brushes created during the
// pass are created again in the replay at the same moments.
#pragma once

#include <windows.h>

#include <cstdint>
#include <functional>
#include <vector>

class BatchedCallLog {
public:
    // Runs `pass` while recording; false when the imports could not be found.
    bool Record(const std::function<void()>& pass);
    void Replay(HDC dc) const;

    size_t GetCallCount() const { return m_ops.size(); }

    // Used by the recording functions.
    enum Code : std::uint8_t {
        PolyPolylineOp, PolygonOp, RectangleOp, EllipseOp, SelectCreatedOp, SelectOtherOp,
        CreatePenOp, CreateBrushOp, DeleteCreatedOp, SetTextColorOp,
    };
    struct Op {
        Code code;
        int a = 0, b = 0, c = 0, d = 0;
        size_t offset = 0;
        HGDIOBJ other = nullptr;
    };
    void AddOp(const Op& op) { m_ops.push_back(op); }
    size_t AddPoints(const POINT* points, size_t count);
    // The slot of an object created during the pass, or -1.
    int FindSlot(HGDIOBJ object) const;
    int NewSlot(HGDIOBJ object);
    void FreeSlot(int slot) { m_recordedSlots[slot] = nullptr; }

private:
    std::vector<Op> m_ops;
    std::vector<POINT> m_points;
    std::vector<HGDIOBJ> m_recordedSlots;
    std::vector<DWORD> m_counts[6]; // m_counts[n]: all n, for polylines of n points
    mutable std::vector<HGDIOBJ> m_replaySlots;
    friend void NoteCounts(BatchedCallLog& log, int pointsPerPolyline, int polylines);
};
