#pragma once

#include "widgets/Histogram.h"

#include <QObject>
#include <QThreadPool>

#include <memory>

namespace Orbane {

// The histogram of the image the viewer shows, shared by every control that
// draws one. It counts only while some control listens (Updated), anew on
// every change of the viewed image: a small image on the spot, a large one
// on a worker thread whose result comes back to the user-interface thread
// as a queued call, where a result for an image already replaced is
// dropped. The controls read Current and keep no locks.
class HistogramFeed : public QObject
{
    Q_OBJECT
public:
    static HistogramFeed &Instance();
    ~HistogramFeed() override;

    // The last histogram counted; empty before the first image.
    std::shared_ptr<const Histogram> Current() const { return mCurrent; }
    // Counts the viewed image now where no count of it is under way or done.
    void Refresh();

signals:
    void Updated();

private:
    HistogramFeed();
    void OnImageChanged();
    void Take(uint64 serial, std::shared_ptr<const Histogram> histogram);

    std::shared_ptr<const Histogram> mCurrent;
    // Its own pool, so that the feed waits for a count still running before
    // it goes, whatever the order of static destruction.
    QThreadPool mPool;
    uint64 mCountedSerial = ~uint64(0); // the image of mCurrent or of the count under way
};

} // namespace Orbane
