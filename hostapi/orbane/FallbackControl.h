#pragma once

#include "orbane/InputControl.h"

class QLabel;

namespace Orbane {

// What the inspector shows for an Input whose control class it cannot
// create (unknown, or not yet built): the Input's label and its value as
// read-only text, so the tool stays readable.
class FallbackControl : public InputControl
{
    Q_OBJECT
public:
    FallbackControl(const Registry *reg, const ScriptVal &args, const TagList &tags);
    ~FallbackControl() override;

    std::size_t SizeOf() const override { return sizeof(FallbackControl); }

    bool AddInput(Input *input, const TagList *tags) override;
    bool SetSize(int32 &width, int32 &height, const TagList *tags) override;
    bool NotifyChanged(Input *input, Parameter *value, const TagList *tags) override;

    // The value as it is shown ("0.5", "(0.2, 0.3)", "text").
    QString ValueText() const;

private:
    QLabel *mLabel;
    QLabel *mValue;
};

} // namespace Orbane
