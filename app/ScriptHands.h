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
    // The tool named by argument `idx`; raises where there is none.
    static Operator *ToolOrRaise(lua_State *L, OrbaneDoc *doc, int idx = 1);
    // The Input named by arguments 1 (tool) and 2 (Input id); raises where
    // either is missing.
    static Input *InputOrRaise(lua_State *L, OrbaneDoc *doc);
    // The time at argument `idx`, the document's current time where absent.
    static double TimeArg(lua_State *L, OrbaneDoc *doc, int idx);
};

} // namespace Orbane
