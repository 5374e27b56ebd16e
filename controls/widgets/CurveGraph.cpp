#include "widgets/CurveGraph.h"

#include "orbane/ScriptVal.h"
#include "orbane/TagList.h"

#include <QKeyEvent>
#include <QMouseEvent>
#include <QPainter>
#include <QPainterPath>
#include <QWheelEvent>

#include <algorithm>
#include <cmath>

namespace Orbane {

namespace {

constexpr float64 kPointRadius = 3.5;
constexpr float64 kZoomPerNotch = 1.25;
constexpr float64 kMinSpan = 1e-3; // the deepest zoom, in values across
const QColor kGridColour(255, 255, 255, 28);
const QColor kFrameColour(0, 0, 0, 90);
const QColor kDiagonalColour(255, 255, 255, 50);
const QColor kGraphBackground(38, 38, 38);

} // namespace

CurveGraph::CurveGraph(QWidget *parent) : CustomControl(nullptr, ScriptVal(), TagList())
{
    setParent(parent);
    setFocusPolicy(Qt::ClickFocus);
    setMinimumHeight(60);
}

QSize CurveGraph::sizeHint() const
{
    return QSize(200, 160);
}

void CurveGraph::SetLines(std::vector<Line> lines)
{
    mLines = std::move(lines);
    mActive = std::clamp(mActive, 0, std::max(0, int32(mLines.size()) - 1));
    mPicked = -1;
    update();
}

void CurveGraph::SetCurve(int32 line, const Curve &curve)
{
    if (line < 0 || line >= int32(mLines.size()) || mLines[std::size_t(line)].curve == curve)
        return;
    mLines[std::size_t(line)].curve = curve;
    if (line == mActive && mPicked >= int32(curve.Points().size()))
        mPicked = -1;
    update();
}

void CurveGraph::SetLineVisible(int32 line, bool visible)
{
    if (line >= 0 && line < int32(mLines.size()) && mLines[std::size_t(line)].visible != visible) {
        mLines[std::size_t(line)].visible = visible;
        update();
    }
}

void CurveGraph::SetActive(int32 line)
{
    if (line == mActive || line < 0 || line >= int32(mLines.size()))
        return;
    mActive = line;
    mPicked = -1;
    update();
}

void CurveGraph::SetPlots(std::vector<Plot> plots)
{
    mPlots = std::move(plots);
    update();
}

void CurveGraph::SetHistogram(std::vector<float> heights, QColor colour)
{
    mHistogram = std::move(heights);
    mHistogramColour = colour;
    update();
}

void CurveGraph::SetDefaultView(const QRectF &view)
{
    mDefaultView = view.normalized();
    SetView(mDefaultView);
}

void CurveGraph::SetView(const QRectF &view)
{
    const QRectF tidy = view.normalized();
    if (!(tidy.width() >= kMinSpan && tidy.height() >= kMinSpan) || tidy == mView)
        return;
    mView = tidy;
    update();
}

void CurveGraph::SetGrid(int32 divisions)
{
    mGrid = std::clamp(divisions, 0, 64);
    update();
}

void CurveGraph::SetSnap(float64 stepX, float64 stepY)
{
    mSnapX = std::max(0.0, stepX);
    mSnapY = std::max(0.0, stepY);
}

void CurveGraph::SetDiagonal(bool on)
{
    mDiagonal = on;
    update();
}

void CurveGraph::SetShowCoords(bool on)
{
    mShowCoords = on;
    update();
}

QPointF CurveGraph::ToPixel(CurvePoint p, const QRectF &view, QSize size)
{
    const float64 w = std::max(1, size.width() - 2 * kMargin), h = std::max(1, size.height() - 2 * kMargin);
    return {kMargin + (p.x - view.left()) / view.width() * w,
            size.height() - kMargin - (p.y - view.top()) / view.height() * h};
}

CurvePoint CurveGraph::ToValue(QPointF pixel, const QRectF &view, QSize size)
{
    const float64 w = std::max(1, size.width() - 2 * kMargin), h = std::max(1, size.height() - 2 * kMargin);
    return {view.left() + (pixel.x() - kMargin) / w * view.width(),
            view.top() + (size.height() - kMargin - pixel.y()) / h * view.height()};
}

float64 CurveGraph::Snap(float64 v, float64 step)
{
    return step > 0.0 ? std::round(v / step) * step : v;
}

// --- painting ---

void CurveGraph::paintEvent(QPaintEvent *event)
{
    if (!BeginDraw(event->rect()))
        return;
    QPainter &painter = *BackPainter();
    painter.fillRect(rect().adjusted(kMargin, kMargin, -kMargin, -kMargin), kGraphBackground);
    PaintGrid(painter);
    PaintHistogram(painter);
    painter.setRenderHint(QPainter::Antialiasing, true);
    for (const Plot &plot : mPlots)
        PaintPlot(painter, plot);
    for (std::size_t i = 0; i < mLines.size(); ++i)
        if (mLines[i].visible && int32(i) != mActive)
            PaintLine(painter, mLines[i], false);
    if (mActive < int32(mLines.size()) && mLines[std::size_t(mActive)].visible)
        PaintLine(painter, mLines[std::size_t(mActive)], true);
    PaintCoords(painter);
    painter.setRenderHint(QPainter::Antialiasing, false);
    EndDraw();
}

void CurveGraph::PaintGrid(QPainter &painter)
{
    const QRect inner = rect().adjusted(kMargin, kMargin, -kMargin - 1, -kMargin - 1);
    painter.setPen(kGridColour);
    for (int32 i = 1; i < mGrid; ++i) {
        const float64 v = float64(i) / mGrid;
        const QPointF a =
            ToPixel({mDefaultView.left() + v * mDefaultView.width(), mDefaultView.top() + v * mDefaultView.height()},
                    mView, size());
        painter.drawLine(QPointF(a.x(), inner.top()), QPointF(a.x(), inner.bottom()));
        painter.drawLine(QPointF(inner.left(), a.y()), QPointF(inner.right(), a.y()));
    }
    if (mDiagonal) {
        painter.setPen(QPen(kDiagonalColour, 1, Qt::DashLine));
        painter.drawLine(ToPixel({mView.left(), mView.left()}, mView, size()),
                         ToPixel({mView.right(), mView.right()}, mView, size()));
    }
    painter.setPen(kFrameColour);
    painter.setBrush(Qt::NoBrush);
    painter.drawRect(inner);
}

void CurveGraph::PaintHistogram(QPainter &painter)
{
    if (mHistogram.empty())
        return;
    const float64 bins = float64(mHistogram.size());
    QPainterPath path(ToPixel({0.0, 0.0}, mView, size()));
    for (std::size_t i = 0; i < mHistogram.size(); ++i) {
        const float64 x0 = float64(i) / bins, x1 = float64(i + 1) / bins, y = mHistogram[i];
        path.lineTo(ToPixel({x0, y}, mView, size()));
        path.lineTo(ToPixel({x1, y}, mView, size()));
    }
    path.lineTo(ToPixel({1.0, 0.0}, mView, size()));
    painter.save();
    painter.setClipRect(rect().adjusted(kMargin, kMargin, -kMargin, -kMargin), Qt::IntersectClip);
    painter.fillPath(path, mHistogramColour);
    painter.restore();
}

void CurveGraph::PaintPlot(QPainter &painter, const Plot &plot)
{
    QPolygonF line;
    line.reserve(int(plot.points.size()));
    for (const QPointF &p : plot.points)
        line << ToPixel({p.x(), p.y()}, mView, size());
    painter.setPen(QPen(plot.colour, 1.5, plot.dashed ? Qt::DashLine : Qt::SolidLine));
    painter.drawPolyline(line);
}

// The curve is drawn a pixel at a time across the graph, so any zoom shows
// it smooth; beyond its points it runs flat to the edges.
void CurveGraph::PaintLine(QPainter &painter, const Line &line, bool active)
{
    if (line.flags & Line_PointsOnly) {
        painter.setPen(QPen(line.colour, 1.6));
        for (const CurvePoint &p : line.curve.Points()) {
            painter.setBrush(active && mDragging ? QBrush(line.colour) : QBrush(kGraphBackground));
            painter.drawEllipse(ToPixel(p, mView, size()), kPointRadius, kPointRadius);
        }
        return;
    }
    const int32 from = kMargin, to = width() - kMargin;
    QPolygonF poly;
    poly.reserve(to - from + 1);
    for (int32 px = from; px <= to; ++px) {
        const float64 x = ToValue(QPointF(px, 0), mView, size()).x;
        poly << ToPixel({x, line.curve.Evaluate(x)}, mView, size());
    }
    QColor colour = line.colour;
    if (!active)
        colour.setAlphaF(colour.alphaF() * 0.45);
    painter.setPen(QPen(colour, active ? 1.6 : 1.0));
    painter.setBrush(Qt::NoBrush);
    painter.drawPolyline(poly);
    if (!active)
        return;
    const auto &points = line.curve.Points();
    for (int32 i = 0; i < int32(points.size()); ++i) {
        painter.setBrush(i == mPicked ? QBrush(colour) : QBrush(kGraphBackground));
        painter.drawEllipse(ToPixel(points[std::size_t(i)], mView, size()), kPointRadius, kPointRadius);
    }
}

void CurveGraph::PaintCoords(QPainter &painter)
{
    const Line *line = mActive < int32(mLines.size()) ? &mLines[std::size_t(mActive)] : nullptr;
    if (!mShowCoords || !mDragging || !line || mPicked < 0)
        return;
    const CurvePoint p = line->curve.Points()[std::size_t(mPicked)];
    painter.setPen(QColor(230, 230, 230));
    painter.drawText(rect().adjusted(kMargin + 3, kMargin + 2, 0, 0), Qt::AlignLeft | Qt::AlignTop,
                     QStringLiteral("%1, %2").arg(p.x, 0, 'f', 3).arg(p.y, 0, 'f', 3));
}

// --- the mouse and keys ---

CurveGraph::Line *CurveGraph::ActiveLine()
{
    if (mActive >= int32(mLines.size()) || !mLines[std::size_t(mActive)].visible || IsDisabled())
        return nullptr;
    return &mLines[std::size_t(mActive)];
}

int32 CurveGraph::PointAt(QPointF pixel) const
{
    if (mActive >= int32(mLines.size()))
        return -1;
    const float64 sx = (width() - 2 * kMargin) / mView.width(), sy = (height() - 2 * kMargin) / mView.height();
    return mLines[std::size_t(mActive)].curve.Nearest(ToValue(pixel, mView, size()), sx, sy, kPickTolerance);
}

// The active line keeps a press on its own point; else the first line
// with a point there takes it.
void CurveGraph::PickAnyLine(QPointF pixel)
{
    if (PointAt(pixel) >= 0)
        return;
    const int32 was = mActive;
    for (int32 i = 0; i < int32(mLines.size()); ++i) {
        mActive = i;
        if (mLines[std::size_t(i)].visible && PointAt(pixel) >= 0)
            return;
    }
    mActive = was;
}

void CurveGraph::mousePressEvent(QMouseEvent *event)
{
    mLastMouse = event->localPos();
    if (event->button() == Qt::MiddleButton) {
        mPanning = true;
        return;
    }
    if (event->button() == Qt::LeftButton && mPickAnyLine)
        PickAnyLine(event->localPos());
    Line *line = ActiveLine();
    if (event->button() != Qt::LeftButton || !line)
        return;
    mPicked = PointAt(event->localPos());
    if (mPicked < 0 && !(line->flags & Line_Fixed) && int32(line->curve.Points().size()) < mMaxPoints) {
        const CurvePoint at = ToValue(event->localPos(), mView, size());
        mPicked = line->curve.Insert({at.x, line->flags & Line_LockX ? line->curve.Evaluate(at.x) : at.y});
        emit Edited(mActive);
    }
    if (mPicked >= 0) {
        mDragging = true;
        mDragValue = line->curve.Points()[std::size_t(mPicked)];
    }
    update();
}

void CurveGraph::DragTo(QPointF pixel, Qt::KeyboardModifiers mods)
{
    Line *line = ActiveLine();
    if (!line || mPicked < 0)
        return;
    const float64 factor = mods & Qt::ControlModifier ? kFineFactor : 1.0;
    const CurvePoint a = ToValue(mLastMouse, mView, size()), b = ToValue(pixel, mView, size());
    mDragValue.x += (b.x - a.x) * factor;
    mDragValue.y += (b.y - a.y) * factor;
    CurvePoint target = {Snap(mDragValue.x, mSnapX), Snap(mDragValue.y, mSnapY)};
    if (mods & Qt::ShiftModifier && mGrid > 0) {
        target.x = Snap(target.x, mDefaultView.width() / mGrid);
        target.y = Snap(target.y, mDefaultView.height() / mGrid);
    }
    const CurvePoint now = line->curve.Points()[std::size_t(mPicked)];
    const bool end = mPicked == 0 || mPicked + 1 == int32(line->curve.Points().size());
    if (line->flags & Line_LockX || (end && line->flags & Line_LockEnds))
        target.x = now.x;
    if (line->flags & Line_LockY)
        target.y = now.y;
    if (line->curve.Move(mPicked, target))
        emit Edited(mActive);
    update();
}

void CurveGraph::mouseMoveEvent(QMouseEvent *event)
{
    const QPointF at = event->localPos();
    if (mPanning) {
        const CurvePoint a = ToValue(mLastMouse, mView, size()), b = ToValue(at, mView, size());
        SetView(mView.translated(a.x - b.x, a.y - b.y));
    } else if (mDragging) {
        DragTo(at, event->modifiers());
    }
    mLastMouse = at;
}

void CurveGraph::mouseReleaseEvent(QMouseEvent *event)
{
    if (event->button() == Qt::MiddleButton) {
        mPanning = false;
        return;
    }
    if (event->button() != Qt::LeftButton || !mDragging)
        return;
    mDragging = false;
    update();
    emit Released();
}

void CurveGraph::RemovePicked()
{
    Line *line = ActiveLine();
    if (!line || mPicked < 0 || line->flags & Line_Fixed || int32(line->curve.Points().size()) <= kMinPoints)
        return;
    line->curve.Remove(mPicked);
    mPicked = -1;
    update();
    emit Edited(mActive);
    emit Released();
}

void CurveGraph::mouseDoubleClickEvent(QMouseEvent *event)
{
    if (event->button() != Qt::LeftButton)
        return;
    // The press of the double click has picked the point (or added one).
    mDragging = false;
    mPicked = PointAt(event->localPos());
    RemovePicked();
}

void CurveGraph::wheelEvent(QWheelEvent *event)
{
    const float64 notches = event->angleDelta().y() / 120.0;
    if (notches == 0.0)
        return;
    const float64 scale = std::pow(kZoomPerNotch, -notches);
    const CurvePoint anchor = ToValue(event->position(), mView, size());
    SetView(QRectF(anchor.x - (anchor.x - mView.left()) * scale, anchor.y - (anchor.y - mView.top()) * scale,
                   mView.width() * scale, mView.height() * scale));
    event->accept();
}

void CurveGraph::keyPressEvent(QKeyEvent *event)
{
    if (event->key() == Qt::Key_Delete || event->key() == Qt::Key_Backspace)
        RemovePicked();
    else if (event->key() == Qt::Key_Home)
        SetView(mDefaultView);
    else
        CustomControl::keyPressEvent(event);
}

} // namespace Orbane
