#include "orbane/OrbaneEvent.h"

#include <QtTest>

using namespace Orbane;

namespace {

// Answers every notification with the sum of its parameters and the id.
class Receiver : public QObject
{
public:
    int calls = 0;
    uint32 lastId = 0;

protected:
    void customEvent(QEvent *event) override
    {
        if (event->type() != OrbaneEvent::EventType())
            return;
        auto *e = static_cast<OrbaneEvent *>(event);
        ++calls;
        lastId = e->ID();
        e->SetResult(e->Param1() + e->Param2() + e->ID());
        e->SetHandled();
    }
};

} // namespace

class OrbaneEventTest : public QObject
{
    Q_OBJECT
private slots:
    // Send delivers at once and returns the receiver's result; Post delivers
    // with the event loop. Without a target neither does anything.
    void sendAndPost()
    {
        Receiver r;
        QCOMPARE(OrbaneEvent::Send(&r, 100, 20, 3), 123u);
        QVERIFY(OrbaneEvent::Post(&r, 5, 1, 2));
        QCOMPARE(r.calls, 1);
        QCoreApplication::sendPostedEvents(&r);
        QCOMPARE(r.calls, 2);
        QCOMPARE(r.lastId, 5u);
        QCOMPARE(OrbaneEvent::Send(nullptr, 5, 1, 1), 0u);
        QVERIFY(!OrbaneEvent::Post(nullptr, 5));
    }
};

QTEST_GUILESS_MAIN(OrbaneEventTest)
#include "OrbaneEventTest.moc"
