// ImportPatch: redirects one imported function of one loaded module.
//
// Tests and the benchmark use it to watch the Win32 calls that a DLL makes
// (GDI calls of the surface, heap calls of every module) without changing the
// DLL: the module's import address table entry is replaced while the patch
// lives and restored when it dies. The production code path is untouched.
#pragma once

#include <windows.h>

#include <vector>

class ImportPatch {
public:
    // Redirects every import named `function` of `module`, whatever DLL it is
    // imported from. IsActive() tells whether any entry was found.
    ImportPatch(HMODULE module, const char* function, void* replacement);
    ~ImportPatch();

    ImportPatch(const ImportPatch&) = delete;
    ImportPatch& operator=(const ImportPatch&) = delete;

    bool IsActive() const { return !m_slots.empty(); }
    // The address the first redirected entry held before: call it to forward.
    void* GetOriginal() const { return m_original; }

private:
    struct Slot {
        void** address = nullptr;
        void* previous = nullptr;
    };
    static void Write(void** address, void* value);

    std::vector<Slot> m_slots;
    void* m_original = nullptr;
};
