#include "orbane/LookPack.h"
#include "orbane/LookPackItem.h"

#include <QDir>
#include <QFile>
#include <QTemporaryDir>
#include <QtTest>

using namespace Orbane;

namespace {

// The warnings logged since the test function began.
QStringList gWarnings;

void Collect(QtMsgType type, const QMessageLogContext &, const QString &msg)
{
    if (type == QtWarningMsg)
        gWarnings << msg;
}

// A look folder holding the given files.
struct Folder
{
    QTemporaryDir tmp;
    Folder(std::initializer_list<std::pair<QString, QByteArray>> files)
    {
        for (const auto &[name, text] : files) {
            QFile file(QDir(tmp.path()).filePath(name));
            if (file.open(QIODevice::WriteOnly))
                file.write(text);
        }
    }
};

} // namespace

class LookPackTest : public QObject
{
    Q_OBJECT
private slots:
    void initTestCase() { qInstallMessageHandler(&Collect); }
    void init() { gWarnings.clear(); }

    void missingItemIsNilAndWarnsOnce()
    {
        const LookPackItem first("Controls.NoSuchThing.Layout"), second("Controls.NoSuchThing.Layout");
        QVERIFY(!first.IsValid());
        QVERIFY(first.GetItemData().IsNil() && second.GetItemData().IsNil());
        QCOMPARE(gWarnings.filter("Controls.NoSuchThing.Layout").size(), 1);
        const LookPack pack(QStringLiteral("/nonexistent/looks"));
        QCOMPARE(pack.ItemCount(), 0);
        QVERIFY(pack.FindImageFile("Controls.Slider.Knob.1").isEmpty());
    }

    void laterFileReplacesItem()
    {
        Folder folder{{"a.lua", "return { One = { 1 }, Two = { 'from a' } }"},
                      {"b.lua", "local t = {} for i = 1, 3 do t[i] = i * 2 end return { Two = t }"}};
        const LookPack pack(folder.tmp.path());
        QCOMPARE(pack.ItemCount(), 2);
        QCOMPARE(pack.FindItem("One").FindKeyConst(ScriptVal(1))->GetNumber(), 1.0);
        QCOMPARE(pack.FindItem("Two").Length(), 3);
        QCOMPARE(pack.FindItem("Two").FindKeyConst(ScriptVal(3))->GetNumber(), 6.0);
    }

    // A broken file is skipped with one warning; the files after it load.
    void brokenFiles_data()
    {
        QTest::addColumn<QByteArray>("broken");
        QTest::newRow("syntax error") << QByteArray("return { Bad = ");
        QTest::newRow("not a table") << QByteArray("return 42");
        QTest::newRow("runtime error") << QByteArray("error('no look today')");
        QTest::newRow("reaches the system") << QByteArray("os.execute('true') return {}");
        QTest::newRow("reads files") << QByteArray("return dofile('/etc/hostname')");
    }

    void brokenFiles()
    {
        QFETCH(QByteArray, broken);
        Folder folder{{"a_broken.lua", broken}, {"b_good.lua", "return { Good = { 'yes' } }"}};
        const LookPack pack(folder.tmp.path());
        QCOMPARE(gWarnings.filter("LookPack").size(), 1);
        QCOMPARE(pack.ItemCount(), 1);
        QVERIFY(pack.HasItem("Good"));
    }
};

QTEST_GUILESS_MAIN(LookPackTest)
#include "LookPackTest.moc"
