#pragma once

#include "framework/LabelledInputControl.h"

#include "orbane/OrbID.h"

namespace Orbane {

class CustomButton;

// Shows an Input as a push button that performs the tool's action when
// pressed: it asks the document to render (unless every Input is passive),
// to update scripting, and runs the script of BTNCS_Execute with the globals
// `tool` (the Operator), `self` (this control) and `modifiers` (the click's
// Qt::KeyboardModifiers word) in view. The press writes no value: an action
// has nothing to undo.
class ButtonControl : public LabelledInputControl
{
    Q_OBJECT
public:
    ButtonControl(const Registry *reg, const ScriptVal &args, const TagList &tags);
    ~ButtonControl() override;

    std::size_t SizeOf() const override { return sizeof(ButtonControl); }

    using InputControl::SetAttrsTagList;
    bool SetAttrsTagList(Input *input, const TagList &tags) override;
    bool Open(QWidget *host, const QRect &rect, const TagList *tags) override;

    // The press: `value` is the button's 1.0; the rest as for SetInputs.
    virtual bool Press(Parameter *value, float64 time, uint32 flags, bool quiet, const TagList *tags);

    const char *GetScriptText() const { return mScriptText.c_str(); }

protected:
    // The button shows the label text and the disabled state, the label
    // widget the second text.
    void ShowTexts() override;

private slots:
    void OnButtonPressed();
    void RememberModifiers(uint64 modifiers);

private:
    bool RunScript();
    std::string ChunkName() const;

    CustomButton *mButton;
    OrbID mScriptText;
    uint64 mModifiers = 0; // of the click being handled
};

} // namespace Orbane
