#include "TestControl.h"
#include "ToolFixture.h"

#include "inputcontrols/PickButton.h"

#include "orbane/AutoParam.h"
#include "orbane/Input.h"
#include "orbane/OrbaneEvent.h"

#include <QtTest>

using namespace Orbane;
using namespace Orbane::Test;

Q_DECLARE_METATYPE(Orbane::TagList)

namespace {

constexpr Tag kSaveIndex = 0x10030007;

// A widget of the application that records the pick notifications it gets.
class PickTarget : public QWidget
{
public:
    using QWidget::QWidget;
    QList<QPair<uint32, uint64>> notes;

protected:
    void customEvent(QEvent *event) override
    {
        if (event->type() == OrbaneEvent::EventType()) {
            auto *note = static_cast<OrbaneEvent *>(event);
            notes.append({note->ID(), note->Param2()});
        }
    }
};

} // namespace

class PickButtonTest : public QObject
{
    Q_OBJECT
private slots:
    void saveRestore_data();
    void saveRestore();
    void pick_data();
    void pick();
};

void PickButtonTest::saveRestore_data()
{
    QTest::addColumn<TagList>("attrs");
    QTest::addColumn<bool>("point");
    QTest::addColumn<int>("slot");
    QTest::newRow("slot 0") << TagList{{kSaveIndex, 0}} << false << 0;
    QTest::newRow("slot 31") << TagList{{kSaveIndex, 31}} << false << 31;
    QTest::newRow("slot 32 skipped") << TagList{{kSaveIndex, 32}} << false << -1;
    QTest::newRow("point skipped") << TagList{{kSaveIndex, 3}} << true << -1;
}

void PickButtonTest::saveRestore()
{
    QFETCH(TagList, attrs);
    QFETCH(bool, point);
    QFETCH(int, slot);
    ToolFixture f;
    f.doc.SetCurrentTime(4.0);
    Input *owned = f.AddNumber("Owner", 0.0);
    Input *in = point ? f.AddPoint("Centre", 0.5, 0.5, attrs) : f.AddNumber("Gain", 2.5, attrs);
    auto *owner = static_cast<TestControl *>(f.Bind(new TestControl, {owned}));
    PickButton button(&f.page);
    button.SetOwner(owner);
    QCOMPARE(button.SaveValues(), slot >= 0 ? 1 : 0);
    if (slot >= 0)
        QCOMPARE(button.SavedValue(slot), 2.5);
    if (!point)
        in->SetValue(AutoNumber(9.0), in->CurrentTime());
    const int steps = f.doc.UndoNames().size();
    QCOMPARE(button.RestoreValues(), slot >= 0 ? 1 : 0);
    if (!point)
        QCOMPARE(f.NumberOf(in), slot >= 0 ? 2.5 : 9.0);
    QCOMPARE(f.doc.UndoNames().size(), steps);
}

void PickButtonTest::pick_data()
{
    QTest::addColumn<bool>("overTarget");
    QTest::newRow("released over a widget") << true;
    QTest::newRow("released outside every window") << false;
}

void PickButtonTest::pick()
{
    QFETCH(bool, overTarget);
    ToolFixture f;
    Input *gain = f.AddNumber("Gain", 1.5, TagList{{kSaveIndex, 2}});
    auto *owner = static_cast<TestControl *>(f.Bind(new TestControl, {gain}));
    PickTarget target(&f.page);
    target.setGeometry(100, 300, 120, 80);
    target.show();
    PickButton button(&f.page);
    button.setGeometry(10, 200, 60, 24);
    button.show();
    button.SetOwner(owner);
    button.SetPickEnabled(true);
    QSignalSpy picked(&button, SIGNAL(Picked(QWidget *, QPoint)));
    QTest::mousePress(&button, Qt::LeftButton, Qt::NoModifier, QPoint(5, 5));
    QVERIFY(button.IsPicking());
    QCOMPARE(button.cursor().shape(), Qt::CrossCursor);
    gain->SetValue(AutoNumber(7.0), gain->CurrentTime());
    const QPoint over = button.mapFrom(&f.page, target.geometry().topLeft() + QPoint(30, 20));
    QTest::mouseRelease(&button, Qt::LeftButton, Qt::NoModifier, overTarget ? over : QPoint(-5000, -5000));
    QVERIFY(!button.IsPicking());
    QVERIFY(!button.testAttribute(Qt::WA_SetCursor));
    // A pick that found its widget keeps what the pick did; a failed one restores.
    QCOMPARE(f.NumberOf(gain), overTarget ? 7.0 : 1.5);
    QCOMPARE(picked.count(), int(overTarget));
    if (picked.isEmpty())
        return;
    QCOMPARE(picked.first().at(0).value<QWidget *>(), static_cast<QWidget *>(&target));
    QCOMPARE(picked.first().at(1).toPoint(), QPoint(30, 20));
    QTRY_COMPARE(target.notes.size(), 1);
    QCOMPARE(target.notes.first().first, CCPickButton::kPickEvent);
    QCOMPARE(target.notes.first().second, uint64(30) | uint64(20) << 16);
}

QTEST_MAIN(PickButtonTest)
#include "PickButtonTest.moc"
