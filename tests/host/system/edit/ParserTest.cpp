#include "orbane/Parser.h"

#include <QtTest>

#include <cmath>

using namespace Orbane;

class ParserTest : public QObject
{
    Q_OBJECT
private slots:
    void evaluates_data();
    void evaluates();
    void boundStorageIsReadAtEachEvaluation();
    void ownedVariables();
    void errors_data();
    void errors();
    void badVariableName();
    void laterDefinitionKeepsExpression();
};

void ParserTest::evaluates_data()
{
    QTest::addColumn<QByteArray>("expr");
    QTest::addColumn<double>("value");
    QTest::addColumn<double>("expected");
    QTest::newRow("precedence") << QByteArray("1+2*3") << 0.0 << 7.0;
    QTest::newRow("variable") << QByteArray("value*2") << 4.5 << 9.0;
    QTest::newRow("function") << QByteArray("sqrt(value)") << 16.0 << 4.0;
    QTest::newRow("pi") << QByteArray("pi/2") << 0.0 << M_PI / 2;
    QTest::newRow("power") << QByteArray("value^3") << 2.0 << 8.0;
    QTest::newRow("two variables") << QByteArray("minscale+(maxscale-minscale)*value") << 0.25 << 2.5;
}

void ParserTest::evaluates()
{
    QFETCH(QByteArray, expr);
    QFETCH(double, value);
    QFETCH(double, expected);
    double vars[3] = {value, 1.0, 7.0};
    Parser parser;
    QVERIFY(parser.DefineVar("value", &vars[0]));
    QVERIFY(parser.DefineVar("minscale", &vars[1]));
    QVERIFY(parser.DefineVar("maxscale", &vars[2]));
    QVERIFY2(parser.SetExpression(expr.constData()), parser.GetError());
    QVERIFY(parser.IsValid());
    bool ok = false;
    QCOMPARE(parser.Evaluate(&ok), expected);
    QVERIFY(ok);
    QCOMPARE(QByteArray(parser.GetExpression()), expr);
}

void ParserTest::boundStorageIsReadAtEachEvaluation()
{
    double v = 1.0;
    Parser parser;
    parser.DefineVar("value", &v);
    QVERIFY(parser.SetExpression("value*value+1"));
    for (v = -3.0; v <= 3.0; v += 0.5)
        QCOMPARE(parser.Evaluate(), v * v + 1);
    QCOMPARE(parser.GetVar("value"), &v);
    QCOMPARE(parser.GetVar("other"), nullptr);
}

void ParserTest::ownedVariables()
{
    Parser parser;
    QVERIFY(parser.SetVar("a", 2.0));
    QVERIFY(parser.SetVar("b", 5.0));
    QVERIFY(parser.SetExpression("a*b"));
    QCOMPARE(parser.Evaluate(), 10.0);
    QVERIFY(parser.SetVar("a", 3.0));
    QCOMPARE(parser.Evaluate(), 15.0);
    QCOMPARE(*parser.GetVar("b"), 5.0);
}

void ParserTest::errors_data()
{
    QTest::addColumn<QByteArray>("expr");
    QTest::newRow("dangling operator") << QByteArray("1+");
    QTest::newRow("unknown variable") << QByteArray("foo*2");
    QTest::newRow("unbalanced") << QByteArray("(1+2");
    QTest::newRow("empty") << QByteArray("");
    QTest::newRow("unknown function") << QByteArray("nosuch(1)");
}

void ParserTest::errors()
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

void ParserTest::badVariableName()
{
    double v = 0.0;
    Parser parser;
    QVERIFY(!parser.DefineVar("1abc", &v));
    QVERIFY(!parser.DefineVar("ok", nullptr));
    QVERIFY(!parser.SetVar("a b", 1.0));
    QVERIFY(!parser.GetVar("a b"));
}

void ParserTest::laterDefinitionKeepsExpression()
{
    double x = 2.0, y = 3.0;
    Parser parser;
    parser.DefineVar("x", &x);
    QVERIFY(parser.SetExpression("x*10"));
    QVERIFY(parser.DefineVar("y", &y));
    QVERIFY(parser.IsValid());
    QCOMPARE(parser.Evaluate(), 20.0);
}

QTEST_GUILESS_MAIN(ParserTest)
#include "ParserTest.moc"
