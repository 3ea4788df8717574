#include "TourInput.h"

namespace {

// One wheel notch, in the wheel message's units.
constexpr int NotchDelta = WHEEL_DELTA;

} // namespace

DWORD TourInput::Stamp(DWORD later)
{
    const DWORD now = ::GetTickCount() + later;
    // Message times wrap; the signed difference tells which is later.
    m_last = static_cast<LONG>(now - m_last) > 0 ? now : m_last + 1;
    return m_last;
}

INPUT TourInput::MouseInput(DWORD flags, POINT screen, DWORD data, DWORD time)
{
    const long long width = ::GetSystemMetrics(SM_CXSCREEN);
    const long long height = ::GetSystemMetrics(SM_CYSCREEN);
    INPUT input = {};
    input.type = INPUT_MOUSE;
    // Absolute coordinates land on the pixel exactly when rounded up.
    input.mi.dx = static_cast<LONG>((screen.x * 65536LL + width - 1) / width);
    input.mi.dy = static_cast<LONG>((screen.y * 65536LL + height - 1) / height);
    input.mi.mouseData = data;
    input.mi.dwFlags = flags | MOUSEEVENTF_MOVE | MOUSEEVENTF_ABSOLUTE;
    input.mi.time = time;
    return input;
}

INPUT TourInput::KeyInput(WORD virtualKey, WORD scan, DWORD flags)
{
    INPUT input = {};
    input.type = INPUT_KEYBOARD;
    input.ki.wVk = virtualKey;
    input.ki.wScan = scan;
    input.ki.dwFlags = flags;
    input.ki.time = Stamp();
    return input;
}

void TourInput::SendMouse(DWORD flags, POINT screen, DWORD data, DWORD time)
{
    INPUT input = MouseInput(flags, screen, data, time);
    ::SendInput(1, &input, sizeof input);
}

void TourInput::SendKey(WORD virtualKey, WORD scan, DWORD flags)
{
    INPUT input = KeyInput(virtualKey, scan, flags);
    ::SendInput(1, &input, sizeof input);
}

void TourInput::MoveTo(POINT screen) { SendMouse(0, screen, 0, Stamp()); }
void TourInput::Press(POINT screen) { SendMouse(MOUSEEVENTF_LEFTDOWN, screen, 0, Stamp()); }
void TourInput::Release(POINT screen) { SendMouse(MOUSEEVENTF_LEFTUP, screen, 0, Stamp()); }

void TourInput::Click(POINT screen, DWORD heldMs)
{
    SendMouse(MOUSEEVENTF_LEFTDOWN, screen, 0, Stamp());
    SendMouse(MOUSEEVENTF_LEFTUP, screen, 0, Stamp(heldMs));
}

void TourInput::Wheel(POINT screen, int notches)
{
    SendMouse(MOUSEEVENTF_WHEEL, screen, static_cast<DWORD>(notches * NotchDelta), Stamp());
}

void TourInput::KeyDown(WORD virtualKey) { SendKey(virtualKey, 0, 0); }
void TourInput::KeyUp(WORD virtualKey) { SendKey(virtualKey, 0, KEYEVENTF_KEYUP); }

void TourInput::PressWithShift(POINT screen)
{
    INPUT inputs[2] = {KeyInput(VK_SHIFT, 0, 0), MouseInput(MOUSEEVENTF_LEFTDOWN, screen, 0, Stamp())};
    ::SendInput(2, inputs, sizeof(INPUT));
}

void TourInput::Key(WORD virtualKey, WORD modifier)
{
    if (!modifier) {
        INPUT inputs[2] = {KeyInput(virtualKey, 0, 0), KeyInput(virtualKey, 0, KEYEVENTF_KEYUP)};
        ::SendInput(2, inputs, sizeof(INPUT));
        return;
    }
    INPUT inputs[4] = {KeyInput(modifier, 0, 0), KeyInput(virtualKey, 0, 0), KeyInput(virtualKey, 0, KEYEVENTF_KEYUP),
                       KeyInput(modifier, 0, KEYEVENTF_KEYUP)};
    ::SendInput(4, inputs, sizeof(INPUT));
}

void TourInput::Type(const std::string& text)
{
    for (const char c : text) {
        const WORD unit = static_cast<unsigned char>(c);
        SendKey(0, unit, KEYEVENTF_UNICODE);
        SendKey(0, unit, KEYEVENTF_UNICODE | KEYEVENTF_KEYUP);
    }
}
