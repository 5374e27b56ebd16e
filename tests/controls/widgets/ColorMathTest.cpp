#include "widgets/ColorMath.h"

#include "orbane/ColourSpaces.h"

#include <QtTest>

#include <cmath>

using namespace Orbane;

Q_DECLARE_METATYPE(Orbane::ColorRGBA)
Q_DECLARE_METATYPE(Orbane::ColorTriple)

namespace {

// Conversions are exact up to float rounding; three decimals is what the
// control shows, so a looser match would hide a visible error.
constexpr double kTolerance = 1e-3;

bool Near(double a, double b)
{
    return std::fabs(a - b) <= kTolerance;
}

} // namespace

class ColorMathTest : public QObject
{
    Q_OBJECT
private slots:
    void models_data();
    void models();
    void hex_data();
    void hex();
};

// Each model from RGB and back; the triples are the textbook values.
void ColorMathTest::models_data()
{
    QTest::addColumn<ColorRGBA>("rgb");
    QTest::addColumn<int>("model");
    QTest::addColumn<ColorTriple>("triple");
    const int hsv = ColorMath::Model_HSV, hls = ColorMath::Model_HLS, yuv = ColorMath::Model_YUV;
    QTest::newRow("HSV red") << ColorRGBA{1, 0, 0, 1} << hsv << ColorTriple{{0, 1, 1}};
    QTest::newRow("HSV violet") << ColorRGBA{0.5, 0.25, 0.75, 1} << hsv << ColorTriple{{270, 2.0 / 3.0, 0.75}};
    QTest::newRow("HSV grey has no hue") << ColorRGBA{0.4, 0.4, 0.4, 1} << hsv << ColorTriple{{0, 0, 0.4}};
    QTest::newRow("HSV HDR keeps its value") << ColorRGBA{2, 1, 0, 1} << hsv << ColorTriple{{30, 1, 2}};
    QTest::newRow("HLS red") << ColorRGBA{1, 0, 0, 1} << hls << ColorTriple{{0, 0.5, 1}};
    QTest::newRow("HLS teal") << ColorRGBA{0.2, 0.6, 0.6, 1} << hls << ColorTriple{{180, 0.4, 0.5}};
    QTest::newRow("HLS white") << ColorRGBA{1, 1, 1, 1} << hls << ColorTriple{{0, 1, 0}};
    QTest::newRow("YUV white") << ColorRGBA{1, 1, 1, 1} << yuv << ColorTriple{{1, 0, 0}};
    QTest::newRow("YUV blue") << ColorRGBA{0, 0, 1, 1} << yuv
                              << ColorTriple{{0.0722, 0.5, -0.0722 / (2 * (1 - 0.2126))}};
    QTest::newRow("YUV red") << ColorRGBA{1, 0, 0, 1} << yuv
                             << ColorTriple{{0.2126, -0.2126 / (2 * (1 - 0.0722)), 0.5}};
}

void ColorMathTest::models()
{
    QFETCH(ColorRGBA, rgb);
    QFETCH(int, model);
    QFETCH(ColorTriple, triple);
    const ColorTriple got = ColorMath::ToModel(rgb, model);
    for (int i = 0; i < 3; ++i)
        QVERIFY2(Near(got.c[i], triple.c[i]), qPrintable(QString("channel %1: %2").arg(i).arg(got.c[i])));
    const ColorRGBA back = ColorMath::FromModel(got, model, 0.25);
    QVERIFY(Near(back.r, rgb.r) && Near(back.g, rgb.g) && Near(back.b, rgb.b));
    QCOMPARE(back.a, 0.25);
}

// Hex codes are the sRGB encoding of the linear value: a code read and
// written again is the same code.
void ColorMathTest::hex_data()
{
    QTest::addColumn<QString>("text");
    QTest::addColumn<bool>("valid");
    QTest::addColumn<QString>("written");
    QTest::addColumn<double>("red");
    QTest::newRow("six digits") << "#FF8000" << true << "#FF8000FF" << 1.0;
    QTest::newRow("no hash, lower case") << "80c0ff" << true << "#80C0FFFF" << 0.2158605;
    QTest::newRow("three digits") << "#f00" << true << "#FF0000FF" << 1.0;
    QTest::newRow("eight digits carry alpha") << "#00000080" << true << "#00000080" << 0.0;
    QTest::newRow("too short") << "#FF80" << false << "#333333FF" << 0.0331048;
    QTest::newRow("not hex") << "#GG0000" << false << "#333333FF" << 0.0331048;
}

void ColorMathTest::hex()
{
    QFETCH(QString, text);
    QFETCH(bool, valid);
    QFETCH(QString, written);
    QFETCH(double, red);
    const double grey = ColourSpaces::SrgbToLinear(0x33 / 255.0);
    ColorRGBA c{grey, grey, grey, 1.0};
    QCOMPARE(ColorMath::FromHex(text, c), valid);
    QVERIFY2(std::fabs(c.r - red) < 1e-6, qPrintable(QString::number(c.r, 'g', 8)));
    QCOMPARE(ColorMath::ToHex(c, true), written);
}

QTEST_GUILESS_MAIN(ColorMathTest)
#include "ColorMathTest.moc"
