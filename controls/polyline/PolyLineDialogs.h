#pragma once

#include "polyline/PolyNumbersDialog.h"

#include "orbane/Types.h"

#include <functional>
#include <string>
#include <vector>

class QWidget;

namespace Orbane {

class PolyLineControl;
class PreviewInfo;
struct PolyLineSurface;

// The polyline overlay's commands that work through a dialog of the window:
// the point editor, the keyframe list, the onion-skin settings, and the
// entries that ask for numbers (the "Create" editors, "Reduce Points…",
// the smoothing and easing dialogs), with the commands that share their
// geometry ("Cardinal to Bezier", "Convert to XYPath").
//
// The dialogs open over the viewer (PreviewInfo::DialogParent), one of each
// kind per overlay, not modal. A command from a script that carries a value
// (PCA_CommandValue: the numbers in the dialog's field order) acts at once;
// without one the dialog opens, from a script as from the window, and the
// script fills it by the object names of its parts.
class PolyLineDialogs
{
public:
    PolyLineDialogs(PolyLineControl &control, PreviewInfo *info, std::string value);

    // Runs `command` where it is one of this class's; false with `handled`
    // cleared for any other.
    bool Run(int32 command, int32 arg, bool &handled);

    // Brings the open dialogs up to date with the shape, the selection and
    // the time (called where the overlay learns of a change and draws).
    static void Follow(PolyLineSurface &surface);

private:
    bool PointEditor();
    bool KeyList();
    bool Onion();
    bool Create(int32 command);
    bool Reduce();
    bool SmoothPoints(bool ask);
    bool SmoothAnimation(bool ask);
    bool EaseInOut();
    bool CardinalToBezier();
    // Takes the numbers from the script's value, or opens a dialog of
    // `fields` for them; `apply` gets them (and may refuse with a message).
    using Apply = std::function<bool(const std::vector<float64> &)>;
    bool Numbers(const char *title, const char *name, std::vector<PolyNumbersDialog::Field> fields, Apply apply);
    bool Tell(const std::string &message);

    PolyLineControl &mControl;
    PolyLineSurface &mSurface;
    QWidget *mParent;
    std::string mValue;
};

} // namespace Orbane
