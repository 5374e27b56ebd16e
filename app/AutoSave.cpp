#include "AutoSave.h"

#include "orbane/OrbaneDoc.h"
#include "orbane/ToolLoader.h"

#include <QDir>
#include <QFile>
#include <QSettings>
#include <QStandardPaths>
#include <QTimer>

#include <string>

namespace Orbane {

namespace {

// Where the recovered work was saved before, kept beside the recovery file.
const char kCompPathKey[] = "recovery/compPath";

} // namespace

AutoSave::AutoSave(OrbaneDoc *doc, QObject *parent) : QObject(parent), mDoc(doc), mTimer(new QTimer(this))
{
    mTimer->setInterval(kIntervalMs);
    connect(mTimer, &QTimer::timeout, this, &AutoSave::OnTimeout);
    connect(doc, &OrbaneDoc::modifiedChanged, this, &AutoSave::OnModifiedChanged);
}

// Arming does not remove an old recovery file: it waits to be offered.
void AutoSave::SetEnabled(bool on)
{
    mEnabled = on;
    if (on && mDoc->IsModified())
        mTimer->start();
    else
        mTimer->stop();
}

AutoSave::~AutoSave() = default;

void AutoSave::SetInterval(int ms)
{
    mTimer->setInterval(ms);
}

int AutoSave::Interval() const
{
    return mTimer->interval();
}

QString AutoSave::RecoveryPath()
{
    return QDir(QStandardPaths::writableLocation(QStandardPaths::AppDataLocation)).filePath("recovery.comp.lua");
}

bool AutoSave::HasRecovery()
{
    return QFile::exists(RecoveryPath());
}

QString AutoSave::RecoveredCompPath()
{
    return QSettings().value(kCompPathKey).toString();
}

void AutoSave::OnModifiedChanged(bool modified)
{
    if (!mEnabled)
        return;
    if (modified) {
        if (!mTimer->isActive())
            mTimer->start();
        return;
    }
    mTimer->stop();
    Discard();
}

void AutoSave::OnTimeout()
{
    WriteNow();
}

bool AutoSave::WriteNow(QString *error)
{
    if (!mEnabled || !mDoc->IsModified())
        return false;
    QDir().mkpath(QFileInfo(RecoveryPath()).path());
    std::string why;
    if (!ToolLoader::WriteComp(*mDoc, RecoveryPath().toStdString(), &why)) {
        if (error)
            *error = QString::fromStdString(why);
        return false;
    }
    QSettings().setValue(kCompPathKey, QString::fromStdString(mDoc->CompPath()));
    return true;
}

bool AutoSave::Restore(QString *error)
{
    const QString was = RecoveredCompPath();
    std::string why;
    if (!ToolLoader::OpenComp(*mDoc, RecoveryPath().toStdString(), &why)) {
        if (error)
            *error = QString::fromStdString(why);
        return false;
    }
    // The work is the user's unsaved state of `was`, not a saved file: it
    // keeps that name and needs saving again.
    mDoc->MarkSaved(was.toStdString());
    mDoc->MarkModified();
    Discard();
    if (mEnabled)
        mTimer->start();
    return true;
}

void AutoSave::Discard()
{
    QFile::remove(RecoveryPath());
    QSettings().remove(kCompPathKey);
}

} // namespace Orbane
