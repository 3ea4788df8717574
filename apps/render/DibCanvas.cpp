#include "DibCanvas.h"

namespace {

// DIB pixels are 0x00RRGGBB; COLORREF is 0x00BBGGRR.
std::uint32_t ToDibPixel(COLORREF colour)
{
    return (GetRValue(colour) << 16) | (GetGValue(colour) << 8) | GetBValue(colour);
}

COLORREF ToColorRef(std::uint32_t pixel)
{
    return RGB((pixel >> 16) & 0xFF, (pixel >> 8) & 0xFF, pixel & 0xFF);
}

} // namespace

DibCanvas::DibCanvas(int width, int height, COLORREF background)
{
    if (width <= 0 || height <= 0)
        return;
    BITMAPINFO info = {};
    info.bmiHeader.biSize = sizeof(info.bmiHeader);
    info.bmiHeader.biWidth = width;
    info.bmiHeader.biHeight = -height; // negative: rows run top to bottom
    info.bmiHeader.biPlanes = 1;
    info.bmiHeader.biBitCount = 32;
    info.bmiHeader.biCompression = BI_RGB;

    void* bits = nullptr;
    m_bitmap = CreateDIBSection(nullptr, &info, DIB_RGB_COLORS, &bits, nullptr, 0);
    m_dc = CreateCompatibleDC(nullptr);
    if (!m_bitmap || !m_dc || !bits)
        return;
    m_oldBitmap = SelectObject(m_dc, m_bitmap);
    m_width = width;
    m_height = height;
    m_pixels = static_cast<std::uint32_t*>(bits);
    Fill(background);
}

DibCanvas::~DibCanvas()
{
    if (m_dc && m_oldBitmap)
        SelectObject(m_dc, m_oldBitmap);
    if (m_dc)
        DeleteDC(m_dc);
    if (m_bitmap)
        DeleteObject(m_bitmap);
}

COLORREF DibCanvas::GetPixel(int x, int y) const
{
    if (!m_pixels || x < 0 || y < 0 || x >= m_width || y >= m_height)
        return CLR_INVALID;
    GdiFlush(); // GDI may still hold drawing that has not reached the bits
    return ToColorRef(m_pixels[static_cast<size_t>(y) * m_width + x]);
}

int DibCanvas::CountPixels(COLORREF colour, int left, int top, int right, int bottom) const
{
    if (!m_pixels)
        return 0;
    GdiFlush();
    const std::uint32_t wanted = ToDibPixel(colour);
    int count = 0;
    for (int y = (top < 0 ? 0 : top); y < bottom && y < m_height; ++y)
        for (int x = (left < 0 ? 0 : left); x < right && x < m_width; ++x)
            if ((m_pixels[static_cast<size_t>(y) * m_width + x] & 0xFFFFFF) == wanted)
                ++count;
    return count;
}

void DibCanvas::Fill(COLORREF colour)
{
    if (!m_pixels)
        return;
    GdiFlush();
    const std::uint32_t pixel = ToDibPixel(colour);
    const size_t total = static_cast<size_t>(m_width) * m_height;
    for (size_t i = 0; i < total; ++i)
        m_pixels[i] = pixel;
}
