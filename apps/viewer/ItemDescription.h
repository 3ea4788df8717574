// ItemDescription: the words the viewer uses for what lies under the pointer,
// in the status bar after a click and in the data tip.
//
//     Layer "WALLS": line, 1200 x 30
//     Layer "TEXT": text "Kitchen", 32 x 4 (and 2 more)
//     Nothing here
//
// The item named is the topmost one (the last drawn); the size is its world
// bounds in drawing units.
#pragma once

#include "DrawingUnits.h"

#include "Tavo_GrDrawing.h"

#include <string>

namespace ItemDescription {

// "line", "filled polygon", "text" ...
std::string KindName(Tavo_GrItemKind kind, bool filled);

// The description of the topmost item of count items found.
std::string Describe(const Tavo_GrItemInfo& topmost, int count, const DrawingUnits& units);

// "Nothing here" when nothing lies in the aperture, else the description of
// the topmost item found there.
std::string DescribeAperture(const Tavo_GrDrawing& drawing, const Tavo_GrWRect& aperture, const DrawingUnits& units);

} // namespace ItemDescription
