#pragma once

#include <QTextStream>

namespace Orbane {

// Prints the class registry as a table: one row per registration.
class ControlLister
{
public:
    static int Print(QTextStream &out);
};

} // namespace Orbane
