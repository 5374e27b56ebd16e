#pragma once

#include "orbane/Input.h"
#include "orbane/InputControl.h"
#include "orbane/TagList.h"

#include <algorithm>

namespace Orbane {

// A further Input that an inspector control edits besides the one it stands
// on (a range's high end, a font's style, a clip's trim frames), passed as
// an object tag. The inspector binds a control to its own Input only, so the
// control binds this one itself: it joins the control's Inputs (watched, and
// unbound with OnDisconnect like the first). Returns whether `slot` changed;
// a list without `tag` leaves it alone, and the control's own Input is
// never taken twice.
inline bool LinkInput(InputControl &control, const TagList &tags, Tag tag, Input *&slot)
{
    if (!tags.FindQuery(tag))
        return false;
    Input *in = dynamic_cast<Input *>(tags.GetObject(tag));
    const std::vector<Input *> &bound = control.Inputs();
    if (in == slot || (in && std::find(bound.begin(), bound.end(), in) != bound.end()))
        return false;
    if (slot)
        control.InputControl::RemoveInput(slot, nullptr);
    slot = in && control.InputControl::AddInput(in, nullptr) ? in : nullptr;
    return true;
}

} // namespace Orbane
