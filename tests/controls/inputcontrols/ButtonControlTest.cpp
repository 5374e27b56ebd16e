#include "ToolFixture.h"

#include "orbane/CustomButton.h"
#include "orbane/ElideLabel.h"
#include "orbane/Input.h"
#include "orbane/LuaRuntime.h"
#include "orbane/LuaSandbox.h"
#include "orbane/Operator.h"

#include <QtTest>

using namespace Orbane;
using namespace Orbane::Test;

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

// Button scripts run in the sandbox, away from the globals: they report to
// the test through a call that content is allowed to make. It keeps what it
// was given as the global `pressed` and counts the calls in `presses`.
int Note(lua_State *L)
{
    lua_pushvalue(L, 1);
    lua_setglobal(L, "pressed");
    lua_getglobal(L, "presses");
    lua_pushnumber(L, lua_tonumber(L, -1) + 1);
    lua_setglobal(L, "presses");
    return 0;
}

} // namespace

class ButtonControlTest : public QObject
{
    Q_OBJECT
private slots:
    void initTestCase();
    void cleanup();
    void pressRunsScript_data();
    void pressRunsScript();
    void secondLabel();
};

void ButtonControlTest::initTestCase()
{
    std::string error;
    QVERIFY2(ToolFixture::LoadControls(&error), error.c_str());
    LuaRuntime::Instance().AddModuleFunction("Note", Note);
    LuaSandbox::AllowCall("Note");
}

// The scripts' globals hold the tool and the control: let them go first.
void ButtonControlTest::cleanup()
{
    LuaRuntime::Instance().RunString("pressed, presses = nil collectgarbage()", "cleanup");
}

// A press runs the script with the tool, the control and the modifiers; an
// empty script runs nothing, but the rest of the press still happens: a render
// unless the Input is passive, and the scripting update. Nothing is written.
void ButtonControlTest::pressRunsScript_data()
{
    QTest::addColumn<Qt::KeyboardModifiers>("modifiers");
    QTest::addColumn<bool>("passive");
    QTest::newRow("plain") << Qt::KeyboardModifiers(Qt::NoModifier) << false;
    QTest::newRow("control alt, passive") << (Qt::ControlModifier | Qt::AltModifier) << true;
}

void ButtonControlTest::pressRunsScript()
{
    QFETCH(Qt::KeyboardModifiers, modifiers);
    QFETCH(bool, passive);
    ToolFixture f;
    Input *in = f.AddNumber("Go", 0.0,
                            TagList{{kExecute, "orbane.Note({ tool = tool, self = self, modifiers = modifiers })"},
                                    {ICA_Passive, passive}});
    InputControl *c = Button(f, in);
    QSignalSpy render(&f.doc, SIGNAL(syncRenderRequested()));
    QSignalSpy scripting(&f.doc, SIGNAL(scriptingUpdateRequested()));
    Click(c, modifiers);
    Click(c, modifiers);
    QCOMPARE(Eval("pressed.tool", LuaRuntime::ToObject), static_cast<ScriptObject *>(f.tool));
    QCOMPARE(Eval("pressed.self", LuaRuntime::ToObject), static_cast<ScriptObject *>(c));
    QCOMPARE(Eval("pressed.modifiers", lua_tonumber), double(int(modifiers)));
    QVERIFY(c->SetAttrsTagList(in, TagList{{kExecute, ""}}));
    Click(c);
    QCOMPARE(Eval("presses", lua_tonumber), 2.0);
    QCOMPARE(render.count(), passive ? 0 : 3);
    QCOMPARE(scripting.count(), 3);
    QCOMPARE(f.NumberOf(in), 0.0);
    QVERIFY(f.doc.UndoNames().isEmpty());
}

// The second text sits left of the button (whether it is shown is the
// labelled base's rule); texts and the disabled state change at once.
void ButtonControlTest::secondLabel()
{
    ToolFixture f;
    Input *in = f.AddNumber("Go", 0.0, TagList{{0x30040000, "Apply"}, {0x30040001, "Options"}});
    InputControl *c = Button(f, in);
    QCOMPARE(ButtonOf(c)->GetLabel(), QString("Apply"));
    QVERIFY(LabelOf(c)->geometry().right() < ButtonOf(c)->geometry().left());
    QVERIFY(c->SetAttrsTagList(in, TagList{{0x30040000, "Run"}, {0x30040001, ""}, {ICA_Disabled, 1}}));
    QVERIFY(LabelOf(c)->isHidden());
    QCOMPARE(ButtonOf(c)->GetLabel(), QString("Run"));
    QVERIFY(!ButtonOf(c)->isEnabled());
}

QTEST_MAIN(ButtonControlTest)
#include "ButtonControlTest.moc"
