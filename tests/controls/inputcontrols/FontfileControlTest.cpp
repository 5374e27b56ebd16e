#include "ToolFixture.h"

#include "orbane/AutoParam.h"
#include "orbane/ClassIDs.h"
#include "orbane/Input.h"
#include "orbane/Operator.h"
#include "orbane/Text.h"

#include <QAbstractItemView>
#include <QComboBox>
#include <QFontDatabase>
#include <QLabel>
#include <QtTest>

using namespace Orbane;
using namespace Orbane::Test;

namespace {

constexpr Tag kStyleInput = 0x40050000, kPreviewText = 0x30050000, kLabel = 0x30040000;
const OrbID kFontfile("FontFileControl");

// A tool whose "Font" Input shows the control, with its style on "Style".
struct Font
{
    Font(const char *family, const char *style)
    {
        styleInput = AddText("Style", style, TagList());
        const TagList attrs{
            {kStyleInput, static_cast<ScriptObject *>(styleInput)}, {kLabel, "Face"}, {kPreviewText, "Title"}};
        familyInput = AddText("Font", family, attrs);
        control = f.Create(kFontfile, {familyInput});
    }
    Input *AddText(const char *id, const char *value, const TagList &attrs)
    {
        return f.tool->AddInput(OrbID(id), id, CLSID_DataType_Text, attrs, AutoText(value));
    }
    QString TextOf(Input *in) const
    {
        const AutoText now(in, f.doc.GetCurrentTime());
        return QString::fromStdString(now->Value.str());
    }
    QComboBox *Box(const char *name) const { return control->findChild<QComboBox *>(name); }

    ToolFixture f;
    Input *styleInput = nullptr;
    Input *familyInput = nullptr;
    InputControl *control = nullptr;
};

// Opens the list (which fills it) and clicks the row of `text`.
bool Pick(QComboBox *box, const QString &text)
{
    box->showPopup();
    const int row = box->findData(text);
    if (row < 0)
        return false;
    QAbstractItemView *view = box->view();
    view->scrollTo(view->model()->index(row, 0));
    const QPoint centre = view->visualRect(view->model()->index(row, 0)).center();
    QTest::mouseClick(view->viewport(), Qt::LeftButton, Qt::NoModifier, centre);
    QCoreApplication::processEvents();
    return true;
}

bool HaveFonts()
{
    const QStringList families = QFontDatabase().families();
    return families.contains("DejaVu Sans") && families.contains("DejaVu Serif") &&
           families.contains("DejaVu Sans Mono");
}

} // namespace

class FontfileControlTest : public QObject
{
    Q_OBJECT
private slots:
    void initTestCase();
    void chooseFamily_data();
    void chooseFamily();
    void chooseStyle();
    void notInstalled();
};

void FontfileControlTest::initTestCase()
{
    std::string error;
    QVERIFY2(ToolFixture::LoadControls(&error), error.c_str());
    if (!HaveFonts())
        QSKIP("the DejaVu fonts are not installed");
}

void FontfileControlTest::chooseFamily_data()
{
    QTest::addColumn<QString>("style");
    QTest::addColumn<QString>("family");
    QTest::addColumn<bool>("kept"); // the new family has the style
    QTest::newRow("the style is kept") << "Bold"
                                       << "DejaVu Serif" << true;
    QTest::newRow("a style the family lacks") << "ExtraLight"
                                              << "DejaVu Sans Mono" << false;
}

// A new family is written with a style it has, in one step; a second
// control and the preview show it.
void FontfileControlTest::chooseFamily()
{
    QFETCH(QString, style);
    QFETCH(QString, family);
    QFETCH(bool, kept);
    Font font("DejaVu Sans", style.toUtf8().constData());
    InputControl *other = font.f.Create(kFontfile, {font.familyInput});
    QVERIFY(Pick(font.Box("family"), family));
    QCOMPARE(font.TextOf(font.familyInput), family);
    const QString written = font.TextOf(font.styleInput);
    QCOMPARE(written == style, kept);
    QVERIFY(QFontDatabase().styles(family).contains(written));
    QCOMPARE(font.f.doc.UndoNames(), QStringList{"Change Face"});
    QCOMPARE(other->findChild<QComboBox *>("family")->currentText(), family);
    QCOMPARE(other->findChild<QComboBox *>("style")->currentText(), written);
    const QLabel *preview = other->findChild<QLabel *>("preview");
    QCOMPARE(preview->text(), QString("Title"));
    QCOMPARE(QFontInfo(preview->font()).family(), family);
}

void FontfileControlTest::chooseStyle()
{
    Font font("DejaVu Sans", "Book");
    QVERIFY(Pick(font.Box("style"), "Bold"));
    QCOMPARE(font.TextOf(font.styleInput), QString("Bold"));
    QCOMPARE(font.TextOf(font.familyInput), QString("DejaVu Sans"));
    QCOMPARE(font.f.doc.UndoNames(), QStringList{"Change Face"});
    QVERIFY(QFontInfo(font.control->findChild<QLabel *>("preview")->font()).bold());
}

// A comp from a machine with other fonts reads as it was saved: the family
// is shown, marked, and nothing is rewritten.
void FontfileControlTest::notInstalled()
{
    Font font("Orbane Missing Face", "Heavy");
    QComboBox *family = font.Box("family");
    QCOMPARE(family->currentText(), QString("Orbane Missing Face (not installed)"));
    QVERIFY(family->property("missing").toBool());
    QCOMPARE(font.Box("style")->currentText(), QString("Heavy"));
    QVERIFY(font.control->findChild<QLabel *>("preview")->text().startsWith("Not installed"));
    family->showPopup();
    QCOMPARE(family->currentText(), QString("Orbane Missing Face (not installed)"));
    QVERIFY(family->count() > 1);
    family->hidePopup();
    font.f.Destroy(font.control);
    QCOMPARE(font.TextOf(font.familyInput), QString("Orbane Missing Face"));
    QCOMPARE(font.TextOf(font.styleInput), QString("Heavy"));
    QVERIFY(font.f.doc.UndoNames().isEmpty());
}

QTEST_MAIN(FontfileControlTest)
#include "FontfileControlTest.moc"
