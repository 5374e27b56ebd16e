#include "inputcontrols/ButtonControl.h"

#include "framework/ButtonTags.h"
#include "inputcontrols/ButtonScript.h"

#include "orbane/AutoParam.h"
#include "orbane/CustomButton.h"
#include "orbane/ElideLabel.h"
#include "orbane/Operator.h"
#include "orbane/OrbaneDoc.h"

#include <QtGlobal>

namespace Orbane {

namespace {

OrbColor ToOrbColor(const QColor &c)
{
    return OrbColor(uint8(c.red()), uint8(c.green()), uint8(c.blue()), uint8(c.alpha()));
}

} // namespace

ButtonControl::ButtonControl(const Registry *reg, const ScriptVal &args, const TagList &tags)
    : InputControl(reg, args, tags), mLabel(new ElideLabel(this)), mButton(new CustomButton(this)),
      mScriptText(tags.GetString(BTNCS_Execute, ""))
{
    mFlags |= CF_ActionOnly;
    mLabel->setObjectName("label");
    mButton->setObjectName("button");
    // The click's modifiers reach the press through the first connection.
    connect(mButton, SIGNAL(ButtonPressed(uint64, bool)), this, SLOT(RememberModifiers(uint64)));
    connect(mButton, SIGNAL(ButtonPressed(uint64, bool)), this, SLOT(OnButtonPressed()));
    RegisterChild("label", mLabel);
    RegisterChild("button", mButton);
}

ButtonControl::~ButtonControl() = default;

bool ButtonControl::GetAttrsTagList(TagList &tags) const
{
    InputControl::GetAttrsTagList(tags);
    mTexts.AddTo(tags);
    tags.Set(BTNCS_Execute, mScriptText.c_str());
    return true;
}

bool ButtonControl::AddInput(Input *input, const TagList *tags)
{
    if (!InputControl::AddInput(input, tags))
        return false;
    mTexts.Read(input);
    return true;
}

bool ButtonControl::Open(QWidget *host, const QRect &rect, const TagList *tags)
{
    if (!InputControl::Open(host, rect, tags))
        return false;
    mButton->SetFont(GetControlFont());
    mButton->SetBackgroundColor(ToOrbColor(GetBackgroundColor()));
    mButton->show();
    mButton->setEnabled(!IsDisabled());
    mLabel->setElideMode(ElideLabel::Elide_Right);
    ShowTexts();
    mButton->update();
    mTexts.changed = false;
    LoadLayout("Controls.Button.Layout");
    return true;
}

void ButtonControl::ShowTexts()
{
    mButton->SetLabel(mTexts.label);
    mLabel->setText(QString::fromStdString(mTexts.second.str()));
    mLabel->setVisible(!mTexts.second.IsEmpty());
}

bool ButtonControl::SetAttrsTagList(Input *input, const TagList &tags)
{
    const bool wasDisabled = IsDisabled();
    InputControl::SetAttrsTagList(input, tags);
    mTexts.Take(tags);
    mScriptText = OrbID(tags.GetString(BTNCS_Execute, mScriptText.c_str()));
    if (IsDisabled() != wasDisabled)
        mTexts.changed = true;
    if (mTexts.changed)
        NotifyChanged(nullptr, nullptr, nullptr);
    return true;
}

bool ButtonControl::UpdateDisplay(Input *input, const TagList *tags)
{
    if (IsOpen() && mTexts.changed) {
        mButton->setEnabled(!IsDisabled());
        ShowTexts();
        mTexts.changed = false;
    }
    return InputControl::UpdateDisplay(input, tags);
}

void ButtonControl::RememberModifiers(uint64 modifiers)
{
    mModifiers = modifiers;
}

void ButtonControl::OnButtonPressed()
{
    const AutoNumber value(1.0);
    Press(value, GetCurrentTime(), 0, false, nullptr);
}

bool ButtonControl::Press(Parameter *, float64, uint32, bool, const TagList *)
{
    if (OrbaneDoc *doc = GetDoc()) {
        // Passive Inputs change nothing that shows in the image.
        if (!AllInputsPassive())
            doc->SyncRender();
        doc->UpdateScripting();
    }
    return mScriptText.IsEmpty() || RunScript();
}

std::string ButtonControl::ChunkName() const
{
    const Input *in = GetCurrentInput();
    const Operator *tool = in ? in->GetOperator() : nullptr;
    return std::string(tool ? tool->GetName() : "?") + "." + (in ? in->GetID().c_str() : "Button");
}

bool ButtonControl::RunScript()
{
    const Input *in = GetCurrentInput();
    Operator *tool = in ? in->GetOperator() : nullptr;
    // The script may unbind or remove the tool: keep it alive for the run.
    const AutoRef<Operator> keep = AutoRef<Operator>::Share(tool);
    std::string error;
    const ButtonScript script(mScriptText.c_str(), ChunkName());
    if (script.Run(GetDoc(), tool, this, mModifiers, &error))
        return true;
    qWarning("Button \"%s\" of tool \"%s\": %s", mTexts.label.c_str(), tool ? tool->GetName() : "?", error.c_str());
    return false;
}

} // namespace Orbane
