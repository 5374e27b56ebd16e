#pragma once

#include "orbane/InputControl.h"
#include "orbane/LabelTexts.h"
#include "orbane/OrbID.h"

namespace Orbane {

class CustomButton;
class ElideLabel;

// Shows an Input as a push button that performs the tool's action when
// pressed: it asks the document to render (unless every Input is passive),
// to update scripting, and runs the script of BTNCS_Execute with the globals
// `tool` (the Operator), `self` (this control) and `modifiers` (the click's
// Qt::KeyboardModifiers word) in view. The press writes no value: an action
// has nothing to undo.
class ButtonControl : public InputControl
{
    Q_OBJECT
public:
    ButtonControl(const Registry *reg, const ScriptVal &args, const TagList &tags);
    ~ButtonControl() override;

    std::size_t SizeOf() const override { return sizeof(ButtonControl); }
    bool GetAttrsTagList(TagList &tags) const override;

    using InputControl::SetAttrsTagList;
    bool SetAttrsTagList(Input *input, const TagList &tags) override;
    bool AddInput(Input *input, const TagList *tags) override;
    bool Open(QWidget *host, const QRect &rect, const TagList *tags) override;
    bool UpdateDisplay(Input *input, const TagList *tags) override;

    // The press: `value` is the button's 1.0; the rest as for SetInputs.
    virtual bool Press(Parameter *value, float64 time, uint32 flags, bool quiet, const TagList *tags);

    const char *GetScriptText() const { return mScriptText.c_str(); }

private slots:
    void OnButtonPressed();
    void RememberModifiers(uint64 modifiers);

private:
    void ShowTexts();
    bool RunScript();
    std::string ChunkName() const;

    ElideLabel *mLabel;
    CustomButton *mButton;
    OrbID mScriptText;
    LabelTexts mTexts;
    uint64 mModifiers = 0; // of the click being handled
};

} // namespace Orbane
