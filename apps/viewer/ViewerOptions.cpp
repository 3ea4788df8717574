#include "ViewerOptions.h"

#include <cstring>

bool ParseViewerOptions(int argc, char** argv, ViewerOptions& options, std::string& error)
{
    for (int i = 1; i < argc; ++i) {
        const char* argument = argv[i];
        if (std::strcmp(argument, "--help") == 0 || std::strcmp(argument, "-h") == 0) {
            options.help = true;
        } else if (std::strcmp(argument, "--tour") == 0) {
            if (i + 1 >= argc || !*argv[i + 1]) {
                error = "--tour needs the folder for its pictures";
                return false;
            }
            options.tourFolder = argv[++i];
        } else if (argument[0] == '-' && argument[1] == '-') {
            error = std::string("unknown option ") + argument;
            return false;
        } else if (options.file.empty()) {
            options.file = argument;
        } else {
            error = "more than one file given";
            return false;
        }
    }
    if (!options.tourFolder.empty() && options.file.empty()) {
        error = "--tour needs a drawing file to open";
        return false;
    }
    return true;
}

const char* ViewerUsage()
{
    return "usage: viewer [FILE]\n"
           "       viewer --tour OUTDIR FILE\n"
           "  Shows a drawing (FILE, or the built-in sample drawing) in a window:\n"
           "  click names what lies under the pointer, double click and the wheel zoom\n"
           "  at the pointer, a drag pans, Shift + drag zooms to a rectangle, resting\n"
           "  the pointer shows a data tip; + - Home Backspace arrows Page Up/Down;\n"
           "  File > Open, Print, Export view as PNG.\n"
           "  --tour  drives the viewer through a scripted session on FILE with real\n"
           "          input and writes a PNG of each step and the print job into OUTDIR\n";
}
