#pragma once

#include "orbane/TagMapEntry.h"
#include "orbane/Tags.h"

namespace Orbane {

// Script tags of SplineControl (the curves editor).
constexpr Tag SPC_SplineColor = 0x10050000;   // colour of the luminance curve (kind 5)
constexpr Tag SPC_ShowRed = 0x10050001;       // the red curve is offered (default on)
constexpr Tag SPC_ShowGreen = 0x10050002;     // the green curve is offered (default on)
constexpr Tag SPC_ShowBlue = 0x10050003;      // the blue curve is offered (default on)
constexpr Tag SPC_ShowAlpha = 0x10050004;     // the alpha curve is offered (default off)
constexpr Tag SPC_ShowLuma = 0x10050005;      // the luminance curve is offered (default on)
constexpr Tag SPC_ActiveCurve = 0x10050006;   // the curve the mouse edits ("SplineCurve")
constexpr Tag SPC_Linear = 0x10050007;        // a reset curve has straight segments
constexpr Tag SPC_GridDivisions = 0x10050008; // grid lines across each axis (default 4)
constexpr Tag SPC_MaxPoints = 0x10050009;     // the most points a curve takes (default 32)
constexpr Tag SPC_LockEnds = 0x1005000A;      // the end points move up and down only
constexpr Tag SPC_ShowHistogram = 0x1005000B; // the viewed image's histogram behind the curves
constexpr Tag SPC_Height = 0x1005000C;        // the graph's height in pixels (default 160)
constexpr Tag SPC_ShowDiagonal = 0x1005000D;  // the identity line (default on)
constexpr Tag SPC_ShowCoords = 0x1005000E;    // the dragged point's values shown (default on)
constexpr Tag SPCD_SnapX = 0x20050000;        // points always snap to this input step (0: off)
constexpr Tag SPCD_SnapY = 0x20050001;        // and this output step
constexpr Tag SPCD_MinX = 0x20050002;         // the view's range (default 0..1 both ways)
constexpr Tag SPCD_MaxX = 0x20050003;
constexpr Tag SPCD_MinY = 0x20050004;
constexpr Tag SPCD_MaxY = 0x20050005;

// The curves, in the order of the SplineCurve enumeration and of the keys
// of the value's table.
enum SplineCurve : int32
{
    SPLINE_Luma,
    SPLINE_Red,
    SPLINE_Green,
    SPLINE_Blue,
    SPLINE_Alpha,
    SPLINE_CurveCount
};

extern const EnumEntry SplineCurveEnum[];
extern const TagMapEntry SplineControlTags[];

} // namespace Orbane
