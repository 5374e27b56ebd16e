#pragma once

#include "framework/InputGesture.h"
#include "framework/LabelledInputControl.h"

namespace Orbane {

class CurveGraph;
class TimeCodeEdit;

// A gamma value (its Number Input) with its transfer curve, out = in ^
// (1 / gamma), drawn in a graph ("graph"). The value is typed ("edit") or
// set by dragging the handle over the input 0.5 up and down (Ctrl finer).
// The gamma stays within 0.01 .. 10; each gesture is one undo step.
class GammaControl : public LabelledInputControl
{
    Q_OBJECT
public:
    static constexpr float64 kMinGamma = 0.01;
    static constexpr float64 kMaxGamma = 10.0;

    GammaControl(const Registry *reg, const ScriptVal &args, const TagList &tags);
    ~GammaControl() override;

    std::size_t SizeOf() const override { return sizeof(GammaControl); }

    bool AddInput(Input *input, const TagList *tags) override;
    bool Open(QWidget *host, const QRect &rect, const TagList *tags) override;
    bool NotifyChanged(Input *input, Parameter *value, const TagList *tags) override;
    bool UpdateDisplay(Input *input, const TagList *tags) override;
    bool OnDisconnect(Input *input, const TagList *tags) override;

    static float64 Tidy(float64 gamma);

private slots:
    void OnEdited();
    void OnReleased();
    void OnTyped();

private:
    void Show();
    void Write(float64 gamma);

    float64 mGamma = 1.0;
    InputGesture mGesture;
    TimeCodeEdit *mEdit;
    CurveGraph *mGraph;
};

} // namespace Orbane
