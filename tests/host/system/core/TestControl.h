#pragma once

#include "orbane/InputControl.h"
#include "orbane/ScriptVal.h"
#include "orbane/TagList.h"

#include <QLabel>

namespace Orbane {
namespace Test {

// The smallest real input control: a label and a value text placed by the
// look pack's default layout, with an expression field. It counts the calls
// the base makes into it.
class TestControl : public InputControl
{
public:
    TestControl() : InputControl(nullptr, ScriptVal(), TagList()), label(new QLabel(this)), value(new QLabel(this))
    {
        label->setText("label");
        value->setText("0.000");
        RegisterChild("label", label);
        RegisterChild("value", value);
    }

    bool Open(QWidget *host, const QRect &rect, const TagList *tags) override
    {
        if (!InputControl::Open(host, rect, tags))
            return false;
        LoadLayout("Controls.Default.Layout");
        if (Layout::LayoutObj *where = FindLayoutObj("expression"); where && where->AsContainer())
            CreateExpressionEdit(where->AsContainer(), 0);
        return true;
    }
    bool NotifyChanged(Input *input, Parameter *param, const TagList *tags) override
    {
        ++notifies;
        return InputControl::NotifyChanged(input, param, tags);
    }
    bool UpdateDisplay(Input *input, const TagList *tags) override
    {
        ++displays;
        return InputControl::UpdateDisplay(input, tags);
    }

    QLabel *label;
    QLabel *value;
    int notifies = 0;
    int displays = 0;
};

} // namespace Test
} // namespace Orbane
