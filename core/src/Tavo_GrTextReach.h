// Tavo_GrTextReach: where a surface may draw an item's text, which can lie
// beyond the item's nominal bounds (Tavo_GrDrawing.h), and how far beyond
// them the text of a group of items may reach. The drawing pass culls text by
// these extents. Not part of the core's interface.
//
// What a surface may draw for text, in world units, with the effective
// character height E = max(|charHeight|, floor), where floor is the surface's
// smallest text height (Tavo_GrSurface::GetMinTextPixels) divided by the
// scale:
//
// - No character is wider than E; text below the floor may be drawn as one
//   line of length x E in its place.
// - Text at a point: one line of length x E placed at the anchor by the
//   horizontal alignment, in a character cell of height E placed by the
//   vertical alignment and up to half a cell more off the baseline (the GDI
//   surface lifts bottom-aligned text by the font's descent): within 1.5 E of
//   the baseline.
// - Text in a box: lines from the box's top down, each placed at the box's
//   left edge by the horizontal alignment (right- and centre-aligned lines lie
//   left of the box), each no wider than the box, or 3 E (a character wider
//   than the box, the "..." that marks cut text), or, below the floor, the
//   whole text's line; at most two lines of height E below the box (the last
//   line, top-aligned, and the "...").
#pragma once

#include "Tavo_GrAttr.h"
#include "Tavo_GrRound.h"
#include "Tavo_GrTypes.h"

#include <algorithm>
#include <climits>
#include <cmath>
#include <cstdlib>

namespace Tavo_GrText {

// A text at a point reaches this share of its character height further from
// its baseline than its nominal bounds say.
constexpr double kCellOffsetShare = 0.5;
// A text box's line may be this many characters wide when the box is narrower.
constexpr double kOverflowChars = 3.0;
// Lines a text box may draw below its bottom edge.
constexpr double kLinesBelowBox = 2.0;
// World units added to every reach for the halving and rounding of bounds.
constexpr int kRoundingSlack = 2;

inline int Magnitude(int charHeight)
{
    return Tavo_GrSaturate(std::llabs(static_cast<long long>(charHeight)));
}

// The smallest character height a surface draws, in world units; 0 without one.
inline double Floor(int minTextPixels, double scale)
{
    return minTextPixels > 0 && scale > 0.0 ? minTextPixels / scale : 0.0;
}

inline double EffectiveCharHeight(int charHeight, double floor)
{
    return std::max(static_cast<double>(Magnitude(charHeight)), floor);
}

// The smallest integer rectangle holding x1 ... x2 by y1 ... y2, saturated.
inline Tavo_GrWRect Outward(double x1, double y1, double x2, double y2)
{
    return {Tavo_GrTruncate(std::floor(x1)), Tavo_GrTruncate(std::floor(y1)), Tavo_GrTruncate(std::ceil(x2)),
            Tavo_GrTruncate(std::ceil(y2))};
}

inline Tavo_GrWRect Union(const Tavo_GrWRect& a, const Tavo_GrWRect& b)
{
    return {std::min(a.x1, b.x1), std::min(a.y1, b.y1), std::max(a.x2, b.x2), std::max(a.y2, b.y2)};
}

// Where a text at a point may be drawn: its nominal bounds and the box of
// length x E by 1.5 E on each side of the baseline, placed like the nominal one.
inline Tavo_GrWRect PointExtent(const Tavo_GrWRect& nominal, const Tavo_GrWPoint& anchor, int charHeight, int length,
                                char align, double floor)
{
    const double e = EffectiveCharHeight(charHeight, floor);
    const double width = std::max(length, 0) * e;
    double left = anchor.x;
    switch (align & Tavo_GrAttr::kHorizontalAlignMask) {
    case Tavo_GrAttr::AlignRight: left -= width; break;
    case Tavo_GrAttr::AlignCentre: left -= width / 2; break;
    default: break;
    }
    const double half = (1.0 + kCellOffsetShare) * e;
    return Union(nominal, Outward(left, anchor.y - half, left + width, anchor.y + half));
}

// Where a text box's lines may be drawn: the box, widened by the lines that
// reach past its edges.
inline Tavo_GrWRect BoxExtent(const Tavo_GrWRect& box, int charHeight, int length, char align, double floor)
{
    const double e = EffectiveCharHeight(charHeight, floor);
    const double boxWidth = static_cast<double>(box.x2) - box.x1;
    double line = std::max(boxWidth, kOverflowChars * e);
    if (Magnitude(charHeight) < floor)
        line = std::max(line, std::max(length, 0) * e);
    double left = box.x1;
    double right = box.x2;
    switch (align & Tavo_GrAttr::kHorizontalAlignMask) {
    case Tavo_GrAttr::AlignRight: left -= line; break;
    case Tavo_GrAttr::AlignCentre:
        left -= line / 2;
        right = std::max(right, box.x1 + line / 2);
        break;
    default: right = std::max(right, box.x1 + line); break;
    }
    return Outward(left, box.y1 - kLinesBelowBox * e, right, box.y2);
}

// What the pass needs to know about a group of items holding text (a layer's,
// a whole drawing's), gathered as items are added.
struct Facts {
    bool hasPointText = false;
    bool hasBoxText = false;
    int smallestCharHeight = INT_MAX; // |charHeight|
    int largestCharHeight = 0;        // |charHeight|
    int longestText = 0;              // characters
    int widestShiftedBox = 0;         // widest box whose lines lie left of it (right or centre aligned)

    bool Any() const { return hasPointText || hasBoxText; }

    void AddPointText(int charHeight, int length)
    {
        hasPointText = true;
        AddText(charHeight, length);
    }

    void AddBoxText(const Tavo_GrWRect& box, int charHeight, int length, char align)
    {
        hasBoxText = true;
        AddText(charHeight, length);
        const int a = align & 3;
        if (a == Tavo_GrAttr::AlignRight || a == Tavo_GrAttr::AlignCentre)
            widestShiftedBox = std::max(widestShiftedBox, Tavo_GrSubtract(box.x2, box.x1));
    }

    void Add(const Facts& other)
    {
        hasPointText = hasPointText || other.hasPointText;
        hasBoxText = hasBoxText || other.hasBoxText;
        smallestCharHeight = std::min(smallestCharHeight, other.smallestCharHeight);
        largestCharHeight = std::max(largestCharHeight, other.largestCharHeight);
        longestText = std::max(longestText, other.longestText);
        widestShiftedBox = std::max(widestShiftedBox, other.widestShiftedBox);
    }

    // How far, along x and y, the extent of any of the items may lie beyond
    // its nominal bounds at this floor; (0, 0) when none holds text.
    Tavo_GrWPoint Reach(double floor) const
    {
        if (!Any())
            return {0, 0};
        const double largest = std::max(static_cast<double>(largestCharHeight), floor);
        const double raised = std::max(0.0, floor - smallestCharHeight); // E - |charHeight| at most
        const double wholeLine = raised > 0.0 ? static_cast<double>(longestText) * floor : 0.0;
        double x = 0.0;
        double y = 0.0;
        if (hasPointText) {
            x = longestText * raised;
            y = kCellOffsetShare * largest + raised;
        }
        if (hasBoxText) {
            x = std::max({x, static_cast<double>(widestShiftedBox), kOverflowChars * largest, wholeLine});
            y = std::max(y, kLinesBelowBox * largest);
        }
        return {Tavo_GrAdd(Tavo_GrTruncate(std::ceil(x)), kRoundingSlack),
                Tavo_GrAdd(Tavo_GrTruncate(std::ceil(y)), kRoundingSlack)};
    }

private:
    void AddText(int charHeight, int length)
    {
        const int height = Magnitude(charHeight);
        smallestCharHeight = std::min(smallestCharHeight, height);
        largestCharHeight = std::max(largestCharHeight, height);
        longestText = std::max(longestText, length);
    }
};

} // namespace Tavo_GrText
