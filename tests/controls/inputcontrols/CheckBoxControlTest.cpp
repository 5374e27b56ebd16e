#include "ToolFixture.h"

#include "orbane/AutoParam.h"
#include "orbane/ClassIDs.h"
#include "orbane/CustomCheckBox.h"
#include "orbane/Input.h"

#include <QtTest>

using namespace Orbane;
using namespace Orbane::Test;

Q_DECLARE_METATYPE(Orbane::TagList)

namespace {

constexpr Tag kTriState = 0x10050000;
constexpr Tag kAllowWrap = 0x10050001;

CustomCheckBox *BoxOf(const InputControl *c)
{
    return c->findChild<CustomCheckBox *>("checkbox");
}

InputControl *CheckBox(ToolFixture &f, Input *in, int32 width = ToolFixture::kWidth)
{
    return f.Create(CLSID_InputControl_Checkbox, {in}, width);
}

void Click(InputControl *c)
{
    CustomCheckBox *box = BoxOf(c);
    QTest::mouseClick(box, Qt::LeftButton, Qt::NoModifier, box->BoxRect().center());
}

class PaintCounter : public QObject
{
public:
    explicit PaintCounter(QWidget *w) { w->installEventFilter(this); }
    int paints = 0;

protected:
    bool eventFilter(QObject *, QEvent *event) override
    {
        if (event->type() == QEvent::Paint)
            ++paints;
        return false;
    }
};

} // namespace

class CheckBoxControlTest : public QObject
{
    Q_OBJECT
private slots:
    void initTestCase();
    void notifyGate_data();
    void notifyGate();
    void disconnectWrite_data();
    void disconnectWrite();
    void clicksWrite_data();
    void clicksWrite();
    void wrapping();
};

void CheckBoxControlTest::initTestCase()
{
    std::string error;
    QVERIFY2(ToolFixture::LoadControls(&error), error.c_str());
}

void CheckBoxControlTest::notifyGate_data()
{
    QTest::addColumn<double>("value");
    QTest::addColumn<int>("state");
    QTest::addColumn<int>("paints");
    QTest::newRow("unchanged") << 0.0 << 0 << 0;
    QTest::newRow("0.5 rounds to 1") << 0.5 << 1 << 1;
    QTest::newRow("-0.5 rounds to 0") << -0.5 << 0 << 0;
    QTest::newRow("-1 is mixed") << -1.0 << 2 << 1;
}

void CheckBoxControlTest::notifyGate()
{
    QFETCH(double, value);
    QFETCH(int, state);
    QFETCH(int, paints);
    ToolFixture f;
    Input *in = f.AddNumber("Invert", 0.0);
    InputControl *c = CheckBox(f, in);
    QCoreApplication::processEvents();
    // The box covers the control: a redisplay shows as a repaint of the box.
    PaintCounter counter(BoxOf(c));
    const AutoNumber number(value);
    for (int i = 0; i < 3; ++i) {
        c->NotifyChanged(in, number, nullptr);
        QCoreApplication::processEvents();
        QCOMPARE(counter.paints, paints);
    }
    QCOMPARE(BoxOf(c)->GetCheck(), state);
    QCOMPARE(f.NumberOf(in), 0.0);
    QVERIFY(c->NotifyChanged(in, nullptr, nullptr));
    QCOMPARE(BoxOf(c)->GetCheck(), state);
}

void CheckBoxControlTest::disconnectWrite_data()
{
    QTest::addColumn<bool>("animated");
    QTest::addColumn<double>("stored");
    QTest::addColumn<double>("after");
    QTest::newRow("shown value written back") << false << 1.3 << 1.0;
    QTest::newRow("equal value") << false << 1.0 << 1.0;
    QTest::newRow("no key at the disconnect time") << true << 1.3 << 1.3;
}

void CheckBoxControlTest::disconnectWrite()
{
    QFETCH(bool, animated);
    QFETCH(double, stored);
    QFETCH(double, after);
    ToolFixture f;
    Input *in = f.AddNumber("Invert", stored);
    in->SetAnimated(animated);
    InputControl *c = CheckBox(f, in);
    QCOMPARE(BoxOf(c)->GetCheck(), after < 0 ? 2 : int(after != 0.0));
    f.Destroy(c);
    QCOMPARE(f.NumberOf(in), after);
    QCOMPARE(int(in->KeyTimes().size()), animated ? 1 : 0);
    QVERIFY(f.doc.UndoNames().isEmpty());
}

void CheckBoxControlTest::clicksWrite_data()
{
    QTest::addColumn<bool>("triState"); // as declared
    QTest::addColumn<int>("switchTo");  // the tri-state tag set after Open, or -1
    QTest::addColumn<QList<double>>("values");
    QTest::addColumn<QList<int>>("states");
    QTest::newRow("two states") << false << -1 << QList<double>{1, 0, 1, 0} << QList<int>{1, 0, 1, 0};
    QTest::newRow("three states") << true << -1 << QList<double>{1, -1, 0, 1} << QList<int>{1, 2, 0, 1};
    QTest::newRow("switched to three states") << false << 1 << QList<double>{1, -1} << QList<int>{1, 2};
}

void CheckBoxControlTest::clicksWrite()
{
    QFETCH(bool, triState);
    QFETCH(int, switchTo);
    QFETCH(QList<double>, values);
    QFETCH(QList<int>, states);
    ToolFixture f;
    Input *in = f.AddNumber("Invert", 0.0, TagList{{kTriState, triState}});
    InputControl *c = CheckBox(f, in);
    // A switch applies at once; a list without the tag keeps the style.
    if (switchTo >= 0)
        QVERIFY(c->SetAttrsTagList(TagList{{kTriState, switchTo}}));
    QVERIFY(c->SetAttrsTagList(in, TagList{{0x30040000, "Invert"}}));
    const bool three = switchTo < 0 ? triState : switchTo == 1;
    QCOMPARE(BoxOf(c)->GetStyle(), three ? 2 : 1);
    for (int i = 0; i < values.size(); ++i) {
        Click(c);
        QCOMPARE(f.NumberOf(in), values[i]);
        QCOMPARE(BoxOf(c)->GetCheck(), states[i]);
        QCOMPARE(f.doc.UndoNames().size(), i + 1);
        QVERIFY(!c->IsUndoOpen());
    }
    QCOMPARE(f.doc.UndoNames().first(), QString("Change Invert"));
}

// A wrapping label grows the control, and needs fewer lines when wider.
void CheckBoxControlTest::wrapping()
{
    ToolFixture f;
    const char *text = "Invert the colours of every channel before the mask is applied to the foreground image";
    InputControl *one = CheckBox(f, f.AddNumber("Plain", 0.0, TagList{{0x30040000, text}}), 240);
    InputControl *many = CheckBox(f, f.AddNumber("Wrapping", 0.0, TagList{{0x30040000, text}, {kAllowWrap, 1}}), 240);
    InputControl *fits = CheckBox(f, f.AddNumber("Fits", 0.0, TagList{{0x30040000, "Invert"}, {kAllowWrap, 1}}), 240);
    QVERIFY(BoxOf(many)->IsWrapAllowed() && !BoxOf(one)->IsWrapAllowed());
    QVERIFY(BoxOf(many)->height() > BoxOf(one)->height());
    const int32 narrow = many->height();
    QVERIFY(narrow > one->height());
    QVERIFY(f.Resize(many, 900) < narrow);
    QCOMPARE(fits->height(), one->height());
    // However many controls, the layout description is read once.
    QCOMPARE(ToolFixture::LayoutReadCount("Controls.CheckBox.Layout"), 1);
}

QTEST_MAIN(CheckBoxControlTest)
#include "CheckBoxControlTest.moc"
