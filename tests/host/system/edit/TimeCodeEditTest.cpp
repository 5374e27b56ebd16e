#include "orbane/TimeCodeEdit.h"

#include <QApplication>
#include <QtTest>

using namespace Orbane;

namespace {

void Move(QWidget *w, int x, Qt::KeyboardModifiers mods = Qt::NoModifier)
{
    const QPoint pos(x, w->height() / 2);
    QMouseEvent e(QEvent::MouseMove, pos, w->mapToGlobal(pos), Qt::NoButton, Qt::LeftButton, mods);
    QApplication::sendEvent(w, &e);
}

// A shown, active edit, so that focus and key events behave as on screen.
struct ShownEdit
{
    QWidget window;
    TimeCodeEdit *edit = new TimeCodeEdit(&window);
    QLineEdit *other = new QLineEdit(&window);
    ShownEdit()
    {
        edit->setGeometry(0, 0, 120, 22);
        other->setGeometry(0, 30, 120, 22);
        window.resize(130, 60);
        window.show();
        QApplication::setActiveWindow(&window);
        other->setFocus();
    }
};

} // namespace

class TimeCodeEditTest : public QObject
{
    Q_OBJECT
private slots:
    // Numbers to `decimals` places (-1: up to six); with a frame rate, time
    // codes that read back as the same frame. The plain cases are shown and
    // typed through the slider (SliderControlTest); here the edges.
    void format_data()
    {
        QTest::addColumn<double>("value");
        QTest::addColumn<int>("decimals");
        QTest::addColumn<bool>("integer");
        QTest::addColumn<double>("fps");
        QTest::addColumn<QString>("text");
        QTest::newRow("no places") << 2.5 << 0 << false << 0.0 << "3";
        QTest::newRow("automatic trims zeros") << 1.25 << -1 << false << 0.0 << "1.25";
        QTest::newRow("automatic six places") << 1.0 / 3 << -1 << false << 0.0 << "0.333333";
        QTest::newRow("negative zero") << -0.001 << 2 << false << 0.0 << "0.00";
        QTest::newRow("integer rounds half up") << 2.5 << 3 << true << 0.0 << "3";
        QTest::newRow("integer negative half") << -2.5 << -1 << true << 0.0 << "-2";
        QTest::newRow("an hour") << 90000.0 << 0 << false << 25.0 << "01:00:00:00";
        QTest::newRow("fraction of a frame") << 12.5 << 1 << false << 24.0 << "00:00:00:12.5";
        QTest::newRow("negative time") << -30.0 << 0 << false << 30.0 << "-00:00:01:00";
    }

    void format()
    {
        QFETCH(double, value);
        QFETCH(int, decimals);
        QFETCH(bool, integer);
        QFETCH(double, fps);
        QFETCH(QString, text);
        const bool time = fps > 0.0;
        QCOMPARE(time ? TimeCodeEdit::FormatTime(value, fps, decimals)
                      : TimeCodeEdit::FormatNumber(value, decimals, integer),
                 text);
        double back = 0.0;
        QVERIFY(!time || (TimeCodeEdit::ParseTime(text, fps, &back) && back == value));
    }

    void typedValues_data()
    {
        QTest::addColumn<QString>("typed");
        QTest::addColumn<bool>("time");
        QTest::addColumn<bool>("ok");
        QTest::addColumn<double>("value");
        QTest::addColumn<QString>("expression");
        QTest::newRow("arithmetic") << "2*3+1" << false << true << 7.0 << "";
        QTest::newRow("garbage keeps last value") << "abc" << false << false << 4.0 << "";
        QTest::newRow("division by zero is no number") << "1/0" << false << false << 4.0 << "";
        QTest::newRow("frames in time display") << "30" << true << true << 30.0 << "";
        QTest::newRow("time code with letters") << "00:aa:00" << true << false << 4.0 << "";
        QTest::newRow("too many time fields") << "1:2:3:4:5" << true << false << 4.0 << "";
        QTest::newRow("negative time field") << "00:-1:00" << true << false << 4.0 << "";
        QTest::newRow("expression trimmed") << " = time * 2 " << false << false << 4.0 << "time * 2";
    }

    void typedValues()
    {
        QFETCH(QString, typed);
        QFETCH(bool, time);
        QFETCH(bool, ok);
        QFETCH(double, value);
        QFETCH(QString, expression);
        ShownEdit shown;
        shown.edit->SetTimeType(time);
        shown.edit->SetValue(4.0);
        shown.edit->setFocus();
        shown.edit->selectAll();
        QTest::keyClicks(shown.edit, typed);
        QCOMPARE(shown.edit->text(), typed);
        bool good = !ok;
        QVERIFY(qAbs(shown.edit->GetValue(&good) - value) < 1e-12);
        QCOMPARE(good, ok);
        QCOMPARE(shown.edit->IsExpression(), !expression.isEmpty());
        QCOMPARE(QString(shown.edit->GetExpression().c_str()), expression);
    }

    void digitSteps_data()
    {
        QTest::addColumn<QString>("start");
        QTest::addColumn<int>("cursor");
        QTest::addColumn<int>("key");
        QTest::addColumn<QString>("after");
        QTest::addColumn<int>("cursorAfter");
        QTest::newRow("units up") << "12.34" << 1 << int(Qt::Key_Up) << "13.34" << 1;
        QTest::newRow("tens down") << "12.34" << 0 << int(Qt::Key_Down) << "2.34" << 0;
        QTest::newRow("carry into a new digit") << "99" << 0 << int(Qt::Key_Up) << "109" << 1;
        QTest::newRow("tenths through zero") << "0.05" << 2 << int(Qt::Key_Down) << "-0.05" << 3;
    }

    void digitSteps()
    {
        QFETCH(QString, start);
        QFETCH(int, cursor);
        QFETCH(int, key);
        QFETCH(QString, after);
        QFETCH(int, cursorAfter);
        ShownEdit shown;
        QSignalSpy changed(shown.edit, SIGNAL(digitChanged(TimeCodeEdit *)));
        shown.edit->setText(start);
        shown.edit->setFocus();
        shown.edit->setCursorPosition(cursor);
        QTest::keyClick(shown.edit, Qt::Key(key));
        QCOMPARE(shown.edit->text(), after);
        QCOMPARE(shown.edit->cursorPosition(), cursorAfter);
        QCOMPARE(changed.count(), 1);
        QCOMPARE(changed.at(0).at(0).value<TimeCodeEdit *>(), shown.edit);
    }

    // Past a threshold a press on a virtual edit drags: each move reports the
    // distance from the press, Ctrl moves a tenth and Shift ten times as far, and
    // a distance set back mid-drag is the base of the next move.
    void virtualDrag()
    {
        ShownEdit shown;
        TimeCodeEdit *edit = shown.edit;
        edit->SetVirtual(true);
        QSignalSpy start(edit, SIGNAL(StartDrag(TimeCodeEdit *)));
        QSignalSpy drag(edit, SIGNAL(Drag(float64, TimeCodeEdit *)));
        QSignalSpy end(edit, SIGNAL(EndDrag(TimeCodeEdit *)));
        QTest::mousePress(edit, Qt::LeftButton, Qt::NoModifier, QPoint(50, 10));
        Move(edit, 51); // inside the threshold: still a click
        QCOMPARE(start.count(), 0);
        Move(edit, 60);
        Move(edit, 55);
        QVERIFY(edit->IsDragging());
        Move(edit, 65, Qt::ControlModifier);
        Move(edit, 66, Qt::ShiftModifier);
        QCOMPARE(edit->GetDragDistance(), 16.0);
        edit->SetDragDistance(12.0);
        Move(edit, 61);
        QTest::mouseRelease(edit, Qt::LeftButton, Qt::NoModifier, QPoint(61, 10));
        QCOMPARE(start.count(), 1);
        QCOMPARE(end.count(), 1);
        QList<double> distances;
        for (const QList<QVariant> &args : drag)
            distances << args.at(0).toDouble();
        QCOMPARE(distances, QList<double>({10.0, 5.0, 6.0, 16.0, 7.0}));
        QCOMPARE(drag.at(1).at(1).value<TimeCodeEdit *>(), edit);
        QVERIFY(!edit->hasFocus());
        QVERIFY(!edit->IsDragging());
    }
};

QTEST_MAIN(TimeCodeEditTest)
#include "TimeCodeEditTest.moc"
