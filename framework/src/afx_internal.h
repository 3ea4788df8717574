// afx_internal.h - shared state of the framework's implementation files.
//
// Holds: the per-thread handle maps (HandleMap), the message being handled
// (for CWnd::Default), the window-creation hook, the registry of window
// classes registered through AfxRegisterClass, and named constants.
#ifndef TAVO_FRAMEWORK_AFX_INTERNAL_H
#define TAVO_FRAMEWORK_AFX_INTERNAL_H

#include <afxwin.h>

#include <unordered_map>

namespace afx_internal {

// The framework's default window class (a NULL class name in Create).
constexpr const char* kDefaultWindowClass = "AfxWnd80";
// The class of the input-method windows the system creates on its own; the
// creation hook lets them pass.
constexpr const char* kImeWindowClass = "IME";

// One kind of handle map: objects attached to handles for good (permanent)
// and wrapper objects made on demand for handles nobody attached
// (temporary, owned by the map and deleted by DeleteTemporaries).
template <class Object>
class HandleMap {
public:
    Object* LookupPermanent(HANDLE h) const
    {
        const auto it = m_permanent.find(h);
        return it == m_permanent.end() ? nullptr : it->second;
    }
    Object* LookupTemporary(HANDLE h) const
    {
        const auto it = m_temporary.find(h);
        return it == m_temporary.end() ? nullptr : it->second;
    }
    void SetPermanent(HANDLE h, Object* object) { m_permanent[h] = object; }
    void RemovePermanent(HANDLE h, const Object* object)
    {
        const auto it = m_permanent.find(h);
        if (it != m_permanent.end() && it->second == object)
            m_permanent.erase(it);
    }
    void AddTemporary(HANDLE h, Object* object) { m_temporary[h] = object; }
    // Deletes every temporary object after releaseHandle has cleared its
    // handle, so that its destructor leaves the Windows object alone.
    template <class ReleaseHandle>
    void DeleteTemporaries(ReleaseHandle releaseHandle)
    {
        auto temporaries = std::move(m_temporary);
        m_temporary.clear();
        for (auto& entry : temporaries) {
            releaseHandle(entry.second);
            delete entry.second;
        }
    }
    size_t TemporaryCount() const { return m_temporary.size(); }

private:
    std::unordered_map<HANDLE, Object*> m_permanent;
    std::unordered_map<HANDLE, Object*> m_temporary;
};

struct ThreadState {
    HandleMap<CWnd> windows;
    HandleMap<CDC> dcs;
    HandleMap<CGdiObject> gdiObjects;
    int tempMapLocks = 0;

    // The message the window procedure is handling now (CWnd::Default).
    MSG currentMessage = {};

    // Window creation: the object that the next created window attaches to.
    CWnd* windowBeingCreated = nullptr;
    HHOOK creationHook = nullptr;
};

// The calling thread's state.
ThreadState& CurrentThreadState();

// Deletes all temporary objects of the calling thread.
void DeleteAllTemporaries();

// The instance a window class was registered for by AfxRegisterClass, or
// NULL when the framework did not register it.
HINSTANCE RegisteredClassInstance(LPCSTR className);

// Registers the framework's default window class if needed.
bool RegisterDefaultWindowClass();

// Sets the creation hook so that the next window created on this thread is
// attached to pWnd; Unhook removes it and reports whether it was used.
void HookWindowCreate(CWnd* pWnd);
bool UnhookWindowCreate();

// Runs pWnd->WindowProc for one message with that message recorded as the
// current one; C++ exceptions stop here instead of unwinding through the
// system's window procedure callers.
LRESULT CallWindowProcedure(CWnd* pWnd, HWND hWnd, UINT nMsg, WPARAM wParam, LPARAM lParam);

// Detaches pWnd from its destroyed window and restores the window's
// procedure; used at WM_NCDESTROY.
void DetachDestroyedWindow(CWnd* pWnd);

} // namespace afx_internal

#endif // TAVO_FRAMEWORK_AFX_INTERNAL_H
