#pragma once

#include <QPoint>
#include <QString>

#include <lua.hpp>

class QWidget;

namespace Orbane {

class MainWindow;
class InputControl;

// A widget a script names: "inspector", "window", "viewer", "popup" (the list
// of the open drop-down), or a table
// { tool = "Demo1", input = "Invert", index = 1, child = "checkbox" } for the
// index-th control of an Input (the tool shown first where needed), or one of
// its children by its layout name (a list's or tree's rows: its viewport).
struct UiTarget
{
    QWidget *widget = nullptr;
    InputControl *control = nullptr;
    QString error;

    static UiTarget Resolve(lua_State *L, int idx, MainWindow *window);
};

// Mouse and keyboard options: { x =, y =, button = "left"|"right"|"middle",
// mods = "ctrl+shift", row = n (the n-th top-level row of a list or tree) }.
struct UiGesture
{
    QPoint pos;
    bool hasPos = false;
    int row = 0;
    Qt::MouseButton button = Qt::LeftButton;
    Qt::KeyboardModifiers mods = Qt::NoModifier;

    static UiGesture Read(lua_State *L, int idx);
    static Qt::KeyboardModifiers Modifiers(const QString &text);
    QPoint At(const QWidget *w) const;
};

} // namespace Orbane
