#include "ViewerScripting.h"

#include "MainWindow.h"
#include "ScriptHands.h"
#include "UiTarget.h"

#include "orbane/Input.h"
#include "orbane/LuaArgs.h"
#include "orbane/LuaRuntime.h"
#include "orbane/Operator.h"
#include "orbane/Registry.h"
#include "orbane/ScriptVal.h"
#include "orbane/ViewerPanel.h"

#include <QAction>
#include <QApplication>
#include <QKeySequence>
#include <QMenu>
#include <QMouseEvent>
#include <QTest>
#include <QToolBar>

#include <cmath>
#include <cstring>

namespace Orbane {

namespace {

using Hands = ScriptHands;

MainWindow *gWindow = nullptr;

// { ix =, iy = } in image coordinates (0..1, Y up), else { x =, y = } in the
// viewer's widget pixels (Y down), else the centre; then { dx =, dy = }
// widget pixels more.
QPoint Position(const LuaArgs &args, int idx, const ViewerPanel *viewer)
{
    constexpr float64 kFar = UiGesture::kMaxCoord;
    QPointF at(viewer->width() / 2.0, viewer->height() / 2.0);
    if (lua_istable(args.State(), idx)) {
        // Image coordinates reach far outside the image when zoomed in, but
        // not past what a widget position can hold.
        if (args.HasField(idx, "ix") || args.HasField(idx, "iy"))
            at = viewer->ImageToWidget(
                {args.NumberField(idx, "ix", -kFar, kFar, 0.0), args.NumberField(idx, "iy", -kFar, kFar, 0.0)});
        else if (args.HasField(idx, "x") || args.HasField(idx, "y"))
            at = QPointF(args.NumberField(idx, "x", -kFar, kFar, 0.0), args.NumberField(idx, "y", -kFar, kFar, 0.0));
        at += QPointF(args.NumberField(idx, "dx", -kFar, kFar, 0.0), args.NumberField(idx, "dy", -kFar, kFar, 0.0));
    }
    if (!(std::fabs(at.x()) <= 2 * kFar && std::fabs(at.y()) <= 2 * kFar))
        args.Fail(idx, "position", "lies too far outside the viewer");
    return QPoint(int(std::lround(at.x())), int(std::lround(at.y())));
}

// { flags = 4 } gives the press that event-flag word (PCA_EventFlags).
int ViewerPress(lua_State *L)
{
    const LuaArgs args(L, "ViewerPress");
    const UiGesture g = UiGesture::Read(args, 1);
    const int32 flags = lua_istable(L, 1) ? args.IntegerField(1, "flags", 0, 0x7fffffff, 0) : 0;
    ViewerPanel *viewer = gWindow->Viewer();
    const QPoint at = Position(args, 1, viewer);
    viewer->SetPressFlags(uint32(flags));
    Hands::SendMouse(viewer, QEvent::MouseButtonPress, at, g.button, g.button, g.mods);
    viewer->SetPressFlags(0);
    return 0;
}

// A move with the button held: one step of a drag.
int ViewerMove(lua_State *L)
{
    const LuaArgs args(L, "ViewerMove");
    const UiGesture g = UiGesture::Read(args, 1);
    Hands::SendMouse(gWindow->Viewer(), QEvent::MouseMove, Position(args, 1, gWindow->Viewer()), Qt::NoButton, g.button,
                     g.mods);
    return 0;
}

int ViewerRelease(lua_State *L)
{
    const LuaArgs args(L, "ViewerRelease");
    const UiGesture g = UiGesture::Read(args, 1);
    Hands::SendMouse(gWindow->Viewer(), QEvent::MouseButtonRelease, Position(args, 1, gWindow->Viewer()), g.button,
                     Qt::NoButton, g.mods);
    return 0;
}

int ViewerHover(lua_State *L)
{
    const LuaArgs args(L, "ViewerHover");
    const UiGesture g = UiGesture::Read(args, 1);
    Hands::SendMouse(gWindow->Viewer(), QEvent::MouseMove, Position(args, 1, gWindow->Viewer()), Qt::NoButton,
                     Qt::NoButton, g.mods);
    return 0;
}

// ViewerKey("Left", "shift"[, "press"|"release"|"click"]). The modifier keys
// go down before the key and up after it, as a person's hands do.
int ViewerKey(lua_State *L)
{
    const LuaArgs args(L, "ViewerKey");
    ViewerPanel *viewer = gWindow->Viewer();
    const int key = Hands::KeyCode(args, 1);
    const Qt::KeyboardModifiers mods = UiGesture::ModifiersArg(args, 2, "mods", args.OptString(2, "mods", ""));
    const QByteArray phase = Hands::KeyPhase(args, 3);
    if (phase != "release")
        QTest::keyPress(viewer, Qt::Key(key), mods);
    if (phase != "press")
        QTest::keyRelease(viewer, Qt::Key(key), mods);
    return 0;
}

int ViewerGrab(lua_State *L)
{
    const char *path = LuaArgs(L, "ViewerGrab").String(1, "path");
    if (!gWindow->Viewer()->grab().save(QString::fromUtf8(path)))
        return Hands::Raise(L, QString("cannot write %1").arg(path));
    return 0;
}

int ViewerImage(lua_State *L)
{
    const char *path = LuaArgs(L, "ViewerImage").String(1, "path");
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
    if (!viewer->LastMessage().isEmpty()) {
        lua_pushstring(L, viewer->LastMessage().toUtf8().constData());
        lua_setfield(L, -2, "message");
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
    const LuaArgs args(L, "Overlay");
    const char *toolName = args.String(1, "tool");
    const char *inputID = args.String(2, "input");
    const char *cls = args.OptString(3, "class", nullptr);
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

// ViewerCamera([camera]) -> the camera the 3D overlays are seen through,
// as a table; a table sets it first (its fields over the camera now), the
// text "default" the default view.
int ViewerCamera(lua_State *L)
{
    ViewerPanel *viewer = gWindow->Viewer();
    if (lua_type(L, 1) == LUA_TSTRING && std::strcmp(lua_tostring(L, 1), "default") == 0) {
        viewer->SetCamera(ViewCamera::Default());
    } else if (lua_istable(L, 1)) {
        ScriptVal table;
        std::string why;
        if (!LuaRuntime::ToScriptVal(L, 1, table, why))
            return Hands::Raise(L, QString("ViewerCamera: %1").arg(QString::fromStdString(why)));
        if (!viewer->SetCamera(ViewCamera::FromTable(table, viewer->Camera())))
            return Hands::Raise(L, "ViewerCamera: not a camera (focal length, aperture and near plane above 0)");
    } else if (!lua_isnoneornil(L, 1)) {
        return Hands::Raise(L, "ViewerCamera: argument 1 (camera): expected a table or \"default\"");
    }
    LuaRuntime::Push(L, viewer->Camera().ToTable());
    return 1;
}

// --- the context menu, the toolbar and tips ---

// A menu entry's flag word as the user sees the action: 0x001 disabled,
// 0x008 checked, 0x400 a check item.
int ActionFlags(const QAction *a)
{
    return (a->isEnabled() ? 0 : 0x001) | (a->isChecked() ? 0x008 : 0) | (a->isCheckable() ? 0x400 : 0);
}

void PushMenu(lua_State *L, const QMenu *menu)
{
    const QList<QAction *> actions = menu->actions();
    lua_createtable(L, actions.size(), 0);
    int n = 0;
    for (const QAction *a : actions) {
        lua_newtable(L);
        if (a->isSeparator()) {
            lua_pushboolean(L, 1);
            lua_setfield(L, -2, "separator");
        } else {
            lua_pushstring(L, a->text().toUtf8().constData());
            lua_setfield(L, -2, "text");
            if (a->menu()) {
                PushMenu(L, a->menu());
                lua_setfield(L, -2, "items");
            } else {
                const QVariant id = a->property("menuId");
                lua_pushinteger(L, id.isValid() ? id.toInt() : a->data().toInt());
                lua_setfield(L, -2, "id");
                lua_pushinteger(L, a->property("menuArg").toInt());
                lua_setfield(L, -2, "arg");
                lua_pushinteger(L, ActionFlags(a));
                lua_setfield(L, -2, "flags");
            }
        }
        lua_rawseti(L, -2, ++n);
    }
}

// The texts of the table at `idx`: a path through submenus or pop-downs.
QStringList PathArg(const LuaArgs &args, int idx)
{
    lua_State *L = args.State();
    if (!lua_istable(L, idx))
        args.Fail(idx, "path", "expected a table of entry texts");
    QStringList path;
    const lua_Integer n = lua_Integer(lua_objlen(L, idx));
    for (lua_Integer i = 1; i <= n; ++i) {
        lua_rawgeti(L, idx, i);
        if (lua_type(L, -1) != LUA_TSTRING)
            args.Fail(idx, "path", "expected only texts");
        path << QString::fromUtf8(lua_tostring(L, -1));
        lua_pop(L, 1);
    }
    if (path.isEmpty())
        args.Fail(idx, "path", "is empty");
    return path;
}

// The first entry (that of the overlay under the mouse, where there is one)
// matches by its whole text or by the text before its shortcut
// ("Edit Point" for "Edit Point\tE").
QAction *FindAction(const QList<QAction *> &actions, const QStringList &path)
{
    QList<QAction *> level = actions;
    for (int i = 0; i < path.size(); ++i) {
        QAction *found = nullptr;
        for (QAction *a : level)
            if (!found && !a->isSeparator() && (a->text() == path[i] || a->text().section('\t', 0, 0) == path[i]))
                found = a;
        if (!found || (i + 1 < path.size() && !found->menu()))
            return nullptr;
        if (i + 1 == path.size())
            return found;
        level = found->menu()->actions();
    }
    return nullptr;
}

// The command tags of a choice made by a script: no dialog may wait, and a
// value given is the one the dialog would ask for.
TagList ScriptCommandTags(const LuaArgs &args, int idx)
{
    TagList tags{{PCA_FromScript, 1}};
    if (const char *value = args.OptString(idx, "value", nullptr))
        tags.Set(PCA_CommandValue, OrbString(value));
    return tags;
}

void HoverAt(const LuaArgs &args, int idx)
{
    ViewerPanel *viewer = gWindow->Viewer();
    Hands::SendMouse(viewer, QEvent::MouseMove, Position(args, idx, viewer), Qt::NoButton, Qt::NoButton,
                     Qt::NoModifier);
}

// ViewerMenu(pos) -> the context menu at `pos`: { text =, id =, arg =,
// flags = } per entry, { text =, items = } per submenu, { separator = true }.
int ViewerMenu(lua_State *L)
{
    const LuaArgs args(L, "ViewerMenu");
    HoverAt(args, 1);
    QMenu menu;
    gWindow->Viewer()->FillContextMenu(&menu);
    PushMenu(L, &menu);
    return 1;
}

// ViewerMenuChoose(pos, { "Draw Style", "Dash" } [, value]) -> whether the
// command acted.
int ViewerMenuChoose(lua_State *L)
{
    const LuaArgs args(L, "ViewerMenuChoose");
    const QStringList path = PathArg(args, 2);
    const TagList tags = ScriptCommandTags(args, 3);
    HoverAt(args, 1);
    ViewerPanel *viewer = gWindow->Viewer();
    QMenu menu;
    viewer->FillContextMenu(&menu);
    QAction *action = FindAction(menu.actions(), path);
    if (!action || action->menu())
        return Hands::Raise(L, QString("the viewer's menu has no entry \"%1\"").arg(path.join(" > ")));
    if (!action->isEnabled())
        return Hands::Raise(L, QString("the menu entry \"%1\" is disabled").arg(path.join(" > ")));
    viewer->SetCommandTags(tags);
    const bool acted = viewer->TriggerMenuAction(action);
    viewer->SetCommandTags(TagList());
    lua_pushboolean(L, acted);
    return 1;
}

void PushToolbar(lua_State *L, const QList<QAction *> &actions)
{
    lua_createtable(L, actions.size(), 0);
    int n = 0;
    for (const QAction *a : actions) {
        lua_newtable(L);
        if (a->isSeparator()) {
            lua_pushboolean(L, 1);
            lua_setfield(L, -2, "separator");
        } else {
            lua_pushstring(L, a->toolTip().toUtf8().constData());
            lua_setfield(L, -2, "tip");
            lua_pushstring(L, a->text().toUtf8().constData());
            lua_setfield(L, -2, "label");
            if (a->menu()) {
                PushToolbar(L, a->menu()->actions());
                lua_setfield(L, -2, "items");
            }
        }
        lua_rawseti(L, -2, ++n);
    }
}

// ViewerToolbar() -> the buttons of the viewer's toolbar: { tip =, label =
// [, items = { ... }] }, separators as { separator = true }.
int ViewerToolbar(lua_State *L)
{
    QCoreApplication::processEvents();
    PushToolbar(L, gWindow->Viewer()->OverlayToolBar()->actions());
    return 1;
}

// ViewerToolbarPress({ "Multiframe", "Prev" } [, value]).
int ViewerToolbarPress(lua_State *L)
{
    const LuaArgs args(L, "ViewerToolbarPress");
    const QStringList path = PathArg(args, 1);
    const TagList tags = ScriptCommandTags(args, 2);
    ViewerPanel *viewer = gWindow->Viewer();
    QCoreApplication::processEvents();
    QAction *action = FindAction(viewer->OverlayToolBar()->actions(), path);
    if (!action || action->menu())
        return Hands::Raise(L, QString("the viewer's toolbar has no button \"%1\"").arg(path.join(" > ")));
    viewer->SetCommandTags(tags);
    action->trigger();
    viewer->SetCommandTags(TagList());
    QCoreApplication::processEvents();
    return 0;
}

// ViewerTip(pos) -> the tool tip at `pos`, or nil.
int ViewerTip(lua_State *L)
{
    const LuaArgs args(L, "ViewerTip");
    ViewerPanel *viewer = gWindow->Viewer();
    const QString tip = viewer->TipAt(Position(args, 1, viewer));
    if (tip.isEmpty())
        lua_pushnil(L);
    else
        lua_pushstring(L, tip.toUtf8().constData());
    return 1;
}

// Track(tool, input, "forward"|"backward" [, { from =, to = }]) -> frames
// tracked, message: runs the tracker overlay of the Input through the
// viewer's sequence, blocking, without a dialog. Forward runs from `from`
// (the current frame) to `to` (the last frame); backward from `to` (the
// current frame) down to `from` (the first frame).
int Track(lua_State *L)
{
    const LuaArgs args(L, "Track");
    const char *direction = args.String(3, "direction");
    const bool forward = std::strcmp(direction, "forward") == 0;
    if (!forward && std::strcmp(direction, "backward") != 0)
        args.Fail(3, "direction", "expected \"forward\" or \"backward\"");
    QString range = ":";
    if (lua_istable(L, 4)) {
        constexpr int32 kFar = 1 << 30;
        const auto frame = [&](const char *key) {
            return args.HasField(4, key) ? QString::number(args.IntegerField(4, key, -kFar, kFar, 0)) : QString();
        };
        range = forward ? frame("from") + ":" + frame("to") : frame("to") + ":" + frame("from");
    }
    lua_settop(L, 2);
    lua_pushstring(L, "TrackerControl");
    PreviewControl *overlay = OverlayOrRaise(L);
    ViewerPanel *viewer = gWindow->Viewer();
    TagList tags{{PCA_FromScript, 1}};
    tags.Set(PCA_CommandValue, OrbString(range.toUtf8().constData()));
    overlay->HandleEvent(OrbID(forward ? "TrackForward" : "TrackBackward"), &viewer->Info(), &tags);
    ScriptVal state = ScriptVal::NewTable();
    overlay->GetState(state);
    const ScriptVal *tracked = state.FindKeyConst(ScriptVal("tracked"));
    const ScriptVal *message = state.FindKeyConst(ScriptVal("trackMessage"));
    lua_pushinteger(L, tracked ? lua_Integer(tracked->GetNumber()) : 0);
    lua_pushstring(L, message ? message->GetString() : "");
    return 2;
}

} // namespace

void ViewerScripting::Install(MainWindow *window)
{
    gWindow = window;
    const std::pair<const char *, lua_CFunction> functions[] = {
        {"ViewerPress", ViewerPress},
        {"ViewerMove", ViewerMove},
        {"ViewerRelease", ViewerRelease},
        {"ViewerHover", ViewerHover},
        {"ViewerKey", ViewerKey},
        {"ViewerGrab", ViewerGrab},
        {"ViewerImage", ViewerImage},
        {"ViewerInfo", ViewerInfo},
        {"Overlay", Overlay},
        {"OverlayState", OverlayState},
        {"ViewerMenu", ViewerMenu},
        {"ViewerMenuChoose", ViewerMenuChoose},
        {"ViewerToolbar", ViewerToolbar},
        {"ViewerToolbarPress", ViewerToolbarPress},
        {"ViewerTip", ViewerTip},
        {"ViewerCamera", ViewerCamera},
        {"Track", Track},
    };
    for (const auto &[name, fn] : functions)
        LuaRuntime::Instance().AddModuleFunction(name, fn);
}

} // namespace Orbane
