#pragma once

#include "orbane/ScriptVal.h"

#include <string>

class QDir;

namespace Orbane {

class Input;
class Operator;

// The state of a tool's Inputs in a comp: per Input its plain value, or its
// keys { { time, value }, ... } with their interpolation, and its expression:
//   inputs = { Blend = { value = 0.5 },
//              Center = { interpolation = "smooth", keys = { { 0, { 0.5, 0.5, 0 } }, ... } } }
// Image paths are written relative to the comp's folder `base`.
class CompInputs
{
public:
    // The table of every Input of `tool`, in declaration order.
    static ScriptVal Save(const Operator &tool, const QDir &base);
    // Gives the Inputs of a tool that is in no document yet (so nothing is
    // recorded or shown) the state of `inputs`. Checks everything first, so
    // a refused table leaves the tool as it was; `error` names the Input.
    static bool Restore(Operator &tool, const ScriptVal &inputs, const QDir &base, std::string *error);
    // How a comp in `base` names a file: relative, so a comp moves with its
    // folder, unless the two share no folder below the root.
    static std::string PathFrom(const QDir &base, const std::string &file);
};

} // namespace Orbane
