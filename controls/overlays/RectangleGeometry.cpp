#include "overlays/RectangleGeometry.h"

#include <algorithm>
#include <cmath>

namespace Orbane {

namespace {

constexpr float64 kDegrees = 3.14159265358979323846 / 180.0;
// A pivot this close to the dragged side leaves no length to scale by.
constexpr float64 kMinLever = 1e-9;

bool Finite(OrbPoint p) noexcept
{
    return std::isfinite(p.x) && std::isfinite(p.y);
}

} // namespace

RectangleFrame::RectangleFrame(const RectangleShape &s, int32 imageWidth, int32 imageHeight,
                               float64 pixelAspect) noexcept
    : mCenter(s.center), mAxis(s.axis)
{
    const float64 aspect = pixelAspect > 0.0 && std::isfinite(pixelAspect) ? pixelAspect : 1.0;
    mUnit = std::max(imageWidth, 1) * aspect;
    mPixels = OrbPoint(mUnit, std::max(imageHeight, 1));
    mCos = std::cos(s.angle * kDegrees);
    mSin = std::sin(s.angle * kDegrees);
    mFlip = OrbPoint(s.flipX ? -1.0 : 1.0, s.flipY ? -1.0 : 1.0);
    const OrbPoint drawn(s.width * s.size * s.displayScale.x, s.height * s.size * s.displayScale.y);
    mHalf = drawn * (0.5 * mUnit);
    mMiddle = OrbPoint((0.5 - s.axis.x) * 2.0 * mHalf.x, (0.5 - s.axis.y) * 2.0 * mHalf.y);
    mValid = Finite(mCenter) && Finite(mAxis) && std::isfinite(s.angle) && Finite(mHalf) && Finite(mMiddle);
}

OrbPoint RectangleFrame::ToFrame(OrbPoint image) const noexcept
{
    const OrbPoint d = (image - mCenter).Mul(mPixels);
    return OrbPoint(d.x * mCos + d.y * mSin, -d.x * mSin + d.y * mCos).Mul(mFlip);
}

OrbPoint RectangleFrame::ToImage(OrbPoint frame) const noexcept
{
    const OrbPoint f = frame.Mul(mFlip);
    return OrbPoint(f.x * mCos - f.y * mSin, f.x * mSin + f.y * mCos).Div(mPixels) + mCenter;
}

OrbPoint RectangleFrame::At(float64 u, float64 v) const noexcept
{
    return ToImage(mMiddle + OrbPoint(u * mHalf.x, v * mHalf.y));
}

OrbPoint RectangleTolerance(float64 pickTolerance, OrbPoint viewScale) noexcept
{
    auto per = [pickTolerance](float64 scale) { return scale > 0.0 ? pickTolerance / scale : pickTolerance; };
    return OrbPoint(per(viewScale.x), per(viewScale.y));
}

float64 RectangleCornerRadius(OrbPoint half, float64 cornerRound) noexcept
{
    return cornerRound * std::min(std::fabs(half.x), std::fabs(half.y));
}

int32 RectangleSideX(int32 part) noexcept
{
    return (part & RPART_PlusX) ? 1 : (part & RPART_MinusX) ? -1 : 0;
}

int32 RectangleSideY(int32 part) noexcept
{
    return (part & RPART_PlusY) ? 1 : (part & RPART_MinusY) ? -1 : 0;
}

OrbPoint RectangleGrabOffset(OrbPoint local, int32 part, OrbPoint half, float64 cornerRound) noexcept
{
    const int32 sx = RectangleSideX(part), sy = RectangleSideY(part);
    // A rounded corner is grabbed on its arc, not at the square corner.
    const float64 pull = sx && sy ? (1.0 - std::sqrt(0.5)) * RectangleCornerRadius(half, cornerRound) : 0.0;
    const float64 dx = sx ? sx * (std::fabs(half.x) - pull) - local.x : 0.0;
    const float64 dy = sy ? sy * (std::fabs(half.y) - pull) - local.y : 0.0;
    return OrbPoint(dx, dy);
}

bool RectangleResizedSide(float64 pivotLocal, float64 middleLocal, float64 axis, int32 sideBits, float64 unit,
                          float64 &length) noexcept
{
    if (!sideBits || !(unit > 0.0))
        return false;
    // Outside the rectangle both sides lie on one side of the pivot, so the
    // side is the one the mouse is nearer to, seen from the middle.
    const bool outside = axis < 0.0 || axis > 1.0;
    const float64 side = outside ? (middleLocal >= 0.0 ? 0.5 : -0.5) : 0.5 * sideBits;
    const float64 lever = std::fabs(side - (axis - 0.5));
    if (lever < kMinLever || !std::isfinite(lever) || !std::isfinite(pivotLocal))
        return false;
    length = std::fabs(pivotLocal / unit) / lever;
    return std::isfinite(length);
}

OrbPoint RectangleLockedSize(float64 width, float64 height, float64 aspect) noexcept
{
    const float64 w = std::max(height * aspect, width);
    return OrbPoint(w, w / aspect);
}

} // namespace Orbane
