#include "orbane/Point.h"

#include "orbane/ClassIDs.h"

namespace Orbane {

const OrbID &Point::DataType() const noexcept
{
    return CLSID_DataType_Point;
}

Parameter *Point::Clone() const
{
    return new Point(X, Y, Z);
}

bool Point::Equals(const Parameter &o) const
{
    const auto *p = dynamic_cast<const Point *>(&o);
    return p && p->X == X && p->Y == Y && p->Z == Z;
}

Parameter *Point::Interpolate(const Parameter &to, float64 t) const
{
    const auto *p = dynamic_cast<const Point *>(&to);
    if (!p)
        return Clone();
    return new Point(X + (p->X - X) * t, Y + (p->Y - Y) * t, Z + (p->Z - Z) * t);
}

} // namespace Orbane
