#include "ViewerTour.h"

#include "ScreenCapture.h"
#include "TourWatch.h"

#include "Tavo_WiDataTip.h"
#include "Tavo_WiPrintDialog.h"
#include "ViewerFrame.h"
#include "ViewerSettings.h"
#include "ViewerStatusBar.h"

#include <cstdio>

using namespace TourWatch;

namespace {

// The print job, beside the pictures.
constexpr char PrintJobFile[] = "tour.ps";
// The file name box of the Open dialog (a combo box; edt1 in older templates).
constexpr int FileNameComboId = 1148;
constexpr int FileNameEditId = 1152;
// A click holds the button this long: well under the hold time of a drag.
constexpr DWORD ClickHeldMs = 60;
// Pointer moves of a drag, and the time between them.
constexpr int DragSteps = 12;
constexpr DWORD DragStepMs = 25;
// How long the pointer stays outside the view while the view autoscrolls.
constexpr DWORD AutoscrollMs = 700;
// How long the tour waits for the data tip: the rest time and then some.
constexpr DWORD DataTipWaitMs = 3000;
constexpr int WheelNotches = 3;

bool StartsWith(const std::string& text, const char* prefix)
{
    return text.rfind(prefix, 0) == 0;
}

POINT Between(POINT a, POINT b, int step, int steps)
{
    return {a.x + (b.x - a.x) * step / steps, a.y + (b.y - a.y) * step / steps};
}

} // namespace

ViewerTour::ViewerTour(ViewerFrame& frame, std::string folder, std::string file)
    : m_frame(frame), m_folder(std::move(folder)), m_file(std::move(file))
{
}

ViewerTour::~ViewerTour()
{
    if (m_thread.joinable())
        m_thread.join();
}

void ViewerTour::Start()
{
    ::CreateDirectoryA(m_folder.c_str(), nullptr);
    m_frame.SetPrintOutput(PathOf(PrintJobFile));
    // Window handles, taken once on the viewer's thread; the driver thread
    // only ever uses them through the system.
    m_frameWindow = m_frame.GetSafeHwnd();
    m_view = m_frame.GetView().GetSafeHwnd();
    m_scrollee = m_frame.GetView().GetScrollee()->GetSafeHwnd();
    m_statusBar = m_frame.GetStatusBar().GetSafeHwnd();
    m_dataTip = m_frame.GetView().GetScrollee()->GetDataTip()->GetSafeHwnd();
    m_viewerThread = ::GetCurrentThreadId();
    ::SetForegroundWindow(m_frameWindow);
    m_thread = std::thread([this] { Run(); });
}

void ViewerTour::Run()
{
    const struct {
        const char* name;
        bool (ViewerTour::*step)();
    } steps[] = {
        {"start", &ViewerTour::ShowStart},
        {"File > Open", &ViewerTour::Open},
        {"click", &ViewerTour::Click},
        {"wheel zoom", &ViewerTour::WheelZoom},
        {"pan drag with autoscroll", &ViewerTour::PanWithAutoscroll},
        {"rubber rectangle", &ViewerTour::ZoomToRubberRectangle},
        {"data tip", &ViewerTour::RestForDataTip},
        {"undo", &ViewerTour::UndoZoom},
        {"print", &ViewerTour::PrintPageGrid},
    };
    for (const auto& step : steps) {
        std::printf("viewer tour: %s\n", step.name);
        std::fflush(stdout);
        if (!(this->*step.step)())
            break;
    }
    // Nothing a failed step left behind keeps the viewer from closing: a
    // held button (a drag's or a rubber rectangle's loop waits for it), the
    // Shift key, a dialog.
    if (CaptureOf(m_viewerThread)) {
        POINT pointer = {};
        ::GetCursorPos(&pointer);
        m_input.Release(pointer);
        WaitFor([this] { return CaptureOf(m_viewerThread) == nullptr; });
    }
    m_input.KeyUp(VK_SHIFT);
    if (const HWND dialog = VisibleDialogOf(m_viewerThread))
        ::PostMessageA(dialog, WM_COMMAND, IDCANCEL, 0);
    WaitFor([this] { return VisibleDialogOf(m_viewerThread) == nullptr; });
    ::PostMessageA(m_frameWindow, WM_CLOSE, 0, 0);
}

int ViewerTour::Finish()
{
    if (m_thread.joinable())
        m_thread.join();
    std::printf("viewer tour of %s: %zu pictures in %s\n", m_file.c_str(), m_pictures.size(), m_folder.c_str());
    for (const Picture& picture : m_pictures)
        std::printf("  %-28s %s\n", picture.file.c_str(), picture.caption.c_str());
    if (!m_failure.empty()) {
        std::printf("viewer tour: stopped: %s\n", m_failure.c_str());
        std::fflush(stdout);
        return 1;
    }
    std::printf("viewer tour: the print job is %s\n", PathOf(PrintJobFile).c_str());
    std::fflush(stdout);
    return 0;
}

// ---- the steps ---------------------------------------------------------------------------

bool ViewerTour::ShowStart()
{
    if (!WaitFor([this] { return ::IsWindowVisible(m_frameWindow) && StartsWith(Status(0), "Showing"); }))
        return Fail("the viewer did not show its first drawing");
    return TakePicture("01-start.png", "the viewer at start, showing its built-in sample drawing");
}

bool ViewerTour::Open()
{
    m_input.Key('O', VK_CONTROL);
    HWND dialog = nullptr;
    if (!WaitFor([&] { return (dialog = VisibleDialogOf(m_viewerThread)) != nullptr; }))
        return Fail("Ctrl+O showed no Open dialog");
    HWND name = ::GetDlgItem(dialog, FileNameComboId);
    if (!name)
        name = ::GetDlgItem(dialog, FileNameEditId);
    if (!name)
        return Fail("the Open dialog has no file name box");
    m_input.Click(CentreOf(name), ClickHeldMs);
    m_input.Type(m_file);
    if (!TakePicture("02-open-dialog.png", "File > Open (Ctrl+O), the file's path typed in", dialog))
        return false;
    m_input.Key(VK_RETURN);

    const size_t slash = m_file.find_last_of("\\/");
    const std::string fileName = slash == std::string::npos ? m_file : m_file.substr(slash + 1);
    HWND refusal = nullptr;
    const bool opened = WaitFor([&] {
        refusal = VisibleDialogOf(m_viewerThread);
        if (refusal == dialog && ::IsWindow(dialog))
            refusal = nullptr;
        return refusal != nullptr || WindowText(m_frameWindow).find(fileName) != std::string::npos;
    });
    if (refusal) {
        TakePicture("03-open-refused.png", "the viewer refused the file", refusal);
        return Fail("the viewer refused " + m_file + ": " + Status(ViewerStatusBar::Message));
    }
    if (!opened)
        return Fail("the viewer did not show " + m_file);
    return TakePicture("03-opened.png", "the drawing, fitted to the window (zoom level 0)");
}

bool ViewerTour::Click()
{
    const POINT target = DrawnPointNear(ViewPoint(0.5, 0.5));
    m_input.MoveTo(target);
    m_input.Click(target, ClickHeldMs);
    if (!WaitFor([this] { return StartsWith(Status(ViewerStatusBar::Message), "Layer"); }))
        return Fail("a click on the drawing named nothing: " + Status(ViewerStatusBar::Message));
    return TakePicture("04-click.png", "a click names what lies under the pointer (status bar, left)");
}

bool ViewerTour::WheelZoom()
{
    const POINT target = DrawnPointNear(ViewPoint(0.38, 0.42));
    m_input.MoveTo(target);
    for (int notch = 0; notch < WheelNotches; ++notch) {
        m_input.Wheel(target, 1);
        Pause(40);
    }
    const std::string expected = "Zoom level " + std::to_string(WheelNotches * ViewerSettings::LevelsPerWheelNotch);
    if (!WaitFor([&] { return StartsWith(Status(ViewerStatusBar::Zoom), expected.c_str()); }))
        return Fail("three wheel notches did not zoom in: " + Status(ViewerStatusBar::Zoom));
    return TakePicture("05-wheel-zoom.png", "three wheel notches zoom in about the pointer");
}

bool ViewerTour::PanWithAutoscroll()
{
    const POINT start = ViewPoint(0.55, 0.5);
    const POINT inside = ViewPoint(0.25, 0.62);
    m_input.MoveTo(start);
    m_input.Press(start);
    // The press becomes a drag when the hold timer runs out.
    if (!WaitFor([this] { return CaptureOf(m_viewerThread) == m_scrollee; }))
        return Fail("holding the button started no drag");
    for (int step = 1; step <= DragSteps; ++step) {
        m_input.MoveTo(Between(start, inside, step, DragSteps));
        Pause(DragStepMs);
    }
    if (!TakePicture("06-pan-drag.png", "a drag pans the zoomed-in drawing with the pointer"))
        return false;
    // Past the view's bottom edge, onto the status bar: the view keeps
    // scrolling while the pointer stays out there. The pointer stays inside
    // the frame: entering a window again would make Wine bring its modifier
    // keys in line with the X server's, which the Shift of the next step
    // must not meet.
    RECT view = {};
    ::GetWindowRect(m_scrollee, &view);
    const POINT outside = {inside.x, view.bottom + 25};
    m_input.MoveTo(outside);
    Pause(AutoscrollMs);
    const bool taken =
        TakePicture("07-autoscroll.png", "the pointer went past the view's edge: the view scrolls on by itself");
    m_input.Release(outside);
    if (!WaitFor([this] { return CaptureOf(m_viewerThread) == nullptr; }))
        return Fail("releasing the button did not end the drag");
    return taken;
}

bool ViewerTour::ZoomToRubberRectangle()
{
    const POINT from = ViewPoint(0.35, 0.3);
    const POINT to = ViewPoint(0.62, 0.62);
    m_zoomBeforeRectangle = Status(ViewerStatusBar::Zoom);
    // The pointer comes back into the frame first, and the viewer has seen
    // it there (its position in the status bar) before Shift goes down: on
    // entering a window Wine brings the modifier keys in line with the X
    // server's, where Shift is up.
    const std::string pointerBefore = Status(ViewerStatusBar::Pointer);
    m_input.MoveTo(from);
    WaitFor([&] { return Status(ViewerStatusBar::Pointer) != pointerBefore; });
    m_input.PressWithShift(from);
    // With Shift held the drag is a rubber rectangle, whose loop captures
    // the pointer for the drawing window itself.
    if (!WaitFor([this] { return CaptureOf(m_viewerThread) == m_view; })) {
        m_input.Release(from);
        m_input.KeyUp(VK_SHIFT);
        return Fail("Shift and a held button started no rubber rectangle");
    }
    for (int step = 1; step <= DragSteps; ++step) {
        m_input.MoveTo(Between(from, to, step, DragSteps));
        Pause(DragStepMs);
    }
    // The rectangle is drawn over the view; a repaint now would cover it.
    const bool taken =
        TakePicture("08-rubber-rectangle.png", "Shift + drag draws a rubber rectangle", nullptr, false);
    m_input.Release(to);
    m_input.KeyUp(VK_SHIFT);
    if (!WaitFor([this] { return Status(ViewerStatusBar::Zoom) != m_zoomBeforeRectangle; }))
        return Fail("the rubber rectangle did not zoom");
    return taken && TakePicture("09-zoomed-to-rectangle.png", "released: the view zooms to the rectangle");
}

bool ViewerTour::RestForDataTip()
{
    const POINT target = DrawnPointNear(ViewPoint(0.45, 0.45));
    m_input.MoveTo({target.x - 6, target.y - 6});
    Pause(40);
    m_input.MoveTo(target);
    if (!WaitFor([this] { return ::IsWindowVisible(m_dataTip) != FALSE; }, DataTipWaitMs))
        return Fail("resting the pointer on the drawing showed no data tip");
    return TakePicture("10-data-tip.png", "the pointer at rest: a data tip names the item under it", m_dataTip);
}

bool ViewerTour::UndoZoom()
{
    m_input.Key(VK_BACK);
    if (!WaitFor([this] { return Status(ViewerStatusBar::Zoom) == m_zoomBeforeRectangle; }))
        return Fail("Backspace did not undo the zoom: " + Status(ViewerStatusBar::Zoom));
    // The key hides the data tip at the tip's next tick.
    WaitFor([this] { return !::IsWindowVisible(m_dataTip); });
    return TakePicture("11-undo.png", "Backspace undoes the last zoom: the view before the rectangle");
}

bool ViewerTour::PrintPageGrid()
{
    m_input.Key('P', VK_CONTROL);
    HWND dialog = nullptr;
    if (!WaitFor([&] { return (dialog = VisibleDialogOf(m_viewerThread)) != nullptr; }))
        return Fail("Ctrl+P showed no print dialog");
    if (!TakePicture("12-print-dialog.png", "File > Print (Ctrl+P): the page grid of the view, current page chosen",
                     dialog))
        return false;
    const HWND allPages = ::GetDlgItem(dialog, Tavo_WiPrintDialog::AllPagesButtonId);
    const HWND ok = ::GetDlgItem(dialog, IDOK);
    if (!allPages || !ok)
        return Fail("the print dialog has no all-pages choice or no OK button");
    m_input.Click(CentreOf(allPages), ClickHeldMs);
    if (!WaitFor([&] { return ::SendMessageA(allPages, BM_GETCHECK, 0, 0) == BST_CHECKED; }))
        return Fail("clicking the all-pages choice did not choose it");
    m_input.Click(CentreOf(ok), ClickHeldMs);
    if (!WaitFor([this] { return StartsWith(Status(ViewerStatusBar::Message), "Printed"); }))
        return Fail("the print job did not finish: " + Status(ViewerStatusBar::Message));
    return TakePicture("13-printed.png", "printed: every page of the grid went to " + std::string(PrintJobFile));
}

// ---- helpers ------------------------------------------------------------------------------------

bool ViewerTour::TakePicture(const std::string& file, const std::string& caption, HWND extra, bool repaint)
{
    Settle(m_frameWindow, extra, repaint);
    const std::string failure = ScreenCapture::SavePng(ScreenCapture::Around(m_frameWindow, extra), PathOf(file));
    if (!failure.empty())
        return Fail(file + ": " + failure);
    m_pictures.push_back({file, caption});
    return true;
}

bool ViewerTour::Fail(const std::string& why)
{
    if (m_failure.empty())
        m_failure = why;
    return false;
}

POINT ViewerTour::ViewPoint(double fx, double fy) const
{
    RECT client = {};
    ::GetClientRect(m_scrollee, &client);
    POINT point = {static_cast<LONG>(client.right * fx), static_cast<LONG>(client.bottom * fy)};
    ::ClientToScreen(m_scrollee, &point);
    return point;
}

POINT ViewerTour::DrawnPointNear(POINT target) const
{
    POINT found = target;
    ScreenCapture::FindDrawnPoint(m_scrollee, target, ViewerSettings::Background, found);
    return found;
}

std::string ViewerTour::Status(int part) const
{
    return StatusPart(m_statusBar, part);
}

std::string ViewerTour::PathOf(const std::string& file) const
{
    return m_folder + "\\" + file;
}
