#include "OverlayProbe.h"
#include "ViewerFixture.h"

#include "orbane/AutoParam.h"
#include "orbane/ClassIDs.h"
#include "orbane/Input.h"
#include "orbane/InputWatcher.h"
#include "orbane/Operator.h"
#include "orbane/Point.h"
#include "orbane/Prefs.h"

#include <QAction>
#include <QProgressDialog>
#include <QTemporaryDir>
#include <QToolBar>
#include <QtTest>

#include <cmath>

using namespace Orbane;
using namespace Orbane::Test;

namespace {

constexpr int kWidth = 320, kHeight = 240, kFrames = 12;

// Where the feature lies in frame `f` (image pixels from the top-left
// pixel's centre, Y down): a drift between pixels in both directions.
QPointF Truth(int f)
{
    return {100.0 + 2.35 * (f - 1), 120.0 + 1.15 * (f - 1) - 0.04 * (f - 1) * (f - 1)};
}

// A feature of five soft blobs about `at` on a dark ground, evaluated at
// each pixel's centre, so it moves by exact fractions of a pixel.
QImage Frame(QPointF at)
{
    const QPointF blobs[] = {{0, 0}, {-6, -4}, {5, -5}, {-4, 6}, {7, 4}};
    const double weights[] = {1.0, 0.6, 0.8, 0.5, 0.7};
    QImage image(kWidth, kHeight, QImage::Format_RGB32);
    for (int y = 0; y < kHeight; ++y)
        for (int x = 0; x < kWidth; ++x) {
            double v = 0.15;
            for (int b = 0; b < 5; ++b) {
                const QPointF d = QPointF(x, y) - at - blobs[b];
                v += 0.8 * weights[b] * std::exp(-(d.x() * d.x() + d.y() * d.y()) / (2 * 2.5 * 2.5));
            }
            const int level = std::min(255, int(std::lround(255 * v)));
            image.setPixel(x, y, qRgb(level, level, level));
        }
    return image;
}

// Frames `first`..`last` as plate.####.png in `dir`; the pattern.
QString WriteFrames(const QTemporaryDir &dir, int first, int last)
{
    for (int f = first; f <= last; ++f)
        Frame(Truth(f)).save(dir.filePath(QString("plate.%1.png").arg(f, 4, 10, QChar('0'))));
    return dir.filePath("plate.####.png");
}

OrbPoint ToImage(QPointF px)
{
    return {(px.x() + 0.5) / kWidth, 1.0 - (px.y() + 0.5) / kHeight};
}

QPointF ToPixels(OrbPoint p)
{
    return {p.x * kWidth - 0.5, (1.0 - p.y) * kHeight - 0.5};
}

// The tracker's Point at `at` with its pattern and search sizes as Inputs
// 1 and 2.
Input *AddTracker(ViewerFixture &f, OrbPoint at, OrbPoint pattern, OrbPoint search)
{
    const TagList attrs{{INPA_PreviewControl, OrbID("TrackerControl")},
                        {INPA_OverlayInput, OrbID("Pattern")},
                        {INPA_OverlayInput, OrbID("Search")}};
    Input *track = f.AddPoint("Track", at.x, at.y, attrs);
    f.AddPoint("Pattern", pattern.x, pattern.y);
    f.AddPoint("Search", search.x, search.y);
    return track;
}

Input *AddSequenceTracker(ViewerFixture &f, int startFrame)
{
    return AddTracker(f, ToImage(Truth(startFrame)), {21.0 / kWidth, 21.0 / kHeight}, {41.0 / kWidth, 41.0 / kHeight});
}

QString MessageOf(const PreviewControl *overlay)
{
    ScriptVal state = ScriptVal::NewTable();
    overlay->GetState(state);
    return state.FindKeyConst(ScriptVal("trackMessage"))->GetString();
}

// Presses Cancel on the tracking dialog once the Input holds `keys` keys,
// as a hand would while the progress runs.
class CancelAt : public InputWatcher
{
public:
    CancelAt(Input *in, std::size_t keys) : mIn(in), mKeys(keys) { in->AttachWatcher(this); }
    ~CancelAt() override { mIn->DetachWatcher(this); }
    void OnInputChanged(Input *in, Parameter *, const TagList *) override
    {
        if (in->KeyTimes().size() < mKeys)
            return;
        for (QWidget *w : QApplication::topLevelWidgets())
            if (auto *dialog = qobject_cast<QProgressDialog *>(w); dialog && !dialog->wasCanceled()) {
                dialog->cancel();
                mCancelled = true;
            }
    }
    bool mCancelled = false;

private:
    Input *mIn;
    std::size_t mKeys;
};

} // namespace

class TrackerControlTest : public QObject
{
    Q_OBJECT

private slots:
    void initTestCase()
    {
        std::string why;
        QVERIFY2(ViewerFixture::LoadControls(&why), why.c_str());
        QVERIFY(mDir.isValid());
        mPattern = WriteFrames(mDir, 1, kFrames);
    }

    void track_data()
    {
        QTest::addColumn<int>("start");
        QTest::addColumn<QString>("event");
        QTest::addColumn<QString>("frames");
        QTest::addColumn<int>("tracked");
        QTest::newRow("forward through the sequence") << 1 << "TrackForward"
                                                      << "" << kFrames - 1;
        QTest::newRow("backward from the last frame") << kFrames << "TrackBackward"
                                                      << "" << kFrames - 1;
        QTest::newRow("forward, frames 3 to 8") << 3 << "TrackForward"
                                                << "3:8" << 5;
        QTest::newRow("backward to frame 9") << kFrames << "TrackBackward"
                                             << ":9" << 3;
    }
    // Each tracked key lies within half a pixel of where the feature is;
    // the run is one undo step that takes every key back.
    void track()
    {
        QFETCH(int, start);
        QFETCH(QString, event);
        QFETCH(QString, frames);
        QFETCH(int, tracked);
        ViewerFixture f;
        f.doc.SetCurrentTime(start);
        f.doc.SetPref(PREF_ViewerImage, mPattern.toStdString());
        Input *track = AddSequenceTracker(f, start);
        QVERIFY(f.Show());
        PreviewControl *overlay = f.OverlayOf(track);
        TagList tags{{PCA_FromScript, 1}};
        tags.Set(PCA_CommandValue, OrbString(frames.toUtf8().constData()));
        QVERIFY(overlay->HandleEvent(OrbID(event.toUtf8().constData()), &f.viewer.Info(), &tags));
        QCOMPARE(StateOf(overlay, "tracked"), double(tracked));
        QCOMPARE(int(track->KeyTimes().size()), tracked + 1);
        for (const double t : track->KeyTimes()) {
            const AutoParameter key(track->GetKey(t));
            const auto *p = dynamic_cast<const Point *>(key.get());
            QVERIFY(p);
            const QPointF error = ToPixels({p->X, p->Y}) - Truth(int(t));
            QVERIFY2(std::hypot(error.x(), error.y()) < 0.5,
                     qPrintable(QString("frame %1 off by %2, %3").arg(t).arg(error.x()).arg(error.y())));
        }
        const QString name = event == "TrackForward" ? "Track Forward" : "Track Backward";
        QCOMPARE(f.doc.UndoNames(), QStringList{name});
        QVERIFY(f.doc.Undo());
        QCOMPARE(track->KeyTimes().size(), std::size_t(0));
    }

    // Cancel in the progress dialog keeps the keys tracked so far, one step.
    void cancel()
    {
        ViewerFixture f;
        f.doc.SetCurrentTime(1);
        f.doc.SetPref(PREF_ViewerImage, mPattern.toStdString());
        Input *track = AddSequenceTracker(f, 1);
        QVERIFY(f.Show());
        QAction *forward = nullptr;
        for (QAction *a : f.viewer.OverlayToolBar()->actions())
            if (a->text() == "Track Forward")
                forward = a;
        QVERIFY(forward);
        CancelAt hand(track, 5); // the start and four tracked frames
        forward->trigger();
        QVERIFY(hand.mCancelled);
        QCOMPARE(int(track->KeyTimes().size()), 5);
        QCOMPARE(StateOf(f.OverlayOf(track), "tracked"), 4.0);
        QVERIFY2(MessageOf(f.OverlayOf(track)).contains("cancelled"), qPrintable(MessageOf(f.OverlayOf(track))));
        QCOMPARE(f.doc.UndoNames(), QStringList{"Track Forward"});
        QVERIFY(f.doc.Undo());
        QCOMPARE(track->KeyTimes().size(), std::size_t(0));
    }

    void cannotTrack_data()
    {
        QTest::addColumn<QString>("source"); // "" none, "single", "missing", or the sequence
        QTest::addColumn<double>("patternSize");
        QTest::addColumn<QString>("says");
        QTest::newRow("no sequence") << "" << 0.05 << "no image sequence";
        QTest::newRow("a single frame") << "single" << 0.05 << "at least two frames";
        QTest::newRow("a missing folder") << "missing" << 0.05 << "no frames found";
        QTest::newRow("pattern larger than the image") << "sequence" << 1.5 << "larger than the image";
        QTest::newRow("a frame outside the sequence") << "late" << 0.05 << "not in the sequence";
    }
    // A run that cannot start says why and changes nothing.
    void cannotTrack()
    {
        QFETCH(QString, source);
        QFETCH(double, patternSize);
        QFETCH(QString, says);
        QTemporaryDir single;
        ViewerFixture f;
        f.doc.SetCurrentTime(source == "late" ? 40 : 1);
        if (source == "single")
            f.doc.SetPref(PREF_ViewerImage, WriteFrames(single, 1, 1).toStdString());
        else if (source == "missing")
            f.doc.SetPref(PREF_ViewerImage, std::string("/nonexistent/folder/plate.####.png"));
        else if (!source.isEmpty())
            f.doc.SetPref(PREF_ViewerImage, mPattern.toStdString());
        Input *track = AddTracker(f, ToImage(Truth(1)), {patternSize, patternSize}, {1.6, 1.6});
        QVERIFY(f.Show());
        PreviewControl *overlay = f.OverlayOf(track);
        const TagList tags{{PCA_FromScript, 1}};
        QVERIFY(!overlay->HandleEvent(OrbID("TrackForward"), &f.viewer.Info(), &tags));
        QVERIFY2(MessageOf(overlay).contains(says), qPrintable(MessageOf(overlay)));
        QCOMPARE(StateOf(overlay, "tracked"), 0.0);
        QCOMPARE(track->KeyTimes().size(), std::size_t(0));
        QCOMPARE(f.UndoSteps(), 0);
    }

    void handles_data()
    {
        QTest::addColumn<QPoint>("grab"); // viewer pixels from the point, Y up
        QTest::addColumn<QPoint>("move");
        QTest::addColumn<QString>("input");
        QTest::addColumn<OrbPoint>("value");
        QTest::addColumn<QString>("undo");
        QTest::newRow("inside the pattern moves the point")
            << QPoint(5, 0) << QPoint(10, -10) << "Track" << OrbPoint(0.5 + 10.0 / 400, 0.5 + 10.0 / 200)
            << "Move Tracker";
        QTest::newRow("a pattern corner resizes the pattern")
            << QPoint(20, 20) << QPoint(10, -10) << "Pattern" << OrbPoint(60.0 / 400, 60.0 / 200)
            << "Resize Tracker Pattern";
        QTest::newRow("a search corner resizes the search area")
            << QPoint(-60, -40) << QPoint(-10, 10) << "Search" << OrbPoint(140.0 / 400, 100.0 / 200)
            << "Resize Tracker Search Area";
        QTest::newRow("the pattern stays inside the search area")
            << QPoint(20, 20) << QPoint(80, -80) << "Pattern" << OrbPoint(0.3, 0.4) << "Resize Tracker Pattern";
    }
    // Over the fixture's 400 x 200 image at zoom 1: the pattern box is 40
    // viewer pixels square, the search box 120 by 80.
    void handles()
    {
        QFETCH(QPoint, grab);
        QFETCH(QPoint, move);
        QFETCH(QString, input);
        QFETCH(OrbPoint, value);
        QFETCH(QString, undo);
        ViewerFixture f;
        AddTracker(f, {0.5, 0.5}, {0.1, 0.2}, {0.3, 0.4});
        QVERIFY(f.Show());
        const QPoint from = f.At({0.5, 0.5}, grab);
        f.Drag(from, from + move, 4);
        const OrbPoint got = f.PointOf(f.tool->FindInput(OrbID(input.toUtf8().constData())));
        QVERIFY2(std::fabs(got.x - value.x) < 1e-9 && std::fabs(got.y - value.y) < 1e-9, toString(got));
        QCOMPARE(f.doc.UndoNames(), QStringList{undo});
    }

private:
    QTemporaryDir mDir;
    QString mPattern;
};

QTEST_MAIN(TrackerControlTest)
#include "TrackerControlTest.moc"
