// The viewer's hands: mouse, keys, context menu and tips, routed to the
// overlays of the shown tool.
#include "orbane/ViewerPanel.h"

#include "HoverIndex.h"

#include "orbane/ControlCommands.h"

#include <QContextMenuEvent>
#include <QHelpEvent>
#include <QKeyEvent>
#include <QMenu>
#include <QMouseEvent>
#include <QToolTip>
#include <QWheelEvent>

#include <algorithm>
#include <cmath>

namespace Orbane {

namespace {

void CollectActions(QMenu *menu, std::vector<QAction *> &out)
{
    for (QAction *action : menu->actions()) {
        out.push_back(action);
        if (action->menu())
            CollectActions(action->menu(), out);
    }
}

} // namespace

// --- routing ---

OrbPointI ViewerPanel::SetMouse(QPointF widget)
{
    mLastMouse = widget;
    const OrbPoint viewer = Mapping().WidgetToViewer({widget.x(), widget.y()});
    mInfo.SetMouseFromViewer(viewer);
    return OrbPointI(int32(std::lround(viewer.x)), int32(std::lround(viewer.y)));
}

// Switched-on overlays, the topmost (last drawn) first.
std::vector<PreviewControl *> ViewerPanel::ByPriority() const
{
    std::vector<PreviewControl *> order;
    for (auto it = mOverlays.rbegin(); it != mOverlays.rend(); ++it)
        if ((*it)->IsActive())
            order.push_back(*it);
    return order;
}

bool ViewerPanel::IsOverlay(const PreviewControl *overlay) const
{
    return overlay && std::find(mOverlays.begin(), mOverlays.end(), overlay) != mOverlays.end();
}

void ViewerPanel::Hover()
{
    mInfo.HotControl = nullptr;
    const OrbRect visible(0.0, 0.0, width(), height());
    const HoverIndex::Result walk =
        mPlainHover ? HoverIndex::PlainHover(mOverlays, mInfo) : mHoverIndex->Hover(mOverlays, mInfo, visible);
    mHover = walk.hover;
    mHoverAsked = walk.asked;
    if (walk.redraw)
        RequestRedraw();
}

// The first overlay that answers a drag type is hot; the others are then
// told of it, and those that answer one too are dragged along.
void ViewerPanel::Press(const TagList &tags)
{
    // A press acts on what the user sees: draw what is pending first.
    if (mDirty && isVisible())
        repaint();
    const OrbPointI mouse = SetMouse(mLastMouse);
    mInfo.HotControl = nullptr;
    const std::vector<PreviewControl *> order = ByPriority();
    for (PreviewControl *overlay : order)
        if (overlay->ControlDown(&mInfo, mouse, &tags) != DRAG_None) {
            mHot = overlay;
            break;
        }
    if (!mHot)
        return;
    mLastPressed = mHot;
    mDragging = {mHot};
    mInfo.HotControl = mHot;
    for (PreviewControl *overlay : order)
        if (overlay != mHot && overlay->ControlDown(&mInfo, mouse, &tags) != DRAG_None)
            mDragging.push_back(overlay);
    RequestRedraw();
}

void ViewerPanel::Drag()
{
    const OrbPointI mouse = SetMouse(mLastMouse);
    mInfo.HotControl = mHot;
    const std::vector<PreviewControl *> dragging = mDragging;
    for (PreviewControl *overlay : dragging)
        if (IsOverlay(overlay))
            overlay->ControlMove(&mInfo, mouse, nullptr);
}

// Every overlay that was pressed hears the release, so none keeps state of
// a press that went elsewhere.
void ViewerPanel::Release()
{
    const OrbPointI mouse = SetMouse(mLastMouse);
    for (PreviewControl *overlay : ByPriority())
        overlay->ControlUp(&mInfo, mouse, nullptr);
    const bool wasDragging = !mDragging.empty();
    mDragging.clear();
    mHot = nullptr;
    mInfo.HotControl = nullptr;
    if (wasDragging)
        RequestRedraw();
    Hover();
}

bool ViewerPanel::BeginFollowCursor(PreviewControl *overlay, const TagList &attrs)
{
    if (!IsOverlay(overlay))
        return false;
    TagList follow = attrs;
    follow.Set(PCA_FollowCursor, 1);
    overlay->SetAttrsTagList(follow);
    overlay->ControlCommand(&mInfo, CCMD_FollowCursor, 1, nullptr);
    mFollower = overlay;
    RequestRedraw();
    return true;
}

// --- the mouse ---

void ViewerPanel::mousePressEvent(QMouseEvent *event)
{
    SetMouse(event->localPos());
    if (event->button() == Qt::MiddleButton) {
        mPanning = true;
        mPanFrom = event->localPos();
    } else if (event->button() == Qt::LeftButton && !mFollower) {
        Press(TagList{{PCA_EventFlags, mPressFlags}});
    }
    event->accept();
}

void ViewerPanel::mouseMoveEvent(QMouseEvent *event)
{
    if (mPanning) {
        const QPointF delta = event->localPos() - mPanFrom;
        mPanFrom = event->localPos();
        PanBy({delta.x(), -delta.y()});
        return;
    }
    const OrbPointI mouse = SetMouse(event->localPos());
    if (mFollower)
        mFollower->ControlMove(&mInfo, mouse, nullptr);
    else if (!mDragging.empty())
        Drag();
    else if (!(event->buttons() & Qt::LeftButton))
        Hover();
}

void ViewerPanel::mouseReleaseEvent(QMouseEvent *event)
{
    const OrbPointI mouse = SetMouse(event->localPos());
    if (event->button() == Qt::MiddleButton) {
        mPanning = false;
    } else if (event->button() == Qt::LeftButton && mFollower) {
        PreviewControl *follower = std::exchange(mFollower, nullptr);
        follower->ControlUp(&mInfo, mouse, nullptr);
        RequestRedraw();
    } else if (event->button() == Qt::LeftButton) {
        Release();
    }
}

void ViewerPanel::wheelEvent(QWheelEvent *event)
{
    const OrbPoint anchor = Mapping().WidgetToViewer({event->position().x(), event->position().y()});
    ZoomAbout(WheelZoom(Mapping().Zoom(), event->angleDelta().y()), anchor);
    event->accept();
}

// --- keys ---

PreviewControl *ViewerPanel::UnderMouse()
{
    if (IsOverlay(mHover) && mHover->IsActive())
        return mHover;
    SetMouse(mLastMouse);
    for (PreviewControl *overlay : ByPriority())
        if (overlay->ControlCommand(&mInfo, CCMD_GetInputAt, 0, nullptr))
            return overlay;
    return nullptr;
}

PreviewControl *ViewerPanel::KeyTarget(int key)
{
    const auto wants = [this, key](PreviewControl *o) {
        return o && o->ControlCommand(&mInfo, CCMD_NeedsKey, uint64(key), nullptr) != 0;
    };
    if (mKeyOwner)
        return wants(mKeyOwner) ? mKeyOwner : nullptr;
    std::vector<PreviewControl *> candidates{UnderMouse()};
    if (IsOverlay(mLastPressed) && mLastPressed->IsActive())
        candidates.push_back(mLastPressed);
    for (PreviewControl *overlay : ByPriority())
        candidates.push_back(overlay);
    for (PreviewControl *overlay : candidates)
        if (wants(overlay))
            return mKeyOwner = overlay;
    return nullptr;
}

void ViewerPanel::keyPressEvent(QKeyEvent *event)
{
    if (!event->isAutoRepeat())
        mHeldKeys.insert(event->key());
    PreviewControl *target = KeyTarget(event->key());
    if (!target)
        return QWidget::keyPressEvent(event);
    target->ControlCommand(&mInfo, CCMD_KeyDown, uint64(event->key()), nullptr);
    event->accept();
}

void ViewerPanel::keyReleaseEvent(QKeyEvent *event)
{
    // A held key repeats as release-and-press pairs: only the presses count.
    if (event->isAutoRepeat())
        return;
    mHeldKeys.erase(event->key());
    if (mKeyOwner && mKeyOwner->ControlCommand(&mInfo, CCMD_NeedsKey, uint64(event->key()), nullptr))
        mKeyOwner->ControlCommand(&mInfo, CCMD_KeyUp, uint64(event->key()), nullptr);
    if (mHeldKeys.empty())
        EndKeys();
}

void ViewerPanel::EndKeys()
{
    mHeldKeys.clear();
    if (PreviewControl *owner = std::exchange(mKeyOwner, nullptr))
        owner->ControlCommand(&mInfo, CCMD_KeyUpAll, 0, nullptr);
}

void ViewerPanel::focusOutEvent(QFocusEvent *event)
{
    // Keys released elsewhere are never seen here: the nudges end now.
    EndKeys();
    QWidget::focusOutEvent(event);
}

// --- context menu and tips ---

void ViewerPanel::FillContextMenu(QMenu *menu)
{
    mMenuOwners.clear();
    SetMouse(mLastMouse);
    // The overlay under the mouse offers its entries first, then the others
    // from the topmost down.
    std::vector<PreviewControl *> order = ByPriority();
    if (PreviewControl *under = UnderMouse()) {
        order.erase(std::remove(order.begin(), order.end(), under), order.end());
        order.insert(order.begin(), under);
    }
    for (PreviewControl *overlay : order) {
        std::vector<QAction *> before;
        CollectActions(menu, before);
        overlay->AddToMenu(menu, &mInfo, nullptr);
        std::vector<QAction *> after;
        CollectActions(menu, after);
        for (QAction *action : after)
            if (std::find(before.begin(), before.end(), action) == before.end())
                mMenuOwners[action] = overlay;
    }
}

bool ViewerPanel::TriggerMenuAction(QAction *action)
{
    const auto it = mMenuOwners.find(action);
    if (it == mMenuOwners.end() || !IsOverlay(it->second))
        return false;
    return it->second->HandleMenu(action->data().toInt(), &mInfo, &mCommandTags);
}

void ViewerPanel::contextMenuEvent(QContextMenuEvent *event)
{
    SetMouse(event->pos());
    QMenu menu(this);
    FillContextMenu(&menu);
    if (!menu.actions().isEmpty())
        if (QAction *chosen = menu.exec(event->globalPos()))
            TriggerMenuAction(chosen);
    mMenuOwners.clear();
}

QString ViewerPanel::TipAt(QPointF widget)
{
    SetMouse(widget);
    char tip[PreviewControl::TipSize] = {};
    for (PreviewControl *overlay : ByPriority())
        if (overlay->ControlGetTip(&mInfo, tip, nullptr))
            return QString::fromUtf8(tip);
    return QString();
}

bool ViewerPanel::event(QEvent *event)
{
    if (event->type() != QEvent::ToolTip)
        return QWidget::event(event);
    auto *help = static_cast<QHelpEvent *>(event);
    const QString tip = TipAt(help->pos());
    if (tip.isEmpty()) {
        QToolTip::hideText();
        event->ignore();
    } else {
        QToolTip::showText(help->globalPos(), tip, this);
    }
    return true;
}

} // namespace Orbane
