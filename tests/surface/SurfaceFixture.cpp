#include "SurfaceFixture.h"

#include "Tavo_WiLibrary.h"
#include "Tavo_WiPalette.h"

#include <vector>

COLORREF ColourOf(char index)
{
    return Tavo_WiLibrary::GetPalette()->GetWin32Color(index, false);
}

Tavo_GrAttr Outline(char colour, int charHeight, char align)
{
    return Tavo_GrAttr(colour, 0, charHeight, align);
}

Tavo_GrAttr Filled(char colour, int charHeight, char align)
{
    return Tavo_GrAttr(colour, 1, charHeight, align);
}

ScopedEnvironment::ScopedEnvironment(const char* name, const char* value) : m_name(name)
{
    const DWORD size = GetEnvironmentVariableA(name, nullptr, 0);
    if (size > 0) {
        std::vector<char> text(size);
        GetEnvironmentVariableA(name, text.data(), size);
        m_previous = text.data();
        m_wasSet = true;
    }
    SetEnvironmentVariableA(name, value);
}

ScopedEnvironment::~ScopedEnvironment()
{
    SetEnvironmentVariableA(m_name.c_str(), m_wasSet ? m_previous.c_str() : nullptr);
}

void SurfaceTest::SetUp()
{
    ASSERT_TRUE(m_canvas.IsValid());
    CreateSurface();
}

void SurfaceTest::TearDown()
{
    m_surface.reset();
}

void SurfaceTest::CreateSurface()
{
    m_surface = std::make_unique<Tavo_WiWin32Surface>();
    Bind();
}

void SurfaceTest::Bind(double scale)
{
    m_surface->SetDC(m_canvas.GetDC());
    m_surface->SetDeviceHeight(kHeight);
    m_surface->SetTransform(Tavo_GrTransform(scale, 0.0, 0.0));
    m_surface->BeginDrawing(nullptr);
}

void SurfaceTest::EndPass()
{
    m_surface->Flush();
    m_surface->EndDrawing();
}

Tavo_GrSurfaceStats SurfaceTest::Stats() const
{
    Tavo_GrSurfaceStats stats;
    m_surface->FetchStats(stats);
    return stats;
}

void RecordedSurfaceTest::SetUp()
{
    SurfaceTest::SetUp();
    m_recorder = std::make_unique<GdiCallRecorder>();
    ASSERT_TRUE(m_recorder->IsActive());
}

void RecordedSurfaceTest::TearDown()
{
    m_recorder.reset();
    SurfaceTest::TearDown();
}
