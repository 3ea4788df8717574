#include "HeapCallCounter.h"

#include <atomic>
#include <cstddef>

namespace {

std::atomic<long long> g_calls{0};

// The runtime's own functions, found before any import is redirected: once a
// program's own imports are redirected, the counter's bookkeeping allocates
// through the counted functions, which must already know where to forward.
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
    ++g_calls;
    return g_runtime.malloc(size);
}

void* CountedCalloc(size_t count, size_t size)
{
    ++g_calls;
    return g_runtime.calloc(count, size);
}

void* CountedRealloc(void* block, size_t size)
{
    ++g_calls;
    return g_runtime.realloc(block, size);
}

} // namespace

HeapCallCounter::HeapCallCounter(const std::vector<HMODULE>& modules)
{
    g_calls = 0;
    if (!FindRuntimeHeap())
        return;
    const struct {
        const char* name;
        void* replacement;
    } functions[] = {
        {"malloc", reinterpret_cast<void*>(&CountedMalloc)},
        {"calloc", reinterpret_cast<void*>(&CountedCalloc)},
        {"realloc", reinterpret_cast<void*>(&CountedRealloc)},
    };
    m_patches.reserve(modules.size() * 3); // no reallocation while imports are redirected
    for (const HMODULE module : modules) {
        for (const auto& function : functions) {
            auto patch = std::make_unique<ImportPatch>(module, function.name, function.replacement);
            if (patch->IsActive())
                m_patches.push_back(std::move(patch));
        }
    }
}

HeapCallCounter::HeapCallCounter(const char* moduleName)
    : HeapCallCounter(std::vector<HMODULE>{GetModuleHandleA(moduleName)})
{
}

HeapCallCounter::~HeapCallCounter() = default;

long long HeapCallCounter::GetCount() const
{
    return g_calls.load();
}

void HeapCallCounter::Reset()
{
    g_calls = 0;
}
