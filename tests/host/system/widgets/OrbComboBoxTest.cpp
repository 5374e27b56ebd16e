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
    void rowsCarryItemIndices_data();
    void rowsCarryItemIndices();
    void showItemEmitsNothing();
    void secondTextIsTip();
    void closingTheList_data();
    void closingTheList();
    void separatorCannotBeChosen();
    void keysSkipSeparator();
};

void OrbComboBoxTest::rowsCarryItemIndices_data()
{
    QTest::addColumn<int>("row");
    QTest::addColumn<int>("index");
    QTest::newRow("first") << 0 << 4;
    QTest::newRow("separator") << 1 << 5;
    QTest::newRow("after the separator") << 2 << 6;
    QTest::newRow("last") << 3 << 7;
    QTest::newRow("past the end") << 4 << -1;
    QTest::newRow("no row") << -1 << -1;
}

void OrbComboBoxTest::rowsCarryItemIndices()
{
    QFETCH(int, row);
    QFETCH(int, index);
    OrbComboBox combo;
    AddRows(combo);
    QCOMPARE(combo.count(), 4);
    QCOMPARE(combo.ItemIndexOf(row), index);
    QCOMPARE(combo.itemData(row, Qt::UserRole).isValid(), index >= 0);
    if (index >= 0)
        QCOMPARE(combo.RowOfItem(index), row);
}

void OrbComboBoxTest::showItemEmitsNothing()
{
    OrbComboBox combo;
    AddRows(combo);
    QSignalSpy activated(&combo, SIGNAL(activated(int)));
    QSignalSpy highlighted(&combo, SIGNAL(highlighted(int)));
    combo.ShowItem(7);
    QCOMPARE(combo.currentIndex(), 3);
    QCOMPARE(combo.currentText(), QString("C"));
    combo.ShowItem(2); // no row carries it
    QCOMPARE(combo.currentIndex(), -1);
    QCOMPARE(combo.currentText(), QString());
    combo.ShowItem(4);
    QCOMPARE(combo.currentIndex(), 0);
    QCOMPARE(activated.count(), 0);
    QCOMPARE(highlighted.count(), 0);
}

void OrbComboBoxTest::secondTextIsTip()
{
    OrbComboBox combo;
    AddRows(combo);
    QCOMPARE(combo.itemData(0, Qt::ToolTipRole).toString(), QString("first"));
    QVERIFY(!combo.itemData(2, Qt::ToolTipRole).isValid());
}

void OrbComboBoxTest::closingTheList_data()
{
    QTest::addColumn<QString>("how");
    QTest::addColumn<QStringList>("events");
    QTest::newRow("click on a row") << "click" << QStringList{"show", "hide", "activated 3"};
    QTest::newRow("Return on a row") << "return" << QStringList{"show", "hide", "activated 2"};
    QTest::newRow("Escape") << "escape" << QStringList{"show", "hide"};
    QTest::newRow("hidePopup") << "program" << QStringList{"show", "hide"};
}

void OrbComboBoxTest::closingTheList()
{
    QFETCH(QString, how);
    QFETCH(QStringList, events);
    Shown s;
    s.combo->showPopup();
    QVERIFY(s.combo->IsPopupVisible());
    QVERIFY(s.View()->isVisible());
    // Shown once, however often asked.
    s.combo->showPopup();
    QCOMPARE(s.recorder.events, QStringList{"show"});
    if (how == "click") {
        QTest::mouseClick(s.View()->viewport(), Qt::LeftButton, Qt::NoModifier, s.RowCentre(3));
    } else if (how == "return") {
        // From "A" past the separator to "B".
        QTest::keyClick(s.View(), Qt::Key_Down);
        QTest::keyClick(s.View(), Qt::Key_Return);
    } else if (how == "escape") {
        QTest::keyClick(s.View(), Qt::Key_Escape);
    } else {
        s.combo->hidePopup();
    }
    QCoreApplication::processEvents();
    QVERIFY(!s.View()->isVisible());
    QVERIFY(!s.combo->IsPopupVisible());
    QCOMPARE(s.recorder.events, events);
}

void OrbComboBoxTest::separatorCannotBeChosen()
{
    Shown s;
    s.combo->setCurrentIndex(0);
    s.combo->showPopup();
    QTest::mouseClick(s.View()->viewport(), Qt::LeftButton, Qt::NoModifier, s.RowCentre(1));
    QCoreApplication::processEvents();
    // Qt closes the list on the row that was current; the separator's row
    // is never reported.
    QVERIFY(!s.recorder.events.contains("activated 1"));
    QCOMPARE(s.combo->currentIndex(), 0);
    s.combo->hidePopup();
    QCOMPARE(s.recorder.events.count("hide"), 1);
}

void OrbComboBoxTest::keysSkipSeparator()
{
    Shown s;
    s.combo->setCurrentIndex(0);
    s.combo->setFocus();
    QTest::keyClick(s.combo, Qt::Key_Down);
    QCOMPARE(s.combo->currentIndex(), 2);
    QCOMPARE(s.combo->ItemIndexOf(s.combo->currentIndex()), 6);
    QCOMPARE(s.recorder.events, QStringList{"activated 2"});
}

QTEST_MAIN(OrbComboBoxTest)
#include "OrbComboBoxTest.moc"
