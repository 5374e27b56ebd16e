#pragma once

#include "orbane/InputControl.h"

class QLabel;

namespace Orbane {

// Stand-in for an inspector control whose class is not written yet: it shows
// its class name as read-only text, so a tool that asks for it still lays out
// and nothing pretends to edit the value.
class PendingInputBase : public InputControl
{
public:
    PendingInputBase(const Registry *reg, const ScriptVal &args, const TagList &tags);
    ~PendingInputBase() override;

    QLabel *Label() const noexcept { return mLabel; }

private:
    QLabel *mLabel;
};

} // namespace Orbane
