#pragma once

#include "orbane/OrbVec3.h"

#include <array>

namespace Orbane {

// A box in the viewer's 3D space: its centre, its full sizes along its own
// axes and its turn (degrees about X, then Y, then Z, as the camera's).
struct Box3
{
    OrbVec3 center;
    OrbVec3 size{0.5, 0.5, 0.5};
    OrbVec3 rotation;
};

// What a face drag makes of a box: the sizes and the centre.
struct BoxResize
{
    bool uniform = false;     // all three sizes by the dragged axis's factor
    bool aboutCenter = false; // the opposite face moves too; the centre stays
    float64 minSize = 0.0;    // each size kept at least this
    float64 maxSize = 0.0;    // and at most this (0: no limit)
    float64 step = 0.0;       // the dragged size snapped to multiples (0: none)
};

// The box's corners, edges and faces, pure functions of a Box3, so the
// overlay only draws and grabs them. Faces are numbered +X, -X, +Y, -Y, +Z,
// -Z (0..5): face f lies along axis f / 2 on the side f % 2 ? -1 : +1.
class BoxGeometry
{
public:
    static constexpr int32 Faces = 6;

    // The box's own axes in world space (unit vectors).
    static std::array<OrbVec3, 3> Axes(const Box3 &box) noexcept;
    // Corner c (bit 0 +X, bit 1 +Y, bit 2 +Z; clear bits the minus side).
    static std::array<OrbVec3, 8> Corners(const Box3 &box) noexcept;
    // The twelve edges as pairs of corner numbers.
    static const std::array<std::array<int32, 2>, 12> &Edges() noexcept;
    // The two faces that meet at an edge.
    static std::array<int32, 2> FacesOfEdge(int32 edge) noexcept;
    // The four corners of face f, in order around it.
    static std::array<int32, 4> FaceCorners(int32 face) noexcept;
    static int32 AxisOf(int32 face) noexcept { return face / 2; }
    static float64 SideOf(int32 face) noexcept { return face % 2 ? -1.0 : 1.0; }
    // The outward normal and the middle of face f.
    static OrbVec3 Normal(const Box3 &box, int32 face) noexcept;
    static OrbVec3 FaceCenter(const Box3 &box, int32 face) noexcept;
    // Does face f face an eye at `eye` (its outside is towards it)? A flat
    // box (size 0 on the face's axis) shows both of those faces.
    static bool FacesEye(const Box3 &box, int32 face, OrbVec3 eye) noexcept;

    // The box after face f was dragged `delta` world units along its
    // axis's positive direction (not its normal).
    static Box3 Resized(const Box3 &atPress, int32 face, float64 delta, const BoxResize &how) noexcept;
};

} // namespace Orbane
