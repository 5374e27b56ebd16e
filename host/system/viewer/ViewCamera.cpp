#include "orbane/ViewCamera.h"

#include "orbane/ScriptVal.h"

#include <algorithm>
#include <cmath>

namespace Orbane {

namespace {

constexpr float64 kDegree = M_PI / 180.0;

// Rz * Ry * Rx applied to `v`, or its inverse (the transpose) where `sign`
// is -1: the inverse turns Z back first, then Y, then X.
OrbVec3 Turn(OrbVec3 v, OrbVec3 degrees, float64 sign) noexcept
{
    const auto rotX = [&](OrbVec3 p) {
        const float64 c = std::cos(degrees.x * kDegree), s = sign * std::sin(degrees.x * kDegree);
        return OrbVec3(p.x, c * p.y - s * p.z, s * p.y + c * p.z);
    };
    const auto rotY = [&](OrbVec3 p) {
        const float64 c = std::cos(degrees.y * kDegree), s = sign * std::sin(degrees.y * kDegree);
        return OrbVec3(c * p.x + s * p.z, p.y, -s * p.x + c * p.z);
    };
    const auto rotZ = [&](OrbVec3 p) {
        const float64 c = std::cos(degrees.z * kDegree), s = sign * std::sin(degrees.z * kDegree);
        return OrbVec3(c * p.x - s * p.y, s * p.x + c * p.y, p.z);
    };
    return sign > 0 ? rotZ(rotY(rotX(v))) : rotX(rotY(rotZ(v)));
}

// A number of a table by name, or `def`.
float64 NumberAt(const ScriptVal &table, const char *key, float64 def)
{
    const ScriptVal *v = table.FindKeyConst(ScriptVal(key));
    return v && v->IsNumber() && std::isfinite(v->GetNumber()) ? v->GetNumber() : def;
}

// {x, y, z} or {X=, Y=, Z=} (or lower-case names) over `def`.
OrbVec3 TripleAt(const ScriptVal &table, const char *key, OrbVec3 def)
{
    const ScriptVal *t = table.FindKeyConst(ScriptVal(key));
    if (!t || !t->IsTable())
        return def;
    const auto axis = [&](int64 index, const char *upper, const char *lower, float64 d) {
        const ScriptVal *v = t->FindKeyConst(ScriptVal(index));
        if (v && v->IsNumber() && std::isfinite(v->GetNumber()))
            return v->GetNumber();
        return NumberAt(*t, upper, NumberAt(*t, lower, d));
    };
    return {axis(1, "X", "x", def.x), axis(2, "Y", "y", def.y), axis(3, "Z", "z", def.z)};
}

ScriptVal Triple(OrbVec3 v)
{
    ScriptVal t = ScriptVal::NewTable();
    t.Append(ScriptVal(v.x));
    t.Append(ScriptVal(v.y));
    t.Append(ScriptVal(v.z));
    return t;
}

} // namespace

ViewCamera ViewCamera::Default() noexcept
{
    ViewCamera c;
    c.position = OrbVec3(0.0, 0.0, c.focal / c.aperture);
    return c;
}

bool ViewCamera::IsValid() const noexcept
{
    return position.IsFinite() && rotation.IsFinite() && std::isfinite(focal) && std::isfinite(aperture) &&
           std::isfinite(nearPlane) && focal > 0.0 && aperture > 0.0 && nearPlane > 0.0;
}

float64 ViewCamera::FieldOfView() const noexcept
{
    return 2.0 * std::atan(aperture / (2.0 * focal)) / kDegree;
}

float64 ViewCamera::FocalForFieldOfView(float64 degrees, float64 aperture) noexcept
{
    return aperture / (2.0 * std::tan(degrees * kDegree / 2.0));
}

OrbVec3 ViewCamera::Right() const noexcept
{
    return Turn({1.0, 0.0, 0.0}, rotation, 1.0);
}

OrbVec3 ViewCamera::Up() const noexcept
{
    return Turn({0.0, 1.0, 0.0}, rotation, 1.0);
}

OrbVec3 ViewCamera::Forward() const noexcept
{
    return Turn({0.0, 0.0, -1.0}, rotation, 1.0);
}

OrbVec3 ViewCamera::ToCamera(OrbVec3 world) const noexcept
{
    return Turn(world - position, rotation, -1.0);
}

OrbVec3 ViewCamera::ToWorld(OrbVec3 camera) const noexcept
{
    return Turn(camera, rotation, 1.0) + position;
}

float64 ViewCamera::Depth(OrbVec3 world) const noexcept
{
    return -ToCamera(world).z;
}

OrbPoint ViewCamera::FilmToImage(OrbVec3 camera, const ViewMapping &m) const noexcept
{
    const float64 k = Zoom() / -camera.z;
    return {0.5 + camera.x * k, 0.5 + m.AspectYOut(camera.y * k)};
}

bool ViewCamera::Project(OrbVec3 world, const ViewMapping &m, OrbPoint &image) const noexcept
{
    if (!IsValid() || !world.IsFinite())
        return false;
    const OrbVec3 c = ToCamera(world);
    if (!(-c.z >= nearPlane))
        return false;
    image = FilmToImage(c, m);
    return true;
}

bool ViewCamera::ProjectSegment(OrbVec3 a, OrbVec3 b, const ViewMapping &m, OrbPoint &imageA,
                                OrbPoint &imageB) const noexcept
{
    if (!IsValid() || !a.IsFinite() || !b.IsFinite())
        return false;
    OrbVec3 ca = ToCamera(a), cb = ToCamera(b);
    const float64 da = -ca.z, db = -cb.z;
    if (!(da >= nearPlane) && !(db >= nearPlane))
        return false;
    // Cut the part behind the near plane off where the segment crosses it.
    if (da < nearPlane)
        ca = ca + (cb - ca) * ((nearPlane - da) / (db - da));
    else if (db < nearPlane)
        cb = cb + (ca - cb) * ((nearPlane - db) / (da - db));
    ca.z = std::min(ca.z, -nearPlane);
    cb.z = std::min(cb.z, -nearPlane);
    imageA = FilmToImage(ca, m);
    imageB = FilmToImage(cb, m);
    return true;
}

bool ViewCamera::Ray(OrbPoint image, const ViewMapping &m, OrbVec3 &origin, OrbVec3 &direction) const noexcept
{
    if (!IsValid() || !std::isfinite(image.x) || !std::isfinite(image.y))
        return false;
    const OrbVec3 film((image.x - 0.5) / Zoom(), m.AspectYIn(image.y - 0.5) / Zoom(), -1.0);
    origin = position;
    direction = Turn(film, rotation, 1.0).Normalized();
    return true;
}

bool ViewCamera::OnPlane(OrbPoint image, const ViewMapping &m, OrbVec3 point, OrbVec3 normal,
                         OrbVec3 &hit) const noexcept
{
    OrbVec3 o, d;
    if (!Ray(image, m, o, d) || !point.IsFinite() || !normal.IsFinite())
        return false;
    const float64 across = d.Dot(normal);
    if (std::fabs(across) < 1e-9)
        return false;
    const float64 t = (point - o).Dot(normal) / across;
    if (!(t > 0.0) || !std::isfinite(t))
        return false;
    hit = o + d * t;
    return true;
}

bool ViewCamera::OnLine(OrbPoint image, const ViewMapping &m, OrbVec3 point, OrbVec3 direction,
                        float64 &t) const noexcept
{
    OrbVec3 o, d;
    if (!Ray(image, m, o, d) || !point.IsFinite() || !direction.IsFinite())
        return false;
    // The closest points of two lines: solve for both parameters.
    const OrbVec3 w = point - o;
    const float64 a = direction.Dot(direction), b = direction.Dot(d), c = d.Dot(d);
    const float64 denom = a * c - b * b;
    if (!(std::fabs(denom) > 1e-12 * a * c))
        return false;
    t = (b * d.Dot(w) - c * direction.Dot(w)) / denom;
    return std::isfinite(t);
}

OrbVec3 ViewCamera::Turned(OrbVec3 v, OrbVec3 degrees) noexcept
{
    return Turn(v, degrees, 1.0);
}

OrbVec3 ViewCamera::AimAt(OrbVec3 from, OrbVec3 to, float64 rollZ) noexcept
{
    const OrbVec3 f = (to - from).Normalized();
    if (f == OrbVec3() || !f.IsFinite())
        return {0.0, 0.0, rollZ};
    // Forward of Ry * Rx is (-sin y cos x, sin x, -cos y cos x).
    const float64 x = std::asin(std::clamp(f.y, -1.0, 1.0)) / kDegree;
    const float64 y = std::atan2(-f.x, -f.z) / kDegree;
    return {x, y, rollZ};
}

ViewCamera ViewCamera::FromTable(const ScriptVal &table, const ViewCamera &base)
{
    ViewCamera c = base;
    if (!table.IsTable())
        return c;
    c.position = TripleAt(table, "position", c.position);
    c.rotation = TripleAt(table, "rotation", c.rotation);
    c.aperture = NumberAt(table, "aperture", c.aperture);
    c.focal = NumberAt(table, "focal", c.focal);
    // A field of view sets the focal length only where no focal length is
    // given: ToTable writes both, and the focal length is the exact one.
    const float64 fov = NumberAt(table, "fov", 0.0);
    if (!table.FindKeyConst(ScriptVal("focal")) && fov > 0.0 && fov < 180.0)
        c.focal = FocalForFieldOfView(fov, c.aperture);
    c.nearPlane = NumberAt(table, "near", c.nearPlane);
    return c;
}

ScriptVal ViewCamera::ToTable() const
{
    ScriptVal t = ScriptVal::NewTable();
    t.SetKey(ScriptVal("position"), Triple(position));
    t.SetKey(ScriptVal("rotation"), Triple(rotation));
    t.SetKey(ScriptVal("focal"), ScriptVal(focal));
    t.SetKey(ScriptVal("aperture"), ScriptVal(aperture));
    t.SetKey(ScriptVal("near"), ScriptVal(nearPlane));
    t.SetKey(ScriptVal("fov"), ScriptVal(FieldOfView()));
    return t;
}

bool ViewCamera::operator==(const ViewCamera &o) const noexcept
{
    return position == o.position && rotation == o.rotation && focal == o.focal && aperture == o.aperture &&
           nearPlane == o.nearPlane;
}

} // namespace Orbane
