// DrawingView: the viewer's drawing window.
//
// The library's drawing window paints the bound drawing, scrolls it and pans
// it with a left-button drag while zoomed in. What an application adds is the
// surface the screen is painted with (it owns it, the window only borrows it)
// and whatever input it wants for zooming: here the mouse wheel zooms about
// the pointer and a double click shows the whole drawing again.
#pragma once

#include "Tavo_WiDrawWnd.h"
#include "Tavo_WiNativeWindowSurface.h"

class DrawingView : public Tavo_WiDrawWnd {
public:
    // Zoom levels per wheel notch: five levels double the scale.
    static constexpr int LevelsPerNotch = 1;

    // Creates the window as a child of parent filling rect, and shows the
    // drawing in it (not owned: it must outlive the window). FALSE when the
    // window could not be created.
    BOOL CreateView(CWnd* parent, const CRect& rect, UINT id, Tavo_GrDrawing* drawing);

protected:
    Tavo_WiNativeWindowSurface* GetNativeWindowSurface() override;
    void OnDoubleClick(UINT button, UINT flags, const Tavo_GrWRect& aperture) override;
    using Tavo_WiDrawWnd::OnDoubleClick;

    afx_msg BOOL OnMouseWheel(UINT flags, short delta, CPoint point);
    DECLARE_MESSAGE_MAP()

private:
    Tavo_WiNativeWindowSurface m_surface;
    // Wheel movement short of a whole notch, kept for the next message
    // (high-resolution wheels send small steps).
    int m_wheelRemainder = 0;
};
