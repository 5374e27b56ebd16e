#include "CommandLine.h"

namespace Orbane {

namespace {

// Takes the value of an option that needs one; records an error when missing.
QString TakeValue(const QStringList &args, int &i, CommandLine &cl)
{
    if (i + 1 < args.size())
        return args[++i];
    cl.error = QStringLiteral("%1 needs a value").arg(args[i]);
    return {};
}

} // namespace

CommandLine CommandLine::Parse(const QStringList &args)
{
    CommandLine cl;
    for (int i = 1; i < args.size() && cl.error.isEmpty(); ++i) {
        const QString &a = args[i];
        if (a == "--list-controls")
            cl.listControls = true;
        else if (a == "--headless")
            cl.headless = true;
        else if (a == "--script")
            cl.script = TakeValue(args, i, cl);
        else if (a == "--screenshots")
            cl.shotDir = TakeValue(args, i, cl);
        else if (a == "-h" || a == "--help")
            cl.help = true;
        else if (a.startsWith('-'))
            cl.error = QStringLiteral("unknown option %1").arg(a);
        else if (cl.comp.isEmpty())
            cl.comp = a;
        else
            cl.error = QStringLiteral("only one comp may be opened, got %1 and %2").arg(cl.comp, a);
    }
    return cl;
}

QString CommandLine::Usage()
{
    return QStringLiteral(
        "usage: orbane [options] [comp.lua]\n"
        "  --list-controls      print every registered control class and exit\n"
        "  --headless           run without a window (automatic when there is no display)\n"
        "  --script FILE        run a Lua script with the orbane module, exit with its status\n"
        "  --screenshots DIR    where headless runs write their screenshots\n"
        "  -h, --help           this text\n");
}

} // namespace Orbane
