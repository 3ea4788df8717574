// Tavo_WiWin32Surface as a whole: settings, the attribute-to-GDI mapping and
// its rebuild rules, fonts, statistics, the end of a pass and the interrupt.
#include "SurfaceFixture.h"

#include "Tavo_WiLibrary.h"
#include "Tavo_WiNativeWindowSurface.h"
#include "Tavo_WiPalette.h"

#include <algorithm>
#include <climits>
#include <cstring>
#include <type_traits>

#pragma push_macro("DrawText")
#undef DrawText

namespace {

Tavo_GrDPoint At(int x, int y)
{
    return Tavo_GrDPoint{x, y};
}

} // namespace

// ---- Construction and settings ----------------------------------------------

TEST(SurfaceConstruction, CopyingIsForbidden)
{
    static_assert(!std::is_copy_constructible_v<Tavo_WiWin32Surface>);
    static_assert(!std::is_copy_assignable_v<Tavo_WiWin32Surface>);
}

TEST_F(SurfaceTest, NewSurfaceHasColourOutputNoThickeningAndZeroStats)
{
    EXPECT_FALSE(m_surface->IsBlackAndWhite());
    EXPECT_EQ(0, m_surface->GetThickenVertLine());
    const Tavo_GrSurfaceStats stats = Stats();
    for (int i = 0; i < Tavo_GrSurfaceStats::CounterCount; ++i)
        EXPECT_EQ(0u, stats.m_counters[i]) << "counter " << i;
}

TEST_F(SurfaceTest, SettersAreReadBack)
{
    m_surface->SetBlackAndWhiteFlag(true);
    m_surface->SetThickenVertLine(3);
    EXPECT_TRUE(m_surface->IsBlackAndWhite());
    EXPECT_EQ(3, m_surface->GetThickenVertLine());
}

TEST_F(SurfaceTest, ThickeningComesFromTheEnvironment)
{
    {
        ScopedEnvironment thicken("BRY_VWR_THICKENVERTICALLINE", "2");
        CreateSurface();
    }
    EXPECT_EQ(2, m_surface->GetThickenVertLine());
    {
        ScopedEnvironment thicken("BRY_VWR_THICKENVERTICALLINE", "-4");
        CreateSurface();
    }
    EXPECT_EQ(-4, m_surface->GetThickenVertLine());
    {
        ScopedEnvironment thicken("BRY_VWR_THICKENVERTICALLINE", "99999999999999");
        CreateSurface();
    }
    EXPECT_EQ(INT_MAX, m_surface->GetThickenVertLine()) << "saturates instead of overflowing";
}

// ---- Attributes to GDI objects ----------------------------------------------

TEST_F(RecordedSurfaceTest, SetDcSelectsLeftBottomAlignmentTransparentTextAndAlternateFill)
{
    Bind();
    ASSERT_EQ(3u, m_recorder->GetCalls().size());
    EXPECT_EQ(GdiCall::SetTextAlign, m_recorder->GetCalls()[0].kind);
    EXPECT_EQ(UINT(TA_LEFT | TA_BOTTOM), m_recorder->GetCalls()[0].value);
    EXPECT_EQ(GdiCall::SetBkMode, m_recorder->GetCalls()[1].kind);
    EXPECT_EQ(UINT(TRANSPARENT), m_recorder->GetCalls()[1].value);
    EXPECT_EQ(GdiCall::SetPolyFillMode, m_recorder->GetCalls()[2].kind);
    EXPECT_EQ(UINT(ALTERNATE), m_recorder->GetCalls()[2].value);
}

TEST_F(RecordedSurfaceTest, FirstAttributeCountsAsColourChangeAndFlushesEmptyBatches)
{
    Tavo_GrAttr attr = Outline(kRed);
    Tavo_GrDPoint a = At(5, 5), b = At(50, 5);
    m_surface->DrawLine(a, b, &attr);

    EXPECT_EQ(1u, Stats().Get(Tavo_GrSurfaceStats::AttrChanges));
    const std::vector<GdiCall> calls = m_recorder->GetCalls();
    ASSERT_GE(calls.size(), 5u);
    for (int i = 0; i < 4; ++i) {
        EXPECT_EQ(GdiCall::PolyPolyline, calls[i].kind);
        EXPECT_EQ(0, calls[i].count);
    }
    EXPECT_EQ(1, m_recorder->CountOf(GdiCall::CreatePen));
    EXPECT_EQ(1, m_recorder->CountOf(GdiCall::CreateBrush));
}

TEST_F(RecordedSurfaceTest, PenIsSolidOnePixelInThePaletteColour)
{
    Tavo_GrAttr attr = Filled(kBlue);
    Tavo_GrDRect r{10, 10, 20, 20};
    m_surface->DrawRect(r, &attr);

    const std::vector<GdiCall> pens = m_recorder->Of(GdiCall::CreatePen);
    ASSERT_EQ(1u, pens.size());
    EXPECT_EQ(UINT(PS_SOLID), pens[0].value);
    EXPECT_EQ(0, pens[0].count) << "width 0: one device pixel";
    EXPECT_EQ(RGB(0, 0, 255), pens[0].colour);
    const std::vector<GdiCall> brushes = m_recorder->Of(GdiCall::CreateBrush);
    ASSERT_EQ(1u, brushes.size());
    EXPECT_EQ(UINT(BS_SOLID), brushes[0].value);
    EXPECT_EQ(RGB(0, 0, 255), brushes[0].colour);
    const std::vector<GdiCall> textColours = m_recorder->Of(GdiCall::SetTextColor);
    ASSERT_EQ(1u, textColours.size());
    EXPECT_EQ(RGB(0, 0, 255), textColours[0].value);
}

TEST_F(RecordedSurfaceTest, FillZeroMakesAHollowBrush)
{
    Tavo_GrAttr attr = Outline(kRed);
    Tavo_GrDRect r{10, 10, 20, 20};
    m_surface->DrawRect(r, &attr);
    const std::vector<GdiCall> brushes = m_recorder->Of(GdiCall::CreateBrush);
    ASSERT_EQ(1u, brushes.size());
    EXPECT_EQ(UINT(BS_HOLLOW), brushes[0].value);
}

TEST_F(RecordedSurfaceTest, BlackAndWhiteDrawsColoursAsGrey)
{
    m_surface->SetBlackAndWhiteFlag(true);
    Tavo_GrAttr attr = Outline(kRed);
    Tavo_GrDPoint p = At(3, 3);
    m_surface->DrawDot(p, &attr);
    const std::vector<GdiCall> pens = m_recorder->Of(GdiCall::CreatePen);
    ASSERT_EQ(1u, pens.size());
    EXPECT_EQ(RGB(76, 76, 76), pens[0].colour);
}

TEST_F(RecordedSurfaceTest, ColourChangeRebuildsPenAndBrushAndFlushesFirst)
{
    Tavo_GrAttr red = Outline(kRed);
    Tavo_GrAttr blue = Outline(kBlue);
    Tavo_GrDPoint a = At(5, 5), b = At(50, 5);
    m_surface->DrawLine(a, b, &red);
    m_recorder->Clear();
    m_surface->DrawLine(a, b, &blue);

    const std::vector<GdiCall::Kind> kinds = m_recorder->GetKinds();
    // The red line is emitted before the blue pen exists.
    const auto line = std::find_if(m_recorder->GetCalls().begin(), m_recorder->GetCalls().end(),
                                   [](const GdiCall& call) { return call.kind == GdiCall::PolyPolyline && call.count == 1; });
    const auto pen = std::find_if(m_recorder->GetCalls().begin(), m_recorder->GetCalls().end(),
                                  [](const GdiCall& call) { return call.kind == GdiCall::CreatePen; });
    ASSERT_NE(m_recorder->GetCalls().end(), line);
    ASSERT_NE(m_recorder->GetCalls().end(), pen);
    EXPECT_LT(line - m_recorder->GetCalls().begin(), pen - m_recorder->GetCalls().begin());
    EXPECT_EQ(1, m_recorder->CountOf(GdiCall::CreateBrush));
    EXPECT_EQ(2, m_recorder->CountOf(GdiCall::DeleteObject)) << "the red pen and brush";
    EXPECT_EQ(2u, Stats().Get(Tavo_GrSurfaceStats::AttrChanges));
}

TEST_F(RecordedSurfaceTest, FillChangeRebuildsOnlyTheBrush)
{
    Tavo_GrAttr outline = Outline(kRed);
    Tavo_GrAttr filled = Filled(kRed);
    Tavo_GrDRect r{10, 10, 20, 20};
    m_surface->DrawRect(r, &outline);
    m_recorder->Clear();
    m_surface->DrawRect(r, &filled);
    EXPECT_EQ(0, m_recorder->CountOf(GdiCall::CreatePen));
    EXPECT_EQ(1, m_recorder->CountOf(GdiCall::CreateBrush));
    EXPECT_EQ(2u, Stats().Get(Tavo_GrSurfaceStats::AttrChanges));
}

TEST_F(RecordedSurfaceTest, CharHeightOrAlignmentChangesNeitherCountNorFlush)
{
    Tavo_GrAttr first = Outline(kRed, 10);
    Tavo_GrAttr taller = Outline(kRed, 20);
    Tavo_GrAttr centred = Outline(kRed, 20, Tavo_GrAttr::AlignCentre | Tavo_GrAttr::AlignTop);
    Tavo_GrDPoint a = At(5, 5), b = At(50, 5);
    m_surface->DrawLine(a, b, &first);
    m_recorder->Clear();
    m_surface->DrawLine(a, b, &taller);
    m_surface->DrawLine(a, b, &centred);

    EXPECT_EQ(1u, Stats().Get(Tavo_GrSurfaceStats::AttrChanges));
    EXPECT_EQ(0, m_recorder->CountOf(GdiCall::PolyPolyline));
    EXPECT_EQ(0, m_recorder->CountOf(GdiCall::CreatePen));
    EXPECT_EQ(0, m_recorder->CountOf(GdiCall::CreateBrush));
    EXPECT_EQ(1, m_recorder->CountOf(GdiCall::CreateFont)) << "only the height change builds a font";
    const std::vector<GdiCall> aligns = m_recorder->Of(GdiCall::SetTextAlign);
    ASSERT_EQ(1u, aligns.size());
    EXPECT_EQ(UINT(TA_CENTER | TA_TOP), aligns[0].value);
    EXPECT_EQ(2, m_recorder->CountOf(GdiCall::SetTextColor)) << "text colour is set at every change";
}

TEST_F(RecordedSurfaceTest, AlignmentCodesMapToGdiFlags)
{
    struct Case {
        char code;
        UINT flags;
    };
    // Middle (12) and no code (0) are drawn bottom-aligned; no horizontal code is left.
    const Case cases[] = {
        {2 | 4, TA_RIGHT | TA_BOTTOM}, {3 | 8, TA_CENTER | TA_TOP}, {1 | 12, TA_LEFT | TA_BOTTOM},
        {0, TA_LEFT | TA_BOTTOM},      {2 | 8, TA_RIGHT | TA_TOP},  {3 | 12, TA_CENTER | TA_BOTTOM},
    };
    Tavo_GrDPoint a = At(5, 5), b = At(50, 5);
    for (const Case& c : cases) {
        Bind(); // alignment code 5 again
        m_recorder->Clear();
        Tavo_GrAttr attr = Outline(kRed, 0, c.code);
        m_surface->DrawLine(a, b, &attr);
        const std::vector<GdiCall> aligns = m_recorder->Of(GdiCall::SetTextAlign);
        ASSERT_EQ(1u, aligns.size()) << "code " << int(c.code);
        EXPECT_EQ(c.flags, aligns[0].value) << "code " << int(c.code);
        EndPass();
    }
}

// ---- Fonts --------------------------------------------------------------------

TEST_F(RecordedSurfaceTest, FontIsAMediumSwissHelvFaceOfTheScaledHeight)
{
    Bind(2.0);
    Tavo_GrAttr attr = Outline(kBlack, 10);
    Tavo_GrDPoint p = At(10, 40);
    m_surface->DrawText("font", p, &attr);
    const std::vector<GdiCall> fonts = m_recorder->Of(GdiCall::CreateFont);
    ASSERT_EQ(1u, fonts.size());
    const LOGFONTA& font = fonts[0].font;
    EXPECT_EQ(20, font.lfHeight);
    EXPECT_EQ(0, font.lfWidth);
    EXPECT_EQ(FW_MEDIUM, font.lfWeight);
    EXPECT_EQ(ANSI_CHARSET, font.lfCharSet);
    EXPECT_EQ(OUT_CHARACTER_PRECIS, font.lfOutPrecision);
    EXPECT_EQ(FF_SWISS | DEFAULT_PITCH, font.lfPitchAndFamily);
    EXPECT_STREQ("HelvFace", font.lfFaceName);
    EXPECT_EQ(0, font.lfItalic);
    EXPECT_EQ(0, font.lfUnderline);
    EXPECT_EQ(0, font.lfStrikeOut);
}

TEST_F(RecordedSurfaceTest, ScaledHeightRoundsHalfAwayFromZero)
{
    Bind(0.5);
    Tavo_GrAttr attr = Outline(kBlack, 21); // 10.5 pixels
    Tavo_GrDPoint p = At(10, 40);
    m_surface->DrawText("x", p, &attr);
    const std::vector<GdiCall> fonts = m_recorder->Of(GdiCall::CreateFont);
    ASSERT_EQ(1u, fonts.size());
    EXPECT_EQ(11, fonts[0].font.lfHeight);
}

TEST_F(RecordedSurfaceTest, HeightBelowMinimumGetsTheMinimumFont)
{
    Tavo_GrAttr attr = Outline(kBlack, 5);
    Tavo_GrDPoint p = At(10, 40);
    m_surface->DrawText("x", p, &attr);
    const std::vector<GdiCall> fonts = m_recorder->Of(GdiCall::CreateFont);
    ASSERT_EQ(1u, fonts.size());
    EXPECT_EQ(8, fonts[0].font.lfHeight);
}

TEST_F(RecordedSurfaceTest, MinimumFontFollowsTheEnvironmentButNeverGoesBelowThree)
{
    struct Case {
        const char* value;
        int expectedHeight; // of a font asked for at 5 pixels ... or 3 pixels
        int askedHeight;
    };
    const Case cases[] = {{"12", 12, 5}, {"2", 3, 3}, {nullptr, 8, 5}};
    for (const Case& c : cases) {
        {
            ScopedEnvironment minFont("BRY_VWR_MINFONT", c.value);
            m_surface.reset();
            CreateSurface();
        }
        m_recorder->Clear();
        Tavo_GrAttr attr = Outline(kBlack, c.askedHeight);
        Tavo_GrDPoint p = At(10, 40);
        m_surface->DrawText("x", p, &attr);
        const std::vector<GdiCall> fonts = m_recorder->Of(GdiCall::CreateFont);
        ASSERT_EQ(1u, fonts.size()) << (c.value ? c.value : "unset");
        EXPECT_EQ(c.expectedHeight, fonts[0].font.lfHeight) << (c.value ? c.value : "unset");
        EndPass();
    }
}

TEST_F(RecordedSurfaceTest, HeightBelowThreePixelsSelectsNoFont)
{
    Tavo_GrAttr attr = Outline(kBlack, 2);
    Tavo_GrDPoint p = At(10, 40);
    m_surface->DrawText("x", p, &attr);
    EXPECT_EQ(0, m_recorder->CountOf(GdiCall::CreateFont));
}

TEST_F(RecordedSurfaceTest, NegativeHeightSelectsNoFont)
{
    Tavo_GrAttr attr = Outline(kBlack, -40);
    Tavo_GrDPoint p = At(10, 40);
    m_surface->DrawText("x", p, &attr);
    EXPECT_EQ(0, m_recorder->CountOf(GdiCall::CreateFont));
    EXPECT_EQ(0, m_recorder->CountOf(GdiCall::TextOut));
}

TEST_F(RecordedSurfaceTest, HugeScaledHeightSaturatesInsteadOfOverflowing)
{
    Bind(1.0e12);
    Tavo_GrAttr attr = Outline(kBlack, 1000);
    Tavo_GrDPoint a = At(10, 40), b = At(20, 40);
    m_surface->DrawLine(a, b, &attr);
    const std::vector<GdiCall> fonts = m_recorder->Of(GdiCall::CreateFont);
    ASSERT_EQ(1u, fonts.size());
    EXPECT_EQ(INT_MAX, fonts[0].font.lfHeight);
}

// ---- Statistics ---------------------------------------------------------------

TEST_F(SurfaceTest, StatisticsCountEmittedPrimitivesByKind)
{
    Tavo_GrAttr outline = Outline(kRed);
    Tavo_GrAttr filled = Filled(kRed);
    Tavo_GrDPoint a = At(5, 5), b = At(50, 5), c = At(60, 60);
    Tavo_GrDRect r{10, 10, 20, 20};
    Tavo_GrDPoint tiny[3] = {At(10, 10), At(12, 12), At(8, 12)};
    Tavo_GrDPoint big[3] = {At(10, 10), At(40, 10), At(20, 40)};
    m_surface->DrawDot(a, &outline);
    m_surface->DrawLine(a, b, &outline);
    m_surface->DrawTriangle(tiny, &outline);
    m_surface->DrawTriangle(big, &outline);
    m_surface->DrawRect(r, &outline);
    m_surface->DrawCircle(c, 10, &outline);
    m_surface->DrawCircle(c, 5, &filled);
    m_surface->DrawTriangle(big, &filled);
    m_surface->DrawRect(r, &filled);
    EndPass();

    const Tavo_GrSurfaceStats stats = Stats();
    EXPECT_EQ(2u, stats.Get(Tavo_GrSurfaceStats::AttrChanges));
    EXPECT_EQ(1u, stats.Get(Tavo_GrSurfaceStats::Dots));
    EXPECT_EQ(2u, stats.Get(Tavo_GrSurfaceStats::Lines)) << "a line and a uniangle";
    EXPECT_EQ(1u, stats.Get(Tavo_GrSurfaceStats::HollowTriangles));
    EXPECT_EQ(1u, stats.Get(Tavo_GrSurfaceStats::HollowRects));
    EXPECT_EQ(1u, stats.Get(Tavo_GrSurfaceStats::FilledTriangles));
    EXPECT_EQ(1u, stats.Get(Tavo_GrSurfaceStats::FilledRects));
    EXPECT_EQ(2u, stats.Get(Tavo_GrSurfaceStats::Circles)) << "hollow and filled together";
    EXPECT_EQ(0u, stats.Get(Tavo_GrSurfaceStats::Polylines));
    EXPECT_EQ(0u, stats.Get(Tavo_GrSurfaceStats::Polygons));
    EXPECT_EQ(0u, stats.Get(Tavo_GrSurfaceStats::Grids));
    EXPECT_EQ(0u, stats.Get(Tavo_GrSurfaceStats::Calls));
}

TEST_F(SurfaceTest, ResetStatsClearsEveryCounter)
{
    Tavo_GrAttr attr = Outline(kRed);
    Tavo_GrDPoint a = At(5, 5);
    m_surface->DrawDot(a, &attr);
    EndPass();
    m_surface->ResetStats();
    const Tavo_GrSurfaceStats stats = Stats();
    for (int i = 0; i < Tavo_GrSurfaceStats::CounterCount; ++i)
        EXPECT_EQ(0u, stats.m_counters[i]) << "counter " << i;
}

// ---- End of a pass and interrupt ---------------------------------------------

TEST_F(RecordedSurfaceTest, EndDrawingOnASurfaceThatNeverDrewDeletesNothing)
{
    m_surface->EndDrawing();
    EXPECT_EQ(0, m_recorder->CountOf(GdiCall::DeleteObject));
    EXPECT_EQ(0, m_recorder->CountOf(GdiCall::SelectObject));
}

TEST_F(RecordedSurfaceTest, EscapeKeyInterruptsAndTheFlagStaysUntilReset)
{
    EXPECT_FALSE(m_surface->PollDrawInterrupt());
    m_recorder->SetEscapeDown(true);
    EXPECT_TRUE(m_surface->PollDrawInterrupt());
    EXPECT_TRUE(m_surface->IsDrawingInterrupted());
    m_recorder->SetEscapeDown(false);
    EXPECT_TRUE(m_surface->PollDrawInterrupt()) << "still set after the key is released";
    m_surface->ResetDrawingInterruptFlags();
    EXPECT_FALSE(m_surface->PollDrawInterrupt());
}

TEST_F(RecordedSurfaceTest, StaticCountArraysComeBackAfterTheLastSurfaceDied)
{
    m_surface.reset(); // the last surface: the shared arrays are released
    CreateSurface();
    m_recorder->Clear();
    Tavo_GrAttr attr = Outline(kRed);
    Tavo_GrDPoint a = At(5, 5), b = At(50, 5);
    m_surface->DrawLine(a, b, &attr);
    EndPass();
    bool sawLine = false;
    for (const GdiCall& call : m_recorder->Of(GdiCall::PolyPolyline)) {
        if (call.count != 1)
            continue;
        sawLine = true;
        ASSERT_NE(nullptr, call.counts);
        EXPECT_EQ(std::vector<DWORD>{2}, call.countValues);
    }
    EXPECT_TRUE(sawLine);
}


// ---- The on-screen surface ------------------------------------------------------

TEST(NativeWindowSurface, DrawsAsTheGdiSurfaceDoes)
{
    static_assert(std::is_base_of_v<Tavo_WiWin32Surface, Tavo_WiNativeWindowSurface>);
    DibCanvas canvas(40, 30);
    Tavo_WiNativeWindowSurface surface;
    surface.SetDC(canvas.GetDC());
    surface.SetDeviceHeight(30);
    surface.BeginDrawing(nullptr);
    Tavo_GrAttr attr = Filled(kBlue);
    Tavo_GrDRect r{5, 5, 14, 14};
    surface.DrawRect(r, &attr);
    surface.Flush();
    surface.EndDrawing();
    EXPECT_EQ(100, canvas.CountPixels(ColourOf(kBlue)));
}

#pragma pop_macro("DrawText")
