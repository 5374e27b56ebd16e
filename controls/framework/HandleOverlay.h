#pragma once

#include "framework/HandleSet.h"

#include "orbane/AutoParam.h"
#include "orbane/Input.h"
#include "orbane/PreviewControl.h"

namespace Orbane {

namespace Graphics {
class GPainter;
} // namespace Graphics

// The base of overlays with handles. An overlay says where its handles are
// (BuildHandles) and draws its shape; this base answers the rest alike for
// all of them:
//   - CCMD_HitTest: claims the mouse (bit 0) when a handle is under it and
//     asks for a redraw (bit 1) only when the poised handle or the fade
//     changed;
//   - CCMD_GetInputAt: the main Input when a press would pick a handle;
//   - HoverBounds: where the viewer may find the handles, so that it asks
//     only the overlays near the mouse (none for an overlay that fades,
//     which must hear every move);
//   - the arrow-key nudges (NudgeCommand);
//   - the colours of a handle: the overlay's, the highlight while poised or
//     picked, faded with the mouse's distance where the overlay fades; the
//     painter draws each primitive as a shadow pass and then a colour pass.
// Sizes and tolerances are the viewer's logical pixels: the viewer's pick
// tolerance and handle scale, which a high-DPI screen does not change.
// `Base` is the host family the overlay belongs to: PreviewControl for
// overlays of a tool's Inputs, OverlayControl for the viewer slider.
template <class Base> class HandleOverlayOn : public Base
{
public:
    using Base::Base;
    ~HandleOverlayOn() override;

    std::size_t SizeOf() const override { return sizeof(HandleOverlayOn); }
    // Supplies the grab offset (PCA_GrabOffsetX, PCA_GrabOffsetY).
    bool CopyAttr(Tag tag, void *out) override;
    void ControlUp(PreviewInfo *info, const OrbPointI &mouse, const TagList *tags) override;
    uint64 ControlCommand(PreviewInfo *info, const OrbID &command, uint64 data, const TagList *tags) override;
    bool HoverBounds(const PreviewInfo &info, OrbRect &bounds) const override;
    // Adds `hover` (a handle is poised under the mouse) and `hoverPart` (its
    // part, 0 for none) and, for an overlay that fades, `fade` and
    // `drawnFade` (the opacity as last tested and as last drawn).
    void GetState(ScriptVal &state) const override;

    const HandleSet &Handles() const { return mHandles; }
    float32 Fade() const { return mFade; }
    float32 DrawnFade() const { return mDrawnFade; }
    // Opacity at `distance` viewer units from the mouse: full within 10,
    // half from 60 on.
    static float32 FadeAt(float64 distance) noexcept;

protected:
    // Puts the overlay's handles where its values are now, in `info`'s view.
    // Called before every test; an overlay that takes no clicks adds none.
    virtual void BuildHandles(const PreviewInfo &info, HandleSet &handles) const = 0;
    // The handle under the mouse for the hover test (hover reach). An
    // overlay that keeps something of every hover overrides and calls this.
    virtual HandleHit HoverHit(PreviewInfo &info);
    // How far the mouse is from what fades, in viewer units; only asked
    // after EnableFade.
    virtual float64 FadeDistance(const PreviewInfo &info) const;

    // The handle a press at the mouse would pick (press reach).
    HandleHit PressHit(const PreviewInfo &info);
    // Picks `hit` (or nothing) for the drag to come.
    void Pick(HandleHit hit);

    // The overlay fades with the mouse's distance (FadeDistance) while the
    // viewer does not highlight and the overlay is not dragged.
    void EnableFade();
    // Full opacity while the viewer highlights or the overlay is dragged.
    void SettleFade(const PreviewInfo &info);

    // Colours of a handle of `part`: highlighted while poised or picked,
    // faded by the overlay's fade.
    Graphics::GColor HandleFill(const PreviewInfo &info, uint32 part, int32 item = -1) const;
    Graphics::GColor HandleShadow(const PreviewInfo &info) const;
    // Sets the colours of `part`, then moves the painter to `at` (viewer
    // units) scaled by the handle scale, so that the handle is drawn in
    // handle pixels; EndHandle goes back.
    void BeginHandle(Graphics::GPainter &p, const PreviewInfo &info, OrbPoint at, uint32 part, int32 item = -1) const;
    static void EndHandle(Graphics::GPainter &p);
    // A square knob of half side `half` handle pixels at `at` in the
    // colours of `part`, with a cross through it where `cross` (a centre).
    void DrawSquareKnob(Graphics::GPainter &p, const PreviewInfo &info, OrbPoint at, uint32 part, float64 half,
                        bool cross) const;

    // The arrow-key commands every overlay with a draggable point answers
    // alike: NeedsKey claims the arrows; KeyDown moves `point` by one image
    // pixel (1 / ImageWidth across, `stepY` up) scaled by the modifiers and
    // writes it; KeyUpAll ends the nudges' undo step. True where `command`
    // was one of them, with the answer in `result`.
    bool NudgeCommand(PreviewInfo *info, const OrbID &command, uint64 data, const TagList *tags, OrbPoint point,
                      float64 stepY, uint64 &result);

    static bool IsArrowKey(uint64 key) noexcept;
    // The offset one arrow-key nudge makes: one step along the key's axis
    // (Up is +Y), ten with Shift, a tenth with Control.
    static OrbPoint NudgeOffset(uint64 key, float64 stepX, float64 stepY, Qt::KeyboardModifiers mods) noexcept;
    // The keyboard's modifiers now, as the application sees them.
    static Qt::KeyboardModifiers KeyModifiers();

    // One drag that writes several Inputs is one undo step under the
    // overlay's own `name`: opened at the first write of the drag (a second
    // call does nothing), closed at the release or when the overlay goes.
    void OpenGesture(const char *name);
    void CloseGesture();
    // Writes a value to Input `index` at the current time; nothing for a
    // value that is not a finite number or an index with no Input.
    bool WriteNumber(float64 value, uint32 index);
    bool WritePoint(OrbPoint value, uint32 index);

    // Overlays that edit several values take each from the Input whose
    // index `indexes[role]` gives: true where that Input is there (not the
    // main one) and no earlier role names it, for an Input holds one role.
    bool HoldsRole(const int32 *indexes, int32 role) const;

    // AddInput for an overlay that keeps copies of its Inputs' values: binds
    // `input` as the base does, then hands its value now to `store(index,
    // value, moved)`, so the Input shows from the moment it is bound.
    template <class Store> bool AddInputTaking(Input *input, const TagList *tags, Store store)
    {
        if (!Base::AddInput(input, tags))
            return false;
        const AutoParameter value(input->GetValue(this->GetCurrentTime()));
        bool moved = false;
        store(this->IndexOf(input), value.get(), moved);
        return true;
    }

    // Takes the grab offset a tool or script gives (PCA_GrabOffsetX/Y).
    void ReadGrabOffset(const TagList &tags);

    // Where the mouse held the handle at the press, in the overlay's own
    // units (viewer units for most; the rectangle's frame for it).
    OrbPoint mGrabOffset;
    // The overlay follows the cursor (PCA_FollowCursor) until the release
    // that ends the follow drag.
    int32 mFollowCursor = 0;
    // Where a press flagged PEF_StartGrab began its drag; cleared at release.
    OrbPoint mStartGrab;

private:
    // The base's highlight follows the handles: drawn highlighted while one
    // is poised or picked.
    void UpdateHighlight();
    uint64 HitTest(PreviewInfo &info, uint64 data);
    bool UpdateFade(const PreviewInfo &info);

    HandleSet mHandles;
    bool mGestureOpen = false;
    bool mFades = false;
    float32 mFade = 1.0f, mDrawnFade = 1.0f; // as last tested, as last drawn
};

using HandleOverlay = HandleOverlayOn<PreviewControl>;

} // namespace Orbane
