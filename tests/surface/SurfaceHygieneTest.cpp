// Tavo_WiWin32Surface and GDI objects: a pass leaves the device context as it
// found it, the surface holds nothing between passes, and nothing leaks.
#include "SurfaceFixture.h"

#include "Tavo_GrDrawing.h"
#include "Tavo_GrDrawingBuilder.h"
#include "Tavo_GrMapping.h"

static std::vector<HGDIOBJ> CurrentObjects(HDC dc)
{
    return {GetCurrentObject(dc, OBJ_PEN), GetCurrentObject(dc, OBJ_BRUSH), GetCurrentObject(dc, OBJ_FONT)};
}

TEST_F(SurfaceTest, APassEndedOrCutShortLeavesTheDcAsItWasAndDeletesWhatItMade)
{
    const std::vector<HGDIOBJ> before = CurrentObjects(m_canvas.GetDC());
    enum class Ending {
        EndDrawing,
        Destroyed,
        Rebound
    };
    for (const Ending ending : {Ending::EndDrawing, Ending::Destroyed, Ending::Rebound}) {
        SCOPED_TRACE(ending == Ending::EndDrawing      ? "EndDrawing"
                         : ending == Ending::Destroyed ? "surface destroyed in the middle of a pass"
                                                       : "surface bound to another DC in the middle of a pass");
        CreateSurface();
        Tavo_GrAttr attr = Filled(kRed, 20);
        Tavo_GrDRect r{10, 10, 50, 50};
        Tavo_GrDPoint p{10, 80};
        m_surface->DrawRect(r, &attr);
        m_surface->DrawText("text", p, &attr);
        if (ending == Ending::EndDrawing)
            EndPass();
        else if (ending == Ending::Destroyed)
            m_surface.reset();
        else
            m_surface->SetDC(nullptr);

        EXPECT_EQ(before, CurrentObjects(m_canvas.GetDC()));
        const std::vector<GdiCall>& calls = m_recorder.GetCalls();
        EXPECT_EQ(3, std::count_if(calls.begin(), calls.end(), [](const GdiCall& c) { return c.IsCreation(); }))
            << "pen, brush and font";
        for (const GdiCall& call : calls)
            EXPECT_TRUE(!call.IsCreation() || GetObjectType(call.object) == 0) << "deleted";
        EXPECT_EQ(0, m_recorder.GetLiveObjectCount());
    }
    // After EndDrawing the surface holds nothing: its destructor releases nothing.
    CreateSurface();
    Tavo_GrAttr attr = Filled(kRed, 20);
    m_surface->SetCurrentAttr(&attr);
    EndPass();
    m_recorder.Clear();
    m_surface.reset();
    EXPECT_TRUE(m_recorder.GetCalls().empty());
}

TEST_F(SurfaceTest, TenThousandPassesThroughTheCoreLeakNoGdiObject)
{
    // Several colours, fills and text heights, so that every pass makes and drops objects.
    Tavo_GrDrawing drawing;
    Tavo_GrDrawingBuilder build(drawing);
    build.SetAttr(Tavo_GrAttr(kRed, 1, 12));
    build.AddRect(0, 0, 200, 100);
    build.AddText(10, 50, "text");
    build.SetAttr(Tavo_GrAttr(kBlue, 0, 30));
    build.AddCircle(50, 50, 20);
    build.AddText(60, 20, "more text");
    build.SetAttr(Tavo_GrAttr(kBlack, 1, 1));
    build.AddTriangle({10, 10}, {30, 10}, {20, 30});
    build.AddText(100, 20, "tiny");
    Tavo_GrMapping mapping(&drawing, 5);
    mapping.SetDeviceWindowSize(kWidth, kHeight, true, nullptr);
    const std::vector<HGDIOBJ> before = CurrentObjects(m_canvas.GetDC());
    for (int pass = 0; pass < 10000; ++pass) {
        m_surface->SetDC(m_canvas.GetDC());
        drawing.Draw(*m_surface, mapping, nullptr);
        m_recorder.Clear(); // the object counts stay
    }

    EXPECT_GE(m_recorder.GetCreatedCount(), 10000 * 5);
    EXPECT_EQ(0, m_recorder.GetLiveObjectCount());
    EXPECT_EQ(before, CurrentObjects(m_canvas.GetDC()));
    EXPECT_GT(RedPixels(), 1000) << "the passes did draw";

    // Without a device context nothing is drawn and nothing is kept either.
    m_canvas.Fill(RGB(255, 255, 255));
    m_surface->SetDC(nullptr);
    drawing.Draw(*m_surface, mapping, nullptr);
    EXPECT_EQ(0, m_recorder.GetLiveObjectCount());
    EXPECT_EQ(0, RedPixels());
}
