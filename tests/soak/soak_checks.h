// What a user relies on in a drawing window's view, checked after every
// soak step and by the test cases of the faults the soak found.
#pragma once

#include "soak_window.h"

#include <string>

namespace Soak {

// Empty when the view holds: a bound window has a mapping and an unbound
// one none; the zoom level lies within its limits; and, while the window is
// shown with an area, the scroll position lies inside its range, the mapping
// is sized to the scrollee, the world clip box spans the scrollee's pixels at
// the mapping's scale (cut where it reaches beyond the int range), the scroll
// extent is the view's size, the whole drawing is in view at the zero level,
// and zoomed in the view's top-left corner is where the scroll position puts
// it. Otherwise what does not hold.
std::string CheckView(SoakHost& host);
// The client size, the bars, the mapping's size, scale and level and the
// drawing's bounds, for a report.
std::string DescribeView(SoakHost& host);

} // namespace Soak
