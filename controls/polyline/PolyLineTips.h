#pragma once

#include "orbane/Types.h"

#include <string>

namespace Orbane {

// The polyline overlay's tool tips, built from their pieces:
//   over a point:      "<tool>:<shape> - Point <n>[ Inner| Outer][ <tag>][ (at time <t>)]"
//   over an onion skin: "Time : <t>"
// The role names which shape of an inner/outer pair the point is on; the
// time is given where the shape is animated.
class PolyLineTips
{
public:
    enum Role
    {
        Single,
        Inner,
        Outer,
    };
    struct Point
    {
        const char *tool = "";
        const char *shape = "";
        int32 index = 0; // from 0; shown from 1, as the point numbers are
        Role role = Single;
        const char *tag = nullptr; // a tagged or published point's name
        bool animated = false;
        float64 time = 0.0;
    };
    static std::string ForPoint(const Point &p);
    static std::string ForSkin(float64 time);
};

} // namespace Orbane
