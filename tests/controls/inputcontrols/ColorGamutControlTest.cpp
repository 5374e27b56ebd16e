#include "ToolFixture.h"

#include "widgets/Chromaticity.h"
#include "widgets/GamutDiagram.h"

#include "orbane/AutoParam.h"
#include "orbane/ClassIDs.h"
#include "orbane/Input.h"
#include "orbane/Operator.h"

#include <QComboBox>
#include <QFile>
#include <QtTest>

#include <cmath>

using namespace Orbane;
using namespace Orbane::Test;

namespace {

constexpr Tag kLabel = 0x30040000;
const OrbID kGamut("ColorGamutControl");
// Published chromaticities are given to three or four places.
constexpr double kPublished = 5e-5;

struct GamutFixture
{
    explicit GamutFixture(const ScriptVal &value)
    {
        input = f.tool->AddInput(OrbID("Gamut"), "Gamut", CLSID_DataType_ScriptVal, TagList{{kLabel, "Gamut"}},
                                 AutoScriptValParam(value));
        control = f.Create(kGamut, {input}, 320);
        diagram = control->findChild<GamutDiagram *>("diagram");
    }
    ScriptVal Value() const
    {
        const AutoParameter now(input->GetValue(f.doc.GetCurrentTime()));
        const auto *t = dynamic_cast<const ScriptValParam *>(now.get());
        return t ? t->Value : ScriptVal();
    }
    QPointF Point(const char *key) const
    {
        const ScriptVal value = Value();
        const ScriptVal *p = value.FindKeyConst(ScriptVal(key));
        return p ? QPointF(p->FindKeyConst(ScriptVal(1))->GetNumber(), p->FindKeyConst(ScriptVal(2))->GetNumber())
                 : QPointF(-1, -1);
    }
    QString Space() const
    {
        const ScriptVal value = Value();
        return value.FindKeyConst(ScriptVal("space"))->GetString();
    }

    ToolFixture f;
    Input *input = nullptr;
    InputControl *control = nullptr;
    GamutDiagram *diagram = nullptr;
};

ScriptVal Named(const char *space)
{
    ScriptVal t = ScriptVal::NewTable();
    t.SetKey(ScriptVal("space"), ScriptVal(space));
    return t;
}

} // namespace

class ColorGamutControlTest : public QObject
{
    Q_OBJECT
private slots:
    void initTestCase();
    void spaces_data();
    void spaces();
    void locusFollowsTheFile();
    void locus_data();
    void locus();
    void dragMakesCustom();
    void notAGamut();
};

void ColorGamutControlTest::initTestCase()
{
    std::string error;
    QVERIFY2(ToolFixture::LoadControls(&error), error.c_str());
}

// Each space chosen from the list (by keys, as a person does): its red
// primary and white point against the published values.
void ColorGamutControlTest::spaces_data()
{
    QTest::addColumn<int>("index");
    QTest::addColumn<QString>("space");
    QTest::addColumn<QPointF>("red");
    QTest::addColumn<QPointF>("white");
    const QPointF d65(0.3127, 0.3290), aces(0.32168, 0.33767);
    QTest::newRow("Rec. 709") << 0 << "Rec. 709" << QPointF(0.640, 0.330) << d65;
    QTest::newRow("DCI-P3") << 1 << "DCI-P3" << QPointF(0.680, 0.320) << QPointF(0.314, 0.351);
    QTest::newRow("P3-D65") << 2 << "P3-D65" << QPointF(0.680, 0.320) << d65;
    QTest::newRow("Rec. 2020") << 3 << "Rec. 2020" << QPointF(0.708, 0.292) << d65;
    QTest::newRow("ACES AP0") << 4 << "ACES AP0" << QPointF(0.7347, 0.2653) << aces;
    QTest::newRow("ACES AP1") << 5 << "ACES AP1" << QPointF(0.713, 0.293) << aces;
}

void ColorGamutControlTest::spaces()
{
    QFETCH(int, index);
    QFETCH(QString, space);
    QFETCH(QPointF, red);
    QFETCH(QPointF, white);
    GamutFixture g(Named("ACES AP1"));
    auto *list = g.control->findChild<QComboBox *>("space");
    list->setFocus();
    QTest::keyClick(list, Qt::Key_Home);
    for (int i = 0; i < index; ++i)
        QTest::keyClick(list, Qt::Key_Down);
    QCOMPARE(g.Space(), space);
    QVERIFY(std::fabs(g.Point("red").x() - red.x()) < kPublished &&
            std::fabs(g.Point("red").y() - red.y()) < kPublished);
    QVERIFY(std::fabs(g.Point("white").x() - white.x()) < kPublished);
    QVERIFY(std::fabs(g.Point("white").y() - white.y()) < kPublished);
}

// The locus is the data file's, row for row: read here on its own.
void ColorGamutControlTest::locusFollowsTheFile()
{
    QFile file(ORBANE_CIE1931_FILE);
    QVERIFY(file.open(QIODevice::ReadOnly));
    const auto &locus = Chromaticity::SpectralLocus();
    size_t row = 0;
    while (!file.atEnd()) {
        const QList<QByteArray> cells = file.readLine().trimmed().split(',');
        bool ok = false;
        const double nm = cells.value(0).toDouble(&ok);
        if (!ok || cells.size() != 4)
            continue;
        const double X = cells[1].toDouble(), Y = cells[2].toDouble(), Z = cells[3].toDouble();
        QVERIFY(row < locus.size());
        QCOMPARE(locus[row].nm, nm);
        QVERIFY(std::fabs(locus[row].xy.x - X / (X + Y + Z)) < 1e-12);
        QVERIFY(std::fabs(locus[row].xy.y - Y / (X + Y + Z)) < 1e-12);
        ++row;
    }
    QCOMPARE(row, size_t(81)); // 380 to 780 nm in 5 nm steps
    QCOMPARE(locus.size(), row);
}

// Published chromaticities of the spectral locus (CIE 015, 2-degree observer).
void ColorGamutControlTest::locus_data()
{
    QTest::addColumn<double>("nm");
    QTest::addColumn<QPointF>("xy");
    QTest::newRow("380") << 380.0 << QPointF(0.1741, 0.0050);
    QTest::newRow("450") << 450.0 << QPointF(0.1566, 0.0177);
    QTest::newRow("520") << 520.0 << QPointF(0.0743, 0.8338);
    QTest::newRow("555") << 555.0 << QPointF(0.3373, 0.6589);
    QTest::newRow("600") << 600.0 << QPointF(0.6270, 0.3725);
    QTest::newRow("700") << 700.0 << QPointF(0.7347, 0.2653);
}

void ColorGamutControlTest::locus()
{
    QFETCH(double, nm);
    QFETCH(QPointF, xy);
    for (const auto &s : Chromaticity::SpectralLocus())
        if (s.nm == nm) {
            QVERIFY2(std::fabs(s.xy.x - xy.x()) < 1.5e-4 && std::fabs(s.xy.y - xy.y()) < 1.5e-4,
                     qPrintable(QString("%1 %2").arg(s.xy.x).arg(s.xy.y)));
            return;
        }
    QFAIL("wavelength missing");
}

// A primary dragged on the diagram: the space turns Custom, one step.
void ColorGamutControlTest::dragMakesCustom()
{
    GamutFixture g(Named("Rec. 709"));
    const QRectF plot = g.diagram->Plot();
    const QPoint from = GamutDiagram::ToPixel({0.640, 0.330}, plot).toPoint();
    const QPoint to = GamutDiagram::ToPixel({0.700, 0.290}, plot).toPoint();
    QTest::mousePress(g.diagram, Qt::LeftButton, Qt::NoModifier, from);
    for (int i = 1; i <= 3; ++i) {
        const QPoint at = from + (to - from) * i / 3;
        QMouseEvent move(QEvent::MouseMove, at, g.diagram->mapToGlobal(at), Qt::NoButton, Qt::LeftButton,
                         Qt::NoModifier);
        QApplication::sendEvent(g.diagram, &move);
    }
    QTest::mouseRelease(g.diagram, Qt::LeftButton, Qt::NoModifier, to);
    QCOMPARE(g.Space(), QString("Custom"));
    QVERIFY(std::fabs(g.Point("red").x() - 0.70) < 0.01 && std::fabs(g.Point("red").y() - 0.29) < 0.01);
    QCOMPARE(g.Point("green"), QPointF(0.300, 0.600));
    QCOMPARE(g.f.doc.UndoNames(), QStringList{"Change Gamut"});
    QVERIFY(g.f.doc.Undo());
    QCOMPARE(g.Space(), QString("Rec. 709"));
}

void ColorGamutControlTest::notAGamut()
{
    GamutFixture g(Named("No Such Space"));
    QVERIFY(g.diagram->toolTip().contains("Not a gamut"));
    QCOMPARE(g.diagram->GetGamut().red.x, 0.640);
    QVERIFY(!g.control->grab().isNull());
}

QTEST_MAIN(ColorGamutControlTest)
#include "ColorGamutControlTest.moc"
