// SamplePrintJob: prints a drawing over a grid of pages on the default
// printer, as a host application drives a drawing window's print protocol:
// the window lays out the pages from what it shows, the job takes the
// dialog's all-pages choice without showing it, and every page goes to a
// PostScript file.
#pragma once

#include <string>

class Tavo_GrDrawing;

struct SamplePrintResult {
    int columns = 0;
    int rows = 0;
    int currentPage = 0;
    int pagesPrinted = 0;
};

// Prints drawing as a drawing window of windowWidth x windowHeight pixels at
// zoom level zoomLevel (0: the whole drawing) shows it, into the file output
// (a Windows path). An empty string on success, else what failed.
std::string PrintSampleGrid(Tavo_GrDrawing& drawing, int windowWidth, int windowHeight, int zoomLevel,
                            const std::string& output, SamplePrintResult& result);
