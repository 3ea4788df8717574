// Tavo_GrLibrary: initialisation count, trace sink and the installed palette.
#include "Tavo_GrLibrary.h"

#include "Tavo_GrPalette.h"

#include <windows.h>

#include <memory>

namespace {

void DebuggerTrace(const char* message, void*)
{
    OutputDebugStringA(message);
}

struct LibraryState {
    int initializeCount = 0;
    Tavo_GrLibrary::TraceSink traceSink = DebuggerTrace;
    void* traceContext = nullptr;
    std::unique_ptr<Tavo_GrPalette> palette;
};

// Never destroyed: at process exit the palette may belong to a library that
// has already been detached, so only Terminate releases it.
LibraryState& State()
{
    static LibraryState* state = new LibraryState;
    return *state;
}

} // namespace

void Tavo_GrLibrary::Initialize()
{
    ++State().initializeCount;
}

void Tavo_GrLibrary::Terminate(bool force)
{
    LibraryState& state = State();
    if (!force) {
        if (state.initializeCount <= 0)
            return;
        if (--state.initializeCount > 0)
            return;
    }
    state.initializeCount = 0;
    state.palette.reset();
}

int Tavo_GrLibrary::GetInitializeCount()
{
    return State().initializeCount;
}

void Tavo_GrLibrary::Trace(const char* message)
{
    if (!message)
        return;
    LibraryState& state = State();
    state.traceSink(message, state.traceContext);
}

void Tavo_GrLibrary::SetTraceSink(TraceSink sink, void* context)
{
    LibraryState& state = State();
    state.traceSink = sink ? sink : DebuggerTrace;
    state.traceContext = sink ? context : nullptr;
}

Tavo_GrPalette* Tavo_GrLibrary::GetPalette()
{
    return State().palette.get();
}

void Tavo_GrLibrary::SetPalette(Tavo_GrPalette* palette)
{
    std::unique_ptr<Tavo_GrPalette>& held = State().palette;
    if (held.get() == palette)
        return;
    held.reset(palette);
}
