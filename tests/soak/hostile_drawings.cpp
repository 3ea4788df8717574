#include "hostile_drawings.h"

#include "Tavo_GrDrawingBuilder.h"

#include <string>

namespace Hostile {

namespace {

constexpr char Solid = 1;
constexpr char Hollow = 0;

void AddFilled(Tavo_GrDrawingBuilder& build, const Tavo_GrWRect& r, char colour)
{
    build.SetAttr(Tavo_GrAttr(colour, Solid));
    build.AddRect(r.x1, r.y1, r.x2, r.y2);
}

void BuildDegenerate(Tavo_GrDrawingBuilder& build)
{
    build.SetAttr(Tavo_GrAttr(Red, Solid));
    build.AddRect(0, 0, 0, 0);
    build.AddRect(100, 0, 100, 500);
    build.AddRect(0, 100, 500, 100);
    build.AddRect(500, 500, 300, 300); // inverted: normalised by the builder
    build.AddRect(INT_MAX, INT_MAX, INT_MIN, INT_MIN);
    build.AddCircle(250, 250, 0);
    build.AddCircle(250, 250, -50);
    build.AddTriangle({0, 0}, {0, 0}, {0, 0});
    build.AddTriangle({0, 0}, {100, 100}, {200, 200}); // on one line
    build.SetAttr(Tavo_GrAttr(Blue, Hollow));
    build.AddLine(50, 50, 50, 50);
    build.AddRect(400, 400, 400, 400);
    const Tavo_GrWPoint repeated[] = {{10, 10}, {10, 10}, {10, 10}};
    build.AddPolyline(3, repeated);
    build.AddPolygon(3, repeated);
    build.AddDot(INT_MIN, INT_MAX);
}

void BuildAbsurdText(Tavo_GrDrawingBuilder& build)
{
    build.SetAttr(Tavo_GrAttr(White, Hollow, INT_MAX));
    build.AddText(0, 0, "INT_MAX high");
    build.SetAttr(Tavo_GrAttr(Red, Hollow, 1 << 30, Tavo_GrAttr::AlignCentre | Tavo_GrAttr::AlignMiddle));
    build.AddText(INT_MAX, INT_MIN, "far corner, centred");
    build.SetAttr(Tavo_GrAttr(Blue, Hollow, -1000));
    build.AddText(0, 0, "negative height");
    build.SetAttr(Tavo_GrAttr(White, Hollow, INT_MAX));
    build.AddTextBox(Tavo_GrWRect{INT_MIN, INT_MIN, INT_MAX, INT_MAX}, "a box as high as the range");
    build.SetAttr(Tavo_GrAttr(White, Hollow, 10));
    build.AddText(-500, 0, std::string(100000, 'W').c_str());
}

// Items of every kind, all on one point: a dot, a line, a polyline and a
// polygon of no length, rectangles of no size, circles of no radius, a
// triangle of one point, in turn filled and hollow.
void BuildCrowd(Tavo_GrDrawingBuilder& build, int count)
{
    build.Reserve(count, 3 * count);
    const Tavo_GrWPoint p = CrowdPoint;
    const Tavo_GrWPoint same[] = {p, p, p};
    for (int i = 0; i < count; ++i) {
        if (i % 2 == 0)
            build.SetAttr(Tavo_GrAttr(Red, (i / 2) % 2 == 0 ? Solid : Hollow));
        switch ((i / 4) % 6) {
        case 0: build.AddDot(p.x, p.y); break;
        case 1: build.AddLine(p.x, p.y, p.x, p.y); break;
        case 2: build.AddRect(p.x, p.y, p.x, p.y); break;
        case 3: build.AddCircle(p.x, p.y, 0); break;
        case 4: build.AddTriangle(p, p, p); break;
        default: i % 2 == 0 ? build.AddPolyline(3, same) : build.AddPolygon(3, same); break;
        }
    }
}

} // namespace

std::unique_ptr<Tavo_GrDrawing> BuildStack(const Tavo_GrWRect& box, int count)
{
    auto drawing = std::make_unique<Tavo_GrDrawing>();
    Tavo_GrDrawingBuilder build(*drawing);
    build.Reserve(count, 2 * count);
    build.SetAttr(Tavo_GrAttr(Red, Solid));
    for (int i = 0; i < count; ++i)
        build.AddRect(box.x1, box.y1, box.x2, box.y2);
    return drawing;
}

const char* NameOf(Kind kind)
{
    switch (kind) {
    case Empty: return "empty";
    case OnePoint: return "one point";
    case FullRange: return "full int range";
    case Corners: return "ends of the int range";
    case Degenerate: return "degenerate items";
    case Crowd: return "crowd on one spot";
    case AbsurdText: return "absurd text";
    default: return "?";
    }
}

std::unique_ptr<Tavo_GrDrawing> Build(Kind kind, int crowd)
{
    auto drawing = std::make_unique<Tavo_GrDrawing>();
    Tavo_GrDrawingBuilder build(*drawing);
    switch (kind) {
    case Empty:
        break;
    case OnePoint:
        build.SetAttr(Tavo_GrAttr(White, Hollow));
        build.AddDot(Point.x, Point.y);
        break;
    case FullRange:
        AddFilled(build, Tavo_GrWRect{INT_MIN, INT_MIN, INT_MAX, INT_MAX}, Red);
        AddFilled(build, Middle, White);
        break;
    case Corners:
        AddFilled(build, LowCorner, Red);
        AddFilled(build, HighCorner, Red);
        AddFilled(build, LowInside, Blue);
        AddFilled(build, HighInside, Blue);
        break;
    case Degenerate:
        BuildDegenerate(build);
        break;
    case Crowd:
        BuildCrowd(build, crowd);
        break;
    case AbsurdText:
        BuildAbsurdText(build);
        break;
    default:
        break;
    }
    return drawing;
}

} // namespace Hostile
