#pragma once

#include "orbane/AutoRef.h"
#include "orbane/Input.h"
#include "orbane/Parameter.h"

#include <map>

namespace Orbane {

// The value of an animated Input between two of its keys, linear or smooth.
class KeyBlend
{
public:
    using Keys = std::map<float64, AutoRef<Parameter>>;

    // `after` is the first key later than `time`, and a key lies before it
    // (the caller answers the times at and beyond the keys itself). A new
    // value, one reference for the caller.
    static Parameter *Between(const Keys &keys, Keys::const_iterator after, float64 time, Interpolation mode);
};

} // namespace Orbane
