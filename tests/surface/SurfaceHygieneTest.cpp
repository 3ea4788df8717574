// Tavo_WiWin32Surface and GDI objects: a pass leaves the device context as it
// found it, the surface holds nothing between passes, and nothing leaks.
#include "SurfaceFixture.h"

#include "Tavo_GrDrawing.h"
#include "Tavo_GrDrawingBuilder.h"
#include "Tavo_GrMapping.h"

#pragma push_macro("DrawText")
#undef DrawText

namespace {

struct DcObjects {
    HGDIOBJ pen;
    HGDIOBJ brush;
    HGDIOBJ font;
};

DcObjects CurrentObjects(HDC dc)
{
    return {GetCurrentObject(dc, OBJ_PEN), GetCurrentObject(dc, OBJ_BRUSH), GetCurrentObject(dc, OBJ_FONT)};
}

std::vector<HGDIOBJ> CreatedObjects(const GdiCallRecorder& recorder)
{
    std::vector<HGDIOBJ> objects;
    for (const GdiCall& call : recorder.GetCalls())
        if (call.kind == GdiCall::CreatePen || call.kind == GdiCall::CreateBrush || call.kind == GdiCall::CreateFont)
            objects.push_back(call.object);
    return objects;
}

// A small drawing with several colours, fills and text.
void BuildDrawing(Tavo_GrDrawing& drawing)
{
    Tavo_GrDrawingBuilder build(drawing);
    build.SetAttr(Tavo_GrAttr(4, 1, 12));
    build.AddRect(0, 0, 200, 100);
    build.AddText(10, 50, "text");
    build.SetAttr(Tavo_GrAttr(1, 0, 30));
    build.AddCircle(50, 50, 20);
    build.AddLine(0, 0, 200, 100);
    build.AddText(60, 20, "more text");
    build.SetAttr(Tavo_GrAttr(2, 1, 1));
    build.AddTriangle({10, 10}, {30, 10}, {20, 30});
    build.AddText(100, 20, "tiny");
}

} // namespace

TEST_F(RecordedSurfaceTest, EndDrawingRestoresTheDcAndDeletesWhatTheSurfaceMade)
{
    const DcObjects before = CurrentObjects(m_canvas.GetDC());
    Tavo_GrAttr attr = Filled(kRed, 20);
    Tavo_GrDRect r{10, 10, 50, 50};
    Tavo_GrDPoint p{10, 80};
    m_surface->DrawRect(r, &attr);
    m_surface->DrawText("text", p, &attr);
    EndPass();

    const DcObjects after = CurrentObjects(m_canvas.GetDC());
    EXPECT_EQ(before.pen, after.pen);
    EXPECT_EQ(before.brush, after.brush);
    EXPECT_EQ(before.font, after.font);
    const std::vector<HGDIOBJ> created = CreatedObjects(*m_recorder);
    EXPECT_EQ(3u, created.size());
    for (HGDIOBJ object : created)
        EXPECT_EQ(0u, GetObjectType(object)) << "deleted";
    EXPECT_EQ(0, m_recorder->GetLiveObjectCount());
}

TEST_F(RecordedSurfaceTest, SurfaceHoldsNothingBetweenPasses)
{
    Tavo_GrAttr attr = Filled(kRed, 20);
    Tavo_GrDRect r{10, 10, 50, 50};
    m_surface->DrawRect(r, &attr);
    EndPass();
    m_recorder->Clear();
    m_surface.reset(); // the destructor finds nothing left to release
    EXPECT_EQ(0, m_recorder->CountOf(GdiCall::DeleteObject));
    EXPECT_EQ(0, m_recorder->CountOf(GdiCall::SelectObject));
}

TEST_F(RecordedSurfaceTest, SurfaceDestroyedInTheMiddleOfAPassLeaksNothing)
{
    const DcObjects before = CurrentObjects(m_canvas.GetDC());
    Tavo_GrAttr attr = Filled(kRed, 20);
    Tavo_GrDRect r{10, 10, 50, 50};
    m_surface->DrawRect(r, &attr);
    m_surface.reset();
    EXPECT_EQ(0, m_recorder->GetLiveObjectCount());
    const DcObjects after = CurrentObjects(m_canvas.GetDC());
    EXPECT_EQ(before.pen, after.pen);
    EXPECT_EQ(before.brush, after.brush);
    EXPECT_EQ(before.font, after.font);
}

TEST_F(RecordedSurfaceTest, SurfaceWithoutADeviceContextDrawsNothingAndLeaksNothing)
{
    m_surface->SetDC(nullptr);
    Tavo_GrAttr attr = Filled(kRed, 20);
    Tavo_GrDRect r{10, 10, 50, 50};
    Tavo_GrDPoint p{10, 80};
    m_surface->DrawRect(r, &attr);
    m_surface->DrawText("text", p, &attr);
    EndPass();
    EXPECT_EQ(0, m_recorder->GetLiveObjectCount());
    EXPECT_EQ(0, CountColour(kRed));
}

TEST_F(RecordedSurfaceTest, TenThousandPassesThroughTheCoreLeakNoGdiObject)
{
    Tavo_GrDrawing drawing;
    BuildDrawing(drawing);
    Tavo_GrMapping mapping(&drawing, 5);
    mapping.SetDeviceWindowSize(kWidth, kHeight, true, nullptr);
    const DcObjects before = CurrentObjects(m_canvas.GetDC());
    m_recorder->SetKeepCalls(false);

    for (int pass = 0; pass < 10000; ++pass) {
        m_surface->SetDC(m_canvas.GetDC());
        drawing.Draw(*m_surface, mapping, nullptr);
    }

    EXPECT_GE(m_recorder->GetCreatedCount(), 10000 * 5);
    EXPECT_EQ(0, m_recorder->GetLiveObjectCount());
    const DcObjects after = CurrentObjects(m_canvas.GetDC());
    EXPECT_EQ(before.pen, after.pen);
    EXPECT_EQ(before.brush, after.brush);
    EXPECT_EQ(before.font, after.font);
    EXPECT_GT(CountColour(kRed), 1000) << "the passes did draw";
}

#pragma pop_macro("DrawText")
