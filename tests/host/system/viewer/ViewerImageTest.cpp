#include "TestImages.h"

#include "orbane/ImageFile.h"
#include "orbane/OrbaneDoc.h"
#include "orbane/Prefs.h"
#include "orbane/ViewerPanel.h"

#include <QTemporaryDir>
#include <QtTest>

using namespace Orbane;
using Orbane::Test::WriteFlatImage;
using Orbane::Test::WriteTestImage;

namespace {

constexpr int32 kWait = 30000;

// Frame n of the test sequence is flat at n / 10.
float FrameValue(int frame)
{
    return frame / 10.0f;
}

} // namespace

// The viewer's picture through a real document and a viewer on screen:
// pictures read on a worker thread, sequences following the document's time.
class ViewerImageTest : public QObject
{
    Q_OBJECT
private slots:
    void initTestCase()
    {
        QVERIFY(mDir.isValid());
        for (int frame : {1, 2, 4})
            QVERIFY(WriteFlatImage(Frame(frame).toStdString(), 8, 4, FrameValue(frame)));
        // Large enough to be read in many pieces.
        mLarge = mDir.filePath("large.exr");
        QVERIFY(WriteTestImage(mLarge.toStdString(), 1024, 1024, 4, OIIO::TypeDesc::FLOAT,
                               std::vector<float>(std::size_t(1024) * 1024 * 4, 2.0f)));
    }

    void init()
    {
        mDoc = std::make_unique<OrbaneDoc>();
        mViewer = std::make_unique<ViewerPanel>(mDoc.get());
        mViewer->resize(400, 300);
        mViewer->show();
        QVERIFY(QTest::qWaitForWindowExposed(mViewer.get()));
    }

    void cleanup()
    {
        mViewer.reset();
        mDoc.reset();
    }

    void sequenceFollowsTime_data()
    {
        QTest::addColumn<double>("time");
        QTest::addColumn<int>("shown");
        QTest::addColumn<bool>("missing");
        QTest::newRow("first frame") << 1.0 << 1 << false;
        QTest::newRow("nearest whole frame") << 1.6 << 2 << false;
        QTest::newRow("missing: the last earlier frame held") << 3.0 << 2 << true;
        QTest::newRow("after a gap") << 4.0 << 4 << false;
        QTest::newRow("before the first: the first") << -2.0 << 1 << true;
        QTest::newRow("past the last: the last") << 40.0 << 4 << true;
    }

    // The comp's pattern as the document names it; the time set as the
    // time ruler sets it.
    void sequenceFollowsTime()
    {
        QFETCH(double, time);
        QFETCH(int, shown);
        QFETCH(bool, missing);
        const QString pattern = mDir.filePath("plate.%04d.exr");
        mDoc->SetPref(PREF_ViewerImage, pattern.toStdString());
        QVERIFY(mViewer->WaitForImage(kWait));
        mDoc->SetCurrentTime(time);
        QVERIFY(mViewer->WaitForImage(kWait));
        const ViewerImageState &state = mViewer->ImageState();
        QVERIFY(state.sequence);
        QCOMPARE(state.frame, int(std::lround(time)));
        QCOMPARE(state.shownFrame, shown);
        QCOMPARE(state.file, Frame(shown));
        QCOMPARE(state.error.contains(QString("frame %1 is missing").arg(state.frame)), missing);
        QCOMPARE(mViewer->ImageSize(), QSize(8, 4));
        QVERIFY(qAbs(mViewer->LinearImage().At(3, 2)[0] - FrameValue(shown)) < 1e-3f);
    }

    // The size is known at once and the pixels follow on the worker, with
    // progress on the way; the float values stay above white.
    void largePictureReadInTheBackground()
    {
        std::vector<float> seen;
        connect(mViewer.get(), &ViewerPanel::imageStateChanged, this,
                [&] { seen.push_back(mViewer->ImageState().progress); });
        mViewer->ViewImage(mLarge);
        QVERIFY(mViewer->ImageState().loading);
        QCOMPARE(mViewer->ImageSize(), QSize(1024, 1024));
        QVERIFY(!mViewer->HasImage());
        QVERIFY(mViewer->WaitForImage(kWait));
        QVERIFY(mViewer->HasImage());
        QCOMPARE(mViewer->ImageState().progress, 1.0f);
        QVERIFY(std::is_sorted(seen.begin(), seen.end()));
        QVERIFY(std::any_of(seen.begin(), seen.end(), [](float p) { return p > 0.0f && p < 1.0f; }));
        QCOMPARE(mViewer->LinearImage().At(1000, 1000)[0], 2.0f);
        QCOMPARE(mViewer->grab().toImage().pixelColor(200, 150), QColor(Qt::white)); // above white shows white
    }

    // A picture asked for while another is read replaces it: the older
    // result never shows.
    void newerRequestWins()
    {
        mViewer->ViewImage(mLarge);
        mViewer->ViewImage(Frame(4));
        QVERIFY(mViewer->WaitForImage(kWait));
        QTest::qWait(50); // a late result of the large read would land here
        QCOMPARE(mViewer->ImageSize(), QSize(8, 4));
        QVERIFY(qAbs(mViewer->LinearImage().At(0, 0)[1] - FrameValue(4)) < 1e-3f);
        QVERIFY(mViewer->ImageState().error.isEmpty());
    }

    void badFiles_data()
    {
        QTest::addColumn<QString>("name");
        QTest::addColumn<QString>("says");
        QTest::newRow("missing file") << "nothing.exr"
                                      << "no such file";
        QTest::newRow("no frames of a pattern") << "nothing.####.exr"
                                                << "no frames of";
        QTest::newRow("not a picture") << "junk.exr"
                                       << "not a readable image";
    }

    // A clear message in the viewer, the checkerboard shown, and the window
    // goes on.
    void badFiles()
    {
        QFETCH(QString, name);
        QFETCH(QString, says);
        QFile junk(mDir.filePath("junk.exr"));
        QVERIFY(junk.open(QIODevice::WriteOnly) && junk.write("junk") == 4);
        junk.close();
        mViewer->ViewImage(Frame(1));
        QVERIFY(mViewer->WaitForImage(kWait));
        const QImage before = mViewer->grab().toImage();
        mViewer->ViewImage(mDir.filePath(name));
        QVERIFY(mViewer->WaitForImage(kWait));
        QVERIFY2(mViewer->ImageState().error.contains(says), qPrintable(mViewer->ImageState().error));
        QVERIFY(!mViewer->HasImage());
        QVERIFY(mViewer->LinearImage().IsNull());
        // The status line at the viewer's foot.
        const QRect foot(0, 300 - 40, 200, 40);
        QVERIFY(mViewer->grab().toImage().copy(foot) != before.copy(foot));
    }

private:
    QString Frame(int frame) const { return mDir.filePath(QString("plate.%1.exr").arg(frame, 4, 10, QChar('0'))); }

    QTemporaryDir mDir;
    QString mLarge;
    std::unique_ptr<OrbaneDoc> mDoc;
    std::unique_ptr<ViewerPanel> mViewer;
};

QTEST_MAIN(ViewerImageTest)
#include "ViewerImageTest.moc"
