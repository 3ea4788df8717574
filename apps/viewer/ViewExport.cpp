#include "ViewExport.h"

#include "DibCanvas.h"
#include "DrawingView.h"
#include "PngWriter.h"
#include "ViewerSettings.h"

#include "Tavo_GrMapping.h"
#include "Tavo_WiWin32Surface.h"

std::string ExportViewPng(DrawingView& view, const std::string& path)
{
    const Tavo_GrMapping* mapping = view.GetMapping();
    if (!view.GetDrawing() || !mapping)
        return "there is no drawing to export";
    const int width = mapping->GetDeviceWindowWidth();
    const int height = mapping->GetDeviceWindowHeight();
    DibCanvas canvas(width, height, ViewerSettings::Background);
    if (!canvas.IsValid())
        return "no bitmap of " + std::to_string(width) + " x " + std::to_string(height) + " pixels";
    // A copy: the view's own mapping keeps the error terms of its scrolling.
    const Tavo_GrMapping picture(*mapping);
    Tavo_WiWin32Surface surface;
    surface.SetDC(canvas.GetDC());
    view.GetDrawing()->Draw(surface, picture, nullptr);
    return WritePng(canvas, path);
}
