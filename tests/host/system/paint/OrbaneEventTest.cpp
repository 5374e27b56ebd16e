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
    void fields();
    void sendReturnsResult();
    void postArrivesLater();
    void noTarget();
};

void OrbaneEventTest::fields()
{
    OrbaneEvent e(42, 7, 9);
    QVERIFY(e.type() >= QEvent::User);
    QCOMPARE(e.type(), OrbaneEvent::EventType());
    QCOMPARE(e.ID(), 42u);
    QCOMPARE(e.Param1(), 7u);
    QCOMPARE(e.Param2(), 9u);
    QVERIFY(!e.IsHandled());
    e.SetHandled();
    QCOMPARE(e.Flags(), 4u); // bit 2
    QVERIFY(e.IsHandled());
}

void OrbaneEventTest::sendReturnsResult()
{
    Receiver r;
    QCOMPARE(OrbaneEvent::Send(&r, 100, 20, 3), 123u);
    QCOMPARE(r.calls, 1);
}

void OrbaneEventTest::postArrivesLater()
{
    Receiver r;
    QVERIFY(OrbaneEvent::Post(&r, 5, 1, 2));
    QCOMPARE(r.calls, 0);
    QCoreApplication::sendPostedEvents(&r);
    QCOMPARE(r.calls, 1);
    QCOMPARE(r.lastId, 5u);
}

void OrbaneEventTest::noTarget()
{
    QVERIFY(!OrbaneEvent::Post(nullptr, 5));
    QCOMPARE(OrbaneEvent::Send(nullptr, 5, 1, 1), 0u);
}

QTEST_GUILESS_MAIN(OrbaneEventTest)
#include "OrbaneEventTest.moc"
