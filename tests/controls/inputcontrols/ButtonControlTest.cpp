#include "ToolFixture.h"

#include "orbane/CustomButton.h"
#include "orbane/ElideLabel.h"
#include "orbane/Input.h"
#include "orbane/LuaRuntime.h"
#include "orbane/Operator.h"

#include <QSignalSpy>
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

// Reads and clears a global of the script state.
class LuaGlobal
{
public:
    explicit LuaGlobal(const char *name) : L(LuaRuntime::Instance().State()), mName(name) { lua_getglobal(L, name); }
    ~LuaGlobal()
    {
        lua_pop(L, 1);
        lua_pushnil(L);
        lua_setglobal(L, mName);
        lua_gc(L, LUA_GCCOLLECT, 0);
    }
    bool IsNil() const { return lua_isnil(L, -1); }
    double Number() const { return lua_tonumber(L, -1); }
    ScriptObject *Field(const char *key) const
    {
        lua_getfield(L, -1, key);
        ScriptObject *obj = LuaRuntime::ToObject(L, -1);
        lua_pop(L, 1);
        return obj;
    }
    double NumberField(const char *key) const
    {
        lua_getfield(L, -1, key);
        const double n = lua_tonumber(L, -1);
        lua_pop(L, 1);
        return n;
    }

private:
    lua_State *L;
    const char *mName;
};

} // namespace

class ButtonControlTest : public QObject
{
    Q_OBJECT
private slots:
    void initTestCase();
    void scriptSeesToolSelfModifiers_data();
    void scriptSeesToolSelfModifiers();
    void emptyScriptRunsNothing();
    void scriptErrorIsReported();
    void secondLabel_data();
    void secondLabel();
    void pressRequestsRender_data();
    void pressRequestsRender();
    void textsAndDisabledAtOnce();
    void layoutLoadedAtEachOpen();
};

void ButtonControlTest::initTestCase()
{
    std::string error;
    QVERIFY2(ToolFixture::LoadControls(&error), error.c_str());
}

void ButtonControlTest::scriptSeesToolSelfModifiers_data()
{
    QTest::addColumn<Qt::KeyboardModifiers>("modifiers");
    QTest::newRow("plain") << Qt::KeyboardModifiers(Qt::NoModifier);
    QTest::newRow("shift") << Qt::KeyboardModifiers(Qt::ShiftModifier);
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
    LuaGlobal pressed("pressed");
    QVERIFY(!pressed.IsNil());
    QCOMPARE(pressed.Field("tool"), static_cast<ScriptObject *>(f.tool));
    QCOMPARE(pressed.Field("self"), static_cast<ScriptObject *>(c));
    QCOMPARE(pressed.NumberField("modifiers"), double(int(modifiers)));
    // The press writes no value.
    QCOMPARE(f.NumberOf(in), 0.0);
    QVERIFY(f.doc.UndoNames().isEmpty());
}

void ButtonControlTest::emptyScriptRunsNothing()
{
    ToolFixture f;
    Input *in = f.AddNumber("Go", 0.0, TagList{{kExecute, "presses = (presses or 0) + 1"}});
    InputControl *c = Button(f, in);
    Click(c);
    Click(c);
    QCOMPARE(LuaGlobal("presses").Number(), 2.0);
    QVERIFY(c->SetAttrsTagList(in, TagList{{kExecute, ""}}));
    QSignalSpy scripting(&f.doc, SIGNAL(scriptingUpdateRequested()));
    Click(c);
    QVERIFY(LuaGlobal("presses").IsNil());
    // The rest of the press still happens.
    QCOMPARE(scripting.count(), 1);
}

void ButtonControlTest::scriptErrorIsReported()
{
    ToolFixture f("Grade1");
    Input *in = f.AddNumber("Go", 0.0, TagList{{kExecute, "local x = 1\nerror('boom')"}});
    InputControl *c = Button(f, in);
    QTest::ignoreMessage(QtWarningMsg, QRegularExpression("tool \"Grade1\".*Grade1\\.Go:2: boom"));
    Click(c);
    QVERIFY(c->SetAttrsTagList(in, TagList{{kExecute, "after = 1"}}));
    Click(c);
    QCOMPARE(LuaGlobal("after").Number(), 1.0);
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
    QCOMPARE(LabelOf(c)->elideMode(), int(ElideLabel::Elide_Right));
    if (!second.isEmpty())
        QVERIFY(LabelOf(c)->geometry().right() < ButtonOf(c)->geometry().left());
    // Toggling the second text shows or hides the label at once.
    const QByteArray other = second.isEmpty() ? QByteArray("More") : QByteArray();
    QVERIFY(c->SetAttrsTagList(in, TagList{{0x30040001, other.constData()}}));
    QCOMPARE(LabelOf(c)->isHidden(), other.isEmpty());
}

void ButtonControlTest::pressRequestsRender_data()
{
    QTest::addColumn<bool>("passive");
    QTest::addColumn<int>("renders");
    QTest::newRow("changes the image") << false << 1;
    QTest::newRow("passive Input") << true << 0;
}

void ButtonControlTest::pressRequestsRender()
{
    QFETCH(bool, passive);
    QFETCH(int, renders);
    ToolFixture f;
    InputControl *c = Button(f, f.AddNumber("Go", 0.0, TagList{{ICA_Passive, passive}}));
    QSignalSpy render(&f.doc, SIGNAL(syncRenderRequested()));
    QSignalSpy scripting(&f.doc, SIGNAL(scriptingUpdateRequested()));
    Click(c);
    QCOMPARE(render.count(), renders);
    QCOMPARE(scripting.count(), 1);
    QVERIFY(c->GetControlFlags() & InputControl::CF_ActionOnly);
}

void ButtonControlTest::textsAndDisabledAtOnce()
{
    ToolFixture f;
    Input *in = f.AddNumber("Go", 0.0);
    InputControl *c = Button(f, in);
    QCOMPARE(ButtonOf(c)->GetLabel(), QString("Go"));
    QVERIFY(ButtonOf(c)->isEnabled());
    QVERIFY(c->SetAttrsTagList(in, TagList{{0x30040000, "Run"}, {ICA_Disabled, 1}}));
    QCOMPARE(ButtonOf(c)->GetLabel(), QString("Run"));
    QVERIFY(!ButtonOf(c)->isEnabled());
    QSignalSpy scripting(&f.doc, SIGNAL(scriptingUpdateRequested()));
    Click(c);
    QCOMPARE(scripting.count(), 0);
    QVERIFY(c->SetAttrsTagList(in, TagList{{ICA_Disabled, 0}}));
    QVERIFY(ButtonOf(c)->isEnabled());
    TagList got;
    c->GetAttrsTagList(got);
    QCOMPARE(QString(got.GetString(0x30040000, "")), QString("Run"));
}

void ButtonControlTest::layoutLoadedAtEachOpen()
{
    ToolFixture f;
    const int32 before = InputControl::LayoutReadCount("Controls.Button.Layout");
    InputControl *a = Button(f, f.AddNumber("A", 0.0));
    Button(f, f.AddNumber("B", 0.0));
    QCOMPARE(InputControl::LayoutReadCount("Controls.Button.Layout"), before + 2);
    QVERIFY(a->FindLayoutObj("button"));
    QVERIFY(ButtonOf(a)->geometry().right() < ToolFixture::kWidth);
    QVERIFY(ButtonOf(a)->width() > ToolFixture::kWidth / 2);
}

QTEST_MAIN(ButtonControlTest)
#include "ButtonControlTest.moc"
