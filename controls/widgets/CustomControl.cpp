#include "widgets/CustomControl.h"

#include "orbane/DIB.h"
#include "orbane/InputControl.h"
#include "orbane/OrbaneDoc.h"
#include "orbane/OrbaneEvent.h"

#include <QPainter>
#include <QPointer>
#include <QResizeEvent>

namespace Orbane {

_CustomControl::_CustomControl(const Registry *reg, const ScriptVal &args, const TagList &tags)
    : Object(reg, args, tags), QWidget(nullptr)
{
}

_CustomControl::~_CustomControl() = default;

CustomControl::CustomControl(const Registry *reg, const ScriptVal &args, const TagList &tags)
    : _CustomControl(reg, args, tags)
{
    setAttribute(Qt::WA_OpaquePaintEvent);
    setAttribute(Qt::WA_NoSystemBackground);
}

CustomControl::~CustomControl()
{
    delete mBackPainter;
    if (mBackBuffer)
        mBackBuffer->Recycle();
}

void CustomControl::SetOwner(InputControl *owner)
{
    mOwner = owner;
}

void CustomControl::GetSize(int32 &width, int32 &height)
{
    width = rect().width();
    height = rect().height();
}

void CustomControl::OnSize(int32, int32) {}

void CustomControl::SetDisabled(bool disabled)
{
    if (disabled == mDisabled)
        return;
    mDisabled = disabled;
    update();
}

uint64 CustomControl::HandleNotify(uint32 id, uint64 param1, uint64 param2)
{
    if (id != NOTIFY_ToParent || !parentWidget())
        return 0;
    return OrbaneEvent::Send(parentWidget(), id, param1, param2);
}

void CustomControl::SetOpaque(bool opaque)
{
    mOpaque = opaque;
    setAttribute(Qt::WA_OpaquePaintEvent, opaque);
}

void CustomControl::MakeBackBuffer(int32 width, int32 height, qreal ratio)
{
    if (mBackBuffer && mBackBuffer->Width() == width && mBackBuffer->Height() == height &&
        mBackBuffer->PixelRatio() == ratio)
        return;
    delete mBackPainter;
    mBackPainter = nullptr;
    if (mBackBuffer)
        mBackBuffer->Recycle();
    mBackBuffer = new DIB(width, height, ratio);
    mBackPainter = new QPainter(&mBackBuffer->GetImage());
}

bool CustomControl::BeginDraw(const QRect &rect)
{
    // Inside a paint event Qt has already left out what is hidden, so the
    // event's rectangle is visible; visibleRegion() would walk every sibling
    // up the parents (every row of an inspector) on each paint to say so.
    if (!testAttribute(Qt::WA_WState_InPaintEvent) && visibleRegion().isEmpty())
        return false;
    mDrawRect = OrbRectT<int32>(rect.left(), rect.top(), rect.left() + rect.width(), rect.top() + rect.height());
    if (rect.isEmpty())
        return false;
    int32 width = 0, height = 0;
    GetSize(width, height);
    OnSize(width, height);
    if (width >= 1 && height >= 1)
        MakeBackBuffer(width, height, devicePixelRatioF());
    if (!mBackBuffer)
        return false;
    if (mOwner && mBackPainter->font() != mOwner->font())
        mBackPainter->setFont(mOwner->font());
    const QColor background = BackgroundColor();
    mBackBuffer->SetAntiAlias(false);
    mBackPainter->setRenderHint(QPainter::Antialiasing, false);
    // Only the damaged rectangle reaches the screen, so only it is cleared
    // and drawn.
    mBackPainter->setClipRect(rect);
    mBackPainter->setCompositionMode(QPainter::CompositionMode_Source);
    mBackPainter->fillRect(rect, mOpaque ? QColor(background.red(), background.green(), background.blue())
                                         : QColor(Qt::transparent));
    mBackPainter->setCompositionMode(QPainter::CompositionMode_SourceOver);
    return true;
}

void CustomControl::EndDraw()
{
    if (!mBackBuffer || mDrawRect.Width() <= 0 || mDrawRect.Height() <= 0)
        return;
    const QRect rect(mDrawRect.x1, mDrawRect.y1, mDrawRect.Width(), mDrawRect.Height());
    QPainter painter(this);
    if (mOpaque)
        painter.setCompositionMode(QPainter::CompositionMode_Source);
    mBackBuffer->Merge(painter, rect, rect, 1.0, OrbColor());
}

QColor CustomControl::BackgroundColor() const
{
    if (mOwner)
        return mOwner->GetBackgroundColor();
    // The widget's palette is the application's, which the theme sets.
    return palette().color(QPalette::Window);
}

void CustomControl::OwnerResetUndo()
{
    if (mOwner)
        mOwner->ResetUndo(nullptr);
}

void CustomControl::OwnerUpdateDisplay()
{
    if (!mOwner)
        return;
    // Focus also changes while the owner is being destroyed (its window
    // closes around it), when it must not be called; the next turn of the
    // event loop finds it either alive or gone.
    QPointer<InputControl> owner(mOwner);
    QMetaObject::invokeMethod(
        this,
        [owner] {
            if (owner)
                owner->UpdateDisplay(nullptr, nullptr);
        },
        Qt::QueuedConnection);
}

void CustomControl::OwnerAutoProxy(bool on)
{
    if (mOwner && !mOwner->AllInputsPassive())
        if (OrbaneDoc *doc = mOwner->GetDoc())
            doc->SetAutoProxy(on);
}

void CustomControl::OwnerSyncRender()
{
    if (mOwner && !mOwner->AllInputsPassive())
        if (OrbaneDoc *doc = mOwner->GetDoc())
            doc->SyncRender();
}

void CustomControl::customEvent(QEvent *event)
{
    if (event->type() == OrbaneEvent::EventType()) {
        auto *notify = static_cast<OrbaneEvent *>(event);
        if (!notify->IsHandled()) {
            const uint64 result = HandleNotify(notify->ID(), notify->Param1(), notify->Param2());
            notify->SetHandled();
            notify->SetResult(result);
        }
    }
    QWidget::customEvent(event);
}

void CustomControl::focusInEvent(QFocusEvent *event)
{
    QWidget::focusInEvent(event);
    OwnerUpdateDisplay();
}

void CustomControl::focusOutEvent(QFocusEvent *event)
{
    QWidget::focusOutEvent(event);
    OwnerUpdateDisplay();
}

void CustomControl::resizeEvent(QResizeEvent *event)
{
    OnSize(event->size().width(), event->size().height());
}

void CustomControl::showEvent(QShowEvent *event)
{
    setAttribute(Qt::WA_OpaquePaintEvent, mOpaque);
    QWidget::showEvent(event);
}

} // namespace Orbane
