// Registration of the library's own window classes.
//
// Each window class of the library is registered under its own name, at most
// once per process, and only when the primary language of the user's default
// locale is English; under any other locale the windows are created with the
// framework's default window class instead.
#pragma once

#include <afxwin.h>

namespace Tavo_WiWindowClass {

// Whether the library's own window classes are used in this process.
bool UseOwnClasses();

// Registers a class with the framework's window procedure and the library
// module's instance handle, no icon and no menu, unless registered says it
// has been attempted already. registered is set before the attempt, so a
// class is never tried twice; a failed attempt raises the framework's
// resource exception.
void RegisterOnce(bool& registered, LPCSTR name, UINT style, HCURSOR cursor, HBRUSH background);

} // namespace Tavo_WiWindowClass
