#include "TestControl.h"
#include "ToolFixture.h"

#include "orbane/AutoParam.h"
#include "orbane/Input.h"
#include "orbane/Operator.h"

#include <QLineEdit>
#include <QMenu>
#include <QUndoStack>
#include <QtTest>

using namespace Orbane;
using namespace Orbane::Test;

namespace {

TestControl *Bound(ToolFixture &f, const std::vector<Input *> &inputs)
{
    return static_cast<TestControl *>(f.Bind(new TestControl, inputs));
}

bool Write(InputControl *c, float64 value, bool quiet = false)
{
    const AutoNumber number(value);
    return c->SetInputs(number, c->GetCurrentTime(), 0, quiet, nullptr);
}

QAction *FindAction(QMenu &menu, const QString &text)
{
    for (QAction *a : menu.actions())
        if (a->text() == text)
            return a;
    return nullptr;
}

} // namespace

class InputControlTest : public QObject
{
    Q_OBJECT
private slots:
    void bindsUntilDisconnect()
    {
        ToolFixture f;
        Input *in = f.AddNumber("Gain", 1.0);
        const int32 before = in->RefCount();
        TestControl *gone = Bound(f, {in});
        TestControl *stays = Bound(f, {in});
        QVERIFY(!gone->AddInput(in, nullptr));
        QCOMPARE(in->RefCount(), before + 2);
        QVERIFY(gone->OnDisconnect(in, nullptr));
        QVERIFY(!gone->OnDisconnect(in, nullptr));
        QCOMPARE(in->RefCount(), before + 1);
        QCOMPARE(in->Watchers(), std::vector<InputWatcher *>{stays});
        gone->notifies = 0;
        QVERIFY(Write(stays, 3.0));
        QCOMPARE(gone->notifies, 0);
        QVERIFY(!Write(gone, 4.0));
    }

    void destructorLetsInputsGo()
    {
        ToolFixture f;
        Input *a = f.AddNumber("A", 0.0);
        Input *b = f.AddNumber("B", 0.0);
        auto *c = new TestControl;
        c->AddInput(a, nullptr);
        c->AddInput(b, nullptr);
        // A gesture left open must not keep the document waiting.
        QVERIFY(Write(c, 3.0));
        QCOMPARE(f.doc.UndoDepth(), 1);
        // The undo step keeps a reference of its own; the control's goes.
        const int32 bound = b->RefCount();
        c->DecRef();
        QCOMPARE(f.doc.UndoDepth(), 0);
        QCOMPARE(b->RefCount(), bound - 1);
        QCOMPARE(f.doc.UndoNames(), QStringList{"Change A"});
        QVERIFY(a->Watchers().empty());
        QVERIFY(b->Watchers().empty());
        f.doc.UndoStack()->clear();
        QCOMPARE(a->RefCount(), 1);
    }

    void writesEveryBoundInputAtCurrentTime()
    {
        ToolFixture f;
        Input *plain = f.AddNumber("Plain", 0.0);
        Input *keyed = f.AddNumber("Keyed", 0.0);
        keyed->SetAnimated(true);
        f.doc.SetCurrentTime(12.0);
        TestControl *c = Bound(f, {plain, keyed});
        QCOMPARE(c->GetCurrentTime(), 12.0);
        QVERIFY(Write(c, 5.0));
        c->ResetUndo(nullptr);
        QCOMPARE(f.NumberOf(plain), 5.0);
        QCOMPARE(f.NumberOf(keyed), 5.0);
        const std::vector<float64> keys = keyed->KeyTimes();
        QVERIFY(std::find(keys.begin(), keys.end(), 12.0) != keys.end());
        QCOMPARE(f.doc.UndoNames().size(), 1);
        // A locked tool takes no writes and opens no gesture.
        f.tool->SetLocked(true);
        QVERIFY(!Write(c, 4.0));
        QVERIFY(!c->IsUndoOpen());
        QCOMPARE(f.NumberOf(plain), 5.0);
        QCOMPARE(f.doc.UndoNames().size(), 1);
    }

    void gestureIsOneUndoStep_data()
    {
        QTest::addColumn<QString>("undoName");
        QTest::addColumn<int>("writes");
        QTest::addColumn<QString>("stepName");
        QTest::newRow("a drag") << QString() << 25 << "Change Gain";
        QTest::newRow("named by SetUndo") << "Boost Gain" << 3 << "Boost Gain";
    }

    void gestureIsOneUndoStep()
    {
        QFETCH(QString, undoName);
        QFETCH(int, writes);
        QFETCH(QString, stepName);
        ToolFixture f;
        Input *in = f.AddNumber("Gain", 0.5);
        TestControl *c = Bound(f, {in});
        if (!undoName.isNull())
            c->SetUndo(undoName.toUtf8().constData(), nullptr);
        for (int i = 1; i <= writes; ++i)
            QVERIFY(Write(c, float64(i)));
        QCOMPARE(f.doc.UndoDepth(), 1);
        c->ResetUndo(nullptr);
        QCOMPARE(f.doc.UndoNames(), QStringList{stepName});
        QVERIFY(f.doc.Undo());
        QCOMPARE(f.NumberOf(in), 0.5);
        QVERIFY(f.doc.Redo());
        QCOMPARE(f.NumberOf(in), float64(writes));
        // SetUndo names one gesture only.
        QVERIFY(Write(c, 100.0));
        c->ResetUndo(nullptr);
        QCOMPARE(f.doc.UndoNames().last(), QString("Change Gain"));
    }

    void writeNotifiesBoundControls_data()
    {
        QTest::addColumn<bool>("quiet");
        QTest::addColumn<int>("writerNotifies");
        QTest::newRow("plain write") << false << 1;
        QTest::newRow("quiet write") << true << 0;
    }

    void writeNotifiesBoundControls()
    {
        QFETCH(bool, quiet);
        QFETCH(int, writerNotifies);
        ToolFixture f;
        Input *in = f.AddNumber("Gain", 0.0);
        TestControl *writer = Bound(f, {in});
        TestControl *other = Bound(f, {in});
        writer->notifies = other->notifies = 0;
        other->displays = 0;
        QVERIFY(Write(writer, 2.0, quiet));
        QCOMPARE(writer->notifies, writerNotifies);
        QCOMPARE(other->notifies, 1);
        QCOMPARE(other->displays, 1);
        // An equal value stores nothing and tells nobody.
        QVERIFY(Write(writer, 2.0, quiet));
        QCOMPARE(other->notifies, 1);
    }

    void expressionField()
    {
        ToolFixture f;
        Input *in = f.AddNumber("Gain", 1.0);
        TestControl *c = Bound(f, {in});
        QLineEdit *edit = c->GetExpressionEdit(0);
        QVERIFY(edit && edit->isHidden());
        const int32 plainHeight = c->height();
        QMenu menu;
        c->AddToMenu(&menu);
        QAction *action = FindAction(menu, "Expression");
        QVERIFY(action && !action->isChecked());
        action->trigger();
        QVERIFY(!edit->isHidden());
        QVERIFY(c->height() > plainHeight);
        QVERIFY(c->GetExpressionRect(0).top() >= c->label->geometry().bottom());
        QMenu again;
        c->AddToMenu(&again);
        QVERIFY(FindAction(again, "Expression")->isChecked());
        // Escape puts back the expression in use.
        QVERIFY(c->ExpressionChanged(0, "2"));
        edit->setText("value * 100");
        QTest::keyClick(edit, Qt::Key_Escape);
        QCOMPARE(edit->text(), QString("2"));
        QCOMPARE(f.NumberOf(in), 2.0);
        // The menu again, or an empty expression, removes it and hides the field.
        FindAction(again, "Expression")->trigger();
        QVERIFY(edit->isHidden());
        QVERIFY(c->GetExpressionData(0).IsEmpty());
        QCOMPARE(c->height(), plainHeight);
        action->trigger();
        QVERIFY(c->ExpressionChanged(0, ""));
        QVERIFY(edit->isHidden());
    }

    void expressionWrites_data()
    {
        QTest::addColumn<QString>("text");
        QTest::addColumn<bool>("ok");
        QTest::addColumn<double>("result");
        QTest::newRow("the value") << "value * 2 + 1" << true << 7.0;
        QTest::newRow("the time") << "time + 1" << true << 9.0;
        QTest::newRow("does not parse") << "2 +" << false << 3.0;
        QTest::newRow("unknown name") << "gain * 2" << false << 3.0;
    }

    void expressionWrites()
    {
        QFETCH(QString, text);
        QFETCH(bool, ok);
        QFETCH(double, result);
        ToolFixture f;
        f.doc.SetCurrentTime(8.0);
        Input *in = f.AddNumber("Gain", 3.0);
        TestControl *c = Bound(f, {in});
        QVERIFY(c->AddExpressionEdit(0, nullptr));
        QLineEdit *edit = c->GetExpressionEdit(0);
        QTest::keyClicks(edit, text);
        QTest::keyClick(edit, Qt::Key_Return);
        QCOMPARE(f.NumberOf(in), result);
        QCOMPARE(QString(c->GetExpressionData(0).c_str()), ok ? text : QString());
        QCOMPARE(f.doc.UndoNames(), ok ? QStringList{"Change Gain"} : QStringList());
        QCOMPARE(edit->toolTip().isEmpty(), ok);
    }
};

QTEST_MAIN(InputControlTest)
#include "InputControlTest.moc"
