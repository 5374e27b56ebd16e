#include "inputcontrols/ColorSuppressionControl.h"

#include "framework/ColorSuppressionTags.h"
#include "framework/InputLink.h"
#include "inputcontrols/DisconnectWrite.h"

#include "orbane/AutoParam.h"
#include "orbane/ElideLabel.h"
#include "orbane/Input.h"

#include <QLineEdit>

#include <cmath>

namespace Orbane {

namespace {

constexpr const char *kLayoutItem = "Controls.ColorSuppression.Layout";
constexpr Tag kLinks[ColorSuppressionControl::kHues] = {
    0, CSCP_YellowInput, CSCP_GreenInput, CSCP_CyanInput, CSCP_BlueInput, CSCP_MagentaInput};

bool Same(float64 a, float64 b)
{
    return a == b || (std::isnan(a) && std::isnan(b));
}

} // namespace

const char *const ColorSuppressionControl::kHueNames[kHues] = {"red", "yellow", "green", "cyan", "blue", "magenta"};

ColorSuppressionControl::ColorSuppressionControl(const Registry *reg, const ScriptVal &args, const TagList &tags)
    : LabelledInputControl(reg, args, tags), mGesture(*this), mHexagon(new HueHexagon)
{
    // Painted widgets are made without a parent, then adopted.
    mHexagon->setParent(this);
    mHexagon->SetOwner(this);
    mHexagon->setObjectName("hexagon");
    RegisterChild("hexagon", mHexagon);
    for (int32 i = 0; i < kHues; ++i) {
        auto *edit = new QLineEdit(this);
        edit->setObjectName(kHueNames[i]);
        edit->setToolTip(tr("Suppression of %1").arg(kHueNames[i]));
        connect(edit, SIGNAL(editingFinished()), this, SLOT(OnTyped()));
        RegisterChild(kHueNames[i], edit);
        mEdits[size_t(i)] = edit;
    }
    connect(mHexagon, SIGNAL(Moved(int, float64)), this, SLOT(OnMoved(int, float64)));
    connect(mHexagon, SIGNAL(Released()), this, SLOT(OnReleased()));
    Label()->setFocusProxy(mHexagon);
    AddAttr(CSCD_Maximum, &mMax, Attr_CopyAndList);
    AddAttr(CSC_ShowValues, &mShowValues, Attr_CopyAndList);
    ReadOwnTags(tags);
    ClassLayout(kLayoutItem);
}

ColorSuppressionControl::~ColorSuppressionControl() = default;

void ColorSuppressionControl::ReadOwnTags(const TagList &tags)
{
    const float64 max = tags.GetDouble(CSCD_Maximum, mMax);
    if (max > 0.0 && std::isfinite(max))
        mMax = max;
    mShowValues = tags.GetBool(CSC_ShowValues, mShowValues);
    mHexagon->SetMaximum(mMax);
}

void ColorSuppressionControl::LinkHues(const TagList &tags)
{
    for (int32 i = 1; i < kHues; ++i)
        if (LinkInput(*this, tags, kLinks[i], mInputs[size_t(i)]))
            ReadHue(i);
}

void ColorSuppressionControl::ReadHue(int32 hue)
{
    if (const AutoNumber now(mInputs[size_t(hue)], GetCurrentTime()); now)
        mValues[size_t(hue)] = now->Value;
}

int32 ColorSuppressionControl::HueOf(const Input *input) const
{
    for (int32 i = 0; i < kHues; ++i)
        if (input && mInputs[size_t(i)] == input)
            return i;
    return -1;
}

bool ColorSuppressionControl::SetAttrsTagList(Input *input, const TagList &tags)
{
    ReadOwnTags(tags);
    LinkHues(tags);
    if (IsOpen())
        ShowValue();
    return LabelledInputControl::SetAttrsTagList(input, tags);
}

bool ColorSuppressionControl::AddInput(Input *input, const TagList *tags)
{
    const bool first = IsFirstInput(input);
    if (!LabelledInputControl::AddInput(input, tags))
        return false;
    if (first) {
        mInputs[0] = input;
        ReadHue(0);
        LinkHues(input->GetAttrs());
    }
    return true;
}

bool ColorSuppressionControl::Open(QWidget *host, const QRect &rect, const TagList *tags)
{
    if (!LabelledInputControl::Open(host, rect, tags))
        return false;
    for (int32 i = 0; i < kHues; ++i)
        ReadHue(i);
    ShowChild(Label());
    ShowChild(mHexagon);
    ShowValue();
    PlaceChildren(ClassLayout(kLayoutItem), true);
    return true;
}

bool ColorSuppressionControl::NotifyChanged(Input *input, Parameter *value, const TagList *tags)
{
    if (!value)
        return LabelledInputControl::NotifyChanged(input, value, tags);
    const auto *number = dynamic_cast<const Number *>(value);
    const int32 hue = HueOf(input ? input : GetCurrentInput());
    if (!number || hue < 0 || Same(number->Value, mValues[size_t(hue)]))
        return true;
    mValues[size_t(hue)] = number->Value;
    return LabelledInputControl::NotifyChanged(input, value, tags);
}

bool ColorSuppressionControl::UpdateDisplay(Input *input, const TagList *tags)
{
    if (IsOpen())
        ShowValue();
    return LabelledInputControl::UpdateDisplay(input, tags);
}

void ColorSuppressionControl::ShowValue()
{
    if (!mGesture.IsOpen())
        mHexagon->SetValues(mValues);
    for (int32 i = 0; i < kHues; ++i) {
        QLineEdit *edit = mEdits[size_t(i)];
        edit->setVisible(mShowValues);
        edit->setEnabled(mInputs[size_t(i)] != nullptr && !IsDisabled());
        if (!edit->isModified())
            edit->setText(QString::number(mValues[size_t(i)], 'f', 3));
    }
}

void ColorSuppressionControl::OnMoved(int hue, float64 value)
{
    if (hue >= 0 && hue < kHues && mInputs[size_t(hue)])
        mGesture.Write(mInputs[size_t(hue)], AutoNumber(value), InputGesture::StepName(*this));
    ShowValue();
}

void ColorSuppressionControl::OnReleased()
{
    mGesture.End();
    // A hue without an Input, or a refused write, goes back to the value.
    mHexagon->SetValues(mValues);
    ShowValue();
}

void ColorSuppressionControl::OnTyped()
{
    auto *edit = qobject_cast<QLineEdit *>(sender());
    const auto it = std::find(mEdits.begin(), mEdits.end(), edit);
    if (it == mEdits.end() || !edit->isModified())
        return;
    edit->setModified(false);
    const int32 hue = int32(it - mEdits.begin());
    bool ok = false;
    const float64 v = edit->text().toDouble(&ok);
    if (ok && mInputs[size_t(hue)] && !Same(v, mValues[size_t(hue)])) {
        mGesture.Write(mInputs[size_t(hue)], AutoNumber(v), InputGesture::StepName(*this));
        mGesture.End();
    }
    ShowValue();
}

bool ColorSuppressionControl::OnDisconnect(Input *input, const TagList *tags)
{
    const int32 hue = HueOf(input);
    if (hue >= 0)
        WriteOnDisconnect(input, mValues[size_t(hue)]);
    const bool done = LabelledInputControl::OnDisconnect(input, tags);
    if (hue > 0)
        mInputs[size_t(hue)] = nullptr;
    return done;
}

} // namespace Orbane
