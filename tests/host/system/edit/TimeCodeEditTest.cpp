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
    void formatNumber_data();
    void formatNumber();
    void formatTime_data();
    void formatTime();
    void parseTimeRejects_data();
    void parseTimeRejects();
    void displayModes();
    void typedValues_data();
    void typedValues();
    void expressions();
    void digitSteps_data();
    void digitSteps();
    void returnFinishesEditing();
    void virtualDrag();
    void dragModifiersScale();
    void dragDistanceCanBeSetBack();
    void clickStartsTyping();
    void notVirtualSelectsText();
};

void TimeCodeEditTest::formatNumber_data()
{
    QTest::addColumn<double>("value");
    QTest::addColumn<int>("decimals");
    QTest::addColumn<bool>("integer");
    QTest::addColumn<QString>("text");
    QTest::newRow("two places") << 0.127 << 2 << false << "0.13";
    QTest::newRow("no places") << 2.5 << 0 << false << "3";
    QTest::newRow("automatic trims zeros") << 1.25 << -1 << false << "1.25";
    QTest::newRow("automatic whole") << 3.0 << -1 << false << "3";
    QTest::newRow("automatic six places") << 1.0 / 3 << -1 << false << "0.333333";
    QTest::newRow("negative zero") << -0.001 << 2 << false << "0.00";
    QTest::newRow("integer rounds half up") << 2.5 << 3 << true << "3";
    QTest::newRow("integer negative half") << -2.5 << -1 << true << "-2";
}

void TimeCodeEditTest::formatNumber()
{
    QFETCH(double, value);
    QFETCH(int, decimals);
    QFETCH(bool, integer);
    QFETCH(QString, text);
    QCOMPARE(TimeCodeEdit::FormatNumber(value, decimals, integer), text);
}

void TimeCodeEditTest::formatTime_data()
{
    QTest::addColumn<double>("frames");
    QTest::addColumn<double>("fps");
    QTest::addColumn<int>("decimals");
    QTest::addColumn<QString>("text");
    QTest::newRow("zero") << 0.0 << 24.0 << 0 << "00:00:00:00";
    QTest::newRow("one second and a half") << 36.0 << 24.0 << 0 << "00:00:01:12";
    QTest::newRow("an hour") << 90000.0 << 25.0 << 0 << "01:00:00:00";
    QTest::newRow("fraction of a frame") << 12.5 << 24.0 << 1 << "00:00:00:12.5";
    QTest::newRow("negative") << -30.0 << 30.0 << 0 << "-00:00:01:00";
}

void TimeCodeEditTest::formatTime()
{
    QFETCH(double, frames);
    QFETCH(double, fps);
    QFETCH(int, decimals);
    QFETCH(QString, text);
    QCOMPARE(TimeCodeEdit::FormatTime(frames, fps, decimals), text);
    double back = 0.0;
    QVERIFY(TimeCodeEdit::ParseTime(text, fps, &back));
    QCOMPARE(back, frames);
}

void TimeCodeEditTest::parseTimeRejects_data()
{
    QTest::addColumn<QString>("text");
    QTest::newRow("letters") << "00:aa:00";
    QTest::newRow("too many fields") << "1:2:3:4:5";
    QTest::newRow("negative field") << "00:-1:00";
}

void TimeCodeEditTest::parseTimeRejects()
{
    QFETCH(QString, text);
    double frames = 0.0;
    QVERIFY(!TimeCodeEdit::ParseTime(text, 24.0, &frames));
}

void TimeCodeEditTest::displayModes()
{
    TimeCodeEdit edit;
    edit.SetValue(48.25, 2);
    QCOMPARE(edit.text(), QString("48.25"));
    edit.SetInteger(true);
    QCOMPARE(edit.text(), QString("48"));
    edit.SetInteger(false);
    edit.SetTimeType(true);
    QCOMPARE(edit.text(), QString("00:00:02:00.25"));
    QCOMPARE(edit.GetValue(), 48.25);
    edit.SetFrameRate(12.0);
    QCOMPARE(edit.text(), QString("00:00:04:00.25"));
    edit.SetDisabled(true);
    QVERIFY(!edit.isEnabled());
}

void TimeCodeEditTest::typedValues_data()
{
    QTest::addColumn<QString>("typed");
    QTest::addColumn<bool>("time");
    QTest::addColumn<bool>("ok");
    QTest::addColumn<double>("value");
    QTest::newRow("plain") << "12.5" << false << true << 12.5;
    QTest::newRow("negative") << "-0.75" << false << true << -0.75;
    QTest::newRow("arithmetic") << "2*3+1" << false << true << 7.0;
    QTest::newRow("function") << "sqrt(2)^2" << false << true << 2.0;
    QTest::newRow("garbage keeps last value") << "abc" << false << false << 4.0;
    QTest::newRow("division by zero is no number") << "1/0" << false << false << 4.0;
    QTest::newRow("time code") << "00:00:02:06" << true << true << 54.0;
    QTest::newRow("frames in time display") << "30" << true << true << 30.0;
}

void TimeCodeEditTest::typedValues()
{
    QFETCH(QString, typed);
    QFETCH(bool, time);
    QFETCH(bool, ok);
    QFETCH(double, value);
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
    QVERIFY(!shown.edit->IsExpression());
}

void TimeCodeEditTest::expressions()
{
    ShownEdit shown;
    shown.edit->setFocus();
    shown.edit->clear();
    QTest::keyClicks(shown.edit, " = time * 2 ");
    QVERIFY(shown.edit->IsExpression());
    QCOMPARE(QString(shown.edit->GetExpression().c_str()), QString("time * 2"));
    shown.edit->selectAll();
    QTest::keyClicks(shown.edit, "=3*4");
    QVERIFY(shown.edit->IsExpression());
    QCOMPARE(shown.edit->GetValue(), 12.0);
    shown.edit->selectAll();
    QTest::keyClicks(shown.edit, "3*4");
    QVERIFY(!shown.edit->IsExpression());
    QCOMPARE(QString(shown.edit->GetExpression().c_str()), QString());
}

void TimeCodeEditTest::digitSteps_data()
{
    QTest::addColumn<QString>("start");
    QTest::addColumn<int>("cursor");
    QTest::addColumn<int>("key");
    QTest::addColumn<QString>("after");
    QTest::addColumn<int>("cursorAfter");
    QTest::newRow("units up") << "12.34" << 1 << int(Qt::Key_Up) << "13.34" << 1;
    QTest::newRow("tens down") << "12.34" << 0 << int(Qt::Key_Down) << "2.34" << 0;
    QTest::newRow("hundredths at the end") << "12.34" << 5 << int(Qt::Key_Up) << "12.35" << 5;
    QTest::newRow("carry into a new digit") << "99" << 0 << int(Qt::Key_Up) << "109" << 1;
    QTest::newRow("tenths through zero") << "0.05" << 2 << int(Qt::Key_Down) << "-0.05" << 3;
}

void TimeCodeEditTest::digitSteps()
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

void TimeCodeEditTest::returnFinishesEditing()
{
    ShownEdit shown;
    QSignalSpy finished(shown.edit, SIGNAL(editingFinished()));
    shown.edit->setFocus();
    QTest::keyClicks(shown.edit, "5");
    QTest::keyClick(shown.edit, Qt::Key_Return);
    QCOMPARE(finished.count(), 1);
}

void TimeCodeEditTest::virtualDrag()
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
    QTest::mouseRelease(edit, Qt::LeftButton, Qt::NoModifier, QPoint(55, 10));
    QCOMPARE(start.count(), 1);
    QCOMPARE(end.count(), 1);
    QCOMPARE(drag.count(), 2);
    QCOMPARE(drag.at(0).at(0).toDouble(), 10.0);
    QCOMPARE(drag.at(1).at(0).toDouble(), 5.0);
    QCOMPARE(drag.at(1).at(1).value<TimeCodeEdit *>(), edit);
    QVERIFY(!edit->hasFocus());
    QVERIFY(!edit->IsDragging());
}

void TimeCodeEditTest::dragModifiersScale()
{
    ShownEdit shown;
    shown.edit->SetVirtual(true);
    QTest::mousePress(shown.edit, Qt::LeftButton, Qt::NoModifier, QPoint(10, 10));
    Move(shown.edit, 20);                      // +10
    Move(shown.edit, 30, Qt::ControlModifier); // +1
    Move(shown.edit, 31, Qt::ShiftModifier);   // +10
    QCOMPARE(shown.edit->GetDragDistance(), 21.0);
    QTest::mouseRelease(shown.edit, Qt::LeftButton, Qt::NoModifier, QPoint(31, 10));
}

void TimeCodeEditTest::dragDistanceCanBeSetBack()
{
    ShownEdit shown;
    shown.edit->SetVirtual(true);
    QSignalSpy drag(shown.edit, SIGNAL(Drag(float64, TimeCodeEdit *)));
    QTest::mousePress(shown.edit, Qt::LeftButton, Qt::NoModifier, QPoint(10, 10));
    Move(shown.edit, 40);
    shown.edit->SetDragDistance(12.0);
    Move(shown.edit, 35);
    QCOMPARE(drag.last().at(0).toDouble(), 7.0);
    QTest::mouseRelease(shown.edit, Qt::LeftButton, Qt::NoModifier, QPoint(35, 10));
}

void TimeCodeEditTest::clickStartsTyping()
{
    ShownEdit shown;
    shown.edit->SetVirtual(true);
    shown.edit->SetValue(1.5);
    QSignalSpy start(shown.edit, SIGNAL(StartDrag(TimeCodeEdit *)));
    QTest::mouseClick(shown.edit, Qt::LeftButton, Qt::NoModifier, QPoint(30, 10));
    QCOMPARE(start.count(), 0);
    QVERIFY(shown.edit->hasFocus());
    QCOMPARE(shown.edit->selectedText(), QString("1.5"));
    // With focus the edit is an ordinary line edit: a drag selects text.
    QSignalSpy drag(shown.edit, SIGNAL(Drag(float64, TimeCodeEdit *)));
    QTest::mousePress(shown.edit, Qt::LeftButton, Qt::NoModifier, QPoint(5, 10));
    Move(shown.edit, 60);
    QTest::mouseRelease(shown.edit, Qt::LeftButton, Qt::NoModifier, QPoint(60, 10));
    QCOMPARE(drag.count(), 0);
}

void TimeCodeEditTest::notVirtualSelectsText()
{
    ShownEdit shown;
    QSignalSpy start(shown.edit, SIGNAL(StartDrag(TimeCodeEdit *)));
    QTest::mousePress(shown.edit, Qt::LeftButton, Qt::NoModifier, QPoint(5, 10));
    Move(shown.edit, 60);
    QTest::mouseRelease(shown.edit, Qt::LeftButton, Qt::NoModifier, QPoint(60, 10));
    QCOMPARE(start.count(), 0);
}

QTEST_MAIN(TimeCodeEditTest)
#include "TimeCodeEditTest.moc"
