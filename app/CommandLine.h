#pragma once

#include <QString>
#include <QStringList>

namespace Orbane {

// What the user asked for on the command line.
struct CommandLine
{
    bool listControls = false;
    bool headless = false;
    bool help = false;
    QString script;   // --script FILE: run it, then exit with its status
    QString comp;     // the comp to open
    QString shotDir;  // --screenshots DIR: where headless runs write screenshots
    QString error;    // set when the arguments make no sense

    static CommandLine Parse(const QStringList &args);
    static QString Usage();
};

} // namespace Orbane
