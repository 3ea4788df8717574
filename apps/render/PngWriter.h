// WritePng: saves a 32-bit top-down canvas as an opaque PNG file through the
// platform's imaging codecs (WIC).
#pragma once

#include <string>

class DibCanvas;

// Writes `canvas` to `path` (8-bit path, as the command line gives it).
// Returns an empty string on success, else a description of what failed.
std::string WritePng(const DibCanvas& canvas, const std::string& path);
