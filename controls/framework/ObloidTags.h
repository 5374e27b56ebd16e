#pragma once

#include "orbane/TagMapEntry.h"
#include "orbane/Tags.h"

namespace Orbane {

// Script tags of ObloidControl (class ID "CubeControl"). Its main Input is
// the box's centre, a Point whose X, Y and Z are world units (image widths as
// displayed, the origin at the image's centre); the _Input tags say which of
// its Inputs hold the three sizes and the three turns (-1, or an index with
// no Input: the Set tag's value, not draggable).
constexpr Tag OBC_SizeXInput = 0x10058000;  // default 1
constexpr Tag OBC_SizeYInput = 0x10058001;  // default 2
constexpr Tag OBC_SizeZInput = 0x10058002;  // default 3
constexpr Tag OBC_RotXInput = 0x10058003;   // default 4 (degrees)
constexpr Tag OBC_RotYInput = 0x10058004;   // default 5
constexpr Tag OBC_RotZInput = 0x10058005;   // default 6
constexpr Tag OBC_Uniform = 0x10058006;     // face drags scale all three sizes alike, as with Shift
constexpr Tag OBC_AboutCenter = 0x10058007; // face drags move the opposite face too, as with Ctrl
constexpr Tag OBC_Cube = 0x10058008;        // one size, X, for all three axes
constexpr Tag OBC_ShowFaces = 0x10058009;   // the six face handles (default on)
constexpr Tag OBC_ShowCenter = 0x1005800a;  // the centre handle (default on)
constexpr Tag OBC_ShowAxes = 0x1005800b;    // the box's own axes from its centre, X red, Y green, Z blue
constexpr Tag OBC_ShowHidden = 0x1005800c;  // edges behind the box drawn dashed (default on); off: left out
constexpr Tag OBC_PenStyle = 0x1005800d;    // the visible edges' pen: 0 solid, 1..4 dashed as the rectangle's
constexpr Tag OBC_FillFaces = 0x1005800e;   // shade the faces that face the camera
constexpr Tag OBC_Color = 0x1005800f;       // the edges' colour (default: the overlay's)
constexpr Tag OBC_FillColor = 0x10058010;   // the shade's colour
constexpr Tag OBC_AxisMove =
    0x10058011; // centre drags: 0 in the view's plane, 1 along X, 2 Y, 3 Z, 4 on the ground (XZ)
constexpr Tag OBC_HideWhileDragging = 0x10058012; // only the handles are drawn while the box is dragged
constexpr Tag OBC_KeysDepth = 0x10058013;         // Up and Down move the centre in Z (away, nearer) instead of Y
constexpr Tag OBCD_SetSizeX = 0x20058000;         // where no Input gives it (0.5)
constexpr Tag OBCD_SetSizeY = 0x20058001;         // (0.5)
constexpr Tag OBCD_SetSizeZ = 0x20058002;         // (0.5)
constexpr Tag OBCD_SetRotX = 0x20058003;          // (0)
constexpr Tag OBCD_SetRotY = 0x20058004;          // (0)
constexpr Tag OBCD_SetRotZ = 0x20058005;          // (0)
constexpr Tag OBCD_MinSize = 0x20058006;          // drags keep each size at least this (0)
constexpr Tag OBCD_MaxSize = 0x20058007;          // and at most this (0: no limit)
constexpr Tag OBCD_SizeScale = 0x20058008;        // drawn size = value x scale (1)
constexpr Tag OBCD_LineWidth = 0x20058009;        // the edges' width (viewer pixels, 1)
constexpr Tag OBCD_FillOpacity = 0x2005800a;      // the shade's opacity (0.2)
constexpr Tag OBCD_KnobSize = 0x2005800b;         // half side of the face knobs (handle pixels, 4)
constexpr Tag OBCD_CenterSize = 0x2005800c;       // radius of the centre's disc (handle pixels, 6)
constexpr Tag OBCD_SizeStep = 0x2005800d;         // face drags snap the size to multiples of this (0: none)
constexpr Tag OBCD_CurrentSizeX = 0x2005800e;     // read only: the X size as drawn
constexpr Tag OBCD_CurrentSizeY = 0x2005800f;     // read only: the Y size as drawn
constexpr Tag OBCD_CurrentSizeZ = 0x20058010;     // read only: the Z size as drawn
constexpr Tag OBCS_Label = 0x30058000;            // a text beside the centre
constexpr Tag OBCID_Visible = 0x80058000;         // a Number Input; 0 hides the box
constexpr Tag OBCP_Visible = 0x60058000;
constexpr Tag OBCID_Lock = 0x80058001; // a Number Input; not 0: shown without handles
constexpr Tag OBCP_Lock = 0x60058001;
constexpr Tag OBCID_Size = 0x80058002; // a Number Input scaling all three sizes as drawn
constexpr Tag OBCP_Size = 0x60058002;
constexpr Tag OBCID_Camera = 0x80058003; // a script-table Input holding the camera to draw through
constexpr Tag OBCP_Camera = 0x60058003;

extern const TagMapEntry ObloidControlTags[];

} // namespace Orbane
