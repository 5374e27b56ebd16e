#include "ToolFixture.h"

#include "orbane/AutoParam.h"
#include "orbane/ClassIDs.h"
#include "orbane/ImageParam.h"
#include "orbane/Input.h"
#include "orbane/Operator.h"

#include <QLabel>
#include <QtTest>

using namespace Orbane;
using namespace Orbane::Test;

namespace {

const OrbID kImage("ImageControl");

QImage Made(QImage::Format format, QSize size)
{
    QImage image(size, format);
    image.fill(Qt::red);
    return image;
}

} // namespace

class ImageControlTest : public QObject
{
    Q_OBJECT
private slots:
    void initTestCase();
    void info_data();
    void info();
};

void ImageControlTest::initTestCase()
{
    std::string error;
    QVERIFY2(ToolFixture::LoadControls(&error), error.c_str());
}

// What the control says of the image, first as declared, then after the
// Input changes to a 1x1 grey image.
void ImageControlTest::info_data()
{
    QTest::addColumn<QString>("path");
    QTest::addColumn<QImage>("image");
    QTest::addColumn<QString>("text");
    QTest::addColumn<bool>("thumbnail");
    QTest::newRow("RGBA") << "a.png" << Made(QImage::Format_ARGB32, {40, 20}) << "40 x 20, RGBA 8-bit" << true;
    QTest::newRow("RGB") << "b.jpg" << Made(QImage::Format_RGB32, {3, 300}) << "3 x 300, RGB 8-bit" << true;
    QTest::newRow("16-bit grey") << "c.png" << Made(QImage::Format_Grayscale16, {8, 8}) << "8 x 8, Grey 16-bit" << true;
    QTest::newRow("unreadable file") << "/nowhere/missing.exr" << QImage() << "cannot read missing.exr" << false;
    QTest::newRow("no image") << "" << QImage() << "no image" << false;
}

void ImageControlTest::info()
{
    QFETCH(QString, path);
    QFETCH(QImage, image);
    QFETCH(QString, text);
    QFETCH(bool, thumbnail);
    ToolFixture f;
    Input *in = f.tool->AddInput(OrbID("Plate"), "Plate", CLSID_DataType_Image, TagList(),
                                 AutoParam<ImageParam>(OrbString(path.toStdString()), image));
    InputControl *c = f.Create(kImage, {in});
    auto *info = c->findChild<QLabel *>("info");
    auto *thumb = c->findChild<QLabel *>("thumbnail");
    QCOMPARE(info->text(), text);
    QCOMPARE(!thumb->pixmap(Qt::ReturnByValue).isNull(), thumbnail);
    in->SetValue(AutoParam<ImageParam>(OrbString("d.png"), Made(QImage::Format_Grayscale8, {1, 1})),
                 f.doc.GetCurrentTime(), 0, nullptr);
    QCOMPARE(info->text(), QString("1 x 1, Grey 8-bit"));
    QVERIFY(!thumb->pixmap(Qt::ReturnByValue).isNull());
}

QTEST_MAIN(ImageControlTest)
#include "ImageControlTest.moc"
