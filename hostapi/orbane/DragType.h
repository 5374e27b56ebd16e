#pragma once

#include "orbane/Types.h"

namespace Orbane {

// The drag an overlay's ControlDown starts. Overlays may use further values
// of their own above DRAG_Handle.
enum DragType : int32
{
    DRAG_None = 0,
    DRAG_Linked = 1, // a press on the handle of an overlay linked through an Input
    DRAG_Handle = 2, // the overlay's own handle
};

} // namespace Orbane
