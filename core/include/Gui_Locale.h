// Gui_Locale: makes a library's string resources findable by Gui_Msg.
//
// Each call registers one module (the library's instance handle, or a resource
// library loaded in its place) at the end of the list that Gui_Msg searches
// when it is given no module of its own. A module registered twice is listed
// once.
#pragma once

#include "Tavo_CoreApi.h"

#include <afx.h>

class TAVO_CORE_API Gui_Locale {
public:
    // resourceLibrary: null to use instance itself; else the file name of a
    // library that holds the resources in its place, loaded as a data file (if
    // it cannot be loaded, instance is used). The framework's module record
    // gets the module that holds the resources as its resource handle when it
    // has none yet.
    static void SetDllResourceHandle(AFX_EXTENSION_MODULE& module, HINSTANCE instance, const char* resourceLibrary);

    static int GetResourceModuleCount();
    // Null for an index outside 0 ... GetResourceModuleCount() - 1.
    static HINSTANCE GetResourceModule(int index);
};
