#pragma once

#include "orbane/AutoParam.h"
#include "orbane/ControlCommands.h"
#include "orbane/GPainter.h"
#include "orbane/Point.h"
#include "orbane/PreviewControl.h"
#include "orbane/PreviewInfo.h"

#include <QAction>
#include <QMenu>

#include <algorithm>
#include <cmath>
#include <string>
#include <vector>

namespace Orbane {
namespace Test {

// A 7-pixel square at its Input's point that drags, claims the space key,
// offers a menu entry, links to a second Input and logs the viewer's calls.
class TestOverlay : public PreviewControl
{
public:
    static constexpr Tag TO_Link = 0x80068000;
    static constexpr Tag TO_LinkObject = 0x60068000;
    static constexpr int32 kMenuID = 7;
    static inline int destroyed = 0;

    using PreviewControl::PreviewControl;
    ~TestOverlay() override
    {
        DetachFromInput(link);
        ++destroyed;
    }

    std::size_t SizeOf() const override { return sizeof(TestOverlay); }

    using PreviewControl::SetAttrsTagList;
    bool SetAttrsTagList(Input *input, const TagList &tags) override
    {
        Log("SetAttrs");
        const Input *main = GetMainInput();
        linked = AttachToInput(link, main ? main->GetOperator() : nullptr, tags, TO_LinkObject, TO_Link, ATTACH_Watch,
                               ATTACH_Watch);
        return PreviewControl::SetAttrsTagList(input, tags);
    }
    bool AddInput(Input *input, const TagList *tags) override
    {
        Log("AddInput");
        return PreviewControl::AddInput(input, tags);
    }
    bool RemoveInput(Input *input, const TagList *tags) override
    {
        Log("RemoveInput");
        return PreviewControl::RemoveInput(input, tags);
    }
    void NotifyChanged(Input *input, Parameter *value, const TagList *tags) override
    {
        Log(input == link ? "NotifyLink" : "Notify");
        if (const auto *p = dynamic_cast<const Point *>(value); p && input == GetMainInput())
            at = OrbPoint(p->X, p->Y);
        PreviewControl::NotifyChanged(input, value, tags);
    }
    void SetActive(int32 active, const TagList *tags) override
    {
        Log(active ? "SetActive" : "SetInactive");
        PreviewControl::SetActive(active, tags);
        if (active)
            ActivateOverlaysOf(link);
    }
    void DrawControls(PreviewInfo *info, const TagList *tags) override
    {
        passes.push_back(info->DrawPass);
        if (Graphics::GPainter *p = info->GetPainter()) {
            const OrbPoint s = info->TransformOut(at);
            p->Color(Graphics::GColor(1, 0, 0), Graphics::GColor());
            p->Rectangle(s.x - 3, s.y - 3, s.x + 4, s.y + 4);
        }
        PreviewControl::DrawControls(info, tags);
    }
    DragType ControlDown(PreviewInfo *info, const OrbPointI &mouse, const TagList *tags) override
    {
        pressFlags = tags ? tags->GetLong(PCA_EventFlags, -1) : -1;
        if (info->HotControl) {
            if (link && info->HotControl->GetMainInput() == link)
                mDragType = DRAG_Linked;
        } else if (Hit(*info)) {
            grab = info->TransformOut(at) - info->TransformOut(info->MouseX, info->MouseY);
            mDragType = DRAG_Handle;
        }
        return PreviewControl::ControlDown(info, mouse, tags);
    }
    void ControlMove(PreviewInfo *info, const OrbPointI &mouse, const TagList *tags) override
    {
        PreviewControl::ControlMove(info, mouse, tags);
        Log(mDragType == DRAG_Linked ? "MoveLinked" : "Move");
        if (mDragType != DRAG_Handle)
            return;
        const OrbPoint to = info->TransformIn(info->TransformOut(info->MouseX, info->MouseY) + grab);
        AutoPoint value(to.x, to.y, 0.0);
        SetInputs(value.get(), GetCurrentTime(), 0, nullptr);
    }
    uint64 ControlCommand(PreviewInfo *info, const OrbID &command, uint64 data, const TagList *tags) override
    {
        Log(command.c_str());
        if (command == CCMD_HitTest) {
            const bool wasHover = hover;
            hover = !(data & 1) && Hit(*info);
            return data | (hover ? 1 : 0) | (hover != wasHover ? 2 : 0);
        }
        if (command == CCMD_NeedsKey)
            return data == Qt::Key_Space ? 1 : 0;
        if (command == CCMD_KeyDown)
            modifiers.push_back(KeyModifiers());
        if (command == CCMD_GetInputAt && Hit(*info))
            return uint64(reinterpret_cast<uintptr_t>(GetMainInput()));
        return PreviewControl::ControlCommand(info, command, data, tags);
    }
    void AddToMenu(QMenu *menu, PreviewInfo *info, const TagList *tags) override
    {
        menu->addAction(QString("Test %1").arg(GetMainInput()->GetID().c_str()))->setData(kMenuID);
        PreviewControl::AddToMenu(menu, info, tags);
    }
    bool HandleMenu(int32 id, PreviewInfo *, const TagList *) override
    {
        menuIDs.push_back(id);
        return true;
    }

    int Count(const std::string &call) const { return int(std::count(calls.begin(), calls.end(), call)); }
    void Log(const std::string &call) { calls.push_back(call); }
    bool Hit(const PreviewInfo &info) const
    {
        const OrbPoint d = info.TransformOut(at) - info.TransformOut(info.MouseX, info.MouseY);
        return std::fabs(d.x) < info.PickTolerance && std::fabs(d.y) < info.PickTolerance;
    }

    OrbPoint at{0.5, 0.5};
    OrbPoint grab;
    Input *link = nullptr;
    bool linked = false;
    bool hover = false;
    int64 pressFlags = -1;
    std::vector<std::string> calls;
    std::vector<int32> passes;
    std::vector<int32> menuIDs;
    std::vector<Qt::KeyboardModifiers> modifiers;
};

} // namespace Test
} // namespace Orbane
