#pragma once

#include "QtGPainter.h"

#include <QColor>
#include <QImage>
#include <QPainter>

#include <cmath>
#include <functional>

namespace Orbane {

// A canvas for painter tests: an image of a given logical size and device
// pixel ratio, painted through a QtGPainter, read back in viewer units
// (logical pixels, Y up from the bottom edge).
class PixelProbe
{
public:
    PixelProbe(int width, int height, qreal dpr = 1.0, QColor background = Qt::black)
        : mHeight(height), mDpr(dpr), mBackground(background),
          mImage(int(width * dpr), int(height * dpr), QImage::Format_ARGB32_Premultiplied)
    {
        mImage.setDevicePixelRatio(dpr);
        mImage.fill(background);
    }

    void Paint(const std::function<void(Graphics::QtGPainter &)> &draw)
    {
        QPainter painter(&mImage);
        Graphics::QtGPainter g(&painter, mHeight);
        draw(g);
    }

    // The device pixel that contains the viewer point (x, y).
    QColor At(qreal x, qreal y) const
    {
        return mImage.pixelColor(int(std::floor(x * mDpr)), int(std::floor((mHeight - y) * mDpr)));
    }
    QColor AtDevice(int dx, int dy) const { return mImage.pixelColor(dx, dy); }
    bool IsBackground(qreal x, qreal y) const { return At(x, y) == mBackground; }
    const QImage &Image() const { return mImage; }

private:
    int mHeight;
    qreal mDpr;
    QColor mBackground;
    QImage mImage;
};

} // namespace Orbane
