#include "orbane/DIB.h"

#include "orbane/ResDIB.h"

#include <QColor>
#include <QFileInfo>
#include <QPainter>
#include <QSvgRenderer>

#include <algorithm>
#include <cmath>

namespace Orbane {

namespace {

int32 DeviceSize(int32 logical, qreal ratio)
{
    return int32(std::ceil(logical * ratio - 1e-9));
}

QRectF DeviceRect(const QRect &r, qreal ratio)
{
    return QRectF(r.x() * ratio, r.y() * ratio, r.width() * ratio, r.height() * ratio);
}

int32 Clamp255(int32 v)
{
    return std::min(255, std::max(0, v));
}

} // namespace

DIB::DIB(int32 width, int32 height, qreal ratio) : mWidth(std::max(0, width)), mHeight(std::max(0, height))
{
    if (ratio <= 0.0)
        ratio = 1.0;
    if (mWidth > 0 && mHeight > 0) {
        mImage = QImage(DeviceSize(mWidth, ratio), DeviceSize(mHeight, ratio), QImage::Format_ARGB32_Premultiplied);
        mImage.setDevicePixelRatio(ratio);
        mImage.fill(Qt::transparent);
    }
}

DIB::DIB(const QImage &image) : mImage(image.convertToFormat(QImage::Format_ARGB32_Premultiplied))
{
    const qreal ratio = mImage.devicePixelRatio();
    mWidth = int32(std::lround(mImage.width() / ratio));
    mHeight = int32(std::lround(mImage.height() / ratio));
}

DIB::~DIB() = default;

void DIB::Recycle() noexcept
{
    if (--mRefs <= 0)
        delete this;
}

DIB *DIB::FromResource(const char *name, qreal ratio)
{
    if (!name || !*name)
        return nullptr;
    const ResDIB *resource = ResDIB::Find(OrbID(name));
    if (!resource)
        return nullptr;
    DIB *dib = new DIB(resource->Image(ratio > 0.0 ? ratio : 1.0));
    dib->mWidth = resource->Size().width();
    dib->mHeight = resource->Size().height();
    return dib;
}

DIB *DIB::FromFile(const QString &path, qreal ratio)
{
    if (ratio <= 0.0)
        ratio = 1.0;
    if (path.endsWith(QLatin1String(".svg"), Qt::CaseInsensitive)) {
        QSvgRenderer svg(path);
        const QSize size = svg.defaultSize();
        if (!svg.isValid() || size.isEmpty())
            return nullptr;
        DIB *dib = new DIB(size.width(), size.height(), ratio);
        QPainter painter(&dib->mImage);
        painter.setRenderHint(QPainter::Antialiasing);
        svg.render(&painter, QRectF(0, 0, size.width(), size.height()));
        return dib;
    }
    QImage image;
    if (ratio > 1.0) {
        const QFileInfo info(path);
        const QString twin =
            info.path() + QLatin1Char('/') + info.completeBaseName() + QLatin1String("@2x.") + info.suffix();
        if (image.load(twin))
            image.setDevicePixelRatio(2.0);
    }
    if (image.isNull() && !image.load(path))
        return nullptr;
    return new DIB(image);
}

DIB *DIB::Copy() const
{
    DIB *copy = new DIB(mImage.copy());
    copy->mWidth = mWidth;
    copy->mHeight = mHeight;
    copy->mAntiAlias = mAntiAlias;
    return copy;
}

void DIB::Fill(const QColor &colour)
{
    if (IsValid())
        mImage.fill(colour);
}

void DIB::Clear()
{
    if (IsValid())
        mImage.fill(Qt::transparent);
}

bool DIB::Merge(QPainter &painter, const QRect &src, const QRect &dst, qreal opacity, OrbColor key) const
{
    if (!IsValid() || src.isEmpty() || dst.isEmpty() || opacity <= 0.0)
        return false;
    const qreal ratio = PixelRatio();
    QRectF from = DeviceRect(src, ratio);
    const QImage *image = &mImage;
    QImage keyed;
    if (!key.IsNone()) {
        // Only the part drawn is copied, so a keyed merge of a small
        // rectangle stays cheap.
        keyed = mImage.copy(from.toAlignedRect());
        const QRgb rgb = qRgb(key.R(), key.G(), key.B());
        for (int32 y = 0; y < keyed.height(); ++y) {
            QRgb *line = reinterpret_cast<QRgb *>(keyed.scanLine(y));
            for (int32 x = 0; x < keyed.width(); ++x)
                if ((qUnpremultiply(line[x]) & 0xFFFFFFu) == (rgb & 0xFFFFFFu) && qAlpha(line[x]))
                    line[x] = 0;
        }
        keyed.setDevicePixelRatio(ratio);
        from.moveTo(0, 0);
        image = &keyed;
    }
    const qreal oldOpacity = painter.opacity();
    painter.setOpacity(oldOpacity * opacity);
    if (src.size() == dst.size())
        painter.drawImage(QPointF(dst.topLeft()), *image, from);
    else
        painter.drawImage(QRectF(dst), *image, from);
    painter.setOpacity(oldOpacity);
    return true;
}

bool DIB::Merge(DIB &target, const QRect &src, const QRect &dst, qreal opacity, OrbColor key) const
{
    if (!target.IsValid())
        return false;
    QPainter painter(&target.mImage);
    painter.setRenderHint(QPainter::SmoothPixmapTransform, target.mAntiAlias);
    return Merge(painter, src, dst, opacity, key);
}

bool DIB::FillStretched(const DIB &src, const QMargins &fixed)
{
    if (!IsValid() || !src.IsValid())
        return false;
    Clear();
    // Fixed edges never take more than the source has, nor more than half
    // of the target each.
    const int32 l = std::min({fixed.left(), src.mWidth / 2, mWidth / 2});
    const int32 r = std::min({fixed.right(), src.mWidth - l, mWidth - l});
    const int32 t = std::min({fixed.top(), src.mHeight / 2, mHeight / 2});
    const int32 b = std::min({fixed.bottom(), src.mHeight - t, mHeight - t});
    const int32 sx[4] = {0, l, src.mWidth - r, src.mWidth};
    const int32 sy[4] = {0, t, src.mHeight - b, src.mHeight};
    const int32 dx[4] = {0, l, mWidth - r, mWidth};
    const int32 dy[4] = {0, t, mHeight - b, mHeight};
    QPainter painter(&mImage);
    painter.setRenderHint(QPainter::SmoothPixmapTransform, mAntiAlias);
    for (int32 j = 0; j < 3; ++j)
        for (int32 i = 0; i < 3; ++i)
            src.Merge(painter, QRect(QPoint(sx[i], sy[j]), QPoint(sx[i + 1] - 1, sy[j + 1] - 1)),
                      QRect(QPoint(dx[i], dy[j]), QPoint(dx[i + 1] - 1, dy[j + 1] - 1)));
    return true;
}

void DIB::AdjustHLS(int32 hue, int32 lightness, int32 saturation)
{
    if (!IsValid())
        return;
    const int32 dl = lightness * 255 / 100;
    const int32 ds = saturation * 255 / 100;
    for (int32 y = 0; y < mImage.height(); ++y) {
        QRgb *line = reinterpret_cast<QRgb *>(mImage.scanLine(y));
        for (int32 x = 0; x < mImage.width(); ++x) {
            const int32 alpha = qAlpha(line[x]);
            if (!alpha)
                continue;
            int32 h, s, l;
            QColor colour(qUnpremultiply(line[x]));
            colour.getHsl(&h, &s, &l);
            if (h >= 0)
                h = ((h + hue) % 360 + 360) % 360;
            colour.setHsl(h, Clamp255(s + ds), Clamp255(l + dl), alpha);
            line[x] = qPremultiply(colour.rgba());
        }
    }
}

} // namespace Orbane
