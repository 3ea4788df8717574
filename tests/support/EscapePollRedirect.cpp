#include "EscapePollRedirect.h"

namespace {

const char kRedirectedModule[] = "libTavo_Windows.dll";
// GetAsyncKeyState's sign bit: the key is down now.
const SHORT kKeyDown = static_cast<SHORT>(0x8000);

} // namespace

EscapePollRedirect* EscapePollRedirect::s_current = nullptr;

EscapePollRedirect::EscapePollRedirect()
    : m_keyState(GetModuleHandleA(kRedirectedModule), "GetAsyncKeyState", reinterpret_cast<void*>(&KeyState)),
      m_tickCount(GetModuleHandleA(kRedirectedModule), "GetTickCount64", reinterpret_cast<void*>(&TickCount))
{
    s_current = this;
}

EscapePollRedirect::~EscapePollRedirect()
{
    s_current = nullptr;
    // The members put the imports back.
}

SHORT WINAPI EscapePollRedirect::KeyState(int key)
{
    EscapePollRedirect& self = *s_current;
    ++self.m_keyQueries;
    if (key == VK_ESCAPE && self.m_escapeDown)
        return *self.m_escapeDown ? kKeyDown : 0;
    return reinterpret_cast<decltype(&GetAsyncKeyState)>(self.m_keyState.GetOriginal())(key);
}

ULONGLONG WINAPI EscapePollRedirect::TickCount()
{
    EscapePollRedirect& self = *s_current;
    if (self.m_tick)
        return *self.m_tick;
    return reinterpret_cast<decltype(&GetTickCount64)>(self.m_tickCount.GetOriginal())();
}
