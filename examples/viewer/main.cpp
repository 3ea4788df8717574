// viewer: shows a site plan in a window. Turn the mouse wheel to zoom about
// the pointer, drag with the left button to pan while zoomed in, double-click
// to see the whole plan again.
#include <afxwin.h>

#include "SitePlan.h"
#include "Tavo_GrDrawing.h"
#include "Tavo_WiLibrary.h"
#include "Tavo_WiVersion.h"
#include "ViewerFrame.h"

int WINAPI WinMain(HINSTANCE, HINSTANCE, LPSTR, int showCommand)
{
    // The application object runs the message loop, which ends when the main
    // window is destroyed.
    CWinApp app("Tavo viewer");
    Tavo_WiLibrary::Initialize();
    int status = 1;
    {
        // The drawing outlives the windows that show it: declared first, it
        // is destroyed last.
        Tavo_GrDrawing drawing;
        BuildSitePlan(drawing);
        ViewerFrame frame;
        if (frame.CreateFrame("Site plan - libTavo_Windows " TAVO_VERSION_STRING, &drawing)) {
            app.m_pMainWnd = &frame;
            frame.ShowWindow(showCommand);
            frame.UpdateWindow();
            status = app.Run();
        }
    }
    Tavo_WiLibrary::Terminate(false);
    return status;
}
