#include "ImportPatch.h"

#include <cstring>

namespace {

template <class T>
T* At(HMODULE module, DWORD rva)
{
    return reinterpret_cast<T*>(reinterpret_cast<BYTE*>(module) + rva);
}

// True when the import thunk `name` (from the lookup table) is `function`.
bool NamesFunction(HMODULE module, const IMAGE_THUNK_DATA& name, const char* function)
{
    if (IMAGE_SNAP_BY_ORDINAL(name.u1.Ordinal))
        return false;
    const auto* byName = At<IMAGE_IMPORT_BY_NAME>(module, static_cast<DWORD>(name.u1.AddressOfData));
    return std::strcmp(reinterpret_cast<const char*>(byName->Name), function) == 0;
}

} // namespace

ImportPatch::ImportPatch(HMODULE module, const char* function, void* replacement)
{
    if (!module)
        return;
    const auto* dos = reinterpret_cast<const IMAGE_DOS_HEADER*>(module);
    const auto* nt = At<IMAGE_NT_HEADERS>(module, dos->e_lfanew);
    const IMAGE_DATA_DIRECTORY& imports = nt->OptionalHeader.DataDirectory[IMAGE_DIRECTORY_ENTRY_IMPORT];
    if (imports.VirtualAddress == 0)
        return;

    for (auto* descriptor = At<IMAGE_IMPORT_DESCRIPTOR>(module, imports.VirtualAddress);
         descriptor->Name != 0; ++descriptor) {
        // Without a lookup table the names are gone; compare addresses instead.
        const HMODULE exporter = GetModuleHandleA(At<char>(module, descriptor->Name));
        const void* exported = exporter ? reinterpret_cast<void*>(GetProcAddress(exporter, function)) : nullptr;
        auto* slot = At<IMAGE_THUNK_DATA>(module, descriptor->FirstThunk);
        const IMAGE_THUNK_DATA* name = descriptor->OriginalFirstThunk
            ? At<IMAGE_THUNK_DATA>(module, descriptor->OriginalFirstThunk)
            : nullptr;
        for (; slot->u1.Function != 0; ++slot, name = name ? name + 1 : nullptr) {
            void** address = reinterpret_cast<void**>(&slot->u1.Function);
            const bool match = name ? NamesFunction(module, *name, function) : (exported && *address == exported);
            if (!match)
                continue;
            m_slots.push_back({address, *address});
            Write(address, replacement);
        }
    }
}

ImportPatch::~ImportPatch()
{
    for (const Slot& slot : m_slots)
        Write(slot.address, slot.previous);
}

void ImportPatch::Write(void** address, void* value)
{
    DWORD protection = 0;
    VirtualProtect(address, sizeof(void*), PAGE_READWRITE, &protection);
    *address = value;
    VirtualProtect(address, sizeof(void*), protection, &protection);
}
