// Tavo_WiWin32Surface batching: the exact GDI calls that batches become, the
// fixed flush order, full batches and the shared point-count arrays.
#include "SurfaceFixture.h"

#include <algorithm>
#include <ostream>

#pragma push_macro("DrawText")
#undef DrawText

namespace {

Tavo_GrDPoint At(int x, int y)
{
    return Tavo_GrDPoint{x, y};
}

std::vector<POINT> Points(std::initializer_list<POINT> points)
{
    return std::vector<POINT>(points);
}

} // namespace

// POINT is a global type: its comparison and printing must be found there.
inline bool operator==(const POINT& a, const POINT& b)
{
    return a.x == b.x && a.y == b.y;
}

inline void PrintTo(const POINT& point, std::ostream* out)
{
    *out << "(" << point.x << ", " << point.y << ")";
}

class BatchingTest : public RecordedSurfaceTest {
protected:
    // Applies the attribute once and forgets the calls that caused, so that a
    // test sees only the calls of its own primitives.
    void Prepare(Tavo_GrAttr attr)
    {
        m_attr = attr;
        m_surface->SetCurrentAttr(&m_attr);
        m_recorder->Clear();
    }

    std::vector<GdiCall> NonEmptyPolyPolylines() const
    {
        std::vector<GdiCall> calls;
        for (const GdiCall& call : m_recorder->Of(GdiCall::PolyPolyline))
            if (call.count > 0)
                calls.push_back(call);
        return calls;
    }

    Tavo_GrAttr m_attr;
};

TEST_F(BatchingTest, FlushOfEmptyBatchesIssuesFiveEmptyPolyPolylinesAndTheNullBrushRoundTrip)
{
    Prepare(Outline(kRed));
    m_surface->Flush();

    const std::vector<GdiCall>& calls = m_recorder->GetCalls();
    ASSERT_EQ(7u, calls.size());
    for (int i : {0, 1, 2, 3, 4}) {
        EXPECT_EQ(GdiCall::PolyPolyline, calls[i].kind) << i;
        EXPECT_EQ(0, calls[i].count) << i;
    }
    EXPECT_EQ(GdiCall::SelectObject, calls[5].kind);
    EXPECT_EQ(GetStockObject(NULL_BRUSH), calls[5].object);
    EXPECT_EQ(GdiCall::SelectObject, calls[6].kind);
    EXPECT_EQ(calls[5].displaced, calls[6].object) << "the displaced brush goes back";
}

TEST_F(BatchingTest, FlushPollsTheInterruptOncePerBatch)
{
    Prepare(Outline(kRed));
    const int before = m_recorder->GetEscapePollCount();
    m_surface->Flush();
    EXPECT_EQ(9, m_recorder->GetEscapePollCount() - before);
}

TEST_F(BatchingTest, PolylineKindsUseTheSharedCountArrays)
{
    Tavo_WiWin32Surface other;
    Prepare(Outline(kRed));
    Tavo_GrDPoint a = At(5, 5), b = At(50, 5);
    Tavo_GrDPoint tiny[3] = {At(10, 10), At(12, 12), At(8, 12)};
    Tavo_GrDPoint big[3] = {At(10, 10), At(40, 10), At(20, 40)};
    Tavo_GrDRect r{10, 10, 20, 20};
    m_surface->DrawDot(a, &m_attr);
    m_surface->DrawLine(a, b, &m_attr);
    m_surface->DrawTriangle(tiny, &m_attr);
    m_surface->DrawTriangle(big, &m_attr);
    m_surface->DrawRect(r, &m_attr);
    m_surface->Flush();
    const std::vector<GdiCall> first = m_recorder->Of(GdiCall::PolyPolyline);

    other.SetDC(m_canvas.GetDC());
    other.SetDeviceHeight(kHeight);
    other.BeginDrawing(nullptr);
    m_recorder->Clear();
    other.Flush();
    const std::vector<GdiCall> second = m_recorder->Of(GdiCall::PolyPolyline);
    other.EndDrawing();

    ASSERT_EQ(5u, first.size());
    ASSERT_EQ(5u, second.size());
    const DWORD expected[] = {2, 2, 3, 4, 5}; // dots, lines, uniangles, hollow triangles, hollow rects
    for (int i = 0; i < 5; ++i) {
        EXPECT_EQ(first[i].counts, second[i].counts) << "kind " << i << " shares one array";
        ASSERT_EQ(1u, first[i].countValues.size());
        EXPECT_EQ(expected[i], first[i].countValues[0]) << "kind " << i;
    }
    EXPECT_EQ(first[0].counts, first[1].counts) << "dots and lines both use the array of 2";
}

TEST_F(BatchingTest, ElementLayoutsFollowTheKind)
{
    Prepare(Outline(kRed));
    Tavo_GrDPoint a = At(5, 150), b = At(50, 140);
    Tavo_GrDPoint tiny[3] = {At(10, 10), At(12, 12), At(8, 12)};
    Tavo_GrDPoint big[3] = {At(10, 10), At(40, 10), At(20, 40)};
    Tavo_GrDRect r{10, 20, 30, 40};
    m_surface->DrawDot(a, &m_attr);
    m_surface->DrawLine(a, b, &m_attr);
    m_surface->DrawTriangle(tiny, &m_attr);
    m_surface->DrawTriangle(big, &m_attr);
    m_surface->DrawRect(r, &m_attr);
    m_surface->Flush();

    const std::vector<GdiCall> calls = NonEmptyPolyPolylines();
    ASSERT_EQ(5u, calls.size());
    const int H = kHeight;
    EXPECT_EQ(Points({{5, H - 150}, {6, H - 150}}), calls[0].points) << "dot: (x, y), (x + 1, y)";
    EXPECT_EQ(Points({{5, H - 150}, {50, H - 140}}), calls[1].points);
    EXPECT_EQ(Points({{10, H - 10}, {12, H - 12}, {8, H - 12}}), calls[2].points) << "uniangle stays open";
    EXPECT_EQ(Points({{10, H - 10}, {40, H - 10}, {20, H - 40}, {10, H - 10}}), calls[3].points);
    EXPECT_EQ(Points({{10, H - 40}, {31, H - 40}, {31, H - 20 + 1}, {10, H - 20 + 1}, {10, H - 40}}), calls[4].points);
}

TEST_F(BatchingTest, FlushEmitsKindsInTheFixedOrder)
{
    Prepare(Outline(kRed));
    Tavo_GrAttr filled = Filled(kRed);
    Tavo_GrDPoint a = At(5, 5), b = At(50, 5), c = At(60, 60);
    Tavo_GrDPoint tiny[3] = {At(10, 10), At(12, 12), At(8, 12)};
    Tavo_GrDPoint big[3] = {At(10, 10), At(40, 10), At(20, 40)};
    Tavo_GrDRect r{10, 10, 20, 20};
    // The outline kinds, issued in reverse order within one run.
    m_surface->DrawCircle(c, 10, &m_attr);
    m_surface->DrawRect(r, &m_attr);
    m_surface->DrawTriangle(big, &m_attr);
    m_surface->DrawTriangle(tiny, &m_attr);
    m_surface->DrawLine(a, b, &m_attr);
    m_surface->DrawDot(a, &m_attr);
    m_surface->Flush();
    // Points per polyline of each PolyPolyline, -1 for an Ellipse.
    std::vector<int> counts;
    for (const GdiCall& call : m_recorder->GetCalls()) {
        if (call.kind == GdiCall::PolyPolyline || call.kind == GdiCall::Ellipse) {
            counts.push_back(call.kind == GdiCall::PolyPolyline ? int(call.countValues.empty() ? 0 : call.countValues[0]) : -1);
        }
    }
    EXPECT_EQ((std::vector<int>{2, 2, 3, 4, 5, -1}), counts)
        << "dots, lines, uniangles, hollow triangles, hollow rectangles, then the circle";

    // The filled kinds, in one filled run: circle, rect, triangle issued in reverse.
    m_attr = filled;
    m_surface->SetCurrentAttr(&m_attr);
    m_recorder->Clear();
    m_surface->DrawCircle(c, 10, &m_attr);
    m_surface->DrawRect(r, &m_attr);
    m_surface->DrawTriangle(big, &m_attr);
    m_surface->Flush();
    std::vector<GdiCall::Kind> filledKinds;
    for (const GdiCall& call : m_recorder->GetCalls())
        if (call.kind == GdiCall::Polygon || call.kind == GdiCall::Rectangle || call.kind == GdiCall::Ellipse)
            filledKinds.push_back(call.kind);
    EXPECT_EQ((std::vector<GdiCall::Kind>{GdiCall::Polygon, GdiCall::Rectangle, GdiCall::Ellipse}), filledKinds);
}

TEST_F(BatchingTest, HollowCirclesAreDrawnWithTheNullBrushWhichIsThenRestored)
{
    Prepare(Outline(kRed));
    Tavo_GrDPoint c = At(60, 60);
    m_surface->DrawCircle(c, 10, &m_attr);
    m_surface->DrawCircle(c, 20, &m_attr);
    m_surface->Flush();

    const std::vector<GdiCall>& calls = m_recorder->GetCalls();
    const auto select = std::find_if(calls.begin(), calls.end(), [](const GdiCall& call) {
        return call.kind == GdiCall::SelectObject && call.object == GetStockObject(NULL_BRUSH);
    });
    ASSERT_NE(calls.end(), select);
    ASSERT_LE(4, calls.end() - select);
    EXPECT_EQ(GdiCall::Ellipse, select[1].kind);
    EXPECT_EQ(GdiCall::Ellipse, select[2].kind);
    EXPECT_EQ(GdiCall::SelectObject, select[3].kind);
    EXPECT_EQ(select[0].displaced, select[3].object);
    const int y = kHeight - 60;
    EXPECT_EQ(50, select[1].values[0]);
    EXPECT_EQ(y - 10, select[1].values[1]);
    EXPECT_EQ(70, select[1].values[2]);
    EXPECT_EQ(y + 10, select[1].values[3]);
}

TEST_F(BatchingTest, FullLineBatchIsEmittedBeforeTheAddReturns)
{
    Prepare(Outline(kRed));
    Tavo_GrDPoint a = At(5, 5), b = At(50, 5);
    for (int i = 0; i < Tavo_WiWin32Surface::kLineCapacity - 1; ++i)
        m_surface->DrawLine(a, b, &m_attr);
    EXPECT_TRUE(NonEmptyPolyPolylines().empty());
    m_surface->DrawLine(a, b, &m_attr);
    const std::vector<GdiCall> calls = NonEmptyPolyPolylines();
    ASSERT_EQ(1u, calls.size());
    EXPECT_EQ(5000, calls[0].count);
    m_recorder->Clear();
    m_surface->Flush();
    EXPECT_TRUE(NonEmptyPolyPolylines().empty()) << "the batch was left empty";
}

TEST_F(BatchingTest, TwoHundredFilledTrianglesBecomeTwoHundredClosedPolygons)
{
    Prepare(Filled(kRed));
    Tavo_GrDPoint big[3] = {At(10, 10), At(40, 10), At(20, 40)};
    for (int i = 0; i < 199; ++i)
        m_surface->DrawTriangle(big, &m_attr);
    EXPECT_EQ(0, m_recorder->CountOf(GdiCall::Polygon));
    m_surface->DrawTriangle(big, &m_attr);
    const std::vector<GdiCall> polygons = m_recorder->Of(GdiCall::Polygon);
    ASSERT_EQ(200u, polygons.size());
    const int H = kHeight;
    for (const GdiCall& polygon : polygons) {
        ASSERT_EQ(4, polygon.count);
        EXPECT_EQ(Points({{10, H - 10}, {40, H - 10}, {20, H - 40}, {10, H - 10}}), polygon.points);
    }
}

TEST_F(BatchingTest, FilledRectanglesKeepCoordinatesBeyondSixteenBits)
{
    Prepare(Filled(kRed));
    Tavo_GrDRect r{-70000, -5, 39999, 100000};
    m_surface->DrawRect(r, &m_attr);
    m_surface->Flush();
    const std::vector<GdiCall> rects = m_recorder->Of(GdiCall::Rectangle);
    ASSERT_EQ(1u, rects.size());
    EXPECT_EQ(-70000, rects[0].values[0]);
    EXPECT_EQ(kHeight - 100000, rects[0].values[1]);
    EXPECT_EQ(40000, rects[0].values[2]) << "not wrapped to -25536";
    EXPECT_EQ(kHeight + 5 + 1, rects[0].values[3]);
    EXPECT_EQ(kWidth * kHeight, CountColour(kRed)) << "the rectangle covers the whole canvas";
}

TEST_F(BatchingTest, FilledCirclesKeepCoordinatesBeyondSixteenBits)
{
    Prepare(Filled(kRed));
    Tavo_GrDPoint c = At(40000, 50);
    m_surface->DrawCircle(c, 39950, &m_attr);
    m_surface->Flush();
    const std::vector<GdiCall> ellipses = m_recorder->Of(GdiCall::Ellipse);
    ASSERT_EQ(1u, ellipses.size());
    EXPECT_EQ(50, ellipses[0].values[0]);
    EXPECT_EQ(79950, ellipses[0].values[2]);
    EXPECT_TRUE(IsColour(60, kHeight - 50, kRed)) << "the circle's left edge reaches into the canvas";
    EXPECT_TRUE(IsColour(kWidth - 1, kHeight - 50, kRed));
    EXPECT_FALSE(IsColour(10, kHeight - 50, kRed));
}

TEST_F(BatchingTest, ExtremeCoordinatesSaturateInsteadOfOverflowing)
{
    Prepare(Filled(kRed));
    Tavo_GrDRect r{INT_MIN, INT_MIN, INT_MAX, INT_MAX};
    m_surface->DrawRect(r, &m_attr);
    m_surface->Flush();
    const std::vector<GdiCall> rects = m_recorder->Of(GdiCall::Rectangle);
    ASSERT_EQ(1u, rects.size());
    EXPECT_EQ(INT_MIN, rects[0].values[0]);
    EXPECT_EQ(kHeight - INT_MAX, rects[0].values[1]);
    EXPECT_EQ(INT_MAX, rects[0].values[2]) << "INT_MAX + 1 saturates";
    EXPECT_EQ(INT_MAX, rects[0].values[3]) << "H - INT_MIN + 1 saturates";
}

TEST_F(BatchingTest, LinesAndUniAnglesShareACounterAsDoHollowAndFilledCircles)
{
    Prepare(Outline(kRed));
    Tavo_GrDPoint a = At(5, 5), b = At(50, 5), c = At(60, 60);
    Tavo_GrDPoint tiny[3] = {At(10, 10), At(12, 12), At(8, 12)};
    m_surface->DrawLine(a, b, &m_attr);
    m_surface->DrawTriangle(tiny, &m_attr);
    m_surface->DrawCircle(c, 10, &m_attr);
    Tavo_GrAttr filled = Filled(kRed);
    m_surface->DrawCircle(c, 10, &filled);
    EndPass();
    EXPECT_EQ(2u, Stats().Get(Tavo_GrSurfaceStats::Lines));
    EXPECT_EQ(2u, Stats().Get(Tavo_GrSurfaceStats::Circles));
}

TEST_F(BatchingTest, DotAtMinusOneIsSkippedAfterTheDotBatchWasEmitted)
{
    Prepare(Outline(kRed));
    m_surface->Flush();
    m_recorder->Clear();
    Tavo_GrDPoint p = At(-1, -1);
    m_surface->DrawDot(p, &m_attr);
    m_surface->Flush();
    EXPECT_TRUE(NonEmptyPolyPolylines().empty());
}

TEST_F(BatchingTest, ColourRunsKeepTheirOrder)
{
    Tavo_GrAttr red = Filled(kRed);
    Tavo_GrAttr blue = Filled(kBlue);
    Tavo_GrDRect r{10, 10, 50, 50};
    Prepare(red);
    m_surface->DrawRect(r, &red);
    m_surface->DrawRect(r, &blue);
    EndPass();
    EXPECT_TRUE(IsColour(30, kHeight - 30, kBlue)) << "the later run is drawn over the earlier";
}

#pragma pop_macro("DrawText")
