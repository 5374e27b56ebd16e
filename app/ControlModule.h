#pragma once

#include <QString>

namespace Orbane {

// Finds and loads the control library: ORBANE_CONTROLS names the file;
// otherwise <application dir>/../lib/orbane/liborbanecontrols.so, which holds
// both in the build tree and in an installed tree.
class ControlModule
{
public:
    static QString Path();
    // Loads it into the script layer (symbols global, FFI declared).
    static bool Load(QString *error);
};

} // namespace Orbane
