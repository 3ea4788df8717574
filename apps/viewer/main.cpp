// viewer: a Windows drawing viewer on the library. Opens the drawing file
// named on the command line (or the built-in sample drawing), shows it in a
// frame with a menu and a status bar, and runs until the frame is closed.
// With --tour it drives itself through a scripted session and writes a
// picture of each step.
#include "ViewerFrame.h"
#include "ViewerOptions.h"
#include "ViewerSettings.h"
#include "tour/ViewerTour.h"

#include "Tavo_WiLibrary.h"

#include <afxwin.h>

#include <cstdio>
#include <cstdlib>

namespace {

// Where the tour places the frame: fully on the virtual screen, with room
// around it for the pointer to leave the view.
constexpr int TourFrameX = 40;
constexpr int TourFrameY = 30;

int RunViewer(CWinApp& app, const ViewerOptions& options, int showCommand)
{
    const bool touring = !options.tourFolder.empty();
    ViewerFrame frame;
    const int x = touring ? TourFrameX : CW_USEDEFAULT;
    const int y = touring ? TourFrameY : CW_USEDEFAULT;
    if (!frame.CreateFrame(MakeSampleDocument(), x, y, ViewerSettings::FrameWidth, ViewerSettings::FrameHeight)) {
        std::fprintf(stderr, "viewer: could not create the main window\n");
        return 1;
    }
    app.m_pMainWnd = &frame;
    frame.ShowWindow(touring ? SW_SHOWNORMAL : showCommand);
    frame.UpdateWindow();
    if (touring) {
        ViewerTour tour(frame, options.tourFolder, options.file);
        tour.Start();
        app.Run();
        return tour.Finish();
    }
    if (!options.file.empty()) {
        std::string error;
        if (!frame.OpenFile(options.file, error))
            ::MessageBoxA(frame.GetSafeHwnd(), error.c_str(), "Tavo viewer", MB_OK | MB_ICONWARNING);
    }
    return app.Run();
}

} // namespace

int WINAPI WinMain(HINSTANCE, HINSTANCE, LPSTR, int showCommand)
{
    ViewerOptions options;
    std::string error;
    if (!ParseViewerOptions(__argc, __argv, options, error)) {
        std::fprintf(stderr, "viewer: %s\n%s", error.c_str(), ViewerUsage());
        return 2;
    }
    if (options.help) {
        std::printf("%s", ViewerUsage());
        return 0;
    }
    // The application object runs the message loop, which ends when the main
    // window is destroyed, and holds the printer defaults.
    CWinApp app("Tavo viewer");
    Tavo_WiLibrary::Initialize();
    const int status = RunViewer(app, options, showCommand);
    Tavo_WiLibrary::Terminate(false);
    return status;
}
