// The hand-written comparison renderer: one GDI call per primitive, a pen and a
// brush created and selected whenever the colour or fill changes, as a typical
// view's drawing code does it.
#pragma once

#include "BenchDrawing.h"

#include <windows.h>

#include <vector>

class Tavo_GrTransform;

void DrawPerPrimitive(HDC dc, const std::vector<BenchPrimitive>& primitives, const Tavo_GrTransform& transform,
                      int deviceHeight);
