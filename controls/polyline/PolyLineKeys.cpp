#include "polyline/PolyLineKeys.h"

#include "polyline/PolyLineMenu.h"

namespace Orbane {

namespace {

constexpr Qt::KeyboardModifiers kCounted = Qt::ShiftModifier | Qt::ControlModifier | Qt::AltModifier;

bool Always(int key)
{
    switch (key) {
    case Qt::Key_O:
    case Qt::Key_X:
    case Qt::Key_Left:
    case Qt::Key_Up:
    case Qt::Key_Right:
    case Qt::Key_Down:
    case Qt::Key_Shift:
    case Qt::Key_Control:
        return true;
    default:
        return false;
    }
}

bool Plain(int key)
{
    switch (key) {
    case Qt::Key_E:
    case Qt::Key_V:
    case Qt::Key_Y:
    case Qt::Key_Tab:
    case Qt::Key_Backspace:
    case Qt::Key_Return:
    case Qt::Key_Enter:
    case Qt::Key_Delete:
    case Qt::Key_PageUp:
    case Qt::Key_PageDown:
        return true;
    default:
        return false;
    }
}

bool ShiftLetter(int key)
{
    switch (key) {
    case Qt::Key_A:
    case Qt::Key_B:
    case Qt::Key_C:
    case Qt::Key_D:
    case Qt::Key_F:
    case Qt::Key_H:
    case Qt::Key_I:
    case Qt::Key_K:
    case Qt::Key_L:
    case Qt::Key_M:
    case Qt::Key_N:
    case Qt::Key_P:
    case Qt::Key_S:
    case Qt::Key_T:
        return true;
    default:
        return false;
    }
}

PolyLineKeys::Action Cmd(int32 command, int32 arg = 0)
{
    return {PolyLineKeys::Action::Command, command, arg};
}

PolyLineKeys::Action PlainAction(int key)
{
    switch (key) {
    case Qt::Key_E:
        return Cmd(PLCMD_EditPoint);
    case Qt::Key_V:
        return Cmd(PLCMD_ToggleMarkers);
    case Qt::Key_Y:
        return Cmd(PLCMD_FlipPoints, 1);
    case Qt::Key_Tab:
        return Cmd(PLCMD_NextPoint, 1);
    case Qt::Key_Backspace:
    case Qt::Key_Delete:
        return Cmd(PLCMD_DeletePoints);
    case Qt::Key_Return:
    case Qt::Key_Enter:
        return Cmd(PLCMD_FinishMode);
    case Qt::Key_PageUp:
        return Cmd(PLCMD_NextKeyframe, -1);
    default: // Page Down
        return Cmd(PLCMD_NextKeyframe, 1);
    }
}

PolyLineKeys::Action ShiftAction(int key)
{
    switch (key) {
    case Qt::Key_A:
        return Cmd(PLCMD_SelectAll);
    case Qt::Key_B:
        return Cmd(PLCMD_ShapeBox, 0);
    case Qt::Key_C:
        return Cmd(PLCMD_Closed);
    case Qt::Key_D:
        return Cmd(PLCMD_Done);
    case Qt::Key_F:
        return Cmd(PLCMD_FollowNearby);
    case Qt::Key_H:
        return Cmd(PLCMD_ShowHandles, 0);
    case Qt::Key_I:
        return Cmd(PLCMD_InsertModify);
    case Qt::Key_K:
        return Cmd(PLCMD_ShowKeyPoints);
    case Qt::Key_L:
        return Cmd(PLCMD_Linear);
    case Qt::Key_M:
        return Cmd(PLCMD_ModifyOnly);
    case Qt::Key_N:
        return Cmd(PLCMD_PointNumbers);
    case Qt::Key_P:
        return Cmd(PLCMD_PublishPoints);
    case Qt::Key_S:
        return Cmd(PLCMD_Smooth);
    default: // T
        return Cmd(PLCMD_TagPoints);
    }
}

} // namespace

bool PolyLineKeys::Claims(int key, Qt::KeyboardModifiers mods) noexcept
{
    const Qt::KeyboardModifiers held = mods & kCounted;
    if (Always(key))
        return true;
    if (Plain(key))
        return held == Qt::NoModifier;
    if (ShiftLetter(key))
        return held == Qt::ShiftModifier;
    if (key == Qt::Key_R)
        return held & (Qt::ShiftModifier | Qt::ControlModifier);
    return false;
}

PolyLineKeys::Action PolyLineKeys::ActionOf(int key, Qt::KeyboardModifiers mods) noexcept
{
    if (!Claims(key, mods))
        return {};
    switch (key) {
    case Qt::Key_Left:
    case Qt::Key_Up:
    case Qt::Key_Right:
    case Qt::Key_Down:
        return {Action::Nudge, 0, 0};
    case Qt::Key_Shift:
    case Qt::Key_Control:
        return {};
    case Qt::Key_O:
        return Cmd(PLCMD_ClosePolygon);
    case Qt::Key_X:
        return Cmd(PLCMD_FlipPoints, 0);
    case Qt::Key_R: // Shift: the reduce-points dialog; Control: the outer points back on the inner
        return (mods & Qt::ShiftModifier) ? Cmd(PLCMD_ReducePoints) : Cmd(PLCMD_OuterReset);
    default:
        break;
    }
    return Plain(key) ? PlainAction(key) : ShiftAction(key);
}

} // namespace Orbane
