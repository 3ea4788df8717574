// Tavo_GrTransform: world to device and back.
#include "Tavo_GrTransform.h"

#include "Tavo_GrRound.h"

#include <algorithm>

Tavo_GrTransform::Tavo_GrTransform(double scale, double xOrigin, double yOrigin, double xError, double yError)
    : m_scale(scale > 0.0 ? scale : 1.0), m_xOrigin(xOrigin), m_yOrigin(yOrigin), m_xError(xError), m_yError(yError)
{
}

int Tavo_GrTransform::xcoord(int worldX) const
{
    return Tavo_GrRound((worldX - m_xOrigin) * m_scale + m_xError);
}

int Tavo_GrTransform::ycoord(int worldY) const
{
    return Tavo_GrRound((worldY - m_yOrigin) * m_scale + m_yError);
}

Tavo_GrDPoint Tavo_GrTransform::Point(const Tavo_GrWPoint& world) const
{
    return {xcoord(world.x), ycoord(world.y)};
}

Tavo_GrDRect Tavo_GrTransform::Rect(const Tavo_GrWRect& world) const
{
    const int xa = xcoord(world.x1);
    const int xb = xcoord(world.x2);
    const int ya = ycoord(world.y1);
    const int yb = ycoord(world.y2);
    return {std::min(xa, xb), std::min(ya, yb), std::max(xa, xb), std::max(ya, yb)};
}

int Tavo_GrTransform::Length(int worldLength) const
{
    return Tavo_GrRound(worldLength * m_scale);
}

int Tavo_GrTransform::Invertxcoord(int deviceX) const
{
    return Tavo_GrRound(m_xOrigin + (deviceX - m_xError) / m_scale);
}

int Tavo_GrTransform::Invertycoord(int deviceY) const
{
    return Tavo_GrRound(m_yOrigin + (deviceY - m_yError) / m_scale);
}

Tavo_GrWPoint Tavo_GrTransform::InvertPoint(const Tavo_GrDPoint& device) const
{
    return {Invertxcoord(device.x), Invertycoord(device.y)};
}

Tavo_GrWRect Tavo_GrTransform::InvertRect(const Tavo_GrDRect& device) const
{
    const int xa = Invertxcoord(device.xmin);
    const int xb = Invertxcoord(device.xmax);
    const int ya = Invertycoord(device.ymin);
    const int yb = Invertycoord(device.ymax);
    return {std::min(xa, xb), std::min(ya, yb), std::max(xa, xb), std::max(ya, yb)};
}

Tavo_GrTransform Tavo_GrTransform::Translated(int dx, int dy) const
{
    Tavo_GrTransform moved = *this;
    moved.m_xOrigin -= dx;
    moved.m_yOrigin -= dy;
    return moved;
}
