// Tavo_DxfImport: reads an ASCII DXF drawing (R12 and later) into a drawing of
// the graphics core.
//
// Classes: Tavo_DxfLimits (what an import may cost), Tavo_DxfMessage (an error
// or a warning with its line), Tavo_DxfImportResult (what came of an import).
//
//     Tavo_GrDrawing drawing;
//     Tavo_DxfPaletteColours colours(*Tavo_WiLibrary::GetPalette());
//     Tavo_DxfImportResult result = Tavo_DxfImportFile("plan.dxf", drawing, colours);
//     if (!result.ok) report(result.error.line, result.error.text);
//
// What is read: the LAYER table (one core layer per DXF layer, in table order;
// frozen and switched-off layers are made invisible), the BLOCKS section and the
// ENTITIES section. LINE, LWPOLYLINE, POLYLINE (2-D and 3-D; bulges become arcs),
// CIRCLE, ARC, ELLIPSE, TEXT, MTEXT, SOLID, TRACE, POINT and INSERT become core
// items; arcs and ellipses become polylines. An INSERT is expanded: the block's
// entities are placed with the insert's scale, rotation and column/row array,
// nested inserts included. Every other entity is skipped with a warning that
// names it; every other section is skipped.
//
// Coordinates: the extents of everything drawn are measured first; the world of
// the core drawing is the drawing's coordinates, with the middle of the extents
// at 0, multiplied by a power of ten chosen so that the longer side of the
// extents spans between kWorldSpan / 10 and kWorldSpan units. That keeps detail
// down to a hundred-millionth of the drawing and every coordinate far from the
// int range's ends.
//
// Colours: ACI colours and true colours become RGB values, which the caller's
// Tavo_DxfColourResolver turns into palette indices. ACI 7 (white on a dark
// screen, black on paper) is drawn black, since drawings are shown on white.
//
// Text: TEXT and MTEXT become texts at a point, horizontal (the core has no
// rotated text), with their height and the nearest alignment the core has.
// MTEXT is split into lines at its paragraph breaks and its formatting codes
// are removed. Texts reach the core in the Windows-1252 code page; characters
// outside it become '?'.
//
// Bad input never crashes the importer, never makes it loop without end and
// never lets it use memory beyond the limits:
//  - refused, with the line number, and the drawing left untouched: a group
//    code that is not a number, a file that ends before its EOF marker (or in
//    the middle of a group), binary DXF, a file larger than maxInputBytes, a
//    drawing that would expand to more items, points, text or work than the
//    limits allow;
//  - skipped with a warning that names the entity and its line: unknown
//    entities, entities with numbers that are not finite or absurdly large,
//    negative radii, zero insert scales, inserts of undefined blocks, cyclic
//    block references, inserts nested deeper than maxInsertDepth.
#pragma once

#include "Tavo_DxfColours.h"

#include <cstddef>
#include <string>
#include <vector>

class Tavo_GrDrawing;

// What one import may cost. The defaults suit drawings of up to a few hundred
// megabytes of core data; a caller may lower them (the fuzzer does).
struct Tavo_DxfLimits {
    // Larger files are refused before anything is read.
    size_t maxInputBytes = 128u * 1024 * 1024;
    // Core items (lines, polylines, texts ...) after every insert is expanded.
    long long maxItems = 4000000;
    // Points of those items (a line has 2, a polyline one per vertex).
    long long maxPoints = 24000000;
    // Bytes of text of those items.
    long long maxTextBytes = 32 * 1024 * 1024;
    // Entities visited while expanding inserts, drawn or not: bounds the time
    // spent on arrays and nests of inserts of empty blocks.
    long long maxWork = 20000000;
    // Inserts inside blocks inside inserts ... deeper ones are skipped.
    int maxInsertDepth = 16;
    // Distinct warnings kept; further ones are only counted.
    int maxWarnings = 200;
};

struct Tavo_DxfMessage {
    int line = 0; // 1-based line of the DXF file; 0 when no line applies
    std::string text;
};

struct Tavo_DxfImportResult {
    // The longer side of the extents spans at most this many world units.
    static constexpr double kWorldSpan = 268435456.0; // 2^28

    bool ok = false;
    Tavo_DxfMessage error; // when !ok
    // Skipped entities and other things the caller may want to know, in the
    // order met; one per kind of problem and entity type, with a count.
    std::vector<Tavo_DxfMessage> warnings;
    int droppedWarnings = 0; // beyond Tavo_DxfLimits::maxWarnings

    std::string version;     // $ACADVER, e.g. "AC1015"; empty when absent
    int entitiesRead = 0;    // entities of the ENTITIES section
    int entitiesSkipped = 0; // of those and of the blocks they insert
    long long itemsMade = 0; // core items added to the drawing
    int layersMade = 0;

    // world = (drawing coordinate - origin) * scale, on both axes.
    double scale = 1.0;
    double originX = 0.0;
    double originY = 0.0;
};

// Reads the DXF text in data[0 .. size) into drawing, which should be empty:
// its layers and items are appended. On failure (result.ok false) nothing is
// added to drawing.
Tavo_DxfImportResult Tavo_DxfImport(const char* data, size_t size, Tavo_GrDrawing& drawing,
                                    Tavo_DxfColourResolver& colours, const Tavo_DxfLimits& limits = Tavo_DxfLimits());

// The same for a file; a file that cannot be read, or is larger than
// limits.maxInputBytes, is refused with line 0.
Tavo_DxfImportResult Tavo_DxfImportFile(const char* path, Tavo_GrDrawing& drawing, Tavo_DxfColourResolver& colours,
                                        const Tavo_DxfLimits& limits = Tavo_DxfLimits());
