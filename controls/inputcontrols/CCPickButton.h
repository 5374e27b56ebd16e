#pragma once

#include "orbane/CustomButton.h"

#include <QCursor>
#include <QPoint>

namespace Orbane {

// A button to pick with: the user presses the left button on it, drags over
// another widget of the application and releases there. The widget under the
// release point gets the host notification kPickEvent (parameter 2: the
// point in its coordinates, x in the low 16 bits, y in the next 16), and
// the button emits Picked with the widget and that point.
class CCPickButton : public CustomButton
{
    Q_OBJECT
public:
    static constexpr uint32 kPickEvent = 5147;

    explicit CCPickButton(QWidget *parent = nullptr);
    ~CCPickButton() override;

    void SetPickEnabled(bool enabled) { mPickEnabled = enabled; }
    bool IsPickEnabled() const { return mPickEnabled; }
    bool IsPicking() const { return mPicking; }
    const QCursor &GetPickCursor() const { return mPickCursor; }
    void SetPickCursor(const QCursor &cursor) { mPickCursor = cursor; }

    // The point packed as the notification carries it.
    static uint64 PackPoint(const QPoint &p) noexcept { return uint64(uint16(p.x())) | uint64(uint16(p.y())) << 16; }

signals:
    void Picked(QWidget *target, QPoint pos);

protected:
    // A pick starts (the press) and ends; `target` is null where the
    // release was over no widget of the application.
    virtual void PickStarted();
    virtual void PickFinished(QWidget *target, const QPoint &pos);

    void mousePressEvent(QMouseEvent *event) override;
    void mouseReleaseEvent(QMouseEvent *event) override;

private:
    QWidget *TargetAt(const QPoint &global) const;

    bool mPicking = false;
    bool mPickEnabled = false;
    QCursor mPickCursor;
    void *mReserved = nullptr;
};

} // namespace Orbane
