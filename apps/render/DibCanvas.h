// DibCanvas: a 32-bit top-down DIB section selected into its own memory DC.
//
// The render program, the benchmark and the surface tests draw into one; its
// pixels are then read directly (0x00RRGGBB per pixel, rows top to bottom).
#pragma once

#include <windows.h>

#include <cstdint>

class DibCanvas {
public:
    // A canvas of the given size filled with `background` (a COLORREF).
    // IsValid() is false when the size is not positive or GDI refused.
    DibCanvas(int width, int height, COLORREF background = RGB(255, 255, 255));
    ~DibCanvas();

    DibCanvas(const DibCanvas&) = delete;
    DibCanvas& operator=(const DibCanvas&) = delete;

    bool IsValid() const { return m_pixels != nullptr; }
    HDC GetDC() const { return m_dc; }
    int GetWidth() const { return m_width; }
    int GetHeight() const { return m_height; }

    // Pixel as COLORREF (red in the low byte), or CLR_INVALID outside.
    COLORREF GetPixel(int x, int y) const;
    // Number of pixels in the rectangle [left, right) x [top, bottom) whose
    // colour is `colour`.
    int CountPixels(COLORREF colour, int left, int top, int right, int bottom) const;
    int CountPixels(COLORREF colour) const { return CountPixels(colour, 0, 0, m_width, m_height); }
    void Fill(COLORREF colour);

    // Rows top to bottom, 4 bytes a pixel: blue, green, red, unused.
    const std::uint32_t* GetBits() const { return m_pixels; }

private:
    int m_width = 0;
    int m_height = 0;
    HDC m_dc = nullptr;
    HBITMAP m_bitmap = nullptr;
    HGDIOBJ m_oldBitmap = nullptr;
    std::uint32_t* m_pixels = nullptr;
};
