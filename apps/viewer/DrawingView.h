// DrawingView: the viewer's drawing window. It owns the surfaces it paints
// and prints with, answers the pointer the way the viewer promises, and keeps
// the status bar's pointer and zoom parts and the click message up to date.
//
//   click            names what lies under the aperture (status bar)
//   double click     zooms in at the pointer (a doubling)
//   wheel            zooms in or out at the pointer
//   drag             pans, while zoomed in; leaving the view autoscrolls
//   Shift + drag     rubber rectangle, then zooms to it
//   rest             data tip naming what lies under the pointer
//
// The keyboard's commands (ZoomIn ... Scroll) come through the frame's
// accelerators. Escape needs nothing here: the screen surface polls the key
// while it paints and stops a long paint.
#pragma once

#include "ViewerDocument.h"
#include "ViewerStatusBar.h"

#include "Tavo_WiDrawWnd.h"
#include "Tavo_WiNativeWindowSurface.h"
#include "Tavo_WiWin32Surface.h"

#include <string>

class DrawingView : public Tavo_WiDrawWnd {
public:
    DrawingView();
    ~DrawingView() override;

    // Creates the window as a child of parent and sets its background.
    BOOL CreateView(CWnd* parent, const CRect& rect, UINT id);
    // Shows document (not owned; null: nothing), fitted. The document must
    // outlive its binding: Bind(null) or another document ends it.
    void Bind(ViewerDocument* document);
    ViewerDocument* GetDocument() const { return m_document; }
    // Where the pointer and zoom parts and click messages go; not owned.
    void SetStatusBar(ViewerStatusBar* statusBar) { m_statusBar = statusBar; }

    // ---- commands ------------------------------------------------------------
    void ZoomIn(); // about the view's centre
    void ZoomOut();
    void ZoomToFit();
    void UndoZoom(); // a second undo returns (a toggle)
    void Scroll(Tavo_WiScroll::Dir dir, Tavo_WiScroll::Amount amount);

    // What lies under a client point of the scrollee, in the viewer's words.
    std::string DescribePoint(const CPoint& point);
    // Writes the zoom part of the status bar.
    void ShowZoom();

    // ---- the drawing window's overridables --------------------------------------
    Tavo_WiNativeWindowSurface* GetNativeWindowSurface() override { return &m_screenSurface; }
    Tavo_WiWin32Surface* GetPrintSurface() override { return &m_printSurface; }
    CString GetPrintHeader(const Tavo_WiPrintLayout& layout) override;
    BOOL PreTranslateMessage(MSG* msg) override;

protected:
    void OnClick(UINT button, UINT flags, const Tavo_GrWRect& aperture) override;
    void OnDoubleClick(UINT button, UINT flags, const Tavo_GrWRect& aperture) override;
    DragAction GetDragAction(UINT button, UINT flags, const CPoint& point) override;
    void OnRubberRectangle(UINT button, UINT flags, const Tavo_GrWRect& rect) override;
    CString GetDataTipText(const Tavo_GrWRect& aperture) override;

public:
    // The scrollee's point forms, as public as the drawing window has them.
    using Tavo_WiDrawWnd::GetDataTipText;
    using Tavo_WiDrawWnd::OnClick;
    using Tavo_WiDrawWnd::OnDoubleClick;

    afx_msg BOOL OnMouseWheel(UINT flags, short delta, CPoint point);
    afx_msg void OnWindowPosChanged(WINDOWPOS* windowPos);

protected:
    DECLARE_MESSAGE_MAP()

private:
    // Writes the world position under a scrollee point to the pointer part.
    void ShowPointer(const CPoint& point);
    void ShowMessage(const std::string& text);

    ViewerDocument* m_document = nullptr;   // not owned
    ViewerStatusBar* m_statusBar = nullptr; // not owned
    Tavo_WiNativeWindowSurface m_screenSurface;
    Tavo_WiWin32Surface m_printSurface;
    int m_wheelRemainder = 0; // wheel delta short of a notch
};
