#include "ToolFixture.h"

#include "orbane/AutoParam.h"
#include "orbane/ClassIDs.h"
#include "orbane/ElideLabel.h"
#include "orbane/Input.h"
#include "orbane/InputWatcher.h"
#include "orbane/Operator.h"
#include "orbane/OrbComboBox.h"

#include <QAbstractItemView>
#include <QtTest>

using namespace Orbane;
using namespace Orbane::Test;

Q_DECLARE_METATYPE(Orbane::TagList)

namespace {

constexpr Tag kLabelPosition = 0x10050000;
constexpr Tag kAlphaSort = 0x10050001;
constexpr Tag kAddString = 0x38040000;
constexpr Tag kAddSeparator = 0x38040001;
constexpr Tag kItemInteger = 0x18040000;
constexpr Tag kItemValue = 0x28030000;
constexpr Tag kItemPointer = 0x68040000;
constexpr Tag kItemID = 0x88030000;
constexpr Tag kWrittenInteger = 0x100003e8;
constexpr Tag kWrittenPointer = 0x600003e8;
// The value Inputs start at: no item has it, so every first choice writes.
constexpr float64 kNoItem = -7.0;

OrbComboBox *ComboOf(const InputControl *c)
{
    return c ? c->findChild<OrbComboBox *>("combo") : nullptr;
}

QStringList RowTexts(const OrbComboBox *combo)
{
    QStringList rows;
    for (int row = 0; row < combo->count(); ++row)
        rows << (combo->ItemIndexOf(row) >= 0 && combo->itemText(row).isEmpty() ? "-" : combo->itemText(row));
    return rows;
}

TagList ABC(TagList more = TagList())
{
    TagList attrs{{kAddString, "A"}, {kAddSeparator, ""}, {kAddString, "B"}, {kAddString, "C"}};
    attrs.Append(more);
    return attrs;
}

AutoParameter MakeID(const OrbID &type, const QString &value)
{
    const std::string text = value.toStdString();
    return type == CLSID_DataType_Text ? AutoParameter(AutoText(OrbString(text)))
                                       : AutoParameter(AutoOrbIDParam(OrbID(text)));
}

Input *AddID(ToolFixture &f, const char *id, const OrbID &type, const char *value, const TagList &attrs)
{
    return f.tool->AddInput(OrbID(id), id, type, attrs, MakeID(type, value));
}

// Opens the list and clicks a row, as the user picks an item.
void Pick(OrbComboBox *combo, int row)
{
    combo->showPopup();
    const QAbstractItemView *view = combo->view();
    const QPoint centre = view->visualRect(view->model()->index(row, 0)).center();
    QTest::mouseClick(view->viewport(), Qt::LeftButton, Qt::NoModifier, centre);
    QCoreApplication::processEvents();
}

// Keeps the tags of the last write an Input told its watchers of.
class TagWatcher : public InputWatcher
{
public:
    explicit TagWatcher(Input *in) : mInput(in) { in->AttachWatcher(this); }
    ~TagWatcher() override { mInput->DetachWatcher(this); }
    void OnInputChanged(Input *, Parameter *, const TagList *tags) override
    {
        ++calls;
        last = tags ? *tags : TagList();
    }
    int calls = 0;
    TagList last;

private:
    Input *mInput;
};

} // namespace

class ComboControlTest : public QObject
{
    Q_OBJECT
private slots:
    void initTestCase();
    void itemValues_data();
    void itemValues();
    void nearestItem_data();
    void nearestItem();
    void identifiers_data();
    void identifiers();
    void livePreview_data();
    void livePreview();
    void writesCarryItemTags();
    void labelPosition_data();
    void labelPosition();
};
void ComboControlTest::initTestCase()
{
    std::string error;
    QVERIFY2(ToolFixture::LoadControls(&error), error.c_str());
}

void ComboControlTest::itemValues_data()
{
    QTest::addColumn<TagList>("attrs");
    QTest::addColumn<QStringList>("rows");
    QTest::addColumn<QList<double>>("values"); // of each row, written by picking it
    const double sep = -1000000.0;             // a separator's value
    QTest::newRow("separator does not count") << TagList{{kAddString, "A"}, {kAddSeparator, ""}, {kAddString, "B"}}
                                              << QStringList{"A", "-", "B"} << QList<double>{0, sep, 1};
    QTest::newRow("explicit value keeps the ordinal")
        << TagList{{kAddString, "A"}, {kItemValue, 10.0}, {kAddString, "B"}} << QStringList{"A", "B"}
        << QList<double>{10, 1};
    // Sorted rows still write their own item's value.
    QTest::newRow("sorted by number") << TagList{{kAlphaSort, 1},
                                                 {kAddString, "Layer 10"},
                                                 {kAddString, "Layer 2"},
                                                 {kAddString, "layer 1"}}
                                      << QStringList{"layer 1", "Layer 2", "Layer 10"} << QList<double>{2, 1, 0};
}

void ComboControlTest::itemValues()
{
    QFETCH(TagList, attrs);
    QFETCH(QStringList, rows);
    QFETCH(QList<double>, values);
    ToolFixture f;
    Input *in = f.AddNumber("Mode", kNoItem, attrs);
    OrbComboBox *combo = ComboOf(f.Create(CLSID_InputControl_Combo, {in}));
    QVERIFY(combo);
    QCOMPARE(RowTexts(combo), rows);
    QCOMPARE(combo->currentIndex(), -1);
    for (int row = 0; row < values.size(); ++row) {
        if (rows[row] == "-") {
            // A separator's value selects it, though no row text is shown.
            QVERIFY(in->SetValue(AutoNumber(values[row]), f.doc.GetCurrentTime()));
            QCOMPARE(combo->currentIndex(), -1);
            continue;
        }
        Pick(combo, row);
        QCOMPARE(f.NumberOf(in), values[row]);
        QCOMPARE(combo->currentIndex(), row);
    }
}

// A value between items shows the nearest within reach; closing the control
// writes the shown item's value back, or 0 where none is shown, in one step.
void ComboControlTest::nearestItem_data()
{
    QTest::addColumn<TagList>("attrs");
    QTest::addColumn<double>("value");
    QTest::addColumn<QString>("shown");
    QTest::addColumn<double>("closed");
    QTest::newRow("1.4 picks 1") << ABC() << 1.4 << "B" << 1.0;
    QTest::newRow("1.6 picks 2") << ABC() << 1.6 << "C" << 2.0;
    QTest::newRow("1.6 past the last") << TagList{{kAddString, "A"}, {kAddString, "B"}} << 1.6 << "" << 0.0;
    QTest::newRow("equal distances: the first")
        << TagList{{kAddString, "A"}, {kItemValue, 1.25}, {kAddString, "B"}, {kItemValue, 0.75}} << 1.0 << "A" << 1.25;
    // A separator is an item of value -1000000: a number within reach of it
    // selects it, and closing writes that value back.
    QTest::newRow("near a separator picks it")
        << TagList{{kAddString, "A"}, {kAddSeparator, ""}, {kAddString, "B"}} << -999999.6 << "" << -1000000.0;
    QTest::newRow("beyond reach of a separator")
        << TagList{{kAddString, "A"}, {kAddSeparator, ""}, {kAddString, "B"}} << -999999.4 << "" << 0.0;
    QTest::newRow("nearest of two within reach")
        << TagList{{kAddString, "A"}, {kItemValue, 1.4}, {kAddString, "B"}, {kItemValue, 1.0}} << 1.1 << "B" << 1.0;
}

void ComboControlTest::nearestItem()
{
    QFETCH(TagList, attrs);
    QFETCH(double, value);
    QFETCH(QString, shown);
    QFETCH(double, closed);
    ToolFixture f;
    Input *in = f.AddNumber("Mode", kNoItem, attrs);
    InputControl *c = f.Create(CLSID_InputControl_Combo, {in});
    QCOMPARE(ComboOf(c)->currentIndex(), -1);
    QVERIFY(in->SetValue(AutoNumber(value), f.doc.GetCurrentTime()));
    QCOMPARE(ComboOf(c)->currentText(), shown);
    QCOMPARE(f.NumberOf(in), value);
    const int steps = f.doc.UndoNames().size();
    f.Destroy(c);
    QCOMPARE(f.NumberOf(in), closed);
    QCOMPARE(f.doc.UndoNames().size(), steps + 1);
    QCOMPARE(f.doc.UndoDepth(), 0);
}

void ComboControlTest::identifiers_data()
{
    QTest::addColumn<QString>("type");
    QTest::addColumn<QStringList>("texts"); // the value set, the item then shown, the value a pick writes
    QTest::addColumn<int>("pick");          // a row
    for (const char *type : {"ID", "Text"}) {
        QTest::addRow("%s: identifier given", type) << type << QStringList{"add", "Add", "over"} << 1;
        QTest::addRow("%s: text is the identifier", type) << type << QStringList{"Multiply", "Multiply", "screen"} << 4;
        QTest::addRow("%s: unknown identifier", type) << type << QStringList{"dissolve", "", "screen"} << 4;
    }
}

void ComboControlTest::identifiers()
{
    QFETCH(QString, type);
    QFETCH(QStringList, texts);
    QFETCH(int, pick);
    ToolFixture f;
    const TagList attrs{{kAddString, "Add"},      {kItemID, OrbID("add")},   {kAddString, "Over"},
                        {kItemID, OrbID("over")}, {kAddSeparator, ""},       {kAddString, "Multiply"},
                        {kAddString, "Screen"},   {kItemID, OrbID("screen")}};
    const OrbID dataType = type == "Text" ? CLSID_DataType_Text : CLSID_DataType_ID;
    Input *in = AddID(f, "Apply", dataType, "over", attrs);
    OrbComboBox *combo = ComboOf(f.Create(CLSID_InputControl_ComboID, {in}));
    QVERIFY(combo);
    QCOMPARE(RowTexts(combo), (QStringList{"Add", "Over", "-", "Multiply", "Screen"}));
    QCOMPARE(combo->currentText(), QString("Over"));
    in->SetValue(MakeID(dataType, texts[0]), f.doc.GetCurrentTime());
    QCOMPARE(combo->currentText(), texts[1]);
    QCOMPARE(combo->currentIndex() < 0, texts[1].isEmpty());
    Pick(combo, pick);
    const AutoParameter written(in->GetValue(f.doc.GetCurrentTime()));
    QVERIFY(written->Equals(*MakeID(dataType, texts[2])));
}

// Keys in the open list preview each item, which a second control of the
// Input follows; a gesture that ends on the value it started from leaves no
// step. (Choosing and Escape are worked in the choices script.)
void ComboControlTest::livePreview_data()
{
    QTest::addColumn<QList<int>>("keys");
    QTest::addColumn<QList<double>>("previews"); // the value after each key but the last
    QTest::newRow("preview and come back")
        << QList<int>{Qt::Key_Down, Qt::Key_Up, Qt::Key_Return} << QList<double>{1, 0};
    QTest::newRow("choosing the shown item") << QList<int>{Qt::Key_Return} << QList<double>{};
}

void ComboControlTest::livePreview()
{
    QFETCH(QList<int>, keys);
    QFETCH(QList<double>, previews);
    ToolFixture f;
    Input *in = f.AddNumber("Mode", 0.0, ABC());
    OrbComboBox *combo = ComboOf(f.Create(CLSID_InputControl_Combo, {in}));
    InputControl *other = f.Create(CLSID_InputControl_Combo, {in});
    combo->showPopup();
    for (int i = 0; i < keys.size(); ++i) {
        QTest::keyClick(combo->view(), Qt::Key(keys[i]));
        if (i < previews.size()) {
            QCOMPARE(f.NumberOf(in), previews[i]);
            QCOMPARE(ComboOf(other)->currentText(), QString("ABC").mid(int(previews[i]), 1));
        }
    }
    QCoreApplication::processEvents();
    QVERIFY(!combo->IsPopupVisible());
    QCOMPARE(f.NumberOf(in), 0.0);
    QCOMPARE(f.doc.UndoDepth(), 0);
    QVERIFY(f.doc.UndoNames().isEmpty());
}

// A pick writes its item's integer (a zero one left out) and pointer.
void ComboControlTest::writesCarryItemTags()
{
    static int anchor = 0;
    void *const address = &anchor;
    for (bool idVariant : {false, true}) {
        ToolFixture f;
        const TagList attrs{{kAddString, "A"}, {kItemInteger, 7}, {kItemPointer, address}, {kAddString, "B"},
                            {kAddString, "C"}, {kItemInteger, 0}, {kItemPointer, address}};
        Input *in =
            idVariant ? AddID(f, "Mode", CLSID_DataType_ID, "none", attrs) : f.AddNumber("Mode", kNoItem, attrs);
        InputControl *c = f.Create(idVariant ? CLSID_InputControl_ComboID : CLSID_InputControl_Combo, {in});
        TagWatcher watcher(in);
        Pick(ComboOf(c), 0);
        QCOMPARE(watcher.last.GetLong(kWrittenInteger, 0), int64(7));
        QCOMPARE(watcher.last.GetPtr(kWrittenPointer, nullptr), address);
        Pick(ComboOf(c), 2);
        QCOMPARE(watcher.calls, 2);
        QVERIFY(!watcher.last.FindQuery(kWrittenInteger));
        QCOMPARE(watcher.last.GetPtr(kWrittenPointer, nullptr), address);
    }
}

void ComboControlTest::labelPosition_data()
{
    QTest::addColumn<int>("position");
    QTest::addColumn<bool>("beside");
    QTest::newRow("Horizontal") << 0 << true;
    QTest::newRow("Vertical") << 1 << false;
}

void ComboControlTest::labelPosition()
{
    QFETCH(int, position);
    QFETCH(bool, beside);
    ToolFixture f;
    const TagList attrs = ABC({{kLabelPosition, position}, {0x30040000, "Blend"}});
    InputControl *c = f.Create(CLSID_InputControl_Combo, {f.AddNumber("Mode", 0.0, attrs)});
    f.Create(CLSID_InputControl_Combo, {f.AddNumber("Mode2", 0.0, attrs)});
    const char *item = position ? "Controls.Combo.Layout.Vertical" : "Controls.Combo.Layout.Horizontal";
    QCOMPARE(ToolFixture::LayoutReadCount(item), 1);
    const ElideLabel *labelWidget = c->findChild<ElideLabel *>("label");
    const QRect label = labelWidget->geometry(), combo = ComboOf(c)->geometry();
    QCOMPARE(labelWidget->text(), QString("Blend"));
    QVERIFY(beside ? label.right() < combo.left() : label.bottom() < combo.top());
    QCOMPARE(combo.width() == ToolFixture::kWidth, !beside);
}

QTEST_MAIN(ComboControlTest)
#include "ComboControlTest.moc"
