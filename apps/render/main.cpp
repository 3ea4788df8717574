// render: draws the built-in sample drawing, or a DXF drawing, through the GDI
// rendering surface into a 32-bit DIB section and writes it as a PNG, or prints
// the sample drawing's page grid on the default printer.
#include "DibCanvas.h"
#include "PngWriter.h"
#include "RenderOptions.h"
#include "SampleDrawing.h"
#include "SamplePrintJob.h"

#include "Tavo_DxfImport.h"
#include "Tavo_DxfPaletteColours.h"
#include "Tavo_GrDrawing.h"
#include "Tavo_GrMapping.h"
#include "Tavo_WiLibrary.h"
#include "Tavo_WiWin32Surface.h"

#include <cstdio>
#include <string>

namespace {

// Zoom levels per doubling of the scale, as the drawing window uses them.
const int kLevelsPerDoubling = 5;

const char* const kCounterNames[Tavo_GrSurfaceStats::CounterCount] = {
    "attribute changes",
    "dots",
    "polylines",
    "lines",
    "hollow triangles",
    "hollow rectangles",
    "polygons",
    "filled triangles",
    "filled rectangles",
    "circles",
    "texts",
    "grids",
    "calls",
};

void PrintStats(const Tavo_GrSurfaceStats& stats)
{
    for (int i = 0; i < Tavo_GrSurfaceStats::CounterCount; ++i)
        if (stats.m_counters[i] != 0)
            std::printf("  %-18s %u\n", kCounterNames[i], static_cast<unsigned>(stats.m_counters[i]));
}

// Imports the DXF file into the drawing and says how it went; false when the
// file was refused.
bool ImportDxf(const std::string& path, Tavo_GrDrawing& drawing)
{
    Tavo_DxfPaletteColours colours(*Tavo_WiLibrary::GetPalette());
    const Tavo_DxfImportResult result = Tavo_DxfImportFile(path.c_str(), drawing, colours);
    for (const Tavo_DxfMessage& warning : result.warnings)
        std::printf("render: %s: warning: %s\n", path.c_str(), warning.text.c_str());
    if (!result.ok) {
        std::fprintf(stderr, "render: %s: line %d: %s\n", path.c_str(), result.error.line, result.error.text.c_str());
        return false;
    }
    std::printf("render: %s: %lld items on %d layers, %g world units per drawing unit\n", path.c_str(),
                result.itemsMade, result.layersMade, result.scale);
    return true;
}

int Render(const RenderOptions& options)
{
    Tavo_GrDrawing drawing;
    if (options.dxf.empty())
        BuildSampleDrawing(drawing);
    else if (!ImportDxf(options.dxf, drawing))
        return 1;

    Tavo_GrMapping mapping(&drawing, kLevelsPerDoubling);
    mapping.SetDeviceWindowSize(options.width, options.height, true, nullptr);
    if (options.zoom > 0) {
        const Tavo_GrWRect bounds = drawing.GetBounds();
        const int cx = bounds.x1 + (bounds.x2 - bounds.x1) / 2;
        const int cy = bounds.y1 + (bounds.y2 - bounds.y1) / 2;
        mapping.Zoom(Tavo_GrZoom::ToLevel, cx, cy, options.zoom);
    }

    DibCanvas canvas(options.width, options.height, RGB(255, 255, 255));
    if (!canvas.IsValid()) {
        std::fprintf(stderr, "render: could not create a %d x %d bitmap\n", options.width, options.height);
        return 1;
    }
    Tavo_WiWin32Surface surface;
    surface.SetDC(canvas.GetDC());
    drawing.Draw(surface, mapping, nullptr);

    const std::string failure = WritePng(canvas, options.output);
    if (!failure.empty()) {
        std::fprintf(stderr, "render: %s: %s\n", options.output.c_str(), failure.c_str());
        return 1;
    }
    std::printf("render: wrote %s (%d x %d pixels, zoom level %d, scale %.4f pixels per world unit, %d items)\n",
                options.output.c_str(), options.width, options.height, mapping.GetZoomLevel(),
                mapping.GetTransform().GetScale(), drawing.GetItemCount());
    Tavo_GrSurfaceStats stats;
    surface.FetchStats(stats);
    std::printf("render: emitted by the surface:\n");
    PrintStats(stats);
    return 0;
}

int Print(const RenderOptions& options)
{
    Tavo_GrDrawing drawing;
    BuildSampleDrawing(drawing);
    SamplePrintResult result;
    const std::string failure =
        PrintSampleGrid(drawing, options.width, options.height, options.zoom, options.print, result);
    if (!failure.empty()) {
        std::fprintf(stderr, "render: printing to %s: %s\n", options.print.c_str(), failure.c_str());
        return 1;
    }
    std::printf("render: printed %d pages (%d columns x %d rows, current page %d, zoom level %d) to %s\n",
                result.pagesPrinted, result.columns, result.rows, result.currentPage, options.zoom,
                options.print.c_str());
    return 0;
}

} // namespace

int main(int argc, char** argv)
{
    RenderOptions options;
    std::string error;
    if (!ParseRenderOptions(argc, argv, options, error)) {
        std::fprintf(stderr, "render: %s\n%s", error.c_str(), RenderUsage());
        return 2;
    }
    if (options.help) {
        std::printf("%s", RenderUsage());
        return 0;
    }
    Tavo_WiLibrary::Initialize();
    const int status = options.print.empty() ? Render(options) : Print(options);
    Tavo_WiLibrary::Terminate(false);
    return status;
}
