#include "SampleDrawing.h"

#include "Tavo_GrDrawing.h"
#include "Tavo_GrDrawingBuilder.h"

#include <cmath>
#include <cstdio>

namespace {

// Built-in palette indices.
enum Colour : char {
    Black = 0,
    Blue = 1,
    Green = 2,
    Cyan = 3,
    Red = 4,
    Magenta = 5,
    Yellow = 6,
    White = 7,
    Gray = 8,
    DarkGray = 9,
    DarkBlue = 10,
    DarkGreen = 11,
    DarkCyan = 12,
    DarkRed = 13,
    DarkMagenta = 14,
    Olive = 15,
};
const char* const kColourNames[16] = {
    "black",
    "blue",
    "green",
    "cyan",
    "red",
    "magenta",
    "yellow",
    "white",
    "gray",
    "dark_gray",
    "dark_blue",
    "dark_green",
    "dark_cyan",
    "dark_red",
    "dark_magenta",
    "olive",
};

const char kHollow = 0;
const char kSolid = 1;

const char kLeftBottom = Tavo_GrAttr::AlignLeft | Tavo_GrAttr::AlignBottom;
const char kCentreBottom = Tavo_GrAttr::AlignCentre | Tavo_GrAttr::AlignBottom;

// Panel frames and titles.
const int kTitleHeight = 18;

void Panel(Tavo_GrDrawingBuilder& build, int x1, int y1, int x2, int y2, const char* title)
{
    build.SetAttr(Tavo_GrAttr(DarkGray, kHollow));
    build.AddRect(x1, y1, x2, y2);
    build.SetAttr(Tavo_GrAttr(DarkBlue, kHollow, kTitleHeight, kLeftBottom));
    build.AddText(x1 + 8, y2 - kTitleHeight - 4, title);
}

void Label(Tavo_GrDrawingBuilder& build, int x, int y, const char* text)
{
    build.SetAttr(Tavo_GrAttr(Black, kHollow, 13, kCentreBottom));
    build.AddText(x, y, text);
}

// Sixteen swatches, each filled with its colour and framed in black.
void ColourPanel(Tavo_GrDrawingBuilder& build)
{
    Panel(build, 20, 780, 1580, 940, "The sixteen built-in colours");
    for (int i = 0; i < 16; ++i) {
        const int x = 40 + i * 96;
        build.SetAttr(Tavo_GrAttr(static_cast<char>(i), kSolid));
        build.AddRect(x, 830, x + 80, 890);
        build.SetAttr(Tavo_GrAttr(Black, kHollow));
        build.AddRect(x - 2, 828, x + 82, 892);
        Label(build, x + 40, 806, kColourNames[i]);
    }
}

void DotsAndLines(Tavo_GrDrawingBuilder& build)
{
    Panel(build, 20, 420, 400, 760, "Dots, lines, polylines");
    // A grid of dots, one colour per row.
    for (int row = 0; row < 6; ++row) {
        build.SetAttr(Tavo_GrAttr(static_cast<char>(1 + row), kHollow));
        for (int col = 0; col < 20; ++col)
            build.AddDot(40 + col * 8, 700 - row * 8);
    }
    Label(build, 116, 640, "dots");
    // A fan of lines.
    build.SetAttr(Tavo_GrAttr(DarkGreen, kHollow));
    for (int i = 0; i <= 12; ++i) {
        const double angle = 3.14159265358979 * i / 24.0;
        build.AddLine(240, 600, 240 + static_cast<int>(140 * std::cos(angle)), 600 + static_cast<int>(140 * std::sin(angle)));
    }
    build.SetAttr(Tavo_GrAttr(Red, kHollow));
    build.AddLine(230, 470, 230, 590); // vertical
    Label(build, 300, 578, "lines");
    // A zig-zag polyline and a sine wave.
    Tavo_GrWPoint zigzag[9];
    for (int i = 0; i < 9; ++i)
        zigzag[i] = {40 + i * 20, (i % 2) ? 560 : 520};
    build.SetAttr(Tavo_GrAttr(Magenta, kHollow));
    build.AddPolyline(9, zigzag);
    Tavo_GrWPoint wave[40];
    for (int i = 0; i < 40; ++i)
        wave[i] = {40 + i * 4, 470 + static_cast<int>(25 * std::sin(i / 4.0))};
    build.SetAttr(Tavo_GrAttr(DarkCyan, kHollow));
    build.AddPolyline(40, wave);
    Label(build, 120, 430, "polylines");
}

void Rectangles(Tavo_GrDrawingBuilder& build)
{
    Panel(build, 420, 420, 800, 760, "Rectangles");
    const char colours[] = {Red, Green, Blue, Yellow, Cyan, Magenta};
    for (int i = 0; i < 6; ++i) {
        const int x = 440 + i * 58;
        build.SetAttr(Tavo_GrAttr(colours[i], kSolid));
        build.AddRect(x, 620, x + 44, 700);
        build.SetAttr(Tavo_GrAttr(colours[i], kHollow));
        build.AddRect(x, 510, x + 44, 590);
    }
    Label(build, 610, 596, "filled");
    Label(build, 610, 490, "outlined");
    // Overlapping filled rectangles: later colour runs are drawn on top.
    build.SetAttr(Tavo_GrAttr(DarkRed, kSolid));
    build.AddRect(460, 440, 560, 480);
    build.SetAttr(Tavo_GrAttr(Olive, kSolid));
    build.AddRect(520, 450, 620, 490);
    build.SetAttr(Tavo_GrAttr(Black, kHollow));
    build.AddRect(700, 450, 700, 450); // one pixel
    build.AddRect(720, 440, 780, 480);
}

void Circles(Tavo_GrDrawingBuilder& build)
{
    Panel(build, 820, 420, 1200, 760, "Circles");
    const char colours[] = {DarkBlue, DarkGreen, DarkCyan, DarkRed, DarkMagenta};
    for (int i = 0; i < 5; ++i) {
        const int x = 870 + i * 70;
        build.SetAttr(Tavo_GrAttr(colours[i], kSolid));
        build.AddCircle(x, 660, 10 + i * 5);
        build.SetAttr(Tavo_GrAttr(colours[i], kHollow));
        build.AddCircle(x, 560, 10 + i * 5);
    }
    Label(build, 1010, 610, "filled");
    Label(build, 1010, 510, "outlined");
    // Concentric rings and the smallest circles (drawn as tiny triangles).
    build.SetAttr(Tavo_GrAttr(Blue, kHollow));
    for (int r = 4; r <= 40; r += 6)
        build.AddCircle(900, 460, r);
    build.SetAttr(Tavo_GrAttr(Red, kSolid));
    for (int i = 0; i < 8; ++i)
        build.AddCircle(980 + i * 20, 460, i % 3);
    Label(build, 1060, 436, "tiny circles");
}

void Triangles(Tavo_GrDrawingBuilder& build)
{
    Panel(build, 1220, 420, 1580, 760, "Triangles");
    const char colours[] = {Red, Green, Blue, Olive};
    for (int i = 0; i < 4; ++i) {
        const int x = 1250 + i * 80;
        build.SetAttr(Tavo_GrAttr(colours[i], kSolid));
        build.AddTriangle({x, 620}, {x + 60, 620}, {x + 30, 700});
        build.SetAttr(Tavo_GrAttr(colours[i], kHollow));
        build.AddTriangle({x, 520}, {x + 60, 520}, {x + 30, 600});
    }
    Label(build, 1400, 596, "filled");
    Label(build, 1400, 496, "outlined");
    // Tiny outlined triangles are drawn open.
    build.SetAttr(Tavo_GrAttr(Black, kHollow));
    for (int i = 0; i < 10; ++i)
        build.AddTriangle({1260 + i * 30, 460}, {1263 + i * 30, 457}, {1257 + i * 30, 457});
    Tavo_GrWPoint star[5] = {{1400, 440}, {1420, 480}, {1440, 440}, {1395, 465}, {1445, 465}};
    build.SetAttr(Tavo_GrAttr(Magenta, kSolid));
    build.AddPolygon(5, star);
    Label(build, 1330, 436, "tiny / polygon");
}

void Texts(Tavo_GrDrawingBuilder& build)
{
    Panel(build, 20, 20, 1000, 400, "Text sizes and alignments");
    const int sizes[] = {10, 14, 20, 28, 40};
    int y = 320;
    for (int size : sizes) {
        build.SetAttr(Tavo_GrAttr(Black, kHollow, size, kLeftBottom));
        char text[48];
        std::snprintf(text, sizeof text, "Text %d units high", size);
        build.AddText(40, y, text);
        y -= size + 14;
    }
    // A marker cross at each anchor, with the text aligned around it.
    struct Anchor {
        char align;
        const char* text;
    };
    const Anchor anchors[] = {
        {Tavo_GrAttr::AlignLeft | Tavo_GrAttr::AlignBottom, "left bottom"},
        {Tavo_GrAttr::AlignCentre | Tavo_GrAttr::AlignBottom, "centre bottom"},
        {Tavo_GrAttr::AlignRight | Tavo_GrAttr::AlignBottom, "right bottom"},
        {Tavo_GrAttr::AlignLeft | Tavo_GrAttr::AlignTop, "left top"},
        {Tavo_GrAttr::AlignCentre | Tavo_GrAttr::AlignMiddle, "centre middle"},
        {Tavo_GrAttr::AlignRight | Tavo_GrAttr::AlignTop, "right top"},
    };
    for (int i = 0; i < 6; ++i) {
        const int x = 560 + (i % 3) * 150;
        const int ay = 300 - (i / 3) * 90;
        build.SetAttr(Tavo_GrAttr(Red, kHollow));
        build.AddLine(x - 8, ay, x + 8, ay);
        build.AddLine(x, ay - 8, x, ay + 8);
        build.SetAttr(Tavo_GrAttr(DarkBlue, kHollow, 16, anchors[i].align));
        build.AddText(x, ay, anchors[i].text);
    }
    // Text too small to read becomes a thin line.
    build.SetAttr(Tavo_GrAttr(Gray, kHollow, 1, kLeftBottom));
    build.AddText(560, 110, "far too small to read at this scale");
    build.SetAttr(Tavo_GrAttr(Black, kHollow, 13, kLeftBottom));
    build.AddText(560, 80, "(tiny text above is drawn as a line)");
}

void TextBoxes(Tavo_GrDrawingBuilder& build)
{
    Panel(build, 1020, 20, 1580, 400, "Text wrapped in boxes");
    const Tavo_GrWRect wide = {1040, 200, 1300, 340};
    const Tavo_GrWRect low = {1320, 280, 1560, 340};
    build.SetAttr(Tavo_GrAttr(Cyan, kHollow));
    build.AddRect(wide.x1, wide.y1, wide.x2, wide.y2);
    build.AddRect(low.x1, low.y1, low.x2, low.y2);
    const char* text = "Text in a box breaks at any character when a line is full, and is cut "
                       "with three dots when the box is too low for the rest.";
    build.SetAttr(Tavo_GrAttr(DarkGreen, kHollow, 18, kLeftBottom));
    build.AddTextBox(wide, text);
    build.SetAttr(Tavo_GrAttr(DarkRed, kHollow, 18, kLeftBottom));
    build.AddTextBox(low, text);
    Label(build, 1170, 180, "wrapped");
    Label(build, 1440, 260, "cut");
    // A filled shape behind a box.
    build.SetAttr(Tavo_GrAttr(Yellow, kSolid));
    build.AddRect(1320, 60, 1560, 160);
    build.SetAttr(Tavo_GrAttr(Black, kHollow, 22, kLeftBottom));
    build.AddTextBox({1330, 60, 1550, 150}, "Black text on a yellow box");
}

} // namespace

void BuildSampleDrawing(Tavo_GrDrawing& drawing)
{
    Tavo_GrDrawingBuilder build(drawing);
    build.BeginLayer("sample");
    // The frame gives the drawing its exact world size.
    build.SetAttr(Tavo_GrAttr(Black, kHollow));
    build.AddRect(0, 0, kSampleWidth, kSampleHeight);
    build.SetAttr(Tavo_GrAttr(Black, kHollow, 34, kCentreBottom));
    build.AddText(kSampleWidth / 2, 955, "libTavo_Windows: the GDI rendering surface");
    ColourPanel(build);
    DotsAndLines(build);
    Rectangles(build);
    Circles(build);
    Triangles(build);
    Texts(build);
    TextBoxes(build);
}
