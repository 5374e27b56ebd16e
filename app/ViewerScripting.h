#pragma once

namespace Orbane {

class MainWindow;

// Adds the viewer's gestures to the `orbane` module: press, move, release
// and hover at image or viewer positions, keys with modifiers, screenshots
// of the viewer and the image it shows. docs/scripting.md describes them.
class ViewerScripting
{
public:
    static void Install(MainWindow *window);
};

} // namespace Orbane
