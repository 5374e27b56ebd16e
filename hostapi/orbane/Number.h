#pragma once

#include "orbane/Parameter.h"

namespace Orbane {

// A number value (CLSID_DataType_Number); blends linearly between keys.
class Number : public Parameter
{
public:
    explicit Number(float64 value = 0.0) noexcept : Value(value) {}

    const OrbID &DataType() const noexcept override;
    Parameter *Clone() const override;
    bool Equals(const Parameter &o) const override;
    Parameter *Interpolate(const Parameter &to, float64 t) const override;

    float64 Value;
};

} // namespace Orbane
