// Label groups in a real inspector: headers fold the rows under them, inner
// groups keep their own state inside outer ones, Ctrl-click folds every
// group, and the open state lives in the header's Input.
#include "ToolFixture.h"

#include "orbane/AutoParam.h"
#include "orbane/ClassIDs.h"
#include "orbane/Input.h"
#include "orbane/Operator.h"
#include "orbane/ParameterPanel.h"

#include <QToolButton>
#include <QtTest>

using namespace Orbane;
using namespace Orbane::Test;

Q_DECLARE_METATYPE(Orbane::OrbID)

namespace {

constexpr Tag kDropDown = 0x10050000;
constexpr Tag kNumInputs = 0x10050001;
constexpr Tag kNestLevel = 0x10050002;
constexpr Tag kHeight = 0x10050006;

TagList Shows(const OrbID &classID, TagList more = TagList())
{
    TagList attrs{{INPA_InputControl, classID}};
    attrs.Append(more);
    return attrs;
}

// G1 folds A, G2, B and C; G2, inside it, folds B; D is outside both.
void AddGroups(ToolFixture &f)
{
    f.AddNumber("G1", 1.0, Shows(CLSID_InputControl_Nest, {{kNumInputs, 4}}));
    f.AddNumber("A", 0.0, Shows(CLSID_InputControl_Checkbox));
    f.AddNumber("G2", 1.0, Shows(CLSID_InputControl_Label, {{kDropDown, 1}, {kNumInputs, 1}, {kNestLevel, 1}}));
    f.AddNumber("B", 0.0, Shows(CLSID_InputControl_Checkbox));
    f.AddNumber("C", 0.0, Shows(CLSID_InputControl_Checkbox));
    f.AddNumber("D", 0.0, Shows(CLSID_InputControl_Checkbox));
}

InputControl *ControlOf(ParameterPanel &panel, Operator *tool, const char *id)
{
    const auto controls = panel.ControlsOf(tool->FindInput(OrbID(id)));
    return controls.empty() ? nullptr : controls.front();
}

// "G1" clicks G1's header, "ctrl+G2" Ctrl-clicks G2's.
void ClickHeader(ParameterPanel &panel, Operator *tool, const QString &what)
{
    const bool ctrl = what.startsWith("ctrl+");
    const QString id = ctrl ? what.mid(5) : what;
    auto *header = ControlOf(panel, tool, id.toUtf8().constData())->findChild<QToolButton *>("header");
    QVERIFY(header && header->isVisible());
    QTest::mouseClick(header, Qt::LeftButton, ctrl ? Qt::ControlModifier : Qt::NoModifier);
}

QStringList VisibleRows(ParameterPanel &panel, Operator *tool)
{
    QStringList ids;
    for (Input *in : tool->Inputs())
        if (ControlOf(panel, tool, in->GetID().c_str())->isVisible())
            ids << in->GetID().c_str();
    return ids;
}

} // namespace

class LabelControlTest : public QObject
{
    Q_OBJECT
private slots:
    void initTestCase();
    void folding_data();
    void folding();
    void stateKeptPerTool();
    void boundControlsFollow_data();
    void boundControlsFollow();
    void variantsTakeTheirRoom_data();
    void variantsTakeTheirRoom();
};

void LabelControlTest::initTestCase()
{
    std::string error;
    QVERIFY2(ToolFixture::LoadControls(&error), error.c_str());
}

void LabelControlTest::folding_data()
{
    QTest::addColumn<QStringList>("clicks");
    QTest::addColumn<QStringList>("visible");
    const QStringList all{"G1", "A", "G2", "B", "C", "D"};
    QTest::newRow("all open") << QStringList{} << all;
    QTest::newRow("outer closed") << QStringList{"G1"} << QStringList{"G1", "D"};
    QTest::newRow("inner closed") << QStringList{"G2"} << QStringList{"G1", "A", "G2", "C", "D"};
    QTest::newRow("outer closed and opened keeps inner closed")
        << QStringList{"G2", "G1", "G1"} << QStringList{"G1", "A", "G2", "C", "D"};
    QTest::newRow("ctrl-click closes every group") << QStringList{"ctrl+G2"} << QStringList{"G1", "D"};
    QTest::newRow("ctrl-click on a closed group opens every group") << QStringList{"G2", "G1", "ctrl+G1"} << all;
}

void LabelControlTest::folding()
{
    QFETCH(QStringList, clicks);
    QFETCH(QStringList, visible);
    ToolFixture f;
    AddGroups(f);
    ParameterPanel panel(&f.doc);
    panel.resize(300, 600);
    panel.show();
    panel.ShowTool(f.tool);
    for (const QString &click : clicks)
        ClickHeader(panel, f.tool, click);
    QCOMPARE(VisibleRows(panel, f.tool), visible);
    // The rows close up under the last visible one, in order.
    int32 bottom = ControlOf(panel, f.tool, "G1")->y();
    for (const QString &id : visible) {
        const InputControl *c = ControlOf(panel, f.tool, id.toUtf8().constData());
        QCOMPARE(c->y(), bottom);
        bottom += c->height();
    }
    // Folding changes the view, not the tool.
    QVERIFY(f.doc.UndoNames().isEmpty());
}

void LabelControlTest::stateKeptPerTool()
{
    ToolFixture f;
    AddGroups(f);
    AutoRef<Operator> other(new Operator("Tool2", "TestTool"));
    other->AddInput(OrbID("G2"), "G2", CLSID_DataType_Number,
                    Shows(CLSID_InputControl_Label, {{kDropDown, 1}, {kNumInputs, 1}}), AutoNumber(1.0));
    other->AddInput(OrbID("B"), "B", CLSID_DataType_Number, Shows(CLSID_InputControl_Checkbox), AutoNumber(0.0));
    QVERIFY(f.doc.AddTool(other.get()));
    ParameterPanel panel(&f.doc);
    panel.resize(300, 600);
    panel.show();
    panel.ShowTool(f.tool);
    ClickHeader(panel, f.tool, "G2");
    panel.ShowTool(other.get());
    QCOMPARE(VisibleRows(panel, other.get()), (QStringList{"G2", "B"}));
    panel.ShowTool(f.tool);
    QCOMPARE(VisibleRows(panel, f.tool), (QStringList{"G1", "A", "G2", "C", "D"}));
}

// Two headers of one Input fold together; unbinding one writes the state
// it showed, rounded, without an undo step.
void LabelControlTest::boundControlsFollow_data()
{
    QTest::addColumn<double>("stored");
    QTest::addColumn<double>("afterClick");
    QTest::newRow("open, 2.6 shown as open") << 2.6 << 0.0;
    QTest::newRow("closed, 0.3 shown as closed") << 0.3 << 1.0;
}

void LabelControlTest::boundControlsFollow()
{
    QFETCH(double, stored);
    QFETCH(double, afterClick);
    ToolFixture f;
    Input *in = f.AddNumber("Group", stored, {{kNumInputs, 1}});
    InputControl *first = f.Create(CLSID_InputControl_Nest, {in});
    InputControl *second = f.Create(CLSID_InputControl_Nest, {in});
    auto *header = second->findChild<QToolButton *>("header");
    QCOMPARE(header->arrowType(), stored > 0.5 ? Qt::DownArrow : Qt::RightArrow);
    f.Destroy(second);
    QCOMPARE(f.NumberOf(in), afterClick == 0.0 ? 1.0 : 0.0);
    QTest::mouseClick(first->findChild<QToolButton *>("header"), Qt::LeftButton);
    QCOMPARE(f.NumberOf(in), afterClick);
    QVERIFY(f.doc.UndoNames().isEmpty());
}

void LabelControlTest::variantsTakeTheirRoom_data()
{
    QTest::addColumn<OrbID>("classID");
    QTest::addColumn<int>("height");
    QTest::addColumn<QString>("shown"); // the one child that shows
    QTest::newRow("spacer") << CLSID_InputControl_Spacer << 23 << "space";
    QTest::newRow("separator") << CLSID_InputControl_Separator << 23 << "line";
    QTest::newRow("label") << CLSID_InputControl_Label << -1 << "label";
    QTest::newRow("nest") << CLSID_InputControl_Nest << -1 << "header";
}

void LabelControlTest::variantsTakeTheirRoom()
{
    QFETCH(OrbID, classID);
    QFETCH(int, height);
    QFETCH(QString, shown);
    ToolFixture f;
    Input *in = f.AddNumber("Row", 1.0, {{kHeight, 23}});
    InputControl *c = f.Create(classID, {in});
    QVERIFY(c);
    if (height >= 0)
        QCOMPARE(c->height(), height);
    for (const char *child : {"space", "line", "label", "header"})
        QCOMPARE(c->findChild<QWidget *>(child)->isVisible(), shown == child);
}

QTEST_MAIN(LabelControlTest)
#include "LabelControlTest.moc"
