// Tavo_WiDrawWnd: a scroll window that shows one drawing of the graphics core.
//
// Coordinates. Client coordinates are pixels of the scrollee's client area,
// y down; every CPoint handed to the pointer operations is one. Device
// coordinates have their origin at the scrollee's bottom-left corner, y up: the
// client point (x, y) is the device point (x, H - y), H being the device window
// height last given to the mapping. World coordinates are the drawing's, y up;
// the mapping's transform converts device and world, S device pixels per world
// unit. The window runs its scroll model in world units with inverted y, so
// the scroll position is the world point at the view's top-left corner.
//
// Zoom level. L is the smaller of the mapping's integer and real zoom levels;
// L = 0 is the zero level, where the whole drawing is fitted, L > 0 is zoomed
// in.
//
// Use. Create the window with the scroll window's Create, bind a drawing with
// SetDrawingInfo, hand out an on-screen surface from GetNativeWindowSurface
// (and a print surface from GetPrintSurface), and override the world-rectangle
// notifications. The window owns its mapping; it never owns the drawing or the
// surfaces. Everything that needs a drawing does nothing (or returns an empty
// result) while none is bound.
//
// Frames that support live resizing call OnEnterSizeMove and OnExitSizeMove
// from their WM_ENTERSIZEMOVE and WM_EXITSIZEMOVE handlers; the window does not
// receive those messages itself.
#pragma once

#include <afxwin.h>

#include "Tavo_GrDrawing.h"
#include "Tavo_GrMapping.h"
#include "Tavo_GrTypes.h"
#include "Tavo_WiNativeWindowSurface.h"
#include "Tavo_WiPrintLayout.h"
#include "Tavo_WiScrollWnd.h"
#include "Tavo_WiZoomCenter.h"

#include <memory>

struct CPrintInfo;

class AFX_EXT_CLASS Tavo_WiDrawWnd : public Tavo_WiScrollWnd {
public:
    // What a drag does (GetDragAction). Any other value: nothing.
    enum DragAction {
        Pan = 0,             // moves the view with the pointer (only while zoomed in)
        RubberRectangle = 1, // DoRubberRectangle
        DragAndDrop = 2      // DoDragAndDrop
    };

    // The autoscroll timer of a pan drag that has left the view: on this
    // window (not the scrollee), re-armed while the pointer stays outside.
    static constexpr UINT_PTR AutoScrollTimerId = 1;
    static constexpr UINT AutoScrollPeriodMs = 50;
    // The construction argument of the window's mapping: zoom levels per
    // doubling of the scale.
    static constexpr int ZoomLevelsPerDoubling = 5;
    // The margin, in pixels, added on every side of an invalidated world
    // rectangle's screen area.
    static constexpr int InvalidateMarginPixels = 2;
    // Paint messages PumpPaintMessages dispatches at most.
    static constexpr int MaxPumpedPaintMessages = 10;

    Tavo_WiDrawWnd();
    virtual ~Tavo_WiDrawWnd();

    // ---- overrides of the scroll window --------------------------------------
    // False without a drawing or at the zero level; else the scroll window decides.
    bool ScrollWindowTest(Tavo_WiScroll::Dir dir, Tavo_WiScroll::Amount amount, int n) override;
    // The paint path: surface, mapping sized to the scrollee, clip box as a
    // device rectangle, the drawing's Draw.
    void OnDraw(Tavo_WiScrollee* scrollee, CDC* dc) override;
    // Pointer operations: points become world apertures for the application.
    void OnClick(UINT button, UINT flags, const CPoint& point) override;
    void OnDoubleClick(UINT button, UINT flags, const CPoint& point) override;
    void OnDragStart(UINT button, UINT flags, const CPoint& point) override;
    void OnDragMove(UINT button, UINT flags, const CPoint& point) override;
    void OnDragEnd(UINT button, UINT flags, const CPoint& point, int completed) override;
    CString GetDataTipText(const CPoint& point) override;

protected:
    // World deltas in device pixels; while really scrolling, the rounding is
    // kept in the mapping's error terms.
    void GetScrollDeviceDeltas(const CPoint& from, const CPoint& to, int& dx, int& dy,
                               int scrolling) override;
    // The mapping follows every change of the scroll position at once.
    void OnDragScrollMove(const CPoint& position) override;
    void OnNonDragScrollEnd(const CPoint& position) override;

    // ---- overridables: painting -------------------------------------------------
    // The surface to paint the screen with; owned by the application. Base: none,
    // so nothing is drawn.
    virtual Tavo_WiNativeWindowSurface* GetNativeWindowSurface();
    // Binds the surface to the paint device context, with the window's surface option.
    virtual void OnPrepareSurface(Tavo_WiScrollee* scrollee, CDC* dc,
                                  Tavo_WiNativeWindowSurface* surface);
    // Sizes the mapping to the scrollee and yields the device rectangle to repaint.
    virtual void OnPrepareMapping(Tavo_WiScrollee* scrollee, CDC* dc, Tavo_GrMapping* mapping,
                                  Tavo_GrDRect& rect);
    // Pans the mapping to the scroll position when zoomed in and draws.
    virtual void OnDraw(Tavo_WiScrollee* scrollee, CDC* dc, Tavo_GrDrawing* drawing,
                        Tavo_WiNativeWindowSurface* surface, Tavo_GrMapping* mapping,
                        Tavo_GrDRect& rect);

public:
    // ---- overridables: printing -------------------------------------------------
    // The surface to print with; owned by the application. Base: none, so
    // pages carry only their header and corner marks.
    virtual Tavo_WiWin32Surface* GetPrintSurface();
    // Lays out the page grid from the view and installs the print dialog in info.
    virtual void OnPreparePrinting(CPrintInfo* info);
    // The header printed above page layout.m_page.
    virtual CString GetPrintHeader(const Tavo_WiPrintLayout& layout);

protected:
    // ---- overridables: the application's notifications -----------------------
    // A click or double click on a world rectangle (the aperture of the point).
    // Base: nothing.
    virtual void OnClick(UINT button, UINT flags, const Tavo_GrWRect& aperture);
    virtual void OnDoubleClick(UINT button, UINT flags, const Tavo_GrWRect& aperture);
    // What the drag that starts at point does. Base: Pan.
    virtual DragAction GetDragAction(UINT button, UINT flags, const CPoint& point);
    // Runs a rubber rectangle from start until button is released; reports it
    // to OnRubberRectangle in world coordinates.
    virtual void DoRubberRectangle(UINT button, UINT flags, const CPoint& start);
    // The finished rubber rectangle. Base: nothing.
    virtual void OnRubberRectangle(UINT button, UINT flags, const Tavo_GrWRect& rect);
    // A drag-and-drop drag; the scrollee has already forgotten the press. Base: nothing.
    virtual void DoDragAndDrop(UINT button, UINT flags, const CPoint& point);
    // The data-tip text for a world rectangle; empty: no tip. Base: empty.
    virtual CString GetDataTipText(const Tavo_GrWRect& aperture);

public:
    // ---- binding and access -------------------------------------------------------
    // Binds a drawing (not owned) and shows it at the zero level, or unbinds
    // with null. The mapping gets the largest zoom level, the zero-level
    // expansion (percent) and the largest-zoom world clip box size. The view
    // to undo goes with the old mapping. When there is no memory for the
    // mapping the window stays unbound (GetDrawing() gives null).
    void SetDrawingInfo(Tavo_GrDrawing* drawing, int maxZoomLevel, int surfaceOption,
                        int zeroLevelExpansion, unsigned int maxClipWidth,
                        unsigned int maxClipHeight);
    Tavo_GrDrawing* GetDrawing() const { return m_drawing; }
    Tavo_GrMapping* GetMapping() const { return m_mapping.get(); }
    // The world rectangle the scrollee's client area shows now; all zero unbound.
    Tavo_GrWRect GetWorldClipBox() const;
    // The zoom level L; 0 unbound.
    double GetZoomLevel() const;
    // Marks the screen area of a world rectangle, widened by
    // InvalidateMarginPixels, for repainting. Nothing for the all-zero
    // rectangle or one wholly outside the view.
    void InvalidateRect(const Tavo_GrWRect& rect, bool erase);
    // Dispatches up to MaxPumpedPaintMessages pending paint messages of the thread.
    void PumpPaintMessages();

    // ---- live resizing --------------------------------------------------------------
    void OnEnterSizeMove();
    void OnExitSizeMove();
    afx_msg void OnWindowPosChanged(WINDOWPOS* windowPos);

    // ---- zooming and panning ------------------------------------------------------
    // Zooms by type and amount about the pointer, the view centre or the device
    // point (x, y). Without force, a zoom that would not change the level does
    // nothing. No zoom form does anything while the window has no client area
    // (minimised or zero-sized).
    void ZoomWindow(Tavo_GrZoom::Type type, int amount, Tavo_WiZoomCenter::Type centre, int x, int y,
                    bool force);
    // Zooms to a (fractional) zoom level about the world point (x, y).
    void ZoomWindow(double level, int x, int y);
    // Zooms so that a world rectangle fills the view (the view that is left
    // once the zoom has shown or hidden the scroll bars); nothing for a
    // rectangle of zero width or height.
    void ZoomWindow(const Tavo_GrWRect& rect);
    // Whether ZoomWindow(type, amount, ...) would change the zoom level.
    bool ZoomWindowTest(Tavo_GrZoom::Type type, int amount) const;
    // Goes back to the view before the last zoom or window change; a second
    // call returns to the view before the first (a toggle).
    void UndoLastScrollZoom();
    // Scrolls so that the world point under the pointer comes to the centre.
    void CenterWindowAtCursor();
    // Scrolls by device pixels; any non-zero delta moves at least one world unit.
    void ScrollWindowByDeviceDeltas(int dx, int dy);
    // +1: the drawing follows the pointer in pan drags; -1: the view does.
    // Negative values give -1, others +1.
    void SetPanDirectionality(int direction);
    int GetPanDirectionality() const { return m_panDirection; }

    // ---- pointer ----------------------------------------------------------------------
    // The world aperture of a client point (the point's world position widened
    // by two pixels' worth of world units); non-zero when the point lies in the
    // scrollee's client area. Without a drawing: all zero and 0.
    int FetchApertureFromPoint(const CPoint& point, Tavo_GrWRect& aperture);
    afx_msg void OnTimer(UINT_PTR id);

    // ---- printing (the framework's print protocol) ----------------------------------
    // Turns the current-page choice of the dialog into a one-page range.
    void OnBeginPrinting(CDC* dc, CPrintInfo* info);
    // Prints page info->m_nCurPage: header, corner marks and the page's part of
    // the drawing.
    void OnPrint(CDC* dc, CPrintInfo* info);
    void OnEndPrinting(CDC* dc, CPrintInfo* info);
    const Tavo_WiPrintLayout& GetPrintLayout() const { return m_printLayout; }

protected:
    DECLARE_MESSAGE_MAP()

private:
    // Re-derives the scroll model (range, deltas, extent, position) from the
    // mapping after zooming it by type and amount about a device point (null:
    // the view's centre, or the drawing's at the zero level), once more when
    // laying out the scroll bars changed the scrollee's size. Invalidates the
    // scrollee when the view changed or force is set.
    void InternalZoom(Tavo_GrZoom::Type type, int amount, Tavo_GrDPoint* centre, bool force);
    // Sets the scroll range, deltas, extent and position from the mapping's
    // view of a scrollee of the given size (the caller lays out).
    void DeriveScrollModel(const Tavo_GrWRect& bounds, const CSize& size);
    // The pointer as a device point of the scrollee, unclipped; (0, 0) unbound.
    Tavo_GrDPoint GetCursorPositionInScrollee();
    // The scrollee's client size.
    CSize GetScrolleeSize();
    // Whether the window exists and shows, for the live-resize bookkeeping.
    bool IsShownWindow();
    // The world rectangle the device rectangle (0, 0, width, height) shows.
    Tavo_GrWRect VisibleWorldRect(int width, int height) const;

    Tavo_GrDrawing* m_drawing = nullptr;       // not owned
    std::unique_ptr<Tavo_GrMapping> m_mapping; // exactly while a drawing is bound
    int m_surfaceOption = 3;                   // copied into every on-screen surface
    int m_panDirection = 1;                    // +1 or -1
    // During a pan drag: the scrollee's window size at its start and the
    // reference pointer position. During a live resize: the scrollee's client
    // size and the scroll position when it began.
    CSize m_savedSize{0, 0};
    CPoint m_savedPoint{0, 0};
    Tavo_GrWRect m_undoClipBox; // the view before the last zoom
    Tavo_WiPrintLayout m_printLayout;
    UINT m_autoScrollTimerId = 0; // while the autoscroll timer runs
    int m_sizing = 0;             // 1 during a live resize
    int m_panDrag = 0;            // 1 during a pan drag
    int m_zoomedIn = 1;           // after InternalZoom: L != 0
};
