#pragma once

#include "framework/LabelledInputControl.h"

#include "orbane/OrbString.h"

#include <limits>

class QLabel;

namespace Orbane {

class CustomSlider;
class TimeCodeEdit;

// Shows a number Input as a label, an edit box and the painted number
// slider, with up to three captions under the slider. Values the user
// drags or types are rounded to the Input's decimal places before they are
// written; the control shows what the host notifies back, not what it wrote.
class SliderControl : public LabelledInputControl
{
    Q_OBJECT
public:
    // Input attributes the control reads; the script tags are in SliderTags.h.
    enum SliderAttr : Tag
    {
        SLA_InputIndex = 0x10030007,     // which value of a multi-value tool this Input is
        SLA_IntegerDisplay = 0x1003000c, // show and gate values as integers
        SLA_KnobStyle = 0x10030011,      // 6-9: the colour channel knobs
        SLA_StepCount = 0x10040003,      // normal steps across the soft range
        SLA_DecimalPlaces = 0x10040004,  // -1: as many as needed
        SLA_TimeDisplay = 0x10040006,    // frames shown as a time code, written unrounded
        SLA_SnapToStep = 0x10040007,     // with integer display, values snap to the normal step
        SLA_ReadAttrs = 0x10040008,      // false: leave the slider's own attributes alone
        SLA_ColorSpace = 0x10050003,     // colour space of the track ramp
        SLA_ColorSpace2 = 0x10050004,    // colour space of the right half's ramp
        SLA_MinAllowed = 0x20030000,
        SLA_MaxAllowed = 0x20030001,
        SLA_MinScale = 0x20030002,
        SLA_MaxScale = 0x20030003,
        SLA_Default = 0x20030004,
        SLA_Centre = 0x20040006,      // splits the track into two linear halves
        SLA_ForwardExpr = 0x30040003, // value -> track coordinate, over "value", "minscale", ...
        SLA_InverseExpr = 0x30040004, // track coordinate -> value
        SLA_Gradient = 0x40050000,    // colour ramp painted in the track
        SLA_Gradient2 = 0x40050001,   // ramp of the half right of the centre
        SLA_ForwardFunc = 0x60040001, // float64 (*)(float64, void *)
        SLA_InverseFunc = 0x60040002,
        SLA_ForwardData = 0x60040003,
        SLA_InverseData = 0x60040004,
    };
    // The allowed range of an Input that gives none.
    static constexpr float64 kDefaultMinAllowed = -1000000.0;
    static constexpr float64 kDefaultMaxAllowed = 1000000.0;
    // The step of automatic decimal places: finer than any shown digit.
    static constexpr float64 kAutoStep = 1e-7;
    static constexpr float64 kNoDefault = std::numeric_limits<float64>::max();

    SliderControl(const Registry *reg, const ScriptVal &args, const TagList &tags);
    ~SliderControl() override;

    std::size_t SizeOf() const override { return sizeof(SliderControl); }

    using InputControl::SetAttrsTagList;
    bool SetAttrsTagList(Input *input, const TagList &tags) override;
    bool AddInput(Input *input, const TagList *tags) override;
    bool Open(QWidget *host, const QRect &rect, const TagList *tags) override;
    bool NotifyChanged(Input *input, Parameter *value, const TagList *tags) override;
    bool UpdateDisplay(Input *input, const TagList *tags) override;
    bool OnDisconnect(Input *input, const TagList *tags) override;
    Input *GetInputFrom(const QWidget *child) const override;

    // The step values are rounded to: 1/10^places, or kAutoStep for -1.
    static float64 StepFor(int32 places);
    // The look-pack names of the knob pair a knob style uses.
    static const char *KnobImageName(int32 style, bool held);

    float64 GetCurrentValue() const noexcept { return mValue; }
    float64 GetStep() const noexcept { return mStep; }
    int32 GetDecimalPlaces() const noexcept { return mPlaces; }
    int32 GetInputIndex() const noexcept { return mInputIndex; }

protected:
    // The label and the captions under the track.
    void ShowTexts() override;

public slots:
    // Enter in the edit box, or the box losing focus: what was typed is applied.
    void OnOK() override;

private slots:
    void OnValueChanged(float64 value);
    void OnDigitEdit();
    void OnValueEdit();

private:
    void AddAttrRows();
    void ReadOwnAttrs(Input *input, const TagList &tags);
    void ReadRanges(const TagList &tags);
    void ReadCaptions(const TagList &tags);
    void ReadTrackLook(const TagList &tags);
    void PassToEdit();
    void PassToSlider();
    void ApplyKnobStyle();
    void ApplyEdit();
    // Rounds as the settings say and writes where it changed the Input.
    void WriteValue(float64 value);

    float64 mScaleLow = 0.0;
    float64 mScaleHigh = 1.0;
    float64 mAllowedLow = kDefaultMinAllowed;
    float64 mAllowedHigh = kDefaultMaxAllowed;
    float64 mValue = 0.0;
    float64 mDefault = kNoDefault;
    float64 mCentre = 0.0;
    bool mHasCentre = false;
    int32 mPlaces = -1;
    float64 mStep = kAutoStep;
    int32 mStepCount = 0;
    int32 mTickCount = 0;
    bool mTimeDisplay = false;
    bool mIntegerDisplay = false;
    bool mSnapToStep = false;
    bool mSliderDisabled = false;
    int32 mKnobStyle = 0;
    bool mKnobStyleChanged = false;
    bool mValueReceived = false;
    int32 mInputIndex = 0;
    OrbString mLowText;
    OrbString mMidText;
    OrbString mHighText;
    const QWidget *mPendingEdit = nullptr;

    TimeCodeEdit *mEdit;
    CustomSlider *mSlider;
    QLabel *mCaptions[3];
};

} // namespace Orbane
