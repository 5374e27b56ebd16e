#include "inputcontrols/LevelsBase.h"

#include "framework/InputLink.h"
#include "inputcontrols/DisconnectWrite.h"

#include "orbane/AutoParam.h"
#include "orbane/ElideLabel.h"
#include "orbane/Input.h"
#include "orbane/TimeCodeEdit.h"

#include <cmath>

namespace Orbane {

namespace {

constexpr int32 kPlaces = 3;
constexpr float64 kTolerance = 0.5e-6;

} // namespace

LevelsBase::LevelsBase(const Registry *reg, const ScriptVal &args, const TagList &tags, std::vector<End> ends,
                       const char *barName)
    : LabelledInputControl(reg, args, tags), mEnds(std::move(ends)), mBar(new LevelsBar(this)), mGesture(*this)
{
    mBar->setObjectName(barName);
    RegisterChild(barName, mBar);
    connect(mBar, SIGNAL(Moved(int, double)), this, SLOT(OnMoved(int, double)));
    connect(mBar, SIGNAL(Released()), this, SLOT(OnReleased()));
    connect(mBar, SIGNAL(ResetAsked(int)), this, SLOT(OnReset(int)));
    for (End &end : mEnds) {
        end.edit = new TimeCodeEdit(this);
        end.edit->setObjectName(end.name);
        connect(end.edit, SIGNAL(editingFinished()), this, SLOT(OnTyped()));
        RegisterChild(end.name, end.edit);
    }
    Label()->setFocusProxy(mBar);
}

LevelsBase::~LevelsBase() = default;

std::vector<float64> LevelsBase::Values() const
{
    std::vector<float64> values;
    for (const End &end : mEnds)
        values.push_back(end.value);
    return values;
}

std::vector<LevelsBar::Handle> LevelsBase::Handles(const std::vector<float64> &values) const
{
    std::vector<LevelsBar::Handle> handles;
    for (float64 v : values)
        handles.push_back({std::clamp(v, 0.0, 1.0), QColor(200, 200, 200)});
    return handles;
}

void LevelsBase::HandleMoved(int32 handle, float64 x, std::vector<float64> &values) const
{
    values[std::size_t(handle)] = x;
}

void LevelsBase::Link(const TagList &tags)
{
    for (End &end : mEnds)
        if (end.link && LinkInput(*this, tags, end.link, end.input))
            if (const AutoNumber now(end.input, GetCurrentTime()); now)
                end.value = now->Value;
}

bool LevelsBase::SetAttrsTagList(Input *input, const TagList &tags)
{
    Link(tags);
    if (IsOpen())
        ShowValues();
    return LabelledInputControl::SetAttrsTagList(input, tags);
}

bool LevelsBase::AddInput(Input *input, const TagList *tags)
{
    const bool first = IsFirstInput(input);
    if (!LabelledInputControl::AddInput(input, tags))
        return false;
    if (!first)
        return true;
    mEnds[0].input = input;
    if (const AutoNumber now(input, GetCurrentTime()); now)
        mEnds[0].value = now->Value;
    Link(input->GetAttrs());
    return true;
}

bool LevelsBase::OpenLevels(QWidget *host, const QRect &rect, const TagList *tags, const char *layoutItem)
{
    if (!LabelledInputControl::Open(host, rect, tags))
        return false;
    ShowValues();
    PlaceChildren(ClassLayout(layoutItem), false);
    return true;
}

bool LevelsBase::NotifyChanged(Input *input, Parameter *value, const TagList *tags)
{
    const auto *number = dynamic_cast<const Number *>(value);
    if (!number)
        return LabelledInputControl::NotifyChanged(input, value, tags);
    for (End &end : mEnds)
        if (end.input && end.input == input) {
            if (!HasValueChanged(false, number->Value, end.value, kTolerance))
                return true;
            end.value = number->Value;
        }
    return LabelledInputControl::NotifyChanged(input, value, tags);
}

bool LevelsBase::UpdateDisplay(Input *input, const TagList *tags)
{
    if (IsOpen())
        ShowValues();
    return LabelledInputControl::UpdateDisplay(input, tags);
}

void LevelsBase::ShowValues()
{
    for (End &end : mEnds) {
        end.edit->setEnabled(end.input != nullptr);
        // What the user is typing stays until it is applied.
        if (!end.edit->isModified())
            end.edit->SetValue(end.value, kPlaces);
    }
    mBar->SetHandles(Handles(Values()));
}

// Only the ends that change are written; an end without an Input keeps
// its value.
void LevelsBase::Write(std::vector<float64> values, int32 moved)
{
    Constrain(values, moved);
    const OrbString name = InputGesture::StepName(*this);
    for (std::size_t i = 0; i < mEnds.size(); ++i)
        if (mEnds[i].input && HasValueChanged(false, values[i], mEnds[i].value, kTolerance))
            mGesture.Write(mEnds[i].input, AutoNumber(values[i]), name);
    ShowValues();
}

void LevelsBase::OnMoved(int handle, double x)
{
    std::vector<float64> values = Values();
    HandleMoved(handle, x, values);
    Write(values, handle);
}

void LevelsBase::OnReleased()
{
    mGesture.End();
}

void LevelsBase::OnReset(int handle)
{
    std::vector<float64> values = Values();
    values[std::size_t(handle)] = mEnds[std::size_t(handle)].defaultValue;
    Write(values, handle);
    mGesture.End();
}

void LevelsBase::OnTyped()
{
    for (std::size_t i = 0; i < mEnds.size(); ++i) {
        TimeCodeEdit *edit = mEnds[i].edit;
        if (sender() != edit || !edit->isModified())
            continue;
        edit->setModified(false);
        bool ok = false;
        const float64 typed = edit->GetValue(&ok);
        std::vector<float64> values = Values();
        if (ok && std::isfinite(typed)) {
            values[i] = typed;
            Write(values, int32(i));
        }
        mGesture.End();
        ShowValues();
    }
}

bool LevelsBase::OnDisconnect(Input *input, const TagList *tags)
{
    for (End &end : mEnds)
        if (end.input && end.input == input)
            WriteOnDisconnect(input, end.value);
    const bool done = LabelledInputControl::OnDisconnect(input, tags);
    for (std::size_t i = 1; i < mEnds.size(); ++i)
        if (mEnds[i].input == input)
            mEnds[i].input = nullptr;
    return done;
}

} // namespace Orbane
