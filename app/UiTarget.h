#pragma once

#include <QPoint>
#include <QString>

#include "orbane/LuaArgs.h"

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

// Mouse and keyboard options: { x =, y =, button = "left"|"right"|"middle"|"none",
// mods = "ctrl+shift", row = n (the n-th top-level row of a list or tree) }.
struct UiGesture
{
    QPoint pos;
    bool hasPos = false;
    int row = 0;
    Qt::MouseButton button = Qt::LeftButton;
    Qt::KeyboardModifiers mods = Qt::NoModifier;

    // Positions beyond this many pixels are refused: no widget is that big,
    // and QPoint arithmetic must not overflow.
    static constexpr int kMaxCoord = 1 << 20;

    static UiGesture Read(const LuaArgs &args, int idx);
    // "ctrl+shift"; false for a name that is not a modifier.
    static bool Modifiers(const QString &text, Qt::KeyboardModifiers &mods);
    static Qt::KeyboardModifiers ModifiersArg(const LuaArgs &args, int idx, const char *name, const char *text);
    QPoint At(const QWidget *w) const;
};

} // namespace Orbane
