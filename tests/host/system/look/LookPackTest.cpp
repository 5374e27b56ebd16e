#include "orbane/LookPack.h"
#include "orbane/LookPackItem.h"

#include <QDir>
#include <QFile>
#include <QTemporaryDir>
#include <QtTest>

using namespace Orbane;

namespace {

// Collects the warnings logged while it lives.
class WarningLog
{
public:
    WarningLog()
    {
        sLog = this;
        mPrevious = qInstallMessageHandler(&WarningLog::Handle);
    }
    ~WarningLog()
    {
        qInstallMessageHandler(mPrevious);
        sLog = nullptr;
    }
    int CountContaining(const QString &text) const
    {
        return int(
            std::count_if(mWarnings.begin(), mWarnings.end(), [&](const QString &w) { return w.contains(text); }));
    }
    int Count() const { return mWarnings.size(); }

private:
    static void Handle(QtMsgType type, const QMessageLogContext &, const QString &msg)
    {
        if (sLog && type == QtWarningMsg)
            sLog->mWarnings << msg;
    }
    static inline WarningLog *sLog = nullptr;
    QtMessageHandler mPrevious = nullptr;
    QStringList mWarnings;
};

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
    void folderComesFromEnvironment();
    void layoutItems_data();
    void layoutItems();
    void missingItemIsNilAndWarnsOnce();
    void imageFiles_data();
    void imageFiles();
    void laterFileReplacesItem();
    void brokenFiles_data();
    void brokenFiles();
    void missingFolderGivesEmptyPack();
};

void LookPackTest::folderComesFromEnvironment()
{
    const QString env = QString::fromLocal8Bit(qgetenv("ORBANE_LOOKS"));
    QVERIFY2(!env.isEmpty(), "the test runs with ORBANE_LOOKS set");
    QCOMPARE(LookPack::Get().Folder(), QDir(env).absolutePath());
    QCOMPARE(LookPack::LocateFolder(), QDir(env).absolutePath());
}

void LookPackTest::layoutItems_data()
{
    QTest::addColumn<QString>("item");
    QTest::addColumn<QStringList>("names"); // names the description must mention

    QTest::newRow("check box") << "Controls.CheckBox.Layout" << QStringList{"label", "checkbox", "expression"};
    QTest::newRow("button") << "Controls.Button.Layout" << QStringList{"label", "button"};
    QTest::newRow("combo horizontal") << "Controls.Combo.Layout.Horizontal" << QStringList{"label", "combo"};
    QTest::newRow("combo vertical") << "Controls.Combo.Layout.Vertical" << QStringList{"label", "combo"};
    QTest::newRow("slider") << "Controls.Slider.Layout"
                            << QStringList{"slider", "edit", "label", "minlabel", "midlabel", "maxlabel"};
    QTest::newRow("script value list") << "Controls.ScriptValList.Layout" << QStringList{"label", "list"};
    QTest::newRow("default") << "Controls.Default.Layout" << QStringList{"expression"};
}

namespace {

void CollectNames(const ScriptVal &node, QStringList &out)
{
    if (node.IsString()) {
        out << QString::fromUtf8(node.GetString());
        return;
    }
    if (const ScriptVal *name = node.FindKeyConst(ScriptVal("name")))
        out << QString::fromUtf8(name->GetString());
    for (int32 i = 1; node.IsTable() && i <= node.Length(); ++i)
        CollectNames(*node.FindKeyConst(ScriptVal(i)), out);
}

} // namespace

void LookPackTest::layoutItems()
{
    QFETCH(QString, item);
    QFETCH(QStringList, names);

    WarningLog log;
    const LookPackItem look(OrbID(item.toStdString()));
    QVERIFY(look.IsValid());
    QVERIFY(look.GetItemData().IsTable());
    const ScriptVal *description = look.GetItemData().FindKeyConst(ScriptVal(1));
    QVERIFY(description);
    QVERIFY(description->IsTable());

    QStringList mentioned;
    CollectNames(*description, mentioned);
    for (const QString &name : names)
        QVERIFY2(mentioned.contains(name), qPrintable(name));
    QCOMPARE(log.Count(), 0);
}

void LookPackTest::missingItemIsNilAndWarnsOnce()
{
    WarningLog log;
    const LookPackItem first("Controls.NoSuchThing.Layout");
    const LookPackItem second("Controls.NoSuchThing.Layout");
    QVERIFY(!first.IsValid());
    QVERIFY(first.GetItemData().IsNil());
    QVERIFY(second.GetItemData().IsNil());
    QVERIFY(!first.GetItemData().FindKeyConst(ScriptVal(1)));
    QCOMPARE(log.CountContaining(QStringLiteral("Controls.NoSuchThing.Layout")), 1);
}

void LookPackTest::imageFiles_data()
{
    QTest::addColumn<QString>("item");
    QTest::addColumn<bool>("present");
    QTest::newRow("knob") << "Controls.Slider.Knob.1" << true;
    QTest::newRow("held knob") << "Controls.Slider.Knob.2" << true;
    QTest::newRow("track") << "Controls.Slider.Track" << true;
    QTest::newRow("reset") << "Controls.Slider.Reset" << true;
    QTest::newRow("colour knob") << "Controls.Color.Knob.4.2" << true;
    QTest::newRow("layout is no image") << "Controls.CheckBox.Layout" << false;
    QTest::newRow("missing") << "Controls.Nothing" << false;
}

void LookPackTest::imageFiles()
{
    QFETCH(QString, item);
    QFETCH(bool, present);
    const QString path = LookPack::Get().FindImageFile(OrbID(item.toStdString()));
    QCOMPARE(!path.isEmpty(), present);
    if (present)
        QVERIFY(QFileInfo(path).isFile());
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

    WarningLog log;
    const LookPack pack(tmp.path());
    QCOMPARE(log.CountContaining(QStringLiteral("LookPack")), 1);
    QCOMPARE(pack.ItemCount(), 1);
    QVERIFY(pack.HasItem("Good"));
}

void LookPackTest::missingFolderGivesEmptyPack()
{
    WarningLog log;
    const LookPack pack(QStringLiteral("/nonexistent/looks"));
    QCOMPARE(pack.ItemCount(), 0);
    QVERIFY(pack.FindItem("Controls.CheckBox.Layout").IsNil());
    QVERIFY(pack.FindImageFile("Controls.Slider.Knob.1").isEmpty());
    QVERIFY(log.Count() >= 1);
}

QTEST_GUILESS_MAIN(LookPackTest)
#include "LookPackTest.moc"
