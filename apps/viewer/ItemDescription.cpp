#include "ItemDescription.h"

namespace {

// Texts longer than this are cut, so that one item cannot fill the status bar.
constexpr size_t LongestQuotedText = 40;

bool IsClosedShape(Tavo_GrItemKind kind)
{
    switch (kind) {
    case Tavo_GrItemKind::Polygon:
    case Tavo_GrItemKind::Rect:
    case Tavo_GrItemKind::Circle:
    case Tavo_GrItemKind::Triangle: return true;
    default: return false;
    }
}

std::string Quoted(const char* text)
{
    std::string quoted(text);
    if (quoted.size() > LongestQuotedText)
        quoted = quoted.substr(0, LongestQuotedText - 3) + "...";
    return "\"" + quoted + "\"";
}

} // namespace

namespace ItemDescription {

std::string KindName(Tavo_GrItemKind kind, bool filled)
{
    const char* name = "item";
    switch (kind) {
    case Tavo_GrItemKind::Dot: name = "dot"; break;
    case Tavo_GrItemKind::Line: name = "line"; break;
    case Tavo_GrItemKind::Polyline: name = "polyline"; break;
    case Tavo_GrItemKind::Polygon: name = "polygon"; break;
    case Tavo_GrItemKind::Rect: name = "rectangle"; break;
    case Tavo_GrItemKind::Circle: name = "circle"; break;
    case Tavo_GrItemKind::Triangle: name = "triangle"; break;
    case Tavo_GrItemKind::Text: name = "text"; break;
    case Tavo_GrItemKind::TextBox: name = "text box"; break;
    case Tavo_GrItemKind::Call: name = "symbol"; break;
    }
    return filled && IsClosedShape(kind) ? std::string("filled ") + name : name;
}

std::string Describe(const Tavo_GrItemInfo& topmost, int count, const DrawingUnits& units)
{
    std::string text = "Layer \"";
    text += topmost.layer ? topmost.layer->GetName() : "";
    text += "\": " + KindName(topmost.kind, !topmost.attr.IsHollow());
    if (topmost.text)
        text += " " + Quoted(topmost.text);
    const double width = static_cast<double>(topmost.bounds.x2) - topmost.bounds.x1;
    const double height = static_cast<double>(topmost.bounds.y2) - topmost.bounds.y1;
    text += ", " + DrawingUnitsText::Length(units.ToDrawingLength(width)) + " x " +
        DrawingUnitsText::Length(units.ToDrawingLength(height));
    if (count > 1)
        text += " (and " + std::to_string(count - 1) + " more)";
    return text;
}

std::string DescribeAperture(const Tavo_GrDrawing& drawing, const Tavo_GrWRect& aperture, const DrawingUnits& units)
{
    Tavo_GrItemInfo topmost;
    const int count = drawing.FindItems(aperture, [&topmost](const Tavo_GrItemInfo& info) {
        topmost = info;
        return true;
    });
    return count == 0 ? std::string("Nothing here") : Describe(topmost, count, units);
}

} // namespace ItemDescription
