#pragma once

#include "framework/LabelledInputControl.h"

namespace Orbane {

class ThumbWheel;
class TimeCodeEdit;

// A number Input without bounds, turned with a thumbwheel ("wheel"): each
// step of the wheel changes the value by SCRD_Step; a drag or a notch of
// the mouse wheel is one undo step. The edit box ("edit") shows the value
// and takes typed numbers and expressions.
class ScrewControl : public LabelledInputControl
{
    Q_OBJECT
public:
    static constexpr float64 kDefaultStep = 0.01;
    // Values closer than this are the same: no redisplay.
    static constexpr float64 kSameValue = 1e-9;

    ScrewControl(const Registry *reg, const ScriptVal &args, const TagList &tags);
    ~ScrewControl() override;

    std::size_t SizeOf() const override { return sizeof(ScrewControl); }

    using InputControl::SetAttrsTagList;
    bool SetAttrsTagList(Input *input, const TagList &tags) override;
    bool Open(QWidget *host, const QRect &rect, const TagList *tags) override;
    bool NotifyChanged(Input *input, Parameter *value, const TagList *tags) override;
    bool UpdateDisplay(Input *input, const TagList *tags) override;
    bool OnDisconnect(Input *input, const TagList *tags) override;

private slots:
    void OnTurn(float64 steps);
    void OnTurnEnded();
    void OnTyped();

private:
    void Write(float64 value);

    float64 mValue = 0.0;
    float64 mStep = kDefaultStep;
    ThumbWheel *mWheel;
    TimeCodeEdit *mEdit;
};

} // namespace Orbane
