#pragma once

#include "widgets/Chromaticity.h"
#include "widgets/CustomControl.h"

#include <QImage>

namespace Orbane {

// The CIE 1931 xy chromaticity diagram: the spectral locus closed by the
// line of purples, filled with the colours it holds (clipped to the
// screen's), a gamut's triangle and its white point. A press near one of
// the four points picks it and a drag moves it; the owner writes on Moved
// and Released. x runs 0..0.8 to the right, y 0..0.9 upwards.
class GamutDiagram : public CustomControl
{
    Q_OBJECT
public:
    static constexpr float64 kMaxX = 0.8;
    static constexpr float64 kMaxY = 0.9;
    static constexpr float64 kPickRadius = 8.0; // logical pixels

    GamutDiagram();
    ~GamutDiagram() override;

    std::size_t SizeOf() const override { return sizeof(GamutDiagram); }

    void SetGamut(const Chromaticity::Gamut &gamut);
    const Chromaticity::Gamut &GetGamut() const noexcept { return mGamut; }

    // The plot's rectangle in the widget.
    QRectF Plot() const;
    static QPointF ToPixel(Chromaticity::XY xy, const QRectF &plot);
    static Chromaticity::XY FromPixel(QPointF pixel, const QRectF &plot);
    // The gamut point (0 red .. 3 white) within the pick radius of `at`, or -1.
    int32 PointAt(QPointF at) const;

signals:
    void Moved(int index, float64 x, float64 y);
    void Released();

protected:
    void paintEvent(QPaintEvent *event) override;
    void mousePressEvent(QMouseEvent *event) override;
    void mouseMoveEvent(QMouseEvent *event) override;
    void mouseReleaseEvent(QMouseEvent *event) override;

private:
    const QImage &Fill(const QRectF &plot, qreal ratio);

    Chromaticity::Gamut mGamut;
    int32 mDragged = -1;
    QImage mFill; // the locus filled, kept while the size stays
};

} // namespace Orbane
