#pragma once

#include "orbane/OrbID.h"
#include "orbane/ScriptObject.h"

#include <cstddef>

namespace Orbane {

// A value of an Input. Reference counted: it starts with one reference owned
// by its creator (hold it in an AutoParam). A value that an Input stores or
// hands out is never changed afterwards; to edit one, Clone it.
class Parameter : public RefObject
{
public:
    // The CLSID_DataType_ id of this kind of value; an Input accepts only
    // values of its own data type.
    virtual const OrbID &DataType() const noexcept = 0;
    // A new value equal to this one, with one reference for the caller.
    virtual Parameter *Clone() const = 0;
    virtual bool Equals(const Parameter &o) const = 0;
    // The value a fraction `t` (0..1) of the way from this one to `to`, with
    // one reference for the caller. The base steps: it holds this value until
    // `t` reaches 1. Numeric kinds blend linearly. A `to` of another kind
    // yields a copy of this value.
    virtual Parameter *Interpolate(const Parameter &to, float64 t) const;
    // About how many bytes the value holds. The undo history adds these up
    // to stay within its memory bound; kinds that hold more than a few
    // numbers say so.
    virtual std::size_t Footprint() const noexcept;
    // What a value of a few numbers costs, its object and bookkeeping.
    static constexpr std::size_t kSmallFootprint = 64;

    // Scripts know a value by its data type ("Number", "Point").
    const char *ScriptTypeName() const override { return DataType().c_str(); }

protected:
    ~Parameter() override;
};

} // namespace Orbane
