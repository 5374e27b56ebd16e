#pragma once

#include "orbane/OrbID.h"

#include <QImage>
#include <QPixmap>
#include <QSize>
#include <QString>

#include <map>
#include <mutex>

namespace Orbane {

// A named skin image of the look pack ("Controls.Slider.Knob.1"), shared by
// the whole process. The file is read once; each device pixel ratio asked
// for is rendered once (an SVG at that ratio, a PNG from its "@2x" twin when
// the ratio is above 1) and kept, so painting never scales a bitmap up.
class ResDIB
{
public:
    // The image of that name; null, with one warning, where the look pack
    // has no readable image of it.
    static const ResDIB *Find(const OrbID &name);
    // As Find, but never null: a missing image answers an empty ResDIB.
    static const ResDIB &Get(const OrbID &name);

    const OrbID &GetName() const { return mName; }
    bool IsNull() const { return mSize.isEmpty(); }
    // Logical size in device-independent pixels.
    QSize Size() const { return mSize; }
    // The image rendered for `dpr`: Size() * dpr pixels, with its device
    // pixel ratio set. A null image where this ResDIB is empty.
    QImage Image(qreal dpr) const;
    QPixmap Pixmap(qreal dpr) const;

    ResDIB(const ResDIB &) = delete;
    ResDIB &operator=(const ResDIB &) = delete;

private:
    ResDIB(const OrbID &name, const QString &path);
    QImage Render(qreal dpr) const;
    QImage RenderSvg(qreal dpr) const;
    QImage LoadRaster(qreal dpr) const;

    OrbID mName;
    QString mPath;
    QSize mSize;
    mutable std::mutex mLock;
    mutable std::map<qreal, QImage> mRendered;
};

} // namespace Orbane
