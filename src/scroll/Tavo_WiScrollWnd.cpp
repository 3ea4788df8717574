// Tavo_WiScrollWnd: construction and windows, the scroll model, scrolling,
// the bars' messages, layout, and the default virtual operations.
#include "Tavo_WiScrollWnd.h"

#include "Tavo_WiScrollMath.h"
#include "Tavo_WiWindowClass.h"

#include <algorithm>

using namespace Tavo_WiScrollMath;

namespace {

constexpr char ClassName[] = "Tavo_WiScrollWnd";
constexpr UINT ClassStyle = CS_DBLCLKS | CS_PARENTDC;
bool s_classRegistered = false;

// Every child is created with this rectangle and laid out by the first
// OnSize or SetScrollDone after it exists.
constexpr RECT InitialChildRect = {0, 0, 10, 10};
constexpr DWORD ScrolleeStyle = WS_CHILD | WS_VISIBLE | WS_CLIPSIBLINGS;
constexpr DWORD HorzBarStyle = WS_CHILD | WS_VISIBLE | SBS_HORZ;
constexpr DWORD VertBarStyle = WS_CHILD | WS_VISIBLE | SBS_VERT;
constexpr DWORD CornerStyle = WS_CHILD | WS_VISIBLE | BS_PUSHBUTTON;

// The scroll codes of ScrollWindow: rows by amount, columns by direction.
constexpr UINT ScrollCodes[4][4] = {
    {SB_LINELEFT, SB_LINERIGHT, SB_LINEUP, SB_LINEDOWN},
    {SB_PAGELEFT, SB_PAGERIGHT, SB_PAGEUP, SB_PAGEDOWN},
    {SB_LEFT, SB_RIGHT, SB_TOP, SB_BOTTOM},
    {Tavo_WiScrollWnd::PercentBack, Tavo_WiScrollWnd::PercentForward,
     Tavo_WiScrollWnd::PercentBack, Tavo_WiScrollWnd::PercentForward},
};

// The thumb position of a bar message in bar units. The message carries only
// its low 16 bits, while a bar range may lie anywhere in int range (only its
// width is limited). While the thumb is tracked the bar itself knows all 32
// bits; otherwise the one value of the bar's range with those low bits is
// the position, since a bar range is narrower than 65536 units.
int ThumbPosition(UINT n, CScrollBar* bar)
{
    const int fromMessage = static_cast<int>(n);
    if (bar == nullptr || !::IsWindow(bar->GetSafeHwnd()))
        return fromMessage;
    SCROLLINFO info = {};
    info.cbSize = sizeof info;
    info.fMask = SIF_RANGE | SIF_TRACKPOS;
    if (!::GetScrollInfo(bar->GetSafeHwnd(), SB_CTL, &info))
        return fromMessage;
    if (static_cast<WORD>(info.nTrackPos) == static_cast<WORD>(n))
        return info.nTrackPos;
    const long long inRange = info.nMin + ((static_cast<long long>(n) - info.nMin) & 0xFFFF);
    if (inRange <= info.nMax)
        return static_cast<int>(inRange);
    return fromMessage;
}

void SetBarPageSize(CScrollBar& bar, int page)
{
    SCROLLINFO info = {};
    info.cbSize = sizeof info;
    info.fMask = SIF_PAGE;
    info.nPage = static_cast<UINT>(std::max(page, 0));
    ::SetScrollInfo(bar.GetSafeHwnd(), SB_CTL, &info, TRUE);
}

void DestroyChild(CWnd& child)
{
    if (child.GetSafeHwnd() != nullptr)
        child.DestroyWindow();
}

void PlaceChild(CWnd& child, int x, int y, int width, int height)
{
    if (!::IsWindow(child.GetSafeHwnd()))
        return;
    ::SetWindowPos(child.GetSafeHwnd(), nullptr, x, y, std::max(width, 0), std::max(height, 0),
                   SWP_NOZORDER);
}

void ShowChild(CWnd& child, bool visible)
{
    if (!::IsWindow(child.GetSafeHwnd()))
        return;
    ::ShowWindow(child.GetSafeHwnd(), visible ? SW_SHOWNORMAL : SW_HIDE);
}

} // namespace

BEGIN_MESSAGE_MAP(Tavo_WiScrollWnd, CWnd)
    ON_WM_HSCROLL()
    ON_WM_SIZE()
    ON_WM_VSCROLL()
END_MESSAGE_MAP()

Tavo_WiScrollWnd::Tavo_WiScrollWnd() = default;

Tavo_WiScrollWnd::~Tavo_WiScrollWnd()
{
    // The children go first, in the order DestroyWindow takes them; the
    // members then die without windows.
    if (GetSafeHwnd() != nullptr)
        Tavo_WiScrollWnd::DestroyWindow();
}

// ---- construction and windows ----------------------------------------------

BOOL Tavo_WiScrollWnd::Create(LPCSTR className, LPCSTR windowName, DWORD style, const CRect& rect,
                              CWnd* parent, UINT id, CCreateContext* context)
{
    BOOL created = FALSE;
    if (Tavo_WiWindowClass::UseOwnClasses()) {
        Tavo_WiWindowClass::RegisterOnce(s_classRegistered, ClassName, ClassStyle, nullptr, nullptr);
        created = CWnd::Create(className, windowName, style, rect, parent, id, context);
    } else {
        created = CWnd::Create(nullptr, nullptr, style, rect, parent, id, context);
    }
    if (!created)
        return FALSE;

    const CRect childRect(InitialChildRect);
    if (!m_scrollee.Create("Tavo_WiScrollee", "", ScrolleeStyle, childRect, this, ScrolleeId, nullptr))
        return FALSE;
    if (!m_horzBar.Create(HorzBarStyle, childRect, this, HorzBarId))
        return FALSE;
    if (!m_vertBar.Create(VertBarStyle, childRect, this, VertBarId))
        return FALSE;
    return m_corner.Create("", CornerStyle, childRect, this, CornerId);
}

BOOL Tavo_WiScrollWnd::Create(DWORD style, const CRect& rect, CWnd* parent, UINT id)
{
    return Create(ClassName, "", style, rect, parent, id, nullptr);
}

BOOL Tavo_WiScrollWnd::DestroyWindow()
{
    m_scrollee.DestroyWindow();
    DestroyChild(m_horzBar);
    DestroyChild(m_vertBar);
    DestroyChild(m_corner);
    if (!::IsWindow(GetSafeHwnd())) {
        m_hWnd = nullptr;
        return FALSE;
    }
    const BOOL destroyed = CWnd::DestroyWindow();
    m_hWnd = nullptr;
    return destroyed;
}

// ---- scroll model -------------------------------------------------------------

void Tavo_WiScrollWnd::SetScrollRange(int xMin, int xMax, int yMin, int yMax)
{
    const int xEnd = EffectiveMaximum(xMin, xMax);
    const int yEnd = EffectiveMaximum(yMin, yMax);
    m_horzScale = ScaleFor(xMin, xEnd);
    m_vertScale = ScaleFor(yMin, yEnd);

    const int xMinBar = ToBarUnits(xMin, m_horzScale);
    const int xEndBar = ToBarUnits(xEnd, m_horzScale);
    const int yMinBar = ToBarUnits(yMin, m_vertScale);
    const int yEndBar = ToBarUnits(yEnd, m_vertScale);
    ::SetScrollRange(m_horzBar.GetSafeHwnd(), SB_CTL, xMinBar, xEndBar, TRUE);
    ::SetScrollRange(m_vertBar.GetSafeHwnd(), SB_CTL, yMinBar, yEndBar, TRUE);

    // The stored range is the bar range in scroll units again, so that a
    // position at either end of it is a whole bar position.
    m_rangeMin = CPoint(ToScrollUnits(xMinBar, m_horzScale), ToScrollUnits(yMinBar, m_vertScale));
    m_rangeMax = CPoint(ToScrollUnits(xEndBar, m_horzScale), ToScrollUnits(yEndBar, m_vertScale));
}

void Tavo_WiScrollWnd::SetScrollDeltas(const CSize& pageDelta, const CSize& lineDelta)
{
    m_pageDelta = CSize(std::max<int>(pageDelta.cx, 2), std::max<int>(pageDelta.cy, 2));
    m_lineDelta = CSize(std::max<int>(lineDelta.cx, 1), std::max<int>(lineDelta.cy, 1));
}

void Tavo_WiScrollWnd::SetScrollWindowExtent(int width, int height)
{
    m_windowExtent.cx = width;
    SetBarPageSize(m_horzBar, ToBarUnits(width, m_horzScale));
    m_windowExtent.cy = height;
    SetBarPageSize(m_vertBar, ToBarUnits(height, m_vertScale));
}

void Tavo_WiScrollWnd::ForcePositionIntoRange()
{
    m_position.x = Clamp(m_position.x, m_rangeMin.x,
                         static_cast<long long>(m_rangeMax.x) - m_windowExtent.cx);
    if (m_invertedY)
        m_position.y = Clamp(m_position.y, static_cast<long long>(m_rangeMin.y) + m_windowExtent.cy,
                             m_rangeMax.y);
    else
        m_position.y = Clamp(m_position.y, m_rangeMin.y,
                             static_cast<long long>(m_rangeMax.y) - m_windowExtent.cy);
}

void Tavo_WiScrollWnd::SetScrollPosition(const CPoint& position)
{
    m_position = position;
    ForcePositionIntoRange();
    ::SetScrollPos(m_horzBar.GetSafeHwnd(), SB_CTL, ToBarUnits(m_position.x, m_horzScale), TRUE);
    // In inverted-Y mode the top of the range is at the top of the bar.
    const int barY = m_invertedY ? Tavo_GrSaturate(static_cast<long long>(m_rangeMin.y) - m_position.y +
                                                   m_rangeMax.y)
                                 : m_position.y;
    ::SetScrollPos(m_vertBar.GetSafeHwnd(), SB_CTL, ToBarUnits(barY, m_vertScale), TRUE);
}

void Tavo_WiScrollWnd::SetScrollDone()
{
    CRect client(0, 0, 0, 0);
    ::GetClientRect(GetSafeHwnd(), &client);
    if (m_autoVisibility)
        DecideBarVisibility(client.Width(), client.Height());
    MoveControls(client.Width(), client.Height());
}

// ---- scrolling ------------------------------------------------------------

void Tavo_WiScrollWnd::ScrollWindowTo(const CPoint& position)
{
    const CPoint old = m_position;
    if (m_testMode) {
        m_position = position;
        ForcePositionIntoRange();
        m_moved = m_position != old;
        m_position = old;
        return;
    }

    SetScrollPosition(position);
    int dx = 0;
    int dy = 0;
    GetScrollDeviceDeltas(old, m_position, dx, dy, 1);
    // Device pixels grow downwards; inverted-Y scroll units grow upwards.
    if (m_invertedY)
        dy = Tavo_GrSaturate(-static_cast<long long>(dy));
    // The moved pixels stay; only the uncovered strip is invalidated and
    // erased, and the scrollee paints it at its next paint message.
    CRect client(0, 0, 0, 0);
    ::GetClientRect(m_scrollee.GetSafeHwnd(), &client);
    ::ScrollWindowEx(m_scrollee.GetSafeHwnd(), dx, dy, &client, &client, nullptr, nullptr,
                     SW_INVALIDATE | SW_ERASE);
    m_moved = m_position != old;
}

void Tavo_WiScrollWnd::ScrollWindowCenterTo(const CPoint& point)
{
    const int halfWidth = m_windowExtent.cx / 2;
    const int halfHeight = m_windowExtent.cy / 2;
    const CPoint target(Tavo_GrAdd(point.x, -static_cast<long long>(halfWidth)),
                        m_invertedY ? Tavo_GrAdd(point.y, halfHeight)
                                    : Tavo_GrAdd(point.y, -static_cast<long long>(halfHeight)));
    ScrollWindowTo(target);
}

void Tavo_WiScrollWnd::ScrollWindow(Tavo_WiScroll::Dir dir, Tavo_WiScroll::Amount amount, int n)
{
    if (dir < Tavo_WiScroll::Left || dir > Tavo_WiScroll::Down)
        return;
    if (amount < Tavo_WiScroll::Line || amount > Tavo_WiScroll::Percent)
        return;

    const UINT code = ScrollCodes[amount][dir];
    const UINT argument = amount == Tavo_WiScroll::Percent ? static_cast<UINT>(std::max(n, 0)) : 0;
    if (dir == Tavo_WiScroll::Up || dir == Tavo_WiScroll::Down)
        OnVScroll(code, argument, &m_vertBar);
    else
        OnHScroll(code, argument, &m_horzBar);

    // A drag's own end reports the end of a drag scroll.
    if (!m_dragScrolling) {
        m_dragScrolling = 0;
        OnNonDragScrollEnd(m_position);
    }
}

bool Tavo_WiScrollWnd::ScrollWindowTest(Tavo_WiScroll::Dir dir, Tavo_WiScroll::Amount amount, int n)
{
    m_testMode = 1;
    m_moved = 0;
    ScrollWindow(dir, amount, n);
    m_testMode = 0;
    return m_moved != 0;
}

void Tavo_WiScrollWnd::BeginThumbDrag()
{
    if (m_dragScrolling)
        return;
    m_dragScrolling = 1;
    OnDragScrollStart(m_position);
}

void Tavo_WiScrollWnd::EndScrollAction()
{
    const int wasDragScrolling = m_dragScrolling;
    m_dragScrolling = 0;
    if (wasDragScrolling)
        OnDragScrollEnd(m_position);
    else
        OnNonDragScrollEnd(m_position);
}

void Tavo_WiScrollWnd::ScrollTo(Axis axis, int value)
{
    const bool horizontal = axis == Axis::Horizontal;
    if (value == (horizontal ? m_position.x : m_position.y))
        return;
    ScrollWindowTo(horizontal ? CPoint(value, m_position.y) : CPoint(m_position.x, value));
    if (m_dragScrolling)
        OnDragScrollMove(m_position);
}

void Tavo_WiScrollWnd::OnHScroll(UINT code, UINT n, CScrollBar* bar)
{
    OnScroll(Axis::Horizontal, code, n, bar);
}

void Tavo_WiScrollWnd::OnVScroll(UINT code, UINT n, CScrollBar* bar)
{
    OnScroll(Axis::Vertical, code, n, bar);
}

// The horizontal and vertical scroll codes share their values (SB_LINELEFT is
// SB_LINEUP, SB_LEFT is SB_TOP, ...), so one routine serves both bars.
void Tavo_WiScrollWnd::OnScroll(Axis axis, UINT code, UINT n, CScrollBar* bar)
{
    const bool horizontal = axis == Axis::Horizontal;
    // Backwards (left, up the bar) is towards smaller values, except on the
    // vertical axis in inverted-Y mode, where the top of the range is its
    // maximum.
    const bool flipped = !horizontal && m_invertedY;
    const int sign = flipped ? -1 : 1;
    const long long position = horizontal ? m_position.x : m_position.y;
    const long long lineDelta = horizontal ? m_lineDelta.cx : m_lineDelta.cy;
    const long long pageDelta = horizontal ? m_pageDelta.cx : m_pageDelta.cy;
    const int rangeMin = horizontal ? m_rangeMin.x : m_rangeMin.y;
    const int rangeMax = horizontal ? m_rangeMax.x : m_rangeMax.y;
    const int extent = horizontal ? m_windowExtent.cx : m_windowExtent.cy;
    const double scale = horizontal ? m_horzScale : m_vertScale;

    long long target = position;
    switch (code) {
    case SB_LINEUP:
        target = position - sign * lineDelta;
        break;
    case SB_LINEDOWN:
        target = position + sign * lineDelta;
        break;
    case SB_PAGEUP:
        target = position - sign * pageDelta;
        break;
    case SB_PAGEDOWN:
        target = position + sign * pageDelta;
        break;
    case SB_THUMBPOSITION:
    case SB_THUMBTRACK: {
        BeginThumbDrag();
        const double barOffset = static_cast<double>(ThumbPosition(n, bar)) - ToBarUnits(rangeMin, scale);
        const long long offset = Tavo_GrTruncate(barOffset * scale);
        target = flipped ? rangeMax - offset : rangeMin + offset;
        break;
    }
    case SB_TOP:
        target = flipped ? rangeMax : rangeMin;
        break;
    case SB_BOTTOM:
        target = flipped ? rangeMin : rangeMax; // the clamp brings it back by the extent
        break;
    case SB_ENDSCROLL:
        EndScrollAction();
        return;
    // A percentage step is truncated horizontally and rounded to the nearest
    // unit vertically.
    case PercentBack:
        target = position - (horizontal ? TruncatedPercentOf(extent, n) : RoundedPercentOf(extent, n, sign));
        break;
    case PercentForward:
        target = position + (horizontal ? TruncatedPercentOf(extent, n) : RoundedPercentOf(extent, n, sign));
        break;
    default:
        return;
    }
    ScrollTo(axis, Tavo_GrSaturate(target));
}

// ---- layout -------------------------------------------------------------------

void Tavo_WiScrollWnd::OnSize(UINT, int width, int height)
{
    if (m_autoVisibility)
        DecideBarVisibility(width, height);
    MoveControls(width, height);
}

void Tavo_WiScrollWnd::DecideBarVisibility(int clientWidth, int clientHeight)
{
    // The whole client size is compared with the whole range in pixels,
    // including the room the bars themselves take: a bar is needed exactly
    // when the range does not fit without it.
    int rangeWidth = 0;
    int rangeHeight = 0;
    GetScrollDeviceDeltas(m_rangeMax, m_rangeMin, rangeWidth, rangeHeight, 0);
    m_horzBarVisible = clientWidth < rangeWidth;
    m_vertBarVisible = clientHeight < rangeHeight;
}

void Tavo_WiScrollWnd::SetScrollBarVisibilityFlags(int horizontal, int vertical)
{
    if (horizontal == m_horzBarVisible && vertical == m_vertBarVisible)
        return;
    m_horzBarVisible = horizontal;
    m_vertBarVisible = vertical;
    MoveControls(0, 0);
}

void Tavo_WiScrollWnd::MoveControls(int, int)
{
    CRect client(0, 0, 0, 0);
    ::GetClientRect(GetSafeHwnd(), &client);
    const int barWidth = m_vertBarVisible ? GetSystemMetrics(SM_CXVSCROLL) : 0;
    const int barHeight = m_horzBarVisible ? GetSystemMetrics(SM_CYHSCROLL) : 0;
    const int contentWidth = client.Width() - barWidth;
    const int contentHeight = client.Height() - barHeight;

    PlaceChild(m_scrollee, 0, 0, contentWidth, contentHeight);
    PlaceChild(m_horzBar, 0, contentHeight, contentWidth, barHeight);
    ShowChild(m_horzBar, m_horzBarVisible != 0);
    PlaceChild(m_vertBar, contentWidth, 0, barWidth, contentHeight);
    ShowChild(m_vertBar, m_vertBarVisible != 0);
    PlaceChild(m_corner, contentWidth, contentHeight, barWidth, barHeight);
    ShowChild(m_corner, m_horzBarVisible && m_vertBarVisible);
}

// ---- drags and data tips -------------------------------------------------------

void Tavo_WiScrollWnd::AbortDrag()
{
    // The press state is cleared before the capture goes, so the scrollee's
    // capture-lost handling finds no drag to end.
    m_scrollee.ClearButtonDownState();
    m_scrollee.ReleaseMouse();
    OnDragAbort();
}

void Tavo_WiScrollWnd::SetParkedCursorMonitorFlag(int flag)
{
    m_scrollee.SetParkedCursorMonitorFlag(flag);
}

void Tavo_WiScrollWnd::OnParkedCursorStart(const CPoint& point)
{
    const CString text = GetDataTipText(point);
    if (text.IsEmpty())
        return;
    m_scrollee.ShowDataTip(point, text);
}

void Tavo_WiScrollWnd::OnParkedCursorEnd()
{
    m_scrollee.HideDataTip();
}

// ---- default virtual operations ----------------------------------------------

void Tavo_WiScrollWnd::OnDraw(Tavo_WiScrollee*, CDC*) {}

void Tavo_WiScrollWnd::GetScrollDeviceDeltas(const CPoint& a, const CPoint& b, int& dx, int& dy,
                                             int)
{
    dx = Tavo_GrSaturate(static_cast<long long>(a.x) - b.x);
    dy = Tavo_GrSaturate(static_cast<long long>(a.y) - b.y);
}

void Tavo_WiScrollWnd::OnClick(UINT, UINT, const CPoint&) {}
void Tavo_WiScrollWnd::OnDoubleClick(UINT, UINT, const CPoint&) {}
void Tavo_WiScrollWnd::OnDragStart(UINT, UINT, const CPoint&) {}
void Tavo_WiScrollWnd::OnDragMove(UINT, UINT, const CPoint&) {}
void Tavo_WiScrollWnd::OnDragEnd(UINT, UINT, const CPoint&, int) {}
void Tavo_WiScrollWnd::OnDragAbort() {}

CString Tavo_WiScrollWnd::GetDataTipText(const CPoint&)
{
    return CString();
}

void Tavo_WiScrollWnd::OnDragScrollStart(const CPoint&) {}
void Tavo_WiScrollWnd::OnDragScrollMove(const CPoint&) {}
void Tavo_WiScrollWnd::OnDragScrollEnd(const CPoint&) {}
void Tavo_WiScrollWnd::OnNonDragScrollEnd(const CPoint&) {}
