#pragma once

#include "orbane/OrbID.h"

#include <string>

namespace Orbane {

class Parameter;
class ScriptVal;

// Script values of Input data types, both ways: a Number is a number, a
// Point a table {x, y[, z]} (also {X=, Y=, Z=}), Text a string, an ID a
// string, a ScriptVal a table, a shape the table of PolyLineScript.
class ParameterScript
{
public:
    // A new Parameter (one reference) of `dataType`; null with `error` set
    // where the value does not suit the type.
    static Parameter *FromScript(const OrbID &dataType, const ScriptVal &value, std::string *error);
    static ScriptVal ToScript(const Parameter *value);
    // Whether every number in `value` (and in its tables) is finite: a key
    // or a saved value of NaN or infinity is refused before it is stored.
    static bool IsFinite(const ScriptVal &value);
};

} // namespace Orbane
