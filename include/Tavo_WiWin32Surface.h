// Tavo_WiWin32Surface: the GDI rendering surface of the graphics core.
//
// The graphics core walks a drawing and calls this surface's drawing
// operations with device coordinates whose y axis points up. The surface turns
// each attribute into a pen, a brush, a text colour, a text alignment and a
// font on the device context bound with SetDC, flips y into GDI's downward
// axis, collects primitives per kind in fixed-size batches and emits each
// batch with one PolyPolyline call or a tight loop of Polygon, Rectangle or
// Ellipse calls. Text is drawn at once.
//
// One drawing pass: SetDC -> drawing operations -> Flush -> EndDrawing.
// EndDrawing selects back what the surface displaced and deletes the GDI
// objects it created; between passes the surface holds none.
//
// Holding Escape interrupts a pass. The surface polls before every batch it
// emits (nine times per Flush) and the graphics core every so often; a poll
// asks the keyboard at the first poll of a pass and then at most once per tick
// of the system clock (GetTickCount64), answering from the interrupted flag in
// between, so Escape is seen within one clock tick and one batch.
#pragma once

#include <afxwin.h>

#include "Tavo_GrSurface.h"
#include "Tavo_GrSurfaceStats.h"
#include "Tavo_WiPrimitiveBatch.h"

#include <climits>
#include <memory>

// The graphics core names an operation DrawText; keep <windows.h>'s macro of
// that name away from the declarations below.
#pragma push_macro("DrawText")
#undef DrawText

class AFX_EXT_CLASS Tavo_WiWin32Surface : public Tavo_GrSurface {
public:
    Tavo_WiWin32Surface();
    ~Tavo_WiWin32Surface();

    // Two surfaces must never share batches or GDI objects.
    Tavo_WiWin32Surface(const Tavo_WiWin32Surface&) = delete;
    Tavo_WiWin32Surface& operator=(const Tavo_WiWin32Surface&) = delete;

    // ---- Attributes and operations --------------------------------------

    // Binds the surface to a device context before a drawing pass.
    void SetDC(HDC dc);

    void SetBlackAndWhiteFlag(bool blackAndWhite) { m_blackAndWhite = blackAndWhite; }
    bool IsBlackAndWhite() const { return m_blackAndWhite; }

    // Extra pixel columns drawn right of each vertical line; 0 or less: none.
    void SetThickenVertLine(int columns) { m_thickenVertLine = columns; }
    int GetThickenVertLine() const { return m_thickenVertLine; }

    void ResetStats();
    void FetchStats(Tavo_GrSurfaceStats& out) const;

    // ---- Overridables: the graphics core's drawing operations ------------

    void DrawCircle(Tavo_GrDPoint& centre, int radius, Tavo_GrAttr* attr) override;
    void DrawDot(Tavo_GrDPoint& point, Tavo_GrAttr* attr) override;
    void DrawGrid(Tavo_GrDPoint& origin, Tavo_GrDPoint& step, Tavo_GrDPoint& extent, Tavo_GrAttr* attr) override;
    void DrawLine(Tavo_GrDPoint& from, Tavo_GrDPoint& to, Tavo_GrAttr* attr) override;
    void DrawPline(int count, Tavo_GrDPoint* points, Tavo_GrAttr* attr) override;
    void DrawRect(Tavo_GrDRect& rect, Tavo_GrAttr* attr) override;
    void DrawText(const char* text, Tavo_GrDRect& box, Tavo_GrAttr* attr, unsigned int fontHeight) override;
    void DrawText(const char* text, Tavo_GrDPoint& point, Tavo_GrAttr* attr) override;
    void DrawTriangle(Tavo_GrDPoint points[3], Tavo_GrAttr* attr) override;
    void Flush() override;
    void OnAttrChange() override;
    void BeginDrawing(const Tavo_GrDrawing* drawing) override;
    void EndDrawing() override;
    bool PollDrawInterrupt() override;

    // ---- Batch capacities, in elements --------------------------------------

    static constexpr int kDotCapacity = 5000;
    static constexpr int kLineCapacity = 5000;
    static constexpr int kUniangleCapacity = 1000;
    static constexpr int kHollowTriangleCapacity = 1000;
    static constexpr int kFilledTriangleCapacity = 200;
    static constexpr int kHollowRectCapacity = 5000;
    static constexpr int kFilledRectCapacity = 500;
    static constexpr int kCircleCapacity = 500;

private:
    // ---- Implementation ---------------------------------------------------

    using PolylineBatch2 = Tavo_WiPrimitiveBatch<POINT, 2>;
    using PolylineBatch3 = Tavo_WiPrimitiveBatch<POINT, 3>;
    using PolylineBatch4 = Tavo_WiPrimitiveBatch<POINT, 4>;
    using PolylineBatch5 = Tavo_WiPrimitiveBatch<POINT, 5>;
    using BoxBatch = Tavo_WiPrimitiveBatch<RECT, 1>;

    int SetCurrentFont(unsigned int pixelHeight);
    void ReleaseGdiObjects();
    // Clears the handles; releasing what they name is ReleaseGdiObjects' job.
    void ForgetGdiObjects();
    int GetCharsInBox(const char* text, Tavo_GrDRect& box);
    void DrawTextPlaceholder(Tavo_GrDPoint start, int width, int rightLimit, Tavo_GrAttr* attr);
    void DrawSegment(const Tavo_GrDPoint& from, const Tavo_GrDPoint& to);

    void AddDot(int x, int y);
    void AddLine(int x1, int y1, int x2, int y2);
    void AddUniangle(int x0, int y0, int x1, int y1, int x2, int y2);
    void AddHollowTriangle(int x0, int y0, int x1, int y1, int x2, int y2);
    void AddFilledTriangle(int x0, int y0, int x1, int y1, int x2, int y2);
    void AddHollowRect(int l, int t, int r, int b);
    void AddFilledRect(int l, int t, int r, int b);
    void AddHollowCircle(int x, int y, int radius);
    void AddFilledCircle(int x, int y, int radius);

    void FlushDots();
    void FlushLines();
    void FlushUniangles();
    void FlushHollowTriangles();
    void FlushFilledTriangles();
    void FlushHollowRects();
    void FlushFilledRects();
    void FlushHollowCircles();
    void FlushFilledCircles();
    void EmitPolylines(const POINT* points, const DWORD* counts, int polylines);
    void EmitEllipses(const BoxBatch& batch);

    static void AllocStaticArrays(const int* maxCounts);
    static void FreeStaticArrays();

    // GDI's downward y of a core y (the core's y points up).
    int FlipY(int y) const;

    // The nine batches; each allocates its element storage once, here.
    PolylineBatch2 m_dots{kDotCapacity};
    PolylineBatch2 m_lines{kLineCapacity};
    PolylineBatch5 m_hollowRects{kHollowRectCapacity};
    BoxBatch m_filledRects{kFilledRectCapacity};
    PolylineBatch3 m_uniangles{kUniangleCapacity};
    PolylineBatch4 m_hollowTriangles{kHollowTriangleCapacity};
    PolylineBatch4 m_filledTriangles{kFilledTriangleCapacity};
    BoxBatch m_hollowCircles{kCircleCapacity};
    BoxBatch m_filledCircles{kCircleCapacity};

    int m_charHeight = 0;
    unsigned int m_fontHeight = 0;
    bool m_blackAndWhite = false;
    int m_thickenVertLine = 0;
    int m_minFont = kDefaultMinFont;
    int m_lastDotX = kNoDot;
    int m_lastDotY = kNoDot;

    // The device context is the owner's; the displaced objects are the DC's.
    HDC m_hdc = nullptr;
    HPEN m_pen = nullptr; // owned while a pass runs
    HGDIOBJ m_oldPen = nullptr;
    HBRUSH m_brush = nullptr; // owned while a pass runs
    HGDIOBJ m_oldBrush = nullptr;
    HFONT m_font = nullptr; // owned while a pass runs
    HGDIOBJ m_oldFont = nullptr;

    Tavo_GrSurfaceStats m_stats;
    unsigned char m_textAlign = Tavo_GrAttr::AlignDefault; // left, bottom: what SetDC selects
    unsigned char m_color = kNoAttrCode;
    unsigned char m_fill = kNoAttrCode;
    // The clock tick of the last Escape query of this pass.
    ULONGLONG m_escapeQueryTick = kNoEscapeQuery;

    // The last-dot position before any dot was added: no core position
    // equals it in practice.
    static constexpr int kNoDot = INT_MIN;
    // The last-dot position once the dot batch has been emitted: one pixel
    // beyond the device window's bottom-left corner, so a dot there (and only
    // there) right after an emission counts as a repeat and is not drawn.
    static constexpr int kNoDotSinceEmission = -1;
    // Smallest font height in pixels unless BRY_VWR_MINFONT says otherwise.
    static constexpr int kDefaultMinFont = 8;
    // Neither a colour nor a fill code: the first attribute change rebuilds all.
    static constexpr unsigned char kNoAttrCode = 157;
    // No Escape query yet in this pass; the system clock never reads it.
    static constexpr ULONGLONG kNoEscapeQuery = ~0ull;

    static int m_instanceCount;
    static std::unique_ptr<DWORD[]> m_2array;
    static std::unique_ptr<DWORD[]> m_3array;
    static std::unique_ptr<DWORD[]> m_4array;
    static std::unique_ptr<DWORD[]> m_5array;
};

#pragma pop_macro("DrawText")
