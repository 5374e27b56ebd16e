#pragma once

#include "orbane/FloatImage.h"
#include "orbane/Types.h"

#include <QObject>

namespace Orbane {

// The image the viewer shows, published for controls that measure it but
// have no viewer of their own (the histograms of the levels and curves
// controls). It is the viewer's own linear image (ViewerPanel::LinearImage,
// the same pixels, not a copy), so a histogram counts the values a colour
// picker samples. The viewer sets it on every change; controls read it and
// hear of changes through Changed. Only the user-interface thread calls it;
// the pixels never change once made, so a copy may be read on a worker.
class ViewedImage : public QObject
{
    Q_OBJECT
public:
    static ViewedImage &Instance();

    void Set(const FloatImage &image);
    const FloatImage &Image() const { return mImage; }
    // Counts the images set, so that a late result can tell it is stale.
    uint64 Serial() const noexcept { return mSerial; }

signals:
    void Changed();

private:
    FloatImage mImage;
    uint64 mSerial = 0;
};

} // namespace Orbane
