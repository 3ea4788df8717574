#include "DrawingView.h"

#include "ItemDescription.h"
#include "StatusText.h"
#include "ViewerSettings.h"

#include "Tavo_GrRound.h"

#include <cstdlib>

BEGIN_MESSAGE_MAP(DrawingView, Tavo_WiDrawWnd)
    ON_WM_MOUSEWHEEL()
    ON_WM_WINDOWPOSCHANGED()
END_MESSAGE_MAP()

DrawingView::DrawingView() = default;
DrawingView::~DrawingView() = default;

BOOL DrawingView::CreateView(CWnd* parent, const CRect& rect, UINT id)
{
    if (!Create(WS_CHILD | WS_VISIBLE, rect, parent, id))
        return FALSE;
    GetScrollee()->SetBackgroundColor(ViewerSettings::Background);
    // Both bars always show, so the view keeps its size at every zoom: bars
    // that came and went would change the fitted scale under the view, and
    // zooming out as far as in would not lead back to the fitted drawing.
    SetScrollBarAutoVisibilityFlag(0);
    SetScrollBarVisibilityFlags(1, 1);
    return TRUE;
}

void DrawingView::Bind(ViewerDocument* document)
{
    m_document = document;
    SetDrawingInfo(document ? &document->GetDrawing() : nullptr, ViewerSettings::MaxZoomLevel,
                   ViewerSettings::SurfaceOption, ViewerSettings::ZeroLevelExpansionPercent,
                   ViewerSettings::NoMinimumViewWidth, ViewerSettings::NoMinimumViewHeight);
    GetScrollee()->Invalidate(TRUE);
    ShowZoom();
}

// ---- commands ------------------------------------------------------------------------

void DrawingView::ZoomIn()
{
    ZoomWindow(Tavo_GrZoom::In, ViewerSettings::LevelsPerKey, Tavo_WiZoomCenter::AtViewCentre, 0, 0, false);
    ShowZoom();
}

void DrawingView::ZoomOut()
{
    ZoomWindow(Tavo_GrZoom::Out, ViewerSettings::LevelsPerKey, Tavo_WiZoomCenter::AtViewCentre, 0, 0, false);
    ShowZoom();
}

void DrawingView::ZoomToFit()
{
    ZoomWindow(Tavo_GrZoom::ZeroLevel, 0, Tavo_WiZoomCenter::AtViewCentre, 0, 0, false);
    ShowZoom();
}

void DrawingView::UndoZoom()
{
    UndoLastScrollZoom();
    ShowZoom();
}

void DrawingView::Scroll(Tavo_WiScroll::Dir dir, Tavo_WiScroll::Amount amount)
{
    ScrollWindow(dir, amount, 0);
}

// ---- the pointer -------------------------------------------------------------------------

void DrawingView::OnClick(UINT button, UINT, const Tavo_GrWRect& aperture)
{
    if (button != MK_LBUTTON || !m_document)
        return;
    ShowMessage(ItemDescription::DescribeAperture(m_document->GetDrawing(), aperture, m_document->GetUnits()));
}

void DrawingView::OnDoubleClick(UINT button, UINT, const Tavo_GrWRect&)
{
    if (button != MK_LBUTTON)
        return;
    ZoomWindow(Tavo_GrZoom::In, ViewerSettings::LevelsPerDoubleClick, Tavo_WiZoomCenter::AtCursor, 0, 0, false);
    ShowZoom();
}

Tavo_WiDrawWnd::DragAction DrawingView::GetDragAction(UINT, UINT flags, const CPoint&)
{
    return (flags & MK_SHIFT) != 0 ? RubberRectangle : Pan;
}

void DrawingView::OnRubberRectangle(UINT, UINT, const Tavo_GrWRect& rect)
{
    ZoomWindow(rect);
    ShowZoom();
}

CString DrawingView::GetDataTipText(const Tavo_GrWRect& aperture)
{
    if (!m_document)
        return CString();
    Tavo_GrItemInfo topmost;
    const int count = m_document->GetDrawing().FindItems(aperture, [&topmost](const Tavo_GrItemInfo& info) {
        topmost = info;
        return true;
    });
    // Empty space gets no tip.
    if (count == 0)
        return CString();
    return CString(ItemDescription::Describe(topmost, count, m_document->GetUnits()).c_str());
}

std::string DrawingView::DescribePoint(const CPoint& point)
{
    Tavo_GrWRect aperture;
    if (!m_document || !FetchApertureFromPoint(point, aperture))
        return std::string();
    return ItemDescription::DescribeAperture(m_document->GetDrawing(), aperture, m_document->GetUnits());
}

// The wheel message goes to the window with the focus, the scrollee, whose
// default handling passes it on to its parent: this window.
BOOL DrawingView::OnMouseWheel(UINT, short delta, CPoint)
{
    m_wheelRemainder += delta;
    const int notches = m_wheelRemainder / WHEEL_DELTA;
    m_wheelRemainder -= notches * WHEEL_DELTA;
    if (notches == 0)
        return TRUE;
    const Tavo_GrZoom::Type direction = notches > 0 ? Tavo_GrZoom::In : Tavo_GrZoom::Out;
    ZoomWindow(direction, std::abs(notches) * ViewerSettings::LevelsPerWheelNotch, Tavo_WiZoomCenter::AtCursor, 0,
               0, false);
    ShowZoom();
    return TRUE;
}

BOOL DrawingView::PreTranslateMessage(MSG* msg)
{
    // Every pointer move over the view, drags included, passes here on its
    // way to the scrollee.
    if (msg->message == WM_MOUSEMOVE && msg->hwnd == GetScrollee()->GetSafeHwnd())
        ShowPointer(CPoint(static_cast<short>(LOWORD(msg->lParam)), static_cast<short>(HIWORD(msg->lParam))));
    return Tavo_WiDrawWnd::PreTranslateMessage(msg);
}

void DrawingView::OnWindowPosChanged(WINDOWPOS* windowPos)
{
    // A new size may change the zoom level the fitted drawing is shown at.
    Tavo_WiDrawWnd::OnWindowPosChanged(windowPos);
    ShowZoom();
}

// ---- printing --------------------------------------------------------------------------------

CString DrawingView::GetPrintHeader(const Tavo_WiPrintLayout& layout)
{
    const CString grid = Tavo_WiDrawWnd::GetPrintHeader(layout);
    if (!m_document)
        return grid;
    return CString((m_document->GetName() + "   ").c_str()) + grid;
}

// ---- the status bar ----------------------------------------------------------------------------

void DrawingView::ShowZoom()
{
    if (!m_statusBar || !::IsWindow(m_statusBar->GetSafeHwnd()))
        return;
    m_statusBar->SetPartText(ViewerStatusBar::Zoom,
                             GetMapping() ? StatusText::Zoom(GetZoomLevel(), ZoomLevelsPerDoubling) : std::string());
}

void DrawingView::ShowPointer(const CPoint& point)
{
    if (!m_statusBar || !::IsWindow(m_statusBar->GetSafeHwnd()) || !m_document || !GetMapping())
        return;
    const Tavo_GrTransform& t = GetMapping()->GetTransform();
    const int h = GetMapping()->GetDeviceWindowHeight();
    const DrawingUnits& units = m_document->GetUnits();
    const double x = units.ToDrawingX(t.Invertxcoord(point.x));
    const double y = units.ToDrawingY(t.Invertycoord(Tavo_GrSubtract(h, point.y)));
    const int decimals = DrawingUnitsText::DecimalsForPixel(t.GetScale() * units.scale);
    m_statusBar->SetPartText(ViewerStatusBar::Pointer, StatusText::Pointer(x, y, decimals));
}

void DrawingView::ShowMessage(const std::string& text)
{
    if (m_statusBar && ::IsWindow(m_statusBar->GetSafeHwnd()))
        m_statusBar->SetPartText(ViewerStatusBar::Message, text);
}
