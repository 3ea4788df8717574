// Tavo_GrSurface: the abstract surface a drawing is drawn onto.
//
// How a drawing calls its surface (Tavo_GrDrawing::Draw), in one pass:
//
//   1. ResetDrawingInterruptFlags()
//   2. the base state is set: the transform (Tavo_GrTransform; its first field,
//      the scale, is the number of device pixels per world unit, also given by
//      GetScale()) and the device height H (the mapping's device window height)
//   3. BeginDrawing(drawing): no current attribute any more, so the first
//      SetCurrentAttr of the pass always calls OnAttrChange
//   4. for every visible layer, in order: BeginLayer(layer), the items of the
//      layer that meet the clip, in the order they were added, EndLayer().
//      Item kinds go to: dot DrawDot, line DrawLine, polyline DrawPline,
//      polygon DrawPolygon, rectangle DrawRect (a normalised device rectangle),
//      circle DrawCircle (radius scaled and rounded), triangle DrawTriangle,
//      text at a point DrawText(text, point, attr), text in a box
//      DrawText(text, box, attr, fontHeight) with fontHeight the character
//      height in pixels (rounded, never below 0), calls DrawCall, DrawEHCall or
//      DrawEHSignalCall by the call's kind. The base call operations draw the
//      called drawing's items (without BeginLayer/EndLayer) through the same
//      surface with the transform moved by the call's offset.
//   5. Flush()
//   6. EndDrawing()
//
// Every drawing operation receives device coordinates with y pointing up from
// the bottom edge of the device window (a surface drawing with a downward y
// uses H - y) and the item's attribute. A surface applies the attribute by
// handing it to SetCurrentAttr, which makes it current, sets the hollow flag
// (fill 0: outlines only) and calls OnAttrChange when the attribute differs from
// the current one (always for the first after BeginDrawing or EndDrawing). So
// while an operation runs, after it has applied its attribute, the base state
// holds: the transform and scale of the pass, H, the attribute's colour, fill,
// character height and alignment (GetCurrent...), the hollow flag, the
// interrupted flag, and the settings (thickening gate, surface option,
// screen-paint flag, smallest text height), which the pass does not touch.
//
// Every 256 items (kPollInterval) the drawing calls PollDrawInterrupt, and it
// checks the interrupted flag after every item; once the flag is set it draws
// no further item, ends the open layer and goes on with Flush and EndDrawing.
//
// Derived surfaces override the drawing operations; overrides of OnAttrChange,
// Flush and EndDrawing call the base's. The base versions of the primitive
// operations only apply the attribute; DrawPline, DrawTriangle and DrawPolygon
// are expressed through the simpler operations, and the call operations draw
// the called drawing's items through this surface at the call's offset.
#pragma once

#include "Tavo_CoreApi.h"
#include "Tavo_GrAttr.h"
#include "Tavo_GrTransform.h"
#include "Tavo_GrTypes.h"

class Tavo_GrCall;
class Tavo_GrDrawing;
class Tavo_GrLayer;

// <windows.h> defines DrawText as a macro; the core's operation of that name
// must not be renamed by it.
#pragma push_macro("DrawText")
#undef DrawText

class TAVO_CORE_API Tavo_GrSurface {
public:
    static constexpr int kPollInterval = 256; // items between PollDrawInterrupt calls
    static constexpr int kMaxCallDepth = 16;  // calls nested deeper are not drawn

    Tavo_GrSurface();
    Tavo_GrSurface(const Tavo_GrSurface&) = delete;
    Tavo_GrSurface& operator=(const Tavo_GrSurface&) = delete;

    // ---- Overridables, in slot order --------------------------------------
    virtual void DrawCall(const Tavo_GrCall* call);                                // 0
    virtual void DrawEHCall(const Tavo_GrCall* call);                              // 1
    virtual void DrawEHSignalCall(const Tavo_GrCall* call);                        // 2
    virtual void DrawCircle(Tavo_GrDPoint& centre, int radius, Tavo_GrAttr* attr); // 3
    virtual void DrawDot(Tavo_GrDPoint& point, Tavo_GrAttr* attr);                 // 4
    virtual void DrawGrid(Tavo_GrDPoint& origin, Tavo_GrDPoint& step, Tavo_GrDPoint& extent,
                          Tavo_GrAttr* attr);                                         // 5
    virtual void DrawLine(Tavo_GrDPoint& from, Tavo_GrDPoint& to, Tavo_GrAttr* attr); // 6
    virtual void DrawPline(int count, Tavo_GrDPoint* points, Tavo_GrAttr* attr);      // 7
    virtual void DrawPolygon(int count, Tavo_GrDPoint* points, Tavo_GrAttr* attr);    // 8
    virtual void DrawRect(Tavo_GrDRect& rect, Tavo_GrAttr* attr);                     // 9
    virtual void DrawText(const char* text, Tavo_GrDRect& box, Tavo_GrAttr* attr,
                          unsigned int fontHeight);                                   // 10
    virtual void DrawText(const char* text, Tavo_GrDPoint& point, Tavo_GrAttr* attr); // 11
    virtual void DrawTriangle(Tavo_GrDPoint points[3], Tavo_GrAttr* attr);            // 12
    virtual void Flush();                                                             // 13
    virtual void OnAttrChange();                                                      // 14
    virtual void BeginDrawing(const Tavo_GrDrawing* drawing);                         // 15
    virtual void EndDrawing();                                                        // 16
    virtual void BeginLayer(const Tavo_GrLayer* layer);                               // 17
    virtual void EndLayer();                                                          // 18
    virtual bool PollDrawInterrupt();                                                 // 19
    virtual void ResetDrawingInterruptFlags();                                        // 20

    // ---- Current attribute ------------------------------------------------
    // Makes the attribute current; calls OnAttrChange when it differs from the
    // current one or when there is none (after construction, BeginDrawing and
    // EndDrawing). A null attribute stands for the default Tavo_GrAttr().
    void SetCurrentAttr(Tavo_GrAttr* attr);
    char GetCurrentColor() const { return m_currentAttr.GetColor(); }
    char GetCurrentFill() const { return m_currentAttr.GetFill(); }
    char GetCurrentTextAlign() const { return m_currentAttr.GetTextAlign(); }
    int GetCurrentCharHeight() const { return m_currentAttr.GetCharHeight(); }
    const Tavo_GrAttr& GetCurrentAttr() const { return m_currentAttr; }

    // ---- Base state ---------------------------------------------------------
    const Tavo_GrTransform& GetTransform() const { return m_transform; }
    double GetScale() const { return m_transform.GetScale(); }
    void SetTransform(const Tavo_GrTransform& transform) { m_transform = transform; }
    // Height in pixels of the device window, for flipping y.
    int GetDeviceHeight() const { return m_deviceHeight; }
    void SetDeviceHeight(int height) { m_deviceHeight = height; }
    // True while the current attribute draws outlines only (fill 0).
    bool IsHollow() const { return m_hollow; }
    bool IsDrawingInterrupted() const { return m_drawingInterrupted; }
    // Line thickening is allowed only while the gate is above 0 (default 1).
    double GetThickenGate() const { return m_thickenGate; }
    void SetThickenGate(double gate) { m_thickenGate = gate; }
    // An option for the surface from the drawing window (default 0).
    int GetSurfaceOption() const { return m_surfaceOption; }
    void SetSurfaceOption(int option) { m_surfaceOption = option; }
    // Whether the pass paints a window on screen (default false).
    bool IsScreenPaint() const { return m_screenPaint; }
    void SetScreenPaintFlag(int screenPaint) { m_screenPaint = screenPaint != 0; }
    // The smallest text height, in device pixels, the surface draws: text
    // whose character height scales to less is drawn this high (or as a line
    // no longer than that), so the pass looks that much further for text
    // beside the clip (Tavo_GrDrawing.h). Default 0: text is drawn at its
    // scaled height; a value below 0 counts as 0.
    int GetMinTextPixels() const { return m_minTextPixels; }
    void SetMinTextPixels(int pixels) { m_minTextPixels = pixels > 0 ? pixels : 0; }
    // The drawing of the pass in progress (null outside BeginDrawing/EndDrawing).
    const Tavo_GrDrawing* GetDrawing() const { return m_drawing; }

protected:
    ~Tavo_GrSurface() = default;

    void SetDrawingInterruptedFlag() { m_drawingInterrupted = true; }

private:
    friend class Tavo_GrDrawing;

    Tavo_GrTransform m_transform;
    int m_deviceHeight = 0;
    bool m_hollow = true;
    bool m_drawingInterrupted = false;
    double m_thickenGate = 1.0;
    int m_surfaceOption = 0;
    bool m_screenPaint = false;
    int m_minTextPixels = 0;

    Tavo_GrAttr m_currentAttr;
    bool m_hasCurrentAttr = false;
    const Tavo_GrDrawing* m_drawing = nullptr; // not owned

    // Pass bookkeeping kept by Tavo_GrDrawing: the world rectangle items must
    // meet (in the coordinates of the drawing being visited), whether there is
    // one, the depth of nested calls and the items since the last poll.
    Tavo_GrWRect m_worldClip;
    bool m_hasWorldClip = false;
    int m_callDepth = 0;
    int m_itemsSincePoll = 0;
};

#pragma pop_macro("DrawText")
