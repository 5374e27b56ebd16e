#pragma once

namespace Orbane {

class MainWindow;
class OrbaneDoc;

// Script functions for saved work: writing and opening comps as the File
// menu does (SaveComp, OpenComp), the document's comp path and modified
// state (CompPath, IsModified), and how an Input's keys blend
// (SetInterpolation, GetInterpolation). docs/scripting.md describes them.
class CompScripting
{
public:
    static void Install(OrbaneDoc *doc, MainWindow *window);
};

} // namespace Orbane
