#pragma once

#include <QColor>
#include <QImage>

#include <functional>

namespace Orbane {
namespace Graphics {
class QtGPainter;
} // namespace Graphics

// A canvas for painter tests: an image of a given logical size and device
// pixel ratio, painted through a QtGPainter, read back in viewer units
// (logical pixels, Y up from the bottom edge).
class PixelProbe
{
public:
    PixelProbe(int width, int height, qreal dpr = 1.0, QColor background = Qt::black);

    void Paint(const std::function<void(Graphics::QtGPainter &)> &draw);

    // The device pixel that contains the viewer point (x, y).
    QColor At(qreal x, qreal y) const;
    QColor AtDevice(int dx, int dy) const { return mImage.pixelColor(dx, dy); }
    bool IsBackground(qreal x, qreal y) const { return At(x, y) == mBackground; }
    const QImage &Image() const { return mImage; }
    qreal Dpr() const { return mDpr; }
    int Height() const { return mHeight; }

private:
    int mHeight;
    qreal mDpr;
    QColor mBackground;
    QImage mImage;
};

} // namespace Orbane
