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

// The class layout description, read when the first instance is made.
ScriptVal gLayout;

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
    : InputControl(reg, args, tags), mLabel(new ElideLabel(this)), mCheckBox(new OrbCheckBox(this))
{
    mTriState = tags.GetBool(CBC_TriState, false);
    mLabel->setObjectName("label");
    connect(mCheckBox, SIGNAL(CheckChanged(int32, uint64)), this, SLOT(OnCheckChanged(int32, uint64)));
    RegisterChild("label", mLabel);
    RegisterChild("checkbox", mCheckBox);
    if (gLayout.IsNil())
        gLayout = ReadLayoutItem("Controls.CheckBox.Layout");
    mCheckBox->SetBasicCols(OrbColor(), OrbColor(), OrbColor(), ToOrbColor(Theme::Accent()));
}

CheckBoxControl::~CheckBoxControl() = default;

bool CheckBoxControl::CopyAttr(Tag tag, void *out)
{
    if (tag == CBC_TriState && out) {
        *static_cast<int32 *>(out) = mTriState ? 1 : 0;
        // False: the value was supplied.
        return false;
    }
    return InputControl::CopyAttr(tag, out);
}

bool CheckBoxControl::GetAttrsTagList(TagList &tags) const
{
    InputControl::GetAttrsTagList(tags);
    mTexts.AddTo(tags);
    tags.Set(CBC_TriState, mTriState);
    return true;
}

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
    InputControl::SetAttrsTagList(input, tags);
    mTexts.Take(tags);
    if (mTexts.changed)
        NotifyChanged(nullptr, nullptr, nullptr);
    return true;
}

bool CheckBoxControl::AddInput(Input *input, const TagList *tags)
{
    if (!InputControl::AddInput(input, tags))
        return false;
    mTexts.Read(input);
    return true;
}

bool CheckBoxControl::Open(QWidget *host, const QRect &rect, const TagList *tags)
{
    if (!InputControl::Open(host, rect, tags))
        return false;
    mCheckBox->SetStyle(mTriState ? CustomButton::Style_TriState : CustomButton::Style_TwoState);
    mCheckBox->SetFont(GetControlFont());
    mCheckBox->SetBackgroundColor(ToOrbColor(GetBackgroundColor()));
    mLabel->setElideMode(ElideLabel::Elide_Right);
    mLabel->setFocusProxy(mCheckBox);
    ShowTexts();
    if (GetCurrentInput()) {
        const AutoNumber now(GetCurrentInput(), GetCurrentTime());
        if (now)
            mValue = RoundValue(now->Value);
    }
    mCheckBox->SetValue(mValue);
    mCheckBox->show();
    CreateLayout(gLayout, true, nullptr);
    if (Layout::LayoutObj *row = FindLayoutObj("checkbox"))
        mRowHeight = row->GetHeight();
    if (Layout::LayoutObj *where = FindLayoutObj("expression"); where && where->AsContainer())
        CreateExpressionEdit(where->AsContainer(), 0);
    mTexts.changed = false;
    return true;
}

void CheckBoxControl::ShowTexts()
{
    mCheckBox->SetLabel(mTexts.label);
    mLabel->setText(QString::fromStdString(mTexts.second.str()));
    // An empty second label gives its room to the box.
    mLabel->setVisible(!mTexts.second.IsEmpty());
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
    const QString text = QString::fromStdString(mTexts.label.str());
    const int single = metrics.boundingRect(box, 0x321, text).height();
    const int wrapped = metrics.boundingRect(box, 0x1021, text).height();
    return mRowHeight + wrapped - single;
}

bool CheckBoxControl::SetSize(int32 &width, int32 &height, const TagList *tags)
{
    if (WrapsLabel()) {
        Layout::LayoutObj *row = FindLayoutObj("checkbox");
        row->SetAttrs(TagList{{INPA_LayoutHeight, mRowHeight}});
        InputControl::SetSize(width, height, tags);
        row->SetAttrs(TagList{{INPA_LayoutHeight, WrappedRowHeight()}});
    }
    return InputControl::SetSize(width, height, tags);
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
    return InputControl::NotifyChanged(input, value, tags);
}

bool CheckBoxControl::UpdateDisplay(Input *input, const TagList *tags)
{
    if (IsOpen()) {
        mCheckBox->SetValue(mValue);
        if (mTexts.changed) {
            ShowTexts();
            mTexts.changed = false;
        }
    }
    return InputControl::UpdateDisplay(input, tags);
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
    return InputControl::OnDisconnect(input, tags);
}

} // namespace Orbane
