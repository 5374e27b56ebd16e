#include "orbane/PreviewInfo.h"

#include <algorithm>
#include <cmath>

namespace Orbane {

namespace {

int32 roundedSpan(float64 span)
{
    // A divisor: never 0, even for an image zoomed down to nothing.
    return std::max<int32>(1, int32(std::lround(span)));
}

} // namespace

PreviewInfo::PreviewInfo()
{
    SetMapping(ViewMapping());
}

void PreviewInfo::SetMapping(const ViewMapping &mapping)
{
    mMapping = mapping;
    ViewWidth = roundedSpan(mapping.SpanX());
    ViewHeight = roundedSpan(mapping.SpanY());
    ImageWidth = mapping.ImageWidth();
    ImageHeight = mapping.ImageHeight();
}

void PreviewInfo::SetMouseFromViewer(OrbPoint viewer)
{
    OrbPoint image = TransformIn(viewer);
    MouseX = image.x;
    MouseY = image.y;
}

void PreviewInfo::TransformOut(float64 &x, float64 &y, float64 &z) const
{
    OrbPoint p = TransformOut(x, y);
    x = p.x;
    y = p.y;
    z *= mMapping.SpanX();
}

void PreviewInfo::TransformIn(float64 &x, float64 &y, float64 &z) const
{
    OrbPoint p = TransformIn(x, y);
    x = p.x;
    y = p.y;
    z /= mMapping.SpanX();
}

OrbRect PreviewInfo::TransformOut(const OrbRect &r) const
{
    return OrbRect(TransformOut(r.Corner1()), TransformOut(r.Corner2()));
}

OrbRect PreviewInfo::TransformIn(const OrbRect &r) const
{
    return OrbRect(TransformIn(r.Corner1()), TransformIn(r.Corner2()));
}

Graphics::GColor PreviewInfo::GetColor(OrbColor c) const
{
    return Graphics::GColor::FromOrb(c.IsNone() ? OverlayColor : c);
}

Graphics::GColor PreviewInfo::GetShadow(OrbColor c) const
{
    Graphics::GColor shadow = Graphics::GColor::FromOrb(ShadowColor);
    return c.IsNone() ? shadow : shadow.Faded(c.A() / 255.0f);
}

void PreviewInfo::SetCursor(const QCursor *cursor) const
{
    if (mCursorHandler)
        mCursorHandler(cursor);
}

} // namespace Orbane
