// Shared helpers of the drawing-window tests: a drawing window that paints
// through a real GDI surface and records what it tells the application, a
// host window around it, and small drawings built in code.
#pragma once

#include "scroll_test_support.h"

#include "Tavo_GrDrawing.h"
#include "Tavo_GrDrawingBuilder.h"
#include "Tavo_WiDrawWnd.h"

#include <functional>
#include <ostream>
#include <string>
#include <vector>

namespace DrawWndTest {

// A drawing window with its own on-screen surface (switched off with
// useSurface) that notes the application notifications it receives, and the
// ends of drags.
class TestDrawWnd : public Tavo_WiDrawWnd {
public:
    struct Note {
        std::string name;
        UINT button = 0;
        UINT flags = 0;
        Tavo_GrWRect rect;
        HWND capture = nullptr; // the window holding the mouse capture at the call
    };

    Tavo_WiNativeWindowSurface surface;
    bool useSurface = true;
    Tavo_WiWin32Surface* printSurface = nullptr; // handed out by GetPrintSurface; not owned
    std::vector<Note> notes;
    DragAction dragAction = Pan;
    CString dataTipText;
    int paints = 0;                // passes of the full paint path that reached the drawing
    Tavo_GrDRect lastPaintRect;    // the device rectangle the last of them repainted
    std::function<void()> onPaint; // run at each of those passes, before the drawing

    Tavo_WiNativeWindowSurface* GetNativeWindowSurface() override { return useSurface ? &surface : nullptr; }
    Tavo_WiWin32Surface* GetPrintSurface() override { return printSurface; }

    // The protected and private parts the tests drive directly.
    using Tavo_WiDrawWnd::GetScrollDeviceDeltas;
    using Tavo_WiDrawWnd::SetDragScrollingFlag;

    // Noted as "DragEnd" with the button, the flags and the point (as a
    // one-point rectangle); then the window's own handling.
    void OnDragEnd(UINT button, UINT flags, const CPoint& point, int completed) override
    {
        Note("DragEnd", button, flags, Tavo_GrWRect{point.x, point.y, point.x, point.y});
        Tavo_WiDrawWnd::OnDragEnd(button, flags, point, completed);
    }

protected:
    void OnDraw(Tavo_WiScrollee* scrollee, CDC* dc, Tavo_GrDrawing* drawing, Tavo_WiNativeWindowSurface* s,
                Tavo_GrMapping* mapping, Tavo_GrDRect& rect) override
    {
        ++paints;
        lastPaintRect = rect;
        if (onPaint)
            onPaint();
        Tavo_WiDrawWnd::OnDraw(scrollee, dc, drawing, s, mapping, rect);
    }
    using Tavo_WiDrawWnd::OnDraw;
    void OnClick(UINT button, UINT flags, const Tavo_GrWRect& rect) override { Note("Click", button, flags, rect); }
    void OnDoubleClick(UINT button, UINT flags, const Tavo_GrWRect& rect) override
    {
        Note("DoubleClick", button, flags, rect);
    }
    using Tavo_WiDrawWnd::OnClick;
    using Tavo_WiDrawWnd::OnDoubleClick;
    DragAction GetDragAction(UINT, UINT, const CPoint&) override { return dragAction; }
    void OnRubberRectangle(UINT button, UINT flags, const Tavo_GrWRect& rect) override
    {
        Note("RubberRectangle", button, flags, rect);
    }
    void DoDragAndDrop(UINT button, UINT flags, const CPoint& point) override
    {
        Note("DragAndDrop", button, flags, Tavo_GrWRect{point.x, point.y, point.x, point.y});
    }
    CString GetDataTipText(const Tavo_GrWRect& rect) override
    {
        Note("DataTipText", 0, 0, rect);
        return dataTipText;
    }
    using Tavo_WiDrawWnd::GetDataTipText;

private:
    void Note(const char* name, UINT button, UINT flags, const Tavo_GrWRect& rect)
    {
        notes.push_back({name, button, flags, rect, ::GetCapture()});
    }
};

// A shown top-level host with a drawing window filling a client rectangle.
struct HostedDrawWnd {
    explicit HostedDrawWnd(const CRect& clientRect = CRect(0, 0, 500, 400),
                           const CRect& hostRect = CRect(50, 50, 650, 550));
    ~HostedDrawWnd();

    HWND Scrollee() { return wnd.GetScrollee()->GetSafeHwnd(); }
    CSize ScrolleeSize();

    ScrollTest::TestWindow host;
    TestDrawWnd wnd;
};

// Palette indices of the built-in colours the tests draw with.
constexpr char White = 7;
constexpr char Red = 4;
constexpr char Blue = 1;

// A filled rectangle of the given colour covering the world rectangle, in a
// new layer of drawing.
void AddFilledRect(Tavo_GrDrawing& drawing, const Tavo_GrWRect& rect, char colour);

// Paints every pending update of the window at once.
void PaintNow(HWND window);

// The bounding box of a window's pending update region, in its client
// coordinates; empty when nothing waits to be painted.
CRect PendingUpdate(HWND window);

// A window's client area as on screen, row by row from the top, 0x00RRGGBB.
struct ClientPicture {
    int width = 0;
    int height = 0;
    std::vector<unsigned int> pixels;

    unsigned int At(int x, int y) const { return pixels[static_cast<size_t>(y) * width + x]; }
};
ClientPicture Snapshot(HWND window);
// How many pixels of two pictures of the same size differ (all of them when
// the sizes differ).
long DifferingPixels(const ClientPicture& a, const ClientPicture& b);

} // namespace DrawWndTest

inline void PrintTo(const Tavo_GrWRect& r, std::ostream* out)
{
    *out << "(" << r.x1 << ", " << r.y1 << ", " << r.x2 << ", " << r.y2 << ")";
}
inline void PrintTo(const CSize& s, std::ostream* out)
{
    *out << s.cx << " x " << s.cy;
}
inline void PrintTo(const Tavo_GrDRect& r, std::ostream* out)
{
    *out << "(" << r.xmin << ", " << r.ymin << ", " << r.xmax << ", " << r.ymax << ")";
}
