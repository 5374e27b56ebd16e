#pragma once

#include "orbane/OrbString.h"
#include "orbane/OrbaneDoc.h"

#include <QPointer>

namespace Orbane {

class Input;
class InputControl;
class Parameter;

// One user gesture of a control that writes several Inputs, each its own
// value (a range's two ends, a clip's file and frames): the base's SetInputs
// writes one value to every bound Input, so such a control writes each
// Input here instead. The first write opens the gesture's undo step in the
// Inputs' document and End closes it, so a drag or a choice that touches
// three Inputs is still one step.
class InputGesture
{
public:
    explicit InputGesture(const InputControl &owner) : mOwner(owner) {}
    ~InputGesture() { End(); }
    InputGesture(const InputGesture &) = delete;
    InputGesture &operator=(const InputGesture &) = delete;

    // Writes `value` to `input` at the owner's current time, opening the
    // step named `name` where none is open. Refused while the tool is locked.
    bool Write(Input *input, Parameter *value, const OrbString &name);
    // Closes the step; a gesture that changed nothing leaves none.
    void End();
    bool IsOpen() const { return !mDoc.isNull(); }

    // The name the base gives a gesture of `control`: "Change <label>".
    static OrbString StepName(const InputControl &control);

private:
    const InputControl &mOwner;
    QPointer<OrbaneDoc> mDoc;
};

} // namespace Orbane
