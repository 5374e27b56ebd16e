#include "overlays/AngleGeometry.h"

#include <algorithm>
#include <cmath>

namespace Orbane {

namespace {

constexpr float64 kPi = 3.14159265358979323846;
constexpr float64 kDegrees = 180.0 / kPi;
// The quarter marks stand just outside the ring, in handle pixels, apart
// from it: lines drawn over each other would add up their transparency.
constexpr float64 kMarkInner = 54.0;
constexpr float64 kMarkOuter = 60.0;
constexpr float64 kCross = 4.0;

} // namespace

float64 AngleGeometry::DragDirection(OrbPoint d) noexcept
{
    if (std::fabs(d.x) <= VerticalBand)
        return d.y >= 0.0 ? 90.0 : 270.0;
    const float64 base = std::atan(d.y / d.x) * kDegrees;
    return std::fmod(base + (d.x >= 0.0 ? 360.0 : 180.0), 360.0);
}

float64 AngleGeometry::PressDirection(OrbPoint d) noexcept
{
    if (d.x == 0.0)
        return d.y >= 0.0 ? 90.0 : -90.0;
    const float64 base = std::atan(d.y / d.x) * kDegrees;
    return d.x < 0.0 ? base + 180.0 : base;
}

float64 AngleGeometry::Turn(float64 target, float64 current) noexcept
{
    float64 turn = target - std::fmod(current + TurnBias, 360.0);
    if (turn > 180.0)
        turn -= 360.0;
    else if (turn < -180.0)
        turn += 360.0;
    return std::fmod(turn, 360.0);
}

std::optional<float64> AngleGeometry::Dragged(float64 angle, float64 target, float64 current) noexcept
{
    const float64 turn = Turn(target, current);
    if (!(std::fabs(turn) > MinTurn))
        return std::nullopt;
    const float64 to = angle + turn;
    // A huge angle may not change at all by a small turn: nothing to write.
    if (!std::isfinite(to) || to == angle)
        return std::nullopt;
    return to;
}

float64 AngleGeometry::Radius(float64 minRadius, float64 value, float64 scale) noexcept
{
    const float64 scaled = value * scale;
    if (std::isnan(scaled))
        return minRadius;
    if (std::isnan(minRadius))
        return scaled;
    return std::max(minRadius, scaled);
}

bool AngleGeometry::Differs(float64 a, float64 b, float64 threshold) noexcept
{
    if (std::isnan(a) || std::isnan(b))
        return std::isnan(a) != std::isnan(b);
    // Two equal infinities are the same value, though their difference is not a number.
    return a != b && !(std::fabs(a - b) <= threshold);
}

float64 AngleGeometry::RingDistance(OrbPoint mouse, OrbPoint centre, float64 radius) noexcept
{
    return std::fabs((mouse - centre).Length() - radius);
}

float64 AngleGeometry::PressTolerance(int32 pickTolerance, float64 handleScale) noexcept
{
    return std::max(float64(pickTolerance), std::trunc(GrabReach * handleScale));
}

float64 AngleGeometry::HoverTolerance(int32 pickTolerance, float64 handleScale) noexcept
{
    return std::max(float64(pickTolerance), GrabReach * handleScale);
}

OrbPoint AngleGeometry::ArmEnd(OrbPoint centre, float64 degrees, float64 radius, float64 yPerX) noexcept
{
    const OrbPoint u = UnitAt(degrees);
    return {centre.x + u.x * radius, centre.y + u.y * radius * yPerX};
}

OrbPoint AngleGeometry::RingGrab(OrbPoint mouse, OrbPoint centre, float64 radius) noexcept
{
    return centre + UnitOf(mouse - centre) * radius - mouse;
}

OrbPoint AngleGeometry::UnitAt(float64 degrees) noexcept
{
    const float64 radians = std::fmod(degrees, 360.0) / kDegrees;
    return {std::cos(radians), std::sin(radians)};
}

OrbPoint AngleGeometry::UnitOf(OrbPoint v) noexcept
{
    const float64 length = v.Length();
    if (!(length > 0.0) || !std::isfinite(length))
        return {1.0, 0.0};
    return v / length;
}

float64 AngleGeometry::KeyStep(int key, Qt::KeyboardModifiers mods) noexcept
{
    if (!IsAngleKey(uint64(key)))
        return 0.0;
    float64 step = key == Qt::Key_Left ? 1.0 : -1.0;
    if (mods & Qt::ShiftModifier)
        step *= 10.0;
    if (mods & Qt::ControlModifier)
        step /= 10.0;
    return step;
}

std::vector<OrbPoint> AngleGeometry::RingLoop()
{
    std::vector<OrbPoint> loop;
    loop.reserve(RingPoints);
    for (int32 i = 0; i < RingPoints; ++i)
        loop.push_back(UnitAt(360.0 * i / RingPoints) * RingRadius);
    return loop;
}

std::vector<OrbPoint> AngleGeometry::DialLines(int32 style, float64 degrees)
{
    std::vector<OrbPoint> lines;
    if (!DrawsDial(style))
        return lines;
    if (std::isfinite(degrees))
        lines.insert(lines.end(), {OrbPoint(), UnitAt(degrees) * RingRadius});
    lines.insert(lines.end(), {{-kCross, 0.0}, {kCross, 0.0}, {0.0, -kCross}, {0.0, kCross}});
    for (int32 quarter = 0; quarter < 4; ++quarter) {
        const OrbPoint u = UnitAt(90.0 * quarter);
        lines.insert(lines.end(), {u * kMarkInner, u * kMarkOuter});
    }
    return lines;
}

} // namespace Orbane
