// Tavo_WiLibrary: passes initialisation, termination and trace text to the
// graphics core and keeps a Tavo_WiPalette installed in it.
#include "Tavo_WiLibrary.h"

#include "Tavo_GrLibrary.h"
#include "Tavo_WiPalette.h"
#include "UT_STR.h"

void Tavo_WiLibrary::Initialize()
{
    Tavo_GrLibrary::Initialize();
}

void Tavo_WiLibrary::Terminate(bool force)
{
    Tavo_GrLibrary::Terminate(force);
}

void Tavo_WiLibrary::Trace(const char* message)
{
    Tavo_GrLibrary::Trace(message);
}

Tavo_WiPalette* Tavo_WiLibrary::GetPalette()
{
    Tavo_GrPalette* held = Tavo_GrLibrary::GetPalette();
    // The class name, compared exactly, is what tells a Tavo_WiPalette apart
    // from a palette of another class that someone installed in the core.
    if (held && UT_STR::Compare(held->GetClassName(), "Tavo_WiPalette") == 0)
        return static_cast<Tavo_WiPalette*>(held);

    // The core owns the new palette, and decides the fate of the one it held.
    auto* palette = new Tavo_WiPalette();
    Tavo_GrLibrary::SetPalette(palette);
    return palette;
}
