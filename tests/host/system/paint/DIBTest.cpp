#include "orbane/DIB.h"

#include <QPainter>
#include <QtTest>

using namespace Orbane;

namespace {

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
    // Every device pixel of an empty 10x10 target is red inside `filled` (in
    // logical pixels) and untouched outside it.
    void merge_data()
    {
        QTest::addColumn<qreal>("ratio");
        QTest::addColumn<QRect>("from");
        QTest::addColumn<QRect>("to");
        QTest::addColumn<QRect>("filled");
        QTest::newRow("copies a rectangle") << 1.0 << QRect(0, 0, 2, 3) << QRect(5, 4, 2, 3) << QRect(5, 4, 2, 3);
        QTest::newRow("scales") << 1.0 << QRect(0, 0, 4, 4) << QRect(0, 0, 6, 4) << QRect(0, 0, 6, 4);
        QTest::newRow("at pixel ratio 2") << 2.0 << QRect(1, 1, 2, 2) << QRect(4, 4, 2, 2) << QRect(4, 4, 2, 2);
    }

    void merge()
    {
        QFETCH(qreal, ratio);
        QFETCH(QRect, from);
        QFETCH(QRect, to);
        QFETCH(QRect, filled);
        Held src{Solid(4, 4, Qt::red, ratio)};
        Held dst{new DIB(10, 10, ratio)};
        QVERIFY(src->Merge(*dst, from, to));
        const QImage &image = dst->GetImage();
        const QRect device(filled.topLeft() * ratio, filled.size() * ratio);
        for (int y = 0; y < image.height(); ++y)
            for (int x = 0; x < image.width(); ++x)
                QVERIFY2(image.pixel(x, y) == (device.contains(x, y) ? qRgb(255, 0, 0) : 0u),
                         qPrintable(QString("%1,%2").arg(x).arg(y)));
    }

    void mergeColourKey()
    {
        Held src{new DIB(4, 1)};
        {
            QPainter p(&src->GetImage());
            p.fillRect(0, 0, 2, 1, Qt::red);
            p.fillRect(2, 0, 2, 1, Qt::blue);
        }
        Held dst{Solid(4, 1, Qt::green)};
        src->Merge(*dst, src->Rect(), dst->Rect(), 1.0, OrbColor(0, 0, 255));
        QCOMPARE(At(*dst, 1, 0), QColor(Qt::red));
        QCOMPARE(At(*dst, 2, 0), QColor(Qt::green));
        // The key is applied to a copy: the source itself keeps its blue.
        QCOMPARE(At(*src, 3, 0), QColor(Qt::blue));
    }

    void mergeOpacity()
    {
        Held src{Solid(2, 2, Qt::white)};
        Held dst{new DIB(4, 4)};
        QVERIFY(!src->Merge(*dst, QRect(), dst->Rect()));
        QVERIFY(!src->Merge(*dst, src->Rect(), dst->Rect(), 0.0)); // nothing to draw
        QCOMPARE(At(*dst, 0, 0).alpha(), 0);
        QVERIFY(src->Merge(*dst, src->Rect(), dst->Rect(), 0.25));
        QVERIFY(qAbs(At(*dst, 1, 1).alpha() - 64) <= 1);
    }

    // Sources and results as a row of colour letters.
    void fillStretched_data()
    {
        QTest::addColumn<QByteArray>("source");
        QTest::addColumn<int>("fixed");
        QTest::addColumn<QByteArray>("result");
        QTest::newRow("plain") << QByteArray("rb") << 0 << QByteArray("rrrrbbbb");
        QTest::newRow("fixed ends keep their size") << QByteArray("rgb") << 1 << QByteArray("rggggggggb");
    }

    void fillStretched()
    {
        QFETCH(QByteArray, source);
        QFETCH(int, fixed);
        QFETCH(QByteArray, result);
        const QHash<char, QRgb> colours{{'r', qRgb(255, 0, 0)}, {'g', qRgb(0, 255, 0)}, {'b', qRgb(0, 0, 255)}};
        Held src{new DIB(source.size(), 1)};
        for (int x = 0; x < source.size(); ++x)
            src->GetImage().setPixel(x, 0, colours[source[x]]);
        Held dst{new DIB(result.size(), 2)};
        dst->SetAntiAlias(false);
        QVERIFY(dst->FillStretched(*src, QMargins(fixed, 0, fixed, 0)));
        for (int y = 0; y < 2; ++y)
            for (int x = 0; x < result.size(); ++x)
                QCOMPARE(At(*dst, x, y), QColor(colours[result[x]]));
    }

    void adjustHLS_data()
    {
        QTest::addColumn<QColor>("before");
        QTest::addColumn<int>("hue");
        QTest::addColumn<int>("lightness");
        QTest::addColumn<int>("saturation");
        QTest::addColumn<QColor>("after");
        QTest::newRow("grey lighter") << QColor(128, 128, 128) << 0 << 20 << 0 << QColor(179, 179, 179);
        QTest::newRow("lightness clamps at white") << QColor(240, 240, 240) << 0 << 50 << 0 << QColor(255, 255, 255);
        QTest::newRow("red turned to green") << QColor(255, 0, 0) << 120 << 0 << 0 << QColor(0, 255, 0);
        QTest::newRow("hue wraps backwards") << QColor(255, 0, 0) << -120 << 0 << 0 << QColor(0, 0, 255);
        QTest::newRow("no saturation is grey") << QColor(255, 0, 0) << 0 << 0 << -100 << QColor(128, 128, 128);
        QTest::newRow("transparent stays") << QColor(0, 0, 0, 0) << 30 << 50 << 50 << QColor(0, 0, 0, 0);
        QTest::newRow("alpha kept") << QColor(128, 128, 128, 128) << 0 << 20 << 0 << QColor(179, 179, 179, 128);
    }

    void adjustHLS()
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
};

QTEST_MAIN(DIBTest)
#include "DIBTest.moc"
