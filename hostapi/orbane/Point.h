#pragma once

#include "orbane/Parameter.h"

namespace Orbane {

// A position value (CLSID_DataType_Point), normalised image coordinates for
// X and Y; blends linearly between keys, component by component.
class Point : public Parameter
{
public:
    explicit Point(float64 x = 0.0, float64 y = 0.0, float64 z = 0.0) noexcept : X(x), Y(y), Z(z) {}

    const OrbID &DataType() const noexcept override;
    Parameter *Clone() const override;
    bool Equals(const Parameter &o) const override;
    Parameter *Interpolate(const Parameter &to, float64 t) const override;

    float64 X;
    float64 Y;
    float64 Z;
};

} // namespace Orbane
