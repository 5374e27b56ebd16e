#pragma once

#include "orbane/Types.h"

#include <QWidget>

#include <vector>

namespace Orbane {

class Operator;
class OrbaneDoc;

// The painted strip of the time ruler: frame ticks over the document's
// range, the current time as a line, and a mark at every key of the shown
// tool's Inputs. Pressing or dragging sets the document's time (scrubbing),
// so every bound control and overlay shows the value at that time.
class TimeScale : public QWidget
{
    Q_OBJECT
public:
    explicit TimeScale(OrbaneDoc *doc, QWidget *parent = nullptr);

    void SetTool(const Operator *tool);
    const Operator *Tool() const { return mTool; }
    // The first and last frame shown; swapped where given the wrong way round.
    void SetRange(float64 first, float64 last);
    float64 First() const { return mFirst; }
    float64 Last() const { return mLast; }

    // The key times of every Input of the tool, earliest first, each once.
    std::vector<float64> KeyMarks() const;
    // Pixel <-> time over `width` pixels, the ends kMargin in from the edges;
    // times snap to whole frames when scrubbing.
    static int TimeToX(float64 time, float64 first, float64 last, int width);
    static float64 XToFrame(int x, float64 first, float64 last, int width);
    int XOf(float64 time) const { return TimeToX(time, mFirst, mLast, width()); }

    static constexpr int kMargin = 8;

    QSize sizeHint() const override { return QSize(400, 28); }

protected:
    void paintEvent(QPaintEvent *event) override;
    void mousePressEvent(QMouseEvent *event) override;
    void mouseMoveEvent(QMouseEvent *event) override;

private:
    void ScrubTo(int x);
    void PaintTicks(QPainter &painter) const;
    void PaintKeys(QPainter &painter) const;

    OrbaneDoc *mDoc;
    const Operator *mTool = nullptr;
    float64 mFirst = 0.0;
    float64 mLast = 100.0;
};

} // namespace Orbane
