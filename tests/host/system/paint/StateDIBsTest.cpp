#include "orbane/StateDIBs.h"
#include "orbane/DIB.h"

#include <QtTest>

using namespace Orbane;

class StateDIBsTest : public QObject
{
    Q_OBJECT
private slots:
    void storesUses();
    void outOfRangeIgnored();
    void fromResource_data();
    void fromResource();
};

void StateDIBsTest::storesUses()
{
    DIB *a = new DIB(2, 2), *b = new DIB(3, 3);
    {
        StateDIBs states;
        states.SetState(0, a);
        states.SetState(2, b);
        QCOMPARE(a->UseCount(), 2);
        QCOMPARE(states.GetState(0), a);
        QCOMPARE(states.GetState(1), nullptr);
        QCOMPARE(states.Count(), 3);
        states.SetState(0, b);
        QCOMPARE(a->UseCount(), 1);
        QCOMPARE(b->UseCount(), 3);
    }
    QCOMPARE(b->UseCount(), 1);
    a->Recycle();
    b->Recycle();
}

void StateDIBsTest::outOfRangeIgnored()
{
    DIB *a = new DIB(2, 2);
    StateDIBs states;
    states.SetState(-1, a);
    states.SetState(StateDIBs::MaxStates, a);
    QCOMPARE(a->UseCount(), 1);
    QCOMPARE(states.Count(), 0);
    QCOMPARE(states.GetState(StateDIBs::MaxStates), nullptr);
    a->Recycle();
}

void StateDIBsTest::fromResource_data()
{
    QTest::addColumn<QByteArray>("base");
    QTest::addColumn<int>("count");
    QTest::newRow("slider knob pair") << QByteArray("Controls.Slider.Knob") << 2;
    QTest::newRow("colour knob pair") << QByteArray("Controls.Color.Knob.3") << 2;
    QTest::newRow("unknown") << QByteArray("Controls.NoSuchKnob") << 0;
}

void StateDIBsTest::fromResource()
{
    QFETCH(QByteArray, base);
    QFETCH(int, count);
    StateDIBs *states = StateDIBs::FromResource(base.constData(), 2.0);
    QCOMPARE(states ? states->Count() : 0, count);
    if (states) {
        QCOMPARE(states->GetState(0)->PixelRatio(), 2.0);
        QCOMPARE(states->GetState(0)->UseCount(), 1);
    }
    delete states;
}

QTEST_MAIN(StateDIBsTest)
#include "StateDIBsTest.moc"
