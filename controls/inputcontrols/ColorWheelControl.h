#pragma once

#include "framework/InputGesture.h"
#include "framework/LabelledInputControl.h"

#include "orbane/OrbPointT.h"

class QLabel;

namespace Orbane {

class CustomController;
class CustomSlider;
class HueWheel;

// A grading wheel (lift, gamma, gain or offset): a hue and saturation disc
// whose puck is the Point Input the control stands on, and a master slider
// of a further Number Input (CWCP_MasterInput) whose range and default
// follow the wheel's role. Children: "wheel" (drag the puck, Ctrl finer,
// Shift along hue or saturation; a double click puts it back in the
// centre), "master" and "readout" (the puck as hue and saturation). Each
// drag, reset or master change is one undo step.
class ColorWheelControl : public LabelledInputControl
{
    Q_OBJECT
public:
    ColorWheelControl(const Registry *reg, const ScriptVal &args, const TagList &tags);
    ~ColorWheelControl() override;

    std::size_t SizeOf() const override { return sizeof(ColorWheelControl); }

    using InputControl::SetAttrsTagList;
    bool SetAttrsTagList(Input *input, const TagList &tags) override;
    bool AddInput(Input *input, const TagList *tags) override;
    bool Open(QWidget *host, const QRect &rect, const TagList *tags) override;
    bool NotifyChanged(Input *input, Parameter *value, const TagList *tags) override;
    bool UpdateDisplay(Input *input, const TagList *tags) override;
    bool OnDisconnect(Input *input, const TagList *tags) override;

    // The master's scale and default of each role.
    struct RoleRange
    {
        float64 low, high, neutral;
    };
    static RoleRange RangeOf(int32 role);

private slots:
    void OnPuckMoved(float64 x, float64 y);
    void OnWheelReleased();
    void OnReset();
    void OnMasterChanged(float64 value);
    void OnMasterReleased(CustomController *slider);

private:
    void ReadOwnTags(const TagList &tags);
    void ReadValues();
    void ShowValue();

    OrbPoint mPuck{0.0, 0.0};
    float64 mMaster = 0.0;
    int32 mRole = 0;
    float64 mRim = 1.0;
    Input *mMasterInput = nullptr;
    InputGesture mGesture;
    HueWheel *mWheel;
    CustomSlider *mMasterSlider;
    QLabel *mReadout;
};

} // namespace Orbane
