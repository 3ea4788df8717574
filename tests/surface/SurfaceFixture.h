// Shared set-up of the surface tests: a white 32-bit canvas, a surface bound
// to it with the device height of the canvas and a scale of 1, and helpers to
// name colours and run a pass.
#pragma once

#include "DibCanvas.h"
#include "GdiCallRecorder.h"

#include "Tavo_GrAttr.h"
#include "Tavo_GrTransform.h"
#include "Tavo_WiWin32Surface.h"

#include <gtest/gtest.h>

#include <memory>
#include <string>

#pragma push_macro("DrawText")
#undef DrawText

// Built-in palette indices used by the tests.
enum TestColour : char {
    kBlack = 0,
    kBlue = 1,
    kGreen = 2,
    kRed = 4,
    kWhite = 7,
};

// The COLORREF the surface draws a palette index with.
COLORREF ColourOf(char index);

// An attribute: outlines only (fill 0) or filled (fill 1).
Tavo_GrAttr Outline(char colour, int charHeight = 0, char align = Tavo_GrAttr::AlignDefault);
Tavo_GrAttr Filled(char colour, int charHeight = 0, char align = Tavo_GrAttr::AlignDefault);

// Sets an environment variable while it lives (null value: unset), restoring
// the previous state afterwards.
class ScopedEnvironment {
public:
    ScopedEnvironment(const char* name, const char* value);
    ~ScopedEnvironment();
    ScopedEnvironment(const ScopedEnvironment&) = delete;
    ScopedEnvironment& operator=(const ScopedEnvironment&) = delete;

private:
    std::string m_name;
    std::string m_previous;
    bool m_wasSet = false;
};

class SurfaceTest : public ::testing::Test {
protected:
    static constexpr int kWidth = 240;
    static constexpr int kHeight = 160;

    void SetUp() override;
    void TearDown() override;

    // Builds the surface now (after a test has set its environment) and binds it.
    void CreateSurface();
    // SetDC, device height, scale and the start of a pass.
    void Bind(double scale = 1.0);
    // Flush and EndDrawing.
    void EndPass();

    int CountColour(char colour) const { return m_canvas.CountPixels(ColourOf(colour)); }
    bool IsColour(int x, int y, char colour) const { return m_canvas.GetPixel(x, y) == ColourOf(colour); }
    Tavo_GrSurfaceStats Stats() const;

    DibCanvas m_canvas{kWidth, kHeight};
    std::unique_ptr<Tavo_WiWin32Surface> m_surface;
};

// The same with every GDI call of the surface recorded.
class RecordedSurfaceTest : public SurfaceTest {
protected:
    void SetUp() override;
    void TearDown() override;

    std::unique_ptr<GdiCallRecorder> m_recorder;
};

#pragma pop_macro("DrawText")
