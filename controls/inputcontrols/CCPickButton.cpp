#include "inputcontrols/CCPickButton.h"

#include "orbane/OrbaneEvent.h"

#include <QApplication>
#include <QMouseEvent>

namespace Orbane {

CCPickButton::CCPickButton(QWidget *parent) : CustomButton(parent), mPickCursor(Qt::CrossCursor) {}

CCPickButton::~CCPickButton() = default;

void CCPickButton::PickStarted() {}

void CCPickButton::PickFinished(QWidget *target, const QPoint &pos)
{
    if (target)
        emit Picked(target, pos);
}

void CCPickButton::mousePressEvent(QMouseEvent *event)
{
    if (mPickEnabled && event->button() == Qt::LeftButton) {
        if (mPickCursor.shape() != Qt::ArrowCursor)
            setCursor(mPickCursor);
        mPicking = true;
        PickStarted();
    }
    CustomButton::mousePressEvent(event);
}

QWidget *CCPickButton::TargetAt(const QPoint &global) const
{
    QWidget *target = QApplication::widgetAt(global);
    // Only widgets in one of the application's own windows take a pick.
    if (!target || !QApplication::topLevelWidgets().contains(target->window()))
        return nullptr;
    return target;
}

void CCPickButton::mouseReleaseEvent(QMouseEvent *event)
{
    if (mPickEnabled && mPicking && event->button() == Qt::LeftButton) {
        unsetCursor();
        mPicking = false;
        QWidget *target = parentWidget() ? TargetAt(mapToGlobal(event->pos())) : nullptr;
        QPoint local;
        if (target) {
            local = target->mapFromGlobal(mapToGlobal(event->pos()));
            OrbaneEvent::Post(target, kPickEvent, 0, PackPoint(local));
        }
        PickFinished(target, local);
    }
    CustomButton::mouseReleaseEvent(event);
}

} // namespace Orbane
