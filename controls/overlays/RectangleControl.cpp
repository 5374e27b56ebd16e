#include "overlays/RectangleControl.h"

#include "framework/OverlayValue.h"
#include "framework/RectangleTags.h"

#include "orbane/AutoParam.h"
#include "orbane/ControlCommands.h"
#include "orbane/GPainter.h"
#include "orbane/ImageParam.h"
#include "orbane/Input.h"
#include "orbane/Number.h"
#include "orbane/OrbaneDoc.h"
#include "orbane/Point.h"
#include "orbane/PreviewInfo.h"
#include "orbane/ScriptVal.h"

#include <algorithm>
#include <cmath>

namespace Orbane {

using Graphics::GColor;
using Graphics::GPainter;

namespace {

// Aspects and display scales closer than single precision are the same.
constexpr float64 kScaleEpsilon = 1.1920928955078125e-07;
// A size this small would blow a written width up: it counts as 1.
constexpr float64 kMinSize = 1e-5;
// Corner strips reach this fraction of the smaller half side along each edge.
constexpr float64 kCornerStrip = 0.25;

using OV = OverlayValue;

} // namespace

// The flips are linked by pointer only: a tool names them by id nowhere, and
// their id tags stay in the tag map as accepted no-ops.
const LinkedInput<RectangleControl> RectangleControl::Links[] = {
    {RCP_FlipX, 0, &RectangleControl::mFlipXInput},
    {RCP_FlipY, 0, &RectangleControl::mFlipYInput},
    {RCP_Center, RCID_Center, &RectangleControl::mCenterInput},
    {RCP_CenterX, RCID_CenterX, &RectangleControl::mCenterXInput},
    {RCP_CenterY, RCID_CenterY, &RectangleControl::mCenterYInput},
    {RCP_Axis, RCID_Axis, &RectangleControl::mAxisInput},
    {RCP_AxisX, RCID_AxisX, &RectangleControl::mAxisXInput},
    {RCP_AxisY, RCID_AxisY, &RectangleControl::mAxisYInput},
    {RCP_Angle, RCID_Angle, &RectangleControl::mAngleInput},
    {RCP_Size, RCID_Size, &RectangleControl::mSizeInput},
    {RCP_Image, RCID_Image, &RectangleControl::mImageInput},
};

RectangleControl::RectangleControl(const Registry *reg, const ScriptVal &args, const TagList &tags)
    : HandleOverlay(reg, args, tags)
{
    RectangleControl::SetAttrsTagList(nullptr, tags);
}

RectangleControl::~RectangleControl()
{
    DetachLinkedInputs(*this, Links);
}

bool RectangleControl::GetAttrsTagList(TagList &tags) const
{
    WriteLinkedInputIds(*this, Links, tags);
    tags.Set(RC_PenStyle, mPenStyle);
    tags.Set(RC_BlendMode, mBlendMode);
    tags.Set(RCD_BlendAmount, mBlendAmount);
    tags.Set(RCD_SetX, mCenter.x);
    tags.Set(RCD_SetY, mCenter.y);
    tags.Set(RCD_SetAngle, mAngle);
    tags.Set(RCD_SetSize, mSize);
    tags.Set(RCD_SetAxisX, mAxis.x);
    tags.Set(RCD_SetAxisY, mAxis.y);
    tags.Set(RCD_DisplayXScale, mDisplayXScale);
    tags.Set(RCD_DisplayYScale, mDisplayYScale);
    // The aspect's presence is what locks it.
    if (mLockAspect) {
        tags.Set(RC_DoLockAspect, true);
        tags.Set(RCD_LockAspect, mAspect);
    }
    return true;
}

void RectangleControl::GetState(ScriptVal &state) const
{
    HandleOverlay::GetState(state);
    state.SetKey(ScriptVal("dragPart"), ScriptVal(mDragPart));
    state.SetKey(ScriptVal("lastPart"), ScriptVal(mLastPart));
    state.SetKey(ScriptVal("grabOffsetX"), ScriptVal(mGrabOffset.x));
    state.SetKey(ScriptVal("grabOffsetY"), ScriptVal(mGrabOffset.y));
}

bool RectangleControl::SetAttrsTagList(Input *input, const TagList &tags)
{
    const Input *main = GetMainInput();
    const uint32 linked = AttachLinkedInputs(*this, Links, main ? main->GetOperator() : nullptr, tags);
    ReadPlacement(tags);
    bool display = ReadAspectLock(tags);
    for (auto [tag, scale] : {std::pair{RCD_DisplayXScale, &mDisplayXScale}, {RCD_DisplayYScale, &mDisplayYScale}}) {
        const float64 to = tags.GetDouble(tag, *scale);
        display = (std::isfinite(to) && std::fabs(to - *scale) > kScaleEpsilon) || display;
        if (std::isfinite(to))
            *scale = to;
    }
    const int32 mode = tags.GetInt(RC_BlendMode, mBlendMode);
    const bool modeChanged = mode != mBlendMode;
    mBlendMode = mode;
    mBlendAmount = tags.GetDouble(RCD_BlendAmount, mBlendAmount);
    // The amount is compared with itself, so a new amount alone is shown
    // only with the next change that refreshes the display. Kept so: tools
    // rely on setting the amount before the mode without a flash between.
    const bool amountChanged = std::fabs(mBlendAmount - mBlendAmount) > kScaleEpsilon;
    if (modeChanged || display || amountChanged) {
        mShownBlendAmount = mBlendAmount;
        UpdateDisplay(nullptr, nullptr);
    }
    PullLinkedInputs(*this, Links, linked);
    return HandleOverlay::SetAttrsTagList(input, tags);
}

// Centre, axis, angle and size come from tags only where no Input gives them.
void RectangleControl::ReadPlacement(const TagList &tags)
{
    auto read = [&tags](Tag tag, float64 &field) {
        const float64 to = tags.GetDouble(tag, field);
        if (std::isfinite(to))
            field = to;
    };
    if (!mCenterInput && !mCenterXInput)
        read(RCD_SetX, mCenter.x);
    if (!mCenterInput && !mCenterYInput)
        read(RCD_SetY, mCenter.y);
    if (!mAxisInput && !mAxisXInput)
        read(RCD_SetAxisX, mAxis.x);
    if (!mAxisInput && !mAxisYInput)
        read(RCD_SetAxisY, mAxis.y);
    mPenStyle = tags.GetInt(RC_PenStyle, mPenStyle);
    if (!mAngleInput)
        read(RCD_SetAngle, mAngle);
    if (!mSizeInput)
        read(RCD_SetSize, mSize);
}

// The lock is on while the tags carry an aspect. A new lock or aspect
// rescales the height copy, so the drawn shape keeps the new aspect until
// the Inputs say otherwise. True where the display changed.
bool RectangleControl::ReadAspectLock(const TagList &tags)
{
    const uint8 wasLocked = mLockAspect;
    const float64 oldAspect = mAspect;
    if (tags.FindQuery(RCD_LockAspect)) {
        mLockAspect = tags.GetBool(RC_DoLockAspect, true) ? 1 : 0;
        const float64 aspect = tags.GetDouble(RCD_LockAspect, mAspect);
        // An aspect of 0 or less, or no number, cannot be held: keep the old.
        if (std::isfinite(aspect) && aspect > 0.0)
            mAspect = aspect;
    } else {
        mLockAspect = 0;
    }
    if (mLockAspect == wasLocked && !(mLockAspect && std::fabs(mAspect - oldAspect) > kScaleEpsilon))
        return false;
    mHeight *= oldAspect / mAspect;
    return true;
}

bool RectangleControl::RemoveInput(Input *input, const TagList *tags)
{
    const LinkedInput<RectangleControl> *row = FindLinkedInput(*this, Links, input);
    if (row && row->slot == &RectangleControl::mImageInput)
        mImage = QImage();
    if (row)
        DetachFromInput(this->*(row->slot));
    return HandleOverlay::RemoveInput(input, tags) || row;
}

void RectangleControl::NotifyChanged(Input *input, Parameter *value, const TagList *tags)
{
    if (!value)
        return;
    bool moved = false;
    if (input && input == GetMainInput())
        moved = OV::TakeNumber(mWidth, value);
    else if (input && Inputs().size() > 1 && input == Inputs()[1])
        moved = OV::TakeNumber(mHeight, value);
    else if (FindLinkedInput(*this, Links, input))
        StoreLinked(input, value, moved);
    else
        moved = true;
    if (moved)
        HandleOverlay::NotifyChanged(input, value, tags);
}

// One Input may fill several slots (a point Input linked as centre and
// axis), so every slot is tested, in this order.
void RectangleControl::StoreLinked(Input *input, const Parameter *value, bool &moved)
{
    OrbPoint point;
    float64 n = 0.0;
    const bool isPoint = OV::ReadPoint(value, point), isNumber = OV::ReadNumber(value, n);
    if (input == mCenterInput && isPoint)
        moved = OV::Take(mCenter, point) || moved;
    if (input == mCenterXInput && isNumber)
        moved = OV::Take(mCenter.x, n) || moved;
    if (input == mCenterYInput && isNumber)
        moved = OV::Take(mCenter.y, n) || moved;
    if (input == mAngleInput && isNumber)
        moved = OV::Take(mAngle, n) || moved;
    if (input == mSizeInput && isNumber)
        moved = OV::Take(mSize, n) || moved;
    if (input == mAxisInput && isPoint)
        moved = OV::Take(mAxis, point) || moved;
    if (input == mAxisXInput && isNumber)
        moved = OV::Take(mAxis.x, n) || moved;
    if (input == mAxisYInput && isNumber)
        moved = OV::Take(mAxis.y, n) || moved;
    if (input == mFlipXInput && isNumber && mFlipX != (n != 0.0)) {
        mFlipX = n != 0.0;
        moved = true;
    }
    if (input == mFlipYInput && isNumber && mFlipY != (n != 0.0)) {
        mFlipY = n != 0.0;
        moved = true;
    }
    if (input == mImageInput) {
        const auto *image = dynamic_cast<const ImageParam *>(value);
        mImage = image ? image->Image : QImage();
        moved = true;
    }
}

RectangleShape RectangleControl::Shape() const
{
    RectangleShape s;
    s.center = mCenter;
    s.angle = mAngle;
    s.size = mSize;
    s.axis = mAxis;
    s.width = mWidth;
    s.height = mHeight;
    s.displayScale = OrbPoint(mDisplayXScale, mDisplayYScale);
    s.flipX = mFlipX;
    s.flipY = mFlipY;
    return s;
}

// The mouse meets the sides as they were last drawn, where the user saw
// them, placed where the Inputs put the rectangle now.
RectangleFrame RectangleControl::DrawnFrame(const PreviewInfo &info) const
{
    RectangleShape s = Shape();
    s.width = mDrawn.width;
    s.height = mDrawn.height;
    s.displayScale = mDrawn.displayScale;
    const ViewMapping &m = info.Mapping();
    return RectangleFrame(s, m.ImageWidth(), m.ImageHeight(), m.PixelAspect());
}

// A frame unit is one image pixel high (and as wide as high on screen), so
// the view scales it by the zoom on both axes.
OrbPoint RectangleControl::Tolerance(const PreviewInfo &info) const
{
    const ViewMapping &m = info.Mapping();
    const OrbPoint viewScale(m.SpanX() / (m.ImageWidth() * m.PixelAspect()), m.SpanY() / m.ImageHeight());
    return RectangleTolerance(info.PickTolerance, viewScale);
}

OrbPoint RectangleControl::MouseInFrame(const PreviewInfo &info, const RectangleFrame &frame) const
{
    return frame.ToFrame(OrbPoint(info.MouseX, info.MouseY)) - frame.Middle();
}

// Eight handles, one per part: the edges, and above them the corners, each
// the part of the outline (as last drawn) that its side bits name. The mouse
// meets them in the rectangle's frame, taken from the viewer's units by the
// frame's steps per viewer unit on each axis.
void RectangleControl::BuildHandles(const PreviewInfo &info, HandleSet &handles) const
{
    handles.Clear();
    AddOutline(info, DrawnFrame(info), handles);
}

void RectangleControl::AddOutline(const PreviewInfo &info, const RectangleFrame &frame, HandleSet &handles) const
{
    const ViewMapping &m = info.Mapping();
    const OrbPoint at = info.TransformOut(frame.ToImage(frame.Middle()));
    const OrbPoint origin = frame.ToFrame(mCenter);
    const OrbPoint stepX = frame.ToFrame(mCenter + OrbPoint(1.0 / m.SpanX(), 0.0)) - origin;
    const OrbPoint stepY = frame.ToFrame(mCenter + OrbPoint(0.0, 1.0 / m.SpanY())) - origin;
    if (!frame.IsValid() || !OV::Finite(at) || !OV::Finite(stepX) || !OV::Finite(stepY))
        return;
    Handle h;
    h.shape = HSH_Outline;
    h.at = at;
    h.frameX = OrbPoint(stepX.x, stepY.x);
    h.frameY = OrbPoint(stepX.y, stepY.y);
    h.half = frame.Half();
    h.reach = Tolerance(info);
    h.radius = RectangleCornerRadius(frame.Half(), mCornerRound);
    for (const int32 part : StripOrder) {
        h.sideX = int8(RectangleSideX(part));
        h.sideY = int8(RectangleSideY(part));
        h.part = uint32(part);
        h.priority = h.sideX && h.sideY ? HP_Corner : HP_Edge;
        handles.Add(h);
    }
}

// The viewer takes the bounds when a new value asks for a redraw, before
// the draw that puts the sides where the value says: they hold the outline
// as drawn and as it will be drawn.
bool RectangleControl::HoverBounds(const PreviewInfo &info, OrbRect &bounds) const
{
    HandleSet handles;
    BuildHandles(info, handles);
    const ViewMapping &m = info.Mapping();
    AddOutline(info, RectangleFrame(Shape(), m.ImageWidth(), m.ImageHeight(), m.PixelAspect()), handles);
    handles.Bounds(info.HandleScale, info.PickTolerance, bounds);
    return true;
}

bool RectangleControl::IsPlacingInput(const Input *input) const
{
    return input && (input == mCenterInput || input == mCenterXInput || input == mCenterYInput ||
                     input == mAngleInput || input == mAxisInput);
}

DragType RectangleControl::ControlDown(PreviewInfo *info, const OrbPointI &mouse, const TagList *tags)
{
    if (info->HotControl) {
        // Another overlay moves what places us: we follow as a linked drag.
        if (IsPlacingInput(info->HotControl->GetMainInput()))
            mDragType = DRAG_Linked;
        return HandleOverlay::ControlDown(info, mouse, tags);
    }
    const HandleHit hit = PressHit(*info);
    const int32 part = int32(hit.part);
    mDragWidth = RectangleSideX(part) != 0;
    mDragHeight = RectangleSideY(part) != 0;
    if (hit) {
        mDragType = DRAG_Handle;
        if (mLockAspect)
            mDragWidth = mDragHeight = 1;
    }
    const RectangleFrame frame = DrawnFrame(*info);
    mGrabOffset = RectangleGrabOffset(MouseInFrame(*info, frame), hit ? part : mLastPart, frame.Half(), mCornerRound);
    if (!OV::Finite(mGrabOffset))
        mGrabOffset = OrbPoint();
    if (mDragType == DRAG_Handle) {
        mDragPart = part;
        if (hit)
            mLastPart = part;
        Pick(hit);
    }
    return HandleOverlay::ControlDown(info, mouse, tags);
}

void RectangleControl::ControlMove(PreviewInfo *info, const OrbPointI &mouse, const TagList *tags)
{
    HandleOverlay::ControlMove(info, mouse, tags);
    if (mDragType != DRAG_Handle)
        return;
    const ViewMapping &m = info->Mapping();
    const RectangleFrame frame(Shape(), m.ImageWidth(), m.ImageHeight(), m.PixelAspect());
    const OrbPoint to = frame.ToFrame(OrbPoint(info->MouseX, info->MouseY)) + mGrabOffset;
    if (!frame.IsValid() || !OV::Finite(to))
        return;
    const OrbPoint mid = to - frame.Middle();
    OrbPoint sides(0.0, 0.0);
    const bool hasW = RectangleResizedSide(to.x, mid.x, mAxis.x, RectangleSideX(mDragPart), frame.Unit(), sides.x);
    const bool hasH = RectangleResizedSide(to.y, mid.y, mAxis.y, RectangleSideY(mDragPart), frame.Unit(), sides.y);
    if (!hasW && !hasH)
        return;
    if (!mLockAspect) {
        WriteSides(OrbPoint(hasW ? sides.x : std::nan(""), hasH ? sides.y : std::nan("")));
        return;
    }
    // Locked: the values as drawn go straight to both Inputs, in the base's
    // own undo step, not ours.
    const OrbPoint locked = RectangleLockedSize(hasW ? sides.x : 0.0, hasH ? sides.y : 0.0, mAspect);
    if (OV::Finite(locked) && (Moved(locked.x, mWidth) || Moved(locked.y, mHeight))) {
        WriteNumber(locked.x, 0);
        WriteNumber(locked.y, 1);
    }
}

// Unlocked: drawn lengths back to Input values (a size of 0 counts as 1),
// each written only where it is dragged and moved, in one undo group.
void RectangleControl::WriteSides(OrbPoint drawn)
{
    const float64 size = std::fabs(mSize) < kMinSize ? 1.0 : mSize;
    const float64 width = drawn.x / (size * mDisplayXScale), height = drawn.y / (size * mDisplayYScale);
    const bool w = mDragWidth && std::isfinite(width) && Moved(width, mWidth);
    const bool h = mDragHeight && std::isfinite(height) && Moved(height, mHeight);
    if (!w && !h)
        return;
    OpenGesture("Adjust Rectangle");
    if (w)
        WriteNumber(width, 0);
    if (h)
        WriteNumber(height, 1);
}

void RectangleControl::ControlUp(PreviewInfo *info, const OrbPointI &mouse, const TagList *tags)
{
    mDragWidth = 0;
    HandleOverlay::ControlUp(info, mouse, tags);
}

uint16 RectangleControl::StipplePattern(int32 penStyle) noexcept
{
    static constexpr uint16 patterns[] = {0, 0xf0f0, 0xcccc, 0xf060, 0xf0cc};
    return penStyle >= 0 && penStyle < int32(std::size(patterns)) ? patterns[penStyle] : 0;
}

void RectangleControl::ApplyPen(GPainter &p, int32 style, float64 width)
{
    p.LineWidth(float32(std::clamp(width, 0.0, 16.0)));
    if (style == 0)
        return;
    if (const uint16 pattern = StipplePattern(style))
        p.LineStipple(1, pattern);
    p.Enable(Graphics::GC_LineStipple);
}

void RectangleControl::DrawControls(PreviewInfo *info, const TagList *tags)
{
    mDrawn = Shape();
    GPainter *p = info->GetPainter();
    if (p && info->DrawPass != 3) {
        const RectangleFrame frame = DrawnFrame(*info);
        p->PushAttrib();
        p->Color(info->GetColor(OrbColor()), info->GetShadow(OrbColor()));
        // A style past the table stipples with whatever pattern is set.
        if (mPenStyle != 0) {
            if (const uint16 pattern = StipplePattern(mPenStyle))
                p->LineStipple(1, pattern);
            p->Enable(Graphics::GC_LineStipple);
        }
        const OrbPoint corner = info->TransformOut(frame.At(1.0, 1.0)) - info->TransformOut(frame.At(-1.0, -1.0));
        if (frame.IsValid() && OV::Finite(corner) && std::fabs(corner.x) + std::fabs(corner.y) < OV::FarAway &&
            info->TransformOut(frame.ToImage(frame.Middle())).Length() < OV::FarAway) {
            if (mImageInput && !mImage.isNull())
                DrawImage(*p, *info, frame);
            DrawOutline(*p, *info, frame);
        }
        p->PopAttrib();
    }
    HandleOverlay::DrawControls(info, tags);
}

// Eight strips, edges and corners in turn round the rectangle; then the
// part under the mouse (or being dragged) once more, highlighted.
void RectangleControl::DrawOutline(GPainter &p, const PreviewInfo &info, const RectangleFrame &frame) const
{
    for (int32 part : StripOrder)
        DrawStrip(p, info, frame, part);
    const int32 hot = mDragType == DRAG_Handle ? mDragPart : HoverPart();
    static constexpr int32 highlightOrder[8] = {3, 2, 6, 4, 12, 8, 9, 1};
    for (int32 part : highlightOrder)
        if (part == hot) {
            p.Color(HandleFill(info, uint32(part)), HandleShadow(info));
            p.LineWidth(2.0f);
            DrawStrip(p, info, frame, part);
        }
}

void RectangleControl::DrawStrip(GPainter &p, const PreviewInfo &info, const RectangleFrame &frame, int32 part) const
{
    const OrbPoint half(std::fabs(frame.Half().x), std::fabs(frame.Half().y));
    const float64 k = kCornerStrip * std::min(half.x, half.y);
    const float64 sx = RectangleSideX(part), sy = RectangleSideY(part);
    OrbPoint points[3];
    int32 count = 0;
    if (sx && sy) {
        points[count++] = OrbPoint(sx * half.x, sy * (half.y - k));
        points[count++] = OrbPoint(sx * half.x, sy * half.y);
        points[count++] = OrbPoint(sx * (half.x - k), sy * half.y);
    } else if (sx) {
        points[count++] = OrbPoint(sx * half.x, -(half.y - k));
        points[count++] = OrbPoint(sx * half.x, half.y - k);
    } else {
        points[count++] = OrbPoint(-(half.x - k), sy * half.y);
        points[count++] = OrbPoint(half.x - k, sy * half.y);
    }
    p.Begin(Graphics::GP_LineStrip);
    for (int32 i = 0; i < count; ++i) {
        const OrbPoint at = info.TransformOut(frame.ToImage(frame.Middle() + points[i]));
        p.Vertex(at.x, at.y);
    }
    p.End();
}

// The image fills the rectangle, turned and flipped with it. Mode 0 lays it
// over by its alpha, mode 1 multiplies, any other mode screens; a mode
// other than 0 at full amount draws it opaque.
void RectangleControl::DrawImage(GPainter &p, const PreviewInfo &info, const RectangleFrame &frame) const
{
    const float32 alpha = float32(info.OverlayColor.A() / 255.0 * mShownBlendAmount);
    if (mBlendMode != 0 && mShownBlendAmount >= 1.0) {
        p.Disable(Graphics::GC_Blend);
    } else {
        p.Enable(Graphics::GC_Blend);
        if (mBlendMode == 0)
            p.BlendFunc(Graphics::GBF_SrcAlpha, Graphics::GBF_OneMinusSrcAlpha);
        else if (mBlendMode == 1)
            p.BlendFunc(Graphics::GBF_DstColor, Graphics::GBF_OneMinusSrcColor);
        else
            p.BlendFunc(Graphics::GBF_One, Graphics::GBF_OneMinusSrcColor);
    }
    const float32 grey = mBlendMode == 1 ? 1.0f : alpha;
    float64 corners[8];
    const OrbPoint at[4] = {frame.At(-1, -1), frame.At(1, -1), frame.At(1, 1), frame.At(-1, 1)};
    for (int i = 0; i < 4; ++i) {
        const OrbPoint v = info.TransformOut(at[i]);
        corners[2 * i] = v.x;
        corners[2 * i + 1] = v.y;
    }
    p.Texture(mImage, corners, GColor(grey, grey, grey, alpha));
    // The outline after it blends as usual.
    p.Enable(Graphics::GC_Blend);
    p.BlendFunc(Graphics::GBF_SrcAlpha, Graphics::GBF_OneMinusSrcAlpha);
}

} // namespace Orbane
