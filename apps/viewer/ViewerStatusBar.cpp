#include "ViewerStatusBar.h"

#include <algorithm>

BOOL ViewerStatusBar::CreateBar(CWnd* parent, UINT id)
{
    // The bar places itself; the rectangle is only a placeholder.
    return CStatusBarCtrl::Create(WS_CHILD | WS_VISIBLE | SBARS_SIZEGRIP, CRect(0, 0, 0, 0), parent, id);
}

int ViewerStatusBar::Layout(int width)
{
    SendMessage(WM_SIZE, 0, 0);
    const int zoomLeft = std::max(0, width - ZoomWidth);
    int edges[PartCount] = {std::max(0, zoomLeft - PointerWidth), zoomLeft, -1};
    SetParts(PartCount, edges);
    CRect bar(0, 0, 0, 0);
    GetWindowRect(&bar);
    return bar.Height();
}

std::string ViewerStatusBar::PartText(const std::string& text)
{
    if (text.size() <= MaxPartLength)
        return text;
    return text.substr(0, MaxPartLength - 3) + "...";
}

void ViewerStatusBar::SetPartText(Part part, const std::string& text)
{
    // The control keeps its own copy of the text.
    SetText(PartText(text).c_str(), part, 0);
}

std::string ViewerStatusBar::GetPartText(Part part) const
{
    return std::string(static_cast<LPCSTR>(GetText(part)));
}
