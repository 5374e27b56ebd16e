#include "TimeScale.h"

#include "orbane/Input.h"
#include "orbane/Operator.h"
#include "orbane/OrbaneDoc.h"

#include <QMouseEvent>
#include <QPainter>
#include <QPainterPath>
#include <QUndoStack>

#include <algorithm>
#include <cmath>

namespace Orbane {

namespace {

const QColor kKeyColour(240, 190, 60);
const QColor kNowColour(220, 70, 60);
constexpr int kKeyRadius = 4;

} // namespace

TimeScale::TimeScale(OrbaneDoc *doc, QWidget *parent) : QWidget(parent), mDoc(doc)
{
    setObjectName("timeScale");
    setMinimumHeight(24);
    setAccessibleName("Time");
    // Keys come and go with edits, undo and redo; the time moves with scrubbing and scripts.
    connect(doc->UndoStack(), &QUndoStack::indexChanged, this, qOverload<>(&QWidget::update));
    connect(doc, SIGNAL(currentTimeChanged(float64)), this, SLOT(update()));
}

void TimeScale::SetTool(const Operator *tool)
{
    mTool = tool;
    update();
}

void TimeScale::SetRange(float64 first, float64 last)
{
    if (first > last)
        std::swap(first, last);
    mFirst = first;
    mLast = std::max(last, first + 1.0);
    update();
}

std::vector<float64> TimeScale::KeyMarks() const
{
    std::vector<float64> marks;
    if (!mTool)
        return marks;
    for (const Input *input : mTool->Inputs())
        if (input->IsAnimated())
            for (const float64 time : input->KeyTimes())
                marks.push_back(time);
    std::sort(marks.begin(), marks.end());
    marks.erase(std::unique(marks.begin(), marks.end()), marks.end());
    return marks;
}

int TimeScale::TimeToX(float64 time, float64 first, float64 last, int width)
{
    const int span = std::max(1, width - 2 * kMargin);
    return kMargin + int(std::lround((time - first) / (last - first) * span));
}

float64 TimeScale::XToFrame(int x, float64 first, float64 last, int width)
{
    const int span = std::max(1, width - 2 * kMargin);
    const float64 time = first + float64(x - kMargin) / span * (last - first);
    return std::clamp(std::round(time), first, last);
}

void TimeScale::ScrubTo(int x)
{
    mDoc->SetCurrentTime(XToFrame(x, mFirst, mLast, width()));
}

void TimeScale::mousePressEvent(QMouseEvent *event)
{
    if (event->button() == Qt::LeftButton)
        ScrubTo(event->pos().x());
}

void TimeScale::mouseMoveEvent(QMouseEvent *event)
{
    if (event->buttons() & Qt::LeftButton)
        ScrubTo(event->pos().x());
}

void TimeScale::paintEvent(QPaintEvent *)
{
    QPainter painter(this);
    painter.fillRect(rect(), palette().base());
    PaintTicks(painter);
    PaintKeys(painter);
    const int now = XOf(mDoc->GetCurrentTime());
    painter.setPen(QPen(kNowColour, 2));
    painter.drawLine(now, 0, now, height());
}

// A tick per frame where they are at least 4 pixels apart, a longer one every tenth.
void TimeScale::PaintTicks(QPainter &painter) const
{
    painter.setPen(palette().color(QPalette::Mid));
    const float64 frames = mLast - mFirst;
    const int step = std::max(1, int(std::ceil(frames * 4 / std::max(1, width() - 2 * kMargin))));
    for (float64 f = std::ceil(mFirst); f <= mLast; f += step) {
        const int x = XOf(f);
        const bool tenth = std::fmod(f, 10.0) == 0.0;
        painter.drawLine(x, height() - (tenth ? 10 : 5), x, height());
    }
}

void TimeScale::PaintKeys(QPainter &painter) const
{
    painter.setRenderHint(QPainter::Antialiasing);
    painter.setPen(Qt::black);
    painter.setBrush(kKeyColour);
    const int y = height() / 2 - 2;
    for (const float64 time : KeyMarks()) {
        const int x = XOf(time);
        QPainterPath diamond;
        diamond.moveTo(x, y - kKeyRadius);
        diamond.lineTo(x + kKeyRadius, y);
        diamond.lineTo(x, y + kKeyRadius);
        diamond.lineTo(x - kKeyRadius, y);
        diamond.closeSubpath();
        painter.drawPath(diamond);
    }
}

} // namespace Orbane
