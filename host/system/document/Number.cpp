#include "orbane/Number.h"

#include "orbane/ClassIDs.h"

namespace Orbane {

const OrbID &Number::DataType() const noexcept
{
    return CLSID_DataType_Number;
}

Parameter *Number::Clone() const
{
    return new Number(Value);
}

bool Number::Equals(const Parameter &o) const
{
    const auto *n = dynamic_cast<const Number *>(&o);
    return n && n->Value == Value;
}

Parameter *Number::Interpolate(const Parameter &to, float64 t) const
{
    const auto *n = dynamic_cast<const Number *>(&to);
    if (!n)
        return Clone();
    return new Number(Value + (n->Value - Value) * t);
}

} // namespace Orbane
