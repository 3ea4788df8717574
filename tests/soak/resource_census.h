// What a process holds that a long-running user interface must give back:
// live GDI objects, windows of the thread, timers, hooks and heap bytes.
//
// ResourceLedger notes the timers and hooks that the library and the
// framework set and remove, and the device contexts they take and give back,
// by redirecting the user32 and gdi32 imports of libTavo_Windows.dll and
// afx.dll (ImportPatch): Win32 has no call that lists a thread's timers or
// hooks, and the system keeps the device contexts of windows in a cache, so
// one taken and never given back is not a GDI object more. TakeCensus counts
// the rest directly. One ledger at a time.
#pragma once

#include "ImportPatch.h"

#include <windows.h>

#include <array>
#include <memory>
#include <ostream>
#include <string>
#include <vector>

struct Census {
    int gdiObjects = 0;      // every live GDI object of the process
    int windows = 0;         // every window of the calling thread, children included
    int timers = 0;          // noted by the ledger and still running
    int hooks = 0;           // noted by the ledger and still installed
    int deviceContexts = 0;  // noted by the ledger: taken or made, not given back or deleted
    long long heapBytes = 0; // busy bytes of the C runtime's heap

    bool operator==(const Census& other) const;
    bool operator!=(const Census& other) const { return !(*this == other); }
};
std::ostream& operator<<(std::ostream& out, const Census& census);

class ResourceLedger {
public:
    ResourceLedger();
    ~ResourceLedger();
    ResourceLedger(const ResourceLedger&) = delete;
    ResourceLedger& operator=(const ResourceLedger&) = delete;

    // Whether the modules' imports were found and redirected.
    bool IsActive() const;

    // Timers the modules set and have not killed. A window's timers end with
    // the window, so those of windows that are gone are not counted; a timer
    // without a window (a thread timer) lives until it is killed.
    int CountTimers() const;
    bool HasTimer(HWND window, UINT_PTR id) const;
    // Timers set without a window: what a SetTimer on a window that is
    // already gone makes, and nothing ever kills.
    int CountThreadTimers() const;
    int CountHooks() const { return m_hooks; }
    // Device contexts taken from windows and not given back (a window's
    // end gives them back), and those made and not deleted.
    int CountDeviceContexts() const;

    // Kills a noted timer as the modules would (used to deliver a due
    // one-shot tick and to end a thread timer).
    void Forget(HWND window, UINT_PTR id);

    // Used by the redirected functions.
    static ResourceLedger* Current() { return s_current; }
    void NoteTimer(HWND window, UINT_PTR id);
    void NoteKilledTimer(HWND window, UINT_PTR id);
    void NoteHook(int delta) { m_hooks += delta; }
    void NoteTakenDeviceContext(HWND window, HDC dc);
    void NoteGivenBackDeviceContext(HDC dc);
    void NoteMadeDeviceContext(int delta) { m_madeDeviceContexts += delta; }

private:
    struct Timer {
        HWND window = nullptr;
        UINT_PTR id = 0;
    };
    struct TakenDeviceContext {
        HWND window = nullptr;
        HDC dc = nullptr;
    };
    // A fixed table, so that the ledger itself allocates nothing while the
    // heap is being counted.
    static constexpr size_t Capacity = 256;

    static ResourceLedger* s_current;
    std::vector<std::unique_ptr<ImportPatch>> m_patches;
    std::array<Timer, Capacity> m_timers = {};
    std::array<TakenDeviceContext, Capacity> m_takenDeviceContexts = {};
    int m_hooks = 0;
    int m_madeDeviceContexts = 0;
    // Noted nowhere for want of room: counted as held for good.
    int m_unnotedTimers = 0;
    int m_unnotedDeviceContexts = 0;
};

// Counts everything; the timers and hooks come from the ledger (0 without one).
Census TakeCensus(const ResourceLedger* ledger);

// The parts on their own.
int CountGdiObjects();
// The type (OBJ_...) of the object in each entry of the GDI handle table,
// 0 for a free one; empty where the table cannot be walked.
std::vector<unsigned char> GdiHandleTable();
// The entries that hold another object now than in an earlier table, as
// "0x1234 brush" for a report.
std::string DescribeNewGdiObjects(const std::vector<unsigned char>& earlier);
int CountThreadWindows();
// The class names of those windows, for a report.
std::string NameThreadWindows();
long long CountHeapBytes();
