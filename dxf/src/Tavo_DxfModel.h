// The plain model a DXF file is parsed into (Tavo_DxfParser) before it is
// turned into a core drawing (Tavo_DxfConverter).
//
// Structs: Tavo_DxfPoint, Tavo_DxfVertex, Tavo_DxfEntity, Tavo_DxfLayer,
// Tavo_DxfBlock, Tavo_DxfModel.
//
// Numbers are as the file has them: coordinates in drawing units (points of
// most 2-D entities in the entity's object coordinate system, given by its
// extrusion direction), angles in degrees (ELLIPSE parameters in radians).
// Every number in the model is finite and within kTavo_DxfLargestCoordinate:
// the parser skips entities with any other.
#pragma once

#include <cstdint>
#include <string>
#include <unordered_map>
#include <vector>

// Larger magnitudes are no drawing's coordinates: they are treated as bad
// input, which also keeps every product and sum of them finite.
constexpr double kTavo_DxfLargestCoordinate = 1e15;

struct Tavo_DxfPoint {
    double x = 0.0;
    double y = 0.0;
    double z = 0.0;
};

struct Tavo_DxfVertex {
    double x = 0.0;
    double y = 0.0;
    double bulge = 0.0; // tan(included angle / 4) of the arc to the next vertex
};

enum class Tavo_DxfKind : uint8_t {
    Line,
    Polyline, // LWPOLYLINE and POLYLINE with its VERTEX entities
    Circle,
    Arc,
    Ellipse,
    Text, // TEXT and ATTRIB
    MText,
    Solid, // SOLID and TRACE
    Point,
    Insert, // INSERT, and DIMENSION (which inserts its own block)
};

// ACI colour numbers with a meaning of their own.
constexpr int kTavo_DxfByBlock = 0;
constexpr int kTavo_DxfByLayer = 256;

struct Tavo_DxfEntity {
    Tavo_DxfKind kind = Tavo_DxfKind::Line;
    bool hasTrueColour = false;
    bool closed = false;  // polylines
    bool inWorld = false; // polyline points are world (3-D POLYLINE), not OCS
    int line = 0;         // where the entity starts in the file
    int layer = 0;        // index in Tavo_DxfModel::layers
    int colour = kTavo_DxfByLayer;
    uint32_t trueColour = 0; // 0x00RRGGBB when hasTrueColour

    Tavo_DxfPoint normal{0.0, 0.0, 1.0}; // extrusion direction
    // LINE: 0, 1; POINT, CIRCLE, ARC, TEXT, MTEXT, INSERT: 0 (TEXT: 1 is the
    // alignment point); ELLIPSE: 0 centre, 1 end of the major axis relative to
    // the centre; SOLID: the four corners.
    Tavo_DxfPoint p[4];
    int corners = 0; // SOLID: corners given
    bool hasAlignmentPoint = false;

    double radius = 0.0;      // CIRCLE, ARC
    double start = 0.0;       // ARC: degrees; ELLIPSE: parameter
    double end = 360.0;       // ARC: degrees; ELLIPSE: parameter
    double ratio = 1.0;       // ELLIPSE: minor / major axis
    double height = 0.0;      // TEXT, MTEXT: character height
    double rotation = 0.0;    // TEXT, MTEXT, INSERT: degrees
    double lineSpacing = 1.0; // MTEXT: factor
    double elevation = 0.0;   // LWPOLYLINE, POLYLINE: z of the OCS points
    int horizontal = 0;       // TEXT: 72; MTEXT: attachment point 71
    int vertical = 0;         // TEXT: 73 (ATTRIB: 74)

    double scaleX = 1.0; // INSERT
    double scaleY = 1.0;
    int columns = 1;
    int rows = 1;
    double columnSpacing = 0.0;
    double rowSpacing = 0.0;

    std::vector<Tavo_DxfVertex> vertices; // polylines
    std::string text;                     // TEXT, MTEXT: raw text; INSERT: block name
};

struct Tavo_DxfLayer {
    std::string name;
    int colour = 7; // ACI; negative: switched off
    bool hasTrueColour = false;
    uint32_t trueColour = 0;
    bool frozen = false;
};

struct Tavo_DxfBlock {
    std::string name;
    Tavo_DxfPoint base;
    int line = 0;
    std::vector<Tavo_DxfEntity> entities;
};

struct Tavo_DxfModel {
    std::string version;  // $ACADVER
    std::string codePage; // $DWGCODEPAGE
    std::vector<Tavo_DxfLayer> layers;
    std::vector<Tavo_DxfBlock> blocks;
    std::vector<Tavo_DxfEntity> entities;

    // Layer and block names are compared ignoring case: keys are upper case.
    std::unordered_map<std::string, int> layerIndex;
    std::unordered_map<std::string, int> blockIndex;

    // The index of the layer of that name, made (colour 7, on) when new.
    int LayerNamed(const std::string& name);
    // -1 when no block has that name.
    int BlockNamed(const std::string& name) const;
    // Texts are UTF-8 from AutoCAD 2007 (AC1021) on, a code page before.
    bool TextIsUtf8() const;
};

// Upper case, ASCII letters only: the key of a layer or block name.
std::string Tavo_DxfNameKey(const std::string& name);
