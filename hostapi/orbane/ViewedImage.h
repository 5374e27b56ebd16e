#pragma once

#include "orbane/Types.h"

#include <QImage>
#include <QObject>

#include <vector>

namespace Orbane {

// Pixels as float RGBA, four floats a pixel, row by row from the top.
struct FloatRGBAImage
{
    int32 width = 0;
    int32 height = 0;
    std::vector<float> rgba;

    std::size_t PixelCount() const noexcept { return std::size_t(width) * std::size_t(height); }
};

// The image the viewer shows, for controls that measure it (the histogram
// of the levels and curves controls). The viewer hands its image over on
// every change; controls read it and hear of changes through Changed. Only
// the user-interface thread calls it; the image itself is implicitly
// shared, so a copy may be read on a worker thread.
class ViewedImage : public QObject
{
    Q_OBJECT
public:
    static ViewedImage &Instance();

    void Set(const QImage &image);
    QImage Image() const { return mImage; }
    // Counts the images set, so that a late result can tell it is stale.
    uint64 Serial() const noexcept { return mSerial; }

    // The image's values as float RGBA: 8- and 16-bit channels scaled to 0..1
    // as stored (code values, not linearised); a null image gives an empty one.
    static FloatRGBAImage ToFloatRGBA(const QImage &image);

signals:
    void Changed();

private:
    QImage mImage;
    uint64 mSerial = 0;
};

} // namespace Orbane
