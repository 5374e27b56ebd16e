#pragma once

#include "orbane/PreviewControl.h"

#include <vector>

namespace Orbane {

// The polyline overlay's viewer toolbar: its buttons, in order, with their
// tips and short labels, the "Publish" and "Multiframe" pop-downs and the
// "Onion Skin" and "Roto Assist" groups, parted by separators. Every button
// sends a command of the overlay (PolyLineCommand) with an argument, the
// same one the context menu sends.
class PolyLineToolbar
{
public:
    struct Values
    {
        int32 rotoDistance = 0;
        int32 rotoFrameSkip = 0;
    };
    static std::vector<PreviewControl::ToolbarEvent> Events(const Values &values);
    // The command and argument of a button's id; false for an id that is
    // not one of the toolbar's.
    static bool CommandOf(const OrbID &id, int32 &command, int32 &arg);
};

} // namespace Orbane
