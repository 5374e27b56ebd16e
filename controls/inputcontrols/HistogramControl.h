#pragma once

#include "framework/LabelledInputControl.h"

namespace Orbane {

class HistogramChoice;
class LevelsBar;

// The viewed image's histogram ("histogram") of the channel chosen
// ("channel"), on a linear or log scale ("scale"). Its Number Input holds
// the channel: 0 luminance, 1 red, 2 green, 3 blue, 4 alpha; a choice is one
// undo step.
class HistogramControl : public LabelledInputControl
{
    Q_OBJECT
public:
    HistogramControl(const Registry *reg, const ScriptVal &args, const TagList &tags);
    ~HistogramControl() override;

    std::size_t SizeOf() const override { return sizeof(HistogramControl); }

    bool AddInput(Input *input, const TagList *tags) override;
    bool Open(QWidget *host, const QRect &rect, const TagList *tags) override;
    bool NotifyChanged(Input *input, Parameter *value, const TagList *tags) override;
    bool UpdateDisplay(Input *input, const TagList *tags) override;
    bool OnDisconnect(Input *input, const TagList *tags) override;

private slots:
    void OnChannelChosen(int channel);

private:
    int32 mChoice = 0; // the choice's place: luminance first
    LevelsBar *mBar;
    HistogramChoice *mHistogram;
};

} // namespace Orbane
