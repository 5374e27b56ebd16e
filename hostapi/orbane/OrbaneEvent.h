#pragma once

#include "orbane/Types.h"

#include <QEvent>

class QObject;

namespace Orbane {

// A host notification delivered through Qt's event queue: an id, two
// parameters, a flags word and a result that the receiver fills in.
class OrbaneEvent : public QEvent
{
public:
    // Set by the receiver that dealt with the notification.
    static constexpr uint32 FLAG_Handled = 1u << 2;

    OrbaneEvent(uint32 id, uint64 param1 = 0, uint64 param2 = 0, uint32 flags = 0);
    ~OrbaneEvent() override;

    // The Qt event type shared by every OrbaneEvent, registered once.
    static QEvent::Type EventType();

    uint32 ID() const noexcept { return mID; }
    uint64 Param1() const noexcept { return mParam1; }
    uint64 Param2() const noexcept { return mParam2; }
    uint32 Flags() const noexcept { return mFlags; }
    void SetFlags(uint32 flags) noexcept { mFlags = flags; }
    bool IsHandled() const noexcept { return (mFlags & FLAG_Handled) != 0; }
    void SetHandled() noexcept { mFlags |= FLAG_Handled; }
    uint64 Result() const noexcept { return mResult; }
    void SetResult(uint64 result) noexcept { mResult = result; }

    // Queues a notification for `target`; false where there is no target.
    static bool Post(QObject *target, uint32 id, uint64 param1 = 0, uint64 param2 = 0);
    // Delivers a notification at once and returns the receiver's result;
    // 0 where there is no target or nobody handled it.
    static uint64 Send(QObject *target, uint32 id, uint64 param1 = 0, uint64 param2 = 0);

private:
    uint32 mID;
    uint64 mParam1;
    uint64 mParam2;
    uint32 mFlags;
    uint64 mResult = 0;
};

} // namespace Orbane
