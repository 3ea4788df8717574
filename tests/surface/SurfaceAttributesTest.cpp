// Tavo_WiWin32Surface attributes: the pen, brush, font and text settings an
// attribute becomes, and which of them a change of attribute rebuilds.
#include "SurfaceFixture.h"

#include <climits>
#include <type_traits>

static_assert(!std::is_copy_constructible_v<Tavo_WiWin32Surface>, "a surface owns GDI objects");
static_assert(!std::is_copy_assignable_v<Tavo_WiWin32Surface>, "a surface owns GDI objects");

namespace {

unsigned AttrChanges(const Tavo_WiWin32Surface& surface)
{
    Tavo_GrSurfaceStats stats;
    surface.FetchStats(stats);
    return stats.Get(Tavo_GrSurfaceStats::AttrChanges);
}

} // namespace

TEST_F(SurfaceTest, FirstAttributeFlushesAndBuildsPenBrushAndTextColourInItsColour)
{
    const struct {
        Tavo_GrAttr attr;
        bool blackAndWhite;
        COLORREF colour;
        UINT brushStyle;
    } cases[] = {
        {Filled(kBlue), false, RGB(0, 0, 255), BS_SOLID},
        {Outline(kRed), false, RGB(255, 0, 0), BS_HOLLOW},
        {Outline(kRed), true, RGB(76, 76, 76), BS_HOLLOW}, // black and white: grey
    };
    for (auto c : cases) {
        SCOPED_TRACE(testing::Message() << "colour " << int(c.attr.GetColor()) << " b/w " << c.blackAndWhite);
        CreateSurface();
        m_surface->SetBlackAndWhiteFlag(c.blackAndWhite);
        m_surface->SetCurrentAttr(&c.attr);

        EXPECT_EQ(1u, AttrChanges(*m_surface)) << "the first attribute counts as a change";
        const std::vector<GdiCall>& calls = m_recorder.GetCalls();
        ASSERT_GE(calls.size(), 5u);
        for (int i = 0; i < 5; ++i)
            EXPECT_TRUE(calls[i].kind == GdiCall::PolyPolyline && calls[i].countValues.empty()) << "flush first, " << i;
        for (const GdiCall::Kind kind : {GdiCall::CreatePen, GdiCall::CreateBrush, GdiCall::SetTextColor}) {
            const std::vector<GdiCall> made = m_recorder.Of(kind);
            ASSERT_EQ(1u, made.size()) << kind;
            EXPECT_EQ(c.colour, made[0].colour) << kind;
        }
        EXPECT_EQ(c.brushStyle, m_recorder.Of(GdiCall::CreateBrush)[0].value);
    }
}

TEST_F(SurfaceTest, AttributeChangeRebuildsOnlyWhatChangedAndFlushesOnlyOnColourOrFill)
{
    // What the second of two lines made: pens, brushes, fonts, objects deleted,
    // alignments and text colours set, lines emitted before anything new was
    // made, lines emitted in all.
    const struct {
        const char* change;
        Tavo_GrAttr next;
        std::vector<int> calls;
        unsigned changes;
    } cases[] = {
        {"colour", Outline(kBlue, 10), {1, 1, 0, 2, 0, 1, 1, 1}, 2},
        {"fill", Filled(kRed, 10), {0, 1, 0, 1, 0, 1, 1, 1}, 2},
        {"height", Outline(kRed, 20), {0, 0, 1, 1, 0, 1, 0, 0}, 1},
        {"alignment", Outline(kRed, 10, Tavo_GrAttr::AlignCentre | Tavo_GrAttr::AlignTop), {0, 0, 0, 0, 1, 1, 0, 0}, 1},
    };
    Tavo_GrDPoint a{5, 5}, b{50, 5};
    for (auto c : cases) {
        SCOPED_TRACE(c.change);
        CreateSurface();
        Tavo_GrAttr first = Outline(kRed, 10);
        m_surface->DrawLine(a, b, &first);
        m_recorder.Clear();
        m_surface->DrawLine(a, b, &c.next);

        std::vector<int> calls(8); // CreatePen .. SetTextColor are the last six kinds
        for (const GdiCall& call : m_recorder.GetCalls()) {
            if (call.kind >= GdiCall::CreatePen)
                ++calls[call.kind - GdiCall::CreatePen];
            const bool line = call.kind == GdiCall::PolyPolyline && !call.countValues.empty();
            calls[6] += line && calls[0] + calls[1] + calls[2] == 0;
            calls[7] += line;
        }
        EXPECT_EQ(c.calls, calls);
        EXPECT_EQ(c.changes, AttrChanges(*m_surface));
    }
}

TEST_F(SurfaceTest, FontHeightIsScaledRoundedAndKeptAtTheMinimum)
{
    const struct {
        const char* minFont; // BRY_VWR_MINFONT, null: unset
        double scale;
        int charHeight;
        std::vector<int> fonts; // the heights of the fonts made; none: the text becomes a placeholder
    } cases[] = {
        {nullptr, 1.0, 5, {8}},
        {"12", 1.0, 5, {12}},
        {"2", 1.0, 3, {3}},
        {"2", 1.0, 2, {}},
        {nullptr, 0.5, 21, {11}},
        {nullptr, 1.0, -40, {}},
        {nullptr, 1.0e12, 1000, {}}, // taller than twice the device: a placeholder
    };
    for (const auto& c : cases) {
        SCOPED_TRACE(testing::Message() << "minimum " << (c.minFont ? c.minFont : "unset") << ", " << c.charHeight);
        CreateSurface("BRY_VWR_MINFONT", c.minFont, c.scale);
        Tavo_GrAttr attr = Outline(kBlack, c.charHeight);
        Tavo_GrDPoint p{10, 40};
        m_surface->DrawText("x", p, &attr);
        std::vector<int> fonts;
        for (const GdiCall& font : m_recorder.Of(GdiCall::CreateFont))
            fonts.push_back(static_cast<int>(font.value));
        EXPECT_EQ(c.fonts, fonts);
        EXPECT_TRUE(!c.fonts.empty() || m_recorder.CountOf(GdiCall::TextOut) == 0) << "no font, no text";
        EndPass();
    }
}
