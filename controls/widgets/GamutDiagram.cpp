#include "widgets/GamutDiagram.h"

#include "orbane/ColourSpaces.h"
#include "orbane/ScriptVal.h"
#include "orbane/TagList.h"

#include <QMouseEvent>
#include <QPaintEvent>
#include <QPainter>
#include <QPainterPath>

#include <algorithm>
#include <cmath>
#include <vector>

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

// CIE XYZ at Y = 1 of a chromaticity; nothing below the x axis.
void XyzOf(XY xy, float *xyz)
{
    if (xy.y <= 0.0) {
        std::fill_n(xyz, 3, 0.0f);
        return;
    }
    xyz[0] = float(xy.x / xy.y);
    xyz[1] = 1.0f;
    xyz[2] = float((1.0 - xy.x - xy.y) / xy.y);
}

// A picture of a linear Rec. 709 colour, in place: negative channels
// dropped and normalised to the largest, a map of hues, not a measurement.
void Normalise(float *rgb)
{
    for (int32 c = 0; c < 3; ++c)
        rgb[c] = std::max(0.0f, rgb[c]);
    const float m = std::max({rgb[0], rgb[1], rgb[2], 1e-9f});
    for (int32 c = 0; c < 3; ++c)
        rgb[c] /= m;
}

int32 Code8(float encoded)
{
    return int32(std::lround(std::clamp(encoded, 0.0f, 1.0f) * 255.0f));
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
    // Every pixel's XYZ, converted in one pass.
    std::vector<float> colours(std::size_t(size.width()) * std::size_t(size.height()) * 3);
    float *at = colours.data();
    for (int32 y = 0; y < size.height(); ++y)
        for (int32 x = 0; x < size.width(); ++x, at += 3)
            XyzOf(FromPixel(QPointF((x + 0.5) / ratio, (y + 0.5) / ratio), plot), at);
    const std::size_t count = colours.size() / 3;
    ColourSpaces::XyzToRec709(colours.data(), count);
    for (std::size_t i = 0; i < count; ++i)
        Normalise(&colours[3 * i]);
    ColourSpaces::LinearToSrgb(colours.data(), count, 3, false);
    at = colours.data();
    for (int32 y = 0; y < size.height(); ++y) {
        auto *line = reinterpret_cast<QRgb *>(mFill.scanLine(y));
        for (int32 x = 0; x < size.width(); ++x, at += 3)
            line[x] = qRgb(Code8(at[0]), Code8(at[1]), Code8(at[2]));
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
