#pragma once

#include "framework/HandleOverlay.h"
#include "framework/LinkedInput.h"

namespace Orbane {

// The plain point handle: a small square over the image that the user drags
// or nudges to edit a Point Input. A previous-point Input (PCID_PrevPoint)
// joins it by a line to another point, so a chain of point Inputs draws as
// a path. Its one handle is a square of whole viewer pixels within the pick
// tolerance, highlighted while poised or picked.
class PointControl : public HandleOverlay
{
public:
    PointControl(const Registry *reg, const ScriptVal &args, const TagList &tags);
    ~PointControl() override;

    std::size_t SizeOf() const override { return sizeof(PointControl); }
    bool GetAttrsTagList(TagList &tags) const override;

    using PreviewControl::SetAttrsTagList;
    bool SetAttrsTagList(Input *input, const TagList &tags) override;
    bool RemoveInput(Input *input, const TagList *tags) override;
    void NotifyChanged(Input *input, Parameter *value, const TagList *tags) override;
    void SetActive(int32 active, const TagList *tags) override;
    void DrawControls(PreviewInfo *info, const TagList *tags) override;
    DragType ControlDown(PreviewInfo *info, const OrbPointI &mouse, const TagList *tags) override;
    void ControlMove(PreviewInfo *info, const OrbPointI &mouse, const TagList *tags) override;
    uint64 ControlCommand(PreviewInfo *info, const OrbID &command, uint64 data, const TagList *tags) override;

    OrbPoint Value() const { return mValue; }
    OrbPoint PrevValue() const { return mPrevValue; }
    OrbPoint DrawnPoint() const { return mDrawnPoint; }
    OrbPoint DrawnPrev() const { return mDrawnPrev; }
    OrbPoint GrabOffset() const { return mGrabOffset; }
    Input *PrevInput() const { return mPrevInput; }

    // Half the side of the handle's square, in handle pixels.
    static constexpr float64 HalfSize = 2.0;

protected:
    void BuildHandles(const PreviewInfo &info, HandleSet &handles) const override;

private:
    static const LinkedInput<PointControl> Links[];

    OrbPoint HandleOffset(const PreviewInfo &info) const;
    bool Store(OrbPoint &copy, const Parameter *value);

    OrbPoint mValue{0.5, 0.5};
    OrbPoint mDrawnPoint{0.5, 0.5};
    OrbPoint mPrevValue{0.5, 0.5};
    OrbPoint mDrawnPrev{0.5, 0.5};
    Input *mPrevInput = nullptr; // one reference, watched
};

} // namespace Orbane
