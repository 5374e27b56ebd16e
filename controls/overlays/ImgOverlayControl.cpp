#include "overlays/ImgOverlayControl.h"

#include "framework/ImgOverlayTags.h"
#include "framework/OverlayValue.h"
#include "overlays/RectangleControl.h"

#include "orbane/AutoParam.h"
#include "orbane/GPainter.h"
#include "orbane/ImageParam.h"
#include "orbane/Input.h"
#include "orbane/PreviewInfo.h"
#include "orbane/ScriptVal.h"

#include <algorithm>
#include <cmath>

namespace Orbane {

using Graphics::GColor;
using Graphics::GPainter;
using OV = OverlayValue;

namespace {

constexpr Tag kCropTags[4] = {IOD_CropLeft, IOD_CropBottom, IOD_CropRight, IOD_CropTop};

} // namespace

const LinkedInput<ImgOverlayControl> ImgOverlayControl::Links[] = {
    {IOP_Image, IOID_Image, &ImgOverlayControl::mImageInput},
    {IOP_Opacity, IOID_Opacity, &ImgOverlayControl::mOpacityInput},
    {IOP_Visible, IOID_Visible, &ImgOverlayControl::mVisibleInput},
};

ImgOverlayControl::ImgOverlayControl(const Registry *reg, const ScriptVal &args, const TagList &tags)
    : TransformControl(reg, args, tags)
{
    ImgOverlayControl::SetAttrsTagList(nullptr, tags);
}

ImgOverlayControl::~ImgOverlayControl()
{
    DetachLinkedInputs(*this, Links);
}

bool ImgOverlayControl::GetAttrsTagList(TagList &tags) const
{
    TransformControl::GetAttrsTagList(tags);
    WriteLinkedInputIds(*this, Links, tags);
    tags.Set(IO_BlendMode, mBlendMode);
    tags.Set(IO_FitImage, mFitImage);
    tags.Set(IO_FlipX, mFlipX);
    tags.Set(IO_FlipY, mFlipY);
    tags.Set(IO_ShowHandles, mShowHandles);
    tags.Set(IO_BorderStyle, mBorderStyle);
    tags.Set(IO_BorderColor, int32(mFrameColor.Packed()));
    tags.Set(IO_HideWhileDragging, mHideWhileDragging);
    tags.Set(IOD_Opacity, mOpacity);
    tags.Set(IOD_Gain, mGain);
    for (int i = 0; i < 4; ++i)
        tags.Set(kCropTags[i], mCrop[i]);
    tags.Set(IOD_BorderWidth, mBorderWidth);
    tags.Set(IOS_Label, mLabel.c_str());
    return true;
}

void ImgOverlayControl::GetState(ScriptVal &state) const
{
    TransformControl::GetState(state);
    state.SetKey(ScriptVal("opacity"), ScriptVal(mOpacity));
    state.SetKey(ScriptVal("visible"), ScriptVal(ShowsImage()));
    state.SetKey(ScriptVal("imageWidth"), ScriptVal(int64(mImage.width())));
    state.SetKey(ScriptVal("imageHeight"), ScriptVal(int64(mImage.height())));
}

bool ImgOverlayControl::SetAttrsTagList(Input *input, const TagList &tags)
{
    const uint32 linked = AttachLinkedInputs(*this, Links, GetOperator(nullptr), tags);
    ReadLook(tags);
    PullLinkedInputs(*this, Links, linked);
    return TransformControl::SetAttrsTagList(input, tags);
}

void ImgOverlayControl::ReadLook(const TagList &tags)
{
    mBlendMode = tags.GetInt(IO_BlendMode, mBlendMode);
    mFitImage = tags.GetBool(IO_FitImage, mFitImage);
    mFlipX = tags.GetBool(IO_FlipX, mFlipX);
    mFlipY = tags.GetBool(IO_FlipY, mFlipY);
    mShowHandles = tags.GetBool(IO_ShowHandles, mShowHandles);
    mBorderStyle = tags.GetInt(IO_BorderStyle, mBorderStyle);
    mFrameColor = OrbColor(uint32(tags.GetLong(IO_BorderColor, int64(mFrameColor.Packed()))));
    mHideWhileDragging = tags.GetBool(IO_HideWhileDragging, mHideWhileDragging);
    auto read = [&tags](Tag tag, float64 &field) {
        const float64 to = tags.GetDouble(tag, field);
        if (std::isfinite(to))
            field = to;
    };
    if (!mOpacityInput)
        read(IOD_Opacity, mOpacity);
    read(IOD_Gain, mGain);
    for (int i = 0; i < 4; ++i)
        read(kCropTags[i], mCrop[i]);
    read(IOD_BorderWidth, mBorderWidth);
    if (const char *label = tags.GetString(IOS_Label))
        mLabel = label;
}

bool ImgOverlayControl::RemoveInput(Input *input, const TagList *tags)
{
    if (input && input == mImageInput)
        mImage = QImage();
    const bool linked = DetachLinkedInput(*this, Links, input);
    return TransformControl::RemoveInput(input, tags) || linked;
}

void ImgOverlayControl::NotifyChanged(Input *input, Parameter *value, const TagList *tags)
{
    if (!value || !FindLinkedInput(*this, Links, input))
        return TransformControl::NotifyChanged(input, value, tags);
    bool moved = false;
    if (input == mImageInput) {
        const auto *image = dynamic_cast<const ImageParam *>(value);
        mImage = image ? image->Image : QImage();
        moved = true;
    }
    if (input == mOpacityInput)
        moved = OV::TakeNumber(mOpacity, value) || moved;
    if (input == mVisibleInput)
        moved = OV::TakeFlag(mVisible, value) || moved;
    if (moved)
        HandleOverlay::NotifyChanged(input, value, tags);
}

// Without handles the image is only shown: nothing to grab.
void ImgOverlayControl::BuildHandles(const PreviewInfo &info, HandleSet &handles) const
{
    if (mShowHandles)
        TransformControl::BuildHandles(info, handles);
    else
        handles.Clear();
}

// A fitted frame is as high as the image's shape makes it for its width.
TransformFrame ImgOverlayControl::FrameIn(const PreviewInfo &info, const TransformShape &shape) const
{
    const TransformFrame frame = TransformControl::FrameIn(info, shape);
    if (!mFitImage || mImage.isNull())
        return frame;
    TransformShape s = frame.Shape();
    s.frame.y = s.frame.x * mImage.height() / mImage.width();
    return TransformFrame(s, info.AspectScaleYOut(1.0));
}

bool ImgOverlayControl::ShowsImage() const
{
    return mVisible && !mImage.isNull() && !(mHideWhileDragging && mDragType == DRAG_Handle);
}

void ImgOverlayControl::DrawTransform(GPainter &p, const PreviewInfo &info) const
{
    const TransformFrame frame = FrameIn(info, Shape());
    if (frame.IsValid() && ShowsImage())
        DrawImage(p, info, frame);
    if (mShowHandles)
        TransformControl::DrawTransform(p, info);
    if (!mLabel.empty() && frame.IsValid()) {
        const OrbPoint corner = info.TransformOut(frame.ToImage(OrbPoint(0.0, 1.0)));
        if (OV::OnScreen(corner)) {
            p.Color(info.GetColor(mFrameColor), info.GetShadow(mFrameColor));
            p.Text(corner.x + 4, corner.y + 4, mLabel.c_str());
        }
    }
}

void ImgOverlayControl::DrawFrame(GPainter &p, const PreviewInfo &info, const TransformFrame &frame) const
{
    p.PushAttrib();
    p.LineWidth(float32(std::clamp(mBorderWidth, 0.0, 16.0)));
    if (mBorderStyle != 0) {
        if (const uint16 pattern = RectangleControl::StipplePattern(mBorderStyle))
            p.LineStipple(1, pattern);
        p.Enable(Graphics::GC_LineStipple);
    }
    TransformControl::DrawFrame(p, info, frame);
    p.PopAttrib();
}

// The image's part that the crop leaves, on the same part of the frame,
// mirrored by the flips; blended as the rectangle blends its image.
void ImgOverlayControl::DrawImage(GPainter &p, const PreviewInfo &info, const TransformFrame &frame) const
{
    const float64 l = std::clamp(mCrop[0], 0.0, 1.0), b = std::clamp(mCrop[1], 0.0, 1.0);
    const float64 r = std::clamp(1.0 - mCrop[2], l, 1.0), t = std::clamp(1.0 - mCrop[3], b, 1.0);
    const QRect part(int(std::lround(l * mImage.width())), int(std::lround((1.0 - t) * mImage.height())),
                     int(std::lround((r - l) * mImage.width())), int(std::lround((t - b) * mImage.height())));
    if (part.isEmpty())
        return;
    const QImage shown = mImage.copy(part).mirrored(mFlipX, mFlipY);
    const OrbPoint at[4] = {{l, b}, {r, b}, {r, t}, {l, t}};
    float64 corners[8];
    for (int i = 0; i < 4; ++i) {
        const OrbPoint v = info.TransformOut(frame.ToImage(at[i]));
        if (!OV::OnScreen(v))
            return;
        corners[2 * i] = v.x;
        corners[2 * i + 1] = v.y;
    }
    const float32 alpha = float32(std::clamp(mOpacity, 0.0, 1.0)), gain = float32(std::max(mGain, 0.0));
    p.PushAttrib();
    p.Enable(Graphics::GC_Blend);
    if (mBlendMode == 1)
        p.BlendFunc(Graphics::GBF_DstColor, Graphics::GBF_OneMinusSrcColor);
    else if (mBlendMode == 2)
        p.BlendFunc(Graphics::GBF_One, Graphics::GBF_OneMinusSrcColor);
    else
        p.BlendFunc(Graphics::GBF_SrcAlpha, Graphics::GBF_OneMinusSrcAlpha);
    p.Texture(shown, corners, GColor(gain, gain, gain, alpha));
    p.PopAttrib();
}

} // namespace Orbane
