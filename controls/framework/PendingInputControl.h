#pragma once

#include "framework/PendingInputBase.h"

namespace Orbane {

// A distinct type for each inspector control not written yet, so that the
// exported casts tell them apart: `using ButtonControl =
// PendingInputControl<struct ButtonControlMarker>`. A real class replaces the
// alias (see ControlClasses.h) without touching its registration.
template <class Marker>
class PendingInputControl : public PendingInputBase
{
public:
    using PendingInputBase::PendingInputBase;

    std::size_t SizeOf() const override { return sizeof(PendingInputControl); }

    // The class has no static buffers yet: its clean-up is the family's.
    static bool RegCleanup(Registry *reg) { return InputControl::RegCleanup(reg); }
};

} // namespace Orbane
