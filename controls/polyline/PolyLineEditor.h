#pragma once

#include "orbane/AutoRef.h"
#include "orbane/OrbPointT.h"
#include "orbane/OrbRectT.h"
#include "orbane/Types.h"

#include <Qt>

#include <functional>
#include <string>
#include <vector>

namespace Orbane {

class Input;
class PolyLine;
class PolyLineControl;
class PreviewInfo;
class SelMask;

// The operations behind the polyline overlay's keys, menu and toolbar: the
// selection, the edits of the selected points, the clipboard, the outer
// (feather) polyline and the time settings. Each edit is one undo step under
// its own name and answers whether it changed the shape; one that refuses
// (a locked tool, a read-only or empty shape, nothing selected) changes
// nothing and says why in Message(), for the caller to show.
//
// Edits of an animated shape: moving points changes the shape at the
// current time and, in multi-frame mode, at the chosen neighbouring keys;
// edits that change the number of points (delete, cut, paste, subdivide,
// reduce) change every key unless "Current Time Only" is on, so the keys
// keep blending point by point.
class PolyLineEditor
{
public:
    enum SelectHow : int32
    {
        SH_Replace,
        SH_Add,
        SH_Toggle,
        SH_Remove,
    };
    enum MultiFrame : int32
    {
        MF_None,
        MF_Prev,
        MF_Next,
        MF_All,
    };
    enum ShapeBoxMode : int32
    {
        SB_Off,
        SB_Shape,
        SB_Both, // the outer polyline's points too
    };
    enum PublishTarget : int32
    {
        PT_Path,
        PT_XYPath,
        PT_IntelliTrack,
        PT_PointTracker,
    };
    // How far "Paste With Offset" moves the points, in image pixels.
    static constexpr float64 PasteOffsetPixels = 10.0;

    explicit PolyLineEditor(PolyLineControl &control) : mControl(control) {}

    // --- selection: the view's, so no undo step ---
    bool SelectAll();
    bool SelectNone();
    bool Select(const std::vector<int32> &indices, SelectHow how);
    bool SelectInBox(const OrbRect &image, SelectHow how);
    // Moves a single selection `step` points on (round a closed shape);
    // with none, the first (or, stepping back, the last) point.
    bool SelectNext(int32 step);
    void SetSelectionLocked(bool locked) { mSelectionLocked = locked; }
    bool IsSelectionLocked() const { return mSelectionLocked; }

    // --- edits of the selected points ---
    bool DeleteSelected();
    bool Smooth();
    bool MakeLinear();
    bool SetClosed(bool closed);
    // Qt::Horizontal mirrors X, Qt::Vertical Y, about the selection's middle.
    bool Flip(Qt::Orientation axis);
    // A run of nudges is one step, ended by EndNudge (all keys released).
    bool Nudge(OrbPoint imageDelta);
    bool NudgeKey(int key, Qt::KeyboardModifiers mods, const PreviewInfo &info);
    void EndNudge();
    bool TagSelected();
    bool PublishSelected();
    bool Unpublish();
    bool FollowNearby();
    bool StopFollowing();
    bool PublishTo(int32 target);
    bool LockSelected(bool locked);
    // Does the (first) selected point carry the lock?
    bool IsSelectionLockedPoint() const;
    void SetLockPairs(bool on) { mLockPairs = on; }
    bool LockPairs() const { return mLockPairs; }
    bool Subdivide();
    bool Reduce(float64 tolerancePx);

    // --- the clipboard, as the shape file's text ---
    bool Copy();
    bool CopyPathValue();
    bool Cut();
    bool Paste();
    bool PasteWithOffset(OrbPoint imageOffset);
    // The offset of PasteOffsetPixels image pixels right and down.
    OrbPoint DefaultPasteOffset() const;

    // --- the outer polyline ---
    bool MakeOuter();
    bool RemoveOuter();
    bool EnableOuter();
    bool ResetOuter();
    bool FollowInner();

    // --- time ---
    void SetMultiFrame(int32 mode);
    int32 GetMultiFrame() const { return mMultiFrame; }
    void SetCurrentTimeOnly(bool on);
    bool CurrentTimeOnly() const;
    std::vector<float64> KeyTimes() const;

    // --- the shape box ---
    void SetShapeBox(int32 mode);
    int32 GetShapeBox() const { return mShapeBox; }

    // Why the last refused edit did nothing; empty after one that worked.
    const std::string &Message() const { return mMessage; }

    // --- for the mouse ---
    // Writes `shape` as one step under `undo` (at the current time, and at
    // the keys multi-frame editing adds when `moves`); false with a message
    // where the tool or shape refuses.
    bool Commit(const char *undo, const std::function<bool(PolyLine &)> &edit, bool structural);
    // True where edits may go on: an Input, an unlocked tool, an editable shape.
    bool CanEdit();
    // The times besides the current one that an edit also changes.
    std::vector<float64> OtherTimes(bool structural) const;

private:
    bool Refuse(const char *why);
    bool NeedSelection();
    bool NeedPoints();
    Input *Outer() const;
    AutoRef<PolyLine> OuterShape() const;
    bool WriteOuter(const char *undo, PolyLine *shape, int32 pairing);
    bool EditSelected(const char *undo, const std::function<bool(PolyLine &, const uint8 *)> &edit);
    bool PasteText(OrbPoint offset);
    bool CreatePointInputs(const PolyLine &shape) const;

    PolyLineControl &mControl;
    std::string mMessage;
    bool mSelectionLocked = false;
    bool mLockPairs = false;
    bool mNudging = false;
    int32 mMultiFrame = MF_None;
    int32 mShapeBox = SB_Off;
};

} // namespace Orbane
