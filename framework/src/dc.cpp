// dc.cpp - CDC: output goes to m_hDC, attributes are set on both handles
// and read from m_hAttribDC.
#include <afxwin.h>

namespace {

// Applies an attribute change to the output handle (when it differs) and
// to the attribute handle, returning the attribute handle's answer.
template <class Result, class Change>
Result SetOnBoth(HDC output, HDC attribute, Result fallback, Change change)
{
    Result result = fallback;
    if (output != attribute && output != NULL)
        result = change(output);
    if (attribute != NULL)
        result = change(attribute);
    return result;
}

// The handle to read attributes from: the attribute handle, else the output.
HDC ReadHandle(const CDC& dc) { return dc.m_hAttribDC != NULL ? dc.m_hAttribDC : dc.m_hDC; }

} // namespace

CDC::~CDC()
{
    if (m_hDC != NULL)
        ::DeleteDC(Detach());
}

CWnd* CDC::GetWindow() const { return CWnd::FromHandle(::WindowFromDC(m_hDC)); }

void CDC::SetAttribDC(HDC hDC) { m_hAttribDC = hDC; }
void CDC::SetOutputDC(HDC hDC) { m_hDC = hDC; }
void CDC::ReleaseAttribDC() { m_hAttribDC = NULL; }
void CDC::ReleaseOutputDC() { m_hDC = NULL; }

BOOL CDC::CreateDC(LPCTSTR lpszDriverName, LPCTSTR lpszDeviceName, LPCTSTR lpszOutput, const void* lpInitData)
{
    return Attach(::CreateDCA(lpszDriverName, lpszDeviceName, lpszOutput, static_cast<const DEVMODEA*>(lpInitData)));
}

BOOL CDC::CreateIC(LPCTSTR lpszDriverName, LPCTSTR lpszDeviceName, LPCTSTR lpszOutput, const void* lpInitData)
{
    return Attach(::CreateICA(lpszDriverName, lpszDeviceName, lpszOutput, static_cast<const DEVMODEA*>(lpInitData)));
}

BOOL CDC::CreateCompatibleDC(CDC* pDC) { return Attach(::CreateCompatibleDC(pDC->GetSafeHdc())); }

BOOL CDC::DeleteDC()
{
    if (m_hDC == NULL)
        return FALSE;
    return ::DeleteDC(Detach());
}

int CDC::SaveDC()
{
    int saved = 0;
    if (m_hAttribDC != NULL)
        saved = ::SaveDC(m_hAttribDC);
    if (m_hDC != m_hAttribDC && ::SaveDC(m_hDC) != 0)
        saved = -1; // -1: restore the latest of both
    return saved;
}

BOOL CDC::RestoreDC(int nSavedDC)
{
    BOOL restored = TRUE;
    if (m_hDC != m_hAttribDC)
        restored = ::RestoreDC(m_hDC, nSavedDC);
    if (m_hAttribDC != NULL)
        restored = ::RestoreDC(m_hAttribDC, nSavedDC) && restored;
    return restored;
}

int CDC::GetDeviceCaps(int nIndex) const { return ::GetDeviceCaps(ReadHandle(*this), nIndex); }

// Selection

HGDIOBJ CDC::SelectObject(HGDIOBJ hObject)
{
    return SetOnBoth<HGDIOBJ>(m_hDC, m_hAttribDC, NULL, [&](HDC h) { return ::SelectObject(h, hObject); });
}

CGdiObject* CDC::SelectStockObject(int nIndex)
{
    return CGdiObject::FromHandle(SelectObject(::GetStockObject(nIndex)));
}

CPen* CDC::SelectObject(CPen* pPen) { return CPen::FromHandle(static_cast<HPEN>(SelectObject(pPen->GetSafeHandle()))); }

CBrush* CDC::SelectObject(CBrush* pBrush)
{
    return CBrush::FromHandle(static_cast<HBRUSH>(SelectObject(pBrush->GetSafeHandle())));
}

CFont* CDC::SelectObject(CFont* pFont)
{
    return CFont::FromHandle(static_cast<HFONT>(SelectObject(pFont->GetSafeHandle())));
}

CGdiObject* CDC::SelectObject(CGdiObject* pObject)
{
    return CGdiObject::FromHandle(SelectObject(pObject->GetSafeHandle()));
}

int CDC::SelectObject(CRgn* pRgn) { return SelectClipRgn(pRgn); }

// Colours and modes

COLORREF CDC::GetBkColor() const { return ::GetBkColor(ReadHandle(*this)); }
COLORREF CDC::SetBkColor(COLORREF crColor)
{
    return SetOnBoth<COLORREF>(m_hDC, m_hAttribDC, CLR_INVALID, [&](HDC h) { return ::SetBkColor(h, crColor); });
}
int CDC::GetBkMode() const { return ::GetBkMode(ReadHandle(*this)); }
int CDC::SetBkMode(int nBkMode)
{
    return SetOnBoth<int>(m_hDC, m_hAttribDC, 0, [&](HDC h) { return ::SetBkMode(h, nBkMode); });
}
int CDC::GetPolyFillMode() const { return ::GetPolyFillMode(ReadHandle(*this)); }
int CDC::SetPolyFillMode(int nPolyFillMode)
{
    return SetOnBoth<int>(m_hDC, m_hAttribDC, 0, [&](HDC h) { return ::SetPolyFillMode(h, nPolyFillMode); });
}
int CDC::GetROP2() const { return ::GetROP2(ReadHandle(*this)); }
int CDC::SetROP2(int nDrawMode)
{
    return SetOnBoth<int>(m_hDC, m_hAttribDC, 0, [&](HDC h) { return ::SetROP2(h, nDrawMode); });
}
COLORREF CDC::GetTextColor() const { return ::GetTextColor(ReadHandle(*this)); }
COLORREF CDC::SetTextColor(COLORREF crColor)
{
    return SetOnBoth<COLORREF>(m_hDC, m_hAttribDC, CLR_INVALID, [&](HDC h) { return ::SetTextColor(h, crColor); });
}
UINT CDC::GetTextAlign() const { return ::GetTextAlign(ReadHandle(*this)); }
UINT CDC::SetTextAlign(UINT nFlags)
{
    return SetOnBoth<UINT>(m_hDC, m_hAttribDC, GDI_ERROR, [&](HDC h) { return ::SetTextAlign(h, nFlags); });
}

// Mapping

int CDC::GetMapMode() const { return ::GetMapMode(ReadHandle(*this)); }
int CDC::SetMapMode(int nMapMode)
{
    return SetOnBoth<int>(m_hDC, m_hAttribDC, 0, [&](HDC h) { return ::SetMapMode(h, nMapMode); });
}
CPoint CDC::GetViewportOrg() const
{
    POINT point = {};
    ::GetViewportOrgEx(ReadHandle(*this), &point);
    return point;
}
CPoint CDC::SetViewportOrg(int x, int y)
{
    POINT previous = {};
    SetOnBoth<BOOL>(m_hDC, m_hAttribDC, FALSE, [&](HDC h) { return ::SetViewportOrgEx(h, x, y, &previous); });
    return previous;
}
CPoint CDC::SetViewportOrg(POINT point) { return SetViewportOrg(point.x, point.y); }
CPoint CDC::OffsetViewportOrg(int nWidth, int nHeight)
{
    POINT previous = {};
    SetOnBoth<BOOL>(m_hDC, m_hAttribDC, FALSE,
                    [&](HDC h) { return ::OffsetViewportOrgEx(h, nWidth, nHeight, &previous); });
    return previous;
}
CSize CDC::GetViewportExt() const
{
    SIZE size = {};
    ::GetViewportExtEx(ReadHandle(*this), &size);
    return size;
}
CSize CDC::SetViewportExt(int cx, int cy)
{
    SIZE previous = {};
    SetOnBoth<BOOL>(m_hDC, m_hAttribDC, FALSE, [&](HDC h) { return ::SetViewportExtEx(h, cx, cy, &previous); });
    return previous;
}
CSize CDC::SetViewportExt(SIZE size) { return SetViewportExt(size.cx, size.cy); }
CPoint CDC::GetWindowOrg() const
{
    POINT point = {};
    ::GetWindowOrgEx(ReadHandle(*this), &point);
    return point;
}
CPoint CDC::SetWindowOrg(int x, int y)
{
    POINT previous = {};
    SetOnBoth<BOOL>(m_hDC, m_hAttribDC, FALSE, [&](HDC h) { return ::SetWindowOrgEx(h, x, y, &previous); });
    return previous;
}
CPoint CDC::SetWindowOrg(POINT point) { return SetWindowOrg(point.x, point.y); }
CSize CDC::GetWindowExt() const
{
    SIZE size = {};
    ::GetWindowExtEx(ReadHandle(*this), &size);
    return size;
}
CSize CDC::SetWindowExt(int cx, int cy)
{
    SIZE previous = {};
    SetOnBoth<BOOL>(m_hDC, m_hAttribDC, FALSE, [&](HDC h) { return ::SetWindowExtEx(h, cx, cy, &previous); });
    return previous;
}
CSize CDC::SetWindowExt(SIZE size) { return SetWindowExt(size.cx, size.cy); }
void CDC::DPtoLP(LPPOINT lpPoints, int nCount) const { ::DPtoLP(ReadHandle(*this), lpPoints, nCount); }
void CDC::DPtoLP(LPRECT lpRect) const { ::DPtoLP(ReadHandle(*this), reinterpret_cast<LPPOINT>(lpRect), 2); }
void CDC::LPtoDP(LPPOINT lpPoints, int nCount) const { ::LPtoDP(ReadHandle(*this), lpPoints, nCount); }
void CDC::LPtoDP(LPRECT lpRect) const { ::LPtoDP(ReadHandle(*this), reinterpret_cast<LPPOINT>(lpRect), 2); }

// Clipping: the output handle's region is the one that counts.

int CDC::GetClipBox(LPRECT lpRect) const { return ::GetClipBox(m_hDC, lpRect); }
BOOL CDC::PtVisible(int x, int y) const { return ::PtVisible(m_hDC, x, y); }
BOOL CDC::RectVisible(LPCRECT lpRect) const { return ::RectVisible(m_hDC, lpRect); }
int CDC::SelectClipRgn(CRgn* pRgn)
{
    const auto hRgn = static_cast<HRGN>(pRgn->GetSafeHandle());
    return SetOnBoth<int>(m_hAttribDC, m_hDC, ERROR, [&](HDC h) { return ::SelectClipRgn(h, hRgn); });
}
int CDC::SelectClipRgn(CRgn* pRgn, int nMode)
{
    const auto hRgn = static_cast<HRGN>(pRgn->GetSafeHandle());
    return SetOnBoth<int>(m_hAttribDC, m_hDC, ERROR, [&](HDC h) { return ::ExtSelectClipRgn(h, hRgn, nMode); });
}
int CDC::ExcludeClipRect(int x1, int y1, int x2, int y2)
{
    return SetOnBoth<int>(m_hAttribDC, m_hDC, ERROR, [&](HDC h) { return ::ExcludeClipRect(h, x1, y1, x2, y2); });
}
int CDC::ExcludeClipRect(LPCRECT lpRect)
{
    return ExcludeClipRect(lpRect->left, lpRect->top, lpRect->right, lpRect->bottom);
}
int CDC::IntersectClipRect(int x1, int y1, int x2, int y2)
{
    return SetOnBoth<int>(m_hAttribDC, m_hDC, ERROR, [&](HDC h) { return ::IntersectClipRect(h, x1, y1, x2, y2); });
}
int CDC::IntersectClipRect(LPCRECT lpRect)
{
    return IntersectClipRect(lpRect->left, lpRect->top, lpRect->right, lpRect->bottom);
}
int CDC::OffsetClipRgn(int x, int y)
{
    return SetOnBoth<int>(m_hAttribDC, m_hDC, ERROR, [&](HDC h) { return ::OffsetClipRgn(h, x, y); });
}

// Lines: the current position is kept on both handles.

CPoint CDC::GetCurrentPosition() const
{
    POINT point = {};
    ::GetCurrentPositionEx(ReadHandle(*this), &point);
    return point;
}
CPoint CDC::MoveTo(int x, int y)
{
    POINT previous = {};
    SetOnBoth<BOOL>(m_hDC, m_hAttribDC, FALSE, [&](HDC h) { return ::MoveToEx(h, x, y, &previous); });
    return previous;
}
CPoint CDC::MoveTo(POINT point) { return MoveTo(point.x, point.y); }
BOOL CDC::LineTo(int x, int y)
{
    if (m_hAttribDC != NULL && m_hAttribDC != m_hDC)
        ::MoveToEx(m_hAttribDC, x, y, NULL);
    return ::LineTo(m_hDC, x, y);
}
BOOL CDC::LineTo(POINT point) { return LineTo(point.x, point.y); }
BOOL CDC::Polyline(const POINT* lpPoints, int nCount) { return ::Polyline(m_hDC, lpPoints, nCount); }
BOOL CDC::PolyPolyline(const POINT* lpPoints, const DWORD* lpPolyPoints, int nCount)
{
    return ::PolyPolyline(m_hDC, lpPoints, lpPolyPoints, static_cast<DWORD>(nCount));
}

// Shapes and fills

void CDC::FillRect(LPCRECT lpRect, CBrush* pBrush) { ::FillRect(m_hDC, lpRect, static_cast<HBRUSH>(pBrush->GetSafeHandle())); }
void CDC::FrameRect(LPCRECT lpRect, CBrush* pBrush) { ::FrameRect(m_hDC, lpRect, static_cast<HBRUSH>(pBrush->GetSafeHandle())); }
void CDC::InvertRect(LPCRECT lpRect) { ::InvertRect(m_hDC, lpRect); }
void CDC::DrawFocusRect(LPCRECT lpRect) { ::DrawFocusRect(m_hDC, lpRect); }
void CDC::FillSolidRect(LPCRECT lpRect, COLORREF clr)
{
    // ExtTextOut with an opaque rectangle fills in the colour without a brush.
    const COLORREF previous = ::SetBkColor(m_hDC, clr);
    ::ExtTextOutA(m_hDC, 0, 0, ETO_OPAQUE, lpRect, NULL, 0, NULL);
    ::SetBkColor(m_hDC, previous);
}
void CDC::FillSolidRect(int x, int y, int cx, int cy, COLORREF clr)
{
    const RECT rect = {x, y, x + cx, y + cy};
    FillSolidRect(&rect, clr);
}
BOOL CDC::FillRgn(CRgn* pRgn, CBrush* pBrush)
{
    return ::FillRgn(m_hDC, static_cast<HRGN>(pRgn->GetSafeHandle()), static_cast<HBRUSH>(pBrush->GetSafeHandle()));
}
BOOL CDC::Rectangle(int x1, int y1, int x2, int y2) { return ::Rectangle(m_hDC, x1, y1, x2, y2); }
BOOL CDC::Rectangle(LPCRECT lpRect) { return Rectangle(lpRect->left, lpRect->top, lpRect->right, lpRect->bottom); }
BOOL CDC::Ellipse(int x1, int y1, int x2, int y2) { return ::Ellipse(m_hDC, x1, y1, x2, y2); }
BOOL CDC::Ellipse(LPCRECT lpRect) { return Ellipse(lpRect->left, lpRect->top, lpRect->right, lpRect->bottom); }
BOOL CDC::Polygon(const POINT* lpPoints, int nCount) { return ::Polygon(m_hDC, lpPoints, nCount); }
BOOL CDC::PolyPolygon(const POINT* lpPoints, const INT* lpPolyCounts, int nCount)
{
    return ::PolyPolygon(m_hDC, lpPoints, lpPolyCounts, nCount);
}
BOOL CDC::PatBlt(int x, int y, int nWidth, int nHeight, DWORD dwRop)
{
    return ::PatBlt(m_hDC, x, y, nWidth, nHeight, dwRop);
}
BOOL CDC::BitBlt(int x, int y, int nWidth, int nHeight, CDC* pSrcDC, int xSrc, int ySrc, DWORD dwRop)
{
    return ::BitBlt(m_hDC, x, y, nWidth, nHeight, pSrcDC->GetSafeHdc(), xSrc, ySrc, dwRop);
}
COLORREF CDC::SetPixel(int x, int y, COLORREF crColor) { return ::SetPixel(m_hDC, x, y, crColor); }
COLORREF CDC::GetPixel(int x, int y) const { return ::GetPixel(m_hDC, x, y); }

// Text

BOOL CDC::TextOut(int x, int y, LPCTSTR lpszString, int nCount) { return ::TextOutA(m_hDC, x, y, lpszString, nCount); }
BOOL CDC::TextOut(int x, int y, const CString& str) { return TextOut(x, y, str, str.GetLength()); }
BOOL CDC::ExtTextOut(int x, int y, UINT nOptions, LPCRECT lpRect, LPCTSTR lpszString, UINT nCount, LPINT lpDxWidths)
{
    return ::ExtTextOutA(m_hDC, x, y, nOptions, lpRect, lpszString, nCount, lpDxWidths);
}
int CDC::DrawText(LPCTSTR lpszString, int nCount, LPRECT lpRect, UINT nFormat)
{
    return ::DrawTextA(m_hDC, lpszString, nCount, lpRect, nFormat);
}
int CDC::DrawText(const CString& str, LPRECT lpRect, UINT nFormat)
{
    return DrawText(str, str.GetLength(), lpRect, nFormat);
}
CSize CDC::GetTextExtent(LPCTSTR lpszString, int nCount) const
{
    SIZE size = {};
    ::GetTextExtentPoint32A(ReadHandle(*this), lpszString, nCount, &size);
    return size;
}
CSize CDC::GetTextExtent(const CString& str) const { return GetTextExtent(str, str.GetLength()); }
CSize CDC::GetOutputTextExtent(LPCTSTR lpszString, int nCount) const
{
    SIZE size = {};
    ::GetTextExtentPoint32A(m_hDC, lpszString, nCount, &size);
    return size;
}
BOOL CDC::GetTextMetrics(LPTEXTMETRIC lpMetrics) const { return ::GetTextMetricsA(ReadHandle(*this), lpMetrics); }
BOOL CDC::GetOutputTextMetrics(LPTEXTMETRIC lpMetrics) const { return ::GetTextMetricsA(m_hDC, lpMetrics); }

// Printing

int CDC::StartDoc(LPDOCINFO lpDocInfo) { return ::StartDocA(m_hDC, lpDocInfo); }
int CDC::StartPage() { return ::StartPage(m_hDC); }
int CDC::EndPage() { return ::EndPage(m_hDC); }
int CDC::EndDoc() { return ::EndDoc(m_hDC); }
int CDC::AbortDoc() { return ::AbortDoc(m_hDC); }
int CDC::SetAbortProc(BOOL(CALLBACK* lpfn)(HDC, int)) { return ::SetAbortProc(m_hDC, lpfn); }
