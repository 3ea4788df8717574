// Tavo_WiWin32Surface: text at a point and text wrapped into a box. Text is
// drawn at once with TextOut, never batched. Without a font (text under 3
// pixels high, or taller than twice the device window) a thin line of the
// text's approximate width stands in for it.
#include "Tavo_WiWin32Surface.h"

#include "Tavo_GrRound.h"

#include <algorithm>
#include <cstring>

#pragma push_macro("DrawText")
#undef DrawText

namespace {

// Marks text cut off at the bottom of its box.
const char kEllipsis[] = "...";
const int kEllipsisLength = 3;

int TextLength(const char* text)
{
    return text ? Tavo_GrSaturate(static_cast<long long>(std::strlen(text))) : 0;
}

} // namespace

void Tavo_WiWin32Surface::DrawTextPlaceholder(Tavo_GrDPoint anchor, int width, int rightLimit, Tavo_GrAttr* attr)
{
    Tavo_GrDPoint start = anchor;
    Tavo_GrDPoint end = anchor;
    switch (m_textAlign & Tavo_GrAttr::kHorizontalAlignMask) {
    case Tavo_GrAttr::AlignRight:
        start.x = Tavo_GrSubtract(anchor.x, width);
        break;
    case Tavo_GrAttr::AlignCentre: {
        const int half = width / 2;
        start.x = Tavo_GrSubtract(anchor.x, half);
        end.x = Tavo_GrAdd(anchor.x, width - half);
        break;
    }
    default:
        end.x = Tavo_GrAdd(anchor.x, width);
        break;
    }
    end.x = std::min(end.x, rightLimit);
    // Through the virtual operation, in core coordinates and the text's colour.
    DrawLine(start, end, attr);
}

void Tavo_WiWin32Surface::DrawText(const char* text, Tavo_GrDPoint& point, Tavo_GrAttr* attr)
{
    SetCurrentAttr(attr);
    const int length = TextLength(text);
    if (!m_font) {
        const int width = Tavo_GrSaturate(static_cast<long long>(m_fontHeight) * length);
        DrawTextPlaceholder(point, width, INT_MAX, attr);
        return;
    }
    // The core's point is the baseline; the DC aligns the bottom of the cell.
    TEXTMETRICA metrics = {};
    GetTextMetricsA(m_hdc, &metrics);
    long long y = static_cast<long long>(GetDeviceHeight()) - point.y - metrics.tmDescent;
    // Middle alignment is drawn bottom-aligned, half a font lower.
    if ((m_textAlign & Tavo_GrAttr::kVerticalAlignMask) == Tavo_GrAttr::AlignMiddle)
        y += m_fontHeight / 2;
    TextOutA(m_hdc, point.x, Tavo_GrSaturate(y), text ? text : "", length);
    m_stats.Add(Tavo_GrSurfaceStats::Texts, 1);
}

void Tavo_WiWin32Surface::DrawText(const char* text, Tavo_GrDRect& box, Tavo_GrAttr* attr, unsigned int fontHeight)
{
    if (m_fontHeight != fontHeight)
        SetCurrentFont(fontHeight);
    // After the font: an attribute change may rebuild the font from the
    // attribute's character height and so override the height asked for.
    SetCurrentAttr(attr);
    const int length = TextLength(text);
    if (!m_font) {
        const int width = Tavo_GrSaturate(static_cast<long long>(m_fontHeight) * length);
        DrawTextPlaceholder(Tavo_GrDPoint{box.xmin, box.ymax}, width, box.xmax, attr);
        return;
    }

    TEXTMETRICA metrics = {};
    GetTextMetricsA(m_hdc, &metrics);
    const long long lineHeight = metrics.tmHeight;
    const long long height = GetDeviceHeight();
    // GDI y of the bottom of the first line (the DC aligns the cell bottom).
    const long long top = height - box.ymax + lineHeight;
    const long long bottom = height - box.ymin;
    int consumed = 0;
    for (long long line = 0; consumed != length; ++line) {
        const int count = GetCharsInBox(text + consumed, box);
        const long long y = top + line * lineHeight;
        if (y > bottom) {
            TextOutA(m_hdc, box.xmin, Tavo_GrSaturate(y), kEllipsis, kEllipsisLength);
            break;
        }
        TextOutA(m_hdc, box.xmin, Tavo_GrSaturate(y), text + consumed, count);
        consumed += count;
    }
    m_stats.Add(Tavo_GrSurfaceStats::Texts, 1);
}

int Tavo_WiWin32Surface::GetCharsInBox(const char* text, Tavo_GrDRect& box)
{
    // Compared as unsigned 32-bit values: a box with xmax below xmin is wide
    // enough for any text.
    const unsigned int width = static_cast<unsigned int>(box.xmax) - static_cast<unsigned int>(box.xmin);
    const int length = TextLength(text);
    SIZE extent = {};
    GetTextExtentPoint32A(m_hdc, text, length, &extent);
    if (length < 2 || static_cast<unsigned int>(extent.cx) <= width)
        return length;

    // The longest prefix that fits, by halving; never less than one character
    // so that wrapping always advances.
    int lo = 0;
    int hi = length;
    for (;;) {
        const int mid = lo + (hi - lo) / 2;
        extent = {};
        GetTextExtentPoint32A(m_hdc, text, mid, &extent);
        const unsigned int cx = static_cast<unsigned int>(extent.cx);
        if (cx < width) {
            if (lo == mid)
                return std::max(lo, 1);
            lo = mid;
        } else if (cx > width) {
            if (hi == mid)
                return std::max(hi - 1, 1);
            hi = mid;
        } else {
            return std::max(mid, 1);
        }
    }
}

#pragma pop_macro("DrawText")
