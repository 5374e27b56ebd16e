#include "ToolFixture.h"

#include "orbane/AutoParam.h"
#include "orbane/ClassIDs.h"
#include "orbane/Input.h"
#include "orbane/LuaRuntime.h"
#include "orbane/Operator.h"

#include <QTreeWidget>
#include <QtTest>

using namespace Orbane;
using namespace Orbane::Test;

Q_DECLARE_METATYPE(Orbane::TagList)

namespace {

const OrbID kScriptValList("ScriptValListControl");

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

InputControl *List(ToolFixture &f, const QString &table, const TagList &attrs = {})
{
    Input *in = f.tool->AddInput("Meta", "Meta", CLSID_DataType_ScriptVal, attrs, FromLua(table));
    return f.Create(kScriptValList, {in});
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

} // namespace

class ScriptValListControlTest : public QObject
{
    Q_OBJECT
private slots:
    void initTestCase();
    void contents_data();
    void contents();
    void followsTheInput();
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
    QVERIFY(in->SetValue(FromLua("{ b = 2, c = { 3 } }"), f.doc.GetCurrentTime()));
    QCOMPARE(Rows(c), (QStringList{"b = 2", "c = { 3 }"}));
    QVERIFY(f.doc.Undo());
    QCOMPARE(Rows(c), QStringList{"a = 1"});
}

QTEST_MAIN(ScriptValListControlTest)
#include "ScriptValListControlTest.moc"
