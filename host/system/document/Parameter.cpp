#include "orbane/Parameter.h"

namespace Orbane {

Parameter::~Parameter() = default;

std::size_t Parameter::Footprint() const noexcept
{
    return kSmallFootprint;
}

Parameter *Parameter::Interpolate(const Parameter &to, float64 t) const
{
    const bool reached = t >= 1.0 && to.DataType() == DataType();
    return (reached ? to : *this).Clone();
}

} // namespace Orbane
