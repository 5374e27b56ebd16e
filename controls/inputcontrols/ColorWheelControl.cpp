#include "inputcontrols/ColorWheelControl.h"

#include "framework/ColorWheelTags.h"
#include "framework/InputLink.h"
#include "inputcontrols/DisconnectWrite.h"
#include "widgets/CustomSlider.h"
#include "widgets/HueWheel.h"
#include "widgets/SkinImages.h"

#include "orbane/AutoParam.h"
#include "orbane/ElideLabel.h"
#include "orbane/Input.h"
#include "orbane/Point.h"

#include <QLabel>

#include <cmath>

namespace Orbane {

namespace {

constexpr const char *kLayoutItem = "Controls.ColorWheel.Layout";
constexpr float64 kDegrees = 57.29577951308232;

} // namespace

ColorWheelControl::ColorWheelControl(const Registry *reg, const ScriptVal &args, const TagList &tags)
    : LabelledInputControl(reg, args, tags), mGesture(*this), mWheel(new HueWheel), mMasterSlider(new CustomSlider),
      mReadout(new QLabel(this))
{
    // Painted widgets are made without a parent, then adopted.
    mWheel->setParent(this);
    mWheel->SetOwner(this);
    mMasterSlider->setParent(this);
    mMasterSlider->SetOwner(this);
    mMasterSlider->SetKnobImage(SkinImages::Get("Controls.Color.Knob.5.1"), SkinImages::Get("Controls.Color.Knob.5.2"));
    mMasterSlider->SetStepCount(100);
    const std::pair<const char *, QWidget *> children[] = {
        {"wheel", mWheel}, {"master", mMasterSlider}, {"readout", mReadout}};
    for (const auto &[name, child] : children) {
        child->setObjectName(name);
        RegisterChild(name, child);
    }
    connect(mWheel, SIGNAL(PuckMoved(float64, float64)), this, SLOT(OnPuckMoved(float64, float64)));
    connect(mWheel, SIGNAL(Released()), this, SLOT(OnWheelReleased()));
    connect(mWheel, SIGNAL(ResetAsked()), this, SLOT(OnReset()));
    connect(mMasterSlider, SIGNAL(ValueChanged(float64)), this, SLOT(OnMasterChanged(float64)));
    connect(mMasterSlider, SIGNAL(Released(CustomController *)), this, SLOT(OnMasterReleased(CustomController *)));
    Label()->setFocusProxy(mWheel);
    AddAttr(CWC_Role, &mRole, Attr_CopyAndList);
    AddAttr(CWCD_Rim, &mRim, Attr_CopyAndList);
    ReadOwnTags(tags);
    ClassLayout(kLayoutItem);
}

ColorWheelControl::~ColorWheelControl() = default;

ColorWheelControl::RoleRange ColorWheelControl::RangeOf(int32 role)
{
    // Lift and offset add, gamma and gain multiply: their neutral is 1.
    switch (role) {
    case WheelRole_Gamma:
        return {0.0, 2.0, 1.0};
    case WheelRole_Gain:
        return {0.0, 4.0, 1.0};
    default:
        return {-1.0, 1.0, 0.0};
    }
}

void ColorWheelControl::ReadOwnTags(const TagList &tags)
{
    mRole = std::clamp(tags.GetInt(CWC_Role, mRole), 0, int32(WheelRole_Count) - 1);
    const float64 rim = tags.GetDouble(CWCD_Rim, mRim);
    if (rim > 0.0 && std::isfinite(rim))
        mRim = rim;
    mWheel->SetRim(mRim);
    const RoleRange range = RangeOf(mRole);
    mMasterSlider->SetScale(range.low, range.high, false);
    mMasterSlider->SetDefault(range.neutral, false);
}

void ColorWheelControl::ReadValues()
{
    if (const AutoPoint now(GetCurrentInput(), GetCurrentTime()); now)
        mPuck = {now->X, now->Y};
    if (const AutoNumber master(mMasterInput, GetCurrentTime()); master)
        mMaster = master->Value;
}

bool ColorWheelControl::SetAttrsTagList(Input *input, const TagList &tags)
{
    ReadOwnTags(tags);
    if (LinkInput(*this, tags, CWCP_MasterInput, mMasterInput))
        ReadValues();
    if (IsOpen())
        ShowValue();
    return LabelledInputControl::SetAttrsTagList(input, tags);
}

bool ColorWheelControl::AddInput(Input *input, const TagList *tags)
{
    const bool first = IsFirstInput(input);
    if (!LabelledInputControl::AddInput(input, tags))
        return false;
    if (first) {
        LinkInput(*this, input->GetAttrs(), CWCP_MasterInput, mMasterInput);
        ReadValues();
    }
    return true;
}

bool ColorWheelControl::Open(QWidget *host, const QRect &rect, const TagList *tags)
{
    if (!LabelledInputControl::Open(host, rect, tags))
        return false;
    ReadValues();
    ShowChild(Label());
    ShowChild(mWheel);
    ShowChild(mReadout);
    ShowValue();
    PlaceChildren(ClassLayout(kLayoutItem), false);
    return true;
}

bool ColorWheelControl::NotifyChanged(Input *input, Parameter *value, const TagList *tags)
{
    if (!value)
        return LabelledInputControl::NotifyChanged(input, value, tags);
    if (const auto *point = dynamic_cast<const Point *>(value); point && input != mMasterInput) {
        if (point->X == mPuck.x && point->Y == mPuck.y)
            return true;
        mPuck = {point->X, point->Y};
    } else if (const auto *number = dynamic_cast<const Number *>(value); number && input == mMasterInput) {
        if (number->Value == mMaster)
            return true;
        mMaster = number->Value;
    } else {
        return true;
    }
    return LabelledInputControl::NotifyChanged(input, value, tags);
}

bool ColorWheelControl::UpdateDisplay(Input *input, const TagList *tags)
{
    if (IsOpen())
        ShowValue();
    return LabelledInputControl::UpdateDisplay(input, tags);
}

void ColorWheelControl::ShowValue()
{
    mWheel->SetPuck(mPuck);
    mMasterSlider->setVisible(mMasterInput != nullptr);
    mMasterSlider->SetValue(std::isnan(mMaster) ? 0.0 : mMaster, true);
    float64 hue = std::atan2(mPuck.y, mPuck.x) * kDegrees;
    if (hue < 0.0)
        hue += 360.0;
    const float64 sat = std::hypot(mPuck.x, mPuck.y);
    mReadout->setText(QString::asprintf("H %.1f  S %.3f", sat > 0.0 ? hue : 0.0, sat) +
                      (mMasterInput ? QString::asprintf("  M %.3f", mMaster) : QString()));
}

void ColorWheelControl::OnPuckMoved(float64 x, float64 y)
{
    mGesture.Write(GetCurrentInput(), AutoPoint(x, y), InputGesture::StepName(*this));
    ShowValue();
}

void ColorWheelControl::OnWheelReleased()
{
    mGesture.End();
}

void ColorWheelControl::OnReset()
{
    if (mPuck.x != 0.0 || mPuck.y != 0.0)
        mGesture.Write(GetCurrentInput(), AutoPoint(0.0, 0.0), OrbString("Reset " + LabelOf(GetCurrentInput()).str()));
    mGesture.End();
    ShowValue();
}

void ColorWheelControl::OnMasterChanged(float64 value)
{
    if (mMasterInput && value != mMaster)
        mGesture.Write(mMasterInput, AutoNumber(value), InputGesture::StepName(*this));
    // A key press or a page click is a gesture of its own; a drag ends on release.
    if (!mMasterSlider->IsDragging())
        mGesture.End();
    ShowValue();
}

void ColorWheelControl::OnMasterReleased(CustomController *)
{
    mGesture.End();
}

bool ColorWheelControl::OnDisconnect(Input *input, const TagList *tags)
{
    if (input && input == mMasterInput)
        WriteOnDisconnect(input, mMaster);
    else if (input)
        input->SetValue(AutoPoint(mPuck.x, mPuck.y), TIME_DISCONNECT, SETVALUE_NoUndo, nullptr);
    const bool done = LabelledInputControl::OnDisconnect(input, tags);
    if (input && input == mMasterInput)
        mMasterInput = nullptr;
    return done;
}

} // namespace Orbane
