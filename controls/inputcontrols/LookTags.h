#pragma once

#include "orbane/Types.h"

#include <Qt>

class QWidget;

namespace Orbane {

// How the look tags of the inspector controls reach Qt widgets: colours
// packed as the tag maps carry them (RGBA8, all bits set for none), the
// "Align" enumeration, bold text.
class LookTags
{
public:
    // The colour for the widget's text (and a plain frame's line), or the
    // palette's own where `packed` is none.
    static void SetTextColor(QWidget *widget, uint32 packed);
    static void SetBold(QWidget *widget, bool bold);
    // "Align": 0 Left, 1 CenteredLeft, 2 Center, 3 CenteredRight, 4 Right.
    static Qt::Alignment AlignmentOf(int32 align);
};

} // namespace Orbane
