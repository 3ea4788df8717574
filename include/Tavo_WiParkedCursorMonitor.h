// Tavo_WiParkedCursorMonitor: detects that the mouse pointer has come to rest
// over a window and tells that window when the rest begins and ends.
//
// The monitor is an invisible, zero-sized child window of the watched window
// (its owner); its only job is to own the park timer. The owner feeds it every
// message it pre-translates (RelayEvent). Half a second after the last mouse
// move to a new position, if no button is down, the pointer is inside the
// owner and the owner belongs to the active window, the owner receives the
// registered message GetNotifyMsg() with wParam 1; the next move to another
// position, or any mouse button press, release or double click, ends the rest
// with wParam 0. lParam is always 0.
#pragma once

#include <afxwin.h>

class AFX_EXT_CLASS Tavo_WiParkedCursorMonitor : public CWnd {
public:
    // Park timer id on the monitor's window, the rest time in milliseconds,
    // and the control id under which a scrollee creates its monitor.
    static constexpr UINT_PTR ParkTimerId = 1;
    static constexpr UINT ParkTimeMs = 500;
    static constexpr UINT ControlId = 2000;

    Tavo_WiParkedCursorMonitor();
    virtual ~Tavo_WiParkedCursorMonitor();

    // Creates the hidden child window of parent, which becomes the owner
    // (also when creation fails). Returns nonzero on success.
    BOOL Create(CWnd* parent, UINT id, CCreateContext* context = nullptr);

    // ---- attributes ----------------------------------------------------
    // Switching off stops a pending park timer but does not end a rest in
    // progress; switching on starts nothing until the next mouse move.
    void Enable(int flag);
    int IsEnabled() const { return m_enabled; }
    int IsParked() const { return m_parked; }
    // The pointer position at which the current rest began, in the owner's
    // client coordinates; (-1, -1) when no rest is in progress.
    CPoint GetParkPoint() const { return m_parkPoint; }

    // ---- operations ----------------------------------------------------
    // Watches one message on its way to the owner.
    void RelayEvent(MSG* msg);

    // The registered message "BrymarTavo_WiParkedCursorMonitorMessage".
    static UINT GetNotifyMsg();

    // ---- implementation --------------------------------------------------
    afx_msg void OnTimer(UINT_PTR id);

protected:
    DECLARE_MESSAGE_MAP()

private:
    // The window's own Create replaces the general one, which stays out of reach.
    using CWnd::Create;
    void StartParkTimer();
    void StopParkTimer();
    void StartParkedCursor();
    void StopParkedCursor();
    void SendParkedNotification(WPARAM parked);
    bool OwnerIsLive() const;

    CWnd* m_owner = nullptr;    // the watched window; not owned
    CPoint m_lastPoint{-1, -1}; // position of the last mouse move seen
    CPoint m_parkPoint{-1, -1}; // where the current rest began, owner's client coordinates
    UINT_PTR m_timerId = 0;     // id of the running park timer, else 0
    int m_enabled = 1;
    int m_parked = 0;
    int m_buttonDown = 0; // 1 from a button press until its release or double click
};
