#include "ViewerDocument.h"

#include "SampleDrawing.h"

#include "Tavo_DxfImport.h"
#include "Tavo_DxfPaletteColours.h"
#include "Tavo_WiLibrary.h"

#include <windows.h>

namespace {

// The name of the file without its folder; a path that names a folder is
// named whole.
std::string FileNameOf(const std::string& path)
{
    const size_t slash = path.find_last_of("\\/:");
    if (slash == std::string::npos || slash + 1 == path.size())
        return path;
    return path.substr(slash + 1);
}

// Why the file cannot be opened for reading; empty when it can.
std::string UnreadableReason(const std::string& path)
{
    const HANDLE file = ::CreateFileA(path.c_str(), GENERIC_READ, FILE_SHARE_READ, nullptr, OPEN_EXISTING,
                                      FILE_ATTRIBUTE_NORMAL, nullptr);
    if (file != INVALID_HANDLE_VALUE) {
        ::CloseHandle(file);
        return std::string();
    }
    switch (::GetLastError()) {
    case ERROR_FILE_NOT_FOUND:
    case ERROR_PATH_NOT_FOUND: return "there is no such file";
    case ERROR_ACCESS_DENIED: return "access is denied (a folder, or a file without read permission)";
    default: return "it cannot be read";
    }
}

} // namespace

std::unique_ptr<ViewerDocument> MakeSampleDocument()
{
    auto document = std::make_unique<ViewerDocument>("Sample drawing");
    BuildSampleDrawing(document->GetDrawing());
    return document;
}

OpenDrawingResult OpenDrawing(const std::string& path)
{
    OpenDrawingResult result;
    const std::string name = FileNameOf(path);
    if (path.empty()) {
        result.error = "No file name was given.";
        return result;
    }
    const std::string unreadable = UnreadableReason(path);
    if (!unreadable.empty()) {
        result.error = "Cannot open " + name + ": " + unreadable + ".";
        return result;
    }
    auto document = std::make_unique<ViewerDocument>(name);
    // DXF colours become palette entries of the library's palette.
    Tavo_DxfPaletteColours colours(*Tavo_WiLibrary::GetPalette());
    const Tavo_DxfImportResult imported = Tavo_DxfImportFile(path.c_str(), document->GetDrawing(), colours);
    if (!imported.ok) {
        result.error = "Cannot open " + name + ": " + imported.error.text +
            (imported.error.line > 0 ? " (line " + std::to_string(imported.error.line) + ")." : ".");
        return result;
    }
    for (const Tavo_DxfMessage& warning : imported.warnings)
        result.warnings.push_back(warning.line > 0 ? "line " + std::to_string(warning.line) + ": " + warning.text
                                                   : warning.text);
    DrawingUnits units;
    units.scale = imported.scale;
    units.originX = imported.originX;
    units.originY = imported.originY;
    document->SetUnits(units);
    result.document = std::move(document);
    return result;
}
