#include "Tavo_WiWindowClass.h"

#include "Tavo_WiModule.h"

namespace Tavo_WiWindowClass {

namespace {

// The low ten bits of a locale id are its primary language.
constexpr LCID PrimaryLanguageMask = 0x3FF;

} // namespace

bool UseOwnClasses()
{
    return (GetUserDefaultLCID() & PrimaryLanguageMask) == LANG_ENGLISH;
}

void RegisterOnce(bool& registered, LPCSTR name, UINT style, HCURSOR cursor, HBRUSH background)
{
    if (registered)
        return;
    registered = true;

    WNDCLASSA wc = {};
    wc.style = style;
    wc.lpfnWndProc = AfxGetAfxWndProc();
    wc.hInstance = Tavo_WiGetModuleInstance();
    wc.hCursor = cursor;
    wc.hbrBackground = background;
    wc.lpszClassName = name;
    if (!AfxRegisterClass(&wc))
        AfxThrowResourceException();
}

} // namespace Tavo_WiWindowClass
