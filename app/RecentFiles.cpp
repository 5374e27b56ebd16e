#include "RecentFiles.h"

#include <QFileInfo>
#include <QSettings>

namespace Orbane {

namespace {

const char kKey[] = "recentComps";

} // namespace

RecentFiles::RecentFiles(QObject *parent) : QObject(parent) {}

QStringList RecentFiles::Paths() const
{
    return QSettings().value(kKey).toStringList();
}

void RecentFiles::Add(const QString &path)
{
    const QString absolute = QFileInfo(path).absoluteFilePath();
    QStringList paths = Paths();
    paths.removeAll(absolute);
    paths.prepend(absolute);
    Store(paths.mid(0, kMax));
}

void RecentFiles::Remove(const QString &path)
{
    QStringList paths = Paths();
    if (paths.removeAll(QFileInfo(path).absoluteFilePath()) > 0)
        Store(paths);
}

void RecentFiles::Clear()
{
    Store(QStringList());
}

void RecentFiles::Store(const QStringList &paths)
{
    QSettings().setValue(kKey, paths);
    emit changed();
}

} // namespace Orbane
