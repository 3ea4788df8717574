// dxf_check: imports (and draws) each DXF file named on the command line or
// listed, one path a line, in the file given with --list, and prints one line
// per file: "ok" with its item count, or "refused" with the error. Ends with
// the counts. Exits non-zero only when a file cannot be read.
#include "NativeImport.h"

#include <cstdio>
#include <cstring>
#include <fstream>
#include <iterator>
#include <string>
#include <vector>

int main(int argc, char** argv)
{
    std::vector<std::string> paths;
    bool verbose = false;
    for (int i = 1; i < argc; ++i) {
        if (std::strcmp(argv[i], "--list") == 0 && i + 1 < argc) {
            std::ifstream list(argv[++i]);
            std::string line;
            while (std::getline(list, line))
                if (!line.empty())
                    paths.push_back(line);
        } else if (std::strcmp(argv[i], "--verbose") == 0) {
            verbose = true;
        } else {
            paths.push_back(argv[i]);
        }
    }
    int imported = 0, refused = 0, unreadable = 0;
    for (const std::string& path : paths) {
        std::ifstream in(path, std::ios::binary);
        if (!in) {
            std::printf("unreadable %s\n", path.c_str());
            ++unreadable;
            continue;
        }
        const std::string text((std::istreambuf_iterator<char>(in)), std::istreambuf_iterator<char>());
        const Tavo_DxfImportResult result = ImportAndDraw(text.data(), text.size(), Tavo_DxfLimits());
        if (result.ok) {
            ++imported;
            std::printf("ok %s: %lld items, %d layers, %zu warnings, scale %g\n", path.c_str(), result.itemsMade,
                        result.layersMade, result.warnings.size(), result.scale);
        } else {
            ++refused;
            std::printf("refused %s: line %d: %s\n", path.c_str(), result.error.line, result.error.text.c_str());
        }
        if (verbose)
            for (const Tavo_DxfMessage& warning : result.warnings)
                std::printf("  warning: %s\n", warning.text.c_str());
    }
    std::printf("%d imported, %d refused, %d unreadable\n", imported, refused, unreadable);
    return unreadable == 0 ? 0 : 1;
}
