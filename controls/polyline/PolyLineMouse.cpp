#include "polyline/PolyLineMouse.h"

#include "polyline/PolyLineControl.h"
#include "polyline/PolyLineDrawing.h"
#include "polyline/PolyLineEditor.h"
#include "polyline/PolyLineShapes.h"
#include "polyline/ShapeBox.h"

#include "orbane/GPainter.h"
#include "orbane/Input.h"
#include "orbane/PolyLine.h"
#include "orbane/PreviewInfo.h"

#include <QGuiApplication>

#include <cmath>
#include <vector>

namespace Orbane {

namespace {

// A press that the mouse leaves by no more than this (viewer units) is a
// click, not a drag.
constexpr float64 kClickSlop = 2.0;

Qt::KeyboardModifiers HeldModifiers()
{
    return qGuiApp ? QGuiApplication::queryKeyboardModifiers() : Qt::NoModifier;
}

// The view's image-to-viewer mapping as a transform (it is affine).
QTransform ToViewer(const PreviewInfo &info)
{
    const OrbPoint o = info.TransformOut(0.0, 0.0);
    const OrbPoint ex = info.TransformOut(1.0, 0.0) - o, ey = info.TransformOut(0.0, 1.0) - o;
    return QTransform(ex.x, ex.y, ey.x, ey.y, o.x, o.y);
}

AutoRef<PolyLine> CloneOf(const PolyLine &shape)
{
    return AutoRef<PolyLine>(static_cast<PolyLine *>(shape.Clone()));
}

} // namespace

bool PolyLineMouse::Press(const PreviewInfo &info, HandleHit hit)
{
    Cancel();
    mPressShape = mExpected = mControl.Shape();
    if (!mPressShape)
        return false;
    mMods = HeldModifiers();
    mFrom = mTo = OrbPoint(info.MouseX, info.MouseY);
    mPressViewer = info.MouseInViewer();
    mHit = hit;
    if (PressShapeBox(info))
        return true;
    if (hit && hit.part == PolyLineControl::PLP_Point)
        return PressPoint(hit, mMods);
    if (hit) {
        const PolyPoint &p = *mPressShape->GetPoint(hit.item);
        mHeld = hit.part == PolyLineControl::PLP_InHandle ? p.In() : p.Out();
        mGesture = PMG_Handle;
        return true;
    }
    if (PressSegment(info))
        return true;
    mGesture = PMG_Box;
    return true;
}

bool PolyLineMouse::PressPoint(HandleHit hit, Qt::KeyboardModifiers mods)
{
    PolyLineEditor &edit = mControl.Editor();
    mHeld = mPressShape->GetPoint(hit.item)->Pos();
    const bool selected = mControl.mSelection.IsSet(hit.item);
    mGesture = PMG_Points;
    if (edit.IsSelectionLocked())
        mGesture = selected ? PMG_Points : PMG_Toggle;
    else if (mods & Qt::ControlModifier) {
        edit.Select({hit.item}, PolyLineEditor::SH_Toggle);
        mGesture = PMG_Toggle;
    } else if (mods & Qt::ShiftModifier)
        edit.Select({hit.item}, PolyLineEditor::SH_Add);
    else if (!selected)
        edit.Select({hit.item}, PolyLineEditor::SH_Replace);
    else
        mReselect = mControl.mSelection.IsMultiSet();
    return true;
}

// Within the pick tolerance of the curve, measured on screen.
bool PolyLineMouse::PressSegment(const PreviewInfo &info)
{
    if (mPressShape->GetSegmentsCount() < 1)
        return false;
    OrbPoint near;
    float64 par = 0.0;
    if (mPressShape->CalcClosestPoint(info.MouseX, info.MouseY, near.x, near.y, &par) < 0.0)
        return false;
    if ((info.TransformOut(near) - mPressViewer).Length() > info.PickTolerance)
        return false;
    mSegment = std::min(int32(par), mPressShape->GetSegmentsCount() - 1);
    mSegmentT = par - mSegment;
    mSegmentPar = par;
    mHeld = near;
    mGesture = PMG_Segment;
    return true;
}

bool PolyLineMouse::PressShapeBox(const PreviewInfo &info)
{
    if (mControl.Editor().GetShapeBox() == PolyLineEditor::SB_Off || !mControl.mSelection.GetSetCount())
        return false;
    ShapeBox &box = *mControl.mShapeBox;
    std::vector<OrbPoint> points;
    for (int32 i = 0; i < mPressShape->GetCount(); ++i)
        if (mControl.mSelection.IsSet(i))
            points.push_back(info.TransformOut(mPressShape->GetPoint(i)->Pos()));
    box.SetPoints(points);
    mBoxPart = box.HitTest(mPressViewer, info.PickTolerance);
    if (mBoxPart == ShapeBox::SBP_None)
        return false;
    mGesture = PMG_ShapeBox;
    if (mControl.Editor().GetShapeBox() == PolyLineEditor::SB_Both)
        mPressOuter = mControl.OuterShape();
    // The step opens at the press, so the press alone names it.
    mControl.OpenStep(mBoxPart == ShapeBox::SBP_Inside ? "Move Points" : "Dragging Shaping Box");
    return true;
}

bool PolyLineMouse::Moved(const PreviewInfo &info) const
{
    return (info.MouseInViewer() - mPressViewer).Length() > kClickSlop;
}

// Someone else (an undo, a script) changed the shape since this gesture
// last wrote it: the gesture ends rather than write over that.
bool PolyLineMouse::Overtaken() const
{
    return mControl.Shape().get() != mExpected.get();
}

void PolyLineMouse::Move(const PreviewInfo &info)
{
    if (mGesture == PMG_None || mGesture == PMG_Toggle)
        return;
    mTo = OrbPoint(info.MouseX, info.MouseY);
    if (mGesture == PMG_Box) {
        mControl.Redraw();
        return;
    }
    if (!Moved(info) && !mControl.mStepOpen)
        return;
    if (Overtaken())
        return Cancel();
    mReselect = false;
    const OrbPoint delta = mTo - mFrom;
    AutoRef<PolyLine> shape = CloneOf(*mPressShape);
    switch (mGesture) {
    case PMG_Points:
        return MovePoints(delta);
    case PMG_Handle:
        PolyLineShapes::MoveHandle(*shape, mHit.item, mHit.part, mHeld + delta,
                                   bool(HeldModifiers() & Qt::ControlModifier));
        return Write("Tensioning", shape.get());
    case PMG_Segment:
        PolyLineShapes::ShapeSegment(*shape, mSegment, mSegmentT, delta);
        return Write("Shape points", shape.get());
    case PMG_ShapeBox:
        return MoveShapeBox(info);
    default:
        return;
    }
}

void PolyLineMouse::MovePoints(OrbPoint delta)
{
    const std::vector<uint8> movable = PolyLineShapes::Movable(*mPressShape, mControl.mSelection);
    AutoRef<PolyLine> shape = CloneOf(*mPressShape);
    shape->MovePoints(movable.data(), delta.x, delta.y);
    Write(mControl.mSelection.IsMultiSet() ? "Move points" : "Move Point", shape.get());
    // Locked pairs: the outer points of the moved ones go along.
    const AutoRef<PolyLine> outer = mControl.Editor().LockPairs() ? mControl.OuterShape() : AutoRef<PolyLine>();
    if (!mPressOuter)
        mPressOuter = outer;
    if (mPressOuter && mPressOuter->GetCount() == mPressShape->GetCount()) {
        AutoRef<PolyLine> moved = CloneOf(*mPressOuter);
        moved->MovePoints(movable.data(), delta.x, delta.y);
        mControl.OuterInput()->SetValue(moved.get(), mControl.GetCurrentTime());
    }
}

void PolyLineMouse::MoveShapeBox(const PreviewInfo &info)
{
    const QTransform toViewer = ToViewer(info);
    const QTransform inViewer = mControl.mShapeBox->Drag(mBoxPart, mPressViewer, info.MouseInViewer(),
                                                         bool(HeldModifiers() & Qt::ShiftModifier));
    const QTransform t = toViewer * inViewer * toViewer.inverted();
    const std::vector<uint8> movable = PolyLineShapes::Movable(*mPressShape, mControl.mSelection);
    AutoRef<PolyLine> shape = CloneOf(*mPressShape);
    PolyLineShapes::Transform(*shape, movable.data(), t);
    Write("Dragging Shaping Box", shape.get());
    if (mPressOuter && mPressOuter->GetCount() == mPressShape->GetCount()) {
        AutoRef<PolyLine> outer = CloneOf(*mPressOuter);
        PolyLineShapes::Transform(*outer, movable.data(), t);
        mControl.OuterInput()->SetValue(outer.get(), mControl.GetCurrentTime());
    }
}

void PolyLineMouse::Write(const char *undo, PolyLine *shape)
{
    mControl.OpenStep(undo);
    mControl.WriteShape(shape);
    mExpected = mControl.Shape();
}

void PolyLineMouse::Release(const PreviewInfo &info)
{
    PolyLineEditor &edit = mControl.Editor();
    // The release may come where no move went before it.
    mTo = OrbPoint(info.MouseX, info.MouseY);
    const bool click = !Moved(info);
    if (mGesture == PMG_Points && mReselect && click)
        edit.Select({mHit.item}, PolyLineEditor::SH_Replace);
    if (mGesture == PMG_Box && !edit.IsSelectionLocked()) {
        const PolyLineEditor::SelectHow how = (mMods & Qt::ControlModifier) ? PolyLineEditor::SH_Toggle
                                              : (mMods & Qt::ShiftModifier) ? PolyLineEditor::SH_Add
                                                                            : PolyLineEditor::SH_Replace;
        if (!click)
            edit.SelectInBox(SelectionBox(), how);
        else if (how == PolyLineEditor::SH_Replace)
            edit.SelectNone();
    }
    if (mGesture == PMG_Segment && click && mControl.ModeOf() == PolyLineControl::PLM_InsertModify && !Overtaken()) {
        AutoRef<PolyLine> shape = CloneOf(*mPressShape);
        const int32 added = shape->InsertPointAt(mSegmentPar);
        if (added >= 0) {
            SelMask sel(shape->GetCount());
            sel.Set(added, true);
            mControl.mSelection = sel;
            Write("InsertAndModify", shape.get());
        }
    }
    Cancel();
}

void PolyLineMouse::Cancel()
{
    const bool box = mGesture == PMG_Box;
    mGesture = PMG_None;
    mReselect = false;
    mPressShape = mExpected = mPressOuter = AutoRef<PolyLine>();
    mControl.CloseStep();
    if (box)
        mControl.Redraw();
}

int32 PolyLineMouse::HoverCursor(const PreviewInfo &info) const
{
    const AutoRef<PolyLine> shape = mControl.Shape();
    if (!shape || mControl.Editor().GetShapeBox() == PolyLineEditor::SB_Off || !mControl.mSelection.GetSetCount())
        return -1;
    std::vector<OrbPoint> points;
    for (int32 i = 0; i < shape->GetCount(); ++i)
        if (mControl.mSelection.IsSet(i))
            points.push_back(info.TransformOut(shape->GetPoint(i)->Pos()));
    ShapeBox &box = *mControl.mShapeBox;
    box.SetPoints(points);
    const int32 part = box.HitTest(info.MouseInViewer(), info.PickTolerance);
    return part == ShapeBox::SBP_None ? -1 : ShapeBox::CursorOf(part);
}

// In image coordinates: the painter's matrix takes them to the viewer.
void PolyLineMouse::Draw(Graphics::GPainter &p, const PreviewInfo &info, const PolyLineStyle &style) const
{
    auto outline = [&p](OrbPoint a, OrbPoint b) {
        p.Begin(Graphics::GP_LineLoop);
        p.Vertex(a.x, a.y), p.Vertex(b.x, a.y), p.Vertex(b.x, b.y), p.Vertex(a.x, b.y);
        p.End();
    };
    p.Color(style.curve, style.shadow);
    if (mGesture == PMG_Box)
        outline(mFrom, mTo);
    const AutoRef<PolyLine> shape = mControl.Shape();
    if (!shape || mControl.Editor().GetShapeBox() == PolyLineEditor::SB_Off || !mControl.mSelection.GetSetCount())
        return;
    std::vector<OrbPoint> points;
    for (int32 i = 0; i < shape->GetCount(); ++i)
        if (mControl.mSelection.IsSet(i))
            points.push_back(info.TransformOut(shape->GetPoint(i)->Pos()));
    ShapeBox &box = *mControl.mShapeBox;
    box.SetPoints(points);
    outline(info.TransformIn(box.Bounds().Corner1()), info.TransformIn(box.Bounds().Corner2()));
    p.Color(style.handle, style.shadow);
    for (int32 part = 0; part < 8; ++part) {
        const OrbPoint at = info.TransformIn(box.HandleAt(part));
        outline(at - style.half, at + style.half);
    }
}

} // namespace Orbane
