#include "orbane/Parser.h"

#include <QtTest>

#include <cmath>

using namespace Orbane;

class ParserTest : public QObject
{
    Q_OBJECT
private slots:
    void evaluates_data()
    {
        QTest::addColumn<QByteArray>("expr");
        QTest::addColumn<double>("expected");
        // value 0.25, minscale 1, maxscale 7; pi is ours, the rest muParser's
        QTest::newRow("function") << QByteArray("sqrt(value*64)") << 4.0;
        QTest::newRow("pi") << QByteArray("pi/2") << M_PI / 2;
        QTest::newRow("three variables") << QByteArray("minscale+(maxscale-minscale)*value") << 2.5;
    }

    void evaluates()
    {
        QFETCH(QByteArray, expr);
        QFETCH(double, expected);
        double vars[3] = {0.25, 1.0, 7.0};
        Parser parser;
        QVERIFY(parser.DefineVar("value", &vars[0]));
        QVERIFY(parser.DefineVar("minscale", &vars[1]));
        QVERIFY(parser.DefineVar("maxscale", &vars[2]));
        QVERIFY2(parser.SetExpression(expr.constData()), parser.GetError());
        bool ok = false;
        QCOMPARE(parser.Evaluate(&ok), expected);
        QVERIFY(ok);
        QCOMPARE(QByteArray(parser.GetExpression()), expr);
    }

    // Bound variables are read at each evaluation, owned ones can be set again,
    // and a variable defined later leaves the expression valid.
    void variables()
    {
        double v = 1.0;
        Parser parser;
        parser.DefineVar("value", &v);
        QVERIFY(parser.SetVar("a", 2.0));
        QVERIFY(parser.SetExpression("value*value+a"));
        for (v = -3.0; v <= 3.0; v += 0.5)
            QCOMPARE(parser.Evaluate(), v * v + 2);
        QVERIFY(parser.SetVar("a", 3.0));
        QVERIFY(parser.DefineVar("b", &v));
        QVERIFY(parser.IsValid());
        QCOMPARE(parser.Evaluate(), v * v + 3);
        QVERIFY(!parser.DefineVar("1abc", &v));
        QVERIFY(!parser.DefineVar("ok", nullptr));
        QVERIFY(!parser.SetVar("a b", 1.0));
    }

    void errors_data()
    {
        QTest::addColumn<QByteArray>("expr");
        QTest::newRow("dangling operator") << QByteArray("1+");
        QTest::newRow("unknown variable") << QByteArray("foo*2");
        QTest::newRow("empty") << QByteArray("");
    }

    void errors()
    {
        QFETCH(QByteArray, expr);
        Parser parser;
        QVERIFY(parser.SetExpression("1"));
        QVERIFY(!parser.SetExpression(expr.constData()));
        QVERIFY(!parser.IsValid());
        QVERIFY(*parser.GetError());
        QCOMPARE(QByteArray(parser.GetExpression()), QByteArray());
        bool ok = true;
        QVERIFY(std::isnan(parser.Evaluate(&ok)));
        QVERIFY(!ok);
    }
};

QTEST_GUILESS_MAIN(ParserTest)
#include "ParserTest.moc"
