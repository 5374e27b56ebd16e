#include "inputcontrols/ImageControl.h"

#include "orbane/AutoParam.h"
#include "orbane/ElideLabel.h"
#include "orbane/Input.h"

#include <QFileInfo>
#include <QLabel>
#include <QPainter>

namespace Orbane {

namespace {

constexpr const char *kLayoutItem = "Controls.Image.Layout";
constexpr int32 kThumbHeight = 72; // logical pixels; the layout gives the width

// The image fitted into `size` over a checkerboard, at `ratio` device pixels.
QPixmap Thumbnail(const QImage &image, QSize size, qreal ratio)
{
    const QSize device = size * ratio;
    QImage out(device, QImage::Format_ARGB32_Premultiplied);
    out.fill(QColor(40, 40, 40));
    QPainter p(&out);
    const QSize fitted = image.size().scaled(device, Qt::KeepAspectRatio);
    const QRect at(QPoint((device.width() - fitted.width()) / 2, (device.height() - fitted.height()) / 2), fitted);
    const int32 cell = int32(6 * ratio);
    for (int32 y = at.top(); y <= at.bottom(); y += cell)
        for (int32 x = at.left(); x <= at.right(); x += cell)
            p.fillRect(QRect(x, y, cell, cell).intersected(at), ((x - at.left()) / cell + (y - at.top()) / cell) % 2
                                                                    ? QColor(150, 150, 150)
                                                                    : QColor(200, 200, 200));
    p.setRenderHint(QPainter::SmoothPixmapTransform);
    p.drawImage(at, image);
    p.end();
    QPixmap pixmap = QPixmap::fromImage(out);
    pixmap.setDevicePixelRatio(ratio);
    return pixmap;
}

} // namespace

ImageControl::ImageControl(const Registry *reg, const ScriptVal &args, const TagList &tags)
    : LabelledInputControl(reg, args, tags), mThumbnail(new QLabel(this)), mInfo(new QLabel(this))
{
    mThumbnail->setObjectName("thumbnail");
    mInfo->setObjectName("info");
    mThumbnail->setAlignment(Qt::AlignCenter);
    RegisterChild("thumbnail", mThumbnail);
    RegisterChild("info", mInfo);
    ClassLayout(kLayoutItem);
}

ImageControl::~ImageControl() = default;

QString ImageControl::Describe(const QImage &image)
{
    switch (image.format()) {
    case QImage::Format_Grayscale8:
        return "Grey 8-bit";
    case QImage::Format_Grayscale16:
        return "Grey 16-bit";
    case QImage::Format_RGBX64:
        return "RGB 16-bit";
    case QImage::Format_RGBA64:
    case QImage::Format_RGBA64_Premultiplied:
        return "RGBA 16-bit";
    default:
        return image.hasAlphaChannel() ? "RGBA 8-bit" : "RGB 8-bit";
    }
}

bool ImageControl::Open(QWidget *host, const QRect &rect, const TagList *tags)
{
    if (!LabelledInputControl::Open(host, rect, tags))
        return false;
    if (Input *in = GetCurrentInput()) {
        const AutoParameter now(in->GetValue(GetCurrentTime()));
        mValue = AutoRef<ImageParam>::Share(dynamic_cast<ImageParam *>(now.get()));
    }
    ShowChild(Label());
    ShowChild(mThumbnail);
    ShowChild(mInfo);
    PlaceChildren(ClassLayout(kLayoutItem), false);
    ShowValue();
    return true;
}

bool ImageControl::NotifyChanged(Input *input, Parameter *value, const TagList *tags)
{
    if (!value)
        return LabelledInputControl::NotifyChanged(input, value, tags);
    auto *image = dynamic_cast<ImageParam *>(value);
    if (!image || (mValue && mValue->Equals(*image)))
        return true;
    mValue = AutoRef<ImageParam>::Share(image);
    return LabelledInputControl::NotifyChanged(input, value, tags);
}

bool ImageControl::UpdateDisplay(Input *input, const TagList *tags)
{
    if (IsOpen())
        ShowValue();
    return LabelledInputControl::UpdateDisplay(input, tags);
}

void ImageControl::ShowValue()
{
    const QImage image = mValue ? mValue->Image : QImage();
    if (image.isNull()) {
        mThumbnail->clear();
        const QString path = mValue ? QString::fromStdString(mValue->Path.str()) : QString();
        mInfo->setText(path.isEmpty() ? tr("no image") : tr("cannot read %1").arg(QFileInfo(path).fileName()));
        return;
    }
    const QSize box(std::max(16, mThumbnail->width()), kThumbHeight);
    mThumbnail->setPixmap(Thumbnail(image, box, devicePixelRatioF()));
    mInfo->setText(QString("%1 x %2, %3").arg(image.width()).arg(image.height()).arg(Describe(image)));
    mInfo->setToolTip(QString::fromStdString(mValue->Path.str()));
}

bool ImageControl::OnDisconnect(Input *input, const TagList *tags)
{
    // The control never changes the image; what it showed goes back as it was.
    if (input && mValue)
        input->SetValue(AutoRef<Parameter>(mValue->Clone()).get(), TIME_DISCONNECT, SETVALUE_NoUndo, nullptr);
    return LabelledInputControl::OnDisconnect(input, tags);
}

} // namespace Orbane
