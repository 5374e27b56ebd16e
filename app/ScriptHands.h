#pragma once

#include <QEvent>
#include <QPoint>
#include <QString>

#include "orbane/LuaArgs.h"

#include <lua.hpp>

class QWidget;

namespace Orbane {

class Input;
class Operator;
class OrbaneDoc;

// What every scripting function that works the UI shares: raising an error
// at the script's line, sending a mouse event, and reading a key.
class ScriptHands
{
public:
    // Raises a Lua error with the script's file and line; does not return.
    static int Raise(lua_State *L, const QString &message);
    static void SendMouse(QWidget *w, QEvent::Type type, QPoint pos, Qt::MouseButton button, Qt::MouseButtons held,
                          Qt::KeyboardModifiers mods);
    // A key by Qt name ("Left", "PgUp", "Home") or by code.
    static int KeyCode(const LuaArgs &args, int idx);
    // "click" (the default), "press" or "release".
    static QByteArray KeyPhase(const LuaArgs &args, int idx);
    // A tool by name, or the tool object a button script is given, if it is
    // one of the document's; raises naming the argument otherwise.
    static Operator *ToolArg(const LuaArgs &args, OrbaneDoc *doc, int idx);
    // The Input named by arguments 1 (tool) and 2 (Input id).
    static Input *InputArg(const LuaArgs &args, OrbaneDoc *doc);
    // The time at argument `idx`, the document's current time where absent.
    static float64 TimeArg(const LuaArgs &args, OrbaneDoc *doc, int idx);
};

} // namespace Orbane
