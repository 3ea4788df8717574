// The library's module, for the library's own subsystems (and its tests).
//
//   Tavo_WiGetModuleInstance   the instance handle of libTavo_Windows.dll, as
//                              the entry point received it at the first process
//                              attach (null before): register window classes
//                              and load resources with it.
//   Tavo_WiLibraryEntry        the work of the library's entry point: DllMain
//                              passes every call on to it unchanged. Exported so
//                              that tests can call it with a second process
//                              attach.
//   Tavo_WiGetExtensionModule  the framework's record of this library.
//   Tavo_WiGetLibraryLink      the library's link in the framework's chain of
//                              libraries, made at the first process attach (not
//                              owned: the framework owns the chain); null when
//                              it could not be made.
#pragma once

#include <afxwin.h>

AFX_EXT_API HINSTANCE Tavo_WiGetModuleInstance();
AFX_EXT_API BOOL Tavo_WiLibraryEntry(HINSTANCE instance, DWORD reason, LPVOID reserved);
AFX_EXT_API const AFX_EXTENSION_MODULE& Tavo_WiGetExtensionModule();
AFX_EXT_API const CDynLinkLibrary* Tavo_WiGetLibraryLink();
