#pragma once

#include "orbane/OrbColor.h"
#include "orbane/Types.h"

#include <QObject>

#include <memory>

namespace Orbane {

// What the polyline overlay's menu, toolbar and keys switch that is neither
// the shape nor the draw flags: plain view and tool settings.
struct PolyLineSettings
{
    bool pointNumbers = false;      // each key point's number drawn beside it
    bool hull = false;              // the Bezier control polygon drawn
    bool reduceOpen = false;        // the reduce-points dialog is shown
    bool publishPathPoints = false; // new points of a published shape publish themselves
    bool onionEnabled = true;       // the other keyframes' shapes drawn
    bool onionClickTime = false;    // a click on an onion skin goes to its time
    float64 onionAnchor = TIME_UNDEFINED;
    OrbColor onionPrevColor; // the skins before the current time; none: the skin colour
    bool rotoEnabled = false, rotoMultiple = false, rotoTrackPoints = false;
    bool rotoShowArea = false, rotoPatternEdit = false;
    int32 rotoDistance = 5;  // frames between tracked keys
    int32 rotoFrameSkip = 1; // frames the tracker steps
};

// The command surface's own part of the overlay, held apart so that the
// overlay stays small enough for the host's pooled allocator.
struct PolyLineSurface
{
    PolyLineSettings settings;
    std::unique_ptr<QObject> dialogs; // the parent of open dialogs: they go with the control
};

} // namespace Orbane
