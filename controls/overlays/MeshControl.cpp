#include "overlays/MeshControl.h"

#include "framework/MeshTags.h"
#include "framework/OverlayValue.h"

#include "orbane/AutoParam.h"
#include "orbane/ControlCommands.h"
#include "orbane/Input.h"
#include "orbane/PreviewInfo.h"
#include "orbane/ScriptValParam.h"
#include "orbane/TagList.h"

#include <algorithm>
#include <cmath>

namespace Orbane {

using OV = OverlayValue;

namespace {

// Handle parts: a vertex (its number as the item) and the mesh's body,
// where a press starts a selection box.
constexpr uint32 kVertex = 1;
constexpr uint32 kBody = 2;

const OrbID kResetMesh("ResetMesh");
const OrbID kSelectAll("SelectAllVertices");
const OrbID kSelectNone("SelectNoVertices");

} // namespace

const LinkedInput<MeshControl> MeshControl::Links[] = {
    {MSCP_Rest, MSCID_Rest, &MeshControl::mRestInput},
    {MSCP_Offset, MSCID_Offset, &MeshControl::mOffsetInput},
    {MSCP_Visible, MSCID_Visible, &MeshControl::mVisibleInput},
};

MeshControl::MeshControl(const Registry *reg, const ScriptVal &args, const TagList &tags)
    : HandleOverlay(reg, args, tags)
{
    MeshControl::SetAttrsTagList(nullptr, tags);
}

MeshControl::~MeshControl()
{
    DetachLinkedInputs(*this, Links);
}

bool MeshControl::GetAttrsTagList(TagList &tags) const
{
    HandleOverlay::GetAttrsTagList(tags);
    WriteLinkedInputIds(*this, Links, tags);
    const Look &l = mLook;
    for (const auto &[tag, on] : {std::pair{MSC_ShowVertices, l.showVertices},
                                  {MSC_ShowRows, l.showRows},
                                  {MSC_ShowColumns, l.showColumns},
                                  {MSC_ShowBorder, l.showBorder},
                                  {MSC_ShowDiagonals, l.showDiagonals},
                                  {MSC_ShowLabels, l.showLabels},
                                  {MSC_HideWhileDragging, l.hideWhileDragging},
                                  {MSC_ShowRest, l.showRest},
                                  {MSC_BoxSelect, l.boxSelect},
                                  {MSC_ReadOnly, l.readOnly},
                                  {MSC_SnapToPixels, l.snapToPixels},
                                  {MSC_SnapToGrid, l.snapToGrid},
                                  {MSC_LockBorder, l.rules.lockBorder},
                                  {MSC_LockCorners, l.rules.lockCorners},
                                  {MSC_SlideBorder, l.rules.slideBorder},
                                  {MSC_ClampToImage, l.rules.clampToImage},
                                  {MSC_MirrorX, l.rules.mirrorX}})
        tags.Set(tag, on);
    for (const auto &[tag, n] : {std::pair{MSC_Columns, l.cols},
                                 {MSC_Rows, l.rows},
                                 {MSC_LineEvery, l.lineEvery},
                                 {MSC_VertexShape, l.vertexShape},
                                 {MSC_LineStyle, l.lineStyle}})
        tags.Set(tag, n);
    for (const auto &[tag, c] : {std::pair{MSC_HandleColor, l.handle},
                                 {MSC_LineColor, l.line},
                                 {MSC_SelectedColor, l.selected},
                                 {MSC_BorderColor, l.border},
                                 {MSC_RestColor, l.rest},
                                 {MSC_BoxColor, l.box}})
        tags.Set(tag, int32(c.Packed()));
    for (const auto &[tag, d] : {std::pair{MSCD_VertexSize, l.vertexSize},
                                 {MSCD_LineWidth, l.lineWidth},
                                 {MSCD_BorderWidth, l.borderWidth},
                                 {MSCD_SnapSpacing, l.snapSpacing},
                                 {MSCD_Opacity, l.opacity},
                                 {MSCD_Falloff, l.falloff},
                                 {MSCD_FineFactor, l.fineFactor},
                                 {MSCD_NudgeStep, l.nudgeStep}})
        tags.Set(tag, d);
    tags.Set(MSCS_Label, l.label.c_str());
    return true;
}

void MeshControl::GetState(ScriptVal &state) const
{
    HandleOverlay::GetState(state);
    state.SetKey(ScriptVal("cols"), ScriptVal(mMesh.cols));
    state.SetKey(ScriptVal("rows"), ScriptVal(mMesh.rows));
    state.SetKey(ScriptVal("vertices"), ScriptVal(mMesh.Count()));
    ScriptVal selection = ScriptVal::NewTable();
    for (std::size_t i = 0; i < mSelected.size(); ++i)
        if (mSelected[i])
            selection.Append(ScriptVal(int64(i + 1)));
    state.SetKey(ScriptVal("selected"), ScriptVal(selection.Length()));
    state.SetKey(ScriptVal("selection"), selection);
    state.SetKey(ScriptVal("boxing"), ScriptVal(mBoxing));
    const char *status = "";
    if (mMesh.Empty())
        status = "the mesh has no vertices: nothing to draw (Reset Mesh makes an even grid)";
    else if (!mVisible)
        status = "hidden by its visibility Input";
    state.SetKey(ScriptVal("status"), ScriptVal(status));
}

void MeshControl::GetAvailableEvents(std::vector<ToolbarEvent> &events, const TagList *)
{
    if (mLook.readOnly)
        return;
    events.push_back({kResetMesh, OrbString("Reset Mesh"), OrbString("Reset the mesh to an even grid"), {}});
    events.push_back({kSelectAll, OrbString("Select All"), OrbString("Select every vertex of the mesh"), {}});
    events.push_back({kSelectNone, OrbString("Select None"), OrbString("Clear the mesh's selection"), {}});
}

bool MeshControl::HandleEvent(const OrbID &event, PreviewInfo *info, const TagList *tags)
{
    if (mLook.readOnly)
        return HandleOverlay::HandleEvent(event, info, tags);
    if (event == kResetMesh) {
        // A mesh Input shows the new grid at once; the old selection means
        // nothing on it.
        const bool done = WriteMesh(MeshGrid::Regular(mLook.cols, mLook.rows), "Reset Mesh");
        ResetUndo(nullptr);
        CloseGesture();
        return done;
    }
    if (event == kSelectAll || event == kSelectNone) {
        std::fill(mSelected.begin(), mSelected.end(), uint8(event == kSelectAll));
        Redraw();
        return true;
    }
    return HandleOverlay::HandleEvent(event, info, tags);
}

bool MeshControl::SetAttrsTagList(Input *input, const TagList &tags)
{
    const uint32 linked = AttachLinkedInputs(*this, Links, GetOperator(nullptr), tags);
    ReadLook(tags);
    PullLinkedInputs(*this, Links, linked);
    return HandleOverlay::SetAttrsTagList(input, tags);
}

void MeshControl::ReadLook(const TagList &tags)
{
    Look &l = mLook;
    for (auto [tag, field] : {std::pair{MSC_ShowVertices, &l.showVertices},
                              {MSC_ShowRows, &l.showRows},
                              {MSC_ShowColumns, &l.showColumns},
                              {MSC_ShowBorder, &l.showBorder},
                              {MSC_ShowDiagonals, &l.showDiagonals},
                              {MSC_ShowLabels, &l.showLabels},
                              {MSC_HideWhileDragging, &l.hideWhileDragging},
                              {MSC_ShowRest, &l.showRest},
                              {MSC_BoxSelect, &l.boxSelect},
                              {MSC_ReadOnly, &l.readOnly},
                              {MSC_SnapToPixels, &l.snapToPixels},
                              {MSC_SnapToGrid, &l.snapToGrid},
                              {MSC_LockBorder, &l.rules.lockBorder},
                              {MSC_LockCorners, &l.rules.lockCorners},
                              {MSC_SlideBorder, &l.rules.slideBorder},
                              {MSC_ClampToImage, &l.rules.clampToImage},
                              {MSC_MirrorX, &l.rules.mirrorX}})
        *field = tags.GetBool(tag, *field);
    l.cols = std::clamp(tags.GetInt(MSC_Columns, l.cols), 2, 1024);
    l.rows = std::clamp(tags.GetInt(MSC_Rows, l.rows), 2, 1024);
    l.lineEvery = std::max(tags.GetInt(MSC_LineEvery, l.lineEvery), 1);
    l.vertexShape = std::clamp(tags.GetInt(MSC_VertexShape, l.vertexShape), 0, 2);
    l.lineStyle = std::clamp(tags.GetInt(MSC_LineStyle, l.lineStyle), 0, 2);
    for (auto [tag, field] : {std::pair{MSC_HandleColor, &l.handle},
                              {MSC_LineColor, &l.line},
                              {MSC_SelectedColor, &l.selected},
                              {MSC_BorderColor, &l.border},
                              {MSC_RestColor, &l.rest},
                              {MSC_BoxColor, &l.box}})
        *field = OrbColor(uint32(tags.GetLong(tag, int64(field->Packed()))));
    // Sizes that make no sense (not finite, or not positive where a size
    // must be) keep what was there.
    auto read = [&tags](Tag tag, float64 &field, float64 lo, float64 hi) {
        const float64 to = tags.GetDouble(tag, field);
        if (std::isfinite(to))
            field = std::clamp(to, lo, hi);
    };
    read(MSCD_VertexSize, l.vertexSize, 0.5, 50.0);
    read(MSCD_LineWidth, l.lineWidth, 0.0, 20.0);
    read(MSCD_BorderWidth, l.borderWidth, 0.0, 20.0);
    read(MSCD_SnapSpacing, l.snapSpacing, 1e-3, 1e6);
    read(MSCD_Opacity, l.opacity, 0.0, 1.0);
    read(MSCD_Falloff, l.falloff, 0.0, 1e6);
    read(MSCD_FineFactor, l.fineFactor, 1e-3, 1.0);
    read(MSCD_NudgeStep, l.nudgeStep, 1e-3, 1e4);
    if (const char *label = tags.GetString(MSCS_Label))
        l.label = label;
}

bool MeshControl::AddInput(Input *input, const TagList *tags)
{
    return AddInputTaking(input, tags, [this](int32 index, const Parameter *value, bool &) {
        if (index == 0)
            TakeMesh(value);
    });
}

bool MeshControl::RemoveInput(Input *input, const TagList *tags)
{
    if (input && input == mRestInput)
        mRest = MeshGrid();
    const bool linked = DetachLinkedInput(*this, Links, input);
    return HandleOverlay::RemoveInput(input, tags) || linked;
}

void MeshControl::TakeMesh(const Parameter *value)
{
    const auto *sv = dynamic_cast<const ScriptValParam *>(value);
    MeshGrid mesh = MeshGrid::FromScript(sv ? sv->Value : ScriptVal());
    // The selection survives a new position of the same vertices, not a
    // mesh of another size.
    if (mesh.cols != mMesh.cols || mesh.rows != mMesh.rows)
        mSelected.assign(mesh.points.size(), 0);
    mMesh = std::move(mesh);
}

void MeshControl::NotifyChanged(Input *input, Parameter *value, const TagList *tags)
{
    if (!value)
        return;
    if (input && input == GetMainInput()) {
        TakeMesh(value);
    } else if (input && input == mRestInput) {
        const auto *sv = dynamic_cast<const ScriptValParam *>(value);
        mRest = MeshGrid::FromScript(sv ? sv->Value : ScriptVal());
    } else if (input && input == mOffsetInput) {
        if (!OV::TakePoint(mOffset, value))
            return;
    } else if (input && input == mVisibleInput) {
        float64 v = 1.0;
        if (OV::ReadNumber(value, v))
            mVisible = v != 0.0;
    }
    HandleOverlay::NotifyChanged(input, value, tags);
}

OrbPoint MeshControl::ViewerPoint(const PreviewInfo &info, OrbPoint p) const
{
    return info.TransformOut(p + mOffset);
}

void MeshControl::BuildHandles(const PreviewInfo &info, HandleSet &handles) const
{
    handles.Clear();
    if (!Shows() || mLook.readOnly)
        return;
    const float64 s = mLook.vertexSize;
    OrbPoint lo(HUGE_VAL, HUGE_VAL), hi(-HUGE_VAL, -HUGE_VAL);
    for (int32 i = 0; i < mMesh.Count(); ++i) {
        const OrbPoint at = ViewerPoint(info, mMesh.points[std::size_t(i)]);
        if (!OV::OnScreen(at))
            continue;
        handles.AddBox(at, {-s, -s}, {s, s}, kVertex, HP_Point).item = i;
        lo = {std::min(lo.x, at.x), std::min(lo.y, at.y)};
        hi = {std::max(hi.x, at.x), std::max(hi.y, at.y)};
    }
    if (handles.Empty())
        return;
    // The body: the vertices' bounds, in handle pixels about its middle.
    const OrbPoint mid = (lo + hi) * 0.5;
    const float64 scale = info.HandleScale > 0 ? info.HandleScale : 1.0;
    handles.AddBox(mid, (lo - mid) * (1.0 / scale), (hi - mid) * (1.0 / scale), kBody, HP_Body);
}

// Between vertices the mesh takes a press (for a selection box) but claims
// no hover: overlays under it still light up, and the mesh does not.
HandleHit MeshControl::HoverHit(PreviewInfo &info)
{
    const HandleHit hit = HandleOverlay::HoverHit(info);
    return hit.part == kVertex ? hit : HandleHit();
}

MeshMoveRules MeshControl::RulesFor(const PreviewInfo &info) const
{
    MeshMoveRules r = mLook.rules;
    const float64 w = std::max(info.ImageWidth, 1), h = std::max(info.ImageHeight, 1);
    if (mLook.snapToGrid) {
        r.snapX = mLook.snapSpacing / w;
        r.snapY = mLook.snapSpacing / h;
    } else if (mLook.snapToPixels) {
        r.snapX = 1.0 / w;
        r.snapY = 1.0 / h;
    }
    r.falloffX = mLook.falloff / w;
    r.falloffY = mLook.falloff / h;
    return r;
}

void MeshControl::Select(int32 vertex, bool add)
{
    uint8 &flag = mSelected[std::size_t(vertex)];
    if (add) {
        flag = !flag;
    } else if (!flag) {
        std::fill(mSelected.begin(), mSelected.end(), uint8(0));
        flag = 1;
    }
}

void MeshControl::SelectBox()
{
    if (!mBoxAdds)
        std::fill(mSelected.begin(), mSelected.end(), uint8(0));
    for (const int32 i : MeshEdit::InBox(mMesh, mBoxFrom - mOffset, mBoxTo - mOffset))
        mSelected[std::size_t(i)] = 1;
}

DragType MeshControl::ControlDown(PreviewInfo *info, const OrbPointI &mouse, const TagList *tags)
{
    if (info->HotControl)
        return HandleOverlay::ControlDown(info, mouse, tags);
    const HandleHit hit = PressHit(*info);
    if (!hit)
        return HandleOverlay::ControlDown(info, mouse, tags);
    const bool shift = KeyModifiers() & Qt::ShiftModifier;
    if (hit.part == kVertex) {
        Select(hit.item, shift);
        mDragFrom = mMesh;
        mDelta = OrbPoint();
        mLastMouse = info->MouseInViewer();
        mDragType = DRAG_Handle;
    } else {
        // Between vertices: a box to select by, or a click that clears.
        mBoxFrom = mBoxTo = OrbPoint(info->MouseX, info->MouseY);
        mBoxAdds = shift;
        mBoxing = mLook.boxSelect;
        if (!mBoxing && !shift)
            std::fill(mSelected.begin(), mSelected.end(), uint8(0));
        mDragType = DRAG_MeshBox;
    }
    Pick(hit);
    Redraw();
    return HandleOverlay::ControlDown(info, mouse, tags);
}

void MeshControl::ControlMove(PreviewInfo *info, const OrbPointI &mouse, const TagList *tags)
{
    HandleOverlay::ControlMove(info, mouse, tags);
    if (mDragType == DRAG_MeshBox && mBoxing) {
        mBoxTo = OrbPoint(info->MouseX, info->MouseY);
        Redraw();
        return;
    }
    if (mDragType != DRAG_Handle)
        return;
    // Each move adds its own step, so that Ctrl slows the drag from where
    // it is pressed rather than jumping back.
    const OrbPoint now = info->MouseInViewer();
    const OrbPoint step = info->TransformIn(now) - info->TransformIn(mLastMouse);
    mLastMouse = now;
    const bool fine = KeyModifiers() & Qt::ControlModifier;
    mDelta = mDelta + step * (fine ? mLook.fineFactor : 1.0);
    if (!OV::Finite(mDelta))
        return;
    WriteMesh(MeshEdit::Moved(mDragFrom, mSelected, mDelta, RulesFor(*info)), "Move Mesh Points");
}

void MeshControl::ControlUp(PreviewInfo *info, const OrbPointI &mouse, const TagList *tags)
{
    if (mDragType == DRAG_MeshBox && mBoxing) {
        // A box too small to see is a click between vertices: it clears.
        const OrbPoint a = info->TransformOut(mBoxFrom), b = info->TransformOut(mBoxTo);
        if (std::fabs(a.x - b.x) < 2 && std::fabs(a.y - b.y) < 2)
            mBoxTo = mBoxFrom;
        SelectBox();
        mBoxing = false;
        Redraw();
    }
    HandleOverlay::ControlUp(info, mouse, tags);
}

// Writes the mesh where some vertex moved by more than the change
// threshold; the first write of a gesture opens its undo step.
bool MeshControl::WriteMesh(const MeshGrid &mesh, const char *gesture)
{
    bool moved = mesh.cols != mMesh.cols || mesh.rows != mMesh.rows;
    for (std::size_t i = 0; !moved && i < mesh.points.size(); ++i)
        moved = Moved(mesh.points[i].x, mMesh.points[i].x) || Moved(mesh.points[i].y, mMesh.points[i].y);
    if (!moved || !GetMainInput())
        return false;
    OpenGesture(gesture);
    const AutoScriptValParam value(mesh.ToScript());
    return SetInputs(value.get(), GetCurrentTime(), 0, nullptr);
}

void MeshControl::Nudge(const PreviewInfo &info, uint64 key)
{
    const float64 step = mLook.nudgeStep;
    const OrbPoint delta =
        NudgeOffset(key, step / std::max(info.ImageWidth, 1), step / std::max(info.ImageHeight, 1), KeyModifiers());
    WriteMesh(MeshEdit::Moved(mMesh, mSelected, delta, RulesFor(info)), "Nudge Mesh Points");
}

uint64 MeshControl::ControlCommand(PreviewInfo *info, const OrbID &command, uint64 data, const TagList *tags)
{
    const bool editable = Shows() && !mLook.readOnly;
    if (command == CCMD_NeedsKey)
        return editable && IsArrowKey(data) ? 1 : 0;
    if (command == CCMD_KeyDown && editable && IsArrowKey(data)) {
        Nudge(*info, data);
        HandleOverlay::ControlCommand(info, command, data, tags);
        return 1;
    }
    if (command == CCMD_KeyUpAll) {
        // The writes' own level first, then the nudges' named step.
        ResetUndo(nullptr);
        CloseGesture();
    }
    return HandleOverlay::ControlCommand(info, command, data, tags);
}

} // namespace Orbane
