#include "ToolFixture.h"

#include "orbane/AutoParam.h"
#include "orbane/ColourSpaces.h"
#include "orbane/Input.h"
#include "orbane/Operator.h"
#include "orbane/ViewerPanel.h"

#include <QColorDialog>
#include <QLineEdit>
#include <QPushButton>
#include <QtTest>

#include <cmath>

using namespace Orbane;
using namespace Orbane::Test;

namespace {

constexpr Tag kGreen = 0x40050000, kBlue = 0x40050001, kAlpha = 0x40050002;
constexpr Tag kModel = 0x10050000, kLabel = 0x30040000;
const OrbID kColor("ColorControl");

double Linear(int code)
{
    return ColourSpaces::SrgbToLinear(code / 255.0);
}

// A tool with four channel Inputs; the control stands on "Red".
struct Colour
{
    explicit Colour(bool withAlpha = true, int model = 0)
    {
        inputs[1] = f.AddNumber("Green", 0.5);
        inputs[2] = f.AddNumber("Blue", 0.25);
        inputs[3] = f.AddNumber("Alpha", 1.0);
        TagList attrs{{kLabel, "Tint"}, {kModel, model}};
        attrs.Add(kGreen, static_cast<ScriptObject *>(inputs[1]));
        attrs.Add(kBlue, static_cast<ScriptObject *>(inputs[2]));
        if (withAlpha)
            attrs.Add(kAlpha, static_cast<ScriptObject *>(inputs[3]));
        inputs[0] = f.AddNumber("Red", 1.0, attrs);
        control = f.Create(kColor, {inputs[0]});
    }
    template <class W> W *Child(const char *name) const { return control->findChild<W *>(name); }
    QVector<double> Values() const
    {
        return {f.NumberOf(inputs[0]), f.NumberOf(inputs[1]), f.NumberOf(inputs[2]), f.NumberOf(inputs[3])};
    }
    void Type(const char *child, const QString &text) const
    {
        auto *edit = Child<QLineEdit>(child);
        edit->selectAll();
        QTest::keyClicks(edit, text);
        QTest::keyClick(edit, Qt::Key_Return);
    }

    ToolFixture f;
    Input *inputs[4] = {};
    InputControl *control = nullptr;
};

bool Near(const QVector<double> &a, const QVector<double> &b)
{
    for (int i = 0; i < a.size(); ++i)
        if (std::fabs(a[i] - b[i]) > 1e-4)
            return false;
    return a.size() == b.size();
}

QString Listed(const QVector<double> &v)
{
    QStringList s;
    for (double d : v)
        s << QString::number(d, 'g', 6);
    return s.join(' ');
}

} // namespace

class ColorControlTest : public QObject
{
    Q_OBJECT
private slots:
    void initTestCase();
    void edits_data();
    void edits();
    void sliderDragIsOneStep();
    void picker_data();
    void picker();
    void hdrAndNanKeptExactly();
    void dialogWrites();
};

void ColorControlTest::initTestCase()
{
    std::string error;
    QVERIFY2(ToolFixture::LoadControls(&error), error.c_str());
}

// Typed entries: each is one undo step over every channel it changes.
void ColorControlTest::edits_data()
{
    QTest::addColumn<int>("model");
    QTest::addColumn<QString>("child");
    QTest::addColumn<QString>("typed");
    QTest::addColumn<QVector<double>>("values");
    QTest::addColumn<int>("steps");
    const double half = Linear(0x80);
    QTest::newRow("hex") << 0 << "hex"
                         << "#008080" << QVector<double>{0, half, half, 1} << 1;
    QTest::newRow("hex with alpha") << 0 << "hex"
                                    << "#FFFFFF00" << QVector<double>{1, 1, 1, 0} << 1;
    QTest::newRow("bad hex changes nothing") << 0 << "hex"
                                             << "#12345" << QVector<double>{1, 0.5, 0.25, 1} << 0;
    QTest::newRow("HSV") << 0 << "space"
                         << "120 1 0.5" << QVector<double>{0, 0.5, 0, 1} << 1;
    QTest::newRow("HLS") << 1 << "space"
                         << "240, 0.5, 1" << QVector<double>{0, 0, 1, 1} << 1;
    QTest::newRow("YUV grey") << 2 << "space"
                              << "0.3 0 0" << QVector<double>{0.3, 0.3, 0.3, 1} << 1;
    QTest::newRow("two numbers are no colour") << 0 << "space"
                                               << "1 2" << QVector<double>{1, 0.5, 0.25, 1} << 0;
}

void ColorControlTest::edits()
{
    QFETCH(int, model);
    QFETCH(QString, child);
    QFETCH(QString, typed);
    QFETCH(QVector<double>, values);
    QFETCH(int, steps);
    Colour c(true, model);
    c.Type(child.toUtf8().constData(), typed);
    QVERIFY2(Near(c.Values(), values), qPrintable(Listed(c.Values())));
    QCOMPARE(c.f.doc.UndoNames().size(), steps);
    if (steps) {
        QCOMPARE(c.f.doc.UndoNames().first(), QString("Change Tint"));
        QVERIFY(c.f.doc.Undo());
        QVERIFY(Near(c.Values(), {1, 0.5, 0.25, 1}));
        // The control follows the undo: its hex shows the old colour again.
        QCOMPARE(c.Child<QLineEdit>("hex")->text(), QString("#FFBC89FF"));
    }
}

// A drag on a channel's track is one step however many moves it makes;
// the other channels stay.
void ColorControlTest::sliderDragIsOneStep()
{
    Colour c;
    QWidget *green = c.Child<QWidget>("green");
    QVERIFY(green && green->isVisible());
    ToolFixture::DragSideways(green, {-20, -20, -20}, Qt::NoModifier);
    const QVector<double> after = c.Values();
    QVERIFY2(after[1] < 0.45, qPrintable(Listed(after)));
    QCOMPARE(after[0], 1.0);
    QCOMPARE(after[2], 0.25);
    QCOMPARE(c.f.doc.UndoNames(), QStringList{"Change Tint"});
    QVERIFY(c.f.doc.Undo());
    QCOMPARE(c.f.NumberOf(c.inputs[1]), 0.5);
    // Without an alpha Input there is no alpha slider.
    Colour rgb(false);
    QVERIFY(!rgb.Child<QWidget>("alpha")->isVisible());
}

// The picker samples a generated image in the viewer: orange at the left,
// blue at the right. A click takes a pixel, a drag the box's average.
void ColorControlTest::picker_data()
{
    QTest::addColumn<QPoint>("from");
    QTest::addColumn<QPoint>("to");
    QTest::addColumn<QVector<double>>("values");
    const double g = Linear(128);
    QTest::newRow("one orange pixel") << QPoint(10, 10) << QPoint(10, 10) << QVector<double>{1, g, 0, 1};
    QTest::newRow("one blue pixel") << QPoint(80, 70) << QPoint(80, 70) << QVector<double>{0, 0, 1, 1};
    QTest::newRow("box over both halves") << QPoint(40, 10) << QPoint(59, 29) << QVector<double>{0.5, g / 2, 0.5, 1};
    QTest::newRow("box dragged backwards")
        << QPoint(59, 29) << QPoint(45, 10) << QVector<double>{5.0 / 15, g * 5 / 15, 10.0 / 15, 1};
}

void ColorControlTest::picker()
{
    QFETCH(QPoint, from);
    QFETCH(QPoint, to);
    QFETCH(QVector<double>, values);
    Colour c;
    ViewerPanel viewer(&c.f.doc);
    viewer.resize(240, 200);
    QImage image(100, 100, QImage::Format_ARGB32);
    image.fill(QColor(0, 0, 255));
    for (int y = 0; y < 100; ++y)
        for (int x = 0; x < 50; ++x)
            image.setPixelColor(x, y, QColor(255, 128, 0));
    viewer.SetImage(image);
    viewer.show();
    QVERIFY(QTest::qWaitForWindowExposed(&viewer));
    const auto at = [&](QPoint px) {
        return viewer.ImageToWidget({(px.x() + 0.5) / 100.0, 1.0 - (px.y() + 0.5) / 100.0}).toPoint();
    };
    QTest::mouseClick(c.Child<QPushButton>("pick"), Qt::LeftButton);
    QVERIFY(c.Child<QPushButton>("pick")->isChecked());
    QTest::mousePress(&viewer, Qt::LeftButton, Qt::NoModifier, at(from));
    QMouseEvent move(QEvent::MouseMove, at(to), viewer.mapToGlobal(at(to)), Qt::NoButton, Qt::LeftButton,
                     Qt::NoModifier);
    QApplication::sendEvent(&viewer, &move);
    QTest::mouseRelease(&viewer, Qt::LeftButton, Qt::NoModifier, at(to));
    QVERIFY2(Near(c.Values(), values), qPrintable(Listed(c.Values())));
    QCOMPARE(c.f.doc.UndoNames(), QStringList{"Change Tint"});
    // One pick, then the viewer is the viewer again.
    QVERIFY(!c.Child<QPushButton>("pick")->isChecked());
}

// Values the screen cannot show stay exactly what they are; the swatch and
// hex show them clipped.
void ColorControlTest::hdrAndNanKeptExactly()
{
    Colour c;
    c.inputs[0]->SetValue(AutoNumber(4.5), c.f.doc.GetCurrentTime(), 0, nullptr);
    c.inputs[1]->SetValue(AutoNumber(std::nan("")), c.f.doc.GetCurrentTime(), 0, nullptr);
    c.inputs[2]->SetValue(AutoNumber(-0.5), c.f.doc.GetCurrentTime(), 0, nullptr);
    QCOMPARE(c.Child<QLineEdit>("hex")->text(), QString("#FF0000FF"));
    QCOMPARE(c.f.NumberOf(c.inputs[0]), 4.5);
    QVERIFY(std::isnan(c.f.NumberOf(c.inputs[1])));
    // Typing alpha alone leaves the others untouched.
    c.Type("hex", "#FF000080");
    QCOMPARE(c.f.NumberOf(c.inputs[0]), 1.0); // the hex names red as the screen shows it
    QCOMPARE(c.f.NumberOf(c.inputs[2]), 0.0);
    QVERIFY(!c.control->grab().isNull());
}

void ColorControlTest::dialogWrites()
{
    Colour c(false);
    QTest::mouseDClick(c.Child<QWidget>("swatch"), Qt::LeftButton);
    auto *dialog = c.control->findChild<QColorDialog *>("colorDialog");
    QVERIFY(dialog && dialog->isVisible());
    dialog->setCurrentColor(QColor(0, 255, 0));
    dialog->accept();
    QVERIFY(Near(c.Values(), {0, 1, 0, 1}));
    QCOMPARE(c.f.doc.UndoNames().size(), 1);
}

QTEST_MAIN(ColorControlTest)
#include "ColorControlTest.moc"
