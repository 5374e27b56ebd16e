#include "ToolFixture.h"

#include "orbane/AutoParam.h"
#include "orbane/Input.h"
#include "orbane/Operator.h"
#include "orbane/TimeCodeEdit.h"

#include <QtTest>

using namespace Orbane;
using namespace Orbane::Test;

Q_DECLARE_METATYPE(Orbane::TagList)

namespace {

constexpr Tag kHighInput = 0x40050000;
constexpr Tag kMinAllowed = 0x20050000, kMaxAllowed = 0x20050001, kMinSpan = 0x20050004;
constexpr Tag kDefaultLow = 0x20050005, kDefaultHigh = 0x20050006;
constexpr Tag kPlaces = 0x10050000, kInteger = 0x10050001, kPush = 0x10050002;
constexpr Tag kLowName = 0x30050000, kHighName = 0x30050001, kLabel = 0x30040000;
constexpr int kMargin = 6; // the track keeps this much room at each end
const OrbID kRange("RangeControl");

// A tool with a "Low" Input that shows the range and a "High" one it links.
struct Range
{
    explicit Range(float64 low, float64 high, TagList attrs = TagList())
    {
        highInput = f.AddNumber("High", high);
        attrs.Add(kHighInput, static_cast<ScriptObject *>(highInput));
        attrs.Add(kLabel, "Window");
        lowInput = f.AddNumber("Low", low, attrs);
        control = f.Create(kRange, {lowInput});
    }
    TimeCodeEdit *Edit(const char *end) const { return control->findChild<TimeCodeEdit *>(end); }
    QWidget *Track() const { return control->findChild<QWidget *>("span"); }
    // The track's x of a value on the default scale, 0 to 1.
    int XOf(float64 value) const { return kMargin + int(value * (Track()->width() - 2 * kMargin) + 0.5); }

    ToolFixture f;
    Input *highInput = nullptr;
    Input *lowInput = nullptr;
    InputControl *control = nullptr;
};

// The values of both ends, each compared as QCOMPARE compares numbers.
#define COMPARE_ENDS(r, low, high)                                                                                     \
    do {                                                                                                               \
        QCOMPARE((r).f.NumberOf((r).lowInput), double(low));                                                           \
        QCOMPARE((r).f.NumberOf((r).highInput), double(high));                                                         \
    } while (false)

void Type(TimeCodeEdit *edit, const QString &text)
{
    edit->selectAll();
    QTest::keyClicks(edit, text);
    QTest::keyClick(edit, Qt::Key_Return);
}

// A move with the button held and the modifiers given, which QTest's own
// mouseMove cannot carry.
void DragTo(QWidget *w, int x, Qt::KeyboardModifiers mods)
{
    QMouseEvent move(QEvent::MouseMove, QPointF(x, 7), w->mapToGlobal(QPoint(x, 7)), Qt::NoButton, Qt::LeftButton,
                     mods);
    QApplication::sendEvent(w, &move);
}

} // namespace

class RangeControlTest : public QObject
{
    Q_OBJECT
private slots:
    void initTestCase();
    void constraints_data();
    void constraints();
    void drags_data();
    void drags();
    void followsOtherControls();
    void disconnectWrite();
};

void RangeControlTest::initTestCase()
{
    std::string error;
    QVERIFY2(ToolFixture::LoadControls(&error), error.c_str());
}

void RangeControlTest::constraints_data()
{
    QTest::addColumn<TagList>("attrs");
    QTest::addColumn<QString>("end");
    QTest::addColumn<QString>("typed");
    QTest::addColumn<double>("low");
    QTest::addColumn<double>("high");
    QTest::newRow("low inside") << TagList() << "low"
                                << "0.3" << 0.3 << 0.8;
    QTest::newRow("low above high stops at high") << TagList() << "low"
                                                  << "0.9" << 0.8 << 0.8;
    QTest::newRow("high below low stops at low") << TagList() << "high"
                                                 << "0.1" << 0.2 << 0.2;
    QTest::newRow("least span kept") << TagList{{kMinSpan, 0.25}} << "low"
                                     << "0.7" << 0.55 << 0.8;
    QTest::newRow("push takes the other along") << TagList{{kPush, 1}, {kMinSpan, 0.1}} << "low"
                                                << "0.85" << 0.85 << 0.95;
    QTest::newRow("push stops at the allowed end") << TagList{{kPush, 1}, {kMinSpan, 0.1}, {kMaxAllowed, 1.0}} << "low"
                                                   << "0.95" << 0.9 << 1.0;
    QTest::newRow("allowed range clamps") << TagList{{kMinAllowed, 0.1}} << "low"
                                          << "-4" << 0.1 << 0.8;
    QTest::newRow("rounded to the places") << TagList{{kPlaces, 1}} << "high"
                                           << "0.46" << 0.2 << 0.5;
    QTest::newRow("whole numbers") << TagList{{kInteger, 1}, {kMaxAllowed, 10.0}} << "high"
                                   << "6.6" << 0.2 << 7.0;
    QTest::newRow("expression") << TagList() << "high"
                                << "0.5 + 0.25" << 0.2 << 0.75;
}

void RangeControlTest::constraints()
{
    QFETCH(TagList, attrs);
    QFETCH(QString, end);
    QFETCH(QString, typed);
    QFETCH(double, low);
    QFETCH(double, high);
    Range r(0.2, 0.8, attrs);
    Type(r.Edit(end.toUtf8().constData()), typed);
    COMPARE_ENDS(r, low, high);
    QCOMPARE(r.f.doc.UndoNames(), QStringList{"Change Window"});
    QVERIFY(r.f.doc.Undo());
    COMPARE_ENDS(r, 0.2, 0.8);
}

// Knobs move their end, the bar both; Ctrl drags finer; a drag is one step
// named for the end it moved.
void RangeControlTest::drags_data()
{
    QTest::addColumn<double>("from");
    QTest::addColumn<double>("to");
    QTest::addColumn<bool>("fine");
    QTest::addColumn<double>("low");
    QTest::addColumn<double>("high");
    QTest::addColumn<QString>("step");
    QTest::newRow("low knob") << 0.2 << 0.4 << false << 0.4 << 0.8 << "Change In";
    QTest::newRow("high knob past the end") << 0.8 << 1.3 << false << 0.2 << 1.0 << "Change Out";
    QTest::newRow("span keeps its width") << 0.5 << 0.6 << false << 0.3 << 0.9 << "Change Window";
    QTest::newRow("span stops at the edge") << 0.5 << 0.9 << false << 0.4 << 1.0 << "Change Window";
    QTest::newRow("fine") << 0.2 << 0.4 << true << 0.22 << 0.8 << "Change In";
    QTest::newRow("bare track brings the nearer end") << 0.9 << 0.95 << false << 0.2 << 0.95 << "Change Out";
}

void RangeControlTest::drags()
{
    QFETCH(double, from);
    QFETCH(double, to);
    QFETCH(bool, fine);
    QFETCH(double, low);
    QFETCH(double, high);
    QFETCH(QString, step);
    Range r(0.2, 0.8,
            TagList{{kMinAllowed, 0.0}, {kMaxAllowed, 1.0}, {kPlaces, 2}, {kLowName, "In"}, {kHighName, "Out"}});
    QWidget *track = r.Track();
    const Qt::KeyboardModifiers mods = fine ? Qt::ControlModifier : Qt::NoModifier;
    QTest::mousePress(track, Qt::LeftButton, mods, QPoint(r.XOf(from), 7));
    for (int i = 1; i <= 4; ++i)
        DragTo(track, r.XOf(from + (to - from) * i / 4), mods);
    QTest::mouseRelease(track, Qt::LeftButton, mods, QPoint(r.XOf(to), 7));
    COMPARE_ENDS(r, low, high);
    QCOMPARE(r.f.doc.UndoNames(), QStringList{step});
    QCOMPARE(r.Edit("low")->text().toDouble(), low);
    QCOMPARE(r.Edit("high")->text().toDouble(), high);
}

// A second range of the same Inputs follows every write; an inverted pair
// from a script is shown as it is, marked, until a double click puts the
// defaults back in one step.
void RangeControlTest::followsOtherControls()
{
    Range r(0.2, 0.8, TagList{{kDefaultLow, 0.1}, {kDefaultHigh, 0.6}});
    InputControl *other = r.f.Create(kRange, {r.lowInput});
    Type(r.Edit("high"), "0.5");
    QCOMPARE(other->findChild<TimeCodeEdit *>("high")->text().toDouble(), 0.5);
    QVERIFY(r.lowInput->SetValue(AutoNumber(0.7), r.f.doc.GetCurrentTime()));
    QCOMPARE(other->findChild<TimeCodeEdit *>("low")->text().toDouble(), 0.7);
    QVERIFY(other->findChild<QWidget *>("span")->property("inverted").toBool());
    QTest::mouseDClick(r.Track(), Qt::LeftButton, Qt::NoModifier, QPoint(r.XOf(0.3), 7));
    COMPARE_ENDS(r, 0.1, 0.6);
    QVERIFY(!other->findChild<QWidget *>("span")->property("inverted").toBool());
    QCOMPARE(r.f.doc.UndoNames().last(), QString("Change Window"));
}

// Each end writes what it shows when it is unbound: a value finer than the
// places comes back rounded, without an undo step.
void RangeControlTest::disconnectWrite()
{
    Range r(0.2, 0.8, TagList{{kPlaces, 2}});
    QVERIFY(r.lowInput->SetValue(AutoNumber(0.2031), r.f.doc.GetCurrentTime()));
    QVERIFY(r.highInput->SetValue(AutoNumber(0.7969), r.f.doc.GetCurrentTime()));
    const int steps = r.f.doc.UndoNames().size();
    r.f.Destroy(r.control);
    COMPARE_ENDS(r, 0.2, 0.8);
    QCOMPARE(r.f.doc.UndoNames().size(), steps);
}

QTEST_MAIN(RangeControlTest)
#include "RangeControlTest.moc"
