// The arithmetic of printing a drawing over a grid of pages, kept apart from
// the window and the printer so that it can be driven with given numbers.
//
// One page covers the full width of the area to print; its height follows
// from the paper's proportions below the header. Further pages are added to
// the left, right, above and below until the drawing is covered. Every count
// and coordinate saturates instead of overflowing; a layout that cannot be
// made (no area, no paper, a page of no width or height) is one page covering
// the area.
#pragma once

#include "Tavo_GrRound.h"
#include "Tavo_GrTypes.h"
#include "Tavo_WiPrintLayout.h"

#include <algorithm>
#include <climits>

namespace Tavo_WiPrintMath {

// The dialog's page fields are 16 bits wide.
constexpr int MaxDialogPage = 65535;

// The header above each page is one and a half lines of the printer's font.
inline int HeaderHeight(int textHeight)
{
    return Tavo_GrSaturate(3LL * textHeight / 2);
}

// A corner mark is a 32nd of the page width long.
inline int CornerMarkLength(int pageWidth)
{
    return pageWidth / 32;
}

// The printer's page, as the layout needs it.
struct Paper {
    int width = 0;      // HORZRES, pixels
    int height = 0;     // VERTRES, pixels
    int textHeight = 0; // tmHeight of the printer's font
};

// The layout with one page covering area.
inline Tavo_WiPrintLayout OnePage(const Tavo_GrWRect& area)
{
    Tavo_WiPrintLayout layout;
    layout.m_numCols = 1;
    layout.m_numRows = 1;
    layout.m_currentPage = 1;
    layout.m_page = 1;
    layout.m_firstPageBox = area;
    return layout;
}

// ceil(n / d) for n >= 0, d > 0.
inline long long CeilDiv(long long n, long long d)
{
    return n / d + (n % d != 0 ? 1 : 0);
}

// The page grid for printing area (what the window shows) of a drawing with
// the given bounds on paper.
inline Tavo_WiPrintLayout LayOutPages(const Tavo_GrWRect& area, const Tavo_GrWRect& bounds, const Paper& paper)
{
    const Tavo_WiPrintLayout onePage = OnePage(area);
    const long long areaWidth = static_cast<long long>(area.x2) - area.x1;
    if (area.x2 == area.x1 || area.y2 == area.y1 || paper.width <= 0)
        return onePage;

    const int hh = HeaderHeight(paper.textHeight);
    const double ratio = (static_cast<double>(paper.height) - hh) / paper.width;
    // The page's top-left corner is the area's; its width is the area's, its
    // height that width times the paper ratio.
    const int yEnd = Tavo_GrTruncate(static_cast<double>(area.y2) -
                                     static_cast<double>(static_cast<unsigned int>(areaWidth)) * ratio);
    const long long left = std::min(area.x1, area.x2);
    const long long right = std::max(area.x1, area.x2);
    const long long bottom = std::min(area.y2, yEnd);
    const long long top = std::max(area.y2, yEnd);
    const long long w = right - left;
    const long long h = top - bottom;
    if (w <= 0 || h <= 0)
        return onePage;

    const long long colsLeft = left > bounds.x1 ? CeilDiv(left - bounds.x1, w) : 0;
    const long long colsRight = right < bounds.x2 ? CeilDiv(bounds.x2 - right, w) : 0;
    const long long rowsAbove = top < bounds.y2 ? CeilDiv(bounds.y2 - top, h) : 0;
    const long long rowsBelow = bottom > bounds.y1 ? CeilDiv(bottom - bounds.y1, h) : 0;

    Tavo_WiPrintLayout layout;
    layout.m_numCols = Tavo_GrSaturate(colsLeft + 1 + colsRight);
    layout.m_numRows = Tavo_GrSaturate(rowsAbove + 1 + rowsBelow);
    layout.m_firstPageBox = {Tavo_GrSaturate(left - colsLeft * w), Tavo_GrSaturate(bottom + rowsAbove * h),
                             Tavo_GrSaturate(right - colsLeft * w), Tavo_GrSaturate(top + rowsAbove * h)};
    layout.m_currentPage = Tavo_GrSaturate(static_cast<long long>(layout.m_numCols) * rowsAbove + colsLeft + 1);
    layout.m_page = layout.m_currentPage;
    return layout;
}

// The number of pages of the grid, for the dialog's 16-bit page fields.
inline int DialogPageCount(const Tavo_WiPrintLayout& layout)
{
    const long long pages = static_cast<long long>(layout.m_numCols) * layout.m_numRows;
    return static_cast<int>(std::clamp(pages, 0LL, static_cast<long long>(MaxDialogPage)));
}

// Whether page is a page of the grid (numbered from 1) that the layout's
// m_page can name.
inline bool IsPageOfGrid(const Tavo_WiPrintLayout& layout, long long page)
{
    return page >= 1 && page <= INT_MAX && page <= static_cast<long long>(layout.m_numCols) * layout.m_numRows;
}

// The world box of page (numbered from 1): column (page - 1) mod columns,
// row (page - 1) div columns, each row one box height further down.
inline Tavo_GrWRect PageBox(const Tavo_WiPrintLayout& layout, int page)
{
    const Tavo_GrWRect& first = layout.m_firstPageBox;
    const long long columns = std::max(layout.m_numCols, 1);
    const long long c = (static_cast<long long>(page) - 1) % columns;
    const long long r = (static_cast<long long>(page) - 1) / columns;
    const long long bw = static_cast<long long>(first.x2) - first.x1;
    const long long bh = static_cast<long long>(first.y2) - first.y1;
    return {Tavo_GrSaturate(first.x1 + c * bw), Tavo_GrSaturate(first.y1 - r * bh),
            Tavo_GrSaturate(first.x2 + c * bw), Tavo_GrSaturate(first.y2 - r * bh)};
}

} // namespace Tavo_WiPrintMath
