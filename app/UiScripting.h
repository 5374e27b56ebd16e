#pragma once

namespace Orbane {

class MainWindow;
class OrbaneDoc;

// Adds the functions that let scripts work the application the way a person
// does: load comps and tools, read and write Input values, click, drag and
// type on controls with modifiers, undo and redo, and grab screenshots.
// docs/scripting.md describes them.
class UiScripting
{
public:
    static void Install(OrbaneDoc *doc, MainWindow *window);
};

} // namespace Orbane
