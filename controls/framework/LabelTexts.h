#pragma once

#include "orbane/OrbString.h"

namespace Orbane {

class Input;
class TagList;

// An inspector control's label texts, and whether they changed since the
// control last showed them.
struct LabelTexts
{
    OrbString label;  // shown by the control's main child
    OrbString second; // shown by its label widget
    bool changed = false;

    // From the Input's attributes: the label is 0x30040000, else 0x30020014,
    // else the identifier; the second text is 0x30040001.
    void Read(const Input *input);
    // From attributes a script or the tool set: takes a text only where one of
    // its tags is present, and marks the texts changed where one differs.
    void Take(const TagList &tags);
    // Both texts, for GetAttrs.
    void AddTo(TagList &tags) const;
};

} // namespace Orbane
