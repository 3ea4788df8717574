// Tavo_WiScrollWnd: a child window that frames one scrollable view.
//
// It holds by value its client child (the scrollee, control id 1000), a
// horizontal and a vertical scroll bar (1001, 1002) and a blank button in the
// corner between them (1003). It keeps the scroll model in the caller's own
// scroll units (range, visible window extent, position), maps it onto the
// bars, whose ranges it keeps within Tavo_WiScroll::MaxBarRange bar units by
// a scale factor, and moves the scrollee's pixels when the position changes.
//
// A derived class overrides the virtual operations to draw (OnDraw), to turn
// scroll units into pixels (GetScrollDeviceDeltas), and to react to clicks,
// double clicks, drags, drag scrolling and a resting pointer. In inverted-Y
// mode y grows upwards; the position's y is still the top edge of the window.
//
// A caller that changes the model calls, in this order, SetScrollRange,
// SetScrollDeltas, SetScrollWindowExtent, SetScrollPosition and SetScrollDone
// (or the last three alone when only the window size changed), after Create.
#pragma once

#include <afxwin.h>

#include "Tavo_WiScroll.h"
#include "Tavo_WiScrollee.h"

class AFX_EXT_CLASS Tavo_WiScrollWnd : public CWnd {
public:
    // Control ids of the children.
    static constexpr UINT ScrolleeId = 1000;
    static constexpr UINT HorzBarId = 1001;
    static constexpr UINT VertBarId = 1002;
    static constexpr UINT CornerId = 1003;
    // Scroll codes beyond the platform's: back and forward by a percentage of
    // the window extent (OnHScroll, OnVScroll, ScrollWindow).
    static constexpr UINT PercentBack = 100;
    static constexpr UINT PercentForward = 101;

    Tavo_WiScrollWnd();
    virtual ~Tavo_WiScrollWnd();

    // ---- overridables --------------------------------------------------
    // Whether ScrollWindow(dir, amount, n) would change the position; changes
    // neither the position, nor the bars, nor any pixel.
    virtual bool ScrollWindowTest(Tavo_WiScroll::Dir dir, Tavo_WiScroll::Amount amount, int n);

private:
    // Its own slot of the table (it takes a CRect, so it does not override
    // the framework's Create); the framework's form stays reachable only
    // through it, as before.
    using CWnd::Create;
    virtual BOOL Create(LPCSTR className, LPCSTR windowName, DWORD style, const CRect& rect,
                        CWnd* parent, UINT id, CCreateContext* context);

public:
    // Creates the window, the scrollee (with its monitor and data tip), both
    // bars and the corner; nonzero when all of them were created.
    virtual BOOL Create(DWORD style, const CRect& rect, CWnd* parent, UINT id);
    // Paints the view; called by the scrollee's paint handler with a paint
    // device context in MM_TEXT mode. Base: nothing.
    virtual void OnDraw(Tavo_WiScrollee* scrollee, CDC* dc);
    // The pixels between two scroll positions: dx = a.x - b.x, dy = a.y - b.y
    // in the base class. scrolling is 1 when the content really moves from a
    // to b (ScrollWindowTo), 0 when only the range is measured.
    virtual void GetScrollDeviceDeltas(const CPoint& a, const CPoint& b, int& dx, int& dy,
                                       int scrolling);
    // Pointer operations, called by the scrollee with the button's mouse-key
    // flag, the key flags of the message and a point in the scrollee's client
    // coordinates. Base: nothing.
    virtual void OnClick(UINT button, UINT flags, const CPoint& point);
    virtual void OnDoubleClick(UINT button, UINT flags, const CPoint& point);
    virtual void OnDragStart(UINT button, UINT flags, const CPoint& point);
    virtual void OnDragMove(UINT button, UINT flags, const CPoint& point);
    // completed is 1 when the button was released, 0 when the capture was lost.
    virtual void OnDragEnd(UINT button, UINT flags, const CPoint& point, int completed);
    virtual void OnDragAbort();
    // The pointer has come to rest at point: shows GetDataTipText(point) in
    // the scrollee's data tip unless it is empty.
    virtual void OnParkedCursorStart(const CPoint& point);
    // The rest has ended: hides the data tip.
    virtual void OnParkedCursorEnd();
    // The data-tip text for a point. Base: empty.
    virtual CString GetDataTipText(const CPoint& point);

protected:
    // Drag scrolling, called with the current position. Base: nothing.
    virtual void OnDragScrollStart(const CPoint& position);
    virtual void OnDragScrollMove(const CPoint& position);
    virtual void OnDragScrollEnd(const CPoint& position);
    virtual void OnNonDragScrollEnd(const CPoint& position);

public:
    virtual BOOL DestroyWindow();

    Tavo_WiScrollee* GetScrollee() { return &m_scrollee; }

    // ---- scroll model ----------------------------------------------------
    void SetScrollRange(int xMin, int xMax, int yMin, int yMax);
    // Note the order: page delta first. Page steps are at least 2, line steps at least 1.
    void SetScrollDeltas(const CSize& pageDelta, const CSize& lineDelta);
    void SetScrollWindowExtent(int width, int height);
    // Sets the position (clamped into the range) without moving any pixels.
    void SetScrollPosition(const CPoint& position);
    // Ends a change of the model: decides the bars' visibility and lays out.
    void SetScrollDone();
    void SetScrollInvertedY(int flag) { m_invertedY = flag; }
    CPoint GetScrollPosition() const { return m_position; }
    CSize GetWindowExtent() const { return m_windowExtent; }

    // ---- scrolling -------------------------------------------------------
    void ScrollWindowTo(const CPoint& position);
    void ScrollWindowCenterTo(const CPoint& point);
    // n is the percentage for Percent (not negative; a negative one scrolls
    // nothing) and is ignored otherwise.
    void ScrollWindow(Tavo_WiScroll::Dir dir, Tavo_WiScroll::Amount amount, int n);

    // ---- scroll bars -----------------------------------------------------
    void SetScrollBarVisibilityFlags(int horizontal, int vertical);
    void SetScrollBarAutoVisibilityFlag(int flag) { m_autoVisibility = flag; }

    // ---- drags and data tips ---------------------------------------------
    int IsDragScrolling() const { return m_dragScrolling; }
    // Cancels the scrollee's pending press or drag without reporting its end,
    // then calls OnDragAbort.
    void AbortDrag();
    void SetParkedCursorMonitorFlag(int flag);

    // ---- message handlers --------------------------------------------------
    // n is the thumb position in bar units for the thumb codes (of which the
    // message carries only the low 16 bits; the bar, when given, supplies the
    // rest) and the percentage for PercentBack/PercentForward.
    afx_msg void OnHScroll(UINT code, UINT n, CScrollBar* bar);
    afx_msg void OnVScroll(UINT code, UINT n, CScrollBar* bar);
    afx_msg void OnSize(UINT type, int width, int height);

protected:
    void SetDragScrollingFlag(int flag) { m_dragScrolling = flag; }

    DECLARE_MESSAGE_MAP()

private:
    void ForcePositionIntoRange();
    void MoveControls(int, int);
    void DecideBarVisibility(int clientWidth, int clientHeight);
    void BeginThumbDrag();
    void EndScrollAction();
    enum class Axis {
        Horizontal,
        Vertical
    };
    // The scroll codes of either bar (OnHScroll, OnVScroll).
    void OnScroll(Axis axis, UINT code, UINT n, CScrollBar* bar);
    // Moves the position on one axis and reports the move of a drag scroll.
    void ScrollTo(Axis axis, int value);

    double m_horzScale = 1.0; // scroll units per horizontal bar unit, at least 1
    double m_vertScale = 1.0;
    CSize m_windowExtent{0, 0}; // the visible window, in scroll units
    CSize m_lineDelta{1, 1};
    CSize m_pageDelta{10, 10};
    CPoint m_rangeMin{0, 100};
    CPoint m_rangeMax{0, 100};
    CPoint m_position{0, 0}; // left edge (x) and top edge (y) of the window
    int m_invertedY = 0;
    int m_autoVisibility = 1;
    int m_horzBarVisible = 1;
    int m_vertBarVisible = 1;
    int m_dragScrolling = 0;
    int m_testMode = 0; // 1 only inside ScrollWindowTest
    Tavo_WiScrollee m_scrollee;
    CScrollBar m_horzBar;
    CScrollBar m_vertBar;
    CButton m_corner;
    int m_moved = 0; // whether the last ScrollWindowTo changed the position
};
