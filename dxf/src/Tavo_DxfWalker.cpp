// Tavo_DxfWalker: entities to plane shapes, inserts expanded.
#include "Tavo_DxfWalker.h"

#include "Tavo_DxfText.h"
#include "Tavo_GrAttr.h"

#include <algorithm>
#include <cmath>

namespace {

// MTEXT lines are 5/3 of the character height apart at a spacing factor of 1;
// factors outside these bounds are not what a drawing means.
constexpr double kMTextLinePitch = 5.0 / 3.0;
constexpr double kSmallestLineSpacing = 0.25;
constexpr double kLargestLineSpacing = 4.0;

// TEXT justification codes (group 72 and 73).
constexpr int kTextLeft = 0;
constexpr int kTextCentre = 1;
constexpr int kTextRight = 2;
constexpr int kTextAligned = 3;
constexpr int kTextMiddle = 4;
constexpr int kTextFit = 5;
constexpr int kTextBaseline = 0;
constexpr int kTextBottom = 1;
constexpr int kTextVerticalMiddle = 2;
constexpr int kTextTop = 3;

char HorizontalAlign(int column)
{
    return column == 1 ? Tavo_GrAttr::AlignCentre : column == 2 ? Tavo_GrAttr::AlignRight
                                                                : Tavo_GrAttr::AlignLeft;
}

char VerticalAlign(int row)
{
    return row == 0 ? Tavo_GrAttr::AlignTop : row == 1 ? Tavo_GrAttr::AlignMiddle
                                                       : Tavo_GrAttr::AlignBottom;
}

double Length(const Tavo_DxfXY& v)
{
    return std::sqrt(v.x * v.x + v.y * v.y);
}

const char* KindName(const Tavo_DxfEntity& entity)
{
    switch (entity.kind) {
    case Tavo_DxfKind::Line: return "LINE";
    case Tavo_DxfKind::Polyline: return "POLYLINE";
    case Tavo_DxfKind::Circle: return "CIRCLE";
    case Tavo_DxfKind::Arc: return "ARC";
    case Tavo_DxfKind::Ellipse: return "ELLIPSE";
    case Tavo_DxfKind::Text: return "TEXT";
    case Tavo_DxfKind::MText: return "MTEXT";
    case Tavo_DxfKind::Solid: return "SOLID";
    case Tavo_DxfKind::Point: return "POINT";
    case Tavo_DxfKind::Insert: return "INSERT";
    }
    return "entity";
}

} // namespace

Tavo_DxfWalker::Tavo_DxfWalker(const Tavo_DxfModel& model, Tavo_DxfSink& sink, const Tavo_DxfFlattening& flattening,
                               const Tavo_DxfLimits& limits, Tavo_DxfWarnings* warnings)
    : m_model(model), m_sink(sink), m_flattening(flattening), m_limits(limits), m_warnings(warnings),
      m_utf8(model.TextIsUtf8())
{
    auto zero = model.layerIndex.find("0");
    m_layerZero = zero == model.layerIndex.end() ? -1 : zero->second;
}

bool Tavo_DxfWalker::Walk()
{
    Context top;
    top.byBlock = Tavo_DxfRgb{}; // "by block" outside any block: the foreground
    for (const Tavo_DxfEntity& entity : m_model.entities) {
        m_current = &entity;
        Entity(entity, top);
        if (m_failed)
            return false;
    }
    return true;
}

bool Tavo_DxfWalker::Fail(std::string message)
{
    if (!m_failed) {
        m_failed = true;
        m_error = std::move(message);
        m_errorLine = m_current ? m_current->line : 0;
    }
    return false;
}

void Tavo_DxfWalker::Skip(const Tavo_DxfEntity& entity, const std::string& why)
{
    ++m_skipped;
    if (m_warnings)
        m_warnings->Add(entity.line, std::string(KindName(entity)) + ": skipped, " + why);
}

bool Tavo_DxfWalker::Count(long long items, long long points, long long textBytes)
{
    if (m_items + items > m_limits.maxItems)
        return Fail("the drawing expands to more than " + std::to_string(m_limits.maxItems) + " items (lines, polylines, texts ...), the most an import makes");
    if (m_points + points > m_limits.maxPoints)
        return Fail("the drawing expands to more than " + std::to_string(m_limits.maxPoints) + " points, the most an import makes");
    if (m_textBytes + textBytes > m_limits.maxTextBytes)
        return Fail("the drawing expands to more than " + std::to_string(m_limits.maxTextBytes) + " bytes of text, the most an import makes");
    m_items += items;
    m_points += points;
    m_textBytes += textBytes;
    return true;
}

bool Tavo_DxfWalker::InRange(const Tavo_DxfXY& p) const
{
    return std::fabs(p.x) <= kLargestWorldCoordinate && std::fabs(p.y) <= kLargestWorldCoordinate;
}

bool Tavo_DxfWalker::ScratchInRange() const
{
    for (const Tavo_DxfXY& p : m_scratch)
        if (!InRange(p))
            return false;
    return true;
}

Tavo_DxfFlattening Tavo_DxfWalker::LocalFlattening(const Tavo_DxfAffine& t) const
{
    Tavo_DxfFlattening local = m_flattening;
    const double stretch = std::max(Length({t.a, t.d}), Length({t.b, t.e}));
    if (local.tolerance > 0.0)
        local.tolerance = stretch > 0.0 ? local.tolerance / stretch : 0.0;
    return local;
}

int Tavo_DxfWalker::EffectiveLayer(const Tavo_DxfEntity& entity, const Context& context) const
{
    if (context.insertLayer >= 0 && entity.layer == m_layerZero)
        return context.insertLayer;
    return entity.layer;
}

Tavo_DxfRgb Tavo_DxfWalker::ColourOf(const Tavo_DxfEntity& entity, int layer, const Context& context) const
{
    if (entity.hasTrueColour)
        return Tavo_DxfRgb::FromPacked(entity.trueColour);
    int aci = entity.colour;
    if (aci == kTavo_DxfByBlock)
        return context.byBlock;
    if (aci == kTavo_DxfByLayer || aci == -kTavo_DxfByLayer) {
        const Tavo_DxfLayer& owner = m_model.layers[layer];
        if (owner.hasTrueColour)
            return Tavo_DxfRgb::FromPacked(owner.trueColour);
        aci = owner.colour;
    }
    aci = std::abs(aci);
    if (aci == 0 || aci > 255 || aci == kTavo_DxfAciForeground)
        return Tavo_DxfRgb{}; // drawn on white: the foreground is black
    return Tavo_DxfAciColour(aci);
}

void Tavo_DxfWalker::Entity(const Tavo_DxfEntity& entity, const Context& context)
{
    if (m_failed)
        return;
    if (++m_work > m_limits.maxWork) {
        Fail("the drawing's inserts expand to more than " + std::to_string(m_limits.maxWork) + " entities, the most an import visits");
        return;
    }
    if (entity.kind == Tavo_DxfKind::Insert) {
        Insert(entity, context);
        return;
    }
    Tavo_DxfStyle style;
    style.layer = EffectiveLayer(entity, context);
    style.colour = ColourOf(entity, style.layer, context);
    const Tavo_DxfAffine& t = context.transform;

    switch (entity.kind) {
    case Tavo_DxfKind::Line: {
        const Tavo_DxfXY p = t.Apply(entity.p[0].x, entity.p[0].y);
        const Tavo_DxfXY q = t.Apply(entity.p[1].x, entity.p[1].y);
        if (!InRange(p) || !InRange(q))
            return Skip(entity, "its coordinates are out of range once its inserts are applied");
        if (Count(1, 2, 0))
            m_sink.Line(style, p, q);
        return;
    }
    case Tavo_DxfKind::Point: {
        const Tavo_DxfXY p = t.Apply(entity.p[0].x, entity.p[0].y);
        if (!InRange(p))
            return Skip(entity, "its coordinates are out of range once its inserts are applied");
        if (Count(1, 1, 0))
            m_sink.Dot(style, p);
        return;
    }
    case Tavo_DxfKind::Circle: return Circle(entity, context, style);
    case Tavo_DxfKind::Arc: return Arc(entity, context, style);
    case Tavo_DxfKind::Ellipse: return Ellipse(entity, context, style);
    case Tavo_DxfKind::Polyline: return Polyline(entity, context, style);
    case Tavo_DxfKind::Solid: return Solid(entity, context, style);
    case Tavo_DxfKind::Text: return Text(entity, context, style);
    case Tavo_DxfKind::MText: return MText(entity, context, style);
    case Tavo_DxfKind::Insert: return;
    }
}

void Tavo_DxfWalker::EmitPolyline(const Tavo_DxfStyle& style, bool closed)
{
    // Repeated points draw nothing; dropping them keeps zero-length segments
    // out of the core.
    auto last = std::unique(m_scratch.begin(), m_scratch.end(),
                            [](const Tavo_DxfXY& a, const Tavo_DxfXY& b) { return a.x == b.x && a.y == b.y; });
    m_scratch.erase(last, m_scratch.end());
    if (closed && m_scratch.size() > 1 && m_scratch.front().x == m_scratch.back().x && m_scratch.front().y == m_scratch.back().y)
        m_scratch.pop_back();
    if (m_scratch.empty())
        return;
    if (m_scratch.size() == 1) {
        if (Count(1, 1, 0))
            m_sink.Dot(style, m_scratch[0]);
        return;
    }
    closed = closed && m_scratch.size() > 2;
    if (Count(1, static_cast<long long>(m_scratch.size()) + (closed ? 1 : 0), 0))
        m_sink.Polyline(style, m_scratch, closed);
}

void Tavo_DxfWalker::EmitText(const Tavo_DxfStyle& style, const Tavo_DxfTextPlacement& placement,
                              const std::string& text)
{
    if (text.empty() || text.find_first_not_of(' ') == std::string::npos)
        return;
    if (!InRange(placement.anchor) || !(placement.height <= kLargestWorldCoordinate))
        return;
    if (Count(1, 1, static_cast<long long>(text.size()) + 1))
        m_sink.Text(style, placement, text);
}

void Tavo_DxfWalker::Circle(const Tavo_DxfEntity& entity, const Context& context, const Tavo_DxfStyle& style)
{
    if (entity.radius < 0.0)
        return Skip(entity, "its radius is negative");
    const Tavo_DxfAffine t = context.transform.After(Tavo_DxfObjectToWorld(entity.normal, entity.p[0].z));
    const Tavo_DxfXY centre = t.Apply(entity.p[0].x, entity.p[0].y);
    if (!InRange(centre))
        return Skip(entity, "its coordinates are out of range once its inserts are applied");
    if (entity.radius == 0.0) {
        if (Count(1, 1, 0))
            m_sink.Dot(style, centre);
        return;
    }
    if (t.IsSimilarity()) {
        const double radius = entity.radius * t.LengthFactor();
        if (!(radius <= kLargestWorldCoordinate))
            return Skip(entity, "its radius is out of range once its inserts are applied");
        if (Count(1, 1, 0))
            m_sink.Circle(style, centre, radius);
        return;
    }
    // Scaled unevenly by its inserts: an ellipse.
    m_scratch.clear();
    Tavo_DxfAppendArc(m_scratch, entity.p[0].x, entity.p[0].y, entity.radius, 0.0, 2.0 * kTavo_DxfPi,
                      LocalFlattening(t));
    for (Tavo_DxfXY& p : m_scratch)
        p = t.Apply(p.x, p.y);
    if (!ScratchInRange())
        return Skip(entity, "its coordinates are out of range once its inserts are applied");
    EmitPolyline(style, true);
}

void Tavo_DxfWalker::Arc(const Tavo_DxfEntity& entity, const Context& context, const Tavo_DxfStyle& style)
{
    if (entity.radius < 0.0)
        return Skip(entity, "its radius is negative");
    const Tavo_DxfAffine t = context.transform.After(Tavo_DxfObjectToWorld(entity.normal, entity.p[0].z));
    const double sweep = Tavo_DxfArcSweep(entity.start, entity.end);
    const double from = std::fmod(entity.start, 360.0) * kTavo_DxfPi / 180.0;
    m_scratch.clear();
    Tavo_DxfAppendArc(m_scratch, entity.p[0].x, entity.p[0].y, entity.radius, from, sweep, LocalFlattening(t));
    for (Tavo_DxfXY& p : m_scratch)
        p = t.Apply(p.x, p.y);
    if (!ScratchInRange())
        return Skip(entity, "its coordinates are out of range once its inserts are applied");
    EmitPolyline(style, false);
}

void Tavo_DxfWalker::Ellipse(const Tavo_DxfEntity& entity, const Context& context, const Tavo_DxfStyle& style)
{
    // Centre and major axis are world points; the minor axis is the major one
    // turned a quarter about the extrusion direction and shortened by the ratio.
    const Tavo_DxfPoint& n = entity.normal;
    const Tavo_DxfPoint& major = entity.p[1];
    const double nLength = std::sqrt(n.x * n.x + n.y * n.y + n.z * n.z);
    const double nx = nLength > 0 ? n.x / nLength : 0.0;
    const double ny = nLength > 0 ? n.y / nLength : 0.0;
    const double nz = nLength > 0 ? n.z / nLength : 1.0;
    const double ratio = std::min(std::fabs(entity.ratio), 1.0);
    const Tavo_DxfXY minor{ratio * (ny * major.z - nz * major.y), ratio * (nz * major.x - nx * major.z)};
    const double majorLength = Length({major.x, major.y});
    if (majorLength == 0.0 && Length(minor) == 0.0)
        return Skip(entity, "its axes have no length");

    double sweep = std::fmod(entity.end - entity.start, 2.0 * kTavo_DxfPi);
    if (sweep <= 1e-12)
        sweep += 2.0 * kTavo_DxfPi;
    const bool full = sweep >= 2.0 * kTavo_DxfPi - 1e-9;
    const Tavo_DxfFlattening flattening = LocalFlattening(context.transform);
    const int segments = flattening.Segments(sweep, std::max(majorLength, Length(minor)));
    m_scratch.clear();
    for (int i = 0; i <= segments; ++i) {
        const double u = entity.start + sweep * i / segments;
        const double x = entity.p[0].x + major.x * std::cos(u) + minor.x * std::sin(u);
        const double y = entity.p[0].y + major.y * std::cos(u) + minor.y * std::sin(u);
        m_scratch.push_back(context.transform.Apply(x, y));
    }
    if (!ScratchInRange())
        return Skip(entity, "its coordinates are out of range once its inserts are applied");
    EmitPolyline(style, full);
}

void Tavo_DxfWalker::Polyline(const Tavo_DxfEntity& entity, const Context& context, const Tavo_DxfStyle& style)
{
    if (entity.vertices.empty())
        return;
    const Tavo_DxfAffine t = entity.inWorld
        ? context.transform
        : context.transform.After(Tavo_DxfObjectToWorld(entity.normal, entity.elevation));
    const Tavo_DxfFlattening flattening = LocalFlattening(t);
    m_scratch.clear();
    const size_t count = entity.vertices.size();
    m_scratch.push_back({entity.vertices[0].x, entity.vertices[0].y});
    for (size_t i = 0; i < count; ++i) {
        const bool last = i + 1 == count;
        if (last && !entity.closed)
            break;
        const Tavo_DxfVertex& from = entity.vertices[i];
        const Tavo_DxfVertex& to = entity.vertices[last ? 0 : i + 1];
        // 3-D polylines have no bulges.
        const double bulge = entity.inWorld ? 0.0 : from.bulge;
        Tavo_DxfAppendBulge(m_scratch, {from.x, from.y}, {to.x, to.y}, bulge, flattening);
        if (static_cast<long long>(m_scratch.size()) > m_limits.maxPoints) {
            Fail("a polyline has more than " + std::to_string(m_limits.maxPoints) + " points");
            return;
        }
    }
    for (Tavo_DxfXY& p : m_scratch)
        p = t.Apply(p.x, p.y);
    if (!ScratchInRange())
        return Skip(entity, "its coordinates are out of range once its inserts are applied");
    // A closed polyline came back to its first vertex; EmitPolyline drops the
    // repeated point and closes it.
    EmitPolyline(style, entity.closed);
}

void Tavo_DxfWalker::Solid(const Tavo_DxfEntity& entity, const Context& context, const Tavo_DxfStyle& style)
{
    if (entity.corners < 3)
        return Skip(entity, "it has fewer than three corners");
    const Tavo_DxfAffine t = context.transform.After(Tavo_DxfObjectToWorld(entity.normal, entity.p[0].z));
    // The corners of a SOLID go round as 1, 2, 4, 3; a missing fourth one
    // is the third.
    const Tavo_DxfPoint& third = entity.p[2];
    const Tavo_DxfPoint& fourth = entity.corners >= 4 ? entity.p[3] : entity.p[2];
    const bool triangle = fourth.x == third.x && fourth.y == third.y;
    Tavo_DxfXY corners[4] = {t.Apply(entity.p[0].x, entity.p[0].y), t.Apply(entity.p[1].x, entity.p[1].y),
                             t.Apply(fourth.x, fourth.y), t.Apply(third.x, third.y)};
    const int count = triangle ? 3 : 4;
    if (triangle)
        corners[2] = corners[3];
    for (int i = 0; i < count; ++i)
        if (!InRange(corners[i]))
            return Skip(entity, "its coordinates are out of range once its inserts are applied");
    if (Count(1, count, 0))
        m_sink.Polygon(style, corners, count);
}

void Tavo_DxfWalker::Text(const Tavo_DxfEntity& entity, const Context& context, const Tavo_DxfStyle& style)
{
    const Tavo_DxfAffine t = context.transform.After(Tavo_DxfObjectToWorld(entity.normal, entity.p[0].z));
    const bool aligned = entity.horizontal != kTextLeft || entity.vertical != kTextBaseline;
    Tavo_DxfPoint at = aligned && entity.hasAlignmentPoint ? entity.p[1] : entity.p[0];
    char horizontal = Tavo_GrAttr::AlignLeft;
    char vertical = Tavo_GrAttr::AlignBottom;
    switch (entity.horizontal) {
    case kTextCentre: horizontal = Tavo_GrAttr::AlignCentre; break;
    case kTextRight: horizontal = Tavo_GrAttr::AlignRight; break;
    case kTextMiddle:
        horizontal = Tavo_GrAttr::AlignCentre;
        vertical = Tavo_GrAttr::AlignMiddle;
        break;
    case kTextAligned:
    case kTextFit:
        // Spread between the two points: shown centred between them.
        horizontal = Tavo_GrAttr::AlignCentre;
        if (entity.hasAlignmentPoint)
            at = {(entity.p[0].x + entity.p[1].x) / 2.0, (entity.p[0].y + entity.p[1].y) / 2.0, 0.0};
        break;
    default: break;
    }
    if (entity.horizontal != kTextMiddle) {
        switch (entity.vertical) {
        case kTextVerticalMiddle: vertical = Tavo_GrAttr::AlignMiddle; break;
        case kTextTop: vertical = Tavo_GrAttr::AlignTop; break;
        case kTextBottom:
        case kTextBaseline:
        default: break;
        }
    }
    Tavo_DxfTextPlacement placement;
    placement.anchor = t.Apply(at.x, at.y);
    const double height = entity.height > 0.0 ? entity.height : kDefaultTextHeight;
    placement.height = height * Length(t.ApplyVector(0.0, 1.0));
    placement.align = static_cast<char>(horizontal | vertical);
    EmitText(style, placement, Tavo_DxfPlainText(entity.text, m_utf8));
}

void Tavo_DxfWalker::MText(const Tavo_DxfEntity& entity, const Context& context, const Tavo_DxfStyle& style)
{
    const std::vector<std::string> lines = Tavo_DxfPlainMText(entity.text, m_utf8);
    // Attachment points 1 ... 9: top left, top centre, ... bottom right.
    const int attachment = entity.horizontal >= 1 && entity.horizontal <= 9 ? entity.horizontal - 1 : 0;
    const int row = attachment / 3;
    const int column = attachment % 3;
    const double height = entity.height > 0.0 ? entity.height : kDefaultTextHeight;
    const double pitch = height * kMTextLinePitch * std::clamp(entity.lineSpacing, kSmallestLineSpacing, kLargestLineSpacing);
    const double heightFactor = Length(context.transform.ApplyVector(0.0, 1.0));
    const int count = static_cast<int>(lines.size());
    for (int i = 0; i < count && !m_failed; ++i) {
        // The block of lines hangs from, centres on or stands on the point.
        const double offset = row == 0 ? -i * pitch : row == 1 ? ((count - 1) / 2.0 - i) * pitch
                                                               : (count - 1 - i) * pitch;
        Tavo_DxfTextPlacement placement;
        placement.anchor = context.transform.Apply(entity.p[0].x, entity.p[0].y + offset);
        placement.height = height * heightFactor;
        placement.align = static_cast<char>(HorizontalAlign(column) | VerticalAlign(row));
        EmitText(style, placement, lines[i]);
    }
}

void Tavo_DxfWalker::Insert(const Tavo_DxfEntity& entity, const Context& context)
{
    if (entity.text.empty())
        return Skip(entity, "it names no block");
    const int block = m_model.BlockNamed(entity.text);
    const std::string quoted = "\"" + entity.text.substr(0, 60) + "\"";
    if (block < 0)
        return Skip(entity, "block " + quoted + " is not defined");
    if (std::find(m_activeBlocks.begin(), m_activeBlocks.end(), block) != m_activeBlocks.end())
        return Skip(entity, "block " + quoted + " inserts itself (a cyclic block reference)");
    if (context.depth >= m_limits.maxInsertDepth)
        return Skip(entity, "inserts are nested deeper than " + std::to_string(m_limits.maxInsertDepth));
    if (entity.scaleX == 0.0 || entity.scaleY == 0.0)
        return Skip(entity, "its scale is zero");

    Context inner;
    inner.insertLayer = EffectiveLayer(entity, context);
    inner.byBlock = ColourOf(entity, inner.insertLayer, context);
    inner.depth = context.depth + 1;
    const Tavo_DxfBlock& definition = m_model.blocks[block];
    const Tavo_DxfAffine placement = context.transform.After(Tavo_DxfObjectToWorld(entity.normal, entity.p[0].z))
                                         .After(Tavo_DxfAffine::Translation(entity.p[0].x, entity.p[0].y))
                                         .After(Tavo_DxfAffine::ScaleRotate(1.0, 1.0, entity.rotation));
    const Tavo_DxfAffine scaling = Tavo_DxfAffine::ScaleRotate(entity.scaleX, entity.scaleY, 0.0)
                                       .After(Tavo_DxfAffine::Translation(-definition.base.x, -definition.base.y));

    m_activeBlocks.push_back(block);
    for (int r = 0; r < entity.rows && !m_failed; ++r) {
        for (int c = 0; c < entity.columns && !m_failed; ++c) {
            // Array copies are spaced along the insert's turned axes.
            inner.transform = placement.After(Tavo_DxfAffine::Translation(c * entity.columnSpacing, r * entity.rowSpacing))
                                  .After(scaling);
            if (++m_work > m_limits.maxWork) {
                Fail("the drawing's inserts expand to more than " + std::to_string(m_limits.maxWork) + " entities, the most an import visits");
                break;
            }
            for (const Tavo_DxfEntity& child : definition.entities) {
                Entity(child, inner);
                if (m_failed)
                    break;
            }
        }
    }
    m_activeBlocks.pop_back();
}
