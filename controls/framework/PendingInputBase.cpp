#include "framework/PendingInputBase.h"

#include "orbane/Registry.h"

#include <QHBoxLayout>
#include <QLabel>

namespace Orbane {

PendingInputBase::PendingInputBase(const Registry *reg, const ScriptVal &args, const TagList &tags)
    : InputControl(reg, args, tags), mLabel(new QLabel(reg ? reg->Name() : "", this))
{
    mLabel->setObjectName("label");
    mLabel->setTextInteractionFlags(Qt::NoTextInteraction);
    auto *layout = new QHBoxLayout(this);
    layout->setContentsMargins(0, 0, 0, 0);
    layout->addWidget(mLabel);
}

PendingInputBase::~PendingInputBase() = default;

} // namespace Orbane
