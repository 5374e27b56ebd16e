#pragma once

#include "orbane/Object.h"

#include <QWidget>

namespace Orbane {

// The two roots of every inspector control, in this order: the host Object
// first, so that the script-visible root sits at the start of the object (the
// exported uncast functions rely on it), then QWidget. This class has no
// Q_OBJECT of its own; moc sees it as a QWidget subclass through its second base.
class _InputControl : public Object, public QWidget
{
public:
    _InputControl(const Registry *reg, const ScriptVal &args, const TagList &tags);
    ~_InputControl() override;
};

// The host base of every inspector control: an Input shown and edited in a
// tool's inspector.
class InputControl : public _InputControl
{
    Q_OBJECT
public:
    InputControl(const Registry *reg, const ScriptVal &args, const TagList &tags);
    ~InputControl() override;

    std::size_t SizeOf() const override { return sizeof(InputControl); }

    static const OrbID ClassID;
};

} // namespace Orbane
