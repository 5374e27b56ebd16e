#include "ScriptHands.h"

#include "orbane/Input.h"
#include "orbane/LuaRuntime.h"
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

Operator *ScriptHands::ToolArg(const LuaArgs &args, OrbaneDoc *doc, int idx)
{
    if (ScriptObject *obj = LuaRuntime::ToObject(args.State(), idx)) {
        auto *tool = dynamic_cast<Operator *>(obj);
        if (!tool || doc->FindTool(tool->GetName()) != tool)
            args.Fail(idx, "tool", "not a tool of the document");
        return tool;
    }
    const char *name = args.String(idx, "tool");
    Operator *tool = doc->FindTool(name);
    if (!tool)
        args.Fail(idx, "tool", std::string("no tool \"") + name + "\"");
    return tool;
}

Input *ScriptHands::InputArg(const LuaArgs &args, OrbaneDoc *doc)
{
    Operator *tool = ToolArg(args, doc, 1);
    const char *id = args.String(2, "input");
    Input *input = tool->FindInput(OrbID(id));
    if (!input)
        args.Fail(2, "input", std::string("tool \"") + tool->GetName() + "\" has no Input \"" + id + "\"");
    return input;
}

float64 ScriptHands::TimeArg(const LuaArgs &args, OrbaneDoc *doc, int idx)
{
    return args.OptNumber(idx, "time", doc->GetCurrentTime());
}

} // namespace Orbane
