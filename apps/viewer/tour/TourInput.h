// TourInput: the tour's real input, sent through SendInput like a person's,
// every event with an explicit message time. Times follow the clock but
// never repeat or go back, so the drawing window's click and hold
// classification sees the intervals the tour means.
#pragma once

#include <windows.h>

#include <string>

class TourInput {
public:
    // The pointer to a screen point.
    void MoveTo(POINT screen);
    // Left button down or up at a screen point.
    void Press(POINT screen);
    // Shift down, then the left button at a screen point, in one go (see Key).
    void PressWithShift(POINT screen);
    void Release(POINT screen);
    // A click: press and release heldMs apart (message times).
    void Click(POINT screen, DWORD heldMs);
    // Wheel notches at a screen point: positive away from the user (zoom in).
    void Wheel(POINT screen, int notches);
    void KeyDown(WORD virtualKey);
    void KeyUp(WORD virtualKey);
    // A key pressed and released, with modifier held around it (0: none),
    // in one go: Wine brings its modifier keys in line with the X server's
    // whenever one of its windows gains the pointer or the focus, and must
    // find no gap between a modifier and its key to do that in.
    void Key(WORD virtualKey, WORD modifier = 0);
    // ASCII characters as typed (Unicode key events), one press and release each.
    void Type(const std::string& text);

private:
    // The message time of the next event: now, or one after the last.
    DWORD Stamp(DWORD later = 0);
    static INPUT MouseInput(DWORD flags, POINT screen, DWORD data, DWORD time);
    INPUT KeyInput(WORD virtualKey, WORD scan, DWORD flags);
    void SendMouse(DWORD flags, POINT screen, DWORD data, DWORD time);
    void SendKey(WORD virtualKey, WORD scan, DWORD flags);

    DWORD m_last = 0;
};
