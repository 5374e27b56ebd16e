#include "orbane/FallbackControl.h"

#include "orbane/AutoParam.h"
#include "orbane/Input.h"
#include "orbane/ParameterScript.h"
#include "orbane/ScriptVal.h"

#include <QHBoxLayout>
#include <QLabel>

namespace Orbane {

namespace {

QString Show(const ScriptVal &v)
{
    if (v.IsNumber())
        return QString::number(v.GetNumber(), 'g', 10);
    if (v.IsString())
        return QString::fromUtf8(v.GetString());
    if (!v.IsTable())
        return QString::fromUtf8(v.TypeName());
    QStringList parts;
    for (const auto &entry : v.GetEntries())
        parts << Show(entry.second);
    return "(" + parts.join(", ") + ")";
}

} // namespace

FallbackControl::FallbackControl(const Registry *reg, const ScriptVal &args, const TagList &tags)
    : InputControl(reg, args, tags), mLabel(new QLabel(this)), mValue(new QLabel(this))
{
    auto *row = new QHBoxLayout(this);
    row->setContentsMargins(4, 2, 4, 2);
    row->addWidget(mLabel, 1);
    row->addWidget(mValue, 2);
    mValue->setTextInteractionFlags(Qt::TextSelectableByMouse);
}

FallbackControl::~FallbackControl() = default;

bool FallbackControl::AddInput(Input *input, const TagList *tags)
{
    if (!InputControl::AddInput(input, tags))
        return false;
    mLabel->setText(QString::fromUtf8(LabelOf(input).c_str()));
    mValue->setText(ValueText());
    return true;
}

bool FallbackControl::SetSize(int32 &width, int32 &height, const TagList *tags)
{
    height = qMax(sizeHint().height(), 20);
    return InputControl::SetSize(width, height, tags);
}

bool FallbackControl::NotifyChanged(Input *input, Parameter *value, const TagList *tags)
{
    mValue->setText(ValueText());
    return InputControl::NotifyChanged(input, value, tags);
}

QString FallbackControl::ValueText() const
{
    Input *input = GetCurrentInput();
    if (!input)
        return QString();
    AutoParameter value(input->GetValue(GetCurrentTime()));
    return Show(ParameterScript::ToScript(value.get()));
}

} // namespace Orbane
