#include "ToolFixture.h"

#include "orbane/CustomButton.h"
#include "orbane/ElideLabel.h"
#include "orbane/Input.h"
#include "orbane/LuaRuntime.h"
#include "orbane/Operator.h"

#include <QtTest>

using namespace Orbane;
using namespace Orbane::Test;

Q_DECLARE_METATYPE(Orbane::TagList)

namespace {

constexpr Tag kExecute = 0x30050000;

CustomButton *ButtonOf(const InputControl *c)
{
    return c->findChild<CustomButton *>("button");
}

ElideLabel *LabelOf(const InputControl *c)
{
    return c->findChild<ElideLabel *>("label");
}

InputControl *Button(ToolFixture &f, Input *in)
{
    return f.Create(OrbID("ButtonControl"), {in});
}

void Click(InputControl *c, Qt::KeyboardModifiers modifiers = Qt::NoModifier)
{
    CustomButton *button = ButtonOf(c);
    QTest::mouseClick(button, Qt::LeftButton, modifiers, button->rect().center());
}

// The value of a script expression, read off the stack by `read`.
template <class T> T Eval(const std::string &expr, T (*read)(lua_State *, int))
{
    LuaRuntime &lua = LuaRuntime::Instance();
    if (!lua.RunString("return " + expr, "check", nullptr, 1))
        return T();
    const T value = read(lua.State(), -1);
    lua_pop(lua.State(), 1);
    return value;
}

} // namespace

class ButtonControlTest : public QObject
{
    Q_OBJECT
private slots:
    void initTestCase();
    void cleanup();
    void scriptSeesToolSelfModifiers_data();
    void scriptSeesToolSelfModifiers();
    void pressRunsScriptAndRequestsRender_data();
    void pressRunsScriptAndRequestsRender();
    void secondLabel_data();
    void secondLabel();
};

void ButtonControlTest::initTestCase()
{
    std::string error;
    QVERIFY2(ToolFixture::LoadControls(&error), error.c_str());
}

// The scripts' globals hold the tool and the control: let them go first.
void ButtonControlTest::cleanup()
{
    LuaRuntime::Instance().RunString("pressed, presses, after = nil collectgarbage()", "cleanup");
}

void ButtonControlTest::scriptSeesToolSelfModifiers_data()
{
    QTest::addColumn<Qt::KeyboardModifiers>("modifiers");
    QTest::newRow("plain") << Qt::KeyboardModifiers(Qt::NoModifier);
    QTest::newRow("control alt") << (Qt::ControlModifier | Qt::AltModifier);
}

void ButtonControlTest::scriptSeesToolSelfModifiers()
{
    QFETCH(Qt::KeyboardModifiers, modifiers);
    ToolFixture f;
    Input *in =
        f.AddNumber("Go", 0.0, TagList{{kExecute, "pressed = { tool = tool, self = self, modifiers = modifiers }"}});
    InputControl *c = Button(f, in);
    Click(c, modifiers);
    QCOMPARE(Eval("pressed.tool", LuaRuntime::ToObject), static_cast<ScriptObject *>(f.tool));
    QCOMPARE(Eval("pressed.self", LuaRuntime::ToObject), static_cast<ScriptObject *>(c));
    QCOMPARE(Eval("pressed.modifiers", lua_tonumber), double(int(modifiers)));
    QCOMPARE(f.NumberOf(in), 0.0);
    QVERIFY(f.doc.UndoNames().isEmpty());
}

void ButtonControlTest::pressRunsScriptAndRequestsRender_data()
{
    QTest::addColumn<bool>("passive");
    QTest::addColumn<int>("renders"); // per press
    QTest::newRow("changes the image") << false << 1;
    QTest::newRow("passive Input") << true << 0;
}

void ButtonControlTest::pressRunsScriptAndRequestsRender()
{
    QFETCH(bool, passive);
    QFETCH(int, renders);
    ToolFixture f;
    Input *in = f.AddNumber("Go", 0.0, TagList{{kExecute, "presses = (presses or 0) + 1"}, {ICA_Passive, passive}});
    InputControl *c = Button(f, in);
    QSignalSpy render(&f.doc, SIGNAL(syncRenderRequested()));
    QSignalSpy scripting(&f.doc, SIGNAL(scriptingUpdateRequested()));
    Click(c);
    Click(c);
    QCOMPARE(Eval("presses", lua_tonumber), 2.0);
    // An empty script runs nothing; the rest of the press still happens.
    QVERIFY(c->SetAttrsTagList(in, TagList{{kExecute, ""}}));
    Click(c);
    QCOMPARE(Eval("presses", lua_tonumber), 2.0);
    QCOMPARE(render.count(), 3 * renders);
    QCOMPARE(scripting.count(), 3);
}

void ButtonControlTest::secondLabel_data()
{
    QTest::addColumn<QString>("second");
    QTest::newRow("empty") << "";
    QTest::newRow("given") << "Options";
}

void ButtonControlTest::secondLabel()
{
    QFETCH(QString, second);
    ToolFixture f;
    const QByteArray text = second.toUtf8();
    Input *in = f.AddNumber("Go", 0.0, TagList{{0x30040000, "Apply"}, {0x30040001, text.constData()}});
    InputControl *c = Button(f, in);
    QCOMPARE(ButtonOf(c)->GetLabel(), QString("Apply"));
    QCOMPARE(LabelOf(c)->isHidden(), second.isEmpty());
    QCOMPARE(LabelOf(c)->text(), second);
    if (!second.isEmpty())
        QVERIFY(LabelOf(c)->geometry().right() < ButtonOf(c)->geometry().left());
    // Texts and the disabled state change at once.
    const QByteArray other = second.isEmpty() ? QByteArray("More") : QByteArray();
    QVERIFY(c->SetAttrsTagList(in, TagList{{0x30040000, "Run"}, {0x30040001, other.constData()}, {ICA_Disabled, 1}}));
    QCOMPARE(LabelOf(c)->isHidden(), other.isEmpty());
    QCOMPARE(ButtonOf(c)->GetLabel(), QString("Run"));
    QVERIFY(!ButtonOf(c)->isEnabled());
}

QTEST_MAIN(ButtonControlTest)
#include "ButtonControlTest.moc"
