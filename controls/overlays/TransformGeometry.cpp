#include "overlays/TransformGeometry.h"

#include <cmath>

namespace Orbane {

namespace {

constexpr float64 kDegrees = M_PI / 180.0;
// A reach or height this short (aspect units) cannot be scaled or sheared
// by: the division would throw the value far off.
constexpr float64 kTiny = 1e-9;

bool Finite(OrbPoint p) noexcept
{
    return std::isfinite(p.x) && std::isfinite(p.y);
}

} // namespace

TransformFrame::TransformFrame(const TransformShape &shape, float64 yPerX) noexcept : mShape(shape), mYPerX(yPerX)
{
    const float64 a = std::fmod(shape.angle, 360.0) * kDegrees;
    mCos = std::cos(a);
    mSin = std::sin(a);
    mValid = Finite(shape.center) && Finite(shape.pivot) && Finite(shape.size) && Finite(shape.frame) &&
             std::isfinite(shape.angle) && std::isfinite(shape.shear) && std::isfinite(yPerX) && yPerX > 0.0 &&
             shape.size.x != 0.0 && shape.size.y != 0.0 && shape.frame.x != 0.0 && shape.frame.y != 0.0;
}

OrbPoint TransformFrame::Turn(OrbPoint v, float64 sign) const noexcept
{
    return {v.x * mCos - sign * v.y * mSin, sign * v.x * mSin + v.y * mCos};
}

OrbPoint TransformFrame::ToArm(OrbPoint image) const noexcept
{
    return Turn(OrbPoint(image.x - mShape.center.x, (image.y - mShape.center.y) / mYPerX), -1.0);
}

OrbPoint TransformFrame::FromArm(OrbPoint arm) const noexcept
{
    const OrbPoint v = Turn(arm, 1.0);
    return {mShape.center.x + v.x, mShape.center.y + v.y * mYPerX};
}

OrbPoint TransformFrame::Reach(OrbPoint layer) const noexcept
{
    return {(layer.x - mShape.pivot.x) * mShape.frame.x, (layer.y - mShape.pivot.y) * mShape.frame.y};
}

OrbPoint TransformFrame::ToImage(OrbPoint layer) const noexcept
{
    const OrbPoint a = Reach(layer);
    const float64 y = mShape.size.y * a.y;
    return FromArm(OrbPoint(mShape.size.x * a.x + mShape.shear * y, y));
}

OrbPoint TransformFrame::ToLayer(OrbPoint image) const noexcept
{
    const OrbPoint d = ToArm(image);
    const float64 ax = (d.x - mShape.shear * d.y) / mShape.size.x, ay = d.y / mShape.size.y;
    return {ax / mShape.frame.x + mShape.pivot.x, ay / mShape.frame.y + mShape.pivot.y};
}

// From the pivot the dragged side lies at size x reach; about the opposite
// side, the side's distance from that fixed side is what scales.
float64 TransformFrame::ScaleOf(float64 arm, float64 reachSide, float64 reachOpposite, float64 size,
                                bool aboutOpposite) const
{
    const float64 span = aboutOpposite ? reachSide - reachOpposite : reachSide;
    if (std::fabs(span) < kTiny)
        return size;
    return aboutOpposite ? (arm - size * reachOpposite) / span : arm / span;
}

TransformScale TransformFrame::Scaled(OrbPoint image, OrbPointI side, bool uniform, bool aboutOpposite) const noexcept
{
    const OrbPoint old = mShape.size;
    TransformScale out{old, mShape.center};
    if (!mValid || (!side.x && !side.y))
        return out;
    const OrbPoint d = ToArm(image);
    const OrbPoint reachSide = Reach(OrbPoint((1.0 + side.x) / 2.0, (1.0 + side.y) / 2.0));
    const OrbPoint reachOpposite = Reach(OrbPoint((1.0 - side.x) / 2.0, (1.0 - side.y) / 2.0));
    if (side.x)
        out.size.x = ScaleOf(d.x - mShape.shear * d.y, reachSide.x, reachOpposite.x, old.x, aboutOpposite);
    if (side.y)
        out.size.y = ScaleOf(d.y, reachSide.y, reachOpposite.y, old.y, aboutOpposite);
    if (uniform) {
        const float64 k = side.x ? out.size.x / old.x : out.size.y / old.y;
        out.size = OrbPoint(old.x * k, old.y * k);
    }
    if (!Finite(out.size))
        return {old, mShape.center};
    if (aboutOpposite) {
        // The opposite side, pulled back from the pivot by the old scale,
        // stays put: the centre takes up what the new scale moved it by.
        const OrbPoint fixed(side.x ? reachOpposite.x : 0.0, side.y ? reachOpposite.y : 0.0);
        const float64 dy = (old.y - out.size.y) * fixed.y;
        out.center = FromArm(OrbPoint((old.x - out.size.x) * fixed.x + mShape.shear * dy, dy));
    }
    return out;
}

float64 TransformFrame::Sheared(OrbPoint image) const noexcept
{
    const OrbPoint d = ToArm(image);
    if (!mValid || !Finite(d) || std::fabs(d.y) < kTiny)
        return mShape.shear;
    const float64 shear = (d.x - mShape.size.x * Reach(OrbPoint(0.5, 1.0)).x) / d.y;
    return std::isfinite(shear) ? shear : mShape.shear;
}

OrbPoint TransformFrame::ShearKnob(float64 out) const noexcept
{
    const OrbPoint a = Reach(OrbPoint(0.5, 1.0));
    const float64 top = mShape.size.y * a.y;
    const float64 y = top + (top >= 0.0 ? out : -out);
    return FromArm(OrbPoint(mShape.size.x * a.x + mShape.shear * y, y));
}

} // namespace Orbane
