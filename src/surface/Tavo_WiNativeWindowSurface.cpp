#include "Tavo_WiNativeWindowSurface.h"

Tavo_WiNativeWindowSurface::Tavo_WiNativeWindowSurface() = default;

Tavo_WiNativeWindowSurface::~Tavo_WiNativeWindowSurface() = default;
