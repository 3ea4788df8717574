// Tavo_GrPolygonFill: cuts a simple polygon into triangles (ear clipping), for
// surfaces that fill polygons as triangles (Tavo_GrSurface::DrawPolygon).
#pragma once

#include "Tavo_GrTypes.h"

#include <vector>

// Calls emit(a, b, c) with the device points of each triangle. Convex polygons
// and polygons of more than kMaxEarClippingPoints points are cut as a fan from
// the first point (quick, and exact for convex ones); others by ear clipping.
// A polygon whose remaining points have no ear (it crosses itself) is finished
// as a fan. Triangles of zero area are left out. scratch is reused storage.
template <typename Emit>
void Tavo_GrFillPolygon(int count, const Tavo_GrDPoint* points, std::vector<int>& scratch, Emit emit);

// The reused storage of the polygons a surface fills (Tavo_GrSurface::DrawPolygon).
std::vector<int>& Tavo_GrPolygonScratch();

namespace Tavo_GrPolygonFillDetail {

constexpr int kMaxEarClippingPoints = 2000;

inline long long Cross(const Tavo_GrDPoint& o, const Tavo_GrDPoint& a, const Tavo_GrDPoint& b)
{
    return (static_cast<long long>(a.x) - o.x) * (static_cast<long long>(b.y) - o.y) - (static_cast<long long>(a.y) - o.y) * (static_cast<long long>(b.x) - o.x);
}

// Whether p lies inside or on triangle abc of the given orientation sign.
inline bool InTriangle(const Tavo_GrDPoint& p, const Tavo_GrDPoint& a, const Tavo_GrDPoint& b,
                       const Tavo_GrDPoint& c, int sign)
{
    return Cross(a, b, p) * sign >= 0 && Cross(b, c, p) * sign >= 0 && Cross(c, a, p) * sign >= 0;
}

inline bool IsConvex(int count, const Tavo_GrDPoint* points, int sign)
{
    for (int i = 0; i < count; ++i) {
        const long long turn = Cross(points[i], points[(i + 1) % count], points[(i + 2) % count]);
        if (turn * sign < 0)
            return false;
    }
    return true;
}

} // namespace Tavo_GrPolygonFillDetail

template <typename Emit>
void Tavo_GrFillPolygon(int count, const Tavo_GrDPoint* points, std::vector<int>& scratch, Emit emit)
{
    using namespace Tavo_GrPolygonFillDetail;
    if (count < 3 || !points)
        return;

    long long twiceArea = 0;
    for (int i = 0; i < count; ++i)
        twiceArea += Cross(Tavo_GrDPoint{}, points[i], points[(i + 1) % count]);
    const int sign = twiceArea >= 0 ? 1 : -1;

    auto emitIfArea = [&](int a, int b, int c) {
        if (Cross(points[a], points[b], points[c]) != 0)
            emit(points[a], points[b], points[c]);
    };

    if (count > kMaxEarClippingPoints || IsConvex(count, points, sign)) {
        for (int i = 1; i + 1 < count; ++i)
            emitIfArea(0, i, i + 1);
        return;
    }

    scratch.clear();
    for (int i = 0; i < count; ++i)
        scratch.push_back(i);

    while (scratch.size() > 3) {
        const int n = static_cast<int>(scratch.size());
        bool clipped = false;
        for (int i = 0; i < n && !clipped; ++i) {
            const int a = scratch[(i + n - 1) % n];
            const int b = scratch[i];
            const int c = scratch[(i + 1) % n];
            const long long turn = Cross(points[a], points[b], points[c]);
            if (turn * sign < 0)
                continue; // reflex corner: not an ear
            bool holdsPoint = false;
            for (int j = 0; j < n && !holdsPoint && turn != 0; ++j) {
                const int k = scratch[j];
                if (k == a || k == b || k == c)
                    continue;
                holdsPoint = InTriangle(points[k], points[a], points[b], points[c], sign);
            }
            if (holdsPoint)
                continue;
            emitIfArea(a, b, c);
            scratch.erase(scratch.begin() + i);
            clipped = true;
        }
        if (!clipped) {
            for (int i = 1; i + 1 < n; ++i)
                emitIfArea(scratch[0], scratch[i], scratch[i + 1]);
            return;
        }
    }
    emitIfArea(scratch[0], scratch[1], scratch[2]);
}
