// Tavo_WiNativeWindowSurface: the surface a drawing window paints the screen
// with. The application creates one, hands it out from its drawing window's
// GetNativeWindowSurface override and deletes it; the window binds it to each
// paint device context (SetDC) and draws through it. It adds nothing to the
// GDI surface: painting a window and drawing into any other device context
// are the same work.
#pragma once

#include "Tavo_WiWin32Surface.h"

class AFX_EXT_CLASS Tavo_WiNativeWindowSurface : public Tavo_WiWin32Surface {
public:
    Tavo_WiNativeWindowSurface();
    ~Tavo_WiNativeWindowSurface();
};
