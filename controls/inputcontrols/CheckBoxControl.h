#pragma once

#include "framework/LabelledInputControl.h"

namespace Orbane {

class OrbCheckBox;

// Shows an integer Input as a check box with a label, optionally with a
// third, mixed state (CBC_TriState), stored in the Input as -1. The label
// may wrap onto several lines (Input attribute 0x10050001); the control then
// grows in height with its text.
class CheckBoxControl : public LabelledInputControl
{
    Q_OBJECT
public:
    // Input attribute: let the label wrap.
    static constexpr Tag CBA_AllowWrap = 0x10050001;
    // The room of the box itself, left of a wrapping label.
    static constexpr int32 kBoxRoom = 25;

    CheckBoxControl(const Registry *reg, const ScriptVal &args, const TagList &tags);
    ~CheckBoxControl() override;

    std::size_t SizeOf() const override { return sizeof(CheckBoxControl); }

    using InputControl::SetAttrsTagList;
    bool SetAttrsTagList(Input *input, const TagList &tags) override;
    bool Open(QWidget *host, const QRect &rect, const TagList *tags) override;
    bool SetSize(int32 &width, int32 &height, const TagList *tags) override;
    bool NotifyChanged(Input *input, Parameter *value, const TagList *tags) override;
    bool UpdateDisplay(Input *input, const TagList *tags) override;
    bool OnDisconnect(Input *input, const TagList *tags) override;

protected:
    // The box shows the label text, the label widget the second text.
    void ShowTexts() override;

private slots:
    void OnCheckChanged(int32 state, uint64 modifiers);

private:
    bool WrapsLabel() const;
    int32 WrappedRowHeight() const;

    int32 mValue = 0; // -1: the mixed state
    bool mTriState = false;
    OrbCheckBox *mCheckBox;
    int32 mRowHeight = 0;
};

} // namespace Orbane
