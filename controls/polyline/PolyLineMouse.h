#pragma once

#include "framework/HandleHit.h"

#include "orbane/AutoRef.h"
#include "orbane/OrbPointT.h"
#include "orbane/OrbRectT.h"
#include "orbane/PolyLine.h"

#include <Qt>

namespace Orbane {

class PolyLineControl;
class PreviewInfo;
struct PolyLineStyle;

namespace Graphics {
class GPainter;
} // namespace Graphics

// The mouse gestures that edit an existing shape in "Insert and Modify" and
// "Modify Only":
//   - a press on a key point selects it alone (one already selected keeps
//     the selection, so a drag moves all the selected points; a click
//     without a drag then selects it alone), Shift adds it, Ctrl toggles it
//     (and drags nothing); a drag moves the selected points that are not
//     locked ("Move Point" for one, "Move points" for several);
//   - a press on a handle end drags it; its opposite handle turns with it
//     unless Ctrl is held, which breaks the tangent ("Tensioning");
//   - a press on the curve drags the segment, reshaping it so the curve
//     follows the mouse where it was held ("Shape points"); in "Insert and
//     Modify" a click on the curve without a drag inserts a point there
//     ("InsertAndModify");
//   - a press on empty space draws a selection box: the points inside are
//     selected alone, with Shift added, with Ctrl toggled; a click on empty
//     space without Shift or Ctrl empties the selection;
//   - with the shape box on, its handles scale, its ring turns and its
//     inside moves the selected points ("Dragging Shaping Box", "Move
//     Points" from the press).
// With "Lock Point Selection" on, presses change no selection. Every drag
// is one undo step; an undo that lands between the press and the first
// move ends the gesture instead of writing over it.
class PolyLineMouse
{
public:
    enum Gesture : int32
    {
        PMG_None,
        PMG_Points,   // the selected points follow the mouse
        PMG_Handle,   // a handle end
        PMG_Segment,  // the curve between two points
        PMG_Box,      // a selection box
        PMG_ShapeBox, // the shape box's part `part`
        PMG_Toggle,   // a Ctrl-click on a point: nothing to drag
    };

    explicit PolyLineMouse(PolyLineControl &control) : mControl(control) {}

    // Takes the press where it edits; false leaves it to the others.
    bool Press(const PreviewInfo &info, HandleHit hit);
    void Move(const PreviewInfo &info);
    void Release(const PreviewInfo &info);
    void Cancel();
    // The cursor of the shape box's part under the mouse (its index among
    // the control's cursors), -1 off the box.
    int32 HoverCursor(const PreviewInfo &info) const;
    // The selection box and the shape box, in image coordinates.
    void Draw(Graphics::GPainter &p, const PreviewInfo &info, const PolyLineStyle &style) const;

    Gesture Current() const { return mGesture; }
    // The selection box being drawn (image coordinates).
    OrbRect SelectionBox() const { return OrbRect(mFrom, mTo); }

private:
    bool PressPoint(HandleHit hit, Qt::KeyboardModifiers mods);
    bool PressSegment(const PreviewInfo &info);
    bool PressShapeBox(const PreviewInfo &info);
    void MovePoints(OrbPoint delta);
    void MoveShapeBox(const PreviewInfo &info);
    void Write(const char *undo, PolyLine *shape);
    bool Moved(const PreviewInfo &info) const;
    bool Overtaken() const;

    PolyLineControl &mControl;
    Gesture mGesture = PMG_None;
    HandleHit mHit;
    Qt::KeyboardModifiers mMods;
    AutoRef<PolyLine> mPressShape; // the shape as the press found it
    AutoRef<PolyLine> mExpected;   // the shape as this gesture last left it
    AutoRef<PolyLine> mPressOuter;
    OrbPoint mFrom, mTo;   // image coordinates of the press and the mouse now
    OrbPoint mPressViewer; // the press in viewer units
    OrbPoint mHeld;        // what the press held (image coordinates)
    int32 mSegment = -1;
    float64 mSegmentT = 0.0, mSegmentPar = 0.0;
    int32 mBoxPart = -1;
    bool mReselect = false; // a click on a selected point selects it alone
};

} // namespace Orbane
