#include "widgets/HueHexagon.h"

#include "widgets/ColorMath.h"

#include "orbane/ScriptVal.h"
#include "orbane/TagList.h"

#include <QMouseEvent>
#include <QPaintEvent>
#include <QPainter>

#include <cmath>

namespace Orbane {

namespace {

constexpr float64 kPi = 3.141592653589793;
constexpr int32 kMargin = 8;
constexpr float64 kKnob = 4.5;

float64 Shown(float64 v, float64 max)
{
    return std::isnan(v) ? 0.0 : std::clamp(v, 0.0, max);
}

} // namespace

HueHexagon::HueHexagon() : CustomControl(nullptr, ScriptVal(), TagList())
{
    setMinimumSize(60, 60);
}

HueHexagon::~HueHexagon() = default;

void HueHexagon::SetValues(const std::array<float64, kSpokes> &values)
{
    if (values == mValues)
        return;
    mValues = values;
    update();
}

void HueHexagon::SetMaximum(float64 max)
{
    if (!(max > 0.0) || !std::isfinite(max) || max == mMax)
        return;
    mMax = max;
    update();
}

QPointF HueHexagon::Centre() const
{
    return QPointF(width() / 2.0, height() / 2.0);
}

float64 HueHexagon::Radius() const
{
    return std::max(1.0, std::min(width(), height()) / 2.0 - kMargin);
}

QPointF HueHexagon::Direction(int32 spoke)
{
    const float64 a = spoke * kPi / 3.0;
    return QPointF(std::cos(a), -std::sin(a));
}

int32 HueHexagon::SpokeToward(QPointF at, QPointF centre)
{
    float64 angle = std::atan2(-(at.y() - centre.y()), at.x() - centre.x());
    if (angle < 0.0)
        angle += 2.0 * kPi;
    return int32(std::lround(angle / (kPi / 3.0))) % kSpokes;
}

float64 HueHexagon::ValueOn(QPointF at, QPointF centre, float64 radius, int32 spoke, float64 max)
{
    const QPointF d = Direction(spoke), v = at - centre;
    const float64 along = v.x() * d.x() + v.y() * d.y();
    return std::clamp(along / radius * max, 0.0, max);
}

QPointF HueHexagon::KnobAt(int32 spoke, float64 value) const
{
    return Centre() + Direction(spoke) * (Shown(value, mMax) / mMax * Radius());
}

void HueHexagon::paintEvent(QPaintEvent *event)
{
    if (!BeginDraw(event->rect()))
        return;
    QPainter &p = *BackPainter();
    p.setRenderHint(QPainter::Antialiasing);
    const QPointF c = Centre();
    const float64 r = Radius();
    QPolygonF outline, filled;
    for (int32 i = 0; i < kSpokes; ++i) {
        outline << c + Direction(i) * r;
        filled << KnobAt(i, mValues[size_t(i)]);
    }
    p.setPen(QPen(QColor(90, 90, 90), 1.0));
    p.setBrush(QColor(45, 45, 45));
    p.drawPolygon(outline);
    // The suppressed share of each hue, as a shape joining the knobs.
    p.setBrush(QColor(200, 200, 200, 60));
    p.setPen(QPen(QColor(200, 200, 200, 140), 1.0));
    p.drawPolygon(filled);
    for (int32 i = 0; i < kSpokes; ++i) {
        const ColorRGBA hue = ColorMath::HsvToRgb({{i * 60.0, 1.0, 1.0}});
        const QColor colour = QColor::fromRgbF(hue.r, hue.g, hue.b);
        p.setPen(QPen(colour, 2.0));
        p.drawLine(c, c + Direction(i) * r);
        p.setPen(QPen(QColor(0, 0, 0, 200), 1.0));
        p.setBrush(i == mDragged ? QColor(255, 220, 80) : colour);
        p.drawEllipse(KnobAt(i, mValues[size_t(i)]), kKnob, kKnob);
    }
    EndDraw();
}

void HueHexagon::mousePressEvent(QMouseEvent *event)
{
    if (event->button() != Qt::LeftButton || IsDisabled())
        return;
    mDragged = SpokeToward(event->localPos(), Centre());
    mPressAt = event->localPos();
    const float64 v = ValueOn(event->localPos(), Centre(), Radius(), mDragged, mMax);
    // Ctrl presses keep the value and only fine-tune from it.
    mPressValue = event->modifiers() & Qt::ControlModifier ? Shown(mValues[size_t(mDragged)], mMax) : v;
    if (mPressValue != mValues[size_t(mDragged)]) {
        mValues[size_t(mDragged)] = mPressValue;
        emit Moved(mDragged, mPressValue);
    }
    update();
}

void HueHexagon::mouseMoveEvent(QMouseEvent *event)
{
    if (mDragged < 0)
        return;
    const QPointF d = Direction(mDragged), moved = event->localPos() - mPressAt;
    const float64 k = (event->modifiers() & Qt::ControlModifier ? kFine : 1.0) * mMax / Radius();
    const float64 v = std::clamp(mPressValue + (moved.x() * d.x() + moved.y() * d.y()) * k, 0.0, mMax);
    if (v == mValues[size_t(mDragged)])
        return;
    mValues[size_t(mDragged)] = v;
    update();
    emit Moved(mDragged, v);
}

void HueHexagon::mouseReleaseEvent(QMouseEvent *event)
{
    if (event->button() != Qt::LeftButton || mDragged < 0)
        return;
    mDragged = -1;
    update();
    emit Released();
}

} // namespace Orbane
