#include "HeapCounter.h"

#include <psapi.h>

#include <algorithm>
#include <atomic>
#include <cstdlib>
#include <cstring>
#include <string>

namespace {

std::atomic<long long> g_allocations{0};

// The C runtime's own functions, found before any import is redirected (the
// program's own imports are redirected too, so calling malloc here would
// come back to the counter).
struct RuntimeHeap {
    void* (*malloc)(size_t) = nullptr;
    void* (*calloc)(size_t, size_t) = nullptr;
    void* (*realloc)(void*, size_t) = nullptr;
} g_runtime;

template <class Function>
Function Lookup(HMODULE module, const char* name)
{
    // Through void*: FARPROC has no parameters to match.
    return reinterpret_cast<Function>(reinterpret_cast<void*>(GetProcAddress(module, name)));
}

bool FindRuntimeHeap()
{
    for (const char* name : {"msvcrt.dll", "ucrtbase.dll"}) {
        const HMODULE runtime = GetModuleHandleA(name);
        if (!runtime)
            continue;
        g_runtime.malloc = Lookup<void* (*)(size_t)>(runtime, "malloc");
        g_runtime.calloc = Lookup<void* (*)(size_t, size_t)>(runtime, "calloc");
        g_runtime.realloc = Lookup<void* (*)(void*, size_t)>(runtime, "realloc");
        if (g_runtime.malloc && g_runtime.calloc && g_runtime.realloc)
            return true;
    }
    return false;
}

void* CountedMalloc(size_t size)
{
    ++g_allocations;
    return g_runtime.malloc(size);
}

void* CountedCalloc(size_t count, size_t size)
{
    ++g_allocations;
    return g_runtime.calloc(count, size);
}

void* CountedRealloc(void* block, size_t size)
{
    ++g_allocations;
    return g_runtime.realloc(block, size);
}

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

HeapCounter::HeapCounter()
{
    if (!FindRuntimeHeap())
        return;
    m_patches.reserve(64); // no reallocation while imports are being redirected
    const std::string folder = Folder(ModulePath(nullptr));
    HMODULE modules[512];
    DWORD needed = 0;
    if (!EnumProcessModules(GetCurrentProcess(), modules, sizeof modules, &needed))
        return;
    const size_t count = std::min<size_t>(needed / sizeof(HMODULE), 512);
    const struct {
        const char* name;
        void* replacement;
    } functions[] = {
        {"malloc", reinterpret_cast<void*>(&CountedMalloc)},
        {"calloc", reinterpret_cast<void*>(&CountedCalloc)},
        {"realloc", reinterpret_cast<void*>(&CountedRealloc)},
    };
    for (size_t i = 0; i < count; ++i) {
        // Only the project's modules: those in the program's folder.
        if (_stricmp(Folder(ModulePath(modules[i])).c_str(), folder.c_str()) != 0)
            continue;
        ++m_moduleCount;
        for (const auto& function : functions) {
            auto patch = std::make_unique<ImportPatch>(modules[i], function.name, function.replacement);
            if (patch->IsActive())
                m_patches.push_back(std::move(patch));
        }
    }
}

HeapCounter::~HeapCounter() = default;

long long HeapCounter::GetCount() const
{
    return g_allocations.load();
}
