#pragma once

#include "orbane/ViewMapping.h"

#include <QImage>
#include <QPixmap>

class QPainter;

namespace Orbane {

// What the viewer shows under the overlays: an image, or a checkerboard of
// a default size when there is none. Painted in widget pixels through a
// ViewMapping. At zooms below 1 the smoothly scaled image is kept for the
// device pixel ratio it was made for, so a repaint for a moved handle costs
// one blit; above 1 only the visible part is drawn.
class ViewerBackdrop
{
public:
    static constexpr int32 DefaultWidth = 1920;
    static constexpr int32 DefaultHeight = 1080;
    // Checkerboard cells, in image pixels.
    static constexpr int32 CellSize = 32;

    // A null image means "none": the checkerboard.
    void SetImage(const QImage &image);
    bool HasImage() const { return !mImage.isNull(); }
    const QImage &Image() const { return mImage; }
    // The checkerboard's size while there is no image: that of a picture on
    // its way, or of one that could not be read. Empty: the default.
    void SetPlaceholderSize(QSize size) { mPlaceholder = size; }
    int32 Width() const
    {
        return HasImage() ? mImage.width() : mPlaceholder.isEmpty() ? DefaultWidth : mPlaceholder.width();
    }
    int32 Height() const
    {
        return HasImage() ? mImage.height() : mPlaceholder.isEmpty() ? DefaultHeight : mPlaceholder.height();
    }

    // Where the image lies in widget pixels (Y down).
    static QRectF WidgetRect(const ViewMapping &m);
    void Paint(QPainter &p, const ViewMapping &m, qreal dpr) const;

private:
    void PaintChecker(QPainter &p, const QRectF &target, float64 zoom) const;
    void PaintImage(QPainter &p, const QRectF &target, const ViewMapping &m, qreal dpr) const;

    QImage mImage;
    QSize mPlaceholder;
    mutable QPixmap mScaled; // the image at the last zoom below 1
    mutable float64 mScaledZoom = 0.0;
    mutable qreal mScaledDpr = 0.0;
};

} // namespace Orbane
