#include "UiTarget.h"

#include "MainWindow.h"

#include "orbane/Input.h"
#include "orbane/InputControl.h"
#include "orbane/ParameterPanel.h"
#include "orbane/LayoutObj.h"
#include "orbane/Operator.h"

#include <QAbstractItemView>
#include <QApplication>

namespace Orbane {

namespace {

QString Field(lua_State *L, int idx, const char *key)
{
    lua_getfield(L, idx, key);
    QString s = lua_isstring(L, -1) ? QString::fromUtf8(lua_tostring(L, -1)) : QString();
    lua_pop(L, 1);
    return s;
}

int IntField(lua_State *L, int idx, const char *key, int def)
{
    lua_getfield(L, idx, key);
    const int v = lua_isnumber(L, -1) ? int(lua_tointeger(L, -1)) : def;
    lua_pop(L, 1);
    return v;
}

UiTarget Fail(const QString &why)
{
    UiTarget t;
    t.error = why;
    return t;
}

// A person clicks the rows of a list or tree, which live in its viewport.
QWidget *ClickSurface(QWidget *w)
{
    auto *area = qobject_cast<QAbstractScrollArea *>(w);
    return area ? area->viewport() : w;
}

// The list of the open drop-down (a combo box's popup), where rows are chosen.
QWidget *OpenPopupList()
{
    QWidget *popup = QApplication::activePopupWidget();
    auto *list = popup ? popup->findChild<QAbstractItemView *>() : nullptr;
    return list ? list->viewport() : popup;
}

UiTarget Named(const QString &name, MainWindow *window)
{
    UiTarget t;
    if (name == "popup") {
        t.widget = OpenPopupList();
        if (!t.widget)
            t.error = "no popup is open";
    } else if (name == "inspector")
        t.widget = window->Inspector();
    else if (name == "window")
        t.widget = window;
    else if (name == "viewer")
        t.widget = window->Viewer();
    else
        t.error =
            QString("unknown widget \"%1\"; expected inspector, viewer, window, popup or a control table").arg(name);
    return t;
}

// The control of the Input; shows its tool first so a script need not.
UiTarget OfControl(lua_State *L, int idx, MainWindow *window)
{
    const QString toolName = Field(L, idx, "tool"), inputName = Field(L, idx, "input");
    ParameterPanel *inspector = window->Inspector();
    if (!inspector->GetTool() || toolName != inspector->GetTool()->GetName())
        if (!window->ShowTool(toolName))
            return Fail(QString("no tool \"%1\"").arg(toolName));
    Input *input = inspector->GetTool()->FindInput(OrbID(inputName.toStdString()));
    if (!input)
        return Fail(QString("tool \"%1\" has no Input \"%2\"").arg(toolName, inputName));
    const auto controls = inspector->ControlsOf(input);
    const int index = IntField(L, idx, "index", 1);
    if (index < 1 || index > int(controls.size()))
        return Fail(QString("Input \"%1\" has %2 controls, not %3").arg(inputName).arg(controls.size()).arg(index));
    UiTarget t;
    t.control = controls[size_t(index - 1)];
    t.widget = t.control;
    const QString child = Field(L, idx, "child");
    if (!child.isEmpty()) {
        Layout::LayoutObj *obj = t.control->FindLayoutObj(child.toUtf8().constData());
        t.widget = obj ? ClickSurface(obj->GetWidget()) : nullptr;
        if (!t.widget)
            return Fail(QString("the control of \"%1\" has no child \"%2\"").arg(inputName, child));
    }
    return t;
}

} // namespace

UiTarget UiTarget::Resolve(lua_State *L, int idx, MainWindow *window)
{
    if (lua_type(L, idx) == LUA_TSTRING)
        return Named(QString::fromUtf8(lua_tostring(L, idx)), window);
    if (lua_type(L, idx) == LUA_TTABLE)
        return OfControl(L, idx, window);
    return Fail("expected a widget name or a control table");
}

Qt::KeyboardModifiers UiGesture::Modifiers(const QString &text)
{
    Qt::KeyboardModifiers mods;
    for (const QString &m : text.toLower().split('+', Qt::SkipEmptyParts)) {
        if (m == "ctrl")
            mods |= Qt::ControlModifier;
        else if (m == "shift")
            mods |= Qt::ShiftModifier;
        else if (m == "alt")
            mods |= Qt::AltModifier;
        else if (m == "meta")
            mods |= Qt::MetaModifier;
    }
    return mods;
}

UiGesture UiGesture::Read(lua_State *L, int idx)
{
    UiGesture g;
    if (lua_type(L, idx) != LUA_TTABLE)
        return g;
    lua_getfield(L, idx, "x");
    lua_getfield(L, idx, "y");
    g.hasPos = lua_isnumber(L, -2) && lua_isnumber(L, -1);
    g.pos = QPoint(int(lua_tointeger(L, -2)), int(lua_tointeger(L, -1)));
    lua_pop(L, 2);
    g.row = IntField(L, idx, "row", 0);
    const QString button = Field(L, idx, "button");
    g.button = button == "right" ? Qt::RightButton : button == "middle" ? Qt::MiddleButton : Qt::LeftButton;
    g.mods = Modifiers(Field(L, idx, "mods"));
    return g;
}

QPoint UiGesture::At(const QWidget *w) const
{
    if (hasPos)
        return pos;
    // row = n: the middle of a list's or tree's n-th top-level row.
    const auto *view = w ? qobject_cast<const QAbstractItemView *>(w->parentWidget()) : nullptr;
    if (row > 0 && view && view->viewport() == w)
        return view->visualRect(view->model()->index(row - 1, 0)).center();
    return w->rect().center();
}

} // namespace Orbane
