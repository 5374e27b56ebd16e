#include "orbane/DIB.h"

#include <QPainter>
#include <QTemporaryDir>
#include <QtTest>

using namespace Orbane;

namespace {

// A DIB filled with one colour.
DIB *Solid(int w, int h, const QColor &c, qreal ratio = 1.0)
{
    DIB *dib = new DIB(w, h, ratio);
    dib->Fill(c);
    return dib;
}

// The colour of logical pixel (x, y), read from its first device pixel.
QColor At(const DIB &dib, int x, int y)
{
    const qreal r = dib.PixelRatio();
    return dib.GetImage().pixelColor(int(x * r), int(y * r));
}

// Recycles on scope exit, so a failing check leaks nothing.
struct Held
{
    DIB *dib;
    ~Held() { dib->Recycle(); }
    DIB *operator->() const { return dib; }
    DIB &operator*() const { return *dib; }
};

} // namespace

class DIBTest : public QObject
{
    Q_OBJECT
private slots:
    void construction_data();
    void construction();
    void useAndRecycle();
    void mergeCopiesRectangle();
    void mergeOpacity_data();
    void mergeOpacity();
    void mergeColourKey();
    void mergeAtPixelRatio();
    void mergeScales();
    void mergeRefusesEmpty();
    void fillStretchedPlain();
    void fillStretchedKeepsEdges();
    void adjustHLS_data();
    void adjustHLS();
    void adjustKeepsTransparent();
    void copyIsIndependent();
    void fromFileSvg();
    void fromResource();
};

void DIBTest::construction_data()
{
    QTest::addColumn<int>("w");
    QTest::addColumn<int>("h");
    QTest::addColumn<qreal>("ratio");
    QTest::addColumn<QSize>("device");
    QTest::newRow("plain") << 10 << 4 << 1.0 << QSize(10, 4);
    QTest::newRow("double density") << 10 << 4 << 2.0 << QSize(20, 8);
    QTest::newRow("fractional ratio rounds up") << 5 << 3 << 1.5 << QSize(8, 5);
    QTest::newRow("empty") << 0 << 4 << 1.0 << QSize(0, 0);
}

void DIBTest::construction()
{
    QFETCH(int, w);
    QFETCH(int, h);
    QFETCH(qreal, ratio);
    QFETCH(QSize, device);
    Held dib{new DIB(w, h, ratio)};
    QCOMPARE(dib->Width(), w);
    QCOMPARE(dib->Height(), h);
    QCOMPARE(dib->GetImage().size(), device);
    QCOMPARE(dib->IsValid(), !device.isEmpty());
    if (dib->IsValid()) {
        QCOMPARE(dib->PixelRatio(), ratio);
        QCOMPARE(qAlpha(dib->GetImage().pixel(0, 0)), 0);
    }
}

void DIBTest::useAndRecycle()
{
    DIB *dib = new DIB(2, 2);
    QCOMPARE(dib->UseCount(), 1);
    dib->Use();
    dib->Use();
    QCOMPARE(dib->UseCount(), 3);
    dib->Recycle();
    dib->Recycle();
    QCOMPARE(dib->UseCount(), 1);
    dib->Recycle(); // the last use deletes; the sanitizer run catches a leak or double free
}

void DIBTest::mergeCopiesRectangle()
{
    Held src{Solid(4, 4, Qt::red)};
    Held dst{new DIB(8, 8)};
    QVERIFY(src->Merge(*dst, QRect(0, 0, 2, 3), QRect(5, 4, 2, 3)));
    QCOMPARE(At(*dst, 5, 4), QColor(Qt::red));
    QCOMPARE(At(*dst, 6, 6), QColor(Qt::red));
    QCOMPARE(At(*dst, 4, 4).alpha(), 0);
    QCOMPARE(At(*dst, 7, 4).alpha(), 0);
    QCOMPARE(At(*dst, 5, 7).alpha(), 0);
}

void DIBTest::mergeOpacity_data()
{
    QTest::addColumn<qreal>("opacity");
    QTest::addColumn<int>("alpha");
    QTest::newRow("full") << 1.0 << 255;
    QTest::newRow("half") << 0.5 << 128;
    QTest::newRow("quarter") << 0.25 << 64;
}

void DIBTest::mergeOpacity()
{
    QFETCH(qreal, opacity);
    QFETCH(int, alpha);
    Held src{Solid(2, 2, Qt::white)};
    Held dst{new DIB(2, 2)};
    src->Merge(*dst, src->Rect(), dst->Rect(), opacity);
    QVERIFY(qAbs(At(*dst, 1, 1).alpha() - alpha) <= 1);
}

void DIBTest::mergeColourKey()
{
    Held src{new DIB(4, 1)};
    {
        QPainter p(&src->GetImage());
        p.fillRect(0, 0, 2, 1, Qt::red);
        p.fillRect(2, 0, 2, 1, Qt::blue);
    }
    Held dst{Solid(4, 1, Qt::green)};
    src->Merge(*dst, src->Rect(), dst->Rect(), 1.0, OrbColor(0, 0, 255));
    QCOMPARE(At(*dst, 0, 0), QColor(Qt::red));
    QCOMPARE(At(*dst, 1, 0), QColor(Qt::red));
    QCOMPARE(At(*dst, 2, 0), QColor(Qt::green));
    QCOMPARE(At(*dst, 3, 0), QColor(Qt::green));
    // The key is applied to a copy: the source itself keeps its blue.
    QCOMPARE(At(*src, 3, 0), QColor(Qt::blue));
}

void DIBTest::mergeAtPixelRatio()
{
    Held src{Solid(3, 3, Qt::red, 2.0)};
    Held dst{new DIB(10, 10, 2.0)};
    src->Merge(*dst, QRect(1, 1, 2, 2), QRect(4, 4, 2, 2));
    const QImage &img = dst->GetImage();
    QCOMPARE(QColor::fromRgba(img.pixel(8, 8)), QColor(Qt::red));
    QCOMPARE(QColor::fromRgba(img.pixel(11, 11)), QColor(Qt::red));
    QCOMPARE(qAlpha(img.pixel(7, 8)), 0);
    QCOMPARE(qAlpha(img.pixel(12, 12)), 0);
}

void DIBTest::mergeScales()
{
    Held src{Solid(2, 2, Qt::blue)};
    Held dst{new DIB(8, 8)};
    src->Merge(*dst, src->Rect(), QRect(0, 0, 6, 4));
    QCOMPARE(At(*dst, 5, 3), QColor(Qt::blue));
    QCOMPARE(At(*dst, 6, 3).alpha(), 0);
    QCOMPARE(At(*dst, 5, 4).alpha(), 0);
}

void DIBTest::mergeRefusesEmpty()
{
    Held src{Solid(2, 2, Qt::blue)};
    Held dst{new DIB(4, 4)};
    QVERIFY(!src->Merge(*dst, QRect(), dst->Rect()));
    QVERIFY(!src->Merge(*dst, src->Rect(), QRect(0, 0, 0, 3)));
    QVERIFY(!src->Merge(*dst, src->Rect(), dst->Rect(), 0.0));
    QCOMPARE(At(*dst, 0, 0).alpha(), 0);
}

void DIBTest::fillStretchedPlain()
{
    Held src{new DIB(2, 1)};
    src->GetImage().setPixel(0, 0, qRgb(255, 0, 0));
    src->GetImage().setPixel(1, 0, qRgb(0, 0, 255));
    src->SetAntiAlias(false);
    Held dst{new DIB(8, 2)};
    dst->SetAntiAlias(false);
    QVERIFY(dst->FillStretched(*src));
    for (int x = 0; x < 4; ++x)
        QCOMPARE(At(*dst, x, 1), QColor(Qt::red));
    for (int x = 4; x < 8; ++x)
        QCOMPARE(At(*dst, x, 0), QColor(Qt::blue));
}

void DIBTest::fillStretchedKeepsEdges()
{
    // Caps of one pixel on each side, a green middle that stretches.
    Held src{new DIB(3, 1)};
    src->GetImage().setPixel(0, 0, qRgb(255, 0, 0));
    src->GetImage().setPixel(1, 0, qRgb(0, 255, 0));
    src->GetImage().setPixel(2, 0, qRgb(0, 0, 255));
    Held dst{new DIB(10, 1)};
    dst->SetAntiAlias(false);
    QVERIFY(dst->FillStretched(*src, QMargins(1, 0, 1, 0)));
    QCOMPARE(At(*dst, 0, 0), QColor(Qt::red));
    for (int x = 1; x < 9; ++x)
        QCOMPARE(At(*dst, x, 0), QColor(Qt::green));
    QCOMPARE(At(*dst, 9, 0), QColor(Qt::blue));
}

void DIBTest::adjustHLS_data()
{
    QTest::addColumn<QColor>("before");
    QTest::addColumn<int>("hue");
    QTest::addColumn<int>("lightness");
    QTest::addColumn<int>("saturation");
    QTest::addColumn<QColor>("after");
    QTest::newRow("grey lighter") << QColor(128, 128, 128) << 0 << 20 << 0 << QColor(179, 179, 179);
    QTest::newRow("grey darker") << QColor(128, 128, 128) << 0 << -20 << 0 << QColor(77, 77, 77);
    QTest::newRow("lightness clamps at white") << QColor(240, 240, 240) << 0 << 50 << 0 << QColor(255, 255, 255);
    QTest::newRow("red turned to green") << QColor(255, 0, 0) << 120 << 0 << 0 << QColor(0, 255, 0);
    QTest::newRow("hue wraps backwards") << QColor(255, 0, 0) << -120 << 0 << 0 << QColor(0, 0, 255);
    QTest::newRow("no saturation is grey") << QColor(255, 0, 0) << 0 << 0 << -100 << QColor(128, 128, 128);
    QTest::newRow("alpha kept") << QColor(128, 128, 128, 128) << 0 << 20 << 0 << QColor(179, 179, 179, 128);
}

void DIBTest::adjustHLS()
{
    QFETCH(QColor, before);
    QFETCH(int, hue);
    QFETCH(int, lightness);
    QFETCH(int, saturation);
    QFETCH(QColor, after);
    Held dib{Solid(2, 2, before)};
    dib->AdjustHLS(hue, lightness, saturation);
    const QColor got = At(*dib, 1, 1);
    // Premultiplied storage loses a little at partial alpha.
    QVERIFY2(qAbs(got.red() - after.red()) <= 2 && qAbs(got.green() - after.green()) <= 2 &&
                 qAbs(got.blue() - after.blue()) <= 2 && got.alpha() == after.alpha(),
             qPrintable(got.name(QColor::HexArgb)));
}

void DIBTest::adjustKeepsTransparent()
{
    Held dib{new DIB(2, 2)};
    dib->AdjustHLS(30, 50, 50);
    QCOMPARE(dib->GetImage().pixel(0, 0), 0u);
}

void DIBTest::copyIsIndependent()
{
    Held dib{Solid(3, 2, Qt::red, 2.0)};
    Held copy{dib->Copy()};
    QCOMPARE(copy->Width(), 3);
    QCOMPARE(copy->Height(), 2);
    QCOMPARE(copy->PixelRatio(), 2.0);
    QCOMPARE(copy->UseCount(), 1);
    copy->Fill(Qt::blue);
    QCOMPARE(At(*dib, 0, 0), QColor(Qt::red));
}

void DIBTest::fromFileSvg()
{
    QTemporaryDir dir;
    const QString path = dir.filePath("box.svg");
    QFile file(path);
    QVERIFY(file.open(QIODevice::WriteOnly));
    file.write("<svg xmlns='http://www.w3.org/2000/svg' width='6' height='4'>"
               "<rect width='6' height='4' fill='#ff0000'/></svg>");
    file.close();
    Held dib{DIB::FromFile(path, 2.0)};
    QCOMPARE(dib->Width(), 6);
    QCOMPARE(dib->Height(), 4);
    QCOMPARE(dib->GetImage().size(), QSize(12, 8));
    QCOMPARE(At(*dib, 3, 2), QColor(Qt::red));
    QVERIFY(!DIB::FromFile(dir.filePath("missing.svg"), 1.0));
}

void DIBTest::fromResource()
{
    DIB *knob = DIB::FromResource("Controls.Slider.Knob.1", 2.0);
    QVERIFY2(knob, "the default look pack has the slider knob");
    Held held{knob};
    QVERIFY(knob->Width() > 0 && knob->Height() > 0);
    QCOMPARE(knob->PixelRatio(), 2.0);
    QCOMPARE(knob->GetImage().width(), knob->Width() * 2);
    QVERIFY(!DIB::FromResource("Controls.NoSuchImage", 1.0));
    QVERIFY(!DIB::FromResource(nullptr, 1.0));
}

QTEST_MAIN(DIBTest)
#include "DIBTest.moc"
