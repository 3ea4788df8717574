// Tavo_GrSpatialIndex: finds the items whose bounds meet a rectangle.
//
// A packed R-tree (sort-tile-recursive): items are sorted into leaves of up to
// kFanout neighbours, leaves into parents the same way, up to one root. Built
// once from all bounds; a query costs about log(n) plus the number of items it
// finds. The index holds item numbers, not the bounds themselves.
#pragma once

#include "Tavo_GrTypes.h"

#include <cstdint>
#include <vector>

class Tavo_GrSpatialIndex {
public:
    static constexpr int kFanout = 16;

    // Indexes every item, or only the given item numbers (into bounds).
    void Build(const std::vector<Tavo_GrWRect>& bounds);
    void Build(const std::vector<Tavo_GrWRect>& bounds, std::vector<uint32_t> items);
    void Clear();
    bool IsBuilt() const { return m_built; }

    // Appends to hits the number of every indexed item whose bounds (the same
    // vector the index was built from) meet area, touching counts; in no
    // particular order.
    void Query(const Tavo_GrWRect& area, const std::vector<Tavo_GrWRect>& bounds, std::vector<uint32_t>& hits) const;

private:
    struct Node {
        Tavo_GrWRect box;
        uint32_t first = 0; // first child in the level below, or first entry of m_order
        uint32_t count = 0;
    };

    void QueryNode(int level, const Node& node, const Tavo_GrWRect& area, const std::vector<Tavo_GrWRect>& bounds,
                   std::vector<uint32_t>& hits) const;

    // m_levels[0] are the leaves (ranges of m_order), the last level the root.
    std::vector<std::vector<Node>> m_levels;
    std::vector<uint32_t> m_order;
    bool m_built = false;
};
