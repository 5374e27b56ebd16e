#include "polyline/PolyLineTips.h"

#include <cstdio>

namespace Orbane {

namespace {

template <class... A> std::string Printed(const char *format, A... args)
{
    char text[256];
    std::snprintf(text, sizeof text, format, args...);
    return text;
}

} // namespace

std::string PolyLineTips::ForPoint(const Point &p)
{
    std::string tip = p.tool;
    tip += Printed(":%s - ", p.shape);
    tip += Printed("Point %d", int(p.index + 1));
    if (p.role == Inner)
        tip += " Inner";
    else if (p.role == Outer)
        tip += " Outer";
    if (p.tag && *p.tag)
        tip += Printed(" %s", p.tag);
    if (p.animated)
        tip += Printed(" (at time %.2f)", p.time);
    return tip;
}

std::string PolyLineTips::ForSkin(float64 time)
{
    return Printed("Time : %.2f", time);
}

} // namespace Orbane
