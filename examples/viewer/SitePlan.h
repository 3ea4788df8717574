// The drawing the viewer shows: a small site plan made in code.
#pragma once

#include "Tavo_GrDrawing.h"

// Fills an empty drawing with the site plan. World units are metres, y up;
// the plan covers (0, 0) to (1200, 800) with the pond at its centre.
void BuildSitePlan(Tavo_GrDrawing& drawing);
