#pragma once

#include "orbane/ClipSequence.h"
#include "orbane/FloatImage.h"
#include "orbane/ViewerImageState.h"

#include <QImage>
#include <QObject>
#include <QSize>
#include <QThreadPool>

#include <atomic>

namespace Orbane {

// Feeds the viewer its picture: a still file, or the frame of the current
// time of a sequence, decoded on a worker thread so the window never waits
// for a large file. Only the header is read on the calling thread, so the
// viewer knows the size (and the overlays their place) at once.
//
// A newer request cancels an older read: the old one stops at its next
// progress report and its result is dropped. Results and progress come
// back through queued calls, on the thread the feed lives on.
//
// A missing frame holds the nearest earlier frame (else the first later
// one), as playback holds a frame, and says so in the state's error; the
// folder is looked at again first, in case the frame was rendered since.
class ViewerImageFeed : public QObject
{
    Q_OBJECT
public:
    explicit ViewerImageFeed(QObject *parent = nullptr);
    // Stops the read under way and waits for it.
    ~ViewerImageFeed() override;

    // A file or a pattern of frames, shown at `time`; empty: none.
    void SetSource(const QString &source, float64 time);
    // A sequence shows the frame of `time`; a still image stays.
    void SetTime(float64 time);
    // Reads `path` now, on this thread; false with the reason where it
    // cannot, and then what was shown stays.
    bool LoadNow(const QString &path, QString *error);
    // Drops the source and any read under way: the viewer was given an
    // image by other means.
    void Forget();
    const ViewerImageState &State() const { return mState; }

    // The frame of a time: the nearest whole frame.
    static int32 FrameAt(float64 time);

signals:
    // The file to come has this size (from its header).
    void sizeKnown(QSize size);
    void imageReady(const QImage &display, const Orbane::FloatImage &linear);
    // Nothing to show: no source, no frames, a file that cannot be read.
    void cleared();
    void stateChanged();

private:
    void ShowFrame(int32 frame, bool force);
    void Start(const QString &file, const QString &note);
    void Progress(uint64 job, float done);
    void Finish(uint64 job, const QImage &display, const FloatImage &linear, const QString &error);
    void Clear(const QString &error);

    QThreadPool mPool;
    std::atomic<uint64> mJob{0}; // the read that counts; workers compare against it
    ClipSequence mClip;
    ViewerImageState mState;
};

} // namespace Orbane
