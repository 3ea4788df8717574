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

#include <memory>
#include <ostream>

// The tests call the surface's DrawText, never the Win32 macro of that name.
#undef DrawText

enum TestColour : char { kBlack = 0, kBlue = 1, kRed = 4 };

// The COLORREF the surface draws a palette index with.
inline COLORREF ColourOf(char index)
{
    return Tavo_WiLibrary::GetPalette()->GetWin32Color(index, false);
}

inline Tavo_GrAttr Outline(char colour, int charHeight = 0, char align = Tavo_GrAttr::AlignDefault)
{
    return Tavo_GrAttr(colour, 0, charHeight, align);
}

inline Tavo_GrAttr Filled(char colour, int charHeight = 0, char align = Tavo_GrAttr::AlignDefault)
{
    return Tavo_GrAttr(colour, 1, charHeight, align);
}

inline Tavo_GrDPoint At(int x, int y)
{
    return Tavo_GrDPoint{x, y};
}

// POINT is a global type: its comparison and printing must be found there.
inline bool operator==(const POINT& a, const POINT& b)
{
    return a.x == b.x && a.y == b.y;
}

inline void PrintTo(const POINT& point, std::ostream* out)
{
    *out << "(" << point.x << ", " << point.y << ")";
}

// Sets an environment variable (null: unset) while it lives, then unsets it.
class ScopedEnvironment {
public:
    ScopedEnvironment(const char* name, const char* value) : m_name(name) { SetEnvironmentVariableA(name, value); }
    ~ScopedEnvironment() { SetEnvironmentVariableA(m_name, nullptr); }
    ScopedEnvironment(const ScopedEnvironment&) = delete;
    ScopedEnvironment& operator=(const ScopedEnvironment&) = delete;

private:
    const char* m_name;
};

class SurfaceTest : public ::testing::Test {
protected:
    static constexpr int kWidth = 240;
    static constexpr int kHeight = 160;

    void SetUp() override
    {
        ASSERT_TRUE(m_canvas.IsValid());
        CreateSurface();
        m_recorder = std::make_unique<GdiCallRecorder>();
        ASSERT_TRUE(m_recorder->IsActive());
    }

    // A new surface, reading the environment now.
    void CreateSurface()
    {
        m_surface = std::make_unique<Tavo_WiWin32Surface>();
        Bind();
    }

    void Bind(double scale = 1.0)
    {
        m_surface->SetDC(m_canvas.GetDC());
        m_surface->SetDeviceHeight(kHeight);
        m_surface->SetTransform(Tavo_GrTransform(scale, 0.0, 0.0));
        m_surface->BeginDrawing(nullptr);
    }

    void EndPass()
    {
        m_surface->Flush();
        m_surface->EndDrawing();
    }

    int CountColour(char colour) const { return m_canvas.CountPixels(ColourOf(colour)); }
    bool IsColour(int x, int y, char colour) const { return m_canvas.GetPixel(x, y) == ColourOf(colour); }
    unsigned Stat(Tavo_GrSurfaceStats::Counter counter) const
    {
        Tavo_GrSurfaceStats stats;
        m_surface->FetchStats(stats);
        return stats.Get(counter);
    }

    DibCanvas m_canvas{kWidth, kHeight};
    std::unique_ptr<Tavo_WiWin32Surface> m_surface;
    std::unique_ptr<GdiCallRecorder> m_recorder; // every GDI call of the surface
};
