#include "HeapCounter.h"

#include <psapi.h>

#include <algorithm>
#include <string>

namespace {

std::string Folder(const std::string& path)
{
    const size_t slash = path.find_last_of("\\/");
    return slash == std::string::npos ? std::string() : path.substr(0, slash);
}

std::string ModulePath(HMODULE module)
{
    char path[MAX_PATH] = {};
    GetModuleFileNameA(module, path, MAX_PATH);
    return path;
}

} // namespace

std::vector<HMODULE> HeapCounter::FindProjectModules()
{
    std::vector<HMODULE> project;
    HMODULE modules[512];
    DWORD needed = 0;
    if (!EnumProcessModules(GetCurrentProcess(), modules, sizeof modules, &needed))
        return project;
    const size_t count = std::min<size_t>(needed / sizeof(HMODULE), 512);
    const std::string folder = Folder(ModulePath(nullptr));
    for (size_t i = 0; i < count; ++i)
        if (_stricmp(Folder(ModulePath(modules[i])).c_str(), folder.c_str()) == 0)
            project.push_back(modules[i]);
    return project;
}
