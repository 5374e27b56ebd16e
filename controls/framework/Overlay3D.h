#pragma once

#include "orbane/GColor.h"
#include "orbane/OrbPointT.h"
#include "orbane/OrbVec3.h"
#include "orbane/ViewCamera.h"

#include <Qt>

namespace Orbane {

class Parameter;
class PreviewControl;
class PreviewInfo;
class ScriptVal;

namespace Graphics {
class GPainter;
} // namespace Graphics

// What the 3D overlays (cube, camera, light) share: world points read from
// and written to Point Inputs (X, Y and Z), world -> viewer through the
// viewer's camera (PreviewInfo::Camera) and the view mapping, clipped
// segments, and the drags that turn a mouse position back into a world point.
// The projection itself lives in ViewCamera; this only joins it to the
// overlays' Inputs and painter.
class Overlay3D
{
public:
    // A Point Input's X, Y and Z where all three are finite.
    static bool ReadPoint(const Parameter *value, OrbVec3 &out);
    // Takes the point into `copy` where some axis moved by more than the
    // change threshold (1e-5).
    static bool TakePoint(OrbVec3 &copy, const Parameter *value);
    static bool Moved(OrbVec3 a, OrbVec3 b) noexcept;
    // Writes `value` as a Point (X, Y, Z) to Input `index` of `overlay` at
    // the current time; nothing for a value that is not finite.
    static bool WritePoint(PreviewControl &overlay, OrbVec3 value, uint32 index);
    // The table a camera Input holds (as ViewCamera::FromTable reads it);
    // false where it holds none.
    static bool ReadCameraTable(const Parameter *value, ScriptVal &out);
    // The camera such a table gives over the viewer's; the viewer's where
    // the table is nil or makes no valid camera.
    static ViewCamera CameraOver(const PreviewInfo &info, const ScriptVal &table);

    // A world point in viewer units; false where the camera clips it or it
    // lands too far away to draw.
    static bool ToViewer(const PreviewInfo &info, const ViewCamera &camera, OrbVec3 world, OrbPoint &viewer);
    // Draws the segment a-b clipped at the camera's near plane (a GP_Lines
    // pair); nothing where none of it is in front.
    static void Segment(Graphics::GPainter &p, const PreviewInfo &info, const ViewCamera &camera, OrbVec3 a, OrbVec3 b);
    // The world point under the mouse on the plane through `through` that
    // faces the camera (a drag in the view's plane at that depth).
    static bool MouseOnViewPlane(const PreviewInfo &info, const ViewCamera &camera, OrbVec3 through, OrbVec3 &hit);
    // How far along the line `point + t * direction` the mouse is.
    static bool MouseOnLine(const PreviewInfo &info, const ViewCamera &camera, OrbVec3 point, OrbVec3 direction,
                            float64 &t);
    // One arrow-key nudge in world units: one image pixel across (X) or up
    // (Y, or Z where `depth`), ten with Shift, a tenth with Control.
    static OrbVec3 Nudge(const PreviewInfo &info, uint64 key, Qt::KeyboardModifiers mods, bool depth);
};

} // namespace Orbane
