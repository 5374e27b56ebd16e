#include "orbane/PreviewControl.h"

#include "orbane/AutoParam.h"
#include "orbane/ControlCommands.h"
#include "orbane/Input.h"
#include "orbane/Operator.h"
#include "orbane/OrbaneDoc.h"
#include "orbane/Parameter.h"
#include "orbane/PreviewInfo.h"
#include "orbane/Registry.h"
#include "orbane/ScriptVal.h"

#include <algorithm>
#include <cmath>
#include <cstdio>

#include <QtGlobal>

namespace Orbane {

const OrbID PreviewControl::ClassID("PreviewControl");

PreviewControl::PreviewControl(const Registry *reg, const ScriptVal &args, const TagList &tags)
    : Object(reg, args, tags)
{
}

PreviewControl::~PreviewControl()
{
    ResetUndo(nullptr);
    for (Input *in : mInputs) {
        Unwatch(in);
        in->DecRef();
    }
    // A slot that an overlay forgot to detach must not keep calling a dead
    // object; its reference is the overlay's to drop.
    for (const auto &[in, count] : mWatched)
        in->DetachWatcher(this);
}

bool PreviewControl::SetAttrsTagList(const TagList &tags)
{
    return SetAttrsTagList(GetMainInput(), tags);
}

// --- object operations the viewer routes ---

void PreviewControl::AddToMenu(QMenu *, PreviewInfo *, const TagList *) {}

bool PreviewControl::HandleMenu(int32, PreviewInfo *, const TagList *)
{
    return false;
}

void PreviewControl::GetAvailableEvents(std::vector<ToolbarEvent> &, const TagList *) {}

bool PreviewControl::HandleEvent(const OrbID &, PreviewInfo *, const TagList *)
{
    return false;
}

// --- the preview-control operations ---

void PreviewControl::SetView(PreviewInfo *, const TagList *) {}

Operator *PreviewControl::GetOperator(const TagList *) const
{
    const Input *main = GetMainInput();
    return main ? main->GetOperator() : nullptr;
}

bool PreviewControl::SetAttrsTagList(Input *, const TagList &)
{
    Redraw();
    return true;
}

bool PreviewControl::AddInput(Input *input, const TagList *)
{
    if (!input || IndexOf(input) >= 0)
        return false;
    input->IncRef();
    mInputs.push_back(input);
    Watch(input);
    return true;
}

bool PreviewControl::RemoveInput(Input *input, const TagList *tags)
{
    const int32 index = IndexOf(input);
    if (index < 0)
        return false;
    if (index == 0)
        ResetUndo(tags);
    mInputs.erase(mInputs.begin() + index);
    Unwatch(input);
    input->DecRef();
    return true;
}

bool PreviewControl::SetInputs(Parameter *value, float64 time, uint32 index, const TagList *tags)
{
    if (!value || index >= mInputs.size())
        return false;
    // Watchers told of the write may unbind the Input from this overlay.
    const AutoRef<Input> input = AutoRef<Input>::Share(mInputs[index]);
    const Operator *tool = input->GetOperator();
    if (tool && tool->IsLocked())
        return false;
    OpenUndo();
    return input->SetValue(value, time, 0, tags);
}

void PreviewControl::NotifyChanged(Input *, Parameter *, const TagList *)
{
    Redraw();
}

void PreviewControl::UpdateDisplay(Input *, const TagList *)
{
    Redraw();
}

bool PreviewControl::OnConnect(Input *input, const TagList *)
{
    return IndexOf(input) >= 0;
}

bool PreviewControl::OnDisconnect(Input *input, const TagList *tags)
{
    ResetUndo(tags);
    return IndexOf(input) >= 0;
}

void PreviewControl::SetActive(int32 active, const TagList *)
{
    if (mActive == (active != 0))
        return;
    mActive = active != 0;
    Redraw();
}

void PreviewControl::SetInactive(const TagList *tags)
{
    SetActive(0, tags);
}

void PreviewControl::DrawControls(PreviewInfo *, const TagList *) {}

DragType PreviewControl::ControlDown(PreviewInfo *, const OrbPointI &, const TagList *)
{
    return mDragType;
}

void PreviewControl::ControlMove(PreviewInfo *, const OrbPointI &, const TagList *) {}

void PreviewControl::ControlUp(PreviewInfo *, const OrbPointI &, const TagList *tags)
{
    mDragType = DRAG_None;
    ResetUndo(tags);
}

uint64 PreviewControl::ControlCommand(PreviewInfo *, const OrbID &command, uint64 data, const TagList *)
{
    if (command == CCMD_FollowCursor) {
        mDragType = data ? DRAG_Linked : DRAG_None;
        return 1;
    }
    if (command == CCMD_HitTest)
        return data;
    return 0;
}

bool PreviewControl::ControlGetTip(PreviewInfo *, char *, const TagList *)
{
    return false;
}

void PreviewControl::ResetUndo(const TagList *)
{
    if (!mUndoOpen)
        return;
    mUndoOpen = false;
    if (mUndoDoc)
        mUndoDoc->EndUndo(true);
    mUndoDoc = nullptr;
}

void PreviewControl::SetUndo(uint32 open, const TagList *)
{
    mUndoOpen = open != 0;
    mUndoDoc = mUndoOpen ? GetDoc() : nullptr;
}

void PreviewControl::GetState(ScriptVal &state) const
{
    state.SetKey(ScriptVal("highlight"), ScriptVal(mHighlighted));
    state.SetKey(ScriptVal("dragType"), ScriptVal(int64(mDragType)));
    if (!mLastMessage.IsEmpty())
        state.SetKey(ScriptVal("message"), ScriptVal(mLastMessage.c_str()));
}

void PreviewControl::GetName(char *buffer, int32 size, const TagList *) const
{
    if (buffer && size > 0)
        std::snprintf(buffer, std::size_t(size), "%s", GetRegistry() ? GetRegistry()->Name() : "PreviewControl");
}

void PreviewControl::GetFullName(char *buffer, int32 size, Input *input, const TagList *tags) const
{
    if (!buffer || size <= 0)
        return;
    char name[128];
    GetName(name, sizeof name, tags);
    const Input *in = input ? input : GetMainInput();
    const Operator *tool = in ? in->GetOperator() : nullptr;
    if (!in)
        std::snprintf(buffer, std::size_t(size), "%s", name);
    else
        std::snprintf(buffer, std::size_t(size), "%s.%s (%s)", tool ? tool->GetName() : "", in->GetID().c_str(), name);
}

bool PreviewControl::HoverBounds(const PreviewInfo &, OrbRect &) const
{
    return false;
}

// --- what overlays use of the base ---

bool PreviewControl::AttachToInput(Input *&slot, Operator *tool, const TagList &tags, Tag ptrTag, Tag idTag,
                                   uint32 flags, uint32 flags2)
{
    // Attributes that do not speak of the link keep it.
    if (!tags.FindQuery(ptrTag) && !tags.FindQuery(idTag))
        return slot != nullptr;
    // The pointer tag carries the Input's address as a ScriptObject.
    Input *found = dynamic_cast<Input *>(static_cast<ScriptObject *>(tags.GetPtr(ptrTag)));
    if (!found && tool) {
        const OrbID id = tags.GetID(idTag);
        if (!id.IsEmpty())
            found = tool->FindInput(id);
    }
    if (found == slot)
        return found != nullptr;
    DetachFromInput(slot);
    if (!found)
        return false;
    found->IncRef();
    slot = found;
    if ((flags | flags2) & ATTACH_Watch)
        Watch(found);
    return true;
}

void PreviewControl::DetachFromInput(Input *&slot)
{
    if (!slot)
        return;
    Unwatch(slot);
    slot->DecRef();
    slot = nullptr;
}

OrbaneDoc *PreviewControl::GetDoc() const
{
    const Input *main = GetMainInput();
    return main ? main->GetDoc() : nullptr;
}

float64 PreviewControl::GetCurrentTime() const
{
    const OrbaneDoc *doc = GetDoc();
    return doc ? doc->GetCurrentTime() : 0.0;
}

void PreviewControl::SetDisplayOffset(float64 x, float64 y)
{
    if (x == mDisplayOffsetX && y == mDisplayOffsetY)
        return;
    mDisplayOffsetX = x;
    mDisplayOffsetY = y;
    Redraw();
}

const OrbID PreviewControl::ToolbarSeparator("ToolbarSeparator");
const OrbID PreviewControl::ToolbarPopDown("ToolbarPopDown");

void PreviewControl::Tell(const char *message)
{
    mLastMessage = message;
    if (mTell)
        mTell(this, message);
    else
        qInfo("%s", message);
}

void PreviewControl::Redraw()
{
    if (mRedraw)
        mRedraw(this);
}

bool PreviewControl::Moved(float64 a, float64 b) noexcept
{
    return std::fabs(a - b) > ChangeThreshold;
}

void PreviewControl::ActivateOverlaysOf(Input *input)
{
    if (!input)
        return;
    const LockableObject::ReadGuard lock(*input);
    const std::vector<InputWatcher *> &watchers = input->Watchers();
    // By index: an overlay switched on may in turn switch on others.
    for (std::size_t i = 0; i < watchers.size(); ++i) {
        auto *overlay = dynamic_cast<PreviewControl *>(watchers[i]);
        if (overlay && !overlay->IsActive())
            overlay->SetActive(1, nullptr);
    }
}

bool PreviewControl::RegCleanup(Registry *reg)
{
    return Object::RegCleanup(reg);
}

void PreviewControl::OnInputChanged(Input *input, Parameter *value, const TagList *tags)
{
    NotifyChanged(input, value, tags);
}

int32 PreviewControl::IndexOf(const Input *input) const
{
    const auto it = std::find(mInputs.begin(), mInputs.end(), input);
    return it == mInputs.end() ? -1 : int32(it - mInputs.begin());
}

// An Input may be both bound and held in a slot (a chain that links back to
// itself): it is watched once and let go when the last use goes.
void PreviewControl::Watch(Input *input)
{
    for (auto &[in, count] : mWatched)
        if (in == input) {
            ++count;
            return;
        }
    mWatched.emplace_back(input, 1);
    input->AttachWatcher(this);
}

void PreviewControl::Unwatch(Input *input)
{
    for (auto it = mWatched.begin(); it != mWatched.end(); ++it)
        if (it->first == input) {
            if (--it->second == 0) {
                input->DetachWatcher(this);
                mWatched.erase(it);
            }
            return;
        }
}

void PreviewControl::OpenUndo()
{
    if (mUndoOpen)
        return;
    OrbaneDoc *doc = GetDoc();
    if (!doc)
        return;
    const Input *main = GetMainInput();
    doc->StartUndo(("Change " + std::string(main->GetName())).c_str());
    SetUndo(1, nullptr);
}

} // namespace Orbane
