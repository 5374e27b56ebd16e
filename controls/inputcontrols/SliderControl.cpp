#include "inputcontrols/SliderControl.h"

#include "framework/SliderTags.h"
#include "inputcontrols/DisconnectWrite.h"
#include "widgets/CustomSlider.h"
#include "widgets/SkinImages.h"
#include "widgets/SliderMapping.h"

#include "orbane/AutoParam.h"
#include "orbane/ElideLabel.h"
#include "orbane/Gradient.h"
#include "orbane/TimeCodeEdit.h"

#include <QLabel>

#include <cmath>

namespace Orbane {

namespace {

constexpr const char *kLayoutItem = "Controls.Slider.Layout";

const char *const kCaptionNames[3] = {"minlabel", "midlabel", "maxlabel"};
// Each caption keeps to its end of the track, the middle one centred,
// however wide the layout makes its cell.
const Qt::Alignment kCaptionAlign[3] = {Qt::AlignLeft | Qt::AlignVCenter, Qt::AlignHCenter | Qt::AlignVCenter,
                                        Qt::AlignRight | Qt::AlignVCenter};

} // namespace

SliderControl::SliderControl(const Registry *reg, const ScriptVal &args, const TagList &tags)
    : LabelledInputControl(reg, args, tags), mEdit(new TimeCodeEdit(this)),
      mSlider(new CustomSlider), mCaptions{new QLabel(this), new QLabel(this), new QLabel(this)}
{
    // The slider is made without a parent, as every painted widget is.
    mSlider->setParent(this);
    mSlider->SetOwner(this);
    mEdit->setObjectName("edit");
    mSlider->setObjectName("slider");
    connect(mSlider, SIGNAL(ValueChanged(float64)), this, SLOT(OnValueChanged(float64)));
    connect(mEdit, SIGNAL(digitChanged(TimeCodeEdit *)), this, SLOT(OnDigitEdit())); // normalised: found at once
    connect(mEdit, SIGNAL(editingFinished()), this, SLOT(OnOK()));
    connect(mEdit, SIGNAL(textEdited(QString)), this, SLOT(OnValueEdit()));
    // Dragging the edit box sideways drives the slider.
    mSlider->AttachEdit(mEdit);
    RegisterChild("edit", mEdit);
    RegisterChild("slider", mSlider);
    for (int32 i = 0; i < 3; ++i) {
        mCaptions[i]->setObjectName(kCaptionNames[i]);
        mCaptions[i]->setAlignment(kCaptionAlign[i]);
        mCaptions[i]->hide();
        RegisterChild(kCaptionNames[i], mCaptions[i]);
    }
    Label()->setFocusProxy(mSlider);
    AddAttrRows();
    ClassLayout(kLayoutItem);
}

SliderControl::~SliderControl() = default;

// ---- rounding rules ----

float64 SliderControl::StepFor(int32 places)
{
    // Only exactly -1 means automatic: other negative places give steps of
    // tens, hundreds and so on.
    if (uint32(places) == 0xFFFFFFFFu)
        return kAutoStep;
    return 1.0 / std::pow(10.0, places);
}

const char *SliderControl::KnobImageName(int32 style, bool held)
{
    static const char *const kColourKnobs[4][2] = {
        {"Controls.Color.Knob.2.1", "Controls.Color.Knob.2.2"},
        {"Controls.Color.Knob.3.1", "Controls.Color.Knob.3.2"},
        {"Controls.Color.Knob.4.1", "Controls.Color.Knob.4.2"},
        {"Controls.Color.Knob.5.1", "Controls.Color.Knob.5.2"},
    };
    if (style >= 6 && style <= 9)
        return kColourKnobs[style - 6][held ? 1 : 0];
    return held ? SkinImages::SliderKnobPressed : SkinImages::SliderKnob;
}

// ---- attributes ----

void SliderControl::AddAttrRows()
{
    for (const auto &[tag, field] : {std::pair<Tag, const float64 *>{SLA_MinAllowed, &mAllowedLow},
                                     {SLA_MaxAllowed, &mAllowedHigh},
                                     {SLA_MinScale, &mScaleLow},
                                     {SLA_MaxScale, &mScaleHigh},
                                     {SLA_Default, &mDefault},
                                     {SLA_Centre, &mCentre}})
        AddAttr(tag, field, Attr_Copy);
    AddAttr(IC_TickFreq, &mTickCount, Attr_CopyAndList);
    AddAttr(SLA_StepCount, &mStepCount, Attr_Copy);
    AddAttr(SLA_DecimalPlaces, &mPlaces, Attr_Copy);
    AddAttr(SLA_KnobStyle, &mKnobStyle, Attr_Copy);
    ListAttr(SLCS_LowName, &mLowText);
    ListAttr(SLCS_MidName, &mMidText);
    ListAttr(SLCS_HighName, &mHighText);
}

bool SliderControl::SetAttrsTagList(Input *input, const TagList &tags)
{
    const bool wasDisabled = IsDisabled();
    if (tags.GetBool(SLA_ReadAttrs, true))
        ReadOwnAttrs(input, tags);
    else
        InputControl::SetAttrsTagList(input, tags);
    TakeTexts(tags);
    if (IsDisabled() != wasDisabled)
        MarkTextsChanged();
    if (TextsChanged() || mKnobStyleChanged)
        NotifyChanged(nullptr, nullptr, nullptr);
    else if (IsOpen())
        mSlider->Redraw(true);
    return true;
}

// The order is part of the contract: the scale follows the allowed range,
// and the slider gets its range before the value and the default.
void SliderControl::ReadOwnAttrs(Input *input, const TagList &tags)
{
    mStepCount = tags.GetInt(SLA_StepCount, mStepCount);
    mTickCount = tags.GetInt(IC_TickFreq, mTickCount);
    mTimeDisplay = tags.GetBool(SLA_TimeDisplay, mTimeDisplay);
    mSnapToStep = tags.GetBool(SLA_SnapToStep, mSnapToStep);
    ReadRanges(tags);
    mIntegerDisplay = tags.GetBool(SLA_IntegerDisplay, false);
    InputControl::SetAttrsTagList(input, tags);
    mSliderDisabled = IsDisabled();
    if (tags.FindQuery(SLA_DecimalPlaces)) {
        mPlaces = tags.GetInt(SLA_DecimalPlaces, mPlaces);
        mStep = StepFor(mPlaces);
    }
    mDefault = tags.GetDouble(SLA_Default, 0.0);
    if (tags.FindQuery(SLA_Centre)) {
        mCentre = tags.GetDouble(SLA_Centre, mCentre);
        mHasCentre = true;
    }
    PassToEdit();
    PassToSlider();
    const int32 style = tags.GetInt(SLA_KnobStyle, mKnobStyle);
    if (style != mKnobStyle) {
        mKnobStyle = style;
        mKnobStyleChanged = true;
    }
    ReadCaptions(tags);
    ReadTrackLook(tags);
}

void SliderControl::ReadRanges(const TagList &tags)
{
    // A list without the allowed range resets it: deliberate.
    mAllowedLow = tags.GetDouble(SLA_MinAllowed, kDefaultMinAllowed);
    mAllowedHigh = tags.GetDouble(SLA_MaxAllowed, kDefaultMaxAllowed);
    mScaleLow = tags.GetDouble(SLA_MinAllowed, mScaleLow);
    mScaleHigh = tags.GetDouble(SLA_MaxAllowed, mScaleHigh);
    mScaleLow = tags.GetDouble(SLA_MinScale, mScaleLow);
    mScaleHigh = tags.GetDouble(SLA_MaxScale, mScaleHigh);
}

void SliderControl::ReadCaptions(const TagList &tags)
{
    OrbString *texts[3] = {&mLowText, &mMidText, &mHighText};
    const Tag ids[3] = {SLCS_LowName, SLCS_MidName, SLCS_HighName};
    for (int32 i = 0; i < 3; ++i) {
        if (!tags.FindQuery(ids[i]))
            continue;
        const OrbString text(tags.GetString(ids[i], ""));
        if (text != *texts[i]) {
            *texts[i] = text;
            MarkTextsChanged();
        }
    }
}

void SliderControl::ReadTrackLook(const TagList &tags)
{
    if (tags.FindQuery(SLA_Gradient) || tags.FindQuery(SLA_Gradient2))
        mSlider->SetGradients(dynamic_cast<Gradient *>(tags.GetObject(SLA_Gradient)),
                              dynamic_cast<Gradient *>(tags.GetObject(SLA_Gradient2)));
    mSlider->SetColorSpaces(tags.GetInt(SLA_ColorSpace, 0), tags.GetInt(SLA_ColorSpace2, 0));
    if (tags.FindQuery(SLA_ForwardFunc) || tags.FindQuery(SLA_InverseFunc))
        mSlider->SetMappingCallbacks(
            reinterpret_cast<CustomSlider::MapFunc>(tags.GetPtr(SLA_ForwardFunc)), tags.GetPtr(SLA_ForwardData),
            reinterpret_cast<CustomSlider::MapFunc>(tags.GetPtr(SLA_InverseFunc)), tags.GetPtr(SLA_InverseData));
    if (tags.FindQuery(SLA_ForwardExpr) || tags.FindQuery(SLA_InverseExpr))
        mSlider->SetMappingExpressions(tags.GetString(SLA_ForwardExpr, ""), tags.GetString(SLA_InverseExpr, ""));
}

void SliderControl::PassToEdit()
{
    mEdit->SetDisabled(mSliderDisabled);
    mEdit->SetInteger(mIntegerDisplay);
    mEdit->SetTimeType(mTimeDisplay);
}

void SliderControl::PassToSlider()
{
    mSlider->SetSnapToStep(mSnapToStep);
    mSlider->SetInteger(mIntegerDisplay);
    mSlider->SetDisabled(mSliderDisabled);
    mSlider->SetScale(mScaleLow, mScaleHigh, false);
    mSlider->SetAllowedRange(mAllowedLow, mAllowedHigh, false);
    if (mHasCentre)
        mSlider->SetCentre(mCentre);
    mSlider->SetStepCount(mStepCount);
    mSlider->SetTickCount(mTickCount);
    mSlider->SetValue(mValueReceived ? mValue : mScaleLow, false);
    mSlider->SetDefault(mDefault, false);
}

// ---- life cycle ----

bool SliderControl::AddInput(Input *input, const TagList *tags)
{
    if (!LabelledInputControl::AddInput(input, tags))
        return false;
    mInputIndex = input->GetAttrs().GetInt(SLA_InputIndex, 0);
    Label()->setText(QString::fromStdString(GetLabelTexts().label.str()));
    const AutoParameter now(input, GetCurrentTime());
    if (now) {
        NotifyChanged(input, now.get(), nullptr);
        mValueReceived = true;
    }
    return true;
}

bool SliderControl::Open(QWidget *host, const QRect &rect, const TagList *tags)
{
    if (!LabelledInputControl::Open(host, rect, tags))
        return false;
    // The children have the control font already: the control takes it
    // before it makes them, and they inherit it. Setting it on each again
    // would lay out every text once more.
    if (GetCurrentInput()) {
        const AutoNumber now(GetCurrentInput(), GetCurrentTime());
        if (now)
            mValue = now->Value;
    }
    ApplyKnobStyle();
    mEdit->SetValue(mValue, mPlaces);
    mSlider->SetValue(mValue, false);
    ShowChild(Label());
    ShowChild(mEdit);
    ShowChild(mSlider);
    PlaceChildren(ClassLayout(kLayoutItem), true);
    mKnobStyleChanged = false;
    return true;
}

bool SliderControl::NotifyChanged(Input *input, Parameter *value, const TagList *tags)
{
    if (!value)
        return LabelledInputControl::NotifyChanged(input, value, tags);
    const auto *number = dynamic_cast<const Number *>(value);
    if (!number)
        return true;
    // A tool with several values per Input index routes each to its control.
    if (input && input->GetAttrs().GetInt(SLA_InputIndex, 0) != mInputIndex)
        return true;
    if (!HasValueChanged(mIntegerDisplay && !mTimeDisplay, number->Value, mValue, mStep * 0.5))
        return true;
    mValue = number->Value;
    return LabelledInputControl::NotifyChanged(input, value, tags);
}

bool SliderControl::UpdateDisplay(Input *input, const TagList *tags)
{
    if (IsOpen()) {
        // What the user is typing stays until it is applied.
        if (mPendingEdit != mEdit)
            mEdit->SetValue(mValue, mPlaces);
        mSlider->SetValue(mValue, true);
        if (mKnobStyleChanged) {
            ApplyKnobStyle();
            mKnobStyleChanged = false;
        }
    }
    return LabelledInputControl::UpdateDisplay(input, tags);
}

void SliderControl::ShowTexts()
{
    LabelledInputControl::ShowTexts();
    const OrbString *texts[3] = {&mLowText, &mMidText, &mHighText};
    bool anyCaption = false;
    for (int32 i = 0; i < 3; ++i) {
        mCaptions[i]->setText(QString::fromStdString(texts[i]->str()));
        mCaptions[i]->setVisible(!texts[i]->IsEmpty());
        anyCaption = anyCaption || !texts[i]->IsEmpty();
    }
    // The captions sit close under the track: the slider lets them show through.
    if (anyCaption)
        mSlider->SetOpaque(false);
}

void SliderControl::ApplyKnobStyle()
{
    mSlider->SetKnobImage(SkinImages::Get(KnobImageName(mKnobStyle, false)),
                          SkinImages::Get(KnobImageName(mKnobStyle, true)));
}

bool SliderControl::OnDisconnect(Input *input, const TagList *tags)
{
    WriteOnDisconnect(input, mValue);
    return LabelledInputControl::OnDisconnect(input, tags);
}

Input *SliderControl::GetInputFrom(const QWidget *child) const
{
    return child == mEdit ? LabelledInputControl::GetInputFrom(child) : nullptr;
}

// ---- edits ----

void SliderControl::WriteValue(float64 value)
{
    const float64 tolerance = mStep * 0.5;
    bool integer = false;
    // A time is written as it is: frames need not fall on the decimal grid.
    if (!mTimeDisplay) {
        value = SliderMapping::RoundHalfUp(value, mStep);
        integer = mIntegerDisplay;
    }
    if (!HasValueChanged(integer, value, mValue, tolerance))
        return;
    const AutoNumber number(value);
    SetInputs(number, GetCurrentTime(), 0, false, nullptr);
}

// The slider closes the gesture's undo step itself, at release.
void SliderControl::OnValueChanged(float64 value)
{
    WriteValue(value);
    // The knob goes to what the Input holds: the rounded value.
    UpdateDisplay(nullptr, nullptr);
}

void SliderControl::ApplyEdit()
{
    if (mEdit->IsExpression()) {
        SetExpressions(mEdit->GetExpression().c_str(), nullptr);
        return;
    }
    bool ok = false;
    const float64 value = mEdit->GetValue(&ok);
    if (ok)
        WriteValue(value);
    ResetUndo(nullptr);
}

void SliderControl::OnDigitEdit()
{
    mPendingEdit = mEdit;
    ApplyEdit();
}

// Typing marks the box as the user's until Enter or focus leaves it; each
// keystroke is no value of its own.
void SliderControl::OnValueEdit()
{
    mPendingEdit = mEdit;
}

void SliderControl::OnOK()
{
    const bool typed = mPendingEdit == mEdit || mEdit->isModified();
    mPendingEdit = nullptr;
    // Leaving the box untouched writes nothing, even where it shows fewer
    // places than the Input holds.
    if (typed)
        ApplyEdit();
    LabelledInputControl::OnOK();
    UpdateDisplay(nullptr, nullptr);
}

} // namespace Orbane
