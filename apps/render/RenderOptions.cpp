#include "RenderOptions.h"

#include <cerrno>
#include <cstdlib>
#include <cstring>

namespace {

bool ParseInt(const char* text, int lowest, int highest, int& value)
{
    if (!text || !*text)
        return false;
    char* end = nullptr;
    errno = 0;
    const long number = std::strtol(text, &end, 10);
    if (errno != 0 || *end != '\0' || number < lowest || number > highest)
        return false;
    value = static_cast<int>(number);
    return true;
}

} // namespace

const char* RenderUsage()
{
    return "usage: render [--width N] [--height N] [--zoom L] [--dxf FILE.dxf] [--output FILE.png | --print FILE.ps]\n"
           "  Draws the built-in sample drawing (or a DXF drawing) through the GDI\n"
           "  rendering surface into a 32-bit bitmap and writes it as a PNG, or prints\n"
           "  the sample drawing's page grid.\n"
           "  --width, --height  picture size in pixels (default 1600 x 1000, at most\n"
           "                     16384 a side and 64 megapixels in all); when printing,\n"
           "                     the size of the drawing window whose view is printed\n"
           "  --zoom             zoom level about the drawing's centre: 0 fits the whole\n"
           "                     drawing, each 5 levels double the scale (default 0, at most 50)\n"
           "  --dxf              import this ASCII DXF file and draw it instead\n"
           "  --output           the PNG file to write (default sample.png)\n"
           "  --print            print instead: the page grid of what a drawing window\n"
           "                     shows at that zoom level, on the default printer, into\n"
           "                     this PostScript file (a Windows path, such as Z:\\tmp\\grid.ps)\n";
}

bool ParseRenderOptions(int argc, char** argv, RenderOptions& options, std::string& error)
{
    for (int i = 1; i < argc; ++i) {
        const char* name = argv[i];
        if (std::strcmp(name, "--help") == 0 || std::strcmp(name, "-h") == 0) {
            options.help = true;
            continue;
        }
        const char* value = i + 1 < argc ? argv[i + 1] : nullptr;
        bool ok = false;
        if (std::strcmp(name, "--width") == 0)
            ok = ParseInt(value, 1, RenderOptions::kLargestSide, options.width);
        else if (std::strcmp(name, "--height") == 0)
            ok = ParseInt(value, 1, RenderOptions::kLargestSide, options.height);
        else if (std::strcmp(name, "--zoom") == 0)
            ok = ParseInt(value, 0, RenderOptions::kLargestZoom, options.zoom);
        else if (std::strcmp(name, "--output") == 0 && value && *value) {
            options.output = value;
            ok = true;
        } else if (std::strcmp(name, "--dxf") == 0 && value && *value) {
            options.dxf = value;
            ok = true;
        } else if (std::strcmp(name, "--print") == 0 && value && *value) {
            options.print = value;
            ok = true;
        } else {
            error = std::string("unknown option ") + name;
            return false;
        }
        if (!ok) {
            error = std::string("bad or missing value for ") + name;
            return false;
        }
        ++i;
    }
    if (static_cast<long long>(options.width) * options.height > RenderOptions::kLargestArea) {
        error = "the picture is too large";
        return false;
    }
    return true;
}
