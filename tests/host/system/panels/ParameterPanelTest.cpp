// The inspector as the application uses it: a tool described in Lua, its
// controls built in Input order from the classes the Inputs name, sized on
// every width change, and unbound and destroyed when the tool goes.
#include "ToolFixture.h"

#include "orbane/AutoParam.h"
#include "orbane/FallbackControl.h"
#include "orbane/Input.h"
#include "orbane/ParameterPanel.h"
#include "orbane/LuaRuntime.h"
#include "orbane/Operator.h"
#include "orbane/OrbaneDoc.h"
#include "orbane/ScriptVal.h"
#include "orbane/ToolLoader.h"

#include <QLabel>
#include <QRegularExpression>
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
    if (tool && !doc.AddTool(tool.get()))
        return nullptr;
    return tool.get();
}

const char *kSwitches = R"(return { type = "Switches", inputs = {
    { id = "A", type = "Number", default = 1, control = "CheckboxControl" },
    { id = "B", type = "Number", default = 0, control = { "CheckboxControl", "CheckboxControl" },
      tags = { CBC_TriState = true } },
    { id = "C", name = "Go", type = "Number", control = "ButtonControl" },
}})";

} // namespace

class ParameterPanelTest : public QObject
{
    Q_OBJECT

private slots:
    void initTestCase()
    {
        std::string why;
        QVERIFY2(Test::ToolFixture::LoadControls(&why), why.c_str());
    }

    void buildsControlsInInputOrder()
    {
        OrbaneDoc doc;
        std::string why;
        Operator *tool = AddTool(doc, kSwitches, "Switches1", &why);
        QVERIFY2(tool, why.c_str());
        ParameterPanel panel(&doc);
        panel.resize(300, 400);
        panel.show();
        panel.ShowTool(tool);

        QCOMPARE(panel.Controls().size(), size_t(4));
        QCOMPARE(panel.ControlsOf(tool->FindInput("B")).size(), size_t(2));
        QStringList classes;
        int lastBottom = 0;
        for (InputControl *c : panel.Controls()) {
            classes << c->ScriptTypeName();
            QVERIFY2(c->geometry().top() >= lastBottom, "controls stack top to bottom");
            lastBottom = c->geometry().bottom();
        }
        QCOMPARE(classes, QStringList({"CheckboxControl", "CheckboxControl", "CheckboxControl", "ButtonControl"}));
    }

    // Every control follows the panel's width, inside it, without a horizontal scroll.
    void sizesAgainOnWidthChange()
    {
        OrbaneDoc doc;
        std::string why;
        Operator *tool = AddTool(doc, kSwitches, "Switches1", &why);
        QVERIFY2(tool, why.c_str());
        ParameterPanel panel(&doc);
        panel.resize(300, 400);
        panel.show();
        panel.ShowTool(tool);
        for (int width : {240, 520}) {
            panel.resize(width, 400);
            QCoreApplication::processEvents();
            for (InputControl *c : panel.Controls()) {
                QVERIFY(c->width() > panel.viewport()->width() - 20);
                QVERIFY(c->geometry().right() < panel.viewport()->width());
            }
        }
    }

    void unknownClassGetsTheFallbackAndAWarning()
    {
        OrbaneDoc doc;
        std::string why;
        Operator *tool = AddTool(doc, R"(return { inputs = {
            { id = "Gain", type = "Number", default = 0.25, control = "NoSuchControl" } }})",
                                 "Tool1", &why);
        QVERIFY2(tool, why.c_str());
        ParameterPanel panel(&doc);
        QTest::ignoreMessage(QtWarningMsg, QRegularExpression("Input \"Gain\" .*\"NoSuchControl\", which is unknown"));
        panel.ShowTool(tool);
        QCOMPARE(panel.Controls().size(), size_t(1));
        auto *fallback = dynamic_cast<FallbackControl *>(panel.Controls().front());
        QVERIFY(fallback);
        QCOMPARE(fallback->ValueText(), QString("0.25"));
        tool->FindInput("Gain")->SetValue(AutoNumber(0.5).get(), 0.0);
        QCOMPARE(fallback->ValueText(), QString("0.5"));
    }

    // A registered class whose control is not written yet still shows its
    // Input read-only, without a warning: the class is known.
    void unwrittenControlShowsItsInputReadOnly()
    {
        OrbaneDoc doc;
        std::string why;
        Operator *tool = AddTool(doc, R"(return { inputs = {
            { id = "Mode", name = "Blend Mode", type = "Number", default = 3, control = "MultiButtonControl" } }})",
                                 "Tool1", &why);
        QVERIFY2(tool, why.c_str());
        ParameterPanel panel(&doc);
        panel.ShowTool(tool);
        auto *fallback = dynamic_cast<FallbackControl *>(panel.Controls().front());
        QVERIFY(fallback);
        QCOMPARE(fallback->ScriptTypeName(), "MultiButtonControl");
        QCOMPARE(fallback->ValueText(), QString("3"));
        const auto labels = fallback->findChildren<QLabel *>();
        QCOMPARE(labels.size(), 2);
        QCOMPARE(labels.front()->text(), QString("Blend Mode"));
    }

    // Removing the tool unbinds every control: nothing watches its Inputs.
    void toolRemovalUnbindsAndDestroys()
    {
        OrbaneDoc doc;
        std::string why;
        Operator *tool = AddTool(doc, kSwitches, "Switches1", &why);
        QVERIFY2(tool, why.c_str());
        AutoRef<Operator> keep = AutoRef<Operator>::Share(tool);
        ParameterPanel panel(&doc);
        panel.ShowTool(tool);
        QPointer<QWidget> first = panel.Controls().front();
        QCOMPARE(tool->FindInput("B")->Watchers().size(), size_t(2));
        doc.RemoveTool(tool);
        QVERIFY(!panel.GetTool());
        QVERIFY(panel.Controls().empty());
        QVERIFY2(first.isNull(), "the control is destroyed");
        for (Input *in : tool->Inputs())
            QVERIFY(in->Watchers().empty());
    }

    void badDescriptionsFailWithClearMessages_data()
    {
        QTest::addColumn<QString>("lua");
        QTest::addColumn<QString>("message");
        QTest::newRow("unknown tag") << R"(return { inputs = { { id = "A", control = "CheckboxControl",
            tags = { CBC_Tristate = true } } } })"
                                     << R"(tool "T": Input "A": unknown tag "CBC_Tristate" for CheckboxControl)";
        QTest::newRow("wrong tag type") << R"(return { inputs = { { id = "A", control = "CheckboxControl",
            tags = { CBC_TriState = "yes" } } } })"
                                        << R"(tool "T": Input "A": CBC_TriState: expected a boolean, got string)";
        QTest::newRow("default of another type")
            << R"(return { inputs = { { id = "A", default = "x" } } })"
            << R"(tool "T": Input "A": default: expected a value of type Number, got string)";
        QTest::newRow("no id") << R"(return { inputs = { { name = "A" } } })"
                               << R"(tool "T": an Input needs an id)";
    }

    void badDescriptionsFailWithClearMessages()
    {
        QFETCH(QString, lua);
        QFETCH(QString, message);
        OrbaneDoc doc;
        std::string why;
        QVERIFY(!AddTool(doc, lua.toUtf8().constData(), "T", &why));
        QCOMPARE(QString::fromStdString(why), message);
        QVERIFY(doc.Tools().empty());
    }
};

QTEST_MAIN(ParameterPanelTest)
#include "ParameterPanelTest.moc"
