// HeapCallCounter: counts the C runtime's malloc, calloc and realloc calls made
// from one module (a DLL of the project), by redirecting that module's imports
// of them while the counter lives.
#pragma once

#include <windows.h>

#include <vector>

class HeapCallCounter {
public:
    explicit HeapCallCounter(const char* moduleName);
    ~HeapCallCounter();
    HeapCallCounter(const HeapCallCounter&) = delete;
    HeapCallCounter& operator=(const HeapCallCounter&) = delete;

    // Whether the module's heap imports were found and redirected.
    bool IsCounting() const { return !m_patches.empty(); }
    long long GetCount() const;
    void Reset();

private:
    struct Patch {
        void** slot;
        void* original;
    };
    std::vector<Patch> m_patches;
};
