#pragma once

#include "orbane/OrbColor.h"
#include "orbane/Types.h"

#include <QImage>
#include <QMargins>
#include <QRect>

class QPainter;

namespace Orbane {

// A device-independent bitmap: a premultiplied ARGB image measured in
// logical pixels, stored at a device pixel ratio so that it stays crisp on
// high-density screens. Shared by reference count: whoever stores a DIB calls
// Use, and Recycle when done; the last Recycle deletes it.
class DIB
{
public:
    // A transparent image of width x height logical pixels at `ratio`.
    DIB(int32 width, int32 height, qreal ratio = 1.0);
    // Takes the image as it is; its own device pixel ratio says how it maps
    // onto logical pixels.
    explicit DIB(const QImage &image);
    DIB(const DIB &) = delete;
    DIB &operator=(const DIB &) = delete;

    // A new DIB of the look pack's skin image `name` (ResDIB) rendered for
    // `ratio`. Null where the look pack has no such image.
    static DIB *FromResource(const char *name, qreal ratio);
    // Loads an image file (SVG rendered at `ratio`, or any raster format Qt
    // reads, with "@2x" taken for ratios above 1). Null where it cannot be read.
    static DIB *FromFile(const QString &path, qreal ratio);
    // A new, unshared copy.
    DIB *Copy() const;

    void Use() noexcept { ++mRefs; }
    void Recycle() noexcept;
    int32 UseCount() const noexcept { return mRefs; }

    int32 Width() const noexcept { return mWidth; }
    int32 Height() const noexcept { return mHeight; }
    QRect Rect() const noexcept { return QRect(0, 0, mWidth, mHeight); }
    qreal PixelRatio() const noexcept { return mImage.devicePixelRatio(); }
    bool IsValid() const noexcept { return !mImage.isNull(); }
    QImage &GetImage() noexcept { return mImage; }
    const QImage &GetImage() const noexcept { return mImage; }

    // Whether the DIB's own drawing (stretching) smooths; painting on the
    // image through another painter is not affected.
    void SetAntiAlias(bool on) noexcept { mAntiAlias = on; }
    bool AntiAlias() const noexcept { return mAntiAlias; }

    void Fill(const QColor &colour);
    void Clear();

    // Draws the `src` part of this image (logical pixels) into `dst` on the
    // painter, at `opacity`; pixels whose red, green and blue equal `key` are
    // left out (OrbColor() means no key). False where there is nothing to draw.
    bool Merge(QPainter &painter, const QRect &src, const QRect &dst, qreal opacity = 1.0,
               OrbColor key = OrbColor()) const;
    // The same onto another DIB.
    bool Merge(DIB &target, const QRect &src, const QRect &dst, qreal opacity = 1.0, OrbColor key = OrbColor()) const;

    // Fills the whole image with `src` stretched to fit. The `fixed` margins
    // of `src` (logical pixels) keep their size: corners are copied, edges
    // stretched along one axis, the middle along both (nine-slice).
    bool FillStretched(const DIB &src, const QMargins &fixed = QMargins());

    // Shifts every pixel's hue by `hue` degrees and adds `lightness` and
    // `saturation` (percent of full scale, -100..100), keeping alpha.
    void AdjustHLS(int32 hue, int32 lightness, int32 saturation);

protected:
    virtual ~DIB();

private:
    QImage mImage;
    int32 mWidth = 0;
    int32 mHeight = 0;
    int32 mRefs = 1;
    bool mAntiAlias = true;
};

} // namespace Orbane
