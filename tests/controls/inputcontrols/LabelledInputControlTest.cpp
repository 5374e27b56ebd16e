#include "ToolFixture.h"

#include "orbane/Input.h"

#include <QLabel>
#include <QtTest>

#include <cmath>
#include <cstring>

using namespace Orbane;
using namespace Orbane::Test;

Q_DECLARE_METATYPE(Orbane::TagList)

// The rules every labelled control shares, run through each real control
// class: a control that binds, takes attributes or copies them its own way
// must still follow them.
namespace {

const char *const kClasses[] = {"CheckboxControl", "ButtonControl", "ComboControl", "SliderControl",
                                "ScriptValListControl"};

// The check box and the button show the label text on their own child and
// the second text on the label widget; the others show the label text there.
bool LabelShowsSecond(const QString &cls)
{
    return cls == "CheckboxControl" || cls == "ButtonControl";
}

InputControl *Make(ToolFixture &f, const QString &cls, const TagList &attrs)
{
    return f.Create(OrbID(cls.toStdString()), {f.AddNumber("GainID", 0.0, attrs)});
}

QStringList Texts(const InputControl *c)
{
    TagList got;
    c->GetAttrsTagList(got);
    return {got.GetString(0x30040000, "?"), got.GetString(0x30040001, "?")};
}

QLabel *LabelOf(const InputControl *c)
{
    return c->findChild<QLabel *>("label");
}

} // namespace

class LabelledInputControlTest : public QObject
{
    Q_OBJECT
private slots:
    void initTestCase();
    void labelTexts_data();
    void labelTexts();
    void attributeRows_data();
    void attributeRows();
};

void LabelledInputControlTest::initTestCase()
{
    std::string error;
    QVERIFY2(ToolFixture::LoadControls(&error), error.c_str());
}

void LabelledInputControlTest::labelTexts_data()
{
    QTest::addColumn<QString>("cls");
    QTest::addColumn<TagList>("attrs"); // of the Input
    QTest::addColumn<TagList>("tags");  // a later SetAttrs list
    QTest::addColumn<QStringList>("texts");
    QTest::addColumn<bool>("changed");
    const TagList given{{0x30040000, "Gain"}, {0x30040001, "Opt"}};
    const QStringList same{"Gain", "Opt"};
    for (const char *cls : kClasses) {
        // The label rule: the label text, then the Input's name, then its identifier.
        QTest::addRow("%s: label text first", cls)
            << cls << TagList{{0x30020014, "Gain Name"}, {0x30040000, "Gain"}, {0x30040001, "Opt"}} << TagList{} << same
            << false;
        QTest::addRow("%s: then the Input's name", cls)
            << cls << TagList{{0x30020014, "Gain Name"}} << TagList{} << QStringList{"Gain Name", ""} << false;
        QTest::addRow("%s: then the identifier", cls)
            << cls << TagList{} << TagList{} << QStringList{"GainID", ""} << false;
        // A list gives only the texts whose tags it carries.
        QTest::addRow("%s: same texts", cls) << cls << given << given << same << false;
        QTest::addRow("%s: new label", cls)
            << cls << given << TagList{{0x30040000, "Flip"}} << QStringList{"Flip", "Opt"} << true;
        QTest::addRow("%s: the Input's name", cls)
            << cls << given << TagList{{0x30020014, "Named"}} << QStringList{"Named", "Opt"} << true;
        QTest::addRow("%s: label text before name", cls)
            << cls << given << TagList{{0x30020014, "Named"}, {0x30040000, "Gain"}} << same << false;
        QTest::addRow("%s: second text cleared", cls)
            << cls << given << TagList{{0x30040001, ""}} << QStringList{"Gain", ""} << true;
    }
}

// Open shows the texts; later ones are shown again only where they changed.
void LabelledInputControlTest::labelTexts()
{
    QFETCH(QString, cls);
    QFETCH(TagList, attrs);
    QFETCH(TagList, tags);
    QFETCH(QStringList, texts);
    QFETCH(bool, changed);
    ToolFixture f;
    InputControl *c = Make(f, cls, attrs);
    QVERIFY(c && LabelOf(c));
    const auto shown = [&](const QStringList &t) { return LabelShowsSecond(cls) ? t[1] : t[0]; };
    QCOMPARE(LabelOf(c)->text(), shown(Texts(c)));
    // Where the label widget holds the second text it is hidden without one.
    QCOMPARE(LabelOf(c)->isHidden(), LabelShowsSecond(cls) && Texts(c)[1].isEmpty());
    LabelOf(c)->setText("shown");
    QVERIFY(c->SetAttrsTagList(c->GetCurrentInput(), tags));
    c->UpdateDisplay(nullptr, nullptr);
    QCOMPARE(Texts(c), texts);
    QCOMPARE(LabelOf(c)->text(), changed ? shown(texts) : QString("shown"));
}

void LabelledInputControlTest::attributeRows_data()
{
    QTest::addColumn<QString>("cls");
    QTest::addColumn<TagList>("attrs");
    QTest::addColumn<uint>("tag");
    QTest::addColumn<double>("copied"); // NAN: not copied, the host's answer stands
    QTest::addColumn<bool>("listed");
    QTest::newRow("check box tri-state") << "CheckboxControl" << TagList{{0x10050000, 1}} << 0x10050000u << 1.0 << true;
    QTest::newRow("check box wrap: an Input attribute")
        << "CheckboxControl" << TagList{{0x10050001, 1}} << 0x10050001u << double(NAN) << false;
    QTest::newRow("button script: listed only")
        << "ButtonControl" << TagList{{0x30050000, "x = 1"}} << 0x30050000u << double(NAN) << true;
    QTest::newRow("combo label position") << "ComboControl" << TagList{{0x10050000, 1}} << 0x10050000u << 1.0 << true;
    QTest::newRow("combo sorting") << "ComboControl" << TagList{{0x10050001, 1}} << 0x10050001u << 1.0 << true;
    QTest::newRow("list rows") << "ScriptValListControl" << TagList{{0x10050000, 9}} << 0x10050000u << 9.0 << true;
    QTest::newRow("slider ticks") << "SliderControl" << TagList{{0x10050000, 5}} << 0x10050000u << 5.0 << true;
    QTest::newRow("slider places: copied only")
        << "SliderControl" << TagList{{0x10040004, 2}} << 0x10040004u << 2.0 << false;
    QTest::newRow("slider scale: a number")
        << "SliderControl" << TagList{{0x20030003, 4.5}} << 0x20030003u << 4.5 << false;
    QTest::newRow("slider caption: listed only")
        << "SliderControl" << TagList{{0x30050000, "low"}} << 0x30050000u << double(NAN) << true;
}

void LabelledInputControlTest::attributeRows()
{
    QFETCH(QString, cls);
    QFETCH(TagList, attrs);
    QFETCH(uint, tag);
    QFETCH(double, copied);
    QFETCH(bool, listed);
    ToolFixture f;
    InputControl *c = Make(f, cls, attrs);
    // Integers are copied as int32, numbers as float64; a supplied value answers false.
    float64 out = -3.0;
    QCOMPARE(c->CopyAttr(tag, &out), std::isnan(copied));
    int32 integer = 0;
    std::memcpy(&integer, &out, sizeof integer);
    if (std::isnan(copied))
        QCOMPARE(out, -3.0);
    else
        QCOMPARE(TagTypeOf(tag) == TAGTYPE_Long ? float64(integer) : out, copied);
    TagList got;
    c->GetAttrsTagList(got);
    QCOMPARE(got.FindQuery(tag), listed);
}

QTEST_MAIN(LabelledInputControlTest)
#include "LabelledInputControlTest.moc"
