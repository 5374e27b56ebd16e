#pragma once

#include "orbane/Types.h"

#include <string>

namespace Orbane {

class PolyLine;

// Shapes in SVG files. Reading takes the first path element of the file
// (after the transforms of it and its groups), its first subpath, and maps
// the document's viewBox (or, without one, its width and height) onto image
// coordinates, 0..1 across with Y up. Writing is the reverse, for a
// document of `width` by `height` user units.
class SvgPath
{
public:
    // A new Bezier shape (one reference), or null with `error` naming the
    // file and the line, column or path character where reading failed.
    static PolyLine *Read(const std::string &file, std::string *error);
    // The path data of `shape` (a B-spline shape is written through its
    // Bezier form) in the user units of a `width` by `height` document.
    static std::string PathData(const PolyLine &shape, float64 width, float64 height);
    static bool Write(const std::string &file, const PolyLine &shape, float64 width, float64 height,
                      std::string *error);
};

} // namespace Orbane
