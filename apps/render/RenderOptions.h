// The command line of the render program.
#pragma once

#include <string>

struct RenderOptions {
    static constexpr int kDefaultWidth = 1600;
    static constexpr int kDefaultHeight = 1000;
    static constexpr int kLargestSide = 16384;
    static constexpr long long kLargestArea = 64LL * 1024 * 1024; // pixels
    static constexpr int kLargestZoom = 50;

    int width = kDefaultWidth;
    int height = kDefaultHeight;
    int zoom = 0; // zoom level: 0 fits the whole drawing
    std::string output = "sample.png";
    std::string dxf; // a DXF file to draw instead of the sample drawing
    // When set: print the drawing's page grid to this PostScript file instead
    // of writing the PNG.
    std::string print;
    bool help = false;
};

// Parses argv[1..]; on error returns false and sets `error` to what was wrong.
bool ParseRenderOptions(int argc, char** argv, RenderOptions& options, std::string& error);

// The usage text.
const char* RenderUsage();
