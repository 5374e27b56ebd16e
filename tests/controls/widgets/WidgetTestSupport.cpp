#include "WidgetTestSupport.h"

#include <QApplication>

namespace Orbane {

void SendMouse(QWidget *widget, QEvent::Type type, const QPoint &pos, Qt::MouseButton button, Qt::MouseButtons buttons,
               Qt::KeyboardModifiers modifiers)
{
    QMouseEvent event(type, pos, widget->mapToGlobal(pos), button, buttons, modifiers);
    QApplication::sendEvent(widget, &event);
}

void MoveMouse(QWidget *widget, const QPoint &pos, Qt::KeyboardModifiers modifiers, Qt::MouseButtons buttons)
{
    SendMouse(widget, QEvent::MouseMove, pos, Qt::NoButton, buttons, modifiers);
}

} // namespace Orbane
