#include "widgets/SliderMapping.h"

#include <QtTest>

#include <cmath>
#include <optional>

using namespace Orbane;

namespace {

// Every mapping runs over a 200-pixel track, pixels 5 to 205.
constexpr double kLeft = 5.0, kRight = 205.0;

// The mappings the tables name. Two segments have their centre at 1.
SliderMapping Make(const QByteArray &mode, double min, double max)
{
    static const QHash<QByteArray, QPair<const char *, const char *>> expressions{
        {"square expressions", {"value*value", "sqrt(value)"}},
        {"expressions with variables", {"(value-minscale)/(maxscale-minscale)", "minscale+value*(maxscale-minscale)"}},
        {"steep expressions", {"value^10", "value^0.1"}},
        {"steepest expressions", {"value^1000", "value^0.001"}},
    };
    SliderMapping m;
    const bool twoSegment = mode == "two segments";
    m.SetBounds({min, max, min, max, twoSegment ? 1.0 : 0.0, mode == "power 2" ? 2.0 : 1.0});
    m.SetTwoSegment(twoSegment);
    m.SetTrack(kLeft, kRight);
    if (mode == "steep callbacks")
        m.SetCallbacks([](double v, void *) { return std::pow(v, 10.0); }, nullptr,
                       [](double t, void *) { return std::pow(t, 0.1); }, nullptr);
    if (expressions.contains(mode) && !m.SetExpressions(expressions[mode].first, expressions[mode].second))
        QTest::qFail("the expressions do not compile", __FILE__, __LINE__);
    return m;
}

void AddMappingColumns()
{
    QTest::addColumn<QByteArray>("mode");
    QTest::addColumn<double>("min");
    QTest::addColumn<double>("max");
}

} // namespace

class SliderMappingTest : public QObject
{
    Q_OBJECT
private slots:
    void roundTrip_data();
    void roundTrip();
    void fineScaling_data();
    void fineScaling();
    void resolution_data();
    void resolution();
    void badExpressionIsDropped();
    void copyCompilesItsOwnExpressions();
    void dragValue_data();
    void dragValue();
    void trackStep_data();
    void trackStep();
    void snapToStep_data();
    void snapToStep();
    void roundings_data();
    void roundings();
    void halfUpHitsTheDecimal();
};

// The value at one pixel, the range's ends at the track's ends, and pixel to
// value and back along the whole track.
void SliderMappingTest::roundTrip_data()
{
    AddMappingColumns();
    QTest::addColumn<double>("value");
    QTest::addColumn<double>("pixel");
    QTest::newRow("linear") << QByteArray("linear") << 0.0 << 1.0 << 0.5 << 105.0;
    QTest::newRow("below clamps") << QByteArray("linear") << 0.0 << 1.0 << -3.0 << 5.0;
    QTest::newRow("above clamps") << QByteArray("linear") << 0.0 << 1.0 << 9.0 << 205.0;
    QTest::newRow("negative range") << QByteArray("linear") << -10.0 << -5.0 << -6.0 << 165.0;
    QTest::newRow("power 2") << QByteArray("power 2") << 0.0 << 1.0 << 0.25 << 105.0;
    QTest::newRow("power 2 about zero") << QByteArray("power 2") << -1.0 << 1.0 << -0.25 << 55.0;
    QTest::newRow("callbacks") << QByteArray("steep callbacks") << 0.0 << 1.0 << 0.5 << 5.1953125;
    QTest::newRow("expressions") << QByteArray("square expressions") << 0.0 << 2.0 << 1.0 << 55.0;
    QTest::newRow("expressions with variables")
        << QByteArray("expressions with variables") << 2.0 << 6.0 << 3.0 << 55.0;
    QTest::newRow("two segments below") << QByteArray("two segments") << 0.0 << 10.0 << 0.5 << 55.0;
    QTest::newRow("two segments centre") << QByteArray("two segments") << 0.0 << 10.0 << 1.0 << 105.0;
    QTest::newRow("two segments above") << QByteArray("two segments") << 0.0 << 10.0 << 5.5 << 155.0;
}

void SliderMappingTest::roundTrip()
{
    QFETCH(QByteArray, mode);
    QFETCH(double, min);
    QFETCH(double, max);
    QFETCH(double, value);
    QFETCH(double, pixel);
    const SliderMapping m = Make(mode, min, max);
    QVERIFY(qAbs(m.ValueToPixel(value) - pixel) < 1e-9);
    QCOMPARE(m.ValueToPixel(min), kLeft);
    QCOMPARE(m.ValueToPixel(max), kRight);
    QVERIFY(qAbs(m.PixelToValue(kLeft) - min) < 1e-9);
    QVERIFY(qAbs(m.PixelToValue(kRight) - max) < 1e-9);
    for (double x = kLeft; x <= kRight; x += 2.5) {
        const double v = m.PixelToValue(x);
        QVERIFY(v >= min - 1e-9 && v <= max + 1e-9);
        QVERIFY2(qAbs(m.ValueToPixel(v) - x) < 1e-6, qPrintable(QString::number(x)));
    }
    // Beyond a linear track the value stops at the range's ends; two
    // segments extrapolate, and the widget clamps.
    if (!m.IsTwoSegment()) {
        QVERIFY(qAbs(m.PixelToValue(-50.0) - min) < 1e-9);
        QVERIFY(qAbs(m.PixelToValue(400.0) - max) < 1e-9);
    }
}

// A scaling of 0.1 stretches the track tenfold about the anchor.
void SliderMappingTest::fineScaling_data()
{
    QTest::addColumn<bool>("twoSegment");
    QTest::addColumn<double>("anchor");
    QTest::addColumn<double>("value");
    QTest::addColumn<double>("pixel");
    QTest::newRow("linear about 0") << false << 0.0 << 0.01 << 25.0;
    QTest::newRow("linear about 0.5") << false << 0.5 << 0.49 << 85.0;
    QTest::newRow("two segments") << true << 0.0 << 0.01 << 25.0;
}

void SliderMappingTest::fineScaling()
{
    QFETCH(bool, twoSegment);
    QFETCH(double, anchor);
    QFETCH(double, value);
    QFETCH(double, pixel);
    SliderMapping m = Make("linear", 0.0, 1.0);
    m.SetBounds({0.0, 1.0, 0.0, 1.0, 0.5, 1.0});
    m.SetTwoSegment(twoSegment);
    m.SetAnchor(anchor);
    QVERIFY(qAbs(m.ValueToPixel(value, 0.1) - pixel) < 1e-9);
    QVERIFY(qAbs(m.PixelToValue(pixel, 0.1) - value) < 1e-12);
}

void SliderMappingTest::resolution_data()
{
    AddMappingColumns();
    QTest::addColumn<double>("value");
    QTest::addColumn<double>("resolution");
    // 200 pixels need three digits across the range.
    QTest::newRow("unit range") << QByteArray("linear") << 0.0 << 1.0 << 0.3 << 1000.0;
    QTest::newRow("hundred") << QByteArray("linear") << 0.0 << 100.0 << 30.0 << 10.0;
    QTest::newRow("flat range") << QByteArray("linear") << 2.0 << 2.0 << 2.0 << 1.0;
    QTest::newRow("power, steep end") << QByteArray("power 2") << 0.0 << 1.0 << 0.0001 << 1e5;
    QTest::newRow("power, flat end") << QByteArray("power 2") << 0.0 << 1.0 << 1.0 << 1000.0;
    // A steep mapping needs more digits where a pixel covers less of the
    // range, never more than two beyond the linear case.
    QTest::newRow("callbacks, steep end") << QByteArray("steep callbacks") << 0.0 << 1.0 << 1.0 << 1e4;
    QTest::newRow("expressions, flat end") << QByteArray("steep expressions") << 0.0 << 1.0 << 0.5 << 1000.0;
    QTest::newRow("expressions, steep end") << QByteArray("steep expressions") << 0.0 << 1.0 << 1.0 << 1e4;
    QTest::newRow("expressions, capped") << QByteArray("steepest expressions") << 0.0 << 1.0 << 1.0 << 1e5;
    QTest::newRow("two segments below") << QByteArray("two segments") << 0.0 << 10.0 << 0.5 << 100.0;
    QTest::newRow("two segments above") << QByteArray("two segments") << 0.0 << 10.0 << 5.0 << 100.0;
    QTest::newRow("two segments at centre") << QByteArray("two segments") << 0.0 << 10.0 << 1.0 << 1.0;
}

void SliderMappingTest::resolution()
{
    QFETCH(QByteArray, mode);
    QFETCH(double, min);
    QFETCH(double, max);
    QFETCH(double, value);
    QFETCH(double, resolution);
    const SliderMapping m = Make(mode, min, max);
    QCOMPARE(m.Resolution(value), resolution);
    if (min == max)
        QCOMPARE(m.ValueToPixel(min + 7.0), kLeft);
}

void SliderMappingTest::badExpressionIsDropped()
{
    SliderMapping m = Make("linear", 0.0, 1.0);
    QVERIFY(!m.SetExpressions("value*", "value"));
    QVERIFY(m.GetForwardExpression().IsEmpty());
    QCOMPARE(m.GetInverseExpression(), OrbString("value"));
    QVERIFY(!m.SetExpressions("nosuchvar", ""));
    QVERIFY(m.IsPlainLinear());
    QCOMPARE(m.ValueToPixel(0.5), 105.0);
}

// A copy's parsers read the copy's own variables: it outlives the original
// and follows its own range.
void SliderMappingTest::copyCompilesItsOwnExpressions()
{
    SliderMapping copy;
    {
        const SliderMapping original = Make("expressions with variables", 2.0, 6.0);
        copy = original;
    }
    QCOMPARE(copy.ValueToPixel(3.0), 55.0);
    SliderMapping other(copy);
    other.SetBounds({0.0, 100.0, 0.0, 100.0, 0.0, 1.0});
    QCOMPARE(other.ValueToPixel(3.0), 11.0);
    QCOMPARE(copy.ValueToPixel(3.0), 55.0);
}

// From 0..1 over 200 pixels, 0.005 a pixel; the value the press started from
// is 0.123456.
void SliderMappingTest::dragValue_data()
{
    QTest::addColumn<QByteArray>("mode");
    QTest::addColumn<double>("x");
    QTest::addColumn<double>("k");
    QTest::addColumn<double>("def");
    QTest::addColumn<double>("stored");
    const double none = -1.0;
    const double pressX = kLeft + 200 * 0.123456;
    QTest::newRow("rounded to three places") << QByteArray("linear") << 125.4 << 1.0 << none << 0.602;
    QTest::newRow("back to the press value") << QByteArray("linear") << pressX + 0.4 << 1.0 << none << 0.123456;
    QTest::newRow("the press value before the default")
        << QByteArray("linear") << pressX + 0.4 << 1.0 << 0.1236 << 0.123456;
    // The default lies 0.46 pixels from 0.25.
    QTest::newRow("onto the default") << QByteArray("linear") << 55.0 << 1.0 << 0.2523 << 0.2523;
    QTest::newRow("past the default") << QByteArray("linear") << 54.8 << 1.0 << 0.2523 << 0.249;
    QTest::newRow("fine keeps one more place") << QByteArray("linear") << 108.0 << 0.1 << none << 0.5015;
    QTest::newRow("beyond the end") << QByteArray("linear") << 400.0 << 1.0 << none << 1.0;
    // Near the steep end of a power track a pixel is 0.0001 wide.
    QTest::newRow("power keeps the places a pixel needs") << QByteArray("power 2") << 7.3 << 1.0 << none << 0.00013;
}

void SliderMappingTest::dragValue()
{
    QFETCH(QByteArray, mode);
    QFETCH(double, x);
    QFETCH(double, k);
    QFETCH(double, def);
    QFETCH(double, stored);
    SliderMapping m = Make(mode, 0.0, 1.0);
    m.SetAnchor(0.5);
    const std::optional<double> theDefault = def >= 0.0 ? std::optional<double>(def) : std::nullopt;
    QCOMPARE(m.DragValue(x, k, 0.123456, theDefault), stored);
}

// Steps on a bent track are a fraction of the track, rounded as a drag is:
// on a square track they differ on either side of a value.
void SliderMappingTest::trackStep_data()
{
    QTest::addColumn<double>("value");
    QTest::addColumn<int>("direction");
    QTest::addColumn<int>("level");
    QTest::addColumn<double>("step");
    QTest::newRow("normal, a hundredth of the track") << 0.5 << 1 << 1 << 0.01;
    QTest::newRow("fine, one more place") << 0.5 << 1 << 0 << 0.001;
    QTest::newRow("coarse up") << 0.5 << 1 << 2 << 0.092;
    QTest::newRow("coarse down") << 0.5 << -1 << 2 << 0.113;
    QTest::newRow("stops at the end") << 0.99 << 1 << 2 << 0.01;
}

void SliderMappingTest::trackStep()
{
    QFETCH(double, value);
    QFETCH(int, direction);
    QFETCH(int, level);
    QFETCH(double, step);
    const SliderMapping m = Make("square expressions", 0.0, 1.0);
    QVERIFY(m.HasMapping());
    QCOMPARE(m.TrackStep(value, direction, level), step);
}

void SliderMappingTest::snapToStep_data()
{
    QTest::addColumn<double>("centre");
    QTest::addColumn<double>("stepDown");
    QTest::addColumn<double>("stepUp");
    QTest::addColumn<double>("value");
    QTest::addColumn<double>("snapped");
    const double linear = -100.0; // no centre inside the range
    QTest::newRow("truncates toward zero") << linear << 1.0 << 9.0 << -2.7 << -2.0;
    QTest::newRow("step of five") << linear << 5.0 << 9.0 << 8.0 << 10.0;
    QTest::newRow("negative step of five") << linear << 5.0 << 9.0 << -7.0 << 0.0;
    QTest::newRow("below the centre") << 2.4 << 1.0 << 9.0 << 1.2 << 1.0;
    QTest::newRow("above the centre, the up step") << 2.4 << 1.0 << 3.0 << 5.0 << 6.0;
    QTest::newRow("crossing the centre") << 2.4 << 4.0 << 9.0 << 2.3 << 2.0;
    QTest::newRow("at the centre") << 2.4 << 4.0 << 9.0 << 2.4 << 2.0;
}

void SliderMappingTest::snapToStep()
{
    QFETCH(double, centre);
    QFETCH(double, stepDown);
    QFETCH(double, stepUp);
    QFETCH(double, value);
    QFETCH(double, snapped);
    SliderMapping m = Make("linear", -10.0, 10.0);
    m.SetBounds({-10.0, 10.0, -10.0, 10.0, centre, 1.0});
    m.SetTwoSegment(centre > -10.0);
    QCOMPARE(m.SnapToStep(value, stepDown, stepUp), snapped);
}

// The widget's snap and the control's rounding agree at halves and part
// below zero, as their comment says. Results are compared exactly.
void SliderMappingTest::roundings_data()
{
    QTest::addColumn<double>("step");
    QTest::addColumn<double>("value");
    QTest::addColumn<double>("truncated"); // AddHalfTruncate
    QTest::addColumn<double>("halfUp");    // RoundHalfUp
    QTest::newRow("-2.5") << 1.0 << -2.5 << -2.0 << -2.0;
    QTest::newRow("-0.5") << 1.0 << -0.5 << 0.0 << 0.0;
    QTest::newRow("0.5") << 1.0 << 0.5 << 1.0 << 1.0;
    QTest::newRow("-2.7") << 1.0 << -2.7 << -2.0 << -3.0;
    QTest::newRow("-2.2") << 1.0 << -2.2 << -1.0 << -2.0;
    QTest::newRow("2.2") << 1.0 << 2.2 << 2.0 << 2.0;
    QTest::newRow("quarter -0.625") << 0.25 << -0.625 << -0.5 << -0.5;
    QTest::newRow("quarter -0.125") << 0.25 << -0.125 << 0.0 << 0.0;
    QTest::newRow("quarter 0.125") << 0.25 << 0.125 << 0.25 << 0.25;
    QTest::newRow("quarter -0.6") << 0.25 << -0.6 << -0.25 << -0.5;
    QTest::newRow("no step") << 0.0 << -2.7 << -2.7 << -2.7;
}

void SliderMappingTest::roundings()
{
    QFETCH(double, step);
    QFETCH(double, value);
    QFETCH(double, truncated);
    QFETCH(double, halfUp);
    QVERIFY2(SliderMapping::AddHalfTruncate(value, step) == truncated,
             qPrintable(QString::number(SliderMapping::AddHalfTruncate(value, step), 'g', 17)));
    QVERIFY2(SliderMapping::RoundHalfUp(value, step) == halfUp,
             qPrintable(QString::number(SliderMapping::RoundHalfUp(value, step), 'g', 17)));
}

// Decimal places give the double nearest the decimal: 0.57, not 57 * 0.01.
void SliderMappingTest::halfUpHitsTheDecimal()
{
    QVERIFY(SliderMapping::RoundHalfUp(0.5704, 0.01) == 0.57);
    QVERIFY(SliderMapping::RoundHalfUp(1.125, 0.01) == 1.13);
}

QTEST_APPLESS_MAIN(SliderMappingTest)
#include "SliderMappingTest.moc"
