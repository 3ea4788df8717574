// Tavo_WiLibrary: the library as a whole, for applications and for the
// library's own subsystems.
//
// The application calls Initialize before it draws and Terminate when it is
// done; both are passed on to the graphics core, as is Trace. GetPalette gives
// the one Tavo_WiPalette of the process: the palette the graphics core holds
// when it is one, else a new one that it installs in the core (which owns it
// from then on). Everything here runs on the GUI thread; nothing is locked.
#pragma once

#include <afxwin.h>

class Tavo_WiPalette;

class AFX_EXT_CLASS Tavo_WiLibrary {
public:
    static void Initialize();
    static void Terminate(bool force);
    static void Trace(const char* message);
    static Tavo_WiPalette* GetPalette();

    // The library object holds nothing: assignment copies nothing.
    Tavo_WiLibrary& operator=(const Tavo_WiLibrary&) { return *this; }
};
