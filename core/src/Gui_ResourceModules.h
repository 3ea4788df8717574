// The modules registered with Gui_Locale, searched in order by Gui_Msg.
// Internal to the core.
#pragma once

#include <windows.h>

#include <vector>

std::vector<HINSTANCE>& Gui_ResourceModules();
