#pragma once

#include "framework/LinkedInput.h"
#include "overlays/TransformControl.h"

#include <QImage>

#include <string>

namespace Orbane {

// An image laid over the viewer in a transform's frame: the transform's
// handles move, turn, scale and shear it (the same Inputs and tags), and
// the image is drawn inside at an opacity and blend of its own, cropped,
// flipped and labelled as its tags say. The image, its opacity and a
// switch that hides it come from Inputs the overlay only reads.
class ImgOverlayControl : public TransformControl
{
public:
    ImgOverlayControl(const Registry *reg, const ScriptVal &args, const TagList &tags);
    ~ImgOverlayControl() override;

    std::size_t SizeOf() const override { return sizeof(ImgOverlayControl); }
    bool GetAttrsTagList(TagList &tags) const override;
    // Adds `opacity`, `visible` and the image's `imageWidth`, `imageHeight`
    // (0 for none).
    void GetState(ScriptVal &state) const override;

    using PreviewControl::SetAttrsTagList;
    bool SetAttrsTagList(Input *input, const TagList &tags) override;
    bool RemoveInput(Input *input, const TagList *tags) override;
    void NotifyChanged(Input *input, Parameter *value, const TagList *tags) override;

protected:
    void BuildHandles(const PreviewInfo &info, HandleSet &handles) const override;
    TransformFrame FrameIn(const PreviewInfo &info, const TransformShape &shape) const override;
    void DrawTransform(Graphics::GPainter &p, const PreviewInfo &info) const override;
    void DrawFrame(Graphics::GPainter &p, const PreviewInfo &info, const TransformFrame &frame) const override;

private:
    static const LinkedInput<ImgOverlayControl> Links[];

    void ReadLook(const TagList &tags);
    void DrawImage(Graphics::GPainter &p, const PreviewInfo &info, const TransformFrame &frame) const;
    bool ShowsImage() const;

    Input *mImageInput = nullptr, *mOpacityInput = nullptr, *mVisibleInput = nullptr;
    QImage mImage;
    float64 mOpacity = 1.0;
    bool mVisible = true;
    int32 mBlendMode = 0;
    bool mFitImage = false;
    bool mFlipX = false, mFlipY = false;
    bool mShowHandles = true;
    int32 mBorderStyle = 0;
    bool mHideWhileDragging = false;
    float64 mGain = 1.0;
    float64 mCrop[4] = {0.0, 0.0, 0.0, 0.0}; // left, bottom, right, top
    float64 mBorderWidth = 1.0;
    std::string mLabel;
};

} // namespace Orbane
