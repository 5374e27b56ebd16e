#include "framework/CameraTags.h"

#include "framework/TagTable.h"

namespace Orbane {

const TagMapEntry CameraControlTags[] = {
    ORBANE_TAG(CC_RotXInput, TMK_Plain),
    ORBANE_TAG(CC_RotYInput, TMK_Plain),
    ORBANE_TAG(CC_RotZInput, TMK_Plain),
    ORBANE_TAG(CC_FocalInput, TMK_Plain),
    ORBANE_TAG(CC_ApertureInput, TMK_Plain),
    ORBANE_TAG(CC_TargetInput, TMK_Plain),
    ORBANE_TAG(CC_ShowFrustum, TMK_Boolean),
    ORBANE_TAG(CC_ShowBody, TMK_Boolean),
    ORBANE_TAG(CC_ShowTarget, TMK_Boolean),
    ORBANE_TAG(CC_ShowNearFar, TMK_Boolean),
    ORBANE_TAG(CC_PenStyle, TMK_Plain),
    ORBANE_TAG(CC_Color, TMK_Color),
    ORBANE_TAG(CC_FrustumColor, TMK_Color),
    ORBANE_TAG(CC_KeysAim, TMK_Boolean),
    ORBANE_TAG(CCD_Focal, TMK_Plain),
    ORBANE_TAG(CCD_Aperture, TMK_Plain),
    ORBANE_TAG(CCD_Near, TMK_Plain),
    ORBANE_TAG(CCD_Far, TMK_Plain),
    ORBANE_TAG(CCD_FilmAspect, TMK_Plain),
    ORBANE_TAG(CCD_AimDistance, TMK_Plain),
    ORBANE_TAG(CCD_BodySize, TMK_Plain),
    ORBANE_TAG(CCD_LineWidth, TMK_Plain),
    ORBANE_TAG(CCD_KnobSize, TMK_Plain),
    ORBANE_TAG(CCS_Label, TMK_Plain),
    ORBANE_TAG(CCID_Visible, TMK_Plain),
    ORBANE_OBJECT_TAG(CCP_Visible, "Input"),
    ORBANE_TAG_END,
};

const EnumEntry LightTypeEnum[] = {
    {ENUM_NameRow, "LightType"}, {0, "Directional"}, {1, "Point"}, {2, "Spot"}, {0, nullptr},
};

const TagMapEntry LightControlTags[] = {
    ORBANE_ENUM_TAG(LC_LightType, LightTypeEnum),
    ORBANE_TAG_END,
};

} // namespace Orbane
