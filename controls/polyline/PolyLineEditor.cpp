#include "polyline/PolyLineEditor.h"

#include "polyline/PolyLineControl.h"
#include "polyline/PolyLineShapes.h"

#include "orbane/AutoParam.h"
#include "orbane/BSplinePolyLine.h"
#include "orbane/ClassIDs.h"
#include "orbane/Input.h"
#include "orbane/Operator.h"
#include "orbane/PolyLine.h"
#include "orbane/PreviewInfo.h"
#include "orbane/SelMask.h"
#include "orbane/ShapeFile.h"

#include <QClipboard>
#include <QGuiApplication>

#include <algorithm>
#include <cmath>

namespace Orbane {

namespace {

// A new shape holding one reference: a copy of `shape` to edit.
AutoRef<PolyLine> CloneOf(const PolyLine &shape)
{
    return AutoRef<PolyLine>(static_cast<PolyLine *>(shape.Clone()));
}

} // namespace

// --- refusals ---

bool PolyLineEditor::Refuse(const char *why)
{
    mMessage = why;
    // The user hears of every refusal, whatever asked for the edit.
    mControl.Tell(why);
    return false;
}

bool PolyLineEditor::CanEdit()
{
    mMessage.clear();
    if (!mControl.GetMainInput() || !mControl.Shape())
        return Refuse("The overlay shows no shape");
    if (mControl.IsToolLocked())
        return Refuse("The tool is locked");
    if (mControl.mShapeReadOnly)
        return Refuse("The shape is read-only");
    if (mControl.mCreation.gesture != PolyLineCreation::PCG_None)
        return Refuse("A drag is under way");
    return true;
}

bool PolyLineEditor::NeedPoints()
{
    return mControl.Shape()->GetCount() > 0 || Refuse("The shape has no points");
}

bool PolyLineEditor::NeedSelection()
{
    return NeedPoints() && (mControl.mSelection.GetSetCount() > 0 || Refuse("Nothing is selected"));
}

// --- selection ---

bool PolyLineEditor::SelectAll()
{
    SelMask &sel = mControl.mSelection;
    bool changed = false;
    for (int32 i = 0; i < sel.GetCount(); ++i)
        changed = sel.Set(i, true) || changed;
    if (changed)
        mControl.Redraw();
    return changed;
}

bool PolyLineEditor::SelectNone()
{
    const bool changed = mControl.mSelection.Reset();
    if (changed)
        mControl.Redraw();
    return changed;
}

bool PolyLineEditor::Select(const std::vector<int32> &indices, SelectHow how)
{
    SelMask &sel = mControl.mSelection;
    const SelMask before = sel;
    if (how == SH_Replace)
        sel.Reset();
    for (const int32 i : indices)
        sel.DoSet(i, how == SH_Toggle ? SelMask::SEL_Toggle : how == SH_Remove ? SelMask::SEL_Clear : SelMask::SEL_Set);
    const bool changed = sel != before;
    if (changed)
        mControl.Redraw();
    return changed;
}

bool PolyLineEditor::SelectInBox(const OrbRect &image, SelectHow how)
{
    const AutoRef<PolyLine> shape = mControl.Shape();
    if (!shape)
        return false;
    const OrbRect box = image.Normalized();
    std::vector<int32> inside;
    const std::vector<PolyPoint> &points = shape->Points();
    for (std::size_t i = 0; i < points.size(); ++i)
        if (box.Contains(points[i].Pos()))
            inside.push_back(int32(i));
    return Select(inside, how);
}

bool PolyLineEditor::SelectNext(int32 step)
{
    const AutoRef<PolyLine> shape = mControl.Shape();
    const int32 n = shape ? shape->GetCount() : 0;
    if (n == 0 || step == 0)
        return false;
    const SelMask &sel = mControl.mSelection;
    const int32 from = sel.GetSetCount() ? sel.GetSetItem(step > 0 ? sel.GetSetCount() - 1 : 0) : (step > 0 ? -1 : n);
    int32 to = from + step;
    to = shape->IsClosed() ? ((to % n) + n) % n : std::clamp(to, 0, n - 1);
    return Select({to}, SH_Replace) || sel.GetSetCount() == 1;
}

// --- edits ---

std::vector<float64> PolyLineEditor::OtherTimes(bool structural) const
{
    Input *main = mControl.GetMainInput();
    if (!main || !main->IsAnimated())
        return {};
    const float64 now = mControl.GetCurrentTime();
    std::vector<float64> keys = main->KeyTimes();
    keys.erase(std::remove(keys.begin(), keys.end(), now), keys.end());
    if (structural)
        return CurrentTimeOnly() ? std::vector<float64>() : keys;
    const auto next = std::upper_bound(keys.begin(), keys.end(), now);
    switch (mMultiFrame) {
    case MF_Prev:
        return next == keys.begin() ? std::vector<float64>() : std::vector<float64>{*(next - 1)};
    case MF_Next:
        return next == keys.end() ? std::vector<float64>() : std::vector<float64>{*next};
    case MF_All:
        return keys;
    default:
        return {};
    }
}

bool PolyLineEditor::Commit(const char *undo, const std::function<bool(PolyLine &)> &edit, bool structural)
{
    const AutoRef<PolyLine> shape = mControl.Shape();
    AutoRef<PolyLine> edited = CloneOf(*shape);
    if (!edit(*edited))
        return Refuse("Nothing to change");
    // A caller that opened the step (a run of nudges, a publish that writes
    // the point Inputs too) closes it.
    const bool opens = !mControl.mStepOpen;
    mControl.OpenStep(undo);
    bool written = mControl.WriteShape(edited.get());
    Input *main = mControl.GetMainInput();
    for (const float64 time : OtherTimes(structural)) {
        const AutoParam<PolyLine> key(main, time);
        AutoRef<PolyLine> other = key ? CloneOf(*key) : AutoRef<PolyLine>();
        if (other && other->GetCount() == shape->GetCount() && edit(*other))
            written = mControl.SetInputs(other.get(), time, 0, nullptr) || written;
    }
    mControl.FollowInner(*edited);
    if (opens && !mNudging)
        mControl.CloseStep();
    return written || Refuse("The shape did not take the edit");
}

bool PolyLineEditor::EditSelected(const char *undo, const std::function<bool(PolyLine &, const uint8 *)> &edit)
{
    if (!CanEdit() || !NeedSelection())
        return false;
    const std::vector<uint8> movable = PolyLineShapes::Movable(*mControl.Shape(), mControl.mSelection);
    if (std::none_of(movable.begin(), movable.end(), [](uint8 b) { return b != 0; }))
        return Refuse("The selected points are locked");
    return Commit(
        undo, [&](PolyLine &s) { return edit(s, movable.data()); }, false);
}

bool PolyLineEditor::DeleteSelected()
{
    if (!CanEdit() || !NeedSelection())
        return false;
    const std::vector<uint8> sel(mControl.mSelection.Bytes(),
                                 mControl.mSelection.Bytes() + mControl.mSelection.GetCount());
    SelMask kept = mControl.mSelection;
    kept.RemoveSetItems();
    const SelMask before = mControl.mSelection;
    mControl.mSelection = kept;
    if (Commit(
            "Delete Points", [&](PolyLine &s) { return s.DeletePoints(sel.data()); }, true))
        return true;
    mControl.mSelection = before;
    return false;
}

bool PolyLineEditor::Smooth()
{
    return EditSelected("Smooth Polyline", [](PolyLine &s, const uint8 *sel) { return s.Smooth(sel); });
}

bool PolyLineEditor::MakeLinear()
{
    return EditSelected("Linear Polyline", [](PolyLine &s, const uint8 *sel) { return s.Linear(sel); });
}

bool PolyLineEditor::SetClosed(bool closed)
{
    if (!CanEdit() || !NeedPoints())
        return false;
    if (mControl.Shape()->IsClosed() == closed)
        return Refuse(closed ? "The shape is closed already" : "The shape is open already");
    return Commit(
        closed ? "Close polygon" : "Open polygon", [closed](PolyLine &s) { return closed ? s.Close() : s.Open(); },
        true);
}

bool PolyLineEditor::Flip(Qt::Orientation axis)
{
    return EditSelected("Flip Points", [axis](PolyLine &s, const uint8 *sel) {
        return PolyLineShapes::Flip(s, sel, axis == Qt::Horizontal);
    });
}

bool PolyLineEditor::Nudge(OrbPoint delta)
{
    // The step stays open over the whole run of keys.
    const bool running = std::exchange(mNudging, true);
    const bool moved = EditSelected(
        "Shift points", [delta](PolyLine &s, const uint8 *sel) { return s.MovePoints(sel, delta.x, delta.y); });
    mNudging = running || moved;
    return moved;
}

bool PolyLineEditor::NudgeKey(int key, Qt::KeyboardModifiers mods, const PreviewInfo &info)
{
    float64 factor = (mods & Qt::ShiftModifier) ? 10.0 : 1.0;
    if (mods & Qt::ControlModifier)
        factor /= 10.0;
    const OrbPoint pixel(1.0 / std::max(1, info.ImageWidth), 1.0 / std::max(1, info.ImageHeight));
    switch (key) {
    case Qt::Key_Left:
        return Nudge({-pixel.x * factor, 0.0});
    case Qt::Key_Right:
        return Nudge({pixel.x * factor, 0.0});
    case Qt::Key_Up:
        return Nudge({0.0, pixel.y * factor});
    case Qt::Key_Down:
        return Nudge({0.0, -pixel.y * factor});
    default:
        return false;
    }
}

void PolyLineEditor::EndNudge()
{
    if (std::exchange(mNudging, false))
        mControl.CloseStep();
}

bool PolyLineEditor::TagSelected()
{
    if (!CanEdit() || !NeedSelection())
        return false;
    const std::vector<uint8> sel(mControl.mSelection.Bytes(),
                                 mControl.mSelection.Bytes() + mControl.mSelection.GetCount());
    return Commit(
        "Tag Points", [&](PolyLine &s) { return PolyLineShapes::ToggleTags(s, sel.data()); }, false);
}

bool PolyLineEditor::LockSelected(bool locked)
{
    if (!CanEdit() || !NeedSelection())
        return false;
    const std::vector<uint8> sel(mControl.mSelection.Bytes(),
                                 mControl.mSelection.Bytes() + mControl.mSelection.GetCount());
    return Commit(
        "Lock Points", [&](PolyLine &s) { return PolyLineShapes::SetFlag(s, sel.data(), PPF_Locked, locked); }, false);
}

bool PolyLineEditor::IsSelectionLockedPoint() const
{
    const AutoRef<PolyLine> shape = mControl.Shape();
    const int32 first = mControl.mSelection.GetSetItem(0);
    const PolyPoint *p = shape ? shape->GetPoint(first) : nullptr;
    return p && (p->Flags & PPF_Locked);
}

bool PolyLineEditor::Subdivide()
{
    if (!CanEdit() || !NeedPoints())
        return false;
    if (mControl.Shape()->DataType() != CLSID_DataType_BSplinePolyline)
        return Refuse("Subdivide works on B-spline shapes only");
    if (mControl.Shape()->GetCount() < 2)
        return Refuse("Subdivide needs two points or more");
    mControl.mSelection.Reset();
    return Commit(
        "Subdivide", [](PolyLine &s) { return PolyLineShapes::Subdivide(s); }, true);
}

bool PolyLineEditor::Reduce(float64 tolerancePx)
{
    if (!CanEdit() || !NeedPoints())
        return false;
    if (mControl.Shape()->GetCount() < 3)
        return Refuse("Reduce Points needs three points or more");
    if (CurrentTimeOnly())
        return Refuse("Reduce Points is off while Current Time Only is on");
    if (OtherTimes(true).size() > 0)
        return Refuse("Reduce Points would leave the keyframes with different points");
    mControl.mSelection.Reset();
    return Commit(
        "Reduce Points", [tolerancePx](PolyLine &s) { return s.ReducePoints(tolerancePx, 1e-3, 1e-3); }, true);
}

// --- the clipboard ---

bool PolyLineEditor::Copy()
{
    mMessage.clear();
    const AutoRef<PolyLine> shape = mControl.Shape();
    if (!shape || shape->GetCount() == 0)
        return Refuse("The shape has no points");
    const SelMask &sel = mControl.mSelection;
    const AutoRef<PolyLine> copied =
        sel.GetSetCount() ? PolyLineShapes::Selected(*shape, sel.Bytes()) : CloneOf(*shape);
    QGuiApplication::clipboard()->setText(QString::fromStdString(ShapeFile::Text(*copied)));
    return true;
}

bool PolyLineEditor::CopyPathValue()
{
    mMessage.clear();
    const AutoRef<PolyLine> shape = mControl.Shape();
    if (!shape)
        return Refuse("The overlay shows no shape");
    QGuiApplication::clipboard()->setText(QString::fromStdString(ShapeFile::Text(*shape)));
    return true;
}

bool PolyLineEditor::Cut()
{
    if (!CanEdit() || !NeedSelection() || !Copy())
        return false;
    const std::vector<uint8> sel(mControl.mSelection.Bytes(),
                                 mControl.mSelection.Bytes() + mControl.mSelection.GetCount());
    const SelMask before = mControl.mSelection;
    mControl.mSelection.RemoveSetItems();
    if (Commit(
            "Cut Points", [&](PolyLine &s) { return s.DeletePoints(sel.data()); }, true))
        return true;
    mControl.mSelection = before;
    return false;
}

bool PolyLineEditor::Paste()
{
    return PasteText({});
}

bool PolyLineEditor::PasteWithOffset(OrbPoint offset)
{
    return PasteText(offset);
}

OrbPoint PolyLineEditor::DefaultPasteOffset() const
{
    // Image pixels of the shape's tool are unknown here; the viewer's
    // usual image is a thousand pixels or so across.
    return {PasteOffsetPixels * 1e-3, -PasteOffsetPixels * 1e-3};
}

// The pasted points are appended and selected alone; an empty shape takes
// the pasted one's closure too.
bool PolyLineEditor::PasteText(OrbPoint offset)
{
    if (!CanEdit())
        return false;
    std::string why;
    const std::string text = QGuiApplication::clipboard()->text().toStdString();
    const AutoRef<PolyLine> pasted(text.empty() ? nullptr : ShapeFile::Parse(text, "the clipboard", &why));
    if (!pasted)
        return Refuse(text.empty() ? "The clipboard is empty" : "The clipboard holds no shape");
    if (pasted->GetCount() == 0)
        return Refuse("The clipboard's shape has no points");
    pasted->MovePoints(nullptr, offset.x, offset.y);
    const int32 before = mControl.Shape()->GetCount();
    SelMask sel(before + pasted->GetCount());
    for (int32 i = before; i < sel.GetCount(); ++i)
        sel.Set(i, true);
    const SelMask old = mControl.mSelection;
    mControl.mSelection = sel;
    const bool done = Commit(
        "Paste Points", [&](PolyLine &s) { return PolyLineShapes::Append(s, *pasted); }, true);
    if (!done)
        mControl.mSelection = old;
    return done;
}

// --- publishing ---

// Every published point has the point Input of its number on the tool, so
// that other tools and overlays can follow it. Inputs are part of the tool,
// not of an edit: undo leaves them.
bool PolyLineEditor::CreatePointInputs(const PolyLine &shape) const
{
    Operator *tool = mControl.GetMainInput()->GetOperator();
    if (!tool)
        return false;
    for (const PolyPoint &p : shape.Points()) {
        const OrbID id = PolyLine::PublishedPointInputID(p.TagID);
        if ((p.Flags & PPF_Published) && !tool->FindInput(id)) {
            const AutoPoint at(p.X, p.Y);
            tool->AddInput(id, id.c_str(), CLSID_DataType_Point, TagList(), at.get());
        }
    }
    return true;
}

bool PolyLineEditor::PublishSelected()
{
    if (!CanEdit() || !NeedSelection())
        return false;
    const std::vector<uint8> sel(mControl.mSelection.Bytes(),
                                 mControl.mSelection.Bytes() + mControl.mSelection.GetCount());
    const int32 first = PolyLineShapes::FirstFreePointNumber(*mControl.GetMainInput()->GetOperator());
    mControl.OpenStep("Publish Points");
    const bool done = Commit(
        "Publish Points", [&](PolyLine &s) { return s.PublishPoints(sel.data(), first) > 0; }, false);
    if (done) {
        const AutoRef<PolyLine> shape = mControl.Shape();
        CreatePointInputs(*shape);
        shape->UpdatePublishedPointInputs(*mControl.GetMainInput()->GetOperator(), mControl.GetCurrentTime());
    } else {
        Refuse("The selected points are published already");
    }
    mControl.CloseStep();
    return done;
}

bool PolyLineEditor::Unpublish()
{
    if (!CanEdit() || !NeedSelection())
        return false;
    const std::vector<uint8> sel(mControl.mSelection.Bytes(),
                                 mControl.mSelection.Bytes() + mControl.mSelection.GetCount());
    return Commit(
               "Unpublish Points", [&](PolyLine &s) { return s.UnpublishPoints(sel.data()); }, false) ||
           Refuse("None of the selected points is published");
}

// The selected points stop following: they stay where they are now.
bool PolyLineEditor::StopFollowing()
{
    if (!CanEdit() || !NeedSelection())
        return false;
    const std::vector<uint8> sel(mControl.mSelection.Bytes(),
                                 mControl.mSelection.Bytes() + mControl.mSelection.GetCount());
    return Commit(
               "Stop Points Following",
               [&](PolyLine &s) { return PolyLineShapes::SetFlag(s, sel.data(), PPF_Following, false); }, false) ||
           Refuse("None of the selected points follows another");
}

bool PolyLineEditor::FollowNearby()
{
    if (!CanEdit() || !NeedSelection())
        return false;
    Operator *tool = mControl.GetMainInput()->GetOperator();
    const std::vector<uint8> sel(mControl.mSelection.Bytes(),
                                 mControl.mSelection.Bytes() + mControl.mSelection.GetCount());
    const float64 now = mControl.GetCurrentTime();
    return Commit(
               "Set Points to follow",
               [&](PolyLine &s) { return tool && PolyLineShapes::FollowPublished(s, sel.data(), *tool, now); },
               false) ||
           Refuse("No published point of the tool's other shapes to follow");
}

// A path: the published point's Input animated with a key at each key of
// the shape; an XY path: two animated Numbers, "<id>X" and "<id>Y".
bool PolyLineEditor::PublishTo(int32 target)
{
    if (target == PT_IntelliTrack || target == PT_PointTracker)
        return Refuse("No tracker overlay exists yet: the points cannot be attached to a tracker");
    if (target != PT_Path && target != PT_XYPath)
        return Refuse("Unknown publishing target");
    if (!CanEdit() || !NeedSelection())
        return false;
    Input *main = mControl.GetMainInput();
    Operator *tool = main->GetOperator();
    if (!tool)
        return Refuse("The shape belongs to no tool");
    const std::vector<uint8> sel(mControl.mSelection.Bytes(),
                                 mControl.mSelection.Bytes() + mControl.mSelection.GetCount());
    const int32 first = PolyLineShapes::FirstFreePointNumber(*tool);
    mControl.OpenStep(target == PT_Path ? "Publish To Path" : "Publish To XYPath");
    Commit(
        "Publish Points", [&](PolyLine &s) { return s.PublishPoints(sel.data(), first) > 0; }, false);
    std::vector<float64> times = KeyTimes();
    if (times.empty())
        times.push_back(mControl.GetCurrentTime());
    const AutoRef<PolyLine> shape = mControl.Shape();
    for (std::size_t i = 0; i < sel.size() && i < shape->Points().size(); ++i)
        if (sel[i] && (shape->Points()[i].Flags & PPF_Published))
            PolyLineShapes::AnimatePath(*tool, *main, int32(i), shape->Points()[i].TagID, times, target == PT_XYPath);
    mControl.CloseStep();
    return true;
}

// --- the outer polyline ---

bool PolyLineEditor::WriteOuter(const char *undo, PolyLine *shape, int32 pairing)
{
    Input *outer = mControl.OuterInput();
    if (!outer)
        return Refuse("The tool has no outer polyline");
    mControl.OpenStep(undo);
    const bool written = !shape || outer->SetValue(shape, mControl.GetCurrentTime());
    mControl.CloseStep();
    mControl.SetPairing(pairing);
    return written;
}

bool PolyLineEditor::MakeOuter()
{
    if (!CanEdit() || !NeedPoints())
        return false;
    const AutoRef<PolyLine> inner = mControl.InnerShape();
    if (!inner || inner->GetCount() == 0)
        return Refuse("The inner polyline has no points");
    const AutoRef<PolyLine> outer = PolyLineShapes::OuterOf(*inner, PolyLineShapes::OuterDistance);
    return WriteOuter("Make Outer Polyline", outer.get(), PolyLineControl::PAIR_Free);
}

bool PolyLineEditor::RemoveOuter()
{
    if (!CanEdit())
        return false;
    const AutoRef<PolyLine> empty = mControl.InnerShape() ? CloneOf(*mControl.InnerShape()) : AutoRef<PolyLine>();
    if (empty)
        empty->DeleteAllPoints();
    return WriteOuter("Remove Outer Polyline", empty.get(), PolyLineControl::PAIR_Off);
}

bool PolyLineEditor::EnableOuter()
{
    if (!CanEdit())
        return false;
    const AutoRef<PolyLine> outer = mControl.OuterShape();
    if (!outer || outer->GetCount() == 0)
        return MakeOuter();
    return WriteOuter("Enable Outer Polyline", nullptr, PolyLineControl::PAIR_Free);
}

bool PolyLineEditor::ResetOuter()
{
    if (!CanEdit())
        return false;
    const AutoRef<PolyLine> inner = mControl.InnerShape();
    if (!inner || inner->GetCount() == 0)
        return Refuse("The inner polyline has no points");
    const AutoRef<PolyLine> outer = PolyLineShapes::OuterOf(*inner, PolyLineShapes::OuterDistance);
    return WriteOuter("Reset Outer Point Positions", outer.get(), mControl.Pairing());
}

bool PolyLineEditor::FollowInner()
{
    if (!CanEdit())
        return false;
    const AutoRef<PolyLine> inner = mControl.InnerShape(), outer = mControl.OuterShape();
    if (!inner || !outer || outer->GetCount() != inner->GetCount() || inner->GetCount() == 0)
        return Refuse("The outer polyline must have as many points as the inner one");
    AutoRef<PolyLine> following = CloneOf(*outer);
    following->SetFollowingPointsOrg(*inner);
    following->RecalcDisplacements(*inner);
    return WriteOuter("Follow Inner Polyline", following.get(), PolyLineControl::PAIR_Follow);
}

// --- time ---

void PolyLineEditor::SetMultiFrame(int32 mode)
{
    mMultiFrame = std::clamp(mode, int32(MF_None), int32(MF_All));
}

void PolyLineEditor::SetCurrentTimeOnly(bool on)
{
    mControl.mCurrentTimeOnly = on;
}

bool PolyLineEditor::CurrentTimeOnly() const
{
    return mControl.mCurrentTimeOnly;
}

std::vector<float64> PolyLineEditor::KeyTimes() const
{
    Input *main = mControl.GetMainInput();
    return main && main->IsAnimated() ? main->KeyTimes() : std::vector<float64>();
}

void PolyLineEditor::SetShapeBox(int32 mode)
{
    mShapeBox = std::clamp(mode, int32(SB_Off), int32(SB_Both));
    mControl.Redraw();
}

} // namespace Orbane
