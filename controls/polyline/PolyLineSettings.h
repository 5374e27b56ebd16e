#pragma once

#include "orbane/OrbColor.h"
#include "orbane/Types.h"

#include <QDialog>
#include <QObject>
#include <QPointer>
#include <QWidget>

#include <memory>

namespace Orbane {

// What the polyline overlay's menu, toolbar and keys switch that is neither
// the shape nor the draw flags: plain view and tool settings.
struct PolyLineSettings
{
    bool pointNumbers = false;      // each key point's number drawn beside it
    bool hull = false;              // the Bezier control polygon drawn
    bool reduceOpen = false;        // the reduce-points dialog is shown
    bool publishPathPoints = false; // new points of a published shape publish themselves
    bool onionEnabled = true;       // the other keyframes' shapes drawn
    bool onionClickTime = false;    // a click on an onion skin goes to its time
    float64 onionAnchor = TIME_UNDEFINED;
    OrbColor onionPrevColor;                // the skins before the current time; none: the skin colour
    int32 onionBefore = 5, onionAfter = 5;  // how many keyframes before and after now show a skin
    OrbColor onionColor{255, 140, 26, 153}; // the skins: orange, 60% seen
    uint16 onionStipple = 0x0F0F;           // their dots
    // What the dialogs of smoothing and easing start from: the last used.
    float64 smoothAmount = 0.5;
    int32 smoothPasses = 1;
    float64 easeIn = 1.0, easeOut = 1.0;
    bool rotoEnabled = false, rotoMultiple = false, rotoTrackPoints = false;
    bool rotoShowArea = false, rotoPatternEdit = false;
    int32 rotoDistance = 5;  // frames between tracked keys
    int32 rotoFrameSkip = 1; // frames the tracker steps
};

// The command surface's own part of the overlay, held apart so that the
// overlay stays small enough for the host's pooled allocator.
struct PolyLineSurface
{
    PolyLineSettings settings;
    std::unique_ptr<QObject> dialogs; // the parent of open dialogs: they go with the control
    // The dialogs that live in the window (one each), and the viewer they
    // open over; they go with the control at once, so none outlives it.
    QPointer<QWidget> dialogParent;
    QPointer<QDialog> pointEditor, keyList, onion, numbers;
    ~PolyLineSurface()
    {
        for (QDialog *d : {pointEditor.data(), keyList.data(), onion.data(), numbers.data()})
            delete d;
    }
};

} // namespace Orbane
