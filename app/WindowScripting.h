#pragma once

namespace Orbane {

class MainWindow;
class OrbaneDoc;

// Adds the functions that work the window's own parts from scripts: its
// menus and their questions, an inspector control's context menu, the time
// ruler, the undo history, autosave and recovery, and what accessibility
// tools read of a widget. docs/scripting.md describes them.
class WindowScripting
{
public:
    static void Install(OrbaneDoc *doc, MainWindow *window);
};

} // namespace Orbane
