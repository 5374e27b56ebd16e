#include "widgets/CustomSlider.h"

#include "widgets/SkinImages.h"

#include "orbane/DIB.h"
#include "orbane/Gradient.h"
#include "orbane/Parser.h"

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

enum Symbol
{
    SYM_Value,
    SYM_MinScale,
    SYM_MaxScale,
    SYM_MinAllowed,
    SYM_MaxAllowed
};
const char *const SymbolNames[] = {"value", "minscale", "maxscale", "minallowed", "maxallowed"};

float64 Clamp(float64 v, float64 lo, float64 hi)
{
    return v < lo ? lo : v > hi ? hi : v;
}

float64 SignedPow(float64 v, float64 e)
{
    return v < 0.0 ? -std::pow(-v, e) : std::pow(v, e);
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
    if (mTwoSegment) {
        mStepDown[STEP_Coarse] = (mCentre - mMinScale) / intervals;
        mStepUp[STEP_Coarse] = (mMaxScale - mCentre) / intervals;
    }
}

void CustomSlider::SetStepCount(int32 count)
{
    if (count <= 0)
        return;
    const float64 down = (mTwoSegment ? mCentre - mMinScale : mMaxScale - mMinScale) / count;
    const float64 up = (mTwoSegment ? mMaxScale - mCentre : mMaxScale - mMinScale) / count;
    mStepDown[STEP_Fine] = down / 10.0;
    mStepDown[STEP_Normal] = down;
    mStepUp[STEP_Fine] = up / 10.0;
    mStepUp[STEP_Normal] = up;
}

void CustomSlider::SetCentre(float64 centre)
{
    mCentre = centre;
    mTwoSegment = centre != mMinScale && centre != mMaxScale;
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
    mForward = forward;
    mForwardData = forwardData;
    mInverse = inverse;
    mInverseData = inverseData;
    Redraw(true);
}

bool CustomSlider::SetMappingExpressions(const char *forward, const char *inverse)
{
    auto compile = [this](const char *text, OrbString &expr, std::unique_ptr<Parser> &parser) {
        expr = OrbString();
        if (!text || !*text)
            return true;
        if (!parser) {
            parser = std::make_unique<Parser>();
            for (int32 i = 0; i < 5; ++i)
                parser->DefineVar(SymbolNames[i], &mSymbols[i]);
        }
        if (!parser->SetExpression(text))
            return false;
        expr = OrbString(text);
        return true;
    };
    const bool ok = compile(forward, mForwardExpr, mForwardParser) & compile(inverse, mInverseExpr, mInverseParser);
    Redraw(true);
    return ok;
}

// ---- mapping ----

bool CustomSlider::HasMapping() const noexcept
{
    return mForward || !mForwardExpr.IsEmpty();
}

float64 CustomSlider::ScaleForward(float64 value) const
{
    if (mForward)
        return mForward(value, mForwardData);
    if (!mForwardExpr.IsEmpty()) {
        mSymbols[SYM_Value] = value;
        mSymbols[SYM_MinScale] = mMinScale;
        mSymbols[SYM_MaxScale] = mMaxScale;
        mSymbols[SYM_MinAllowed] = mMinAllowed;
        mSymbols[SYM_MaxAllowed] = mMaxAllowed;
        return mForwardParser->Evaluate();
    }
    return mExponent == 1.0 ? value : SignedPow(value, 1.0 / mExponent);
}

float64 CustomSlider::ScaleInverse(float64 t) const
{
    if (mInverse)
        return mInverse(t, mInverseData);
    if (!mInverseExpr.IsEmpty()) {
        mSymbols[SYM_Value] = t;
        mSymbols[SYM_MinScale] = mMinScale;
        mSymbols[SYM_MaxScale] = mMaxScale;
        mSymbols[SYM_MinAllowed] = mMinAllowed;
        mSymbols[SYM_MaxAllowed] = mMaxAllowed;
        return mInverseParser->Evaluate();
    }
    return mExponent == 1.0 ? t : SignedPow(t, mExponent);
}

float64 CustomSlider::SegmentPixel(float64 v) const
{
    if (v == mCentre)
        return mPixelCentre;
    if (v < mCentre)
        return mCentre == mMinScale ? mPixelMin
                                    : mPixelMin + (mPixelCentre - mPixelMin) * (v - mMinScale) / (mCentre - mMinScale);
    return mCentre == mMaxScale ? mPixelMax + 1
                                : mPixelCentre + (mPixelMax - mPixelCentre) * (v - mCentre) / (mMaxScale - mCentre);
}

float64 CustomSlider::SegmentValue(float64 x) const
{
    if (x < mPixelCentre)
        return mPixelCentre > mPixelMin
                   ? mMinScale + (x - mPixelMin) * (mCentre - mMinScale) / (mPixelCentre - mPixelMin)
                   : mCentre;
    return mPixelMax > mPixelCentre ? mCentre + (x - mPixelCentre) * (mMaxScale - mCentre) / (mPixelMax - mPixelCentre)
                                    : mCentre;
}

float64 CustomSlider::ValueToPixel(float64 value, float64 k) const
{
    if (mMaxScale == mMinScale)
        return mPixelMin;
    float64 x;
    if (!mTwoSegment) {
        float64 s = ScaleForward(value);
        if (k != 1.0) {
            const float64 anchor = ScaleForward(mScaleAnchor);
            s = (s - anchor) / k + anchor;
        }
        const float64 s0 = ScaleForward(mMinScale), s1 = ScaleForward(mMaxScale);
        x = s1 == s0 ? mPixelMin : mPixelMin + (mPixelMax - mPixelMin) * (s - s0) / (s1 - s0);
    } else {
        if (k != 1.0)
            value = (value - mScaleAnchor) / k + mScaleAnchor;
        x = SegmentPixel(value);
    }
    // A mapping that gives no number puts the knob at the start.
    return std::isnan(x) ? mPixelMin : Clamp(x, mPixelMin, mPixelMax);
}

float64 CustomSlider::PixelToValue(float64 x, float64 k) const
{
    if (mTwoSegment) {
        const float64 v = SegmentValue(x);
        return k != 1.0 ? (v - mScaleAnchor) * k + mScaleAnchor : v;
    }
    const float64 s0 = ScaleForward(mMinScale), s1 = ScaleForward(mMaxScale);
    const float64 span = mPixelMax - mPixelMin;
    float64 t = span > 0.0 ? s0 + (x - mPixelMin) * (s1 - s0) / span : s0;
    if (k != 1.0) {
        const float64 anchor = ScaleForward(mScaleAnchor);
        t = (t - anchor) * k + anchor;
    }
    return ScaleInverse(Clamp(t, std::min(s0, s1), std::max(s0, s1)));
}

float64 CustomSlider::Resolution(float64 value) const
{
    if (mMaxScale == mMinScale)
        return 1.0;
    if (mTwoSegment) {
        const float64 xc = ValueToPixel(mCentre);
        if (value < mCentre && mCentre != mMinScale)
            return std::pow(10.0, std::ceil(std::log10(std::max(1.0, xc - mPixelMin))) -
                                      std::floor(std::log10(mCentre - mMinScale)));
        if (value > mCentre && mCentre != mMaxScale)
            return std::pow(10.0, std::ceil(std::log10(std::max(1.0, mPixelMax - xc))) -
                                      std::floor(std::log10(mMaxScale - mCentre)));
        return 1.0;
    }
    float64 n = std::ceil(std::log10(std::max(1.0, mPixelMax - mPixelMin)));
    if (mExponent != 1.0 || HasMapping() || !mInverseExpr.IsEmpty() || mInverse) {
        const float64 p = std::floor(ValueToPixel(value) + 0.5);
        const float64 q = p < mPixelMin + 1 ? p + 1 : p - 1;
        const float64 apart = std::fabs(PixelToValue(p) - PixelToValue(q));
        const float64 local = apart > 0.0 ? std::ceil(std::log10((mMaxScale - mMinScale) / apart)) : n + 2;
        if (std::isfinite(local))
            n = std::max(n, std::min(local, n + 2));
    }
    return std::pow(10.0, n - std::floor(std::log10(mMaxScale - mMinScale)));
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
    mPixelMin = rect.x1 - mKnobRect.x1;
    mPixelMax = std::max(mPixelMin, float64(rect.x2 - mKnobRect.x2 - (mKnobImage ? 0 : 1)));
    mPixelCentre = (mPixelMin + mPixelMax) / 2.0;
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

float64 CustomSlider::RoundToStep(float64 value, float64 step) const
{
    return step > 0.0 ? std::trunc((value + step / 2.0) / step) * step : value;
}

float64 CustomSlider::MapValue(float64 value)
{
    if (!mInteger || !mSnapToStep)
        return value;
    if (!mTwoSegment)
        return RoundToStep(value, mStepDown[STEP_Normal]);
    const float64 atCentre = std::trunc(mCentre + 0.5);
    if (value == mCentre)
        return atCentre;
    const bool below = value < mCentre;
    const float64 mapped = RoundToStep(value, below ? mStepDown[STEP_Normal] : mStepUp[STEP_Normal]);
    return (below ? mapped > mCentre : mapped < mCentre) ? atCentre : mapped;
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
    if (!HasMapping()) {
        const bool above = mTwoSegment && (mValue > mCentre || (mValue == mCentre && direction > 0));
        step = above ? mStepUp[level] : mStepDown[level];
    } else {
        const float64 span = mPixelMax - mPixelMin;
        const float64 x =
            Clamp(ValueToPixel(mValue) + direction * std::pow(10.0, level - 3) * span, mPixelMin, mPixelMax);
        float64 v = PixelToValue(x);
        const float64 r = Resolution(v) / (level == STEP_Fine ? 0.1 : 1.0);
        v = std::floor(r * v + 0.5) / r;
        step = std::fabs(v - mValue);
    }
    return mInteger && step < 1.0 ? 1.0 : step;
}

void CustomSlider::Step(int32 direction, int32 level)
{
    float64 v = mValue + direction * StepSize(direction, level);
    if (mTwoSegment) {
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
    update(KnobUpdateRect(mLastKnobX));
    update(KnobUpdateRect(KnobX()));
}

} // namespace Orbane
