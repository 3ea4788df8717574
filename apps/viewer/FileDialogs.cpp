#include "FileDialogs.h"

#include <commdlg.h>

namespace FileDialogs {

namespace {

bool Ask(HWND owner, const char* filter, const char* defaultExtension, DWORD flags, bool save, std::string& path)
{
    char name[MAX_PATH] = {};
    path.copy(name, sizeof name - 1);
    OPENFILENAMEA request = {};
    request.lStructSize = sizeof(request);
    request.hwndOwner = owner;
    request.lpstrFilter = filter;
    request.lpstrFile = name;
    request.nMaxFile = sizeof name;
    request.lpstrDefExt = defaultExtension;
    request.Flags = flags | OFN_HIDEREADONLY | OFN_NOCHANGEDIR;
    const BOOL confirmed = save ? ::GetSaveFileNameA(&request) : ::GetOpenFileNameA(&request);
    if (!confirmed)
        return false;
    path = name;
    return true;
}

} // namespace

bool AskOpenPath(HWND owner, const char* filter, std::string& path)
{
    return Ask(owner, filter, nullptr, OFN_FILEMUSTEXIST | OFN_PATHMUSTEXIST, false, path);
}

bool AskSavePath(HWND owner, const char* filter, const char* defaultExtension, std::string& path)
{
    return Ask(owner, filter, defaultExtension, OFN_OVERWRITEPROMPT | OFN_PATHMUSTEXIST, true, path);
}

} // namespace FileDialogs
