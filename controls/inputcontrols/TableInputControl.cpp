#include "inputcontrols/TableInputControl.h"

#include "inputcontrols/DisconnectWrite.h"

#include "orbane/AutoParam.h"
#include "orbane/Input.h"
#include "orbane/ScriptValParam.h"

namespace Orbane {

TableInputControl::TableInputControl(const Registry *reg, const ScriptVal &args, const TagList &tags)
    : LabelledInputControl(reg, args, tags), mGesture(*this)
{
}

TableInputControl::~TableInputControl() = default;

void TableInputControl::Take(Parameter *value)
{
    if (const auto *table = dynamic_cast<const ScriptValParam *>(value))
        mValue = ScriptValParam::DeepCopy(table->Value);
}

bool TableInputControl::AddInput(Input *input, const TagList *tags)
{
    const bool first = IsFirstInput(input);
    if (!LabelledInputControl::AddInput(input, tags))
        return false;
    if (first)
        Take(AutoParameter(input->GetValue(GetCurrentTime())));
    return true;
}

// The gate compares content: a script may write an equal table anew.
bool TableInputControl::NotifyChanged(Input *input, Parameter *value, const TagList *tags)
{
    const auto *table = dynamic_cast<const ScriptValParam *>(value);
    if (value && (!table || ScriptValParam::DeepEquals(table->Value, mValue)))
        return true;
    Take(value);
    return LabelledInputControl::NotifyChanged(input, value, tags);
}

bool TableInputControl::UpdateDisplay(Input *input, const TagList *tags)
{
    if (IsOpen())
        ShowValue();
    return LabelledInputControl::UpdateDisplay(input, tags);
}

void TableInputControl::WriteValue(const ScriptVal &table)
{
    Input *input = GetCurrentInput();
    mValue = table;
    if (mGesture.Write(input, AutoScriptValParam(ScriptValParam::DeepCopy(table)), InputGesture::StepName(*this)))
        return;
    // Refused (a locked tool): show what the Input holds.
    if (input)
        Take(AutoParameter(input->GetValue(GetCurrentTime())));
    if (IsOpen())
        ShowValue();
}

bool TableInputControl::OnDisconnect(Input *input, const TagList *tags)
{
    if (mValue.IsTable())
        WriteOnDisconnect(input, AutoScriptValParam(ScriptValParam::DeepCopy(mValue)));
    return LabelledInputControl::OnDisconnect(input, tags);
}

} // namespace Orbane
