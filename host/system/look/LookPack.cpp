#include "orbane/LookPack.h"

#include "orbane/LuaRuntime.h"
#include "orbane/LuaSandbox.h"

#include <QCoreApplication>
#include <QDir>
#include <QFileInfo>
#include <QtGlobal>

namespace Orbane {

namespace {

const ScriptVal kNil;

QString Existing(const QString &path)
{
    return QFileInfo(path).isDir() ? QDir(path).absolutePath() : QString();
}

} // namespace

const LookPack &LookPack::Get()
{
    static const LookPack pack(LocateFolder());
    return pack;
}

LookPack::LookPack(const QString &folder) : mFolder(folder)
{
    if (mFolder.isEmpty() || !QFileInfo(mFolder).isDir()) {
        qWarning("LookPack: no look pack folder \"%s\"; set ORBANE_LOOKS", qPrintable(mFolder));
        return;
    }
    LoadFolder();
}

QString LookPack::LocateFolder()
{
    const QByteArray env = qgetenv("ORBANE_LOOKS");
    if (!env.isEmpty()) {
        const QString folder = Existing(QString::fromLocal8Bit(env));
        if (!folder.isEmpty())
            return folder;
        qWarning("LookPack: ORBANE_LOOKS names no folder: %s", env.constData());
    }
    if (QCoreApplication::instance()) {
        const QString installed =
            Existing(QCoreApplication::applicationDirPath() + QStringLiteral("/../share/orbane/looks/default"));
        if (!installed.isEmpty())
            return installed;
    }
#ifdef ORBANE_SOURCE_LOOKS
    return Existing(QStringLiteral(ORBANE_SOURCE_LOOKS));
#else
    return QString();
#endif
}

void LookPack::LoadFolder()
{
    const QDir dir(mFolder);
    const QStringList files = dir.entryList({QStringLiteral("*.lua")}, QDir::Files | QDir::Readable, QDir::Name);
    for (const QString &file : files)
        LoadFile(dir.filePath(file));
}

bool LookPack::LoadFile(const QString &path)
{
    // A state of its own: the pack loads once, maybe before the runtime,
    // and a look pack from outside is content like any other.
    lua_State *L = LuaSandbox::NewState();
    if (!L)
        return false;
    const QByteArray file = QFile::encodeName(path);
    std::string why;
    ScriptVal items;
    bool ok = LuaSandbox::RunFile(L, file.toStdString(), 1, &why) && LuaRuntime::ToScriptVal(L, -1, items, why);
    if (ok && !items.IsTable()) {
        why = file.toStdString() + ": the file does not return a table of items";
        ok = false;
    }
    if (ok) {
        for (const ScriptVal::Entry &entry : items.GetEntries())
            if (entry.first.IsString())
                mItems[OrbID(entry.first.GetString())] = entry.second;
    } else {
        qWarning("LookPack: %s", why.c_str());
    }
    LuaSandbox::CloseState(L);
    return ok;
}

const ScriptVal &LookPack::FindItem(const OrbID &name) const
{
    const auto it = mItems.find(name);
    if (it != mItems.end())
        return it->second;
    WarnMissing(name);
    return kNil;
}

void LookPack::WarnMissing(const OrbID &name) const
{
    std::lock_guard<std::mutex> lock(mWarnLock);
    if (mWarned.insert(name).second)
        qWarning("LookPack: no item \"%s\" in %s", name.c_str(), qPrintable(mFolder));
}

QString LookPack::FindImageFile(const OrbID &name) const
{
    if (name.IsEmpty() || mFolder.isEmpty())
        return QString();
    const QDir dir(mFolder);
    for (const char *ext : {".svg", ".png"}) {
        const QString path = dir.filePath(QString::fromUtf8(name.c_str()) + QLatin1String(ext));
        if (QFileInfo::exists(path))
            return path;
    }
    return QString();
}

} // namespace Orbane
