#pragma once

#include "framework/InputGesture.h"
#include "framework/LabelledInputControl.h"

#include "orbane/ScriptVal.h"

namespace Orbane {

// The base of the controls whose value is one script table in one Input
// (curves, ranges, log settings, a filter kernel): it holds a copy of the
// table, redisplays only when the table's content changes, writes the
// user's edits as one undo step per gesture, and writes the table it shows
// when it is unbound.
class TableInputControl : public LabelledInputControl
{
    Q_OBJECT
public:
    TableInputControl(const Registry *reg, const ScriptVal &args, const TagList &tags);
    ~TableInputControl() override;

    bool AddInput(Input *input, const TagList *tags) override;
    bool NotifyChanged(Input *input, Parameter *value, const TagList *tags) override;
    bool UpdateDisplay(Input *input, const TagList *tags) override;
    bool OnDisconnect(Input *input, const TagList *tags) override;

    // The table shown: nil until the Input holds a table.
    const ScriptVal &Value() const noexcept { return mValue; }

protected:
    // One write of the gesture under way (opening its undo step); the
    // control shows `table` from now on.
    void WriteValue(const ScriptVal &table);
    void EndGesture() { mGesture.End(); }
    // Shows Value() in the children; called while open, on every change.
    virtual void ShowValue() = 0;

private:
    void Take(Parameter *value);

    ScriptVal mValue;
    InputGesture mGesture;
};

} // namespace Orbane
