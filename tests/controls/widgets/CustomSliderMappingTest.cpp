#include "SliderFixture.h"

#include <QtTest>

#include <cmath>

using namespace Orbane;

namespace {

enum Mode
{
    Linear,
    Squared,
    Cubed,
    TwoSegment,
    Callback,
    Expression,
    ExpressionVars,
    Steep,
    SteepExpression,
    Steepest
};

double Cube(double v, void *)
{
    return v * v * v;
}
double CubeRoot(double t, void *)
{
    return std::cbrt(t);
}
double Pow10(double v, void *)
{
    return std::pow(v, 10.0);
}
double Root10(double t, void *)
{
    return std::pow(t, 0.1);
}

// Sets the mapping of each mode: squared and cubed are the power mapping
// with exponents 1/2 and 1/3 over the track, callbacks and expressions give
// the same curves by other routes.
void Apply(CustomSlider *s, int mode)
{
    switch (mode) {
    case Squared:
        s->SetExponent(2.0);
        break;
    case Cubed:
        s->SetMappingCallbacks(Cube, nullptr, CubeRoot, nullptr);
        break;
    case TwoSegment:
        s->SetCentre(1.0);
        break;
    case Callback:
        s->SetMappingCallbacks(Cube, nullptr, CubeRoot, nullptr);
        break;
    case Expression:
        QVERIFY(s->SetMappingExpressions("value*value", "sqrt(value)"));
        break;
    case Steep:
        s->SetMappingCallbacks(Pow10, nullptr, Root10, nullptr);
        break;
    case SteepExpression:
        QVERIFY(s->SetMappingExpressions("value^10", "value^0.1"));
        break;
    case Steepest:
        QVERIFY(s->SetMappingExpressions("value^1000", "value^0.001"));
        break;
    case ExpressionVars:
        QVERIFY(s->SetMappingExpressions("(value-minscale)/(maxscale-minscale)", "minscale+value*(maxscale-minscale)"));
        break;
    default:
        break;
    }
}

} // namespace

class CustomSliderMappingTest : public QObject
{
    Q_OBJECT
private slots:
    void pixelLimits();
    void valueToPixel_data();
    void valueToPixel();
    void roundTrip_data();
    void roundTrip();
    void fineScaling();
    void flatRange();
    void resolution_data();
    void resolution();
    void badExpressionIsDropped();
    void mapValue_data();
    void mapValue();
    void rangeKeepsWidenedScale();
    void rangeOrdersAndClamps();
    void scaleKeptInsideAllowed();
    void allowedRangeNarrowsScale();
    void tickCount_data();
    void tickCount();
    void centreAtAnEndStaysLinear();
    void stepCount();
};

void CustomSliderMappingTest::pixelLimits()
{
    SliderFixture f;
    QCOMPARE(f.slider->PixelMin(), 5.0);
    QCOMPARE(f.slider->PixelMax(), 205.0);
    QCOMPARE(f.slider->PixelCentre(), 105.0);
    f.slider->SetTrackRect(OrbRectT<int32>(0, 0, 111, 24));
    QCOMPARE(f.slider->PixelMax(), 105.0);
    // A widget narrower than the knob keeps a track of no length.
    f.slider->SetTrackRect(OrbRectT<int32>(0, 0, 6, 24));
    QCOMPARE(f.slider->PixelMax(), f.slider->PixelMin());
}

void CustomSliderMappingTest::valueToPixel_data()
{
    QTest::addColumn<int>("mode");
    QTest::addColumn<double>("min");
    QTest::addColumn<double>("max");
    QTest::addColumn<double>("value");
    QTest::addColumn<double>("pixel");
    QTest::newRow("linear start") << int(Linear) << 0.0 << 1.0 << 0.0 << 5.0;
    QTest::newRow("linear middle") << int(Linear) << 0.0 << 1.0 << 0.5 << 105.0;
    QTest::newRow("linear end") << int(Linear) << 0.0 << 1.0 << 1.0 << 205.0;
    QTest::newRow("below clamps") << int(Linear) << 0.0 << 1.0 << -3.0 << 5.0;
    QTest::newRow("above clamps") << int(Linear) << 0.0 << 1.0 << 9.0 << 205.0;
    QTest::newRow("negative range") << int(Linear) << -10.0 << -5.0 << -6.0 << 165.0;
    QTest::newRow("exponent 2") << int(Squared) << 0.0 << 1.0 << 0.25 << 105.0;
    QTest::newRow("exponent 2 about zero") << int(Squared) << -1.0 << 1.0 << -0.25 << 55.0;
    QTest::newRow("callback") << int(Callback) << 0.0 << 2.0 << 1.0 << 30.0;
    QTest::newRow("expression") << int(Expression) << 0.0 << 2.0 << 1.0 << 55.0;
    QTest::newRow("expression with variables") << int(ExpressionVars) << 2.0 << 6.0 << 3.0 << 55.0;
    QTest::newRow("two segments below") << int(TwoSegment) << 0.0 << 10.0 << 0.5 << 55.0;
    QTest::newRow("two segments centre") << int(TwoSegment) << 0.0 << 10.0 << 1.0 << 105.0;
    QTest::newRow("two segments above") << int(TwoSegment) << 0.0 << 10.0 << 5.5 << 155.0;
    QTest::newRow("two segments end") << int(TwoSegment) << 0.0 << 10.0 << 10.0 << 205.0;
}

void CustomSliderMappingTest::valueToPixel()
{
    QFETCH(int, mode);
    QFETCH(double, min);
    QFETCH(double, max);
    QFETCH(double, value);
    QFETCH(double, pixel);
    SliderFixture f(min, max);
    Apply(f.slider, mode);
    QVERIFY(qAbs(f.slider->ValueToPixel(value) - pixel) < 1e-9);
}

void CustomSliderMappingTest::roundTrip_data()
{
    QTest::addColumn<int>("mode");
    QTest::addColumn<double>("min");
    QTest::addColumn<double>("max");
    QTest::newRow("linear") << int(Linear) << -3.0 << 7.0;
    QTest::newRow("exponent") << int(Squared) << -1.0 << 4.0;
    QTest::newRow("callback") << int(Cubed) << -2.0 << 2.0;
    QTest::newRow("expression") << int(Expression) << 0.0 << 5.0;
    QTest::newRow("expression with variables") << int(ExpressionVars) << 1.0 << 3.0;
    QTest::newRow("two segments") << int(TwoSegment) << 0.0 << 10.0;
}

void CustomSliderMappingTest::roundTrip()
{
    QFETCH(int, mode);
    QFETCH(double, min);
    QFETCH(double, max);
    SliderFixture f(min, max);
    Apply(f.slider, mode);
    for (double x = 5.0; x <= 205.0; x += 2.5) {
        const double v = f.slider->PixelToValue(x);
        QVERIFY(v >= min - 1e-9 && v <= max + 1e-9);
        QVERIFY2(qAbs(f.slider->ValueToPixel(v) - x) < 1e-6, qPrintable(QString::number(x)));
    }
    // Beyond the track the value stops at the range's ends.
    if (mode != TwoSegment) {
        QVERIFY(qAbs(f.slider->PixelToValue(-50.0) - min) < 1e-9);
        QVERIFY(qAbs(f.slider->PixelToValue(400.0) - max) < 1e-9);
    }
}

void CustomSliderMappingTest::fineScaling()
{
    SliderFixture f; // the anchor starts at 0
    QCOMPARE(f.slider->ValueToPixel(0.01, 0.1), 25.0);
    QCOMPARE(f.slider->ValueToPixel(0.01, 1.0), 7.0);
    QVERIFY(qAbs(f.slider->PixelToValue(25.0, 0.1) - 0.01) < 1e-12);
    f.slider->SetCentre(0.5);
    QVERIFY(qAbs(f.slider->ValueToPixel(0.01, 0.1) - 25.0) < 1e-9);
    QVERIFY(qAbs(f.slider->PixelToValue(25.0, 0.1) - 0.01) < 1e-12);
}

void CustomSliderMappingTest::flatRange()
{
    SliderFixture f(2.0, 2.0);
    QCOMPARE(f.slider->ValueToPixel(-5.0), 5.0);
    QCOMPARE(f.slider->ValueToPixel(2.0), 5.0);
    QCOMPARE(f.slider->ValueToPixel(7.0), 5.0);
    QCOMPARE(f.slider->Resolution(2.0), 1.0);
}

void CustomSliderMappingTest::resolution_data()
{
    QTest::addColumn<int>("mode");
    QTest::addColumn<double>("min");
    QTest::addColumn<double>("max");
    QTest::addColumn<double>("value");
    QTest::addColumn<double>("resolution");
    // 200 pixels need three digits across the range.
    QTest::newRow("unit range") << int(Linear) << 0.0 << 1.0 << 0.3 << 1000.0;
    QTest::newRow("hundred") << int(Linear) << 0.0 << 100.0 << 30.0 << 10.0;
    QTest::newRow("hundredth") << int(Linear) << 0.0 << 0.01 << 0.003 << 1e5;
    QTest::newRow("exponent, steep end") << int(Squared) << 0.0 << 1.0 << 0.0001 << 1e5;
    QTest::newRow("exponent, flat end") << int(Squared) << 0.0 << 1.0 << 1.0 << 1000.0;
    // A steep mapping needs more digits where a pixel covers less of the
    // range, never more than two beyond the linear case.
    QTest::newRow("callback, steep end") << int(Steep) << 0.0 << 1.0 << 1.0 << 1e4;
    QTest::newRow("callback, flat end") << int(Steep) << 0.0 << 1.0 << 0.5 << 1000.0;
    QTest::newRow("expression, steep end") << int(SteepExpression) << 0.0 << 1.0 << 1.0 << 1e4;
    QTest::newRow("expression, capped") << int(Steepest) << 0.0 << 1.0 << 1.0 << 1e5;
    QTest::newRow("two segments below") << int(TwoSegment) << 0.0 << 10.0 << 0.5 << 100.0;
    QTest::newRow("two segments above") << int(TwoSegment) << 0.0 << 10.0 << 5.0 << 100.0;
    QTest::newRow("two segments at centre") << int(TwoSegment) << 0.0 << 10.0 << 1.0 << 1.0;
    QTest::newRow("wide two segments") << int(TwoSegment) << -100.0 << 100.0 << -50.0 << 1.0;
}

void CustomSliderMappingTest::resolution()
{
    QFETCH(int, mode);
    QFETCH(double, min);
    QFETCH(double, max);
    QFETCH(double, value);
    QFETCH(double, resolution);
    SliderFixture f(min, max);
    Apply(f.slider, mode);
    if (mode == TwoSegment && min == -100.0)
        f.slider->SetCentre(0.0);
    QCOMPARE(f.slider->Resolution(value), resolution);
}

void CustomSliderMappingTest::badExpressionIsDropped()
{
    SliderFixture f;
    QVERIFY(!f.slider->SetMappingExpressions("value*", "value"));
    QVERIFY(f.slider->GetForwardExpression().IsEmpty());
    QCOMPARE(f.slider->ValueToPixel(0.5), 105.0);
    QVERIFY(!f.slider->SetMappingExpressions("nosuchvar", ""));
    QCOMPARE(f.slider->ValueToPixel(0.5), 105.0);
}

void CustomSliderMappingTest::mapValue_data()
{
    QTest::addColumn<bool>("integer");
    QTest::addColumn<bool>("snap");
    QTest::addColumn<double>("centre");
    QTest::addColumn<double>("stepDown");
    QTest::addColumn<double>("value");
    QTest::addColumn<double>("mapped");
    const double linear = -100.0; // no centre inside the range
    QTest::newRow("truncates toward zero") << true << true << linear << 1.0 << -2.7 << -2.0;
    QTest::newRow("positive rounds half up") << true << true << linear << 1.0 << 2.7 << 3.0;
    QTest::newRow("positive below half") << true << true << linear << 1.0 << 2.4 << 2.0;
    QTest::newRow("step of five") << true << true << linear << 5.0 << 8.0 << 10.0;
    QTest::newRow("negative step of five") << true << true << linear << 5.0 << -7.0 << 0.0;
    QTest::newRow("integer alone keeps value") << true << false << linear << 1.0 << -2.7 << -2.7;
    QTest::newRow("snap alone keeps value") << false << true << linear << 1.0 << -2.7 << -2.7;
    QTest::newRow("at the centre") << true << true << 2.4 << 1.0 << 2.4 << 2.0;
    QTest::newRow("below the centre") << true << true << 2.4 << 1.0 << 1.2 << 1.0;
    QTest::newRow("crossing the centre") << true << true << 2.4 << 4.0 << 2.3 << 2.0;
}

void CustomSliderMappingTest::mapValue()
{
    QFETCH(bool, integer);
    QFETCH(bool, snap);
    QFETCH(double, centre);
    QFETCH(double, stepDown);
    QFETCH(double, value);
    QFETCH(double, mapped);
    SliderFixture f(-10.0, 10.0);
    if (centre > -10.0)
        f.slider->SetCentre(centre);
    f.slider->SetInteger(integer);
    f.slider->SetSnapToStep(snap);
    f.slider->SetStepsDown(0.1, stepDown, 5.0);
    QCOMPARE(f.slider->MapValue(value), mapped);
}

void CustomSliderMappingTest::rangeKeepsWidenedScale()
{
    SliderFixture f(-100.0, 100.0);
    f.slider->SetRange(0.0, 1.0);
    QCOMPARE(f.slider->GetMinScale(), 0.0);
    QCOMPARE(f.slider->GetMaxScale(), 1.0);
    f.slider->SetScale(-1.0, 2.0, false); // the user widened it
    f.slider->SetRange(0.0, 1.0);
    QCOMPARE(f.slider->GetMinScale(), -1.0);
    QCOMPARE(f.slider->GetMaxScale(), 2.0);
    f.slider->SetRange(0.0, 5.0);
    QCOMPARE(f.slider->GetMinScale(), -1.0);
    QCOMPARE(f.slider->GetMaxScale(), 5.0);
}

void CustomSliderMappingTest::rangeOrdersAndClamps()
{
    SliderFixture f(-100.0, 100.0);
    f.slider->SetValue(50.0, false);
    f.slider->SetCentre(-60.0);
    f.slider->SetRange(10.0, -10.0);
    QCOMPARE(f.slider->GetMinScale(), -10.0);
    QCOMPARE(f.slider->GetMaxScale(), 10.0);
    QCOMPARE(f.slider->GetValue(), 10.0);
    QCOMPARE(f.slider->GetCentre(), -10.0);
}

void CustomSliderMappingTest::scaleKeptInsideAllowed()
{
    SliderFixture f(0.0, 10.0);
    f.slider->SetScale(20.0, -5.0, false);
    QCOMPARE(f.slider->GetMinScale(), 0.0);
    QCOMPARE(f.slider->GetMaxScale(), 10.0);
    f.slider->SetScale(2.0, 3.0, false);
    QCOMPARE(f.slider->GetMinScale(), 2.0);
    QCOMPARE(f.slider->GetMaxScale(), 3.0);
}

void CustomSliderMappingTest::allowedRangeNarrowsScale()
{
    SliderFixture f(0.0, 10.0);
    f.slider->SetAllowedRange(8.0, 1.0, false);
    QCOMPARE(f.slider->GetMinAllowed(), 1.0);
    QCOMPARE(f.slider->GetMaxAllowed(), 8.0);
    QCOMPARE(f.slider->GetMinScale(), 1.0);
    QCOMPARE(f.slider->GetMaxScale(), 8.0);
    f.slider->SetAllowedRange(0.0, 100.0, false);
    QCOMPARE(f.slider->GetMaxScale(), 8.0);
}

void CustomSliderMappingTest::tickCount_data()
{
    QTest::addColumn<double>("centre");
    QTest::addColumn<int>("ticks");
    QTest::addColumn<double>("down");
    QTest::addColumn<double>("up");
    QTest::addColumn<int>("kept");
    QTest::newRow("none changes nothing") << -1.0 << 0 << 1.0 << 1.0 << 0;
    QTest::newRow("one becomes two") << -1.0 << 1 << 8.0 << 8.0 << 2;
    QTest::newRow("five") << -1.0 << 5 << 2.0 << 2.0 << 5;
    QTest::newRow("two segments") << 2.0 << 5 << 0.5 << 1.5 << 5;
}

void CustomSliderMappingTest::tickCount()
{
    QFETCH(double, centre);
    QFETCH(int, ticks);
    QFETCH(double, down);
    QFETCH(double, up);
    QFETCH(int, kept);
    SliderFixture f(0.0, 8.0);
    if (centre >= 0.0)
        f.slider->SetCentre(centre);
    f.slider->SetTickCount(ticks);
    QCOMPARE(f.slider->GetStepDown(CustomSlider::STEP_Coarse), down);
    QCOMPARE(f.slider->GetStepUp(CustomSlider::STEP_Coarse), up);
    QCOMPARE(f.slider->GetTickCount(), kept);
    QCOMPARE(f.slider->GetStepDown(CustomSlider::STEP_Normal), 1.0);
}

void CustomSliderMappingTest::centreAtAnEndStaysLinear()
{
    SliderFixture f(0.0, 8.0);
    f.slider->SetCentre(0.0);
    QVERIFY(!f.slider->IsTwoSegment());
    f.slider->SetCentre(8.0);
    QVERIFY(!f.slider->IsTwoSegment());
    f.slider->SetCentre(3.0);
    QVERIFY(f.slider->IsTwoSegment());
}

void CustomSliderMappingTest::stepCount()
{
    SliderFixture f(0.0, 8.0);
    f.slider->SetStepCount(0);
    QCOMPARE(f.slider->GetStepDown(CustomSlider::STEP_Normal), 1.0);
    f.slider->SetStepCount(16);
    QCOMPARE(f.slider->GetStepDown(CustomSlider::STEP_Normal), 0.5);
    QCOMPARE(f.slider->GetStepDown(CustomSlider::STEP_Fine), 0.05);
    f.slider->SetCentre(2.0);
    f.slider->SetStepCount(4);
    QCOMPARE(f.slider->GetStepDown(CustomSlider::STEP_Normal), 0.5);
    QCOMPARE(f.slider->GetStepUp(CustomSlider::STEP_Normal), 1.5);
}

QTEST_MAIN(CustomSliderMappingTest)
#include "CustomSliderMappingTest.moc"
