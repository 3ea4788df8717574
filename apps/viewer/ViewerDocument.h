// ViewerDocument: the drawing the viewer shows, its name and its units.
// OpenDrawing: reads a drawing file into a new document.
#pragma once

#include "DrawingUnits.h"

#include "Tavo_GrDrawing.h"

#include <memory>
#include <string>
#include <vector>

class ViewerDocument {
public:
    explicit ViewerDocument(std::string name) : m_name(std::move(name)) {}
    ViewerDocument(const ViewerDocument&) = delete;
    ViewerDocument& operator=(const ViewerDocument&) = delete;

    Tavo_GrDrawing& GetDrawing() { return m_drawing; }
    const Tavo_GrDrawing& GetDrawing() const { return m_drawing; }
    // The file name without its folder, or "Sample drawing".
    const std::string& GetName() const { return m_name; }
    const DrawingUnits& GetUnits() const { return m_units; }
    void SetUnits(const DrawingUnits& units) { m_units = units; }

private:
    std::string m_name;
    DrawingUnits m_units;
    Tavo_GrDrawing m_drawing;
};

// The built-in sample drawing (every primitive kind, colours, fills, text).
std::unique_ptr<ViewerDocument> MakeSampleDocument();

struct OpenDrawingResult {
    std::unique_ptr<ViewerDocument> document; // null when the file was refused
    std::string error;                        // why it was refused
    std::vector<std::string> warnings;        // what was skipped, one line each
};

// Reads the DXF drawing file at path (a Windows path) into a new document,
// in the importer's world units (DrawingUnits maps them back to the file's).
// A file that cannot be read or that the importer refuses is refused with a
// message that names the file and says why; entities the importer skipped
// are listed as warnings. A drawing with nothing to draw opens empty.
OpenDrawingResult OpenDrawing(const std::string& path);
