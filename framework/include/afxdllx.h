// afxdllx.h - for the entry point of a framework extension library.
//
// An extension library writes its own DllMain: on the first process attach it
// calls AfxInitExtensionModule with a static AFX_EXTENSION_MODULE and its
// instance handle, then creates a CDynLinkLibrary for that record (on the
// heap, never deleted by the library) so that AfxFindResourceHandle and
// CString::LoadString find its resources.
#ifndef TAVO_FRAMEWORK_AFXDLLX_H
#define TAVO_FRAMEWORK_AFXDLLX_H

#include "afxwin.h"

#endif // TAVO_FRAMEWORK_AFXDLLX_H
