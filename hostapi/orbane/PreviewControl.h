#pragma once

#include "orbane/DragType.h"
#include "orbane/InputWatcher.h"
#include "orbane/Object.h"
#include "orbane/OrbPointT.h"
#include "orbane/OrbRectT.h"
#include "orbane/OrbString.h"

#include <QPointer>
#include <Qt>

#include <functional>
#include <utility>
#include <vector>

class QMenu;

namespace Orbane {

class Input;
class Operator;
class OrbaneDoc;
class Parameter;
class PreviewInfo;

// Host attributes that overlays share, besides each class's own.
enum PreviewControlTag : Tag
{
    PCA_EventFlags = 0x10010002,        // a mouse event's flag word (PEF_ bits)
    PCA_ValueFlags = 0x10000451,        // a written value's flag word; 0: an ordinary edit
    PCA_FollowCursor = 0x10048003,      // the overlay's point follows the mouse
    PCA_HideWhileDragging = 0x10048004, // the overlay is not drawn while its own drag runs
    PCA_GrabOffsetX = 0x2004800c,       // screen offset from the mouse to the handle at the press
    PCA_GrabOffsetY = 0x2004800d,
    // HandleMenu and HandleEvent from a script: the value a dialog would ask
    // for (a file path, a colour "#rrggbb", a number), as text; and that the
    // command comes from a script, which no dialog may wait for.
    PCA_CommandValue = 0x30010003,
    PCA_FromScript = 0x10010004,
};

// Bits of PCA_EventFlags.
enum PreviewEventFlag : uint32
{
    PEF_StartGrab = 4, // a press that should remember where its drag began
};

// The flag word of AttachToInput: the overlay watches the Input it finds.
// Overlays pass it as both flag words.
constexpr uint32 ATTACH_Watch = 0x4000000;

// The host base of every viewer overlay: handles drawn over the image that
// edit a tool's Inputs. The viewer drives an overlay through
//   AddInput (each Input) -> SetAttrsTagList(Input, attrs) -> SetActive
//   -> DrawControls per pass / ControlDown, ControlMove..., ControlUp /
//      ControlCommand / NotifyChanged ... -> RemoveInput (each) -> DecRef.
// Overlays override the operations below and call the base of the same
// name where their own contract says (mostly last; ControlMove first).
//
// Coordinates are those of PreviewInfo: image coordinates 0..1 with Y up,
// and viewer units (logical pixels, Y up) for everything on screen.
//
// Undo: the first SetInputs of a gesture opens one undo step on the
// document; ControlUp (a drag) and CCMD_KeyUpAll (a run of nudges) close it
// through ResetUndo, so one gesture is one step.
class PreviewControl : public Object, public InputWatcher
{
public:
    // The viewer that shows the overlay redraws when asked through this.
    using RedrawHandler = std::function<void(PreviewControl *)>;
    // An action the overlay offers on the viewer's toolbar: a button with
    // its short label and its tip. The id "ToolbarSeparator" is a separator;
    // "ToolbarPopDown" is a button that drops down its `items`.
    struct ToolbarEvent
    {
        OrbID id;
        OrbString label;
        OrbString tip;
        std::vector<ToolbarEvent> items;
    };
    static const OrbID ToolbarSeparator;
    static const OrbID ToolbarPopDown;
    // Shows the user a message of the overlay's (the viewer shows it).
    using MessageHandler = std::function<void(PreviewControl *, const char *)>;
    // The size of ControlGetTip's buffer.
    static constexpr int32 TipSize = 256;
    // Coordinates that differ by no more than this are the same point: it
    // keeps drags and notifications from feeding back on each other.
    static constexpr float64 ChangeThreshold = 1e-5;

    PreviewControl(const Registry *reg, const ScriptVal &args, const TagList &tags);
    ~PreviewControl() override;

    std::size_t SizeOf() const override { return sizeof(PreviewControl); }
    // A script's SetAttrs: the attribute form for the main Input.
    bool SetAttrsTagList(const TagList &tags) override;

    // --- object operations the viewer routes to overlays ---
    // Entries of the viewer's context menu; each action's data() is an int
    // id that comes back through HandleMenu.
    virtual void AddToMenu(QMenu *menu, PreviewInfo *info, const TagList *tags);
    virtual bool HandleMenu(int32 id, PreviewInfo *info, const TagList *tags);
    // Actions for the viewer's toolbar while the overlay is shown.
    virtual void GetAvailableEvents(std::vector<ToolbarEvent> &events, const TagList *tags);
    virtual bool HandleEvent(const OrbID &event, PreviewInfo *info, const TagList *tags);

    // --- the preview-control operations, in their order ---
    // The viewer's view changed (zoom, pan, image).
    virtual void SetView(PreviewInfo *info, const TagList *tags);
    // The tool of the main Input, or null.
    virtual Operator *GetOperator(const TagList *tags) const;
    // The tool's attributes for `input` (or a script's): the base asks for a redraw.
    virtual bool SetAttrsTagList(Input *input, const TagList &tags);
    // Binds an Input (one reference, watched); the first is the main one.
    // False for null or one bound already.
    virtual bool AddInput(Input *input, const TagList *tags);
    virtual bool RemoveInput(Input *input, const TagList *tags);
    // Writes `value` to Input `index` at `time`, opening the gesture's undo
    // step at its first write. Refused (false) for a locked tool or a bad index.
    virtual bool SetInputs(Parameter *value, float64 time, uint32 index, const TagList *tags);
    // An Input's value at the current time changed; the base redraws.
    virtual void NotifyChanged(Input *input, Parameter *value, const TagList *tags);
    // Recompute what is drawn; the base redraws.
    virtual void UpdateDisplay(Input *input, const TagList *tags);
    virtual bool OnConnect(Input *input, const TagList *tags);
    // The Input is going: the base closes an open gesture; true where bound.
    virtual bool OnDisconnect(Input *input, const TagList *tags);
    // Switch the overlay on (non-zero) and off for the mouse.
    virtual void SetActive(int32 active, const TagList *tags);
    virtual void SetInactive(const TagList *tags);
    virtual void DrawControls(PreviewInfo *info, const TagList *tags);
    // `mouse` is in viewer units. Answers the drag type; the base returns
    // the overlay's current one.
    virtual DragType ControlDown(PreviewInfo *info, const OrbPointI &mouse, const TagList *tags);
    virtual void ControlMove(PreviewInfo *info, const OrbPointI &mouse, const TagList *tags);
    // The base ends the drag: the drag type goes to none, the undo step closes.
    virtual void ControlUp(PreviewInfo *info, const OrbPointI &mouse, const TagList *tags);
    // CCMD_ commands. The base answers CCMD_FollowCursor (data non-zero
    // starts a follow drag: drag type DRAG_Linked; 0 ends it) and CCMD_HitTest
    // (the flag word unchanged); everything else with 0.
    virtual uint64 ControlCommand(PreviewInfo *info, const OrbID &command, uint64 data, const TagList *tags);
    // Writes a tool tip of at most TipSize bytes; false where there is none.
    virtual bool ControlGetTip(PreviewInfo *info, char *buffer, const TagList *tags);
    // Closes the undo step this overlay opened, if any.
    virtual void ResetUndo(const TagList *tags);
    // Records that this overlay has opened an undo step on its document
    // itself (non-zero), so that ResetUndo closes it, or forgets it (0).
    virtual void SetUndo(uint32 open, const TagList *tags);
    // The overlay's class name.
    virtual void GetName(char *buffer, int32 size, const TagList *tags) const;
    // "Tool.Input (Class)" for `input`, or the main Input where null.
    virtual void GetFullName(char *buffer, int32 size, Input *input, const TagList *tags) const;
    // Where the overlay's handles are, in viewer units, for `info`'s view:
    // the viewer asks an overlay for its hover test (CCMD_HitTest) only when
    // the mouse is inside, or when it claimed the mouse or asked for a redraw
    // the last time. False (the base): the overlay wants every hover, as one
    // that fades with the mouse's distance does. An empty rectangle (x2 < x1)
    // is never under the mouse.
    virtual bool HoverBounds(const PreviewInfo &info, OrbRect &bounds) const;

    // What a user sees of the overlay's state, as named fields of the table
    // `state` (scripts read it through orbane.OverlayState). The base sets
    // `highlight` and `dragType`; each overlay class adds its own fields.
    virtual void GetState(ScriptVal &state) const;

    // --- what overlays use of the base ---
    // Finds the Input that `tags` names, by its address (a ScriptObject
    // pointer) under `ptrTag` or by its id under `idTag` among `tool`'s
    // Inputs, puts it in `slot` (one reference) and, with ATTACH_Watch in a
    // flag word, watches it; an Input held in `slot` before is let go. Tags
    // that name an Input that is not there empty the slot (false); tags that
    // name none leave it as it is. True where the slot holds an Input.
    bool AttachToInput(Input *&slot, Operator *tool, const TagList &tags, Tag ptrTag, Tag idTag, uint32 flags,
                       uint32 flags2);
    void DetachFromInput(Input *&slot);

    DragType IsDragging() const { return mDragType; }
    // Is the overlay drawn highlighted (under the mouse or dragged)?
    bool IsHighlighted() const { return mHighlighted; }
    bool IsActive() const { return mActive; }
    const std::vector<Input *> &Inputs() const { return mInputs; }
    Input *GetMainInput() const { return mInputs.empty() ? nullptr : mInputs.front(); }
    // The document of the main Input's tool; null while none is bound.
    OrbaneDoc *GetDoc() const;
    float64 GetCurrentTime() const;
    bool IsUndoOpen() const { return mUndoOpen; }
    float64 DisplayOffsetX() const { return mDisplayOffsetX; }
    float64 DisplayOffsetY() const { return mDisplayOffsetY; }
    void SetDisplayOffset(float64 x, float64 y);
    void SetRedrawHandler(RedrawHandler handler) { mRedraw = std::move(handler); }
    void SetMessageHandler(MessageHandler handler) { mTell = std::move(handler); }
    // Tells the user why a command did nothing or what it is missing: the
    // viewer shows it; without a viewer it goes to the log. The last one is
    // kept for scripts (OverlayState's `message`).
    void Tell(const char *message);
    const OrbString &LastMessage() const { return mLastMessage; }
    // Asks the viewer for a redraw.
    void Redraw();

    // Does `a` differ from `b` by more than ChangeThreshold?
    static bool Moved(float64 a, float64 b) noexcept;
    // Activates every overlay attached to `input` that is not active yet,
    // walking its watchers under the Input's read lock.
    static void ActivateOverlaysOf(Input *input);

    static bool RegCleanup(Registry *reg);
    static const OrbID ClassID;

protected:
    void OnInputChanged(Input *input, Parameter *value, const TagList *tags) final;
    int32 IndexOf(const Input *input) const;

    DragType mDragType = DRAG_None;
    // Set by overlays that highlight what the mouse is over.
    bool mHighlighted = false;
    float64 mDisplayOffsetX = 0.0;
    float64 mDisplayOffsetY = 0.0;

private:
    void OpenUndo();
    void Watch(Input *input);
    void Unwatch(Input *input);

    std::vector<Input *> mInputs;                  // one reference each
    std::vector<std::pair<Input *, int>> mWatched; // watched Inputs, with their number of uses
    bool mActive = false;
    bool mUndoOpen = false;
    QPointer<OrbaneDoc> mUndoDoc;
    RedrawHandler mRedraw;
    MessageHandler mTell;
    OrbString mLastMessage;
};

} // namespace Orbane
