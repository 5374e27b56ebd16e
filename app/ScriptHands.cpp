#include "ScriptHands.h"

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

int ScriptHands::KeyCode(lua_State *L, int idx)
{
    if (lua_isnumber(L, idx))
        return int(lua_tointeger(L, idx));
    const QKeySequence seq = QKeySequence::fromString(QString::fromUtf8(luaL_checkstring(L, idx)));
    if (seq.isEmpty())
        return Raise(L, QString("unknown key \"%1\"").arg(lua_tostring(L, idx)));
    return seq[0] & ~Qt::KeyboardModifierMask;
}

} // namespace Orbane
