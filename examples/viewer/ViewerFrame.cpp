#include "ViewerFrame.h"

namespace {

constexpr UINT kViewId = 1;
constexpr int kWidth = 900;
constexpr int kHeight = 650;

} // namespace

BEGIN_MESSAGE_MAP(ViewerFrame, CWnd)
    ON_WM_SIZE()
    ON_WM_SETFOCUS()
    ON_MESSAGE(WM_ENTERSIZEMOVE, &ViewerFrame::OnEnterSizeMove)
    ON_MESSAGE(WM_EXITSIZEMOVE, &ViewerFrame::OnExitSizeMove)
END_MESSAGE_MAP()

BOOL ViewerFrame::CreateFrame(const char* title, Tavo_GrDrawing* drawing)
{
    // A null class name takes the framework's default window class.
    if (!CreateEx(0, nullptr, title, WS_OVERLAPPEDWINDOW | WS_CLIPCHILDREN, CW_USEDEFAULT, CW_USEDEFAULT, kWidth,
                  kHeight, nullptr, nullptr))
        return FALSE;
    CRect client;
    GetClientRect(&client);
    return m_view.CreateView(this, client, kViewId, drawing);
}

void ViewerFrame::OnSize(UINT, int width, int height)
{
    if (m_view.GetSafeHwnd() != nullptr)
        m_view.MoveWindow(0, 0, width, height);
}

// Keyboard focus and the wheel belong to the view's scrollee.
void ViewerFrame::OnSetFocus(CWnd*)
{
    if (m_view.GetScrollee() != nullptr)
        m_view.GetScrollee()->SetFocus();
}

LRESULT ViewerFrame::OnEnterSizeMove(WPARAM, LPARAM)
{
    m_view.OnEnterSizeMove();
    return 0;
}

LRESULT ViewerFrame::OnExitSizeMove(WPARAM, LPARAM)
{
    m_view.OnExitSizeMove();
    return 0;
}
