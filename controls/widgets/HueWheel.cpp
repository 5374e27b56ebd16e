#include "widgets/HueWheel.h"

#include "widgets/ColorMath.h"

#include "orbane/ScriptVal.h"
#include "orbane/TagList.h"

#include <QMouseEvent>
#include <QPaintEvent>
#include <QPainter>

#include <cmath>

namespace Orbane {

namespace {

constexpr int32 kMargin = 6; // room for the puck at the rim
constexpr float64 kPuckRadius = 5.0;
constexpr float64 kTwoPi = 6.283185307179586;

float64 Length(OrbPoint p)
{
    return std::hypot(p.x, p.y);
}

// The disc's pixel at unit offset (x, y) from the centre, y up; transparent outside.
QRgb DiscPixel(float64 x, float64 y)
{
    const float64 r = std::hypot(x, y);
    if (r > 1.0)
        return qRgba(0, 0, 0, 0);
    float64 hue = std::atan2(y, x) * 360.0 / kTwoPi;
    if (hue < 0.0)
        hue += 360.0;
    // Display values: the disc is a picture of hues, not linear light.
    const ColorRGBA c = ColorMath::HsvToRgb({{hue, r, 0.9}});
    return qRgb(int(c.r * 255.0 + 0.5), int(c.g * 255.0 + 0.5), int(c.b * 255.0 + 0.5));
}

} // namespace

HueWheel::HueWheel() : CustomControl(nullptr, ScriptVal(), TagList())
{
    setMinimumSize(60, 60);
}

HueWheel::~HueWheel() = default;

void HueWheel::SetPuck(OrbPoint puck)
{
    if (puck.x == mPuck.x && puck.y == mPuck.y)
        return;
    mPuck = puck;
    update();
}

void HueWheel::SetRim(float64 rim)
{
    if (!(rim > 0.0) || !std::isfinite(rim) || rim == mRim)
        return;
    mRim = rim;
    update();
}

QPointF HueWheel::Centre() const
{
    return QPointF(width() / 2.0, height() / 2.0);
}

float64 HueWheel::Radius() const
{
    return std::max(1.0, std::min(width(), height()) / 2.0 - kMargin);
}

QPointF HueWheel::ToPixel(OrbPoint puck, QPointF centre, float64 radius, float64 rim)
{
    const float64 k = radius / rim;
    return QPointF(centre.x() + puck.x * k, centre.y() - puck.y * k);
}

OrbPoint HueWheel::FromPixel(QPointF pixel, QPointF centre, float64 radius, float64 rim)
{
    const float64 k = rim / radius;
    return {(pixel.x() - centre.x()) * k, (centre.y() - pixel.y()) * k};
}

OrbPoint HueWheel::Dragged(OrbPoint start, OrbPoint delta, float64 rim, int32 constrain)
{
    OrbPoint p = start + delta;
    const float64 startR = Length(start);
    if (constrain == 1 && startR > 0.0) {
        // Hue only: round the centre at the start's saturation.
        p = p * (startR / std::max(Length(p), 1e-12));
    } else if (constrain == 2 && startR > 0.0) {
        // Saturation only: along the start's radius, never through the centre.
        const OrbPoint dir = start / startR;
        const float64 along = std::max(0.0, p.x * dir.x + p.y * dir.y);
        p = dir * along;
    }
    const float64 r = Length(p);
    return r > rim ? p * (rim / r) : p;
}

int32 HueWheel::ConstraintFor(QPointF moved) const
{
    const QPointF puck = ToPixel(mPressPuck, Centre(), Radius(), mRim);
    const QPointF radial = puck - Centre();
    const float64 len = std::hypot(radial.x(), radial.y());
    if (len < 1.0)
        return 2; // at the centre only the saturation can grow
    const float64 along = std::fabs((moved.x() * radial.x() + moved.y() * radial.y()) / len);
    const float64 across = std::fabs((moved.x() * radial.y() - moved.y() * radial.x()) / len);
    return along >= across ? 2 : 1;
}

const QImage &HueWheel::Disc(int32 side, qreal ratio)
{
    const int32 px = int32(side * ratio);
    if (mDisc.width() == px && mDisc.devicePixelRatio() == ratio)
        return mDisc;
    mDisc = QImage(px, px, QImage::Format_ARGB32_Premultiplied);
    const float64 half = px / 2.0;
    for (int32 y = 0; y < px; ++y) {
        auto *line = reinterpret_cast<QRgb *>(mDisc.scanLine(y));
        for (int32 x = 0; x < px; ++x)
            line[x] = DiscPixel((x + 0.5 - half) / half, (half - y - 0.5) / half);
    }
    mDisc.setDevicePixelRatio(ratio);
    return mDisc;
}

void HueWheel::paintEvent(QPaintEvent *event)
{
    if (!BeginDraw(event->rect()))
        return;
    QPainter &p = *BackPainter();
    p.setRenderHint(QPainter::Antialiasing);
    const QPointF c = Centre();
    const float64 r = Radius();
    const int32 side = int32(2 * r);
    p.drawImage(QPointF(c.x() - side / 2.0, c.y() - side / 2.0), Disc(side, devicePixelRatioF()));
    p.setPen(QPen(QColor(20, 20, 20), 1.0));
    p.setBrush(Qt::NoBrush);
    p.drawEllipse(c, r, r);
    p.drawLine(QPointF(c.x() - 4, c.y()), QPointF(c.x() + 4, c.y()));
    p.drawLine(QPointF(c.x(), c.y() - 4), QPointF(c.x(), c.y() + 4));
    // The puck: a shadow ring, then a light one.
    const QPointF at = ToPixel(mPuck, c, r, mRim);
    p.setPen(QPen(QColor(0, 0, 0, 200), 3.0));
    p.drawEllipse(at, kPuckRadius, kPuckRadius);
    p.setPen(QPen(mDragging ? QColor(255, 220, 80) : QColor(240, 240, 240), 1.5));
    p.drawEllipse(at, kPuckRadius, kPuckRadius);
    EndDraw();
}

void HueWheel::mousePressEvent(QMouseEvent *event)
{
    if (event->button() != Qt::LeftButton || IsDisabled())
        return;
    mDragging = true;
    mPressAt = event->localPos();
    mPressPuck = mPuck;
    mConstraint = 0;
    emit Pressed();
    update();
}

void HueWheel::mouseMoveEvent(QMouseEvent *event)
{
    if (!mDragging)
        return;
    const QPointF moved = event->localPos() - mPressAt;
    const bool shift = event->modifiers() & Qt::ShiftModifier;
    if (shift && mConstraint == 0 && std::hypot(moved.x(), moved.y()) >= kConstrainAfter)
        mConstraint = ConstraintFor(moved);
    const float64 k = (event->modifiers() & Qt::ControlModifier ? kFine : 1.0) * mRim / Radius();
    const OrbPoint delta{moved.x() * k, -moved.y() * k};
    const OrbPoint next = Dragged(mPressPuck, delta, mRim, shift ? mConstraint : 0);
    if (next.x == mPuck.x && next.y == mPuck.y)
        return;
    SetPuck(next);
    emit PuckMoved(next.x, next.y);
}

void HueWheel::mouseReleaseEvent(QMouseEvent *event)
{
    if (event->button() != Qt::LeftButton || !mDragging)
        return;
    mDragging = false;
    update();
    emit Released();
}

void HueWheel::mouseDoubleClickEvent(QMouseEvent *event)
{
    if (event->button() == Qt::LeftButton && !IsDisabled())
        emit ResetAsked();
}

} // namespace Orbane
