#include "ToolFixture.h"

#include "widgets/CustomSlider.h"

#include "orbane/AutoParam.h"
#include "orbane/Input.h"
#include "orbane/Operator.h"
#include "orbane/Point.h"

#include <QLabel>
#include <QtTest>

#include <cmath>

using namespace Orbane;
using namespace Orbane::Test;

Q_DECLARE_METATYPE(QVector<QPoint>)

namespace {

constexpr Tag kMaster = 0x40050000, kRole = 0x10050000, kLabel = 0x30040000;
const OrbID kWheel("ColorWheelControl");

struct Wheel
{
    Wheel(float64 x, float64 y, int role = 0)
    {
        master = f.AddNumber("Master", role == 0 ? 0.0 : 1.0);
        TagList attrs{{kLabel, "Lift"}, {kRole, role}};
        attrs.Add(kMaster, static_cast<ScriptObject *>(master));
        puck = f.AddPoint("Puck", x, y, attrs);
        control = f.Create(kWheel, {puck});
    }
    QWidget *Child(const char *name) const { return control->findChild<QWidget *>(name); }
    QPointF Puck() const
    {
        const AutoPoint p(puck, f.doc.GetCurrentTime());
        return QPointF(p->X, p->Y);
    }
    // Pixels per unit of saturation: the disc's radius (the wheel's smaller
    // side halved, less the room kept for the puck at the rim).
    double Scale() const
    {
        QWidget *w = Child("wheel");
        return std::min(w->width(), w->height()) / 2.0 - 6.0;
    }

    ToolFixture f;
    Input *master = nullptr;
    Input *puck = nullptr;
    InputControl *control = nullptr;
};

void Drag(QWidget *w, const QVector<QPoint> &moves, Qt::KeyboardModifiers mods)
{
    QPoint at = w->rect().center();
    QTest::mousePress(w, Qt::LeftButton, mods, at);
    for (const QPoint &d : moves) {
        at += d;
        QMouseEvent move(QEvent::MouseMove, at, w->mapToGlobal(at), Qt::NoButton, Qt::LeftButton, mods);
        QApplication::sendEvent(w, &move);
    }
    QTest::mouseRelease(w, Qt::LeftButton, mods, at);
}

} // namespace

class ColorWheelControlTest : public QObject
{
    Q_OBJECT
private slots:
    void initTestCase();
    void drags_data();
    void drags();
    void doubleClickResets();
    void masterFollowsRole();
};

void ColorWheelControlTest::initTestCase()
{
    std::string error;
    QVERIFY2(ToolFixture::LoadControls(&error), error.c_str());
}

// Moves are in units of the disc's radius (r); the puck follows relative to
// where it was.
void ColorWheelControlTest::drags_data()
{
    QTest::addColumn<QPointF>("start");
    QTest::addColumn<QVector<QPointF>>("moves"); // in radii, screen y down
    QTest::addColumn<int>("mods");
    QTest::addColumn<QPointF>("end");
    const double d = std::sqrt(0.125);
    QTest::newRow("plain") << QPointF(0, 0) << QVector<QPointF>{{0.25, 0}, {0.5, 0}} << int(Qt::NoModifier)
                           << QPointF(0.5, 0);
    QTest::newRow("up is positive y") << QPointF(0.2, 0) << QVector<QPointF>{{0, -0.5}} << int(Qt::NoModifier)
                                      << QPointF(0.2, 0.5);
    QTest::newRow("ctrl is ten times finer")
        << QPointF(0, 0) << QVector<QPointF>{{0.5, 0}} << int(Qt::ControlModifier) << QPointF(0.05, 0);
    QTest::newRow("kept inside the rim") << QPointF(0, 0) << QVector<QPointF>{{2, 0}} << int(Qt::NoModifier)
                                         << QPointF(1, 0);
    QTest::newRow("shift across: hue only")
        << QPointF(0.5, 0) << QVector<QPointF>{{0, -0.1}, {0, -0.5}} << int(Qt::ShiftModifier) << QPointF(d, d);
    QTest::newRow("shift along: saturation only")
        << QPointF(0.5, 0) << QVector<QPointF>{{0.2, -0.05}, {0.3, -0.3}} << int(Qt::ShiftModifier) << QPointF(0.8, 0);
}

void ColorWheelControlTest::drags()
{
    QFETCH(QPointF, start);
    QFETCH(QVector<QPointF>, moves);
    QFETCH(int, mods);
    QFETCH(QPointF, end);
    Wheel w(start.x(), start.y());
    QVector<QPoint> pixels;
    QPointF sum;
    QPoint done;
    for (const QPointF &m : moves) {
        // Each move is where the mouse is relative to the press, as pixels.
        sum = m * w.Scale();
        pixels << sum.toPoint() - done;
        done = sum.toPoint();
    }
    Drag(w.Child("wheel"), pixels, Qt::KeyboardModifiers(mods));
    const QPointF got = w.Puck();
    // A pixel of rounding is 1/54 of the radius at the fixture's size.
    QVERIFY2(std::fabs(got.x() - end.x()) < 0.02 && std::fabs(got.y() - end.y()) < 0.02,
             qPrintable(QString("%1, %2").arg(got.x()).arg(got.y())));
    QCOMPARE(w.f.doc.UndoNames(), QStringList{"Change Lift"});
    QVERIFY(w.f.doc.Undo());
    QCOMPARE(w.Puck(), start);
}

void ColorWheelControlTest::doubleClickResets()
{
    Wheel w(0.3, -0.4);
    QTest::mouseDClick(w.Child("wheel"), Qt::LeftButton);
    QCOMPARE(w.Puck(), QPointF(0, 0));
    QCOMPARE(w.f.doc.UndoNames(), QStringList{"Reset Lift"});
    QCOMPARE(qobject_cast<QLabel *>(w.Child("readout"))->text(), QString("H 0.0  S 0.000  M 0.000"));
}

// Gain's master runs 0 to 4 about 1: a drag to the right end writes 4, one step.
void ColorWheelControlTest::masterFollowsRole()
{
    Wheel w(0, 0, 2);
    auto *master = qobject_cast<CustomSlider *>(w.Child("master"));
    QVERIFY(master && master->isVisible());
    const QPoint knob(master->KnobX(), master->height() / 2);
    QTest::mousePress(master, Qt::LeftButton, Qt::NoModifier, knob);
    for (int x = knob.x(); x <= master->width() + 10; x += 20) {
        QMouseEvent move(QEvent::MouseMove, QPoint(x, knob.y()), master->mapToGlobal(QPoint(x, knob.y())), Qt::NoButton,
                         Qt::LeftButton, Qt::NoModifier);
        QApplication::sendEvent(master, &move);
    }
    QTest::mouseRelease(master, Qt::LeftButton, Qt::NoModifier, QPoint(master->width() + 10, knob.y()));
    QCOMPARE(w.f.NumberOf(w.master), 4.0);
    QCOMPARE(w.f.doc.UndoNames(), QStringList{"Change Lift"});
    QVERIFY(w.f.doc.Undo());
    QCOMPARE(w.f.NumberOf(w.master), 1.0);
}

QTEST_MAIN(ColorWheelControlTest)
#include "ColorWheelControlTest.moc"
