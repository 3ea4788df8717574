// Tavo_WiWin32Surface batching: the exact GDI calls that batches become, the
// fixed flush order, full batches and the shared point-count arrays.
#include "SurfaceFixture.h"

#include <climits>
#include <string>

using Points = std::vector<POINT>;
using Box = std::array<int, 4>;

class BatchingTest : public SurfaceTest {
protected:
    static constexpr int H = kHeight;

    // Applies the attribute and forgets the calls that caused.
    void Prepare(Tavo_GrAttr attr)
    {
        m_attr = attr;
        m_surface->SetCurrentAttr(&m_attr);
        m_recorder.Clear();
    }

    // The drawing and selection calls, in order.
    std::vector<GdiCall> DrawingCalls() const
    {
        std::vector<GdiCall> calls = m_recorder.GetCalls();
        calls.erase(std::remove_if(calls.begin(), calls.end(),
                                   [](const GdiCall& call) { return call.kind > GdiCall::SelectObject; }),
                    calls.end());
        return calls;
    }

    // The initial of each call's kind, with the polylines of each PolyPolyline.
    static std::string Kinds(const std::vector<GdiCall>& calls)
    {
        std::string kinds;
        for (const GdiCall& call : calls)
            kinds += std::string(1, "PGRETS"[call.kind]) + std::to_string(call.countValues.size()) + " ";
        return kinds;
    }

    Tavo_GrAttr m_attr;
    Tavo_GrDPoint m_dot{5, 150}, m_lineEnd{50, 140}, m_centre{60, 60};
    Tavo_GrDPoint m_tiny[3] = {{10, 10}, {12, 12}, {8, 12}};
    Tavo_GrDPoint m_big[3] = {{10, 10}, {40, 10}, {20, 40}};
    Tavo_GrDRect m_rect{10, 20, 30, 40};
};

TEST_F(BatchingTest, OutlineKindsAndEmptyBatchesAreEmittedInTheFixedOrderWithTheSharedCountArrays)
{
    Prepare(Outline(kRed));
    // Issued in the reverse of the flush order.
    m_surface->DrawCircle(m_centre, 10, &m_attr);
    m_surface->DrawCircle(m_centre, 20, &m_attr);
    m_surface->DrawRect(m_rect, &m_attr);
    m_surface->DrawTriangle(m_big, &m_attr);
    m_surface->DrawTriangle(m_tiny, &m_attr);
    m_surface->DrawLine(m_dot, m_lineEnd, &m_attr);
    m_surface->DrawDot(m_dot, &m_attr);
    m_surface->Flush();

    const std::vector<GdiCall> calls = DrawingCalls();
    ASSERT_EQ("P1 P1 P1 P1 P1 S0 E0 E0 S0 ", Kinds(calls));
    const Points expected[5] = {
        {{5, H - 150}, {6, H - 150}}, // a dot is (x, y) to (x + 1, y)
        {{5, H - 150}, {50, H - 140}},
        {{10, H - 10}, {12, H - 12}, {8, H - 12}}, // a uniangle stays open
        {{10, H - 10}, {40, H - 10}, {20, H - 40}, {10, H - 10}},
        {{10, H - 40}, {31, H - 40}, {31, H - 20 + 1}, {10, H - 20 + 1}, {10, H - 40}},
    };
    for (int i = 0; i < 5; ++i) {
        EXPECT_EQ(std::vector<DWORD>{DWORD(expected[i].size())}, calls[i].countValues) << i;
        EXPECT_EQ(expected[i], calls[i].points) << i;
    }
    EXPECT_EQ(calls[0].counts, calls[1].counts) << "dots and lines share the array of 2";
    // Hollow circles: drawn with the null brush, then the displaced brush goes back.
    EXPECT_EQ(GetStockObject(NULL_BRUSH), calls[5].object);
    EXPECT_EQ((Box{50, H - 70, 70, H - 50}), calls[6].box);
    EXPECT_EQ(calls[5].displaced, calls[8].object);

    // Another surface flushing empty batches: five empty PolyPolylines on the
    // same count arrays, then the null brush round trip.
    CreateSurface();
    Prepare(Outline(kRed));
    m_surface->Flush();
    const std::vector<GdiCall>& empty = m_recorder.GetCalls();
    ASSERT_EQ("P0 P0 P0 P0 P0 S0 S0 ", Kinds(empty));
    for (int i = 0; i < 5; ++i)
        EXPECT_EQ(calls[i].counts, empty[i].counts) << i;
    EXPECT_EQ(GetStockObject(NULL_BRUSH), empty[5].object);
    EXPECT_EQ(empty[5].displaced, empty[6].object) << "the displaced brush goes back";
}

TEST_F(BatchingTest, FilledKindsAreEmittedInTheFixedOrder)
{
    Prepare(Filled(kRed));
    m_surface->DrawCircle(m_centre, 10, &m_attr);
    m_surface->DrawRect(m_rect, &m_attr);
    m_surface->DrawTriangle(m_big, &m_attr);
    m_surface->DrawCircle(m_centre, 2, &m_attr); // too small for an ellipse: an outlined triangle
    m_surface->DrawLine(m_dot, m_lineEnd, &m_attr);
    m_surface->DrawDot(m_dot, &m_attr);
    m_surface->Flush();

    const std::vector<GdiCall> calls = DrawingCalls();
    ASSERT_EQ("P1 P1 P0 P1 G0 P0 R0 S0 S0 E0 ", Kinds(calls))
        << "dots, lines, uniangles, hollow and filled triangles, hollow and filled rectangles, hollow and filled "
           "circles";
    EXPECT_EQ((Points{{58, H - 58}, {62, H - 58}, {60, H - 62}, {58, H - 58}}), calls[3].points);
    EXPECT_EQ((Points{{10, H - 10}, {40, H - 10}, {20, H - 40}, {10, H - 10}}), calls[4].points)
        << "one closed Polygon of 4 points per filled triangle";
    EXPECT_EQ((Box{10, H - 40, 31, H - 20 + 1}), calls[6].box);
}

TEST_F(BatchingTest, FullBatchIsEmittedInsideTheAddAndLeftEmpty)
{
    const int lines = Tavo_WiWin32Surface::kLineCapacity, triangles = Tavo_WiWin32Surface::kFilledTriangleCapacity;
    Prepare(Outline(kRed));
    for (int i = 1; i < lines; ++i)
        m_surface->DrawLine(m_dot, m_lineEnd, &m_attr);
    EXPECT_TRUE(Polylines().empty());
    m_surface->DrawLine(m_dot, m_lineEnd, &m_attr);
    const std::vector<GdiCall> emitted = m_recorder.Of(GdiCall::PolyPolyline);
    ASSERT_EQ(1u, emitted.size());
    EXPECT_EQ(size_t(lines), emitted[0].countValues.size());

    Prepare(Filled(kRed)); // flushes the batches, then forgets those calls
    for (int i = 1; i < triangles; ++i)
        m_surface->DrawTriangle(m_big, &m_attr);
    EXPECT_EQ(0, m_recorder.CountOf(GdiCall::Polygon));
    m_surface->DrawTriangle(m_big, &m_attr);
    EXPECT_EQ(triangles, m_recorder.CountOf(GdiCall::Polygon));

    m_recorder.Clear();
    m_surface->Flush();
    EXPECT_TRUE(Polylines().empty());
    EXPECT_EQ(0, m_recorder.CountOf(GdiCall::Polygon));
}

TEST_F(BatchingTest, FilledRectanglesAndCirclesKeepThirtyTwoBitCoordinates)
{
    Prepare(Filled(kRed));
    Tavo_GrDRect rect{-70000, -5, 39999, 100000};
    m_surface->DrawRect(rect, &m_attr);
    Tavo_GrDRect extreme{INT_MIN, INT_MIN, INT_MAX, INT_MAX};
    m_surface->DrawRect(extreme, &m_attr);
    m_surface->Flush();
    const std::vector<GdiCall> rects = m_recorder.Of(GdiCall::Rectangle);
    ASSERT_EQ(2u, rects.size());
    EXPECT_EQ((Box{-70000, H - 100000, 40000, H + 5 + 1}), rects[0].box) << "40000, not -25536";
    EXPECT_EQ((Box{INT_MIN, H - INT_MAX, INT_MAX, INT_MAX}), rects[1].box) << "saturated";
    EXPECT_EQ(kWidth * kHeight, RedPixels()) << "the rectangles cover the whole canvas";

    m_canvas.Fill(RGB(255, 255, 255));
    Tavo_GrDPoint centre{40000, 50};
    m_surface->DrawCircle(centre, 39950, &m_attr);
    m_surface->Flush();
    const std::vector<GdiCall> ellipses = m_recorder.Of(GdiCall::Ellipse);
    ASSERT_EQ(1u, ellipses.size());
    EXPECT_EQ((Box{50, H - 39950 - 50, 79950, H + 39950 - 50}), ellipses[0].box);
    EXPECT_TRUE(IsRed(60, kHeight - 50)) << "the left edge reaches into the canvas";
    EXPECT_FALSE(IsRed(10, kHeight - 50));
}
