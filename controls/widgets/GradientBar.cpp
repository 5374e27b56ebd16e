#include "widgets/GradientBar.h"

#include "orbane/ScriptVal.h"
#include "orbane/TagList.h"

#include <QMouseEvent>
#include <QPaintEvent>
#include <QPainter>

#include <cmath>

namespace Orbane {

namespace {

constexpr float64 kMarkerHalf = 5.0;
constexpr int32 kCheck = 5;

} // namespace

GradientBar::GradientBar() : CustomControl(nullptr, ScriptVal(), TagList())
{
    setMinimumHeight(24);
}

GradientBar::~GradientBar() = default;

void GradientBar::SetStops(const GradientStops &stops)
{
    if (stops == mStops)
        return;
    mStops = stops;
    mSelected = std::clamp(mSelected, 0, int32(mStops.stops.size()) - 1);
    update();
}

void GradientBar::Select(int32 index)
{
    index = std::clamp(index, 0, int32(mStops.stops.size()) - 1);
    if (index == mSelected)
        return;
    mSelected = index;
    update();
    emit SelectionChanged(index);
}

float64 GradientBar::PosToX(float64 pos, int32 width)
{
    return kMargin + pos * std::max(1, width - 2 * kMargin);
}

float64 GradientBar::XToPos(float64 x, int32 width)
{
    return std::clamp((x - kMargin) / std::max(1, width - 2 * kMargin), 0.0, 1.0);
}

int32 GradientBar::MarkerAt(float64 x) const
{
    int32 best = -1;
    float64 bestDistance = kMarkerHalf + 1.0;
    for (int32 i = 0; i < int32(mStops.stops.size()); ++i) {
        const float64 d = std::fabs(PosToX(mStops.stops[size_t(i)].pos, width()) - x);
        // The selected marker wins a tie: it is drawn on top.
        if (d < bestDistance || (d == bestDistance && i == mSelected)) {
            best = i;
            bestDistance = d;
        }
    }
    return best;
}

bool GradientBar::IsOffBar(float64 y) const
{
    return y < -kDeleteDistance || y > height() + kDeleteDistance;
}

void GradientBar::paintEvent(QPaintEvent *event)
{
    if (!BeginDraw(event->rect()))
        return;
    QPainter &p = *BackPainter();
    const QRect ramp(kMargin, 1, std::max(1, width() - 2 * kMargin), height() - kMarkerRow - 2);
    for (int32 y = ramp.top(); y <= ramp.bottom(); y += kCheck)
        for (int32 x = ramp.left() + ((y / kCheck) % 2) * kCheck; x <= ramp.right(); x += 2 * kCheck)
            p.fillRect(QRect(x, y, kCheck, kCheck).intersected(ramp), QColor(110, 110, 110));
    // One column per device pixel keeps the ramp crisp at any ratio.
    const qreal ratio = devicePixelRatioF();
    const int32 columns = int32(ramp.width() * ratio);
    for (int32 i = 0; i < columns; ++i) {
        const float64 x = ramp.left() + i / ratio;
        p.fillRect(QRectF(x, ramp.top(), 1.0 / ratio, ramp.height()),
                   ColorMath::ToDisplay(mStops.Evaluate(float64(i) / std::max(1, columns - 1))));
    }
    p.setPen(QColor(20, 20, 20));
    p.drawRect(ramp.adjusted(0, 0, -1, -1));
    p.setRenderHint(QPainter::Antialiasing);
    for (int32 i = 0; i < int32(mStops.stops.size()); ++i)
        if (i != mSelected)
            PaintMarker(p, i);
    PaintMarker(p, mSelected);
    EndDraw();
}

void GradientBar::PaintMarker(QPainter &p, int32 index)
{
    if (index < 0 || index >= int32(mStops.stops.size()))
        return;
    const GradientStops::Stop &s = mStops.stops[size_t(index)];
    const float64 x = PosToX(s.pos, width()), top = height() - kMarkerRow;
    const QPointF tri[3] = {
        {x, top}, {x - kMarkerHalf, top + kMarkerRow - 1.0}, {x + kMarkerHalf, top + kMarkerRow - 1.0}};
    QColor fill = ColorMath::ToDisplay(s.color);
    fill.setAlpha(255);
    const bool doomed = mOff && index == mSelected;
    p.setBrush(doomed ? QColor(90, 90, 90, 120) : fill);
    p.setPen(QPen(index == mSelected ? QColor(255, 220, 80) : QColor(20, 20, 20), index == mSelected ? 1.5 : 1.0));
    p.drawPolygon(tri, 3);
    if (doomed)
        p.drawLine(QPointF(x - kMarkerHalf, top), QPointF(x + kMarkerHalf, top + kMarkerRow - 1.0));
}

void GradientBar::mousePressEvent(QMouseEvent *event)
{
    if (event->button() != Qt::LeftButton || IsDisabled())
        return;
    const float64 x = event->localPos().x();
    int32 index = MarkerAt(x);
    mChanged = false;
    if (index < 0 && int32(mStops.stops.size()) >= mMaxStops)
        return;
    if (index < 0) {
        index = mStops.Add(XToPos(x, width()));
        mChanged = true;
    }
    mDragging = true;
    mOff = false;
    mSelected = index;
    update();
    // The new stop is told before the selection, so that the owner writes it
    // before it shows the selected stop.
    if (mChanged)
        emit Edited();
    emit SelectionChanged(index);
}

void GradientBar::mouseMoveEvent(QMouseEvent *event)
{
    if (!mDragging)
        return;
    const float64 pos = XToPos(event->localPos().x(), width());
    const bool off = IsOffBar(event->localPos().y()) && int32(mStops.stops.size()) > GradientStops::kMinStops;
    if (off != mOff) {
        mOff = off;
        update();
    }
    if (off || pos == mStops.stops[size_t(mSelected)].pos)
        return;
    mSelected = mStops.Move(mSelected, pos);
    mChanged = true;
    update();
    emit Edited();
}

void GradientBar::mouseReleaseEvent(QMouseEvent *event)
{
    if (event->button() != Qt::LeftButton || !mDragging)
        return;
    mDragging = false;
    if (mOff && mStops.Remove(mSelected)) {
        mSelected = std::max(0, mSelected - 1);
        mChanged = true;
        emit Edited();
    }
    mOff = false;
    update();
    emit SelectionChanged(mSelected);
    if (mChanged)
        emit GestureEnded();
    mChanged = false;
}

void GradientBar::mouseDoubleClickEvent(QMouseEvent *event)
{
    const int32 index = event->button() == Qt::LeftButton ? MarkerAt(event->localPos().x()) : -1;
    if (index >= 0 && !IsDisabled())
        emit ColorAsked(index);
}

} // namespace Orbane
