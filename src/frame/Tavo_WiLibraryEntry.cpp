// The library's entry point and the static objects of library lifetime.
//
// The objects below are built when the library is loaded, in the order they
// are defined in this file, and destroyed in the reverse order when it is
// unloaded. Keep them here, in this order, and nowhere else:
//   1. the data tip's shared font
//   2. the data tip's shared background brush
//   3.-7. the portability library's initialisers (file, path list, instance
//      table, factory, message manager)
//   8. the parked-cursor notification message id
#include <afxdllx.h>

#include "Gui_Locale.h"
#include "Port_Init.h"
#include "Tavo_WiModule.h"
#include "Tavo_WiParkedCursorMonitor.h"
#include "Tavo_WiScrollStatics.h"

#include <new>

// ---- 1. The data tip's shared font ------------------------------------------
// An empty font object that the first data tip's Create gives its font; its
// destructor deletes that font, if any, at unload.
CFont Tavo_WiScrollStatics::dataTipFont;

// ---- 2. The data tip's shared background brush --------------------------------
// Null at load; the first data tip's Create makes the brush of the tip's
// window class. The owning pointer deletes it, if any, at unload.
std::unique_ptr<CBrush> Tavo_WiScrollStatics::dataTipBrush;

// ---- 3.-7. The portability library's services ----------------------------------
// Holding one initialiser of each keeps those services usable while the
// library is loaded.
static Port::FileInit s_fileInit;
static Port::PathListInit s_pathListInit;
static InstanceTableInit s_instanceTableInit;
static FactoryInit s_factoryInit;
static Port_MsgManInit s_msgManInit;

// ---- 8. The parked-cursor notification message ----------------------------------
// Read once at load; the scrollee's message map dispatches on it.
UINT Tavo_WiScrollStatics::parkedCursorNotifyMsg = Tavo_WiParkedCursorMonitor::GetNotifyMsg();

namespace {

AFX_EXTENSION_MODULE s_extensionModule = {};
// 1 once the first process attach has done its work: a second process attach
// for the same module changes nothing.
int s_attachDone = 0;
CDynLinkLibrary* s_libraryLink = nullptr; // not owned: the framework's chain owns it

void AttachProcess(HINSTANCE instance)
{
    s_attachDone = 1;
    AfxInitExtensionModule(s_extensionModule, instance);
    // So that Gui_Msg finds this library's string table (print header, print
    // dialog texts).
    Gui_Locale::SetDllResourceHandle(s_extensionModule, instance, nullptr);
    // Links the library into the framework's resource and class lookups. If
    // it cannot be allocated the library still loads, without the link.
    s_libraryLink = new (std::nothrow) CDynLinkLibrary(s_extensionModule, FALSE);
}

} // namespace

BOOL Tavo_WiLibraryEntry(HINSTANCE instance, DWORD reason, LPVOID)
{
    if (reason == DLL_PROCESS_ATTACH && s_attachDone == 0)
        AttachProcess(instance);
    // Detach and thread notifications do nothing: the static objects above are
    // destroyed by the runtime when the module unloads.
    return TRUE;
}

HINSTANCE Tavo_WiGetModuleInstance()
{
    return s_extensionModule.hModule;
}

const AFX_EXTENSION_MODULE& Tavo_WiGetExtensionModule()
{
    return s_extensionModule;
}

const CDynLinkLibrary* Tavo_WiGetLibraryLink()
{
    return s_libraryLink;
}

extern "C" BOOL WINAPI DllMain(HINSTANCE instance, DWORD reason, LPVOID reserved)
{
    return Tavo_WiLibraryEntry(instance, reason, reserved);
}
