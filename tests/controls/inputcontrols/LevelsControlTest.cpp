#include "GraphDrag.h"
#include "ToolFixture.h"

#include "orbane/AutoParam.h"
#include "orbane/Input.h"
#include "orbane/TimeCodeEdit.h"

#include <QComboBox>
#include <QtTest>

using namespace Orbane;
using namespace Orbane::Test;

Q_DECLARE_METATYPE(Orbane::TagList)

namespace {

constexpr Tag kWhiteInput = 0x40050000, kGammaInput = 0x40050001, kAllowInvert = 0x10050001;
constexpr Tag kLabel = 0x30040000;

// The x of a value on a levels strip (a margin of 6 at each end).
int XOf(const QWidget *bar, double v)
{
    return GraphPixel(bar, v, 0).x();
}

// A tool with Black, Gamma and White Inputs under one levels control (or
// Black and White under the output levels).
struct Levels
{
    Levels(const char *classID, TagList attrs = TagList())
    {
        const bool input = QByteArray(classID) == "LevelsControl";
        white = f.AddNumber("White", 0.9);
        attrs.Add(kWhiteInput, static_cast<ScriptObject *>(white));
        if (input) {
            gamma = f.AddNumber("Gamma", 1.0);
            attrs.Add(kGammaInput, static_cast<ScriptObject *>(gamma));
        }
        attrs.Add(kLabel, "Levels");
        black = f.AddNumber("Black", 0.1, attrs);
        control = f.Create(OrbID(classID), {black});
        bar = control->findChild<QWidget *>(input ? "histogram" : "ramp");
    }
    QString Values() const
    {
        QStringList out;
        for (const Input *in : {black, gamma, white})
            if (in)
                out << QString::number(f.NumberOf(in), 'f', 2);
        return out.join(' ');
    }

    ToolFixture f;
    Input *black = nullptr;
    Input *gamma = nullptr;
    Input *white = nullptr;
    InputControl *control = nullptr;
    QWidget *bar = nullptr;
};

} // namespace

class LevelsControlTest : public QObject
{
    Q_OBJECT
private slots:
    void initTestCase();
    void gestures_data();
    void gestures();
    void histogramChannelIsItsValue();
};

void LevelsControlTest::initTestCase()
{
    std::string error;
    QVERIFY2(ToolFixture::LoadControls(&error), error.c_str());
}

// Handles dragged (Ctrl finer), double-clicked (their default) or typed
// write the values, each gesture one undo step that puts them all back.
void LevelsControlTest::gestures_data()
{
    QTest::addColumn<QString>("classID");
    QTest::addColumn<TagList>("attrs");
    QTest::addColumn<QString>("gesture");
    QTest::addColumn<double>("from");
    QTest::addColumn<double>("to");
    QTest::addColumn<int>("mods");
    QTest::addColumn<QString>("values");
    const QString in = "LevelsControl", out = "LevelsOutputControl";
    // Gamma 1 puts its handle half way: 0.1 + 0.8 * 0.5 = 0.5.
    QTest::newRow("black") << in << TagList() << "drag" << 0.1 << 0.3 << 0 << "0.30 1.00 0.90";
    QTest::newRow("black, Ctrl finer") << in << TagList() << "drag" << 0.1 << 0.3 << int(Qt::ControlModifier)
                                       << "0.12 1.00 0.90";
    QTest::newRow("white") << in << TagList() << "drag" << 0.9 << 0.7 << 0 << "0.10 1.00 0.70";
    QTest::newRow("black stops below white") << in << TagList() << "drag" << 0.1 << 1.0 << 0 << "0.90 1.00 0.90";
    // A handle at 0.3 is a quarter of the way: 0.25 = 0.5^gamma, gamma 2.
    QTest::newRow("gamma") << in << TagList() << "drag" << 0.5 << 0.3 << 0 << "0.10 2.00 0.90";
    QTest::newRow("double click: default") << in << TagList() << "double" << 0.9 << 0.0 << 0 << "0.10 1.00 1.00";
    QTest::newRow("typed gamma") << in << TagList() << "gamma" << 0.0 << 2.2 << 0 << "0.10 2.20 0.90";
    QTest::newRow("typed gamma kept above 0.1") << in << TagList() << "gamma" << 0.0 << -3.0 << 0 << "0.10 0.10 0.90";
    QTest::newRow("output black") << out << TagList() << "drag" << 0.1 << 0.25 << 0 << "0.25 0.90";
    QTest::newRow("output black stops below white") << out << TagList() << "drag" << 0.1 << 1.0 << 0 << "0.90 0.90";
    QTest::newRow("output may invert") << out << TagList{{kAllowInvert, 1}} << "drag" << 0.1 << 1.0 << 0 << "1.00 0.90";
}

void LevelsControlTest::gestures()
{
    QFETCH(QString, classID);
    QFETCH(TagList, attrs);
    QFETCH(QString, gesture);
    QFETCH(double, from);
    QFETCH(double, to);
    QFETCH(int, mods);
    QFETCH(QString, values);
    Levels l(classID.toUtf8().constData(), attrs);
    const QString before = l.Values();
    const int y = l.bar->height() - 4;
    if (gesture == "drag") {
        DragWith(l.bar, QPoint(XOf(l.bar, from), y), QPoint(XOf(l.bar, to), y), Qt::KeyboardModifiers(mods), 8);
    } else if (gesture == "double") {
        QTest::mouseDClick(l.bar, Qt::LeftButton, Qt::NoModifier, QPoint(XOf(l.bar, from), y));
    } else {
        auto *edit = l.control->findChild<TimeCodeEdit *>(gesture);
        edit->selectAll();
        QTest::keyClicks(edit, QString::number(to));
        QTest::keyClick(edit, Qt::Key_Return);
    }
    // A drag lands within a pixel of its aim.
    const QStringList got = l.Values().split(' '), want = values.split(' ');
    QCOMPARE(got.size(), want.size());
    for (int i = 0; i < want.size(); ++i)
        QVERIFY2(std::abs(got[i].toDouble() - want[i].toDouble()) < 0.015, qPrintable(l.Values()));
    QCOMPARE(l.f.doc.UndoNames(), QStringList{"Change Levels"});
    QVERIFY(l.f.doc.Undo());
    QCOMPARE(l.Values(), before);
}

// The histogram's Input holds the channel shown; a choice is one step, and
// a value written elsewhere shows.

void LevelsControlTest::histogramChannelIsItsValue()
{
    ToolFixture f;
    Input *channel = f.AddNumber("Channel", 0);
    InputControl *control = f.Create(OrbID("HistogramControl"), {channel});
    auto *combo = control->findChild<QComboBox *>("channel");
    QVERIFY(combo);
    combo->setFocus();
    QTest::keyClick(combo, Qt::Key_Down); // Red
    QCOMPARE(f.NumberOf(channel), 1.0);
    QCOMPARE(f.doc.UndoNames().size(), 1);
    QVERIFY(channel->SetValue(AutoNumber(3.0), f.doc.GetCurrentTime(), 0, nullptr));
    QCOMPARE(combo->currentText(), QString("Blue"));
    // Out of range and not a number: the nearest channel, luminance for NaN.
    QVERIFY(channel->SetValue(AutoNumber(42.0), f.doc.GetCurrentTime(), 0, nullptr));
    QCOMPARE(combo->currentText(), QString("Alpha"));
}

QTEST_MAIN(LevelsControlTest)
#include "LevelsControlTest.moc"
