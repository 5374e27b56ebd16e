#pragma once

#include "orbane/Types.h"

class QMenu;

namespace Orbane {

class Input;

// The keyframe entries of an inspector control's context menu, for one Input
// at the document's current time. Each entry is one undo step named after it:
//   "Set Key"           the value shown now becomes a key (animating a plain
//                       Input with that one key);
//   "Remove Key"        drops the key at the current time; removing the last
//                       key removes the animation and keeps its value;
//   "Animate" / "Remove Animation"  switches animation on or off.
// Entries that cannot apply now are shown disabled.
class KeyframeMenu
{
public:
    static constexpr const char *kSetKey = "Set Key";
    static constexpr const char *kRemoveKey = "Remove Key";
    static constexpr const char *kAnimate = "Animate";
    static constexpr const char *kRemoveAnimation = "Remove Animation";

    // Adds the entries to `menu`; with `locked` (the tool takes no edits)
    // every entry is disabled.
    static void AddTo(QMenu *menu, Input *input, bool locked);

    static bool SetKey(Input *input);
    static bool RemoveKey(Input *input);
    // Is a key at exactly the document's current time?
    static bool HasKeyNow(const Input *input);
};

} // namespace Orbane
