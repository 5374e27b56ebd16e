#include "orbane/PreviewControl.h"

namespace Orbane {

const OrbID PreviewControl::ClassID("PreviewControl");

PreviewControl::PreviewControl(const Registry *reg, const ScriptVal &args, const TagList &tags)
    : Object(reg, args, tags)
{}

PreviewControl::~PreviewControl() = default;

bool PreviewControl::RegCleanup(Registry *reg)
{
    return Object::RegCleanup(reg);
}

} // namespace Orbane
