#pragma once

#include "framework/HandleOverlay.h"
#include "framework/LinkedInput.h"
#include "polyline/PolyLineCreation.h"
#include "polyline/PolyLineDrawing.h"
#include "polyline/PolyLineEditor.h"
#include "polyline/PolyLineMouse.h"
#include "polyline/PolyLineSettings.h"

#include "orbane/AutoRef.h"
#include "orbane/LockableObject.h"
#include "orbane/OrbColor.h"
#include "orbane/SelMask.h"

#include <QCursor>
#include <QElapsedTimer>

#include <array>
#include <memory>
#include <vector>

namespace Orbane {

class PolyLine;
class ShapeBox;

// The viewer overlay of a shape Input (a Bezier PolyLine or a B-spline):
// draws the shape with its key points and the handles of the selected
// points, and creates it by clicking ("Click Append") or by drawing
// freehand ("Draw Append"). Key points and handles are handles of the
// shared handle mechanism, so hovering highlights the one under the mouse.
//
// Drawing reads a copy of the shape taken under the control's lock; a new
// value replaces the copy under the same lock, so a draw never sees a
// half-replaced shape. The shape values themselves are the host's.
class PolyLineControl : public HandleOverlay, public LockableObject
{
public:
    // Editing modes: the low nibble of the draw mode.
    enum Mode : uint8
    {
        PLM_Done = 0,
        PLM_ClickAppend = 1,
        PLM_DrawAppend = 2,
        PLM_InsertModify = 3,
        PLM_ModifyOnly = 4,
    };
    // Pairing of an inner shape with its outer (feather) shape.
    enum Pairing : int32
    {
        PAIR_IsOuter = 0, // this overlay edits the outer shape of an inner one
        PAIR_Follow = 1,  // the outer shape follows the inner one
        PAIR_Free = 2,    // both shown and edited, each on its own
        PAIR_Off = 3,     // no outer shape in use
    };
    // Parts of the handles: a key point, or one of its two handle ends.
    enum Part : uint32
    {
        PLP_Point = 1,
        PLP_InHandle = 2,
        PLP_OutHandle = 4,
    };

    PolyLineControl(const Registry *reg, const ScriptVal &args, const TagList &tags);
    ~PolyLineControl() override;

    std::size_t SizeOf() const override { return sizeof(PolyLineControl); }
    bool GetAttrsTagList(TagList &tags) const override;
    // Adds `mode`, `displayFlags`, `dimmed`, `shapeReadOnly`, `attachResult`,
    // `pairing`, `selected` (the selected point indices, from 0), `points`
    // (the key point count) and `cursor` (the Qt shape of the control's
    // current cursor).
    void GetState(ScriptVal &state) const override;

    using PreviewControl::SetAttrsTagList;
    bool SetAttrsTagList(Input *input, const TagList &tags) override;
    bool RemoveInput(Input *input, const TagList *tags) override;
    void NotifyChanged(Input *input, Parameter *value, const TagList *tags) override;
    void SetInactive(const TagList *tags) override;
    void DrawControls(PreviewInfo *info, const TagList *tags) override;
    DragType ControlDown(PreviewInfo *info, const OrbPointI &mouse, const TagList *tags) override;
    void ControlMove(PreviewInfo *info, const OrbPointI &mouse, const TagList *tags) override;
    void ControlUp(PreviewInfo *info, const OrbPointI &mouse, const TagList *tags) override;
    uint64 ControlCommand(PreviewInfo *info, const OrbID &command, uint64 data, const TagList *tags) override;
    bool HoverBounds(const PreviewInfo &info, OrbRect &bounds) const override;

    // The command surface: context menu, toolbar, keys and tips
    // (PolyLineControlCommands.cpp; the commands run in PolyLineCommandRunner).
    void AddToMenu(QMenu *menu, PreviewInfo *info, const TagList *tags) override;
    bool HandleMenu(int32 id, PreviewInfo *info, const TagList *tags) override;
    void GetAvailableEvents(std::vector<ToolbarEvent> &events, const TagList *tags) override;
    bool HandleEvent(const OrbID &event, PreviewInfo *info, const TagList *tags) override;
    bool ControlGetTip(PreviewInfo *info, char *buffer, const TagList *tags) override;
    // One command of the menu, the toolbar or a key, with its argument;
    // false where it did nothing (it then tells the user why).
    bool RunCommand(int32 command, int32 arg, const TagList *tags);
    const PolyLineSettings &Settings() const { return mSurface->settings; }

    uint8 DrawMode() const { return mDrawMode; }
    uint8 ModeOf() const { return mDrawMode & 0x0F; }
    // Sets the low nibble, keeping the high one; mode 1 takes the append cursor.
    void SetMode(uint8 mode);
    uint16 DisplayFlags() const { return mDisplayFlags; }
    bool IsDimmed() const { return mDimmed; }
    void SetDimmed(bool dimmed) { mDimmed = dimmed; }
    bool IsShapeReadOnly() const { return mShapeReadOnly; }
    uint32 AttachResult() const { return mAttachResult; }
    int32 Pairing() const { return mPairing; }
    const SelMask &Selection() const { return mSelection; }
    SelMask &Selection() { return mSelection; }
    const ShapeBox *Box() const { return mShapeBox; }
    // The editing operations behind keys, menu and toolbar.
    PolyLineEditor &Editor() { return mEditor; }
    const PolyLineEditor &Editor() const { return mEditor; }
    void SetPairing(int32 pairing) { mPairing = pairing; }
    // The pair of shapes this overlay belongs to, whichever of the two it
    // edits; null where it has no partner.
    Input *InnerInput() const;
    Input *OuterInput() const;
    AutoRef<PolyLine> InnerShape() const;
    AutoRef<PolyLine> OuterShape() const;
    const QCursor &CurrentCursor() const { return *mCurrentCursor; }
    // The shape as drawing reads it (one more reference for the caller).
    AutoRef<PolyLine> Shape() const;
    // How far (in viewer pixels) a reduced freehand stroke may stray from
    // the samples; 0 keeps every sample as a corner point.
    float64 ReduceTolerance() const { return mReduceTolerance; }
    void SetReduceTolerance(float64 pixels) { mReduceTolerance = pixels; }

    // The eight cursors, by Qt shape: arrow, cross, the append cursor,
    // horizontal, vertical, forward- and backward-diagonal size, size all.
    static constexpr std::array<Qt::CursorShape, 8> CursorShapes{
        Qt::ArrowCursor,   Qt::CrossCursor,     Qt::ArrowCursor,     Qt::SizeHorCursor,
        Qt::SizeVerCursor, Qt::SizeFDiagCursor, Qt::SizeBDiagCursor, Qt::SizeAllCursor};

protected:
    void BuildHandles(const PreviewInfo &info, HandleSet &handles) const override;

private:
    friend class PolyLineCommandRunner;
    friend class PolyLineDialogs;
    friend class PolyLineKeyEdit;
    friend class PolyLineEditor;
    friend class PolyLineMouse;
    static const LinkedInput<PolyLineControl> Links[];

    uint64 KeyCommand(PreviewInfo *info, const OrbID &command, uint64 data, const TagList *tags);
    void AddSurfaceState(ScriptVal &state) const;
    bool RunWhole(PreviewInfo *info, int32 command, int32 arg, const TagList *tags);
    void DrawExtras(Graphics::GPainter &p, const PolyLine &shape, const PolyLineStyle &style) const;

    void ReadFlags(const TagList &tags);
    void ReadDrawStyle(int64 style);
    void ReadColors(const TagList &tags);
    void ReadDefaults(const TagList &tags);
    void ReadAttachResult(const TagList &tags);
    void ReadPairing(const TagList &tags);
    void EmptySelectionWhenHidden();
    void StoreLinked(Input *input, const Parameter *value, bool &moved);
    bool StoreShape(const Parameter *value);
    bool IsAppending() const;
    bool IsToolLocked() const;
    PolyLineStyle Style(const PreviewInfo &info) const;
    void DrawCentre(Graphics::GPainter &p, const PreviewInfo &info) const;
    void DrawOnionSkins(Graphics::GPainter &p, const PreviewInfo &info, const PolyLineStyle &style) const;
    // The key times that show an onion skin now: the nearest keys before
    // and after the current time, as many as the onion settings say.
    std::vector<float64> SkinTimes() const;
    // Writes `shape` to the main Input at the current time.
    bool WriteShape(PolyLine *shape);
    void ShowCursor(const PreviewInfo &info, bool show);
    bool CanCreate() const;
    void BeginClick(HandleHit hit, OrbPoint at);
    void BeginStroke(OrbPoint at);
    bool CanEditByMouse() const;
    void PullHandles(const PreviewInfo &info, OrbPoint to);
    // An outer shape that follows this one moves with it (same step).
    void FollowInner(const PolyLine &inner);
    void DrawOuter(Graphics::GPainter &p, const PolyLineStyle &style) const;
    void EndStroke(const PreviewInfo &info);
    static OrbPoint OnePixel(const PreviewInfo &info);
    static float64 HandleReach(const PreviewInfo &info);
    void OpenStep(const char *name);
    void CloseStep();

    // --- state, as tags and the editing set it ---
    uint8 mDrawMode = PLM_Done;
    uint16 mDisplayFlags = PLD_Default;
    bool mRecordTime = false, mRecordPressure = false, mRecordHeight = false;
    bool mRecordAngleXY = false, mRecordAngleZ = false, mRecordRotation = false;
    bool mCanPublishPoints = false;
    bool mAnimated = false;
    bool mCurrentTimeOnly = false;
    int32 mStopRendering = 0;
    bool mFollowExternMatchPoint = true;
    bool mShapeReadOnly = false;
    OrbColor mHandleColor{192, 192, 0, 255}, mHandleColorAlt{192, 192, 0, 255};
    OrbColor mCustomSplineColor, mCustomKeyPointColor; // none
    bool mDimmed = false;
    bool mPairFromAttach = false; // 0x10058011
    bool mKeptFlag = false;       // 0x10058012
    uint16 mExportSplineMode = 0;
    uint32 mAttachResult = 0;
    int32 mPairing = 1;
    SelMask mSelection;
    float64 mReduceTolerance = 2.0;

    // --- linked Inputs and their values ---
    Input *mCenterInput = nullptr, *mAngleInput = nullptr, *mSizeInput = nullptr;
    Input *mDisplacementInput = nullptr, *mCurrentTimePointInput = nullptr;
    Input *mAngleXInput = nullptr, *mAngleYInput = nullptr, *mAngleZInput = nullptr;
    Input *mOuterInput = nullptr, *mInnerInput = nullptr;
    Input *mCenterXInput = nullptr, *mCenterYInput = nullptr, *mCenterZInput = nullptr;
    Input *mTrackerSizeInput = nullptr, *mTrackerSearchSizeInput = nullptr;
    OrbPoint mCenter{0.5, 0.5};
    float64 mAngle = 0.0, mSize = 1.0, mAngleX = 0.0, mAngleY = 0.0;
    float64 mTrackerSize = 0.0, mTrackerSearchSize = 0.0;

    // --- the shape as drawn, under the lock ---
    AutoRef<PolyLine> mShape;
    mutable PolyLineDrawing mDrawing;

    // --- creation and the box ---
    PolyLineCreation mCreation;
    bool mStepOpen = false;
    bool mCursorShown = false;
    QElapsedTimer mStrokeClock;
    ShapeBox *mShapeBox = nullptr; // one reference
    // Held apart so that the control stays small enough for the script object pool.
    std::unique_ptr<std::array<QCursor, 8>> mCursors = std::make_unique<std::array<QCursor, 8>>();
    const QCursor *mCurrentCursor = nullptr;

    // --- the command surface ---
    std::unique_ptr<PolyLineSurface> mSurface = std::make_unique<PolyLineSurface>();
    // --- editing ---
    PolyLineEditor mEditor{*this};
    PolyLineMouse mMouse{*this};
};

} // namespace Orbane
