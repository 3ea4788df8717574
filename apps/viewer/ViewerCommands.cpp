#include "ViewerCommands.h"

#include <algorithm>
#include <iterator>

namespace ViewerCommands {

namespace {

struct MenuItem {
    UINT id;           // 0: a separator
    const char* label; // with the key after a tab
};

const MenuItem FileItems[] = {
    {FileOpen, "&Open...\tCtrl+O"},
    {FilePrint, "&Print...\tCtrl+P"},
    {FileExport, "&Export view as PNG...\tCtrl+E"},
    {0, nullptr},
    {FileExit, "E&xit"},
};

const MenuItem ViewItems[] = {
    {ZoomIn, "Zoom &in\t+"},
    {ZoomOut, "Zoom &out\t-"},
    {ZoomToFit, "&Fit the drawing\tHome"},
    {UndoZoom, "&Undo zoom\tBackspace"},
};

// + and - come from the main keys (with or without Shift: '=' and '+' share
// one) and from the number pad.
const ACCEL Keys[] = {
    {FVIRTKEY | FCONTROL, 'O', FileOpen},
    {FVIRTKEY | FCONTROL, 'P', FilePrint},
    {FVIRTKEY | FCONTROL, 'E', FileExport},
    {FVIRTKEY, VK_OEM_PLUS, ZoomIn},
    {FVIRTKEY | FSHIFT, VK_OEM_PLUS, ZoomIn},
    {FVIRTKEY, VK_ADD, ZoomIn},
    {FVIRTKEY, VK_OEM_MINUS, ZoomOut},
    {FVIRTKEY, VK_SUBTRACT, ZoomOut},
    {FVIRTKEY, VK_HOME, ZoomToFit},
    {FVIRTKEY, VK_BACK, UndoZoom},
    {FVIRTKEY, VK_LEFT, ScrollLeft},
    {FVIRTKEY, VK_RIGHT, ScrollRight},
    {FVIRTKEY, VK_UP, ScrollUp},
    {FVIRTKEY, VK_DOWN, ScrollDown},
    {FVIRTKEY, VK_PRIOR, ScrollPageUp},
    {FVIRTKEY, VK_NEXT, ScrollPageDown},
};

template <size_t N>
HMENU CreatePopup(const MenuItem (&items)[N])
{
    const HMENU popup = ::CreatePopupMenu();
    for (const MenuItem& item : items) {
        if (item.id == 0)
            ::AppendMenuA(popup, MF_SEPARATOR, 0, nullptr);
        else
            ::AppendMenuA(popup, MF_STRING, item.id, item.label);
    }
    return popup;
}

} // namespace

HMENU CreateMenuBar()
{
    const HMENU bar = ::CreateMenu();
    ::AppendMenuA(bar, MF_POPUP, reinterpret_cast<UINT_PTR>(CreatePopup(FileItems)), "&File");
    ::AppendMenuA(bar, MF_POPUP, reinterpret_cast<UINT_PTR>(CreatePopup(ViewItems)), "&View");
    return bar;
}

HACCEL CreateAccelerators()
{
    ACCEL keys[std::size(Keys)];
    std::copy(std::begin(Keys), std::end(Keys), keys);
    return ::CreateAcceleratorTableA(keys, static_cast<int>(std::size(keys)));
}

} // namespace ViewerCommands
