// Tavo_WiWin32Surface text: placeholder lines for text too small to read, text
// wrapped into a box with "..." where the box overflows, the minimum font.
#include "SurfaceFixture.h"

#include <cstring>

class TextTest : public SurfaceTest {
protected:
    std::vector<std::string> DrawnTexts() const
    {
        std::vector<std::string> texts;
        for (const GdiCall& call : m_recorder->Of(GdiCall::TextOut))
            texts.push_back(call.text);
        return texts;
    }

    int RedInRow(int y, int left, int right) const
    {
        return m_canvas.CountPixels(ColourOf(kRed), left, kHeight - y, right, kHeight - y + 1);
    }

    // The size of `text` in a font described as the surface describes its own.
    SIZE Measure(const char* text, int pixelHeight) const
    {
        LOGFONTA description = {};
        description.lfHeight = pixelHeight;
        description.lfWeight = FW_MEDIUM;
        description.lfCharSet = ANSI_CHARSET;
        description.lfOutPrecision = OUT_CHARACTER_PRECIS;
        description.lfPitchAndFamily = FF_SWISS | DEFAULT_PITCH;
        std::strcpy(description.lfFaceName, "HelvFace");
        const HFONT font = CreateFontIndirectA(&description);
        const HGDIOBJ old = SelectObject(m_canvas.GetDC(), font);
        SIZE size = {};
        GetTextExtentPoint32A(m_canvas.GetDC(), text, static_cast<int>(std::strlen(text)), &size);
        SelectObject(m_canvas.GetDC(), old);
        DeleteObject(font);
        return size;
    }
};

TEST_F(TextTest, TextTooSmallToReadIsALineOfItsWidthPlacedByTheAlignment)
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
        m_canvas.Fill(RGB(255, 255, 255));
        CreateSurface();
        Tavo_GrAttr attr = Outline(kRed, 2, c.align); // 2 pixels at scale 1
        Tavo_GrDPoint p = At(c.x, 50);
        m_surface->DrawText("abcde", p, &attr);
        EndPass();
        EXPECT_EQ(10, CountColour(kRed)) << "5 characters x 2 pixels, alignment " << int(c.align);
        EXPECT_EQ(10, RedInRow(50, c.left, c.left + 10)) << "alignment " << int(c.align);
    }
    // In a box the line ends at the box's right edge, that point left out.
    m_canvas.Fill(RGB(255, 255, 255));
    CreateSurface();
    Tavo_GrAttr tiny = Outline(kRed, 2);
    Tavo_GrDRect box{20, 40, 35, 60};
    m_surface->DrawText("abcdefghij", box, &tiny, 2);
    EndPass();
    EXPECT_EQ(15, RedInRow(60, 20, 35));
    EXPECT_EQ(15, CountColour(kRed));
    EXPECT_TRUE(DrawnTexts().empty());
}

TEST_F(TextTest, BoxTextWrapsAtAnyCharacterAndMarksWhatDoesNotFit)
{
    const int kFontPixels = 20;
    const int lineHeight = Measure("M", kFontPixels).cy;
    const int threeWide = (Measure("MMM", kFontPixels).cx + Measure("MMMM", kFontPixels).cx) / 2;
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
    Tavo_GrAttr attr = Outline(kRed, kFontPixels);
    const int top = kHeight - 10;
    for (const auto& c : cases) {
        SCOPED_TRACE(testing::Message() << c.text << " in " << c.lines << " lines less " << c.shortBy);
        CreateSurface();
        m_recorder->Clear();
        Tavo_GrDRect box{10, top - c.lines * lineHeight + c.shortBy, 10 + c.width, top};
        m_surface->DrawText(c.text, box, &attr, kFontPixels);
        EndPass();
        ASSERT_EQ(c.drawn, DrawnTexts());
        const std::vector<GdiCall> texts = m_recorder->Of(GdiCall::TextOut);
        for (int line = 0; line < static_cast<int>(texts.size()); ++line)
            EXPECT_EQ((std::array<int, 4>{10, kHeight - top + (line + 1) * lineHeight}), texts[line].box);
    }
}

TEST_F(TextTest, TextBelowTheMinimumFontIsDrawnAtTheMinimumHeight)
{
    int rows[2] = {};
    const char* minFonts[2] = {"3", "16"};
    for (int i = 0; i < 2; ++i) {
        m_canvas.Fill(RGB(255, 255, 255));
        {
            ScopedEnvironment minFont("BRY_VWR_MINFONT", minFonts[i]);
            CreateSurface();
        }
        Tavo_GrAttr attr = Outline(kRed, 5);
        Tavo_GrDPoint p = At(20, 60);
        m_surface->DrawText("HH", p, &attr); // capitals without descenders
        EndPass();
        for (int y = 0; y < kHeight; ++y)
            rows[i] += RedInRow(y, 0, kWidth) > 0;
    }
    EXPECT_GT(rows[0], 0);
    EXPECT_GT(rows[1], rows[0] + 4) << "the letters grew to the minimum font";
}
