#pragma once

#include "orbane/PreviewControl.h"

namespace Orbane {

// The host base of overlays that edit an inspector control's value directly
// in the viewer (the slider overlay).
class OverlayControl : public PreviewControl
{
public:
    OverlayControl(const Registry *reg, const ScriptVal &args, const TagList &tags);
    ~OverlayControl() override;

    std::size_t SizeOf() const override { return sizeof(OverlayControl); }

    static const OrbID ClassID;
};

} // namespace Orbane
