#include "orbane/OrbComboBox.h"

#include <QAbstractItemView>
#include <QSignalSpy>
#include <QtTest>

using namespace Orbane;

// Records the signals in the order they come, through old-style string
// connections, as controls connect.
class Recorder : public QObject
{
    Q_OBJECT
public:
    QStringList events;
public slots:
    void OnShow() { events << "show"; }
    void OnHide() { events << "hide"; }
    void OnActivated(int row) { events << QString("activated %1").arg(row); }
};

namespace {

// "A", separator, "B", "C", carrying the indices 4, 5, 6, 7: not their rows,
// as after a control sorted or regrouped its items.
void AddRows(OrbComboBox &combo)
{
    combo.AddItem("A", 4, "first");
    combo.AddSeparator(5);
    combo.AddItem("B", 6);
    combo.AddItem("C", 7);
}

struct Shown
{
    Shown() : window(new QWidget)
    {
        window->resize(200, 60);
        combo = new OrbComboBox(window.get());
        combo->setGeometry(10, 10, 150, 24);
        AddRows(*combo);
        QObject::connect(combo, SIGNAL(popupShow()), &recorder, SLOT(OnShow()));
        QObject::connect(combo, SIGNAL(popupHide()), &recorder, SLOT(OnHide()));
        QObject::connect(combo, SIGNAL(activated(int)), &recorder, SLOT(OnActivated(int)));
        window->show();
        if (!QTest::qWaitForWindowExposed(window.get()))
            qWarning("the window was never exposed");
    }

    QAbstractItemView *View() const { return combo->view(); }
    QPoint RowCentre(int row) const { return View()->visualRect(View()->model()->index(row, 0)).center(); }

    std::unique_ptr<QWidget> window;
    OrbComboBox *combo = nullptr;
    Recorder recorder;
};

} // namespace

class OrbComboBoxTest : public QObject
{
    Q_OBJECT
private slots:
    // Rows, item indices, picks by click, Return and Escape are the combo
    // control's (ComboControlTest); here what no control reaches.
    void closingTheList_data()
    {
        QTest::addColumn<QString>("how");
        QTest::addColumn<QStringList>("events");
        QTest::addColumn<int>("current");
        QTest::newRow("click on a row") << "click 3" << QStringList{"show", "hide", "activated 3"} << 3;
        QTest::newRow("hidePopup") << "program" << QStringList{"show", "hide"} << 0;
        // The list closes on the row that was current: a separator is never chosen.
        QTest::newRow("click on the separator") << "click 1" << QStringList{"show", "hide", "activated 0"} << 0;
    }

    void closingTheList()
    {
        QFETCH(QString, how);
        QFETCH(QStringList, events);
        QFETCH(int, current);
        Shown s;
        s.combo->setCurrentIndex(0);
        s.combo->showPopup();
        QVERIFY(s.combo->IsPopupVisible());
        // Shown once, however often asked.
        s.combo->showPopup();
        QCOMPARE(s.recorder.events, QStringList{"show"});
        if (how.startsWith("click")) {
            const QPoint at = s.RowCentre(how.back().digitValue());
            QTest::mouseClick(s.View()->viewport(), Qt::LeftButton, Qt::NoModifier, at);
        }
        QCoreApplication::processEvents();
        if (how == "program")
            s.combo->hidePopup();
        QVERIFY(!s.View()->isVisible());
        QVERIFY(!s.combo->IsPopupVisible());
        QCOMPARE(s.recorder.events, events);
        QCOMPARE(s.combo->currentIndex(), current);
    }
};

QTEST_MAIN(OrbComboBoxTest)
#include "OrbComboBoxTest.moc"
