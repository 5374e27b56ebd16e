#pragma once

#include "widgets/CustomController.h"
#include "widgets/SliderMapping.h"

#include "orbane/ScriptVal.h"
#include "orbane/TagList.h"

class QMouseEvent;

namespace Orbane {

class Gradient;

// The inspector's horizontal number slider: a stretched track image with an
// optional colour ramp, a knob at the value and a reset marker under the
// track at the default. Value and pixel meet in a SliderMapping, which the
// slider keeps and feeds with its range.
class CustomSlider : public CustomController
{
    Q_OBJECT
public:
    using MapFunc = SliderMapping::MapFunc;
    enum StepLevel : int32
    {
        STEP_Fine = 0,
        STEP_Normal = 1,
        STEP_Coarse = 2
    };
    // Page repeat: the timer's period and the ticks it waits before repeating.
    static constexpr int32 RepeatInterval = 70;
    static constexpr int32 RepeatDelay = 3;

    CustomSlider(const Registry *reg = nullptr, const ScriptVal &args = ScriptVal(), const TagList &tags = TagList());
    ~CustomSlider() override;

    std::size_t SizeOf() const override { return sizeof(CustomSlider); }

    void SetRange(float64 min, float64 max) override;
    void SetScale(float64 min, float64 max, bool redraw) override;
    void SetAllowedRange(float64 min, float64 max, bool redraw) override;
    void SetTickCount(int32 count) override;
    void SetCentre(float64 centre) override;
    void SetValue(float64 value, bool redraw) override;
    void SetSliderValue(float64 value) override;
    float64 MapValue(float64 value) override;
    void SetTrackRect(const OrbRectT<int32> &rect) override;
    void Redraw(bool full) override;
    void OnSize(int32 width, int32 height) override;

    void SetInteger(bool on);
    bool IsInteger() const noexcept { return mInteger; }
    // With integer stepping, store every value on a multiple of the normal step.
    void SetSnapToStep(bool on);
    bool IsSnapToStep() const noexcept { return mSnapToStep; }
    // Steps by level, both below and above the centre, or each side alone.
    void SetSteps(float64 fine, float64 normal, float64 coarse);
    void SetStepsDown(float64 fine, float64 normal, float64 coarse);
    void SetStepsUp(float64 fine, float64 normal, float64 coarse);
    // Normal steps of 1/count of the soft range (of each half about the
    // centre), fine steps a tenth of that; 0 changes nothing.
    void SetStepCount(int32 count);
    float64 GetStepDown(int32 level) const noexcept { return mStepDown[Level(level)]; }
    float64 GetStepUp(int32 level) const noexcept { return mStepUp[Level(level)]; }
    int32 GetTickCount() const noexcept { return mTickCount; }
    bool IsTwoSegment() const noexcept { return mMapping.IsTwoSegment(); }

    // A colour ramp in the track; the second one paints the part right of
    // the centre. Each holds a reference.
    void SetGradients(Gradient *first, Gradient *second);
    void SetColorSpaces(int32 first, int32 second);
    // Functions that replace the power mapping: track coordinate of a value
    // and back. Both null restores the power mapping.
    void SetMappingCallbacks(MapFunc forward, void *forwardData, MapFunc inverse, void *inverseData);
    // The same as expressions over "value", "minscale", "maxscale",
    // "minallowed" and "maxallowed". An expression that does not compile is
    // dropped (false); empty texts restore the power mapping.
    bool SetMappingExpressions(const char *forward, const char *inverse);

    // The mapping with the slider's present range. `k` scales about the
    // anchor (0.1 for a fine drag).
    const SliderMapping &Mapping() const;
    float64 ValueToPixel(float64 value, float64 k = 1.0) const { return Mapping().ValueToPixel(value, k); }
    float64 PixelToValue(float64 x, float64 k = 1.0) const { return Mapping().PixelToValue(x, k); }
    float64 Resolution(float64 value) const { return Mapping().Resolution(value); }
    // The step one key press of `level` makes from the current value.
    float64 StepSize(int32 direction, int32 level) const;
    void Step(int32 direction, int32 level);

    float64 GetScaleAnchor() const noexcept { return mMapping.GetAnchor(); }
    // The knob's column: the value's pixel rounded.
    int32 KnobX() const;
    bool IsDragging() const noexcept { return mDragKnob; }
    bool IsResetArmed() const noexcept { return mResetArmed; }
    bool IsHoverKnob() const noexcept { return mHoverKnob; }
    bool IsHoverReset() const noexcept { return mHoverReset; }
    bool IsHoverTrack() const noexcept { return mHoverTrack; }
    // Is the reset marker drawn at the moment?
    bool IsResetShown() const;

public slots:
    void OnEditStartDrag(TimeCodeEdit *edit) override;
    void OnEditEndDrag(TimeCodeEdit *edit) override;
    void OnEditDrag(float64 dist, TimeCodeEdit *edit) override;

protected:
    void paintEvent(QPaintEvent *event) override;
    void mousePressEvent(QMouseEvent *event) override;
    void mouseMoveEvent(QMouseEvent *event) override;
    void mouseReleaseEvent(QMouseEvent *event) override;
    void keyPressEvent(QKeyEvent *event) override;
    void keyReleaseEvent(QKeyEvent *event) override;
    void timerEvent(QTimerEvent *event) override;
    void enterEvent(QEvent *event) override;
    void leaveEvent(QEvent *event) override;

private:
    static int32 Level(int32 level) noexcept { return level < 0 ? 0 : level > 2 ? 2 : level; }
    QRect KnobHitRect() const;
    QRect ResetHitRect() const;
    bool OnTrackRows(int32 y) const;
    void MoveHandler(int32 x, int32 y, Qt::KeyboardModifiers modifiers);
    void DragTo(int32 x, float64 k);
    void UpdateHover(int32 x, int32 y);
    void PressTrack(int32 x, bool fine);
    void ReAnchor();
    void EndGesture();
    void StopRepeat();
    bool KeyTarget(int32 key) const;
    void PaintTrack(QPainter &painter, int32 knobY);
    void PaintGradient(DIB &track);
    void PaintKnob(QPainter &painter, int32 knobY);
    void PaintReset(QPainter &painter);
    DIB *Highlighted(DIB *image, DIB *&cache, DIB *&source);
    QRect KnobUpdateRect(int32 x) const;

    bool mInteger = false;
    bool mSnapToStep = false;
    bool mRepeating = false;
    int32 mTimerId = 0;
    int32 mRepeatCount = 0;
    bool mDragKnob = false;
    bool mPageDown = false;
    bool mPageUp = false;
    bool mResetArmed = false;
    float64 mGrabOffset = 0.0;
    int32 mLastX = 0;
    bool mMoved = false;
    bool mFirstChange = false;
    float64 mStepDown[3] = {1.0, 1.0, 1.0};
    float64 mStepUp[3] = {1.0, 1.0, 1.0};
    bool mFineKey = false;
    bool mCoarseKey = false;
    float64 mPressValue = 0.0;
    int32 mLastKnobX = -1;
    bool mHoverKnob = false;
    bool mHoverTrack = false;
    bool mHoverReset = false;
    // Track pixels, two-segment switch, scale anchor and the custom
    // mappings. Its range is copied from the value fields at each use, so
    // that no setter of the base (SetExponent) can leave it behind.
    mutable SliderMapping mMapping;
    Gradient *mGradient = nullptr;
    Gradient *mGradient2 = nullptr;
    int32 mColorSpace = 0;
    int32 mColorSpace2 = 0;
    int32 mTickCount = 0;

    // Painting caches: the track with its ramp, rebuilt when its key
    // changes, and the highlighted knob and marker.
    struct TrackKey
    {
        int32 width = -1;
        qreal ratio = 0.0;
        const DIB *image = nullptr;
        const Gradient *gradients[2] = {};
        uint32 serials[2] = {};
        int32 spaces[2] = {};
        int32 from = 0, to = 0, centre = 0;
        bool twoSegment = false;
        bool operator==(const TrackKey &o) const;
    };
    DIB *mTrack = nullptr;
    TrackKey mTrackKey;
    DIB *mLitKnob = nullptr;
    DIB *mLitKnobSource = nullptr;
    DIB *mLitReset = nullptr;
    DIB *mLitResetSource = nullptr;
};

} // namespace Orbane
