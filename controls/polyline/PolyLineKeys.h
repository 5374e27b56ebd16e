#pragma once

#include "orbane/Types.h"

#include <Qt>

namespace Orbane {

// The keys the polyline overlay takes from the viewer, and what each does.
// Most letters are taken only with Shift alone, so that the viewer's own
// single-letter keys keep working over a shape; O and X are taken with any
// modifiers; G, J, Q, U and W never.
class PolyLineKeys
{
public:
    // A key's action: a command of the overlay (PolyLineCommand) with its
    // argument, a nudge of the selected points (the arrows), or nothing (a
    // modifier held on its own).
    struct Action
    {
        enum Kind
        {
            None,
            Command,
            Nudge,
        } kind = None;
        int32 command = 0;
        int32 arg = 0;
    };

    // Does the overlay claim `key` with these modifiers held? Only Shift,
    // Control and Alt count.
    static bool Claims(int key, Qt::KeyboardModifiers mods) noexcept;
    // What the claimed `key` does; None for a key that is not claimed.
    static Action ActionOf(int key, Qt::KeyboardModifiers mods) noexcept;
};

} // namespace Orbane
