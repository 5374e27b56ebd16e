#include "overlays/SliderOverlay.h"

#include "framework/OverlayValue.h"

#include "orbane/AutoParam.h"
#include "orbane/ControlCommands.h"
#include "orbane/GPainter.h"
#include "orbane/Input.h"
#include "orbane/Operator.h"
#include "orbane/PreviewInfo.h"
#include "orbane/ScriptVal.h"

#include <algorithm>
#include <cmath>
#include <cstdio>
#include <string>

namespace Orbane {

using Graphics::GPainter;
using OV = OverlayValue;

namespace {

// The Input attributes that give a slider its range.
constexpr Tag kMinScale = 0x20030002, kMaxScale = 0x20030003;
// A Ctrl drag moves the value this many times slower.
constexpr float64 kFine = 10.0;
// A key steps by this share of the range.
constexpr float64 kKeyStep = 0.01;

} // namespace

SliderOverlay::SliderOverlay(const Registry *reg, const ScriptVal &args, const TagList &tags)
    : HandleOverlayOn<OverlayControl>(reg, args, tags)
{
}

void SliderOverlay::GetState(ScriptVal &state) const
{
    HandleOverlayOn::GetState(state);
    state.SetKey(ScriptVal("value"), ScriptVal(mValue));
    state.SetKey(ScriptVal("minimum"), ScriptVal(mLow));
    state.SetKey(ScriptVal("maximum"), ScriptVal(mHigh));
}

// The first Input is the slider's: its value, its range, its row.
bool SliderOverlay::AddInput(Input *input, const TagList *tags)
{
    if (!HandleOverlayOn::AddInput(input, tags))
        return false;
    if (input != GetMainInput())
        return true;
    const AutoParameter value(input->GetValue(GetCurrentTime()));
    OV::ReadNumber(value.get(), mValue);
    ReadRange();
    if (const Operator *tool = input->GetOperator()) {
        const auto &all = tool->Inputs();
        mRow = int32(std::find(all.begin(), all.end(), input) - all.begin());
    }
    return true;
}

// A range that is no range, or not numbers, is 0..1.
void SliderOverlay::ReadRange()
{
    const TagList &attrs = GetMainInput()->GetAttrs();
    mLow = attrs.GetDouble(kMinScale, 0.0);
    mHigh = attrs.GetDouble(kMaxScale, 1.0);
    if (!std::isfinite(mLow) || !std::isfinite(mHigh) || mHigh <= mLow) {
        mLow = 0.0;
        mHigh = 1.0;
    }
}

void SliderOverlay::NotifyChanged(Input *input, Parameter *value, const TagList *tags)
{
    if (!value)
        return;
    if (input != GetMainInput() || OV::TakeNumber(mValue, value))
        HandleOverlayOn::NotifyChanged(input, value, tags);
}

float64 SliderOverlay::PositionOf(float64 value, float64 low, float64 high, float64 length) noexcept
{
    if (!(high > low) || !std::isfinite(value))
        return 0.0;
    return std::clamp((value - low) / (high - low), 0.0, 1.0) * length;
}

float64 SliderOverlay::ValueAt(float64 along, float64 low, float64 high, float64 length) noexcept
{
    if (!(length > 0.0))
        return low;
    return low + std::clamp(along / length, 0.0, 1.0) * (high - low);
}

// Screen-fixed: the handle scale sizes it, the view's zoom does not.
OrbPoint SliderOverlay::TrackStart(const PreviewInfo &info) const
{
    const float64 s = info.HandleScale;
    return {Margin * s, (Margin + RowHeight * mRow) * s};
}

void SliderOverlay::BuildHandles(const PreviewInfo &info, HandleSet &handles) const
{
    handles.Clear();
    if (!GetMainInput())
        return;
    const OrbPoint start = TrackStart(info);
    const float64 length = TrackLength * info.HandleScale;
    handles.AddBox(start + OrbPoint(PositionOf(mValue, mLow, mHigh, length), 0.0), {-KnobHalf, -KnobHalf},
                   {KnobHalf, KnobHalf}, SPART_Knob, HP_Point);
    handles.AddBox(start, {0.0, -KnobHalf / 2}, {TrackLength, KnobHalf / 2}, SPART_Track, HP_Body);
}

// The knob is held where it was grabbed; a click on the track moves the
// knob there at once.
DragType SliderOverlay::ControlDown(PreviewInfo *info, const OrbPointI &mouse, const TagList *tags)
{
    if (!info->HotControl)
        if (const HandleHit hit = PressHit(*info)) {
            mDragType = DRAG_Handle;
            const OrbPoint start = TrackStart(*info);
            const float64 length = TrackLength * info->HandleScale;
            const float64 mouseX = info->MouseInViewer().x;
            if (hit.part == SPART_Track)
                Slide(ValueAt(mouseX - start.x, mLow, mHigh, length));
            mPressValue = mValue;
            mPressX = mouseX;
            Pick(hit);
        }
    return HandleOverlayOn::ControlDown(info, mouse, tags);
}

void SliderOverlay::ControlMove(PreviewInfo *info, const OrbPointI &mouse, const TagList *tags)
{
    HandleOverlayOn::ControlMove(info, mouse, tags);
    if (mDragType != DRAG_Handle)
        return;
    const float64 length = TrackLength * info->HandleScale;
    const float64 fine = (KeyModifiers() & Qt::ControlModifier) ? kFine : 1.0;
    const float64 along = PositionOf(mPressValue, mLow, mHigh, length) + (info->MouseInViewer().x - mPressX) / fine;
    Slide(ValueAt(along, mLow, mHigh, length));
}

void SliderOverlay::Slide(float64 value)
{
    if (!std::isfinite(value) || !Moved(value, mValue))
        return;
    OpenGesture(("Slide " + std::string(GetMainInput()->GetName())).c_str());
    WriteNumber(value, 0);
}

// Left and Right step the value, ten times with Shift, a tenth with Ctrl;
// a run of steps is one undo step, closed when every key is up.
uint64 SliderOverlay::ControlCommand(PreviewInfo *info, const OrbID &command, uint64 data, const TagList *tags)
{
    const bool horizontal = data == Qt::Key_Left || data == Qt::Key_Right;
    if (command == CCMD_NeedsKey)
        return horizontal ? 1 : 0;
    if (command == CCMD_KeyDown && horizontal && GetMainInput()) {
        const OrbPoint step = NudgeOffset(data, kKeyStep * (mHigh - mLow), 0.0, KeyModifiers());
        WriteNumber(std::clamp(mValue + step.x, mLow, mHigh), 0);
        HandleOverlayOn::ControlCommand(info, command, data, tags);
        return 1;
    }
    if (command == CCMD_KeyUpAll)
        ResetUndo(nullptr);
    return HandleOverlayOn::ControlCommand(info, command, data, tags);
}

void SliderOverlay::DrawControls(PreviewInfo *info, const TagList *tags)
{
    GPainter *p = info->GetPainter();
    if (p && info->DrawPass != 3 && GetMainInput()) {
        p->PushAttrib();
        DrawSlider(*p, *info);
        p->PopAttrib();
    }
    HandleOverlayOn::DrawControls(info, tags);
}

// The track with its end ticks, the knob, and the Input's name and value
// above the track's start.
void SliderOverlay::DrawSlider(GPainter &p, const PreviewInfo &info) const
{
    const OrbPoint start = TrackStart(info);
    const float64 s = info.HandleScale, length = TrackLength * s;
    p.Color(HandleFill(info, SPART_Track), HandleShadow(info));
    p.Begin(Graphics::GP_Lines);
    for (const OrbPoint v : {OrbPoint(0, 0), OrbPoint(length, 0), OrbPoint(0, -4 * s), OrbPoint(0, 4 * s),
                             OrbPoint(length, -4 * s), OrbPoint(length, 4 * s)})
        p.Vertex(start.x + v.x, start.y + v.y);
    p.End();
    BeginHandle(p, info, start + OrbPoint(PositionOf(mValue, mLow, mHigh, length), 0.0), SPART_Knob);
    p.Rectangle(-KnobHalf, -KnobHalf, KnobHalf, KnobHalf);
    EndHandle(p);
    char text[128];
    std::snprintf(text, sizeof text, "%s %.3g", GetMainInput()->GetName(), mValue);
    p.Color(info.GetColor(OrbColor()), info.GetShadow(OrbColor()));
    p.Text(start.x, start.y + 2 * KnobHalf * s, text);
}

} // namespace Orbane
