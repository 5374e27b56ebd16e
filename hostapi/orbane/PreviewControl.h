#pragma once

#include "orbane/Object.h"

namespace Orbane {

// The host base of every viewer overlay: handles drawn over the image that
// edit a tool's Inputs.
class PreviewControl : public Object
{
public:
    PreviewControl(const Registry *reg, const ScriptVal &args, const TagList &tags);
    ~PreviewControl() override;

    std::size_t SizeOf() const override { return sizeof(PreviewControl); }

    static bool RegCleanup(Registry *reg);
    static const OrbID ClassID;
};

} // namespace Orbane
