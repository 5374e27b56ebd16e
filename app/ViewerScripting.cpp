#include "ViewerScripting.h"

#include "MainWindow.h"
#include "ScriptHands.h"
#include "UiTarget.h"

#include "orbane/Input.h"
#include "orbane/LuaRuntime.h"
#include "orbane/Operator.h"
#include "orbane/Registry.h"
#include "orbane/ScriptVal.h"
#include "orbane/ViewerPanel.h"

#include <QApplication>
#include <QKeySequence>
#include <QMouseEvent>
#include <QTest>

#include <cmath>
#include <cstring>

namespace Orbane {

namespace {

using Hands = ScriptHands;

MainWindow *gWindow = nullptr;

bool Number(lua_State *L, int idx, const char *key, double &out)
{
    lua_getfield(L, idx, key);
    const bool found = lua_isnumber(L, -1);
    if (found)
        out = lua_tonumber(L, -1);
    lua_pop(L, 1);
    return found;
}

// { ix =, iy = } in image coordinates (0..1, Y up), else { x =, y = } in the
// viewer's widget pixels (Y down), else the centre; then { dx =, dy = }
// widget pixels more.
QPoint Position(lua_State *L, int idx, const ViewerPanel *viewer)
{
    QPointF at(viewer->width() / 2.0, viewer->height() / 2.0);
    double ix = 0, iy = 0, x = 0, y = 0, dx = 0, dy = 0;
    if (lua_istable(L, idx)) {
        if (Number(L, idx, "ix", ix) && Number(L, idx, "iy", iy))
            at = viewer->ImageToWidget({ix, iy});
        else if (Number(L, idx, "x", x) && Number(L, idx, "y", y))
            at = QPointF(x, y);
        Number(L, idx, "dx", dx);
        Number(L, idx, "dy", dy);
    }
    return QPoint(int(std::lround(at.x() + dx)), int(std::lround(at.y() + dy)));
}

// { flags = 4 } gives the press that event-flag word (PCA_EventFlags).
int ViewerPress(lua_State *L)
{
    const UiGesture g = UiGesture::Read(L, 1);
    double flags = 0;
    if (lua_istable(L, 1))
        Number(L, 1, "flags", flags);
    ViewerPanel *viewer = gWindow->Viewer();
    viewer->SetPressFlags(uint32(flags));
    Hands::SendMouse(viewer, QEvent::MouseButtonPress, Position(L, 1, viewer), g.button, g.button, g.mods);
    viewer->SetPressFlags(0);
    return 0;
}

// A move with the button held: one step of a drag.
int ViewerMove(lua_State *L)
{
    const UiGesture g = UiGesture::Read(L, 1);
    Hands::SendMouse(gWindow->Viewer(), QEvent::MouseMove, Position(L, 1, gWindow->Viewer()), Qt::NoButton, g.button,
                     g.mods);
    return 0;
}

int ViewerRelease(lua_State *L)
{
    const UiGesture g = UiGesture::Read(L, 1);
    Hands::SendMouse(gWindow->Viewer(), QEvent::MouseButtonRelease, Position(L, 1, gWindow->Viewer()), g.button,
                     Qt::NoButton, g.mods);
    return 0;
}

int ViewerHover(lua_State *L)
{
    const UiGesture g = UiGesture::Read(L, 1);
    Hands::SendMouse(gWindow->Viewer(), QEvent::MouseMove, Position(L, 1, gWindow->Viewer()), Qt::NoButton,
                     Qt::NoButton, g.mods);
    return 0;
}

// ViewerKey("Left", "shift"[, "press"|"release"|"click"]). The modifier keys
// go down before the key and up after it, as a person's hands do.
int ViewerKey(lua_State *L)
{
    ViewerPanel *viewer = gWindow->Viewer();
    const int key = Hands::KeyCode(L, 1);
    const Qt::KeyboardModifiers mods = UiGesture::Modifiers(QString::fromUtf8(luaL_optstring(L, 2, "")));
    const QByteArray phase = luaL_optstring(L, 3, "click");
    if (phase != "click" && phase != "press" && phase != "release")
        return Hands::Raise(
            L, QString("unknown key phase \"%1\"; expected click, press or release").arg(phase.constData()));
    if (phase != "release")
        QTest::keyPress(viewer, Qt::Key(key), mods);
    if (phase != "press")
        QTest::keyRelease(viewer, Qt::Key(key), mods);
    return 0;
}

int ViewerGrab(lua_State *L)
{
    const char *path = luaL_checkstring(L, 1);
    if (!gWindow->Viewer()->grab().save(QString::fromUtf8(path)))
        return Hands::Raise(L, QString("cannot write %1").arg(path));
    return 0;
}

int ViewerImage(lua_State *L)
{
    const char *path = luaL_checkstring(L, 1);
    if (!gWindow->Viewer()->LoadImage(QString::fromUtf8(path)))
        return Hands::Raise(L, QString("cannot read the image %1").arg(path));
    return 0;
}

// ViewerInfo() -> { zoom, pixelAspect, width, height, imageWidth, imageHeight,
// cursor, hot }; `cursor` is the Qt shape number of the viewer's cursor.
int ViewerInfo(lua_State *L)
{
    const ViewerPanel *viewer = gWindow->Viewer();
    lua_createtable(L, 0, 8);
    lua_pushnumber(L, viewer->Mapping().Zoom());
    lua_setfield(L, -2, "zoom");
    lua_pushnumber(L, viewer->PixelAspect());
    lua_setfield(L, -2, "pixelAspect");
    for (auto [key, v] : {std::pair{"width", viewer->width()},
                          {"height", viewer->height()},
                          {"imageWidth", viewer->ImageSize().width()},
                          {"imageHeight", viewer->ImageSize().height()},
                          {"cursor", int(viewer->cursor().shape())}}) {
        lua_pushinteger(L, v);
        lua_setfield(L, -2, key);
    }
    if (const PreviewControl *hot = viewer->HotControl()) {
        lua_pushstring(L, hot->GetRegistry() ? hot->GetRegistry()->Name() : "PreviewControl");
        lua_setfield(L, -2, "hot");
    }
    return 1;
}

// The overlay of Input `input` of the tool shown in the viewer, the first
// one or the first of class `cls`; raises where there is none.
PreviewControl *OverlayOrRaise(lua_State *L)
{
    const char *toolName = luaL_checkstring(L, 1);
    const char *inputID = luaL_checkstring(L, 2);
    const char *cls = luaL_optstring(L, 3, nullptr);
    const ViewerPanel *viewer = gWindow->Viewer();
    const Operator *tool = viewer->GetTool();
    if (!tool || std::strcmp(tool->GetName(), toolName) != 0)
        Hands::Raise(L, QString("tool \"%1\" is not shown in the viewer").arg(toolName));
    const Input *input = tool->FindInput(OrbID(inputID));
    if (!input)
        Hands::Raise(L, QString("tool \"%1\" has no Input \"%2\"").arg(toolName, inputID));
    for (PreviewControl *overlay : viewer->OverlaysOf(input)) {
        const Registry *reg = overlay->GetRegistry();
        if (!cls || (reg && (std::strcmp(reg->Name(), cls) == 0 || std::strcmp(overlay->ScriptTypeName(), cls) == 0)))
            return overlay;
    }
    Hands::Raise(L, QString("Input \"%1\" has no overlay%2").arg(inputID, cls ? QString(" of class ") + cls : ""));
    return nullptr;
}

int ReadOnly(lua_State *L)
{
    return luaL_error(L, "the overlay state is read-only");
}

// Overlay(tool, input [, class]) -> the overlay object, for casts and GetAttrs.
int Overlay(lua_State *L)
{
    LuaRuntime::PushObject(L, OverlayOrRaise(L));
    return 1;
}

// OverlayState(tool, input [, class]) -> a fresh table of what the user sees
// of the overlay's state; each overlay class fills its own fields.
int OverlayState(lua_State *L)
{
    ScriptVal state = ScriptVal::NewTable();
    OverlayOrRaise(L)->GetState(state);
    // A snapshot: writing to it would suggest it changes the overlay.
    LuaRuntime::Push(L, state);
    lua_newtable(L);
    lua_newtable(L);
    lua_pushvalue(L, -3);
    lua_setfield(L, -2, "__index");
    lua_pushcfunction(L, ReadOnly);
    lua_setfield(L, -2, "__newindex");
    lua_setmetatable(L, -2);
    lua_remove(L, -2);
    return 1;
}

} // namespace

void ViewerScripting::Install(MainWindow *window)
{
    gWindow = window;
    const std::pair<const char *, lua_CFunction> functions[] = {
        {"ViewerPress", ViewerPress},   {"ViewerMove", ViewerMove}, {"ViewerRelease", ViewerRelease},
        {"ViewerHover", ViewerHover},   {"ViewerKey", ViewerKey},   {"ViewerGrab", ViewerGrab},
        {"ViewerImage", ViewerImage},   {"ViewerInfo", ViewerInfo}, {"Overlay", Overlay},
        {"OverlayState", OverlayState},
    };
    for (const auto &[name, fn] : functions)
        LuaRuntime::Instance().AddModuleFunction(name, fn);
}

} // namespace Orbane
