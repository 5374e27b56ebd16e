#include "inputcontrols/RangeControl.h"

#include "framework/InputLink.h"
#include "framework/RangeTags.h"
#include "inputcontrols/DisconnectWrite.h"
#include "inputcontrols/RangeTrack.h"

#include "orbane/AutoParam.h"
#include "orbane/ElideLabel.h"
#include "orbane/TimeCodeEdit.h"

#include <cmath>

namespace Orbane {

namespace {

constexpr const char *kLayoutItem = "Controls.Range.Layout";

QString ToQString(const OrbString &s)
{
    return QString::fromStdString(s.str());
}

} // namespace

RangeControl::RangeControl(const Registry *reg, const ScriptVal &args, const TagList &tags)
    : LabelledInputControl(reg, args, tags), mGesture(*this), mLowEdit(new TimeCodeEdit(this)),
      mHighEdit(new TimeCodeEdit(this)), mTrack(new RangeTrack(this))
{
    mLowEdit->setObjectName("low");
    mHighEdit->setObjectName("high");
    mTrack->setObjectName("span");
    connect(mTrack, SIGNAL(Moved(float64, float64, int)), this, SLOT(OnTrackMoved(float64, float64, int)));
    connect(mTrack, SIGNAL(Released()), this, SLOT(OnTrackReleased()));
    connect(mTrack, SIGNAL(ResetAsked()), this, SLOT(OnReset()));
    connect(mLowEdit, SIGNAL(editingFinished()), this, SLOT(OnLowTyped()));
    connect(mHighEdit, SIGNAL(editingFinished()), this, SLOT(OnHighTyped()));
    RegisterChild("low", mLowEdit);
    RegisterChild("high", mHighEdit);
    RegisterChild("span", mTrack);
    Label()->setFocusProxy(mTrack);
    AddAttrRows();
    ReadOwnTags(tags);
    ClassLayout(kLayoutItem);
}

RangeControl::~RangeControl() = default;

void RangeControl::AddAttrRows()
{
    for (const auto &[tag, field] : {std::pair<Tag, const float64 *>{RNGCD_MinAllowed, &mLimits.minAllowed},
                                     {RNGCD_MaxAllowed, &mLimits.maxAllowed},
                                     {RNGCD_MinScale, &mScaleLow},
                                     {RNGCD_MaxScale, &mScaleHigh},
                                     {RNGCD_MinSpan, &mLimits.minSpan},
                                     {RNGCD_DefaultLow, &mDefaultLow},
                                     {RNGCD_DefaultHigh, &mDefaultHigh}})
        AddAttr(tag, field, Attr_CopyAndList);
    AddAttr(RNGC_DecimalPlaces, &mPlaces, Attr_CopyAndList);
    AddAttr(RNGC_IntegerDisplay, &mInteger, Attr_CopyAndList);
    AddAttr(RNGC_PushOther, &mPush, Attr_CopyAndList);
    AddAttr(RNGC_TickCount, &mTicks, Attr_CopyAndList);
    ListAttr(RNGCS_LowName, &mLowName);
    ListAttr(RNGCS_HighName, &mHighName);
}

void RangeControl::ReadOwnTags(const TagList &tags)
{
    mLimits.minAllowed = tags.GetDouble(RNGCD_MinAllowed, mLimits.minAllowed);
    mLimits.maxAllowed = tags.GetDouble(RNGCD_MaxAllowed, mLimits.maxAllowed);
    // The scale follows the allowed range unless it is given itself.
    mScaleLow = tags.GetDouble(RNGCD_MinScale, tags.GetDouble(RNGCD_MinAllowed, mScaleLow));
    mScaleHigh = tags.GetDouble(RNGCD_MaxScale, tags.GetDouble(RNGCD_MaxAllowed, mScaleHigh));
    mLimits.minSpan = std::max(0.0, tags.GetDouble(RNGCD_MinSpan, mLimits.minSpan));
    mDefaultLow = tags.GetDouble(RNGCD_DefaultLow, mDefaultLow);
    mDefaultHigh = tags.GetDouble(RNGCD_DefaultHigh, mDefaultHigh);
    mPlaces = std::clamp(tags.GetInt(RNGC_DecimalPlaces, mPlaces), 0, 9);
    mInteger = tags.GetBool(RNGC_IntegerDisplay, mInteger);
    mPush = tags.GetBool(RNGC_PushOther, mPush);
    mTicks = tags.GetInt(RNGC_TickCount, mTicks);
    if (tags.FindQuery(RNGCS_LowName))
        mLowName = OrbString(tags.GetString(RNGCS_LowName, ""));
    if (tags.FindQuery(RNGCS_HighName))
        mHighName = OrbString(tags.GetString(RNGCS_HighName, ""));
    mLimits.pushOther = mPush;
    mLimits.step = mInteger ? 1.0 : 1.0 / std::pow(10.0, mPlaces);
    mTrack->SetScale(mScaleLow, mScaleHigh);
    mTrack->SetTickCount(mTicks);
    mLowEdit->SetInteger(mInteger);
    mHighEdit->SetInteger(mInteger);
    mLowEdit->setToolTip(ToQString(mLowName));
    mHighEdit->setToolTip(ToQString(mHighName));
}

void RangeControl::LinkHigh(const TagList &tags)
{
    if (!LinkInput(*this, tags, RNGCP_HighInput, mHighInput))
        return;
    if (const AutoNumber high(mHighInput, GetCurrentTime()); high)
        mHigh = high->Value;
    mTrack->SetHasHigh(mHighInput != nullptr);
    mHighEdit->setEnabled(mHighInput != nullptr);
}

bool RangeControl::SetAttrsTagList(Input *input, const TagList &tags)
{
    ReadOwnTags(tags);
    LinkHigh(tags);
    if (IsOpen())
        ShowValues();
    return LabelledInputControl::SetAttrsTagList(input, tags);
}

bool RangeControl::AddInput(Input *input, const TagList *tags)
{
    const bool first = !GetCurrentInput();
    if (!LabelledInputControl::AddInput(input, tags))
        return false;
    if (!first)
        return true;
    if (const AutoNumber low(input, GetCurrentTime()); low)
        mLow = low->Value;
    mTrack->SetHasHigh(false);
    mHighEdit->setEnabled(false);
    LinkHigh(input->GetAttrs());
    return true;
}

bool RangeControl::Open(QWidget *host, const QRect &rect, const TagList *tags)
{
    if (!LabelledInputControl::Open(host, rect, tags))
        return false;
    for (QWidget *child : {static_cast<QWidget *>(Label()), static_cast<QWidget *>(mLowEdit),
                           static_cast<QWidget *>(mHighEdit), static_cast<QWidget *>(mTrack)})
        child->show();
    ShowValues();
    PlaceChildren(ClassLayout(kLayoutItem), false);
    return true;
}

bool RangeControl::NotifyChanged(Input *input, Parameter *value, const TagList *tags)
{
    if (!value)
        return LabelledInputControl::NotifyChanged(input, value, tags);
    const auto *number = dynamic_cast<const Number *>(value);
    float64 &end = input && input == mHighInput ? mHigh : mLow;
    if (!number || !HasValueChanged(mInteger, number->Value, end, mLimits.step * 0.5))
        return true;
    end = number->Value;
    return LabelledInputControl::NotifyChanged(input, value, tags);
}

bool RangeControl::UpdateDisplay(Input *input, const TagList *tags)
{
    if (IsOpen())
        ShowValues();
    return LabelledInputControl::UpdateDisplay(input, tags);
}

void RangeControl::ShowValues()
{
    const int32 places = mInteger ? 0 : mPlaces;
    // What the user is typing stays until it is applied.
    if (!mLowEdit->isModified())
        mLowEdit->SetValue(mLow, places);
    if (!mHighEdit->isModified())
        mHighEdit->SetValue(mHigh, places);
    mTrack->SetValues(mLow, mHigh);
    mTrack->setProperty("inverted", mHighInput && mLow > mHigh);
}

OrbString RangeControl::UndoName(RangeLimits::End moved) const
{
    const OrbString &name = moved == RangeLimits::End_Low    ? mLowName
                            : moved == RangeLimits::End_High ? mHighName
                                                             : OrbString();
    return name.IsEmpty() ? InputGesture::StepName(*this) : OrbString("Change " + name.str());
}

// Only the ends that really change are written; without a high Input the
// low end is bounded by the allowed range alone.
void RangeControl::Write(float64 low, float64 high, RangeLimits::End moved)
{
    const auto [newLow, newHigh] = mHighInput ? mLimits.Constrain(low, high, moved)
                                              : mLimits.Constrain(low, mLimits.maxAllowed, RangeLimits::End_Low);
    const OrbString name = UndoName(moved);
    const float64 tolerance = mLimits.step * 0.5;
    if (HasValueChanged(mInteger, newLow, mLow, tolerance))
        mGesture.Write(GetCurrentInput(), AutoNumber(newLow), name);
    if (mHighInput && HasValueChanged(mInteger, newHigh, mHigh, tolerance))
        mGesture.Write(mHighInput, AutoNumber(newHigh), name);
    // A refused or trimmed write shows what the Inputs hold.
    ShowValues();
}

void RangeControl::OnTrackMoved(float64 low, float64 high, int part)
{
    Write(low, high, RangeLimits::End(part));
}

void RangeControl::OnTrackReleased()
{
    mGesture.End();
}

void RangeControl::OnReset()
{
    Write(mDefaultLow, mDefaultHigh, RangeLimits::End_High);
    mGesture.End();
}

void RangeControl::Typed(TimeCodeEdit *edit, RangeLimits::End end)
{
    if (!edit->isModified())
        return;
    edit->setModified(false);
    bool ok = false;
    const float64 value = edit->GetValue(&ok);
    if (ok)
        Write(end == RangeLimits::End_Low ? value : mLow, end == RangeLimits::End_High ? value : mHigh, end);
    mGesture.End();
    ShowValues();
}

void RangeControl::OnLowTyped()
{
    Typed(mLowEdit, RangeLimits::End_Low);
}

void RangeControl::OnHighTyped()
{
    Typed(mHighEdit, RangeLimits::End_High);
}

bool RangeControl::OnDisconnect(Input *input, const TagList *tags)
{
    WriteOnDisconnect(input, input && input == mHighInput ? mHigh : mLow);
    const bool done = LabelledInputControl::OnDisconnect(input, tags);
    if (input == mHighInput)
        mHighInput = nullptr;
    return done;
}

} // namespace Orbane
