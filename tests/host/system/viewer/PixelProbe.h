#pragma once

#include "QtGPainter.h"

#include <QColor>
#include <QImage>
#include <QPainter>

#include <cmath>
#include <functional>

namespace Orbane {

// A canvas for painter tests, painted through a QtGPainter and read back in
// viewer units (Y up from the bottom edge).
class PixelProbe
{
public:
    PixelProbe(int width, int height, QColor background = Qt::black)
        : mHeight(height), mBackground(background), mImage(width, height, QImage::Format_ARGB32_Premultiplied)
    {
        mImage.fill(background);
    }

    void Paint(const std::function<void(Graphics::QtGPainter &)> &draw)
    {
        QPainter painter(&mImage);
        Graphics::QtGPainter g(&painter, mHeight);
        draw(g);
    }

    QColor At(qreal x, qreal y) const
    {
        return mImage.pixelColor(int(std::floor(x)), int(std::floor(mHeight - y)));
    }
    bool IsBackground(qreal x, qreal y) const { return At(x, y) == mBackground; }

private:
    int mHeight;
    QColor mBackground;
    QImage mImage;
};

} // namespace Orbane
