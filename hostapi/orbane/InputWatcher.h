#pragma once

namespace Orbane {

class Input;
class Parameter;
class TagList;

// Something that shows an Input's value: inspector and viewer controls.
// Attached with Input::AttachWatcher, told of every change of the value at
// the document's current time.
class InputWatcher
{
public:
    // `value` is the Input's value at the current time, borrowed for the call
    // (IncRef it to keep it); `tags` are those the writer passed, or null.
    virtual void OnInputChanged(Input *in, Parameter *value, const TagList *tags) = 0;

protected:
    InputWatcher() = default;
    InputWatcher(const InputWatcher &) = default;
    InputWatcher &operator=(const InputWatcher &) = default;
    virtual ~InputWatcher() = default;
};

} // namespace Orbane
