// Plane geometry of the importer, as small pure functions: 2-D affine maps,
// the object coordinate system of an extrusion direction, and the flattening
// of arcs, bulges and ellipses into points.
#pragma once

#include "Tavo_DxfModel.h"

#include <algorithm>
#include <cmath>
#include <vector>

constexpr double kTavo_DxfPi = 3.14159265358979323846;

struct Tavo_DxfXY {
    double x = 0.0;
    double y = 0.0;
};

// x' = a x + b y + c,  y' = d x + e y + f.
struct Tavo_DxfAffine {
    double a = 1.0, b = 0.0, c = 0.0;
    double d = 0.0, e = 1.0, f = 0.0;

    Tavo_DxfXY Apply(double x, double y) const { return {a * x + b * y + c, d * x + e * y + f}; }
    Tavo_DxfXY ApplyVector(double x, double y) const { return {a * x + b * y, d * x + e * y}; }
    double Determinant() const { return a * e - b * d; }
    // How much lengths grow on average: the square root of the area factor.
    double LengthFactor() const { return std::sqrt(std::fabs(Determinant())); }
    // Whether circles stay circles: a rotation and uniform scale, mirrored or not.
    bool IsSimilarity() const
    {
        const double scale = std::max({std::fabs(a), std::fabs(b), std::fabs(d), std::fabs(e)});
        const double tolerance = 1e-9 * scale;
        const bool turning = std::fabs(a - e) <= tolerance && std::fabs(b + d) <= tolerance;
        const bool mirrored = std::fabs(a + e) <= tolerance && std::fabs(b - d) <= tolerance;
        return scale > 0.0 && (turning || mirrored);
    }

    // this after inner: x -> this(inner(x)).
    Tavo_DxfAffine After(const Tavo_DxfAffine& inner) const
    {
        Tavo_DxfAffine r;
        r.a = a * inner.a + b * inner.d;
        r.b = a * inner.b + b * inner.e;
        r.c = a * inner.c + b * inner.f + c;
        r.d = d * inner.a + e * inner.d;
        r.e = d * inner.b + e * inner.e;
        r.f = d * inner.c + e * inner.f + f;
        return r;
    }

    static Tavo_DxfAffine Translation(double x, double y)
    {
        Tavo_DxfAffine t;
        t.c = x;
        t.f = y;
        return t;
    }
    // Scale, then rotate by `degrees` counter-clockwise.
    static Tavo_DxfAffine ScaleRotate(double sx, double sy, double degrees)
    {
        const double radians = degrees * kTavo_DxfPi / 180.0;
        const double cs = std::cos(radians);
        const double sn = std::sin(radians);
        Tavo_DxfAffine t;
        t.a = cs * sx;
        t.b = -sn * sy;
        t.d = sn * sx;
        t.e = cs * sy;
        return t;
    }
};

// The map from an entity's object coordinate system (OCS) to world x and y,
// for points at height `elevation` in the OCS. The OCS's axes follow from the
// extrusion direction by the arbitrary axis algorithm of the DXF format; the
// world z of the result is dropped (the drawing is seen from above). A zero
// normal counts as +z.
inline Tavo_DxfAffine Tavo_DxfObjectToWorld(const Tavo_DxfPoint& normal, double elevation)
{
    double nx = normal.x, ny = normal.y, nz = normal.z;
    const double length = std::sqrt(nx * nx + ny * ny + nz * nz);
    if (!(length > 1e-12)) {
        nx = 0.0, ny = 0.0, nz = 1.0;
    } else {
        nx /= length, ny /= length, nz /= length;
    }
    if (nx == 0.0 && ny == 0.0 && nz > 0.0)
        return Tavo_DxfAffine::Translation(0.0, 0.0); // the usual case, exactly
    // Arbitrary axis algorithm: Ax = (Wy or Wz) x N, normalised; Ay = N x Ax.
    const double threshold = 1.0 / 64.0;
    double ax, ay, az;
    if (std::fabs(nx) < threshold && std::fabs(ny) < threshold) {
        ax = nz, ay = 0.0, az = -nx; // Wy x N
    } else {
        ax = -ny, ay = nx, az = 0.0; // Wz x N
    }
    const double axLength = std::sqrt(ax * ax + ay * ay + az * az);
    ax /= axLength, ay /= axLength, az /= axLength;
    const double bx = ny * az - nz * ay;
    const double by = nz * ax - nx * az;
    Tavo_DxfAffine t;
    t.a = ax;
    t.b = bx;
    t.c = nx * elevation;
    t.d = ay;
    t.e = by;
    t.f = ny * elevation;
    return t;
}

// How finely curves are cut: the largest distance allowed between a curve and
// its chords, and the fewest and most segments a full turn may have.
struct Tavo_DxfFlattening {
    static constexpr int kFewestPerTurn = 8;
    static constexpr int kMostPerTurn = 2048;
    double tolerance = 0.0; // 0 or less: kFewestPerTurn per turn

    // Segments for an arc of `sweep` radians (absolute) and this radius.
    int Segments(double sweep, double radius) const
    {
        const double turnShare = std::min(std::fabs(sweep), 2.0 * kTavo_DxfPi) / (2.0 * kTavo_DxfPi);
        double perTurn = kFewestPerTurn;
        if (tolerance > 0.0 && radius > tolerance) {
            // A chord of angle s lies r (1 - cos(s / 2)) from its arc.
            const double step = 2.0 * std::acos(1.0 - tolerance / radius);
            perTurn = step > 0.0 ? 2.0 * kTavo_DxfPi / step : kMostPerTurn;
        }
        perTurn = std::clamp(perTurn, double(kFewestPerTurn), double(kMostPerTurn));
        return std::max(1, static_cast<int>(std::ceil(perTurn * turnShare - 1e-9)));
    }
};

// Appends the points of an arc around (cx, cy) from angle `from` by `sweep`
// radians (negative: clockwise), both ends included unless withStart is false.
inline void Tavo_DxfAppendArc(std::vector<Tavo_DxfXY>& out, double cx, double cy, double radius, double from,
                              double sweep, const Tavo_DxfFlattening& flattening, bool withStart = true)
{
    const int segments = flattening.Segments(sweep, radius);
    for (int i = withStart ? 0 : 1; i <= segments; ++i) {
        const double angle = from + sweep * i / segments;
        out.push_back({cx + radius * std::cos(angle), cy + radius * std::sin(angle)});
    }
}

// Appends the points from p to q along the arc of the bulge (tan of a quarter
// of the included angle; positive turns counter-clockwise), without p.
inline void Tavo_DxfAppendBulge(std::vector<Tavo_DxfXY>& out, const Tavo_DxfXY& p, const Tavo_DxfXY& q, double bulge,
                                const Tavo_DxfFlattening& flattening)
{
    const double dx = q.x - p.x;
    const double dy = q.y - p.y;
    const double chord = std::sqrt(dx * dx + dy * dy);
    if (std::fabs(bulge) < 1e-9 || chord == 0.0) {
        out.push_back(q);
        return;
    }
    const double sweep = 4.0 * std::atan(bulge);
    const double radius = chord / (2.0 * std::fabs(std::sin(sweep / 2.0)));
    // The centre lies on the chord's perpendicular bisector, at distance
    // r cos(sweep / 2) from the chord, on the side the arc turns to.
    const double mx = (p.x + q.x) / 2.0;
    const double my = (p.y + q.y) / 2.0;
    const double offset = radius * std::cos(sweep / 2.0) * (bulge > 0 ? 1.0 : -1.0);
    const double cx = mx - dy / chord * offset;
    const double cy = my + dx / chord * offset;
    const double from = std::atan2(p.y - cy, p.x - cx);
    Tavo_DxfAppendArc(out, cx, cy, radius, from, sweep, flattening, false);
    out.back() = q; // end exactly where the next segment starts
}

// The sweep in radians from `start` to `end` degrees, counter-clockwise, in
// (0, 2 pi]: an arc from 30 to 10 degrees runs 340 degrees.
inline double Tavo_DxfArcSweep(double startDegrees, double endDegrees)
{
    double sweep = std::fmod(endDegrees - startDegrees, 360.0);
    if (sweep <= 0.0)
        sweep += 360.0;
    return sweep * kTavo_DxfPi / 180.0;
}
