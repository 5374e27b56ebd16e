#include "ImageScripting.h"

#include "MainWindow.h"

#include "orbane/LuaArgs.h"
#include "orbane/LuaRuntime.h"
#include "orbane/OrbaneDoc.h"
#include "orbane/ViewerPanel.h"

#include <QFileInfo>

namespace Orbane {

namespace {

OrbaneDoc *gDoc = nullptr;
MainWindow *gWindow = nullptr;

// A day: longer than any read, short enough for a timer.
constexpr float64 kMaxWait = 86400.0, kDefaultWait = 60.0;

void SetString(lua_State *L, const char *key, const QString &value)
{
    lua_pushstring(L, value.toUtf8().constData());
    lua_setfield(L, -2, key);
}

// { path, file, sequence, frame, shownFrame, first, last, width, height,
//   channels, loading, progress, error }; error is nil where all is well.
int PushInfo(lua_State *L)
{
    const ViewerImageState &s = gWindow->Viewer()->ImageState();
    lua_createtable(L, 0, 13);
    SetString(L, "path", s.source);
    SetString(L, "file", s.file);
    for (auto [key, v] : {std::pair{"frame", s.frame},
                          {"shownFrame", s.shownFrame},
                          {"first", s.first},
                          {"last", s.last},
                          {"width", s.width},
                          {"height", s.height},
                          {"channels", s.channels}}) {
        lua_pushinteger(L, v);
        lua_setfield(L, -2, key);
    }
    lua_pushboolean(L, s.sequence);
    lua_setfield(L, -2, "sequence");
    lua_pushboolean(L, s.loading);
    lua_setfield(L, -2, "loading");
    lua_pushnumber(L, s.progress);
    lua_setfield(L, -2, "progress");
    if (!s.error.isEmpty())
        SetString(L, "error", s.error);
    return 1;
}

// ViewImage(path_or_pattern): the document's viewer image, so a saved comp
// keeps it; a relative path starts at the current directory. Returns the
// info at once: the size is known, the pixels are on their way.
int ViewImage(lua_State *L)
{
    const QString path = QString::fromUtf8(LuaArgs(L, "ViewImage").String(1, "path"));
    gDoc->SetPref(PREF_ViewerImage, path.isEmpty() ? std::string() : QFileInfo(path).absoluteFilePath().toStdString());
    return PushInfo(L);
}

int ViewerImageInfo(lua_State *L)
{
    return PushInfo(L);
}

// WaitImage([seconds]): lets the read under way finish (60 s at most by
// default); returns the info, `loading` still true where time ran out.
int WaitImage(lua_State *L)
{
    const float64 seconds = LuaArgs(L, "WaitImage").OptNumber(1, "seconds", kDefaultWait);
    gWindow->Viewer()->WaitForImage(int32(std::clamp(seconds, 0.0, kMaxWait) * 1000.0));
    return PushInfo(L);
}

} // namespace

void ImageScripting::Install(OrbaneDoc *doc, MainWindow *window)
{
    gDoc = doc;
    gWindow = window;
    const std::pair<const char *, lua_CFunction> functions[] = {
        {"ViewImage", ViewImage},
        {"ViewerImageInfo", ViewerImageInfo},
        {"WaitImage", WaitImage},
    };
    for (const auto &[name, fn] : functions)
        LuaRuntime::Instance().AddModuleFunction(name, fn);
}

} // namespace Orbane
