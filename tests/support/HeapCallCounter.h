// HeapCallCounter: counts the C runtime's malloc, calloc and realloc calls
// made from chosen modules while it lives, by redirecting those modules'
// imports of them (ImportPatch). A MinGW module's operator new ends in
// malloc, so it is counted too. One counter at a time.
#pragma once

#include "ImportPatch.h"

#include <windows.h>

#include <memory>
#include <vector>

class HeapCallCounter {
public:
    explicit HeapCallCounter(const std::vector<HMODULE>& modules);
    // One loaded module by name, for example "libTavo_Core.dll".
    explicit HeapCallCounter(const char* moduleName);
    HeapCallCounter(const HeapCallCounter&) = delete;
    HeapCallCounter& operator=(const HeapCallCounter&) = delete;

    // Whether any of the modules' heap imports was found and redirected.
    bool IsCounting() const { return !m_patches.empty(); }
    long long GetCount() const;
    void Reset();

private:
    std::vector<std::unique_ptr<ImportPatch>> m_patches;
};
