#include "orbane/CustomCheckBox.h"
#include "orbane/ElideLabel.h"
#include "orbane/LayoutContainer.h"
#include "orbane/LayoutWidgetMap.h"
#include "orbane/LookPackItem.h"
#include "orbane/LuaRuntime.h"

#include <QLineEdit>
#include <QtTest>

#include <map>

using namespace Orbane;
using Layout::Container;
using Layout::LayoutObj;
using Layout::WidgetMap;

namespace {

// A child that asks for 20 x 10, so that expected rectangles can be worked
// out by hand.
class HintWidget : public QWidget
{
public:
    using QWidget::QWidget;
    QSize sizeHint() const override { return QSize(20, 10); }
    QSize minimumSizeHint() const override { return QSize(0, 0); }
};

// A description written in Lua, as look files write them.
ScriptVal FromLua(const QString &code)
{
    lua_State *L = luaL_newstate();
    const QByteArray chunk = ("return " + code).toUtf8();
    ScriptVal value;
    if (luaL_loadstring(L, chunk.constData()) == 0 && lua_pcall(L, 0, 1, 0) == 0)
        value = LuaRuntime::ToScriptVal(L, -1);
    lua_close(L);
    return value;
}

ScriptVal Description(const char *item)
{
    const ScriptVal *desc = LookPackItem(item).GetItemData().FindKeyConst(ScriptVal(1));
    return desc ? *desc : ScriptVal();
}

// An owner widget with named children, the way a control sets itself up.
struct Owner
{
    QWidget widget;
    WidgetMap map;
    std::map<QString, QWidget *> children;

    template <class W = HintWidget> W *Add(const QString &name)
    {
        auto *w = new W(&widget);
        w->show();
        children[name] = w;
        map.Register(OrbID(name.toStdString()), w);
        return w;
    }
    QRect Rect(const QString &name) const { return children.at(name)->geometry(); }
};

} // namespace

class LayoutTest : public QObject
{
    Q_OBJECT
private slots:
    void lookDescriptionsPlaceChildren_data();
    void lookDescriptionsPlaceChildren();
    void checkBoxLayout();
    void heightOverrideByTag();
    void descriptionFormat_data();
    void descriptionFormat();
    void missingDescriptionUsesDefault();
    void hiddenOrDeletedChildTakesNoRoom();
};

void LayoutTest::lookDescriptionsPlaceChildren_data()
{
    // "a<b": a left of b on the same row; "a^b": a above b.
    QTest::addColumn<QString>("item");
    QTest::addColumn<QStringList>("relations");
    QTest::newRow("check box") << "Controls.CheckBox.Layout" << QStringList{"label<checkbox"};
    QTest::newRow("button") << "Controls.Button.Layout" << QStringList{"label<button"};
    QTest::newRow("combo horizontal") << "Controls.Combo.Layout.Horizontal" << QStringList{"label<combo"};
    QTest::newRow("combo vertical") << "Controls.Combo.Layout.Vertical" << QStringList{"label^combo"};
    QTest::newRow("slider") << "Controls.Slider.Layout"
                            << QStringList{"label<edit", "label^slider", "slider^minlabel", "minlabel<midlabel",
                                           "midlabel<maxlabel"};
    QTest::newRow("script value list") << "Controls.ScriptValList.Layout" << QStringList{"label^list"};
}

void LayoutTest::lookDescriptionsPlaceChildren()
{
    QFETCH(QString, item);
    QFETCH(QStringList, relations);
    Owner owner;
    for (const QString &relation : relations)
        for (const QString &name : relation.split(QRegularExpression("[<^]")))
            if (!owner.children.count(name))
                owner.Add(name);
    auto root = Container::Create(Description(item.toUtf8().constData()), owner.map);
    const int height = root->Arrange(300);
    for (const auto &[name, child] : owner.children) {
        const QRect r = child->geometry();
        QVERIFY2(r.width() > 0 && QRect(0, 0, 300, height).contains(r), qPrintable(name));
        QVERIFY(root->Find(OrbID(name.toStdString())));
    }
    for (const QString &relation : relations) {
        const bool leftOf = relation.contains('<');
        const QStringList pair = relation.split(leftOf ? '<' : '^');
        const QRect a = owner.Rect(pair[0]), b = owner.Rect(pair[1]);
        if (leftOf) {
            QVERIFY2(a.right() < b.left(), qPrintable(relation));
            QVERIFY2(a.top() < b.bottom() && b.top() < a.bottom(), qPrintable(relation));
        } else {
            QVERIFY2(a.bottom() < b.top(), qPrintable(relation));
        }
    }
}

void LayoutTest::checkBoxLayout()
{
    Owner owner;
    auto *label = owner.Add<ElideLabel>("label");
    label->setText("Second");
    auto *box = owner.Add<CustomCheckBox>("checkbox");
    box->SetLabel(QStringLiteral("Enabled"));

    auto root = Container::Create(Description("Controls.CheckBox.Layout"), owner.map);
    const int height = root->Arrange(250);

    QVERIFY(label->geometry().right() < box->geometry().left());
    QCOMPARE(box->geometry().right(), 249); // the box takes the rest of the row
    QCOMPARE(box->height(), box->sizeHint().height());
    // An empty expression container adds neither room nor spacing.
    QCOMPARE(height, std::max(label->geometry().bottom(), box->geometry().bottom()) + 1);
    QVERIFY(!root->Find("nothing"));

    // Filled later, it takes a full-width row below the box.
    auto *edit = new QLineEdit(&owner.widget);
    edit->show();
    QVERIFY(root->Find("expression")->AsContainer()->AddWidget("edit", edit));
    QVERIFY(root->Arrange(250) >= height + edit->sizeHint().height());
    QVERIFY(edit->geometry().top() > box->geometry().bottom());
    QCOMPARE(edit->geometry().width(), 250);
    QCOMPARE(root->Find("edit")->GetWidget(), edit);
}

void LayoutTest::heightOverrideByTag()
{
    Owner owner;
    owner.Add<ElideLabel>("label");
    auto *box = owner.Add<CustomCheckBox>("checkbox");
    auto root = Container::Create(Description("Controls.CheckBox.Layout"), owner.map);
    const int before = root->Arrange(250);
    const int rowHeight = box->height();

    LayoutObj *obj = root->Find("checkbox");
    QVERIFY(obj);
    QVERIFY(obj->SetAttrs(TagList{{INPA_LayoutHeight, rowHeight + 37}}));
    QCOMPARE(obj->GetHeight(), rowHeight + 37);
    QCOMPARE(root->Arrange(250), before + 37);
    QCOMPARE(box->height(), rowHeight + 37);

    QVERIFY(!obj->SetAttrs(TagList{{LINKS_Name, "not a layout tag"}}));
    QCOMPARE(obj->GetHeightOverride(), rowHeight + 37);

    QVERIFY(obj->SetAttrs(TagList{{INPA_LayoutHeight, -1}}));
    QCOMPARE(root->Arrange(250), before);
    QCOMPARE(box->height(), rowHeight);
}

void LayoutTest::descriptionFormat_data()
{
    // Children a, b and c ask for 20 x 10 each.
    QTest::addColumn<QString>("lua");
    QTest::addColumn<int>("width");
    QTest::addColumn<QString>("child");
    QTest::addColumn<QRect>("expected");

    const QString fixed = R"({ kind = "hbox", spacing = 0, { name = "a", width = 50 }, { name = "b", stretch = 1 } })";
    QTest::newRow("fixed width b") << fixed << 200 << "b" << QRect(50, 0, 150, 10);

    QTest::newRow("shorthand names and spacing")
        << R"({ kind = "hbox", spacing = 10, "a", "b" })" << 50 << "b" << QRect(30, 0, 20, 10);
    QTest::newRow("margins") << R"({ kind = "hbox", margins = { 5, 6, 7, 8 }, "a" })" << 100 << "a"
                             << QRect(5, 6, 88, 10);
    QTest::newRow("vbox rows") << R"({ spacing = 2, "a", "b", "c" })" << 100 << "c" << QRect(0, 24, 100, 10);
    QTest::newRow("fixed height") << R"({ spacing = 0, { name = "a", height = 33 }, "b" })" << 100 << "b"
                                  << QRect(0, 33, 100, 10);
    QTest::newRow("stretch gap")
        << R"({ kind = "hbox", spacing = 0, { kind = "stretch" }, { name = "a", width = 40 } })" << 200 << "a"
        << QRect(160, 0, 40, 10);
    QTest::newRow("nested rows") << R"({ spacing = 0, { kind = "hbox", spacing = 0, "a", "b" }, "c" })" << 100 << "c"
                                 << QRect(0, 10, 100, 10);
    const QString grid = R"({ kind = "grid", hspacing = 0, vspacing = 5, colstretch = { 1, 1 },
        { name = "a", row = 1, col = 1 }, { name = "b", row = 1, col = 2 }, { name = "c", row = 2, col = 1, colspan = 2 } })";
    QTest::newRow("grid span") << grid << 200 << "c" << QRect(0, 15, 200, 10);
    QTest::newRow("unregistered name left out")
        << R"({ kind = "hbox", spacing = 0, "nosuch", "a" })" << 100 << "a" << QRect(0, 0, 100, 10);
    QTest::newRow("rest in registration order")
        << R"({ kind = "hbox", spacing = 0, { name = "c", width = 10 }, { kind = "rest" } })" << 50 << "b"
        << QRect(30, 0, 20, 10);
}

void LayoutTest::descriptionFormat()
{
    QFETCH(QString, lua);
    QFETCH(int, width);
    QFETCH(QString, child);
    QFETCH(QRect, expected);

    const ScriptVal description = FromLua(lua);
    QVERIFY(description.IsTable());
    Owner owner;
    for (const char *name : {"a", "b", "c"})
        owner.Add(name);
    auto root = Container::Create(description, owner.map);
    root->Arrange(width);
    QCOMPARE(owner.Rect(child), expected);
    QCOMPARE(root->Find(OrbID(child.toStdString()))->GetRect(), expected);
}

void LayoutTest::missingDescriptionUsesDefault()
{
    Owner owner;
    owner.Add("first");
    owner.Add("second");
    owner.Add("third");
    auto root = Container::Create(LookPackItem("Controls.Missing.Layout").GetItemData(), owner.map);
    root->Arrange(200);

    QVERIFY(owner.Rect("first").right() < owner.Rect("second").left());
    QVERIFY(owner.Rect("second").right() < owner.Rect("third").left());
    QCOMPARE(owner.Rect("first").top(), owner.Rect("third").top());
    QVERIFY(root->Find("expression") && root->Find("expression")->AsContainer());
}

void LayoutTest::hiddenOrDeletedChildTakesNoRoom()
{
    Owner owner;
    QWidget *label = owner.Add("label");
    owner.Add("button");
    auto root = Container::Create(Description("Controls.Button.Layout"), owner.map);
    root->Arrange(200);
    QVERIFY(owner.Rect("button").left() > 0);

    label->hide();
    root->Arrange(200);
    QCOMPARE(owner.Rect("button"), QRect(0, 0, 200, 10));
    label->show();
    root->Arrange(200);
    QVERIFY(owner.Rect("button").left() > 0);

    delete label;
    QVERIFY(!root->Find("label")->GetWidget());
    root->Arrange(200);
    QCOMPARE(owner.Rect("button"), QRect(0, 0, 200, 10));
}

QTEST_MAIN(LayoutTest)
#include "LayoutTest.moc"
