#include "inputcontrols/OrbCheckBox.h"

namespace Orbane {

OrbCheckBox::OrbCheckBox(QWidget *parent) : CustomCheckBox(parent)
{
    setObjectName("checkbox");
    setFocusPolicy(Qt::StrongFocus);
}

OrbCheckBox::~OrbCheckBox() = default;

void OrbCheckBox::SetValue(int32 value)
{
    SetCheck(StateOf(value));
}

} // namespace Orbane
