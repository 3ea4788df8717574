// What the fuzz target and dxf_check share: a stand-in for the palette and an
// import followed by a drawing pass at the zero level and at a deep zoom, so
// that what the importer makes is drawn as a window would draw it.
#pragma once

#include "Tavo_DxfImport.h"
#include "Tavo_GrDrawing.h"
#include "Tavo_GrMapping.h"
#include "Tavo_GrSurface.h"

#include <cstddef>

// Sixteen colours, as the library's palette has built in; every colour maps
// onto one of them.
class NativeColours : public Tavo_DxfColourResolver {
public:
    char ColourIndexOf(const Tavo_DxfRgb& colour) override
    {
        return static_cast<char>((colour.red ^ colour.green ^ colour.blue) & 15);
    }
};

// The core's base surface draws nothing; its destructor is for subclasses.
class NativeSurface : public Tavo_GrSurface {
};

inline Tavo_DxfImportResult ImportAndDraw(const char* data, size_t size, const Tavo_DxfLimits& limits)
{
    Tavo_GrDrawing drawing;
    NativeColours colours;
    Tavo_DxfImportResult result = Tavo_DxfImport(data, size, drawing, colours, limits);
    if (!result.ok)
        return result;
    const int kLevelsPerDoubling = 5;
    const int kDeepLevel = 40;
    Tavo_GrMapping mapping(&drawing, kLevelsPerDoubling);
    mapping.SetDeviceWindowSize(800, 600, true, nullptr);
    NativeSurface surface;
    drawing.Draw(surface, mapping, nullptr);
    const Tavo_GrWRect bounds = drawing.GetBounds();
    mapping.Zoom(Tavo_GrZoom::ToLevel, bounds.x1 / 2 + bounds.x2 / 2, bounds.y1 / 2 + bounds.y2 / 2, kDeepLevel);
    drawing.Draw(surface, mapping, nullptr);
    return result;
}
