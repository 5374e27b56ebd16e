// The inspector as the application uses it: a tool described in Lua, its
// controls built in Input order from the classes the Inputs name, sized on
// every width change, and unbound and destroyed when the tool goes.
#include "LoadControlModule.h"

#include "orbane/AutoParam.h"
#include "orbane/ClassIDs.h"
#include "orbane/FallbackControl.h"
#include "orbane/Input.h"
#include "orbane/InputControl.h"
#include "orbane/InputWatcher.h"
#include "orbane/LuaRuntime.h"
#include "orbane/Operator.h"
#include "orbane/OrbaneDoc.h"
#include "orbane/ParameterPanel.h"
#include "orbane/ScriptVal.h"
#include "orbane/ToolLoader.h"

#include <QLabel>
#include <QRegularExpression>
#include <QScrollBar>
#include <QTest>

using namespace Orbane;

namespace {

// A tool from a Lua description, added to the document.
Operator *AddTool(OrbaneDoc &doc, const char *lua, const char *name, std::string *error)
{
    LuaRuntime &rt = LuaRuntime::Instance();
    if (!rt.RunString(lua, "tool.lua", error, 1))
        return nullptr;
    ScriptVal desc = LuaRuntime::ToScriptVal(rt.State(), -1);
    lua_pop(rt.State(), 1);
    AutoRef<Operator> tool(ToolLoader::FromTable(desc, name, error));
    return tool && doc.AddTool(tool.get()) ? tool.get() : nullptr;
}

const char *kSwitches = R"(return { type = "Switches", inputs = {
    { id = "A", type = "Number", default = 1, control = "CheckboxControl" },
    { id = "B", type = "Number", default = 0, control = { "CheckboxControl", "CheckboxControl" },
      tags = { CBC_TriState = true } },
    { id = "C", name = "Go", type = "Number", control = "ButtonControl" },
}})";

// A panel showing one tool of a document.
struct Shown
{
    explicit Shown(const char *lua)
    {
        std::string why;
        tool = AddTool(doc, lua, "Tool1", &why);
        if (!tool)
            qWarning("%s", why.c_str());
        panel.resize(300, 400);
        panel.show();
        panel.ShowTool(tool);
    }
    OrbaneDoc doc;
    Operator *tool = nullptr;
    ParameterPanel panel{&doc};
};

// A tool of `count` number Inputs at 0.3, each shown by a check box, which
// shows 0 and so writes 0 back when it is unbound.
Operator *AddCheckBoxTool(OrbaneDoc &doc, const char *name, int count)
{
    const TagList attrs{{INPA_InputControl, OrbID("CheckboxControl")}};
    AutoRef<Operator> tool(new Operator(name, "Checks"));
    for (int i = 0; i < count; ++i) {
        const std::string id = "Check" + std::to_string(i);
        tool->AddInput(OrbID(id.c_str()), id.c_str(), CLSID_DataType_Number, attrs, AutoNumber(0.3));
    }
    return doc.AddTool(tool.get()) ? tool.get() : nullptr;
}

// Records which Inputs were written, in order.
struct WriteLog : InputWatcher
{
    void OnInputChanged(Input *in, Parameter *, const TagList *) override { written.push_back(in); }
    std::vector<Input *> written;
};

} // namespace

class ParameterPanelTest : public QObject
{
    Q_OBJECT

private slots:
    void initTestCase()
    {
        std::string why;
        QVERIFY2(Test::LoadControlModule(&why), why.c_str());
    }

    // Top to bottom in Input order, every control following the panel's
    // width, inside it, without a horizontal scroll.
    void buildsControlsInInputOrderAndSizesThemToTheWidth()
    {
        Shown s(kSwitches);
        QCOMPARE(s.panel.ControlsOf(s.tool->FindInput("B")).size(), size_t(2));
        QStringList classes;
        int lastBottom = 0;
        for (InputControl *c : s.panel.Controls()) {
            classes << c->ScriptTypeName();
            QVERIFY2(c->geometry().top() >= lastBottom, "controls stack top to bottom");
            lastBottom = c->geometry().bottom();
        }
        QCOMPARE(classes, QStringList({"CheckboxControl", "CheckboxControl", "CheckboxControl", "ButtonControl"}));
        for (int width : {240, 520}) {
            s.panel.resize(width, 400);
            QCoreApplication::processEvents();
            for (InputControl *c : s.panel.Controls())
                QVERIFY(c->width() > s.panel.viewport()->width() - 20 &&
                        c->geometry().right() < s.panel.viewport()->width());
        }
    }

    // However the panel came to show a tool, every control fits the view:
    // shown before the panel itself is, in a panel without a scroll bar
    // (Qt hides the bar's container, never the bar: the bar says nothing),
    // or after a tool long enough to need the bar that this one does not.
    void controlsFitTheViewAfterAnyPath_data()
    {
        QTest::addColumn<bool>("showPanelFirst");
        QTest::addColumn<int>("before");
        QTest::newRow("tool before the panel shows") << false << 0;
        QTest::newRow("short tool in a shown panel") << true << 0;
        QTest::newRow("short tool after a long one") << true << 200;
        QTest::newRow("long tool after a short one") << true << 3;
    }

    void controlsFitTheViewAfterAnyPath()
    {
        QFETCH(bool, showPanelFirst);
        QFETCH(int, before);
        OrbaneDoc doc;
        Operator *previous = before ? AddCheckBoxTool(doc, "Before1", before) : nullptr;
        Operator *tool = AddCheckBoxTool(doc, "Shown1", before == 3 ? 200 : 3);
        ParameterPanel panel(&doc);
        panel.resize(300, 400);
        if (showPanelFirst)
            panel.show();
        panel.ShowTool(previous);
        QCoreApplication::processEvents();
        panel.ShowTool(tool);
        panel.show();
        QCoreApplication::processEvents();
        for (InputControl *c : panel.Controls())
            QVERIFY2(
                c->geometry().right() < panel.viewport()->width() && c->width() > panel.viewport()->width() - 20,
                qPrintable(QString("control %1 wide in a view of %2").arg(c->width()).arg(panel.viewport()->width())));
    }

    // An unknown class gets the fallback, which shows its Input read-only, and a warning.
    void fallbackShowsTheValueReadOnly()
    {
        QTest::ignoreMessage(QtWarningMsg,
                             QRegularExpression("Input \"Blend Gain\" .*\"NoSuchControl\", which is unknown"));
        const char *lua = R"(return { inputs = { { id = "Gain", name = "Blend Gain", type = "Number",
            default = 0.25, control = "NoSuchControl" } }})";
        Shown s(lua);
        QCOMPARE(s.panel.Controls().size(), size_t(1));
        auto *fallback = dynamic_cast<FallbackControl *>(s.panel.Controls().front());
        QVERIFY(fallback);
        QCOMPARE(fallback->ValueText(), QString("0.25"));
        s.tool->FindInput("Gain")->SetValue(AutoNumber(0.5).get(), 0.0);
        QCOMPARE(fallback->ValueText(), QString("0.5"));
        QCOMPARE(fallback->findChildren<QLabel *>().front()->text(), QString("Blend Gain"));
    }

    // Removing the tool unbinds every control: nothing watches its Inputs.
    void toolRemovalUnbindsAndDestroys()
    {
        Shown s(kSwitches);
        AutoRef<Operator> keep = AutoRef<Operator>::Share(s.tool);
        QPointer<QWidget> first = s.panel.Controls().front();
        QCOMPARE(s.tool->FindInput("B")->Watchers().size(), size_t(2));
        s.doc.RemoveTool(s.tool);
        QVERIFY(!s.panel.GetTool());
        QVERIFY(s.panel.Controls().empty());
        QVERIFY2(first.isNull(), "the control is destroyed");
        for (Input *in : keep->Inputs())
            QVERIFY(in->Watchers().empty());
    }

    // A large tool builds what the view shows (and a first batch), each
    // control bound, opened and sized, one under the other; scrolling builds
    // on in Input order up to the end.
    void largeToolBuildsWhatShowsAndTheRestOnScrolling()
    {
        OrbaneDoc doc;
        Operator *tool = AddCheckBoxTool(doc, "Large1", 1000);
        QVERIFY(tool);
        ParameterPanel panel(&doc);
        panel.resize(300, 400);
        panel.show();
        panel.ShowTool(tool);
        QCOMPARE(panel.ControlCount(), size_t(1000));
        QVERIFY(panel.Controls().size() >= ParameterPanel::kFirstBuilt && panel.Controls().size() < 1000);
        QScrollBar *bar = panel.verticalScrollBar();
        for (int guard = 0; panel.Controls().size() < 1000 && guard < 1000; ++guard)
            bar->setValue(bar->maximum());
        QCOMPARE(panel.Controls().size(), size_t(1000));
        int top = panel.Controls().front()->y();
        for (size_t i = 0; i < panel.Controls().size(); ++i) {
            InputControl *c = panel.Controls()[i];
            QCOMPARE(c->Inputs(), std::vector<Input *>{tool->Inputs()[i]});
            QVERIFY(c->IsOpen() && c->isVisible() && c->parentWidget() == panel.widget());
            QVERIFY2(c->height() > 0 && c->y() == top, "sized and placed under the one before");
            top = c->geometry().bottom() + 1;
        }
        QVERIFY2(panel.widget()->height() >= top, "the page holds every control");
    }

    // Leaving the tool writes back through every built control, in order, and
    // through no other; a control a script still holds outlives its page.
    void leavingWritesThroughTheBuiltControlsOnly()
    {
        OrbaneDoc doc;
        Operator *tool = AddCheckBoxTool(doc, "Large1", 1000);
        Operator *other = AddCheckBoxTool(doc, "Small1", 1);
        QVERIFY(tool && other);
        WriteLog log;
        for (Input *in : tool->Inputs())
            in->AttachWatcher(&log);
        ParameterPanel panel(&doc);
        panel.resize(300, 400);
        panel.show();
        panel.ShowTool(tool);
        Input *asked = tool->Inputs()[600];
        QCOMPARE(panel.ControlsOf(asked).size(), size_t(1));
        QCOMPARE(panel.Controls().size(), size_t(601));
        QPointer<InputControl> held = panel.Controls().front(), dropped = panel.Controls().back();
        held->IncRef();
        panel.ShowTool(other);
        const std::vector<Input *> built(tool->Inputs().begin(), tool->Inputs().begin() + 601);
        QVERIFY(log.written == built);
        QVERIFY(dropped.isNull());
        QVERIFY(held && !held->parentWidget() && held->Inputs().empty());
        held->DecRef();
        QVERIFY(held.isNull());
        for (Input *in : tool->Inputs())
            in->DetachWatcher(&log);
    }

    void badDescriptionsFailWithClearMessages_data()
    {
        QTest::addColumn<QString>("input");
        QTest::addColumn<QString>("message");
        QTest::newRow("unknown tag") << R"({ id = "A", control = "CheckboxControl", tags = { CBC_Tristate = true } })"
                                     << R"(Input "A": unknown tag "CBC_Tristate" for CheckboxControl)";
        QTest::newRow("wrong tag type")
            << R"({ id = "A", control = "CheckboxControl", tags = { CBC_TriState = "yes" } })"
            << R"(Input "A": CBC_TriState: expected a boolean, got string)";
        QTest::newRow("default of another type")
            << R"({ id = "A", default = "x" })"
            << R"(Input "A": default: expected a value of type Number, got string)";
        QTest::newRow("no id") << R"({ name = "A" })"
                               << R"(an Input needs an id)";
    }

    void badDescriptionsFailWithClearMessages()
    {
        QFETCH(QString, input);
        QFETCH(QString, message);
        OrbaneDoc doc;
        std::string why;
        QVERIFY(!AddTool(doc, ("return { inputs = { " + input + " } }").toUtf8().constData(), "T", &why));
        QCOMPARE(QString::fromStdString(why), "tool \"T\": " + message);
        QVERIFY(doc.Tools().empty());
    }
};

QTEST_MAIN(ParameterPanelTest)
#include "ParameterPanelTest.moc"
