#pragma once

#include "widgets/Curve.h"
#include "widgets/CustomControl.h"

#include <QColor>
#include <QPointF>
#include <QRectF>

#include <algorithm>
#include <vector>

namespace Orbane {

// A painted graph of tone curves over a grid, shared by the curves, levels,
// ranges, gamma and log controls. Several curves show at once; the active
// one takes the mouse:
// - a press on a point picks it, a press elsewhere adds one there (unless
//   the curve is Fixed); dragging moves the picked point between its
//   neighbours, Ctrl ten times finer, Shift snapped to the grid;
// - a double click on a point, or Delete, removes it (a curve keeps two);
// - the wheel zooms about the mouse, a middle drag pans, Home shows the
//   whole view again.
// Plots (lines computed by the owner, such as a transfer function) and a
// histogram are drawn under the curves. The graph writes nothing: it tells
// its owner of each edit (Edited) and of the gesture's end (Released).
class CurveGraph : public CustomControl
{
    Q_OBJECT
public:
    enum LineFlag : uint32
    {
        Line_Fixed = 1,       // no point added or removed
        Line_LockX = 2,       // points move up and down only
        Line_LockY = 4,       // points move sideways only
        Line_LockEnds = 8,    // the first and last points move up and down only
        Line_PointsOnly = 16, // handles on a plot: the points without the curve
    };
    struct Line
    {
        Curve curve;
        QColor colour;
        uint32 flags = 0;
        bool visible = true;
    };
    struct Plot
    {
        std::vector<QPointF> points; // in values
        QColor colour;
        bool dashed = false;
    };

    // Room kept round the graph so that points at its edges are whole.
    static constexpr int32 kMargin = 6;
    static constexpr float64 kPickTolerance = 6.0;
    static constexpr float64 kFineFactor = 0.1;
    static constexpr int32 kMinPoints = 2;

    explicit CurveGraph(QWidget *parent = nullptr);

    void SetLines(std::vector<Line> lines);
    const std::vector<Line> &Lines() const noexcept { return mLines; }
    void SetCurve(int32 line, const Curve &curve);
    const Curve &GetCurve(int32 line) const { return mLines[std::size_t(line)].curve; }
    void SetLineVisible(int32 line, bool visible);
    void SetActive(int32 line);
    int32 Active() const noexcept { return mActive; }
    int32 Picked() const noexcept { return mPicked; }
    void SetPlots(std::vector<Plot> plots);
    // Bar heights 0..1 over the x range 0..1; empty: no histogram.
    void SetHistogram(std::vector<float> heights, QColor colour);

    // The values shown; the default view is what Home goes back to.
    void SetDefaultView(const QRectF &view);
    void SetView(const QRectF &view);
    const QRectF &View() const noexcept { return mView; }
    void SetGrid(int32 divisions);
    // Steps that points always snap to (0: none).
    void SetSnap(float64 stepX, float64 stepY);
    void SetDiagonal(bool on);
    void SetShowCoords(bool on);
    // A press on a point of any visible line makes that line the active one.
    void SetPickAnyLine(bool on) { mPickAnyLine = on; }
    // The most points a press may make a curve have.
    void SetMaxPoints(int32 count) { mMaxPoints = std::max(kMinPoints, count); }

    // Mappings between values and pixels of a graph `size` showing `view`
    // (y up): pure, for the tests and the drags alike.
    static QPointF ToPixel(CurvePoint p, const QRectF &view, QSize size);
    static CurvePoint ToValue(QPointF pixel, const QRectF &view, QSize size);
    static float64 Snap(float64 v, float64 step);

    QSize sizeHint() const override;

signals:
    void Edited(int line);
    void Released();

protected:
    void paintEvent(QPaintEvent *event) override;
    void mousePressEvent(QMouseEvent *event) override;
    void mouseMoveEvent(QMouseEvent *event) override;
    void mouseReleaseEvent(QMouseEvent *event) override;
    void mouseDoubleClickEvent(QMouseEvent *event) override;
    void wheelEvent(QWheelEvent *event) override;
    void keyPressEvent(QKeyEvent *event) override;

private:
    void PaintGrid(QPainter &painter);
    void PaintHistogram(QPainter &painter);
    void PaintPlot(QPainter &painter, const Plot &plot);
    void PaintLine(QPainter &painter, const Line &line, bool active);
    void PaintCoords(QPainter &painter);
    Line *ActiveLine();
    int32 PointAt(QPointF pixel) const;
    void PickAnyLine(QPointF pixel);
    void DragTo(QPointF pixel, Qt::KeyboardModifiers mods);
    void RemovePicked();

    std::vector<Line> mLines;
    std::vector<Plot> mPlots;
    std::vector<float> mHistogram;
    QColor mHistogramColour;
    QRectF mDefaultView{0.0, 0.0, 1.0, 1.0};
    QRectF mView{0.0, 0.0, 1.0, 1.0};
    int32 mGrid = 4;
    float64 mSnapX = 0.0;
    float64 mSnapY = 0.0;
    bool mDiagonal = true;
    bool mShowCoords = true;
    int32 mMaxPoints = 64;
    bool mPickAnyLine = false;
    int32 mActive = 0;
    int32 mPicked = -1;
    bool mDragging = false;
    bool mPanning = false;
    QPointF mLastMouse;
    CurvePoint mDragValue; // where the picked point would be without limits
};

} // namespace Orbane
