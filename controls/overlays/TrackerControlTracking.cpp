// TrackerControl: following the pattern through the viewer's image sequence.
#include "overlays/PatternTracker.h"
#include "overlays/TrackerControl.h"

#include "orbane/AutoParam.h"
#include "orbane/ClipSequence.h"
#include "orbane/ImageFile.h"
#include "orbane/Input.h"
#include "orbane/OrbaneDoc.h"

#include <QApplication>
#include <QProgressDialog>

#include <cmath>
#include <memory>

namespace Orbane {

namespace {

// The sequence the viewer shows, or why there is none to track.
bool FindSequence(const OrbaneDoc &doc, ClipSequence &clip, QString &why)
{
    const QString source = QString::fromUtf8(doc.GetPrefs().GetString(PREF_ViewerImage, ""));
    if (source.isEmpty()) {
        why = "the viewer shows no image sequence to track";
        return false;
    }
    clip = ClipSequence::Detect(source);
    if (clip.IsEmpty())
        why = QString("no frames found at %1").arg(source);
    else if (!clip.IsSequence() || clip.count < 2)
        why = QString("tracking needs a sequence of at least two frames; %1 is %2").arg(source, clip.Describe());
    return why.isEmpty();
}

// A progress dialog in the window for a run the user started; none for a
// script, which no dialog may wait for.
std::unique_ptr<QProgressDialog> ProgressFor(bool fromScript, int32 frames)
{
    if (fromScript || !qobject_cast<QApplication *>(QCoreApplication::instance()))
        return nullptr;
    auto dialog = std::make_unique<QProgressDialog>("Tracking...", "Cancel", 0, frames, QApplication::activeWindow());
    dialog->setWindowTitle("Tracker");
    dialog->setWindowModality(Qt::WindowModal);
    dialog->setMinimumDuration(0);
    dialog->setValue(0);
    return dialog;
}

QPointF ToPixels(OrbPoint p, QSize size)
{
    return {p.x * size.width() - 0.5, (1.0 - p.y) * size.height() - 0.5};
}

OrbPoint FromPixels(QPointF p, QSize size)
{
    return {(p.x() + 0.5) / size.width(), 1.0 - (p.y() + 0.5) / size.height()};
}

} // namespace

void TrackerControl::Finish(int32 tracked, const QString &message)
{
    mTracked = tracked;
    mTrackMessage = message;
    Tell(message.toUtf8().constData());
    Redraw();
}

// Writes one key per frame tracked on the main Input (animated first),
// all of them one undo step, and says how it ended. Returns the frames
// tracked (0 where nothing could be).
int32 TrackerControl::Track(const Run &run)
{
    Input *input = GetMainInput();
    OrbaneDoc *doc = GetDoc();
    ClipSequence clip;
    QString why = input && doc ? QString() : QString("the tracker has no point to track");
    if (why.isEmpty())
        FindSequence(*doc, clip, why);
    const int32 end = run.end != INT32_MIN ? run.end : (run.step > 0 ? clip.last : clip.first);
    if (why.isEmpty() && !clip.HasFrame(run.start))
        why = QString("frame %1 is not in the sequence (%2)").arg(run.start).arg(clip.Describe());
    if (why.isEmpty() && (end - run.start) * run.step <= 0)
        why = QString("nothing to track %1 of frame %2").arg(run.step > 0 ? "forward" : "backward").arg(run.start);
    const QImage first = why.isEmpty() ? ImageFile::Read(clip.FrameFile(run.start), &why) : QImage();
    const AutoPoint from(input, run.start);
    PatternTracker tracker;
    PatternTracker::Settings settings;
    settings.pattern = QSizeF(mPattern.x * first.width(), mPattern.y * first.height());
    settings.search = QSizeF(mSearch.x * first.width(), mSearch.y * first.height());
    settings.subPixel = mSubPixel;
    settings.updatePattern = mPatternUpdate == 1;
    settings.minScore = mMinScore;
    if (why.isEmpty() && !from)
        why = "the tracker's point has no value";
    if (why.isEmpty())
        tracker.Start(first, ToPixels(OrbPoint(from->X, from->Y), first.size()), settings, &why);
    if (!why.isEmpty()) {
        Finish(0, "Cannot track: " + why);
        return 0;
    }

    OpenGesture(run.step > 0 ? "Track Forward" : "Track Backward");
    input->Animate(true);
    SetInputs(AutoPoint(from->X, from->Y, 0.0).get(), run.start, 0, nullptr);
    const int32 frames = std::abs(end - run.start);
    const std::unique_ptr<QProgressDialog> progress = ProgressFor(run.fromScript, frames);
    int32 tracked = 0;
    QString ended;
    for (int32 f = run.start + run.step; ended.isEmpty() && f != end + run.step; f += run.step) {
        if (progress && progress->wasCanceled()) {
            ended = QString("cancelled at frame %1").arg(f);
            break;
        }
        float64 score = 0.0;
        const QImage frame = clip.HasFrame(f) ? ImageFile::Read(clip.FrameFile(f), &why) : QImage();
        if (frame.isNull())
            ended = QString("frame %1 cannot be read%2").arg(f).arg(why.isEmpty() ? "" : ": " + why);
        else if (frame.size() != first.size())
            ended = QString("frame %1 is of another size").arg(f);
        else if (!tracker.Step(frame, &score))
            ended = QString("lost the pattern at frame %1 (match %2, at least %3 needed)")
                        .arg(f)
                        .arg(score, 0, 'f', 2)
                        .arg(mMinScore, 0, 'f', 2);
        if (!ended.isEmpty())
            break;
        const OrbPoint at = FromPixels(tracker.Position(), frame.size());
        SetInputs(AutoPoint(at.x, at.y, 0.0).get(), f, 0, nullptr);
        ++tracked;
        if (progress)
            progress->setValue(tracked);
    }
    ResetUndo(nullptr);
    CloseGesture();
    const QString done = QString("Tracked %1 frame%2 %3 from frame %4")
                             .arg(tracked)
                             .arg(tracked == 1 ? "" : "s")
                             .arg(run.step > 0 ? "forward" : "backward")
                             .arg(run.start);
    Finish(tracked, ended.isEmpty() ? done : done + "; " + ended);
    return tracked;
}

} // namespace Orbane
