#pragma once

#include "framework/InputGesture.h"
#include "framework/LabelledInputControl.h"
#include "inputcontrols/RangeLimits.h"

#include "orbane/OrbString.h"

namespace Orbane {

class RangeTrack;
class TimeCodeEdit;

// A range of two Number Inputs: the low end is the Input the control stands
// on, the high end a further Input given by RNGCP_HighInput. The ends are
// typed in two edit boxes ("low", "high") or dragged on the track ("span"):
// a knob moves its end, the bar between them both. Every edit keeps the
// limits (RangeLimits): inside the allowed range, on the step, and the low
// end never above the high one. A range that arrives inverted from
// elsewhere is shown as it is, in red, until the user moves it.
class RangeControl : public LabelledInputControl
{
    Q_OBJECT
public:
    RangeControl(const Registry *reg, const ScriptVal &args, const TagList &tags);
    ~RangeControl() override;

    std::size_t SizeOf() const override { return sizeof(RangeControl); }

    using InputControl::SetAttrsTagList;
    bool SetAttrsTagList(Input *input, const TagList &tags) override;
    bool AddInput(Input *input, const TagList *tags) override;
    bool Open(QWidget *host, const QRect &rect, const TagList *tags) override;
    bool NotifyChanged(Input *input, Parameter *value, const TagList *tags) override;
    bool UpdateDisplay(Input *input, const TagList *tags) override;
    bool OnDisconnect(Input *input, const TagList *tags) override;

private slots:
    void OnTrackMoved(float64 low, float64 high, int part);
    void OnTrackReleased();
    void OnReset();
    void OnLowTyped();
    void OnHighTyped();

private:
    void AddAttrRows();
    void ReadOwnTags(const TagList &tags);
    void LinkHigh(const TagList &tags);
    void Write(float64 low, float64 high, RangeLimits::End moved);
    void Typed(TimeCodeEdit *edit, RangeLimits::End end);
    void ShowValues();
    OrbString UndoName(RangeLimits::End moved) const;

    RangeLimits mLimits;
    float64 mScaleLow = 0.0;
    float64 mScaleHigh = 1.0;
    float64 mDefaultLow = 0.0;
    float64 mDefaultHigh = 1.0;
    int32 mPlaces = 3;
    bool mInteger = false;
    bool mPush = false;
    int32 mTicks = 0;
    OrbString mLowName;
    OrbString mHighName;
    float64 mLow = 0.0;
    float64 mHigh = 1.0;
    Input *mHighInput = nullptr;
    InputGesture mGesture;
    TimeCodeEdit *mLowEdit;
    TimeCodeEdit *mHighEdit;
    RangeTrack *mTrack;
};

} // namespace Orbane
