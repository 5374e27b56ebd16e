#include "framework/ColorWheelTags.h"

#include "framework/TagTable.h"

namespace Orbane {

const EnumEntry WheelRoleEnum[] = {
    {ENUM_NameRow, "WheelRole"}, {0, "Lift"}, {1, "Gamma"}, {2, "Gain"}, {3, "Offset"}, {0, nullptr},
};

const TagMapEntry ColorWheelControlTags[] = {
    ORBANE_OBJECT_TAG(CWCP_MasterInput, "Input"),
    ORBANE_ENUM_TAG(CWC_Role, WheelRoleEnum),
    ORBANE_TAG(CWCD_Rim, TMK_Plain),
    ORBANE_TAG_END,
};

} // namespace Orbane
