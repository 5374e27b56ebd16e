#include "ToolFixture.h"

#include "orbane/AutoParam.h"
#include "orbane/ClassIDs.h"
#include "orbane/Input.h"

#include <QCheckBox>
#include <QToolButton>
#include <QtTest>

using namespace Orbane;
using namespace Orbane::Test;

namespace {

constexpr Tag kColumns = 0x10050000;
constexpr Tag kSelectButtons = 0x10050001;
constexpr Tag kNoneText = 0x30050001;
constexpr Tag kAddString = 0x38040000;
constexpr Tag kBit = 0x28030000;

QCheckBox *Box(const InputControl *c, int n)
{
    return c->findChild<QCheckBox *>(QString("item%1").arg(n));
}

InputControl *MakeList(ToolFixture &f, Input *in)
{
    return f.Create(OrbID("CheckListControl"), {in});
}

// R, G and B are bits 0, 1, 2; A is bit 7.
TagList Channels(TagList more = TagList())
{
    TagList attrs{{kAddString, "R"}, {kAddString, "G"}, {kAddString, "B"}, {kAddString, "A"}, {kBit, 7.0}};
    attrs.Append(more);
    return attrs;
}

} // namespace

class CheckListControlTest : public QObject
{
    Q_OBJECT
private slots:
    void initTestCase();
    void gestures_data();
    void gestures();
    void boundListsFollow();
    void columnsAndButtons();
};

void CheckListControlTest::initTestCase()
{
    std::string error;
    QVERIFY2(ToolFixture::LoadControls(&error), error.c_str());
}

// "1" clicks box 1, "all" and "none" the buttons; bits no box shows (64
// here) are kept through all of them.
void CheckListControlTest::gestures_data()
{
    QTest::addColumn<QStringList>("clicks");
    QTest::addColumn<double>("value");
    QTest::addColumn<int>("steps");
    QTest::newRow("check one") << QStringList{"2"} << double(64 | 1 | 2) << 1;
    QTest::newRow("uncheck one") << QStringList{"1"} << 64.0 << 1;
    QTest::newRow("own bit") << QStringList{"4"} << double(64 | 1 | 128) << 1;
    QTest::newRow("all") << QStringList{"all"} << double(64 | 1 | 2 | 4 | 128) << 1;
    QTest::newRow("none") << QStringList{"all", "none"} << 64.0 << 2;
    QTest::newRow("none twice is one step") << QStringList{"none", "none"} << 64.0 << 1;
}

void CheckListControlTest::gestures()
{
    QFETCH(QStringList, clicks);
    QFETCH(double, value);
    QFETCH(int, steps);
    ToolFixture f;
    Input *in = f.AddNumber("Channels", 64 | 1, Channels());
    InputControl *c = MakeList(f, in);
    for (const QString &click : clicks) {
        QWidget *target =
            click.at(0).isDigit() ? static_cast<QWidget *>(Box(c, click.toInt())) : c->findChild<QToolButton *>(click);
        QTest::mouseClick(target, Qt::LeftButton, Qt::NoModifier, QPoint(4, target->height() / 2));
    }
    QCOMPARE(f.NumberOf(in), value);
    QCOMPARE(f.doc.UndoNames(), QVector<QString>(steps, "Change Channels").toList());
    const uint64 bits = uint64(value);
    for (int n = 1; n <= 4; ++n)
        QCOMPARE(Box(c, n)->isChecked(), (bits & (n == 4 ? 128 : 1u << (n - 1))) != 0);
}

void CheckListControlTest::boundListsFollow()
{
    ToolFixture f;
    Input *in = f.AddNumber("Channels", 1.4, Channels());
    InputControl *first = MakeList(f, in);
    InputControl *second = MakeList(f, in);
    QTest::mouseClick(Box(first, 3), Qt::LeftButton, Qt::NoModifier, QPoint(4, 4));
    QVERIFY(Box(second, 1)->isChecked() && Box(second, 3)->isChecked() && !Box(second, 2)->isChecked());
    f.Destroy(second);
    QCOMPARE(f.NumberOf(in), 5.0);
    QCOMPARE(f.doc.UndoNames().size(), 1);
}

void CheckListControlTest::columnsAndButtons()
{
    ToolFixture f;
    InputControl *two = MakeList(f, f.AddNumber("Two", 0.0, Channels({{kColumns, 2}, {kNoneText, "Clear"}})));
    QCOMPARE(Box(two, 2)->y(), Box(two, 1)->y());
    QVERIFY(Box(two, 3)->y() > Box(two, 1)->y());
    QCOMPARE(two->findChild<QToolButton *>("none")->text(), QString("Clear"));
    InputControl *bare = MakeList(f, f.AddNumber("Bare", 0.0, Channels({{kSelectButtons, 0}})));
    QVERIFY(!bare->findChild<QToolButton *>("all")->isVisible());
    QVERIFY(Box(bare, 4)->y() > Box(bare, 3)->y());
}

QTEST_MAIN(CheckListControlTest)
#include "CheckListControlTest.moc"
