// Shared set-up of the surface tests: a white 32-bit canvas, a surface bound
// to it (device height of the canvas, scale 1) and its GDI calls recorded.
#pragma once

#include "DibCanvas.h"
#include "GdiCallRecorder.h"

#include "Tavo_GrAttr.h"
#include "Tavo_GrTransform.h"
#include "Tavo_WiLibrary.h"
#include "Tavo_WiPalette.h"
#include "Tavo_WiWin32Surface.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <memory>
#include <ostream>

// The tests call the surface's DrawText, never the Win32 macro of that name.
#undef DrawText

enum TestColour : char {
    kBlack = 0,
    kBlue = 1,
    kRed = 4
};

inline Tavo_GrAttr Outline(char colour, int charHeight = 0, char align = Tavo_GrAttr::AlignDefault)
{
    return Tavo_GrAttr(colour, 0, charHeight, align);
}

inline Tavo_GrAttr Filled(char colour, int charHeight = 0, char align = Tavo_GrAttr::AlignDefault)
{
    return Tavo_GrAttr(colour, 1, charHeight, align);
}

// POINT is a global type: its comparison and printing must be found there.
inline bool operator==(const POINT& a, const POINT& b) { return a.x == b.x && a.y == b.y; }
inline void PrintTo(const POINT& point, std::ostream* out) { *out << "(" << point.x << ", " << point.y << ")"; }

class SurfaceTest : public ::testing::Test {
protected:
    static constexpr int kWidth = 240;
    static constexpr int kHeight = 160;

    void SetUp() override
    {
        ASSERT_TRUE(m_canvas.IsValid());
        ASSERT_TRUE(m_recorder.IsActive());
        CreateSurface();
    }

    // A white canvas, no calls recorded and a new surface in a pass, which read
    // the environment with `variable` (if any) set to `value`.
    void CreateSurface(const char* variable = nullptr, const char* value = nullptr, double scale = 1.0)
    {
        m_canvas.Fill(RGB(255, 255, 255));
        if (variable)
            SetEnvironmentVariableA(variable, value);
        m_surface = std::make_unique<Tavo_WiWin32Surface>();
        if (variable)
            SetEnvironmentVariableA(variable, nullptr);
        m_surface->SetDC(m_canvas.GetDC());
        m_surface->SetDeviceHeight(kHeight);
        m_surface->SetTransform(Tavo_GrTransform(scale, 0.0, 0.0));
        m_surface->BeginDrawing(nullptr);
        m_recorder.Clear();
    }

    void EndPass()
    {
        m_surface->Flush();
        m_surface->EndDrawing();
    }

    // The PolyPolyline calls that drew something.
    std::vector<GdiCall> Polylines() const
    {
        std::vector<GdiCall> calls = m_recorder.Of(GdiCall::PolyPolyline);
        calls.erase(std::remove_if(calls.begin(), calls.end(), [](const GdiCall& c) { return c.countValues.empty(); }),
                    calls.end());
        return calls;
    }

    static COLORREF Red() { return Tavo_WiLibrary::GetPalette()->GetWin32Color(kRed, false); }
    int RedPixels() const { return m_canvas.CountPixels(Red()); }
    int RedPixelsIn(int left, int top, int right, int bottom) const
    {
        return m_canvas.CountPixels(Red(), left, top, right, bottom);
    }
    bool IsRed(int x, int y) const { return m_canvas.GetPixel(x, y) == Red(); }

    DibCanvas m_canvas{kWidth, kHeight};
    GdiCallRecorder m_recorder; // every GDI call of the surface
    std::unique_ptr<Tavo_WiWin32Surface> m_surface;
};
