#include "widgets/CustomControl.h"

#include "WidgetTestSupport.h"

#include "orbane/DIB.h"

#include <QPaintEvent>
#include <QPainter>
#include <QScreen>
#include <QtTest>

#include <memory>

using namespace Orbane;

namespace {

// A painted widget that fills what it is asked to paint with one colour.
class Probe : public CustomControl
{
public:
    Probe() : CustomControl(nullptr, ScriptVal(), TagList()) {}

    bool Begin(const QRect &r) { return BeginDraw(r); }

    QColor fill;

protected:
    void paintEvent(QPaintEvent *event) override
    {
        if (!BeginDraw(event->rect()))
            return;
        if (fill.isValid())
            BackPainter()->fillRect(event->rect(), fill);
        EndDraw();
    }
};

void ShowAndPaint(QWidget *w)
{
    w->show();
    QVERIFY(QTest::qWaitForWindowExposed(w));
    QApplication::processEvents();
}

} // namespace

// Qt offers no public way to give a screen another pixel ratio at run time;
// its own high-DPI tests use this, as the ratio of a screen a window moves to.
class QHighDpiScaling
{
public:
    static void setScreenFactor(QScreen *screen, qreal factor);
};

class CustomControlTest : public QObject
{
    Q_OBJECT
private slots:
    void backBufferFollowsSize();
    void backBufferRebuiltAtNewPixelRatio();
    void transparentClears();
    void focusTellsOwner();
};

// The back buffer exists only for a shown widget with something to paint,
// and is kept while the size stays.
void CustomControlTest::backBufferFollowsSize()
{
    Probe probe;
    probe.resize(40, 12);
    QVERIFY(!probe.Begin(QRect(0, 0, 40, 12)));
    QCOMPARE(probe.GetBackBuffer(), nullptr);
    ShowAndPaint(&probe);
    const DIB *buffer = probe.GetBackBuffer();
    QVERIFY(buffer);
    QCOMPARE(buffer->GetImage().size(), QSize(40, 12) * probe.devicePixelRatioF());
    probe.repaint();
    probe.repaint(QRect(3, 3, 5, 5));
    QVERIFY(!probe.Begin(QRect(5, 5, 0, 4)));
    QCOMPARE(probe.GetBackBuffer(), buffer);
    probe.resize(60, 14);
    probe.repaint();
    QCOMPARE(probe.GetBackBuffer()->GetImage().size(), QSize(60, 14) * probe.devicePixelRatioF());
    probe.hide();
    QVERIFY(!probe.Begin(QRect(0, 0, 60, 14)));
}

void CustomControlTest::backBufferRebuiltAtNewPixelRatio()
{
    Probe probe;
    probe.fill = Qt::red;
    probe.resize(40, 12);
    ShowAndPaint(&probe);
    const qreal before = probe.devicePixelRatioF();
    QScreen *screen = probe.screen();
    QHighDpiScaling::setScreenFactor(screen, 2.0);
    const qreal after = probe.devicePixelRatioF();
    if (after == before) {
        QHighDpiScaling::setScreenFactor(screen, 1.0);
        QSKIP("this platform cannot change the screen's pixel ratio");
    }
    probe.repaint();
    const DIB *buffer = probe.GetBackBuffer();
    QCOMPARE(buffer->PixelRatio(), after);
    QCOMPARE(buffer->GetImage().size(), QSize(40, 12) * after);
    QCOMPARE(buffer->GetImage().pixelColor(int(39 * after), int(11 * after)), QColor(Qt::red));
    QHighDpiScaling::setScreenFactor(screen, 1.0);
}

// Opaque widgets fill with the owner's background before painting (the
// slider's pixel tests check that), transparent ones clear to nothing.
void CustomControlTest::transparentClears()
{
    Probe probe;
    probe.SetOpaque(false);
    probe.resize(20, 10);
    ShowAndPaint(&probe);
    QVERIFY(!probe.testAttribute(Qt::WA_OpaquePaintEvent));
    QCOMPARE(qAlpha(probe.GetBackBuffer()->GetImage().pixel(3, 3)), 0);
}

// Focus changes ask the owner to update its display. An owner destroyed
// with the focus inside hides its window half destroyed, and the focus leaves
// then: nothing may reach the owner.
void CustomControlTest::focusTellsOwner()
{
    auto owner = std::make_unique<TestOwner>();
    Probe *probe = new Probe;
    probe->setParent(owner.get());
    probe->SetOwner(owner.get());
    probe->setFocusPolicy(Qt::StrongFocus);
    QWidget *other = new QWidget(owner.get());
    other->setFocusPolicy(Qt::StrongFocus);
    ShowAndPaint(owner.get());
    QApplication::setActiveWindow(owner.get());
    other->setFocus();
    QApplication::processEvents();
    owner->updateDisplays = 0;
    probe->setFocus();
    QTRY_COMPARE(owner->updateDisplays, 1);
    other->setFocus();
    QTRY_COMPARE(owner->updateDisplays, 2);
    probe->setFocus();
    QVERIFY(probe->hasFocus());
    QPointer<Probe> watch(probe);
    owner.reset();
    QApplication::processEvents();
    QVERIFY(watch.isNull());
}

QTEST_MAIN(CustomControlTest)
#include "CustomControlTest.moc"
