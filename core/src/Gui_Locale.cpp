// Gui_Locale: the list of modules whose string tables Gui_Msg searches.
#include "Gui_Locale.h"

#include "Gui_ResourceModules.h"

#include <algorithm>

std::vector<HINSTANCE>& Gui_ResourceModules()
{
    // Never destroyed: libraries may still ask for messages while the process
    // ends.
    static std::vector<HINSTANCE>* modules = new std::vector<HINSTANCE>;
    return *modules;
}

void Gui_Locale::SetDllResourceHandle(AFX_EXTENSION_MODULE& module, HINSTANCE instance, const char* resourceLibrary)
{
    HINSTANCE resources = instance;
    if (resourceLibrary) {
        HMODULE loaded = LoadLibraryExA(resourceLibrary, nullptr, LOAD_LIBRARY_AS_DATAFILE);
        if (loaded)
            resources = loaded;
    }
    if (!resources)
        return;
    if (!module.hResource)
        module.hResource = resources;

    std::vector<HINSTANCE>& modules = Gui_ResourceModules();
    if (std::find(modules.begin(), modules.end(), resources) == modules.end())
        modules.push_back(resources);
}

int Gui_Locale::GetResourceModuleCount()
{
    return static_cast<int>(Gui_ResourceModules().size());
}

HINSTANCE Gui_Locale::GetResourceModule(int index)
{
    const std::vector<HINSTANCE>& modules = Gui_ResourceModules();
    if (index < 0 || index >= static_cast<int>(modules.size()))
        return nullptr;
    return modules[index];
}
