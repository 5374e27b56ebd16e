#include "widgets/CustomSlider.h"

#include "widgets/SkinImages.h"

#include "orbane/DIB.h"
#include "orbane/Gradient.h"

#include <algorithm>
#include <cmath>

namespace Orbane {

namespace {

// Values closer than single-precision epsilon count as equal: Inputs store
// what the user sees with float accuracy.
constexpr float64 ValueEpsilon = 1.1920928955078125e-07;
// Steps in two-segment mode stop at the centre unless the value is already
// within this of it.
constexpr float64 CentreEpsilon = 1e-9;

float64 Clamp(float64 v, float64 lo, float64 hi)
{
    return v < lo ? lo : v > hi ? hi : v;
}

} // namespace

bool CustomSlider::TrackKey::operator==(const TrackKey &o) const
{
    return width == o.width && ratio == o.ratio && image == o.image && gradients[0] == o.gradients[0] &&
           gradients[1] == o.gradients[1] && serials[0] == o.serials[0] && serials[1] == o.serials[1] &&
           spaces[0] == o.spaces[0] && spaces[1] == o.spaces[1] && from == o.from && to == o.to && centre == o.centre &&
           twoSegment == o.twoSegment;
}

CustomSlider::CustomSlider(const Registry *reg, const ScriptVal &args, const TagList &tags)
    : CustomController(reg, args, tags)
{
    setFocusPolicy(Qt::ClickFocus);
    SetKnobImage(SkinImages::Get(SkinImages::SliderKnob), SkinImages::Get(SkinImages::SliderKnobPressed));
    SetResetImage(SkinImages::Get(SkinImages::SliderReset));
}

CustomSlider::~CustomSlider()
{
    StopRepeat();
    for (Gradient *ramp : {mGradient, mGradient2})
        if (ramp)
            ramp->DecRef();
    for (DIB **image : {&mTrack, &mLitKnob, &mLitKnobSource, &mLitReset, &mLitResetSource})
        StoreImage(*image, nullptr);
}

// ---- settings ----

void CustomSlider::SetRange(float64 min, float64 max)
{
    if (min > max)
        std::swap(min, max);
    mValue = Clamp(mValue, min, max);
    mCentre = Clamp(mCentre, min, max);
    const float64 oldMin = mMinScale, oldMax = mMaxScale;
    if (std::fabs(min - mLastRangeMin) > ValueEpsilon)
        mMinScale = min;
    if (std::fabs(max - mLastRangeMax) > ValueEpsilon)
        mMaxScale = max;
    mLastRangeMin = min;
    mLastRangeMax = max;
    if (oldMin != mMinScale || oldMax != mMaxScale)
        Redraw(true);
}

void CustomSlider::SetScale(float64 min, float64 max, bool redraw)
{
    if (min > max)
        std::swap(min, max);
    const float64 oldX = ValueToPixel(mValue);
    // An allowed range that was never set (both 0) limits nothing.
    const bool limited = mMaxAllowed > mMinAllowed;
    mMinScale = limited ? std::max(min, mMinAllowed) : min;
    mMaxScale = limited ? std::min(max, mMaxAllowed) : max;
    if (mDragKnob)
        mGrabOffset += oldX - ValueToPixel(mValue);
    if (redraw)
        Redraw(true);
}

void CustomSlider::SetAllowedRange(float64 min, float64 max, bool redraw)
{
    if (min > max)
        std::swap(min, max);
    mMinAllowed = min;
    mMaxAllowed = max;
    const float64 oldMin = mMinScale, oldMax = mMaxScale;
    mMinScale = std::max(mMinScale, mMinAllowed);
    mMaxScale = std::min(mMaxScale, mMaxAllowed);
    if (redraw) {
        const bool scaleChanged = oldMin != mMinScale || oldMax != mMaxScale;
        Redraw(IsResetShown() && scaleChanged);
    }
}

void CustomSlider::SetTickCount(int32 count)
{
    if (count == 0)
        return;
    mTickCount = std::max(2, count);
    const float64 intervals = mTickCount - 1;
    mStepDown[STEP_Coarse] = mStepUp[STEP_Coarse] = (mMaxScale - mMinScale) / intervals;
    if (IsTwoSegment()) {
        mStepDown[STEP_Coarse] = (mCentre - mMinScale) / intervals;
        mStepUp[STEP_Coarse] = (mMaxScale - mCentre) / intervals;
    }
}

void CustomSlider::SetStepCount(int32 count)
{
    if (count <= 0)
        return;
    const bool twoSegment = IsTwoSegment();
    const float64 down = (twoSegment ? mCentre - mMinScale : mMaxScale - mMinScale) / count;
    const float64 up = (twoSegment ? mMaxScale - mCentre : mMaxScale - mMinScale) / count;
    mStepDown[STEP_Fine] = down / 10.0;
    mStepDown[STEP_Normal] = down;
    mStepUp[STEP_Fine] = up / 10.0;
    mStepUp[STEP_Normal] = up;
}

void CustomSlider::SetCentre(float64 centre)
{
    mCentre = centre;
    mMapping.SetTwoSegment(centre != mMinScale && centre != mMaxScale);
    SetTrackRect(mTrackRect);
    Redraw(true);
}

void CustomSlider::SetInteger(bool on)
{
    mInteger = on;
}

void CustomSlider::SetSnapToStep(bool on)
{
    mSnapToStep = on;
}

void CustomSlider::SetSteps(float64 fine, float64 normal, float64 coarse)
{
    SetStepsDown(fine, normal, coarse);
    SetStepsUp(fine, normal, coarse);
}

void CustomSlider::SetStepsDown(float64 fine, float64 normal, float64 coarse)
{
    mStepDown[STEP_Fine] = fine;
    mStepDown[STEP_Normal] = normal;
    mStepDown[STEP_Coarse] = coarse;
}

void CustomSlider::SetStepsUp(float64 fine, float64 normal, float64 coarse)
{
    mStepUp[STEP_Fine] = fine;
    mStepUp[STEP_Normal] = normal;
    mStepUp[STEP_Coarse] = coarse;
}

void CustomSlider::SetGradients(Gradient *first, Gradient *second)
{
    if (first)
        first->IncRef();
    if (second)
        second->IncRef();
    if (mGradient)
        mGradient->DecRef();
    if (mGradient2)
        mGradient2->DecRef();
    mGradient = first;
    mGradient2 = second;
    // A new ramp may sit where a freed one was: the cached track goes.
    StoreImage(mTrack, nullptr);
    Redraw(true);
}

void CustomSlider::SetColorSpaces(int32 first, int32 second)
{
    mColorSpace = first;
    mColorSpace2 = second;
    Redraw(true);
}

void CustomSlider::SetMappingCallbacks(MapFunc forward, void *forwardData, MapFunc inverse, void *inverseData)
{
    mMapping.SetCallbacks(forward, forwardData, inverse, inverseData);
    Redraw(true);
}

bool CustomSlider::SetMappingExpressions(const char *forward, const char *inverse)
{
    const bool ok = mMapping.SetExpressions(forward, inverse);
    Redraw(true);
    return ok;
}

// ---- mapping ----

const SliderMapping &CustomSlider::Mapping() const
{
    mMapping.SetBounds({mMinScale, mMaxScale, mMinAllowed, mMaxAllowed, mCentre, mExponent});
    return mMapping;
}

int32 CustomSlider::KnobX() const
{
    return int32(std::floor(ValueToPixel(mValue) + 0.5));
}

void CustomSlider::SetTrackRect(const OrbRectT<int32> &rect)
{
    CustomController::SetTrackRect(rect);
    // The knob stays wholly on the track: its centre runs from half a knob
    // in from the left to half a knob in from the right.
    const float64 pixelMin = rect.x1 - mKnobRect.x1;
    mMapping.SetTrack(pixelMin, std::max(pixelMin, float64(rect.x2 - mKnobRect.x2 - (mKnobImage ? 0 : 1))));
}

void CustomSlider::OnSize(int32 width, int32 height)
{
    const OrbRectT<int32> rect(0, 0, width, height);
    if (rect != mTrackRect)
        SetTrackRect(rect);
}

// ---- values ----

bool CustomSlider::IsResetShown() const
{
    return HasDefault() && mResetHeight > 0 && std::fabs(mValue - mDefault) > ValueEpsilon;
}

float64 CustomSlider::MapValue(float64 value)
{
    if (!mInteger || !mSnapToStep)
        return value;
    return Mapping().SnapToStep(value, mStepDown[STEP_Normal], mStepUp[STEP_Normal]);
}

void CustomSlider::SetValue(float64 value, bool redraw)
{
    if (value == mValue)
        return;
    const bool shown = IsResetShown();
    mValue = value;
    if (redraw)
        Redraw(shown != IsResetShown());
}

void CustomSlider::SetSliderValue(float64 value)
{
    if (value == mValue && !mFirstChange)
        return;
    const bool shown = IsResetShown();
    mValue = MapValue(value);
    emit ValueChanged(mValue);
    emit dragSlider(this, mFirstChange ? 1 : 0);
    mFirstChange = false;
    Redraw(shown != IsResetShown());
}

float64 CustomSlider::StepSize(int32 direction, int32 level) const
{
    level = Level(level);
    float64 step;
    if (!mMapping.HasMapping()) {
        const bool above = IsTwoSegment() && (mValue > mCentre || (mValue == mCentre && direction > 0));
        step = above ? mStepUp[level] : mStepDown[level];
    } else {
        step = Mapping().TrackStep(mValue, direction, level);
    }
    return mInteger && step < 1.0 ? 1.0 : step;
}

void CustomSlider::Step(int32 direction, int32 level)
{
    float64 v = mValue + direction * StepSize(direction, level);
    if (IsTwoSegment()) {
        if (direction < 0 && mValue > mCentre + CentreEpsilon && v < mCentre)
            v = mCentre;
        else if (direction > 0 && mValue < mCentre - CentreEpsilon && v > mCentre)
            v = mCentre;
    }
    SetSliderValue(Clamp(v, mMinScale, mMaxScale));
}

// ---- redraw ----

QRect CustomSlider::KnobUpdateRect(int32 x) const
{
    return QRect(x + mKnobRect.x1 - 1, mTrackRect.y1 + mKnobTop, mKnobRect.Width() + 2, mKnobRect.Height());
}

void CustomSlider::Redraw(bool full)
{
    if (!isVisible())
        return;
    if (full || mLastKnobX < 0 || !mKnobImage) {
        update();
        return;
    }
    // A drag moves the knob a few pixels at a time: where the old and new
    // places overlap, one rectangle over both is one update instead of two.
    const QRect before = KnobUpdateRect(mLastKnobX), after = KnobUpdateRect(KnobX());
    if (before.intersects(after))
        update(before.united(after));
    else
        update(QRegion(before).united(after));
}

} // namespace Orbane
