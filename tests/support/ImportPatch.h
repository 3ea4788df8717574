// ImportPatch: redirects one imported function of one loaded module while it
// lives, so that tests and the benchmark can watch the Win32 calls a DLL makes
// without changing the DLL.
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
    void* GetOriginal() const { return m_slots.empty() ? nullptr : m_slots.front().previous; }

private:
    struct Slot {
        void** address = nullptr;
        void* previous = nullptr;
    };
    static void Write(void** address, void* value);

    std::vector<Slot> m_slots;
};
