// ViewerTour: a scripted session with the viewer, driven by real input from
// a thread of its own while the viewer's thread runs its message loop as it
// always does. It opens a drawing through File > Open, clicks, zooms with the
// wheel, pans with a drag that leaves the view, zooms to a rubber rectangle,
// rests the pointer for a data tip, undoes the zoom and prints the page grid
// through the print dialog, and writes a PNG picture of the screen after each
// step (and during the drags) into its folder, the print job beside them
// (tour.ps).
//
// Each step waits, with a deadline, for what the viewer shows in response
// (its status bar, its title, its capture, its dialogs); the hold timer of a
// drag and the rest time of the data tip run on the real clock. This is a
// demonstration: the tests drive the same commands deterministically.
#pragma once

#include <windows.h>

#include <string>
#include <thread>
#include <vector>

#include "TourInput.h"

class ViewerFrame;

class ViewerTour {
public:
    // frame: not owned, created; folder and file: Windows paths.
    ViewerTour(ViewerFrame& frame, std::string folder, std::string file);
    ~ViewerTour();
    ViewerTour(const ViewerTour&) = delete;
    ViewerTour& operator=(const ViewerTour&) = delete;

    // On the viewer's thread, before its message loop: starts the session,
    // which closes the frame when it ends.
    void Start();
    // After the message loop: waits for the session, says what it made and
    // where; 0 when every step was seen to work.
    int Finish();

private:
    struct Picture {
        std::string file;
        std::string caption;
    };

    void Run();
    bool ShowStart();
    bool Open();
    bool Click();
    bool WheelZoom();
    bool PanWithAutoscroll();
    bool ZoomToRubberRectangle();
    bool RestForDataTip();
    bool UndoZoom();
    bool PrintPageGrid();

    // Writes a picture of the frame (and of extra, a pop-up, when given).
    bool TakePicture(const std::string& file, const std::string& caption, HWND extra = nullptr,
                     bool repaint = true);
    bool Fail(const std::string& why);
    // A screen point at fractions of the view's client area.
    POINT ViewPoint(double fx, double fy) const;
    // The drawn point nearest to target, or target when nothing is drawn.
    POINT DrawnPointNear(POINT target) const;
    std::string Status(int part) const;
    std::string PathOf(const std::string& file) const;

    ViewerFrame& m_frame;
    std::string m_folder;
    std::string m_file;
    HWND m_frameWindow = nullptr;
    HWND m_scrollee = nullptr;
    HWND m_view = nullptr;
    HWND m_statusBar = nullptr;
    HWND m_dataTip = nullptr;
    DWORD m_viewerThread = 0;
    TourInput m_input;
    std::vector<Picture> m_pictures;
    std::string m_zoomBeforeRectangle;
    std::string m_failure;
    std::thread m_thread;
};
