#pragma once

#include <QString>
#include <QTextStream>

namespace Orbane {

// Runs a Lua script with the orbane module. A script error prints its message
// with file and line and gives status 1; a script that returns a number gives
// that status; otherwise 0.
class ScriptRunner
{
public:
    static int Run(const QString &path, QTextStream &err);
};

} // namespace Orbane
