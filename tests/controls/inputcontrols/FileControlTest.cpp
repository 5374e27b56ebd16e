#include "ToolFixture.h"

#include "orbane/AutoParam.h"
#include "orbane/ClassIDs.h"
#include "orbane/Input.h"
#include "orbane/Operator.h"
#include "orbane/Prefs.h"
#include "orbane/Text.h"

#include <QFileDialog>
#include <QLineEdit>
#include <QMimeData>
#include <QTemporaryDir>
#include <QtTest>

using namespace Orbane;
using namespace Orbane::Test;

Q_DECLARE_METATYPE(Orbane::TagList)

namespace {

constexpr Tag kSave = 0x10050000, kDirectory = 0x10050001, kRelative = 0x10050002, kLabel = 0x30040000;
const OrbID kFile("FileControl");

// A folder with "a.exr", "shots/b.exr" and an empty folder "sub".
struct Disk
{
    Disk()
    {
        QDir(dir.path()).mkpath("shots");
        QDir(dir.path()).mkpath("sub");
        for (const char *name : {"a.exr", "shots/b.exr"}) {
            QFile file(Path(name));
            file.open(QIODevice::WriteOnly);
        }
    }
    QString Path(const QString &name) const { return name.isEmpty() ? name : dir.filePath(name); }
    QTemporaryDir dir;
};

Input *AddText(ToolFixture &f, const char *id, const TagList &attrs)
{
    return f.tool->AddInput(OrbID(id), id, CLSID_DataType_Text, attrs, AutoText(""));
}

QString TextOf(ToolFixture &f, Input *in)
{
    const AutoText now(in, f.doc.GetCurrentTime());
    return now ? QString::fromStdString(now->Value.str()) : QString("<none>");
}

QLineEdit *EditOf(const QWidget *c)
{
    return c->findChild<QLineEdit *>("edit");
}

// A file dragged from elsewhere and dropped on the control.
bool Drop(QWidget *target, const QString &file)
{
    QMimeData mime;
    mime.setUrls({QUrl::fromLocalFile(file)});
    QDragEnterEvent enter(QPoint(5, 5), Qt::CopyAction, &mime, Qt::LeftButton, Qt::NoModifier);
    QApplication::sendEvent(target, &enter);
    QDropEvent drop(QPoint(5, 5), Qt::CopyAction, &mime, Qt::LeftButton, Qt::NoModifier);
    QApplication::sendEvent(target, &drop);
    return enter.isAccepted() && drop.isAccepted();
}

} // namespace

class FileControlTest : public QObject
{
    Q_OBJECT
private slots:
    void initTestCase();
    void choose_data();
    void choose();
    void missingMark_data();
    void missingMark();
    void relativeToComp();
};

void FileControlTest::initTestCase()
{
    std::string error;
    QVERIFY2(ToolFixture::LoadControls(&error), error.c_str());
}

void FileControlTest::choose_data()
{
    QTest::addColumn<QString>("how");
    for (const char *how : {"typed", "dropped", "browsed"})
        QTest::newRow(how) << how;
}

// However the path is given, it is one step, and a second control of the
// Input shows it.
void FileControlTest::choose()
{
    QFETCH(QString, how);
    Disk disk;
    ToolFixture f;
    Input *in = AddText(f, "Source", TagList{{kLabel, "Plate"}});
    InputControl *c = f.Create(kFile, {in});
    InputControl *other = f.Create(kFile, {in});
    const QString path = disk.Path("shots/b.exr");
    if (how == "typed") {
        QTest::keyClicks(EditOf(c), path);
        QTest::keyClick(EditOf(c), Qt::Key_Return);
    } else if (how == "dropped") {
        QVERIFY(Drop(c, path));
    } else {
        QTest::mouseClick(c->findChild<QWidget *>("browse"), Qt::LeftButton);
        auto *dialog = c->findChild<QFileDialog *>("browseDialog");
        QVERIFY(dialog);
        dialog->selectFile(path);
        QMetaObject::invokeMethod(dialog, "accept");
    }
    QCOMPARE(TextOf(f, in), path);
    QCOMPARE(f.doc.UndoNames(), QStringList{"Change Plate"});
    QCOMPARE(EditOf(other)->text(), path);
    QCOMPARE(EditOf(other)->property("missing").toBool(), false);
}

void FileControlTest::missingMark_data()
{
    QTest::addColumn<TagList>("attrs");
    QTest::addColumn<QString>("name"); // in the test's folder
    QTest::addColumn<bool>("missing");
    QTest::newRow("file there") << TagList() << "a.exr" << false;
    QTest::newRow("file not there") << TagList() << "gone.exr" << true;
    QTest::newRow("no path") << TagList() << "" << false;
    QTest::newRow("save: a new file") << TagList{{kSave, 1}} << "new.exr" << false;
    QTest::newRow("save: no such folder") << TagList{{kSave, 1}} << "nowhere/new.exr" << true;
    QTest::newRow("folder there") << TagList{{kDirectory, 1}} << "sub" << false;
    QTest::newRow("a file for a folder") << TagList{{kDirectory, 1}} << "a.exr" << true;
}

void FileControlTest::missingMark()
{
    QFETCH(TagList, attrs);
    QFETCH(QString, name);
    QFETCH(bool, missing);
    Disk disk;
    ToolFixture f;
    Input *in = AddText(f, "Source", attrs);
    InputControl *c = f.Create(kFile, {in});
    QVERIFY(in->SetValue(AutoText(disk.Path(name).toStdString()), f.doc.GetCurrentTime()));
    QCOMPARE(EditOf(c)->text(), disk.Path(name));
    QCOMPARE(EditOf(c)->property("missing").toBool(), missing);
    QCOMPARE(EditOf(c)->toolTip().startsWith("No such"), missing);
}

// A file chosen inside the comp's folder is written relative to it, read
// back from there, and kept so when the control is unbound.
void FileControlTest::relativeToComp()
{
    Disk disk;
    ToolFixture f;
    f.doc.SetPref(PREF_CompFolder, disk.dir.path().toStdString());
    Input *in = AddText(f, "Source", TagList{{kRelative, 1}});
    InputControl *c = f.Create(kFile, {in});
    QVERIFY(Drop(EditOf(c), disk.Path("shots/b.exr")));
    QCOMPARE(TextOf(f, in), QString("shots/b.exr"));
    QCOMPARE(EditOf(c)->property("missing").toBool(), false);
    QVERIFY(Drop(c, disk.Path("../elsewhere.exr")));
    QCOMPARE(TextOf(f, in), QString("../elsewhere.exr"));
    QCOMPARE(EditOf(c)->property("missing").toBool(), true);
    // Unbinding writes back what the control holds: still relative, no step.
    const int steps = f.doc.UndoNames().size();
    f.Destroy(c);
    QCOMPARE(TextOf(f, in), QString("../elsewhere.exr"));
    QCOMPARE(f.doc.UndoNames().size(), steps);
}

QTEST_MAIN(FileControlTest)
#include "FileControlTest.moc"
