#pragma once

#include "orbane/CustomButton.h"

namespace Orbane {

// The host's painted check box: a box left of the label, ticked for state 1
// and showing a dash for the mixed state 2. Style 1 toggles 0 <-> 1, style 2
// cycles 0 -> 1 -> 2 -> 0. A click by the user emits CheckChanged with the
// new state and the click's Qt::KeyboardModifiers word (then ButtonPressed,
// as every button does); SetCheck from the program emits nothing, so a host
// can tell a user's gesture from its own display update.
class CustomCheckBox : public CustomButton
{
    Q_OBJECT
public:
    // The width kept left of the label for the box; a wrapping label has
    // the widget's width less this room and the right margin.
    static constexpr int kBoxRoom = 22;
    static constexpr int kRightMargin = 3;

    explicit CustomCheckBox(QWidget *parent = nullptr);
    ~CustomCheckBox() override;

    // Where the box is drawn, in widget coordinates.
    QRect BoxRect() const;

signals:
    void CheckChanged(int32 state, uint64 modifiers);

protected:
    void Clicked(uint64 modifiers) override;
    QMargins LabelMargins() const override;
    Qt::Alignment LabelAlignment() const override;
    void PaintFace(QPainter &p) const override;

private:
    void PaintBox(QPainter &p, const QRect &box) const;
    void PaintTick(QPainter &p, const QRect &box) const;
    void PaintDash(QPainter &p, const QRect &box) const;
};

} // namespace Orbane
