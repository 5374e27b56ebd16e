#include "ViewerBackdrop.h"

#include <QPainter>

#include <cmath>

namespace Orbane {

namespace {

// Two greys a handle reads well on.
const QColor kDark(58, 58, 58), kLight(84, 84, 84);
constexpr float64 kSharpZoom = 3.0;

QPixmap CheckerTile()
{
    QImage tile(2, 2, QImage::Format_RGB32);
    tile.setPixelColor(0, 0, kLight);
    tile.setPixelColor(1, 1, kLight);
    tile.setPixelColor(1, 0, kDark);
    tile.setPixelColor(0, 1, kDark);
    return QPixmap::fromImage(tile);
}

} // namespace

void ViewerBackdrop::SetImage(const QImage &image)
{
    mImage = image.isNull() ? QImage() : image.convertToFormat(QImage::Format_ARGB32_Premultiplied);
    mScaled = QPixmap();
    mScaledZoom = 0.0;
}

QRectF ViewerBackdrop::WidgetRect(const ViewMapping &m)
{
    const OrbPoint topLeft = m.ViewerToWidget({m.Origin().x, m.Origin().y + m.SpanY()});
    return QRectF(topLeft.x, topLeft.y, m.SpanX(), m.SpanY());
}

void ViewerBackdrop::Paint(QPainter &p, const ViewMapping &m, qreal dpr) const
{
    const QRectF target = WidgetRect(m);
    if (HasImage())
        PaintImage(p, target, m, dpr);
    else
        PaintChecker(p, target, m.Zoom());
}

void ViewerBackdrop::PaintChecker(QPainter &p, const QRectF &target, float64 zoom) const
{
    static const QPixmap tile = CheckerTile();
    QBrush brush(tile);
    // One tile pixel is one cell; cells start at the image's top-left.
    brush.setTransform(QTransform::fromTranslate(target.left(), target.top()).scale(CellSize * zoom, CellSize * zoom));
    p.fillRect(target, brush);
}

void ViewerBackdrop::PaintImage(QPainter &p, const QRectF &target, const ViewMapping &m, qreal dpr) const
{
    const float64 zoom = m.Zoom();
    if (zoom < 1.0) {
        if (zoom != mScaledZoom || dpr != mScaledDpr) {
            const QSize device(std::max(1, int(std::lround(target.width() * dpr))),
                               std::max(1, int(std::lround(target.height() * dpr))));
            mScaled = QPixmap::fromImage(mImage.scaled(device, Qt::IgnoreAspectRatio, Qt::SmoothTransformation));
            mScaled.setDevicePixelRatio(dpr);
            mScaledZoom = zoom;
            mScaledDpr = dpr;
        }
        p.drawPixmap(target.topLeft(), mScaled);
        return;
    }
    // Zoomed in: only the part in the window; smooth at small zooms, and
    // sharp pixels from kSharpZoom on, where one looks at single pixels.
    const QRectF visible = target.intersected(QRectF(p.window()));
    if (visible.isEmpty())
        return;
    const float64 sx = mImage.width() / target.width(), sy = mImage.height() / target.height();
    const QRectF source((visible.left() - target.left()) * sx, (visible.top() - target.top()) * sy,
                        visible.width() * sx, visible.height() * sy);
    p.save();
    p.setRenderHint(QPainter::SmoothPixmapTransform, zoom < kSharpZoom);
    p.drawImage(visible, mImage, source);
    p.restore();
}

} // namespace Orbane
