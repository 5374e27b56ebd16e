#include "WindowScripting.h"

#include "AutoSave.h"
#include "FileMenu.h"
#include "MainWindow.h"
#include "ScriptHands.h"
#include "TimeRuler.h"
#include "TimeScale.h"
#include "UiTarget.h"
#include "UndoHistoryDock.h"

#include "orbane/Input.h"
#include "orbane/InputControl.h"
#include "orbane/LuaArgs.h"
#include "orbane/LuaRuntime.h"
#include "orbane/Operator.h"
#include "orbane/OrbaneDoc.h"

#include <QAccessible>
#include <QMenu>
#include <QMenuBar>

namespace Orbane {

namespace {

using Hands = ScriptHands;

MainWindow *gWindow = nullptr;
OrbaneDoc *gDoc = nullptr;

// Menu texts as a person reads them: no mnemonic marks, no trailing dots.
QString Plain(QString text)
{
    text.remove('&');
    if (text.endsWith("..."))
        text.chop(3);
    return text;
}

// An entry by its text, or by its first words ("Undo" finds "Undo Move Points").
QAction *FindAction(const QList<QAction *> &actions, const QString &text)
{
    QAction *byStart = nullptr;
    for (QAction *action : actions) {
        const QString plain = Plain(action->text());
        if (plain == text)
            return action;
        if (!byStart && plain.startsWith(text + ' '))
            byStart = action;
    }
    return byStart;
}

void PushStrings(lua_State *L, const QStringList &items)
{
    lua_createtable(L, items.size(), 0);
    for (int i = 0; i < items.size(); ++i) {
        lua_pushstring(L, items[i].toUtf8().constData());
        lua_rawseti(L, -2, i + 1);
    }
}

void PushNumbers(lua_State *L, const std::vector<double> &items)
{
    lua_createtable(L, int(items.size()), 0);
    for (std::size_t i = 0; i < items.size(); ++i) {
        lua_pushnumber(L, items[i]);
        lua_rawseti(L, -2, int(i + 1));
    }
}

// { text =, enabled =, checked = } for each entry that is not a separator.
void PushEntries(lua_State *L, const QList<QAction *> &actions)
{
    lua_newtable(L);
    int n = 0;
    for (const QAction *action : actions) {
        if (action->isSeparator())
            continue;
        lua_createtable(L, 0, 3);
        lua_pushstring(L, Plain(action->text()).toUtf8().constData());
        lua_setfield(L, -2, "text");
        lua_pushboolean(L, action->isEnabled());
        lua_setfield(L, -2, "enabled");
        lua_pushstring(L, action->shortcut().toString().toUtf8().constData());
        lua_setfield(L, -2, "shortcut");
        lua_rawseti(L, -2, ++n);
    }
}

// The entries under a path of menu titles ({"File", "Open Recent"}).
QList<QAction *> MenuAt(lua_State *L, int idx, int depth, const char *function)
{
    QList<QAction *> actions = gWindow->menuBar()->actions();
    for (int i = 1; i <= depth; ++i) {
        lua_rawgeti(L, idx, i);
        const QString title = QString::fromUtf8(lua_tostring(L, -1));
        lua_pop(L, 1);
        QAction *action = FindAction(actions, title);
        if (!action || !action->menu())
            Hands::Raise(L, QString("%1: no menu \"%2\"").arg(function, title));
        emit action->menu()->aboutToShow();
        actions = action->menu()->actions();
    }
    return actions;
}

// orbane.Menu({"File", "Save"}): chooses the entry as a click would; false
// where it is disabled. orbane.Menu({"File"}) lists a menu's entries.
int Menu(lua_State *L)
{
    luaL_checktype(L, 1, LUA_TTABLE);
    const int length = int(lua_objlen(L, 1));
    if (length < 1)
        return Hands::Raise(L, "Menu: give a path of menu texts");
    lua_rawgeti(L, 1, length);
    const QString last = QString::fromUtf8(lua_tostring(L, -1));
    lua_pop(L, 1);
    const QList<QAction *> parent = MenuAt(L, 1, length - 1, "Menu");
    QAction *action = FindAction(parent, last);
    if (action && action->menu()) {
        emit action->menu()->aboutToShow();
        PushEntries(L, action->menu()->actions());
        return 1;
    }
    if (!action)
        return Hands::Raise(L, QString("Menu: no entry \"%1\"").arg(last));
    lua_pushboolean(L, action->isEnabled());
    if (action->isEnabled())
        action->trigger();
    return 1;
}

InputControl *FirstControl(lua_State *L, Input *input)
{
    const Operator *tool = input->GetOperator();
    if (gWindow->Inspector()->GetTool() != tool)
        gWindow->ShowTool(QString::fromUtf8(tool->GetName()));
    const std::vector<InputControl *> controls = gWindow->Inspector()->ControlsOf(input);
    if (controls.empty())
        Hands::Raise(L, QString("Input \"%1\" has no inspector control").arg(input->GetName()));
    return controls.front();
}

// orbane.InspectorMenu(tool, input [, entry]): the context menu of the
// Input's first inspector control, listed; or the entry chosen (false where
// it is disabled).
int InspectorMenu(lua_State *L)
{
    const LuaArgs args(L, "InspectorMenu");
    InputControl *control = FirstControl(L, Hands::InputArg(args, gDoc));
    QMenu menu;
    control->AddToMenu(&menu);
    if (lua_isnoneornil(L, 3)) {
        PushEntries(L, menu.actions());
        return 1;
    }
    const QString text = QString::fromUtf8(args.String(3, "entry"));
    QAction *action = FindAction(menu.actions(), text);
    if (!action)
        return Hands::Raise(L, QString("InspectorMenu: no entry \"%1\"").arg(text));
    lua_pushboolean(L, action->isEnabled());
    if (action->isEnabled())
        action->trigger();
    return 1;
}

FileMenu::Answer AnswerArg(lua_State *L, const LuaArgs &args, int idx)
{
    const QString text = QString::fromUtf8(args.String(idx, "answer")).toLower();
    if (text == "save")
        return FileMenu::Answer::Save;
    if (text == "discard")
        return FileMenu::Answer::Discard;
    if (text != "cancel")
        Hands::Raise(L, QString("AnswerPrompts: \"%1\" is not save, discard or cancel").arg(text));
    return FileMenu::Answer::Cancel;
}

QStringList gQuestions;
QStringList gFileAnswers;

// orbane.AnswerPrompts(answer [, path, ...]): from now on every question
// before losing work is answered `answer` ("save", "discard", "cancel"), and
// the next file dialogs answer the paths given, in order ("" cancels), then
// cancel. Failures are recorded instead of shown (see orbane.WindowState).
int AnswerPrompts(lua_State *L)
{
    const LuaArgs args(L, "AnswerPrompts");
    const FileMenu::Answer answer = AnswerArg(L, args, 1);
    gFileAnswers.clear();
    for (int i = 2; i <= lua_gettop(L); ++i)
        gFileAnswers << QString::fromUtf8(args.String(i, "path"));
    FileMenu *file = gWindow->File();
    file->SetAsk([answer](const QString &question) {
        gQuestions << question;
        return answer;
    });
    file->SetChoose(
        [](bool, const QString &) { return gFileAnswers.isEmpty() ? QString() : gFileAnswers.takeFirst(); });
    file->SetTell([](const QString &) {});
    return 0;
}

// orbane.WindowState() -> { title, modified, path, message, questions }.
int WindowState(lua_State *L)
{
    lua_createtable(L, 0, 5);
    lua_pushstring(L, gWindow->windowTitle().toUtf8().constData());
    lua_setfield(L, -2, "title");
    lua_pushboolean(L, gWindow->isWindowModified());
    lua_setfield(L, -2, "modified");
    lua_pushstring(L, gDoc->CompPath().c_str());
    lua_setfield(L, -2, "path");
    lua_pushstring(L, gWindow->File()->LastMessage().toUtf8().constData());
    lua_setfield(L, -2, "message");
    PushStrings(L, gQuestions);
    lua_setfield(L, -2, "questions");
    return 1;
}

// orbane.Ruler() -> { first, last, time, playing, keys = {times}, keyX = {pixels} }:
// the key marks of the shown tool and where they are drawn on "ruler".
int Ruler(lua_State *L)
{
    const TimeScale *scale = gWindow->Ruler()->Scale();
    lua_createtable(L, 0, 6);
    const std::pair<const char *, double> numbers[] = {
        {"first", scale->First()}, {"last", scale->Last()}, {"time", gDoc->GetCurrentTime()}};
    for (const auto &[key, value] : numbers) {
        lua_pushnumber(L, value);
        lua_setfield(L, -2, key);
    }
    lua_pushboolean(L, gWindow->Ruler()->IsPlaying());
    lua_setfield(L, -2, "playing");
    const std::vector<double> keys = scale->KeyMarks();
    std::vector<double> xs;
    for (const double time : keys)
        xs.push_back(scale->XOf(time));
    PushNumbers(L, keys);
    lua_setfield(L, -2, "keys");
    PushNumbers(L, xs);
    lua_setfield(L, -2, "keyX");
    return 1;
}

// orbane.SetRulerRange(first, last).
int SetRulerRange(lua_State *L)
{
    const LuaArgs args(L, "SetRulerRange");
    gWindow->Ruler()->SetRange(args.Number(1, "first"), args.Number(2, "last"));
    return 0;
}

// orbane.History() -> the undo history's rows as shown, "<empty>" first.
int History(lua_State *L)
{
    PushStrings(L, gWindow->History()->Rows());
    return 1;
}

// orbane.AutoSave(on [, interval_ms]): arms or disarms autosave.
int AutoSaveCall(lua_State *L)
{
    const LuaArgs args(L, "AutoSave");
    luaL_checktype(L, 1, LUA_TBOOLEAN);
    AutoSave *save = gWindow->Recovery();
    save->SetInterval(int(args.OptNumber(2, "interval", save->Interval())));
    save->SetEnabled(lua_toboolean(L, 1));
    return 0;
}

// orbane.AutoSaveNow() -> true where the recovery file was written.
int AutoSaveNow(lua_State *L)
{
    QString why;
    const bool written = gWindow->Recovery()->WriteNow(&why);
    if (!written && !why.isEmpty())
        return Hands::Raise(L, "AutoSaveNow: " + why);
    lua_pushboolean(L, written);
    return 1;
}

// orbane.Recovery() -> path of the recovery file, or nil where there is none.
int Recovery(lua_State *L)
{
    if (!AutoSave::HasRecovery())
        return 0;
    lua_pushstring(L, AutoSave::RecoveryPath().toUtf8().constData());
    return 1;
}

// orbane.OfferRecovery() -> true where unsaved work was restored (the
// question is answered as orbane.AnswerPrompts says: "save" restores).
int OfferRecovery(lua_State *L)
{
    lua_pushboolean(L, gWindow->OfferRecovery());
    return 1;
}

// orbane.Accessible(target) -> { name, description, painted = { {name, description}, ... } }:
// what screen readers read; `painted` lists parts without a widget (overlays).
int Accessible(lua_State *L)
{
    const UiTarget t = UiTarget::Resolve(L, 1, gWindow);
    if (!t.widget)
        return Hands::Raise(L, t.error);
    lua_createtable(L, 0, 2);
    lua_pushstring(L, t.widget->accessibleName().toUtf8().constData());
    lua_setfield(L, -2, "name");
    lua_pushstring(L, t.widget->accessibleDescription().toUtf8().constData());
    lua_setfield(L, -2, "description");
    // Painted parts (the viewer's overlays) are children of the widget's interface.
    QAccessibleInterface *face = QAccessible::queryAccessibleInterface(t.widget);
    lua_newtable(L);
    for (int i = 0, n = 0; face && i < face->childCount(); ++i) {
        QAccessibleInterface *child = face->child(i);
        if (!child || child->object())
            continue;
        lua_createtable(L, 0, 2);
        lua_pushstring(L, child->text(QAccessible::Name).toUtf8().constData());
        lua_setfield(L, -2, "name");
        lua_pushstring(L, child->text(QAccessible::Value).toUtf8().constData());
        lua_setfield(L, -2, "description");
        lua_rawseti(L, -2, ++n);
    }
    lua_setfield(L, -2, "painted");
    return 1;
}

} // namespace

void WindowScripting::Install(OrbaneDoc *doc, MainWindow *window)
{
    gDoc = doc;
    gWindow = window;
    const std::pair<const char *, lua_CFunction> functions[] = {
        {"Menu", Menu},
        {"InspectorMenu", InspectorMenu},
        {"AnswerPrompts", AnswerPrompts},
        {"WindowState", WindowState},
        {"Ruler", Ruler},
        {"SetRulerRange", SetRulerRange},
        {"History", History},
        {"AutoSave", AutoSaveCall},
        {"AutoSaveNow", AutoSaveNow},
        {"Recovery", Recovery},
        {"OfferRecovery", OfferRecovery},
        {"Accessible", Accessible},
    };
    for (const auto &[name, fn] : functions)
        LuaRuntime::Instance().AddModuleFunction(name, fn);
}

} // namespace Orbane
