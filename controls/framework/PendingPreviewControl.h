#pragma once

#include "orbane/PreviewControl.h"

namespace Orbane {

// A distinct type for each viewer overlay not written yet: it is attached and
// driven like any overlay and draws nothing. Base is PreviewControl, or the
// overlay's own base (OverlayControl, the transform control). A real class
// replaces the alias (see ControlClasses.h) without touching its registration.
template <class Marker, class Base = PreviewControl>
class PendingPreviewControl : public Base
{
public:
    using Base::Base;

    std::size_t SizeOf() const override { return sizeof(PendingPreviewControl); }

    // The class has no static buffers yet: its clean-up is the base's.
    static bool RegCleanup(Registry *reg) { return Base::RegCleanup(reg); }
};

} // namespace Orbane
