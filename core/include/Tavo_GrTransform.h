// Tavo_GrTransform: the world-to-device transform of a mapping.
//
//   device x = (world x - xOrigin) * scale + xError
//   device y = (world y - yOrigin) * scale + yError
//
// rounded half away from zero and saturated into int range (Tavo_GrRound).
// Both axes point up: the device origin is the bottom-left corner of the
// device window. The scale is the number of device pixels per world unit and
// is always above 0; it is the first field of the record, so surfaces that
// keep a transform read their scale from there.
//
// The error terms are the amounts, in device pixels, by which what is on the
// device differs from the exact transform: after the pixels of a window have
// been scrolled by a whole number of pixels for a world movement that is not a
// whole number of pixels, the mapping records the difference so that later
// drawing lines up with the scrolled pixels (Tavo_GrMapping::SetErrorTerms).
#pragma once

#include "Tavo_CoreApi.h"
#include "Tavo_GrTypes.h"

class TAVO_CORE_API Tavo_GrTransform {
public:
    Tavo_GrTransform() = default;
    Tavo_GrTransform(double scale, double xOrigin, double yOrigin, double xError = 0.0, double yError = 0.0);

    double GetScale() const { return m_scale; }
    double GetXOrigin() const { return m_xOrigin; }
    double GetYOrigin() const { return m_yOrigin; }
    double GetXError() const { return m_xError; }
    double GetYError() const { return m_yError; }

    // World to device.
    int xcoord(int worldX) const;
    int ycoord(int worldY) const;
    Tavo_GrDPoint Point(const Tavo_GrWPoint& world) const;
    // A normalised device rectangle holding both corners of the world rectangle.
    Tavo_GrDRect Rect(const Tavo_GrWRect& world) const;
    // A world length in device pixels (never negative for a non-negative length).
    int Length(int worldLength) const;

    // Device to world.
    int Invertxcoord(int deviceX) const;
    int Invertycoord(int deviceY) const;
    Tavo_GrWPoint InvertPoint(const Tavo_GrDPoint& device) const;
    // A normalised world rectangle holding both corners of the device rectangle.
    Tavo_GrWRect InvertRect(const Tavo_GrDRect& device) const;

    // The same transform with world coordinates moved by (dx, dy): what this
    // transform shows at (x + dx, y + dy), the result shows at (x, y). Used to
    // draw a called drawing at its offset.
    Tavo_GrTransform Translated(int dx, int dy) const;

private:
    friend class Tavo_GrMapping;

    double m_scale = 1.0; // first field: device pixels per world unit
    double m_xOrigin = 0.0;
    double m_yOrigin = 0.0;
    double m_xError = 0.0;
    double m_yError = 0.0;
};
