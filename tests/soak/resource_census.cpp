#include "resource_census.h"

#include <malloc.h>

#include <cstdio>
#include <cstring>
#include <iterator>

#include <tuple>

ResourceLedger* ResourceLedger::s_current = nullptr;

namespace {

// The modules whose timers and hooks are noted: the library and the
// framework (the drawing window's timer goes through CWnd::SetTimer).
constexpr const char* NotedModules[] = {"libTavo_Windows.dll", "afx.dll"};

// What the redirected functions forward to.
decltype(&::SetTimer) s_setTimer = nullptr;
decltype(&::KillTimer) s_killTimer = nullptr;
decltype(&::SetWindowsHookExA) s_setHook = nullptr;
decltype(&::UnhookWindowsHookEx) s_unhook = nullptr;
decltype(&::GetDC) s_getDC = nullptr;
decltype(&::GetWindowDC) s_getWindowDC = nullptr;
decltype(&::ReleaseDC) s_releaseDC = nullptr;
decltype(&::BeginPaint) s_beginPaint = nullptr;
decltype(&::EndPaint) s_endPaint = nullptr;
decltype(&::CreateDCA) s_createDC = nullptr;
decltype(&::CreateICA) s_createIC = nullptr;
decltype(&::CreateCompatibleDC) s_createCompatibleDC = nullptr;
decltype(&::DeleteDC) s_deleteDC = nullptr;

void NoteTaken(HWND window, HDC dc)
{
    if (dc && ResourceLedger::Current())
        ResourceLedger::Current()->NoteTakenDeviceContext(window, dc);
}

void NoteGivenBack(HDC dc)
{
    if (dc && ResourceLedger::Current())
        ResourceLedger::Current()->NoteGivenBackDeviceContext(dc);
}

void NoteDeviceContext(bool happened, int delta)
{
    if (happened && ResourceLedger::Current())
        ResourceLedger::Current()->NoteMadeDeviceContext(delta);
}

HDC WINAPI NotedGetDC(HWND window)
{
    const HDC dc = s_getDC(window);
    NoteTaken(window, dc);
    return dc;
}

HDC WINAPI NotedGetWindowDC(HWND window)
{
    const HDC dc = s_getWindowDC(window);
    NoteTaken(window, dc);
    return dc;
}

int WINAPI NotedReleaseDC(HWND window, HDC dc)
{
    const int released = s_releaseDC(window, dc);
    if (released)
        NoteGivenBack(dc);
    return released;
}

HDC WINAPI NotedBeginPaint(HWND window, PAINTSTRUCT* paint)
{
    const HDC dc = s_beginPaint(window, paint);
    NoteTaken(window, dc);
    return dc;
}

BOOL WINAPI NotedEndPaint(HWND window, const PAINTSTRUCT* paint)
{
    if (paint)
        NoteGivenBack(paint->hdc);
    return s_endPaint(window, paint);
}

HDC WINAPI NotedCreateDC(LPCSTR driver, LPCSTR device, LPCSTR port, const DEVMODEA* mode)
{
    const HDC dc = s_createDC(driver, device, port, mode);
    NoteDeviceContext(dc != nullptr, +1);
    return dc;
}

HDC WINAPI NotedCreateIC(LPCSTR driver, LPCSTR device, LPCSTR port, const DEVMODEA* mode)
{
    const HDC dc = s_createIC(driver, device, port, mode);
    NoteDeviceContext(dc != nullptr, +1);
    return dc;
}

HDC WINAPI NotedCreateCompatibleDC(HDC dc)
{
    const HDC made = s_createCompatibleDC(dc);
    NoteDeviceContext(made != nullptr, +1);
    return made;
}

BOOL WINAPI NotedDeleteDC(HDC dc)
{
    const BOOL deleted = s_deleteDC(dc);
    NoteDeviceContext(deleted != FALSE, -1);
    return deleted;
}

template <class Function>
void Lookup(HMODULE module, const char* name, Function& function)
{
    function = reinterpret_cast<Function>(reinterpret_cast<void*>(::GetProcAddress(module, name)));
}

UINT_PTR WINAPI NotedSetTimer(HWND window, UINT_PTR id, UINT elapse, TIMERPROC proc)
{
    const UINT_PTR result = s_setTimer(window, id, elapse, proc);
    if (result != 0 && ResourceLedger::Current())
        ResourceLedger::Current()->NoteTimer(window, window ? id : result);
    return result;
}

BOOL WINAPI NotedKillTimer(HWND window, UINT_PTR id)
{
    const BOOL killed = s_killTimer(window, id);
    if (killed && ResourceLedger::Current())
        ResourceLedger::Current()->NoteKilledTimer(window, id);
    return killed;
}

HHOOK WINAPI NotedSetHook(int type, HOOKPROC proc, HINSTANCE module, DWORD thread)
{
    const HHOOK hook = s_setHook(type, proc, module, thread);
    if (hook && ResourceLedger::Current())
        ResourceLedger::Current()->NoteHook(+1);
    return hook;
}

BOOL WINAPI NotedUnhook(HHOOK hook)
{
    const BOOL removed = s_unhook(hook);
    if (removed && ResourceLedger::Current())
        ResourceLedger::Current()->NoteHook(-1);
    return removed;
}

} // namespace

bool Census::operator==(const Census& other) const
{
    return std::tie(gdiObjects, windows, timers, hooks, deviceContexts, heapBytes) ==
        std::tie(other.gdiObjects, other.windows, other.timers, other.hooks, other.deviceContexts,
                 other.heapBytes);
}

std::ostream& operator<<(std::ostream& out, const Census& c)
{
    return out << c.gdiObjects << " GDI objects, " << c.windows << " windows, " << c.timers << " timers, "
               << c.hooks << " hooks, " << c.deviceContexts << " device contexts held, " << c.heapBytes
               << " heap bytes";
}

// ---- the ledger ----------------------------------------------------------------------

ResourceLedger::ResourceLedger()
{
    const HMODULE user32 = ::GetModuleHandleA("user32.dll");
    Lookup(user32, "SetTimer", s_setTimer);
    Lookup(user32, "KillTimer", s_killTimer);
    Lookup(user32, "SetWindowsHookExA", s_setHook);
    Lookup(user32, "UnhookWindowsHookEx", s_unhook);
    Lookup(user32, "GetDC", s_getDC);
    Lookup(user32, "GetWindowDC", s_getWindowDC);
    Lookup(user32, "ReleaseDC", s_releaseDC);
    Lookup(user32, "BeginPaint", s_beginPaint);
    Lookup(user32, "EndPaint", s_endPaint);
    const HMODULE gdi32 = ::GetModuleHandleA("gdi32.dll");
    Lookup(gdi32, "CreateDCA", s_createDC);
    Lookup(gdi32, "CreateICA", s_createIC);
    Lookup(gdi32, "CreateCompatibleDC", s_createCompatibleDC);
    Lookup(gdi32, "DeleteDC", s_deleteDC);
    const std::pair<const char*, void*> redirects[] = {
        {"SetTimer", reinterpret_cast<void*>(&NotedSetTimer)},
        {"KillTimer", reinterpret_cast<void*>(&NotedKillTimer)},
        {"SetWindowsHookExA", reinterpret_cast<void*>(&NotedSetHook)},
        {"UnhookWindowsHookEx", reinterpret_cast<void*>(&NotedUnhook)},
        {"GetDC", reinterpret_cast<void*>(&NotedGetDC)},
        {"GetWindowDC", reinterpret_cast<void*>(&NotedGetWindowDC)},
        {"ReleaseDC", reinterpret_cast<void*>(&NotedReleaseDC)},
        {"BeginPaint", reinterpret_cast<void*>(&NotedBeginPaint)},
        {"EndPaint", reinterpret_cast<void*>(&NotedEndPaint)},
        {"CreateDCA", reinterpret_cast<void*>(&NotedCreateDC)},
        {"CreateICA", reinterpret_cast<void*>(&NotedCreateIC)},
        {"CreateCompatibleDC", reinterpret_cast<void*>(&NotedCreateCompatibleDC)},
        {"DeleteDC", reinterpret_cast<void*>(&NotedDeleteDC)},
    };
    for (const char* name : NotedModules) {
        for (const auto& redirect : redirects) {
            auto patch = std::make_unique<ImportPatch>(::GetModuleHandleA(name), redirect.first, redirect.second);
            // Not every module imports every function; a missing one has nothing to note.
            if (patch->IsActive())
                m_patches.push_back(std::move(patch));
        }
    }
    s_current = this;
}

ResourceLedger::~ResourceLedger()
{
    m_patches.clear();
    s_current = nullptr;
}

bool ResourceLedger::IsActive() const
{
    return !m_patches.empty();
}

void ResourceLedger::NoteTimer(HWND window, UINT_PTR id)
{
    // Setting a timer that runs already only restarts it.
    if (HasTimer(window, id))
        return;
    // An entry is free again once its window is gone, with its timers.
    for (Timer& timer : m_timers) {
        if (timer.id == 0 || (timer.window != nullptr && !::IsWindow(timer.window))) {
            timer = {window, id};
            return;
        }
    }
    ++m_unnotedTimers;
}

void ResourceLedger::NoteKilledTimer(HWND window, UINT_PTR id)
{
    for (Timer& timer : m_timers)
        if (timer.id == id && timer.window == window)
            timer = {};
}

void ResourceLedger::NoteTakenDeviceContext(HWND window, HDC dc)
{
    for (TakenDeviceContext& taken : m_takenDeviceContexts) {
        if (taken.dc == nullptr || (taken.window != nullptr && !::IsWindow(taken.window))) {
            taken = {window, dc};
            return;
        }
    }
    ++m_unnotedDeviceContexts;
}

void ResourceLedger::NoteGivenBackDeviceContext(HDC dc)
{
    for (TakenDeviceContext& taken : m_takenDeviceContexts) {
        if (taken.dc == dc) {
            taken = {};
            return;
        }
    }
}

int ResourceLedger::CountDeviceContexts() const
{
    // The system gives a window's device contexts back when it ends.
    int count = m_madeDeviceContexts + m_unnotedDeviceContexts;
    for (const TakenDeviceContext& taken : m_takenDeviceContexts)
        if (taken.dc != nullptr && (taken.window == nullptr || ::IsWindow(taken.window)))
            ++count;
    return count;
}

void ResourceLedger::Forget(HWND window, UINT_PTR id)
{
    ::KillTimer(window, id);
    NoteKilledTimer(window, id);
}

bool ResourceLedger::HasTimer(HWND window, UINT_PTR id) const
{
    for (const Timer& timer : m_timers)
        if (timer.id == id && timer.window == window && (window == nullptr || ::IsWindow(window)))
            return true;
    return false;
}

int ResourceLedger::CountTimers() const
{
    int count = 0;
    for (const Timer& timer : m_timers)
        if (timer.id != 0 && (timer.window == nullptr || ::IsWindow(timer.window)))
            ++count;
    // A timer the full table could not note counts as running for good.
    return count + m_unnotedTimers;
}

int ResourceLedger::CountThreadTimers() const
{
    int count = 0;
    for (const Timer& timer : m_timers)
        if (timer.id != 0 && timer.window == nullptr)
            ++count;
    return count;
}

// ---- counting ------------------------------------------------------------------------

int CountGdiObjects()
{
    // GetGuiResources answers 0 under Wine (a stub), so the GDI handle table
    // is walked instead. Wine keeps a process's GDI objects in one table of
    // at most 65536 entries, and the low 16 bits of a handle are its entry;
    // GetObjectType of a bare entry number (high word 0) names the type of
    // whatever object lives there and answers 0 for a free entry. Where
    // GetGuiResources works, its count is taken.
    if (const DWORD counted = ::GetGuiResources(::GetCurrentProcess(), GR_GDIOBJECTS))
        return static_cast<int>(counted);
    int count = 0;
    for (ULONG_PTR entry = 1; entry <= 0xFFFF; ++entry)
        if (::GetObjectType(reinterpret_cast<HGDIOBJ>(entry)) != 0)
            ++count;
    return count;
}

namespace {

// The system gives a thread a default IME window with its first top-level
// window and takes it away with the last; it is the system's, not a leak.
bool IsSystemImeWindow(HWND window)
{
    char name[8] = {};
    ::GetClassNameA(window, name, sizeof name);
    return std::strcmp(name, "IME") == 0;
}

BOOL CALLBACK CountChild(HWND, LPARAM count)
{
    ++*reinterpret_cast<int*>(count);
    return TRUE;
}

BOOL CALLBACK CountTopLevel(HWND window, LPARAM count)
{
    if (IsSystemImeWindow(window))
        return TRUE;
    ++*reinterpret_cast<int*>(count);
    // Every descendant, not only the direct children.
    ::EnumChildWindows(window, CountChild, count);
    return TRUE;
}

} // namespace

std::vector<unsigned char> GdiHandleTable()
{
    if (::GetGuiResources(::GetCurrentProcess(), GR_GDIOBJECTS) != 0)
        return {};
    std::vector<unsigned char> table(0x10000);
    for (ULONG_PTR entry = 1; entry <= 0xFFFF; ++entry)
        table[entry] = static_cast<unsigned char>(::GetObjectType(reinterpret_cast<HGDIOBJ>(entry)));
    return table;
}

std::string DescribeNewGdiObjects(const std::vector<unsigned char>& earlier)
{
    static const char* const names[] = {"?", "pen", "brush", "DC", "metafile DC", "palette", "font", "bitmap",
                                        "region", "metafile", "memory DC", "extended pen", "enhanced metafile DC",
                                        "enhanced metafile", "colour space"};
    const std::vector<unsigned char> now = GdiHandleTable();
    std::string text;
    for (size_t entry = 0; entry < now.size() && entry < earlier.size(); ++entry) {
        if (now[entry] == 0 || now[entry] == earlier[entry])
            continue;
        char line[64];
        std::snprintf(line, sizeof line, "%s0x%04x %s", text.empty() ? "" : ", ", static_cast<unsigned>(entry),
                      now[entry] < std::size(names) ? names[now[entry]] : "?");
        text += line;
    }
    return text;
}

namespace {

BOOL CALLBACK NameChild(HWND window, LPARAM names)
{
    char name[64] = {};
    ::GetClassNameA(window, name, sizeof name);
    auto& text = *reinterpret_cast<std::string*>(names);
    text += text.empty() ? "" : ", ";
    text += name;
    return TRUE;
}

BOOL CALLBACK NameTopLevel(HWND window, LPARAM names)
{
    NameChild(window, names);
    ::EnumChildWindows(window, NameChild, names);
    return TRUE;
}

} // namespace

std::string NameThreadWindows()
{
    std::string names;
    ::EnumThreadWindows(::GetCurrentThreadId(), NameTopLevel, reinterpret_cast<LPARAM>(&names));
    return names;
}

int CountThreadWindows()
{
    int count = 0;
    ::EnumThreadWindows(::GetCurrentThreadId(), CountTopLevel, reinterpret_cast<LPARAM>(&count));
    return count;
}

long long CountHeapBytes()
{
    // The program, the library, the framework and the graphics core all
    // allocate through msvcrt.dll (operator new included), whose heap this is.
    const HANDLE heap = reinterpret_cast<HANDLE>(_get_heap_handle());
    long long busy = 0;
    PROCESS_HEAP_ENTRY entry = {};
    ::HeapLock(heap);
    while (::HeapWalk(heap, &entry))
        if (entry.wFlags & PROCESS_HEAP_ENTRY_BUSY)
            busy += static_cast<long long>(entry.cbData);
    ::HeapUnlock(heap);
    return busy;
}

Census TakeCensus(const ResourceLedger* ledger)
{
    Census census;
    census.gdiObjects = CountGdiObjects();
    census.windows = CountThreadWindows();
    census.timers = ledger ? ledger->CountTimers() : 0;
    census.hooks = ledger ? ledger->CountHooks() : 0;
    census.deviceContexts = ledger ? ledger->CountDeviceContexts() : 0;
    census.heapBytes = CountHeapBytes();
    return census;
}
