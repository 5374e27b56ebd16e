#include "orbane/CustomCheckBox.h"

#include <QPainter>
#include <QPainterPath>

#include <algorithm>

namespace Orbane {

namespace {

constexpr int kBoxSize = 14; // the box, in logical pixels
constexpr int kBoxLeft = 4;
constexpr int kPadV = 2;

} // namespace

CustomCheckBox::CustomCheckBox(QWidget *parent) : CustomButton(parent)
{
    SetStyle(Style_TwoState);
}

CustomCheckBox::~CustomCheckBox() = default;

void CustomCheckBox::Clicked(uint64 modifiers)
{
    const int32 next = NextCheck();
    if (StoreCheck(next))
        update();
    emit CheckChanged(next, modifiers);
    emit ButtonPressed(modifiers, next != 0);
}

QMargins CustomCheckBox::LabelMargins() const
{
    return QMargins(kBoxRoom, kPadV, kRightMargin, kPadV);
}

Qt::Alignment CustomCheckBox::LabelAlignment() const
{
    return Qt::AlignLeft;
}

QRect CustomCheckBox::BoxRect() const
{
    // A wrapped label keeps the box beside its first line.
    const int line = IsWrapAllowed() ? fontMetrics().height() : height() - 2 * kPadV;
    const int top = kPadV + (line - kBoxSize) / 2;
    return QRect(kBoxLeft, std::max(0, top), kBoxSize, kBoxSize);
}

void CustomCheckBox::PaintFace(QPainter &p) const
{
    const QRect box = BoxRect();
    PaintBox(p, box);
    if (GetCheck() == 1)
        PaintTick(p, box);
    else if (GetCheck() == 2)
        PaintDash(p, box);
}

void CustomCheckBox::PaintBox(QPainter &p, const QRect &box) const
{
    const bool on = GetCheck() != 0;
    QColor fill = on ? AccentColor() : palette().color(QPalette::Base);
    QColor frame = on ? AccentColor().darker(140) : FrameColor().lighter(IsHovered() ? 190 : 150);
    if (IsDown())
        fill = fill.darker(125);
    if (!isEnabled()) {
        fill.setAlphaF(0.45);
        frame.setAlphaF(0.45);
    }
    p.setRenderHint(QPainter::Antialiasing, true);
    p.setPen(QPen(frame, 1.0));
    p.setBrush(fill);
    p.drawRoundedRect(QRectF(box).adjusted(0.5, 0.5, -0.5, -0.5), 2.0, 2.0);
    if (hasFocus()) {
        p.setPen(QPen(AccentColor(), 1.0));
        p.setBrush(Qt::NoBrush);
        p.drawRoundedRect(QRectF(box).adjusted(-1.5, -1.5, 1.5, 1.5), 3.0, 3.0);
    }
    p.setRenderHint(QPainter::Antialiasing, false);
}

void CustomCheckBox::PaintTick(QPainter &p, const QRect &box) const
{
    QPainterPath tick;
    const QPointF o = box.topLeft();
    tick.moveTo(o + QPointF(3.5, 7.5));
    tick.lineTo(o + QPointF(6.0, 10.0));
    tick.lineTo(o + QPointF(10.5, 4.0));
    p.setRenderHint(QPainter::Antialiasing, true);
    p.setPen(QPen(palette().color(QPalette::Base), 2.0, Qt::SolidLine, Qt::RoundCap, Qt::RoundJoin));
    p.setBrush(Qt::NoBrush);
    p.drawPath(tick);
    p.setRenderHint(QPainter::Antialiasing, false);
}

void CustomCheckBox::PaintDash(QPainter &p, const QRect &box) const
{
    // Whole logical pixels, so the dash stays sharp at every ratio.
    const QRect dash(box.left() + 3, box.top() + box.height() / 2 - 1, box.width() - 6, 2);
    p.fillRect(dash, palette().color(QPalette::Base));
}

} // namespace Orbane
