#include "widgets/GamutDiagram.h"

#include "widgets/ColorMath.h"

#include "orbane/ScriptVal.h"
#include "orbane/TagList.h"

#include <QMouseEvent>
#include <QPaintEvent>
#include <QPainter>
#include <QPainterPath>

#include <array>
#include <cmath>

namespace Orbane {

using Chromaticity::XY;

namespace {

constexpr float64 kMargin = 6.0;

QPainterPath LocusPath(const QRectF &plot)
{
    QPainterPath path;
    const auto &locus = Chromaticity::SpectralLocus();
    for (size_t i = 0; i < locus.size(); ++i) {
        const QPointF p = GamutDiagram::ToPixel(locus[i].xy, plot);
        i == 0 ? path.moveTo(p) : path.lineTo(p);
    }
    path.closeSubpath(); // the line of purples
    return path;
}

using Matrix = std::array<std::array<float64, 3>, 3>;

Matrix Inverse(const Matrix &m)
{
    const float64 det = m[0][0] * (m[1][1] * m[2][2] - m[1][2] * m[2][1]) -
                        m[0][1] * (m[1][0] * m[2][2] - m[1][2] * m[2][0]) +
                        m[0][2] * (m[1][0] * m[2][1] - m[1][1] * m[2][0]);
    Matrix r{};
    for (int32 i = 0; i < 3; ++i)
        for (int32 j = 0; j < 3; ++j) {
            // The cofactor of (j, i), by cyclic indices.
            const int32 a = (j + 1) % 3, b = (j + 2) % 3, c = (i + 1) % 3, d = (i + 2) % 3;
            r[size_t(i)][size_t(j)] = (m[size_t(a)][size_t(c)] * m[size_t(b)][size_t(d)] -
                                       m[size_t(a)][size_t(d)] * m[size_t(b)][size_t(c)]) /
                                      det;
        }
    return r;
}

// XYZ to linear RGB of a gamut, derived from its primaries and white point
// (the usual construction: primaries as columns, scaled so that RGB 1, 1, 1
// is the white at Y = 1), so no matrix is typed in by hand.
Matrix XyzToRgb(const Chromaticity::Gamut &g)
{
    const auto column = [](XY p) { return std::array<float64, 3>{p.x / p.y, 1.0, (1.0 - p.x - p.y) / p.y}; };
    const std::array<float64, 3> cr = column(g.red), cg = column(g.green), cb = column(g.blue), w = column(g.white);
    const Matrix primaries{{{cr[0], cg[0], cb[0]}, {cr[1], cg[1], cb[1]}, {cr[2], cg[2], cb[2]}}};
    const Matrix inv = Inverse(primaries);
    Matrix m{};
    for (size_t i = 0; i < 3; ++i) {
        const float64 scale = inv[i][0] * w[0] + inv[i][1] * w[1] + inv[i][2] * w[2];
        for (size_t row = 0; row < 3; ++row)
            m[row][i] = primaries[row][i] * scale;
    }
    return Inverse(m);
}

// A picture of the colour at xy through linear Rec. 709, negative channels
// dropped and normalised to the largest: a map of hues, not a measurement.
QRgb ColourAt(XY xy)
{
    static const Matrix toRgb = [] {
        Chromaticity::Gamut rec709;
        Chromaticity::StandardGamut("Rec. 709", rec709);
        return XyzToRgb(rec709);
    }();
    if (xy.y <= 0.0)
        return qRgb(0, 0, 0);
    const std::array<float64, 3> xyz{xy.x / xy.y, 1.0, (1.0 - xy.x - xy.y) / xy.y};
    float64 rgb[3];
    for (size_t i = 0; i < 3; ++i)
        rgb[i] = std::max(0.0, toRgb[i][0] * xyz[0] + toRgb[i][1] * xyz[1] + toRgb[i][2] * xyz[2]);
    const float64 m = std::max({rgb[0], rgb[1], rgb[2], 1e-9});
    return ColorMath::ToDisplay({rgb[0] / m, rgb[1] / m, rgb[2] / m, 1.0}).rgb();
}

} // namespace

GamutDiagram::GamutDiagram() : CustomControl(nullptr, ScriptVal(), TagList())
{
    Chromaticity::StandardGamut("Rec. 709", mGamut);
    setMinimumSize(120, 120);
}

GamutDiagram::~GamutDiagram() = default;

void GamutDiagram::SetGamut(const Chromaticity::Gamut &gamut)
{
    mGamut = gamut;
    update();
}

QRectF GamutDiagram::Plot() const
{
    // Square units on both axes, as the diagram is drawn everywhere.
    const float64 unit = std::min((width() - 2 * kMargin) / kMaxX, (height() - 2 * kMargin) / kMaxY);
    return QRectF(kMargin, kMargin, unit * kMaxX, unit * kMaxY);
}

QPointF GamutDiagram::ToPixel(XY xy, const QRectF &plot)
{
    return QPointF(plot.left() + xy.x / kMaxX * plot.width(), plot.bottom() - xy.y / kMaxY * plot.height());
}

XY GamutDiagram::FromPixel(QPointF pixel, const QRectF &plot)
{
    return {(pixel.x() - plot.left()) / plot.width() * kMaxX, (plot.bottom() - pixel.y()) / plot.height() * kMaxY};
}

int32 GamutDiagram::PointAt(QPointF at) const
{
    const QRectF plot = Plot();
    int32 best = -1;
    float64 bestDistance = kPickRadius;
    // White first: it sits inside the triangle, where it is easy to lose.
    for (int32 i : {3, 0, 1, 2}) {
        const QPointF p = ToPixel(Chromaticity::PointOf(mGamut, i), plot);
        const float64 d = std::hypot(p.x() - at.x(), p.y() - at.y());
        if (d < bestDistance) {
            best = i;
            bestDistance = d;
        }
    }
    return best;
}

const QImage &GamutDiagram::Fill(const QRectF &plot, qreal ratio)
{
    const QSize size(int(width() * ratio), int(height() * ratio));
    if (mFill.size() == size && mFill.devicePixelRatio() == ratio)
        return mFill;
    mFill = QImage(size, QImage::Format_ARGB32_Premultiplied);
    mFill.fill(Qt::transparent);
    for (int32 y = 0; y < size.height(); ++y) {
        auto *line = reinterpret_cast<QRgb *>(mFill.scanLine(y));
        for (int32 x = 0; x < size.width(); ++x)
            line[x] = ColourAt(FromPixel(QPointF((x + 0.5) / ratio, (y + 0.5) / ratio), plot));
    }
    // Only the inside of the locus keeps its colour.
    QImage mask(size, QImage::Format_ARGB32_Premultiplied);
    mask.fill(Qt::transparent);
    QPainter p(&mask);
    p.scale(ratio, ratio);
    p.setRenderHint(QPainter::Antialiasing);
    p.fillPath(LocusPath(plot), Qt::white);
    p.setCompositionMode(QPainter::CompositionMode_SourceIn);
    p.resetTransform();
    p.drawImage(0, 0, mFill);
    p.end();
    mFill = mask;
    mFill.setDevicePixelRatio(ratio);
    return mFill;
}

void GamutDiagram::paintEvent(QPaintEvent *event)
{
    if (!BeginDraw(event->rect()))
        return;
    QPainter &p = *BackPainter();
    const QRectF plot = Plot();
    p.setPen(QColor(70, 70, 70));
    for (int32 i = 0; i <= 8; ++i) {
        const float64 v = i / 10.0;
        p.drawLine(ToPixel({v, 0.0}, plot), ToPixel({v, kMaxY}, plot));
        p.drawLine(ToPixel({0.0, v}, plot), ToPixel({kMaxX, v}, plot));
    }
    p.drawImage(QPointF(0, 0), Fill(plot, devicePixelRatioF()));
    p.setRenderHint(QPainter::Antialiasing);
    p.setPen(QPen(QColor(220, 220, 220), 1.0));
    p.drawPath(LocusPath(plot));
    QPolygonF triangle;
    for (int32 i = 0; i < 3; ++i)
        triangle << ToPixel(Chromaticity::PointOf(mGamut, i), plot);
    // Shadow pass, then the colour pass.
    p.setBrush(Qt::NoBrush);
    p.setPen(QPen(QColor(0, 0, 0, 200), 3.0));
    p.drawPolygon(triangle);
    p.setPen(QPen(QColor(255, 255, 255), 1.5));
    p.drawPolygon(triangle);
    for (int32 i = 0; i < 4; ++i) {
        const QPointF at = ToPixel(Chromaticity::PointOf(mGamut, i), plot);
        p.setPen(QPen(Qt::black, 1.0));
        p.setBrush(i == mDragged ? QColor(255, 220, 80) : (i == 3 ? QColor(255, 255, 255) : QColor(200, 200, 200)));
        p.drawEllipse(at, 3.5, 3.5);
    }
    EndDraw();
}

void GamutDiagram::mousePressEvent(QMouseEvent *event)
{
    if (event->button() != Qt::LeftButton || IsDisabled())
        return;
    mDragged = PointAt(event->localPos());
    update();
}

void GamutDiagram::mouseMoveEvent(QMouseEvent *event)
{
    if (mDragged < 0)
        return;
    XY xy = FromPixel(event->localPos(), Plot());
    // Points stay on the diagram; imaginary primaries (AP0's) may lie outside the locus.
    xy.x = std::clamp(xy.x, -0.1, kMaxX);
    xy.y = std::clamp(xy.y, -0.1, kMaxY + 0.1);
    Chromaticity::PointOf(mGamut, mDragged) = xy;
    update();
    emit Moved(mDragged, xy.x, xy.y);
}

void GamutDiagram::mouseReleaseEvent(QMouseEvent *event)
{
    if (event->button() != Qt::LeftButton || mDragged < 0)
        return;
    mDragged = -1;
    update();
    emit Released();
}

} // namespace Orbane
