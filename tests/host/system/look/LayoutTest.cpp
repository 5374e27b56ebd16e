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
    void lookDescriptionsPlaceChildren_data()
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
        QTest::newRow("missing: the default row") << "Controls.Missing.Layout" << QStringList{"a<b", "b<c"};
    }

    void lookDescriptionsPlaceChildren()
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
        QVERIFY2(root->Find("expression") && root->Find("expression")->AsContainer(), "room for an expression");
        for (const auto &[name, child] : owner.children) {
            QVERIFY2(child->width() > 0 && QRect(0, 0, 300, height).contains(child->geometry()), qPrintable(name));
            QVERIFY(root->Find(OrbID(name.toStdString())));
        }
        for (const QString &relation : relations) {
            const bool leftOf = relation.contains('<');
            const QStringList pair = relation.split(leftOf ? '<' : '^');
            const QRect a = owner.Rect(pair[0]), b = owner.Rect(pair[1]);
            QVERIFY2(leftOf ? a.right() < b.left() && a.top() < b.bottom() && b.top() < a.bottom()
                            : a.bottom() < b.top(),
                     qPrintable(relation));
        }
    }

    // The box takes the rest of its row; an empty expression container adds
    // neither room nor spacing until it is filled; a height tag overrides a
    // row's height until set back to -1.
    void checkBoxLayoutAndHeightOverride()
    {
        Owner owner;
        auto *label = owner.Add<ElideLabel>("label");
        label->setText("Second");
        auto *box = owner.Add<CustomCheckBox>("checkbox");
        box->SetLabel(QStringLiteral("Enabled"));
        auto root = Container::Create(Description("Controls.CheckBox.Layout"), owner.map);
        const int height = root->Arrange(250);
        const int rowHeight = box->height();
        QVERIFY(label->geometry().right() < box->geometry().left());
        QCOMPARE(box->geometry().right(), 249);
        QCOMPARE(rowHeight, box->sizeHint().height());
        QCOMPARE(height, std::max(label->geometry().bottom(), box->geometry().bottom()) + 1);

        LayoutObj *obj = root->Find("checkbox");
        QVERIFY(obj->SetAttrs(TagList{{INPA_LayoutHeight, rowHeight + 37}}));
        QVERIFY(!obj->SetAttrs(TagList{{LINKS_Name, "not a layout tag"}}));
        QCOMPARE(root->Arrange(250), height + 37);
        QCOMPARE(box->height(), rowHeight + 37);
        QVERIFY(obj->SetAttrs(TagList{{INPA_LayoutHeight, -1}}));
        QCOMPARE(root->Arrange(250), height);

        auto *edit = new QLineEdit(&owner.widget);
        edit->show();
        QVERIFY(root->Find("expression")->AsContainer()->AddWidget("edit", edit));
        QVERIFY(root->Arrange(250) >= height + edit->sizeHint().height());
        QVERIFY(edit->geometry().top() > box->geometry().bottom());
        QCOMPARE(edit->geometry().width(), 250);
    }

    void descriptionFormat_data()
    {
        // Children a, b and c ask for 20 x 10 each.
        QTest::addColumn<QString>("lua");
        QTest::addColumn<int>("width");
        QTest::addColumn<QString>("child");
        QTest::addColumn<QRect>("expected");
        QTest::newRow("fixed width b") << R"({ kind = "hbox", spacing = 0, { name = "a", width = 50 },
            { name = "b", stretch = 1 } })"
                                       << 200 << "b" << QRect(50, 0, 150, 10);
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
        QTest::newRow("nested rows") << R"({ spacing = 0, { kind = "hbox", spacing = 0, "a", "b" }, "c" })" << 100
                                     << "c" << QRect(0, 10, 100, 10);
        QTest::newRow("grid span") << R"({ kind = "grid", hspacing = 0, vspacing = 5, colstretch = { 1, 1 },
            { name = "a", row = 1, col = 1 }, { name = "b", row = 1, col = 2 },
            { name = "c", row = 2, col = 1, colspan = 2 } })"
                                   << 200 << "c" << QRect(0, 15, 200, 10);
        // Numbers out of range are refused (the default taken), not handed
        // to Qt: a grid of two billion rows, a width past any screen.
        QTest::newRow("row of 2^31") << R"({ kind = "grid", hspacing = 0, vspacing = 0,
            { name = "a", row = 2^31, col = 1 }, { name = "b", row = 2, col = 1 } })"
                                     << 100 << "b" << QRect(0, 10, 100, 10);
        QTest::newRow("column and span out of range") << R"({ kind = "grid", hspacing = 0, vspacing = 0,
            { name = "a", row = 1, col = -2^31, colspan = 1e300 }, { name = "b", row = 2, col = 0/0 } })"
                                                      << 100 << "b" << QRect(0, 10, 100, 10);
        QTest::newRow("width and margins out of range")
            << R"({ kind = "hbox", spacing = 0, margins = 1e300, { name = "a", width = 2^40 }, "b" })" << 100 << "a"
            << QRect(0, 0, 50, 10);
        QTest::newRow("unregistered name left out")
            << R"({ kind = "hbox", spacing = 0, "nosuch", "a" })" << 100 << "a" << QRect(0, 0, 100, 10);
        QTest::newRow("rest in registration order")
            << R"({ kind = "hbox", spacing = 0, { name = "c", width = 10 }, { kind = "rest" } })" << 50 << "b"
            << QRect(30, 0, 20, 10);
    }

    void descriptionFormat()
    {
        QFETCH(QString, lua);
        QFETCH(int, width);
        QFETCH(QString, child);
        QFETCH(QRect, expected);
        Owner owner;
        for (const char *name : {"a", "b", "c"})
            owner.Add(name);
        auto root = Container::Create(FromLua(lua), owner.map);
        root->Arrange(width);
        QCOMPARE(owner.Rect(child), expected);
        QCOMPARE(root->Find(OrbID(child.toStdString()))->GetRect(), expected);
    }

    void hiddenOrDeletedChildTakesNoRoom()
    {
        Owner owner;
        QWidget *label = owner.Add("label");
        owner.Add("button");
        auto root = Container::Create(Description("Controls.Button.Layout"), owner.map);
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
};

QTEST_MAIN(LayoutTest)
#include "LayoutTest.moc"
