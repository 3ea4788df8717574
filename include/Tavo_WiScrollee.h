// Tavo_WiScrollee: the client child of a scroll window, the area inside the
// scroll bars in which the view is drawn and the mouse is used.
//
// The scrollee draws nothing itself: it erases its background in one colour
// and hands every paint to its scroll window's OnDraw. It classifies raw
// mouse-button messages into clicks, double clicks and drags (a drag begins
// when a button has been held for HoldTimeMs, not after a distance) and
// reports them to the scroll window's virtual operations. It owns a parked
// cursor monitor, to which it relays every message it pre-translates, and a
// data tip, and turns the monitor's notifications into the scroll window's
// OnParkedCursorStart and OnParkedCursorEnd.
//
// The scroll window is always the scrollee's parent window; the scrollee
// reaches it through the window hierarchy.
#pragma once

#include <afxwin.h>

#include <memory>

class Tavo_WiDataTip;
class Tavo_WiParkedCursorMonitor;
class Tavo_WiScrollWnd;

class AFX_EXT_CLASS Tavo_WiScrollee : public CWnd {
    friend class Tavo_WiScrollWnd; // creates the scrollee through the private Create

public:
    // The hold timer on the scrollee's window; a press held this long becomes
    // a drag, and a release before it is a click.
    static constexpr UINT_PTR HoldTimerId = 1;
    static constexpr UINT HoldTimeMs = 300;
    // The mouse-key flags of the three buttons, as every pointer operation
    // receives them; ButtonFlagMask selects them in a message's key flags.
    static constexpr UINT ButtonFlagMask = MK_LBUTTON | MK_RBUTTON | MK_MBUTTON;

    Tavo_WiScrollee();
    virtual ~Tavo_WiScrollee();

    BOOL Create(DWORD style, const CRect& rect, Tavo_WiScrollWnd* parent, UINT id);

    // ---- operations ----------------------------------------------------
    void CaptureMouse();
    // Releases the capture only when the scrollee took it itself.
    void ReleaseMouse();
    // Forgets the followed press without reporting anything.
    void ClearButtonDownState();
    void ShowDataTip(const CPoint& point, const CString& text);
    void HideDataTip();
    void SetParkedCursorMonitorFlag(int flag);
    // The colour of the next background erase (black until set).
    void SetBackgroundColor(COLORREF color);

    // ---- attributes ----------------------------------------------------
    Tavo_WiDataTip* GetDataTip() const { return m_dataTip.get(); }
    Tavo_WiParkedCursorMonitor* GetParkedCursorMonitor() const { return m_monitor.get(); }

    // ---- overridables ----------------------------------------------------
    virtual BOOL DestroyWindow();
    virtual BOOL PreTranslateMessage(MSG* msg);

    // ---- implementation: message handlers --------------------------------
    afx_msg void OnPaint();
    afx_msg BOOL OnEraseBkgnd(CDC* dc);
    afx_msg void OnLButtonDown(UINT flags, CPoint point);
    afx_msg void OnMButtonDown(UINT flags, CPoint point);
    afx_msg void OnRButtonDown(UINT flags, CPoint point);
    afx_msg void OnLButtonUp(UINT flags, CPoint point);
    afx_msg void OnMButtonUp(UINT flags, CPoint point);
    afx_msg void OnRButtonUp(UINT flags, CPoint point);
    afx_msg void OnLButtonDblClk(UINT flags, CPoint point);
    afx_msg void OnMButtonDblClk(UINT flags, CPoint point);
    afx_msg void OnRButtonDblClk(UINT flags, CPoint point);
    afx_msg void OnMouseMove(UINT flags, CPoint point);
    afx_msg void OnTimer(UINT_PTR id);
    afx_msg void OnCaptureChanged(CWnd* window);
    afx_msg LRESULT OnPCNotifyMsg(WPARAM wParam, LPARAM lParam);

protected:
    DECLARE_MESSAGE_MAP()

private:
    // The window's own Create replaces the general one, which stays out of reach.
    using CWnd::Create;
    BOOL Create(LPCSTR className, LPCSTR windowName, DWORD style, const CRect& rect, CWnd* parent,
                UINT id, CCreateContext* context);
    // The parent window as the scroll window it is, or null when the parent
    // is not one (then nothing is reported).
    Tavo_WiScrollWnd* GetScrollWnd() const;

    void OnXButtonDown(UINT button, UINT flags, const CPoint& point);
    void OnXButtonUp(UINT button, UINT flags, const CPoint& point);
    void OnXButtonDblClk(UINT button, UINT flags, const CPoint& point);

    std::unique_ptr<Tavo_WiParkedCursorMonitor> m_monitor;
    std::unique_ptr<Tavo_WiDataTip> m_dataTip;
    UINT m_pressedButton = 0;   // mouse-key flag of the followed press, 0 when none
    UINT m_pressFlags = 0;      // key flags of the button-down message
    UINT_PTR m_holdTimerId = 0; // what SetTimer returned for the hold timer
    COLORREF m_backgroundColor = 0;
    int m_backgroundColorSet = 0;
    int m_doubleClick = 0; // 1 while the followed press is the second of a double click
    int m_dragging = 0;
    int m_capture = 0; // 1 while the scrollee holds a capture it took itself
    CPoint m_pressPoint{0, 0};
    LONG m_pressTime = -1; // message time of the followed press; 0 once a press ends
};
