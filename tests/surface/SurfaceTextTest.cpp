// Tavo_WiWin32Surface text: placeholder lines for text too small to read, text
// wrapped into a box with "..." where the box overflows, the minimum font.
#include "SurfaceFixture.h"

TEST_F(SurfaceTest, TextTooSmallToReadIsALineOfItsWidthPlacedByTheAlignment)
{
    const struct {
        char align;
        int x;
        int left;
    } cases[] = {
        {Tavo_GrAttr::AlignLeft | Tavo_GrAttr::AlignBottom, 30, 30},
        {Tavo_GrAttr::AlignRight | Tavo_GrAttr::AlignBottom, 100, 90},
        {Tavo_GrAttr::AlignCentre | Tavo_GrAttr::AlignBottom, 100, 95},
    };
    for (const auto& c : cases) {
        SCOPED_TRACE(testing::Message() << "alignment " << int(c.align));
        CreateSurface();
        Tavo_GrAttr attr = Outline(kRed, 2, c.align); // 2 pixels at scale 1
        Tavo_GrDPoint p{c.x, 50};
        m_surface->DrawText("abcde", p, &attr);
        EndPass();
        EXPECT_EQ(10, RedPixels()) << "5 characters x 2 pixels";
        EXPECT_EQ(10, RedPixelsIn(c.left, kHeight - 50, c.left + 10, kHeight - 49));
    }
    // In a box the line ends at the box's right edge, that point left out.
    CreateSurface();
    Tavo_GrAttr tiny = Outline(kRed, 2);
    Tavo_GrDRect box{20, 40, 35, 60};
    m_surface->DrawText("abcdefghij", box, &tiny, 2);
    EndPass();
    EXPECT_EQ(15, RedPixelsIn(20, kHeight - 60, 35, kHeight - 59));
    EXPECT_EQ(15, RedPixels());
    EXPECT_EQ(0, m_recorder.CountOf(GdiCall::TextOut));
}

TEST_F(SurfaceTest, BoxTextWrapsAtAnyCharacterAndMarksWhatDoesNotFit)
{
    const int kFontPixels = 20;
    Tavo_GrAttr attr = Outline(kRed, kFontPixels);
    // Measured in the surface's own font, which stays selected while the pass lasts.
    Tavo_GrDPoint origin{0, 0};
    m_surface->DrawText("M", origin, &attr);
    SIZE letter = {};
    GetTextExtentPoint32A(m_canvas.GetDC(), "M", 1, &letter);
    const int lineHeight = letter.cy, threeWide = letter.cx * 7 / 2; // room for three Ms, not four
    const struct {
        const char* text;
        int lines;   // the box is this many lines high ...
        int shortBy; // ... less this many pixels
        int width;
        std::vector<std::string> drawn;
    } cases[] = {
        {"MMMMMMMM", 3, 0, threeWide, {"MMM", "MMM", "MM"}},
        {"MMMMMMMM", 3, 1, threeWide, {"MMM", "MMM", "..."}},
        {"MMM", 4, 0, 2, {"M", "M", "M"}},    // a character wider than the box: one a line
        {"MMMMMMMM", 3, 0, -1, {"MMMMMMMM"}}, // right edge left of the left edge: no limit
    };
    const int top = kHeight - 10;
    for (const auto& c : cases) {
        SCOPED_TRACE(testing::Message() << c.text << " in " << c.lines << " lines less " << c.shortBy);
        CreateSurface();
        Tavo_GrDRect box{10, top - c.lines * lineHeight + c.shortBy, 10 + c.width, top};
        m_surface->DrawText(c.text, box, &attr, kFontPixels);
        EndPass();
        const std::vector<GdiCall> texts = m_recorder.Of(GdiCall::TextOut);
        ASSERT_EQ(c.drawn.size(), texts.size());
        for (size_t line = 0; line < texts.size(); ++line) {
            EXPECT_EQ(c.drawn[line], texts[line].text);
            EXPECT_EQ((std::array<int, 4>{10, kHeight - top + int(line + 1) * lineHeight}), texts[line].box);
        }
    }
}

TEST_F(SurfaceTest, TextBelowTheMinimumFontIsDrawnAtTheMinimumHeight)
{
    int rows[2] = {};
    const char* minFonts[2] = {"3", "16"};
    for (int i = 0; i < 2; ++i) {
        CreateSurface("BRY_VWR_MINFONT", minFonts[i]);
        Tavo_GrAttr attr = Outline(kRed, 5);
        Tavo_GrDPoint p{20, 60};
        m_surface->DrawText("HH", p, &attr); // capitals without descenders
        EndPass();
        for (int y = 0; y < kHeight; ++y)
            rows[i] += RedPixelsIn(0, y, kWidth, y + 1) > 0;
    }
    EXPECT_GT(rows[0], 0);
    EXPECT_GT(rows[1], rows[0] + 4) << "the letters grew to the minimum font";
}
