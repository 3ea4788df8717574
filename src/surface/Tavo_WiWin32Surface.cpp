// Tavo_WiWin32Surface: construction, binding to a device context, the mapping
// of attributes to GDI objects, the start and end of a pass and the Escape
// interrupt.
// Batching is in Tavo_WiWin32SurfaceBatching.cpp, the drawing operations in
// Tavo_WiWin32SurfaceDrawing.cpp, text in Tavo_WiWin32SurfaceText.cpp.
#include "Tavo_WiWin32Surface.h"

#include "Tavo_WiLibrary.h"
#include "Tavo_WiPalette.h"
#include "Tavo_GrRound.h"

#include "Port_Env.h"
#include "Tavo_GrRound.h"
#include "UT_STR.h"

#include <algorithm>
#include <cstring>

#pragma push_macro("DrawText")
#undef DrawText

int Tavo_WiWin32Surface::m_instanceCount = 0;
std::unique_ptr<DWORD[]> Tavo_WiWin32Surface::m_2array;
std::unique_ptr<DWORD[]> Tavo_WiWin32Surface::m_3array;
std::unique_ptr<DWORD[]> Tavo_WiWin32Surface::m_4array;
std::unique_ptr<DWORD[]> Tavo_WiWin32Surface::m_5array;

namespace {

// Environment settings, read when a surface is constructed.
const char kThickenVerticalLineVariable[] = "BRY_VWR_THICKENVERTICALLINE";
const char kMinFontVariable[] = "BRY_VWR_MINFONT";
// Fonts below this many pixels are never created: text becomes a placeholder.
const unsigned int kSmallestFontPixels = 3;
// Nor fonts taller than twice the device window (and than this many pixels):
// none of their characters can be seen whole, and the font engine takes
// seconds to draw one at a hundred thousand pixels.
const unsigned int kLargestFontFloorPixels = 2048;

// The GDI text-alignment flags of a graphics-core alignment code (bits 0-1
// horizontal: 2 right, 3 centre, else left; bits 2-3 vertical: 8 top, else
// bottom). Middle alignment is drawn bottom-aligned and shifted by the text
// operations.
UINT ToGdiTextAlign(unsigned char code)
{
    UINT flags = TA_LEFT;
    switch (code & Tavo_GrAttr::kHorizontalAlignMask) {
    case Tavo_GrAttr::AlignRight: flags = TA_RIGHT; break;
    case Tavo_GrAttr::AlignCentre: flags = TA_CENTER; break;
    default: break;
    }
    return flags | ((code & Tavo_GrAttr::kVerticalAlignMask) == Tavo_GrAttr::AlignTop ? TA_TOP : TA_BOTTOM);
}

LOGFONTA DescribeFont(unsigned int pixelHeight)
{
    LOGFONTA font = {};
    // A positive height asks for the cell height; width 0 lets the mapper choose.
    font.lfHeight = Tavo_GrSaturate(pixelHeight);
    font.lfWeight = FW_MEDIUM;
    font.lfCharSet = ANSI_CHARSET;
    font.lfOutPrecision = OUT_CHARACTER_PRECIS;
    font.lfPitchAndFamily = FF_SWISS | DEFAULT_PITCH;
    std::strcpy(font.lfFaceName, "HelvFace");
    return font;
}

} // namespace

Tavo_WiWin32Surface::Tavo_WiWin32Surface()
{
    // Decimal values; UT_STR::AToI saturates what does not fit an int.
    if (const char* text = Port_Env::GetEnv(kThickenVerticalLineVariable))
        m_thickenVertLine = UT_STR::AToI(text);
    if (const char* text = Port_Env::GetEnv(kMinFontVariable)) {
        const int value = UT_STR::AToI(text);
        m_minFont = value > static_cast<int>(kSmallestFontPixels) ? value : static_cast<int>(kSmallestFontPixels);
    }
    // Smaller text is drawn at the minimum font: the core culls text by that height.
    SetMinTextPixels(m_minFont);

    ++m_instanceCount;
    if (!m_2array) {
        // Entry n is the length of the count array for n-point polylines.
        const int maxCounts[6] = {
            0,
            0,
            kDotCapacity > kLineCapacity ? kDotCapacity : kLineCapacity,
            kUniangleCapacity,
            kHollowTriangleCapacity > kFilledTriangleCapacity ? kHollowTriangleCapacity : kFilledTriangleCapacity,
            kHollowRectCapacity,
        };
        AllocStaticArrays(maxCounts);
    }
}

Tavo_WiWin32Surface::~Tavo_WiWin32Surface()
{
    if (--m_instanceCount == 0)
        FreeStaticArrays();
    // A pass ended by EndDrawing leaves nothing to release; a surface
    // destroyed in the middle of a pass must not leak its pen, brush and font.
    ReleaseGdiObjects();
    // The batches release their element storage as members.
}

void Tavo_WiWin32Surface::SetDC(HDC dc)
{
    // A surface whose last pass ended with EndDrawing holds no GDI object and
    // nothing is released here; one rebound in the middle of a pass gives the
    // old device context its objects back and deletes its own, which would
    // otherwise be lost.
    ReleaseGdiObjects();
    m_hdc = dc;
    m_textAlign = Tavo_GrAttr::AlignDefault; // left, bottom
    SetTextAlign(dc, TA_LEFT | TA_BOTTOM);
    SetBkMode(dc, TRANSPARENT);
    SetPolyFillMode(dc, ALTERNATE);
}

void Tavo_WiWin32Surface::ResetStats()
{
    m_stats.Reset();
}

void Tavo_WiWin32Surface::FetchStats(Tavo_GrSurfaceStats& out) const
{
    out = m_stats;
}

void Tavo_WiWin32Surface::OnAttrChange()
{
    Tavo_GrSurface::OnAttrChange();

    Tavo_WiPalette* palette = Tavo_WiLibrary::GetPalette();
    const unsigned char colour = static_cast<unsigned char>(GetCurrentColor());
    const unsigned char fill = static_cast<unsigned char>(GetCurrentFill());
    int charHeight = GetCurrentCharHeight();
    const unsigned char align = static_cast<unsigned char>(GetCurrentTextAlign());
    const COLORREF c = palette->GetWin32Color(static_cast<char>(colour), m_blackAndWhite);

    const bool colourChanged = colour != m_color;
    const bool fillChanged = fill != m_fill;
    if (colourChanged || fillChanged) {
        // Everything batched so far belongs to the old pen and brush.
        m_stats.Add(Tavo_GrSurfaceStats::AttrChanges, 1);
        Flush();
    }

    if (!m_pen || colourChanged) {
        if (m_pen) {
            SelectObject(m_hdc, m_oldPen);
            DeleteObject(m_pen);
        }
        // Width 0: one device pixel whatever the mapping.
        m_pen = CreatePen(PS_SOLID, 0, c);
        m_oldPen = SelectObject(m_hdc, m_pen);
    }

    if (!m_brush || colourChanged || fillChanged) {
        if (m_brush) {
            SelectObject(m_hdc, m_oldBrush);
            DeleteObject(m_brush);
        }
        // The brush takes the pen's colour: fill only switches filling on or off.
        LOGBRUSH description = {};
        description.lbStyle = fill != 0 ? BS_SOLID : BS_HOLLOW;
        description.lbColor = c;
        m_brush = CreateBrushIndirect(&description);
        m_oldBrush = SelectObject(m_hdc, m_brush);
    }

    if (!m_font || m_charHeight != charHeight) {
        const int pixels = Tavo_GrRound(charHeight * GetScale());
        // A negative height cannot be drawn: it gets the placeholder, as a tiny one does.
        charHeight = SetCurrentFont(pixels > 0 ? static_cast<unsigned int>(pixels) : 0u);
    }

    if (align != m_textAlign)
        SetTextAlign(m_hdc, ToGdiTextAlign(align));
    SetTextColor(m_hdc, c);

    m_color = colour;
    m_fill = fill;
    m_charHeight = charHeight;
    m_textAlign = align;
}

int Tavo_WiWin32Surface::SetCurrentFont(unsigned int pixelHeight)
{
    int charHeight = GetCurrentCharHeight();
    if (m_font) {
        SelectObject(m_hdc, m_oldFont);
        DeleteObject(m_font);
        m_font = nullptr;
    }
    const unsigned int largest =
        std::max(kLargestFontFloorPixels, 2u * static_cast<unsigned int>(std::max(GetDeviceHeight(), 0)));
    if (pixelHeight >= kSmallestFontPixels && pixelHeight <= largest) {
        if (pixelHeight < static_cast<unsigned int>(m_minFont)) {
            // The minimum font stands for a larger character height than asked.
            pixelHeight = static_cast<unsigned int>(m_minFont);
            charHeight = Tavo_GrRound(m_minFont / GetScale());
        }
        const LOGFONTA description = DescribeFont(pixelHeight);
        m_font = CreateFontIndirectA(&description);
        if (m_font)
            m_oldFont = SelectObject(m_hdc, m_font);
    }
    m_fontHeight = pixelHeight;
    m_charHeight = charHeight;
    return charHeight;
}

void Tavo_WiWin32Surface::EndDrawing()
{
    Tavo_GrSurface::EndDrawing();
    ReleaseGdiObjects();
}

void Tavo_WiWin32Surface::ReleaseGdiObjects()
{
    // The displaced objects go back first: GDI does not delete an object that
    // is still selected into a device context.
    if (m_hdc) {
        if (m_oldPen)
            SelectObject(m_hdc, m_oldPen);
        if (m_oldBrush)
            SelectObject(m_hdc, m_oldBrush);
        if (m_oldFont)
            SelectObject(m_hdc, m_oldFont);
    }
    if (m_pen)
        DeleteObject(m_pen);
    if (m_brush)
        DeleteObject(m_brush);
    if (m_font)
        DeleteObject(m_font);
    ForgetGdiObjects();
}

void Tavo_WiWin32Surface::ForgetGdiObjects()
{
    m_pen = nullptr;
    m_oldPen = nullptr;
    m_brush = nullptr;
    m_oldBrush = nullptr;
    m_font = nullptr;
    m_oldFont = nullptr;
}

void Tavo_WiWin32Surface::BeginDrawing(const Tavo_GrDrawing* drawing)
{
    Tavo_GrSurface::BeginDrawing(drawing);
    // A pass that starts with Escape held stops at its first poll, however
    // recently the previous pass asked.
    m_escapeQueryTick = kNoEscapeQuery;
}

bool Tavo_WiWin32Surface::PollDrawInterrupt()
{
    if (IsDrawingInterrupted())
        return true;
    // Asking the key state is a kernel call on Windows and a round trip to the
    // server under Wine on a thread that owns a window: asked at every batch
    // boundary, nine times per flush, it would cost a third of a paint. Once
    // per clock tick (about 16 ms) is quicker than a person can tell.
    const ULONGLONG now = GetTickCount64();
    if (now == m_escapeQueryTick)
        return false;
    m_escapeQueryTick = now;
    // The sign bit says the key is down now.
    if (GetAsyncKeyState(VK_ESCAPE) & 0x8000) {
        SetDrawingInterruptedFlag();
        return true;
    }
    return false;
}

int Tavo_WiWin32Surface::FlipY(int y) const
{
    return Tavo_GrSubtract(GetDeviceHeight(), y);
}

#pragma pop_macro("DrawText")
