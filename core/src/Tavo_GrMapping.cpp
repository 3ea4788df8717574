// Tavo_GrMapping: zero level, zoom levels, panning and the world clip box.
// The zoom model is written down in Tavo_GrMapping.h.
#include "Tavo_GrMapping.h"

#include "Tavo_GrDrawing.h"
#include "Tavo_GrRound.h"

#include <algorithm>
#include <cmath>

namespace {

// Levels this close to a whole number are that number: zooms that reach a
// whole level through logarithms must read back exactly.
constexpr double kLevelSnap = 1e-9;
// A view that moved by less than this many device pixels did not change.
constexpr double kPixelTolerance = 1e-6;

double SnapLevel(double level)
{
    const double whole = std::round(level);
    return std::fabs(level - whole) < kLevelSnap ? whole : level;
}

bool SameView(const Tavo_GrTransform& a, const Tavo_GrTransform& b)
{
    if (std::fabs(a.GetScale() - b.GetScale()) > 1e-12 * b.GetScale())
        return false;
    const double s = b.GetScale();
    return std::fabs((a.GetXOrigin() - b.GetXOrigin()) * s) < kPixelTolerance && std::fabs((a.GetYOrigin() - b.GetYOrigin()) * s) < kPixelTolerance && std::fabs(a.GetXError() - b.GetXError()) < kPixelTolerance && std::fabs(a.GetYError() - b.GetYError()) < kPixelTolerance;
}

} // namespace

Tavo_GrMapping::Tavo_GrMapping(const Tavo_GrDrawing* drawing, int levelsPerDoubling)
    : m_drawing(drawing), m_levelsPerDoubling(levelsPerDoubling < 1 ? 1 : levelsPerDoubling)
{
    m_maxZoomLevel = kDefaultMaxZoomLevelsPerStep * m_levelsPerDoubling;
    // Until the device window is known, the drawing is shown at scale 1 from
    // the bottom-left corner of its bounds.
    const Tavo_GrWRect bounds = drawing ? drawing->GetBounds() : Tavo_GrWRect{};
    m_transform = Tavo_GrTransform(1.0, bounds.x1, bounds.y1);
}

// ---- Device window ----------------------------------------------------------

int Tavo_GrMapping::SetDeviceWindowSize(int width, int height, bool force, const Tavo_GrWPoint* centre)
{
    width = std::max(width, 0);
    height = std::max(height, 0);
    if (width == m_deviceWidth && height == m_deviceHeight && !force)
        return 0;

    const Tavo_GrWPoint viewCentre = ViewCentre();
    const double cx = centre ? centre->x : viewCentre.x;
    const double cy = centre ? centre->y : viewCentre.y;
    const double s = m_transform.m_scale;
    const double topY = m_transform.m_yOrigin + (m_deviceHeight - m_transform.m_yError) / s;

    m_deviceWidth = width;
    m_deviceHeight = height;

    if (force || m_realZoomLevel <= 0.0) {
        ApplyLevel(m_realZoomLevel, cx, cy);
        return 1;
    }
    // Keep the scale and the top-left corner: the window shows more or less.
    // Once the whole drawing fits at that scale, the view is the zero level.
    // A window that shrank at the largest zoom would show more than the
    // largest level allows: the scale comes down to that level's, and the
    // top-left corner still stays (unless that is the zero level).
    const double largest = LargestLevel();
    const double level = LevelOfScale(s);
    if (level <= 0.0 || largest <= 0.0) {
        ApplyLevel(0.0, cx, cy);
        return 1;
    }
    if (level > largest) {
        SetRealLevel(largest);
        m_transform.m_scale = ScaleOfLevel(m_realZoomLevel);
        m_transform.m_xError = 0.0;
        m_transform.m_yError = 0.0;
        m_transform.m_yOrigin = topY - m_deviceHeight / m_transform.m_scale;
        return 1;
    }
    m_transform.m_yOrigin = topY - (m_deviceHeight - m_transform.m_yError) / s;
    SetRealLevel(level);
    return 1;
}

Tavo_GrDPoint Tavo_GrMapping::GetDeviceWindowCentre() const
{
    return {m_deviceWidth / 2, m_deviceHeight / 2};
}

// ---- View -------------------------------------------------------------------

Tavo_GrWRect Tavo_GrMapping::GetWorldClipBox() const
{
    return m_transform.InvertRect({0, 0, m_deviceWidth, m_deviceHeight});
}

int Tavo_GrMapping::SetWorldClipBox(const Tavo_GrWRect& box)
{
    const Tavo_GrTransform before = m_transform;
    const Tavo_GrWRect b{std::min(box.x1, box.x2), std::min(box.y1, box.y2), std::max(box.x1, box.x2),
                         std::max(box.y1, box.y2)};
    const Tavo_GrWRect current = GetWorldClipBox();
    const double bw = static_cast<double>(b.x2) - b.x1;
    const double bh = static_cast<double>(b.y2) - b.y1;

    if (bw == static_cast<double>(current.x2) - current.x1 && bh == static_cast<double>(current.y2) - current.y1) {
        // Same size: a pan, which keeps the scale and the error terms.
        m_transform.m_xOrigin += static_cast<double>(b.x1) - current.x1;
        m_transform.m_yOrigin += static_cast<double>(b.y1) - current.y1;
        return SameView(m_transform, before) ? 0 : 1;
    }
    if (m_deviceWidth <= 0 || m_deviceHeight <= 0) {
        // Nothing to fit into: keep the scale, start the view at the box.
        m_transform.m_xOrigin = b.x1;
        m_transform.m_yOrigin = b.y1;
        return SameView(m_transform, before) ? 0 : 1;
    }
    const double scale = std::min(m_deviceWidth / std::max(bw, 1.0), m_deviceHeight / std::max(bh, 1.0));
    m_transform.m_scale = scale;
    m_transform.m_xError = 0.0;
    m_transform.m_yError = 0.0;
    CentreOn((static_cast<double>(b.x1) + b.x2) / 2.0, (static_cast<double>(b.y1) + b.y2) / 2.0);
    SetRealLevel(LevelOfScale(scale));
    return SameView(m_transform, before) ? 0 : 1;
}

int Tavo_GrMapping::PanTo(const Tavo_GrWPoint& topLeft)
{
    const Tavo_GrTransform before = m_transform;
    m_transform.m_xOrigin = topLeft.x;
    m_transform.m_yOrigin = topLeft.y - m_deviceHeight / m_transform.m_scale;
    return SameView(m_transform, before) ? 0 : 1;
}

// ---- Zoom -------------------------------------------------------------------

int Tavo_GrMapping::Zoom(Tavo_GrZoom::Type type, int x, int y, int amount)
{
    return ApplyLevel(TargetLevel(type, amount), x, y);
}

int Tavo_GrMapping::Zoom(double level, int x, int y)
{
    return ApplyLevel(LimitLevel(level), x, y);
}

bool Tavo_GrMapping::ChangesZoomLevel(Tavo_GrZoom::Type type, int amount) const
{
    return std::fabs(TargetLevel(type, amount) - m_realZoomLevel) > kLevelSnap;
}

double Tavo_GrMapping::GetEnclosingZoomLevel(const Tavo_GrWRect& rect) const
{
    if (m_deviceWidth <= 0 || m_deviceHeight <= 0)
        return 0.0;
    const double rw = std::max(std::fabs(static_cast<double>(rect.x2) - rect.x1), 1.0);
    const double rh = std::max(std::fabs(static_cast<double>(rect.y2) - rect.y1), 1.0);
    const double fits = LevelOfScale(std::min(m_deviceWidth / rw, m_deviceHeight / rh));
    // Corners are whole world units: a rectangle read from the view of a whole
    // level (its clip box, rounded) is up to a unit smaller than that view.
    // When a whole level lies within one unit of the rectangle, that level it is.
    const double fitsOneUnitMore = LevelOfScale(std::min(m_deviceWidth / (rw + 1.0), m_deviceHeight / (rh + 1.0)));
    const double whole = std::floor(fits);
    return LimitLevel(whole >= fitsOneUnitMore ? whole : fits);
}

void Tavo_GrMapping::SetMaxZoomLevel(int level)
{
    m_maxZoomLevel = std::max(level, 0);
}

void Tavo_GrMapping::SetMaxZoomWorldClipBoxSize(unsigned int width, unsigned int height)
{
    m_maxClipWidth = width;
    m_maxClipHeight = height;
}

void Tavo_GrMapping::SetZeroLevelExpansion(int percent)
{
    m_zeroLevelExpansion = std::max(percent, 0);
}

void Tavo_GrMapping::SetErrorTerms(double xError, double yError)
{
    m_transform.m_xError = xError;
    m_transform.m_yError = yError;
}

// ---- Implementation -----------------------------------------------------------

Tavo_GrWRect Tavo_GrMapping::FittedBounds() const
{
    return m_drawing ? m_drawing->GetBounds() : Tavo_GrWRect{};
}

double Tavo_GrMapping::ZeroLevelScale() const
{
    if (m_deviceWidth <= 0 || m_deviceHeight <= 0)
        return 1.0;
    const Tavo_GrWRect b = FittedBounds();
    const double grow = 1.0 + 2.0 * m_zeroLevelExpansion / 100.0;
    const double bw = std::max(static_cast<double>(b.x2) - b.x1, 1.0) * grow;
    const double bh = std::max(static_cast<double>(b.y2) - b.y1, 1.0) * grow;
    return std::min(m_deviceWidth / bw, m_deviceHeight / bh);
}

double Tavo_GrMapping::ScaleOfLevel(double level) const
{
    return ZeroLevelScale() * std::exp2(level / m_levelsPerDoubling);
}

double Tavo_GrMapping::LevelOfScale(double scale) const
{
    return SnapLevel(m_levelsPerDoubling * std::log2(scale / ZeroLevelScale()));
}

double Tavo_GrMapping::LargestLevel() const
{
    double largest = std::min(static_cast<double>(m_maxZoomLevel), LevelOfScale(kMaxScale));
    if (m_maxClipWidth > 0 && m_deviceWidth > 0)
        largest = std::min(largest, LevelOfScale(static_cast<double>(m_deviceWidth) / m_maxClipWidth));
    if (m_maxClipHeight > 0 && m_deviceHeight > 0)
        largest = std::min(largest, LevelOfScale(static_cast<double>(m_deviceHeight) / m_maxClipHeight));
    return std::max(largest, 0.0);
}

double Tavo_GrMapping::LimitLevel(double level) const
{
    if (!(level > 0.0)) // also NaN
        return 0.0;
    return std::min(level, LargestLevel());
}

double Tavo_GrMapping::TargetLevel(Tavo_GrZoom::Type type, int amount) const
{
    double level = m_realZoomLevel;
    switch (type) {
    case Tavo_GrZoom::ZeroLevel: level = 0.0; break;
    case Tavo_GrZoom::Out: level -= amount; break;
    case Tavo_GrZoom::In: level += amount; break;
    case Tavo_GrZoom::ToLevel: level = amount; break;
    case Tavo_GrZoom::Keep:
    default: break;
    }
    return LimitLevel(level);
}

Tavo_GrWPoint Tavo_GrMapping::ViewCentre() const
{
    const Tavo_GrWRect box = GetWorldClipBox();
    return {static_cast<int>((static_cast<long long>(box.x1) + box.x2) / 2),
            static_cast<int>((static_cast<long long>(box.y1) + box.y2) / 2)};
}

int Tavo_GrMapping::ApplyLevel(double level, double x, double y)
{
    const Tavo_GrTransform before = m_transform;
    if (!(level > 0.0))
        level = 0.0;
    SetRealLevel(level);
    m_transform.m_scale = ScaleOfLevel(m_realZoomLevel);
    m_transform.m_xError = 0.0;
    m_transform.m_yError = 0.0;
    if (m_realZoomLevel == 0.0) {
        const Tavo_GrWRect b = FittedBounds();
        CentreOn((static_cast<double>(b.x1) + b.x2) / 2.0, (static_cast<double>(b.y1) + b.y2) / 2.0);
    } else {
        CentreOn(x, y);
    }
    return SameView(m_transform, before) ? 0 : 1;
}

void Tavo_GrMapping::CentreOn(double x, double y)
{
    m_transform.m_xOrigin = x - (m_deviceWidth / 2.0) / m_transform.m_scale;
    m_transform.m_yOrigin = y - (m_deviceHeight / 2.0) / m_transform.m_scale;
}

void Tavo_GrMapping::SetRealLevel(double level)
{
    m_realZoomLevel = SnapLevel(level);
    m_zoomLevel = Tavo_GrRound(std::ceil(m_realZoomLevel - kLevelSnap));
}
