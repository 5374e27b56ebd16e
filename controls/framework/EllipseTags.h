#pragma once

#include "orbane/TagMapEntry.h"
#include "orbane/Tags.h"

namespace Orbane {

// Script tags of EllipseControl. Its main Input is the centre (a Point);
// the _Input tags say which of its Inputs holds each radius, the angle and
// the softness (-1, or an index with no Input: the Set tag's value, not
// draggable). Radii and softness are in image widths as displayed.
constexpr Tag EC_RadiusXInput = 0x10058000;      // default 1
constexpr Tag EC_RadiusYInput = 0x10058001;      // default 2
constexpr Tag EC_AngleInput = 0x10058002;        // default 3
constexpr Tag EC_SoftInput = 0x10058003;         // default 4
constexpr Tag EC_SoftMode = 0x10058004;          // soft edge: 0 across the edge, 1 inside, 2 outside
constexpr Tag EC_KeepAspect = 0x10058005;        // axis drags scale both radii, as with Shift
constexpr Tag EC_Circle = 0x10058006;            // one radius, X, for both axes
constexpr Tag EC_ShowAxes = 0x10058007;          // draw both axes through the centre
constexpr Tag EC_ShowCenter = 0x10058008;        // draw and grab the centre (default on)
constexpr Tag EC_ShowRotate = 0x10058009;        // the rotation knob (default on)
constexpr Tag EC_ShowSoft = 0x1005800a;          // the soft edge's ellipses and knob (default on)
constexpr Tag EC_Segments = 0x1005800b;          // straight pieces an ellipse is drawn with (default 64)
constexpr Tag EC_PenStyle = 0x1005800c;          // the ellipse's pen: 0 solid, 1..4 dashed as the rectangle's
constexpr Tag EC_SoftPenStyle = 0x1005800d;      // the soft ellipses' pen (default 2)
constexpr Tag EC_FillInside = 0x1005800e;        // shade the inside
constexpr Tag EC_Color = 0x1005800f;             // the ellipse's colour (default: the overlay's)
constexpr Tag EC_SoftColor = 0x10058010;         // the soft ellipses' colour
constexpr Tag EC_FillColor = 0x10058011;         // the shade's colour
constexpr Tag EC_HideWhileDragging = 0x10058012; // only the knobs are drawn while the ellipse is dragged
constexpr Tag EC_AboutOpposite = 0x10058013;     // axis drags keep the opposite knob in place, as with Ctrl
constexpr Tag EC_KeysResize = 0x10058014;        // arrows change the radii (Left/Right X, Up/Down Y)
constexpr Tag ECD_MinRadius = 0x20058000;        // drags keep each radius at least this (default 0)
constexpr Tag ECD_MaxRadius = 0x20058001;        // and at most this (0: no limit)
constexpr Tag ECD_AngleStep = 0x20058002;        // a turn snaps to multiples of this (degrees; 0: none)
constexpr Tag ECD_RotateReach = 0x20058003;      // the rotation knob beyond the +X knob (handle pixels, 24)
constexpr Tag ECD_LineWidth = 0x20058004;        // the ellipse's line width (viewer pixels, 1)
constexpr Tag ECD_SoftLineWidth = 0x20058005;    // the soft ellipses' (1)
constexpr Tag ECD_RadiusScale = 0x20058006;      // drawn radius = value x scale (1)
constexpr Tag ECD_SoftScale = 0x20058007;        // drawn softness = value x scale (1)
constexpr Tag ECD_SetRadiusX = 0x20058008;       // where no Input gives it (0.2)
constexpr Tag ECD_SetRadiusY = 0x20058009;       // (0.1)
constexpr Tag ECD_SetAngle = 0x2005800a;         // (0)
constexpr Tag ECD_SetSoft = 0x2005800b;          // (0)
constexpr Tag ECD_FillOpacity = 0x2005800c;      // the shade's opacity (0.25)
constexpr Tag ECD_KnobSize = 0x2005800d;         // half side of the knobs (handle pixels, 4)
constexpr Tag ECD_CenterSize = 0x2005800e;       // radius of the centre's disc (handle pixels, 6)
constexpr Tag ECD_SoftReach = 0x2005800f;        // the soft knob stands this far off the edge (handle pixels, 12)
constexpr Tag ECD_AspectLock = 0x20058010;       // axis drags hold X radius / Y radius at this (0: free)
constexpr Tag ECD_MinSoft = 0x20058011;          // drags keep the softness at least this (0)
constexpr Tag ECD_MaxSoft = 0x20058012;          // and at most this (0: no limit)
constexpr Tag ECD_AngleOffset = 0x20058013;      // degrees added to the angle value when drawn
constexpr Tag ECD_CurrentRadiusX = 0x20058014;   // read only: the X radius as drawn
constexpr Tag ECD_CurrentRadiusY = 0x20058015;   // read only: the Y radius as drawn
constexpr Tag ECD_CurrentAngle = 0x20058016;     // read only: the angle as drawn
constexpr Tag ECS_Label = 0x30058000;            // a text beside the +X knob
constexpr Tag ECID_Visible = 0x80058000;         // a Number Input; 0 hides the ellipse
constexpr Tag ECP_Visible = 0x60058000;
constexpr Tag ECID_Lock = 0x80058001; // a Number Input; not 0: shown, not draggable
constexpr Tag ECP_Lock = 0x60058001;
constexpr Tag ECID_Size = 0x80058002; // a Number Input scaling both radii as drawn
constexpr Tag ECP_Size = 0x60058002;
constexpr Tag ECID_Offset = 0x80058003; // a Point Input added to the centre as drawn
constexpr Tag ECP_Offset = 0x60058003;

extern const TagMapEntry EllipseControlTags[];

} // namespace Orbane
