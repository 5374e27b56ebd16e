#pragma once

#include "orbane/Parameter.h"

namespace Orbane {

// An identifier value (CLSID_DataType_ID), such as the chosen item of an
// identifier combo box; steps between keys.
class OrbIDParam : public Parameter
{
public:
    explicit OrbIDParam(OrbID value = OrbID()) noexcept : Value(value) {}
    explicit OrbIDParam(const char *value) : Value(value) {}

    const OrbID &DataType() const noexcept override;
    Parameter *Clone() const override;
    bool Equals(const Parameter &o) const override;

    OrbID Value;
};

} // namespace Orbane
