#pragma once

#include "orbane/OrbPointT.h"
#include "orbane/OrbVec3.h"
#include "orbane/ViewMapping.h"

namespace Orbane {

class ScriptVal;

// The viewer's camera: a pinhole that looks at the 3D space behind the image.
// Every 3D overlay draws and drags through it, so that they all agree.
//
// World space: X right, Y up, Z towards the person looking at the image; one
// unit is one image width as displayed (the aspect-corrected length of
// ViewMapping), and the origin is the image's centre. A point (x, y, 0) of the
// default view therefore lies exactly on the image, at image coordinates
// (0.5 + x, 0.5 + y * SpanX / SpanY), so 2D and 3D overlays meet on the
// image plane.
//
// The camera sits at `position` and looks down its own -Z with +Y up, turned
// by `rotation` (degrees about X, then Y, then Z, each about the world axes:
// R = Rz * Ry * Rx). `focal` and `aperture` (the film back's width, both in
// mm) set the field of view: the film's width spans the image's width.
// Points nearer than `nearPlane` (world units in front of the camera), and
// points behind it, are clipped: they are never projected to infinity.
class ViewCamera
{
public:
    OrbVec3 position;
    OrbVec3 rotation; // degrees
    float64 focal = 50.0;
    float64 aperture = 36.0;
    float64 nearPlane = 0.01;

    // The default view: straight at the image, from where the plane z = 0
    // fills the image's width exactly (focal / aperture image widths away).
    static ViewCamera Default() noexcept;

    // Finite values, a focal length, aperture and near plane above 0.
    bool IsValid() const noexcept;
    // The horizontal field of view, degrees.
    float64 FieldOfView() const noexcept;
    // The focal length that gives a horizontal field of view of `degrees`.
    static float64 FocalForFieldOfView(float64 degrees, float64 aperture) noexcept;

    // The camera's axes in world space: right (+X), up (+Y) and the way it
    // looks (its -Z).
    OrbVec3 Right() const noexcept;
    OrbVec3 Up() const noexcept;
    OrbVec3 Forward() const noexcept;
    OrbVec3 ToCamera(OrbVec3 world) const noexcept;
    OrbVec3 ToWorld(OrbVec3 camera) const noexcept;
    // How far in front of the camera `world` lies, along its view.
    float64 Depth(OrbVec3 world) const noexcept;

    // World -> image coordinates (normalised, Y up) in the view `m`; false
    // where the point is clipped or not a finite number.
    bool Project(OrbVec3 world, const ViewMapping &m, OrbPoint &image) const noexcept;
    // A segment clipped at the near plane, projected; false where nothing of
    // it is in front of the camera.
    bool ProjectSegment(OrbVec3 a, OrbVec3 b, const ViewMapping &m, OrbPoint &imageA, OrbPoint &imageB) const noexcept;
    // The ray from the camera through an image point: `direction` has
    // unit length.
    bool Ray(OrbPoint image, const ViewMapping &m, OrbVec3 &origin, OrbVec3 &direction) const noexcept;
    // Where the ray through `image` meets the plane through `point` with
    // `normal`, in front of the camera; false where it does not.
    bool OnPlane(OrbPoint image, const ViewMapping &m, OrbVec3 point, OrbVec3 normal, OrbVec3 &hit) const noexcept;
    // The parameter t of the point `point + t * direction` on a line that
    // comes closest to the ray through `image`; false where the line runs
    // along the ray (no single closest point).
    bool OnLine(OrbPoint image, const ViewMapping &m, OrbVec3 point, OrbVec3 direction, float64 &t) const noexcept;

    // The rotation (X and Y; Z as given) of a camera at `from` that looks at
    // `to`; `from`'s own where the two points are one.
    // `v` turned by `degrees` about X, then Y, then Z (the camera's own
    // order), for objects placed in the same space.
    static OrbVec3 Turned(OrbVec3 v, OrbVec3 degrees) noexcept;

    static OrbVec3 AimAt(OrbVec3 from, OrbVec3 to, float64 rollZ) noexcept;

    // Reads `position`, `rotation` ({x, y, z} or {X=, Y=, Z=}), `focal`,
    // `aperture`, `near` and `fov` (degrees across, for the focal length
    // where no `focal` is given) from a table over `base`; what is absent or
    // not a number keeps base's value.
    static ViewCamera FromTable(const ScriptVal &table, const ViewCamera &base = Default());
    ScriptVal ToTable() const;

    bool operator==(const ViewCamera &o) const noexcept;
    bool operator!=(const ViewCamera &o) const noexcept { return !(*this == o); }

private:
    // Camera space -> image coordinates, for a point known to be in front.
    OrbPoint FilmToImage(OrbVec3 camera, const ViewMapping &m) const noexcept;
    float64 Zoom() const noexcept { return focal / aperture; }
};

} // namespace Orbane
