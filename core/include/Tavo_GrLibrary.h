// Tavo_GrLibrary: the graphics core as a whole.
//
// * Initialize/Terminate are counted: every Initialize is matched by a
//   Terminate(false); the last one, or Terminate(true) at any time, releases
//   what the core holds (the installed palette) and sets the count to 0.
//   Terminate without a matching Initialize does nothing unless forced.
// * The palette: SetPalette(p) installs p, and the core owns it from then on:
//   it deletes the palette it held before (unless that is p itself) and deletes
//   p when it is replaced or released. GetPalette gives the installed palette
//   or null. A palette works without Initialize.
// * Trace hands a message, unchanged, to the trace sink: by default
//   OutputDebugStringA; SetTraceSink installs another (null: the default).
//   A null message is ignored.
//
// All of it is meant for one thread (the GUI thread); nothing is locked.
#pragma once

#include "Tavo_CoreApi.h"

class Tavo_GrPalette;

class TAVO_CORE_API Tavo_GrLibrary {
public:
    using TraceSink = void (*)(const char* message, void* context);

    static void Initialize();
    static void Terminate(bool force);
    static int GetInitializeCount();

    static void Trace(const char* message);
    static void SetTraceSink(TraceSink sink, void* context);

    static Tavo_GrPalette* GetPalette();
    static void SetPalette(Tavo_GrPalette* palette);
};
