#include "ControlModule.h"

#include "orbane/LuaRuntime.h"

#include <QCoreApplication>
#include <QDir>
#include <QFileInfo>

namespace Orbane {

QString ControlModule::Path()
{
    const QByteArray env = qgetenv("ORBANE_CONTROLS");
    if (!env.isEmpty())
        return QString::fromLocal8Bit(env);
    const QDir bin(QCoreApplication::applicationDirPath());
    return QDir::cleanPath(bin.filePath("../lib/orbane/liborbanecontrols.so"));
}

bool ControlModule::Load(QString *error)
{
    const QString path = Path();
    if (!QFileInfo::exists(path)) {
        *error = QStringLiteral("control library not found: %1 (set ORBANE_CONTROLS)").arg(path);
        return false;
    }
    std::string why;
    if (!LuaRuntime::Instance().LoadLibrary(path.toStdString(), &why)) {
        *error = QString::fromStdString(why);
        return false;
    }
    return true;
}

} // namespace Orbane
