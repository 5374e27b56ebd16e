#pragma once

#include "orbane/Types.h"

#include <QtGlobal>

namespace Orbane {

class DIB;

// A set of images of one skin element, one per state (normal, hover, held,
// ...). Each stored image holds one use; a state never set answers null.
class StateDIBs
{
public:
    static constexpr int32 MaxStates = 4;

    StateDIBs() = default;
    ~StateDIBs();
    StateDIBs(const StateDIBs &) = delete;
    StateDIBs &operator=(const StateDIBs &) = delete;

    // Loads "<base>.1", "<base>.2", ... from the look pack into states 0, 1, ...
    // until one is missing. Null where not even the first exists.
    static StateDIBs *FromResource(const char *base, qreal ratio);

    // Stores `image` (taking a use) as `state`, recycling what was there.
    // States outside 0..MaxStates-1 are ignored.
    void SetState(int32 state, DIB *image);
    DIB *GetState(int32 state) const noexcept;
    // The number of states up to and including the last one set.
    int32 Count() const noexcept;

private:
    DIB *mStates[MaxStates] = {};
};

} // namespace Orbane
