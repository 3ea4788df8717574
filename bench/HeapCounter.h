// HeapCounter: counts heap allocations made by the project's own modules (the
// program and the DLLs beside it) while it lives, with the tests' heap call
// counter.
#pragma once

#include "HeapCallCounter.h"

#include <windows.h>

#include <vector>

class HeapCounter {
public:
    // False when no module imports an allocation function by name.
    bool IsActive() const { return m_counter.IsCounting(); }
    long long GetCount() const { return m_counter.GetCount(); }
    int GetModuleCount() const { return static_cast<int>(m_modules.size()); }

private:
    // The loaded modules in the program's folder.
    static std::vector<HMODULE> FindProjectModules();

    std::vector<HMODULE> m_modules = FindProjectModules();
    HeapCallCounter m_counter{m_modules};
};
