#include "widgets/CustomControl.h"

#include "WidgetTestSupport.h"

#include "orbane/DIB.h"
#include "orbane/OrbaneEvent.h"

#include <QPaintEvent>
#include <QPainter>
#include <QScreen>
#include <QtTest>

using namespace Orbane;

namespace {

// A painted widget that fills what it is asked to paint with one colour and
// keeps count of what happens to it.
class Probe : public CustomControl
{
public:
    Probe() : CustomControl(nullptr, ScriptVal(), TagList()) {}

    bool Begin(const QRect &r) { return BeginDraw(r); }
    void End() { EndDraw(); }

    int paints = 0;
    int notifies = 0;
    QSize lastSize;
    QColor fill;

    void OnSize(int32 w, int32 h) override { lastSize = QSize(w, h); }
    uint64 HandleNotify(uint32 id, uint64 a, uint64 b) override
    {
        ++notifies;
        return CustomControl::HandleNotify(id, a, b);
    }

protected:
    void paintEvent(QPaintEvent *event) override
    {
        ++paints;
        if (!BeginDraw(event->rect()))
            return;
        if (fill.isValid())
            BackPainter()->fillRect(event->rect(), fill);
        EndDraw();
    }
};

// A parent that answers forwarded notifications.
class Parent : public QWidget
{
public:
    int received = 0;

protected:
    void customEvent(QEvent *event) override
    {
        if (event->type() != OrbaneEvent::EventType())
            return;
        auto *e = static_cast<OrbaneEvent *>(event);
        ++received;
        e->SetResult(e->Param1() * 1000 + e->Param2());
    }
};

void ShowAndPaint(QWidget *w)
{
    w->show();
    QVERIFY(QTest::qWaitForWindowExposed(w));
    QApplication::processEvents();
}

QColor GrabbedAt(QWidget *w, int x, int y)
{
    return w->grab().toImage().pixelColor(int(x * w->devicePixelRatioF()), int(y * w->devicePixelRatioF()));
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
    void construction();
    void backBufferMatchesWidget();
    void backBufferKeptWhileSizeStays();
    void backBufferRebuiltOnResize();
    void backBufferRebuiltAtNewPixelRatio();
    void nothingDrawnHiddenOrEmpty();
    void opaqueFillsWithOwnerBackground();
    void transparentClears();
    void disabledRepaintsOnlyOnChange();
    void focusTellsOwner();
    void ownerDestroyedWithFocusInside();
    void resizeCallsOnSize();
    void notifyForwardsToParent();
    void otherNotifyAnswersZeroHandled();
    void handledNotifyIsLeftAlone();
};

void CustomControlTest::construction()
{
    Probe probe;
    QVERIFY(probe.testAttribute(Qt::WA_OpaquePaintEvent));
    QVERIFY(probe.testAttribute(Qt::WA_NoSystemBackground));
    QVERIFY(probe.IsOpaque());
    QVERIFY(!probe.IsDisabled());
    QCOMPARE(probe.GetOwner(), nullptr);
    QCOMPARE(probe.GetBackBuffer(), nullptr);
    QCOMPARE(probe.SizeOf(), sizeof(CustomControl));
    QVERIFY(probe.metaObject()->inherits(&QWidget::staticMetaObject));
    QCOMPARE(probe.metaObject()->className(), "Orbane::CustomControl");
}

void CustomControlTest::backBufferMatchesWidget()
{
    Probe probe;
    probe.resize(40, 12);
    ShowAndPaint(&probe);
    const DIB *buffer = probe.GetBackBuffer();
    QVERIFY(buffer);
    QCOMPARE(buffer->Width(), 40);
    QCOMPARE(buffer->Height(), 12);
    QCOMPARE(buffer->PixelRatio(), probe.devicePixelRatioF());
    QCOMPARE(buffer->GetImage().size(), QSize(40, 12) * probe.devicePixelRatioF());
}

void CustomControlTest::backBufferKeptWhileSizeStays()
{
    Probe probe;
    probe.resize(40, 12);
    ShowAndPaint(&probe);
    const DIB *buffer = probe.GetBackBuffer();
    const int paints = probe.paints;
    probe.repaint();
    probe.repaint(QRect(3, 3, 5, 5));
    QCOMPARE(probe.paints, paints + 2);
    QCOMPARE(probe.GetBackBuffer(), buffer);
}

void CustomControlTest::backBufferRebuiltOnResize()
{
    Probe probe;
    probe.resize(40, 12);
    ShowAndPaint(&probe);
    probe.resize(60, 12);
    probe.repaint();
    QCOMPARE(probe.GetBackBuffer()->Width(), 60);
    QCOMPARE(probe.GetBackBuffer()->GetImage().width(), int(60 * probe.devicePixelRatioF()));
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

void CustomControlTest::nothingDrawnHiddenOrEmpty()
{
    Probe probe;
    probe.resize(20, 10);
    QVERIFY(!probe.Begin(QRect(0, 0, 20, 10))); // never shown
    QCOMPARE(probe.GetBackBuffer(), nullptr);
    ShowAndPaint(&probe);
    const DIB *buffer = probe.GetBackBuffer();
    QVERIFY(!probe.Begin(QRect(5, 5, 0, 4)));
    QVERIFY(!probe.Begin(QRect(5, 5, 4, 0)));
    QCOMPARE(probe.GetBackBuffer(), buffer);
    probe.hide();
    QVERIFY(!probe.Begin(QRect(0, 0, 20, 10)));
    QCOMPARE(probe.GetBackBuffer(), buffer);
}

void CustomControlTest::opaqueFillsWithOwnerBackground()
{
    TestOwner owner;
    owner.resize(50, 20);
    Probe *probe = new Probe;
    probe->setParent(&owner);
    probe->SetOwner(&owner);
    probe->setGeometry(0, 0, 50, 20);
    ShowAndPaint(&owner);
    QCOMPARE(GrabbedAt(probe, 25, 10), owner.background);
    owner.background = QColor(200, 10, 10);
    probe->repaint();
    QCOMPARE(GrabbedAt(probe, 25, 10), owner.background);
}

void CustomControlTest::transparentClears()
{
    Probe probe;
    probe.SetOpaque(false);
    QVERIFY(!probe.testAttribute(Qt::WA_OpaquePaintEvent));
    probe.resize(20, 10);
    ShowAndPaint(&probe);
    QVERIFY(!probe.testAttribute(Qt::WA_OpaquePaintEvent));
    QCOMPARE(qAlpha(probe.GetBackBuffer()->GetImage().pixel(3, 3)), 0);
}

void CustomControlTest::disabledRepaintsOnlyOnChange()
{
    Probe probe;
    probe.resize(20, 10);
    ShowAndPaint(&probe);
    const int paints = probe.paints;
    probe.SetDisabled(false);
    QApplication::processEvents();
    QCOMPARE(probe.paints, paints);
    probe.SetDisabled(true);
    QApplication::processEvents();
    QCOMPARE(probe.paints, paints + 1);
    QVERIFY(probe.IsDisabled());
    probe.SetDisabled(true);
    QApplication::processEvents();
    QCOMPARE(probe.paints, paints + 1);
}

void CustomControlTest::focusTellsOwner()
{
    TestOwner owner;
    Probe *probe = new Probe;
    probe->setParent(&owner);
    probe->SetOwner(&owner);
    probe->setFocusPolicy(Qt::StrongFocus);
    QWidget *other = new QWidget(&owner);
    other->setFocusPolicy(Qt::StrongFocus);
    ShowAndPaint(&owner);
    QApplication::setActiveWindow(&owner);
    other->setFocus();
    QApplication::processEvents();
    owner.updateDisplays = 0;
    probe->setFocus();
    QTRY_COMPARE(owner.updateDisplays, 1);
    other->setFocus();
    QTRY_COMPARE(owner.updateDisplays, 2);
}

void CustomControlTest::ownerDestroyedWithFocusInside()
{
    // The owner's window hides while the owner is half destroyed, and the
    // focus leaves the widget then: nothing may reach the owner.
    TestOwner *owner = new TestOwner;
    Probe *probe = new Probe;
    probe->setParent(owner);
    probe->SetOwner(owner);
    probe->setFocusPolicy(Qt::StrongFocus);
    ShowAndPaint(owner);
    QApplication::setActiveWindow(owner);
    probe->setFocus();
    QVERIFY(probe->hasFocus());
    QPointer<Probe> watch(probe);
    delete owner;
    QApplication::processEvents();
    QVERIFY(watch.isNull());
}

void CustomControlTest::resizeCallsOnSize()
{
    Probe probe;
    probe.resize(30, 10);
    ShowAndPaint(&probe);
    probe.resize(33, 14);
    QCOMPARE(probe.lastSize, QSize(33, 14));
}

void CustomControlTest::notifyForwardsToParent()
{
    Parent parent;
    Probe *probe = new Probe;
    probe->setParent(&parent);
    QCOMPARE(OrbaneEvent::Send(probe, CustomControl::NOTIFY_ToParent, 7, 9), 7009u);
    QCOMPARE(parent.received, 1);
    Probe orphan;
    QCOMPARE(OrbaneEvent::Send(&orphan, CustomControl::NOTIFY_ToParent, 7, 9), 0u);
}

void CustomControlTest::otherNotifyAnswersZeroHandled()
{
    Parent parent;
    Probe *probe = new Probe;
    probe->setParent(&parent);
    OrbaneEvent event(5174, 1, 2);
    event.SetResult(99);
    QApplication::sendEvent(probe, &event);
    QVERIFY(event.IsHandled());
    QCOMPARE(event.Result(), 0u);
    QCOMPARE(parent.received, 0);
    QCOMPARE(probe->notifies, 1);
}

void CustomControlTest::handledNotifyIsLeftAlone()
{
    Parent parent;
    Probe *probe = new Probe;
    probe->setParent(&parent);
    OrbaneEvent event(CustomControl::NOTIFY_ToParent, 1, 2, OrbaneEvent::FLAG_Handled);
    event.SetResult(99);
    QApplication::sendEvent(probe, &event);
    QCOMPARE(probe->notifies, 0);
    QCOMPARE(event.Result(), 99u);
    QCOMPARE(parent.received, 0);
}

QTEST_MAIN(CustomControlTest)
#include "CustomControlTest.moc"
