// EscapePollRedirect: while it lives, redirects libTavo_Windows.dll's imports
// of GetAsyncKeyState and GetTickCount64, the two calls behind the surface's
// Escape poll, and counts the key-state queries. Both calls forward to Win32
// until a test takes the key or the clock over (SetEscapeDown, SetTick): then
// the test decides when Escape is down and when the clock moves, without
// touching the keyboard and without sleeping. One at a time.
#pragma once

#include "ImportPatch.h"

#include <windows.h>

#include <optional>

class EscapePollRedirect {
public:
    EscapePollRedirect();
    ~EscapePollRedirect();
    EscapePollRedirect(const EscapePollRedirect&) = delete;
    EscapePollRedirect& operator=(const EscapePollRedirect&) = delete;

    // True when both imports could be redirected.
    bool IsActive() const { return m_keyState.IsActive() && m_tickCount.IsActive(); }

    // GetAsyncKeyState calls, whatever key they asked about.
    long long GetKeyQueryCount() const { return m_keyQueries; }
    void ResetKeyQueryCount() { m_keyQueries = 0; }

    // From now on Escape reads as down or up, whatever the keyboard says.
    void SetEscapeDown(bool down) { m_escapeDown = down; }
    // From now on the clock reads `tick` milliseconds until moved.
    void SetTick(ULONGLONG tick) { m_tick = tick; }
    // Moves a clock that SetTick took over.
    void AdvanceTick(ULONGLONG milliseconds) { m_tick = m_tick.value_or(0) + milliseconds; }

private:
    static SHORT WINAPI KeyState(int key);
    static ULONGLONG WINAPI TickCount();

    static EscapePollRedirect* s_current;

    ImportPatch m_keyState;
    ImportPatch m_tickCount;
    long long m_keyQueries = 0;
    std::optional<bool> m_escapeDown;
    std::optional<ULONGLONG> m_tick;
};
