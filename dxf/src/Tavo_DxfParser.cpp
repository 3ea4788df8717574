// Tavo_DxfParser: sections, tables, blocks and entities.
#include "Tavo_DxfParser.h"

#include <cmath>
#include <cstring>

namespace {

// Group codes of the DXF format that the parser reads.
constexpr int kCodeType = 0;      // starts an entity, table entry or section marker
constexpr int kCodeText = 1;      // text value
constexpr int kCodeName = 2;      // section, block, table name
constexpr int kCodeExtraText = 3; // MTEXT text chunks, header code page
constexpr int kCodeLayer = 8;
constexpr int kCodeHeaderVariable = 9;
constexpr int kCodeColour = 62;
constexpr int kCodeVisibility = 60; // 1: invisible
constexpr int kCodeFollowFlag = 66;
constexpr int kCodePaperSpace = 67; // 1: paper space
constexpr int kCodeTrueColour = 420;

// Colour numbers beyond these are not colours (257 is "by entity" in some
// writers; it is read as "by layer").
constexpr int kLargestColourNumber = 257;
// Vertex flags of POLYLINE's VERTEX entities that mark records that are not
// points of the line.
constexpr long long kVertexSplineFrame = 16;
constexpr long long kVertexPolyfaceFace = 128;
// POLYLINE flags.
constexpr long long kPolylineClosed = 1;
constexpr long long kPolyline3d = 8;
constexpr long long kPolylineMesh = 16;
constexpr long long kPolylinePolyface = 64;
// Array inserts: DXF stores the counts in 16 bits.
constexpr long long kLargestArrayCount = 32767;

bool Is(std::string_view value, const char* name)
{
    return value == name;
}

bool ReadDouble(const Tavo_DxfPair& pair, double& value, std::string& problem)
{
    if (!Tavo_DxfParseDouble(pair.value, value)) {
        problem = "group code " + std::to_string(pair.code) + " at line " + std::to_string(pair.line) + " is not a finite number";
        return false;
    }
    if (std::fabs(value) > kTavo_DxfLargestCoordinate) {
        problem = "group code " + std::to_string(pair.code) + " at line " + std::to_string(pair.line) + " holds an absurdly large number";
        return false;
    }
    return true;
}

bool ReadInt(const Tavo_DxfPair& pair, long long lowest, long long highest, long long& value, std::string& problem)
{
    if (!Tavo_DxfParseInt(pair.value, value) || value < lowest || value > highest) {
        problem = "group code " + std::to_string(pair.code) + " at line " + std::to_string(pair.line) + " is not a whole number in " + std::to_string(lowest) + " ... " + std::to_string(highest);
        return false;
    }
    return true;
}

// Coordinate codes 10 ... 38: point index in the units digit, axis in the tens.
bool ReadCoordinate(Tavo_DxfEntity& entity, const Tavo_DxfPair& pair, std::string& problem)
{
    const int point = pair.code % 10;
    const int axis = pair.code / 10 - 1;
    if (point > 3)
        return true;
    double value = 0.0;
    if (!ReadDouble(pair, value, problem))
        return false;
    Tavo_DxfPoint& p = entity.p[point];
    (axis == 0 ? p.x : axis == 1 ? p.y
                                 : p.z) = value;
    if (entity.kind == Tavo_DxfKind::Solid && axis == 0)
        entity.corners = std::max(entity.corners, point + 1);
    if (entity.kind == Tavo_DxfKind::Text && point == 1)
        entity.hasAlignmentPoint = true;
    return true;
}

enum class EntityType {
    Drawn,       // read into the model
    Quiet,       // skipped without a word: not drawn by nature
    Unsupported, // skipped with a warning
};

struct TypeInfo {
    const char* name;
    EntityType type;
    Tavo_DxfKind kind;
};

constexpr TypeInfo kTypes[] = {
    {"LINE", EntityType::Drawn, Tavo_DxfKind::Line},
    {"LWPOLYLINE", EntityType::Drawn, Tavo_DxfKind::Polyline},
    {"POLYLINE", EntityType::Drawn, Tavo_DxfKind::Polyline},
    {"CIRCLE", EntityType::Drawn, Tavo_DxfKind::Circle},
    {"ARC", EntityType::Drawn, Tavo_DxfKind::Arc},
    {"ELLIPSE", EntityType::Drawn, Tavo_DxfKind::Ellipse},
    {"TEXT", EntityType::Drawn, Tavo_DxfKind::Text},
    {"ATTRIB", EntityType::Drawn, Tavo_DxfKind::Text},
    {"MTEXT", EntityType::Drawn, Tavo_DxfKind::MText},
    {"SOLID", EntityType::Drawn, Tavo_DxfKind::Solid},
    {"TRACE", EntityType::Drawn, Tavo_DxfKind::Solid},
    {"POINT", EntityType::Drawn, Tavo_DxfKind::Point},
    {"INSERT", EntityType::Drawn, Tavo_DxfKind::Insert},
    {"DIMENSION", EntityType::Drawn, Tavo_DxfKind::Insert},
    // Definitions and markers that draw nothing themselves.
    {"ATTDEF", EntityType::Quiet, Tavo_DxfKind::Line},
    {"SEQEND", EntityType::Quiet, Tavo_DxfKind::Line},
    {"VIEWPORT", EntityType::Quiet, Tavo_DxfKind::Line},
};

TypeInfo TypeOf(std::string_view name)
{
    for (const TypeInfo& info : kTypes)
        if (name == info.name)
            return info;
    return {nullptr, EntityType::Unsupported, Tavo_DxfKind::Line};
}

// Reads a pair that belongs to the entity; false with a problem when its
// value is bad.
bool ApplyPair(Tavo_DxfModel& model, Tavo_DxfEntity& entity, bool isAttrib, const Tavo_DxfPair& pair,
               bool& invisible, std::string& problem)
{
    const int code = pair.code;
    long long number = 0;
    double value = 0.0;
    switch (code) {
    case kCodeLayer: entity.layer = model.LayerNamed(std::string(pair.value)); return true;
    case kCodeColour:
        if (!ReadInt(pair, -kLargestColourNumber, kLargestColourNumber, number, problem))
            return false;
        entity.colour = number == kLargestColourNumber ? kTavo_DxfByLayer : static_cast<int>(number);
        return true;
    case kCodeTrueColour:
        if (!ReadInt(pair, -(1LL << 32), 1LL << 32, number, problem))
            return false;
        entity.hasTrueColour = true;
        entity.trueColour = static_cast<uint32_t>(number) & 0xFFFFFF;
        return true;
    case 210:
    case 220:
    case 230:
        if (!ReadDouble(pair, value, problem))
            return false;
        (code == 210 ? entity.normal.x : code == 220 ? entity.normal.y
                                                     : entity.normal.z) = value;
        return true;
    default: break;
    }

    switch (entity.kind) {
    case Tavo_DxfKind::Polyline:
        // LWPOLYLINE: each 10 starts a vertex; 20 and 42 belong to the last one.
        // POLYLINE's own 10/20/30 is a dummy point whose z is the elevation.
        if (code == 10 || code == 20 || code == 42) {
            if (!ReadDouble(pair, value, problem))
                return false;
            if (entity.inWorld) // POLYLINE header: only z counts
                return true;
            if (code == 10)
                entity.vertices.push_back({value, 0.0, 0.0});
            else if (!entity.vertices.empty())
                (code == 20 ? entity.vertices.back().y : entity.vertices.back().bulge) = value;
            return true;
        }
        if (code == 30 || code == 38)
            return ReadDouble(pair, entity.elevation, problem);
        if (code == 70) {
            if (!ReadInt(pair, -32768, 65535, number, problem))
                return false;
            entity.closed = (number & kPolylineClosed) != 0;
            if (number & (kPolylineMesh | kPolylinePolyface)) {
                problem = "polygon meshes and polyface meshes are not supported";
                return false;
            }
            entity.horizontal = static_cast<int>(number); // kept for the 3-D flag
            return true;
        }
        return true;
    case Tavo_DxfKind::Insert:
        if (code == kCodeName) {
            entity.text = std::string(pair.value);
            return true;
        }
        if (code == 41 || code == 42 || code == 50 || code == 44 || code == 45) {
            if (!ReadDouble(pair, value, problem))
                return false;
            (code == 41 ? entity.scaleX : code == 42 ? entity.scaleY
                 : code == 50                        ? entity.rotation
                 : code == 44                        ? entity.columnSpacing
                                                     : entity.rowSpacing) = value;
            return true;
        }
        if (code == 70 || code == 71) {
            if (!ReadInt(pair, -32768, 65535, number, problem))
                return false;
            const int count = static_cast<int>(std::max(1LL, std::min(number, kLargestArrayCount)));
            (code == 70 ? entity.columns : entity.rows) = count;
            return true;
        }
        break;
    case Tavo_DxfKind::Circle:
    case Tavo_DxfKind::Arc:
        if (code == 40)
            return ReadDouble(pair, entity.radius, problem);
        if (code == 50 || code == 51)
            return ReadDouble(pair, code == 50 ? entity.start : entity.end, problem);
        break;
    case Tavo_DxfKind::Ellipse:
        if (code == 40)
            return ReadDouble(pair, entity.ratio, problem);
        if (code == 41 || code == 42)
            return ReadDouble(pair, code == 41 ? entity.start : entity.end, problem);
        break;
    case Tavo_DxfKind::Text:
        if (code == kCodeText) {
            entity.text = std::string(pair.value);
            return true;
        }
        if (code == 40 || code == 50)
            return ReadDouble(pair, code == 40 ? entity.height : entity.rotation, problem);
        if (code == 72 || code == (isAttrib ? 74 : 73)) {
            if (!ReadInt(pair, -32768, 32767, number, problem))
                return false;
            (code == 72 ? entity.horizontal : entity.vertical) = static_cast<int>(number);
            return true;
        }
        if (isAttrib && code == 70) {
            if (!ReadInt(pair, -32768, 65535, number, problem))
                return false;
            if (number & 1)
                invisible = true;
            return true;
        }
        break;
    case Tavo_DxfKind::MText:
        // The text comes in 250-character chunks: 3 for all but the last, 1.
        if (code == kCodeText || code == kCodeExtraText) {
            entity.text.append(pair.value.data(), pair.value.size());
            return true;
        }
        if (code == 40 || code == 50 || code == 44) {
            return ReadDouble(pair, code == 40 ? entity.height : code == 50 ? entity.rotation
                                                                            : entity.lineSpacing,
                              problem);
        }
        if (code == 71) {
            if (!ReadInt(pair, -32768, 32767, number, problem))
                return false;
            entity.horizontal = static_cast<int>(number);
            return true;
        }
        if (code >= 11 && code <= 31 && code % 10 == 1)
            return true; // the direction vector: text is drawn horizontally anyway
        break;
    default: break;
    }
    if (code >= 10 && code <= 38)
        return ReadCoordinate(entity, pair, problem);
    return true;
}

} // namespace

// ---- Tavo_DxfModel ----------------------------------------------------------

std::string Tavo_DxfNameKey(const std::string& name)
{
    std::string key = name;
    for (char& c : key)
        if (c >= 'a' && c <= 'z')
            c = static_cast<char>(c - 'a' + 'A');
    return key;
}

int Tavo_DxfModel::LayerNamed(const std::string& name)
{
    const std::string key = Tavo_DxfNameKey(name);
    auto found = layerIndex.find(key);
    if (found != layerIndex.end())
        return found->second;
    const int index = static_cast<int>(layers.size());
    Tavo_DxfLayer layer;
    layer.name = name;
    layers.push_back(layer);
    layerIndex.emplace(key, index);
    return index;
}

int Tavo_DxfModel::BlockNamed(const std::string& name) const
{
    auto found = blockIndex.find(Tavo_DxfNameKey(name));
    return found == blockIndex.end() ? -1 : found->second;
}

bool Tavo_DxfModel::TextIsUtf8() const
{
    // Versions are "AC1009" ... "AC1032"; AC1021 is AutoCAD 2007.
    return version.size() == 6 && version.compare(0, 2, "AC") == 0 && version.compare("AC1021") >= 0;
}

// ---- Tavo_DxfParser ---------------------------------------------------------

Tavo_DxfParser::Tavo_DxfParser(const char* data, size_t size, Tavo_DxfWarnings& warnings)
    : m_reader(data, size), m_warnings(warnings)
{
    static const char kBinarySentinel[] = "AutoCAD Binary DXF";
    if (data && size >= sizeof(kBinarySentinel) - 1 && std::memcmp(data, kBinarySentinel, sizeof(kBinarySentinel) - 1) == 0)
        Fail(1, "binary DXF is not supported; save the drawing as ASCII DXF");
}

bool Tavo_DxfParser::Fail(int line, std::string message)
{
    if (m_error.empty()) {
        m_error = std::move(message);
        m_errorLine = line;
    }
    return false;
}

bool Tavo_DxfParser::FailFromReader()
{
    if (m_reader.Failed())
        return Fail(m_reader.ErrorLine(), m_reader.Error());
    return Fail(m_reader.Line(), "the file ends unexpectedly");
}

bool Tavo_DxfParser::FailAtEnd(const char* inside)
{
    if (m_reader.Failed())
        return FailFromReader();
    return Fail(m_reader.Line(), std::string("the file ends inside ") + inside + " (is it truncated?)");
}

bool Tavo_DxfParser::Parse(Tavo_DxfModel& model)
{
    if (!m_error.empty())
        return false;
    Tavo_DxfPair pair;
    bool sawAnything = false;
    while (m_reader.Next(pair)) {
        sawAnything = true;
        if (pair.code == kCodeType && Is(pair.value, "EOF"))
            return true;
        if (pair.code == 999) // comment
            continue;
        if (pair.code != kCodeType || !Is(pair.value, "SECTION")) {
            // Some writers leave header variables after the header's ENDSEC.
            m_warnings.Add(pair.line, "group codes outside any section: skipped");
            continue;
        }
        if (!ReadSection(model, pair.line))
            return false;
    }
    if (m_reader.Failed())
        return FailFromReader();
    if (!sawAnything)
        return Fail(0, "the file is empty");
    m_warnings.Add(m_reader.Line(), "the file has no EOF marker after its last section");
    return true;
}

bool Tavo_DxfParser::ReadSection(Tavo_DxfModel& model, int line)
{
    Tavo_DxfPair name;
    if (!m_reader.Next(name))
        return FailAtEnd("a SECTION");
    if (name.code != kCodeName)
        return Fail(name.line, "a SECTION without a name (group code 2)");
    if (Is(name.value, "HEADER"))
        return ReadHeader(model);
    if (Is(name.value, "TABLES"))
        return ReadTables(model);
    if (Is(name.value, "BLOCKS"))
        return ReadBlocks(model);
    if (Is(name.value, "ENTITIES"))
        return ReadEntities(model, model.entities, "ENDSEC", true);
    if (!Is(name.value, "CLASSES") && !Is(name.value, "OBJECTS") && !Is(name.value, "THUMBNAILIMAGE") && !Is(name.value, "ACDSDATA"))
        m_warnings.Add(line, "section " + std::string(name.value.substr(0, 40)) + ": skipped, not known");
    return SkipTo("ENDSEC");
}

bool Tavo_DxfParser::SkipTo(const char* name)
{
    Tavo_DxfPair pair;
    while (m_reader.Next(pair))
        if (pair.code == kCodeType && Is(pair.value, name))
            return true;
    return FailAtEnd(std::strcmp(name, "ENDSEC") == 0 ? "a section" : "a table");
}

bool Tavo_DxfParser::SkipToNextCodeZero()
{
    Tavo_DxfPair pair;
    while (m_reader.Next(pair)) {
        if (pair.code == kCodeType) {
            m_reader.PushBack(pair);
            return true;
        }
    }
    return FailAtEnd("an entity");
}

bool Tavo_DxfParser::ReadHeader(Tavo_DxfModel& model)
{
    Tavo_DxfPair pair;
    std::string variable;
    while (m_reader.Next(pair)) {
        if (pair.code == kCodeType)
            return Is(pair.value, "ENDSEC") ? true : Fail(pair.line, "unexpected \"" + std::string(pair.value.substr(0, 40)) + "\" in the HEADER section");
        if (pair.code == kCodeHeaderVariable)
            variable = std::string(pair.value);
        else if (variable == "$ACADVER" && pair.code == kCodeText)
            model.version = std::string(pair.value.substr(0, 16));
        else if (variable == "$DWGCODEPAGE" && pair.code == kCodeExtraText)
            model.codePage = std::string(pair.value.substr(0, 32));
    }
    return FailAtEnd("the HEADER section");
}

bool Tavo_DxfParser::ReadTables(Tavo_DxfModel& model)
{
    Tavo_DxfPair pair;
    bool inLayerTable = false;
    while (m_reader.Next(pair)) {
        if (pair.code != kCodeType)
            continue; // table headers and entries of tables not read
        if (Is(pair.value, "ENDSEC"))
            return true;
        if (Is(pair.value, "TABLE")) {
            Tavo_DxfPair name;
            if (!m_reader.Next(name))
                return FailAtEnd("a TABLE");
            inLayerTable = name.code == kCodeName && Is(name.value, "LAYER");
        } else if (Is(pair.value, "ENDTAB")) {
            inLayerTable = false;
        } else if (inLayerTable && Is(pair.value, "LAYER")) {
            if (!ReadLayer(model, pair.line))
                return false;
        }
    }
    return FailAtEnd("the TABLES section");
}

bool Tavo_DxfParser::ReadLayer(Tavo_DxfModel& model, int line)
{
    Tavo_DxfPair pair;
    std::string name;
    bool hasName = false;
    long long colour = 7;
    long long flags = 0;
    long long trueColour = -1;
    std::string problem;
    while (m_reader.Next(pair)) {
        if (pair.code == kCodeType) {
            m_reader.PushBack(pair);
            if (!problem.empty() || !hasName) {
                m_warnings.Add(line, "LAYER table entry: skipped, " + (problem.empty() ? std::string("it has no name") : problem));
                return true;
            }
            Tavo_DxfLayer& layer = model.layers[model.LayerNamed(name)];
            layer.colour = static_cast<int>(colour);
            layer.frozen = (flags & 1) != 0;
            if (trueColour >= 0) {
                layer.hasTrueColour = true;
                layer.trueColour = static_cast<uint32_t>(trueColour) & 0xFFFFFF;
            }
            return true;
        }
        if (!problem.empty())
            continue;
        if (pair.code == kCodeName) {
            name = std::string(pair.value);
            hasName = true;
        } else if (pair.code == kCodeColour) {
            ReadInt(pair, -kLargestColourNumber, kLargestColourNumber, colour, problem);
        } else if (pair.code == 70) {
            ReadInt(pair, -32768, 65535, flags, problem);
        } else if (pair.code == kCodeTrueColour) {
            ReadInt(pair, 0, 1LL << 32, trueColour, problem);
        }
    }
    return FailAtEnd("a LAYER table entry");
}

bool Tavo_DxfParser::ReadBlocks(Tavo_DxfModel& model)
{
    Tavo_DxfPair pair;
    while (m_reader.Next(pair)) {
        if (pair.code != kCodeType)
            continue;
        if (Is(pair.value, "ENDSEC"))
            return true;
        if (Is(pair.value, "BLOCK")) {
            if (!ReadBlock(model, pair.line))
                return false;
        }
    }
    return FailAtEnd("the BLOCKS section");
}

bool Tavo_DxfParser::ReadBlock(Tavo_DxfModel& model, int line)
{
    Tavo_DxfBlock block;
    block.line = line;
    Tavo_DxfPair pair;
    std::string problem;
    while (m_reader.Next(pair)) {
        if (pair.code == kCodeType)
            break;
        if (!problem.empty())
            continue;
        if (pair.code == kCodeName) {
            block.name = std::string(pair.value);
        } else if (pair.code == 10 || pair.code == 20 || pair.code == 30) {
            double value = 0.0;
            if (ReadDouble(pair, value, problem))
                (pair.code == 10 ? block.base.x : pair.code == 20 ? block.base.y
                                                                  : block.base.z) = value;
        }
    }
    if (m_reader.Failed() || pair.code != kCodeType)
        return FailAtEnd("a BLOCK");
    m_reader.PushBack(pair);
    if (!ReadEntities(model, block.entities, "ENDBLK", false))
        return false;
    // ENDBLK's own pairs.
    if (!SkipToNextCodeZero())
        return false;
    if (!problem.empty()) {
        m_warnings.Add(line, "BLOCK \"" + block.name.substr(0, 40) + "\": skipped, " + problem);
        return true;
    }
    const std::string key = Tavo_DxfNameKey(block.name);
    if (model.blockIndex.count(key)) {
        m_warnings.Add(line, "BLOCK \"" + block.name.substr(0, 40) + "\": defined twice, the first definition is used");
        return true;
    }
    model.blockIndex.emplace(key, static_cast<int>(model.blocks.size()));
    model.blocks.push_back(std::move(block));
    return true;
}

bool Tavo_DxfParser::ReadEntities(Tavo_DxfModel& model, std::vector<Tavo_DxfEntity>& into, const char* terminator,
                                  bool countEntities)
{
    Tavo_DxfPair pair;
    while (m_reader.Next(pair)) {
        if (pair.code != kCodeType)
            continue; // stray pairs between entities
        if (Is(pair.value, terminator))
            return true;
        if (Is(pair.value, "ENDSEC") || Is(pair.value, "EOF"))
            return Fail(pair.line, std::string("found ") + std::string(pair.value) + " where " + terminator + " was expected");
        if (!ReadEntity(model, pair, into, countEntities))
            return false;
    }
    return FailAtEnd(std::strcmp(terminator, "ENDSEC") == 0 ? "the ENTITIES section" : "a BLOCK");
}

bool Tavo_DxfParser::ReadEntity(Tavo_DxfModel& model, const Tavo_DxfPair& start, std::vector<Tavo_DxfEntity>& into,
                                bool countEntities)
{
    const TypeInfo type = TypeOf(start.value);
    const std::string typeName(start.value.substr(0, 40));
    if (countEntities)
        ++m_entitiesRead;
    if (type.type != EntityType::Drawn) {
        if (type.type == EntityType::Unsupported) {
            m_warnings.Add(start.line, typeName + ": skipped, not supported");
            if (countEntities)
                ++m_entitiesSkipped;
        }
        return SkipToNextCodeZero();
    }

    Tavo_DxfEntity entity;
    entity.kind = type.kind;
    entity.line = start.line;
    entity.layer = model.LayerNamed("0");
    const bool isAttrib = typeName == "ATTRIB";
    const bool isOldPolyline = typeName == "POLYLINE";
    const bool isDimension = typeName == "DIMENSION";
    entity.inWorld = isOldPolyline; // until its vertices are read
    if (entity.kind == Tavo_DxfKind::Arc)
        entity.end = 360.0, entity.start = 0.0;
    if (entity.kind == Tavo_DxfKind::Ellipse)
        entity.end = 2.0 * 3.14159265358979323846;

    std::string problem;
    bool invisible = false;
    bool paperSpace = false;
    Tavo_DxfPair pair;
    while (m_reader.Next(pair)) {
        if (pair.code == kCodeType) {
            m_reader.PushBack(pair);
            break;
        }
        if (!problem.empty())
            continue;
        if (pair.code == kCodeVisibility || pair.code == kCodePaperSpace) {
            long long flag = 0;
            if (ReadInt(pair, -32768, 32767, flag, problem))
                (pair.code == kCodeVisibility ? invisible : paperSpace) = flag != 0;
            continue;
        }
        if (pair.code == kCodeFollowFlag)
            continue;
        if (isDimension && pair.code != kCodeName && pair.code != kCodeLayer && pair.code != kCodeColour && pair.code != kCodeTrueColour)
            continue; // its geometry is in its block, drawn where the block has it
        ApplyPair(model, entity, isAttrib, pair, invisible, problem);
    }
    if (m_reader.Failed() || pair.code != kCodeType)
        return FailAtEnd("an entity");

    if (isOldPolyline) {
        const int flags = entity.horizontal;
        entity.horizontal = 0;
        entity.inWorld = (flags & kPolyline3d) != 0;
        if (!ReadPolylineVertices(entity, problem))
            return false;
    }
    if (!problem.empty()) {
        m_warnings.Add(start.line, typeName + ": skipped, " + problem);
        if (countEntities)
            ++m_entitiesSkipped;
        return true;
    }
    if (paperSpace) {
        m_warnings.Add(start.line, typeName + ": skipped, it is in paper space (only model space is drawn)");
        if (countEntities)
            ++m_entitiesSkipped;
        return true;
    }
    if (invisible)
        return true;
    into.push_back(std::move(entity));
    return true;
}

bool Tavo_DxfParser::ReadPolylineVertices(Tavo_DxfEntity& polyline, std::string& problem)
{
    // POLYLINE is followed by VERTEX entities and a SEQEND.
    Tavo_DxfPair pair;
    while (m_reader.Next(pair)) {
        if (pair.code != kCodeType)
            continue;
        if (Is(pair.value, "SEQEND"))
            return SkipToNextCodeZero();
        if (!Is(pair.value, "VERTEX")) {
            m_reader.PushBack(pair); // a POLYLINE without its SEQEND
            return true;
        }
        Tavo_DxfVertex vertex;
        long long flags = 0;
        double z = 0.0;
        Tavo_DxfPair field;
        while (m_reader.Next(field)) {
            if (field.code == kCodeType) {
                m_reader.PushBack(field);
                break;
            }
            if (!problem.empty())
                continue;
            if (field.code == 10)
                ReadDouble(field, vertex.x, problem);
            else if (field.code == 20)
                ReadDouble(field, vertex.y, problem);
            else if (field.code == 30)
                ReadDouble(field, z, problem);
            else if (field.code == 42)
                ReadDouble(field, vertex.bulge, problem);
            else if (field.code == 70)
                ReadInt(field, -32768, 65535, flags, problem);
        }
        if (m_reader.Failed() || field.code != kCodeType)
            return FailAtEnd("a VERTEX");
        if (problem.empty() && !(flags & (kVertexSplineFrame | kVertexPolyfaceFace)))
            polyline.vertices.push_back(vertex);
    }
    return FailAtEnd("a POLYLINE");
}
