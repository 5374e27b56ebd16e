#include "inputcontrols/HistogramControl.h"

#include "inputcontrols/DisconnectWrite.h"
#include "inputcontrols/HistogramChoice.h"
#include "widgets/LevelsBar.h"

#include "orbane/AutoParam.h"
#include "orbane/ElideLabel.h"
#include "orbane/Input.h"

#include <QComboBox>
#include <QPushButton>

#include <cmath>

namespace Orbane {

namespace {

constexpr const char *kLayoutItem = "Controls.Histogram.Layout";
constexpr int32 kChoices = 5;

int32 ChoiceOf(float64 value)
{
    return std::isfinite(value) ? std::clamp(int32(std::floor(value + 0.5)), 0, kChoices - 1) : 0;
}

} // namespace

HistogramControl::HistogramControl(const Registry *reg, const ScriptVal &args, const TagList &tags)
    : LabelledInputControl(reg, args, tags), mBar(new LevelsBar(this)), mHistogram(new HistogramChoice(this, mBar))
{
    mBar->setObjectName("histogram");
    RegisterChild("histogram", mBar);
    RegisterChild("channel", mHistogram->Channels());
    RegisterChild("scale", mHistogram->Scale());
    connect(mHistogram->Channels(), SIGNAL(activated(int)), this, SLOT(OnChannelChosen(int)));
    Label()->setFocusProxy(mHistogram->Channels());
    ClassLayout(kLayoutItem);
}

HistogramControl::~HistogramControl() = default;

bool HistogramControl::AddInput(Input *input, const TagList *tags)
{
    const bool first = IsFirstInput(input);
    if (!LabelledInputControl::AddInput(input, tags))
        return false;
    if (const AutoNumber now(input, GetCurrentTime()); first && now)
        mChoice = ChoiceOf(now->Value);
    return true;
}

bool HistogramControl::Open(QWidget *host, const QRect &rect, const TagList *tags)
{
    if (!LabelledInputControl::Open(host, rect, tags))
        return false;
    mHistogram->SetChoice(mChoice);
    PlaceChildren(ClassLayout(kLayoutItem), false);
    mHistogram->Start();
    return true;
}

bool HistogramControl::NotifyChanged(Input *input, Parameter *value, const TagList *tags)
{
    const auto *number = dynamic_cast<const Number *>(value);
    if (value && (!number || ChoiceOf(number->Value) == mChoice))
        return true;
    if (number)
        mChoice = ChoiceOf(number->Value);
    return LabelledInputControl::NotifyChanged(input, value, tags);
}

bool HistogramControl::UpdateDisplay(Input *input, const TagList *tags)
{
    if (IsOpen() && mHistogram->Channels()->currentIndex() != mChoice)
        mHistogram->SetChoice(mChoice);
    return LabelledInputControl::UpdateDisplay(input, tags);
}

void HistogramControl::OnChannelChosen(int index)
{
    if (index == mChoice)
        return;
    mChoice = index;
    SetInputs(AutoNumber(float64(index)), GetCurrentTime(), 0, false, nullptr);
    ResetUndo(nullptr);
}

bool HistogramControl::OnDisconnect(Input *input, const TagList *tags)
{
    WriteOnDisconnect(input, float64(mChoice));
    return LabelledInputControl::OnDisconnect(input, tags);
}

} // namespace Orbane
