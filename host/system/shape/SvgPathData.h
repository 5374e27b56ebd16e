#pragma once

#include "orbane/OrbPointT.h"

#include <string>
#include <vector>

namespace Orbane {

// The path data of an SVG path element ("M 10 10 C 20 0 ..."), read into
// cubic pieces: every command of the path grammar, absolute and relative
// (M L H V C S Q T A Z). Lines become cubics with their handles on their
// ends, quadratics are raised to cubics exactly, and elliptical arcs are
// split into cubics of at most a quarter turn.
class SvgPathData
{
public:
    struct Cubic
    {
        OrbPoint c1, c2, end;
        bool line; // from L, H, V or a closing Z: the handles lie on the ends
    };
    struct Subpath
    {
        OrbPoint start;
        std::vector<Cubic> pieces;
        bool closed = false;
    };

    // False with `error` naming the character (from 1) where reading failed.
    static bool Parse(const char *d, std::vector<Subpath> &out, std::string *error);
};

} // namespace Orbane
