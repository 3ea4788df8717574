// Objects of library lifetime used by the scrolling windows.
//
// They are defined by the library entry, which builds them at load in a fixed
// order with the library's other static objects and destroys them in reverse
// order at unload.
#pragma once

#include <afxwin.h>

#include <memory>

namespace Tavo_WiScrollStatics {

// The font of every data tip: empty at load; the first data tip's Create
// gives it a handle, which is deleted with the object at unload.
extern CFont dataTipFont;

// The background brush of the data tip's window class: none at load; the
// first data tip's Create makes it; deleted at unload.
extern std::unique_ptr<CBrush> dataTipBrush;

// The parked cursor monitor's registered message, fetched once at load; the
// scrollee's message map dispatches on it.
extern UINT parkedCursorNotifyMsg;

} // namespace Tavo_WiScrollStatics
