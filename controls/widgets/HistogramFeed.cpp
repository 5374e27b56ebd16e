#include "widgets/HistogramFeed.h"

#include "orbane/ViewedImage.h"

#include <QMetaMethod>
#include <QThread>
#include <QThreadPool>

namespace Orbane {

HistogramFeed &HistogramFeed::Instance()
{
    static HistogramFeed feed;
    return feed;
}

HistogramFeed::HistogramFeed() : mCurrent(std::make_shared<Histogram>())
{
    mPool.setMaxThreadCount(1);
    connect(&ViewedImage::Instance(), &ViewedImage::Changed, this, &HistogramFeed::OnImageChanged);
}

HistogramFeed::~HistogramFeed()
{
    // A count still running would call back into a feed that is gone.
    mPool.waitForDone();
}

void HistogramFeed::OnImageChanged()
{
    if (isSignalConnected(QMetaMethod::fromSignal(&HistogramFeed::Updated)))
        Refresh();
}

void HistogramFeed::Refresh()
{
    const ViewedImage &viewed = ViewedImage::Instance();
    if (viewed.Serial() == mCountedSerial)
        return;
    mCountedSerial = viewed.Serial();
    const FloatImage image = viewed.Image();
    const uint64 serial = mCountedSerial;
    if (std::size_t(image.Width()) * std::size_t(image.Height()) <= Histogram::kSmallImage) {
        Take(serial, std::make_shared<Histogram>(Histogram::Count(image)));
        return;
    }
    // The copy shares the pixels, which nobody changes once made.
    mPool.start([this, image, serial] {
        auto counted = std::make_shared<const Histogram>(
            Histogram::CountParallel(image, std::max(1, QThread::idealThreadCount())));
        QMetaObject::invokeMethod(
            this, [this, serial, counted] { Take(serial, counted); }, Qt::QueuedConnection);
    });
}

void HistogramFeed::Take(uint64 serial, std::shared_ptr<const Histogram> histogram)
{
    if (serial != ViewedImage::Instance().Serial())
        return;
    mCurrent = std::move(histogram);
    emit Updated();
}

} // namespace Orbane
