#pragma once

#include "orbane/Types.h"

#include <string>

namespace Orbane {

class PolyLine;

// The project's own shape file: plain text, one statement a line, so a
// person can read and mend it.
//   orbane-shape 1
//   kind bezier            (or bspline)
//   closed true
//   point x=0.25 y=0.5 inX=0.2 inY=0.5 outX=0.3 outY=0.5 pressure=0.8
// The fields of a point are those of the script table of a shape;
// '#' starts a comment.
class ShapeFile
{
public:
    // A new shape (one reference) as the file says; null with `error`
    // naming the file, the line and, where it helps, the column.
    static PolyLine *Read(const std::string &file, std::string *error);
    // The same from text (the clipboard's); `name` stands for the file in
    // errors.
    static PolyLine *Parse(const std::string &text, const std::string &name, std::string *error);
    static std::string Text(const PolyLine &shape);
    static bool Write(const std::string &file, const PolyLine &shape, std::string *error);

    // By the file's extension: ".svg" through SvgPath, anything else as a
    // shape file. Export writes SVG for a `width` by `height` image.
    static PolyLine *Import(const std::string &file, std::string *error);
    static bool Export(const std::string &file, const PolyLine &shape, float64 width, float64 height,
                       std::string *error);
};

} // namespace Orbane
