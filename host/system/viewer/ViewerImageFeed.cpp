#include "ViewerImageFeed.h"

#include "orbane/ImageFile.h"

#include <QFileInfo>

#include <algorithm>
#include <cmath>
#include <limits>

namespace Orbane {

namespace {

// Progress reports closer than this are not worth a repaint.
constexpr float kProgressStep = 0.01f;

} // namespace

ViewerImageFeed::ViewerImageFeed(QObject *parent) : QObject(parent)
{
    // One read at a time: a newer one waits for the cancelled one to stop.
    mPool.setMaxThreadCount(1);
}

ViewerImageFeed::~ViewerImageFeed()
{
    ++mJob;
    mPool.waitForDone();
}

int32 ViewerImageFeed::FrameAt(float64 time)
{
    constexpr float64 lo = std::numeric_limits<int32>::min(), hi = std::numeric_limits<int32>::max();
    if (!std::isfinite(time))
        return 0;
    return int32(std::clamp(std::round(time), lo, hi));
}

void ViewerImageFeed::SetSource(const QString &source, float64 time)
{
    ++mJob;
    mState = ViewerImageState();
    mState.source = source;
    if (source.isEmpty())
        return Clear(QString());
    mState.sequence = ClipSequence::IsPattern(source);
    if (!mState.sequence)
        return Start(source, QString());
    mClip = ClipSequence::Detect(source);
    ShowFrame(FrameAt(time), true);
}

void ViewerImageFeed::SetTime(float64 time)
{
    const int32 frame = FrameAt(time);
    if (mState.sequence && frame != mState.frame)
        ShowFrame(frame, false);
}

void ViewerImageFeed::ShowFrame(int32 frame, bool force)
{
    mState.frame = frame;
    if (!mClip.HasFrame(frame))
        mClip = ClipSequence::Detect(mClip.pattern);
    mState.first = mClip.first;
    mState.last = mClip.last;
    if (mClip.IsEmpty()) {
        ++mJob;
        mState.file.clear();
        mState.shownFrame = frame;
        return Clear(QString("no frames of %1 found").arg(mClip.pattern));
    }
    const int32 shown = mClip.HeldFrame(frame);
    const QString note = shown == frame ? QString()
                                        : QString("frame %1 is missing (%2); showing frame %3")
                                              .arg(frame)
                                              .arg(QFileInfo(mClip.FrameFile(frame)).fileName())
                                              .arg(shown);
    const QString file = mClip.FrameFile(shown);
    if (!force && file == mState.file) {
        // The held frame is already shown (or on its way).
        mState.error = note;
        emit stateChanged();
        return;
    }
    mState.shownFrame = shown;
    Start(file, note);
}

void ViewerImageFeed::Start(const QString &file, const QString &note)
{
    const uint64 job = ++mJob;
    mState.file = file;
    mState.width = mState.height = mState.channels = 0;
    ImageFile::Header header;
    QString why;
    if (!ImageFile::ReadHeader(file, &header, &why))
        return Clear(why);
    mState.width = header.width;
    mState.height = header.height;
    mState.channels = std::min(header.channels, 4);
    mState.loading = true;
    mState.progress = 0.0f;
    mState.error = note;
    emit sizeKnown(QSize(header.width, header.height));
    emit stateChanged();
    mPool.start([this, job, file] {
        float reported = 0.0f;
        QString error;
        const FloatImage linear = ImageFile::ReadLinear(file, &error, [this, job, &reported](float done) {
            if (mJob.load() != job)
                return false;
            if (done - reported >= kProgressStep) {
                reported = done;
                QMetaObject::invokeMethod(
                    this, [this, job, done] { Progress(job, done); }, Qt::QueuedConnection);
            }
            return true;
        });
        // The picture for the screen is made here too: for a large float
        // file it costs about as much as the read.
        const QImage display = mJob.load() == job ? linear.ToDisplay() : QImage();
        QMetaObject::invokeMethod(
            this, [this, job, display, linear, error] { Finish(job, display, linear, error); }, Qt::QueuedConnection);
    });
}

void ViewerImageFeed::Progress(uint64 job, float done)
{
    if (job != mJob.load() || !mState.loading)
        return;
    mState.progress = done;
    emit stateChanged();
}

void ViewerImageFeed::Finish(uint64 job, const QImage &display, const FloatImage &linear, const QString &error)
{
    if (job != mJob.load())
        return;
    mState.loading = false;
    mState.progress = 1.0f;
    if (linear.IsNull())
        return Clear(error);
    emit imageReady(display, linear);
    emit stateChanged();
}

bool ViewerImageFeed::LoadNow(const QString &path, QString *error)
{
    const FloatImage linear = ImageFile::ReadLinear(path, error);
    if (linear.IsNull())
        return false;
    ++mJob;
    mState = ViewerImageState();
    mState.source = mState.file = path;
    mState.width = linear.Width();
    mState.height = linear.Height();
    mState.channels = linear.Channels();
    mState.progress = 1.0f;
    emit sizeKnown(QSize(linear.Width(), linear.Height()));
    emit imageReady(linear.ToDisplay(), linear);
    emit stateChanged();
    return true;
}

void ViewerImageFeed::Forget()
{
    ++mJob;
    mState = ViewerImageState();
    emit stateChanged();
}

void ViewerImageFeed::Clear(const QString &error)
{
    mState.loading = false;
    mState.error = error;
    emit cleared();
    emit stateChanged();
}

} // namespace Orbane
