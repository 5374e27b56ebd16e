#include "orbane/Parameter.h"

namespace Orbane {

Parameter::~Parameter() = default;

Parameter *Parameter::Interpolate(const Parameter &to, float64 t) const
{
    const bool reached = t >= 1.0 && to.DataType() == DataType();
    return (reached ? to : *this).Clone();
}

} // namespace Orbane
