// Tavo_GrMapping: how a drawing is shown in a device window.
// Tavo_GrZoom:    the zoom types a mapping understands.
//
// Zoom model
// ----------
// A mapping shows its drawing in a device window of w x h pixels through a
// transform (Tavo_GrTransform) of scale S device pixels per world unit.
//
// * Zero level. The drawing's bounds, enlarged on every side by the zero-level
//   expansion (a percentage of the bounds' width and height, default 0), are
//   fitted into the device window and centred in it:
//       S0 = min(w / expanded width, h / expanded height).
//   A bounds side of length 0 counts as 1 world unit. Level 0 always shows this
//   fit, whatever centre a zoom is given.
// * Levels. The construction argument n is the number of zoom levels per
//   doubling of the scale: one level multiplies the scale by 2^(1/n), and the
//   scale at level L is S0 * 2^(L/n). With n = 5, five levels in zoom double the
//   scale. An argument below 1 counts as 1.
// * The real zoom level is L itself (a double, 0 at the zero level, never below
//   0 after a zoom); the integer zoom level is the smallest integer not below
//   it. The typed zooms reach whole levels, where the two agree; zooming to a
//   rectangle (GetEnclosingZoomLevel) or fitting a world clip box reaches levels
//   in between. Readers that take the smaller of the two read L.
// * Largest zoom. Levels are limited to the maximum zoom level (default 10 * n)
//   and further so that the world clip box never becomes narrower or lower than
//   the largest-zoom world clip box size (SetMaxZoomWorldClipBoxSize; 0 on an
//   axis: no limit on that axis), and so that the scale never exceeds kMaxScale:
//   there one world unit spans the whole int range of device pixels, every
//   device coordinate but one saturates, and nothing more can be shown (an
//   absurd maximum level would otherwise take the scale to infinity). The
//   limits from the box and the scale may be levels between whole levels.
// * Zoom types (Tavo_GrZoom::Type), for Zoom(type, x, y, amount) and
//   ChangesZoomLevel(type, amount):
//       ZeroLevel (-2)  go to level 0: the fit; amount and centre are ignored
//       Out       (-1)  amount levels out (L - amount)
//       Keep       (0)  keep the level; only re-centre on (x, y)
//       In         (1)  amount levels in (L + amount)
//       ToLevel    (2)  go to level amount
//   Any other value behaves as Keep. The result is limited to 0 ... largest
//   zoom. At every level above 0 the world point (x, y) becomes the centre of
//   the device window.
// * Window size. SetDeviceWindowSize with the force flag, or at the zero
//   level, keeps the zoom level: the scale follows the new zero-level fit and the
//   view is centred on the given world point (else on the middle of the current
//   view). Without the force flag and above the zero level it keeps the scale
//   and the world point at the top-left corner: the window shows more or less of
//   the drawing, and the real level follows the scale (when that would bring it
//   to 0 or below, the view becomes the zero level; above the largest zoom, the
//   scale becomes the largest zoom's, the top-left corner still staying).
// * Panning. PanTo(p) moves the view, at the same scale, so that the world
//   point p is at the top-left corner of the device window (where a scroll
//   window's scroll position is).
// * World clip box. GetWorldClipBox is the world rectangle the whole device
//   window shows (the inversion of the device rectangle (0, 0, w, h)).
//   SetWorldClipBox with a rectangle of the same width and height as the current
//   clip box moves the view by the difference and keeps the scale and the error
//   terms; any other rectangle is fitted into the device window and centred in
//   it (the error terms are cleared), and the real level follows the new scale.
// * Error terms: see Tavo_GrTransform. They are cleared whenever the scale is set
//   anew (zooms, fits) and kept by pans.
//
// A mapping never owns its drawing. It may be copied (a print pass draws
// through a copy sized to the page).
#pragma once

#include "Tavo_CoreApi.h"
#include "Tavo_GrTransform.h"
#include "Tavo_GrTypes.h"

class Tavo_GrDrawing;

struct Tavo_GrZoom {
    enum Type {
        ZeroLevel = -2,
        Out = -1,
        Keep = 0,
        In = 1,
        ToLevel = 2,
    };
};

class TAVO_CORE_API Tavo_GrMapping {
public:
    static constexpr int kDefaultMaxZoomLevelsPerStep = 10; // default max level = 10 * n
    static constexpr double kMaxScale = 2147483647.0;       // device pixels per world unit at most

    // drawing: shown, not owned (null: an empty drawing). levelsPerDoubling: n above.
    Tavo_GrMapping(const Tavo_GrDrawing* drawing, int levelsPerDoubling);

    // ---- Device window ---------------------------------------------------
    // Returns non-zero when the size changed or force was given.
    int SetDeviceWindowSize(int width, int height, bool force, const Tavo_GrWPoint* centre);
    int GetDeviceWindowWidth() const { return m_deviceWidth; }
    int GetDeviceWindowHeight() const { return m_deviceHeight; }
    // The device point at the middle of the device window.
    Tavo_GrDPoint GetDeviceWindowCentre() const;

    // ---- View ------------------------------------------------------------
    Tavo_GrWRect GetWorldClipBox() const;
    // Returns non-zero when the view changed.
    int SetWorldClipBox(const Tavo_GrWRect& box);
    int PanTo(const Tavo_GrWPoint& topLeft);

    // ---- Zoom ------------------------------------------------------------
    // Both return non-zero when the view (scale or position) changed.
    int Zoom(Tavo_GrZoom::Type type, int x, int y, int amount);
    int Zoom(double level, int x, int y);
    // Whether Zoom(type, ..., amount) would change the zoom level.
    bool ChangesZoomLevel(Tavo_GrZoom::Type type, int amount) const;
    // The largest level (limited to 0 ... largest zoom) at which the whole
    // rectangle fits into the device window; a whole level when one lies
    // within one world unit of the rectangle (so the clip box read at a whole
    // level, rounded to whole units, gives back that level).
    double GetEnclosingZoomLevel(const Tavo_GrWRect& rect) const;

    int GetZoomLevel() const { return m_zoomLevel; }
    double GetRealZoomLevel() const { return m_realZoomLevel; }
    int GetLevelsPerDoubling() const { return m_levelsPerDoubling; }

    void SetMaxZoomLevel(int level);
    int GetMaxZoomLevel() const { return m_maxZoomLevel; }
    void SetMaxZoomWorldClipBoxSize(unsigned int width, unsigned int height);
    void SetZeroLevelExpansion(int percent);
    int GetZeroLevelExpansion() const { return m_zeroLevelExpansion; }

    // ---- Transform and error terms ---------------------------------------
    const Tavo_GrTransform& GetTransform() const { return m_transform; }
    void SetErrorTerms(double xError, double yError);
    double GetXErrorTerm() const { return m_transform.m_xError; }
    double GetYErrorTerm() const { return m_transform.m_yError; }

    const Tavo_GrDrawing* GetDrawing() const { return m_drawing; }

private:
    double ZeroLevelScale() const;
    double ScaleOfLevel(double level) const;
    double LevelOfScale(double scale) const;
    double LargestLevel() const;
    double LimitLevel(double level) const;
    double TargetLevel(Tavo_GrZoom::Type type, int amount) const;
    Tavo_GrWRect FittedBounds() const;
    Tavo_GrWPoint ViewCentre() const;
    // Sets the level and the scale of it, and centres the view on (x, y) (on the
    // fitted bounds at the zero level). Returns non-zero when the view changed.
    int ApplyLevel(double level, double x, double y);
    void CentreOn(double x, double y);
    void SetRealLevel(double level);

    const Tavo_GrDrawing* m_drawing = nullptr; // not owned
    int m_levelsPerDoubling = 1;
    Tavo_GrTransform m_transform;
    int m_deviceWidth = 0;
    int m_deviceHeight = 0;
    int m_zoomLevel = 0;
    double m_realZoomLevel = 0.0;
    int m_maxZoomLevel = 0;
    unsigned int m_maxClipWidth = 0;
    unsigned int m_maxClipHeight = 0;
    int m_zeroLevelExpansion = 0;
};
