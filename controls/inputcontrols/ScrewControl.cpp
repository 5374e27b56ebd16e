#include "inputcontrols/ScrewControl.h"

#include "framework/ScrewTags.h"
#include "inputcontrols/DisconnectWrite.h"
#include "inputcontrols/ThumbWheel.h"

#include "orbane/AutoParam.h"
#include "orbane/ElideLabel.h"
#include "orbane/TimeCodeEdit.h"

#include <cmath>

namespace Orbane {

namespace {

constexpr const char *kLayoutItem = "Controls.Screw.Layout";

} // namespace

ScrewControl::ScrewControl(const Registry *reg, const ScriptVal &args, const TagList &tags)
    : LabelledInputControl(reg, args, tags), mWheel(new ThumbWheel(this)), mEdit(new TimeCodeEdit(this))
{
    mStep = tags.GetDouble(SCRD_Step, mStep);
    AddAttr(SCRD_Step, &mStep, Attr_CopyAndList);
    mWheel->setObjectName("wheel");
    mEdit->setObjectName("edit");
    connect(mWheel, SIGNAL(Turn(float64)), this, SLOT(OnTurn(float64)));
    connect(mWheel, SIGNAL(TurnEnded()), this, SLOT(OnTurnEnded()));
    connect(mEdit, SIGNAL(editingFinished()), this, SLOT(OnTyped()));
    connect(mEdit, SIGNAL(digitChanged(TimeCodeEdit *)), this, SLOT(OnTyped()));
    RegisterChild("wheel", mWheel);
    RegisterChild("edit", mEdit);
    Label()->setFocusProxy(mEdit);
    ClassLayout(kLayoutItem);
}

ScrewControl::~ScrewControl() = default;

bool ScrewControl::SetAttrsTagList(Input *input, const TagList &tags)
{
    mStep = tags.GetDouble(SCRD_Step, mStep);
    return LabelledInputControl::SetAttrsTagList(input, tags);
}

bool ScrewControl::Open(QWidget *host, const QRect &rect, const TagList *tags)
{
    if (!LabelledInputControl::Open(host, rect, tags))
        return false;
    if (GetCurrentInput()) {
        const AutoNumber now(GetCurrentInput(), GetCurrentTime());
        if (now)
            mValue = now->Value;
    }
    mEdit->SetValue(mValue);
    Label()->show();
    mWheel->show();
    mEdit->show();
    PlaceChildren(ClassLayout(kLayoutItem), true);
    return true;
}

bool ScrewControl::NotifyChanged(Input *input, Parameter *value, const TagList *tags)
{
    const auto *number = dynamic_cast<const Number *>(value);
    if (!number)
        return value ? true : LabelledInputControl::NotifyChanged(input, value, tags);
    if (std::fabs(number->Value - mValue) <= kSameValue)
        return true;
    mValue = number->Value;
    return LabelledInputControl::NotifyChanged(input, value, tags);
}

bool ScrewControl::UpdateDisplay(Input *input, const TagList *tags)
{
    // The box being typed into keeps the user's text.
    if (IsOpen() && !mEdit->hasFocus())
        mEdit->SetValue(mValue);
    return LabelledInputControl::UpdateDisplay(input, tags);
}

void ScrewControl::Write(float64 value)
{
    mValue = value;
    SetInputs(AutoNumber(value), GetCurrentTime(), 0, false, nullptr);
    mEdit->SetValue(value);
}

// The first turn of a gesture opens its undo step; the end closes it.
void ScrewControl::OnTurn(float64 steps)
{
    Write(mValue + steps * mStep);
}

void ScrewControl::OnTurnEnded()
{
    ResetUndo(nullptr);
}

void ScrewControl::OnTyped()
{
    bool ok = false;
    const float64 typed = mEdit->GetValue(&ok);
    if (ok && std::fabs(typed - mValue) > kSameValue) {
        Write(typed);
        ResetUndo(nullptr);
    }
    mEdit->SetValue(mValue);
}

bool ScrewControl::OnDisconnect(Input *input, const TagList *tags)
{
    WriteOnDisconnect(input, mValue);
    return LabelledInputControl::OnDisconnect(input, tags);
}

} // namespace Orbane
