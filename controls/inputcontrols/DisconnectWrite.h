#pragma once

#include "orbane/AutoParam.h"
#include "orbane/Input.h"

namespace Orbane {

// What a control does when it is unbound from an Input: it writes the value
// it showed at the disconnect time, without an undo record, so that the
// Input keeps what the user last saw even where the user never touched it.
inline bool WriteOnDisconnect(Input *input, Parameter *value)
{
    static_assert(SETVALUE_NoUndo == 1, "the disconnect write uses flags 1");
    if (!input || !value)
        return false;
    return input->SetValue(value, TIME_DISCONNECT, SETVALUE_NoUndo, nullptr);
}

inline bool WriteOnDisconnect(Input *input, float64 value)
{
    AutoNumber number(value);
    return WriteOnDisconnect(input, number.get());
}

} // namespace Orbane
