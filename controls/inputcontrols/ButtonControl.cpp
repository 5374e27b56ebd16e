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
    : LabelledInputControl(reg, args, tags), mButton(new CustomButton(this)),
      mScriptText(tags.GetString(BTNCS_Execute, ""))
{
    mFlags |= CF_ActionOnly;
    ListAttr(BTNCS_Execute, &mScriptText);
    ShowDisabledWithTexts();
    mButton->setObjectName("button");
    // The click's modifiers reach the press through the first connection.
    connect(mButton, SIGNAL(ButtonPressed(uint64, bool)), this, SLOT(RememberModifiers(uint64)));
    connect(mButton, SIGNAL(ButtonPressed(uint64, bool)), this, SLOT(OnButtonPressed()));
    RegisterChild("button", mButton);
}

ButtonControl::~ButtonControl() = default;

bool ButtonControl::Open(QWidget *host, const QRect &rect, const TagList *tags)
{
    if (!LabelledInputControl::Open(host, rect, tags))
        return false;
    mButton->SetFont(GetControlFont());
    mButton->SetBackgroundColor(ToOrbColor(GetBackgroundColor()));
    ShowChild(mButton);
    mButton->update();
    LoadLayout("Controls.Button.Layout");
    return true;
}

void ButtonControl::ShowTexts()
{
    mButton->setEnabled(!IsDisabled());
    mButton->SetLabel(GetLabelTexts().label);
    Label()->setText(QString::fromStdString(GetLabelTexts().second.str()));
    Label()->setVisible(!GetLabelTexts().second.IsEmpty());
}

bool ButtonControl::SetAttrsTagList(Input *input, const TagList &tags)
{
    mScriptText = OrbID(tags.GetString(BTNCS_Execute, mScriptText.c_str()));
    return LabelledInputControl::SetAttrsTagList(input, tags);
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
    qWarning("Button \"%s\" of tool \"%s\": %s", GetLabelTexts().label.c_str(), tool ? tool->GetName() : "?",
             error.c_str());
    return false;
}

} // namespace Orbane
