#pragma once

#include "orbane/Types.h"

#include <cmath>

namespace Orbane {

// A point or direction in the viewer's 3D space. Kept a plain triple with
// constexpr arithmetic, like OrbPointT, since 3D overlays make many per move.
struct OrbVec3
{
    float64 x = 0.0;
    float64 y = 0.0;
    float64 z = 0.0;

    constexpr OrbVec3() noexcept = default;
    constexpr OrbVec3(float64 px, float64 py, float64 pz) noexcept : x(px), y(py), z(pz) {}

    constexpr OrbVec3 operator+(const OrbVec3 &o) const noexcept { return {x + o.x, y + o.y, z + o.z}; }
    constexpr OrbVec3 operator-(const OrbVec3 &o) const noexcept { return {x - o.x, y - o.y, z - o.z}; }
    constexpr OrbVec3 operator-() const noexcept { return {-x, -y, -z}; }
    constexpr OrbVec3 operator*(float64 s) const noexcept { return {x * s, y * s, z * s}; }
    constexpr OrbVec3 operator/(float64 s) const noexcept { return {x / s, y / s, z / s}; }
    constexpr bool operator==(const OrbVec3 &o) const noexcept { return x == o.x && y == o.y && z == o.z; }
    constexpr bool operator!=(const OrbVec3 &o) const noexcept { return !(*this == o); }

    constexpr float64 Dot(const OrbVec3 &o) const noexcept { return x * o.x + y * o.y + z * o.z; }
    constexpr OrbVec3 Cross(const OrbVec3 &o) const noexcept
    {
        return {y * o.z - z * o.y, z * o.x - x * o.z, x * o.y - y * o.x};
    }
    float64 Length() const noexcept { return std::sqrt(Dot(*this)); }
    bool IsFinite() const noexcept { return std::isfinite(x) && std::isfinite(y) && std::isfinite(z); }
    // The unit vector along this one; a zero vector stays zero.
    OrbVec3 Normalized() const noexcept
    {
        const float64 l = Length();
        return l > 0.0 ? *this / l : OrbVec3();
    }
};

} // namespace Orbane
