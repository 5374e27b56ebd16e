#pragma once

#include "orbane/OrbString.h"
#include "orbane/Types.h"

#include <memory>
#include <optional>

namespace Orbane {

class Parser;

// Where a value sits on a slider's track and back, with no widget: a power
// mapping (or callbacks, or expressions) over the soft range, or two linear
// segments split at the centre; the digits a dragged value keeps
// (Resolution); and the two roundings to a step. It is kept apart from the
// painting so that the arithmetic of every drag can be tested and measured
// on its own, as a pure function of the track and the range.
class SliderMapping
{
public:
    using MapFunc = float64 (*)(float64 value, void *data);

    // The value fields of the widget that the mapping reads: the soft range,
    // the hard limits (which expressions may name), the centre of a
    // two-segment track and the power of the plain mapping.
    struct Bounds
    {
        float64 minScale = 0.0;
        float64 maxScale = 0.0;
        float64 minAllowed = 0.0;
        float64 maxAllowed = 0.0;
        float64 centre = 0.0;
        float64 exponent = 1.0;
    };

    SliderMapping();
    // A copy compiles its own expressions: each parser is bound to the
    // variables of the mapping that owns it.
    SliderMapping(const SliderMapping &other);
    SliderMapping &operator=(const SliderMapping &other);
    ~SliderMapping();

    void SetBounds(const Bounds &bounds) noexcept { mBounds = bounds; }
    const Bounds &GetBounds() const noexcept { return mBounds; }
    // The track pixels of the soft range's ends; the centre pixel lies halfway.
    void SetTrack(float64 pixelMin, float64 pixelMax) noexcept;
    float64 PixelMin() const noexcept { return mPixelMin; }
    float64 PixelMax() const noexcept { return mPixelMax; }
    float64 PixelCentre() const noexcept { return mPixelCentre; }
    // Two linear halves split at the centre instead of the power mapping.
    void SetTwoSegment(bool on) noexcept { mTwoSegment = on; }
    bool IsTwoSegment() const noexcept { return mTwoSegment; }
    // The value about which a scaling factor k other than 1 stretches the track.
    void SetAnchor(float64 anchor) noexcept { mAnchor = anchor; }
    float64 GetAnchor() const noexcept { return mAnchor; }

    // Functions that replace the power mapping: track coordinate of a value
    // and back. Both null restore the power mapping.
    void SetCallbacks(MapFunc forward, void *forwardData, MapFunc inverse, void *inverseData) noexcept;
    // The same as expressions over "value", "minscale", "maxscale",
    // "minallowed" and "maxallowed". An expression that does not compile is
    // dropped (false); empty texts restore the power mapping.
    bool SetExpressions(const char *forward, const char *inverse);
    const OrbString &GetForwardExpression() const noexcept { return mForwardExpr; }
    const OrbString &GetInverseExpression() const noexcept { return mInverseExpr; }
    // A forward callback or expression: steps are then taken on the track.
    bool HasMapping() const noexcept { return mForward || !mForwardExpr.IsEmpty(); }
    // Exponent 1 and no callback or expression in either direction.
    bool IsPlainLinear() const noexcept;

    // The track coordinate of a value and back (the power mapping, or the
    // callbacks, or the expressions).
    float64 Forward(float64 value) const;
    float64 Inverse(float64 t) const;
    // `k` scales about the anchor (0.1 for a fine drag). Pixels are clamped
    // to the track; values of a linear track to the soft range.
    float64 ValueToPixel(float64 value, float64 k = 1.0) const;
    float64 PixelToValue(float64 x, float64 k = 1.0) const;
    // The power of ten a value is rounded by: one digit more than a pixel of
    // track tells apart, at most two more than a linear track needs.
    float64 Resolution(float64 value) const;
    // `value` rounded to Resolution / k.
    float64 Quantise(float64 value, float64 k) const;
    // What a drag to track pixel `x` stores at scaling `k`: within half a
    // pixel of `press` exactly `press`, else within half a pixel of the
    // default exactly the default, else the pixel's value quantised; always
    // inside the soft range.
    float64 DragValue(float64 x, float64 k, float64 press, std::optional<float64> def) const;
    // The size of a step of `level` (0 fine, 1 normal, 2 coarse) taken on the
    // track from `value`: a thousandth, a hundredth or a tenth of it.
    float64 TrackStep(float64 value, int32 direction, int32 level) const;
    // `value` on a multiple of the step of its side of the centre; a value
    // pushed across the centre, or at it, goes to the centre rounded.
    float64 SnapToStep(float64 value, float64 stepDown, float64 stepUp) const;

    // The two roundings to a step. They differ on purpose, and the
    // difference shows below zero only:
    //
    // AddHalfTruncate is how the widget snaps integer sliders: it adds half a
    // step and truncates toward zero, so below zero every fraction goes
    // toward zero (-2.7 is stored as -2, -2.2 as -1). Integer sliders have
    // always stored their values this way and the values users have set
    // depend on it.
    //
    // RoundHalfUp is how a control rounds to an Input's decimal places: the
    // nearest point of the grid, a half going up (-2.7 gives -3, -2.5 gives
    // -2), so that a written value is what the places show. Steps that are
    // a whole fraction of 1 (0.01) divide instead of multiply, which gives
    // the double nearest the decimal (0.12, not 12 * 0.01).
    //
    // A step that is not positive leaves the value as it is.
    static float64 AddHalfTruncate(float64 value, float64 step) noexcept;
    static float64 RoundHalfUp(float64 value, float64 step) noexcept;

private:
    float64 Evaluate(const Parser &parser, float64 value) const;
    bool Compile(const char *text, OrbString &expr, std::unique_ptr<Parser> &parser);
    float64 SegmentPixel(float64 value) const;
    float64 SegmentValue(float64 x) const;

    Bounds mBounds;
    float64 mPixelMin = 0.0;
    float64 mPixelMax = 0.0;
    float64 mPixelCentre = 0.0;
    bool mTwoSegment = false;
    float64 mAnchor = 0.0;
    MapFunc mForward = nullptr;
    void *mForwardData = nullptr;
    MapFunc mInverse = nullptr;
    void *mInverseData = nullptr;
    OrbString mForwardExpr;
    OrbString mInverseExpr;
    std::unique_ptr<Parser> mForwardParser;
    std::unique_ptr<Parser> mInverseParser;
    // The expressions' variables, bound by name in both parsers and filled
    // before each evaluation.
    mutable float64 mSymbols[5] = {};
};

} // namespace Orbane
