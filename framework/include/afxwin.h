// afxwin.h - windows, message maps, device contexts, GDI objects, threads
// and the application object of the framework (MFC 8.0 compatible subset).
//
// Classes: CCmdTarget, CWnd, CDialog, CScrollBar, CButton, CDC, CPaintDC,
// CClientDC, CGdiObject, CPen, CBrush, CFont, CRgn, CWinThread, CWinApp,
// CDynLinkLibrary. Message maps: DECLARE_MESSAGE_MAP, BEGIN_MESSAGE_MAP,
// END_MESSAGE_MAP, ON_MESSAGE, ON_REGISTERED_MESSAGE and ON_WM_*.
//
// Console programs (tests): the framework does not need its own WinMain. A
// CWinApp constructed anywhere becomes the current application (AfxGetApp)
// until it is destroyed; without one, AfxGetInstanceHandle and
// AfxGetResourceHandle give the executable's module (GetModuleHandle(NULL))
// and the message pump is still available through AfxPumpMessage.
//
// ON_MESSAGE and ON_REGISTERED_MESSAGE take the handler as a pointer to
// member, ON_MESSAGE(WM_X, &CMyWnd::OnX), which every compiler accepts (the
// bare name OnX is accepted here too); the ON_WM_* entries name theirs.
// Exceptions that escape a handler end at the framework's window procedure
// (the message then returns 0, or -1 for WM_CREATE).
#ifndef TAVO_FRAMEWORK_AFXWIN_H
#define TAVO_FRAMEWORK_AFXWIN_H

#include "afx.h"

class CCmdTarget;
class CWnd;
class CDC;
class CGdiObject;
class CPen;
class CBrush;
class CFont;
class CRgn;
class CScrollBar;
class CWinThread;
class CWinApp;
class CPrintDialog;    // <afxdlgs.h>
struct CCreateContext; // document/view creation context; passed through, never read

// ---------------------------------------------------------------------------
// Message maps
// ---------------------------------------------------------------------------

typedef void (AFX_MSG_CALL CCmdTarget::*AFX_PMSG)(void);
typedef void (AFX_MSG_CALL CWnd::*AFX_PMSGW)(void);

// Handler signatures. Each ON_WM_* entry names the signature its handler has,
// and the window procedure unpacks the message accordingly.
enum AfxSig : UINT_PTR {
    AfxSig_end = 0,
    AfxSig_lwl,  // LRESULT (WPARAM, LPARAM): ON_MESSAGE, ON_REGISTERED_MESSAGE
    AfxSig_vv,   // void (void)
    AfxSig_is,   // int (LPCREATESTRUCT)
    AfxSig_bD,   // BOOL (CDC*)
    AfxSig_vwii, // void (UINT, int, int)
    AfxSig_vii,  // void (int, int)
    AfxSig_vwwx, // void (UINT, UINT, CScrollBar*)
    AfxSig_vt,   // void (UINT_PTR)
    AfxSig_vwp,  // void (UINT, CPoint)
    AfxSig_bwsp, // BOOL (UINT, short, CPoint)
    AfxSig_vW,   // void (CWnd*)
    AfxSig_vPOS, // void (WINDOWPOS*)
    AfxSig_vwww, // void (UINT, UINT, UINT)
    AfxSig_bWww, // BOOL (CWnd*, UINT, UINT)
    AfxSig_iWww, // int (CWnd*, UINT, UINT)
    AfxSig_vMMI, // void (MINMAXINFO*)
    AfxSig_vbw,  // void (BOOL, UINT)
    AfxSig_lp,   // LRESULT (CPoint)
    AfxSig_vWp,  // void (CWnd*, CPoint)
    AfxSig_wv,   // UINT (void)
};

// Registered messages are entries with this message code; their nSig holds
// the address of the UINT that contains the registered message id, read at
// dispatch time.
#define AFX_REGISTERED_MESSAGE_CODE 0xC002

struct AFX_MSGMAP_ENTRY {
    UINT nMessage; // window message
    UINT nCode;    // control code or WM_NOTIFY code (unused here)
    UINT nID;      // control id (unused here)
    UINT nLastID;  // last control id of a range (unused here)
    UINT_PTR nSig; // handler signature, or the address of a registered id
    AFX_PMSG pfn;  // handler
};

struct AFX_MSGMAP {
    const AFX_MSGMAP*(PASCAL* pfnGetBaseMap)();
    const AFX_MSGMAP_ENTRY* lpEntries;
};

// clang-format off
// Message map entries convert handler pointers between member-function types,
// which is their purpose; the compiler's warning about it is silenced inside
// the map only.
#define PTM_WARNING_DISABLE \
    _Pragma("GCC diagnostic push") _Pragma("GCC diagnostic ignored \"-Wcast-function-type\"")
#define PTM_WARNING_RESTORE _Pragma("GCC diagnostic pop")

#define DECLARE_MESSAGE_MAP() \
protected: \
    static const AFX_MSGMAP* PASCAL GetThisMessageMap(); \
    const AFX_MSGMAP* GetMessageMap() const override;

#define BEGIN_MESSAGE_MAP(theClass, baseClass) \
    PTM_WARNING_DISABLE \
    const AFX_MSGMAP* theClass::GetMessageMap() const { return GetThisMessageMap(); } \
    const AFX_MSGMAP* PASCAL theClass::GetThisMessageMap() \
    { \
        typedef theClass ThisClass; \
        typedef baseClass TheBaseClass; \
        (void)sizeof(ThisClass*); \
        static const AFX_MSGMAP_ENTRY _messageEntries[] = {

#define END_MESSAGE_MAP() \
            {0, 0, 0, 0, AfxSig_end, static_cast<AFX_PMSG>(nullptr)} \
        }; \
        static const AFX_MSGMAP messageMap = {&TheBaseClass::GetThisMessageMap, &_messageEntries[0]}; \
        return &messageMap; \
    } \
    PTM_WARNING_RESTORE

#define AFX_WM_ENTRY(msg, sig, type, memberFxn) \
    {msg, 0, 0, 0, sig, static_cast<AFX_PMSG>(reinterpret_cast<AFX_PMSGW>(static_cast<type>(memberFxn)))},

// LRESULT memberFxn(WPARAM, LPARAM)
#define ON_MESSAGE(message, memberFxn) \
    AFX_WM_ENTRY(message, AfxSig_lwl, LRESULT (AFX_MSG_CALL CWnd::*)(WPARAM, LPARAM), memberFxn)
// nMessageVariable: a UINT holding a RegisterWindowMessage id; read when a
// message arrives, so it may be filled after the map is built.
#define ON_REGISTERED_MESSAGE(nMessageVariable, memberFxn) \
    {AFX_REGISTERED_MESSAGE_CODE, 0, 0, 0, reinterpret_cast<UINT_PTR>(static_cast<UINT*>(&nMessageVariable)), \
      static_cast<AFX_PMSG>(reinterpret_cast<AFX_PMSGW>(static_cast<LRESULT (AFX_MSG_CALL CWnd::*)(WPARAM, LPARAM)>(memberFxn)))},

#define ON_WM_CREATE() AFX_WM_ENTRY(WM_CREATE, AfxSig_is, int (AFX_MSG_CALL CWnd::*)(LPCREATESTRUCT), &ThisClass::OnCreate)
#define ON_WM_DESTROY() AFX_WM_ENTRY(WM_DESTROY, AfxSig_vv, void (AFX_MSG_CALL CWnd::*)(void), &ThisClass::OnDestroy)
#define ON_WM_NCDESTROY() AFX_WM_ENTRY(WM_NCDESTROY, AfxSig_vv, void (AFX_MSG_CALL CWnd::*)(void), &ThisClass::OnNcDestroy)
#define ON_WM_CLOSE() AFX_WM_ENTRY(WM_CLOSE, AfxSig_vv, void (AFX_MSG_CALL CWnd::*)(void), &ThisClass::OnClose)
#define ON_WM_PAINT() AFX_WM_ENTRY(WM_PAINT, AfxSig_vv, void (AFX_MSG_CALL CWnd::*)(void), &ThisClass::OnPaint)
#define ON_WM_ERASEBKGND() AFX_WM_ENTRY(WM_ERASEBKGND, AfxSig_bD, BOOL (AFX_MSG_CALL CWnd::*)(CDC*), &ThisClass::OnEraseBkgnd)
#define ON_WM_SIZE() AFX_WM_ENTRY(WM_SIZE, AfxSig_vwii, void (AFX_MSG_CALL CWnd::*)(UINT, int, int), &ThisClass::OnSize)
#define ON_WM_MOVE() AFX_WM_ENTRY(WM_MOVE, AfxSig_vii, void (AFX_MSG_CALL CWnd::*)(int, int), &ThisClass::OnMove)
#define ON_WM_HSCROLL() AFX_WM_ENTRY(WM_HSCROLL, AfxSig_vwwx, void (AFX_MSG_CALL CWnd::*)(UINT, UINT, CScrollBar*), &ThisClass::OnHScroll)
#define ON_WM_VSCROLL() AFX_WM_ENTRY(WM_VSCROLL, AfxSig_vwwx, void (AFX_MSG_CALL CWnd::*)(UINT, UINT, CScrollBar*), &ThisClass::OnVScroll)
#define ON_WM_TIMER() AFX_WM_ENTRY(WM_TIMER, AfxSig_vt, void (AFX_MSG_CALL CWnd::*)(UINT_PTR), &ThisClass::OnTimer)
#define ON_WM_MOUSEMOVE() AFX_WM_ENTRY(WM_MOUSEMOVE, AfxSig_vwp, void (AFX_MSG_CALL CWnd::*)(UINT, CPoint), &ThisClass::OnMouseMove)
#define ON_WM_LBUTTONDOWN() AFX_WM_ENTRY(WM_LBUTTONDOWN, AfxSig_vwp, void (AFX_MSG_CALL CWnd::*)(UINT, CPoint), &ThisClass::OnLButtonDown)
#define ON_WM_LBUTTONUP() AFX_WM_ENTRY(WM_LBUTTONUP, AfxSig_vwp, void (AFX_MSG_CALL CWnd::*)(UINT, CPoint), &ThisClass::OnLButtonUp)
#define ON_WM_LBUTTONDBLCLK() AFX_WM_ENTRY(WM_LBUTTONDBLCLK, AfxSig_vwp, void (AFX_MSG_CALL CWnd::*)(UINT, CPoint), &ThisClass::OnLButtonDblClk)
#define ON_WM_RBUTTONDOWN() AFX_WM_ENTRY(WM_RBUTTONDOWN, AfxSig_vwp, void (AFX_MSG_CALL CWnd::*)(UINT, CPoint), &ThisClass::OnRButtonDown)
#define ON_WM_RBUTTONUP() AFX_WM_ENTRY(WM_RBUTTONUP, AfxSig_vwp, void (AFX_MSG_CALL CWnd::*)(UINT, CPoint), &ThisClass::OnRButtonUp)
#define ON_WM_RBUTTONDBLCLK() AFX_WM_ENTRY(WM_RBUTTONDBLCLK, AfxSig_vwp, void (AFX_MSG_CALL CWnd::*)(UINT, CPoint), &ThisClass::OnRButtonDblClk)
#define ON_WM_MBUTTONDOWN() AFX_WM_ENTRY(WM_MBUTTONDOWN, AfxSig_vwp, void (AFX_MSG_CALL CWnd::*)(UINT, CPoint), &ThisClass::OnMButtonDown)
#define ON_WM_MBUTTONUP() AFX_WM_ENTRY(WM_MBUTTONUP, AfxSig_vwp, void (AFX_MSG_CALL CWnd::*)(UINT, CPoint), &ThisClass::OnMButtonUp)
#define ON_WM_MBUTTONDBLCLK() AFX_WM_ENTRY(WM_MBUTTONDBLCLK, AfxSig_vwp, void (AFX_MSG_CALL CWnd::*)(UINT, CPoint), &ThisClass::OnMButtonDblClk)
#define ON_WM_MOUSEWHEEL() AFX_WM_ENTRY(WM_MOUSEWHEEL, AfxSig_bwsp, BOOL (AFX_MSG_CALL CWnd::*)(UINT, short, CPoint), &ThisClass::OnMouseWheel)
#define ON_WM_CAPTURECHANGED() AFX_WM_ENTRY(WM_CAPTURECHANGED, AfxSig_vW, void (AFX_MSG_CALL CWnd::*)(CWnd*), &ThisClass::OnCaptureChanged)
#define ON_WM_SETFOCUS() AFX_WM_ENTRY(WM_SETFOCUS, AfxSig_vW, void (AFX_MSG_CALL CWnd::*)(CWnd*), &ThisClass::OnSetFocus)
#define ON_WM_KILLFOCUS() AFX_WM_ENTRY(WM_KILLFOCUS, AfxSig_vW, void (AFX_MSG_CALL CWnd::*)(CWnd*), &ThisClass::OnKillFocus)
#define ON_WM_WINDOWPOSCHANGED() AFX_WM_ENTRY(WM_WINDOWPOSCHANGED, AfxSig_vPOS, void (AFX_MSG_CALL CWnd::*)(WINDOWPOS*), &ThisClass::OnWindowPosChanged)
#define ON_WM_WINDOWPOSCHANGING() AFX_WM_ENTRY(WM_WINDOWPOSCHANGING, AfxSig_vPOS, void (AFX_MSG_CALL CWnd::*)(WINDOWPOS*), &ThisClass::OnWindowPosChanging)
#define ON_WM_KEYDOWN() AFX_WM_ENTRY(WM_KEYDOWN, AfxSig_vwww, void (AFX_MSG_CALL CWnd::*)(UINT, UINT, UINT), &ThisClass::OnKeyDown)
#define ON_WM_KEYUP() AFX_WM_ENTRY(WM_KEYUP, AfxSig_vwww, void (AFX_MSG_CALL CWnd::*)(UINT, UINT, UINT), &ThisClass::OnKeyUp)
#define ON_WM_CHAR() AFX_WM_ENTRY(WM_CHAR, AfxSig_vwww, void (AFX_MSG_CALL CWnd::*)(UINT, UINT, UINT), &ThisClass::OnChar)
#define ON_WM_SETCURSOR() AFX_WM_ENTRY(WM_SETCURSOR, AfxSig_bWww, BOOL (AFX_MSG_CALL CWnd::*)(CWnd*, UINT, UINT), &ThisClass::OnSetCursor)
#define ON_WM_MOUSEACTIVATE() AFX_WM_ENTRY(WM_MOUSEACTIVATE, AfxSig_iWww, int (AFX_MSG_CALL CWnd::*)(CWnd*, UINT, UINT), &ThisClass::OnMouseActivate)
#define ON_WM_GETMINMAXINFO() AFX_WM_ENTRY(WM_GETMINMAXINFO, AfxSig_vMMI, void (AFX_MSG_CALL CWnd::*)(MINMAXINFO*), &ThisClass::OnGetMinMaxInfo)
#define ON_WM_SHOWWINDOW() AFX_WM_ENTRY(WM_SHOWWINDOW, AfxSig_vbw, void (AFX_MSG_CALL CWnd::*)(BOOL, UINT), &ThisClass::OnShowWindow)
#define ON_WM_NCHITTEST() AFX_WM_ENTRY(WM_NCHITTEST, AfxSig_lp, LRESULT (AFX_MSG_CALL CWnd::*)(CPoint), &ThisClass::OnNcHitTest)
#define ON_WM_CONTEXTMENU() AFX_WM_ENTRY(WM_CONTEXTMENU, AfxSig_vWp, void (AFX_MSG_CALL CWnd::*)(CWnd*, CPoint), &ThisClass::OnContextMenu)
#define ON_WM_CANCELMODE() AFX_WM_ENTRY(WM_CANCELMODE, AfxSig_vv, void (AFX_MSG_CALL CWnd::*)(void), &ThisClass::OnCancelMode)
#define ON_WM_GETDLGCODE() AFX_WM_ENTRY(WM_GETDLGCODE, AfxSig_wv, UINT (AFX_MSG_CALL CWnd::*)(void), &ThisClass::OnGetDlgCode)
// clang-format on

// ---------------------------------------------------------------------------
// CCmdTarget: the root of every class with a message map
// ---------------------------------------------------------------------------

class AFX_FRAMEWORK_CLASS CCmdTarget : public CObject {
public:
    CCmdTarget() = default;
    ~CCmdTarget() override = default;

protected:
    static const AFX_MSGMAP* PASCAL GetThisMessageMap();
    virtual const AFX_MSGMAP* GetMessageMap() const;
};

// ---------------------------------------------------------------------------
// CGdiObject and its kinds
// ---------------------------------------------------------------------------

// Owns m_hObject: the destructor and DeleteObject delete it; Detach gives it
// up. Temporary objects (FromHandle of a handle that no object owns) never
// delete their handle and are themselves deleted at idle time.
class AFX_FRAMEWORK_CLASS CGdiObject : public CObject {
public:
    HGDIOBJ m_hObject = NULL;

    CGdiObject() = default;
    ~CGdiObject() override;

    operator HGDIOBJ() const
    {
        const auto* self = AfxNullableThis(this);
        return self == NULL ? NULL : self->m_hObject;
    }
    HGDIOBJ GetSafeHandle() const
    {
        const auto* self = AfxNullableThis(this);
        return self == NULL ? NULL : self->m_hObject;
    }

    // The object attached to hObject, or a temporary one of the matching
    // class (CPen, CBrush, CFont, CRgn or CGdiObject). NULL for NULL.
    static CGdiObject* PASCAL FromHandle(HGDIOBJ hObject);
    static void PASCAL DeleteTempMap();
    BOOL Attach(HGDIOBJ hObject);
    HGDIOBJ Detach();

    BOOL DeleteObject();
    int GetObject(int nCount, LPVOID lpObject) const;
    UINT GetObjectType() const;
    BOOL CreateStockObject(int nIndex);
    BOOL UnrealizeObject();
    BOOL operator==(const CGdiObject& obj) const { return obj.m_hObject == m_hObject; }
    BOOL operator!=(const CGdiObject& obj) const { return obj.m_hObject != m_hObject; }
};

class AFX_FRAMEWORK_CLASS CPen : public CGdiObject {
public:
    static CPen* PASCAL FromHandle(HPEN hPen);
    CPen() = default;
    // Throws CResourceException* when the pen cannot be created.
    CPen(int nPenStyle, int nWidth, COLORREF crColor);
    BOOL CreatePen(int nPenStyle, int nWidth, COLORREF crColor);
    BOOL CreatePenIndirect(LPLOGPEN lpLogPen);
    operator HPEN() const
    {
        const auto* self = AfxNullableThis(this);
        return static_cast<HPEN>(self == NULL ? NULL : self->m_hObject);
    }
    int GetLogPen(LOGPEN* pLogPen) const;
};

class AFX_FRAMEWORK_CLASS CBrush : public CGdiObject {
public:
    static CBrush* PASCAL FromHandle(HBRUSH hBrush);
    CBrush() = default;
    // Throws CResourceException* when the brush cannot be created.
    explicit CBrush(COLORREF crColor);
    BOOL CreateSolidBrush(COLORREF crColor);
    BOOL CreateHatchBrush(int nIndex, COLORREF crColor);
    BOOL CreateBrushIndirect(const LOGBRUSH* lpLogBrush);
    BOOL CreateSysColorBrush(int nIndex);
    operator HBRUSH() const
    {
        const auto* self = AfxNullableThis(this);
        return static_cast<HBRUSH>(self == NULL ? NULL : self->m_hObject);
    }
    int GetLogBrush(LOGBRUSH* pLogBrush) const;
};

class AFX_FRAMEWORK_CLASS CFont : public CGdiObject {
public:
    static CFont* PASCAL FromHandle(HFONT hFont);
    CFont() = default;
    BOOL CreateFontIndirect(const LOGFONT* lpLogFont);
    BOOL CreateFont(int nHeight, int nWidth, int nEscapement, int nOrientation, int nWeight, BYTE bItalic,
                    BYTE bUnderline, BYTE cStrikeOut, BYTE nCharSet, BYTE nOutPrecision, BYTE nClipPrecision,
                    BYTE nQuality, BYTE nPitchAndFamily, LPCTSTR lpszFacename);
    operator HFONT() const
    {
        const auto* self = AfxNullableThis(this);
        return static_cast<HFONT>(self == NULL ? NULL : self->m_hObject);
    }
    int GetLogFont(LOGFONT* pLogFont);
};

class AFX_FRAMEWORK_CLASS CRgn : public CGdiObject {
public:
    static CRgn* PASCAL FromHandle(HRGN hRgn);
    CRgn() = default;
    operator HRGN() const
    {
        const auto* self = AfxNullableThis(this);
        return static_cast<HRGN>(self == NULL ? NULL : self->m_hObject);
    }
    BOOL CreateRectRgn(int x1, int y1, int x2, int y2);
    BOOL CreateRectRgnIndirect(LPCRECT lpRect);
    BOOL CreateEllipticRgn(int x1, int y1, int x2, int y2);
    BOOL CreatePolygonRgn(LPPOINT lpPoints, int nCount, int nMode);
    void SetRectRgn(int x1, int y1, int x2, int y2);
    void SetRectRgn(LPCRECT lpRect);
    int CombineRgn(CRgn* pRgn1, CRgn* pRgn2, int nCombineMode);
    int CopyRgn(CRgn* pRgnSrc);
    BOOL EqualRgn(CRgn* pRgn) const;
    int OffsetRgn(int x, int y);
    int OffsetRgn(POINT point);
    int GetRgnBox(LPRECT lpRect) const;
    BOOL PtInRegion(int x, int y) const;
    BOOL PtInRegion(POINT point) const;
    BOOL RectInRegion(LPCRECT lpRect) const;
};

// ---------------------------------------------------------------------------
// CDC: a device context with an output handle and an attribute handle
// ---------------------------------------------------------------------------

// Output goes to m_hDC; attributes are set on both handles and read, with
// device capabilities, text metrics and text extents, from m_hAttribDC. A CDC
// that created or attached its DC deletes it in its destructor (DeleteDC);
// Detach gives the DC up.
class AFX_FRAMEWORK_CLASS CDC : public CObject {
public:
    HDC m_hDC = NULL;
    HDC m_hAttribDC = NULL;
    BOOL m_bPrinting = FALSE;

    CDC() = default;
    ~CDC() override;

    operator HDC() const
    {
        const auto* self = AfxNullableThis(this);
        return self == NULL ? NULL : self->m_hDC;
    }
    HDC GetSafeHdc() const
    {
        const auto* self = AfxNullableThis(this);
        return self == NULL ? NULL : self->m_hDC;
    }
    CWnd* GetWindow() const;
    BOOL IsPrinting() const { return m_bPrinting; }

    static CDC* PASCAL FromHandle(HDC hDC);
    static void PASCAL DeleteTempMap();
    BOOL Attach(HDC hDC);
    HDC Detach();
    virtual void SetAttribDC(HDC hDC);
    virtual void SetOutputDC(HDC hDC);
    virtual void ReleaseAttribDC();
    virtual void ReleaseOutputDC();

    BOOL CreateDC(LPCTSTR lpszDriverName, LPCTSTR lpszDeviceName, LPCTSTR lpszOutput, const void* lpInitData);
    BOOL CreateIC(LPCTSTR lpszDriverName, LPCTSTR lpszDeviceName, LPCTSTR lpszOutput, const void* lpInitData);
    BOOL CreateCompatibleDC(CDC* pDC);
    BOOL DeleteDC();

    virtual int SaveDC();
    virtual BOOL RestoreDC(int nSavedDC);
    int GetDeviceCaps(int nIndex) const;

    // Selection: each returns the object that was selected before (a
    // temporary object when no CGdiObject owns it).
    CGdiObject* SelectStockObject(int nIndex);
    CPen* SelectObject(CPen* pPen);
    CBrush* SelectObject(CBrush* pBrush);
    virtual CFont* SelectObject(CFont* pFont);
    CGdiObject* SelectObject(CGdiObject* pObject);
    int SelectObject(CRgn* pRgn);          // the region type, as SelectClipRgn
    HGDIOBJ SelectObject(HGDIOBJ hObject); // not for regions

    // Colours and modes
    COLORREF GetBkColor() const;
    virtual COLORREF SetBkColor(COLORREF crColor);
    int GetBkMode() const;
    int SetBkMode(int nBkMode);
    int GetPolyFillMode() const;
    int SetPolyFillMode(int nPolyFillMode);
    int GetROP2() const;
    int SetROP2(int nDrawMode);
    COLORREF GetTextColor() const;
    virtual COLORREF SetTextColor(COLORREF crColor);
    UINT GetTextAlign() const;
    UINT SetTextAlign(UINT nFlags);

    // Mapping
    int GetMapMode() const;
    virtual int SetMapMode(int nMapMode);
    CPoint GetViewportOrg() const;
    virtual CPoint SetViewportOrg(int x, int y);
    CPoint SetViewportOrg(POINT point);
    virtual CPoint OffsetViewportOrg(int nWidth, int nHeight);
    CSize GetViewportExt() const;
    virtual CSize SetViewportExt(int cx, int cy);
    CSize SetViewportExt(SIZE size);
    CPoint GetWindowOrg() const;
    CPoint SetWindowOrg(int x, int y);
    CPoint SetWindowOrg(POINT point);
    CSize GetWindowExt() const;
    virtual CSize SetWindowExt(int cx, int cy);
    CSize SetWindowExt(SIZE size);
    void DPtoLP(LPPOINT lpPoints, int nCount = 1) const;
    void DPtoLP(LPRECT lpRect) const;
    void LPtoDP(LPPOINT lpPoints, int nCount = 1) const;
    void LPtoDP(LPRECT lpRect) const;

    // Clipping
    virtual int GetClipBox(LPRECT lpRect) const;
    BOOL PtVisible(int x, int y) const;
    BOOL RectVisible(LPCRECT lpRect) const;
    int SelectClipRgn(CRgn* pRgn);
    int SelectClipRgn(CRgn* pRgn, int nMode);
    int ExcludeClipRect(int x1, int y1, int x2, int y2);
    int ExcludeClipRect(LPCRECT lpRect);
    int IntersectClipRect(int x1, int y1, int x2, int y2);
    int IntersectClipRect(LPCRECT lpRect);
    int OffsetClipRgn(int x, int y);

    // Lines
    CPoint GetCurrentPosition() const;
    CPoint MoveTo(int x, int y);
    CPoint MoveTo(POINT point);
    BOOL LineTo(int x, int y);
    BOOL LineTo(POINT point);
    BOOL Polyline(const POINT* lpPoints, int nCount);
    BOOL PolyPolyline(const POINT* lpPoints, const DWORD* lpPolyPoints, int nCount);

    // Shapes and fills
    void FillRect(LPCRECT lpRect, CBrush* pBrush);
    void FrameRect(LPCRECT lpRect, CBrush* pBrush);
    void InvertRect(LPCRECT lpRect);
    void DrawFocusRect(LPCRECT lpRect);
    void FillSolidRect(LPCRECT lpRect, COLORREF clr);
    void FillSolidRect(int x, int y, int cx, int cy, COLORREF clr);
    BOOL FillRgn(CRgn* pRgn, CBrush* pBrush);
    BOOL Rectangle(int x1, int y1, int x2, int y2);
    BOOL Rectangle(LPCRECT lpRect);
    BOOL Ellipse(int x1, int y1, int x2, int y2);
    BOOL Ellipse(LPCRECT lpRect);
    BOOL Polygon(const POINT* lpPoints, int nCount);
    BOOL PolyPolygon(const POINT* lpPoints, const INT* lpPolyCounts, int nCount);
    BOOL PatBlt(int x, int y, int nWidth, int nHeight, DWORD dwRop);
    BOOL BitBlt(int x, int y, int nWidth, int nHeight, CDC* pSrcDC, int xSrc, int ySrc, DWORD dwRop);
    COLORREF SetPixel(int x, int y, COLORREF crColor);
    COLORREF GetPixel(int x, int y) const;

    // Text
    virtual BOOL TextOut(int x, int y, LPCTSTR lpszString, int nCount);
    BOOL TextOut(int x, int y, const CString& str);
    virtual BOOL ExtTextOut(int x, int y, UINT nOptions, LPCRECT lpRect, LPCTSTR lpszString, UINT nCount,
                            LPINT lpDxWidths);
    virtual int DrawText(LPCTSTR lpszString, int nCount, LPRECT lpRect, UINT nFormat);
    int DrawText(const CString& str, LPRECT lpRect, UINT nFormat);
    CSize GetTextExtent(LPCTSTR lpszString, int nCount) const;
    CSize GetTextExtent(const CString& str) const;
    CSize GetOutputTextExtent(LPCTSTR lpszString, int nCount) const;
    BOOL GetTextMetrics(LPTEXTMETRIC lpMetrics) const;
    BOOL GetOutputTextMetrics(LPTEXTMETRIC lpMetrics) const;

    // Printing
    int StartDoc(LPDOCINFO lpDocInfo);
    int StartPage();
    int EndPage();
    int EndDoc();
    int AbortDoc();
    int SetAbortProc(BOOL(CALLBACK* lpfn)(HDC, int));
};

// BeginPaint on construction, EndPaint on destruction.
class AFX_FRAMEWORK_CLASS CPaintDC : public CDC {
public:
    PAINTSTRUCT m_ps = {};

    explicit CPaintDC(CWnd* pWnd); // throws CResourceException* if BeginPaint fails
    ~CPaintDC() override;

protected:
    HWND m_hWnd = NULL;
};

// GetDC on construction, ReleaseDC on destruction; a NULL window gives the
// screen's DC.
class AFX_FRAMEWORK_CLASS CClientDC : public CDC {
public:
    explicit CClientDC(CWnd* pWnd); // throws CResourceException* if GetDC fails
    ~CClientDC() override;

protected:
    HWND m_hWnd = NULL;
};

// ---------------------------------------------------------------------------
// CWnd
// ---------------------------------------------------------------------------

// A C++ object attached to a window. Windows created through Create/CreateEx
// (or attached with SubclassWindow) are in the thread's permanent handle map
// and receive their messages through AfxWndProc and the message map; the
// object is detached when the window is destroyed (WM_NCDESTROY), after
// which PostNcDestroy runs. Destroying an object whose window still exists
// destroys the window.
class AFX_FRAMEWORK_CLASS CWnd : public CCmdTarget {
public:
    HWND m_hWnd = NULL;

    // SetWindowPos insert-after markers (HWND_TOP, HWND_BOTTOM, ...).
    static const CWnd wndTop;
    static const CWnd wndBottom;
    static const CWnd wndTopMost;
    static const CWnd wndNoTopMost;

    CWnd() = default;
    ~CWnd() override;

    HWND GetSafeHwnd() const
    {
        const auto* self = AfxNullableThis(this);
        return self == NULL ? NULL : self->m_hWnd;
    }
    operator HWND() const
    {
        const auto* self = AfxNullableThis(this);
        return self == NULL ? NULL : self->m_hWnd;
    }
    BOOL operator==(const CWnd& wnd) const { return wnd.m_hWnd == m_hWnd; }
    BOOL operator!=(const CWnd& wnd) const { return wnd.m_hWnd != m_hWnd; }

    // Handle maps
    static CWnd* PASCAL FromHandle(HWND hWnd);
    static CWnd* PASCAL FromHandlePermanent(HWND hWnd);
    static void PASCAL DeleteTempMap();
    BOOL Attach(HWND hWndNew);
    HWND Detach();
    BOOL SubclassWindow(HWND hWnd);
    BOOL SubclassDlgItem(UINT nID, CWnd* pParent);
    HWND UnsubclassWindow();

    // Creation and destruction. Create adds WS_CHILD; a NULL class name uses
    // the framework's default window class. FALSE when the object already has
    // a window or the window cannot be created.
    virtual BOOL Create(LPCTSTR lpszClassName, LPCTSTR lpszWindowName, DWORD dwStyle, const RECT& rect,
                        CWnd* pParentWnd, UINT nID, CCreateContext* pContext = NULL);
    virtual BOOL CreateEx(DWORD dwExStyle, LPCTSTR lpszClassName, LPCTSTR lpszWindowName, DWORD dwStyle, int x, int y,
                          int nWidth, int nHeight, HWND hWndParent, HMENU nIDorHMenu, LPVOID lpParam = NULL);
    virtual BOOL CreateEx(DWORD dwExStyle, LPCTSTR lpszClassName, LPCTSTR lpszWindowName, DWORD dwStyle,
                          const RECT& rect, CWnd* pParentWnd, UINT nID, LPVOID lpParam = NULL);
    virtual BOOL DestroyWindow();

    // Styles and identity
    DWORD GetStyle() const;
    DWORD GetExStyle() const;
    BOOL ModifyStyle(DWORD dwRemove, DWORD dwAdd, UINT nFlags = 0);
    BOOL ModifyStyleEx(DWORD dwRemove, DWORD dwAdd, UINT nFlags = 0);
    int GetDlgCtrlID() const;
    int SetDlgCtrlID(int nID);
    CWnd* GetOwner() const;
    void SetOwner(CWnd* pOwnerWnd);

    // Window tree
    CWnd* GetParent() const;
    CWnd* SetParent(CWnd* pWndNewParent);
    CWnd* GetTopLevelParent() const;
    BOOL IsChild(const CWnd* pWnd) const;
    CWnd* GetDlgItem(int nID) const;
    void GetDlgItem(int nID, HWND* phWnd) const;
    static CWnd* PASCAL GetActiveWindow();
    CWnd* SetActiveWindow();
    static CWnd* PASCAL GetFocus();
    CWnd* SetFocus();
    static CWnd* PASCAL GetCapture();
    CWnd* SetCapture();
    static CWnd* PASCAL WindowFromPoint(POINT point);

    // Size and position
    void GetWindowRect(LPRECT lpRect) const;
    void GetClientRect(LPRECT lpRect) const;
    void ClientToScreen(LPPOINT lpPoint) const;
    void ClientToScreen(LPRECT lpRect) const;
    void ScreenToClient(LPPOINT lpPoint) const;
    void ScreenToClient(LPRECT lpRect) const;
    void MapWindowPoints(CWnd* pwndTo, LPPOINT lpPoint, UINT nCount) const;
    void MapWindowPoints(CWnd* pwndTo, LPRECT lpRect) const;
    void MoveWindow(int x, int y, int nWidth, int nHeight, BOOL bRepaint = TRUE);
    void MoveWindow(LPCRECT lpRect, BOOL bRepaint = TRUE);
    BOOL SetWindowPos(const CWnd* pWndInsertAfter, int x, int y, int cx, int cy, UINT nFlags);
    BOOL ShowWindow(int nCmdShow);
    BOOL IsWindowVisible() const;
    BOOL IsWindowEnabled() const;
    BOOL EnableWindow(BOOL bEnable = TRUE);
    void BringWindowToTop();

    // Text
    void SetWindowText(LPCTSTR lpszString);
    int GetWindowText(LPTSTR lpszStringBuf, int nMaxCount) const;
    void GetWindowText(CString& rString) const;
    int GetWindowTextLength() const;
    void SetDlgItemText(int nID, LPCTSTR lpszString);
    int GetDlgItemText(int nID, CString& rString) const;
    void SetFont(CFont* pFont, BOOL bRedraw = TRUE);
    CFont* GetFont() const;

    // Buttons of a dialog
    void CheckRadioButton(int nIDFirstButton, int nIDLastButton, int nIDCheckButton);
    void CheckDlgButton(int nIDButton, UINT nCheck);
    UINT IsDlgButtonChecked(int nIDButton) const;

    // Messages and timers
    LRESULT SendMessage(UINT message, WPARAM wParam = 0, LPARAM lParam = 0);
    BOOL PostMessage(UINT message, WPARAM wParam = 0, LPARAM lParam = 0);
    UINT_PTR SetTimer(UINT_PTR nIDEvent, UINT nElapse, void(CALLBACK* lpfnTimer)(HWND, UINT, UINT_PTR, DWORD));
    BOOL KillTimer(UINT_PTR nIDEvent);

    // Painting
    CDC* GetDC();
    CDC* GetWindowDC();
    int ReleaseDC(CDC* pDC);
    CDC* BeginPaint(LPPAINTSTRUCT lpPaint);
    void EndPaint(LPPAINTSTRUCT lpPaint);
    void Invalidate(BOOL bErase = TRUE);
    void InvalidateRect(LPCRECT lpRect, BOOL bErase = TRUE);
    void InvalidateRgn(CRgn* pRgn, BOOL bErase = TRUE);
    void ValidateRect(LPCRECT lpRect);
    void UpdateWindow();
    BOOL RedrawWindow(LPCRECT lpRectUpdate = NULL, CRgn* prgnUpdate = NULL,
                      UINT flags = RDW_INVALIDATE | RDW_UPDATENOW | RDW_ERASE);

    // Scrolling
    void ScrollWindow(int xAmount, int yAmount, LPCRECT lpRect = NULL, LPCRECT lpClipRect = NULL);
    int ScrollWindowEx(int dx, int dy, LPCRECT lpRectScroll, LPCRECT lpRectClip, CRgn* prgnUpdate, LPRECT lpRectUpdate,
                       UINT flags);
    int SetScrollPos(int nBar, int nPos, BOOL bRedraw = TRUE);
    int GetScrollPos(int nBar) const;
    void SetScrollRange(int nBar, int nMinPos, int nMaxPos, BOOL bRedraw = TRUE);
    void GetScrollRange(int nBar, LPINT lpMinPos, LPINT lpMaxPos) const;
    BOOL SetScrollInfo(int nBar, LPSCROLLINFO lpScrollInfo, BOOL bRedraw = TRUE);
    BOOL GetScrollInfo(int nBar, LPSCROLLINFO lpScrollInfo, UINT nMask = SIF_ALL);
    void ShowScrollBar(UINT nBar, BOOL bShow = TRUE);

    // Overridables
    virtual BOOL PreCreateWindow(CREATESTRUCT& cs);
    virtual void PreSubclassWindow();
    virtual BOOL PreTranslateMessage(MSG* pMsg);
    // Offers pMsg to PreTranslateMessage of the object of pMsg->hwnd, then of
    // each parent in turn, stopping at hWndStop or at the first that returns
    // TRUE (then TRUE is returned).
    static BOOL PASCAL WalkPreTranslateTree(HWND hWndStop, MSG* pMsg);

    // The message map dispatch; DefWindowProc calls the window procedure the
    // window had before it was subclassed (or ::DefWindowProc).
    virtual LRESULT WindowProc(UINT message, WPARAM wParam, LPARAM lParam);
    virtual BOOL OnWndMsg(UINT message, WPARAM wParam, LPARAM lParam, LRESULT* pResult);
    virtual LRESULT DefWindowProc(UINT message, WPARAM wParam, LPARAM lParam);
    virtual void PostNcDestroy();
    virtual WNDPROC* GetSuperWndProcAddr();
    // The default processing of the message being handled.
    LRESULT Default();

protected:
    explicit CWnd(HWND hWnd) : m_hWnd(hWnd) {}

    // Default handlers: each passes the current message to Default().
    afx_msg int OnCreate(LPCREATESTRUCT lpCreateStruct);
    afx_msg void OnDestroy();
    afx_msg void OnNcDestroy();
    afx_msg void OnClose();
    afx_msg void OnPaint();
    afx_msg BOOL OnEraseBkgnd(CDC* pDC);
    afx_msg void OnSize(UINT nType, int cx, int cy);
    afx_msg void OnMove(int x, int y);
    afx_msg void OnHScroll(UINT nSBCode, UINT nPos, CScrollBar* pScrollBar);
    afx_msg void OnVScroll(UINT nSBCode, UINT nPos, CScrollBar* pScrollBar);
    afx_msg void OnTimer(UINT_PTR nIDEvent);
    afx_msg void OnMouseMove(UINT nFlags, CPoint point);
    afx_msg void OnLButtonDown(UINT nFlags, CPoint point);
    afx_msg void OnLButtonUp(UINT nFlags, CPoint point);
    afx_msg void OnLButtonDblClk(UINT nFlags, CPoint point);
    afx_msg void OnRButtonDown(UINT nFlags, CPoint point);
    afx_msg void OnRButtonUp(UINT nFlags, CPoint point);
    afx_msg void OnRButtonDblClk(UINT nFlags, CPoint point);
    afx_msg void OnMButtonDown(UINT nFlags, CPoint point);
    afx_msg void OnMButtonUp(UINT nFlags, CPoint point);
    afx_msg void OnMButtonDblClk(UINT nFlags, CPoint point);
    afx_msg BOOL OnMouseWheel(UINT nFlags, short zDelta, CPoint pt);
    afx_msg void OnCaptureChanged(CWnd* pWnd);
    afx_msg void OnSetFocus(CWnd* pOldWnd);
    afx_msg void OnKillFocus(CWnd* pNewWnd);
    afx_msg void OnWindowPosChanged(WINDOWPOS* lpwndpos);
    afx_msg void OnWindowPosChanging(WINDOWPOS* lpwndpos);
    afx_msg void OnKeyDown(UINT nChar, UINT nRepCnt, UINT nFlags);
    afx_msg void OnKeyUp(UINT nChar, UINT nRepCnt, UINT nFlags);
    afx_msg void OnChar(UINT nChar, UINT nRepCnt, UINT nFlags);
    afx_msg BOOL OnSetCursor(CWnd* pWnd, UINT nHitTest, UINT message);
    afx_msg int OnMouseActivate(CWnd* pDesktopWnd, UINT nHitTest, UINT message);
    afx_msg void OnGetMinMaxInfo(MINMAXINFO* lpMMI);
    afx_msg void OnShowWindow(BOOL bShow, UINT nStatus);
    afx_msg LRESULT OnNcHitTest(CPoint point);
    afx_msg void OnContextMenu(CWnd* pWnd, CPoint pos);
    afx_msg void OnCancelMode();
    afx_msg UINT OnGetDlgCode();

    WNDPROC m_pfnSuper = NULL; // the window procedure before subclassing

    DECLARE_MESSAGE_MAP()
};

// The framework's window procedure: the procedure of every window class the
// framework registers, and of every window a CWnd is attached to by creation
// or subclassing.
AFX_FRAMEWORK_API LRESULT CALLBACK AfxWndProc(HWND hWnd, UINT nMsg, WPARAM wParam, LPARAM lParam);
AFX_FRAMEWORK_API WNDPROC AFXAPI AfxGetAfxWndProc();

// Registers lpWndClass unless a class of that name is registered already for
// its instance (then TRUE without change). FALSE for a NULL description, one
// without a class name or window procedure, or a failed registration. The framework creates windows of
// a class registered here with the instance the class was registered for.
AFX_FRAMEWORK_API BOOL AFXAPI AfxRegisterClass(WNDCLASS* lpWndClass);

// Temporary objects made by FromHandle live until the temporary maps are
// unlocked with no lock left: AfxUnlockTempMaps(TRUE) then deletes them.
// CWinThread::OnIdle does exactly that.
AFX_FRAMEWORK_API void AFXAPI AfxLockTempMaps();
AFX_FRAMEWORK_API BOOL AFXAPI AfxUnlockTempMaps(BOOL bDeleteTemps = TRUE);

// ---------------------------------------------------------------------------
// Controls and dialogs
// ---------------------------------------------------------------------------

class AFX_FRAMEWORK_CLASS CScrollBar : public CWnd {
public:
    CScrollBar() = default;
    ~CScrollBar() override = default;
    virtual BOOL Create(DWORD dwStyle, const RECT& rect, CWnd* pParentWnd, UINT nID);

    int GetScrollPos() const;
    int SetScrollPos(int nPos, BOOL bRedraw = TRUE);
    void GetScrollRange(LPINT lpMinPos, LPINT lpMaxPos) const;
    void SetScrollRange(int nMinPos, int nMaxPos, BOOL bRedraw = TRUE);
    void ShowScrollBar(BOOL bShow = TRUE);
    BOOL EnableScrollBar(UINT nArrowFlags = ESB_ENABLE_BOTH);
    BOOL SetScrollInfo(LPSCROLLINFO lpScrollInfo, BOOL bRedraw = TRUE);
    BOOL GetScrollInfo(LPSCROLLINFO lpScrollInfo, UINT nMask = SIF_ALL);
    int GetScrollLimit();

private:
    // The window's own Create replaces the general one, which stays out of reach.
    using CWnd::Create;
};

class AFX_FRAMEWORK_CLASS CButton : public CWnd {
public:
    CButton() = default;
    ~CButton() override = default;
    virtual BOOL Create(LPCTSTR lpszCaption, DWORD dwStyle, const RECT& rect, CWnd* pParentWnd, UINT nID);

    UINT GetState() const;
    void SetState(BOOL bHighlight);
    int GetCheck() const;
    void SetCheck(int nCheck);
    UINT GetButtonStyle() const;
    void SetButtonStyle(UINT nStyle, BOOL bRedraw = TRUE);

private:
    // The window's own Create replaces the general one, which stays out of reach.
    using CWnd::Create;
};

// The base of dialog classes. Dialogs here are shown by the common dialogs
// (CPrintDialog::DoModal), which attach the CDialog to the real dialog window
// while it exists and call OnInitDialog when it initialises.
class AFX_FRAMEWORK_CLASS CDialog : public CWnd {
public:
    ~CDialog() override = default;
    // Called once the dialog and its controls exist. TRUE lets the dialog set
    // the focus to its first control.
    virtual BOOL OnInitDialog();
    void EndDialog(int nResult);

protected:
    explicit CDialog(CWnd* pParentWnd = NULL) : m_pParentWnd(pParentWnd) {}
    CWnd* m_pParentWnd = NULL; // not owned
};

// ---------------------------------------------------------------------------
// Threads and the application
// ---------------------------------------------------------------------------

class AFX_FRAMEWORK_CLASS CWinThread : public CCmdTarget {
public:
    CWnd* m_pMainWnd = NULL;   // not owned; its destruction ends Run
    CWnd* m_pActiveWnd = NULL; // not owned
    BOOL m_bAutoDelete = FALSE;
    HANDLE m_hThread = NULL;
    DWORD m_nThreadID = 0;
    MSG m_msgCur = {}; // the message being pumped

    CWinThread();
    ~CWinThread() override = default;

    virtual CWnd* GetMainWnd();
    virtual BOOL InitInstance();
    virtual int ExitInstance();
    // The message loop: idle processing while the queue is empty, then
    // PumpMessage until WM_QUIT; returns ExitInstance().
    virtual int Run();
    // Takes one message (waiting for it), offers it to PreTranslateMessage and
    // dispatches it unless that returned TRUE. FALSE on WM_QUIT.
    virtual BOOL PumpMessage();
    // Offers the message to the target window and its parents
    // (CWnd::WalkPreTranslateTree up to the main window), then to the main
    // window if the target lies outside it.
    virtual BOOL PreTranslateMessage(MSG* pMsg);
    // Idle work between messages: deletes the temporary handle-map objects.
    // Returns TRUE while more idle work is wanted.
    virtual BOOL OnIdle(LONG lCount);
    virtual BOOL IsIdleMessage(MSG* pMsg);

private:
    CPoint m_ptCursorLast{-1, -1};
    UINT m_nMsgLast = 0;
};

class AFX_FRAMEWORK_CLASS CWinApp : public CWinThread {
public:
    LPCTSTR m_pszAppName = NULL;
    HINSTANCE m_hInstance = NULL;
    LPTSTR m_lpCmdLine = NULL;
    int m_nCmdShow = SW_SHOWNORMAL;
    // The printer defaults of the application (DEVMODE and DEVNAMES, global
    // memory owned by the application object).
    HGLOBAL m_hDevMode = NULL;
    HGLOBAL m_hDevNames = NULL;

    // Becomes the current application (AfxGetApp) until it is destroyed.
    explicit CWinApp(LPCTSTR lpszAppName = NULL);
    ~CWinApp() override;

    BOOL InitInstance() override;
    int ExitInstance() override;
    int Run() override;

    // Fills hDevMode and hDevNames of pPrintDlg with the application's default
    // printer (taken once from PrintDlg with PD_RETURNDEFAULT and kept by the
    // application, which still owns the handles). FALSE when there is no
    // printer; pPrintDlg is then unchanged.
    BOOL GetPrinterDeviceDefaults(PRINTDLG* pPrintDlg);
    // Makes a DC for the application's default printer and attaches it to dc.
    BOOL CreatePrinterDC(CDC& dc);
    void UpdatePrinterSelection(BOOL bForceDefaults);
    // Shows a print dialog on the application's printer defaults and keeps
    // the printer and settings the user chose as the new defaults (the
    // application still owns them; the printer DC in pPD->m_pd.hDC is the
    // caller's). Defaults that name a printer that is gone are dropped and
    // the dialog is shown once more on fresh ones. IDOK or IDCANCEL.
    virtual int DoPrintDialog(CPrintDialog* pPD);

    HCURSOR LoadCursor(LPCTSTR lpszResourceName) const;
    HCURSOR LoadCursor(UINT nIDResource) const;
    HCURSOR LoadStandardCursor(LPCTSTR lpszCursorName) const;

private:
    CWinApp* m_pPreviousApp = NULL;
};

AFX_FRAMEWORK_API CWinApp* AFXAPI AfxGetApp();
AFX_FRAMEWORK_API CWinThread* AFXAPI AfxGetThread();
AFX_FRAMEWORK_API CWnd* AFXAPI AfxGetMainWnd();
// Pumps one message as CWinThread::PumpMessage does (the current thread
// object's, if any). FALSE on WM_QUIT.
AFX_FRAMEWORK_API BOOL AFXAPI AfxPumpMessage();

// ---------------------------------------------------------------------------
// Extension libraries
// ---------------------------------------------------------------------------

// One link of the chain of libraries searched for resources. Constructing it
// puts it at the front of the chain; destroying it takes it out.
class AFX_FRAMEWORK_CLASS CDynLinkLibrary : public CCmdTarget {
public:
    explicit CDynLinkLibrary(AFX_EXTENSION_MODULE& state, BOOL bSystem = FALSE);
    CDynLinkLibrary(HINSTANCE hModule, HINSTANCE hResource);
    ~CDynLinkLibrary() override;

    HMODULE m_hModule = NULL;
    HMODULE m_hResource = NULL;
    BOOL m_bSystem = FALSE;
    CDynLinkLibrary* m_pNextDLL = NULL; // the next link of the chain, not owned
};

#endif // TAVO_FRAMEWORK_AFXWIN_H
