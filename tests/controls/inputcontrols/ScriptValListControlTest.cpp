#include "ToolFixture.h"

#include "orbane/AutoParam.h"
#include "orbane/ClassIDs.h"
#include "orbane/Input.h"
#include "orbane/LuaRuntime.h"
#include "orbane/Operator.h"

#include <QClipboard>
#include <QLabel>
#include <QStyle>
#include <QTreeWidget>
#include <QtTest>

using namespace Orbane;
using namespace Orbane::Test;

Q_DECLARE_METATYPE(Orbane::TagList)

namespace {

const OrbID kScriptValList("ScriptValListControl");
constexpr Tag kRows = 0x10050000;

QTreeWidget *TreeOf(const InputControl *c)
{
    return c->findChild<QTreeWidget *>("list");
}

// A table from Lua source, through the runtime as scripts make them.
AutoScriptValParam FromLua(const QString &source)
{
    LuaRuntime &lua = LuaRuntime::Instance();
    if (!lua.RunString("return " + source.toStdString(), "table", nullptr, 1))
        return AutoScriptValParam(ScriptVal());
    const AutoScriptValParam value(LuaRuntime::ToScriptVal(lua.State(), -1));
    lua_pop(lua.State(), 1);
    return value;
}

// A list control bound to an Input holding `table`.
InputControl *List(ToolFixture &f, const QString &table, const TagList &attrs = {}, int32 width = ToolFixture::kWidth)
{
    Input *in = f.tool->AddInput("Meta", "Meta", CLSID_DataType_ScriptVal, attrs, FromLua(table));
    return f.Create(kScriptValList, {in}, width);
}

// The rows as shown, depth first: "key = value", children indented, and
// "+" before a row that is expanded.
QStringList Rows(const QTreeWidgetItem *parent, const QString &indent = QString())
{
    QStringList rows;
    for (int i = 0; i < parent->childCount(); ++i) {
        const QTreeWidgetItem *row = parent->child(i);
        rows << indent + (row->isExpanded() ? "+" : "") + row->text(0) + " = " + row->text(1);
        rows << Rows(row, indent + "  ");
    }
    return rows;
}

QStringList Rows(const InputControl *c)
{
    return Rows(TreeOf(c)->invisibleRootItem());
}

QPoint RowCentre(const QTreeWidget *tree, int row)
{
    return tree->visualItemRect(tree->topLevelItem(row)).center();
}

} // namespace

class ScriptValListControlTest : public QObject
{
    Q_OBJECT
private slots:
    void initTestCase();
    void contents_data();
    void contents();
    void followsTheInput();
    void geometry_data();
    void geometry();
    void copy_data();
    void copy();
};

void ScriptValListControlTest::initTestCase()
{
    std::string error;
    QVERIFY2(ToolFixture::LoadControls(&error), error.c_str());
}

void ScriptValListControlTest::contents_data()
{
    QTest::addColumn<QString>("table");
    QTest::addColumn<QStringList>("rows");
    QTest::newRow("a named key among others grows a row")
        << "{ a = 1, b = { c = 2 } }" << QStringList{"a = 1", "+b = ", "  c = 2"};
    QTest::newRow("list of numbers") << "{ list = { 1, 2, 3 } }" << QStringList{"list = { 1, 2, 3 }"};
    QTest::newRow("empty table") << "{ e = {} }" << QStringList{"e = {  }"};
    QTest::newRow("one named key") << "{ t = { a = 1 } }" << QStringList{"t = { a = 1 }"};
    QTest::newRow("one level deep") << "{ m = { x = { y = { z = 1 } } } }"
                                    << QStringList{"+m = ", "  x = { y = <subtable> }"};
    QTest::newRow("a table among list values")
        << "{ l = { 10, { 1 } } }" << QStringList{"+l = ", "  1 = 10", "  2 = { 1 }"};
    QTest::newRow("plain values") << "{ s = 'text', n = 2.5, t = true, f = false, i = 42 }"
                                  << QStringList{"f = false", "i = 42", "n = 2.5", "s = text", "t = true"};
    QTest::newRow("number keys sort as text") << "{ 'x', 'y', [10] = 'z' }" << QStringList{"1 = x", "10 = z", "2 = y"};
    QTest::newRow("mixed summary") << "{ q = { 1, 'two', true, require('ffi').cast('void *', 1) } }"
                                   << QStringList{"q = { 1, two, true, <unknown> }"};
    QTest::newRow("not a table") << "7" << QStringList{};
}

void ScriptValListControlTest::contents()
{
    QFETCH(QString, table);
    QFETCH(QStringList, rows);
    ToolFixture f;
    InputControl *c = List(f, table);
    QVERIFY(c);
    QCOMPARE(Rows(c), rows);
}

void ScriptValListControlTest::followsTheInput()
{
    ToolFixture f;
    InputControl *c = List(f, "{ a = 1 }");
    Input *in = c->GetCurrentInput();
    QCOMPARE(Rows(c), QStringList{"a = 1"});
    QVERIFY(in->SetValue(FromLua("{ b = 2, c = { 3 } }"), f.doc.GetCurrentTime()));
    QCOMPARE(Rows(c), (QStringList{"b = 2", "c = { 3 }"}));
    QVERIFY(f.doc.Undo());
    QCOMPARE(Rows(c), QStringList{"a = 1"});
    // A notification without a value leaves the tree showing what it held.
    c->NotifyChanged(in, nullptr, nullptr);
    QCOMPARE(Rows(c), QStringList{"a = 1"});
}

void ScriptValListControlTest::geometry_data()
{
    QTest::addColumn<TagList>("attrs");
    QTest::addColumn<int>("rows");
    QTest::addColumn<int>("width");
    QTest::newRow("default rows, narrow") << TagList{} << 6 << 120;
    QTest::newRow("three rows") << TagList{{kRows, 3}} << 3 << 320;
}

void ScriptValListControlTest::geometry()
{
    QFETCH(TagList, attrs);
    QFETCH(int, rows);
    QFETCH(int, width);
    ToolFixture f;
    attrs.Append(TagList{{0x30040000, "Metadata"}});
    InputControl *c = List(f, "{ 1, 2, 3, 4, 5, 6, 7, 8, 9 }", attrs, width);
    QTreeWidget *tree = TreeOf(c);
    auto *label = c->findChild<QLabel *>("label");
    QCOMPARE(label->text(), QString("Metadata"));
    QVERIFY(label->geometry().bottom() < tree->geometry().top());
    // Keys take two fifths of the room beside the scroll bar, values the rest.
    QCOMPARE(tree->width(), width);
    const int room = width - 2 * tree->frameWidth() - tree->style()->pixelMetric(QStyle::PM_ScrollBarExtent);
    QCOMPARE(tree->columnWidth(0), room * 2 / 5);
    QCOMPARE(tree->columnWidth(0) + tree->columnWidth(1), room);

    const int rowHeight = tree->visualItemRect(tree->topLevelItem(0)).height();
    QVERIFY(rowHeight > 0);
    QCOMPARE(tree->height(), 2 * tree->frameWidth() + rowHeight * rows);
    int32 copied = 0;
    QCOMPARE(c->CopyAttr(kRows, &copied), false);
    QCOMPARE(copied, rows);
    // A script's SetAttrs changes it from the next layout on.
    c->SetAttrsTagList(c->GetCurrentInput(), TagList{{kRows, 2}});
    f.Resize(c, width);
    QCOMPARE(tree->height(), 2 * tree->frameWidth() + rowHeight * 2);
}

void ScriptValListControlTest::copy_data()
{
    QTest::addColumn<QList<int>>("clicks");    // rows clicked in turn
    QTest::addColumn<QList<int>>("modifiers"); // held for each click
    QTest::addColumn<QString>("text");
    const int none = Qt::NoModifier, shift = Qt::ShiftModifier, ctrl = Qt::ControlModifier;
    QTest::newRow("two rows") << QList<int>{0, 1} << QList<int>{none, shift} << "alpha\t1\nbeta\ttwo\n";
    QTest::newRow("apart") << QList<int>{0, 2} << QList<int>{none, ctrl} << "alpha\t1\ngamma\t{ 1, 2 }\n";
    QTest::newRow("nothing selected") << QList<int>{} << QList<int>{} << "";
}

void ScriptValListControlTest::copy()
{
    QFETCH(QList<int>, clicks);
    QFETCH(QList<int>, modifiers);
    QFETCH(QString, text);
    ToolFixture f;
    InputControl *c = List(f, "{ gamma = { 1, 2 }, alpha = 1, beta = 'two' }");
    QTreeWidget *tree = TreeOf(c);
    QApplication::clipboard()->setText("before");
    for (int i = 0; i < clicks.size(); ++i)
        QTest::mouseClick(tree->viewport(), Qt::LeftButton, Qt::KeyboardModifiers(modifiers[i]),
                          RowCentre(tree, clicks[i]));
    QCOMPARE(tree->selectionModel()->selectedRows().size(), clicks.size());
    QTest::keyClick(tree, Qt::Key_C, Qt::ControlModifier);
    QCOMPARE(QApplication::clipboard()->text(), text);
    // Values are read-only: the Input is as it was.
    QCOMPARE(f.doc.UndoNames().size(), 0);
}

QTEST_MAIN(ScriptValListControlTest)
#include "ScriptValListControlTest.moc"
