#pragma once

#include "widgets/CustomControl.h"

#include <limits>

namespace Orbane {

class DIB;
class StateDIBs;
class TimeCodeEdit;

// The value model of the painted value widgets (slider, screw): value,
// default, soft and hard limits, the knob and reset-marker images with their
// rectangles, and the vertical layout of the knob against the track. Edits
// reach the owning input control through the signals; the slots let an edit
// box act as a virtual slider.
class CustomController : public CustomControl
{
    Q_OBJECT
public:
    // A default of this value means there is none: no reset marker, no room for it.
    static constexpr float64 NoDefault = std::numeric_limits<float64>::max();

    CustomController(const Registry *reg, const ScriptVal &args, const TagList &tags);
    ~CustomController() override;

    std::size_t SizeOf() const override { return sizeof(CustomController); }

    virtual void SetDefault(float64 value, bool redraw);
    // State 0 of `first` is the knob, its state 1 the second knob; state 0 of
    // `second` the third knob and its state 1 the held knob.
    virtual void SetKnobImages(StateDIBs *first, StateDIBs *second);
    // `first` serves as knob, second and third knob; `second` as held knob.
    virtual void SetKnobImage(DIB *first, DIB *second);
    virtual void SetResetImage(DIB *image);
    // The last filter every value passes before it is stored.
    virtual float64 MapValue(float64 value);
    // Makes `edit` a virtual slider edit whose drags drive this widget.
    virtual void AttachEdit(TimeCodeEdit *edit);
    virtual void SetTrackRect(const OrbRectT<int32> &rect);
    // Takes effect at the next SetTrackRect; negative values lift the knob.
    virtual void SetKnobOffset(int32 offset);
    virtual void Redraw(bool full);

    // Filled by the slider and the screw; empty here.
    virtual void SetRange(float64 min, float64 max);
    virtual void SetScale(float64 min, float64 max, bool redraw);
    virtual void SetAllowedRange(float64 min, float64 max, bool redraw);
    virtual void SetTickCount(int32 count);
    virtual void SetCentre(float64 centre);
    // A change made by the program: stored and shown, no signal.
    virtual void SetValue(float64 value, bool redraw);
    // A change made by the user: stored through MapValue and signalled.
    virtual void SetSliderValue(float64 value);

    float64 GetValue() const noexcept { return mValue; }
    float64 GetDefault() const noexcept { return mDefault; }
    bool HasDefault() const noexcept { return mDefault != NoDefault; }
    float64 GetMinScale() const noexcept { return mMinScale; }
    float64 GetMaxScale() const noexcept { return mMaxScale; }
    float64 GetMinAllowed() const noexcept { return mMinAllowed; }
    float64 GetMaxAllowed() const noexcept { return mMaxAllowed; }
    float64 GetCentre() const noexcept { return mCentre; }
    float64 GetExponent() const noexcept { return mExponent; }
    void SetExponent(float64 exponent);
    DIB *GetKnobImage() const noexcept { return mKnobImage; }
    DIB *GetKnobImagePressed() const noexcept { return mKnobImagePressed; }
    DIB *GetResetImage() const noexcept { return mResetImage; }
    int32 GetKnobTop() const noexcept { return mKnobTop; }
    int32 GetResetTop() const noexcept { return mResetTop; }
    int32 GetResetHeight() const noexcept { return mResetHeight; }
    const OrbRectT<int32> &GetTrackRect() const noexcept { return mTrackRect; }
    const OrbRectT<int32> &GetKnobRect() const noexcept { return mKnobRect; }
    const OrbRectT<int32> &GetResetRect() const noexcept { return mResetRect; }

    // An image's rectangle about its centre x: (-w/2, 0, w - w/2, h), the
    // odd pixel right of centre; all zeros without an image.
    static OrbRectT<int32> ImageRect(const DIB *image);
    // Knob and reset-marker tops for a track of `trackHeight` rows.
    static void LayoutKnob(int32 trackHeight, int32 knobHeight, int32 resetHeight, int32 offset, int32 &knobTop,
                           int32 &resetTop);

signals:
    void ValueChanged(float64 value);
    // `first` is 1 for the first change of a gesture, 0 for the rest.
    void dragSlider(CustomController *slider, int first);
    void Pressed(CustomController *slider);
    void Released(CustomController *slider);

public slots:
    virtual void OnEditStartDrag(TimeCodeEdit *edit);
    virtual void OnEditEndDrag(TimeCodeEdit *edit);
    virtual void OnEditDrag(float64 dist, TimeCodeEdit *edit);

protected:
    // Stores `image` in `slot`, taking a use of it and recycling the old one.
    static void StoreImage(DIB *&slot, DIB *image);
    void KnobImagesChanged();

    float64 mValue = 0.0;
    float64 mDefault = NoDefault;
    float64 mLastRangeMin = -1.0e10;
    float64 mLastRangeMax = -1.0e10;
    float64 mMinAllowed = 0.0;
    float64 mMaxAllowed = 0.0;
    float64 mMinScale = 0.0;
    float64 mMaxScale = 0.0;
    float64 mSpare1 = 0.0;
    float64 mSpare2 = 0.0;
    float64 mCentre = 0.0;
    float64 mExponent = 1.0;
    DIB *mKnobImage = nullptr;
    DIB *mKnobImagePressed = nullptr;
    DIB *mResetImage = nullptr;
    DIB *mKnobImageSecond = nullptr;
    DIB *mKnobImageThird = nullptr;
    int32 mKnobTop = 0;
    int32 mResetTop = 0;
    int32 mResetHeight = 0;
    int32 mKnobOffset = 0;
    OrbRectT<int32> mTrackRect;
    OrbRectT<int32> mKnobRect;
    OrbRectT<int32> mResetRect;
};

} // namespace Orbane
