#include "orbane/OrbaneEvent.h"

#include <QCoreApplication>

namespace Orbane {

OrbaneEvent::OrbaneEvent(uint32 id, uint64 param1, uint64 param2, uint32 flags)
    : QEvent(EventType()), mID(id), mParam1(param1), mParam2(param2), mFlags(flags)
{
}

OrbaneEvent::~OrbaneEvent() = default;

QEvent::Type OrbaneEvent::EventType()
{
    static const QEvent::Type type = QEvent::Type(QEvent::registerEventType());
    return type;
}

bool OrbaneEvent::Post(QObject *target, uint32 id, uint64 param1, uint64 param2)
{
    if (!target)
        return false;
    QCoreApplication::postEvent(target, new OrbaneEvent(id, param1, param2));
    return true;
}

uint64 OrbaneEvent::Send(QObject *target, uint32 id, uint64 param1, uint64 param2)
{
    if (!target)
        return 0;
    OrbaneEvent event(id, param1, param2);
    QCoreApplication::sendEvent(target, &event);
    return event.Result();
}

} // namespace Orbane
