#include "widgets/SliderMapping.h"

#include "orbane/Parser.h"

#include <algorithm>
#include <cmath>

namespace Orbane {

namespace {

enum Symbol
{
    SYM_Value,
    SYM_MinScale,
    SYM_MaxScale,
    SYM_MinAllowed,
    SYM_MaxAllowed,
    SYM_Count
};
const char *const SymbolNames[SYM_Count] = {"value", "minscale", "maxscale", "minallowed", "maxallowed"};

float64 Clamp(float64 v, float64 lo, float64 hi)
{
    return v < lo ? lo : v > hi ? hi : v;
}

float64 SignedPow(float64 v, float64 e)
{
    return v < 0.0 ? -std::pow(-v, e) : std::pow(v, e);
}

} // namespace

SliderMapping::SliderMapping() = default;
SliderMapping::~SliderMapping() = default;

SliderMapping::SliderMapping(const SliderMapping &other)
{
    *this = other;
}

SliderMapping &SliderMapping::operator=(const SliderMapping &other)
{
    if (this == &other)
        return *this;
    mBounds = other.mBounds;
    SetTrack(other.mPixelMin, other.mPixelMax);
    mTwoSegment = other.mTwoSegment;
    mAnchor = other.mAnchor;
    SetCallbacks(other.mForward, other.mForwardData, other.mInverse, other.mInverseData);
    SetExpressions(other.mForwardExpr.c_str(), other.mInverseExpr.c_str());
    return *this;
}

void SliderMapping::SetTrack(float64 pixelMin, float64 pixelMax) noexcept
{
    mPixelMin = pixelMin;
    mPixelMax = pixelMax;
    mPixelCentre = (pixelMin + pixelMax) / 2.0;
}

void SliderMapping::SetCallbacks(MapFunc forward, void *forwardData, MapFunc inverse, void *inverseData) noexcept
{
    mForward = forward;
    mForwardData = forwardData;
    mInverse = inverse;
    mInverseData = inverseData;
}

bool SliderMapping::Compile(const char *text, OrbString &expr, std::unique_ptr<Parser> &parser)
{
    expr = OrbString();
    if (!text || !*text)
        return true;
    if (!parser) {
        parser = std::make_unique<Parser>();
        for (int32 i = 0; i < SYM_Count; ++i)
            parser->DefineVar(SymbolNames[i], &mSymbols[i]);
    }
    if (!parser->SetExpression(text))
        return false;
    expr = OrbString(text);
    return true;
}

bool SliderMapping::SetExpressions(const char *forward, const char *inverse)
{
    // Both are compiled even when the first fails.
    const bool forwardOk = Compile(forward, mForwardExpr, mForwardParser);
    const bool inverseOk = Compile(inverse, mInverseExpr, mInverseParser);
    return forwardOk && inverseOk;
}

bool SliderMapping::IsPlainLinear() const noexcept
{
    return mBounds.exponent == 1.0 && !mForward && !mInverse && mForwardExpr.IsEmpty() && mInverseExpr.IsEmpty();
}

float64 SliderMapping::Evaluate(const Parser &parser, float64 value) const
{
    mSymbols[SYM_Value] = value;
    mSymbols[SYM_MinScale] = mBounds.minScale;
    mSymbols[SYM_MaxScale] = mBounds.maxScale;
    mSymbols[SYM_MinAllowed] = mBounds.minAllowed;
    mSymbols[SYM_MaxAllowed] = mBounds.maxAllowed;
    return parser.Evaluate();
}

float64 SliderMapping::Forward(float64 value) const
{
    if (mForward)
        return mForward(value, mForwardData);
    if (!mForwardExpr.IsEmpty())
        return Evaluate(*mForwardParser, value);
    return mBounds.exponent == 1.0 ? value : SignedPow(value, 1.0 / mBounds.exponent);
}

float64 SliderMapping::Inverse(float64 t) const
{
    if (mInverse)
        return mInverse(t, mInverseData);
    if (!mInverseExpr.IsEmpty())
        return Evaluate(*mInverseParser, t);
    return mBounds.exponent == 1.0 ? t : SignedPow(t, mBounds.exponent);
}

float64 SliderMapping::SegmentPixel(float64 v) const
{
    const Bounds &b = mBounds;
    if (v == b.centre)
        return mPixelCentre;
    if (v < b.centre)
        return b.centre == b.minScale
                   ? mPixelMin
                   : mPixelMin + (mPixelCentre - mPixelMin) * (v - b.minScale) / (b.centre - b.minScale);
    return b.centre == b.maxScale
               ? mPixelMax + 1
               : mPixelCentre + (mPixelMax - mPixelCentre) * (v - b.centre) / (b.maxScale - b.centre);
}

float64 SliderMapping::SegmentValue(float64 x) const
{
    const Bounds &b = mBounds;
    if (x < mPixelCentre)
        return mPixelCentre > mPixelMin
                   ? b.minScale + (x - mPixelMin) * (b.centre - b.minScale) / (mPixelCentre - mPixelMin)
                   : b.centre;
    return mPixelMax > mPixelCentre
               ? b.centre + (x - mPixelCentre) * (b.maxScale - b.centre) / (mPixelMax - mPixelCentre)
               : b.centre;
}

float64 SliderMapping::ValueToPixel(float64 value, float64 k) const
{
    if (mBounds.maxScale == mBounds.minScale)
        return mPixelMin;
    float64 x;
    if (!mTwoSegment) {
        float64 s = Forward(value);
        if (k != 1.0) {
            const float64 anchor = Forward(mAnchor);
            s = (s - anchor) / k + anchor;
        }
        const float64 s0 = Forward(mBounds.minScale), s1 = Forward(mBounds.maxScale);
        x = s1 == s0 ? mPixelMin : mPixelMin + (mPixelMax - mPixelMin) * (s - s0) / (s1 - s0);
    } else {
        if (k != 1.0)
            value = (value - mAnchor) / k + mAnchor;
        x = SegmentPixel(value);
    }
    // A mapping that gives no number puts the knob at the start.
    return std::isnan(x) ? mPixelMin : Clamp(x, mPixelMin, mPixelMax);
}

float64 SliderMapping::PixelToValue(float64 x, float64 k) const
{
    if (mTwoSegment) {
        const float64 v = SegmentValue(x);
        return k != 1.0 ? (v - mAnchor) * k + mAnchor : v;
    }
    const float64 s0 = Forward(mBounds.minScale), s1 = Forward(mBounds.maxScale);
    const float64 span = mPixelMax - mPixelMin;
    float64 t = span > 0.0 ? s0 + (x - mPixelMin) * (s1 - s0) / span : s0;
    if (k != 1.0) {
        const float64 anchor = Forward(mAnchor);
        t = (t - anchor) * k + anchor;
    }
    return Inverse(Clamp(t, std::min(s0, s1), std::max(s0, s1)));
}

float64 SliderMapping::Resolution(float64 value) const
{
    const Bounds &b = mBounds;
    if (b.maxScale == b.minScale)
        return 1.0;
    if (mTwoSegment) {
        const float64 xc = ValueToPixel(b.centre);
        if (value < b.centre && b.centre != b.minScale)
            return std::pow(10.0, std::ceil(std::log10(std::max(1.0, xc - mPixelMin))) -
                                      std::floor(std::log10(b.centre - b.minScale)));
        if (value > b.centre && b.centre != b.maxScale)
            return std::pow(10.0, std::ceil(std::log10(std::max(1.0, mPixelMax - xc))) -
                                      std::floor(std::log10(b.maxScale - b.centre)));
        return 1.0;
    }
    float64 n = std::ceil(std::log10(std::max(1.0, mPixelMax - mPixelMin)));
    if (!IsPlainLinear()) {
        const float64 p = std::floor(ValueToPixel(value) + 0.5);
        const float64 q = p < mPixelMin + 1 ? p + 1 : p - 1;
        const float64 apart = std::fabs(PixelToValue(p) - PixelToValue(q));
        const float64 local = apart > 0.0 ? std::ceil(std::log10((b.maxScale - b.minScale) / apart)) : n + 2;
        if (std::isfinite(local))
            n = std::max(n, std::min(local, n + 2));
    }
    return std::pow(10.0, n - std::floor(std::log10(b.maxScale - b.minScale)));
}

float64 SliderMapping::Quantise(float64 value, float64 k) const
{
    const float64 r = Resolution(value) / k;
    return std::floor(r * value + 0.5) / r;
}

float64 SliderMapping::DragValue(float64 x, float64 k, float64 press, std::optional<float64> def) const
{
    float64 v = PixelToValue(x, k);
    const float64 tol = 0.5 * k;
    bool snapped = false;
    // Only where the pixel lies on the track: the knob snaps back to where
    // it started, then to the default; a snapped value is kept exactly.
    if (std::fabs(ValueToPixel(v, k) - x) <= tol) {
        const float64 at = ValueToPixel(v);
        if (std::fabs(at - ValueToPixel(press)) <= tol)
            v = press, snapped = true;
        else if (def && std::fabs(at - ValueToPixel(*def)) <= tol)
            v = *def, snapped = true;
    }
    if (!snapped)
        v = Quantise(v, k);
    return Clamp(v, mBounds.minScale, mBounds.maxScale);
}

float64 SliderMapping::TrackStep(float64 value, int32 direction, int32 level) const
{
    const float64 span = mPixelMax - mPixelMin;
    const float64 x = Clamp(ValueToPixel(value) + direction * std::pow(10.0, level - 3) * span, mPixelMin, mPixelMax);
    // A fine step keeps one more digit, as a fine drag does.
    const float64 v = Quantise(PixelToValue(x), level == 0 ? 0.1 : 1.0);
    return std::fabs(v - value);
}

float64 SliderMapping::SnapToStep(float64 value, float64 stepDown, float64 stepUp) const
{
    if (!mTwoSegment)
        return AddHalfTruncate(value, stepDown);
    const float64 centre = mBounds.centre;
    const float64 atCentre = std::trunc(centre + 0.5);
    if (value == centre)
        return atCentre;
    const bool below = value < centre;
    const float64 mapped = AddHalfTruncate(value, below ? stepDown : stepUp);
    return (below ? mapped > centre : mapped < centre) ? atCentre : mapped;
}

float64 SliderMapping::AddHalfTruncate(float64 value, float64 step) noexcept
{
    return step > 0.0 ? std::trunc((value + step / 2.0) / step) * step : value;
}

float64 SliderMapping::RoundHalfUp(float64 value, float64 step) noexcept
{
    if (!(step > 0.0))
        return value;
    const float64 perUnit = std::round(1.0 / step);
    if (perUnit >= 1.0 && std::fabs(perUnit * step - 1.0) < 1e-12)
        return std::floor(value * perUnit + 0.5) / perUnit;
    return std::floor((value + step * 0.5) / step) * step;
}

} // namespace Orbane
