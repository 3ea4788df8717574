// Tavo_DxfParser: reads the group-code pairs of a DXF text into the plain
// model (Tavo_DxfModel.h).
//
// Sections read: HEADER ($ACADVER, $DWGCODEPAGE), TABLES (the LAYER table),
// BLOCKS and ENTITIES. CLASSES, OBJECTS, THUMBNAILIMAGE and ACDSDATA are
// skipped quietly, other sections with a warning.
//
// Parse fails (Error(), ErrorLine()) on a reader error, on binary DXF, and on
// a file that ends inside a section or a table. Everything wrong inside one
// entity skips that entity with a warning naming it; the rest is read.
#pragma once

#include "Tavo_DxfModel.h"
#include "Tavo_DxfReader.h"
#include "Tavo_DxfWarnings.h"

#include <string>

class Tavo_DxfParser {
public:
    Tavo_DxfParser(const char* data, size_t size, Tavo_DxfWarnings& warnings);

    bool Parse(Tavo_DxfModel& model);

    const std::string& Error() const { return m_error; }
    int ErrorLine() const { return m_errorLine; }
    int EntitiesRead() const { return m_entitiesRead; }
    int EntitiesSkipped() const { return m_entitiesSkipped; }

private:
    // Each reads from just after its opening pair up to and including its
    // closing pair; false on a fatal error.
    bool ReadSection(Tavo_DxfModel& model, int line);
    bool ReadHeader(Tavo_DxfModel& model);
    bool ReadTables(Tavo_DxfModel& model);
    bool ReadLayer(Tavo_DxfModel& model, int line);
    bool ReadBlocks(Tavo_DxfModel& model);
    bool ReadBlock(Tavo_DxfModel& model, int line);
    // Entities up to the pair (0, terminator), which is consumed.
    bool ReadEntities(Tavo_DxfModel& model, std::vector<Tavo_DxfEntity>& into, const char* terminator,
                      bool countEntities);
    // One entity whose (0, type) pair has been read; the pairs that follow up
    // to the next code 0 (and, for POLYLINE, its vertices and SEQEND). Adds it
    // to `into` unless it is skipped.
    bool ReadEntity(Tavo_DxfModel& model, const Tavo_DxfPair& start, std::vector<Tavo_DxfEntity>& into,
                    bool countEntities);
    bool ReadPolylineVertices(Tavo_DxfEntity& polyline, std::string& problem);
    // Skips pairs up to the next code 0, which is pushed back.
    bool SkipToNextCodeZero();
    // Skips up to and including (0, name).
    bool SkipTo(const char* name);

    bool Fail(int line, std::string message);
    bool FailFromReader();
    bool FailAtEnd(const char* inside);

    Tavo_DxfReader m_reader;
    Tavo_DxfWarnings& m_warnings;
    std::string m_error;
    int m_errorLine = 0;
    int m_entitiesRead = 0;
    int m_entitiesSkipped = 0;
};
