#pragma once

#include "orbane/InputControl.h"
#include "orbane/OrbaneDoc.h"
#include "orbane/ScriptVal.h"
#include "orbane/TagList.h"

#include <QMouseEvent>
#include <QPoint>
#include <QVariant>

namespace Orbane {

// An input control that owns painted widgets in the tests: it counts what
// the widgets ask of it and, when given a document, reports Inputs that are
// not passive so that drags reach the document.
class TestOwner : public InputControl
{
public:
    TestOwner() : InputControl(nullptr, ScriptVal(), TagList()) {}

    bool UpdateDisplay(Input *, const TagList *) override
    {
        ++updateDisplays;
        return true;
    }
    void ResetUndo(const TagList *) override { ++resetUndos; }
    QColor GetBackgroundColor() const override { return background; }
    OrbaneDoc *GetDoc() const override { return doc; }
    bool AllInputsPassive() const override { return doc == nullptr; }

    int updateDisplays = 0;
    int resetUndos = 0;
    QColor background = QColor(51, 102, 153);
    OrbaneDoc *doc = nullptr;
};

// Mouse events with modifiers and held buttons, which QTest::mouseMove
// cannot send.
void SendMouse(QWidget *widget, QEvent::Type type, const QPoint &pos, Qt::MouseButton button, Qt::MouseButtons buttons,
               Qt::KeyboardModifiers modifiers = Qt::NoModifier);
// A pointer argument of a spied signal as it was emitted. QVariant's own
// conversion would treat it as a QObject pointer, which a class whose first
// base is the host Object is not at the same address.
template <class T> T *PointerArg(const QVariant &arg)
{
    return *static_cast<T *const *>(arg.constData());
}

void MoveMouse(QWidget *widget, const QPoint &pos, Qt::KeyboardModifiers modifiers = Qt::NoModifier,
               Qt::MouseButtons buttons = Qt::LeftButton);

} // namespace Orbane
