// The application side of the soak: a drawing window as an application
// derives it, and a top-level window around it that behaves like a frame.
//
// SoakDrawWnd paints and prints through surfaces of its own, counts what the
// window tells the application, lets the caller choose what a drag does and
// what a data tip says, and runs the caller's actions from inside a paint or
// a drag move (to destroy the window there, or take the capture away).
//
// SoakHost is a shown top-level window whose client area the drawing window
// fills, as a frame's view does: it lays it out on every WM_SIZE (minimised
// too), passes WM_ENTERSIZEMOVE and WM_EXITSIZEMOVE on, and turns the arrow,
// page and Home/End keys into scrolls.
#pragma once

#include <afxwin.h>

#include "Tavo_WiDrawWnd.h"
#include "Tavo_WiNativeWindowSurface.h"
#include "Tavo_WiWin32Surface.h"

#include <functional>

class SoakDrawWnd : public Tavo_WiDrawWnd {
public:
    struct Counts {
        int clicks = 0;
        int doubleClicks = 0;
        int rubberRectangles = 0;
        int dragAndDrops = 0;
        int dataTipQuestions = 0;
        int paints = 0; // passes of the paint path that reached the drawing
    };

    Counts counts;
    DragAction dragAction = Pan;
    CString dataTipText = "tip";
    bool printsWithSurface = true;
    Tavo_GrWRect lastRubberRectangle;
    // Run at each paint pass before the drawing, and after each drag move.
    std::function<void()> onPaint;
    std::function<void()> onDragMove;

    Tavo_WiNativeWindowSurface* GetNativeWindowSurface() override { return &m_surface; }
    Tavo_WiWin32Surface* GetPrintSurface() override { return printsWithSurface ? &m_printSurface : nullptr; }
    void OnDragMove(UINT button, UINT flags, const CPoint& point) override;

protected:
    using Tavo_WiDrawWnd::OnDraw;
    void OnDraw(Tavo_WiScrollee* scrollee, CDC* dc, Tavo_GrDrawing* drawing, Tavo_WiNativeWindowSurface* surface,
                Tavo_GrMapping* mapping, Tavo_GrDRect& rect) override;
    using Tavo_WiDrawWnd::GetDataTipText;
    using Tavo_WiDrawWnd::OnClick;
    using Tavo_WiDrawWnd::OnDoubleClick;
    void OnClick(UINT, UINT, const Tavo_GrWRect&) override { ++counts.clicks; }
    void OnDoubleClick(UINT, UINT, const Tavo_GrWRect&) override { ++counts.doubleClicks; }
    DragAction GetDragAction(UINT, UINT, const CPoint&) override { return dragAction; }
    void OnRubberRectangle(UINT, UINT, const Tavo_GrWRect& rect) override;
    void DoDragAndDrop(UINT, UINT, const CPoint&) override { ++counts.dragAndDrops; }
    CString GetDataTipText(const Tavo_GrWRect&) override;

private:
    Tavo_WiNativeWindowSurface m_surface;
    Tavo_WiWin32Surface m_printSurface;
};

class SoakHost {
public:
    // A shown, activated top-level window at a screen rectangle.
    explicit SoakHost(const CRect& screenRect);
    ~SoakHost();
    SoakHost(const SoakHost&) = delete;
    SoakHost& operator=(const SoakHost&) = delete;

    HWND Handle() const { return m_hwnd; }
    SoakDrawWnd& Wnd() { return m_drawWnd; }
    HWND DrawWnd() const { return m_drawWnd.GetSafeHwnd(); }
    HWND Scrollee() { return m_drawWnd.GetScrollee()->GetSafeHwnd(); }
    // Whether the drawing window still exists (a fault may destroy it).
    bool IsAlive() const { return ::IsWindow(m_drawWnd.GetSafeHwnd()) != FALSE; }
    // Brings the window to the front and makes it the active, focused one.
    void Activate();

    // The windows one host makes: itself, the drawing window with its
    // scrollee, two bars and corner, the parked cursor monitor and the data tip.
    static constexpr int WindowCount = 8;

private:
    static LRESULT CALLBACK Proc(HWND hwnd, UINT message, WPARAM wParam, LPARAM lParam);
    void FillClientArea();
    void ScrollByKey(WPARAM key);

    HWND m_hwnd = nullptr;
    CWnd m_wnd; // the framework's view of the host, as the drawing window's parent
    SoakDrawWnd m_drawWnd;
};
