#include "ToolFixture.h"

#include "orbane/AutoParam.h"
#include "orbane/ClassIDs.h"
#include "orbane/Input.h"
#include "orbane/Text.h"

#include <QListWidget>
#include <QtTest>

using namespace Orbane;
using namespace Orbane::Test;

Q_DECLARE_METATYPE(Orbane::TagList)

namespace {

constexpr Tag kRows = 0x10050000;
constexpr Tag kAlphaSort = 0x10050001;
constexpr Tag kMultiSelect = 0x10050002;
constexpr Tag kAddString = 0x38040000;
constexpr Tag kID = 0x88030000;

QListWidget *ListOf(const InputControl *c)
{
    return c->findChild<QListWidget *>("list");
}

void ClickRow(QListWidget *list, int row, Qt::KeyboardModifiers mods = Qt::NoModifier)
{
    QTest::mouseClick(list->viewport(), Qt::LeftButton, mods, list->visualItemRect(list->item(row)).center());
}

QStringList Selected(const QListWidget *list)
{
    QStringList texts;
    for (int row = 0; row < list->count(); ++row)
        if (list->item(row)->isSelected())
            texts << list->item(row)->text();
    return texts;
}

TagList Seven(TagList more = TagList())
{
    TagList attrs{{kRows, 3}};
    for (const char *name : {"Red", "Green", "Blue", "Cyan", "Magenta", "Yellow", "Black"})
        attrs.Append(TagList{{kAddString, name}, {kID, OrbID(QString(name).toLower().toStdString())}});
    attrs.Append(more);
    return attrs;
}

} // namespace

class ListControlTest : public QObject
{
    Q_OBJECT
private slots:
    void initTestCase();
    void choosing_data();
    void choosing();
    void identifierVariant();
    void boundListsFollow();
};

void ListControlTest::initTestCase()
{
    std::string error;
    QVERIFY2(ToolFixture::LoadControls(&error), error.c_str());
}

// Rows clicked (a negative row is Ctrl-clicked) and keys pressed, then the
// value, the selection shown and the undo steps.
void ListControlTest::choosing_data()
{
    QTest::addColumn<TagList>("attrs");
    QTest::addColumn<QList<int>>("clicks");
    QTest::addColumn<QList<int>>("keys");
    QTest::addColumn<double>("value");
    QTest::addColumn<QStringList>("selected");
    QTest::addColumn<int>("steps");
    QTest::newRow("click") << Seven() << QList<int>{2} << QList<int>{} << 2.0 << QStringList{"Blue"} << 1;
    QTest::newRow("keys step down and scroll")
        << Seven() << QList<int>{0} << QList<int>{Qt::Key_Down, Qt::Key_End} << 6.0 << QStringList{"Black"} << 3;
    QTest::newRow("sorted rows keep their values")
        << Seven({{kAlphaSort, 1}}) << QList<int>{0} << QList<int>{} << 6.0 << QStringList{"Black"} << 1;
    QTest::newRow("several as bits") << Seven({{kMultiSelect, 1}}) << QList<int>{1, -3} << QList<int>{}
                                     << double((1 << 1) | (1 << 3)) << QStringList{"Green", "Cyan"} << 2;
    QTest::newRow("several, one taken off") << Seven({{kMultiSelect, 1}}) << QList<int>{1, -3, -1} << QList<int>{}
                                            << double(1 << 3) << QStringList{"Cyan"} << 3;
}

void ListControlTest::choosing()
{
    QFETCH(TagList, attrs);
    QFETCH(QList<int>, clicks);
    QFETCH(QList<int>, keys);
    QFETCH(double, value);
    QFETCH(QStringList, selected);
    QFETCH(int, steps);
    ToolFixture f;
    Input *in = f.AddNumber("Colour", -5.0, attrs);
    QListWidget *list = ListOf(f.Create(CLSID_InputControl_List, {in}));
    for (int click : clicks)
        ClickRow(list, std::abs(click), click < 0 ? Qt::ControlModifier : Qt::NoModifier);
    for (int key : keys)
        QTest::keyClick(list, Qt::Key(key));
    QCOMPARE(f.NumberOf(in), value);
    QCOMPARE(Selected(list), selected);
    QCOMPARE(f.doc.UndoNames().size(), steps);
    // Three rows show, whatever the count.
    QVERIFY(list->height() < 4 * list->visualItemRect(list->item(0)).height());
    QVERIFY(list->visualItemRect(list->currentItem()).intersects(list->viewport()->rect()));
}

// A Text Input holds the identifier; one that no item has shows none.
void ListControlTest::identifierVariant()
{
    ToolFixture f;
    Input *in = f.tool->AddInput(OrbID("Colour"), "Colour", CLSID_DataType_Text, Seven(), AutoText(OrbString("cyan")));
    InputControl *c = f.Create(CLSID_InputControl_ListID, {in});
    QCOMPARE(Selected(ListOf(c)), QStringList{"Cyan"});
    ClickRow(ListOf(c), 1);
    const AutoText now(in, f.doc.GetCurrentTime());
    QCOMPARE(now->Value.str(), std::string("green"));
    QVERIFY(in->SetValue(AutoText(OrbString("white")), f.doc.GetCurrentTime()));
    QCOMPARE(Selected(ListOf(c)), QStringList{});
    QCOMPARE(f.doc.UndoNames(), (QStringList{"Change Colour", "Change Colour"}));
}

void ListControlTest::boundListsFollow()
{
    ToolFixture f;
    Input *in = f.AddNumber("Colour", 1.3, Seven());
    InputControl *first = f.Create(CLSID_InputControl_List, {in});
    InputControl *second = f.Create(CLSID_InputControl_List, {in});
    QCOMPARE(Selected(ListOf(second)), QStringList{"Green"});
    ClickRow(ListOf(first), 4);
    QCOMPARE(Selected(ListOf(second)), QStringList{"Magenta"});
    QVERIFY(in->SetValue(AutoNumber(2.4), f.doc.GetCurrentTime()));
    f.Destroy(second);
    QCOMPARE(f.NumberOf(in), 2.0);
    QCOMPARE(f.doc.UndoNames().size(), 2);
}

QTEST_MAIN(ListControlTest)
#include "ListControlTest.moc"
