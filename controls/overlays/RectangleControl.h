#pragma once

#include "framework/HandleOverlay.h"
#include "framework/LinkedInput.h"
#include "overlays/RectangleGeometry.h"

#include <QImage>

namespace Orbane {

namespace Graphics {
class GPainter;
} // namespace Graphics

// A rotatable rectangle over the image, resized by its four edges and four
// corners. It edits two Number Inputs, the width (index 0) and the height
// (index 1), and only reads the Inputs that place it: centre (one point or
// two numbers), angle, size multiplier, pivot axis (likewise), flips, and an
// image shown inside it. Its handles are the eight parts of its outline,
// in its own turned frame.
class RectangleControl : public HandleOverlay
{
public:
    RectangleControl(const Registry *reg, const ScriptVal &args, const TagList &tags);
    ~RectangleControl() override;

    std::size_t SizeOf() const override { return sizeof(RectangleControl); }
    bool GetAttrsTagList(TagList &tags) const override;
    void GetState(ScriptVal &state) const override;

    using PreviewControl::SetAttrsTagList;
    bool SetAttrsTagList(Input *input, const TagList &tags) override;
    bool RemoveInput(Input *input, const TagList *tags) override;
    void NotifyChanged(Input *input, Parameter *value, const TagList *tags) override;
    void DrawControls(PreviewInfo *info, const TagList *tags) override;
    DragType ControlDown(PreviewInfo *info, const OrbPointI &mouse, const TagList *tags) override;
    void ControlMove(PreviewInfo *info, const OrbPointI &mouse, const TagList *tags) override;
    void ControlUp(PreviewInfo *info, const OrbPointI &mouse, const TagList *tags) override;
    bool HoverBounds(const PreviewInfo &info, OrbRect &bounds) const override;

    // The shape as the Inputs and tags give it now.
    RectangleShape Shape() const;
    float64 Width() const { return mWidth; }
    float64 Height() const { return mHeight; }
    bool LocksAspect() const { return mLockAspect != 0; }
    float64 Aspect() const { return mAspect; }
    int32 PenStyle() const { return mPenStyle; }
    int32 HoverPart() const { return int32(Handles().PoisedHit().part); }
    int32 DragPart() const { return mDragPart; }
    int32 LastPart() const { return mLastPart; }
    OrbPoint GrabOffset() const { return mGrabOffset; }
    // The blend amount the image inside is drawn with: taken when the
    // display is refreshed, which a change of the amount alone does not do.
    float64 ShownBlendAmount() const { return mShownBlendAmount; }
    void SetCornerRound(float64 round) { mCornerRound = round; }

    // The stipple pattern of a pen style (0: solid, no pattern).
    static uint16 StipplePattern(int32 penStyle) noexcept;
    // Sets the painter's line width (clamped to 0..16 viewer pixels) and, for
    // a style other than 0, its stipple: the pen of every outline overlay.
    static void ApplyPen(Graphics::GPainter &p, int32 style, float64 width);
    // Outline strips in drawing order, one per part code.
    static constexpr int32 StripOrder[8] = {1, 3, 2, 6, 4, 12, 8, 9};

protected:
    void BuildHandles(const PreviewInfo &info, HandleSet &handles) const override;

private:
    static const LinkedInput<RectangleControl> Links[];

    RectangleFrame DrawnFrame(const PreviewInfo &info) const;
    OrbPoint Tolerance(const PreviewInfo &info) const;
    void AddOutline(const PreviewInfo &info, const RectangleFrame &frame, HandleSet &handles) const;
    OrbPoint MouseInFrame(const PreviewInfo &info, const RectangleFrame &frame) const;
    bool IsPlacingInput(const Input *input) const;
    void ReadPlacement(const TagList &tags);
    bool ReadAspectLock(const TagList &tags);
    void StoreLinked(Input *input, const Parameter *value, bool &moved);
    void WriteSides(OrbPoint sides);
    void DrawOutline(Graphics::GPainter &p, const PreviewInfo &info, const RectangleFrame &frame) const;
    void DrawStrip(Graphics::GPainter &p, const PreviewInfo &info, const RectangleFrame &frame, int32 part) const;
    void DrawImage(Graphics::GPainter &p, const PreviewInfo &info, const RectangleFrame &frame) const;

    Input *mCenterInput = nullptr, *mCenterXInput = nullptr, *mCenterYInput = nullptr;
    Input *mAngleInput = nullptr;
    Input *mSizeInput = nullptr;
    Input *mAxisInput = nullptr, *mAxisXInput = nullptr, *mAxisYInput = nullptr;
    Input *mFlipXInput = nullptr, *mFlipYInput = nullptr;
    Input *mImageInput = nullptr;

    OrbPoint mCenter{0.5, 0.5};
    float64 mAngle = 0.0;
    float64 mSize = 1.0;
    OrbPoint mAxis{0.5, 0.5};
    float64 mWidth = 0.0, mHeight = 0.0;
    bool mFlipX = false, mFlipY = false;
    uint8 mLockAspect = 0;
    float64 mAspect = 1.0;
    float64 mDisplayXScale = 1.0, mDisplayYScale = 1.0;
    int32 mPenStyle = 0;
    int32 mBlendMode = 0;
    float64 mBlendAmount = 1.0;
    float64 mShownBlendAmount = 1.0;
    uint8 mDragWidth = 0, mDragHeight = 0;
    int32 mDragPart = 1, mLastPart = 9;
    float64 mCornerRound = 0.0;
    QImage mImage;         // the image Input's pixels, shown inside
    RectangleShape mDrawn; // the shape as last drawn, which the mouse meets
};

} // namespace Orbane
