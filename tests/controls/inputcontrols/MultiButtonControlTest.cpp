#include "ToolFixture.h"

#include "orbane/AutoParam.h"
#include "orbane/ClassIDs.h"
#include "orbane/Input.h"
#include "orbane/Number.h"
#include "orbane/OrbIDParam.h"

#include <QToolButton>
#include <QtTest>

using namespace Orbane;
using namespace Orbane::Test;

Q_DECLARE_METATYPE(Orbane::TagList)

namespace {

constexpr Tag kColumns = 0x10050000;
constexpr Tag kAllowNone = 0x1005000F;
constexpr Tag kUndoName = 0x30050001;
constexpr Tag kAddButton = 0x38040000;
constexpr Tag kAddSeparator = 0x38040001;
constexpr Tag kID = 0x88030000;
constexpr Tag kValue = 0x28030000;
constexpr Tag kDisabled = 0x18050000;
constexpr Tag kNewRow = 0x18050001;

QToolButton *Button(const InputControl *c, int n)
{
    return c->findChild<QToolButton *>(QString("button%1").arg(n));
}

// The Input's value as a script would read it: a number or an identifier.
QString ValueOf(const ToolFixture &f, Input *in)
{
    const AutoParameter value(in->GetValue(f.doc.GetCurrentTime()));
    if (const auto *number = dynamic_cast<const Number *>(value.get()))
        return QString::number(number->Value);
    const auto *id = dynamic_cast<const OrbIDParam *>(value.get());
    return id ? QString(id->Value.c_str()) : QString();
}

Input *AddRow(ToolFixture &f, bool idVariant, const TagList &attrs)
{
    return idVariant ? f.tool->AddInput(OrbID("Mode"), "Mode", CLSID_DataType_ID, attrs, AutoOrbIDParam(OrbID("x")))
                     : f.AddNumber("Mode", -7.0, attrs);
}

InputControl *MakeRow(ToolFixture &f, bool idVariant, Input *in, int32 width = ToolFixture::kWidth)
{
    return f.Create(idVariant ? CLSID_InputControl_MultiButtonID : CLSID_InputControl_MultiButton, {in}, width);
}

TagList Fruit(TagList more = TagList())
{
    TagList attrs{{kAddButton, "Apple"}, {kID, OrbID("apple")}, {kAddSeparator, ""},
                  {kAddButton, "Pear"},  {kID, OrbID("pear")},  {kValue, 5.0},
                  {kAddButton, "Plum"},  {kID, OrbID("plum")},  {kDisabled, 1}};
    attrs.Append(more);
    return attrs;
}

} // namespace

class MultiButtonControlTest : public QObject
{
    Q_OBJECT
private slots:
    void initTestCase();
    void clicksWrite_data();
    void clicksWrite();
    void boundRowsFollow_data();
    void boundRowsFollow();
    void rows_data();
    void rows();
    void keysChooseNeighbours();
    void noneShownWritesNothing_data();
    void noneShownWritesNothing();
};

void MultiButtonControlTest::initTestCase()
{
    std::string error;
    QVERIFY2(ToolFixture::LoadControls(&error), error.c_str());
}

// Buttons clicked in turn; the values written and the undo steps they left.
void MultiButtonControlTest::clicksWrite_data()
{
    QTest::addColumn<bool>("idVariant");
    QTest::addColumn<TagList>("attrs");
    QTest::addColumn<QList<int>>("clicks");
    QTest::addColumn<QString>("value");
    QTest::addColumn<QStringList>("undo");
    QTest::addColumn<int>("checked"); // the button shown chosen, 0 for none
    QTest::newRow("value of the button") << false << Fruit() << QList<int>{2} << "5" << QStringList{"Change Mode"} << 2;
    QTest::newRow("separator does not count")
        << false << Fruit() << QList<int>{2, 1} << "0" << QStringList{"Change Mode", "Change Mode"} << 1;
    QTest::newRow("chosen again writes nothing")
        << false << Fruit() << QList<int>{1, 1} << "0" << QStringList{"Change Mode"} << 1;
    QTest::newRow("disabled button") << false << Fruit() << QList<int>{3} << "-7" << QStringList{} << 0;
    QTest::newRow("chosen again clears") << false << Fruit({{kAllowNone, 1}}) << QList<int>{1, 1} << "-1"
                                         << QStringList{"Change Mode", "Change Mode"} << 0;
    QTest::newRow("own undo name") << false << Fruit({{kUndoName, "Pick fruit"}}) << QList<int>{2} << "5"
                                   << QStringList{"Pick fruit"} << 2;
    QTest::newRow("identifier") << true << Fruit() << QList<int>{2} << "pear" << QStringList{"Change Mode"} << 2;
    QTest::newRow("identifier cleared") << true << Fruit({{kAllowNone, 1}}) << QList<int>{2, 2} << ""
                                        << QStringList{"Change Mode", "Change Mode"} << 0;
}

void MultiButtonControlTest::clicksWrite()
{
    QFETCH(bool, idVariant);
    QFETCH(TagList, attrs);
    QFETCH(QList<int>, clicks);
    QFETCH(QString, value);
    QFETCH(QStringList, undo);
    QFETCH(int, checked);
    ToolFixture f;
    Input *in = AddRow(f, idVariant, attrs);
    InputControl *c = MakeRow(f, idVariant, in);
    for (int n : clicks)
        QTest::mouseClick(Button(c, n), Qt::LeftButton);
    QCOMPARE(ValueOf(f, in), value);
    QCOMPARE(f.doc.UndoNames(), undo);
    for (int n = 1; n <= 3; ++n)
        QCOMPARE(Button(c, n)->isChecked(), n == checked);
}

// A second row of the same Input shows the choice made in the first; the
// one unbound writes what it shows.
void MultiButtonControlTest::boundRowsFollow_data()
{
    QTest::addColumn<bool>("idVariant");
    QTest::newRow("number") << false;
    QTest::newRow("identifier") << true;
}

void MultiButtonControlTest::boundRowsFollow()
{
    QFETCH(bool, idVariant);
    ToolFixture f;
    Input *in = AddRow(f, idVariant, Fruit());
    InputControl *first = MakeRow(f, idVariant, in);
    InputControl *second = MakeRow(f, idVariant, in);
    QTest::mouseClick(Button(first, 2), Qt::LeftButton);
    QVERIFY(Button(second, 2)->isChecked());
    QVERIFY(!Button(second, 1)->isChecked());
    QVERIFY(in->SetValue(idVariant ? AutoParameter(AutoOrbIDParam(OrbID("apple"))) : AutoParameter(AutoNumber(0.2)),
                         f.doc.GetCurrentTime()));
    QVERIFY(Button(first, 1)->isChecked() && Button(second, 1)->isChecked());
    const int steps = f.doc.UndoDepth();
    f.Destroy(second);
    QCOMPARE(ValueOf(f, in), idVariant ? "apple" : "0");
    QCOMPARE(f.doc.UndoDepth(), steps);
}

// Where button 4 lands against button 1: same row or below it.
void MultiButtonControlTest::rows_data()
{
    QTest::addColumn<TagList>("attrs");
    QTest::addColumn<int>("width");
    QTest::addColumn<bool>("fourthBelow");
    TagList six;
    for (const char *name : {"One", "Two", "Three", "Four", "Five", "Six"})
        six.Append(TagList{{kAddButton, name}});
    TagList three(six);
    three.Append(TagList{{kColumns, 3}});
    TagList newRow{{kAddButton, "One"}, {kAddButton, "Two"}, {kAddButton, "Three"}, {kAddButton, "Four"}, {kNewRow, 1}};
    QTest::newRow("wide: one row") << six << 900 << false;
    QTest::newRow("narrow: several rows") << six << 200 << true;
    QTest::newRow("three columns") << three << 900 << true;
    QTest::newRow("new row") << newRow << 900 << true;
}

void MultiButtonControlTest::rows()
{
    QFETCH(TagList, attrs);
    QFETCH(int, width);
    QFETCH(bool, fourthBelow);
    ToolFixture f;
    InputControl *c = MakeRow(f, false, f.AddNumber("Mode", 0.0, attrs), width);
    QCOMPARE(Button(c, 4)->y() > Button(c, 1)->y(), fourthBelow);
    // Every button stays inside the control.
    for (int n = 1; n <= 4; ++n)
        QVERIFY(c->rect().contains(Button(c, n)->geometry()));
}

// Left and Right choose the neighbour, past disabled buttons, one undo step a key.
void MultiButtonControlTest::keysChooseNeighbours()
{
    ToolFixture f;
    Input *in = f.AddNumber("Mode", 0.0, {{kAddButton, "A"}, {kAddButton, "B"}, {kDisabled, 1}, {kAddButton, "C"}});
    InputControl *c = MakeRow(f, false, in);
    QTest::keyClick(Button(c, 1), Qt::Key_Right);
    QCOMPARE(f.NumberOf(in), 2.0);
    QTest::keyClick(Button(c, 3), Qt::Key_Right);
    QCOMPARE(f.NumberOf(in), 2.0);
    QTest::keyClick(Button(c, 3), Qt::Key_Left);
    QCOMPARE(f.NumberOf(in), 0.0);
    QCOMPARE(f.doc.UndoNames().size(), 2);
}

// A row with no buttons, or a value no button has, shows nothing chosen
// and leaves the Input's value alone when it is unbound.
void MultiButtonControlTest::noneShownWritesNothing_data()
{
    QTest::addColumn<bool>("idVariant");
    QTest::addColumn<TagList>("attrs");
    QTest::newRow("no buttons") << false << TagList();
    QTest::newRow("no button has the value") << false << Fruit();
    QTest::newRow("no button has the identifier") << true << Fruit();
}

void MultiButtonControlTest::noneShownWritesNothing()
{
    QFETCH(bool, idVariant);
    QFETCH(TagList, attrs);
    ToolFixture f;
    Input *in = AddRow(f, idVariant, attrs);
    const QString before = ValueOf(f, in);
    InputControl *c = MakeRow(f, idVariant, in);
    QVERIFY(c->height() > 0);
    for (const QToolButton *button : c->findChildren<QToolButton *>())
        QVERIFY(!button->isChecked());
    f.Destroy(c);
    QCOMPARE(ValueOf(f, in), before);
}

QTEST_MAIN(MultiButtonControlTest)
#include "MultiButtonControlTest.moc"
