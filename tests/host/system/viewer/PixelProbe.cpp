#include "PixelProbe.h"

#include "QtGPainter.h"

#include <QPainter>

#include <cmath>

namespace Orbane {

PixelProbe::PixelProbe(int width, int height, qreal dpr, QColor background)
    : mHeight(height), mDpr(dpr), mBackground(background),
      mImage(int(width * dpr), int(height * dpr), QImage::Format_ARGB32_Premultiplied)
{
    mImage.setDevicePixelRatio(dpr);
    mImage.fill(background);
}

void PixelProbe::Paint(const std::function<void(Graphics::QtGPainter &)> &draw)
{
    QPainter painter(&mImage);
    Graphics::QtGPainter g(&painter, mHeight);
    draw(g);
}

QColor PixelProbe::At(qreal x, qreal y) const
{
    int dx = int(std::floor(x * mDpr));
    int dy = int(std::floor((mHeight - y) * mDpr));
    return mImage.pixelColor(dx, dy);
}

} // namespace Orbane
