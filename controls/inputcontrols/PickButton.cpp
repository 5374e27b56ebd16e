#include "inputcontrols/PickButton.h"

#include "orbane/AutoParam.h"
#include "orbane/ClassIDs.h"
#include "orbane/InputControl.h"
#include "orbane/Operator.h"

namespace Orbane {

PickButton::PickButton(QWidget *parent) : CCPickButton(parent) {}

PickButton::~PickButton()
{
    Attach(nullptr);
}

void PickButton::Attach(ScriptObject *object)
{
    if (object)
        object->IncRef();
    if (mAttached)
        mAttached->DecRef();
    mAttached = object;
}

int32 PickButton::SlotOf(const Input *input)
{
    if (!input || input->GetDataType() != CLSID_DataType_Number || !input->GetAttrs().FindQuery(PBA_SaveIndex))
        return -1;
    const int64 slot = input->GetAttrs().GetLong(PBA_SaveIndex, -1);
    return slot >= 0 && slot < kSlots ? int32(slot) : -1;
}

std::vector<Input *> PickButton::OwnerInputs() const
{
    const Input *in = mOwner ? mOwner->GetCurrentInput() : nullptr;
    const Operator *tool = in ? in->GetOperator() : nullptr;
    return tool ? tool->Inputs() : std::vector<Input *>();
}

int32 PickButton::SaveValues()
{
    int32 count = 0;
    for (Input *in : OwnerInputs()) {
        const int32 slot = SlotOf(in);
        const AutoNumber value(in, mOwner->GetCurrentTime());
        if (slot < 0 || !value)
            continue;
        mSaved[std::size_t(slot)] = value->Value;
        mHaveSaved.set(std::size_t(slot));
        ++count;
    }
    return count;
}

int32 PickButton::RestoreValues()
{
    int32 count = 0;
    for (Input *in : OwnerInputs()) {
        const int32 slot = SlotOf(in);
        if (slot < 0 || !mHaveSaved.test(std::size_t(slot)))
            continue;
        AutoNumber value(mSaved[std::size_t(slot)]);
        if (in->SetValue(value, mOwner->GetCurrentTime(), SETVALUE_NoUndo, nullptr))
            ++count;
    }
    return count;
}

float64 PickButton::SavedValue(int32 index) const
{
    return index >= 0 && index < kSlots ? mSaved[std::size_t(index)] : 0.0;
}

void PickButton::PickStarted()
{
    SaveValues();
}

void PickButton::PickFinished(QWidget *target, const QPoint &pos)
{
    if (!target)
        RestoreValues();
    CCPickButton::PickFinished(target, pos);
}

} // namespace Orbane
