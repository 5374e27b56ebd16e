#include "BenchModule.h"

#include <QCoreApplication>
#include <QLibrary>

bool LoadControlModule()
{
    static QLibrary library;
    if (library.isLoaded())
        return true;
    const QByteArray env = qgetenv("ORBANE_CONTROLS");
    library.setFileName(env.isEmpty() ? QCoreApplication::applicationDirPath() + "/../lib/orbane/liborbanecontrols.so"
                                      : QString::fromLocal8Bit(env));
    library.setLoadHints(QLibrary::ExportExternalSymbolsHint);
    return library.load();
}
