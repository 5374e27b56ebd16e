#include "framework/Overlay3D.h"

#include "framework/OverlayValue.h"

#include "orbane/AutoParam.h"
#include "orbane/GPainter.h"
#include "orbane/Point.h"
#include "orbane/PreviewControl.h"
#include "orbane/PreviewInfo.h"
#include "orbane/ScriptValParam.h"

#include <cmath>

namespace Orbane {

bool Overlay3D::ReadPoint(const Parameter *value, OrbVec3 &out)
{
    const auto *p = dynamic_cast<const Point *>(value);
    if (!p || !OrbVec3(p->X, p->Y, p->Z).IsFinite())
        return false;
    out = OrbVec3(p->X, p->Y, p->Z);
    return true;
}

bool Overlay3D::Moved(OrbVec3 a, OrbVec3 b) noexcept
{
    return PreviewControl::Moved(a.x, b.x) || PreviewControl::Moved(a.y, b.y) || PreviewControl::Moved(a.z, b.z);
}

bool Overlay3D::TakePoint(OrbVec3 &copy, const Parameter *value)
{
    OrbVec3 p;
    if (!ReadPoint(value, p) || !Moved(copy, p))
        return false;
    copy = p;
    return true;
}

bool Overlay3D::WritePoint(PreviewControl &overlay, OrbVec3 value, uint32 index)
{
    if (!value.IsFinite() || index >= overlay.Inputs().size())
        return false;
    AutoPoint point(value.x, value.y, value.z);
    return overlay.SetInputs(point.get(), overlay.GetCurrentTime(), index, nullptr);
}

bool Overlay3D::ReadCameraTable(const Parameter *value, ScriptVal &out)
{
    const auto *table = dynamic_cast<const ScriptValParam *>(value);
    if (!table || !table->Value.IsTable())
        return false;
    out = ScriptValParam::DeepCopy(table->Value);
    return true;
}

ViewCamera Overlay3D::CameraOver(const PreviewInfo &info, const ScriptVal &table)
{
    if (!table.IsTable())
        return info.Camera();
    const ViewCamera camera = ViewCamera::FromTable(table, info.Camera());
    return camera.IsValid() ? camera : info.Camera();
}

bool Overlay3D::ToViewer(const PreviewInfo &info, const ViewCamera &camera, OrbVec3 world, OrbPoint &viewer)
{
    OrbPoint image;
    if (!camera.Project(world, info.Mapping(), image))
        return false;
    viewer = info.TransformOut(image);
    return OverlayValue::OnScreen(viewer);
}

void Overlay3D::Segment(Graphics::GPainter &p, const PreviewInfo &info, const ViewCamera &camera, OrbVec3 a, OrbVec3 b)
{
    OrbPoint ia, ib;
    if (!camera.ProjectSegment(a, b, info.Mapping(), ia, ib))
        return;
    const OrbPoint va = info.TransformOut(ia), vb = info.TransformOut(ib);
    if (!OverlayValue::OnScreen(va) || !OverlayValue::OnScreen(vb))
        return;
    p.Vertex(va.x, va.y);
    p.Vertex(vb.x, vb.y);
}

bool Overlay3D::MouseOnViewPlane(const PreviewInfo &info, const ViewCamera &camera, OrbVec3 through, OrbVec3 &hit)
{
    return camera.OnPlane({info.MouseX, info.MouseY}, info.Mapping(), through, camera.Forward(), hit);
}

bool Overlay3D::MouseOnLine(const PreviewInfo &info, const ViewCamera &camera, OrbVec3 point, OrbVec3 direction,
                            float64 &t)
{
    return camera.OnLine({info.MouseX, info.MouseY}, info.Mapping(), point, direction, t);
}

OrbVec3 Overlay3D::Nudge(const PreviewInfo &info, uint64 key, Qt::KeyboardModifiers mods, bool depth)
{
    float64 factor = 1.0;
    if (mods & Qt::ShiftModifier)
        factor *= 10.0;
    if (mods & Qt::ControlModifier)
        factor /= 10.0;
    // World units are image widths as displayed: a pixel across is
    // 1 / ImageWidth, a pixel up that height in aspect units.
    const float64 across = factor / info.ImageWidth;
    const float64 up = factor * info.AspectScaleYIn(1.0 / info.ImageHeight);
    switch (key) {
    case Qt::Key_Left:
        return {-across, 0.0, 0.0};
    case Qt::Key_Right:
        return {across, 0.0, 0.0};
    case Qt::Key_Up:
        return depth ? OrbVec3(0.0, 0.0, -up) : OrbVec3(0.0, up, 0.0);
    case Qt::Key_Down:
        return depth ? OrbVec3(0.0, 0.0, up) : OrbVec3(0.0, -up, 0.0);
    default:
        return {};
    }
}

} // namespace Orbane
