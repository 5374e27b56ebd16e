#pragma once

#include "orbane/OrbID.h"

#include <string>

namespace Orbane {

class PolyLine;
class ScriptVal;

// Shapes as script tables, both ways:
//   { kind = "bezier" | "bspline", closed = bool,
//     points = { { x =, y =, inX =, inY =, outX =, outY =, weight =, time =,
//                  pressure =, height =, angleXY =, angleZ =, rotation =,
//                  dispX =, dispY =, id =, follows =, linear =, tagged =,
//                  published =, following =, gap = }, ... } }
// in image coordinates (0..1 across each axis, Y up), handles absolute.
// Missing handles lie on their point; missing extras take their defaults.
class PolyLineScript
{
public:
    // A new shape of `dataType` (one reference), or null with `error` saying
    // which point and field is wrong. A `kind` that disagrees with the data
    // type is an error; a missing `kind` takes the data type's.
    static PolyLine *FromScript(const OrbID &dataType, const ScriptVal &value, std::string *error);
    static ScriptVal ToScript(const PolyLine &shape);
};

} // namespace Orbane
