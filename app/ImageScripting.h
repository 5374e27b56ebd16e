#pragma once

namespace Orbane {

class MainWindow;
class OrbaneDoc;

// Adds the viewer's picture to the `orbane` module: show a file or a
// sequence, read what is shown and how far its read has come, and wait for
// it. docs/scripting.md describes them.
class ImageScripting
{
public:
    static void Install(OrbaneDoc *doc, MainWindow *window);
};

} // namespace Orbane
