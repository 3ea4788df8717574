#include "ViewerFrame.h"

#include "FileDialogs.h"
#include "ViewExport.h"
#include "ViewerCommands.h"

namespace {

constexpr char ApplicationName[] = "Tavo viewer";
constexpr char DrawingFilter[] = "DXF drawings (*.dxf)\0*.dxf\0All files (*.*)\0*.*\0";
constexpr char PngFilter[] = "PNG pictures (*.png)\0*.png\0";
constexpr char PostScriptFilter[] = "PostScript files (*.ps)\0*.ps\0";

} // namespace

BEGIN_MESSAGE_MAP(ViewerFrame, CWnd)
    ON_WM_SIZE()
    ON_WM_SETFOCUS()
    ON_WM_MOUSEWHEEL()
    ON_MESSAGE(WM_COMMAND, &ViewerFrame::OnCommandMessage)
    ON_MESSAGE(WM_ENTERSIZEMOVE, &ViewerFrame::OnEnterSizeMove)
    ON_MESSAGE(WM_EXITSIZEMOVE, &ViewerFrame::OnExitSizeMove)
END_MESSAGE_MAP()

ViewerFrame::ViewerFrame() = default;

ViewerFrame::~ViewerFrame()
{
    if (GetSafeHwnd())
        DestroyWindow();
    if (m_accelerators)
        ::DestroyAcceleratorTable(m_accelerators);
}

BOOL ViewerFrame::CreateFrame(std::unique_ptr<ViewerDocument> document, int x, int y, int width, int height)
{
    // The menu bar belongs to the window from here on and goes with it.
    const HMENU menu = ViewerCommands::CreateMenuBar();
    if (!CreateEx(0, nullptr, ApplicationName, WS_OVERLAPPEDWINDOW | WS_CLIPCHILDREN, x, y, width, height, nullptr,
                  menu)) {
        ::DestroyMenu(menu);
        return FALSE;
    }
    m_accelerators = ViewerCommands::CreateAccelerators();
    if (!m_statusBar.CreateBar(this, StatusBarId))
        return FALSE;
    CRect client(0, 0, 0, 0);
    GetClientRect(&client);
    if (!m_view.CreateView(this, client, ViewId))
        return FALSE;
    m_view.SetStatusBar(&m_statusBar);
    OnSize(SIZE_RESTORED, client.Width(), client.Height());
    ShowDocument(std::move(document));
    return TRUE;
}

// ---- documents ------------------------------------------------------------------------

bool ViewerFrame::OpenFile(const std::string& path, std::string& error)
{
    OpenDrawingResult opened = OpenDrawing(path);
    if (!opened.document) {
        error = opened.error;
        ShowMessage(error);
        return false;
    }
    ShowDocument(std::move(opened.document));
    const size_t warnings = opened.warnings.size();
    if (warnings == 1)
        ShowMessage("Opened with a warning: " + opened.warnings.front());
    else if (warnings > 1)
        ShowMessage("Opened with " + std::to_string(warnings) + " warnings; the first: " + opened.warnings.front());
    return true;
}

void ViewerFrame::ShowDocument(std::unique_ptr<ViewerDocument> document)
{
    // The view lets go of the old drawing before it is destroyed.
    m_view.Bind(nullptr);
    m_document = std::move(document);
    m_view.Bind(m_document.get());
    if (m_document)
        ShowMessage("Showing " + m_document->GetName() + ": " + std::to_string(m_document->GetDrawing().GetItemCount()) +
                    " items on " + std::to_string(m_document->GetDrawing().GetLayerCount()) + " layers.");
    UpdateTitle();
}

void ViewerFrame::UpdateTitle()
{
    const std::string title = m_document ? m_document->GetName() + " - " + ApplicationName : ApplicationName;
    SetWindowText(title.c_str());
}

// ---- commands -----------------------------------------------------------------------------

BOOL ViewerFrame::PreTranslateMessage(MSG* msg)
{
    // Keys become commands wherever the focus is inside the frame.
    if (m_accelerators && msg->message >= WM_KEYFIRST && msg->message <= WM_KEYLAST &&
        ::TranslateAcceleratorA(m_hWnd, m_accelerators, msg))
        return TRUE;
    return CWnd::PreTranslateMessage(msg);
}

LRESULT ViewerFrame::OnCommandMessage(WPARAM wParam, LPARAM lParam)
{
    // Menu items and accelerators only; notifications of child controls
    // carry their window in lParam.
    if (lParam != 0)
        return Default();
    using namespace ViewerCommands;
    switch (LOWORD(wParam)) {
    case FileOpen: OnFileOpen(); break;
    case FilePrint: Print(); break;
    case FileExport: OnFileExport(); break;
    case FileExit: DestroyWindow(); break;
    case ZoomIn: m_view.ZoomIn(); break;
    case ZoomOut: m_view.ZoomOut(); break;
    case ZoomToFit: m_view.ZoomToFit(); break;
    case UndoZoom: m_view.UndoZoom(); break;
    case ScrollLeft: m_view.Scroll(Tavo_WiScroll::Left, Tavo_WiScroll::Line); break;
    case ScrollRight: m_view.Scroll(Tavo_WiScroll::Right, Tavo_WiScroll::Line); break;
    case ScrollUp: m_view.Scroll(Tavo_WiScroll::Up, Tavo_WiScroll::Line); break;
    case ScrollDown: m_view.Scroll(Tavo_WiScroll::Down, Tavo_WiScroll::Line); break;
    case ScrollPageUp: m_view.Scroll(Tavo_WiScroll::Up, Tavo_WiScroll::Page); break;
    case ScrollPageDown: m_view.Scroll(Tavo_WiScroll::Down, Tavo_WiScroll::Page); break;
    default: return Default();
    }
    return 0;
}

void ViewerFrame::OnFileOpen()
{
    std::string path;
    if (!FileDialogs::AskOpenPath(m_hWnd, DrawingFilter, path))
        return;
    std::string error;
    if (!OpenFile(path, error))
        ::MessageBoxA(m_hWnd, error.c_str(), ApplicationName, MB_OK | MB_ICONWARNING);
}

ViewerPrinting::Result ViewerFrame::Print()
{
    const std::string title = m_document ? m_document->GetName() : std::string(ApplicationName);
    const auto askOutput = [this](std::string& path) {
        return FileDialogs::AskSavePath(m_hWnd, PostScriptFilter, "ps", path);
    };
    ViewerPrinting::Result result = ViewerPrinting::PrintView(m_view, this, title, m_printOutput, askOutput);
    ShowMessage(result.message);
    return result;
}

void ViewerFrame::OnFileExport()
{
    std::string path;
    if (!FileDialogs::AskSavePath(m_hWnd, PngFilter, "png", path))
        return;
    const std::string failure = ExportView(path);
    if (!failure.empty())
        ::MessageBoxA(m_hWnd, failure.c_str(), ApplicationName, MB_OK | MB_ICONWARNING);
}

std::string ViewerFrame::ExportView(const std::string& path)
{
    std::string failure = ExportViewPng(m_view, path);
    if (!failure.empty())
        failure = "Cannot export the view to " + path + ": " + failure + ".";
    ShowMessage(failure.empty() ? "Exported the view to " + path + "." : failure);
    return failure;
}

void ViewerFrame::ShowMessage(const std::string& text)
{
    if (::IsWindow(m_statusBar.GetSafeHwnd()))
        m_statusBar.SetPartText(ViewerStatusBar::Message, text);
}

// ---- layout and live resizing -----------------------------------------------------------------

void ViewerFrame::OnSize(UINT, int width, int height)
{
    if (!::IsWindow(m_statusBar.GetSafeHwnd()) || !::IsWindow(m_view.GetSafeHwnd()))
        return;
    const int barHeight = m_statusBar.Layout(width);
    CRect view(0, 0, width, std::max(0, height - barHeight));
    CRect now(0, 0, 0, 0);
    m_view.GetWindowRect(&now);
    ScreenToClient(&now);
    // The view takes a move as a new view and forgets its undo box: only a
    // real change of its rectangle is passed on.
    if (now != view)
        m_view.MoveWindow(&view);
}

void ViewerFrame::OnSetFocus(CWnd*)
{
    // The keys and the wheel belong to the view's scrollee.
    if (::IsWindow(m_view.GetScrollee()->GetSafeHwnd()))
        m_view.GetScrollee()->SetFocus();
}

BOOL ViewerFrame::OnMouseWheel(UINT flags, short delta, CPoint point)
{
    return m_view.OnMouseWheel(flags, delta, point);
}

LRESULT ViewerFrame::OnEnterSizeMove(WPARAM, LPARAM)
{
    m_view.OnEnterSizeMove();
    return Default();
}

LRESULT ViewerFrame::OnExitSizeMove(WPARAM, LPARAM)
{
    m_view.OnExitSizeMove();
    m_view.ShowZoom();
    return Default();
}
