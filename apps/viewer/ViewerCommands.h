// ViewerCommands: the command ids of the viewer's menu and keys, and the
// tables the frame builds its menu bar and accelerators from.
#pragma once

#include <windows.h>

namespace ViewerCommands {

enum Id : UINT {
    FileOpen = 100,
    FilePrint = 101,
    FileExport = 102,
    FileExit = 103,
    ZoomIn = 200,
    ZoomOut = 201,
    ZoomToFit = 202,
    UndoZoom = 203,
    ScrollLeft = 300,
    ScrollRight = 301,
    ScrollUp = 302,
    ScrollDown = 303,
    ScrollPageUp = 304,
    ScrollPageDown = 305,
};

// A new menu bar: File (Open, Print, Export, Exit) and View (zoom commands),
// each item with its key named. The caller owns it (a window's menu is
// destroyed with the window).
HMENU CreateMenuBar();

// A new accelerator table for the keys of every command; the caller
// destroys it (DestroyAcceleratorTable).
HACCEL CreateAccelerators();

} // namespace ViewerCommands
