// HeapCallCounter: import-table redirection of the runtime's heap functions.
#include "HeapCallCounter.h"

#include <cstring>

namespace {

long long g_calls = 0;
void* (*g_malloc)(size_t) = nullptr;
void* (*g_calloc)(size_t, size_t) = nullptr;
void* (*g_realloc)(void*, size_t) = nullptr;

void* CountedMalloc(size_t size)
{
    ++g_calls;
    return g_malloc(size);
}

void* CountedCalloc(size_t count, size_t size)
{
    ++g_calls;
    return g_calloc(count, size);
}

void* CountedRealloc(void* block, size_t size)
{
    ++g_calls;
    return g_realloc(block, size);
}

// GetProcAddress gives a generic function pointer; go through void* to the
// real type.
template <typename Function>
Function Lookup(HMODULE module, const char* name)
{
    return reinterpret_cast<Function>(reinterpret_cast<void*>(GetProcAddress(module, name)));
}

void WriteSlot(void** slot, void* value)
{
    DWORD old = 0;
    VirtualProtect(slot, sizeof(void*), PAGE_READWRITE, &old);
    *slot = value;
    VirtualProtect(slot, sizeof(void*), old, &old);
}

} // namespace

HeapCallCounter::HeapCallCounter(const char* moduleName)
{
    auto* base = reinterpret_cast<unsigned char*>(GetModuleHandleA(moduleName));
    HMODULE runtime = GetModuleHandleA("msvcrt.dll");
    if (!base || !runtime)
        return;
    g_malloc = Lookup<void* (*)(size_t)>(runtime, "malloc");
    g_calloc = Lookup<void* (*)(size_t, size_t)>(runtime, "calloc");
    g_realloc = Lookup<void* (*)(void*, size_t)>(runtime, "realloc");

    const auto* dos = reinterpret_cast<const IMAGE_DOS_HEADER*>(base);
    const auto* nt = reinterpret_cast<const IMAGE_NT_HEADERS*>(base + dos->e_lfanew);
    const IMAGE_DATA_DIRECTORY& imports = nt->OptionalHeader.DataDirectory[IMAGE_DIRECTORY_ENTRY_IMPORT];
    if (!imports.VirtualAddress)
        return;
    m_patches.reserve(8);
    for (auto* d = reinterpret_cast<const IMAGE_IMPORT_DESCRIPTOR*>(base + imports.VirtualAddress); d->Name; ++d) {
        if (_stricmp(reinterpret_cast<const char*>(base + d->Name), "msvcrt.dll") != 0)
            continue;
        auto* names = reinterpret_cast<const IMAGE_THUNK_DATA*>(base + d->OriginalFirstThunk);
        auto* slots = reinterpret_cast<void**>(base + d->FirstThunk);
        for (; names->u1.AddressOfData; ++names, ++slots) {
            if (IMAGE_SNAP_BY_ORDINAL(names->u1.Ordinal))
                continue;
            const char* name = reinterpret_cast<const IMAGE_IMPORT_BY_NAME*>(base + names->u1.AddressOfData)->Name;
            void* counted = nullptr;
            if (std::strcmp(name, "malloc") == 0)
                counted = reinterpret_cast<void*>(&CountedMalloc);
            else if (std::strcmp(name, "calloc") == 0)
                counted = reinterpret_cast<void*>(&CountedCalloc);
            else if (std::strcmp(name, "realloc") == 0)
                counted = reinterpret_cast<void*>(&CountedRealloc);
            if (!counted)
                continue;
            m_patches.push_back({slots, *slots});
            WriteSlot(slots, counted);
        }
    }
}

HeapCallCounter::~HeapCallCounter()
{
    for (const Patch& patch : m_patches)
        WriteSlot(patch.slot, patch.original);
}

long long HeapCallCounter::GetCount() const
{
    return g_calls;
}

void HeapCallCounter::Reset()
{
    g_calls = 0;
}
