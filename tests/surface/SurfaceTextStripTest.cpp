// Repainting a strip, as a window does after it scrolled: text the surface
// draws beyond its nominal bounds (raised to the minimum font, lifted by the
// font's descent, wrapped or cut out of its box) is drawn by the strip it
// reaches into, so two complementary strips give the picture of one full pass.
#include "SurfaceFixture.h"

#include "Tavo_GrDrawing.h"
#include "Tavo_GrDrawingBuilder.h"
#include "Tavo_GrMapping.h"

#include <cstdint>
#include <vector>

namespace {

constexpr int kWidth = 320;
constexpr int kHeight = 200;
constexpr int kBoundary = 150; // the first column (or, for a horizontal cut, core row) of the second strip
constexpr int kMargin = Tavo_GrDrawing::kClipMarginPixels;

// A device rectangle (core coordinates, y up, corners included) and the same
// pixels as a GDI clip rectangle (y down, right and bottom excluded).
struct Strip {
    Tavo_GrDRect device;
    RECT gdi;
};

Strip StripOf(int xmin, int ymin, int xmax, int ymax)
{
    return {{xmin, ymin, xmax, ymax}, {xmin, kHeight - ymax, xmax + 1, kHeight - ymin + 1}};
}

// The two strips either side of the boundary: columns for a vertical cut,
// rows for a horizontal one.
void Strips(bool vertical, Strip& before, Strip& after)
{
    before = vertical ? StripOf(0, 0, kBoundary - 1, kHeight) : StripOf(0, 0, kWidth, kBoundary - 1);
    after = vertical ? StripOf(kBoundary, 0, kWidth, kHeight) : StripOf(0, kBoundary, kWidth, kHeight);
}

// Where a pass over the strip looks for items, at one pixel per unit.
Tavo_GrWRect SearchedArea(const Strip& strip)
{
    return {strip.device.xmin - kMargin, strip.device.ymin - kMargin, strip.device.xmax + kMargin,
            strip.device.ymax + kMargin};
}

class TextStripTest : public ::testing::Test {
protected:
    void SetUp() override { ASSERT_TRUE(m_canvas.IsValid()); }

    // One pass of the drawing at one pixel per unit (device = world), limited
    // by a GDI clip rectangle as a window's paint DC is, when one is given.
    void Draw(const Tavo_GrDrawing& drawing, const Tavo_GrDRect* clip, const RECT* gdiClip)
    {
        Tavo_GrMapping mapping(&drawing, 5);
        mapping.SetDeviceWindowSize(kWidth, kHeight, true, nullptr);
        mapping.SetWorldClipBox({0, 0, kWidth, kHeight});
        if (gdiClip)
            IntersectClipRect(m_canvas.GetDC(), gdiClip->left, gdiClip->top, gdiClip->right, gdiClip->bottom);
        m_surface.SetDC(m_canvas.GetDC());
        drawing.Draw(m_surface, mapping, clip);
        SelectClipRgn(m_canvas.GetDC(), nullptr);
    }

    std::vector<std::uint32_t> Pixels() const { return {m_canvas.GetBits(), m_canvas.GetBits() + kWidth * kHeight}; }

    // Pixels that are not white: text is drawn with smoothed edges.
    int InkIn(const RECT& r) const
    {
        const RECT canvas = {0, 0, kWidth, kHeight};
        RECT inside = {};
        IntersectRect(&inside, &r, &canvas);
        const int area = (inside.right - inside.left) * (inside.bottom - inside.top);
        return area - m_canvas.CountPixels(RGB(255, 255, 255), inside.left, inside.top, inside.right, inside.bottom);
    }

    DibCanvas m_canvas{kWidth, kHeight};
    Tavo_WiWin32Surface m_surface; // minimum font 8 pixels
};

// The nominal bounds of the item alone.
Tavo_GrWRect ItemBounds(void (*add)(Tavo_GrDrawingBuilder& build))
{
    Tavo_GrDrawing drawing;
    Tavo_GrDrawingBuilder build(drawing);
    add(build);
    return drawing.GetBounds();
}

int Differing(const std::vector<std::uint32_t>& a, const std::vector<std::uint32_t>& b)
{
    int count = 0;
    for (size_t i = 0; i < a.size() && i < b.size(); ++i)
        count += a[i] != b[i];
    return count;
}

TEST_F(TextStripTest, TwoComplementaryStripsDrawWhatOneFullPassDraws)
{
    const char kTopLeft = Tavo_GrAttr::AlignLeft | Tavo_GrAttr::AlignTop;
    const struct {
        const char* name;
        bool vertical;
        void (*add)(Tavo_GrDrawingBuilder& build);
    } cases[] = {
        // 5 units are 5 pixels: drawn at the 8-pixel minimum font, the line
        // is longer than its nominal 100 pixels, which end just outside the
        // other strip's margin.
        {"text raised to the minimum font", true,
         [](Tavo_GrDrawingBuilder& b) {
             b.SetAttr(Outline(kRed, 5));
             b.AddText(kBoundary - kMargin - 2 - 100, 100, "MMMMMMMMMMMMMMMMMMMM");
         }},
        // Bottom-aligned text stands a descent above its baseline: the accents
        // of a 60-pixel line pass its nominal top, just outside the margin.
        {"tall accented text", false,
         [](Tavo_GrDrawingBuilder& b) {
             b.SetAttr(Outline(kRed, 60));
             b.AddText(20, kBoundary - kMargin - 2 - 60, "\xC9\xC9\xC9\xC9");
         }},
        // Right-aligned lines of a box lie left of the box.
        {"right-aligned box", true,
         [](Tavo_GrDrawingBuilder& b) {
             b.SetAttr(Outline(kRed, 10, Tavo_GrAttr::AlignRight | Tavo_GrAttr::AlignBottom));
             b.AddTextBox({kBoundary + kMargin + 6, 60, kBoundary + 100, 120}, "MMM");
         }},
        // Top-aligned lines of a box start a line down; the last and the
        // "..." hang below it.
        {"cut box", false,
         [](Tavo_GrDrawingBuilder& b) {
             b.SetAttr(Outline(kRed, 10, kTopLeft));
             b.AddTextBox({20, kBoundary + kMargin + 6, 50, kBoundary + 40}, "MMMMMMMMMMMMMMMMMMMMMMMM");
         }},
    };
    for (const auto& c : cases) {
        SCOPED_TRACE(c.name);
        Tavo_GrDrawing drawing;
        Tavo_GrDrawingBuilder build(drawing);
        // Corners that make the whole canvas the drawing's extent, so that
        // the mapping shows it at one pixel per unit.
        build.AddDot(0, 0);
        build.AddDot(kWidth, kHeight);
        c.add(build);
        Strip before;
        Strip after;
        Strips(c.vertical, before, after);
        // The strip the item's nominal bounds lie in, and the other one.
        const Tavo_GrWRect bounds = ItemBounds(c.add);
        const bool inBefore = Tavo_GrIntersects(bounds, SearchedArea(before));
        const Strip& home = inBefore ? before : after;
        const Strip& other = inBefore ? after : before;

        m_canvas.Fill(RGB(255, 255, 255));
        Draw(drawing, nullptr, nullptr);
        const std::vector<std::uint32_t> full = Pixels();
        // The case is as described: by its nominal bounds the item is out
        // of the other strip's reach, yet it draws there.
        EXPECT_FALSE(Tavo_GrIntersects(bounds, SearchedArea(other)));
        EXPECT_GT(InkIn(other.gdi), 0);
        EXPECT_GT(InkIn(home.gdi), 0);

        m_canvas.Fill(RGB(255, 255, 255));
        Draw(drawing, &home.device, &home.gdi);
        Draw(drawing, &other.device, &other.gdi);
        EXPECT_EQ(Differing(Pixels(), full), 0) << "pixels where the strips differ from the full pass";
    }
}

TEST(TextStripSurface, TheSmallestTextHeightTheCoreCullsByIsTheMinimumFont)
{
    const struct {
        const char* value; // of BRY_VWR_MINFONT, null: unset
        int pixels;
    } cases[] = {{nullptr, 8}, {"2", 3}, {"12", 12}};
    for (const auto& c : cases) {
        SCOPED_TRACE(c.value ? c.value : "unset");
        SetEnvironmentVariableA("BRY_VWR_MINFONT", c.value);
        const Tavo_WiWin32Surface surface;
        SetEnvironmentVariableA("BRY_VWR_MINFONT", nullptr);
        EXPECT_EQ(surface.GetMinTextPixels(), c.pixels);
    }
}

} // namespace
