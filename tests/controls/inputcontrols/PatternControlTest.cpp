#include "ToolFixture.h"

#include "widgets/PatternSwatch.h"

#include "orbane/AutoParam.h"
#include "orbane/Input.h"
#include "orbane/Operator.h"

#include <QtTest>

using namespace Orbane;
using namespace Orbane::Test;

namespace {

constexpr Tag kLabel = 0x30040000, kTile = 0x10050000, kInk = 0x10050001;
const OrbID kPattern("PatternControl");

} // namespace

class PatternControlTest : public QObject
{
    Q_OBJECT
private slots:
    void initTestCase();
    void choose_data();
    void choose();
    void previewsFollowTheTags();
};

void PatternControlTest::initTestCase()
{
    std::string error;
    QVERIFY2(ToolFixture::LoadControls(&error), error.c_str());
}

void PatternControlTest::choose_data()
{
    QTest::addColumn<double>("start");
    QTest::addColumn<int>("clicked");
    QTest::addColumn<double>("value");
    QTest::addColumn<int>("steps");
    QTest::addColumn<int>("framed");
    QTest::newRow("another pattern") << 0.0 << 3 << 2.0 << 1 << 3;
    QTest::newRow("the chosen one again") << 4.0 << 5 << 4.0 << 0 << 5;
    QTest::newRow("from a value that names none") << 9.0 << 1 << 0.0 << 1 << 1;
}

void PatternControlTest::choose()
{
    QFETCH(double, start);
    QFETCH(int, clicked);
    QFETCH(double, value);
    QFETCH(int, steps);
    QFETCH(int, framed);
    ToolFixture f;
    Input *in = f.AddNumber("Fill", start, TagList{{kLabel, "Fill"}});
    InputControl *c = f.Create(kPattern, {in});
    const QByteArray name = "pattern" + QByteArray::number(clicked);
    if (start == 9.0)
        QVERIFY(c->findChild<QWidget *>("label")->toolTip().contains("names no pattern"));
    QTest::mouseClick(c->findChild<QWidget *>(name.constData()), Qt::LeftButton);
    QCOMPARE(f.NumberOf(in), value);
    QCOMPARE(f.doc.UndoNames().size(), steps);
    for (int i = 1; i <= PatternSwatch::PatternCount; ++i) {
        auto *s = c->findChild<PatternSwatch *>("pattern" + QByteArray::number(i));
        QCOMPARE(s->IsChosen(), i == framed);
    }
}

// The tile size and ink reach the previews: a stripe preview of 4-pixel
// tiles inks rows 0-1 and leaves rows 2-3, in the given red.
void PatternControlTest::previewsFollowTheTags()
{
    QCOMPARE(PatternSwatch::Inked(PatternSwatch::HStripes, 5, 1, 4), true);
    QCOMPARE(PatternSwatch::Inked(PatternSwatch::HStripes, 5, 2, 4), false);
    QCOMPARE(PatternSwatch::Inked(PatternSwatch::Grid, 8, 3, 8), true);
    QCOMPARE(PatternSwatch::Inked(PatternSwatch::Grid, 9, 3, 8), false);
    ToolFixture f;
    Input *in = f.AddNumber("Fill", 1.0, TagList{{kTile, 4}, {kInk, int64(0xFF0000FF)}});
    InputControl *c = f.Create(kPattern, {in});
    const QImage shot = c->findChild<QWidget *>("pattern2")->grab().toImage();
    // The preview is inset by two pixels; its row 1 inked, row 2 not.
    const qreal r = shot.devicePixelRatio();
    QCOMPARE(shot.pixelColor(int(12 * r), int(3 * r)), QColor(255, 0, 0));
    QCOMPARE(shot.pixelColor(int(12 * r), int(4 * r)), QColor(25, 25, 25));
}

QTEST_MAIN(PatternControlTest)
#include "PatternControlTest.moc"
