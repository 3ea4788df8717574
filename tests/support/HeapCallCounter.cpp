#include "HeapCallCounter.h"

#include <atomic>
#include <cstddef>
#include <utility>

namespace {

std::atomic<long long> g_calls{0};

// The runtime's own functions, found before any import is redirected: once a
// program's own imports are redirected, the counter's bookkeeping allocates
// through the counted functions, which must already know where to forward.
void* (*g_malloc)(size_t) = nullptr;
void* (*g_calloc)(size_t, size_t) = nullptr;
void* (*g_realloc)(void*, size_t) = nullptr;

template <class Function>
void Lookup(HMODULE module, const char* name, Function& function)
{
    // Through void*: FARPROC has no parameters to match.
    function = reinterpret_cast<Function>(reinterpret_cast<void*>(GetProcAddress(module, name)));
}

bool FindRuntimeHeap()
{
    for (const char* name : {"msvcrt.dll", "ucrtbase.dll"}) {
        if (const HMODULE runtime = GetModuleHandleA(name)) {
            Lookup(runtime, "malloc", g_malloc);
            Lookup(runtime, "calloc", g_calloc);
            Lookup(runtime, "realloc", g_realloc);
        }
        if (g_malloc && g_calloc && g_realloc)
            return true;
    }
    return false;
}

// Counts a call, then forwards it to the runtime's own function.
template <auto& runtime, class... Arguments>
void* Counted(Arguments... arguments)
{
    ++g_calls;
    return runtime(arguments...);
}

} // namespace

HeapCallCounter::HeapCallCounter(const std::vector<HMODULE>& modules)
{
    g_calls = 0;
    if (!FindRuntimeHeap())
        return;
    const std::pair<const char*, void*> functions[] = {
        {"malloc", reinterpret_cast<void*>(&Counted<g_malloc, size_t>)},
        {"calloc", reinterpret_cast<void*>(&Counted<g_calloc, size_t, size_t>)},
        {"realloc", reinterpret_cast<void*>(&Counted<g_realloc, void*, size_t>)},
    };
    m_patches.reserve(modules.size() * 3); // no reallocation while imports are redirected
    for (const HMODULE module : modules) {
        for (const auto& function : functions) {
            auto patch = std::make_unique<ImportPatch>(module, function.first, function.second);
            if (patch->IsActive())
                m_patches.push_back(std::move(patch));
        }
    }
}

HeapCallCounter::HeapCallCounter(const char* moduleName)
    : HeapCallCounter(std::vector<HMODULE>{GetModuleHandleA(moduleName)})
{
}

long long HeapCallCounter::GetCount() const
{
    return g_calls.load();
}

void HeapCallCounter::Reset()
{
    g_calls = 0;
}
