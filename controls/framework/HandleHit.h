#pragma once

#include "orbane/Types.h"

namespace Orbane {

// What a hit test found: the part and item of the winning handle, or part 0.
struct HandleHit
{
    uint32 part = 0;
    int32 item = -1;

    explicit operator bool() const noexcept { return part != 0; }
    bool operator==(const HandleHit &o) const noexcept { return part == o.part && item == o.item; }
    bool operator!=(const HandleHit &o) const noexcept { return !(*this == o); }
};

} // namespace Orbane
