// ViewerStatusBar: the frame's status bar, in three parts: a message (what a
// click found, what opening or printing did), the pointer's position in
// drawing units and the zoom.
#pragma once

#include <afxcmn.h>

#include <string>

class ViewerStatusBar : public CStatusBarCtrl {
public:
    enum Part {
        Message = 0,
        Pointer = 1,
        Zoom = 2,
        PartCount = 3
    };
    // Widths of the fixed parts, in pixels; the message takes the rest.
    static constexpr int PointerWidth = 280;
    static constexpr int ZoomWidth = 190;
    // The most characters a part holds; longer texts are cut and end in
    // "...". Far more than a part shows, and a bound on what a reader of
    // the bar (SB_GETTEXT has no buffer size) must make room for.
    static constexpr size_t MaxPartLength = 255;

    BOOL CreateBar(CWnd* parent, UINT id);
    // Places the bar along the parent's bottom edge and divides it for a
    // parent client area width pixels wide; returns the bar's height.
    int Layout(int width);
    void SetPartText(Part part, const std::string& text);
    // text as a part holds it: cut to MaxPartLength characters.
    static std::string PartText(const std::string& text);
    std::string GetPartText(Part part) const;
};
