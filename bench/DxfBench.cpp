// dxf_bench: how fast DXF drawings are imported and first painted.
//
// Takes the largest DXF files under a folder (by default the librecad-data
// drawings), and for each, several runs of:
//   import   Tavo_DxfImport from the file's bytes in memory (reading the file
//            is not timed), reported as milliseconds per megabyte of DXF;
//   zero     the first paint of the fresh drawing at the zero level (the whole
//            drawing) through the GDI surface into a 1920 x 1080 DIB section;
//            it includes building the drawing's spatial index;
//   deep     the first paint at a deep zoom level (16 times the fit), about
//            the busiest part of the drawing: the cell of a 16 x 16 grid over
//            the zero-level picture with the most drawn pixels (title sheets
//            are mostly empty paper; a view of their middle shows nothing).
// It prints the median and the smallest time of each, per file and summed.
#include "DibCanvas.h"

#include "Tavo_DxfImport.h"
#include "Tavo_DxfPaletteColours.h"
#include "Tavo_GrDrawing.h"
#include "Tavo_GrMapping.h"
#include "Tavo_WiLibrary.h"
#include "Tavo_WiWin32Surface.h"

#include <windows.h>

#include <algorithm>
#include <cerrno>
#include <cstdio>
#include <cstdlib>
#include <cstring>
#include <fstream>
#include <iterator>
#include <memory>
#include <string>
#include <vector>

namespace {

const char* const kDefaultFolder = "Z:/usr/share/librecad";
const int kDefaultFiles = 10;
const int kDefaultRuns = 5;
const int kLevelsPerDoubling = 5;
const int kDeepLevel = 20; // 2^4: the drawing 16 times the size of the fit
const int kGridCells = 16; // per axis: one cell is what the deep zoom shows
const int kWidth = 1920;
const int kHeight = 1080;
const double kBytesPerMegabyte = 1024.0 * 1024.0;

struct Options {
    std::string folder = kDefaultFolder;
    int files = kDefaultFiles;
    int runs = kDefaultRuns;
};

bool ParseCount(const char* text, int& value)
{
    char* end = nullptr;
    errno = 0;
    const long number = std::strtol(text, &end, 10);
    if (errno != 0 || *end != '\0' || number < 1 || number > 10000)
        return false;
    value = static_cast<int>(number);
    return true;
}

bool ParseOptions(int argc, char** argv, Options& options)
{
    for (int i = 1; i < argc; i += 2) {
        if (i + 1 >= argc)
            return false;
        const char* name = argv[i];
        const char* value = argv[i + 1];
        if (std::strcmp(name, "--folder") == 0)
            options.folder = value;
        else if (std::strcmp(name, "--files") == 0 && ParseCount(value, options.files))
            continue;
        else if (std::strcmp(name, "--runs") == 0 && ParseCount(value, options.runs))
            continue;
        else
            return false;
    }
    return true;
}

class Stopwatch {
public:
    Stopwatch() { QueryPerformanceCounter(&m_start); }
    double Milliseconds() const
    {
        LARGE_INTEGER now, frequency;
        QueryPerformanceCounter(&now);
        QueryPerformanceFrequency(&frequency);
        return 1000.0 * static_cast<double>(now.QuadPart - m_start.QuadPart) / static_cast<double>(frequency.QuadPart);
    }

private:
    LARGE_INTEGER m_start;
};

double Median(std::vector<double> values)
{
    std::sort(values.begin(), values.end());
    const size_t n = values.size();
    return n % 2 ? values[n / 2] : (values[n / 2 - 1] + values[n / 2]) / 2.0;
}

double Smallest(const std::vector<double>& values)
{
    return *std::min_element(values.begin(), values.end());
}

struct SampleFile {
    std::string path;
    unsigned long long size = 0;
};

// Every .dxf file under the folder, largest first.
std::vector<SampleFile> LargestFiles(const std::string& folder, int count)
{
    std::vector<SampleFile> found;
    std::vector<std::string> pending{folder};
    while (!pending.empty()) {
        const std::string dir = pending.back();
        pending.pop_back();
        WIN32_FIND_DATAA entry;
        HANDLE search = FindFirstFileA((dir + "\\*").c_str(), &entry);
        if (search == INVALID_HANDLE_VALUE)
            continue;
        do {
            const std::string name = entry.cFileName;
            if (name == "." || name == "..")
                continue;
            if (entry.dwFileAttributes & FILE_ATTRIBUTE_DIRECTORY) {
                pending.push_back(dir + "\\" + name);
            } else if (name.size() > 4 && _stricmp(name.c_str() + name.size() - 4, ".dxf") == 0) {
                const unsigned long long size = (static_cast<unsigned long long>(entry.nFileSizeHigh) << 32) | entry.nFileSizeLow;
                found.push_back({dir + "\\" + name, size});
            }
        } while (FindNextFileA(search, &entry));
        FindClose(search);
    }
    std::sort(found.begin(), found.end(), [](const SampleFile& a, const SampleFile& b) {
        return a.size != b.size ? a.size > b.size : a.path < b.path;
    });
    if (static_cast<int>(found.size()) > count)
        found.resize(count);
    return found;
}

// The time of one paint; `primitives` grows by what the surface drew.
double Paint(const Tavo_GrDrawing& drawing, const Tavo_GrMapping& mapping, DibCanvas& canvas, long long& primitives)
{
    canvas.Fill(RGB(255, 255, 255));
    Tavo_WiWin32Surface surface;
    surface.SetDC(canvas.GetDC());
    Stopwatch watch;
    drawing.Draw(surface, mapping, nullptr);
    GdiFlush();
    const double milliseconds = watch.Milliseconds();
    Tavo_GrSurfaceStats stats;
    surface.FetchStats(stats);
    for (int i = 1; i < Tavo_GrSurfaceStats::CounterCount; ++i) // all but attribute changes
        primitives += stats.m_counters[i];
    return milliseconds;
}

// The world point at the middle of the grid cell of the picture on the canvas
// with the most pixels that are not white.
Tavo_GrWPoint BusiestPoint(const DibCanvas& canvas, const Tavo_GrMapping& mapping)
{
    const int cellWidth = std::max(1, canvas.GetWidth() / kGridCells);
    const int cellHeight = std::max(1, canvas.GetHeight() / kGridCells);
    int best = -1;
    int bestColumn = kGridCells / 2;
    int bestRow = kGridCells / 2;
    for (int row = 0; row < kGridCells; ++row) {
        for (int column = 0; column < kGridCells; ++column) {
            const int left = column * cellWidth;
            const int top = row * cellHeight;
            const int drawn = cellWidth * cellHeight - canvas.CountPixels(RGB(255, 255, 255), left, top, left + cellWidth, top + cellHeight);
            if (drawn > best) {
                best = drawn;
                bestColumn = column;
                bestRow = row;
            }
        }
    }
    // Device coordinates of the core have y up from the bottom edge.
    const Tavo_GrDPoint centre{bestColumn * cellWidth + cellWidth / 2,
                               canvas.GetHeight() - (bestRow * cellHeight + cellHeight / 2)};
    return mapping.GetTransform().InvertPoint(centre);
}

struct Timings {
    std::vector<double> import, zero, deep;
};

} // namespace

int main(int argc, char** argv)
{
    Options options;
    if (!ParseOptions(argc, argv, options)) {
        std::fprintf(stderr, "usage: dxf_bench [--folder DIR] [--files N] [--runs R]\n");
        return 2;
    }
    Tavo_WiLibrary::Initialize();
    const std::vector<SampleFile> files = LargestFiles(options.folder, options.files);
    if (files.empty()) {
        std::fprintf(stderr, "dxf_bench: no .dxf files under %s\n", options.folder.c_str());
        return 1;
    }
    DibCanvas canvas(kWidth, kHeight);
    Tavo_DxfPaletteColours colours(*Tavo_WiLibrary::GetPalette());
    std::printf("dxf_bench: %zu largest drawings under %s, %d runs each, paints %d x %d, deep zoom level %d\n",
                files.size(), options.folder.c_str(), options.runs, kWidth, kHeight, kDeepLevel);
    std::printf("%-24s %6s %6s | %9s %7s | %8s %7s %6s | %8s %7s %6s\n", "file", "KB", "items", "import ms",
                "ms/MB", "zero ms", "(min)", "drawn", "deep ms", "(min)", "drawn");

    double totalBytes = 0.0;
    double totalImport = 0.0, totalZero = 0.0, totalDeep = 0.0;
    for (const SampleFile& file : files) {
        std::ifstream in(file.path, std::ios::binary);
        const std::string text((std::istreambuf_iterator<char>(in)), std::istreambuf_iterator<char>());
        Timings timings;
        long long items = 0;
        long long zeroDrawn = 0;
        long long deepDrawn = 0;
        for (int run = 0; run < options.runs; ++run) {
            auto drawing = std::make_unique<Tavo_GrDrawing>();
            Stopwatch watch;
            const Tavo_DxfImportResult result = Tavo_DxfImport(text.data(), text.size(), *drawing, colours);
            timings.import.push_back(watch.Milliseconds());
            if (!result.ok) {
                std::fprintf(stderr, "dxf_bench: %s refused: line %d: %s\n", file.path.c_str(), result.error.line,
                             result.error.text.c_str());
                return 1;
            }
            items = result.itemsMade;
            Tavo_GrMapping mapping(drawing.get(), kLevelsPerDoubling);
            mapping.SetDeviceWindowSize(kWidth, kHeight, true, nullptr);
            zeroDrawn = 0;
            timings.zero.push_back(Paint(*drawing, mapping, canvas, zeroDrawn));
            const Tavo_GrWPoint busiest = BusiestPoint(canvas, mapping);
            mapping.Zoom(Tavo_GrZoom::ToLevel, busiest.x, busiest.y, kDeepLevel);
            deepDrawn = 0;
            timings.deep.push_back(Paint(*drawing, mapping, canvas, deepDrawn));
        }
        const double megabytes = text.size() / kBytesPerMegabyte;
        const double import = Median(timings.import);
        std::string name = file.path.substr(file.path.find_last_of("\\/") + 1);
        std::printf("%-24s %6.0f %6lld | %9.2f %7.1f | %8.2f %7.2f %6lld | %8.3f %7.3f %6lld\n", name.c_str(),
                    text.size() / 1024.0, items, import, import / megabytes, Median(timings.zero),
                    Smallest(timings.zero), zeroDrawn, Median(timings.deep), Smallest(timings.deep),
                    deepDrawn);
        totalBytes += text.size();
        totalImport += import;
        totalZero += Median(timings.zero);
        totalDeep += Median(timings.deep);
    }
    std::printf("all: %.2f MB imported in %.1f ms (median sums): %.1f ms per MB; first paints: zero level %.1f ms, "
                "deep zoom %.2f ms\n",
                totalBytes / kBytesPerMegabyte, totalImport, totalImport / (totalBytes / kBytesPerMegabyte), totalZero,
                totalDeep);
    Tavo_WiLibrary::Terminate(false);
    return 0;
}
