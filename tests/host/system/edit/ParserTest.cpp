#include "orbane/Parser.h"

#include <QtTest>

#include <cmath>

using namespace Orbane;

class ParserTest : public QObject
{
    Q_OBJECT
private slots:
    // Evaluation through InputControlTest and the slider's expression
    // mapping; here what they do not reach: bound variables are read at each
    // evaluation, owned ones can be set again, a variable defined later leaves
    // the expression valid, pi is ours, and bad names are refused.
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
        QVERIFY(parser.SetExpression("pi/2"));
        QCOMPARE(parser.Evaluate(), M_PI / 2);
        QVERIFY(!parser.DefineVar("1abc", &v));
        QVERIFY(!parser.DefineVar("ok", nullptr));
        QVERIFY(!parser.SetVar("a b", 1.0));
    }

    void errors_data()
    {
        QTest::addColumn<QByteArray>("expr");
        QTest::newRow("dangling operator") << QByteArray("1+");
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
