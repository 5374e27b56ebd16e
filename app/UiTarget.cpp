#include "UiTarget.h"

#include "MainWindow.h"

#include "orbane/Input.h"
#include "orbane/InputControl.h"
#include "orbane/LayoutObj.h"
#include "orbane/Operator.h"
#include "orbane/ParameterPanel.h"

#include <QAbstractItemView>
#include <QApplication>

#include <algorithm>
#include <iterator>

namespace Orbane {

namespace {

QString Field(lua_State *L, int idx, const char *key)
{
    lua_getfield(L, idx, key);
    QString s = lua_isstring(L, -1) ? QString::fromUtf8(lua_tostring(L, -1)) : QString();
    lua_pop(L, 1);
    return s;
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
    else if (name == "ruler")
        t.widget = window->findChild<QWidget *>("timeScale");
    else if (QWidget *part = window->findChild<QWidget *>(name))
        t.widget = ClickSurface(part); // a list's rows, as for a control's child

    if (!t.widget && t.error.isEmpty())
        t.error = QString("unknown widget \"%1\"; expected inspector, viewer, window, popup, ruler, the object "
                          "name of a window part or a control table")
                      .arg(name);
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
    const int index = LuaArgs(L, "target").IntegerField(idx, "index", 1, 1 << 20, 1);
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

bool UiGesture::Modifiers(const QString &text, Qt::KeyboardModifiers &mods)
{
    const std::pair<const char *, Qt::KeyboardModifier> names[] = {{"ctrl", Qt::ControlModifier},
                                                                   {"shift", Qt::ShiftModifier},
                                                                   {"alt", Qt::AltModifier},
                                                                   {"meta", Qt::MetaModifier}};
    mods = Qt::NoModifier;
    for (const QString &m : text.toLower().split('+', Qt::SkipEmptyParts)) {
        const auto *it = std::find_if(std::begin(names), std::end(names), [&](auto &n) { return m == n.first; });
        if (it == std::end(names))
            return false;
        mods |= it->second;
    }
    return true;
}

Qt::KeyboardModifiers UiGesture::ModifiersArg(const LuaArgs &args, int idx, const char *name, const char *text)
{
    Qt::KeyboardModifiers mods;
    if (!Modifiers(QString::fromUtf8(text), mods))
        args.Fail(idx, name, std::string("unknown modifier in \"") + text + "\"; expected ctrl, shift, alt, meta");
    return mods;
}

UiGesture UiGesture::Read(const LuaArgs &args, int idx)
{
    UiGesture g;
    if (!args.OptTable(idx, "gesture"))
        return g;
    g.hasPos = args.HasField(idx, "x") || args.HasField(idx, "y");
    g.pos = QPoint(args.IntegerField(idx, "x", -kMaxCoord, kMaxCoord, 0),
                   args.IntegerField(idx, "y", -kMaxCoord, kMaxCoord, 0));
    g.row = args.IntegerField(idx, "row", 0, kMaxCoord, 0);
    const QString button = QString::fromUtf8(args.StringField(idx, "button", "left"));
    if (button != "left" && button != "right" && button != "middle" && button != "none")
        args.Fail(idx, "button", "expected left, right, middle or none");
    g.button = button == "right" ? Qt::RightButton : button == "middle" ? Qt::MiddleButton : Qt::LeftButton;
    g.mods = ModifiersArg(args, idx, "mods", args.StringField(idx, "mods", ""));
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
