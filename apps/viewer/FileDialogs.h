// FileDialogs: the system's Open and Save As dialogs, for one file each.
#pragma once

#include <windows.h>

#include <string>

namespace FileDialogs {

// filter: pairs of a description and a pattern, each ending in '\0', the
// whole ending in a second '\0'. false when the person cancels.
bool AskOpenPath(HWND owner, const char* filter, std::string& path);
// defaultExtension (without the dot) is added to a name typed without one.
bool AskSavePath(HWND owner, const char* filter, const char* defaultExtension, std::string& path);

} // namespace FileDialogs
