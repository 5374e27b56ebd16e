#include "overlays/CropControl.h"

#include "framework/OverlayValue.h"

#include "orbane/AutoParam.h"
#include "orbane/GPainter.h"
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

// The knobs' half side in handle pixels; the shade's darkness.
constexpr float64 kKnob = 4.0;
constexpr float32 kShade = 0.55f;
constexpr int32 kParts[8] = {1, 2, 4, 8, 3, 6, 12, 9};

OrbPointI SideOf(uint32 part) noexcept
{
    return {(part & 1) ? 1 : (part & 4) ? -1 : 0, (part & 2) ? 1 : (part & 8) ? -1 : 0};
}

// Image units to image pixels, axis by axis.
OrbPoint InPixels(OrbPoint v, OrbPoint pixels) noexcept
{
    return {v.x * pixels.x, v.y * pixels.y};
}

// One axis of a locked box: `length` about the middle of `lo`..`hi`.
void Around(float64 &lo, float64 &hi, float64 length) noexcept
{
    const float64 mid = (lo + hi) / 2.0;
    lo = mid - length / 2.0;
    hi = mid + length / 2.0;
}

} // namespace

CropControl::CropControl(const Registry *reg, const ScriptVal &args, const TagList &tags)
    : HandleOverlay(reg, args, tags)
{
}

void CropControl::GetState(ScriptVal &state) const
{
    HandleOverlay::GetState(state);
    const std::pair<const char *, float64> fields[] = {
        {"left", Low().x}, {"bottom", Low().y},          {"right", High().x},
        {"top", High().y}, {"locked", float64(mLocked)}, {"dragPart", float64(mDragPart)}};
    for (const auto &[key, value] : fields)
        state.SetKey(ScriptVal(key), ScriptVal(value));
}

OrbPoint CropControl::Low() const
{
    return {std::min(mCorner.x, mCorner.x + mSize.x), std::min(mCorner.y, mCorner.y + mSize.y)};
}

OrbPoint CropControl::High() const
{
    return {std::max(mCorner.x, mCorner.x + mSize.x), std::max(mCorner.y, mCorner.y + mSize.y)};
}

// The crop's Inputs show their values from the moment they are bound.
bool CropControl::AddInput(Input *input, const TagList *tags)
{
    return AddInputTaking(input, tags,
                          [this](int32 index, const Parameter *value, bool &moved) { Store(index, value, moved); });
}

void CropControl::Store(int32 index, const Parameter *value, bool &moved)
{
    float64 lock = 0.0;
    if (index == 0)
        moved = OV::TakePoint(mCorner, value);
    else if (index == 1)
        moved = OV::TakePoint(mSize, value);
    else if (index == 2 && OV::ReadNumber(value, lock))
        mLocked = lock != 0.0;
}

void CropControl::NotifyChanged(Input *input, Parameter *value, const TagList *tags)
{
    if (!value)
        return;
    bool moved = IndexOf(input) < 0 || IndexOf(input) > 1;
    Store(IndexOf(input), value, moved);
    if (moved)
        HandleOverlay::NotifyChanged(input, value, tags);
}

// The edges and corners of the box as drawn, and its inside below them.
void CropControl::BuildHandles(const PreviewInfo &info, HandleSet &handles) const
{
    handles.Clear();
    const OrbPoint lo = info.TransformOut(Low()), hi = info.TransformOut(High());
    if (!OV::OnScreen(lo) || !OV::OnScreen(hi))
        return;
    const OrbPoint at = (lo + hi) / 2.0, half = (hi - lo) / 2.0;
    const float64 t = info.PickTolerance;
    for (const int32 part : kParts) {
        const OrbPointI side = SideOf(uint32(part));
        handles.AddBoxPart(at, {1.0, 0.0}, half, t, side, uint32(part), side.x && side.y ? HP_Corner : HP_Edge);
    }
    handles.AddBoxPart(at, {1.0, 0.0}, half, 0.0, {0, 0}, CropInside, HP_Body);
}

DragType CropControl::ControlDown(PreviewInfo *info, const OrbPointI &mouse, const TagList *tags)
{
    if (!info->HotControl)
        if (const HandleHit hit = PressHit(*info)) {
            mDragType = DRAG_Handle;
            mDragPart = hit.part;
            mPressMouse = OrbPoint(info->MouseX, info->MouseY);
            mPressLow = Low();
            mPressHigh = High();
            Pick(hit);
        }
    return HandleOverlay::ControlDown(info, mouse, tags);
}

void CropControl::Dragged(uint32 part, OrbPoint delta, float64 lockRatio, OrbPoint pixels, OrbPoint &low,
                          OrbPoint &high) noexcept
{
    if (part == CropInside) {
        low = low + delta;
        high = high + delta;
        return;
    }
    const OrbPointI side = SideOf(part);
    const OrbPoint was = InPixels(high - low, pixels); // in image pixels
    float64 &x = side.x > 0 ? high.x : low.x;
    float64 &y = side.y > 0 ? high.y : low.y;
    x += side.x ? delta.x : 0.0;
    y += side.y ? delta.y : 0.0;
    if (lockRatio <= 0.0 || !std::isfinite(lockRatio) || was.x == 0.0 || was.y == 0.0)
        return;
    const OrbPoint now = InPixels(high - low, pixels);
    if (side.x && side.y) {
        // The corner follows the axis that grew the more; the opposite
        // corner stays.
        const float64 k = std::max(std::fabs(now.x / was.x), std::fabs(now.y / was.y));
        x = (side.x > 0 ? low.x : high.x) + side.x * k * std::fabs(was.x) / pixels.x;
        y = (side.y > 0 ? low.y : high.y) + side.y * k * std::fabs(was.y) / pixels.y;
    } else if (side.x) {
        Around(low.y, high.y, now.x / lockRatio / pixels.y);
    } else {
        Around(low.x, high.x, now.y * lockRatio / pixels.x);
    }
}

// Each move starts again from the box as it was at the press, so the box
// follows the mouse exactly however many moves there were.
void CropControl::ControlMove(PreviewInfo *info, const OrbPointI &mouse, const TagList *tags)
{
    HandleOverlay::ControlMove(info, mouse, tags);
    if (mDragType != DRAG_Handle)
        return;
    const OrbPoint pixels(info->ImageWidth, info->ImageHeight);
    const OrbPoint was = InPixels(mPressHigh - mPressLow, pixels);
    const bool lock = mLocked || (KeyModifiers() & Qt::ShiftModifier);
    OrbPoint lo = mPressLow, hi = mPressHigh;
    Dragged(mDragPart, OrbPoint(info->MouseX, info->MouseY) - mPressMouse, lock ? was.x / was.y : 0.0, pixels, lo, hi);
    const OrbPoint corner(std::min(lo.x, hi.x), std::min(lo.y, hi.y));
    const OrbPoint size(std::fabs(hi.x - lo.x), std::fabs(hi.y - lo.y));
    if (!OV::Finite(corner) || !OV::Finite(size))
        return;
    const bool c = Moved(corner.x, mCorner.x) || Moved(corner.y, mCorner.y);
    const bool s = Moved(size.x, mSize.x) || Moved(size.y, mSize.y);
    if (!c && !s)
        return;
    OpenGesture("Adjust Crop");
    if (c)
        WritePoint(corner, 0);
    if (s)
        WritePoint(size, 1);
}

uint64 CropControl::ControlCommand(PreviewInfo *info, const OrbID &command, uint64 data, const TagList *tags)
{
    uint64 result = 0;
    if (NudgeCommand(info, command, data, tags, mCorner, 1.0 / info->ImageHeight, result))
        return result;
    return HandleOverlay::ControlCommand(info, command, data, tags);
}

void CropControl::DrawControls(PreviewInfo *info, const TagList *tags)
{
    GPainter *p = info->GetPainter();
    const OrbPoint lo = info->TransformOut(Low()), hi = info->TransformOut(High());
    if (p && info->DrawPass != 3 && OV::OnScreen(lo) && OV::OnScreen(hi)) {
        p->PushAttrib();
        DrawShade(*p, *info, lo, hi);
        DrawBox(*p, *info, lo, hi);
        p->PopAttrib();
    }
    HandleOverlay::DrawControls(info, tags);
}

// The image outside the box, darkened: four bands, each clipped to the image.
void CropControl::DrawShade(GPainter &p, const PreviewInfo &info, OrbPoint lo, OrbPoint hi) const
{
    const OrbPoint i0 = info.TransformOut(OrbPoint(0.0, 0.0)), i1 = info.TransformOut(OrbPoint(1.0, 1.0));
    const float64 x0 = std::clamp(lo.x, i0.x, i1.x), x1 = std::clamp(hi.x, i0.x, i1.x);
    const float64 y0 = std::clamp(lo.y, i0.y, i1.y), y1 = std::clamp(hi.y, i0.y, i1.y);
    p.Enable(Graphics::GC_Blend);
    p.BlendFunc(Graphics::GBF_SrcAlpha, Graphics::GBF_OneMinusSrcAlpha);
    p.Color(GColor(0.0f, 0.0f, 0.0f, kShade), GColor(0.0f, 0.0f, 0.0f, 0.0f));
    p.Rectangle(i0.x, i0.y, x0, i1.y);
    p.Rectangle(x1, i0.y, i1.x, i1.y);
    p.Rectangle(x0, i0.y, x1, y0);
    p.Rectangle(x0, y1, x1, i1.y);
}

// The outline, the edge or corner under the mouse drawn again highlighted,
// and a knob on every corner and every edge's middle.
void CropControl::DrawBox(GPainter &p, const PreviewInfo &info, OrbPoint lo, OrbPoint hi) const
{
    p.Color(info.GetColor(OrbColor()), info.GetShadow(OrbColor()));
    p.Begin(Graphics::GP_LineLoop);
    p.Vertex(lo.x, lo.y);
    p.Vertex(hi.x, lo.y);
    p.Vertex(hi.x, hi.y);
    p.Vertex(lo.x, hi.y);
    p.End();
    const OrbPoint mid = (lo + hi) / 2.0, half = (hi - lo) / 2.0;
    for (const int32 part : kParts) {
        const OrbPointI side = SideOf(uint32(part));
        BeginHandle(p, info, OrbPoint(mid.x + side.x * half.x, mid.y + side.y * half.y), uint32(part));
        p.Rectangle(-kKnob, -kKnob, kKnob, kKnob);
        EndHandle(p);
    }
}

} // namespace Orbane
