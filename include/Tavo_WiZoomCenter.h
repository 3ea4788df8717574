// Tavo_WiZoomCenter: where a zoom started by Tavo_WiDrawWnd::ZoomWindow is
// centred.
#pragma once

namespace Tavo_WiZoomCenter {

enum Type {
    AtCursor = 0,     // the pointer's current position over the scrollee
    AtViewCentre = 1, // no point: the middle of the view (of the drawing at the zero level)
    AtPoint = 2       // the device point given to ZoomWindow
};

} // namespace Tavo_WiZoomCenter
