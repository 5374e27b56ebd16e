#include "overlays/BoxGeometry.h"

#include "orbane/ViewCamera.h"

#include <algorithm>
#include <cmath>

namespace Orbane {

namespace {

float64 Component(OrbVec3 v, int32 axis) noexcept
{
    return axis == 0 ? v.x : axis == 1 ? v.y : v.z;
}

void SetComponent(OrbVec3 &v, int32 axis, float64 value) noexcept
{
    (axis == 0 ? v.x : axis == 1 ? v.y : v.z) = value;
}

float64 Limited(float64 size, const BoxResize &how) noexcept
{
    if (how.step > 0.0)
        size = std::round(size / how.step) * how.step;
    size = std::max(size, std::max(how.minSize, 0.0));
    return how.maxSize > 0.0 ? std::min(size, how.maxSize) : size;
}

} // namespace

std::array<OrbVec3, 3> BoxGeometry::Axes(const Box3 &box) noexcept
{
    return {ViewCamera::Turned({1, 0, 0}, box.rotation), ViewCamera::Turned({0, 1, 0}, box.rotation),
            ViewCamera::Turned({0, 0, 1}, box.rotation)};
}

std::array<OrbVec3, 8> BoxGeometry::Corners(const Box3 &box) noexcept
{
    const auto axes = Axes(box);
    std::array<OrbVec3, 8> out;
    for (int32 c = 0; c < 8; ++c) {
        const float64 sx = c & 1 ? 0.5 : -0.5, sy = c & 2 ? 0.5 : -0.5, sz = c & 4 ? 0.5 : -0.5;
        out[std::size_t(c)] =
            box.center + axes[0] * (sx * box.size.x) + axes[1] * (sy * box.size.y) + axes[2] * (sz * box.size.z);
    }
    return out;
}

const std::array<std::array<int32, 2>, 12> &BoxGeometry::Edges() noexcept
{
    // Four along X, four along Y, four along Z.
    static const std::array<std::array<int32, 2>, 12> edges = {
        {{0, 1}, {2, 3}, {4, 5}, {6, 7}, {0, 2}, {1, 3}, {4, 6}, {5, 7}, {0, 4}, {1, 5}, {2, 6}, {3, 7}}};
    return edges;
}

// An edge along one axis touches one face of each of the other two axes:
// the sides its corners share.
std::array<int32, 2> BoxGeometry::FacesOfEdge(int32 edge) noexcept
{
    const auto &e = Edges()[std::size_t(edge)];
    const int32 along = edge / 4;
    std::array<int32, 2> out{};
    int32 n = 0;
    for (int32 axis = 0; axis < 3; ++axis)
        if (axis != along)
            out[std::size_t(n++)] = axis * 2 + ((e[0] >> axis) & 1 ? 0 : 1);
    return out;
}

std::array<int32, 4> BoxGeometry::FaceCorners(int32 face) noexcept
{
    const int32 axis = AxisOf(face), bit = 1 << axis;
    const int32 on = SideOf(face) > 0 ? bit : 0;
    const int32 u = 1 << ((axis + 1) % 3), v = 1 << ((axis + 2) % 3);
    return {on, on | u, on | u | v, on | v};
}

OrbVec3 BoxGeometry::Normal(const Box3 &box, int32 face) noexcept
{
    return Axes(box)[std::size_t(AxisOf(face))] * SideOf(face);
}

OrbVec3 BoxGeometry::FaceCenter(const Box3 &box, int32 face) noexcept
{
    return box.center + Normal(box, face) * (0.5 * std::fabs(Component(box.size, AxisOf(face))));
}

bool BoxGeometry::FacesEye(const Box3 &box, int32 face, OrbVec3 eye) noexcept
{
    return Normal(box, face).Dot(eye - FaceCenter(box, face)) > 0.0;
}

// The dragged face follows the mouse; without aboutCenter the opposite face
// stays, so the centre moves half as far.
Box3 BoxGeometry::Resized(const Box3 &atPress, int32 face, float64 delta, const BoxResize &how) noexcept
{
    Box3 box = atPress;
    const int32 axis = AxisOf(face);
    const float64 side = SideOf(face);
    const float64 was = Component(atPress.size, axis);
    const float64 grow = side * delta * (how.aboutCenter ? 2.0 : 1.0);
    const float64 size = Limited(was + grow, how);
    SetComponent(box.size, axis, size);
    if (how.uniform && was > 0.0)
        for (int32 other = 0; other < 3; ++other)
            if (other != axis)
                SetComponent(box.size, other, Limited(Component(atPress.size, other) * size / was, how));
    if (!how.aboutCenter)
        box.center = atPress.center + Axes(atPress)[std::size_t(axis)] * (side * (size - was) / 2.0);
    return box;
}

} // namespace Orbane
