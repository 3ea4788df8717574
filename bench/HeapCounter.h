// HeapCounter: counts heap allocations made by the project's own modules (the
// program and the DLLs beside it) while it lives, by redirecting their imports
// of the C runtime's allocation functions. C++ operator new of each module
// ends in malloc, so it is counted too.
#pragma once

#include "ImportPatch.h"

#include <memory>
#include <vector>

class HeapCounter {
public:
    HeapCounter();
    ~HeapCounter();
    HeapCounter(const HeapCounter&) = delete;
    HeapCounter& operator=(const HeapCounter&) = delete;

    // False when no module imports an allocation function by name.
    bool IsActive() const { return !m_patches.empty(); }
    long long GetCount() const;
    int GetModuleCount() const { return m_moduleCount; }

private:
    std::vector<std::unique_ptr<ImportPatch>> m_patches;
    int m_moduleCount = 0;
};
