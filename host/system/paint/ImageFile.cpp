#include "orbane/ImageFile.h"

#include <QImageReader>

namespace Orbane {

namespace {

bool Fail(QString *error, const QString &why)
{
    if (error)
        *error = why;
    return false;
}

bool CheckReader(QImageReader &reader, const QString &path, QString *error)
{
    const QSize size = reader.size();
    if (!reader.canRead() || !size.isValid())
        return Fail(error, QString("%1: not a readable image").arg(path));
    if (qint64(size.width()) * size.height() > ImageFile::kMaxPixels)
        return Fail(error, QString("%1: %2 x %3 pixels is more than the limit of %4")
                               .arg(path)
                               .arg(size.width())
                               .arg(size.height())
                               .arg(ImageFile::kMaxPixels));
    return true;
}

} // namespace

bool ImageFile::Check(const QString &path, QString *error)
{
    QImageReader reader(path);
    return CheckReader(reader, path, error);
}

QImage ImageFile::Read(const QString &path, QString *error)
{
    QImageReader reader(path);
    if (!CheckReader(reader, path, error))
        return QImage();
    const QImage image = reader.read();
    if (image.isNull())
        Fail(error, QString("%1: %2").arg(path, reader.errorString()));
    return image;
}

} // namespace Orbane
