#include "orbane/Gradient.h"

#include <QtTest>

using namespace Orbane;

Q_DECLARE_METATYPE(GradientColor)

namespace {

// Gradients are shared objects; the test holds the creator's reference.
struct Ramp
{
    Gradient *g = new Gradient;
    ~Ramp() { g->DecRef(); }
    Gradient *operator->() const { return g; }
};

bool Near(const GradientColor &a, const GradientColor &b, double tol)
{
    return qAbs(a.R - b.R) <= tol && qAbs(a.G - b.G) <= tol && qAbs(a.B - b.B) <= tol && qAbs(a.A - b.A) <= tol;
}

} // namespace

class GradientTest : public QObject
{
    Q_OBJECT
private slots:
    void evaluate_data()
    {
        QTest::addColumn<GradientColor>("from");
        QTest::addColumn<GradientColor>("to");
        QTest::addColumn<int>("space");
        QTest::addColumn<double>("pos");
        QTest::addColumn<GradientColor>("expected");
        const GradientColor black{0, 0, 0, 1}, white{1, 1, 1, 1}, red{1, 0, 0, 1}, blue{0, 0, 1, 1};
        QTest::newRow("rgb middle") << black << white << int(GCS_RGB) << 0.5 << GradientColor{0.5, 0.5, 0.5, 1};
        QTest::newRow("before start clamps") << black << white << int(GCS_RGB) << -3.0 << black;
        QTest::newRow("after end clamps") << black << white << int(GCS_RGB) << 7.0 << white;
        QTest::newRow("alpha interpolates")
            << GradientColor{1, 0, 0, 0} << red << int(GCS_RGB) << 0.25 << GradientColor{1, 0, 0, 0.25};
        QTest::newRow("hsv red to blue goes round by magenta")
            << red << blue << int(GCS_HSV) << 0.5 << GradientColor{1, 0, 1, 1};
        QTest::newRow("hls red to blue goes round by magenta")
            << red << blue << int(GCS_HLS) << 0.5 << GradientColor{1, 0, 1, 1};
        QTest::newRow("hsv white takes red's hue")
            << white << red << int(GCS_HSV) << 0.5 << GradientColor{1, 0.5, 0.5, 1};
        QTest::newRow("unknown space is rgb") << red << blue << 99 << 0.5 << GradientColor{0.5, 0, 0.5, 1};
    }

    void evaluate()
    {
        QFETCH(GradientColor, from);
        QFETCH(GradientColor, to);
        QFETCH(int, space);
        QFETCH(double, pos);
        QFETCH(GradientColor, expected);
        Ramp ramp;
        ramp->AddStop(1.0, to);
        ramp->AddStop(0.0, from);
        const GradientColor got = ramp->Evaluate(pos, space);
        QVERIFY(Near(got, expected, 1e-9));
    }

    void quickMatchesExact()
    {
        Ramp ramp;
        ramp->AddStop(0.0, {1, 0, 0, 1});
        ramp->AddStop(0.3, {0.2, 0.9, 0.1, 0.5});
        ramp->AddStop(1.0, {0, 0.2, 1, 1});
        // A 1024-entry table is within a thousandth of the exact ramp.
        for (int space : {GCS_RGB, GCS_HSV, GCS_HLS})
            for (int i = 0; i <= 500; ++i)
                QVERIFY2(Near(ramp->QuickEvaluate(i / 500.0, space), ramp->Evaluate(i / 500.0, space), 2e-3),
                         qPrintable(QString("space %1 at %2").arg(space).arg(i / 500.0)));
    }

    void changeRebuildsTable()
    {
        Ramp ramp;
        QVERIFY(Near(ramp->QuickEvaluate(0.3), GradientColor{0, 0, 0, 0}, 0)); // no stops: transparent
        ramp->AddStop(0.0, {0, 0, 0, 1});
        ramp->AddStop(1.0, {0, 0, 0, 1});
        const uint32 serial = ramp->Serial();
        QVERIFY(Near(ramp->QuickEvaluate(0.5), GradientColor{0, 0, 0, 1}, 1e-9));
        ramp->Clear();
        ramp->AddStop(0.0, {1, 1, 1, 1});
        ramp->AddStop(1.0, {1, 1, 1, 1});
        QVERIFY(ramp->Serial() != serial);
        QVERIFY(Near(ramp->QuickEvaluate(0.5), GradientColor{1, 1, 1, 1}, 1e-9));
    }

    void hardEdge()
    {
        Ramp ramp;
        ramp->AddStop(0.0, {1, 0, 0, 1});
        ramp->AddStop(0.5, {1, 0, 0, 1});
        ramp->AddStop(0.5, {0, 0, 1, 1});
        ramp->AddStop(1.0, {0, 0, 1, 1});
        QVERIFY(Near(ramp->Evaluate(0.49), GradientColor{1, 0, 0, 1}, 1e-9));
        QVERIFY(Near(ramp->Evaluate(0.51), GradientColor{0, 0, 1, 1}, 1e-9));
    }
};

QTEST_MAIN(GradientTest)
#include "GradientTest.moc"
