#include "inputcontrols/RangeTrack.h"

#include <QMouseEvent>
#include <QPainter>

#include <cmath>

namespace Orbane {

namespace {

constexpr int32 kGrooveHeight = 4;
constexpr int32 kKnobWidth = 8;
constexpr int32 kKnobHeight = 14;
constexpr int32 kTickLength = 3;
const QColor kInvertedColour(224, 88, 64);

} // namespace

RangeTrack::RangeTrack(QWidget *parent) : QWidget(parent)
{
    setFocusPolicy(Qt::ClickFocus);
    setMinimumHeight(kKnobHeight + kTickLength + 2);
}

QSize RangeTrack::sizeHint() const
{
    return QSize(120, kKnobHeight + kTickLength + 2);
}

void RangeTrack::SetScale(float64 low, float64 high)
{
    // An empty scale would divide by zero: it is widened to one.
    if (high <= low)
        high = low + 1.0;
    if (low == mScaleLow && high == mScaleHigh)
        return;
    mScaleLow = low;
    mScaleHigh = high;
    update();
}

void RangeTrack::SetValues(float64 low, float64 high)
{
    if (low == mLow && high == mHigh)
        return;
    mLow = low;
    mHigh = high;
    update();
}

void RangeTrack::SetHasHigh(bool on)
{
    mHasHigh = on;
    update();
}

void RangeTrack::SetTickCount(int32 count)
{
    mTicks = std::max(0, count);
    update();
}

float64 RangeTrack::ValueToPixel(float64 value, float64 scaleLow, float64 scaleHigh, int32 width)
{
    const float64 inner = std::max(1, width - 2 * kMargin);
    return kMargin + (value - scaleLow) / (scaleHigh - scaleLow) * inner;
}

float64 RangeTrack::PixelToValue(float64 x, float64 scaleLow, float64 scaleHigh, int32 width)
{
    const float64 inner = std::max(1, width - 2 * kMargin);
    return scaleLow + (x - kMargin) / inner * (scaleHigh - scaleLow);
}

// Knobs on top of each other: a press right of them takes the high one,
// so that the range can be opened either way.
RangeTrack::Part RangeTrack::HitPart(float64 x, float64 lowX, float64 highX, bool hasHigh)
{
    const float64 toLow = std::abs(x - lowX), toHigh = hasHigh ? std::abs(x - highX) : 1e300;
    if (std::min(toLow, toHigh) <= kPickTolerance) {
        if (toLow == toHigh)
            return x > lowX ? Part_High : Part_Low;
        return toLow < toHigh ? Part_Low : Part_High;
    }
    if (hasHigh && x > std::min(lowX, highX) && x < std::max(lowX, highX))
        return Part_Span;
    return Part_None;
}

float64 RangeTrack::XOf(float64 value) const
{
    return ValueToPixel(value, mScaleLow, mScaleHigh, width());
}

float64 RangeTrack::ValueAt(float64 x) const
{
    return PixelToValue(x, mScaleLow, mScaleHigh, width());
}

void RangeTrack::paintEvent(QPaintEvent *)
{
    QPainter p(this);
    p.setRenderHint(QPainter::Antialiasing);
    const QPalette &pal = palette();
    const int32 mid = kKnobHeight / 2;
    p.fillRect(QRectF(kMargin, mid - kGrooveHeight / 2, width() - 2 * kMargin, kGrooveHeight), pal.dark());
    const float64 lowX = XOf(mLow), highX = XOf(mHasHigh ? mHigh : mLow);
    const QColor bar = mLow > mHigh && mHasHigh ? kInvertedColour : pal.color(QPalette::Highlight);
    p.fillRect(QRectF(std::min(lowX, highX), mid - kGrooveHeight / 2, std::abs(highX - lowX), kGrooveHeight), bar);
    p.setPen(pal.color(QPalette::Mid));
    for (int32 i = 0; i < mTicks; ++i) {
        const float64 x = mTicks == 1 ? width() / 2.0 : kMargin + i * (width() - 2.0 * kMargin) / (mTicks - 1);
        p.drawLine(QPointF(x, kKnobHeight + 1), QPointF(x, kKnobHeight + kTickLength));
    }
    p.setPen(pal.color(QPalette::Shadow));
    p.setBrush(pal.button());
    for (float64 x : {lowX, highX}) {
        p.drawRoundedRect(QRectF(x - kKnobWidth / 2.0, 0.5, kKnobWidth, kKnobHeight - 1), 2, 2);
        if (!mHasHigh)
            break;
    }
}

// The drag counts from where it was anchored; a change of Ctrl anchors it
// again, so going fine never makes the ends jump.
void RangeTrack::Anchor(float64 x, bool fine)
{
    mAnchorX = x;
    mAnchorLow = mLow;
    mAnchorHigh = mHigh;
    mFine = fine;
}

void RangeTrack::mousePressEvent(QMouseEvent *event)
{
    if (event->button() != Qt::LeftButton || !isEnabled())
        return QWidget::mousePressEvent(event);
    const float64 x = event->localPos().x();
    mDragged = HitPart(x, XOf(mLow), XOf(mHigh), mHasHigh);
    emit Pressed();
    if (mDragged == Part_None) {
        // A press on the bare track brings the nearer end to it.
        mDragged = !mHasHigh || std::abs(x - XOf(mLow)) <= std::abs(x - XOf(mHigh)) ? Part_Low : Part_High;
        const float64 value = ValueAt(x);
        emit Moved(mDragged == Part_Low ? value : mLow, mDragged == Part_High ? value : mHigh, mDragged);
    }
    Anchor(x, event->modifiers() & Qt::ControlModifier);
}

void RangeTrack::mouseMoveEvent(QMouseEvent *event)
{
    if (mDragged == Part_None)
        return QWidget::mouseMoveEvent(event);
    const float64 x = event->localPos().x();
    const bool fine = event->modifiers() & Qt::ControlModifier;
    if (fine != mFine)
        Anchor(x, fine);
    const float64 delta = (ValueAt(x) - ValueAt(mAnchorX)) * (mFine ? kFineFactor : 1.0);
    emit Moved(mAnchorLow + (mDragged & Part_Low ? delta : 0.0), mAnchorHigh + (mDragged & Part_High ? delta : 0.0),
               mDragged);
}

void RangeTrack::mouseReleaseEvent(QMouseEvent *event)
{
    if (mDragged == Part_None)
        return QWidget::mouseReleaseEvent(event);
    mDragged = Part_None;
    emit Released();
}

void RangeTrack::mouseDoubleClickEvent(QMouseEvent *event)
{
    if (event->button() == Qt::LeftButton && isEnabled())
        emit ResetAsked();
}

} // namespace Orbane
