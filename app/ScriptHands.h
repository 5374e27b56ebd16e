#pragma once

#include <QEvent>
#include <QPoint>
#include <QString>

#include "orbane/LuaArgs.h"

#include <lua.hpp>

class QWidget;

namespace Orbane {

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
};

} // namespace Orbane
