// Tavo_WiWin32Surface drawing operations, checked on the pixels of a 32-bit
// DIB section (and on the recorded calls where pixels cannot tell).
#include "SurfaceFixture.h"

class DrawingTest : public SurfaceTest {
protected:
    Tavo_GrAttr m_red = Outline(kRed);
    Tavo_GrAttr m_redFilled = Filled(kRed);
};

TEST_F(DrawingTest, DotIsExactlyOnePixelAtTheFlippedPosition)
{
    Tavo_GrDPoint p{17, 30};
    m_surface->DrawDot(p, &m_red);
    EndPass();
    EXPECT_EQ(1, RedPixels());
    EXPECT_TRUE(IsRed(17, kHeight - 30));
}

TEST_F(DrawingTest, RectangleEdgesAreInclusiveAndAOnePointRectangleCoversOnePixel)
{
    Tavo_GrDRect filled{10, 20, 29, 34}, column{40, 40, 40, 41}, row{60, 40, 61, 40}, point{80, 40, 80, 40};
    m_surface->DrawRect(filled, &m_redFilled);
    m_surface->DrawRect(column, &m_redFilled);
    m_surface->DrawRect(row, &m_redFilled);
    m_surface->DrawRect(point, &m_redFilled);
    EndPass();
    // Wine's DIB engine draws nothing for a Rectangle one pixel wide and one
    // high (Windows draws the pixel), so that one is checked on the call.
    const std::vector<GdiCall> rects = m_recorder.Of(GdiCall::Rectangle);
    ASSERT_EQ(4u, rects.size());
    EXPECT_EQ((std::array<int, 4>{80, kHeight - 40, 81, kHeight - 40 + 1}), rects[3].box);
    EXPECT_EQ(20 * 15, RedPixelsIn(10, kHeight - 34, 30, kHeight - 19));
    EXPECT_EQ(2, RedPixelsIn(40, kHeight - 41, 41, kHeight - 39));
    EXPECT_EQ(2, RedPixelsIn(60, kHeight - 40, 62, kHeight - 39));
    EXPECT_EQ(20 * 15 + 2 + 2, RedPixelsIn(0, 0, 70, kHeight)) << "nothing else left of the one-pixel rectangle";

    CreateSurface();
    m_surface->DrawRect(filled, &m_red);
    EndPass();
    EXPECT_EQ(2 * 21 + 2 * 14, RedPixels()) << "outline through (l, t) .. (r + 1, b + 1)";
    EXPECT_FALSE(IsRed(20, kHeight - 27)) << "inside stays empty";
}

TEST_F(DrawingTest, VerticalLinesBeyondTheSurfaceAreClampedSlantedOnesAreNot)
{
    Tavo_GrDPoint a{30, -100}, b{30, kHeight + 50}, c{31, kHeight + 50};
    m_surface->DrawLine(a, b, &m_red);
    m_surface->DrawLine(a, c, &m_red);
    EndPass();
    const std::vector<GdiCall> lines = Polylines();
    ASSERT_EQ(1u, lines.size());
    EXPECT_EQ((std::vector<POINT>{{30, kHeight}, {30, -1}, {30, kHeight + 100}, {31, -50}}), lines[0].points);
    EXPECT_EQ(kHeight, RedPixelsIn(30, 0, 31, kHeight)) << "the clamped line still covers the column";
}

TEST_F(DrawingTest, ThickeningWidensVerticalLinesToTheRightOnly)
{
    const struct {
        const char* environment; // BRY_VWR_THICKENVERTICALLINE
        int thicken;             // given to SetThickenVertLine, 0: not called
        bool gateClosed;         // a thickening gate of 0
        int columns;
    } cases[] = {{nullptr, 2, false, 3}, {"2", 0, false, 3}, {nullptr, 2, true, 1}};
    for (const auto& c : cases) {
        SCOPED_TRACE(testing::Message() << "case " << &c - cases);
        CreateSurface("BRY_VWR_THICKENVERTICALLINE", c.environment);
        if (c.thicken)
            m_surface->SetThickenVertLine(c.thicken);
        if (c.gateClosed)
            m_surface->SetThickenGate(0.0);
        Tavo_GrDPoint a{10, 20}, b{10, 60}, d{50, 80}, e{90, 80};
        m_surface->DrawLine(a, b, &m_red);
        m_surface->DrawLine(d, e, &m_red);
        EndPass();
        for (int x = 9; x <= 13; ++x)
            EXPECT_EQ(x >= 10 && x < 10 + c.columns ? 40 : 0, RedPixelsIn(x, 0, x + 1, kHeight)) << "column " << x;
        EXPECT_EQ(40, RedPixelsIn(0, kHeight - 80, kWidth, kHeight - 79)) << "the horizontal line stays one row";
    }
}

TEST_F(DrawingTest, BadInputDrawsNothing)
{
    Tavo_GrDPoint points[1] = {{10, 20}};
    m_surface->DrawPline(1, points, &m_red);
    m_surface->DrawPline(-3, points, &m_red);
    m_surface->DrawPline(3, nullptr, &m_red);
    Tavo_GrDRect box{10, 10, 100, 100};
    Tavo_GrAttr text = Outline(kRed, 20);
    m_surface->DrawText(nullptr, box, &text, 20);
    m_surface->DrawText("", box, &text, 20);
    EndPass();
    EXPECT_EQ(0, RedPixels());
}
