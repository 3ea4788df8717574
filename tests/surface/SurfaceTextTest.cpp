// Tavo_WiWin32Surface text: at a point and wrapped into a box, placeholder
// lines for text too small to read, "..." where a box overflows.
#include "SurfaceFixture.h"

#include <cstring>

#pragma push_macro("DrawText")
#undef DrawText

namespace {

Tavo_GrDPoint At(int x, int y)
{
    return Tavo_GrDPoint{x, y};
}

// A font described as the surface describes its own, selected into a DC for
// measuring while it lives.
class MeasuringFont {
public:
    MeasuringFont(HDC dc, int pixelHeight) : m_dc(dc)
    {
        LOGFONTA description = {};
        description.lfHeight = pixelHeight;
        description.lfWeight = FW_MEDIUM;
        description.lfCharSet = ANSI_CHARSET;
        description.lfOutPrecision = OUT_CHARACTER_PRECIS;
        description.lfPitchAndFamily = FF_SWISS | DEFAULT_PITCH;
        std::strcpy(description.lfFaceName, "HelvFace");
        m_font = CreateFontIndirectA(&description);
        m_old = SelectObject(dc, m_font);
    }
    ~MeasuringFont()
    {
        SelectObject(m_dc, m_old);
        DeleteObject(m_font);
    }
    int Width(const char* text) const
    {
        SIZE size = {};
        GetTextExtentPoint32A(m_dc, text, static_cast<int>(std::strlen(text)), &size);
        return size.cx;
    }
    TEXTMETRICA Metrics() const
    {
        TEXTMETRICA metrics = {};
        GetTextMetricsA(m_dc, &metrics);
        return metrics;
    }

private:
    HDC m_dc;
    HFONT m_font;
    HGDIOBJ m_old;
};

} // namespace

class TextTest : public RecordedSurfaceTest {
protected:
    static constexpr int kFontPixels = 20;

    std::vector<std::string> DrawnTexts() const
    {
        std::vector<std::string> texts;
        for (const GdiCall& call : m_recorder->Of(GdiCall::TextOut))
            texts.push_back(call.text);
        return texts;
    }
};

// ---- Text at a point ------------------------------------------------------------

TEST_F(TextTest, PointTextSitsOnItsBaselineAndCounts)
{
    Tavo_GrAttr attr = Outline(kRed, kFontPixels);
    Tavo_GrDPoint p = At(20, 60);
    m_surface->DrawText("Hello", p, &attr);
    EndPass();

    const std::vector<GdiCall> texts = m_recorder->Of(GdiCall::TextOut);
    ASSERT_EQ(1u, texts.size());
    EXPECT_EQ("Hello", texts[0].text);
    MeasuringFont font(m_canvas.GetDC(), kFontPixels);
    EXPECT_EQ(20, texts[0].values[0]);
    EXPECT_EQ(kHeight - 60 - font.Metrics().tmDescent, texts[0].values[1]);
    EXPECT_EQ(1u, Stats().Get(Tavo_GrSurfaceStats::Texts));
    // Letters appear above the baseline, right of the point.
    EXPECT_GT(m_canvas.CountPixels(ColourOf(kRed), 20, kHeight - 60 - kFontPixels, 100, kHeight - 60 + 1), 20);
    EXPECT_EQ(0, m_canvas.CountPixels(ColourOf(kRed), 0, 0, 19, kHeight));
}

TEST_F(TextTest, MiddleAlignedTextIsDrawnHalfAFontLower)
{
    const char bottom = Tavo_GrAttr::AlignLeft | Tavo_GrAttr::AlignBottom;
    const char middle = Tavo_GrAttr::AlignLeft | Tavo_GrAttr::AlignMiddle;
    Tavo_GrAttr bottomAttr = Outline(kRed, 8, bottom);
    Tavo_GrAttr middleAttr = Outline(kRed, 8, middle);
    Tavo_GrDPoint p = At(20, 60);
    m_surface->DrawText("a", p, &bottomAttr);
    m_surface->DrawText("a", p, &middleAttr);
    EndPass();
    const std::vector<GdiCall> texts = m_recorder->Of(GdiCall::TextOut);
    ASSERT_EQ(2u, texts.size());
    EXPECT_EQ(4, texts[1].values[1] - texts[0].values[1]);
}

TEST_F(TextTest, TextTooSmallToReadBecomesALineOfItsWidth)
{
    Tavo_GrAttr attr = Outline(kRed, 2); // 2 pixels at scale 1
    Tavo_GrDPoint p = At(30, 50);
    m_surface->DrawText("abcde", p, &attr);
    EndPass();
    EXPECT_TRUE(DrawnTexts().empty());
    EXPECT_EQ(10, CountColour(kRed)) << "5 characters x 2 pixels";
    EXPECT_EQ(10, m_canvas.CountPixels(ColourOf(kRed), 30, kHeight - 50, 40, kHeight - 49));
    EXPECT_EQ(0u, Stats().Get(Tavo_GrSurfaceStats::Texts));
}

TEST_F(TextTest, PlaceholderFollowsTheHorizontalAlignment)
{
    const char right = Tavo_GrAttr::AlignRight | Tavo_GrAttr::AlignBottom;
    const char centre = Tavo_GrAttr::AlignCentre | Tavo_GrAttr::AlignBottom;
    Tavo_GrAttr rightAttr = Outline(kRed, 2, right);
    Tavo_GrAttr centreAttr = Outline(kBlue, 2, centre);
    Tavo_GrDPoint p = At(100, 50);
    Tavo_GrDPoint q = At(100, 80);
    m_surface->DrawText("abcde", p, &rightAttr);
    m_surface->DrawText("abcde", q, &centreAttr);
    EndPass();
    EXPECT_EQ(10, m_canvas.CountPixels(ColourOf(kRed), 90, kHeight - 50, 100, kHeight - 49));
    EXPECT_EQ(10, m_canvas.CountPixels(ColourOf(kBlue), 95, kHeight - 80, 105, kHeight - 79));
}

namespace {

// Rows of the canvas that hold at least one pixel of the colour.
int RowsWith(const DibCanvas& canvas, COLORREF colour)
{
    int rows = 0;
    for (int y = 0; y < canvas.GetHeight(); ++y)
        if (canvas.CountPixels(colour, 0, y, canvas.GetWidth(), y + 1) > 0)
            ++rows;
    return rows;
}

} // namespace

TEST_F(SurfaceTest, TextBelowTheMinimumFontIsDrawnAtTheMinimumHeight)
{
    // "HH": capital letters without descenders, 5 pixels asked for.
    Tavo_GrAttr attr = Outline(kRed, 5);
    Tavo_GrDPoint p = At(20, 60);
    {
        ScopedEnvironment minFont("BRY_VWR_MINFONT", "3");
        CreateSurface();
    }
    m_surface->DrawText("HH", p, &attr);
    EndPass();
    const int rowsAtFive = RowsWith(m_canvas, ColourOf(kRed));

    m_canvas.Fill(RGB(255, 255, 255));
    {
        ScopedEnvironment minFont("BRY_VWR_MINFONT", "16");
        CreateSurface();
    }
    m_surface->DrawText("HH", p, &attr);
    EndPass();
    const int rowsAtSixteen = RowsWith(m_canvas, ColourOf(kRed));

    EXPECT_GT(rowsAtFive, 0);
    EXPECT_GT(rowsAtSixteen, rowsAtFive + 4) << "the letters grew to the minimum font";
}

// ---- Text in a box ----------------------------------------------------------------

class BoxTextTest : public TextTest {
protected:
    void SetUp() override
    {
        TextTest::SetUp();
        MeasuringFont font(m_canvas.GetDC(), kFontPixels);
        m_lineHeight = font.Metrics().tmHeight;
        // Wide enough for three M but not four.
        m_boxWidth = (font.Width("MMM") + font.Width("MMMM")) / 2;
    }

    Tavo_GrDRect Box(int lines) const
    {
        const int top = kHeight - 10;
        return Tavo_GrDRect{10, top - lines * m_lineHeight, 10 + m_boxWidth, top};
    }

    int m_lineHeight = 0;
    int m_boxWidth = 0;
    Tavo_GrAttr m_attr = Outline(kRed, kFontPixels);
};

TEST_F(BoxTextTest, TextWrapsAtAnyCharacterIntoTheBoxWidth)
{
    Tavo_GrDRect box = Box(3);
    m_surface->DrawText("MMMMMMMM", box, &m_attr, kFontPixels);
    EndPass();
    EXPECT_EQ((std::vector<std::string>{"MMM", "MMM", "MM"}), DrawnTexts());
    const std::vector<GdiCall> texts = m_recorder->Of(GdiCall::TextOut);
    const int firstBottom = kHeight - box.ymax + m_lineHeight;
    for (int line = 0; line < 3; ++line) {
        EXPECT_EQ(10, texts[line].values[0]);
        EXPECT_EQ(firstBottom + line * m_lineHeight, texts[line].values[1]);
    }
    EXPECT_EQ(1u, Stats().Get(Tavo_GrSurfaceStats::Texts));
}

TEST_F(BoxTextTest, TextBelowTheBoxIsCutAndMarked)
{
    Tavo_GrDRect box = Box(3);
    box.ymin += 1; // the third line no longer fits
    m_surface->DrawText("MMMMMMMM", box, &m_attr, kFontPixels);
    EndPass();
    EXPECT_EQ((std::vector<std::string>{"MMM", "MMM", "..."}), DrawnTexts());
}

TEST_F(BoxTextTest, CharacterWiderThanTheBoxIsStillDrawnOnePerLine)
{
    Tavo_GrDRect box = Box(4);
    box.xmax = box.xmin + 2;
    m_surface->DrawText("MMM", box, &m_attr, kFontPixels);
    EndPass();
    EXPECT_EQ((std::vector<std::string>{"M", "M", "M"}), DrawnTexts());
}

TEST_F(BoxTextTest, BoxWithRightEdgeLeftOfItsLeftEdgeTakesAnyText)
{
    Tavo_GrDRect box = Box(3);
    box.xmax = box.xmin - 1;
    m_surface->DrawText("MMMMMMMM", box, &m_attr, kFontPixels);
    EndPass();
    EXPECT_EQ((std::vector<std::string>{"MMMMMMMM"}), DrawnTexts());
}

TEST_F(BoxTextTest, EmptyTextDrawsNothingButCounts)
{
    Tavo_GrDRect box = Box(3);
    m_surface->DrawText("", box, &m_attr, kFontPixels);
    m_surface->DrawText(nullptr, box, &m_attr, kFontPixels);
    EndPass();
    EXPECT_TRUE(DrawnTexts().empty());
    EXPECT_EQ(2u, Stats().Get(Tavo_GrSurfaceStats::Texts));
}

TEST_F(BoxTextTest, TinyBoxTextIsAPlaceholderLimitedToTheBox)
{
    Tavo_GrAttr tiny = Outline(kRed, 2);
    Tavo_GrDRect box{20, 40, 35, 60};
    m_surface->DrawText("abcdefghij", box, &tiny, 2); // 20 pixels wide, box 15
    EndPass();
    EXPECT_TRUE(DrawnTexts().empty());
    EXPECT_EQ(15, CountColour(kRed)) << "from xmin to xmax, the last point left out";
    EXPECT_EQ(15, m_canvas.CountPixels(ColourOf(kRed), 20, kHeight - 60, 35, kHeight - 59));
}

TEST_F(BoxTextTest, BoxTextDrawsLettersInsideTheBox)
{
    Tavo_GrDRect box = Box(3);
    m_surface->DrawText("MMMMMMMM", box, &m_attr, kFontPixels);
    EndPass();
    const int inside = m_canvas.CountPixels(ColourOf(kRed), box.xmin, kHeight - box.ymax,
                                            box.xmax + 1, kHeight - box.ymin + 1);
    EXPECT_GT(inside, 50);
    EXPECT_EQ(inside, CountColour(kRed)) << "nothing outside the box";
}

#pragma pop_macro("DrawText")
