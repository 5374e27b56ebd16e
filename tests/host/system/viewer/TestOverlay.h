#pragma once

#include "orbane/AutoParam.h"
#include "orbane/ControlCommands.h"
#include "orbane/GPainter.h"
#include "orbane/Point.h"
#include "orbane/PreviewControl.h"
#include "orbane/PreviewInfo.h"
#include "orbane/Registry.h"
#include "orbane/RegistryList.h"

#include <QAction>
#include <QGuiApplication>
#include <QMenu>

#include <algorithm>
#include <cmath>
#include <string>
#include <vector>

namespace Orbane {
namespace Test {

// A 7-pixel square at its Input's point that drags, claims the space key,
// offers a menu entry, links to a second Input and logs the viewer's calls.
// It tells the viewer where it can be hovered, unless it fades (TO_Fades):
// then it wants every hover and redraws when the mouse's distance crosses
// a 20-pixel step.
class TestOverlay : public PreviewControl
{
public:
    static constexpr Tag TO_Link = 0x80068000;
    static constexpr Tag TO_LinkObject = 0x60068000;
    static constexpr Tag TO_Fades = 0x10068001;
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
        fades = tags.GetInt(TO_Fades, fades) != 0;
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
            const int wasStep = fadeStep;
            hover = !(data & 1) && Hit(*info);
            if (fades)
                fadeStep = std::min(3, int(Offset(*info).Length() / 20.0));
            const bool redraw = hover != wasHover || fadeStep != wasStep;
            redraws += redraw ? 1 : 0;
            return data | (hover ? 1 : 0) | (redraw ? 2 : 0);
        }
        if (command == CCMD_NeedsKey)
            return data == Qt::Key_Space ? 1 : 0;
        if (command == CCMD_KeyDown)
            modifiers.push_back(QGuiApplication::queryKeyboardModifiers());
        if (command == CCMD_GetInputAt && Hit(*info))
            return uint64(reinterpret_cast<uintptr_t>(GetMainInput()));
        return PreviewControl::ControlCommand(info, command, data, tags);
    }
    bool HoverBounds(const PreviewInfo &info, OrbRect &bounds) const override
    {
        // A pixel beyond the tolerance: Hit's comparisons round their own way.
        const OrbPoint s = info.TransformOut(at);
        const float64 r = info.PickTolerance + 1.0;
        bounds = OrbRect(s.x - r, s.y - r, s.x + r, s.y + r);
        return !fades;
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
    OrbPoint Offset(const PreviewInfo &info) const
    {
        return info.TransformOut(at) - info.TransformOut(info.MouseX, info.MouseY);
    }
    bool Hit(const PreviewInfo &info) const
    {
        const OrbPoint d = Offset(info);
        return std::fabs(d.x) < info.PickTolerance && std::fabs(d.y) < info.PickTolerance;
    }

    OrbPoint at{0.5, 0.5};
    OrbPoint grab;
    Input *link = nullptr;
    bool linked = false;
    bool hover = false;
    bool fades = false;
    int fadeStep = -1;
    int redraws = 0; // hover answers that asked for a redraw
    int64 pressFlags = -1;
    std::vector<std::string> calls;
    std::vector<int32> passes;
    std::vector<int32> menuIDs;
    std::vector<Qt::KeyboardModifiers> modifiers;
};

inline const OrbID kTestOverlayID("TestOverlay");

// Registers the class for as long as a test object lives.
struct TestOverlayClass
{
    TestOverlayClass()
    {
        reg._Init(ClassRegistry, kTestOverlayID,
                  TagList{{REG_Factory, &NewObject<TestOverlay>},
                          {REG_Kind, REGKIND_PreviewControl},
                          {REG_Name, "TestOverlay"}});
    }
    Registry reg;
};

} // namespace Test
} // namespace Orbane
