// Tavo_WiScroll: the direction and the amount of a programmatic scroll
// (Tavo_WiScrollWnd::ScrollWindow and ScrollWindowTest), and the bars' limit.
#pragma once

namespace Tavo_WiScroll {

// The longest scroll bar range; longer scroll-unit ranges are compressed by a
// scale factor onto it.
constexpr int MaxBarRange = 32767;

// Which bar a scroll moves, and which way: Left and Up go backwards (towards
// the range minimum, or the range maximum for y in inverted-Y mode), Right and
// Down forwards.
enum Dir {
    Left = 0,
    Right = 1,
    Up = 2,
    Down = 3
};

// How far a scroll goes.
enum Amount {
    Line = 0,   // one line delta
    Page = 1,   // one page delta
    Limit = 2,  // to the end of the range in that direction
    Percent = 3 // a percentage of the window extent, given as the third argument
};

} // namespace Tavo_WiScroll
