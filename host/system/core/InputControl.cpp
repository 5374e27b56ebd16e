#include "orbane/InputControl.h"

namespace Orbane {

const OrbID InputControl::ClassID("InputControl");

_InputControl::_InputControl(const Registry *reg, const ScriptVal &args, const TagList &tags)
    : Object(reg, args, tags)
{}

_InputControl::~_InputControl() = default;

InputControl::InputControl(const Registry *reg, const ScriptVal &args, const TagList &tags)
    : _InputControl(reg, args, tags)
{}

InputControl::~InputControl() = default;

} // namespace Orbane
