// Tavo_GrSurfaceStats: thirteen 32-bit counters that a surface keeps about the
// work of its drawing passes. All are 0 after construction and only grow until
// a surface clears them. Which counters a surface maintains is the surface's
// business; the names say what each is meant to count.
#pragma once

#include <cstdint>

struct Tavo_GrSurfaceStats {
    enum Counter {
        AttrChanges = 0,     // attribute changes that changed colour or fill
        Dots = 1,            // dots emitted
        Polylines = 2,       // polylines emitted as such
        Lines = 3,           // line segments and open triangles emitted
        HollowTriangles = 4, // outlined triangles emitted
        HollowRects = 5,     // outlined rectangles emitted
        Polygons = 6,        // polygons emitted as such
        FilledTriangles = 7, // filled triangles emitted
        FilledRects = 8,     // filled rectangles emitted
        Circles = 9,         // circles emitted, outlined and filled together
        Texts = 10,          // texts drawn with a font
        Grids = 11,          // grids drawn
        Calls = 12,          // calls of other drawings drawn
        CounterCount = 13,
    };

    uint32_t m_counters[CounterCount] = {};

    uint32_t Get(Counter counter) const { return m_counters[counter]; }
    void Add(Counter counter, uint32_t amount) { m_counters[counter] += amount; }
    void Reset()
    {
        for (uint32_t& counter : m_counters)
            counter = 0;
    }
};
