#include "framework/SplineTags.h"

#include "framework/TagTable.h"

namespace Orbane {

const EnumEntry SplineCurveEnum[] = {
    {ENUM_NameRow, "SplineCurve"}, {SPLINE_Luma, "Luma"},   {SPLINE_Red, "Red"}, {SPLINE_Green, "Green"},
    {SPLINE_Blue, "Blue"},         {SPLINE_Alpha, "Alpha"}, {0, nullptr},
};

const TagMapEntry SplineControlTags[] = {
    ORBANE_TAG(SPC_SplineColor, TMK_Color),
    ORBANE_TAG(SPC_ShowRed, TMK_Boolean),
    ORBANE_TAG(SPC_ShowGreen, TMK_Boolean),
    ORBANE_TAG(SPC_ShowBlue, TMK_Boolean),
    ORBANE_TAG(SPC_ShowAlpha, TMK_Boolean),
    ORBANE_TAG(SPC_ShowLuma, TMK_Boolean),
    ORBANE_ENUM_TAG(SPC_ActiveCurve, SplineCurveEnum),
    ORBANE_TAG(SPC_Linear, TMK_Boolean),
    ORBANE_TAG(SPC_GridDivisions, TMK_Plain),
    ORBANE_TAG(SPC_MaxPoints, TMK_Plain),
    ORBANE_TAG(SPC_LockEnds, TMK_Boolean),
    ORBANE_TAG(SPC_ShowHistogram, TMK_Boolean),
    ORBANE_TAG(SPC_Height, TMK_Plain),
    ORBANE_TAG(SPC_ShowDiagonal, TMK_Boolean),
    ORBANE_TAG(SPC_ShowCoords, TMK_Boolean),
    ORBANE_TAG(SPCD_SnapX, TMK_Plain),
    ORBANE_TAG(SPCD_SnapY, TMK_Plain),
    ORBANE_TAG(SPCD_MinX, TMK_Plain),
    ORBANE_TAG(SPCD_MaxX, TMK_Plain),
    ORBANE_TAG(SPCD_MinY, TMK_Plain),
    ORBANE_TAG(SPCD_MaxY, TMK_Plain),
    ORBANE_TAG_END,
};

} // namespace Orbane
