#pragma once

#include "orbane/CustomCheckBox.h"

namespace Orbane {

// The check box of CheckBoxControl: the host's painted check box that also
// knows how the control's integer value maps to its states. The value -1
// stands for the mixed state (state 2); any other non-zero value is checked.
class OrbCheckBox : public CustomCheckBox
{
    Q_OBJECT
public:
    explicit OrbCheckBox(QWidget *parent = nullptr);
    ~OrbCheckBox() override;

    // Shows a control value without emitting anything.
    void SetValue(int32 value);

    // The state that shows `value`, and the value a state stands for.
    static int32 StateOf(int32 value) noexcept { return value < 0 ? 2 : value == 0 ? 0 : 1; }
    static int32 ValueOf(int32 state) noexcept { return state == 2 ? -1 : state; }
};

} // namespace Orbane
