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

void WriteFile(const QDir &dir, const QString &name, const QByteArray &text)
{
    QFile file(dir.filePath(name));
    QVERIFY(file.open(QIODevice::WriteOnly));
    file.write(text);
}

} // namespace

class LookPackTest : public QObject
{
    Q_OBJECT
private slots:
    void initTestCase() { qInstallMessageHandler(&Collect); }
    void init() { gWarnings.clear(); }
    void missingItemIsNilAndWarnsOnce();
    void laterFileReplacesItem();
    void brokenFiles_data();
    void brokenFiles();
    void missingFolderGivesEmptyPack();
};

void LookPackTest::missingItemIsNilAndWarnsOnce()
{
    const LookPackItem first("Controls.NoSuchThing.Layout");
    const LookPackItem second("Controls.NoSuchThing.Layout");
    QVERIFY(!first.IsValid());
    QVERIFY(first.GetItemData().IsNil());
    QVERIFY(second.GetItemData().IsNil());
    QCOMPARE(gWarnings.filter("Controls.NoSuchThing.Layout").size(), 1);
}

void LookPackTest::laterFileReplacesItem()
{
    QTemporaryDir tmp;
    QVERIFY(tmp.isValid());
    const QDir dir(tmp.path());
    WriteFile(dir, "a.lua", "return { One = { 1 }, Two = { 'from a' } }");
    WriteFile(dir, "b.lua", "local t = {} for i = 1, 3 do t[i] = i * 2 end return { Two = t }");

    const LookPack pack(tmp.path());
    QCOMPARE(pack.ItemCount(), 2);
    QCOMPARE(pack.FindItem("One").FindKeyConst(ScriptVal(1))->GetNumber(), 1.0);
    const ScriptVal &two = pack.FindItem("Two");
    QCOMPARE(two.Length(), 3);
    QCOMPARE(two.FindKeyConst(ScriptVal(3))->GetNumber(), 6.0);
}

void LookPackTest::brokenFiles_data()
{
    QTest::addColumn<QByteArray>("broken");
    QTest::newRow("syntax error") << QByteArray("return { Bad = ");
    QTest::newRow("not a table") << QByteArray("return 42");
    QTest::newRow("runtime error") << QByteArray("error('no look today')");
    QTest::newRow("reaches the system") << QByteArray("os.execute('true') return {}");
    QTest::newRow("reads files") << QByteArray("return dofile('/etc/hostname')");
}

void LookPackTest::brokenFiles()
{
    QFETCH(QByteArray, broken);
    QTemporaryDir tmp;
    QVERIFY(tmp.isValid());
    const QDir dir(tmp.path());
    WriteFile(dir, "a_broken.lua", broken);
    WriteFile(dir, "b_good.lua", "return { Good = { 'yes' } }");

    const LookPack pack(tmp.path());
    QCOMPARE(gWarnings.filter("LookPack").size(), 1);
    QCOMPARE(pack.ItemCount(), 1);
    QVERIFY(pack.HasItem("Good"));
}

void LookPackTest::missingFolderGivesEmptyPack()
{
    const LookPack pack(QStringLiteral("/nonexistent/looks"));
    QCOMPARE(pack.ItemCount(), 0);
    QVERIFY(pack.FindItem("Controls.CheckBox.Layout").IsNil());
    QVERIFY(pack.FindImageFile("Controls.Slider.Knob.1").isEmpty());
    QVERIFY(gWarnings.size() >= 1);
}

QTEST_GUILESS_MAIN(LookPackTest)
#include "LookPackTest.moc"
