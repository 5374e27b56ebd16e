#pragma once

#include "orbane/OrbString.h"
#include "orbane/Parameter.h"

namespace Orbane {

// A text value (CLSID_DataType_Text); steps between keys.
class Text : public Parameter
{
public:
    explicit Text(OrbString value = OrbString()) : Value(std::move(value)) {}
    explicit Text(const char *value) : Value(value) {}

    const OrbID &DataType() const noexcept override;
    Parameter *Clone() const override;
    std::size_t Footprint() const noexcept override;
    bool Equals(const Parameter &o) const override;

    OrbString Value;
};

} // namespace Orbane
