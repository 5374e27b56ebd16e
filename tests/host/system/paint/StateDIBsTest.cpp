#include "orbane/StateDIBs.h"
#include "orbane/DIB.h"

#include <QtTest>

#include <memory>

using namespace Orbane;

class StateDIBsTest : public QObject
{
    Q_OBJECT
private slots:
    void storesUses()
    {
        DIB *a = new DIB(2, 2), *b = new DIB(3, 3);
        {
            StateDIBs states;
            states.SetState(0, a);
            states.SetState(2, b);
            states.SetState(-1, a);
            states.SetState(StateDIBs::MaxStates, a); // out of range: ignored
            QCOMPARE(a->UseCount(), 2);
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

    // Skins numbered from 1 after the base name, at the pixel ratio asked for.
    void fromResource()
    {
        for (const char *base : {"Controls.Slider.Knob", "Controls.Color.Knob.3"}) {
            std::unique_ptr<StateDIBs> states(StateDIBs::FromResource(base, 2.0));
            QVERIFY2(states && states->Count() == 2, base);
            const DIB *first = states->GetState(0);
            QCOMPARE(first->GetImage().width(), first->Width() * 2);
            QCOMPARE(first->UseCount(), 1);
        }
        QVERIFY(!StateDIBs::FromResource("Controls.NoSuchKnob", 2.0));
    }
};

QTEST_MAIN(StateDIBsTest)
#include "StateDIBsTest.moc"
