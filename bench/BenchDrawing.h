// The benchmark's generated drawing: at least a million primitives of mixed
// kinds, colours and fills over a 1920 x 1080 device window, kept both as a
// graphics-core drawing (for the surface) and as a plain list in device
// coordinates (for the hand-written GDI renderer).
#pragma once

#include <cstdint>
#include <vector>

class Tavo_GrDrawing;
class Tavo_GrTransform;

struct BenchPrimitive {
    enum Kind : std::uint8_t {
        Dot,
        Line,
        Polyline,
        Rect,
        Circle,
        Triangle
    };
    Kind kind = Dot;
    char colour = 0;
    char fill = 0;
    std::uint8_t pointCount = 0; // points used in `points` (polylines up to 5)
    int radius = 0;
    int points[5][2] = {}; // world coordinates
};

constexpr int kBenchWidth = 1920;
constexpr int kBenchHeight = 1080;

// A deterministic mix of `count` primitives in runs of one colour and fill;
// with `only` set, every primitive is of that kind (to see where time goes).
std::vector<BenchPrimitive> GeneratePrimitives(int count, int only = -1);
// The kind of a name ("dot", "line", "polyline", "rect", "circle",
// "triangle"); -1 for any other.
int BenchKindOfName(const char* name);

// Adds the primitives to an empty drawing, with a frame that makes its world
// bounds exactly the device window (so that the fitted scale is 1).
void BuildDrawing(const std::vector<BenchPrimitive>& primitives, Tavo_GrDrawing& drawing);
