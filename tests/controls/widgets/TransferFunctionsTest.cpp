#include "widgets/TransferFunctions.h"

#include <QtTest>

#include <cmath>
#include <limits>

using namespace Orbane;
using namespace Orbane::TransferFunctions;

class TransferFunctionsTest : public QObject
{
    Q_OBJECT
private slots:
    void values_data();
    void values();
    void softClipRollsOffBelowOne();
};

void TransferFunctionsTest::values_data()
{
    QTest::addColumn<QString>("function");
    QTest::addColumn<double>("x");
    QTest::addColumn<double>("setting");
    QTest::addColumn<double>("y");
    const double nan = std::numeric_limits<double>::quiet_NaN();
    QTest::newRow("gamma 2 lifts a quarter to a half") << "gamma" << 0.25 << 2.0 << 0.5;
    QTest::newRow("gamma keeps the sign") << "gamma" << -0.25 << 2.0 << -0.5;
    QTest::newRow("gamma 0 is taken as 1") << "gamma" << 0.3 << 0.0 << 0.3;
    QTest::newRow("gamma through 0.5^(1/2.2)") << "through" << std::pow(0.5, 1 / 2.2) << 0.0 << 2.2;
    QTest::newRow("log: white code is 1") << "log" << 685.0 << 685.0 << 1.0;
    QTest::newRow("log: black code is 0") << "log" << 95.0 << 685.0 << 0.0;
    // (10^(338 * 0.002 / 0.6) - o) / (1 - o), o = 10^(-590 * 0.002 / 0.6).
    QTest::newRow("log: top code") << "log" << 1023.0 << 685.0 << 13.521694569;
    QTest::newRow("log: a white of NaN is the default") << "log" << 685.0 << nan << 1.0;
}

void TransferFunctionsTest::values()
{
    QFETCH(QString, function);
    QFETCH(double, x);
    QFETCH(double, setting);
    QFETCH(double, y);
    double got = 0.0;
    if (function == "gamma") {
        got = Gamma(x, setting);
    } else if (function == "through") {
        got = GammaThrough(x);
    } else {
        LogSettings s;
        s.white = setting;
        got = LogToLinear(x, s);
    }
    QVERIFY2(std::abs(got - y) < 1e-6, qPrintable(QString::number(got, 'g', 12)));
}

// With soft clip the highlights never fall and never pass 1 (they reach it
// only where a double can no longer tell them apart); below the knee
// nothing changes.
void TransferFunctionsTest::softClipRollsOffBelowOne()
{
    LogSettings soft;
    soft.softClip = 0.2;
    const LogSettings hard;
    QCOMPARE(LogToLinear(300.0, soft), LogToLinear(300.0, hard));
    double last = -1.0;
    for (double code = 600; code <= 1023; code += 1) {
        const double y = LogToLinear(code, soft);
        QVERIFY(y >= last && y <= 1.0);
        last = y;
    }
    QVERIFY(LogToLinear(685.0, soft) > 0.9 && LogToLinear(685.0, soft) < 0.95);
}

QTEST_APPLESS_MAIN(TransferFunctionsTest)
#include "TransferFunctionsTest.moc"
