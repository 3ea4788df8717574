#include "SitePlan.h"

#include "Tavo_GrDrawingBuilder.h"
#include "Tavo_WiLibrary.h"
#include "Tavo_WiPalette.h"

namespace {

constexpr char kOutline = 0;
constexpr char kFilled = 1;

// Colours are looked up by name in the library's palette; the sixteen
// built-in names are listed in Tavo_WiPalette.h.
char Colour(const char* name)
{
    constexpr char kBlack = 0;
    return Tavo_WiLibrary::GetPalette()->GetUserNamedColor(name, kBlack);
}

void House(Tavo_GrDrawingBuilder& build, int x, int y, int width, int height, const char* name)
{
    build.SetAttr(Tavo_GrAttr(Colour("red"), kFilled));
    build.AddRect(x, y, x + width, y + height);
    build.SetAttr(Tavo_GrAttr(Colour("black"), kOutline));
    build.AddRect(x, y, x + width, y + height);
    build.SetAttr(Tavo_GrAttr(Colour("white"), kOutline, 16, Tavo_GrAttr::AlignCentre | Tavo_GrAttr::AlignMiddle));
    build.AddText(x + width / 2, y + height / 2, name);
}

void Tree(Tavo_GrDrawingBuilder& build, int x, int y)
{
    build.SetAttr(Tavo_GrAttr(Colour("dark_green"), kFilled));
    build.AddCircle(x, y, 18);
}

} // namespace

void BuildSitePlan(Tavo_GrDrawing& drawing)
{
    Tavo_GrDrawingBuilder build(drawing);

    // Layers are drawn in the order they are made: ground first.
    build.BeginLayer("ground");
    build.SetAttr(Tavo_GrAttr(Colour("green"), kFilled));
    build.AddRect(0, 0, 1200, 800);
    build.SetAttr(Tavo_GrAttr(Colour("blue"), kFilled));
    build.AddCircle(600, 400, 140);
    build.SetAttr(Tavo_GrAttr(Colour("dark_blue"), kOutline, 24, Tavo_GrAttr::AlignCentre | Tavo_GrAttr::AlignTop));
    build.AddText(600, 250, "Pond");

    build.BeginLayer("roads");
    build.SetAttr(Tavo_GrAttr(Colour("dark_gray"), kFilled));
    build.AddRect(0, 60, 1200, 120);
    build.AddRect(120, 120, 180, 800);
    build.SetAttr(Tavo_GrAttr(Colour("yellow"), kOutline));
    build.AddLine(0, 90, 1200, 90);
    build.AddLine(150, 120, 150, 800);

    build.BeginLayer("buildings");
    House(build, 240, 560, 200, 140, "Hall");
    House(build, 240, 200, 120, 100, "Store");
    House(build, 880, 540, 180, 180, "Lodge");
    House(build, 900, 180, 140, 90, "Shed");

    build.BeginLayer("trees");
    for (int x = 760; x <= 840; x += 40) {
        for (int y = 300; y <= 500; y += 50)
            Tree(build, x, y);
    }

    build.BeginLayer("labels");
    build.SetAttr(Tavo_GrAttr(Colour("black"), kOutline, 36, Tavo_GrAttr::AlignLeft | Tavo_GrAttr::AlignTop));
    build.AddText(220, 760, "Site plan");
    build.SetAttr(Tavo_GrAttr(Colour("white"), kOutline, 14, Tavo_GrAttr::AlignLeft | Tavo_GrAttr::AlignMiddle));
    build.AddText(200, 90, "Lake Road");
}
