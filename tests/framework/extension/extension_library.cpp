// extension_library.cpp - the test extension library: its entry point joins
// the framework's extension-module chain, as the system's library does.
#include "extension_library.h"

#include <afxdllx.h>

namespace {

AFX_EXTENSION_MODULE g_extensionModule = {};
BOOL g_attached = FALSE;

} // namespace

extern "C" BOOL WINAPI DllMain(HINSTANCE hInstance, DWORD dwReason, LPVOID)
{
    if (dwReason == DLL_PROCESS_ATTACH && !g_attached) {
        g_attached = TRUE;
        AfxInitExtensionModule(g_extensionModule, hInstance);
        new CDynLinkLibrary(g_extensionModule); // owned by the framework's chain
    }
    return TRUE;
}

BOOL ExtensionLibraryAttached() { return g_attached; }
