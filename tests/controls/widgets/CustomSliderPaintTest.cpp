#include "SliderFixture.h"
#include "WidgetTestSupport.h"

#include "orbane/Gradient.h"

#include <QPaintEvent>
#include <QtTest>

using namespace Orbane;

namespace {

// Records the rectangles it is asked to paint.
class RecordingSlider : public CustomSlider
{
public:
    QList<QRect> painted;

protected:
    void paintEvent(QPaintEvent *event) override
    {
        painted << event->rect();
        CustomSlider::paintEvent(event);
    }
};

struct Painted
{
    TestOwner owner;
    SliderFixture f;
    CustomSlider *s;

    Painted() : s(f.slider)
    {
        s->setParent(&owner);
        s->SetOwner(&owner);
        owner.resize(SliderFixture::Width, SliderFixture::Height);
        owner.show();
        QVERIFY(QTest::qWaitForWindowExposed(&owner));
    }
    int KnobY() const { return s->GetTrackRect().y1 + s->GetKnobTop() + 7; }
    QColor Pixel(int x, int y) const
    {
        const qreal r = s->devicePixelRatioF();
        return s->grab().toImage().pixelColor(int(x * r), int(y * r));
    }
};

bool Close(const QColor &a, const QColor &b, int tol = 3)
{
    return qAbs(a.red() - b.red()) <= tol && qAbs(a.green() - b.green()) <= tol && qAbs(a.blue() - b.blue()) <= tol;
}

} // namespace

class CustomSliderPaintTest : public QObject
{
    Q_OBJECT
private slots:
    void knobDrawnAtValue();
    void heldKnobUsesItsImage();
    void hoveredKnobIsLighter();
    void disabledKnobIsFaded();
    void markerOnlyAwayFromDefault();
    void gradientPaintsTrack();
    void secondGradientRightOfCentre();
    void valueChangeRepaintsOnlyTheKnob();
    void sameValueRepaintsNothing();
    void backBufferKeptAcrossValues();
};

void CustomSliderPaintTest::knobDrawnAtValue()
{
    Painted w;
    w.s->SetValue(0.2, true);
    QVERIFY(Close(w.Pixel(45, w.KnobY()), QColor(200, 200, 200)));
    QVERIFY(Close(w.Pixel(45, 0), w.owner.background));
    w.s->SetValue(0.8, true);
    QVERIFY(Close(w.Pixel(165, w.KnobY()), QColor(200, 200, 200)));
    QVERIFY(!Close(w.Pixel(45, w.KnobY()), QColor(200, 200, 200)));
}

void CustomSliderPaintTest::heldKnobUsesItsImage()
{
    Painted w;
    w.s->SetValue(0.5, true);
    QTest::mousePress(w.s, Qt::LeftButton, Qt::NoModifier, QPoint(105, w.KnobY()));
    QVERIFY(Close(w.Pixel(105, w.KnobY()), QColor(240, 160, 60)));
    QTest::mouseRelease(w.s, Qt::LeftButton, Qt::NoModifier, QPoint(105, w.KnobY()));
    QEvent leave(QEvent::Leave); // still over the knob it would be lit
    QApplication::sendEvent(w.s, &leave);
    QVERIFY(Close(w.Pixel(105, w.KnobY()), QColor(200, 200, 200)));
}

void CustomSliderPaintTest::hoveredKnobIsLighter()
{
    Painted w;
    w.s->SetValue(0.5, true);
    QEvent enter(QEvent::Enter); // hover needs the tracking that entering turns on
    QApplication::sendEvent(w.s, &enter);
    MoveMouse(w.s, QPoint(105, w.KnobY()), Qt::NoModifier, Qt::NoButton);
    QVERIFY(w.s->IsHoverKnob());
    const QColor lit = w.Pixel(105, w.KnobY());
    QVERIFY(lit.lightness() > QColor(200, 200, 200).lightness() + 10);
}

void CustomSliderPaintTest::disabledKnobIsFaded()
{
    Painted w;
    w.s->SetValue(0.5, true);
    w.s->SetDisabled(true);
    const QColor faded = w.Pixel(105, w.KnobY());
    QVERIFY(!Close(faded, QColor(200, 200, 200)));
    QVERIFY(faded.lightness() < QColor(200, 200, 200).lightness());
    w.s->SetDisabled(false);
    QVERIFY(Close(w.Pixel(105, w.KnobY()), QColor(200, 200, 200)));
}

void CustomSliderPaintTest::markerOnlyAwayFromDefault()
{
    Painted w;
    w.s->SetDefault(0.3, true);
    w.s->SetValue(0.8, true);
    const int markerY = w.s->GetTrackRect().y1 + w.s->GetResetTop() + 2;
    QVERIFY(Close(w.Pixel(65, markerY), QColor(150, 150, 150)));
    w.s->SetValue(0.3, true);
    QVERIFY(Close(w.Pixel(65, markerY), w.owner.background));
}

void CustomSliderPaintTest::gradientPaintsTrack()
{
    Painted w;
    w.s->SetValue(0.5, true);
    const int trackY = w.KnobY();
    const QColor plain = w.Pixel(20, trackY);
    Gradient *ramp = new Gradient;
    ramp->AddStop(0.0, {1, 0, 0, 1});
    ramp->AddStop(1.0, {0, 0, 1, 1});
    w.s->SetGradients(ramp, nullptr);
    ramp->DecRef();
    const QColor left = w.Pixel(20, trackY), right = w.Pixel(190, trackY);
    QVERIFY(!Close(left, plain));
    QVERIFY(left.red() > 200 && left.blue() < 60);
    QVERIFY(right.blue() > 200 && right.red() < 60);
    w.s->SetColorSpaces(GCS_HSV, GCS_RGB);
    QVERIFY(w.Pixel(105 - 20, trackY).green() < 40); // hue runs through magenta, never green
    w.s->SetGradients(nullptr, nullptr);
    QVERIFY(Close(w.Pixel(20, trackY), plain));
}

void CustomSliderPaintTest::secondGradientRightOfCentre()
{
    Painted w;
    w.s->SetCentre(0.5);
    w.s->SetValue(0.5, true);
    Gradient *left = new Gradient, *right = new Gradient;
    left->AddStop(0.0, {1, 0, 0, 1});
    left->AddStop(1.0, {1, 0, 0, 1});
    right->AddStop(0.0, {0, 1, 0, 1});
    right->AddStop(1.0, {0, 1, 0, 1});
    w.s->SetGradients(left, right);
    left->DecRef();
    right->DecRef();
    QVERIFY(w.Pixel(40, w.KnobY()).red() > 200);
    QVERIFY(w.Pixel(170, w.KnobY()).green() > 200);
}

void CustomSliderPaintTest::valueChangeRepaintsOnlyTheKnob()
{
    TestOwner owner;
    RecordingSlider *s = new RecordingSlider;
    s->setParent(&owner);
    s->SetOwner(&owner);
    s->SetAllowedRange(0.0, 1.0, false);
    s->SetScale(0.0, 1.0, false);
    s->resize(SliderFixture::Width, SliderFixture::Height);
    owner.resize(SliderFixture::Width, SliderFixture::Height);
    owner.show();
    QVERIFY(QTest::qWaitForWindowExposed(&owner));
    s->SetValue(0.5, true);
    QApplication::processEvents();
    s->painted.clear();
    s->SetValue(0.55, true); // the knob moves 10 pixels
    QApplication::processEvents();
    QCOMPARE(s->painted.size(), 1);
    const QRect r = s->painted.first();
    const int knobW = s->GetKnobRect().Width();
    QCOMPARE(r.height(), s->GetKnobRect().Height());
    QCOMPARE(r.width(), knobW + 2 + 10);
    QCOMPARE(r.left(), s->KnobX() - 10 + s->GetKnobRect().x1 - 1);
}

void CustomSliderPaintTest::sameValueRepaintsNothing()
{
    TestOwner owner;
    RecordingSlider *s = new RecordingSlider;
    s->setParent(&owner);
    s->resize(SliderFixture::Width, SliderFixture::Height);
    owner.show();
    QVERIFY(QTest::qWaitForWindowExposed(&owner));
    s->SetValue(0.5, true);
    QApplication::processEvents();
    s->painted.clear();
    s->SetValue(0.5, true);
    s->SetDisabled(false);
    QApplication::processEvents();
    QCOMPARE(s->painted.size(), 0);
}

void CustomSliderPaintTest::backBufferKeptAcrossValues()
{
    Painted w;
    w.s->repaint();
    const DIB *buffer = w.s->GetBackBuffer();
    QVERIFY(buffer);
    for (double v = 0.0; v <= 1.0; v += 0.125) {
        w.s->SetValue(v, true);
        w.s->repaint();
    }
    QCOMPARE(w.s->GetBackBuffer(), buffer);
}

QTEST_MAIN(CustomSliderPaintTest)
#include "CustomSliderPaintTest.moc"
