#include "UiScripting.h"

#include "CompScripting.h"
#include "ExpressionScripting.h"
#include "ImageScripting.h"
#include "MainWindow.h"
#include "ScriptHands.h"
#include "UiTarget.h"
#include "ValueScripting.h"
#include "ViewerScripting.h"
#include "WindowScripting.h"

#include "orbane/AutoParam.h"
#include "orbane/CustomButton.h"
#include "orbane/Input.h"
#include "orbane/InputControl.h"
#include "orbane/LuaArgs.h"
#include "orbane/LuaRuntime.h"
#include "orbane/LuaSandbox.h"
#include "orbane/Operator.h"
#include "orbane/OrbaneDoc.h"
#include "orbane/ParameterScript.h"
#include "orbane/ScriptError.h"
#include "orbane/ScriptVal.h"
#include "orbane/ToolLoader.h"

#include <QAbstractButton>
#include <QApplication>
#include <QClipboard>
#include <QComboBox>
#include <QKeySequence>
#include <QLabel>
#include <QLineEdit>
#include <QMouseEvent>
#include <QTest>
#include <QUndoStack>

namespace Orbane {

namespace {

using Hands = ScriptHands;

// A drag takes this many steps at most, typing this many characters: each is
// an event sent while the script waits.
constexpr int kMaxSteps = 10000;
constexpr int kMaxTyped = 10000;

OrbaneDoc *gDoc = nullptr;
MainWindow *gWindow = nullptr;

QWidget *TargetOrRaise(lua_State *L, int idx, InputControl **control = nullptr)
{
    UiTarget t = UiTarget::Resolve(L, idx, gWindow);
    if (!t.widget)
        Hands::Raise(L, t.error);
    if (control)
        *control = t.control;
    return t.widget;
}

Input *InputArg(const LuaArgs &args)
{
    return Hands::InputArg(args, gDoc);
}

float64 TimeArg(const LuaArgs &args, int idx)
{
    return Hands::TimeArg(args, gDoc, idx);
}

void PushNames(lua_State *L, const QStringList &names)
{
    lua_createtable(L, names.size(), 0);
    for (int i = 0; i < names.size(); ++i) {
        lua_pushstring(L, names[i].toUtf8().constData());
        lua_rawseti(L, -2, i + 1);
    }
}

// --- document ---

int LoadComp(lua_State *L)
{
    std::string why;
    if (!ToolLoader::LoadComp(*gDoc, LuaArgs(L, "LoadComp").String(1, "path"), &why))
        return Hands::Raise(L, QString::fromStdString(why));
    if (!gDoc->Tools().empty())
        gWindow->ShowTool(QString::fromUtf8(gDoc->Tools().front()->GetName()));
    return 0;
}

int LoadTool(lua_State *L)
{
    const LuaArgs args(L, "LoadTool");
    std::string why;
    AutoRef<Operator> tool(ToolLoader::LoadTool(args.String(1, "path"), args.String(2, "name"), &why));
    if (!tool)
        return Hands::Raise(L, QString::fromStdString(why));
    if (!gDoc->AddTool(tool.get()))
        return Hands::Raise(L, QString("a tool named \"%1\" exists already").arg(lua_tostring(L, 2)));
    return 0;
}

int Tools(lua_State *L)
{
    QStringList names;
    for (Operator *tool : gDoc->Tools())
        names << QString::fromUtf8(tool->GetName());
    PushNames(L, names);
    return 1;
}

int ShowTool(lua_State *L)
{
    if (!gWindow->ShowTool(QString::fromUtf8(LuaArgs(L, "ShowTool").String(1, "tool"))))
        return Hands::Raise(L, QString("no tool \"%1\"").arg(lua_tostring(L, 1)));
    return 0;
}

int GetValue(lua_State *L)
{
    const LuaArgs args(L, "GetValue");
    Input *input = InputArg(args);
    AutoParameter value(input->GetValue(TimeArg(args, 3)));
    LuaRuntime::Push(L, ParameterScript::ToScript(value.get()));
    return 1;
}

// A script's write: one undo step, like any other edit.
int SetValue(lua_State *L)
{
    const LuaArgs args(L, "SetValue");
    Input *input = InputArg(args);
    const float64 time = TimeArg(args, 4);
    std::string why;
    AutoParameter value(ParameterScript::FromScript(input->GetDataType(), args.Value(3, "value"), &why));
    if (!value)
        args.Fail(3, "value", std::string("Input \"") + input->GetName() + "\": " + why);
    if (!input->SetValue(value.get(), time, 0, nullptr) && HasScriptError())
        return Hands::Raise(L, QString::fromStdString(TakeScriptError()));
    return 0;
}

int GetTime(lua_State *L)
{
    lua_pushnumber(L, gDoc->GetCurrentTime());
    return 1;
}

int SetTime(lua_State *L)
{
    gDoc->SetCurrentTime(LuaArgs(L, "SetTime").Number(1, "time"));
    return 0;
}

int Undo(lua_State *L)
{
    lua_pushboolean(L, gDoc->Undo());
    return 1;
}

int Redo(lua_State *L)
{
    lua_pushboolean(L, gDoc->Redo());
    return 1;
}

int UndoNames(lua_State *L)
{
    PushNames(L, gDoc->UndoNames());
    return 1;
}

int RedoNames(lua_State *L)
{
    PushNames(L, gDoc->RedoNames());
    return 1;
}

// The control object itself, for ffi casts and attributes.
int Control(lua_State *L)
{
    InputControl *control = nullptr;
    TargetOrRaise(L, 1, &control);
    LuaRuntime::PushObject(L, control);
    return 1;
}

// --- a person's hands ---

int Press(lua_State *L)
{
    QWidget *w = TargetOrRaise(L, 1);
    const UiGesture g = UiGesture::Read(LuaArgs(L, "Press"), 2);
    Hands::SendMouse(w, QEvent::MouseButtonPress, g.At(w), g.button, g.button, g.mods);
    return 0;
}

int Release(lua_State *L)
{
    QWidget *w = TargetOrRaise(L, 1);
    const UiGesture g = UiGesture::Read(LuaArgs(L, "Release"), 2);
    Hands::SendMouse(w, QEvent::MouseButtonRelease, g.At(w), g.button, Qt::NoButton, g.mods);
    return 0;
}

// A move with the button held (a drag step), or a hover with button = "none".
int Move(lua_State *L)
{
    QWidget *w = TargetOrRaise(L, 1);
    const UiGesture g = UiGesture::Read(LuaArgs(L, "Move"), 2);
    bool hover = false;
    if (lua_istable(L, 2)) {
        lua_getfield(L, 2, "button");
        hover = lua_isstring(L, -1) && QByteArray(lua_tostring(L, -1)) == "none";
        lua_pop(L, 1);
    }
    Hands::SendMouse(w, QEvent::MouseMove, g.At(w), Qt::NoButton, hover ? Qt::NoButton : g.button, g.mods);
    return 0;
}

int Click(lua_State *L)
{
    QWidget *w = TargetOrRaise(L, 1);
    const UiGesture g = UiGesture::Read(LuaArgs(L, "Click"), 2);
    QTest::mouseClick(w, g.button, g.mods, g.At(w));
    return 0;
}

// A double click as Qt delivers it: press, release, double-click, release.
int DoubleClick(lua_State *L)
{
    QWidget *w = TargetOrRaise(L, 1);
    const UiGesture g = UiGesture::Read(LuaArgs(L, "DoubleClick"), 2);
    QTest::mouseDClick(w, g.button, g.mods, g.At(w));
    return 0;
}

// Drag(target, {x =, y =}, {x =, y =}, {mods =, steps =}): press, moves in
// steps, release; one gesture.
int Drag(lua_State *L)
{
    const LuaArgs args(L, "Drag");
    QWidget *w = TargetOrRaise(L, 1);
    const UiGesture from = UiGesture::Read(args, 2), to = UiGesture::Read(args, 3), opts = UiGesture::Read(args, 4);
    const int steps = args.OptTable(4, "options") ? args.IntegerField(4, "steps", 1, kMaxSteps, 10) : 10;
    const QPoint a = from.At(w), b = to.At(w);
    Hands::SendMouse(w, QEvent::MouseButtonPress, a, opts.button, opts.button, opts.mods);
    for (int i = 1; i <= steps; ++i)
        Hands::SendMouse(w, QEvent::MouseMove, a + (b - a) * i / steps, Qt::NoButton, opts.button, opts.mods);
    Hands::SendMouse(w, QEvent::MouseButtonRelease, b, opts.button, Qt::NoButton, opts.mods);
    return 0;
}

// Key(target, "Left", "shift"[, "press"|"release"]).
int Key(lua_State *L)
{
    const LuaArgs args(L, "Key");
    QWidget *w = TargetOrRaise(L, 1);
    const int key = Hands::KeyCode(args, 2);
    const Qt::KeyboardModifiers mods = UiGesture::ModifiersArg(args, 3, "mods", args.OptString(3, "mods", ""));
    const QByteArray phase = Hands::KeyPhase(args, 4);
    if (phase != "release")
        QTest::keyPress(w, Qt::Key(key), mods);
    if (phase != "press")
        QTest::keyRelease(w, Qt::Key(key), mods);
    return 0;
}

// Types text as a keyboard would. QTest's own typing knows only the ASCII
// keys (others stop it with an assertion): a character beyond them arrives
// as a key event that carries the character but no key of its own.
void TypeText(QWidget *w, const QString &text)
{
    for (const uint code : text.toUcs4()) {
        const bool keyed = (code >= 0x20 && code < 0x7f) || code == '\t' || code == '\n' || code == '\b';
        if (keyed)
            QTest::keyClick(w, char(code));
        else
            QTest::sendKeyEvent(QTest::Click, w, Qt::Key_unknown, QString::fromUcs4(&code, 1), Qt::NoModifier);
    }
}

int Type(lua_State *L)
{
    const LuaArgs args(L, "Type");
    QWidget *w = TargetOrRaise(L, 1);
    const QString text = QString::fromUtf8(args.String(2, "text"));
    if (text.size() > kMaxTyped)
        args.Fail(2, "text", "longer than " + std::to_string(kMaxTyped) + " characters");
    TypeText(w, text);
    return 0;
}

int Grab(lua_State *L)
{
    QWidget *w = TargetOrRaise(L, 1);
    const char *path = LuaArgs(L, "Grab").String(2, "path");
    if (!w->grab().save(QString::fromUtf8(path)))
        return Hands::Raise(L, QString("cannot write %1").arg(path));
    return 0;
}

QString TextOf(QWidget *w)
{
    if (auto *edit = qobject_cast<QLineEdit *>(w))
        return edit->text();
    if (auto *label = qobject_cast<QLabel *>(w))
        return label->text();
    if (auto *button = qobject_cast<CustomButton *>(w))
        return button->GetLabel();
    if (auto *combo = qobject_cast<QComboBox *>(w))
        return combo->currentText();
    if (auto *plain = qobject_cast<QAbstractButton *>(w))
        return plain->text();
    return QString();
}

// State(target) -> { visible, enabled, x, y, width, height, text, tip, check }.
int State(lua_State *L)
{
    QWidget *w = TargetOrRaise(L, 1);
    lua_createtable(L, 0, 8);
    lua_pushboolean(L, w->isVisible());
    lua_setfield(L, -2, "visible");
    lua_pushboolean(L, w->isEnabled());
    lua_setfield(L, -2, "enabled");
    const QRect r = w->geometry();
    for (auto [key, v] : {std::pair{"x", r.x()}, {"y", r.y()}, {"width", r.width()}, {"height", r.height()}}) {
        lua_pushinteger(L, v);
        lua_setfield(L, -2, key);
    }
    lua_pushstring(L, TextOf(w).toUtf8().constData());
    lua_setfield(L, -2, "text");
    lua_pushstring(L, w->toolTip().toUtf8().constData());
    lua_setfield(L, -2, "tip");
    if (auto *button = qobject_cast<CustomButton *>(w)) {
        lua_pushinteger(L, button->GetCheck());
        lua_setfield(L, -2, "check");
    } else if (auto *plain = qobject_cast<QAbstractButton *>(w); plain && plain->isCheckable()) {
        lua_pushinteger(L, plain->isChecked() ? 1 : 0);
        lua_setfield(L, -2, "check");
    }
    return 1;
}

// The text on the clipboard, as a paste would give it.
int Clipboard(lua_State *L)
{
    lua_pushstring(L, QApplication::clipboard()->text().toUtf8().constData());
    return 1;
}

int Process(lua_State *)
{
    QApplication::processEvents();
    return 0;
}

} // namespace

void UiScripting::Install(OrbaneDoc *doc, MainWindow *window)
{
    gDoc = doc;
    gWindow = window;
    const std::pair<const char *, lua_CFunction> functions[] = {
        {"LoadComp", LoadComp}, {"LoadTool", LoadTool},   {"Tools", Tools},
        {"ShowTool", ShowTool}, {"GetValue", GetValue},   {"SetValue", SetValue},
        {"GetTime", GetTime},   {"SetTime", SetTime},     {"Undo", Undo},
        {"Redo", Redo},         {"UndoNames", UndoNames}, {"RedoNames", RedoNames},
        {"Control", Control},   {"Press", Press},         {"Release", Release},
        {"Move", Move},         {"Click", Click},         {"Drag", Drag},
        {"Key", Key},           {"Type", Type},           {"Grab", Grab},
        {"State", State},       {"Process", Process},     {"Clipboard", Clipboard},
    };
    for (const auto &[name, fn] : functions)
        LuaRuntime::Instance().AddModuleFunction(name, fn);
    LuaRuntime::Instance().AddModuleFunction("DoubleClick", DoubleClick);
    // What content (a button script) may do: read and write the document,
    // each write an undo step like any other.
    for (const char *name : {"Tools", "GetValue", "SetValue", "GetTime", "SetTime", "UndoNames", "RedoNames"})
        LuaSandbox::AllowCall(name);
    ViewerScripting::Install(window);
    ImageScripting::Install(doc, window);
    WindowScripting::Install(doc, window);
    ValueScripting::Install(doc);
    CompScripting::Install(doc, window);
    ExpressionScripting::Install(doc);
}

} // namespace Orbane
