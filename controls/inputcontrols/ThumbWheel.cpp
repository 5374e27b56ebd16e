#include "inputcontrols/ThumbWheel.h"

#include <QMouseEvent>
#include <QPainter>
#include <QWheelEvent>

#include <cmath>

namespace Orbane {

namespace {

// One notch of a mouse wheel, in the units of QWheelEvent::angleDelta.
constexpr float64 kNotchAngle = 120.0;

} // namespace

ThumbWheel::ThumbWheel(QWidget *parent) : QWidget(parent)
{
    setCursor(Qt::SizeHorCursor);
    setSizePolicy(QSizePolicy::Expanding, QSizePolicy::Fixed);
}

QSize ThumbWheel::sizeHint() const
{
    return QSize(120, 18);
}

float64 ThumbWheel::StepsFor(float64 pixels, Qt::KeyboardModifiers modifiers)
{
    if (modifiers & Qt::ControlModifier)
        return pixels * 0.1;
    if (modifiers & Qt::ShiftModifier)
        return pixels * 10.0;
    return pixels;
}

void ThumbWheel::TurnBy(float64 steps)
{
    if (steps == 0.0)
        return;
    mTurned += steps;
    update();
    emit Turn(steps);
}

void ThumbWheel::mousePressEvent(QMouseEvent *event)
{
    if (event->button() != Qt::LeftButton || !isEnabled())
        return QWidget::mousePressEvent(event);
    mDragging = true;
    mLastX = event->x();
}

void ThumbWheel::mouseMoveEvent(QMouseEvent *event)
{
    if (!mDragging)
        return QWidget::mouseMoveEvent(event);
    const int32 dx = event->x() - mLastX;
    mLastX = event->x();
    TurnBy(StepsFor(dx, event->modifiers()));
}

void ThumbWheel::mouseReleaseEvent(QMouseEvent *event)
{
    if (event->button() != Qt::LeftButton || !mDragging)
        return QWidget::mouseReleaseEvent(event);
    mouseMoveEvent(event);
    mDragging = false;
    emit TurnEnded();
}

// Each notch is a gesture of its own: nothing marks where a run of them ends.
void ThumbWheel::wheelEvent(QWheelEvent *event)
{
    const float64 notches = event->angleDelta().y() / kNotchAngle;
    if (notches == 0.0 || !isEnabled() || mDragging)
        return QWidget::wheelEvent(event);
    TurnBy(StepsFor(notches * kNotchSteps, event->modifiers()));
    emit TurnEnded();
    event->accept();
}

// Ridges across a rounded drum, darker towards its edges, shifted by the turn.
void ThumbWheel::paintEvent(QPaintEvent *)
{
    QPainter p(this);
    p.setRenderHint(QPainter::Antialiasing);
    const QRectF drum = QRectF(rect()).adjusted(0.5, 0.5, -0.5, -0.5);
    QLinearGradient shade(drum.topLeft(), drum.topRight());
    const QColor base = palette().color(QPalette::Button);
    shade.setColorAt(0.0, base.darker(160));
    shade.setColorAt(0.5, base.lighter(115));
    shade.setColorAt(1.0, base.darker(160));
    p.setPen(palette().color(QPalette::Mid));
    p.setBrush(shade);
    p.drawRoundedRect(drum, 3, 3);
    const float64 phase = std::fmod(mTurned, float64(kRidgeSpacing));
    p.setPen(palette().color(QPalette::Dark));
    for (float64 x = phase < 0 ? phase + kRidgeSpacing : phase; x < width(); x += kRidgeSpacing)
        p.drawLine(QPointF(x, 3), QPointF(x, height() - 3));
}

} // namespace Orbane
