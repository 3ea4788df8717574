// Shared by the DXF importer's tests: reading test files, listing DXF files
// under a folder (through Win32, as the tests run on Wine), parsing a file
// into the plain model, and a sink that writes down the walker's shapes.
#pragma once

#include "Tavo_DxfParser.h"
#include "Tavo_DxfWalker.h"

#include <windows.h>

#include <algorithm>
#include <fstream>
#include <iterator>
#include <string>
#include <vector>

// Folders given by the build (Z: paths that Wine maps onto the Linux tree).
inline std::string DxfTestData(const std::string& name)
{
    return std::string(TAVO_DXF_TEST_DATA) + "/" + name;
}

inline std::string ReadWholeFile(const std::string& path)
{
    std::ifstream in(path, std::ios::binary);
    return std::string((std::istreambuf_iterator<char>(in)), std::istreambuf_iterator<char>());
}

// Every file under folder (recursively) whose name ends in one of the
// extensions (compared ignoring case), sorted.
inline std::vector<std::string> FilesUnder(const std::string& folder, const std::vector<std::string>& extensions)
{
    std::vector<std::string> found;
    std::vector<std::string> pending{folder};
    while (!pending.empty()) {
        const std::string dir = pending.back();
        pending.pop_back();
        WIN32_FIND_DATAA entry;
        HANDLE search = FindFirstFileA((dir + "\\*").c_str(), &entry);
        if (search == INVALID_HANDLE_VALUE)
            continue;
        do {
            const std::string name = entry.cFileName;
            if (name == "." || name == "..")
                continue;
            const std::string path = dir + "\\" + name;
            if (entry.dwFileAttributes & FILE_ATTRIBUTE_DIRECTORY) {
                pending.push_back(path);
                continue;
            }
            std::string lower = name;
            std::transform(lower.begin(), lower.end(), lower.begin(), [](char c) { return char(tolower(c)); });
            for (const std::string& extension : extensions)
                if (lower.size() >= extension.size() && lower.compare(lower.size() - extension.size(), extension.size(), extension) == 0)
                    found.push_back(path);
        } while (FindNextFileA(search, &entry));
        FindClose(search);
    }
    std::sort(found.begin(), found.end());
    return found;
}

// A parsed test file; the text stays alive with the model.
struct ParsedDxf {
    std::string text;
    Tavo_DxfModel model;
    Tavo_DxfWarnings warnings{100};
    bool ok = false;
    std::string error;
    int errorLine = 0;

    explicit ParsedDxf(const std::string& contents) : text(contents)
    {
        Tavo_DxfParser parser(text.data(), text.size(), warnings);
        ok = parser.Parse(model);
        error = parser.Error();
        errorLine = parser.ErrorLine();
    }
};

// The walker's shapes, in drawing coordinates.
class RecordingSink : public Tavo_DxfSink {
public:
    struct Shape {
        std::string kind; // "Dot", "Line", "Polyline", "Polygon", "Circle", "Text"
        Tavo_DxfStyle style;
        std::vector<Tavo_DxfXY> points;
        bool closed = false;
        double radius = 0.0;
        Tavo_DxfTextPlacement text;
        std::string string;
    };
    std::vector<Shape> shapes;

    std::string Kinds() const
    {
        std::string kinds;
        for (const Shape& shape : shapes)
            kinds += (kinds.empty() ? "" : " ") + shape.kind;
        return kinds;
    }

    void Dot(const Tavo_DxfStyle& style, const Tavo_DxfXY& p) override { Add("Dot", style, {p}); }
    void Line(const Tavo_DxfStyle& style, const Tavo_DxfXY& p, const Tavo_DxfXY& q) override { Add("Line", style, {p, q}); }
    void Polyline(const Tavo_DxfStyle& style, const std::vector<Tavo_DxfXY>& points, bool closed) override
    {
        Add("Polyline", style, points).closed = closed;
    }
    void Polygon(const Tavo_DxfStyle& style, const Tavo_DxfXY* points, int count) override
    {
        Add("Polygon", style, std::vector<Tavo_DxfXY>(points, points + count));
    }
    void Circle(const Tavo_DxfStyle& style, const Tavo_DxfXY& centre, double radius) override
    {
        Add("Circle", style, {centre}).radius = radius;
    }
    void Text(const Tavo_DxfStyle& style, const Tavo_DxfTextPlacement& placement, const std::string& text) override
    {
        Shape& shape = Add("Text", style, {placement.anchor});
        shape.text = placement;
        shape.string = text;
    }

private:
    Shape& Add(const char* kind, const Tavo_DxfStyle& style, std::vector<Tavo_DxfXY> points)
    {
        Shape shape;
        shape.kind = kind;
        shape.style = style;
        shape.points = std::move(points);
        shapes.push_back(std::move(shape));
        return shapes.back();
    }
};

// Walks a parsed file at a fine flattening into a recording sink.
struct WalkedDxf {
    ParsedDxf parsed;
    RecordingSink sink;
    bool ok = false;

    explicit WalkedDxf(const std::string& contents) : parsed(contents)
    {
        Tavo_DxfFlattening flattening;
        flattening.tolerance = 1e-3;
        Tavo_DxfWalker walker(parsed.model, sink, flattening, Tavo_DxfLimits(), &parsed.warnings);
        ok = parsed.ok && walker.Walk();
    }
};
