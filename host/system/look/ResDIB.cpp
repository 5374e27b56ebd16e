#include "orbane/ResDIB.h"

#include "orbane/LookPack.h"

#include "orbane/ImageFile.h"
#include <QFileInfo>

#include <QImageReader>
#include <QPainter>
#include <QSvgRenderer>
#include <QtGlobal>

#include <cmath>
#include <memory>
#include <unordered_map>

namespace Orbane {

namespace {

bool IsSvg(const QString &path)
{
    return path.endsWith(QLatin1String(".svg"), Qt::CaseInsensitive);
}

QString TwinPath(const QString &path)
{
    const QFileInfo info(path);
    return info.path() + QLatin1Char('/') + info.completeBaseName() + QLatin1String("@2x.") + info.suffix();
}

int DeviceSize(int logical, qreal dpr)
{
    return int(std::ceil(logical * dpr - 1e-9));
}

qreal SaneRatio(qreal dpr)
{
    return dpr > 0.0 && dpr <= 16.0 ? dpr : 1.0;
}

struct Cache
{
    std::mutex lock;
    std::unordered_map<OrbID, std::unique_ptr<ResDIB>> images;
};

Cache &TheCache()
{
    static Cache cache;
    return cache;
}

} // namespace

ResDIB::ResDIB(const OrbID &name, const QString &path) : mName(name), mPath(path)
{
    if (path.isEmpty())
        return;
    if (IsSvg(path)) {
        const QSvgRenderer svg(path);
        if (svg.isValid())
            mSize = svg.defaultSize();
    } else {
        mSize = QImageReader(path).size();
    }
}

const ResDIB *ResDIB::Find(const OrbID &name)
{
    const ResDIB &image = Get(name);
    return image.IsNull() ? nullptr : &image;
}

const ResDIB &ResDIB::Get(const OrbID &name)
{
    Cache &cache = TheCache();
    std::lock_guard<std::mutex> lock(cache.lock);
    std::unique_ptr<ResDIB> &slot = cache.images[name];
    if (!slot) {
        slot.reset(new ResDIB(name, LookPack::Get().FindImageFile(name)));
        if (slot->IsNull())
            qWarning("ResDIB: no image \"%s\" in the look pack", name.c_str());
    }
    return *slot;
}

QImage ResDIB::Image(qreal dpr) const
{
    if (IsNull())
        return QImage();
    dpr = SaneRatio(dpr);
    std::lock_guard<std::mutex> lock(mLock);
    QImage &image = mRendered[dpr];
    if (image.isNull())
        image = Render(dpr);
    return image;
}

QPixmap ResDIB::Pixmap(qreal dpr) const
{
    return QPixmap::fromImage(Image(dpr));
}

QImage ResDIB::Render(qreal dpr) const
{
    QImage image = IsSvg(mPath) ? RenderSvg(dpr) : LoadRaster(dpr);
    image.setDevicePixelRatio(dpr);
    return image;
}

QImage ResDIB::RenderSvg(qreal dpr) const
{
    QImage image(DeviceSize(mSize.width(), dpr), DeviceSize(mSize.height(), dpr), QImage::Format_ARGB32_Premultiplied);
    image.fill(Qt::transparent);
    QSvgRenderer svg(mPath);
    QPainter painter(&image);
    painter.setRenderHint(QPainter::Antialiasing);
    svg.render(&painter, QRectF(0, 0, image.width(), image.height()));
    return image;
}

QImage ResDIB::LoadRaster(qreal dpr) const
{
    // The "@2x" twin where the screen is dense and the pack has one; any
    // other ratio is scaled smoothly from the best source.
    QImage source;
    if (dpr > 1.0)
        source = ImageFile::Read(TwinPath(mPath));
    if (source.isNull())
        source = ImageFile::Read(mPath);
    const QSize want(DeviceSize(mSize.width(), dpr), DeviceSize(mSize.height(), dpr));
    if (source.size() != want)
        source = source.scaled(want, Qt::IgnoreAspectRatio, Qt::SmoothTransformation);
    return source.convertToFormat(QImage::Format_ARGB32_Premultiplied);
}

} // namespace Orbane
