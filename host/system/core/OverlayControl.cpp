#include "orbane/OverlayControl.h"

namespace Orbane {

const OrbID OverlayControl::ClassID("OverlayControl");

OverlayControl::OverlayControl(const Registry *reg, const ScriptVal &args, const TagList &tags)
    : PreviewControl(reg, args, tags)
{}

OverlayControl::~OverlayControl() = default;

} // namespace Orbane
