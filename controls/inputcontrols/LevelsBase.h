#pragma once

#include "framework/InputGesture.h"
#include "framework/LabelledInputControl.h"
#include "widgets/LevelsBar.h"

#include <vector>

namespace Orbane {

class TimeCodeEdit;

// The base of the levels controls: a few Number Inputs ("ends": the Input
// the control stands on, then Inputs linked by object tags), each with an
// edit box named after it, and handles on a LevelsBar ("histogram" or
// "ramp"). A drag of a handle, a typed value or a double click (the end's
// default) writes the ends that changed as one undo step. The derived
// class places the handles and constrains the values.
class LevelsBase : public LabelledInputControl
{
    Q_OBJECT
public:
    struct End
    {
        const char *name; // the edit box's child name
        Tag link;         // the object tag that links its Input; 0: the control's own
        float64 value;    // shown; the default until an Input says otherwise
        float64 defaultValue;
        Input *input = nullptr;
        TimeCodeEdit *edit = nullptr;
    };

    LevelsBase(const Registry *reg, const ScriptVal &args, const TagList &tags, std::vector<End> ends,
               const char *barName);
    ~LevelsBase() override;

    using InputControl::SetAttrsTagList;
    bool SetAttrsTagList(Input *input, const TagList &tags) override;
    bool AddInput(Input *input, const TagList *tags) override;
    bool NotifyChanged(Input *input, Parameter *value, const TagList *tags) override;
    bool UpdateDisplay(Input *input, const TagList *tags) override;
    bool OnDisconnect(Input *input, const TagList *tags) override;

    float64 ValueOf(int32 end) const { return mEnds[std::size_t(end)].value; }

protected:
    // The handles for the values; by default one per end at its value.
    virtual std::vector<LevelsBar::Handle> Handles(const std::vector<float64> &values) const;
    // The values when handle `handle` is asked to be at `x`; by default the
    // end of the same index takes x.
    virtual void HandleMoved(int32 handle, float64 x, std::vector<float64> &values) const;
    // Keeps the values sensible after end `moved` changed.
    virtual void Constrain(std::vector<float64> &values, int32 moved) const = 0;

    LevelsBar *Bar() const { return mBar; }
    std::vector<float64> Values() const;
    void ShowValues();
    // Opens as the levels controls do: texts, children, layout.
    bool OpenLevels(QWidget *host, const QRect &rect, const TagList *tags, const char *layoutItem);

private slots:
    void OnMoved(int handle, double x);
    void OnReleased();
    void OnReset(int handle);
    void OnTyped();

private:
    void Link(const TagList &tags);
    void Write(std::vector<float64> values, int32 moved);

    std::vector<End> mEnds;
    LevelsBar *mBar;
    InputGesture mGesture;
};

} // namespace Orbane
