// Picture: the pixels of a PNG file, read through the platform's imaging
// component, for the print tests that look at pages Ghostscript rendered.
#pragma once

#include <windows.h>

#include <string>
#include <vector>

namespace DrawWndTest {

struct Picture {
    int width = 0;
    int height = 0;
    std::vector<COLORREF> pixels; // rows top to bottom

    // The pixel, or CLR_INVALID outside the picture.
    COLORREF At(int x, int y) const
    {
        return x < 0 || y < 0 || x >= width || y >= height ? CLR_INVALID : pixels[static_cast<size_t>(y) * width + x];
    }
};

// Reads a PNG file; false when it cannot be read.
bool ReadPng(const std::string& path, Picture& picture);

} // namespace DrawWndTest
