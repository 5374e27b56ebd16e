#include "widgets/LevelsBar.h"

#include "orbane/ScriptVal.h"
#include "orbane/TagList.h"

#include <QLinearGradient>
#include <QMouseEvent>
#include <QPainter>
#include <QPainterPath>

#include <algorithm>
#include <cmath>

namespace Orbane {

namespace {

const QColor kStripBackground(38, 38, 38);
const QColor kFrameColour(0, 0, 0, 90);

} // namespace

LevelsBar::LevelsBar(QWidget *parent) : CustomControl(nullptr, ScriptVal(), TagList())
{
    setParent(parent);
    setFocusPolicy(Qt::ClickFocus);
    setMinimumHeight(kHandleHeight + 12);
}

QSize LevelsBar::sizeHint() const
{
    return QSize(200, 90);
}

void LevelsBar::SetHistogram(std::vector<float> heights, QColor colour)
{
    mHeights = std::move(heights);
    mHistogramColour = colour;
    mRamp = false;
    update();
}

void LevelsBar::SetRamp(QColor from, QColor to)
{
    mRampFrom = from;
    mRampTo = to;
    mRamp = true;
    update();
}

void LevelsBar::SetHandles(std::vector<Handle> handles)
{
    const bool same = handles.size() == mHandles.size() &&
                      std::equal(handles.begin(), handles.end(), mHandles.begin(),
                                 [](const Handle &a, const Handle &b) { return a.x == b.x && a.colour == b.colour; });
    if (same)
        return;
    mHandles = std::move(handles);
    update();
}

float64 LevelsBar::ToPixel(float64 value, int32 width)
{
    return kMargin + value * std::max(1, width - 2 * kMargin);
}

float64 LevelsBar::ToValue(float64 x, int32 width)
{
    return (x - kMargin) / std::max(1, width - 2 * kMargin);
}

int32 LevelsBar::HandleAt(const std::vector<Handle> &handles, float64 x, int32 width)
{
    int32 best = -1;
    float64 bestDistance = kPickTolerance;
    for (int32 i = 0; i < int32(handles.size()); ++i) {
        const float64 d = std::abs(ToPixel(handles[std::size_t(i)].x, width) - x);
        if (d <= bestDistance) {
            bestDistance = d;
            best = i;
        }
    }
    return best;
}

void LevelsBar::paintEvent(QPaintEvent *event)
{
    if (!BeginDraw(event->rect()))
        return;
    QPainter &painter = *BackPainter();
    const float64 top = height() - kHandleHeight - 1;
    const QRectF area(kMargin, 2, width() - 2 * kMargin, top - 2);
    PaintBackdrop(painter, area);
    painter.setRenderHint(QPainter::Antialiasing, true);
    for (const Handle &handle : mHandles)
        PaintHandle(painter, handle, top);
    painter.setRenderHint(QPainter::Antialiasing, false);
    EndDraw();
}

void LevelsBar::PaintBackdrop(QPainter &painter, const QRectF &area)
{
    if (mRamp) {
        QLinearGradient ramp(area.topLeft(), area.topRight());
        ramp.setColorAt(0.0, mRampFrom);
        ramp.setColorAt(1.0, mRampTo);
        painter.fillRect(area, ramp);
    } else {
        painter.fillRect(area, kStripBackground);
        const float64 bins = float64(std::max<std::size_t>(1, mHeights.size()));
        QPainterPath path(area.bottomLeft());
        for (std::size_t i = 0; i < mHeights.size(); ++i) {
            const float64 y = area.bottom() - float64(mHeights[i]) * area.height();
            path.lineTo(area.left() + area.width() * float64(i) / bins, y);
            path.lineTo(area.left() + area.width() * float64(i + 1) / bins, y);
        }
        path.lineTo(area.bottomRight());
        painter.fillPath(path, mHistogramColour);
    }
    painter.setPen(kFrameColour);
    painter.setBrush(Qt::NoBrush);
    painter.drawRect(area.adjusted(0, 0, -1, -1));
}

void LevelsBar::PaintHandle(QPainter &painter, const Handle &handle, float64 top)
{
    const float64 x = ToPixel(handle.x, width());
    const float64 half = kHandleHeight * 0.6;
    const QPointF tip[3] = {{x, top}, {x - half, top + kHandleHeight}, {x + half, top + kHandleHeight}};
    painter.setPen(QColor(0, 0, 0, 160));
    painter.setBrush(handle.colour);
    painter.drawPolygon(tip, 3);
}

void LevelsBar::mousePressEvent(QMouseEvent *event)
{
    if (event->button() != Qt::LeftButton || IsDisabled())
        return;
    mPicked = HandleAt(mHandles, event->localPos().x(), width());
    if (mPicked < 0)
        return;
    mDragValue = mHandles[std::size_t(mPicked)].x;
    mLastX = event->localPos().x();
}

void LevelsBar::mouseMoveEvent(QMouseEvent *event)
{
    if (mPicked < 0)
        return;
    const float64 x = event->localPos().x();
    const float64 factor = event->modifiers() & Qt::ControlModifier ? kFineFactor : 1.0;
    mDragValue += (ToValue(x, width()) - ToValue(mLastX, width())) * factor;
    mLastX = x;
    emit Moved(mPicked, std::clamp(mDragValue, 0.0, 1.0));
}

void LevelsBar::mouseReleaseEvent(QMouseEvent *event)
{
    if (event->button() != Qt::LeftButton || mPicked < 0)
        return;
    mPicked = -1;
    emit Released();
}

void LevelsBar::mouseDoubleClickEvent(QMouseEvent *event)
{
    const int32 handle = HandleAt(mHandles, event->localPos().x(), width());
    if (event->button() == Qt::LeftButton && handle >= 0 && !IsDisabled())
        emit ResetAsked(handle);
}

} // namespace Orbane
