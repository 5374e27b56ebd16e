#pragma once

#include "orbane/FallbackControl.h"

namespace Orbane {

// A distinct type for each inspector control not written yet, so that the
// exported casts tell them apart; it shows its Input's label and value as
// read-only text, so a tool that asks for it still reads right:
// `using ButtonControl =
// PendingInputControl<struct ButtonControlMarker>`. A real class replaces the
// alias (see ControlClasses.h) without touching its registration.
template <class Marker>
class PendingInputControl : public FallbackControl
{
public:
    using FallbackControl::FallbackControl;

    std::size_t SizeOf() const override { return sizeof(PendingInputControl); }

    // The class has no static buffers yet: its clean-up is the family's.
    static bool RegCleanup(Registry *reg) { return InputControl::RegCleanup(reg); }
};

} // namespace Orbane
