// Tavo_GrSpatialIndex: sort-tile-recursive packing and queries.
#include "Tavo_GrSpatialIndex.h"

#include <algorithm>
#include <cmath>
#include <utility>

namespace {

long long CentreX2(const Tavo_GrWRect& r) { return static_cast<long long>(r.x1) + r.x2; }
long long CentreY2(const Tavo_GrWRect& r) { return static_cast<long long>(r.y1) + r.y2; }

Tavo_GrWRect Union(const Tavo_GrWRect& a, const Tavo_GrWRect& b)
{
    return {std::min(a.x1, b.x1), std::min(a.y1, b.y1), std::max(a.x2, b.x2), std::max(a.y2, b.y2)};
}

// Sorts the entries into tiles: vertical slices by centre x, each slice by
// centre y, so that runs of kFanout consecutive entries are near each other.
template <typename Entry, typename BoxOf>
void SortIntoTiles(std::vector<Entry>& entries, BoxOf boxOf, int fanout)
{
    const size_t n = entries.size();
    const size_t groups = (n + fanout - 1) / fanout;
    const size_t slices = static_cast<size_t>(std::ceil(std::sqrt(static_cast<double>(groups))));
    const size_t sliceSize = std::max<size_t>(1, slices) * fanout;
    std::sort(entries.begin(), entries.end(),
              [&](const Entry& a, const Entry& b) { return CentreX2(boxOf(a)) < CentreX2(boxOf(b)); });
    for (size_t start = 0; start < n; start += sliceSize) {
        const auto first = entries.begin() + start;
        const auto last = entries.begin() + std::min(n, start + sliceSize);
        std::sort(first, last,
                  [&](const Entry& a, const Entry& b) { return CentreY2(boxOf(a)) < CentreY2(boxOf(b)); });
    }
}

} // namespace

void Tavo_GrSpatialIndex::Clear()
{
    m_levels.clear();
    m_order.clear();
    m_built = false;
}

void Tavo_GrSpatialIndex::Build(const std::vector<Tavo_GrWRect>& bounds)
{
    std::vector<uint32_t> items(bounds.size());
    for (uint32_t i = 0; i < items.size(); ++i)
        items[i] = i;
    Build(bounds, std::move(items));
}

void Tavo_GrSpatialIndex::Build(const std::vector<Tavo_GrWRect>& bounds, std::vector<uint32_t> items)
{
    Clear();
    m_built = true;
    if (items.empty())
        return;

    m_order = std::move(items);
    SortIntoTiles(
        m_order, [&](uint32_t item) -> const Tavo_GrWRect& { return bounds[item]; }, kFanout);

    std::vector<Node> leaves;
    leaves.reserve((m_order.size() + kFanout - 1) / kFanout);
    for (size_t start = 0; start < m_order.size(); start += kFanout) {
        Node leaf;
        leaf.first = static_cast<uint32_t>(start);
        leaf.count = static_cast<uint32_t>(std::min<size_t>(kFanout, m_order.size() - start));
        leaf.box = bounds[m_order[start]];
        for (uint32_t i = 1; i < leaf.count; ++i)
            leaf.box = Union(leaf.box, bounds[m_order[start + i]]);
        leaves.push_back(leaf);
    }
    m_levels.push_back(std::move(leaves));

    while (m_levels.back().size() > 1) {
        std::vector<Node>& children = m_levels.back();
        // Reordering the children is safe: each refers to its own range below.
        SortIntoTiles(
            children, [](const Node& node) -> const Tavo_GrWRect& { return node.box; }, kFanout);
        std::vector<Node> parents;
        parents.reserve((children.size() + kFanout - 1) / kFanout);
        for (size_t start = 0; start < children.size(); start += kFanout) {
            Node parent;
            parent.first = static_cast<uint32_t>(start);
            parent.count = static_cast<uint32_t>(std::min<size_t>(kFanout, children.size() - start));
            parent.box = children[start].box;
            for (uint32_t i = 1; i < parent.count; ++i)
                parent.box = Union(parent.box, children[start + i].box);
            parents.push_back(parent);
        }
        m_levels.push_back(std::move(parents));
    }
}

void Tavo_GrSpatialIndex::Query(const Tavo_GrWRect& area, const std::vector<Tavo_GrWRect>& bounds,
                                std::vector<uint32_t>& hits) const
{
    if (m_levels.empty())
        return;
    const int top = static_cast<int>(m_levels.size()) - 1;
    QueryNode(top, m_levels[top].front(), area, bounds, hits);
}

void Tavo_GrSpatialIndex::QueryNode(int level, const Node& node, const Tavo_GrWRect& area,
                                    const std::vector<Tavo_GrWRect>& bounds, std::vector<uint32_t>& hits) const
{
    if (!Tavo_GrIntersects(node.box, area))
        return;
    if (level == 0) {
        for (uint32_t i = 0; i < node.count; ++i) {
            const uint32_t item = m_order[node.first + i];
            if (Tavo_GrIntersects(bounds[item], area))
                hits.push_back(item);
        }
        return;
    }
    const std::vector<Node>& below = m_levels[level - 1];
    for (uint32_t i = 0; i < node.count; ++i)
        QueryNode(level - 1, below[node.first + i], area, bounds, hits);
}
