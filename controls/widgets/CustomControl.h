#pragma once

#include "orbane/Object.h"
#include "orbane/OrbRectT.h"

#include <QColor>
#include <QWidget>

class QPainter;

namespace Orbane {

class DIB;
class InputControl;

// The two roots of every painted widget, in this order: the host Object, so
// that the script-visible root sits at the start of the object, then
// QWidget. No Q_OBJECT here; moc sees the class as a QWidget subclass through
// its second base.
class _CustomControl : public Object, public QWidget
{
public:
    _CustomControl(const Registry *reg, const ScriptVal &args, const TagList &tags);
    ~_CustomControl() override;
};

// The base of the hand-painted inspector widgets. Subclasses paint into an
// off-screen image kept while the widget's size and pixel ratio stay, between
// BeginDraw and EndDraw in their paintEvent; only the damaged rectangle is
// copied to the screen. The widget never writes Inputs: the input control
// that owns it does.
class CustomControl : public _CustomControl
{
    Q_OBJECT
public:
    // A notification passed on to the parent widget (see HandleNotify).
    static constexpr uint32 NOTIFY_ToParent = 5173;

    CustomControl(const Registry *reg, const ScriptVal &args, const TagList &tags);
    ~CustomControl() override;

    std::size_t SizeOf() const override { return sizeof(CustomControl); }

    virtual void SetOwner(InputControl *owner);
    virtual void GetSize(int32 &width, int32 &height);
    // Called on every resize and before every paint with the current size.
    virtual void OnSize(int32 width, int32 height);
    virtual void SetDisabled(bool disabled);
    // Host notifications that arrive as OrbaneEvents; answers 5173 by handing
    // it to the parent widget, everything else with 0.
    virtual uint64 HandleNotify(uint32 id, uint64 param1, uint64 param2);

    InputControl *GetOwner() const noexcept { return mOwner; }
    bool IsDisabled() const noexcept { return mDisabled; }
    // Opaque widgets fill the back buffer with the background before every
    // paint; transparent ones clear it and let the parent show through.
    void SetOpaque(bool opaque);
    bool IsOpaque() const noexcept { return mOpaque; }
    const DIB *GetBackBuffer() const noexcept { return mBackBuffer; }
    const OrbRectT<int32> &GetDrawRect() const noexcept { return mDrawRect; }

protected:
    // Prepares the back buffer for painting `rect`; false: nothing to paint.
    bool BeginDraw(const QRect &rect);
    // Copies the rectangle being painted from the back buffer to the screen.
    void EndDraw();
    QPainter *BackPainter() const noexcept { return mBackPainter; }
    QColor BackgroundColor() const;

    // What the widget asks of its owner; each does nothing without one.
    void OwnerResetUndo();
    void OwnerUpdateDisplay();
    // The document's automatic proxy while a drag lasts, and the render that
    // follows it; only for owners whose Inputs are not all passive.
    void OwnerAutoProxy(bool on);
    void OwnerSyncRender();

    void customEvent(QEvent *event) override;
    void focusInEvent(QFocusEvent *event) override;
    void focusOutEvent(QFocusEvent *event) override;
    void resizeEvent(QResizeEvent *event) override;
    void showEvent(QShowEvent *event) override;

    InputControl *mOwner = nullptr;
    bool mDisabled = false;
    bool mReserved = false;
    OrbRectT<int32> mDrawRect;
    DIB *mBackBuffer = nullptr;
    QPainter *mBackPainter = nullptr;
    bool mOpaque = true;

private:
    void MakeBackBuffer(int32 width, int32 height, qreal ratio);
};

} // namespace Orbane
