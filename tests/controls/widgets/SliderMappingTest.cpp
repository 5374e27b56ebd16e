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
    const bool twoSegment = mode.startsWith("two segments");
    // "two segments at 0.5" and "two segments at 2.4" put the centre there.
    const double centre = mode.contains(" at ") ? mode.split(' ').last().toDouble() : twoSegment ? 1.0 : 0.0;
    m.SetBounds({min, max, min, max, centre, mode == "power 2" ? 2.0 : 1.0});
    m.SetTwoSegment(twoSegment);
    m.SetTrack(kLeft, kRight);
    if (mode == "steep callbacks")
        m.SetCallbacks([](double v, void *) { return std::pow(v, 10.0); }, nullptr,
                       [](double t, void *) { return std::pow(t, 0.1); }, nullptr);
    if (expressions.contains(mode) && !m.SetExpressions(expressions[mode].first, expressions[mode].second))
        QTest::qFail("the expressions do not compile", __FILE__, __LINE__);
    return m;
}

// One row of the table: a call on a mapping made by Make, its arguments and
// the results expected.
void Row(const char *name, const char *mode, double min, double max, const char *call, QList<double> args,
         QList<double> expected)
{
    QTest::newRow(name) << QByteArray(mode) << min << max << QByteArray(call) << args << expected;
}

bool Same(double a, double b)
{
    return a == b || qFuzzyCompare(a, b);
}

// Value to pixel and back along the whole track, with the range's ends at the
// track's ends.
void CheckRoundTrip(const SliderMapping &m, double min, double max)
{
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

} // namespace

class SliderMappingTest : public QObject
{
    Q_OBJECT
private slots:
    void calls_data();
    void calls();
    void badExpressionIsDropped();
    void copyCompilesItsOwnExpressions();
    void halfUpHitsTheDecimal();
};

// pixel (value): the value's pixel, and the round trip of the whole track.
// fine (anchor, value): the pixel at a scaling of 0.1, which stretches the
// track tenfold about the anchor, and back.
// resolution (value): the decimal steps a pixel needs there.
// drag (x, k, default or -1): the value stored for a drag from 0.123456.
// step (value, direction, level): a step on a bent track, a fraction of the
// track rounded as a drag is; on a square track it differs either side.
// snap (stepDown, stepUp, value): the value snapped to the side's step.
// round (step, value): AddHalfTruncate, the widget's snap, and RoundHalfUp,
// the control's rounding; they agree at halves and part below zero. Exact.
void SliderMappingTest::calls_data()
{
    QTest::addColumn<QByteArray>("mode");
    QTest::addColumn<double>("min");
    QTest::addColumn<double>("max");
    QTest::addColumn<QByteArray>("call");
    QTest::addColumn<QList<double>>("args");
    QTest::addColumn<QList<double>>("expected");
    const double none = -1.0, pressX = kLeft + 200 * 0.123456;
    // clang-format off
    Row("linear", "linear", 0, 1, "pixel", {0.5}, {105});
    Row("below clamps", "linear", 0, 1, "pixel", {-3}, {5});
    Row("above clamps", "linear", 0, 1, "pixel", {9}, {205});
    Row("negative range", "linear", -10, -5, "pixel", {-6}, {165});
    Row("power 2", "power 2", 0, 1, "pixel", {0.25}, {105});
    Row("power 2 about zero", "power 2", -1, 1, "pixel", {-0.25}, {55});
    Row("callbacks", "steep callbacks", 0, 1, "pixel", {0.5}, {5.1953125});
    Row("expressions", "square expressions", 0, 2, "pixel", {1}, {55});
    Row("expressions with variables", "expressions with variables", 2, 6, "pixel", {3}, {55});
    Row("two segments below", "two segments", 0, 10, "pixel", {0.5}, {55});
    Row("two segments centre", "two segments", 0, 10, "pixel", {1}, {105});
    Row("two segments above", "two segments", 0, 10, "pixel", {5.5}, {155});
    Row("fine, linear about 0", "linear", 0, 1, "fine", {0, 0.01}, {25});
    Row("fine, linear about 0.5", "linear", 0, 1, "fine", {0.5, 0.49}, {85});
    Row("fine, two segments", "two segments at 0.5", 0, 1, "fine", {0, 0.01}, {25});
    // 200 pixels need three digits across the range.
    Row("resolution, unit range", "linear", 0, 1, "resolution", {0.3}, {1000});
    Row("resolution, hundred", "linear", 0, 100, "resolution", {30}, {10});
    Row("resolution, flat range", "linear", 2, 2, "resolution", {2}, {1});
    Row("resolution, power, steep end", "power 2", 0, 1, "resolution", {0.0001}, {1e5});
    Row("resolution, power, flat end", "power 2", 0, 1, "resolution", {1}, {1000});
    // A steep mapping needs more digits where a pixel covers less of the
    // range, never more than two beyond the linear case.
    Row("resolution, callbacks, steep end", "steep callbacks", 0, 1, "resolution", {1}, {1e4});
    Row("resolution, expressions, flat end", "steep expressions", 0, 1, "resolution", {0.5}, {1000});
    Row("resolution, expressions, steep end", "steep expressions", 0, 1, "resolution", {1}, {1e4});
    Row("resolution, expressions, capped", "steepest expressions", 0, 1, "resolution", {1}, {1e5});
    Row("resolution, two segments below", "two segments", 0, 10, "resolution", {0.5}, {100});
    Row("resolution, two segments above", "two segments", 0, 10, "resolution", {5}, {100});
    Row("resolution, two segments at centre", "two segments", 0, 10, "resolution", {1}, {1});
    // 0..1 over 200 pixels is 0.005 a pixel.
    Row("drag rounded to three places", "linear", 0, 1, "drag", {125.4, 1, none}, {0.602});
    Row("drag back to the press value", "linear", 0, 1, "drag", {pressX + 0.4, 1, none}, {0.123456});
    Row("drag, the press value before the default", "linear", 0, 1, "drag", {pressX + 0.4, 1, 0.1236}, {0.123456});
    // The default lies 0.46 pixels from 0.25.
    Row("drag onto the default", "linear", 0, 1, "drag", {55, 1, 0.2523}, {0.2523});
    Row("drag past the default", "linear", 0, 1, "drag", {54.8, 1, 0.2523}, {0.249});
    Row("fine drag keeps one more place", "linear", 0, 1, "drag", {108, 0.1, none}, {0.5015});
    Row("drag beyond the end", "linear", 0, 1, "drag", {400, 1, none}, {1});
    // Near the steep end of a power track a pixel is 0.0001 wide.
    Row("power drag keeps the places a pixel needs", "power 2", 0, 1, "drag", {7.3, 1, none}, {0.00013});
    Row("step, normal, a hundredth of the track", "square expressions", 0, 1, "step", {0.5, 1, 1}, {0.01});
    Row("step, fine, one more place", "square expressions", 0, 1, "step", {0.5, 1, 0}, {0.001});
    Row("step, coarse up", "square expressions", 0, 1, "step", {0.5, 1, 2}, {0.092});
    Row("step, coarse down", "square expressions", 0, 1, "step", {0.5, -1, 2}, {0.113});
    Row("step stops at the end", "square expressions", 0, 1, "step", {0.99, 1, 2}, {0.01});
    Row("snap truncates toward zero", "linear", -10, 10, "snap", {1, 9, -2.7}, {-2});
    Row("snap, step of five", "linear", -10, 10, "snap", {5, 9, 8}, {10});
    Row("snap, negative step of five", "linear", -10, 10, "snap", {5, 9, -7}, {0});
    Row("snap below the centre", "two segments at 2.4", -10, 10, "snap", {1, 9, 1.2}, {1});
    Row("snap above the centre, the up step", "two segments at 2.4", -10, 10, "snap", {1, 3, 5}, {6});
    Row("snap crossing the centre", "two segments at 2.4", -10, 10, "snap", {4, 9, 2.3}, {2});
    Row("snap at the centre", "two segments at 2.4", -10, 10, "snap", {4, 9, 2.4}, {2});
    Row("round -2.5", "linear", 0, 1, "round", {1, -2.5}, {-2, -2});
    Row("round -0.5", "linear", 0, 1, "round", {1, -0.5}, {0, 0});
    Row("round 0.5", "linear", 0, 1, "round", {1, 0.5}, {1, 1});
    Row("round -2.7", "linear", 0, 1, "round", {1, -2.7}, {-2, -3});
    Row("round -2.2", "linear", 0, 1, "round", {1, -2.2}, {-1, -2});
    Row("round 2.2", "linear", 0, 1, "round", {1, 2.2}, {2, 2});
    Row("round quarter -0.625", "linear", 0, 1, "round", {0.25, -0.625}, {-0.5, -0.5});
    Row("round quarter -0.125", "linear", 0, 1, "round", {0.25, -0.125}, {0, 0});
    Row("round quarter 0.125", "linear", 0, 1, "round", {0.25, 0.125}, {0.25, 0.25});
    Row("round quarter -0.6", "linear", 0, 1, "round", {0.25, -0.6}, {-0.25, -0.5});
    Row("round, no step", "linear", 0, 1, "round", {0, -2.7}, {-2.7, -2.7});
    // clang-format on
}

void SliderMappingTest::calls()
{
    QFETCH(QByteArray, mode);
    QFETCH(double, min);
    QFETCH(double, max);
    QFETCH(QByteArray, call);
    QFETCH(QList<double>, args);
    QFETCH(QList<double>, expected);
    const SliderMapping m = Make(mode, min, max);
    QList<double> got;
    if (call == "pixel") {
        QVERIFY(qAbs(m.ValueToPixel(args[0]) - expected[0]) < 1e-9);
        return CheckRoundTrip(m, min, max);
    }
    if (call == "fine") {
        SliderMapping fine = m;
        fine.SetAnchor(args[0]);
        QVERIFY(qAbs(fine.ValueToPixel(args[1], 0.1) - expected[0]) < 1e-9);
        QVERIFY(qAbs(fine.PixelToValue(expected[0], 0.1) - args[1]) < 1e-12);
        return;
    }
    if (call == "resolution") {
        got << m.Resolution(args[0]);
        if (min == max)
            QCOMPARE(m.ValueToPixel(min + 7.0), kLeft);
    } else if (call == "drag") {
        SliderMapping drag = m;
        drag.SetAnchor(0.5);
        got << drag.DragValue(args[0], args[1], 0.123456, args[2] >= 0 ? std::optional<double>(args[2]) : std::nullopt);
    } else if (call == "step") {
        QVERIFY(m.HasMapping());
        got << m.TrackStep(args[0], int(args[1]), int(args[2]));
    } else if (call == "snap") {
        got << m.SnapToStep(args[2], args[0], args[1]);
    } else {
        got << SliderMapping::AddHalfTruncate(args[1], args[0]) << SliderMapping::RoundHalfUp(args[1], args[0]);
    }
    for (int i = 0; i < got.size(); ++i)
        QVERIFY2(call == "round" ? got[i] == expected[i] : Same(got[i], expected[i]),
                 qPrintable(QString::number(got[i], 'g', 17)));
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

// Decimal places give the double nearest the decimal: 0.57, not 57 * 0.01.
void SliderMappingTest::halfUpHitsTheDecimal()
{
    QVERIFY(SliderMapping::RoundHalfUp(0.5704, 0.01) == 0.57);
    QVERIFY(SliderMapping::RoundHalfUp(1.125, 0.01) == 1.13);
}

QTEST_APPLESS_MAIN(SliderMappingTest)
#include "SliderMappingTest.moc"
