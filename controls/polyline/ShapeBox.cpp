#include "polyline/ShapeBox.h"

#include <algorithm>
#include <cmath>

namespace Orbane {

namespace {

// Each handle's place as fractions (0, 0.5 or 1) across and up the box.
constexpr OrbPoint kPlace[8] = {{0, 0}, {0.5, 0}, {1, 0}, {1, 0.5}, {1, 1}, {0.5, 1}, {0, 1}, {0, 0.5}};
// A box side this short scales nothing: its factor would blow up.
constexpr float64 kMinSide = 1e-9;

bool IsCorner(int32 part)
{
    return part >= 0 && part < 8 && part % 2 == 0;
}

} // namespace

ShapeBox::ShapeBox(const Registry *reg, const ScriptVal &args, const TagList &tags) : Object(reg, args, tags) {}

void ShapeBox::SetPoints(const std::vector<OrbPoint> &points)
{
    mEmpty = points.empty();
    if (mEmpty)
        return;
    mBounds = OrbRect(points.front(), points.front());
    for (const OrbPoint &p : points)
        mBounds = OrbRect(std::min(mBounds.x1, p.x), std::min(mBounds.y1, p.y), std::max(mBounds.x2, p.x),
                          std::max(mBounds.y2, p.y));
}

OrbPoint ShapeBox::HandleAt(int32 part) const
{
    const OrbPoint f = kPlace[std::clamp(part, 0, 7)];
    return {mBounds.x1 + f.x * mBounds.Width(), mBounds.y1 + f.y * mBounds.Height()};
}

int32 ShapeBox::HitTest(OrbPoint mouse, float64 tolerance) const
{
    if (mEmpty)
        return SBP_None;
    auto near = [&](int32 part, float64 reach) {
        const OrbPoint d = mouse - HandleAt(part);
        return std::fabs(d.x) < reach && std::fabs(d.y) < reach;
    };
    for (int32 pass = 0; pass < 2; ++pass)
        for (int32 part = pass; part < 8; part += 2)
            if (near(part, tolerance))
                return part;
    if (mBounds.Contains(mouse))
        return SBP_Inside;
    for (int32 corner = 0; corner < 8; corner += 2)
        if (near(corner, RotateReach * tolerance))
            return SBP_Rotate;
    return SBP_None;
}

int32 ShapeBox::CursorOf(int32 part) noexcept
{
    switch (part) {
    case SBP_Left:
    case SBP_Right:
        return 3;
    case SBP_Bottom:
    case SBP_Top:
        return 4;
    case SBP_TopLeft:
    case SBP_BottomRight:
        return 5;
    // With Y up the bottom-left to top-right diagonal leans forward on
    // screen ("/"), the way Qt's backward-diagonal size cursor points.
    case SBP_BottomLeft:
    case SBP_TopRight:
        return 6;
    case SBP_Inside:
        return 7;
    case SBP_Rotate:
        return 1;
    default:
        return 0;
    }
}

QTransform ShapeBox::Drag(int32 part, OrbPoint from, OrbPoint to, bool keepAspect) const
{
    if (mEmpty || part == SBP_None)
        return {};
    if (part == SBP_Inside)
        return QTransform::fromTranslate(to.x - from.x, to.y - from.y);
    const OrbPoint mid = mBounds.Center();
    if (part == SBP_Rotate) {
        const float64 turn = std::atan2(to.y - mid.y, to.x - mid.x) - std::atan2(from.y - mid.y, from.x - mid.x);
        return QTransform().translate(mid.x, mid.y).rotateRadians(turn).translate(-mid.x, -mid.y);
    }
    // The handle opposite stays; the dragged one follows the mouse.
    const OrbPoint anchor = HandleAt((part + 4) % 8), handle = HandleAt(part);
    const OrbPoint moved = handle + (to - from);
    const OrbPoint side = handle - anchor;
    float64 sx = std::fabs(side.x) > kMinSide ? (moved.x - anchor.x) / side.x : 1.0;
    float64 sy = std::fabs(side.y) > kMinSide ? (moved.y - anchor.y) / side.y : 1.0;
    if (part == SBP_Bottom || part == SBP_Top)
        sx = 1.0;
    if (part == SBP_Left || part == SBP_Right)
        sy = 1.0;
    if (keepAspect && IsCorner(part))
        sx = sy = std::fabs(sx) > std::fabs(sy) ? sx : sy;
    return QTransform().translate(anchor.x, anchor.y).scale(sx, sy).translate(-anchor.x, -anchor.y);
}

} // namespace Orbane
