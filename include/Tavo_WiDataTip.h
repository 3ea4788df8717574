// Tavo_WiDataTip: a small bordered popup that shows one line of text next to
// the mouse pointer in the system's tool-tip colours.
//
// A tip belongs to an owner window (a scrollee): it is created as a popup
// owned by it, Show takes points in the owner's client coordinates, and the
// owner receives the registered message GetNotifyMsg() with wParam 1 when the
// tip has been shown and 0 when it has been hidden (lParam 0).
//
// At most one tip of the process is shown at a time (the current tip): Show
// first hides the current one. A keyboard event anywhere in the thread that
// created the first tip hides the shown tip at the next tick of its 100 ms
// timer.
#pragma once

#include <afxwin.h>

class AFX_EXT_CLASS Tavo_WiDataTip : public CWnd {
public:
    // Timer id on the tip's window and its period in milliseconds; the tip's
    // anchor lies this far right of and below the pointer; margins around the
    // text inside the border.
    static constexpr UINT_PTR TimerId = 1;
    static constexpr UINT TimerPeriodMs = 100;
    static constexpr int AnchorOffset = 16;
    static constexpr int MarginX = 4;
    static constexpr int MarginY = 2;

    Tavo_WiDataTip();
    virtual ~Tavo_WiDataTip();

    // Creates the hidden popup window owned by owner's window. The first call
    // in the process also creates the shared font and brush and installs the
    // thread keyboard hook. Returns nonzero on success.
    BOOL Create(CWnd* owner);

    // ---- operations ----------------------------------------------------
    // Shows text at point (owner's client coordinates) moved by the anchor
    // offset, kept on the screen horizontally. A point outside the owner's
    // client area, or a tip whose window does not exist, shows nothing; the
    // tip shown before has been hidden in every case.
    void Show(const CPoint& point, const CString& text);
    // Hides the tip and tells the owner, also when it was not shown.
    void Hide();

    // ---- attributes ----------------------------------------------------
    int IsVisible() const { return m_visible; }
    // The registered message "BrymarTavo_WiDataTipMessage".
    static UINT GetNotifyMsg();

    // ---- overridables ----------------------------------------------------
    virtual BOOL DestroyWindow();

    // ---- implementation --------------------------------------------------
    afx_msg void OnPaint();
    afx_msg void OnTimer(UINT_PTR id);

protected:
    DECLARE_MESSAGE_MAP()

private:
    // The window's own Create replaces the general one, which stays out of reach.
    using CWnd::Create;
    void StartTimer();
    void StopTimer();
    void SendDataTipNotification();

    CWnd* m_owner = nullptr;   // the owning window; not owned
    CPoint m_position{-1, -1}; // anchor of the tip in screen coordinates
    CString m_text;
    UINT_PTR m_timerId = 0; // id of the running timer, else 0
    int m_visible = 0;      // also the wParam of every notification
};
