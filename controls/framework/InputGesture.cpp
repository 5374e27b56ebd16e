#include "framework/InputGesture.h"

#include "orbane/Input.h"
#include "orbane/InputControl.h"

namespace Orbane {

bool InputGesture::Write(Input *input, Parameter *value, const OrbString &name)
{
    if (!input || !value || mOwner.IsLocked())
        return false;
    if (!mDoc) {
        mDoc = input->GetDoc();
        if (mDoc)
            mDoc->StartUndo(name.c_str());
    }
    return input->SetValue(value, mOwner.GetCurrentTime(), 0, nullptr);
}

OrbString InputGesture::StepName(const InputControl &control)
{
    return OrbString("Change " + InputControl::LabelOf(control.GetCurrentInput()).str());
}

void InputGesture::End()
{
    if (OrbaneDoc *doc = mDoc.data()) {
        mDoc = nullptr;
        doc->EndUndo(true);
    }
}

} // namespace Orbane
