#include "BenchDrawing.h"

#include "Tavo_GrDrawing.h"
#include "Tavo_GrDrawingBuilder.h"

#include <cstring>

namespace {

// A small linear congruential generator: the same drawing on every run.
class Random {
public:
    explicit Random(std::uint32_t seed) : m_state(seed) {}
    std::uint32_t Next()
    {
        m_state = m_state * 1664525u + 1013904223u;
        return m_state >> 8;
    }
    int Below(int limit) { return static_cast<int>(Next() % static_cast<std::uint32_t>(limit)); }
    int Between(int low, int high) { return low + Below(high - low + 1); }

private:
    std::uint32_t m_state;
};

// Runs of one colour and fill are 1 to this many primitives long.
const int kLongestRun = 64;
// Largest extent of a shape, in pixels.
const int kShapeSize = 48;

int ClampX(int x) { return x < 0 ? 0 : (x >= kBenchWidth ? kBenchWidth - 1 : x); }
int ClampY(int y) { return y < 1 ? 1 : (y > kBenchHeight ? kBenchHeight : y); }

BenchPrimitive::Kind PickKind(Random& random)
{
    const int roll = random.Below(100);
    if (roll < 20)
        return BenchPrimitive::Dot;
    if (roll < 45)
        return BenchPrimitive::Line;
    if (roll < 55)
        return BenchPrimitive::Polyline;
    if (roll < 70)
        return BenchPrimitive::Rect;
    if (roll < 85)
        return BenchPrimitive::Circle;
    return BenchPrimitive::Triangle;
}

} // namespace

int BenchKindOfName(const char* name)
{
    static const char* const names[] = {"dot", "line", "polyline", "rect", "circle", "triangle"};
    for (int kind = 0; kind < 6; ++kind)
        if (std::strcmp(name, names[kind]) == 0)
            return kind;
    return -1;
}

std::vector<BenchPrimitive> GeneratePrimitives(int count, int only)
{
    Random random(20261206u);
    std::vector<BenchPrimitive> primitives;
    primitives.reserve(static_cast<size_t>(count));
    char colour = 0;
    char fill = 0;
    int runLeft = 0;
    for (int i = 0; i < count; ++i) {
        if (runLeft-- <= 0) {
            runLeft = random.Between(1, kLongestRun) - 1;
            colour = static_cast<char>(random.Below(16));
            fill = static_cast<char>(random.Below(2));
        }
        BenchPrimitive p;
        p.kind = PickKind(random);
        if (only >= 0)
            p.kind = static_cast<BenchPrimitive::Kind>(only);
        p.colour = colour;
        p.fill = fill;
        const int x = random.Below(kBenchWidth);
        const int y = random.Between(1, kBenchHeight);
        const auto near = [&](int c, bool isX) {
            const int moved = c + random.Between(-kShapeSize, kShapeSize);
            return isX ? ClampX(moved) : ClampY(moved);
        };
        p.points[0][0] = x;
        p.points[0][1] = y;
        switch (p.kind) {
        case BenchPrimitive::Dot:
            p.pointCount = 1;
            break;
        case BenchPrimitive::Line:
        case BenchPrimitive::Rect:
            p.pointCount = 2;
            p.points[1][0] = near(x, true);
            p.points[1][1] = near(y, false);
            break;
        case BenchPrimitive::Polyline:
            p.pointCount = static_cast<std::uint8_t>(random.Between(3, 5));
            for (int k = 1; k < p.pointCount; ++k) {
                p.points[k][0] = near(p.points[k - 1][0], true);
                p.points[k][1] = near(p.points[k - 1][1], false);
            }
            break;
        case BenchPrimitive::Circle:
            // Wholly inside, so that the drawing's bounds stay the window.
            p.pointCount = 1;
            p.radius = random.Between(0, kShapeSize / 2);
            p.points[0][0] = random.Between(p.radius, kBenchWidth - 1 - p.radius);
            p.points[0][1] = random.Between(1 + p.radius, kBenchHeight - p.radius);
            break;
        case BenchPrimitive::Triangle:
            p.pointCount = 3;
            for (int k = 1; k < 3; ++k) {
                p.points[k][0] = near(x, true);
                p.points[k][1] = near(y, false);
            }
            break;
        }
        primitives.push_back(p);
    }
    return primitives;
}

void BuildDrawing(const std::vector<BenchPrimitive>& primitives, Tavo_GrDrawing& drawing)
{
    Tavo_GrDrawingBuilder build(drawing);
    build.Reserve(static_cast<int>(primitives.size()) + 1, static_cast<int>(primitives.size()) * 3);
    build.SetAttr(Tavo_GrAttr(0, 0));
    build.AddRect(0, 0, kBenchWidth, kBenchHeight);
    for (const BenchPrimitive& p : primitives) {
        build.SetAttr(Tavo_GrAttr(p.colour, p.fill));
        switch (p.kind) {
        case BenchPrimitive::Dot:
            build.AddDot(p.points[0][0], p.points[0][1]);
            break;
        case BenchPrimitive::Line:
            build.AddLine(p.points[0][0], p.points[0][1], p.points[1][0], p.points[1][1]);
            break;
        case BenchPrimitive::Polyline: {
            Tavo_GrWPoint points[5];
            for (int k = 0; k < p.pointCount; ++k)
                points[k] = {p.points[k][0], p.points[k][1]};
            build.AddPolyline(p.pointCount, points);
            break;
        }
        case BenchPrimitive::Rect:
            build.AddRect(p.points[0][0], p.points[0][1], p.points[1][0], p.points[1][1]);
            break;
        case BenchPrimitive::Circle:
            build.AddCircle(p.points[0][0], p.points[0][1], p.radius);
            break;
        case BenchPrimitive::Triangle:
            build.AddTriangle({p.points[0][0], p.points[0][1]}, {p.points[1][0], p.points[1][1]},
                              {p.points[2][0], p.points[2][1]});
            break;
        }
    }
}
