#include "inputcontrols/CheckBoxControl.h"

#include "framework/CheckBoxTags.h"
#include "inputcontrols/DisconnectWrite.h"
#include "inputcontrols/OrbCheckBox.h"

#include "orbane/AutoParam.h"
#include "orbane/ElideLabel.h"
#include "orbane/Theme.h"

#include <QApplication>
#include <QFontMetrics>

#include <cmath>

namespace Orbane {

namespace {

constexpr const char *kLayoutItem = "Controls.CheckBox.Layout";

int32 RoundValue(float64 value)
{
    return int32(std::floor(value + 0.5));
}

OrbColor ToOrbColor(const QColor &c)
{
    return OrbColor(uint8(c.red()), uint8(c.green()), uint8(c.blue()), uint8(c.alpha()));
}

} // namespace

CheckBoxControl::CheckBoxControl(const Registry *reg, const ScriptVal &args, const TagList &tags)
    : LabelledInputControl(reg, args, tags), mCheckBox(new OrbCheckBox(this))
{
    mTriState = tags.GetBool(CBC_TriState, false);
    AddAttr(CBC_TriState, &mTriState, Attr_CopyAndList);
    connect(mCheckBox, SIGNAL(CheckChanged(int32, uint64)), this, SLOT(OnCheckChanged(int32, uint64)));
    RegisterChild("checkbox", mCheckBox);
    Label()->setFocusProxy(mCheckBox);
    ClassLayout(kLayoutItem);
    mCheckBox->SetBasicCols(OrbColor(), OrbColor(), OrbColor(), ToOrbColor(Theme::Accent()));
}

CheckBoxControl::~CheckBoxControl() = default;

bool CheckBoxControl::SetAttrsTagList(Input *input, const TagList &tags)
{
    if (tags.FindQuery(CBC_TriState)) {
        const bool triState = tags.GetBool(CBC_TriState, mTriState);
        if (triState != mTriState) {
            mTriState = triState;
            mCheckBox->SetStyle(triState ? CustomButton::Style_TriState : CustomButton::Style_TwoState);
        }
    }
    mCheckBox->AllowWrap(tags.GetBool(CBA_AllowWrap, false));
    return LabelledInputControl::SetAttrsTagList(input, tags);
}

bool CheckBoxControl::Open(QWidget *host, const QRect &rect, const TagList *tags)
{
    if (!LabelledInputControl::Open(host, rect, tags))
        return false;
    mCheckBox->SetStyle(mTriState ? CustomButton::Style_TriState : CustomButton::Style_TwoState);
    mCheckBox->SetFont(GetControlFont());
    mCheckBox->SetBackgroundColor(ToOrbColor(GetBackgroundColor()));
    if (GetCurrentInput()) {
        const AutoNumber now(GetCurrentInput(), GetCurrentTime());
        if (now)
            mValue = RoundValue(now->Value);
    }
    mCheckBox->SetValue(mValue);
    ShowChild(mCheckBox);
    PlaceChildren(ClassLayout(kLayoutItem), true);
    if (Layout::LayoutObj *row = FindLayoutObj("checkbox"))
        mRowHeight = row->GetHeight();
    return true;
}

void CheckBoxControl::ShowTexts()
{
    mCheckBox->SetLabel(GetLabelTexts().label);
    Label()->setText(QString::fromStdString(GetLabelTexts().second.str()));
    // An empty second label gives its room to the box.
    Label()->setVisible(!GetLabelTexts().second.IsEmpty());
}

bool CheckBoxControl::WrapsLabel() const
{
    const Input *in = GetCurrentInput();
    return IsOpen() && in && in->GetAttrs().GetBool(CBA_AllowWrap, false) && FindLayoutObj("checkbox");
}

int32 CheckBoxControl::WrappedRowHeight() const
{
    const QFontMetrics metrics(QApplication::font());
    const QRect box(0, 0, mCheckBox->width() - kBoxRoom, 1000);
    const QString text = QString::fromStdString(GetLabelTexts().label.str());
    const int single = metrics.boundingRect(box, 0x321, text).height();
    const int wrapped = metrics.boundingRect(box, 0x1021, text).height();
    return mRowHeight + wrapped - single;
}

bool CheckBoxControl::SetSize(int32 &width, int32 &height, const TagList *tags)
{
    if (WrapsLabel()) {
        Layout::LayoutObj *row = FindLayoutObj("checkbox");
        row->SetAttrs(TagList{{INPA_LayoutHeight, mRowHeight}});
        LabelledInputControl::SetSize(width, height, tags);
        row->SetAttrs(TagList{{INPA_LayoutHeight, WrappedRowHeight()}});
    }
    return LabelledInputControl::SetSize(width, height, tags);
}

bool CheckBoxControl::NotifyChanged(Input *input, Parameter *value, const TagList *tags)
{
    const auto *number = dynamic_cast<const Number *>(value);
    if (!number)
        return true;
    const int32 rounded = RoundValue(number->Value);
    if (rounded == mValue)
        return true;
    mValue = rounded;
    return LabelledInputControl::NotifyChanged(input, value, tags);
}

bool CheckBoxControl::UpdateDisplay(Input *input, const TagList *tags)
{
    if (IsOpen())
        mCheckBox->SetValue(mValue);
    return LabelledInputControl::UpdateDisplay(input, tags);
}

void CheckBoxControl::OnCheckChanged(int32 state, uint64)
{
    mValue = OrbCheckBox::ValueOf(state);
    const AutoNumber value{float64(mValue)};
    SetInputs(value, GetCurrentTime(), 0, false, nullptr);
    ResetUndo(nullptr);
}

bool CheckBoxControl::OnDisconnect(Input *input, const TagList *tags)
{
    WriteOnDisconnect(input, float64(mValue));
    return LabelledInputControl::OnDisconnect(input, tags);
}

} // namespace Orbane
