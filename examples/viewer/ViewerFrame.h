// ViewerFrame: the viewer's main window, a top-level window whose client
// area is one DrawingView.
#pragma once

#include <afxwin.h>

#include "DrawingView.h"

class Tavo_GrDrawing;

class ViewerFrame : public CWnd {
public:
    // Creates the frame (hidden) and the view, and binds the drawing, which
    // must outlive the windows. FALSE when a window could not be created.
    BOOL CreateFrame(const char* title, Tavo_GrDrawing* drawing);

protected:
    afx_msg void OnSize(UINT type, int width, int height);
    afx_msg void OnSetFocus(CWnd* previous);
    // The view follows a live resize only when told where it starts and ends.
    afx_msg LRESULT OnEnterSizeMove(WPARAM, LPARAM);
    afx_msg LRESULT OnExitSizeMove(WPARAM, LPARAM);
    DECLARE_MESSAGE_MAP()

private:
    DrawingView m_view;
};
