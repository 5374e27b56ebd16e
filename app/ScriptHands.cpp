#include "ScriptHands.h"

#include "orbane/Input.h"
#include "orbane/Operator.h"
#include "orbane/OrbaneDoc.h"

#include <QApplication>
#include <QKeySequence>
#include <QMouseEvent>
#include <QWidget>

namespace Orbane {

int ScriptHands::Raise(lua_State *L, const QString &message)
{
    luaL_where(L, 1);
    lua_pushstring(L, message.toUtf8().constData());
    lua_concat(L, 2);
    return lua_error(L);
}

void ScriptHands::SendMouse(QWidget *w, QEvent::Type type, QPoint pos, Qt::MouseButton button, Qt::MouseButtons held,
                            Qt::KeyboardModifiers mods)
{
    QMouseEvent event(type, pos, w->mapToGlobal(pos), button, held, mods);
    QApplication::sendEvent(w, &event);
}

int ScriptHands::KeyCode(const LuaArgs &args, int idx)
{
    if (lua_type(args.State(), idx) == LUA_TNUMBER)
        return args.Integer(idx, "key", 0, int32(~Qt::KeyboardModifierMask));
    const char *name = args.String(idx, "key");
    const QKeySequence seq = QKeySequence::fromString(QString::fromUtf8(name));
    const int key = seq.isEmpty() ? 0 : int(seq[0] & ~Qt::KeyboardModifierMask);
    if (key == 0 || key == Qt::Key_unknown)
        args.Fail(idx, "key", std::string("unknown key \"") + name + "\"");
    return key;
}

QByteArray ScriptHands::KeyPhase(const LuaArgs &args, int idx)
{
    const QByteArray phase = args.OptString(idx, "phase", "click");
    if (phase != "click" && phase != "press" && phase != "release")
        args.Fail(idx, "phase", "expected click, press or release");
    return phase;
}

Operator *ScriptHands::ToolOrRaise(lua_State *L, OrbaneDoc *doc, int idx)
{
    Operator *tool = doc->FindTool(luaL_checkstring(L, idx));
    if (!tool)
        Raise(L, QString("no tool \"%1\"").arg(lua_tostring(L, idx)));
    return tool;
}

Input *ScriptHands::InputOrRaise(lua_State *L, OrbaneDoc *doc)
{
    Input *input = ToolOrRaise(L, doc)->FindInput(OrbID(luaL_checkstring(L, 2)));
    if (!input)
        Raise(L, QString("tool \"%1\" has no Input \"%2\"").arg(lua_tostring(L, 1), lua_tostring(L, 2)));
    return input;
}

double ScriptHands::TimeArg(lua_State *L, OrbaneDoc *doc, int idx)
{
    return lua_isnumber(L, idx) ? lua_tonumber(L, idx) : doc->GetCurrentTime();
}

} // namespace Orbane
