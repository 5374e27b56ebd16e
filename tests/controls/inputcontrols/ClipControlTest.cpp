#include "ToolFixture.h"

#include "orbane/AutoParam.h"
#include "orbane/ClassIDs.h"
#include "orbane/Input.h"
#include "orbane/Operator.h"
#include "orbane/Text.h"

#include <QLabel>
#include <QLineEdit>
#include <QSpinBox>
#include <QTemporaryDir>
#include <QtTest>

using namespace Orbane;
using namespace Orbane::Test;

namespace {

constexpr Tag kInInput = 0x40050000, kOutInput = 0x40050001, kLabel = 0x30040000;
const OrbID kClip("ClipControl");

// A tool with a clip on "Clip", its trims on "In" and "Out", over a folder
// of empty files named as a test asks.
struct Clip
{
    explicit Clip(const QStringList &files)
    {
        for (const QString &name : files) {
            QFile file(dir.filePath(name));
            file.open(QIODevice::WriteOnly);
        }
        in = f.AddNumber("In", 0.0);
        out = f.AddNumber("Out", 0.0);
        const TagList attrs{{kInInput, static_cast<ScriptObject *>(in)},
                            {kOutInput, static_cast<ScriptObject *>(out)},
                            {kLabel, "Plate"}};
        clip = f.tool->AddInput(OrbID("Clip"), "Clip", CLSID_DataType_Text, attrs, AutoText(""));
        control = f.Create(kClip, {clip});
    }
    QString Path() const
    {
        const AutoText now(clip, f.doc.GetCurrentTime());
        return QString::fromStdString(now->Value.str());
    }
    QSpinBox *Box(const char *name) const { return control->findChild<QSpinBox *>(name); }
    QString Frames() const { return control->findChild<QLabel *>("frames")->text(); }
    void Choose(const QString &name) const
    {
        QLineEdit *edit = control->findChild<QLineEdit *>("edit");
        edit->selectAll();
        QTest::keyClicks(edit, dir.filePath(name));
        QTest::keyClick(edit, Qt::Key_Return);
    }

    QTemporaryDir dir;
    ToolFixture f;
    Input *in = nullptr;
    Input *out = nullptr;
    Input *clip = nullptr;
    InputControl *control = nullptr;
};

QStringList Frames(const char *pattern, std::initializer_list<int> frames)
{
    QStringList names;
    for (int frame : frames)
        names << QString::asprintf(pattern, frame);
    return names;
}

} // namespace

class ClipControlTest : public QObject
{
    Q_OBJECT
private slots:
    void initTestCase();
    void detect_data();
    void detect();
    void trims();
    void disconnectWrite();
};

void ClipControlTest::initTestCase()
{
    std::string error;
    QVERIFY2(ToolFixture::LoadControls(&error), error.c_str());
}

void ClipControlTest::detect_data()
{
    QTest::addColumn<QStringList>("files");
    QTest::addColumn<QString>("chosen");
    QTest::addColumn<QString>("stored"); // the name the Input holds
    QTest::addColumn<QString>("frames");
    QTest::addColumn<int>("in");  // -1: not shown
    QTest::addColumn<int>("out"); // -1: not shown
    const QStringList plate = Frames("plate.%04d.exr", {1001, 1002, 1003, 1004});
    QTest::newRow("a file of the sequence") << plate << "plate.1002.exr"
                                            << "plate.####.exr"
                                            << "1001-1004 (4 frames)" << 1001 << 1004;
    QTest::newRow("the pattern") << plate << "plate.####.exr"
                                 << "plate.####.exr"
                                 << "1001-1004 (4 frames)" << 1001 << 1004;
    QTest::newRow("gaps") << Frames("shot_v2.%03d.exr", {1, 2, 5}) << "shot_v2.001.exr"
                          << "shot_v2.###.exr"
                          << "1-5 (3 frames), 2 missing" << 1 << 5;
    QTest::newRow("other padding left out")
        << Frames("a.%04d.exr", {7, 8}) + Frames("a.%02d.exr", {1, 2, 3}) << "a.0007.exr"
        << "a.####.exr"
        << "7-8 (2 frames)" << 7 << 8;
    QTest::newRow("frames past the padding") << Frames("b.%02d.exr", {98, 99, 100}) << "b.##.exr"
                                             << "b.##.exr"
                                             << "98-100 (3 frames)" << 98 << 100;
    QTest::newRow("still image") << QStringList{"still.png"} << "still.png"
                                 << "still.png"
                                 << "still image" << -1 << -1;
    QTest::newRow("nothing there") << plate << "other.####.exr"
                                   << "other.####.exr"
                                   << "no frames found" << -1 << -1;
}

// Choosing a clip finds its frames and sets the trims to all of them, in
// one step that undo takes back whole.
void ClipControlTest::detect()
{
    QFETCH(QStringList, files);
    QFETCH(QString, chosen);
    QFETCH(QString, stored);
    QFETCH(QString, frames);
    QFETCH(int, in);
    QFETCH(int, out);
    Clip c(files);
    c.Choose(chosen);
    QCOMPARE(c.Path(), c.dir.filePath(stored));
    QCOMPARE(c.Frames(), frames);
    QCOMPARE(c.control->findChild<QLineEdit *>("edit")->property("missing").toBool(), frames == "no frames found");
    QCOMPARE(c.Box("in")->isVisible(), in >= 0);
    QCOMPARE(c.f.NumberOf(c.in), in >= 0 ? double(in) : 0.0);
    QCOMPARE(c.f.NumberOf(c.out), out >= 0 ? double(out) : 0.0);
    QCOMPARE(c.f.doc.UndoNames(), QStringList{"Change Plate"});
    QVERIFY(c.f.doc.Undo());
    QCOMPARE(c.Path(), QString());
    QCOMPARE(c.f.NumberOf(c.in), 0.0);
}

// The trim boxes keep in <= out inside the frames found, each change its
// own step, and a second control follows them.
void ClipControlTest::trims()
{
    Clip c(Frames("p.%04d.exr", {1, 2, 3, 4, 5, 6, 7, 8, 9, 10}));
    InputControl *other = c.f.Create(kClip, {c.clip});
    c.Choose("p.0001.exr");
    QSpinBox *in = c.Box("in");
    QSpinBox *out = c.Box("out");
    in->selectAll();
    QTest::keyClicks(in, "4");
    QTest::keyClick(in, Qt::Key_Return);
    QTest::keyClick(out, Qt::Key_Down);
    QCOMPARE(c.f.NumberOf(c.in), 4.0);
    QCOMPARE(c.f.NumberOf(c.out), 9.0);
    QCOMPARE(other->findChild<QSpinBox *>("in")->value(), 4);
    QCOMPARE(other->findChild<QSpinBox *>("out")->minimum(), 4);
    QCOMPARE(in->maximum(), 9);
    QCOMPARE(c.f.doc.UndoNames().size(), 3);
    QVERIFY(c.f.doc.Undo());
    QCOMPARE(other->findChild<QSpinBox *>("out")->value(), 10);
}

// Unbinding writes each Input what the control shows: a trim between
// frames comes back whole.
void ClipControlTest::disconnectWrite()
{
    Clip c(Frames("p.%04d.exr", {1, 2, 3}));
    c.Choose("p.0001.exr");
    QVERIFY(c.in->SetValue(AutoNumber(2.3), c.f.doc.GetCurrentTime()));
    const int steps = c.f.doc.UndoNames().size();
    c.f.Destroy(c.control);
    QCOMPARE(c.f.NumberOf(c.in), 2.0);
    QCOMPARE(c.f.NumberOf(c.out), 3.0);
    QCOMPARE(c.Path(), c.dir.filePath("p.####.exr"));
    QCOMPARE(c.f.doc.UndoNames().size(), steps);
}

QTEST_MAIN(ClipControlTest)
#include "ClipControlTest.moc"
