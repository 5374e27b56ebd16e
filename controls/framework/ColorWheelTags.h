#pragma once

#include "orbane/TagMapEntry.h"
#include "orbane/Tags.h"

namespace Orbane {

// Script tags of ColorWheelControl. The control stands on a Point Input: the
// puck's place in the colour plane (X, Y; its angle the hue, its length the
// saturation).
constexpr Tag CWCP_MasterInput = 0x40050000; // the master slider's Number Input; without it no master
constexpr Tag CWC_Role = 0x10050000;         // Lift, Gamma, Gain or Offset: the master's range and default
constexpr Tag CWCD_Rim = 0x20050000;         // the saturation at the wheel's rim (default 1)

// The roles of a grading wheel, in the order of the "WheelRole" enumeration.
enum WheelRole : int32
{
    WheelRole_Lift,
    WheelRole_Gamma,
    WheelRole_Gain,
    WheelRole_Offset,
    WheelRole_Count
};

extern const EnumEntry WheelRoleEnum[];
extern const TagMapEntry ColorWheelControlTags[];

} // namespace Orbane
